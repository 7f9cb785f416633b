#pragma once
// Marks an annotation set loaded in light (lightweight) mode; its owner answers
// QelILumLightLoadModeObservable.
#include "QelVar.h"

class QelITPSLightSet : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSLightSet;
  static constexpr QelIID IID = QelIID::Parse("{66664499-6EA0-41CF-9582-10E11DE95351}");

 protected:
  ~QelITPSLightSet() override = default;
};
