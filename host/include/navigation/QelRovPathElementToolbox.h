#pragma once
// QelRovPathElementToolbox: geometry read along a path of the product tree. Static
// operations only; they keep no reference on the path or its elements once they return,
// and never throw.
#include "QelMathTransformation.h"
#include "QelStatus.h"

class QelPathElement;

class QelRovPathElementToolbox {
 public:
  QelRovPathElementToolbox() = delete;

  // From the coordinates of the path's part (its last product occurrence; rep instances,
  // sets, captures and other non-product elements are passed over) to those of its context
  // (the first product occurrence, normally the root). `transformation` is the identity
  // first and stays so on E_FAIL: a null or empty path, or one without a product occurrence.
  static HRESULT GetMechPartToContextTransfo(QelPathElement* path, QelMathTransformation& transformation);
};
