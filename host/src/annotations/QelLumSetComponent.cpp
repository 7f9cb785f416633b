#include "QelLumSetComponent.h"

#include "QelLumAnnotationSet.h"
#include "QelMetaObject.h"
#include "QelPLMProductOccurrence.h"
#include "QelPLMRepInstance.h"

namespace {
struct Modes {
  bool lightReview = false;
  bool typeFilterAllowed = false;
  bool typeFilterForced = false;
};
Modes& CurrentModes() {
  static Modes modes;
  return modes;
}
}  // namespace

const QelMetaObject& QelLumSetComponent::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumSetComponent", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumSetComponent::GetMetaObject() const { return &MetaObject(); }

QelLumSetComponent::~QelLumSetComponent() = default;

void* QelLumSetComponent::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelILumSetComponent>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

void QelLumSetComponent::SetModes(bool lightReviewMode, bool typeFilterAllowed, bool typeFilterForced) {
  CurrentModes() = {lightReviewMode, typeFilterAllowed, typeFilterForced};
}

HRESULT QelLumSetComponent::IsLightReviewMode(bool& on) {
  on = CurrentModes().lightReview;
  return S_OK;
}

HRESULT QelLumSetComponent::IsTypeFilterAllowed(bool& on) {
  on = CurrentModes().typeFilterAllowed;
  return S_OK;
}

HRESULT QelLumSetComponent::IsTypeFilterForced(bool& on) {
  on = CurrentModes().typeFilterForced;
  return S_OK;
}

HRESULT QelLumSetComponent::ListRepInstances(QelBaseUnknown* owner, QelListValQelBaseUnknown_var& out) {
  auto* product = QelSysDynamicCast<QelPLMProductOccurrence>(owner);
  if (!product) return E_FAIL;
  for (const auto& rep : product->RepInstances()) out.Append(static_cast<QelIPLMNavRepInstance*>(rep.get()));
  return S_OK;
}

HRESULT QelLumSetComponent::GetSetKind(QelBaseUnknown* set, int& kind) {
  auto* found = QelSysDynamicCast<QelLumAnnotationSet>(set);
  if (!found) return E_FAIL;
  kind = found->Kind();
  return S_OK;
}

HRESULT QelLumSetComponent::GetSetOwner(QelBaseUnknown* set, QelBaseUnknown_var& owner) {
  owner = nullptr;
  auto* found = QelSysDynamicCast<QelLumAnnotationSet>(set);
  if (!found) return E_FAIL;
  owner = QelVar<QelBaseUnknown>(found->Owner());
  return owner ? S_OK : E_FAIL;
}
