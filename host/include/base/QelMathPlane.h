#pragma once
// QelMathPlane: an annotation view's plane, a value. It keeps its normal as it was given
// (not normalised: callers normalise with their own rule) and its two in-plane directions;
// the second direction is the up direction of a view.
#include "QelMathVector.h"

class QelMathPlane {
 public:
  QelMathPlane() = default;
  QelMathPlane(const QelMathPoint& origin, const QelMathVector& normal, const QelMathVector& firstDirection,
               const QelMathVector& secondDirection)
      : origin_(origin), normal_(normal), first_(firstDirection), second_(secondDirection) {}

  const QelMathPoint& GetOrigin() const { return origin_; }
  const QelMathVector& GetNormal() const { return normal_; }
  const QelMathVector& GetFirstDirection() const { return first_; }
  const QelMathVector& GetSecondDirection() const { return second_; }

  // Signed distance of `p` from the plane, positive on the side the normal points to; 0 for
  // a zero normal.
  double DistanceTo(const QelMathPoint& p) const {
    const double s = normal_.SquareNorm();
    return s == 0.0 ? 0.0 : (p - origin_).Dot(normal_) / std::sqrt(s);
  }

  // Orthogonal projection of `p` onto the plane; `p` itself for a zero normal.
  QelMathPoint Projection(const QelMathPoint& p) const {
    const double s = normal_.SquareNorm();
    if (s == 0.0) return p;
    return p - normal_ * ((p - origin_).Dot(normal_) / s);
  }

 private:
  QelMathPoint origin_;
  QelMathVector normal_{0.0, 0.0, 1.0};
  QelMathVector first_{1.0, 0.0, 0.0};
  QelMathVector second_{0.0, 1.0, 0.0};
};
