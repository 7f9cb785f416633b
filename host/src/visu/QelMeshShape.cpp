#include "QelMeshShape.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {
std::array<float, 3> F(const QelMathPoint& p) {
  return {static_cast<float>(p.x), static_cast<float>(p.y), static_cast<float>(p.z)};
}
}  // namespace

void QelMeshShape::Append(const QelMeshShape& other, const QelMathVector& offset) {
  const auto base = static_cast<uint32_t>(vertices.size());
  for (const auto& v : other.vertices) vertices.push_back(F(QelMathPoint{v[0], v[1], v[2]} + offset));
  for (const auto& t : other.triangles) triangles.push_back({t[0] + base, t[1] + base, t[2] + base});
}

QelMeshShape QelMeshShape::Box(const QelMathPoint& a, const QelMathPoint& b) {
  const QelMathPoint lo{std::min(a.x, b.x), std::min(a.y, b.y), std::min(a.z, b.z)};
  const QelMathPoint hi{std::max(a.x, b.x), std::max(a.y, b.y), std::max(a.z, b.z)};
  QelMeshShape m;
  for (int i = 0; i < 8; ++i) m.vertices.push_back(F({i & 1 ? hi.x : lo.x, i & 2 ? hi.y : lo.y, i & 4 ? hi.z : lo.z}));
  // Two triangles per face, wound counter-clockwise seen from outside.
  static constexpr uint32_t faces[6][4] = {{0, 2, 3, 1}, {4, 5, 7, 6}, {0, 1, 5, 4}, {2, 6, 7, 3}, {0, 4, 6, 2}, {1, 3, 7, 5}};
  for (const auto& f : faces) {
    m.triangles.push_back({f[0], f[1], f[2]});
    m.triangles.push_back({f[0], f[2], f[3]});
  }
  return m;
}

QelMeshShape QelMeshShape::Cylinder(const QelMathPoint& base, const QelMathVector& axis, double radius, int sides) {
  QelMeshShape m;
  const double h = axis.Norm();
  if (h == 0.0 || radius <= 0.0) return m;
  sides = std::max(sides, 3);
  const QelMathVector w = axis * (1.0 / h);
  // Any vector square to the axis, then a right-handed frame (u, v, w).
  QelMathVector u = std::abs(w.x) < 0.9 ? QelMathVector{1, 0, 0}.Cross(w) : QelMathVector{0, 1, 0}.Cross(w);
  u = u * (1.0 / u.Norm());
  const QelMathVector v = w.Cross(u);
  const QelMathPoint top = base + axis;
  m.vertices.push_back(F(base));  // 0: bottom centre
  m.vertices.push_back(F(top));   // 1: top centre
  for (int i = 0; i < sides; ++i) {
    const double a = 2.0 * std::numbers::pi * i / sides;
    const QelMathVector r = (u * std::cos(a) + v * std::sin(a)) * radius;
    m.vertices.push_back(F(base + r));
    m.vertices.push_back(F(top + r));
  }
  for (uint32_t i = 0; i < static_cast<uint32_t>(sides); ++i) {
    const uint32_t j = (i + 1) % sides;
    const uint32_t b0 = 2 + 2 * i, t0 = b0 + 1, b1 = 2 + 2 * j, t1 = b1 + 1;
    m.triangles.push_back({b0, b1, t1});
    m.triangles.push_back({b0, t1, t0});
    m.triangles.push_back({0, b1, b0});
    m.triangles.push_back({1, t0, t1});
  }
  return m;
}
