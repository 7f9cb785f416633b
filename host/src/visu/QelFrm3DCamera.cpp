#include "QelFrm3DCamera.h"

QelFrm3DCamera::QelFrm3DCamera(const char* name) : name_(name) {}

void* QelFrm3DCamera::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelI3DCamera, QelICamera>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelFrm3DCamera::GetOrigin(QelMathPoint& origin) {
  origin = origin_;
  return S_OK;
}
HRESULT QelFrm3DCamera::GetTarget(QelMathPoint& target) {
  target = target_;
  return S_OK;
}
HRESULT QelFrm3DCamera::GetDirection(QelMathVector& sight) {
  sight = direction_;
  return S_OK;
}
HRESULT QelFrm3DCamera::GetZenith(QelMathVector& up) {
  up = zenith_;
  return S_OK;
}
HRESULT QelFrm3DCamera::SetOrigin(const QelMathPoint& origin) {
  origin_ = origin;
  return S_OK;
}
HRESULT QelFrm3DCamera::SetTarget(const QelMathPoint& target) {
  target_ = target;
  return S_OK;
}
HRESULT QelFrm3DCamera::SetDirection(const QelMathVector& sight) {
  direction_ = sight;
  return S_OK;
}
HRESULT QelFrm3DCamera::SetZenith(const QelMathVector& up) {
  zenith_ = up;
  return S_OK;
}

HRESULT QelFrm3DCamera::CopyFrom(QelICamera* source) {
  if (!source) return E_FAIL;
  QelMathPoint origin, target;
  QelMathVector direction, zenith;
  if (source->GetOrigin(origin) != S_OK || source->GetTarget(target) != S_OK ||
      source->GetDirection(direction) != S_OK || source->GetZenith(zenith) != S_OK) {
    return E_FAIL;
  }
  origin_ = origin;
  target_ = target;
  direction_ = direction;
  zenith_ = zenith;
  return S_OK;
}
