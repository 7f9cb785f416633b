#pragma once
// QelSYP: toolkit-wide operations on introspectable objects.
#include "QelBaseUnknown.h"

class QelSYP {
 public:
  // Re-reads every bound property of the object's style into its parts (all bindings,
  // not one property). E_FAIL when the object is no styled toolkit control.
  static HRESULT LoadResources(QelBaseUnknown* introspectable);

  QelSYP() = delete;
};
