#include "QelTPSViewRelationComponent.h"

#include "QelLumView.h"
#include "QelMetaObject.h"

const QelMetaObject& QelTPSViewRelationComponent::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelTPSViewRelationComponent", QelMetaKind::Implementation,
                             &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelTPSViewRelationComponent::GetMetaObject() const { return &MetaObject(); }

QelTPSViewRelationComponent::~QelTPSViewRelationComponent() = default;

void* QelTPSViewRelationComponent::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelITPSViewRelations>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelTPSViewRelationComponent::GetRelatedObject(QelBaseUnknown* view, QelBaseUnknown_var& related) {
  related = nullptr;
  auto* found = QelSysDynamicCast<QelLumView>(view);
  if (!found) return E_FAIL;
  if (!found->HasRelatedViews()) return S_FALSE;
  related = QelVar<QelBaseUnknown>(static_cast<QelITPSViewGroup*>(found));
  return S_OK;
}
