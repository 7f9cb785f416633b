#include "QelRovFacetPropertyItemAnnotSet.h"

#include "QelAssert.h"
#include "QelIAlias.h"
#include "QelRovFacetServices.h"

namespace {
// Appends `source`'s alias after `separator` (only when the label already has text);
// false when the source has no alias.
bool AppendAlias(QelUnicodeString& label, QelBaseUnknown* source, const char* separator) {
  QelVar<QelIAlias> alias = source;
  if (!alias) return false;
  QelUnicodeString text;
  alias->GetAlias(text);
  if (!label.IsEmpty()) label += QelUnicodeString(separator);
  label += text;
  return true;
}
}  // namespace

const QelMetaObject& QelRovFacetPropertyItemAnnotSet::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelRovFacetPropertyItemAnnotSet", QelMetaKind::Implementation,
                             &QelRovFacetPropertyItem::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetPropertyItemAnnotSet::GetMetaObject() const { return &MetaObject(); }

QelRovFacetPropertyItemAnnotSet::QelRovFacetPropertyItemAnnotSet(QelBaseUnknown* set, QelBaseUnknown* ownerObject,
                                                                 const QelListValQelBaseUnknown_var& references,
                                                                 QelBaseUnknown* group)
    : QelRovFacetPropertyItem(QelUnicodeString(), group), ownerObject_(ownerObject), references_(references) {
  SetObject(set);
  references_.RemoveDuplicates();
  const HRESULT shown = QelRovFacetServices::IsDisplayEnabled(set);
  if (shown > 1) QelAssertBool("IsDisplayEnabled");
  SetCheckState(shown);
  QelBaseUnknown* iconSource = references_.Size() > 0 ? references_[1].get() : ownerObject;
  if (!SetIconFrom(iconSource)) QelAssertNullHandler();
}

QelRovFacetPropertyItemAnnotSet::~QelRovFacetPropertyItemAnnotSet() = default;

HRESULT QelRovFacetPropertyItemAnnotSet::UpdateName() {
  QelUnicodeString label;
  for (int i = 1; i <= references_.Size(); ++i)
    if (!AppendAlias(label, references_[i].get(), ", ")) QelAssertNullHandler();
  AppendAlias(label, ownerObject_.Get().get(), "/");
  AppendAlias(label, GetObject().get(), "/");
  SetName(label);
  return S_OK;
}

HRESULT QelRovFacetPropertyItemAnnotSet::ApplyCheckState() {
  QelBaseUnknown_var set = GetObject();
  if (!set) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  const QelCheckState state = GetCheckState();
  if (state != Checked && state != Unchecked) {
    QelAssertBool("check state");
    return E_UNEXPECTED;
  }
  return QelRovFacetServices::EnableDisableDisplay(set.get(), state == Checked ? 1 : 0, nullptr);
}
