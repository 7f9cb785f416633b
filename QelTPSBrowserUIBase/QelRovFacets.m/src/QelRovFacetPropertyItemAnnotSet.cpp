#include "QelRovFacetPropertyItemAnnotSet.h"

#include "QelAssert.h"
#include "QelIAlias.h"

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
  if (ReadStateFromDisplay(set) > 1) QelAssertBool("IsDisplayEnabled");
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

HRESULT QelRovFacetPropertyItemAnnotSet::ApplyCheckState() { return ApplyToObject(nullptr, false); }
