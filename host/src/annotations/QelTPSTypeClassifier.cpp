#include "QelTPSTypeClassifier.h"

#include "QelLumAnnotation.h"
#include "QelMetaObject.h"
#include "QelTPSAnnotationType.h"

const QelMetaObject& QelTPSTypeClassifier::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelTPSTypeClassifier", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelTPSTypeClassifier::GetMetaObject() const { return &MetaObject(); }

QelTPSTypeClassifier::~QelTPSTypeClassifier() = default;

void* QelTPSTypeClassifier::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelITPSTypeClassifier>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelTPSTypeClassifier::GetTypeCount(int& count) {
  count = kLastTypeCode - kFirstTypeCode + 1;
  return S_OK;
}

HRESULT QelTPSTypeClassifier::IsKnownTypeCode(int code, bool& known) {
  known = code >= kFirstTypeCode && code <= kLastTypeCode;
  return S_OK;
}

HRESULT QelTPSTypeClassifier::GetType(QelBaseUnknown* annotation, QelBaseUnknown_var& type) {
  type = nullptr;
  QelLumAnnotation* found = QelLumAnnotation::From(annotation);
  if (!found) return E_FAIL;
  type = QelBaseUnknown_var::Adopt(new QelTPSAnnotationType(found));
  return S_OK;
}
