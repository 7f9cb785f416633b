#pragma once
// QelLumCameraGeometryComponent: annotation component 74: bound to a camera (or, failing
// that, to the capture at the leaf end of a path), it answers the camera's eye point,
// sight, up vector and target in the coordinates of the capture's part. Holds what it is
// bound to until released.
#include "QelILumCameraGeometry.h"
#include "QelICamera.h"

class QelLumCameraGeometryComponent : public QelILumCameraGeometry {
 public:
  QelLumCameraGeometryComponent() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT Bind(QelBaseUnknown* camera, QelPathElement* capturePath) override;
  HRESULT GetEyePoint(QelMathPoint& eye) override;
  HRESULT GetSightVector(QelMathVector& sight) override;
  HRESULT GetUpVector(QelMathVector& up) override;
  HRESULT GetTargetPoint(QelMathPoint& target) override;

 protected:
  ~QelLumCameraGeometryComponent() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelVar<QelICamera> camera_;
};
