#pragma once
// Annotation component 45: gives, for a view, the related object (a QelITPSViewGroup)
// listing the views grouped under it; S_FALSE and a null object when there is none.
#include "QelVar.h"

class QelITPSViewRelations : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSViewRelations;
  static constexpr QelIID IID = QelIID::Parse("{BE3A358D-DCDB-458F-812D-9BF60E4B85B3}");

  virtual HRESULT GetRelatedObject(QelBaseUnknown* view, QelBaseUnknown_var& related) = 0;

 protected:
  ~QelITPSViewRelations() override = default;
};
