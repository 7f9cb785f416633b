#pragma once
// QelPLMRepInstance: a representation instance of a product occurrence, and at the same
// time its representation occurrence. It owns the representation reference it
// instantiates (the object that stores annotation sets); its product is a weak link.
#include "QelBaseUnknown_WR.h"
#include "QelIPLMNavRepInstance.h"
#include "QelIPLMNavRepOccurrence.h"
#include "QelModelObject.h"

class QelPLMRepReference;

class QelPLMRepInstance : public QelModelObject, public QelIPLMNavRepInstance, public QelIPLMNavRepOccurrence {
 public:
  QelPLMRepInstance(QelBaseUnknown* product, std::string alias, std::string icon, QelPLMRepReference* reference);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelBaseUnknown_var GetReferencedObject() override;
  HRESULT GetFather(QelBaseUnknown_var& product) override;
  HRESULT GetRepReference(QelBaseUnknown_var& reference) override;

  QelPLMRepReference* Reference() const { return reference_.get(); }
  QelBaseUnknown* Product() const { return product_.GetRaw(); }

 protected:
  ~QelPLMRepInstance() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR product_;
  QelVar<QelPLMRepReference> reference_;
};
