#include "QelPLMRepReference.h"

#include "QelMetaObject.h"

const QelMetaObject& QelPLMRepReference::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelPLMRepReference", QelMetaKind::Implementation, &QelModelObject::MetaObject(), "QelProductNavigation");
  return meta;
}
const QelMetaObject* QelPLMRepReference::GetMetaObject() const { return &MetaObject(); }

QelPLMRepReference::QelPLMRepReference(std::string alias, std::string icon)
    : QelModelObject(std::move(alias), std::move(icon), true) {}
QelPLMRepReference::~QelPLMRepReference() = default;
