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
  const QelMathDirectionf s(sight);
  const QelMathVector f = s.ToDouble();
  QelMathVector u = up - f * up.Dot(f);
  if (u.SquareNorm() < 1e-18) u = std::abs(f.z) < 0.9 ? QelMathVector{0, 0, 1} : QelMathVector{0, 1, 0};
  u = QelMathDirection(u - f * u.Dot(f));
  const QelMathVector r = f.Cross(u);
  // The box's extent across and along the sight, measured from its centre.
  const QelMathPoint centre = (lo + hi) * 0.5;
  double halfWidth = 0.0, halfHeight = 0.0, halfDepth = 0.0;
  for (int i = 0; i < 8; ++i) {
    const QelMathVector d = QelMathPoint{i & 1 ? hi.x : lo.x, i & 2 ? hi.y : lo.y, i & 4 ? hi.z : lo.z} - centre;
    halfWidth = std::max(halfWidth, std::abs(d.Dot(r)));
    halfHeight = std::max(halfHeight, std::abs(d.Dot(u)));
    halfDepth = std::max(halfDepth, std::abs(d.Dot(f)));
  }
  const double margin = 1.12;  // room for annotation frames, which sit beside their anchors
  const double tanV = std::tan(viewpoint->GetFieldOfView() * std::numbers::pi / 360.0);
  const double tanH = tanV * viewpoint->GetAspectRatio();
  const double fit = std::max({halfWidth / tanH, halfHeight / tanV, 1.0}) * margin;
  viewpoint->SetOrigin(centre - f * (fit + halfDepth));
  viewpoint->SetOrientation(s, QelMathDirectionf(u));
  viewpoint->SetTarget(QelMathPointf(centre));
  return S_OK;
}
