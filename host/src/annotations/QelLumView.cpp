#include "QelLumView.h"

#include "QelLumAnnotationSet.h"
#include "QelLumCollection.h"
#include "QelMetaObject.h"

const QelMetaObject& QelLumView::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumView", QelMetaKind::Implementation,
                                                            &QelModelObject::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumView::GetMetaObject() const { return &MetaObject(); }
const char* QelLumView::GetLateType() const { return light_ ? "QelTPSLightView" : "QelLumView"; }

QelLumView::QelLumView(QelLumAnnotationSet* set, std::string alias, std::string icon,
                       std::optional<QelMathPlane> plane, bool extraction, bool shown)
    : QelModelObject(std::move(alias), std::move(icon), shown),
      set_(set ? set->GetImpl() : nullptr),
      plane_(plane),
      extraction_(extraction),
      light_(set && set->IsLight()) {}
QelLumView::~QelLumView() = default;

void* QelLumView::QueryDirect(const QelIID& iid) {
  if (iid == QelITPSExtractionView::IID) return extraction_ ? static_cast<QelITPSExtractionView*>(this) : nullptr;
  if (iid == QelITPSViewGroup::IID) return related_.empty() ? nullptr : static_cast<QelITPSViewGroup*>(this);
  if (iid == QelITPSLight::IID) return light_ ? static_cast<QelITPSLight*>(this) : nullptr;
  if (void* mine = QelQueryDirect<QelITPSView>(this, iid)) return mine;
  return QelModelObject::QueryDirect(iid);
}

QelLumAnnotationSet* QelLumView::Set() const { return QelSysDynamicCast<QelLumAnnotationSet>(set_.GetRaw()); }

HRESULT QelLumView::GetSet(QelBaseUnknown_var& set) {
  set = set_.Get();
  return set ? S_OK : E_FAIL;
}

HRESULT QelLumView::GetPlane(QelMathPlane*& plane) {
  plane = plane_ ? new QelMathPlane(*plane_) : nullptr;
  return plane ? S_OK : S_FALSE;
}

HRESULT QelLumView::GetElements(QelVar<QelILumCollection>& elements) {
  elements = QelLumCollection::FromLinks(elements_);
  return S_OK;
}

HRESULT QelLumView::GetReferenceViews(QelVar<QelILumCollection>& views) {
  views = QelLumCollection::FromLinks(references_);
  return S_OK;
}

HRESULT QelLumView::GetViews(QelVar<QelILumCollection>& views) {
  views = QelLumCollection::FromLinks(related_);
  return S_OK;
}
