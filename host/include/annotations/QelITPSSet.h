#pragma once
// The set side of an annotation set as a capture's first operation hands it out; query
// the base identifier and then QelILumSet to reach the set.
#include "QelVar.h"

class QelITPSSet : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSSet;
  static constexpr QelIID IID = QelIID::Parse("{F4A2D38F-3DDC-11D3-A929-006094B99C4B}");

  virtual HRESULT GetAnnotationCount(int& count) = 0;

 protected:
  ~QelITPSSet() override = default;
};
