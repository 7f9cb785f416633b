#include "Qel3DViewpoint.h"

void Qel3DViewpoint::SetSupportArea(float /*x*/, float /*y*/, float width, float height) {
  if (width > 0.0f && height > 0.0f) aspect_ = width / height;
}

HRESULT ApplyCameraToViewpoint(Qel3DViewpoint* viewpoint, QelI3DCamera* camera, int /*mode*/) {
  if (!viewpoint || !camera) return E_FAIL;
  QelMathPoint origin, target;
  QelMathVector sight, up;
  if (camera->GetOrigin(origin) != S_OK || camera->GetTarget(target) != S_OK || camera->GetDirection(sight) != S_OK ||
      camera->GetZenith(up) != S_OK) {
    return E_FAIL;
  }
  if (sight.SquareNorm() == 0.0) sight = target - origin;
  // An up direction along the sight would leave the picture's rotation undefined.
  QelMathVector square = up - sight * (sight.SquareNorm() > 0.0 ? up.Dot(sight) / sight.SquareNorm() : 0.0);
  if (square.SquareNorm() < 1e-18) square = std::abs(sight.z) < 0.9 * sight.Norm() ? QelMathVector{0, 0, 1} : QelMathVector{0, 1, 0};
  viewpoint->SetOrigin(origin);
  viewpoint->SetOrientation(QelMathDirectionf(sight), QelMathDirectionf(square));
  viewpoint->SetTarget(QelMathPointf(target));
  return S_OK;
}
