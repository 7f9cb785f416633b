#include "QelLumCamera.h"

#include "QelMetaObject.h"

const QelMetaObject& QelLumCamera::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumCamera", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumCamera::GetMetaObject() const { return &MetaObject(); }

QelLumCamera::QelLumCamera(const QelMathPoint& origin, const QelMathPoint& target, const QelMathVector& zenith)
    : origin_(origin), target_(target), zenith_(zenith) {}
QelLumCamera::~QelLumCamera() = default;

void* QelLumCamera::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelICamera>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelLumCamera::GetOrigin(QelMathPoint& origin) {
  origin = origin_;
  return S_OK;
}

HRESULT QelLumCamera::GetTarget(QelMathPoint& target) {
  target = target_;
  return S_OK;
}

HRESULT QelLumCamera::GetDirection(QelMathVector& sight) {
  sight = target_ - origin_;
  return S_OK;
}

HRESULT QelLumCamera::GetZenith(QelMathVector& up) {
  up = zenith_;
  return S_OK;
}
