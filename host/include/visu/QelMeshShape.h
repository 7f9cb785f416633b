#pragma once
// QelMeshShape: a triangle mesh in a product's own coordinates, immutable once built and
// shared (std::shared_ptr<const QelMeshShape>) by the model and every picture drawn of it.
// Primitives are tessellated here; mesh files are read by QelMeshFileReader.
#include <array>
#include <cstdint>
#include <vector>

#include "QelMathVector.h"

struct QelMeshShape {
  std::vector<std::array<float, 3>> vertices;
  std::vector<std::array<uint32_t, 3>> triangles;  // counter-clockwise seen from outside

  size_t TriangleCount() const { return triangles.size(); }
  // Appends `other` moved by `offset`.
  void Append(const QelMeshShape& other, const QelMathVector& offset = {});

  // An axis-aligned box from `min` to `max` (12 triangles).
  static QelMeshShape Box(const QelMathPoint& min, const QelMathPoint& max);
  // A closed cylinder: base centre, axis (its length is the height), radius, and the number
  // of sides (3 at least).
  static QelMeshShape Cylinder(const QelMathPoint& base, const QelMathVector& axis, double radius, int sides = 32);
};
