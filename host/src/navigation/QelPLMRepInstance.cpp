#include "QelPLMRepInstance.h"

#include "QelMetaObject.h"
#include "QelPLMRepReference.h"

const QelMetaObject& QelPLMRepInstance::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelPLMRepInstance", QelMetaKind::Implementation, &QelModelObject::MetaObject(), "QelProductNavigation");
  return meta;
}
const QelMetaObject* QelPLMRepInstance::GetMetaObject() const { return &MetaObject(); }

QelPLMRepInstance::QelPLMRepInstance(QelBaseUnknown* product, std::string alias, std::string icon,
                                     QelPLMRepReference* reference)
    : QelModelObject(std::move(alias), std::move(icon), true),
      product_(product),
      reference_(QelVar<QelPLMRepReference>::Retain(reference)) {
  if (reference) reference->SetInstance(static_cast<QelIPLMNavRepInstance*>(this));
}
QelPLMRepInstance::~QelPLMRepInstance() = default;

void* QelPLMRepInstance::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIPLMNavRepInstance, QelIPLMNavRepOccurrence>(this, iid)) return mine;
  return QelModelObject::QueryDirect(iid);
}

QelBaseUnknown_var QelPLMRepInstance::GetReferencedObject() {
  return QelBaseUnknown_var(static_cast<QelModelObject*>(reference_.get()));
}

HRESULT QelPLMRepInstance::GetFather(QelBaseUnknown_var& product) {
  product = product_.Get();
  return product ? S_OK : S_FALSE;
}

HRESULT QelPLMRepInstance::GetRepReference(QelBaseUnknown_var& reference) {
  reference = GetReferencedObject();
  return reference ? S_OK : E_FAIL;
}
