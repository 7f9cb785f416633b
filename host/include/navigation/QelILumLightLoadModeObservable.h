#pragma once
// The owner of light annotation sets: it tells its observers when its light-load mode
// changes. Observers are held weakly: one that goes away unremoved is skipped, never kept alive.
#include "QelVar.h"

class QelILumLightLoadModeObservable : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumLightLoadModeObservable;
  static constexpr QelIID IID = QelIID::Parse("{AAA2AD96-CA06-4080-92B6-2A9A92E802FE}");

  virtual HRESULT AddObserver(QelBaseUnknown* observer) = 0;
  virtual HRESULT RemoveObserver(QelBaseUnknown* observer) = 0;
  virtual HRESULT IsLightLoadMode(bool& on) = 0;
  // Notifies the observers when the mode really changes (S_FALSE otherwise).
  virtual HRESULT SetLightLoadMode(bool on) = 0;

 protected:
  ~QelILumLightLoadModeObservable() override = default;
};
