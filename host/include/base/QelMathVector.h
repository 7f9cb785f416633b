#pragma once
// QelMathVector: a point or a vector of 3D space in double precision. A plain value with
// no lifetime rules; the annotation layer stores view planes, camera positions and
// annotation geometry with it.
#include <cmath>

struct QelMathVector {
  double x = 0.0;
  double y = 0.0;
  double z = 0.0;

  friend constexpr bool operator==(const QelMathVector&, const QelMathVector&) = default;
  constexpr QelMathVector operator+(const QelMathVector& o) const { return {x + o.x, y + o.y, z + o.z}; }
  constexpr QelMathVector operator-(const QelMathVector& o) const { return {x - o.x, y - o.y, z - o.z}; }
  constexpr QelMathVector operator-() const { return {-x, -y, -z}; }
  constexpr QelMathVector operator*(double s) const { return {x * s, y * s, z * s}; }
  constexpr double Dot(const QelMathVector& o) const { return x * o.x + y * o.y + z * o.z; }
  constexpr QelMathVector Cross(const QelMathVector& o) const {
    return {y * o.z - z * o.y, z * o.x - x * o.z, x * o.y - y * o.x};
  }
  constexpr double SquareNorm() const { return Dot(*this); }
  double Norm() const { return std::sqrt(SquareNorm()); }
  double DistanceTo(const QelMathVector& o) const { return (*this - o).Norm(); }
};

using QelMathPoint = QelMathVector;
