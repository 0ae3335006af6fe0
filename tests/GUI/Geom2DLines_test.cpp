// Clipping and intersection of lines.

#include <vorl/GUI/Geom2D.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>
#include <random>

#include <vorl/Platform/Gdi.h>

#include "../Data/GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Same;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
const tagRECT kRect = {10, 20, 50, 60};

TEST(Geom2DClipLine, GivesThePieceInTheDirectionOfTheLine) {
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(0.0F, 30.0F), dVect2D(1.0F, 30.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 10, 30));
  EXPECT_TRUE(Same(end, 50, 30));
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(1.0F, 30.0F), dVect2D(0.0F, 30.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 50, 30));
  EXPECT_TRUE(Same(end, 10, 30));
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(30.0F, 99.0F), dVect2D(30.0F, 98.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 30, 60));
  EXPECT_TRUE(Same(end, 30, 20));
}

TEST(Geom2DClipLine, GoesBeyondTheTwoPoints) {
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(30.0F, 40.0F), dVect2D(31.0F, 42.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 20, 20));
  EXPECT_TRUE(Same(end, 40, 60));
}

TEST(Geom2DClipLine, CutsCornersOffSlantedLines) {
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(0.0F, 35.0F), dVect2D(35.0F, 0.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 10, 25));
  EXPECT_TRUE(Same(end, 15, 20));
}

TEST(Geom2DClipLine, TheEdgesBelongToTheRectangle) {
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(0.0F, 60.0F), dVect2D(1.0F, 60.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 10, 60));
  EXPECT_TRUE(Same(end, 50, 60));
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(10.0F, 0.0F), dVect2D(10.0F, 1.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 10, 20));
  EXPECT_TRUE(Same(end, 10, 60));
}

TEST(Geom2DClipLine, ATouchedCornerComesTwice) {
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(0.0F, 30.0F), dVect2D(30.0F, 0.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 10, 20));
  EXPECT_TRUE(Same(end, 10, 20));
}

TEST(Geom2DClipLine, ALineThatMissesLeavesTheOutputs) {
  dVect2D start(1.0F, 2.0F), end(3.0F, 4.0F);
  EXPECT_FALSE(Geom2D::ClipLine(dVect2D(0.0F, 29.0F), dVect2D(29.0F, 0.0F), kRect, start, end));
  EXPECT_FALSE(Geom2D::ClipLine(dVect2D(0.0F, 19.0F), dVect2D(1.0F, 19.0F), kRect, start, end));
  EXPECT_FALSE(Geom2D::ClipLine(dVect2D(0.0F, 61.0F), dVect2D(1.0F, 61.0F), kRect, start, end));
  EXPECT_FALSE(Geom2D::ClipLine(dVect2D(9.0F, 0.0F), dVect2D(9.0F, 1.0F), kRect, start, end));
  EXPECT_FALSE(Geom2D::ClipLine(dVect2D(51.0F, 0.0F), dVect2D(51.0F, 1.0F), kRect, start, end));
  EXPECT_TRUE(Same(start, 1, 2));
  EXPECT_TRUE(Same(end, 3, 4));
}

TEST(Geom2DClipLine, EndsLieExactlyOnTheEdgesHoweverFarThePointsAre) {
  // At such distances the plain sum of point and way misses the edge.
  Numbers numbers(183);
  for (int i = 0; i < 200; ++i) {
    const float distance = 1e12F * (1.0F + std::abs(numbers.Next()));
    const float step = 1.0F + std::abs(numbers.Next());
    dVect2D start, end;
    ASSERT_TRUE(Geom2D::ClipLine(dVect2D(-distance, 30.0F), dVect2D(distance * step, 30.0F), kRect,
                                 start, end));
    ASSERT_TRUE(Same(start, 10, 30));
    ASSERT_TRUE(Same(end, 50, 30));
    ASSERT_TRUE(Geom2D::ClipLine(dVect2D(40.0F, distance), dVect2D(40.0F, -distance * step), kRect,
                                 start, end));
    ASSERT_TRUE(Same(start, 40, 60));
    ASSERT_TRUE(Same(end, 40, 20));
  }
}

TEST(Geom2DClipLine, EndsNeverLieOutside) {
  // Past a corner from very far: the coordinate that is not cut is rounded to either side of it.
  Numbers numbers(184);
  const Rect2D edges(kRect);
  int hits = 0;
  for (int i = 0; i < 2000; ++i) {
    const float farX = -1e15F * (1.0F + std::abs(numbers.Next()));
    const float farY = -1e15F * (1.0F + std::abs(numbers.Next()));
    dVect2D start, end;
    const dVect2D nearCorner(50.0F + 0.1F * numbers.Next(), 60.0F + 0.1F * numbers.Next());
    if (Geom2D::ClipLine(dVect2D(farX, farY), nearCorner, kRect, start, end)) {
      ++hits;
      ASSERT_TRUE(edges.IsInside(start)) << start.x << ' ' << start.y;
      ASSERT_TRUE(edges.IsInside(end)) << end.x << ' ' << end.y;
    }
  }
  EXPECT_GT(hits, 100);
}

TEST(Geom2DClipLine, TakesAnAngleInRadians) {
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(30.0F, 40.0F), 0, kRect, start, end));
  EXPECT_TRUE(Same(start, 10, 40));
  EXPECT_TRUE(Same(end, 50, 40));
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(30.0F, 40.0F), std::numbers::pi / 2, kRect, start, end));
  EXPECT_NEAR(start.x, 30.0, 1e-5);
  EXPECT_EQ(start.y, 20.0F);
  EXPECT_NEAR(end.x, 30.0, 1e-5);
  EXPECT_EQ(end.y, 60.0F);
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(30.0F, 40.0F), -std::atan2(1, 2), kRect, start, end));
  EXPECT_EQ(start.x, 10.0F);
  EXPECT_NEAR(start.y, 50.0, 1e-5);
  EXPECT_EQ(end.x, 50.0F);
  EXPECT_NEAR(end.y, 30.0, 1e-5);
  EXPECT_FALSE(Geom2D::ClipLine(dVect2D(30.0F, 19.0F), std::numbers::pi, kRect, start, end));
}

TEST(Geom2DClipLine, TheOrderOfTheEdgesDoesNotMatter) {
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(30.0F, 40.0F), dVect2D(31.0F, 42.0F),
                               tagRECT{50, 60, 10, 20}, start, end));
  EXPECT_TRUE(Same(start, 20, 20));
  EXPECT_TRUE(Same(end, 40, 60));
}

TEST(Geom2DClipLine, EmptyRectanglesAreCutInOnePoint) {
  dVect2D start, end;
  ASSERT_TRUE(
      Geom2D::ClipLine(dVect2D(0.0F, 0.0F), dVect2D(1.0F, 1.0F), tagRECT{5, 0, 5, 9}, start, end));
  EXPECT_TRUE(Same(start, 5, 5));
  EXPECT_TRUE(Same(end, 5, 5));
}

TEST(Geom2DClipLine, TheOutputsMayBeTheInputs) {
  dVect2D a(30.0F, 40.0F), b(31.0F, 42.0F);
  ASSERT_TRUE(Geom2D::ClipLine(a, b, kRect, b, a));
  EXPECT_TRUE(Same(b, 20, 20));
  EXPECT_TRUE(Same(a, 40, 60));
}

TEST(Geom2DClipLine, WithoutALineThereIsNoPiece) {
  dVect2D start(1.0F, 2.0F), end(3.0F, 4.0F);
  const dVect2D inside(30.0F, 40.0F);
  EXPECT_FALSE(Geom2D::ClipLine(inside, inside, kRect, start, end));
  for (const dVect2D& bad : {dVect2D(kNaN, 30.0F), dVect2D(30.0F, kInfinity)}) {
    EXPECT_FALSE(Geom2D::ClipLine(bad, inside, kRect, start, end));
    EXPECT_FALSE(Geom2D::ClipLine(inside, bad, kRect, start, end));
    EXPECT_FALSE(Geom2D::ClipLine(bad, 1.0, kRect, start, end));
  }
  EXPECT_FALSE(Geom2D::ClipLine(inside, double{kNaN}, kRect, start, end));
  EXPECT_FALSE(Geom2D::ClipLine(inside, double{kInfinity}, kRect, start, end));
  EXPECT_TRUE(Same(start, 1, 2));
  EXPECT_TRUE(Same(end, 3, 4));
}

TEST(Geom2DClipLine, WorksOnTheWholeRangeOfNumbers) {
  constexpr LONG kLowest = std::numeric_limits<LONG>::min();
  constexpr LONG kLargest = std::numeric_limits<LONG>::max();
  const tagRECT all = {kLowest, kLowest, kLargest, kLargest};
  dVect2D start, end;
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(), dVect2D(1e-45F, 0.0F), all, start, end));
  EXPECT_TRUE(Same(start, kLowest, 0));
  EXPECT_TRUE(Same(end, kLargest, 0));
  ASSERT_TRUE(Geom2D::ClipLine(dVect2D(), dVect2D(1e-45F, 3e38F), all, start, end));
  EXPECT_TRUE(Same(end, 0, kLargest));
  EXPECT_FALSE(Geom2D::ClipLine(dVect2D(3e38F, 3e38F), dVect2D(3e38F, -3e38F), all, start, end));
}

/// On which side of the line through a and b a point lies: the sign of the result.
double Side(const dVect2D& a, const dVect2D& b, double x, double y) {
  return (double{b.x} - a.x) * (y - a.y) - (double{b.y} - a.y) * (x - a.x);
}

TEST(Geom2DClipLine, EndsLieOnTheOutlineAndOnTheLine) {
  std::mt19937 engine(181);
  const auto next = [&] { return static_cast<int>(engine() % 201U) - 100; };
  int hits = 0;
  for (int i = 0; i < 5000; ++i) {
    const tagRECT rect = {next(), next(), next(), next()};
    const dVect2D a(static_cast<float>(next()), static_cast<float>(next()));
    const dVect2D b(static_cast<float>(next()), static_cast<float>(next()));
    if (a == b) {
      continue;
    }
    const auto sides = {Side(a, b, rect.left, rect.top), Side(a, b, rect.right, rect.top),
                        Side(a, b, rect.left, rect.bottom), Side(a, b, rect.right, rect.bottom)};
    const bool isHit = std::min(sides) <= 0.0 && std::max(sides) >= 0.0;
    dVect2D start, end;
    const bool isClipped = Geom2D::ClipLine(a, b, rect, start, end);
    if (std::min(sides) == 0.0 || std::max(sides) == 0.0) {
      continue;  // through a corner alone: whether rounding meets it is not said
    }
    ASSERT_EQ(isClipped, isHit) << i;
    if (!isHit) {
      continue;
    }
    ++hits;
    const Rect2D edges(rect);
    const dVect2D way(a, b);
    ASSERT_GE(way.Product(dVect2D(start, end)), 0.0);
    for (const dVect2D& p : {start, end}) {
      ASSERT_TRUE(edges.IsInside(p));
      ASSERT_TRUE(p.x == edges.GetTL().x || p.x == edges.GetBR().x ||  //
                  p.y == edges.GetTL().y || p.y == edges.GetBR().y);
      ASSERT_NEAR(Side(a, b, p.x, p.y) / way.Length(), 0.0, 1e-4);
    }
  }
  EXPECT_GT(hits, 1000);
}

TEST(Geom2DIntersection, IsWhereTheLinesMeet) {
  dVect2D p;
  ASSERT_TRUE(Geom2D::CalcIntersection(dVect2D(0.0F, 0.0F), dVect2D(4.0F, 4.0F),
                                       dVect2D(0.0F, 4.0F), dVect2D(4.0F, 0.0F), p));
  EXPECT_TRUE(Same(p, 2, 2));
}

TEST(Geom2DIntersection, LinesGoBeyondTheirPoints) {
  dVect2D p;
  ASSERT_TRUE(Geom2D::CalcIntersection(dVect2D(0.0F, 1.0F), dVect2D(1.0F, 1.0F),
                                       dVect2D(10.0F, 5.0F), dVect2D(10.0F, 6.0F), p));
  EXPECT_TRUE(Same(p, 10, 1));
}

TEST(Geom2DIntersection, ParallelsHaveNone) {
  dVect2D p(7.0F, 8.0F);
  const dVect2D a(0.0F, 0.0F), b(1.0F, 3.0F), c(5.0F, 0.0F);
  EXPECT_FALSE(Geom2D::CalcIntersection(a, b, c, dVect2D(6.0F, 3.0F), p));
  EXPECT_FALSE(Geom2D::CalcIntersection(a, b, c, dVect2D(4.0F, -3.0F), p));  // against each other
  EXPECT_FALSE(Geom2D::CalcIntersection(a, b, a, b, p));                     // the same line
  EXPECT_FALSE(Geom2D::CalcIntersection(a, b, b, b, p));                     // not a line
  EXPECT_FALSE(Geom2D::CalcIntersection(a, a, b, c, p));
  EXPECT_TRUE(Same(p, 7, 8));
}

TEST(Geom2DIntersection, ParallelIsWhatSinglePrecisionCannotTellApart) {
  dVect2D p;
  const dVect2D o(0.0F, 0.0F), x(1.0F, 0.0F);
  // Tenths of (1, 3), rounded: meant as parallel.
  EXPECT_FALSE(Geom2D::CalcIntersection(o, dVect2D(1.0F, 3.0F), o, dVect2D(0.1F, 0.3F), p));
  // The sine itself decides, whatever the lengths.
  EXPECT_FALSE(Geom2D::CalcIntersection(o, x, dVect2D(0.0F, 1.0F), dVect2D(1.0F, 1.0000005F), p));
  EXPECT_FALSE(Geom2D::CalcIntersection(o, dVect2D(1e20F, 0.0F), dVect2D(0.0F, 1.0F),
                                        dVect2D(1e20F, 5e13F), p));
  EXPECT_TRUE(Geom2D::CalcIntersection(o, dVect2D(1e-20F, 0.0F), o, dVect2D(1e-20F, 5e-25F), p));
}

TEST(Geom2DIntersection, BadNumbersHaveNone) {
  dVect2D p(7.0F, 8.0F);
  const dVect2D o, x(1.0F, 0.0F), y(0.0F, 1.0F);
  for (const dVect2D& bad : {dVect2D(kNaN, 1.0F), dVect2D(1.0F, kInfinity)}) {
    EXPECT_FALSE(Geom2D::CalcIntersection(bad, x, o, y, p));
    EXPECT_FALSE(Geom2D::CalcIntersection(o, bad, o, y, p));
    EXPECT_FALSE(Geom2D::CalcIntersection(o, x, bad, y, p));
    EXPECT_FALSE(Geom2D::CalcIntersection(o, x, o, bad, p));
  }
  // They meet beyond the largest number.
  EXPECT_FALSE(Geom2D::CalcIntersection(dVect2D(0.0F, 3e38F), dVect2D(1e38F, 3e38F), o,
                                        dVect2D(1.0F, 1e-4F), p));
  EXPECT_TRUE(Same(p, 7, 8));
}

TEST(Geom2DIntersection, TheOutputMayBeAnInput) {
  dVect2D p(0.0F, 4.0F);
  ASSERT_TRUE(Geom2D::CalcIntersection(dVect2D(), dVect2D(4.0F, 4.0F), p, dVect2D(4.0F, 0.0F), p));
  EXPECT_TRUE(Same(p, 2, 2));
}

TEST(Geom2DIntersection, LiesOnBothLines) {
  Numbers numbers(182);
  for (int i = 0; i < 2000; ++i) {
    const dVect2D a1 = numbers.Next2D(), a2 = numbers.Next2D();
    const dVect2D b1 = numbers.Next2D(), b2 = numbers.Next2D();
    dVect2D p;
    const double sine = std::abs(dVect2D(a1, a2).CrossProduct(dVect2D(b1, b2))) /
                        (dVect2D(a1, a2).Length() * dVect2D(b1, b2).Length());
    if (!Geom2D::CalcIntersection(a1, a2, b1, b2, p)) {
      ASSERT_LT(sine, 1.1e-6);
      continue;
    }
    const double tolerance = 1e-6 * (p.Length() + a1.Length() + b1.Length()) / sine;
    ASSERT_NEAR(Side(a1, a2, p.x, p.y) / a1.Distance(a2), 0.0, tolerance);
    ASSERT_NEAR(Side(b1, b2, p.x, p.y) / b1.Distance(b2), 0.0, tolerance);
  }
}

}  // namespace
