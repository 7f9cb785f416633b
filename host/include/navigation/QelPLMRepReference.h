#pragma once
// QelPLMRepReference: a representation reference, the object in which annotation sets
// can be stored. Owned by the representation instance that instantiates it; the instance
// is a weak link.
#include "QelBaseUnknown_WR.h"
#include "QelModelObject.h"

class QelPLMRepReference : public QelModelObject {
 public:
  QelPLMRepReference(std::string alias, std::string icon);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  void SetInstance(QelBaseUnknown* instance) { instance_ = QelBaseUnknown_WR(instance); }
  QelBaseUnknown* Instance() const { return instance_.GetRaw(); }

 protected:
  ~QelPLMRepReference() override;

 private:
  QelBaseUnknown_WR instance_;
};
