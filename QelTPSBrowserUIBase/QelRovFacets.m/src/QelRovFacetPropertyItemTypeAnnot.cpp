#include "QelRovFacetPropertyItemTypeAnnot.h"

#include "QelAssert.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetServices.h"

const QelMetaObject& QelRovFacetPropertyItemTypeAnnot::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelRovFacetPropertyItemTypeAnnot", QelMetaKind::Implementation,
                             &QelRovFacetPropertyItem::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetPropertyItemTypeAnnot::GetMetaObject() const { return &MetaObject(); }

QelRovFacetPropertyItemTypeAnnot::QelRovFacetPropertyItemTypeAnnot(const QelUnicodeString& label,
                                                                   QelRovFacetFilterData* filterData,
                                                                   QelBaseUnknown* group)
    : QelRovFacetPropertyItem(label, group), filterData_(QelVar<QelRovFacetFilterData>::Retain(filterData)) {
  if (!filterData_) QelAssertPointer();
  SetCheckState(Unchecked);
}

QelRovFacetPropertyItemTypeAnnot::~QelRovFacetPropertyItemTypeAnnot() = default;

int32_t QelRovFacetPropertyItemTypeAnnot::CountItems() { return annotations_.Size(); }

HRESULT QelRovFacetPropertyItemTypeAnnot::ApplyCheckState() {
  int enable = 0;
  if (!EnableOfCheckState(enable)) return E_UNEXPECTED;
  for (int i = annotations_.Size(); i >= 1; --i) {
    QelBaseUnknown* annotation = annotations_[i].get();
    if (!annotation) {
      QelAssertNullHandler();
      continue;
    }
    QelRovFacetServices::EnableDisableDisplay(annotation, enable, filterData_.get());
  }
  return S_OK;
}
