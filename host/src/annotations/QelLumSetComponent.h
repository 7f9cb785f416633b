#pragma once
// QelLumSetComponent: annotation component 62 (sets). Stateless apart from the three
// process-wide review mode answers; made per request and released by the caller.
#include "QelILumSetComponent.h"

class QelLumSetComponent : public QelILumSetComponent {
 public:
  QelLumSetComponent() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  static void SetModes(bool lightReviewMode, bool typeFilterAllowed, bool typeFilterForced);

  HRESULT IsLightReviewMode(bool& on) override;
  HRESULT IsTypeFilterAllowed(bool& on) override;
  HRESULT IsTypeFilterForced(bool& on) override;
  HRESULT ListRepInstances(QelBaseUnknown* owner, QelListValQelBaseUnknown_var& out) override;
  HRESULT GetSetKind(QelBaseUnknown* set, int& kind) override;
  HRESULT GetSetOwner(QelBaseUnknown* set, QelBaseUnknown_var& owner) override;

 protected:
  ~QelLumSetComponent() override;
  void* QueryDirect(const QelIID& iid) override;
};
