#pragma once
// Gives the clipping of a view or capture, built for its path under a context.
#include "QelDbrClipping.h"
#include "QelPathElement.h"

class QelIDriClippingFactory : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDriClippingFactory;
  static constexpr QelIID IID = QelIID::Parse("{8F6D2C4B-0A91-4E3F-B7D8-5C2E6A9F1D04}");

  // S_OK and a new clipping; S_FALSE and null when the object clips nothing. `flag`: the
  // clipping follows the object's plane (true) or nothing (false).
  virtual HRESULT GetClipping(QelPathElement* path, bool flag, QelVar<QelDbrClipping>& clipping) = 0;

 protected:
  ~QelIDriClippingFactory() override = default;
};
