#include "QelRovFacetPropertyItem.h"

#include "QelAssert.h"
#include "QelIAlias.h"
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
  if (QelBaseUnknown_var object = object_.Get()) ReadStateFromDisplay(object.get());
  return S_OK;
}

HRESULT QelRovFacetPropertyItem::ReadStateFromDisplay(QelBaseUnknown* object) {
  const HRESULT shown = QelRovFacetServices::IsDisplayEnabled(object);
  if (shown >= 0) SetCheckState(shown);
  return shown;
}

int32_t QelRovFacetPropertyItem::CountItems() { return 1; }

HRESULT QelRovFacetPropertyItem::GetChildren(QelListValQelBaseUnknown_var&) { return E_NOTIMPL; }

HRESULT QelRovFacetPropertyItem::UpdateName() { return S_OK; }

bool QelRovFacetPropertyItem::SetIconFrom(QelBaseUnknown* source) {
  QelVar<QelIIcon> icon(source);
  if (!icon) return false;
  QelUnicodeString name;
  icon->GetIconName(name);
  QelUnicodeString prefixed = IconPrefix;
  prefixed += name;
  SetIconName(std::move(prefixed));
  return true;
}

bool QelRovFacetPropertyItem::EnableOfCheckState(int& enable) const {
  const QelCheckState state = GetCheckState();
  if (state != Checked && state != Unchecked) {
    QelAssertBool("check state");
    return false;
  }
  enable = state == Checked ? 1 : 0;
  return true;
}

HRESULT QelRovFacetPropertyItem::ApplyToObject(QelRovFacetFilterData* filterData, bool filterRequired) {
  QelBaseUnknown_var object = GetObject();
  if (!object) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  if (filterRequired && !filterData) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  int enable = 0;
  if (!EnableOfCheckState(enable)) return E_UNEXPECTED;
  return QelRovFacetServices::EnableDisableDisplay(object.get(), enable, filterData);
}

bool QelRovFacetPropertyItem::AppendAlias(QelUnicodeString& label, QelBaseUnknown* source, const char* separator) {
  QelVar<QelIAlias> alias(source);
  if (!alias) return false;
  QelUnicodeString text;
  alias->GetAlias(text);
  if (!label.IsEmpty()) label += QelUnicodeString(separator);
  label += text;
  return true;
}
