#pragma once
// QelDbrFilter: a review filter of a given type on a root path, made of components; while
// applied to a viewpoint it leaves out every object a component names. Type 0 is the only
// type: leave out the named objects. Counted; holds its components and root path.
#include <vector>

#include "QelIDriFilterComponent.h"
#include "QelIVisuObjectFilter.h"

class QelDbrFilter : public QelIVisuObjectFilter {
 public:
  QelDbrFilter(int type, QelPathElement* root);

  int GetFilterType() const { return type_; }
  QelPathElement* GetRoot() const { return root_.get(); }
  HRESULT AddFilterComponent(QelIDriFilterComponent* component);
  int GetComponentCount() const { return static_cast<int>(components_.size()); }
  QelIDriFilterComponent* GetComponent(int index) const;

  bool IsFilteredOut(QelBaseUnknown* object) override;
  // Objects drawn even while hidden (what a capture's activation would show).
  void Keep(QelBaseUnknown* object);
  bool IsKeptIn(QelBaseUnknown* object) override;

 protected:
  ~QelDbrFilter() override = default;
  void* QueryDirect(const QelIID& iid) override;

 private:
  int type_;
  QelVar<QelPathElement> root_;
  std::vector<QelVar<QelIDriFilterComponent>> components_;
  std::vector<QelBaseUnknown_var> kept_;
};
