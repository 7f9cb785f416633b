#include "QelTPSAnnotationType.h"

#include "QelLumAnnotation.h"
#include "QelMetaObject.h"

const QelMetaObject& QelTPSAnnotationType::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelTPSAnnotationType", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelTPSAnnotationType::GetMetaObject() const { return &MetaObject(); }

QelTPSAnnotationType::QelTPSAnnotationType(QelLumAnnotation* annotation)
    : annotation_(QelVar<QelLumAnnotation>::Retain(annotation)) {}
QelTPSAnnotationType::~QelTPSAnnotationType() = default;

void* QelTPSAnnotationType::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelITPSType>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelTPSAnnotationType::GetTypeName(QelUnicodeString& name) {
  name = QelUnicodeString(annotation_->TypeName());
  return S_OK;
}

HRESULT QelTPSAnnotationType::GetSubTypeName(QelUnicodeString& name) {
  name = QelUnicodeString(annotation_->SubTypeName());
  return S_OK;
}

HRESULT QelTPSAnnotationType::IsTextOrDimensionVisu(bool& visu) {
  visu = annotation_->Visu() != QelAnnotationVisu::None;
  return S_OK;
}

HRESULT QelTPSAnnotationType::GetTypeCode(int& code) {
  code = annotation_->TypeCode();
  return S_OK;
}
