#pragma once
// QelIDMUPersistencySupportOwner: an object stored inside a persistency support (a DMU
// validation, for one) names the object that owns that support.
#include "QelVar.h"

class QelIDMUPersistencySupportOwner : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDMUPersistencySupportOwner;
  static constexpr QelIID IID = QelIID::Parse("{D522C26E-B7BA-4C87-800F-ACC4C824F98D}");

  // The owning object, or null.
  virtual QelBaseUnknown_var GetSupportOwner() = 0;

 protected:
  ~QelIDMUPersistencySupportOwner() override = default;
};
