#include <vorl/Data/dRect.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <limits>
#include <vector>

#include <vorl/Platform/Gdi.h>

namespace {

constexpr int kMin = std::numeric_limits<std::int32_t>::min();
constexpr int kMax = std::numeric_limits<std::int32_t>::max();
constexpr unsigned int kLargestSize = std::numeric_limits<std::uint32_t>::max();

/// All four fields, whatever `operator==` says.
::testing::AssertionResult Is(const dRect& r, int x, int y, unsigned int width,
                              unsigned int height) {
  if (r.x == x && r.y == y && r.width == width && r.height == height) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure()
         << "(" << r.x << ", " << r.y << ", " << r.width << ", " << r.height << ")";
}

::testing::AssertionResult Is(const dRect& r, const dRect& expected) {
  return Is(r, expected.x, expected.y, expected.width, expected.height);
}

TEST(dRect, IsZeroAfterConstructionAndReset) {
  EXPECT_TRUE(Is(dRect(), 0, 0, 0, 0));
  dRect r(1, 2, 3, 4);
  r.Reset();
  EXPECT_TRUE(Is(r, 0, 0, 0, 0));
}

TEST(dRect, TakesPositionAndSize) {
  dRect r(1, -2, 3, 4);
  EXPECT_TRUE(Is(r, 1, -2, 3, 4));
  r.Set(-5, 6, kLargestSize, 8);
  EXPECT_TRUE(Is(r, -5, 6, kLargestSize, 8));
  r.SetPos(9, 10);
  EXPECT_TRUE(Is(r, 9, 10, kLargestSize, 8));
}

TEST(dRect, Copies) {
  const dRect source(1, 2, 3, 4);
  const dRect copy(source);
  EXPECT_TRUE(Is(copy, 1, 2, 3, 4));
  dRect assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_TRUE(Is(assigned, 1, 2, 3, 4));
}

TEST(dRect, MoveAddsToThePosition) {
  dRect r(1, 2, 3, 4);
  r.Move(10, -20);
  EXPECT_TRUE(Is(r, 11, -18, 3, 4));
}

TEST(dRect, MoveStopsAtTheLimits) {
  dRect r(kMax - 1, kMin + 1, 3, 4);
  r.Move(2, -2);
  EXPECT_TRUE(Is(r, kMax, kMin, 3, 4));
  r.Move(kMax, kMin);
  EXPECT_TRUE(Is(r, kMax, kMin, 3, 4));
  r.Move(kMin, kMax);
  EXPECT_TRUE(Is(r, -1, -1, 3, 4));
}

TEST(dRect, TakesDeviceRectanglesInAnyOrientation) {
  dRect r;
  EXPECT_EQ(&(r = tagRECT{1, 2, 11, 22}), &r);
  EXPECT_TRUE(Is(r, 1, 2, 10, 20));
  r = tagRECT{11, 2, 1, 22};
  EXPECT_TRUE(Is(r, 1, 2, 10, 20));
  r = tagRECT{1, 22, 11, 2};
  EXPECT_TRUE(Is(r, 1, 2, 10, 20));
  r = tagRECT{11, 22, 1, 2};
  EXPECT_TRUE(Is(r, 1, 2, 10, 20));
  r = tagRECT{5, 6, 5, 6};
  EXPECT_TRUE(Is(r, 5, 6, 0, 0));
}

TEST(dRect, TakesTheLargestDeviceRectangle) {
  dRect r;
  r = tagRECT{kMin, kMax, kMax, kMin};
  EXPECT_TRUE(Is(r, kMin, kMin, kLargestSize, kLargestSize));
}

TEST(dRect, EqualWhenAllFieldsAre) {
  const dRect r(1, 2, 3, 4);
  EXPECT_TRUE(r == dRect(1, 2, 3, 4));
  EXPECT_FALSE(r != dRect(1, 2, 3, 4));
  for (const dRect& other :
       {dRect(0, 2, 3, 4), dRect(1, 0, 3, 4), dRect(1, 2, 0, 4), dRect(1, 2, 3, 0)}) {
    EXPECT_FALSE(r == other);
    EXPECT_TRUE(r != other);
  }
}

TEST(dRect, IsEmptyWithoutWidthOrHeight) {
  EXPECT_TRUE(dRect().IsEmpty());
  EXPECT_TRUE(dRect(1, 1, 0, 5).IsEmpty());
  EXPECT_TRUE(dRect(1, 1, 5, 0).IsEmpty());
  EXPECT_FALSE(dRect(1, 1, 1, 1).IsEmpty());
}

TEST(dRect, InsideExcludesTheRightAndBottomEdges) {
  const dRect r(0, 0, 10, 10);
  EXPECT_TRUE(r.IsInside(0, 0));
  EXPECT_TRUE(r.IsInside(9, 9));
  EXPECT_FALSE(r.IsInside(10, 0));
  EXPECT_FALSE(r.IsInside(0, 10));
  EXPECT_FALSE(r.IsInside(-1, 0));
  EXPECT_FALSE(r.IsInside(0, -1));
  EXPECT_FALSE(dRect(0, 0, 0, 10).IsInside(0, 0));
}

TEST(dRect, InsideHoldsBeyondTheLargestPosition) {
  const dRect r(kMax - 1, kMin, 5, kLargestSize);
  EXPECT_TRUE(r.IsInside(kMax, kMin));
  EXPECT_TRUE(r.IsInside(kMax, kMax - 1));
  EXPECT_FALSE(r.IsInside(kMax, kMax));
  EXPECT_FALSE(r.IsInside(kMin, 0));
}

TEST(dRect, IntersectionIsTheOverlap) {
  const dRect a(0, 0, 10, 10);
  EXPECT_TRUE(Is(a & dRect(5, 5, 10, 10), 5, 5, 5, 5));
  EXPECT_TRUE(Is(a & dRect(-5, 2, 100, 3), 0, 2, 10, 3));
  dRect r(a);
  EXPECT_EQ(&(r &= dRect(5, 5, 10, 10)), &r);
  EXPECT_TRUE(Is(r, 5, 5, 5, 5));
  r &= r;
  EXPECT_TRUE(Is(r, 5, 5, 5, 5));
}

TEST(dRect, IntersectionWithoutOverlapIsReset) {
  const dRect a(0, 0, 10, 10);
  EXPECT_TRUE(Is(a & dRect(10, 0, 5, 5), 0, 0, 0, 0));  // touching is no overlap
  EXPECT_TRUE(Is(a & dRect(3, -5, 5, 5), 0, 0, 0, 0));
  EXPECT_TRUE(Is(a & dRect(20, 20, 5, 5), 0, 0, 0, 0));
  EXPECT_TRUE(Is(a & dRect(5, 5, 0, 5), 0, 0, 0, 0));
  EXPECT_TRUE(Is(dRect(5, 5, 5, 0) & a, 0, 0, 0, 0));
}

TEST(dRect, UnionIsTheBoundingRectangle) {
  const dRect a(0, 0, 10, 10);
  EXPECT_TRUE(Is(a | dRect(5, 5, 10, 10), 0, 0, 15, 15));
  EXPECT_TRUE(Is(a | dRect(-20, 30, 1, 1), -20, 0, 30, 31));
  dRect r(a);
  EXPECT_EQ(&(r |= dRect(5, 5, 10, 10)), &r);
  EXPECT_TRUE(Is(r, 0, 0, 15, 15));
}

TEST(dRect, UnionWithAnEmptyRectangleAddsNothing) {
  const dRect a(1, 2, 3, 4);
  EXPECT_TRUE(Is(a | dRect(-50, -50, 0, 9), a));
  EXPECT_TRUE(Is(dRect(-50, -50, 9, 0) | a, a));
  // An empty argument does not even tidy an empty rectangle.
  EXPECT_TRUE(Is(dRect(5, 6, 0, 7) | dRect(1, 1, 8, 0), 5, 6, 0, 7));
}

TEST(dRect, EdgesBeyondTheLargestPositionCount) {
  const dRect corner(kMax - 1, kMax - 1, 10, 10);
  EXPECT_TRUE(Is(corner & dRect(0, 0, kLargestSize, kLargestSize), corner));
  EXPECT_TRUE(Is(corner & dRect(kMax, kMax, 3, 20), kMax, kMax, 3, 9));
  EXPECT_TRUE(Is(corner | dRect(kMax, kMax, 20, 1), kMax - 1, kMax - 1, 21, 10));
  EXPECT_TRUE(
      Is(dRect(kMin, kMin, kLargestSize, 1) & dRect(kMax - 1, kMin, 9, 9), kMax - 1, kMin, 1, 1));
}

TEST(dRect, UnionCutsASizeBeyond32Bits) {
  const dRect all(kMin, kMin, kLargestSize, kLargestSize);
  EXPECT_TRUE(Is(all | dRect(kMax, 0, 10, 1), all));
  EXPECT_TRUE(Is(dRect(kMax, kMax, kLargestSize, 2) | dRect(kMin, kMin, 1, 1), all));
}

/// The parts of a split.
struct Split {
  Split(const dRect& whole, const dRect& other) {
    for (dRect* part : {&r1, &r2, &r3, &r4}) {
      part->Set(7, 7, 7, 7);  // must not survive
    }
    result = whole.SubRect(other, r1, r2, r3, r4);
  }

  bool result;
  dRect r1, r2, r3, r4;
};

TEST(dRect, SplitAroundAnInnerRectangleGivesFourParts) {
  const Split split(dRect(0, 0, 10, 20), dRect(2, 3, 4, 5));
  EXPECT_TRUE(split.result);
  EXPECT_TRUE(Is(split.r1, 0, 0, 10, 3));
  EXPECT_TRUE(Is(split.r2, 0, 8, 10, 12));
  EXPECT_TRUE(Is(split.r3, 0, 3, 2, 5));
  EXPECT_TRUE(Is(split.r4, 6, 3, 4, 5));
}

TEST(dRect, SplitLeavesOutPartsThatDoNotExist) {
  const Split corner(dRect(0, 0, 10, 10), dRect(-5, -5, 10, 10));
  EXPECT_TRUE(corner.result);
  EXPECT_TRUE(Is(corner.r1, 0, 0, 0, 0));
  EXPECT_TRUE(Is(corner.r2, 0, 5, 10, 5));
  EXPECT_TRUE(Is(corner.r3, 0, 0, 0, 0));
  EXPECT_TRUE(Is(corner.r4, 5, 0, 5, 5));
}

TEST(dRect, SplitByACoveringRectangleIsFalse) {
  for (const dRect& other : {dRect(0, 0, 10, 10), dRect(-1, -1, 20, 20)}) {
    const Split split(dRect(0, 0, 10, 10), other);
    EXPECT_FALSE(split.result);
    for (const dRect* part : {&split.r1, &split.r2, &split.r3, &split.r4}) {
      EXPECT_TRUE(Is(*part, 0, 0, 0, 0));
    }
  }
}

TEST(dRect, SplitWithoutOverlapIsTheWhole) {
  for (const dRect& other : {dRect(20, 0, 5, 5), dRect(0, 0, 0, 5), dRect(10, 0, 5, 5)}) {
    const Split split(dRect(0, 0, 10, 10), other);
    EXPECT_TRUE(split.result);
    EXPECT_TRUE(Is(split.r1, 0, 0, 10, 10));
    for (const dRect* part : {&split.r2, &split.r3, &split.r4}) {
      EXPECT_TRUE(Is(*part, 0, 0, 0, 0));
    }
  }
}

TEST(dRect, SplitOfAnEmptyRectangle) {
  // The reset rectangle equals its overlap with anything; any other empty one does not.
  EXPECT_FALSE(Split(dRect(), dRect(0, 0, 5, 5)).result);
  const Split split(dRect(3, 4, 0, 5), dRect(0, 0, 5, 5));
  EXPECT_TRUE(split.result);
  EXPECT_TRUE(Is(split.r1, 3, 4, 0, 5));
  EXPECT_TRUE(Is(split.r2, 0, 0, 0, 0));
}

TEST(dRect, SplitPartsMayBeTheRectanglesThemselves) {
  dRect whole(0, 0, 10, 20);
  dRect other(2, 3, 4, 5);
  dRect r3, r4;
  EXPECT_TRUE(whole.SubRect(other, other, whole, r3, r4));
  EXPECT_TRUE(Is(other, 0, 0, 10, 3));
  EXPECT_TRUE(Is(whole, 0, 8, 10, 12));
  EXPECT_TRUE(Is(r3, 0, 3, 2, 5));
  EXPECT_TRUE(Is(r4, 6, 3, 4, 5));
  const dRect covering(-5, -5, 99, 99);
  EXPECT_FALSE(whole.SubRect(covering, whole, other, r3, r4));
  EXPECT_TRUE(Is(whole, 0, 0, 0, 0));
}

TEST(dRect, SplitHoldsAtTheLimits) {
  const Split split(dRect(kMin, kMin, kLargestSize, kLargestSize), dRect(0, 0, 1, 1));
  EXPECT_TRUE(Is(split.r1, kMin, kMin, kLargestSize, 2147483648U));
  EXPECT_TRUE(Is(split.r2, kMin, 1, kLargestSize, 2147483646U));
  EXPECT_TRUE(Is(split.r3, kMin, 0, 2147483648U, 1));
  EXPECT_TRUE(Is(split.r4, 1, 0, 2147483646U, 1));
}

TEST(dRect, SplitLeavesOutAPartBeyondTheLargestPosition) {
  const Split split(dRect(0, 0, kLargestSize, kLargestSize), dRect(0, 0, 2147483648U, 2147483647U));
  EXPECT_TRUE(split.result);
  EXPECT_TRUE(Is(split.r2, 0, kMax, kLargestSize, 2147483648U));  // just representable
  EXPECT_TRUE(Is(split.r4, 0, 0, 0, 0));                          // would begin at 2147483648
}

/// Every rectangle with its corners on a small grid, empty ones included.
std::vector<dRect> SmallRects() {
  std::vector<dRect> rects;
  for (int x = -1; x <= 1; ++x) {
    for (int y = -1; y <= 1; ++y) {
      for (unsigned int width = 0; width <= 3; ++width) {
        for (unsigned int height = 0; height <= 3; ++height) {
          rects.emplace_back(x, y, width, height);
        }
      }
    }
  }
  return rects;
}

/// True when each cell of the grid is in `r` exactly when the condition says so.
template <typename Condition>
bool HasCells(const dRect& r, Condition condition) {
  for (int y = -2; y <= 5; ++y) {
    for (int x = -2; x <= 5; ++x) {
      if (r.IsInside(x, y) != condition(x, y)) {
        return false;
      }
    }
  }
  return true;
}

TEST(dRect, IntersectionHasTheCellsOfBoth) {
  for (const dRect& a : SmallRects()) {
    for (const dRect& b : SmallRects()) {
      ASSERT_TRUE(
          HasCells(a & b, [&](int x, int y) { return a.IsInside(x, y) && b.IsInside(x, y); }));
    }
  }
}

TEST(dRect, UnionIsTheSmallestRectangleWithTheCellsOfBoth) {
  for (const dRect& a : SmallRects()) {
    for (const dRect& b : SmallRects()) {
      int left = kMax, top = kMax, right = kMin, bottom = kMin;
      for (int y = -2; y <= 5; ++y) {
        for (int x = -2; x <= 5; ++x) {
          if (a.IsInside(x, y) || b.IsInside(x, y)) {
            left = std::min(left, x);
            top = std::min(top, y);
            right = std::max(right, x);
            bottom = std::max(bottom, y);
          }
        }
      }
      ASSERT_TRUE(HasCells(
          a | b, [&](int x, int y) { return left <= x && x <= right && top <= y && y <= bottom; }));
    }
  }
}

TEST(dRect, SplitPartsHaveEachOuterCellOnce) {
  for (const dRect& whole : SmallRects()) {
    for (const dRect& other : SmallRects()) {
      const Split split(whole, other);
      for (int y = -2; y <= 5; ++y) {
        for (int x = -2; x <= 5; ++x) {
          int count = 0;
          for (const dRect* part : {&split.r1, &split.r2, &split.r3, &split.r4}) {
            count += part->IsInside(x, y) ? 1 : 0;
          }
          ASSERT_EQ(count, whole.IsInside(x, y) && !other.IsInside(x, y) ? 1 : 0);
        }
      }
    }
  }
}

}  // namespace
