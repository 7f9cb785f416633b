#include "QelDbrFilter.h"

QelDbrFilter::QelDbrFilter(int type, QelPathElement* root) : type_(type), root_(QelVar<QelPathElement>::Retain(root)) {}

void* QelDbrFilter::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIVisuObjectFilter>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelDbrFilter::AddFilterComponent(QelIDriFilterComponent* component) {
  if (!component) return E_FAIL;
  components_.push_back(QelVar<QelIDriFilterComponent>::Retain(component));
  return S_OK;
}

QelIDriFilterComponent* QelDbrFilter::GetComponent(int index) const {
  return index >= 0 && index < GetComponentCount() ? components_[static_cast<size_t>(index)].get() : nullptr;
}

bool QelDbrFilter::IsFilteredOut(QelBaseUnknown* object) {
  if (!object) return false;
  for (const auto& component : components_) {
    for (int i = 0, n = component->GetPathCount(); i < n; ++i) {
      QelPathElement* path = component->GetPath(i);
      if (path && path->GetLeaf() && path->GetLeaf()->IsEqual(object)) return true;
    }
  }
  return false;
}

void QelDbrFilter::Keep(QelBaseUnknown* object) {
  if (object) kept_.push_back(QelBaseUnknown_var::Retain(object));
}

bool QelDbrFilter::IsKeptIn(QelBaseUnknown* object) {
  if (!object) return false;
  for (const auto& kept : kept_)
    if (kept->IsEqual(object)) return true;
  return false;
}
