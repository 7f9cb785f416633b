#include "QelDbrFilterComponent.h"

void* QelDbrFilterComponent::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIDriFilterComponent>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelDbrFilterComponent::AddPathElement(QelPathElement* path) {
  if (!path || path->GetSize() == 0) return E_FAIL;
  paths_.push_back(QelVar<QelPathElement>::Retain(path));
  return S_OK;
}

QelPathElement* QelDbrFilterComponent::GetPath(int index) {
  return index >= 0 && index < GetPathCount() ? paths_[static_cast<size_t>(index)].get() : nullptr;
}

HRESULT QelDbrFilterComponent::SetFilterComponentInfo(int type, int value) {
  infos_[type] = value;
  return S_OK;
}

HRESULT QelDbrFilterComponent::GetFilterComponentInfo(int type, int& value) {
  auto it = infos_.find(type);
  if (it == infos_.end()) return E_FAIL;
  value = it->second;
  return S_OK;
}
