#pragma once
// QelLumNamingComponent: annotation component 59 (naming): the type and sub-type names of
// an annotation of this layer. Stateless; made per request and released by the caller.
#include "QelILumNamingComponent.h"

class QelLumNamingComponent : public QelILumNamingComponent {
 public:
  QelLumNamingComponent() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetTypeCodeName(QelBaseUnknown* annotation, QelString& codeName) override;
  HRESULT GetSubTypeName(QelBaseUnknown* annotation, QelUnicodeString& name) override;
  HRESULT GetTypeName(QelBaseUnknown* annotation, QelUnicodeString& name) override;

 protected:
  ~QelLumNamingComponent() override;
  void* QueryDirect(const QelIID& iid) override;
};
