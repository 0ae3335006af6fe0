// Hit tests.

#include <vorl/GUI/Geom2D.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

#include <vorl/Platform/Gdi.h>

#include "../Data/GeometryTesting.h"

namespace {

using geometry_testing::Numbers;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();

TEST(Geom2DPoint, IsHitWithinTheTrueDistance) {
  const dVect2D q(10.0F, 20.0F);
  EXPECT_TRUE(Geom2D::IsPointOnPoint(dVect2D(13.0F, 24.0F), q, 5));
  EXPECT_TRUE(Geom2D::IsPointOnPoint(dVect2D(7.0F, 16.0F), q, 5.0));
  EXPECT_FALSE(Geom2D::IsPointOnPoint(dVect2D(13.0F, 24.001F), q, 5));
  EXPECT_FALSE(Geom2D::IsPointOnPoint(dVect2D(14.0F, 24.0F), q, 5));
}

TEST(Geom2DPoint, WithoutToleranceOnlyItselfIsHit) {
  const dVect2D q(10.0F, 20.0F);
  EXPECT_TRUE(Geom2D::IsPointOnPoint(q, q, 0));
  EXPECT_FALSE(Geom2D::IsPointOnPoint(dVect2D(10.000001F, 20.0F), q, 0));
}

TEST(Geom2DPoint, IntegerPointsAreHitAlike) {
  EXPECT_TRUE(Geom2D::IsPointOnPoint(tagPOINT{13, 24}, tagPOINT{10, 20}, 5));
  EXPECT_FALSE(Geom2D::IsPointOnPoint(tagPOINT{13, 25}, tagPOINT{10, 20}, 5));
  EXPECT_FALSE(Geom2D::IsPointOnPoint(tagPOINT{14, 24}, tagPOINT{10, 20}, 5));
}

TEST(Geom2DPoint, IntegerPointsFarOutAreTakenExactly) {
  // In single precision both would be 16777216.
  EXPECT_FALSE(Geom2D::IsPointOnPoint(tagPOINT{16777216, 0}, tagPOINT{16777217, 0}, 0.5));
  const LONG lowest = std::numeric_limits<LONG>::min(), largest = std::numeric_limits<LONG>::max();
  EXPECT_FALSE(Geom2D::IsPointOnPoint(tagPOINT{lowest, 0}, tagPOINT{largest, 0}, 4e9));
  EXPECT_TRUE(Geom2D::IsPointOnPoint(tagPOINT{lowest, 0}, tagPOINT{largest, 0}, 4.3e9));
}

TEST(Geom2DPoint, DifferencesAreRoundedToSinglePrecision) {
  // The difference 16777217 becomes 16777216.
  EXPECT_TRUE(Geom2D::IsPointOnPoint(dVect2D(-16777216.0F, 0.0F), dVect2D(1.0F, 0.0F), 16777216));
  EXPECT_TRUE(Geom2D::IsPointOnPoint(tagPOINT{0, 0}, tagPOINT{16777217, 0}, 16777216));
}

TEST(Geom2DPoint, TheSignOfAToleranceDoesNotMatter) {
  EXPECT_TRUE(Geom2D::IsPointOnPoint(dVect2D(3.0F, 4.0F), dVect2D(), -5));
}

TEST(Geom2DPoint, WhatIsNotANumberHitsNothing) {
  EXPECT_FALSE(Geom2D::IsPointOnPoint(dVect2D(kNaN, 0.0F), dVect2D(), 5));
  EXPECT_FALSE(Geom2D::IsPointOnPoint(dVect2D(), dVect2D(0.0F, kInfinity), 5));
}

TEST(Geom2DLine, IsHitAlongItsWholeLength) {
  const dVect2D pos(10.0F, 20.0F), dir(3.0F, 4.0F);
  for (const float t : {-100.0F, -1.0F, 0.0F, 0.5F, 1.0F, 100.0F}) {
    // Beside the line by 5 times (-4, 3) / 5.
    const dVect2D beside(10.0F + 3.0F * t - 4.0F, 20.0F + 4.0F * t + 3.0F);
    EXPECT_TRUE(Geom2D::IsPointOnLine(beside, pos, dir, 5.001)) << t;
    EXPECT_FALSE(Geom2D::IsPointOnLine(beside, pos, dir, 4.999)) << t;
  }
}

TEST(Geom2DLine, TheToleranceItselfIsAHit) {
  const dVect2D pos(0.0F, 2.0F), dir(7.0F, 0.0F);
  EXPECT_TRUE(Geom2D::IsPointOnLine(dVect2D(-50.0F, 5.0F), pos, dir, 3));
  EXPECT_FALSE(Geom2D::IsPointOnLine(dVect2D(-50.0F, 5.00001F), pos, dir, 3));
}

TEST(Geom2DLine, TheLengthOfTheDirectionDoesNotMatter) {
  for (const float length : {1e-30F, 1.0F, 1e18F}) {
    EXPECT_TRUE(Geom2D::IsPointOnLine(dVect2D(9.0F, 2.0F), dVect2D(), dVect2D(length, 0.0F), 2));
    EXPECT_FALSE(Geom2D::IsPointOnLine(dVect2D(9.0F, 3.0F), dVect2D(), dVect2D(length, 0.0F), 2));
  }
}

TEST(Geom2DLine, WithoutADirectionNothingIsHit) {
  EXPECT_FALSE(Geom2D::IsPointOnLine(dVect2D(1.0F, 1.0F), dVect2D(1.0F, 1.0F), dVect2D(), 5));
  EXPECT_FALSE(Geom2D::IsPointOnLine(dVect2D(2.0F, 1.0F), dVect2D(1.0F, 1.0F), dVect2D(), 5));
  EXPECT_FALSE(Geom2D::IsPointOnLine(dVect2D(2.0F, 1.0F), dVect2D(), dVect2D(kInfinity, 0.0F), 5));
}

TEST(Geom2DSegment, IsHitBesideItOnly) {
  const dVect2D a(10.0F, 10.0F), b(20.0F, 10.0F);
  EXPECT_TRUE(Geom2D::IsPointOnLineSegment(dVect2D(15.0F, 13.0F), a, b, 3));
  EXPECT_TRUE(Geom2D::IsPointOnLineSegment(dVect2D(15.0F, 7.0F), b, a, 3));
  EXPECT_FALSE(Geom2D::IsPointOnLineSegment(dVect2D(15.0F, 13.01F), a, b, 3));
}

TEST(Geom2DSegment, TheEndsBelongToIt) {
  const dVect2D a(10.0F, 10.0F), b(20.0F, 10.0F);
  EXPECT_TRUE(Geom2D::IsPointOnLineSegment(dVect2D(10.0F, 13.0F), a, b, 3));
  EXPECT_TRUE(Geom2D::IsPointOnLineSegment(dVect2D(20.0F, 7.0F), a, b, 3));
  EXPECT_TRUE(Geom2D::IsPointOnLineSegment(a, a, b, 0));
  EXPECT_TRUE(Geom2D::IsPointOnLineSegment(b, a, b, 0));
}

TEST(Geom2DSegment, BeyondAnEndNothingIsHit) {
  const dVect2D a(10.0F, 10.0F), b(20.0F, 10.0F);
  EXPECT_FALSE(Geom2D::IsPointOnLineSegment(dVect2D(9.999F, 10.0F), a, b, 3));
  EXPECT_FALSE(Geom2D::IsPointOnLineSegment(dVect2D(20.001F, 10.0F), a, b, 3));
}

TEST(Geom2DSegment, EqualEndsAreNeverHit) {
  const dVect2D a(10.0F, 10.0F);
  EXPECT_FALSE(Geom2D::IsPointOnLineSegment(a, a, a, 3));
  EXPECT_FALSE(Geom2D::IsPointOnLineSegment(dVect2D(kNaN, 0.0F), a, dVect2D(), 3));
}

TEST(Geom2DSegment, FollowsItsDefinition) {
  Numbers numbers(171);
  int hits = 0;
  for (int i = 0; i < 5000; ++i) {
    const dVect2D p = numbers.Next2D(), a = numbers.Next2D(), b = numbers.Next2D();
    const double tolerance = std::abs(numbers.Next());
    const float dx = b.x - a.x, dy = b.y - a.y, rx = p.x - a.x, ry = p.y - a.y;
    const double along = double{rx} * dx + double{ry} * dy;
    const double t = along / (double{dx} * dx + double{dy} * dy);
    const double x = rx - t * dx, y = ry - t * dy;
    const bool isNear = x * x + y * y <= tolerance * tolerance;
    ASSERT_EQ(Geom2D::IsPointOnLine(p, a, dVect2D(dx, dy), tolerance), isNear);
    const bool isOn = t >= 0 && t <= 1 && isNear;
    ASSERT_EQ(Geom2D::IsPointOnLineSegment(p, a, b, tolerance), isOn);
    hits += isOn ? 1 : 0;
  }
  EXPECT_GT(hits, 200);
  EXPECT_LT(hits, 4800);
}

TEST(Geom2DRect, ItsOutlineIsHitFromBothSides) {
  const Rect2D rect(10, 20, 50, 80);
  for (const dVect2D& p : {dVect2D(10.0F, 50.0F), dVect2D(50.0F, 50.0F), dVect2D(30.0F, 20.0F),
                           dVect2D(30.0F, 80.0F), dVect2D(12.0F, 50.0F), dVect2D(52.0F, 50.0F),
                           dVect2D(30.0F, 18.0F), dVect2D(30.0F, 78.0F), dVect2D(10.0F, 20.0F)}) {
    EXPECT_TRUE(Geom2D::IsPointOnRect(p, rect, 2)) << p.x << ' ' << p.y;
  }
  for (const dVect2D& p : {dVect2D(30.0F, 50.0F), dVect2D(12.1F, 50.0F), dVect2D(52.1F, 50.0F),
                           dVect2D(30.0F, 17.9F), dVect2D(30.0F, 77.9F)}) {
    EXPECT_FALSE(Geom2D::IsPointOnRect(p, rect, 2)) << p.x << ' ' << p.y;
  }
}

TEST(Geom2DRect, CornersAreRound) {
  const Rect2D rect(50, 80, 10, 20);  // in any order
  EXPECT_TRUE(Geom2D::IsPointOnRect(dVect2D(7.0F, 16.0F), rect, 5));
  EXPECT_TRUE(Geom2D::IsPointOnRect(dVect2D(53.0F, 16.0F), rect, 5));
  EXPECT_TRUE(Geom2D::IsPointOnRect(dVect2D(53.0F, 84.0F), rect, 5));
  EXPECT_TRUE(Geom2D::IsPointOnRect(dVect2D(7.0F, 84.0F), rect, 5));
  EXPECT_FALSE(Geom2D::IsPointOnRect(dVect2D(6.0F, 16.0F), rect, 5));
}

TEST(Geom2DRect, EmptyRectanglesAreHitToo) {
  EXPECT_TRUE(Geom2D::IsPointOnRect(dVect2D(3.0F, 4.0F), Rect2D(), 5));
  EXPECT_FALSE(Geom2D::IsPointOnRect(dVect2D(3.0F, 4.1F), Rect2D(), 5));
  EXPECT_TRUE(Geom2D::IsPointOnRect(dVect2D(5.0F, 2.0F), Rect2D(0, 0, 10, 0), 2));
}

TEST(Geom2DRect, IsHitByItsDistance) {
  Numbers numbers(172);
  int hits = 0;
  for (int i = 0; i < 5000; ++i) {
    const dVect2D a = numbers.Next2D(), b = numbers.Next2D(), p = numbers.Next2D();
    const double tolerance = std::abs(numbers.Next());
    const double x1 = std::min(a.x, b.x), x2 = std::max(a.x, b.x);
    const double y1 = std::min(a.y, b.y), y2 = std::max(a.y, b.y);
    // Inside, to the nearest edge; outside, to the nearest point of the rectangle.
    const double outX = std::max({x1 - p.x, p.x - x2, 0.0});
    const double outY = std::max({y1 - p.y, p.y - y2, 0.0});
    const double in = std::min({p.x - x1, x2 - p.x, p.y - y1, y2 - p.y});
    const double distance = in > 0.0 ? in : std::hypot(outX, outY);
    if (std::abs(distance - tolerance) < 1e-4) {
      continue;  // too near to tell with rounded differences
    }
    ASSERT_EQ(Geom2D::IsPointOnRect(p, Rect2D(a, b), tolerance), distance <= tolerance) << i;
    hits += distance <= tolerance ? 1 : 0;
  }
  EXPECT_GT(hits, 500);
  EXPECT_LT(hits, 4500);
}

}  // namespace
