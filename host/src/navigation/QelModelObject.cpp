#include "QelModelObject.h"

#include "QelMetaObject.h"

const QelMetaObject& QelModelObject::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelModelObject", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelProductNavigation");
  return meta;
}
const QelMetaObject* QelModelObject::GetMetaObject() const { return &MetaObject(); }

QelModelObject::QelModelObject(std::string alias, std::string icon, bool shown)
    : alias_(std::move(alias)), icon_(std::move(icon)), shown_(shown) {}
QelModelObject::~QelModelObject() = default;

HRESULT QelModelObject::GetAlias(QelUnicodeString& alias) {
  alias = QelUnicodeString(alias_);
  return S_OK;
}

HRESULT QelModelObject::GetIconName(QelUnicodeString& name) {
  name = QelUnicodeString(icon_);
  return S_OK;
}

void* QelModelObject::QueryDirect(const QelIID& iid) {
  if (iid == ClassIID) return this;
  if (void* mine = QelQueryDirect<QelIAlias, QelIIcon>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}
