#pragma once
// The icon name of a host object, without any prefix (the caller adds its own).
#include "QelUnicodeString.h"
#include "QelVar.h"

class QelIIcon : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIIcon;
  static constexpr QelIID IID = QelIID::Parse("{C9EA80C3-DE43-4CFC-A894-BD2EEC255225}");

  virtual HRESULT GetIconName(QelUnicodeString& name) = 0;

 protected:
  ~QelIIcon() override = default;
};
