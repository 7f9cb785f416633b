#pragma once
// QelTPSViewRelationComponent: annotation component 45: for a view, the object listing
// the views grouped under it (the view itself when it groups any). Stateless.
#include "QelITPSViewRelations.h"

class QelTPSViewRelationComponent : public QelITPSViewRelations {
 public:
  QelTPSViewRelationComponent() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetRelatedObject(QelBaseUnknown* view, QelBaseUnknown_var& related) override;

 protected:
  ~QelTPSViewRelationComponent() override;
  void* QueryDirect(const QelIID& iid) override;
};
