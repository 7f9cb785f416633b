// The math values the cameras and the renderer rely on, by cases a person can check.
#include <gtest/gtest.h>

#include <numbers>

#include "QelMathPlane.h"
#include "QelMathTransformation.h"
#include "QelMathVectorf.h"

namespace {
bool Near(const QelMathVector& a, const QelMathVector& b) { return (a - b).Norm() < 1e-12; }
}  // namespace

TEST(QelMathTest, TransformationsMovePointsButOnlyTurnAndScaleVectors) {
  const auto quarter = QelMathTransformation::Rotation({0, 0, 2}, std::numbers::pi / 2);
  EXPECT_TRUE(Near(quarter.ApplyToVector({1, 0, 0}), {0, 1, 0}));
  EXPECT_TRUE(Near(quarter.ApplyToVector({0, 1, 0}), {-1, 0, 0}));
  EXPECT_NEAR(quarter.Determinant(), 1.0, 1e-12);
  EXPECT_TRUE(QelMathTransformation::Rotation({0, 0, 0}, 1.0).IsIdentity());
  const auto placed = QelMathTransformation::Translation({5, 0, 0}) * QelMathTransformation::Scale(2);
  EXPECT_EQ(placed.Apply({1, 1, 1}), (QelMathPoint{7, 2, 2}));
  EXPECT_EQ(placed.ApplyToVector({1, 1, 1}), (QelMathVector{2, 2, 2}));
}

TEST(QelMathTest, PlaneDistanceIsSignedAndIgnoresTheNormalsLength) {
  const QelMathPlane plane({0, 0, 1}, {0, 0, 4}, {1, 0, 0}, {0, 1, 0});
  EXPECT_DOUBLE_EQ(plane.DistanceTo({3, 3, 4}), 3.0);
  EXPECT_DOUBLE_EQ(plane.DistanceTo({3, 3, -1}), -2.0);
  EXPECT_EQ(plane.Projection({3, 3, 4}), (QelMathPoint{3, 3, 1}));
  EXPECT_DOUBLE_EQ(QelMathPlane({}, {0, 0, 0}, {1, 0, 0}, {0, 1, 0}).DistanceTo({1, 2, 3}), 0.0);
}

TEST(QelMathTest, SinglePrecisionDirectionsAreUnitOrZero) {
  const QelMathDirectionf d(QelMathVector{0, 3, 4});
  EXPECT_FLOAT_EQ(d.y, 0.6f);
  EXPECT_FLOAT_EQ(d.z, 0.8f);
  EXPECT_EQ(QelMathDirectionf(QelMathVector{}), QelMathDirectionf());
  EXPECT_EQ(QelMathPointf(QelMathPoint{1.5, -2, 3}).ToDouble(), (QelMathPoint{1.5, -2, 3}));
}
