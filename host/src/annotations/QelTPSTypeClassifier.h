#pragma once
// QelTPSTypeClassifier: the annotation type classifier an annotation hands out through its
// type services. Stateless and counted; each type object it gives is new and holds its
// annotation until released.
#include "QelITPSTypeClassifier.h"

class QelTPSTypeClassifier : public QelITPSTypeClassifier {
 public:
  QelTPSTypeClassifier() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // Type codes a model may use.
  static constexpr int kFirstTypeCode = 1;
  static constexpr int kLastTypeCode = 13;

  HRESULT GetTypeCount(int& count) override;
  HRESULT IsKnownTypeCode(int code, bool& known) override;
  HRESULT GetType(QelBaseUnknown* annotation, QelBaseUnknown_var& type) override;

 protected:
  ~QelTPSTypeClassifier() override;
  void* QueryDirect(const QelIID& iid) override;
};
