#pragma once
// Annotation component 62, the sets component: the review modes and, per set, its kind and
// owner; per owner, its representation instances. Created by number, released after use.
#include "QelListValQelBaseUnknown_var.h"
#include "QelVar.h"

class QelILumSetComponent : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumSetComponent;
  static constexpr QelIID IID = QelIID::Parse("{D0A5DEC5-091F-44A5-97E3-5D673454AFCC}");

  virtual HRESULT IsLightReviewMode(bool& on) = 0;
  virtual HRESULT IsTypeFilterAllowed(bool& on) = 0;
  virtual HRESULT IsTypeFilterForced(bool& on) = 0;
  virtual HRESULT ListRepInstances(QelBaseUnknown* owner, QelListValQelBaseUnknown_var& out) = 0;
  virtual HRESULT GetSetKind(QelBaseUnknown* set, int& kind) = 0;
  virtual HRESULT GetSetOwner(QelBaseUnknown* set, QelBaseUnknown_var& owner) = 0;

 protected:
  ~QelILumSetComponent() override = default;
};
