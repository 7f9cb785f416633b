#pragma once
// Single-precision points and directions, the form a viewpoint hands out and takes.
// Plain values; a direction is normalised when made from a vector (zero stays zero).
#include <cmath>

#include "QelMathVector.h"

struct QelMathPointf {
  float x = 0.0f;
  float y = 0.0f;
  float z = 0.0f;

  QelMathPointf() = default;
  QelMathPointf(float px, float py, float pz) : x(px), y(py), z(pz) {}
  explicit QelMathPointf(const QelMathPoint& p)
      : x(static_cast<float>(p.x)), y(static_cast<float>(p.y)), z(static_cast<float>(p.z)) {}
  QelMathPoint ToDouble() const { return {x, y, z}; }
  friend bool operator==(const QelMathPointf&, const QelMathPointf&) = default;
};

struct QelMathDirectionf {
  float x = 0.0f;
  float y = 0.0f;
  float z = 0.0f;

  QelMathDirectionf() = default;
  explicit QelMathDirectionf(const QelMathVector& v) {
    const double n = v.Norm();
    if (n > 0.0) {
      x = static_cast<float>(v.x / n);
      y = static_cast<float>(v.y / n);
      z = static_cast<float>(v.z / n);
    }
  }
  QelMathVector ToDouble() const { return {x, y, z}; }
  friend bool operator==(const QelMathDirectionf&, const QelMathDirectionf&) = default;
};

// A direction of double precision: the vector, unit length unless it was zero.
inline QelMathVector QelMathDirection(const QelMathVector& v) {
  const double n = v.Norm();
  return n > 0.0 ? v * (1.0 / n) : v;
}
