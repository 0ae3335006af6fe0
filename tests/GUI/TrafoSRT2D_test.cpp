// What the rotation adds to scale and translation.

#include <vorl/GUI/Trafo2D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "TrafoTesting.h"

namespace {

using geometry_testing::Numbers;
using gui_testing::Is;
using gui_testing::IsNear;
using gui_testing::IsUndone;
using gui_testing::NextScale;
using gui_testing::PointA2B;
using gui_testing::PointB2A;
using gui_testing::VectorA2B;
using gui_testing::VectorB2A;

constexpr double kQuarter = std::numbers::pi / 2;
constexpr double kRadPerDegree = 3.1415926535 / 180;

TEST(TrafoSRT2D, ScalesThenRotatesThenTranslates) {
  TrafoSRT2D trafo;
  trafo.SetScale(2, 3);
  trafo.SetRotationRad(kQuarter);
  trafo.SetTranslation(100, 200);
  // Scaled (2, 3); a quarter from y towards x takes x to -y and y to x.
  EXPECT_TRUE(IsNear(PointA2B(trafo, 1, 1), 103, 198));
  EXPECT_TRUE(IsNear(VectorA2B(trafo, 1, 1), 3, -2));
  EXPECT_TRUE(IsNear(PointB2A(trafo, 103, 198), 1, 1));
  EXPECT_TRUE(IsNear(VectorB2A(trafo, 3, -2), 1, 1));
}

TEST(TrafoSRT2D, FollowsItsFormulas) {
  Numbers numbers(151);
  for (int i = 0; i < 1000; ++i) {
    const double sx = NextScale(numbers), sy = NextScale(numbers), angle = numbers.Next();
    const double tx = numbers.Next(), ty = numbers.Next();
    const double x = numbers.NextDouble(), y = numbers.NextDouble();
    const double s = std::sin(angle), c = std::cos(angle);
    TrafoSRT2D trafo;
    trafo.SetScale(sx, sy);
    trafo.SetRotationRad(angle);
    trafo.SetTranslation(tx, ty);
    ASSERT_TRUE(Is(VectorA2B(trafo, x, y), s * (sy * y) + c * (sx * x),  //
                   c * (sy * y) - s * (sx * x)));
    ASSERT_TRUE(Is(PointA2B(trafo, x, y), s * (sy * y) + c * (sx * x) + tx,
                   c * (sy * y) - s * (sx * x) + ty));
    ASSERT_TRUE(Is(VectorB2A(trafo, x, y), (c * x - s * y) / sx, (s * x + c * y) / sy));
    const double u = x - tx, v = y - ty;
    ASSERT_TRUE(Is(PointB2A(trafo, x, y), (c * u - s * v) / sx, (s * u + c * v) / sy));
    ASSERT_TRUE(IsUndone(trafo, {x, y}, 1e-10));
  }
}

TEST(TrafoSRT2D, EveryRotationKeepsTheAnchor) {
  TrafoSRT2D trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  trafo.SetRotationRad(kQuarter);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 5, 7), 100, 200));
  EXPECT_TRUE(IsNear(PointA2B(trafo, 6, 7), 100, 198));
  trafo.UpdateRotationRad(kQuarter);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 5, 7), 100, 200));
  EXPECT_TRUE(IsNear(PointA2B(trafo, 6, 7), 98, 200));
  trafo.SetRotationDeg(45);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 5, 7), 100, 200));
  trafo.UpdateRotationDeg(-20);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 5, 7), 100, 200));
  trafo.SetScale(3, -5);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 5, 7), 100, 200));
}

TEST(TrafoSRT2D, SetTranslationAnchorsTheOriginUnderRotationToo) {
  TrafoSRT2D trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  trafo.SetRotationRad(1.0);
  trafo.SetTranslation(30, 40);
  trafo.SetRotationRad(2.0);
  EXPECT_TRUE(Is(PointA2B(trafo, 0, 0), 30, 40));
  trafo.UpdateTranslation(1, 2);
  trafo.SetRotationRad(3.0);
  EXPECT_TRUE(Is(PointA2B(trafo, 0, 0), 31, 42));
}

TEST(TrafoSRT2D, SetKeepsTheRotation) {
  TrafoSRT2D trafo;
  trafo.SetRotationRad(kQuarter);
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  EXPECT_EQ(trafo.GetAngleRad(), kQuarter);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 5, 7), 100, 200));
  EXPECT_TRUE(IsNear(PointA2B(trafo, 15, 17), 140, 180));
}

TEST(TrafoSRT2D, AnglesAddUp) {
  TrafoSRT2D trafo;
  EXPECT_EQ(trafo.GetAngleRad(), 0.0);
  trafo.SetRotationRad(0.5);
  trafo.UpdateRotationRad(0.25);
  EXPECT_EQ(trafo.GetAngleRad(), 0.75);
  trafo.SetRotationDeg(30);
  EXPECT_EQ(trafo.GetAngleRad(), 30 * kRadPerDegree);
  trafo.UpdateRotationDeg(60);
  EXPECT_EQ(trafo.GetAngleRad(), 30 * kRadPerDegree + 60 * kRadPerDegree);
  EXPECT_NEAR(trafo.GetAngleDeg(), 90.0, 1e-12);
  trafo.SetRotationRad(std::numbers::pi);
  EXPECT_EQ(trafo.GetAngleDeg(), std::numbers::pi / kRadPerDegree);
}

TEST(TrafoSRT2D, ResetTakesTheRotationBack) {
  TrafoSRT2D trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  trafo.SetRotationRad(1.0);
  trafo.Reset();
  EXPECT_EQ(trafo.GetAngleRad(), 0.0);
  EXPECT_TRUE(Is(PointA2B(trafo, 3, 4), 3, 4));
  EXPECT_TRUE(Is(VectorB2A(trafo, 3, 4), 3, 4));
}

TEST(TrafoSRT2D, CopiesTheRotation) {
  TrafoSRT2D source;
  source.SetRotationRad(0.5);
  TrafoSRT2D copy(source), assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  for (TrafoSRT2D* trafo : {&copy, &assigned}) {
    EXPECT_EQ(trafo->GetAngleRad(), 0.5);
    EXPECT_TRUE(Is(VectorA2B(*trafo, 1, 0), std::cos(0.5), -std::sin(0.5)));
  }
}

}  // namespace
