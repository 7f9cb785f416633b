#pragma once
// Annotation component 74: bound to a camera and a capture path, it reads the camera's
// eye point, sight, up vector and target in the coordinates of the capture's part.
#include "QelMathVector.h"
#include "QelVar.h"

class QelPathElement;

class QelILumCameraGeometry : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumCameraGeometry;
  static constexpr QelIID IID = QelIID::Parse("{0B7984F3-DE9A-4C40-8D94-BA801BD2DA75}");

  virtual HRESULT Bind(QelBaseUnknown* camera, QelPathElement* capturePath) = 0;
  virtual HRESULT GetEyePoint(QelMathPoint& eye) = 0;
  virtual HRESULT GetSightVector(QelMathVector& sight) = 0;
  virtual HRESULT GetUpVector(QelMathVector& up) = 0;
  virtual HRESULT GetTargetPoint(QelMathPoint& target) = 0;

 protected:
  ~QelILumCameraGeometry() override = default;
};
