#include "QelRovFacetPropertyItemCustomAnnot.h"

#include <memory>

#include "QelAssert.h"
#include "QelIAlias.h"
#include "QelINavigateObject.h"
#include "QelRovFacetFilterData.h"

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
  if (QelVar<QelINavigateObject> navigate{annotation}) {
    std::unique_ptr<QelListValQelUnicodeString> names(navigate->GetIdentificators());
    if (names && names->Size() > 0) label = (*names)[1];
  }
  if (label.IsEmpty()) {
    QelVar<QelIAlias> alias(annotation);
    if (!alias) {
      QelAssertNullHandler();
      return;
    }
    alias->GetAlias(label);
  }
  SetName(std::move(label));
  if (!SetIconFrom(annotation)) QelAssertNullHandler();
}

QelRovFacetPropertyItemCustomAnnot::~QelRovFacetPropertyItemCustomAnnot() = default;

HRESULT QelRovFacetPropertyItemCustomAnnot::ApplyCheckState() { return ApplyToObject(filterData_.get(), true); }
