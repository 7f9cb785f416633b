#pragma once
// QelTPSAnnotationType: the type object of one annotation, as the classifier gives it. A
// short-lived counted object that holds its annotation until released.
#include "QelITPSType.h"

class QelLumAnnotation;

class QelTPSAnnotationType : public QelITPSType {
 public:
  explicit QelTPSAnnotationType(QelLumAnnotation* annotation);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetTypeName(QelUnicodeString& name) override;
  HRESULT GetSubTypeName(QelUnicodeString& name) override;
  HRESULT IsTextOrDimensionVisu(bool& visu) override;
  HRESULT GetTypeCode(int& code) override;

 protected:
  ~QelTPSAnnotationType() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelVar<QelLumAnnotation> annotation_;
};
