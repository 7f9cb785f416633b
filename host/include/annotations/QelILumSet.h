#pragma once
// An annotation set: holds annotations, views and captures. Its owner (a product
// occurrence) is found through the set component (62); the set keeps it by a weak link.
#include "QelILumCollection.h"
#include "QelVar.h"

class QelILumSet : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumSet;
  static constexpr QelIID IID = QelIID::Parse("{4AAD053D-6478-4A49-B58C-D1CA77769EDB}");

  // The set's integer kind (2: a set held by a product whose children are searched for it).
  virtual HRESULT GetKind(int& kind) = 0;
  // Failed query: E_FAIL. The collections hold counted items.
  virtual HRESULT GetCaptures(QelVar<QelILumCollection>& captures) = 0;
  virtual HRESULT GetElements(QelVar<QelILumCollection>& elements) = 0;
  virtual HRESULT GetViews(QelVar<QelILumCollection>& views) = 0;

 protected:
  ~QelILumSet() override = default;
};
