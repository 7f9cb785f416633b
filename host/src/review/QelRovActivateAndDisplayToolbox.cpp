#include "QelRovActivateAndDisplayToolbox.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <memory>
#include <numbers>

#include "Qel3DViewer.h"
#include "QelITPSView.h"
#include "QelRovPathElementToolbox.h"

namespace {
// The box around everything the viewer shows now (shapes and annotation marks).
bool SceneBounds(Qel3DViewer* viewer, Qel3DViewpoint* viewpoint, QelMathPoint& lo, QelMathPoint& hi) {
  QelIVisuSceneSource* source = viewer->GetSceneSource();
  if (!source) return false;
  QelRenderScene scene;
  source->CollectScene(scene, viewpoint->GetFilter());
  constexpr double inf = std::numeric_limits<double>::infinity();
  lo = {inf, inf, inf};
  hi = {-inf, -inf, -inf};
  auto add = [&](const QelMathPoint& p) {
    lo = {std::min(lo.x, p.x), std::min(lo.y, p.y), std::min(lo.z, p.z)};
    hi = {std::max(hi.x, p.x), std::max(hi.y, p.y), std::max(hi.z, p.z)};
  };
  for (const QelRenderMesh& mesh : scene.meshes) {
    if (!mesh.shape) continue;
    for (const auto& v : mesh.shape->vertices) add(mesh.toWorld.Apply({v[0], v[1], v[2]}));
  }
  for (const QelRenderAnnotation& a : scene.annotations) {
    add(a.anchor);
    for (const QelMathPoint& p : a.segments) add(p);
  }
  return lo.x <= hi.x;
}
}  // namespace

HRESULT QelRovActivateAndDisplayToolbox::ReframeViewpointOnDisplayArea(QelPathElement* path, Qel3DViewer* viewer,
                                                                       Qel3DViewpoint* viewpoint) {
  if (!path || !viewer || !viewpoint) return E_FAIL;
  QelMathVector sight = viewpoint->GetSightDirection().ToDouble();
  QelMathVector up = viewpoint->GetUpDirection().ToDouble();
  if (QelVar<QelITPSView> view{path->GetLeaf().get()}) {
    QelMathPlane* plane = nullptr;
    if (view->GetPlane(plane) == S_OK && plane) {
      std::unique_ptr<QelMathPlane> owned(plane);
      QelMathTransformation toContext;
      QelRovPathElementToolbox::GetMechPartToContextTransfo(path, toContext);
      const QelMathVector n = toContext.ApplyToVector(owned->GetNormal());
      if (n.SquareNorm() > 0.0) {
        sight = -n;
        up = toContext.ApplyToVector(owned->GetSecondDirection());
      }
    }
  }
  QelMathPoint lo, hi;
  if (!SceneBounds(viewer, viewpoint, lo, hi)) lo = hi = viewpoint->GetTarget().ToDouble();
  const QelMathPoint centre = (lo + hi) * 0.5;
  const double radius = std::max((hi - lo).Norm() * 0.5, 1.0);
  // The sphere around the box fits the narrower of the two angles of view.
  const double halfV = viewpoint->GetFieldOfView() * std::numbers::pi / 360.0;
  const double halfH = std::atan(std::tan(halfV) * viewpoint->GetAspectRatio());
  const double distance = radius / std::sin(std::min(halfV, halfH)) * 1.05;
  const QelMathDirectionf s(sight);
  viewpoint->SetOrigin(centre - s.ToDouble() * distance);
  viewpoint->SetOrientation(s, QelMathDirectionf(up - s.ToDouble() * up.Dot(s.ToDouble())));
  viewpoint->SetTarget(QelMathPointf(centre));
  return S_OK;
}
