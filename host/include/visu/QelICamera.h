#pragma once
// A stored camera of a capture, in the coordinates of the capture's product part.
#include "QelMathVector.h"
#include "QelVar.h"

class QelICamera : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelICamera;
  static constexpr QelIID IID = QelIID::Parse("{86EC1D00-EA75-4A2D-8F1A-FE1C13053FC9}");

  virtual HRESULT GetOrigin(QelMathPoint& origin) = 0;
  virtual HRESULT GetTarget(QelMathPoint& target) = 0;
  virtual HRESULT GetDirection(QelMathVector& sight) = 0;
  virtual HRESULT GetZenith(QelMathVector& up) = 0;

 protected:
  ~QelICamera() override = default;
};
