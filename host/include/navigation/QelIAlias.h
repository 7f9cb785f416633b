#pragma once
// The display name of a host object (product, set, annotation, view, capture).
#include "QelUnicodeString.h"
#include "QelVar.h"

class QelIAlias : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIAlias;
  static constexpr QelIID IID = QelIID::Parse("{6CA07506-1EA4-4593-B684-2E513E70ECB5}");

  virtual HRESULT GetAlias(QelUnicodeString& alias) = 0;

 protected:
  ~QelIAlias() override = default;
};
