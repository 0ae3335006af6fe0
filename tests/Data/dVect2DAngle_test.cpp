#include <vorl/Data/dVect2D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Round;
using geometry_testing::Same;

constexpr double kLargest = 3.4028234663852886e38;
const double kQuarter = std::acos(0.0);

TEST(dVect2DAngle, CosineAndSineAreSharesOfTheLength) {
  const dVect2D v(-3.0F, 4.0F);
  EXPECT_EQ(v.AngleCos(), -3.0 / 5.0);
  EXPECT_EQ(v.AngleSin(), 4.0 / 5.0);
}

TEST(dVect2DAngle, AVectorNearZeroPointsAlongX) {
  for (const dVect2D& v : {dVect2D(), dVect2D(-1e-6F, 1e-6F)}) {
    EXPECT_EQ(v.AngleCos(), 1.0);
    EXPECT_EQ(v.AngleSin(), 0.0);
  }
  const dVect2D beyond(0.0F, 2e-6F);
  EXPECT_EQ(beyond.AngleCos(), 0.0);
  EXPECT_EQ(beyond.AngleSin(), 1.0);
}

TEST(dVect2DAngle, TangentIsTheSlope) {
  EXPECT_EQ(dVect2D(4.0F, 3.0F).AngleTan(), 0.75);
  EXPECT_EQ(dVect2D(-4.0F, 3.0F).AngleTan(), -0.75);
  EXPECT_EQ(dVect2D(3.0F, 1.0F).AngleTan(), 1.0 / 3.0);
}

TEST(dVect2DAngle, TangentOfAVerticalIsTheLargestNumber) {
  EXPECT_EQ(dVect2D(0.0F, 5.0F).AngleTan(), kLargest);
  EXPECT_EQ(dVect2D(0.0F, -5.0F).AngleTan(), -kLargest);
  EXPECT_EQ(dVect2D().AngleTan(), kLargest);
  EXPECT_EQ(dVect2D(1e-6F, 1.0F).AngleTan(), kLargest);   // still near zero
  EXPECT_EQ(dVect2D(-1e-6F, 1.0F).AngleTan(), kLargest);  // the sign of x says nothing
  const float beyond = std::nextafter(1e-6F, 1.0F);
  EXPECT_EQ(dVect2D(-beyond, 1.0F).AngleTan(), 1.0 / -static_cast<double>(beyond));
}

TEST(dVect2DAngle, RadiansHaveNoQuadrant) {
  EXPECT_EQ(dVect2D(1.0F, 1.0F).AngleRad(), std::atan(1.0));
  EXPECT_EQ(dVect2D(-1.0F, -1.0F).AngleRad(), std::atan(1.0));
  EXPECT_EQ(dVect2D(-1.0F, 1.0F).AngleRad(), -std::atan(1.0));
  EXPECT_EQ(dVect2D(-1.0F, 0.0F).AngleRad(), 0.0);
  EXPECT_DOUBLE_EQ(dVect2D(0.0F, 5.0F).AngleRad(), kQuarter);
}

TEST(dVect2DAngle, DegreesTakeARoundedPi) {
  // 45 * pi / 3.1415926535 = 45.0000000012862
  EXPECT_NEAR(dVect2D(1.0F, 1.0F).AngleDeg(), 45.0000000012862, 1e-12);
  EXPECT_EQ(dVect2D(1.0F, 1.0F).AngleDeg(), std::atan(1.0) / 0.017453292519444445);
  EXPECT_NEAR(dVect2D(0.0F, 5.0F).AngleDeg(), 90.0, 1e-8);
  EXPECT_NEAR(dVect2D(0.0F, -5.0F).AngleDeg(), -90.0, 1e-8);
  EXPECT_NEAR(dVect2D(-1.0F, 1.0F).AngleDeg(), -45.0, 1e-8);
}

TEST(dVect2DAngle, RotatesFromXTowardsY) {
  dVect2D v(2.0F, 0.0F);
  v.vRotate(kQuarter);
  EXPECT_NEAR(v.x, 0.0, 1e-7);
  EXPECT_EQ(v.y, 2.0F);
}

TEST(dVect2DAngle, RotationIsRoundedOnce) {
  Numbers numbers(6);
  for (int i = 0; i < 1000; ++i) {
    const dVect2D v = numbers.Next2D();
    const double angle = numbers.NextDouble();
    const double c = std::cos(angle), s = std::sin(angle);
    dVect2D rotated(v);
    rotated.vRotate(angle);
    ASSERT_TRUE(Same(rotated, v.x * c - v.y * s, v.x * s + v.y * c));
  }
}

TEST(dVect2DAngle, AngleNearZeroRotatesNothing) {
  dVect2D v(1.0F, 0.0F);
  v.vRotate(1e-6);
  EXPECT_TRUE(Same(v, 1, 0));
  v.vRotate(-1e-6);
  EXPECT_TRUE(Same(v, 1, 0));
  v.vRotate(std::nextafter(1e-6, 1.0));
  EXPECT_TRUE(Same(v, 1, 1e-6F));
}

TEST(dVect2DAngle, RotatesAPointAboutACentre) {
  dVect2D p(3.0F, 1.0F);
  p.pRotate(dVect2D(1.0F, 1.0F), kQuarter);
  EXPECT_NEAR(p.x, 1.0, 1e-7);
  EXPECT_EQ(p.y, 3.0F);
  p.pRotate(p, 1.0);  // about itself
  EXPECT_NEAR(p.x, 1.0, 1e-7);
  EXPECT_EQ(p.y, 3.0F);
}

TEST(dVect2DAngle, RotationAboutACentreRoundsEachStep) {
  Numbers numbers(7);
  for (int i = 0; i < 1000; ++i) {
    const dVect2D p = numbers.Next2D();
    const dVect2D centre = numbers.Next2D();
    const double angle = numbers.NextDouble();
    const double c = std::cos(angle), s = std::sin(angle);
    const double x = Round(static_cast<double>(p.x) - centre.x);
    const double y = Round(static_cast<double>(p.y) - centre.y);
    dVect2D rotated(p);
    rotated.pRotate(centre, angle);
    ASSERT_TRUE(Same(rotated, static_cast<double>(Round(x * c - y * s)) + centre.x,
                     static_cast<double>(Round(x * s + y * c)) + centre.y));
  }
}

TEST(dVect2DAngle, RotationAboutACentreByNothingStillSubtractsAndAdds) {
  dVect2D p(1.0F, std::ldexp(1.0F, -30));
  p.pRotate(dVect2D(0.0F, 1.0F), 0.0);  // the small part is lost on the way
  EXPECT_TRUE(Same(p, 1, 0));
}

}  // namespace
