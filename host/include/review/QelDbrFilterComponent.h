#pragma once
// QelDbrFilterComponent: a filter component holding the paths it leaves out; counted, held
// by its filter.
#include <map>
#include <vector>

#include "QelIDriFilterComponent.h"

class QelDbrFilterComponent : public QelIDriFilterComponent {
 public:
  QelDbrFilterComponent() = default;

  HRESULT AddPathElement(QelPathElement* path) override;
  int GetPathCount() override { return static_cast<int>(paths_.size()); }
  QelPathElement* GetPath(int index) override;
  HRESULT SetFilterComponentInfo(int type, int value) override;
  HRESULT GetFilterComponentInfo(int type, int& value) override;

 protected:
  ~QelDbrFilterComponent() override = default;
  void* QueryDirect(const QelIID& iid) override;

 private:
  std::vector<QelVar<QelPathElement>> paths_;
  std::map<int, int> infos_;
};
