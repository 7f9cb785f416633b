#pragma once
// Navigation names of an annotation: the identifiers a reviewer knows it by.
#include "QelListValQelUnicodeString.h"
#include "QelVar.h"

class QelINavigateObject : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelINavigateObject;
  static constexpr QelIID IID = QelIID::Parse("{BB57DE10-CCAF-4B92-9A5B-46187E9F0031}");

  // A newly allocated list (possibly empty) that the caller deletes; never null.
  virtual QelListValQelUnicodeString* GetIdentificators() = 0;

 protected:
  ~QelINavigateObject() override = default;
};
