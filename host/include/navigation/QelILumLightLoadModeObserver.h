#pragma once
// Told when the light-load mode of an observed set owner changes.
#include "QelVar.h"

class QelILumLightLoadModeObserver : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumLightLoadModeObserver;
  static constexpr QelIID IID = QelIID::Parse("{03A57D44-9FB3-4386-A0B6-7C1245DD6B94}");

  virtual HRESULT OnLightLoadModeChanged() = 0;

 protected:
  ~QelILumLightLoadModeObserver() override = default;
};
