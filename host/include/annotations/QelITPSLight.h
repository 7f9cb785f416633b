#pragma once
// Marks a view or capture of a light annotation set.
#include "QelVar.h"

class QelITPSLight : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSLight;
  static constexpr QelIID IID = QelIID::Parse("{E0C56DEF-9204-4DD2-8E71-54FAB0EE91E3}");

 protected:
  ~QelITPSLight() override = default;
};
