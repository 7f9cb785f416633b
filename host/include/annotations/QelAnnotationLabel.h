#pragma once
// QelAnnotationLabel: what an annotation says, as a person reads it (a tolerance frame's
// compartments, a dimension's nominal and tolerance, a datum's letter), and the length
// unit its model's values are in. For hosts that see annotations through interfaces only.
#include <string>

#include "QelBaseUnknown.h"

class QelAnnotationLabel {
 public:
  // "⌖ | ⌀0.75 Ⓜ | A | B", "⌀35 +0 -0.2": what a tolerance frame or a dimension value
  // says; empty for an annotation that says no more than its name (a datum, a note) and
  // for an object that is no annotation of a model.
  static std::string Text(QelBaseUnknown* annotation);
  // "mm", "in"...: the unit of the model any object belongs to; empty when it names none.
  static std::string LengthUnit(QelBaseUnknown* modelObject);
};
