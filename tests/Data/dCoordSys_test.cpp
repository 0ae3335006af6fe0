#include <vorl/Data/dCoordSys.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Round;
using geometry_testing::Same;

TEST(dCoordSys1D, StartsAtZeroWithUnitScale) {
  dCoordSys1D system;
  EXPECT_EQ(system.origin, 0.0);
  EXPECT_EQ(system.scale, 1.0);
  system.Set(3.0, 4.0);
  system.Reset();
  EXPECT_EQ(system.origin, 0.0);
  EXPECT_EQ(system.scale, 1.0);
}

TEST(dCoordSys1D, TakesOriginAndScale) {
  const dCoordSys1D built(1.5, 0.1);
  EXPECT_EQ(built.origin, 1.5);
  EXPECT_EQ(built.scale, 0.1);  // not rounded to single precision
  dCoordSys1D set;
  set.Set(1.5, 0.1);
  EXPECT_EQ(set.origin, 1.5);
  EXPECT_EQ(set.scale, 0.1);
}

TEST(dCoordSys1D, Copies) {
  const dCoordSys1D source(1.5, 0.1);
  const dCoordSys1D copy(source);
  dCoordSys1D assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  for (const dCoordSys1D* system : {&copy, &static_cast<const dCoordSys1D&>(assigned)}) {
    EXPECT_EQ(system->origin, 1.5);
    EXPECT_EQ(system->scale, 0.1);
  }
}

TEST(dCoordSys1D, IsValidUnlessTheScaleIsZero) {
  dCoordSys1D system;
  EXPECT_TRUE(system.IsValid());
  system.scale = 0.0;
  EXPECT_FALSE(system.IsValid());
  system.scale = -0.0;
  EXPECT_FALSE(system.IsValid());
  system.scale = 1e-300;
  EXPECT_TRUE(system.IsValid());
  system.scale = std::numeric_limits<double>::quiet_NaN();
  EXPECT_TRUE(system.IsValid());
}

TEST(dCoordSys1D, MovesAndScales) {
  dCoordSys1D system(1.0, 2.0);
  system.Move(0.5);
  EXPECT_EQ(system.origin, 1.5);
  system.Scale(4);
  EXPECT_EQ(system.origin, 1.5);
  EXPECT_EQ(system.scale, 8.0);
}

TEST(dCoordSys1D, ScalingAboutACentreMovesTheOriginTowardsIt) {
  dCoordSys1D system;
  system.Scale(2, 10);
  EXPECT_EQ(system.origin, 10.0);
  EXPECT_EQ(system.scale, 2.0);
  system.Scale(0.5, 20.0);
  EXPECT_EQ(system.origin, 5.0);
  EXPECT_EQ(system.scale, 1.0);
}

::testing::AssertionResult IsUnit(const dCoordSys2D& system) {
  const auto result = Same(system.origin, 0, 0);
  return result ? (Same(system.axisX, 1, 0) ? Same(system.axisY, 0, 1) : Same(system.axisX, 1, 0))
                : result;
}

const dVect2D kOrigin2(1.0F, 2.0F), kX2(3.0F, 4.0F), kY2(-5.0F, 6.0F);

void ExpectSample(const dCoordSys2D& system) {
  EXPECT_TRUE(Same(system.origin, kOrigin2));
  EXPECT_TRUE(Same(system.axisX, kX2));
  EXPECT_TRUE(Same(system.axisY, kY2));
}

TEST(dCoordSys2D, StartsWithUnitAxes) {
  dCoordSys2D system;
  EXPECT_TRUE(IsUnit(system));
  EXPECT_TRUE(system.IsValid());
  system.Set(kOrigin2, kX2, kY2);
  system.Reset();
  EXPECT_TRUE(IsUnit(system));
}

TEST(dCoordSys2D, TakesOriginAndAxes) {
  const dCoordSys2D built(kOrigin2, kX2, kY2);
  ExpectSample(built);
  ExpectSample(dCoordSys2D(built));
  dCoordSys2D system;
  system.Set(kOrigin2, kX2, kY2);
  ExpectSample(system);
  dCoordSys2D assigned;
  EXPECT_EQ(&(assigned = system), &assigned);
  ExpectSample(assigned);
  system.Set(kX2, kY2, dVect2D());
  EXPECT_TRUE(system.IsValid());  // whatever the axes
}

TEST(dCoordSys2D, SetTakesItsOwnVectors) {
  dCoordSys2D system(kY2, kOrigin2, kX2);
  system.Set(system.axisX, system.axisY, system.origin);
  ExpectSample(system);
}

TEST(dCoordSys2D, MoveRoundsTheDistancesFirst) {
  dCoordSys2D system(dVect2D(1.0F, 1.0F), kX2, kY2);
  system.Move(2, 3);
  EXPECT_TRUE(Same(system.origin, 3, 4));
  system.Move(dVect2D(-2.0F, 1.0F));
  EXPECT_TRUE(Same(system.origin, 1, 5));
  EXPECT_TRUE(Same(system.axisX, kX2));
  EXPECT_TRUE(Same(system.axisY, kY2));
  // Half a step of the origin and a little more: the little is lost first, and the half to the even
  // neighbour.
  const double half = std::ldexp(1.0, -24);
  system.origin.Set(1, 1);
  system.Move(half + std::ldexp(1.0, -50), half + std::ldexp(1.0, -50));
  EXPECT_TRUE(Same(system.origin, 1, 1));
}

TEST(dCoordSys2D, ScalesTheAxesByUnroundedFactors) {
  Numbers numbers(31);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect2D origin = numbers.Next2D(), x = numbers.Next2D(), y = numbers.Next2D();
    const double fx = numbers.NextDouble(), fy = numbers.NextDouble();
    dCoordSys2D system(origin, x, y);
    system.Scale(fx, fy);
    ASSERT_TRUE(Same(system.origin, origin));
    ASSERT_TRUE(Same(system.axisX, x.x * fx, x.y * fx));
    ASSERT_TRUE(Same(system.axisY, y.x * fy, y.y * fy));
    differing += system.axisX.x != Round(x.x * static_cast<double>(Round(fx)));
  }
  EXPECT_GT(differing, 0);
}

TEST(dCoordSys2D, ScalingAboutACentreMovesTheOriginTowardsIt) {
  dCoordSys2D system(dVect2D(1.0F, 2.0F), dVect2D(1.0F, 2.0F), dVect2D(3.0F, 4.0F));
  system.Scale(2, 3, dVect2D(11.0F, 12.0F));
  EXPECT_TRUE(Same(system.origin, 11, 22));
  EXPECT_TRUE(Same(system.axisX, 2, 4));
  EXPECT_TRUE(Same(system.axisY, 9, 12));
}

TEST(dCoordSys2D, ScalingAboutACentreRoundsTheProductBeforeAdding) {
  Numbers numbers(32);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect2D o = numbers.Next2D(), c = numbers.Next2D();
    const double fx = numbers.NextDouble(), fy = numbers.NextDouble();
    const double ox = o.x, oy = o.y;
    dCoordSys2D system(o, kX2, kY2);
    system.Scale(fx, fy, c);
    ASSERT_TRUE(
        Same(system.origin, ox + Round((fx - 1) * (c.x - ox)), oy + Round((fy - 1) * (c.y - oy))));
    ASSERT_TRUE(Same(system.axisX, kX2.x * fx, kX2.y * fx));
    ASSERT_TRUE(Same(system.axisY, kY2.x * fy, kY2.y * fy));
    differing += system.origin.x != Round(ox + (fx - 1) * (c.x - ox));
  }
  EXPECT_GT(differing, 0);
}

}  // namespace
