// Intersection and union of rectangles.

#include <vorl/GUI/Rect2D.h>

#include <gtest/gtest.h>

#include <vorl/Platform/Gdi.h>

#include "RectTesting.h"

namespace {

using geometry_testing::Numbers;
using gui_testing::Same;

TEST(Rect2DSets, IntersectionIsTheOverlap) {
  Rect2D rect(0, 0, 10, 10);
  EXPECT_EQ(&(rect &= Rect2D(5, -5, 15, 7)), &rect);
  EXPECT_TRUE(Same(rect, 5, 0, 10, 7));
}

TEST(Rect2DSets, UnionIsTheBoundingRectangle) {
  Rect2D rect(0, 0, 10, 10);
  EXPECT_EQ(&(rect |= Rect2D(5, -5, 15, 7)), &rect);
  EXPECT_TRUE(Same(rect, 0, -5, 15, 10));
}

TEST(Rect2DSets, IntegerRectanglesTakePart) {
  const tagRECT other = {5, -5, 15, 7};
  Rect2D rect(0, 0, 10, 10);
  EXPECT_EQ(&(rect &= other), &rect);
  EXPECT_TRUE(Same(rect, 5, 0, 10, 7));
  rect.Set(0, 0, 10, 10);
  EXPECT_EQ(&(rect |= other), &rect);
  EXPECT_TRUE(Same(rect, 0, -5, 15, 10));
}

TEST(Rect2DSets, TheResultKeepsTheOrderOfTheFirst) {
  // The order of each direction by itself; that of the argument does not matter.
  for (const Rect2D& other : {Rect2D(5, -5, 15, 7), Rect2D(15, 7, 5, -5)}) {
    EXPECT_TRUE(Same(Rect2D(10, 0, 0, 10) & other, 10, 0, 5, 7));
    EXPECT_TRUE(Same(Rect2D(0, 10, 10, 0) & other, 5, 7, 10, 0));
    EXPECT_TRUE(Same(Rect2D(10, 10, 0, 0) & other, 10, 7, 5, 0));
    EXPECT_TRUE(Same(Rect2D(10, 0, 0, 10) | other, 15, -5, 0, 10));
    EXPECT_TRUE(Same(Rect2D(0, 10, 10, 0) | other, 0, 10, 15, -5));
    EXPECT_TRUE(Same(Rect2D(10, 10, 0, 0) | other, 15, 10, 0, -5));
  }
}

TEST(Rect2DSets, WithoutOverlapTheIntersectionIsAllZero) {
  for (const Rect2D& other : {Rect2D(11, 1, 15, 9), Rect2D(1, 11, 9, 15), Rect2D(-5, 1, -1, 9)}) {
    EXPECT_TRUE(Same(Rect2D(1, 1, 10, 10) & other, 0, 0, 0, 0));
    EXPECT_TRUE(Same(Rect2D(10, 10, 1, 1) & other, 0, 0, 0, 0));
  }
}

TEST(Rect2DSets, TouchingIsNoOverlap) {
  EXPECT_TRUE(Same(Rect2D(1, 1, 10, 10) & Rect2D(10, 1, 20, 10), 0, 0, 0, 0));
  EXPECT_TRUE(Same(Rect2D(1, 1, 10, 10) & Rect2D(1, 10, 10, 20), 0, 0, 0, 0));
  EXPECT_TRUE(Same(Rect2D(1, 1, 10, 10) & Rect2D(5, 5, 5, 8), 0, 0, 0, 0));
}

TEST(Rect2DSets, AnEmptyRectangleCountsInTheUnion) {
  EXPECT_TRUE(Same(Rect2D(5, 6, 7, 8) | Rect2D(), 0, 0, 7, 8));
  EXPECT_TRUE(Same(Rect2D() | Rect2D(5, 6, 7, 8), 0, 0, 7, 8));
}

TEST(Rect2DSets, ARectangleWithItselfStays) {
  Rect2D rect(10, 0, 0, 10);
  const Rect2D& same = rect;
  rect &= same;
  EXPECT_TRUE(Same(rect, 10, 0, 0, 10));
  rect |= same;
  EXPECT_TRUE(Same(rect, 10, 0, 0, 10));
}

TEST(Rect2DSets, OperatorsLeaveTheirArgumentsAlone) {
  const Rect2D a(0, 0, 10, 10), b(5, 5, 15, 15);
  EXPECT_TRUE(Same(a & b, 5, 5, 10, 10));
  EXPECT_TRUE(Same(a | b, 0, 0, 15, 15));
  EXPECT_TRUE(Same(a, 0, 0, 10, 10));
  EXPECT_TRUE(Same(b, 5, 5, 15, 15));
}

TEST(Rect2DSets, APointIsInTheOverlapWhenItIsInBoth) {
  Numbers numbers(121);
  int overlaps = 0;
  for (int i = 0; i < 3000; ++i) {
    const Rect2D a{numbers.Next2D(), numbers.Next2D()}, b{numbers.Next2D(), numbers.Next2D()};
    const Rect2D overlap = a & b, bounds = a | b;
    ASSERT_TRUE(bounds.IsInside(a) && bounds.IsInside(b));
    ASSERT_EQ(bounds.Width() < 0, a.Width() < 0);
    if (overlap == Rect2D()) {
      continue;
    }
    ++overlaps;
    ASSERT_TRUE(a.IsInside(overlap) && b.IsInside(overlap));
    ASSERT_EQ(overlap.Height() < 0, a.Height() < 0);
    const dVect2D p = numbers.Next2D();
    ASSERT_EQ(overlap.IsInside(p), a.IsInside(p) && b.IsInside(p));
  }
  EXPECT_GT(overlaps, 300);
}

}  // namespace
