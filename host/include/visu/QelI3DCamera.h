#pragma once
// A camera of the 3D viewer that can be changed: the stored camera's four values plus
// setters, a name and a copy from any stored camera. Counted; held through handles.
#include "QelICamera.h"
#include "QelString.h"

class QelI3DCamera : public QelICamera {
 public:
  using QelInterfaceSelf = QelI3DCamera;
  static constexpr QelIID IID = QelIID::Parse("{5C1E2B7A-93D4-4F60-A8E1-0D7B3C9F2A41}");

  virtual HRESULT SetOrigin(const QelMathPoint& origin) = 0;
  virtual HRESULT SetTarget(const QelMathPoint& target) = 0;
  virtual HRESULT SetDirection(const QelMathVector& sight) = 0;
  virtual HRESULT SetZenith(const QelMathVector& up) = 0;
  // Takes the four values of `source`; E_FAIL (and no change) for a null or unreadable one.
  virtual HRESULT CopyFrom(QelICamera* source) = 0;
  virtual QelString GetName() = 0;

 protected:
  ~QelI3DCamera() override = default;
};
