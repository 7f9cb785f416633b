#pragma once
// What an annotation or a capture belongs to: its first operation gives the owning set
// (null when the set is gone).
#include "QelVar.h"

class QelISetMember : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelISetMember;
  static constexpr QelIID IID = QelIID::Parse("{C0074552-099B-11D6-BE99-0003479EC69D}");

  virtual HRESULT GetOwner(QelBaseUnknown_var& set) = 0;

 protected:
  ~QelISetMember() override = default;
};
