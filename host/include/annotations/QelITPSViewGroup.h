#pragma once
// The object related to a view by component 45: the first operation lists the views
// grouped under it.
#include "QelILumCollection.h"
#include "QelVar.h"

class QelITPSViewGroup : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSViewGroup;
  static constexpr QelIID IID = QelIID::Parse("{BC06E178-8588-4554-8B72-216E2DC4A1A4}");

  virtual HRESULT GetViews(QelVar<QelILumCollection>& views) = 0;

 protected:
  ~QelITPSViewGroup() override = default;
};
