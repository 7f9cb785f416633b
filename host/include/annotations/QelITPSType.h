#pragma once
// The type object of an annotation, given by the type classifier; fourth operation: the
// integer type code.
#include "QelUnicodeString.h"
#include "QelVar.h"

class QelITPSType : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSType;
  static constexpr QelIID IID = QelIID::Parse("{80B7FAA2-A455-4817-88BD-EA77F62069C1}");

  virtual HRESULT GetTypeName(QelUnicodeString& name) = 0;
  virtual HRESULT GetSubTypeName(QelUnicodeString& name) = 0;
  virtual HRESULT IsTextOrDimensionVisu(bool& visu) = 0;
  virtual HRESULT GetTypeCode(int& code) = 0;

 protected:
  ~QelITPSType() override = default;
};
