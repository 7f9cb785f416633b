#include "QelPLMProductOccurrence.h"

#include <algorithm>

#include "QelILumLightLoadModeObserver.h"
#include "QelMetaObject.h"
#include "QelPLMRepInstance.h"

const QelMetaObject& QelPLMProductOccurrence::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelPLMProductOccurrence", QelMetaKind::Implementation, &QelModelObject::MetaObject(), "QelProductNavigation");
  return meta;
}
const QelMetaObject* QelPLMProductOccurrence::GetMetaObject() const { return &MetaObject(); }
const char* QelPLMProductOccurrence::GetLateType() const { return "SorOccurrence"; }

QelPLMProductOccurrence::QelPLMProductOccurrence(std::string alias, std::string icon, bool shown)
    : QelModelObject(std::move(alias), std::move(icon), shown) {}
QelPLMProductOccurrence::~QelPLMProductOccurrence() = default;

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
  for (const auto& known : observers_) {
    if (QelBaseUnknown* alive = known.GetRaw(); alive && alive->IsEqual(observer)) return S_FALSE;
  }
  observers_.emplace_back(observer);
  return S_OK;
}

HRESULT QelPLMProductOccurrence::RemoveObserver(QelBaseUnknown* observer) {
  if (!observer) return E_FAIL;
  for (auto it = observers_.begin(); it != observers_.end(); ++it) {
    if (QelBaseUnknown* alive = it->GetRaw(); alive && alive->IsEqual(observer)) {
      observers_.erase(it);
      return S_OK;
    }
  }
  return S_FALSE;
}

int QelPLMProductOccurrence::CountObservers() const {
  return static_cast<int>(std::count_if(observers_.begin(), observers_.end(), [](const auto& o) { return o.IsAlive(); }));
}

HRESULT QelPLMProductOccurrence::IsLightLoadMode(bool& on) {
  on = lightLoadMode_;
  return S_OK;
}

HRESULT QelPLMProductOccurrence::SetLightLoadMode(bool on) {
  if (on == lightLoadMode_) return S_FALSE;
  lightLoadMode_ = on;
  // Observers may add or remove observers while being told; work on a snapshot and skip
  // whoever was removed meanwhile, so a removed observer is never called again.
  QelBaseUnknown_var self(static_cast<QelIPLMNavOccurrence*>(this));
  std::vector<QelBaseUnknown_WR> snapshot = observers_;
  for (const auto& entry : snapshot) {
    QelBaseUnknown_var target = entry.Get();
    if (!target) continue;
    bool stillObserving = std::any_of(observers_.begin(), observers_.end(), [&](const QelBaseUnknown_WR& o) {
      QelBaseUnknown* alive = o.GetRaw();
      return alive && alive->IsEqual(target.get());
    });
    if (!stillObserving) continue;
    if (QelVar<QelILumLightLoadModeObserver> observer = target.get()) observer->OnLightLoadModeChanged();
  }
  std::erase_if(observers_, [](const QelBaseUnknown_WR& o) { return !o.IsAlive(); });
  return S_OK;
}
