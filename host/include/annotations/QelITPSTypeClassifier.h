#pragma once
// The annotation type classifier, reached from an annotation (third operation of
// QelITPS, eighth of QelILumGeometry). Third operation: an annotation's type object.
#include "QelVar.h"

class QelITPSTypeClassifier : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSTypeClassifier;
  static constexpr QelIID IID = QelIID::Parse("{B3F77E4C-697A-11D6-BE57-0002B33BD2CE}");

  virtual HRESULT GetTypeCount(int& count) = 0;
  virtual HRESULT IsKnownTypeCode(int code, bool& known) = 0;
  virtual HRESULT GetType(QelBaseUnknown* annotation, QelBaseUnknown_var& type) = 0;

 protected:
  ~QelITPSTypeClassifier() override = default;
};
