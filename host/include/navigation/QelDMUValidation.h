#pragma once
// QelDMUValidation: a DMU validation: a review document that an editor shows over its
// product. Its class (and late type) is "PCCMemDMUValidationValidation"; it owns its own
// persistency support, so it answers QelIDMUPersistencySupportOwner with itself.
#include "QelIDMUPersistencySupportOwner.h"

class QelDMUValidation : public QelIDMUPersistencySupportOwner {
 public:
  QelDMUValidation() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  QelBaseUnknown_var GetSupportOwner() override { return QelBaseUnknown_var(static_cast<QelBaseUnknown*>(this)); }

 protected:
  ~QelDMUValidation() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (void* mine = QelQueryDirect<QelIDMUPersistencySupportOwner>(this, iid)) return mine;
    return QelBaseUnknown::QueryDirect(iid);
  }
};
