#include "QelRovFacetPropertyItem.h"

#include "QelIIcon.h"
#include "QelRovFacetServices.h"

const QelUnicodeString QelRovFacetPropertyItem::IconPrefix("normal\\");

const QelMetaObject& QelRovFacetPropertyItem::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelRovFacetPropertyItem", QelMetaKind::Implementation,
                             &QelRovFacetProperty::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetPropertyItem::GetMetaObject() const { return &MetaObject(); }

QelRovFacetPropertyItem::QelRovFacetPropertyItem(const QelUnicodeString& name, QelBaseUnknown* owner)
    : QelRovFacetProperty(name, QelUnicodeString(), owner) {
  SetFlags(FlagsCheckBox);
}

QelRovFacetPropertyItem::~QelRovFacetPropertyItem() = default;

HRESULT QelRovFacetPropertyItem::ApplyCheckState() { return S_OK; }

HRESULT QelRovFacetPropertyItem::RefreshCheckState() {
  if (QelBaseUnknown_var object = object_.Get()) SetCheckState(QelRovFacetServices::IsDisplayEnabled(object.get()));
  return S_OK;
}

int32_t QelRovFacetPropertyItem::CountItems() { return 1; }

HRESULT QelRovFacetPropertyItem::GetChildren(QelListValQelBaseUnknown_var&) { return E_NOTIMPL; }

HRESULT QelRovFacetPropertyItem::UpdateName() { return S_OK; }

bool QelRovFacetPropertyItem::SetIconFrom(QelBaseUnknown* source) {
  QelVar<QelIIcon> icon = source;
  if (!icon) return false;
  QelUnicodeString name;
  icon->GetIconName(name);
  SetIconName(IconPrefix + name);
  return true;
}
