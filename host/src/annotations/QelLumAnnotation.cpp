#include "QelLumAnnotation.h"

#include "QelLumAnnotationSet.h"
#include "QelMetaObject.h"
#include "QelRovFacetFilterData.h"
#include "QelTPSTypeClassifier.h"

const QelMetaObject& QelLumAnnotation::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumAnnotation", QelMetaKind::Implementation,
                                                            &QelModelObject::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumAnnotation::GetMetaObject() const { return &MetaObject(); }

QelLumAnnotation::QelLumAnnotation(QelLumAnnotationSet* set, const QelModelAnnotationDesc& desc)
    : QelModelObject(desc.alias, desc.icon, desc.shown),
      set_(set ? set->GetImpl() : nullptr),
      typeName_(desc.typeName),
      subTypeName_(desc.subTypeName),
      navigationNames_(desc.navigationNames),
      tolerance_(desc.tolerance),
      typeCode_(desc.typeCode),
      geometry_(desc.geometry),
      isDefault_(desc.isDefault),
      visu_(desc.visu),
      anchor_(desc.anchor),
      segments_(desc.segments) {}
QelLumAnnotation::~QelLumAnnotation() = default;

void* QelLumAnnotation::QueryDirect(const QelIID& iid) {
  if (iid == ClassIID) return this;
  // Which kind of annotation this is decides the interfaces it answers.
  if (iid == QelITPS::IID) return geometry_ ? nullptr : static_cast<QelITPS*>(this);
  if (iid == QelILumGeometry::IID) return geometry_ ? static_cast<QelILumGeometry*>(this) : nullptr;
  if (iid == QelITPSTextVisu::IID) return visu_ == QelAnnotationVisu::Text ? static_cast<QelITPSTextVisu*>(this) : nullptr;
  if (iid == QelITPSDimVisu::IID) {
    return visu_ == QelAnnotationVisu::Dimension ? static_cast<QelITPSDimVisu*>(this) : nullptr;
  }
  if (void* mine = QelQueryDirect<QelINavigateObject, QelISetMember>(this, iid)) return mine;
  return QelModelObject::QueryDirect(iid);
}

QelLumAnnotationSet* QelLumAnnotation::Set() const { return QelSysDynamicCast<QelLumAnnotationSet>(set_.GetRaw()); }

HRESULT QelLumAnnotation::GetSet(QelBaseUnknown_var& set) {
  set = set_.Get();
  return set ? S_OK : E_FAIL;
}

HRESULT QelLumAnnotation::GetOwner(QelBaseUnknown_var& set) { return GetSet(set); }

HRESULT QelLumAnnotation::GetToleranceValue(double& value) {
  if (!tolerance_) return S_FALSE;
  value = *tolerance_;
  return S_OK;
}

HRESULT QelLumAnnotation::GetTypeServices(QelBaseUnknown_var& classifierOwner) {
  classifierOwner = QelBaseUnknown_var::Adopt(new QelTPSTypeClassifier());
  return S_OK;
}

HRESULT QelLumAnnotation::IsDefaultAnnotation(bool& isDefault) {
  isDefault = isDefault_;
  return S_OK;
}

HRESULT QelLumAnnotation::GetAnchor(QelMathPoint& anchor) {
  anchor = anchor_;
  return S_OK;
}

HRESULT QelLumAnnotation::GetSegmentCount(int& count) {
  count = static_cast<int>(segments_.size());
  return S_OK;
}

HRESULT QelLumAnnotation::GetSegment(int index, QelMathPoint& from, QelMathPoint& to) {
  if (index < 0 || index >= static_cast<int>(segments_.size())) return E_FAIL;
  from = segments_[index].from;
  to = segments_[index].to;
  return S_OK;
}

HRESULT QelLumAnnotation::GetColor(float& red, float& green, float& blue) {
  // Default annotations are drawn darker so a reviewer tells them apart.
  red = isDefault_ ? 0.0f : 0.1f;
  green = isDefault_ ? 0.4f : 0.6f;
  blue = isDefault_ ? 0.6f : 0.9f;
  return S_OK;
}

QelListValQelUnicodeString* QelLumAnnotation::GetIdentificators() {
  auto* names = new QelListValQelUnicodeString();
  for (const auto& name : navigationNames_) names->Append(QelUnicodeString(name));
  return names;
}

bool QelLumAnnotation::PassesFilter(const QelRovFacetFilterData& filter) const {
  if (filter.DefaultAnnot && !isDefault_) return false;
  if (filter.TolAnnot && (!tolerance_ || !filter.IsInToleranceRange(*tolerance_))) return false;
  return true;
}
