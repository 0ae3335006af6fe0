#include <vorl/GUI/Geom2D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "../Data/GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Same;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
const dVect3D kOrigin;
const dVect3D kX(1.0F, 0.0F, 0.0F);
const dVect3D kY(0.0F, 1.0F, 0.0F);
const dVect3D kZ(0.0F, 0.0F, 1.0F);

TEST(Geom3DLinePlane, MeetInAPoint) {
  dVect3D p;
  ASSERT_TRUE(Geom3D::LinePlaneIntersection(dVect3D(1.0F, 2.0F, 3.0F), dVect3D(1.0F, 1.0F, 2.0F),
                                            dVect3D(0.0F, 0.0F, 7.0F), kZ, p));
  EXPECT_TRUE(Same(p, 3, 4, 7));
}

TEST(Geom3DLinePlane, TheLineGoesBothWaysAndLengthsDoNotMatter) {
  dVect3D p;
  for (const float length : {-5.0F, 1e-20F, 1e18F}) {
    ASSERT_TRUE(Geom3D::LinePlaneIntersection(dVect3D(1.0F, 2.0F, 3.0F),
                                              dVect3D(0.0F, 0.0F, length), kOrigin,
                                              dVect3D(0.0F, 0.0F, -length), p));
    EXPECT_TRUE(Same(p, 1, 2, 0));
  }
}

TEST(Geom3DLinePlane, ALineAlongThePlaneDoesNotMeetIt) {
  dVect3D p(7.0F, 8.0F, 9.0F);
  EXPECT_FALSE(Geom3D::LinePlaneIntersection(kZ, kX, kOrigin, kZ, p));
  EXPECT_FALSE(Geom3D::LinePlaneIntersection(kOrigin, kX, kOrigin, kZ, p));  // in it
  EXPECT_FALSE(Geom3D::LinePlaneIntersection(kZ, dVect3D(1.0F, 0.0F, 9e-7F), kOrigin, kZ, p));
  EXPECT_TRUE(Same(p, 7, 8, 9));
  EXPECT_TRUE(Geom3D::LinePlaneIntersection(kZ, dVect3D(1.0F, 0.0F, 2e-6F), kOrigin, kZ, p));
  EXPECT_NEAR(p.x, -500000.0, 1.0);
}

TEST(Geom3DLinePlane, WithoutDirectionOrNumbersThereIsNoPoint) {
  dVect3D p(7.0F, 8.0F, 9.0F);
  EXPECT_FALSE(Geom3D::LinePlaneIntersection(kZ, kOrigin, kOrigin, kZ, p));
  EXPECT_FALSE(Geom3D::LinePlaneIntersection(kZ, kZ, kOrigin, kOrigin, p));
  for (const dVect3D& bad : {dVect3D(kNaN, 0.0F, 1.0F), dVect3D(0.0F, 0.0F, kInfinity)}) {
    EXPECT_FALSE(Geom3D::LinePlaneIntersection(bad, kZ, kOrigin, kZ, p));
    EXPECT_FALSE(Geom3D::LinePlaneIntersection(kOrigin, bad, kOrigin, kZ, p));
    EXPECT_FALSE(Geom3D::LinePlaneIntersection(kOrigin, kZ, bad, kZ, p));
    EXPECT_FALSE(Geom3D::LinePlaneIntersection(kOrigin, kZ, kOrigin, bad, p));
  }
  // It is met beyond the largest number.
  EXPECT_FALSE(Geom3D::LinePlaneIntersection(dVect3D(0.0F, 0.0F, 3e38F), dVect3D(1.0F, 0.0F, 1e-3F),
                                             kOrigin, kZ, p));
  EXPECT_TRUE(Same(p, 7, 8, 9));
}

TEST(Geom3DLinePlane, TheOutputMayBeAnInput) {
  dVect3D p(1.0F, 2.0F, 3.0F);
  ASSERT_TRUE(Geom3D::LinePlaneIntersection(p, dVect3D(1.0F, 1.0F, 2.0F), dVect3D(0.0F, 0.0F, 7.0F),
                                            kZ, p));
  EXPECT_TRUE(Same(p, 3, 4, 7));
}

/// The distance of a point from a plane.
double Distance(const dVect3D& p, const dVect3D& pos, const dVect3D& normal) {
  return std::abs(dVect3D(pos, p).Product(normal)) / normal.Length();
}

/// The distance of a point from a line.
double DistanceFromLine(const dVect3D& p, const dVect3D& pos, const dVect3D& dir) {
  return (dVect3D(pos, p) * dir).Length() / dir.Length();
}

TEST(Geom3DLinePlane, ThePointLiesOnBoth) {
  Numbers numbers(191);
  for (int i = 0; i < 2000; ++i) {
    const dVect3D linePos = numbers.Next3D(), dir = numbers.Next3D();
    const dVect3D planePos = numbers.Next3D(), normal = numbers.Next3D();
    const double sine = std::abs(dir.Product(normal)) / (dir.Length() * normal.Length());
    if (sine < 1e-3) {
      continue;
    }
    dVect3D p;
    ASSERT_TRUE(Geom3D::LinePlaneIntersection(linePos, dir, planePos, normal, p));
    const double tolerance = 1e-6 * (p.Length() + linePos.Length() + planePos.Length() + 1.0);
    ASSERT_LT(Distance(p, planePos, normal), tolerance);
    ASSERT_LT(DistanceFromLine(p, linePos, dir), 10 * tolerance);
  }
}

TEST(Geom3DPlanes, ShareALine) {
  dVect3D pos, dir;
  ASSERT_TRUE(Geom3D::PlaneIntersection(dVect3D(5.0F, 6.0F, 7.0F), kZ, dVect3D(1.0F, 2.0F, 3.0F),
                                        dVect3D(4.0F, 0.0F, 0.0F), pos, dir));
  EXPECT_TRUE(Same(pos, 1, 6, 7));  // the nearest to the first point
  EXPECT_TRUE(Same(dir, 0, 1, 0));  // z x x
  ASSERT_TRUE(Geom3D::PlaneIntersection(dVect3D(1.0F, 2.0F, 3.0F), dVect3D(4.0F, 0.0F, 0.0F),
                                        dVect3D(5.0F, 6.0F, 7.0F), kZ, pos, dir));
  EXPECT_TRUE(Same(pos, 1, 2, 7));
  EXPECT_TRUE(Same(dir, 0, -1, 0));
}

TEST(Geom3DPlanes, ParallelsShareNone) {
  dVect3D pos(7.0F, 8.0F, 9.0F), dir(1.0F, 2.0F, 3.0F);
  EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, kZ, kX, kZ, pos, dir));  // the same
  EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, kZ, kZ, dVect3D(0.0F, 0.0F, -9.0F), pos, dir));
  EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, kZ, kZ, dVect3D(9e-7F, 0.0F, 1.0F), pos, dir));
  EXPECT_TRUE(Same(pos, 7, 8, 9));
  EXPECT_TRUE(Same(dir, 1, 2, 3));
  EXPECT_TRUE(Geom3D::PlaneIntersection(kOrigin, kZ, kZ, dVect3D(2e-6F, 0.0F, 1.0F), pos, dir));
}

TEST(Geom3DPlanes, WithoutNormalOrNumbersThereIsNoLine) {
  dVect3D pos(7.0F, 8.0F, 9.0F), dir(1.0F, 2.0F, 3.0F);
  EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, kOrigin, kOrigin, kX, pos, dir));
  EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, kZ, kOrigin, kOrigin, pos, dir));
  for (const dVect3D& bad : {dVect3D(kNaN, 0.0F, 1.0F), dVect3D(0.0F, 1.0F, kInfinity)}) {
    EXPECT_FALSE(Geom3D::PlaneIntersection(bad, kX, kOrigin, kZ, pos, dir));
    EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, bad, kOrigin, kX, pos, dir));
    EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, kX, bad, kY, pos, dir));
    EXPECT_FALSE(Geom3D::PlaneIntersection(kOrigin, kX, kOrigin, bad, pos, dir));
  }
  EXPECT_TRUE(Same(pos, 7, 8, 9));
  EXPECT_TRUE(Same(dir, 1, 2, 3));
}

TEST(Geom3DPlanes, TheOutputsMayBeTheInputs) {
  dVect3D pos(5.0F, 6.0F, 7.0F), normal(kZ);
  ASSERT_TRUE(Geom3D::PlaneIntersection(pos, normal, dVect3D(1.0F, 2.0F, 3.0F), kX, pos, normal));
  EXPECT_TRUE(Same(pos, 1, 6, 7));
  EXPECT_TRUE(Same(normal, 0, 1, 0));
}

TEST(Geom3DPlanes, TheLineLiesInBoth) {
  Numbers numbers(192);
  for (int i = 0; i < 2000; ++i) {
    const dVect3D pos1 = numbers.Next3D(), normal1 = numbers.Next3D();
    const dVect3D pos2 = numbers.Next3D(), normal2 = numbers.Next3D();
    const double sine = (normal1 * normal2).Length() / (normal1.Length() * normal2.Length());
    if (sine < 1e-3) {
      continue;
    }
    dVect3D pos, dir;
    ASSERT_TRUE(Geom3D::PlaneIntersection(pos1, normal1, pos2, normal2, pos, dir));
    const double tolerance = 1e-6 * (pos.Length() + pos1.Length() + pos2.Length() + 1.0);
    ASSERT_LT(Distance(pos, pos1, normal1), tolerance);
    ASSERT_LT(Distance(pos, pos2, normal2), tolerance);
    ASSERT_NEAR(dir.Length(), 1.0, 1e-6);
    ASSERT_NEAR(dir.Product(normal1) / normal1.Length(), 0.0, 1e-6);
    ASSERT_NEAR(dir.Product(normal2) / normal2.Length(), 0.0, 1e-6);
    ASSERT_NEAR(dVect3D(pos1, pos).Product(dir), 0.0, tolerance);
    ASSERT_GT(dir.Product(normal1 * normal2), 0.0);
  }
}

}  // namespace
