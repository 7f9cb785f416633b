#include "QelRovFacetServices.h"


#include "QelAnnotationModel.h"
#include "QelAssert.h"
#include "QelFrmEditor.h"
#include "QelLumAnnotationSet.h"
#include "QelLumCapture.h"
#include "QelLumSetComponent.h"
#include "QelLumView.h"
#include "QelLumAnnotation.h"
#include "QelModelObject.h"
#include "QelPLMProductOccurrence.h"
#include "QelPLMRepInstance.h"
#include "QelPLMRepReference.h"
#include "QelRovFacetFilterData.h"

namespace {
bool& RefinementSwitch() {
  static bool active = QelGetEnv("QEL_REFINEMENT_DEV") != "0";
  return active;
}
}  // namespace

bool QelRovFacetServices::IsRefinementDevActive() { return RefinementSwitch(); }
void QelRovFacetServices::SetRefinementDevActive(bool active) { RefinementSwitch() = active; }

void QelRovFacetServices::SetLumSetModes(bool lightReviewMode, bool typeFilterAllowed, bool typeFilterForced) {
  QelLumSetComponent::SetModes(lightReviewMode, typeFilterAllowed, typeFilterForced);
}

HRESULT QelRovFacetServices::GetRootPLMObject(QelFrmEditor* editor, QelBaseUnknown_var& root) {
  root = nullptr;
  if (!editor) return E_FAIL;
  root = editor->GetRootObject();
  return S_OK;
}

HRESULT QelRovFacetServices::GetWorkingUIActivePath(QelFrmEditor* editor, QelVar<QelPathElement>& path) {
  path = nullptr;
  if (!editor) return E_FAIL;
  path = editor->GetUIActivePath();
  return path ? S_OK : E_FAIL;
}

HRESULT QelRovFacetServices::ListAllSets(QelBaseUnknown* root, QelListValQelBaseUnknown_var& list, bool /*flag*/) {
  QelAnnotationModel* model = QelAnnotationModel::Of(root);
  if (!model) return E_FAIL;
  for (const auto& set : model->Sets()) list.Append(static_cast<QelILumSet*>(set.get()));
  return S_OK;
}

HRESULT QelRovFacetServices::ListDirectSets(QelBaseUnknown* object, QelListValQelBaseUnknown_var& list, bool flag) {
  QelAnnotationModel* model = QelAnnotationModel::Of(object);
  if (!model) return E_FAIL;
  QelBaseUnknown* impl = object->GetImpl();
  auto* product = dynamic_cast<QelPLMProductOccurrence*>(impl);
  auto* reference = dynamic_cast<QelPLMRepReference*>(impl);
  const bool isRoot = product && product == model->Root();
  for (const auto& set : model->Sets()) {
    auto* rep = QelSysDynamicCast<QelPLMRepInstance>(set->Rep());
    bool take = false;
    if (reference) {
      take = rep && rep->Reference() == reference;
    } else if (product) {
      const bool ownedHere = set->Owner() && set->Owner()->IsEqual(product);
      take = (ownedHere && !rep) || (ownedHere && rep && flag) || (isRoot && set->RootScope() == QelRootSetScope::Direct);
    }
    if (take) list.Append(static_cast<QelILumSet*>(set.get()));
  }
  return S_OK;
}

HRESULT QelRovFacetServices::ListARMOrDirectSets(QelBaseUnknown* root, QelListValQelBaseUnknown_var& list,
                                                 bool /*flag*/) {
  QelAnnotationModel* model = QelAnnotationModel::Of(root);
  if (!model) return E_FAIL;
  // A product below the root (made UI-active) is the root of its own sets: those it owns.
  auto* product = dynamic_cast<QelPLMProductOccurrence*>(root->GetImpl());
  const bool below = product && product != model->Root();
  for (const auto& set : model->Sets()) {
    const bool take = below ? set->Owner() && set->Owner()->IsEqual(product) : set->RootScope() != QelRootSetScope::None;
    if (take) list.Append(static_cast<QelILumSet*>(set.get()));
  }
  return S_OK;
}

HRESULT QelRovFacetServices::ListAnnotationsOfVisibleSets(QelBaseUnknown* root, QelListValQelBaseUnknown_var& list) {
  QelAnnotationModel* model = QelAnnotationModel::Of(root);
  if (!model) return E_FAIL;
  size_t count = static_cast<size_t>(list.Size());
  for (const auto& set : model->Sets())
    if (set->IsShown()) count += set->Annotations().size();
  list.Reserve(static_cast<int>(count));
  for (const auto& set : model->Sets()) {
    if (!set->IsShown()) continue;
    for (const auto& annotation : set->Annotations()) list.Append(static_cast<QelITPS*>(annotation.get()));
  }
  return S_OK;
}

HRESULT QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(QelBaseUnknown* root,
                                                               QelListValQelBaseUnknown_var& list) {
  QelAnnotationModel* model = QelAnnotationModel::Of(root);
  if (!model) return E_FAIL;
  for (const auto& set : model->Sets()) {
    if (!set->IsShown()) continue;
    for (const auto& view : set->Views()) list.Append(static_cast<QelITPSView*>(view.get()));
    for (const auto& capture : set->Captures()) list.Append(static_cast<QelILumCapture*>(capture.get()));
  }
  return S_OK;
}

HRESULT QelRovFacetServices::EnableDisableDisplay(const QelListValQelBaseUnknown_var& list, int enable,
                                                  QelRovFacetFilterData* filter) {
  HRESULT result = S_OK;
  for (const auto& object : list) {
    HRESULT one = EnableDisableDisplay(object.get(), enable, filter);
    if (QelFailed(one) && QelSucceeded(result)) result = one;
  }
  return result;
}

HRESULT QelRovFacetServices::EnableDisableDisplay(QelBaseUnknown* object, int enable, QelRovFacetFilterData* filter) {
  auto* target = QelModelObject::From(object);
  if (!target) return E_FAIL;
  if (enable != 0 && enable != 1) return E_FAIL;
  // The filter rule itself (docs/display-rule.md) lives with the annotation.
  const bool shown = enable == 1 && (!filter || target->PassesFilter(*filter));
  if (shown == target->IsShown()) return S_OK;
  target->SetShown(shown);
  QelAnnotationModel* model = QelAnnotationModel::Of(object);
  if (model && model->IsDisplayWatched()) QelCallbackManager::Get().Dispatch(model, kQelDisplayChanged, object);
  return S_OK;
}

QelCallbackId QelRovFacetServices::AddDisplayChangeCallback(QelBaseUnknown* objectOfModel, QelBaseUnknown* subscriber,
                                                            QelCallbackFn fn) {
  QelAnnotationModel* model = QelAnnotationModel::Of(objectOfModel);
  if (!model) return 0;
  model->WatchDisplay();
  return QelCallbackManager::Get().AddCallback(model, kQelDisplayChanged, subscriber, std::move(fn));
}

HRESULT QelRovFacetServices::IsDisplayEnabled(QelBaseUnknown* object) {
  auto* target = QelModelObject::From(object);
  if (!target) return E_FAIL;
  return target->IsShown() ? S_OK : S_FALSE;
}
