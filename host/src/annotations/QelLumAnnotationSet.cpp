#include "QelLumAnnotationSet.h"

#include "QelAnnotationModel.h"
#include "QelLumAnnotation.h"
#include "QelLumCapture.h"
#include "QelLumCollection.h"
#include "QelLumView.h"
#include "QelMetaObject.h"

const QelMetaObject& QelLumAnnotationSet::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumAnnotationSet", QelMetaKind::Implementation,
                                                            &QelModelObject::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumAnnotationSet::GetMetaObject() const { return &MetaObject(); }

QelLumAnnotationSet::QelLumAnnotationSet(QelAnnotationModel* model, QelBaseUnknown* owner, QelBaseUnknown* rep,
                                         const QelModelSetDesc& desc)
    : QelModelObject(desc.alias, desc.icon, desc.shown),
      model_(model),
      owner_(owner),
      rep_(rep),
      kind_(desc.kind),
      light_(desc.light),
      rootScope_(desc.rootScope) {}
QelLumAnnotationSet::~QelLumAnnotationSet() = default;

void* QelLumAnnotationSet::QueryDirect(const QelIID& iid) {
  if (iid == QelITPSLightSet::IID) return light_ ? static_cast<QelITPSLightSet*>(this) : nullptr;
  if (void* mine = QelQueryDirect<QelILumSet, QelITPSSet, QelIHyxViewsOfComponent>(this, iid)) return mine;
  return QelModelObject::QueryDirect(iid);
}

QelAnnotationModel* QelLumAnnotationSet::Model() const {
  return QelSysDynamicCast<QelAnnotationModel>(model_.GetRaw());
}

void QelLumAnnotationSet::AddAnnotation(QelLumAnnotation* a) { annotations_.push_back(QelVar<QelLumAnnotation>::Retain(a)); }
void QelLumAnnotationSet::AddView(QelLumView* v) { views_.push_back(QelVar<QelLumView>::Retain(v)); }
void QelLumAnnotationSet::AddCapture(QelLumCapture* c) { captures_.push_back(QelVar<QelLumCapture>::Retain(c)); }

void QelLumAnnotationSet::SetOtherElements(const std::vector<QelBaseUnknown*>& elements) {
  otherElements_.emplace();
  for (QelBaseUnknown* e : elements) otherElements_->emplace_back(e);
}

HRESULT QelLumAnnotationSet::GetKind(int& kind) {
  kind = kind_;
  return S_OK;
}

HRESULT QelLumAnnotationSet::GetCaptures(QelVar<QelILumCollection>& captures) {
  captures = QelLumCollection::FromHandles(captures_);
  return S_OK;
}

HRESULT QelLumAnnotationSet::GetElements(QelVar<QelILumCollection>& elements) {
  elements = QelLumCollection::FromHandles(annotations_);
  return S_OK;
}

HRESULT QelLumAnnotationSet::GetViews(QelVar<QelILumCollection>& views) {
  views = QelLumCollection::FromHandles(views_);
  return S_OK;
}

HRESULT QelLumAnnotationSet::GetAnnotationCount(int& count) {
  count = static_cast<int>(annotations_.size());
  return S_OK;
}

HRESULT QelLumAnnotationSet::GetSet(QelBaseUnknown_var& set) {
  set = QelBaseUnknown_var(static_cast<QelILumSet*>(this));
  return S_OK;
}

HRESULT QelLumAnnotationSet::CountViews(int& count) {
  count = static_cast<int>(views_.size());
  return S_OK;
}

HRESULT QelLumAnnotationSet::CountOtherElements(int& count) {
  QelListValQelBaseUnknown_var others;
  ListOtherElements(others);
  count = others.Size();
  return S_OK;
}

HRESULT QelLumAnnotationSet::ListViews(QelListValQelBaseUnknown_var& views) {
  for (const auto& v : views_) views.Append(static_cast<QelITPSView*>(v.get()));
  return S_OK;
}

HRESULT QelLumAnnotationSet::ListOtherElements(QelListValQelBaseUnknown_var& elements) {
  if (!otherElements_) {
    for (const auto& c : captures_) elements.Append(static_cast<QelILumCapture*>(c.get()));
    return S_OK;
  }
  for (const auto& link : *otherElements_) {
    if (QelBaseUnknown_var e = link.Get()) elements.Append(e);
  }
  return S_OK;
}
