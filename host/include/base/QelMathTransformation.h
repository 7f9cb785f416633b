#pragma once
// QelMathTransformation: an affine transformation of 3D space in double precision, a value.
// Its columns are the images of the x, y and z axes (not necessarily unit or orthogonal:
// a scale or a skew is kept as given) and its translation is the image of the origin.
//
//   QelMathTransformation toRoot = fatherToRoot * childToFather;  // applies childToFather first
#include "QelMathVector.h"

class QelMathTransformation {
 public:
  QelMathTransformation() = default;
  QelMathTransformation(const QelMathVector& xAxis, const QelMathVector& yAxis, const QelMathVector& zAxis,
                        const QelMathVector& translation)
      : x_(xAxis), y_(yAxis), z_(zAxis), t_(translation) {}

  static QelMathTransformation Translation(const QelMathVector& t) { return {{1, 0, 0}, {0, 1, 0}, {0, 0, 1}, t}; }
  static QelMathTransformation Scale(double s) { return {{s, 0, 0}, {0, s, 0}, {0, 0, s}, {}}; }
  // Right-handed rotation by `radians` about `axis` through the origin; the identity for a zero axis.
  static QelMathTransformation Rotation(const QelMathVector& axis, double radians) {
    const double n = axis.Norm();
    if (n == 0.0) return {};
    const QelMathVector u = axis * (1.0 / n);
    const double c = std::cos(radians), s = std::sin(radians), k = 1.0 - c;
    return {{c + u.x * u.x * k, u.y * u.x * k + u.z * s, u.z * u.x * k - u.y * s},
            {u.x * u.y * k - u.z * s, c + u.y * u.y * k, u.z * u.y * k + u.x * s},
            {u.x * u.z * k + u.y * s, u.y * u.z * k - u.x * s, c + u.z * u.z * k},
            {}};
  }

  const QelMathVector& GetXAxis() const { return x_; }
  const QelMathVector& GetYAxis() const { return y_; }
  const QelMathVector& GetZAxis() const { return z_; }
  const QelMathVector& GetTranslation() const { return t_; }

  QelMathVector ApplyToVector(const QelMathVector& v) const { return x_ * v.x + y_ * v.y + z_ * v.z; }
  QelMathPoint Apply(const QelMathPoint& p) const { return ApplyToVector(p) + t_; }

  // `b` first, then this one.
  QelMathTransformation operator*(const QelMathTransformation& b) const {
    return {ApplyToVector(b.x_), ApplyToVector(b.y_), ApplyToVector(b.z_), Apply(b.t_)};
  }

  // Zero for a degenerate transformation, which flattens space and cannot be undone.
  double Determinant() const { return x_.Dot(y_.Cross(z_)); }
  // Exact comparison: a composition that only nearly cancels out is not the identity.
  bool IsIdentity() const { return *this == QelMathTransformation(); }

  friend bool operator==(const QelMathTransformation&, const QelMathTransformation&) = default;

 private:
  QelMathVector x_{1.0, 0.0, 0.0};
  QelMathVector y_{0.0, 1.0, 0.0};
  QelMathVector z_{0.0, 0.0, 1.0};
  QelMathVector t_{};
};
