#pragma once
// Annotation component 59, the naming component: an annotation's sub-type name and,
// declared right after it, its type name.
#include "QelString.h"
#include "QelUnicodeString.h"
#include "QelVar.h"

class QelILumNamingComponent : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumNamingComponent;
  static constexpr QelIID IID = QelIID::Parse("{034B5D82-3814-4AA5-8D61-EA0EAB264051}");

  virtual HRESULT GetTypeCodeName(QelBaseUnknown* annotation, QelString& codeName) = 0;
  virtual HRESULT GetSubTypeName(QelBaseUnknown* annotation, QelUnicodeString& name) = 0;
  virtual HRESULT GetTypeName(QelBaseUnknown* annotation, QelUnicodeString& name) = 0;

 protected:
  ~QelILumNamingComponent() override = default;
};
