#include "QelRovFacetPropertyItemCustomAnnot.h"

#include <memory>

#include "QelAssert.h"
#include "QelIAlias.h"
#include "QelIIcon.h"
#include "QelINavigateObject.h"
#include "QelRovFacetFilterData.h"

namespace {
// The annotation's first navigation name, else its alias; false when it has neither
// interface.
bool ReadLabel(QelBaseUnknown* annotation, QelUnicodeString& label) {
  label = QelUnicodeString();
  if (QelVar<QelINavigateObject> navigate{annotation}) {
    std::unique_ptr<QelListValQelUnicodeString> names(navigate->GetIdentificators());
    if (names && names->Size() > 0) label = (*names)[1];
  }
  if (!label.IsEmpty()) return true;
  QelVar<QelIAlias> alias(annotation);
  if (!alias) return false;
  alias->GetAlias(label);
  return true;
}
}  // namespace

const QelMetaObject& QelRovFacetPropertyItemCustomAnnot::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelRovFacetPropertyItemCustomAnnot", QelMetaKind::Implementation,
                             &QelRovFacetPropertyItem::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetPropertyItemCustomAnnot::GetMetaObject() const { return &MetaObject(); }

QelRovFacetPropertyItemCustomAnnot::QelRovFacetPropertyItemCustomAnnot(QelBaseUnknown* annotation,
                                                                       QelRovFacetFilterData* filterData,
                                                                       QelBaseUnknown* group)
    : QelRovFacetPropertyItem(QelUnicodeString(), group),
      filterData_(QelVar<QelRovFacetFilterData>::Retain(filterData)) {
  SetObject(annotation);
  ReadStateFromDisplay(annotation);
  if (!filterData_) {
    QelAssertPointer();
    return;
  }
  QelUnicodeString label;
  if (!ReadLabel(annotation, label)) {
    QelAssertNullHandler();
    return;
  }
  SetName(std::move(label));
  if (!SetIconFrom(annotation)) QelAssertNullHandler();
}

QelRovFacetPropertyItemCustomAnnot::~QelRovFacetPropertyItemCustomAnnot() = default;

HRESULT QelRovFacetPropertyItemCustomAnnot::ApplyCheckState() { return ApplyToObject(filterData_.get(), true); }

bool QelRovFacetPropertyItemCustomAnnot::Renew(QelBaseUnknown* annotation, QelRovFacetFilterData* filterData) {
  if (!annotation || !filterData || filterData_.get() != filterData || !StandsFor(annotation)) return false;
  QelUnicodeString label;
  if (!ReadLabel(annotation, label)) return false;
  QelVar<QelIIcon> icon(annotation);
  if (!icon) return false;
  QelUnicodeString iconName;
  icon->GetIconName(iconName);
  // Compared in place: the prefixed name is built only when it changed.
  const std::string& stored = StoredIconName().Utf8();
  const std::string& prefix = IconPrefix.Utf8();
  const std::string& name = iconName.Utf8();
  if (stored.size() != prefix.size() + name.size() || stored.compare(0, prefix.size(), prefix) != 0 ||
      stored.compare(prefix.size(), std::string::npos, name) != 0)
    SetIconName(IconPrefix + iconName);
  if (label != StoredName()) SetName(std::move(label));
  ResetPresentation(FlagsCheckBox);
  SetCheckState(Unchecked);
  ReadStateFromDisplay(annotation);
  return true;
}
