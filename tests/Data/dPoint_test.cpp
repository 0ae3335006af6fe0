#include <vorl/Data/dPoint.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>

#include <vorl/Platform/Gdi.h>

namespace {

constexpr std::int32_t kMin = std::numeric_limits<std::int32_t>::min();
constexpr std::int32_t kMax = std::numeric_limits<std::int32_t>::max();

dPoint At(int x, int y) {
  return dPoint(tagPOINT{x, y});
}

::testing::AssertionResult Is(const dPoint& p, std::int32_t x, std::int32_t y) {
  if (p.x == x && p.y == y) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure() << "(" << p.x << ", " << p.y << ")";
}

TEST(dPoint, IsZeroAfterConstructionInitAndReset) {
  dPoint p;
  EXPECT_TRUE(Is(p, 0, 0));
  p.Init(1, 2);
  EXPECT_TRUE(Is(p, 1, 2));
  p.Init();
  EXPECT_TRUE(Is(p, 0, 0));
  p.Init(3, 4);
  p.Reset();
  EXPECT_TRUE(Is(p, 0, 0));
}

TEST(dPoint, TakesDevicePoints) {
  EXPECT_TRUE(Is(dPoint(tagPOINT{kMin, kMax}), kMin, kMax));
  dPoint p;
  EXPECT_EQ(&(p = tagPOINT{-5, 6}), &p);
  EXPECT_TRUE(Is(p, -5, 6));
}

TEST(dPoint, Copies) {
  const dPoint source = At(7, -8);
  const dPoint copy(source);
  EXPECT_TRUE(Is(copy, 7, -8));
  dPoint assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_TRUE(Is(assigned, 7, -8));
}

TEST(dPoint, AddsAndSubtracts) {
  dPoint p = At(1, 2);
  EXPECT_EQ(&(p += At(10, 20)), &p);
  EXPECT_TRUE(Is(p, 11, 22));
  EXPECT_EQ(&(p -= At(1, 30)), &p);
  EXPECT_TRUE(Is(p, 10, -8));
  const dPoint a = At(1, 2), b = At(5, -5);
  EXPECT_TRUE(Is(a + b, 6, -3));
  EXPECT_TRUE(Is(a - b, -4, 7));
  EXPECT_TRUE(Is(a, 1, 2));
}

TEST(dPoint, NegationChangesThePointItself) {
  dPoint p = At(3, -4);
  EXPECT_EQ(&(-p), &p);
  EXPECT_TRUE(Is(p, -3, 4));
}

TEST(dPoint, ComparesExactly) {
  EXPECT_TRUE(At(1, 2) == At(1, 2));
  EXPECT_FALSE(At(1, 2) != At(1, 2));
  EXPECT_FALSE(At(1, 2) == At(2, 2));
  EXPECT_FALSE(At(1, 2) == At(1, 3));
  EXPECT_TRUE(At(1, 2) != At(1, 3));
}

TEST(dPoint, IsEmptyWhenBothCoordinatesAreZero) {
  EXPECT_TRUE(dPoint().IsEmpty());
  EXPECT_FALSE(At(1, 0).IsEmpty());
  EXPECT_FALSE(At(0, -1).IsEmpty());
}

TEST(dPoint, ArithmeticWrapsAround) {
  EXPECT_TRUE(Is(At(kMax, kMin) + At(1, -1), kMin, kMax));
  EXPECT_TRUE(Is(At(kMin, kMax) - At(1, -1), kMax, kMin));
  dPoint p = At(kMin, kMax);
  -p;
  EXPECT_TRUE(Is(p, kMin, -kMax));  // the smallest number is its own negative
}

}  // namespace
