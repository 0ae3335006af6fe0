#include <vorl/GUI/Rect2D.h>

#include <gtest/gtest.h>

#include <limits>
#include <type_traits>

#include <vorl/Platform/Gdi.h>

#include "RectTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Same;
using gui_testing::Same;

static_assert(std::has_virtual_destructor_v<Rect2D>);

// One table pointer and two corners: a class without any further virtual function or field.
static_assert(sizeof(Rect2D) == sizeof(void*) + 2 * sizeof(dVect2D));

TEST(Rect2D, IsZeroAfterConstructionAndReset) {
  Rect2D rect;
  EXPECT_TRUE(Same(rect, 0, 0, 0, 0));
  rect.Set(1, 2, 3, 4);
  rect.Reset();
  EXPECT_TRUE(Same(rect, 0, 0, 0, 0));
}

TEST(Rect2D, IsBuiltFromEveryForm) {
  const Rect2D source(1.5F, 2.5F, -3.5F, 4.5F);
  EXPECT_TRUE(Same(source, 1.5, 2.5, -3.5, 4.5));
  EXPECT_TRUE(Same(Rect2D(source), 1.5, 2.5, -3.5, 4.5));
  EXPECT_TRUE(Same(Rect2D(tagRECT{1, 2, -3, 4}), 1, 2, -3, 4));
  EXPECT_TRUE(Same(Rect2D(dVect2D(1.5F, 2.5F), dVect2D(-3.5F, 4.5F)), 1.5, 2.5, -3.5, 4.5));
  EXPECT_TRUE(Same(Rect2D(tagPOINT{1, 2}, tagPOINT{-3, 4}), 1, 2, -3, 4));
}

TEST(Rect2D, IsSetInEveryForm) {
  const Rect2D source(1.5F, 2.5F, -3.5F, 4.5F);
  Rect2D rect;
  EXPECT_EQ(&(rect = source), &rect);
  EXPECT_TRUE(Same(rect, 1.5, 2.5, -3.5, 4.5));
  rect.Set(tagRECT{1, 2, -3, 4});
  EXPECT_TRUE(Same(rect, 1, 2, -3, 4));
  rect.Set(source);
  EXPECT_TRUE(Same(rect, 1.5, 2.5, -3.5, 4.5));
  rect.Set(tagPOINT{5, 6}, tagPOINT{7, 8});
  EXPECT_TRUE(Same(rect, 5, 6, 7, 8));
  rect.Set(dVect2D(0.5F, 1.5F), dVect2D(2.5F, 3.5F));
  EXPECT_TRUE(Same(rect, 0.5, 1.5, 2.5, 3.5));
  rect.Set(9.0F, 10.0F, 11.0F, 12.0F);
  EXPECT_TRUE(Same(rect, 9, 10, 11, 12));
  rect = tagRECT{1, 2, -3, 4};
  EXPECT_TRUE(Same(rect, 1, 2, -3, 4));
}

TEST(Rect2D, SizesAreSigned) {
  const Rect2D rect(10.0F, 20.0F, 4.0F, 50.0F);
  EXPECT_EQ(rect.Width(), -6.0);
  EXPECT_EQ(rect.Height(), 30.0);
}

TEST(Rect2D, SizesAreNotRoundedToSinglePrecision) {
  const Rect2D rect(-16777216.0F, 0.0F, 1.0F, 0.0F);
  EXPECT_EQ(rect.Width(), 16777217.0);
}

TEST(Rect2D, SetPosKeepsTheSize) {
  Rect2D rect(10.0F, 20.0F, 4.0F, 50.0F);
  rect.SetPos(1.5F, 2.5F);
  EXPECT_TRUE(Same(rect, 1.5, 2.5, -4.5, 32.5));
  rect.SetPos(dVect2D(100.0F, 200.0F));
  EXPECT_TRUE(Same(rect, 100, 200, 94, 230));
  rect.SetPos(tagPOINT{-1, -2});
  EXPECT_TRUE(Same(rect, -1, -2, -7, 28));
}

TEST(Rect2D, MovesBothCorners) {
  Rect2D rect(1.0F, 2.0F, 3.0F, 4.0F);
  rect.Move(10.0F, 20.0F);
  EXPECT_TRUE(Same(rect, 11, 22, 13, 24));
  rect.Move(dVect2D(-1.0F, 0.5F));
  EXPECT_TRUE(Same(rect, 10, 22.5, 12, 24.5));
}

TEST(Rect2D, TellsCornersAndCentreInBothForms) {
  const Rect2D rect(1.0F, 2.0F, 7.0F, 12.0F);
  EXPECT_TRUE(Same(rect.GetTL(), 1, 2));
  EXPECT_TRUE(Same(rect.GetTR(), 7, 2));
  EXPECT_TRUE(Same(rect.GetBL(), 1, 12));
  EXPECT_TRUE(Same(rect.GetBR(), 7, 12));
  EXPECT_TRUE(Same(rect.GetCenter(), 4, 7));
  dVect2D v;
  rect.GetTL(v);
  EXPECT_TRUE(Same(v, 1, 2));
  rect.GetTR(v);
  EXPECT_TRUE(Same(v, 7, 2));
  rect.GetBL(v);
  EXPECT_TRUE(Same(v, 1, 12));
  rect.GetBR(v);
  EXPECT_TRUE(Same(v, 7, 12));
  rect.GetCenter(v);
  EXPECT_TRUE(Same(v, 4, 7));
}

TEST(Rect2D, RelativePositionsRunFromTopLeftToBottomRight) {
  const Rect2D rect(10.0F, 20.0F, 4.0F, 60.0F);
  dVect2D v;
  rect.GetRelativePos(0.0F, 0.0F, v);
  EXPECT_TRUE(Same(v, 10, 20));
  rect.GetRelativePos(1.0F, 1.0F, v);
  EXPECT_TRUE(Same(v, 4, 60));
  rect.GetRelativePos(0.5F, 0.25F, v);
  EXPECT_TRUE(Same(v, 7, 30));
  rect.GetRelativePos(-1.0F, 2.0F, v);
  EXPECT_TRUE(Same(v, 16, 100));
}

TEST(Rect2D, ScalesAboutItsCentre) {
  Rect2D rect(0.0F, 10.0F, 8.0F, 30.0F);
  rect.Scale(0.5F);
  EXPECT_TRUE(Same(rect, 2, 15, 6, 25));
  rect.Scale(2.0F, 3.0F);
  EXPECT_TRUE(Same(rect, 0, 5, 8, 35));
}

TEST(Rect2D, ScalesAboutAPointWhichKeepsItsPlace) {
  Rect2D rect(0.0F, 10.0F, 8.0F, 30.0F);
  rect.Scale(2.0F, 3.0F, dVect2D(8.0F, 20.0F));
  EXPECT_TRUE(Same(rect, -8, -10, 8, 50));
  rect.Scale(0.0F, -1.0F, dVect2D(1.0F, 0.0F));  // onto a line, and mirrored
  EXPECT_TRUE(Same(rect, 1, 10, 1, -50));
}

TEST(Rect2D, AFactorOfOneChangesNothing) {
  Numbers numbers(111);
  for (int i = 0; i < 1000; ++i) {
    const dVect2D a = numbers.Next2D(), b = numbers.Next2D();
    Rect2D rect(a, b);
    rect.Scale(1.0F);
    ASSERT_TRUE(Same(rect, a.x, a.y, b.x, b.y));
    rect.Scale(1.0F, 1.0F, dVect2D(1e10F, -1e10F));
    ASSERT_TRUE(Same(rect, a.x, a.y, b.x, b.y));
  }
}

TEST(Rect2D, IsEmptyWithoutWidthOrHeightAndElseValid) {
  struct Case {
    Rect2D rect;
    bool isEmpty;
  };
  for (const Case& c :
       {Case{Rect2D(), true}, Case{Rect2D(1, 2, 1, 5), true}, Case{Rect2D(1, 2, 5, 2), true},
        Case{Rect2D(1, 2, 5, 6), false}, Case{Rect2D(5, 6, 1, 2), false},
        Case{Rect2D(1, 2, 1.0000001F, 6), false}}) {
    EXPECT_EQ(c.rect.IsEmpty(), c.isEmpty) << c.rect.GetBR().x;
    EXPECT_EQ(c.rect.IsValid(), !c.isEmpty) << c.rect.GetBR().x;
  }
}

TEST(Rect2D, NormalizeSwapsEachDirectionByItself) {
  Rect2D rect(5.0F, 2.0F, 1.0F, 9.0F);
  EXPECT_FALSE(rect.IsNormalized());
  rect.Normalize();
  EXPECT_TRUE(Same(rect, 1, 2, 5, 9));
  EXPECT_TRUE(rect.IsNormalized());
  rect.Set(1, 9, 5, 2);
  EXPECT_FALSE(rect.IsNormalized());
  rect.Normalize();
  EXPECT_TRUE(Same(rect, 1, 2, 5, 9));
  rect.Normalize();
  EXPECT_TRUE(Same(rect, 1, 2, 5, 9));
}

TEST(Rect2D, IsNormalizedWithoutAnySize) {
  EXPECT_TRUE(Rect2D(3, 4, 3, 4).IsNormalized());
}

TEST(Rect2D, HoldsItsEdges) {
  // The same rectangle in every order of corners.
  for (const Rect2D& rect :
       {Rect2D(1, 2, 5, 8), Rect2D(5, 2, 1, 8), Rect2D(1, 8, 5, 2), Rect2D(5, 8, 1, 2)}) {
    for (const float x : {1.0F, 3.0F, 5.0F}) {
      for (const float y : {2.0F, 5.0F, 8.0F}) {
        EXPECT_TRUE(rect.IsInside(x, y)) << x << ' ' << y;
        EXPECT_TRUE(rect.IsInside(dVect2D(x, y))) << x << ' ' << y;
      }
    }
    EXPECT_FALSE(rect.IsInside(0.99F, 5.0F));
    EXPECT_FALSE(rect.IsInside(5.01F, 5.0F));
    EXPECT_FALSE(rect.IsInside(3.0F, 1.99F));
    EXPECT_FALSE(rect.IsInside(dVect2D(3.0F, 8.01F)));
    EXPECT_TRUE(rect.IsInside(tagPOINT{5, 8}));
    EXPECT_FALSE(rect.IsInside(tagPOINT{6, 8}));
    EXPECT_FALSE(rect.IsInside(tagPOINT{5, 1}));
  }
}

TEST(Rect2D, IntegerPointsAreNotRoundedBeforeTheTest) {
  const Rect2D rect(0.0F, 0.0F, 16777216.0F, 1.0F);
  EXPECT_TRUE(rect.IsInside(tagPOINT{16777216, 0}));
  EXPECT_FALSE(rect.IsInside(tagPOINT{16777217, 0}));
}

TEST(Rect2D, WhatIsNotANumberLiesNowhere) {
  const float nan = std::numeric_limits<float>::quiet_NaN();
  EXPECT_FALSE(Rect2D(0, 0, 9, 9).IsInside(nan, 1.0F));
  EXPECT_FALSE(Rect2D(0, 0, 9, 9).IsInside(1.0F, nan));
}

TEST(Rect2D, HoldsARectangleWithBothCornersInside) {
  const Rect2D rect(10, 0, 0, 10);
  EXPECT_TRUE(rect.IsInside(rect));
  EXPECT_TRUE(rect.IsInside(Rect2D(9, 9, 1, 1)));
  EXPECT_FALSE(rect.IsInside(Rect2D(1, 1, 11, 9)));
  EXPECT_FALSE(rect.IsInside(Rect2D(1, 1, 9, 11)));
  EXPECT_FALSE(rect.IsInside(Rect2D(-1, 1, 9, 9)));
  EXPECT_FALSE(rect.IsInside(Rect2D(-1, -1, 11, 11)));
}

TEST(Rect2D, EqualityForgivesAMillionth) {
  const Rect2D rect(1, 2, 3, 4);
  EXPECT_TRUE(rect == Rect2D(1, 2, 3, 4));
  EXPECT_TRUE(rect == Rect2D(1.0000005F, 2, 3, 4));
  EXPECT_FALSE(rect != Rect2D(1.0000005F, 2, 3, 4));
  for (const Rect2D& other : {Rect2D(1.1F, 2, 3, 4), Rect2D(1, 2.1F, 3, 4), Rect2D(1, 2, 3.1F, 4),
                              Rect2D(1, 2, 3, 4.1F), Rect2D(3, 2, 1, 4)}) {
    EXPECT_FALSE(rect == other);
    EXPECT_TRUE(rect != other);
  }
}

TEST(Rect2D, EqualsIntegerRectangles) {
  const Rect2D rect(1, 2, 3, 4);
  EXPECT_TRUE(rect == (tagRECT{1, 2, 3, 4}));
  EXPECT_FALSE(rect != (tagRECT{1, 2, 3, 4}));
  for (const tagRECT& other :
       {tagRECT{0, 2, 3, 4}, tagRECT{1, 0, 3, 4}, tagRECT{1, 2, 0, 4}, tagRECT{1, 2, 3, 0}}) {
    EXPECT_FALSE(rect == other);
    EXPECT_TRUE(rect != other);
  }
}

}  // namespace
