#include "QelLumNamingComponent.h"

#include <string>

#include "QelLumAnnotation.h"
#include "QelMetaObject.h"

const QelMetaObject& QelLumNamingComponent::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumNamingComponent", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumNamingComponent::GetMetaObject() const { return &MetaObject(); }

QelLumNamingComponent::~QelLumNamingComponent() = default;

void* QelLumNamingComponent::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelILumNamingComponent>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelLumNamingComponent::GetTypeCodeName(QelBaseUnknown* annotation, QelString& codeName) {
  QelLumAnnotation* found = QelLumAnnotation::From(annotation);
  if (!found) return E_FAIL;
  codeName = QelString("TypeCode" + std::to_string(found->TypeCode()));
  return S_OK;
}

HRESULT QelLumNamingComponent::GetSubTypeName(QelBaseUnknown* annotation, QelUnicodeString& name) {
  QelLumAnnotation* found = QelLumAnnotation::From(annotation);
  if (!found) return E_FAIL;
  name = QelUnicodeString(found->SubTypeName());
  return S_OK;
}

HRESULT QelLumNamingComponent::GetTypeName(QelBaseUnknown* annotation, QelUnicodeString& name) {
  QelLumAnnotation* found = QelLumAnnotation::From(annotation);
  if (!found) return E_FAIL;
  name = QelUnicodeString(found->TypeName());
  return S_OK;
}
