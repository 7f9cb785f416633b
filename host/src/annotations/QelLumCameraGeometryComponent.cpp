#include "QelLumCameraGeometryComponent.h"

#include "QelILumCapture.h"
#include "QelMetaObject.h"
#include "QelPathElement.h"

const QelMetaObject& QelLumCameraGeometryComponent::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelLumCameraGeometryComponent", QelMetaKind::Implementation,
                             &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumCameraGeometryComponent::GetMetaObject() const { return &MetaObject(); }

QelLumCameraGeometryComponent::~QelLumCameraGeometryComponent() = default;

void* QelLumCameraGeometryComponent::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelILumCameraGeometry>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelLumCameraGeometryComponent::Bind(QelBaseUnknown* camera, QelPathElement* capturePath) {
  camera_ = QelVar<QelICamera>(camera);
  // A viewer camera handed in is not one of ours: read the stored camera of the capture
  // nearest to the leaf end of the path instead.
  for (int i = capturePath ? capturePath->GetSize() - 1 : -1; !camera_ && i >= 0; --i) {
    if (QelVar<QelILumCapture> capture{(*capturePath)[i].get()}) capture->GetCamera(camera_);
  }
  return camera_ ? S_OK : E_FAIL;
}

HRESULT QelLumCameraGeometryComponent::GetEyePoint(QelMathPoint& eye) {
  return camera_ ? camera_->GetOrigin(eye) : E_FAIL;
}

HRESULT QelLumCameraGeometryComponent::GetSightVector(QelMathVector& sight) {
  return camera_ ? camera_->GetDirection(sight) : E_FAIL;
}

HRESULT QelLumCameraGeometryComponent::GetUpVector(QelMathVector& up) {
  return camera_ ? camera_->GetZenith(up) : E_FAIL;
}

HRESULT QelLumCameraGeometryComponent::GetTargetPoint(QelMathPoint& target) {
  return camera_ ? camera_->GetTarget(target) : E_FAIL;
}
