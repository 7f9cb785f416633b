#include "QelPLMProductOccurrence.h"

#include "QelCallbackManager.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelMetaObject.h"
#include "QelPLMRepInstance.h"

namespace {
constexpr const char* kLightLoadModeChanged = "LightLoadModeChanged";
}  // namespace

const QelMetaObject& QelPLMProductOccurrence::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelPLMProductOccurrence", QelMetaKind::Implementation, &QelModelObject::MetaObject(), "QelProductNavigation");
  return meta;
}
const QelMetaObject* QelPLMProductOccurrence::GetMetaObject() const { return &MetaObject(); }
const char* QelPLMProductOccurrence::GetLateType() const { return "SorOccurrence"; }

QelPLMProductOccurrence::QelPLMProductOccurrence(std::string alias, std::string icon, bool shown)
    : QelModelObject(std::move(alias), std::move(icon), shown) {}
QelPLMProductOccurrence::~QelPLMProductOccurrence() {
  // A tree built through the API may be far deeper than the loaders allow: releasing it
  // child by child would recurse once per level. A child about to go hands its own
  // children over first, so each destructor below finds none and the stack stays flat.
  std::vector<QelVar<QelPLMProductOccurrence>> pending = std::move(children_);
  while (!pending.empty()) {
    QelVar<QelPLMProductOccurrence> child = std::move(pending.back());
    pending.pop_back();
    if (child && child->HasOneReference())
      for (auto& grandchild : child->children_) pending.push_back(std::move(grandchild));
  }
}

void* QelPLMProductOccurrence::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIPLMNavOccurrence, QelILumLightLoadModeObservable>(this, iid)) return mine;
  return QelModelObject::QueryDirect(iid);
}

HRESULT QelPLMProductOccurrence::ListRepOccurrences(QelListValQelBaseUnknown_var& reps) {
  for (const auto& rep : reps_) reps.Append(rep.get());
  return S_OK;
}

HRESULT QelPLMProductOccurrence::ListChildren(QelListValQelBaseUnknown_var& children) {
  for (const auto& child : children_) children.Append(child.get());
  return S_OK;
}

HRESULT QelPLMProductOccurrence::GetFather(QelBaseUnknown_var& father) {
  father = father_.Get();
  return father ? S_OK : S_FALSE;
}

HRESULT QelPLMProductOccurrence::GetPlacement(QelMathTransformation& placement) {
  placement = placement_;
  return S_OK;
}

QelPLMProductOccurrence* QelPLMProductOccurrence::Father() const {
  return QelSysDynamicCast<QelPLMProductOccurrence>(father_.GetRaw());
}

void QelPLMProductOccurrence::AddChild(QelPLMProductOccurrence* child) {
  child->father_ = QelBaseUnknown_WR(this);
  children_.push_back(QelVar<QelPLMProductOccurrence>::Retain(child));
}

void QelPLMProductOccurrence::AddRepInstance(QelPLMRepInstance* rep) {
  reps_.push_back(QelVar<QelPLMRepInstance>::Retain(rep));
}

void QelPLMProductOccurrence::SetModelData(QelBaseUnknown* data, bool owning) {
  data_ = QelBaseUnknown_WR(data);
  ownedData_ = owning ? QelBaseUnknown_var(data) : nullptr;
}

QelBaseUnknown_var QelPLMProductOccurrence::ModelData() const { return data_.Get(); }

HRESULT QelPLMProductOccurrence::AddObserver(QelBaseUnknown* observer) {
  if (!observer) return E_FAIL;
  QelCallbackManager& callbacks = QelCallbackManager::Get();
  if (callbacks.CountCallbacks(this, kLightLoadModeChanged, observer) > 0) return S_FALSE;
  // The callback list holds the observer weakly: one that goes away is skipped, never kept.
  QelBaseUnknown_WR weak(observer);
  callbacks.AddCallback(this, kLightLoadModeChanged, observer, [weak](QelBaseUnknown*, QelBaseUnknown*) {
    if (QelVar<QelILumLightLoadModeObserver> told{weak.Get().get()}) told->OnLightLoadModeChanged();
  });
  return S_OK;
}

HRESULT QelPLMProductOccurrence::RemoveObserver(QelBaseUnknown* observer) {
  if (!observer) return E_FAIL;
  return QelCallbackManager::Get().RemoveCallbacksOn(this, observer, kLightLoadModeChanged) > 0 ? S_OK : S_FALSE;
}

HRESULT QelPLMProductOccurrence::IsLightLoadMode(bool& on) {
  on = lightLoadMode_;
  return S_OK;
}

HRESULT QelPLMProductOccurrence::SetLightLoadMode(bool on) {
  if (on == lightLoadMode_) return S_FALSE;
  lightLoadMode_ = on;
  QelCallbackManager::Get().Dispatch(this, kLightLoadModeChanged);
  return S_OK;
}
