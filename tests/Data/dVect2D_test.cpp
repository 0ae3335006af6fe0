#include <vorl/Data/dVect2D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <type_traits>

#include "GeometryTesting.h"

#include <vorl/Platform/Gdi.h>

namespace {

using geometry_testing::Numbers;
using geometry_testing::Round;
using geometry_testing::Same;

constexpr float kJustNearZero = 1e-6F;              // 9.99999997e-7
const float kBeyond = std::nextafter(1e-6F, 1.0F);  // 1.00000011e-6

TEST(dVect2D, IsZeroAfterConstructionAndReset) {
  dVect2D v;
  EXPECT_TRUE(Same(v, 0, 0));
  v.Set(1, 2);
  v.Reset();
  EXPECT_TRUE(Same(v, 0, 0));
}

TEST(dVect2D, TakesComponents) {
  EXPECT_TRUE(Same(dVect2D(1.5F, -2.5F), 1.5, -2.5));
  dVect2D v;
  v.Set(0.1, 0.2);  // rounded to single precision
  EXPECT_EQ(v.x, 0.1F);
  EXPECT_EQ(v.y, 0.2F);
}

TEST(dVect2D, BuiltFromAnAngleIsItsUnitVector) {
  EXPECT_TRUE(Same(dVect2D(0.5), std::cos(0.5), std::sin(0.5)));
  EXPECT_TRUE(Same(dVect2D(0.0), 1, 0));
  // A bare number does not turn into a direction by itself.
  static_assert(!std::is_convertible_v<double, dVect2D>);
  static_assert(std::is_constructible_v<dVect2D, double>);
}

TEST(dVect2D, TakesIntegerPoints) {
  const tagPOINT point = {-7, 16777217};  // the latter rounds to the even neighbour
  EXPECT_TRUE(Same(dVect2D(point), -7, 16777216));
  dVect2D v;
  v.Set(point);
  EXPECT_TRUE(Same(v, -7, 16777216));
  v.Reset();
  EXPECT_EQ(&(v = point), &v);
  EXPECT_TRUE(Same(v, -7, 16777216));
}

TEST(dVect2D, CopiesBothComponents) {
  const dVect2D source(3.0F, -4.0F);
  const dVect2D copy(source);
  EXPECT_TRUE(Same(copy, 3, -4));
  dVect2D assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_TRUE(Same(assigned, 3, -4));
  dVect2D set;
  set.Set(source);
  EXPECT_TRUE(Same(set, 3, -4));
}

TEST(dVect2D, DifferenceOfTwoLeadsFromTheFirstToTheSecond) {
  const dVect2D a(1.0F, 2.0F);
  const dVect2D b(10.0F, 5.0F);
  EXPECT_TRUE(Same(dVect2D(a, b), 9, 3));
  dVect2D v;
  v.Diff(a, b);
  EXPECT_TRUE(Same(v, 9, 3));
}

TEST(dVect2D, DifferenceToOneIsArgumentMinusThis) {
  dVect2D v(1.0F, 2.0F);
  v.Diff(dVect2D(10.0F, 5.0F));
  EXPECT_TRUE(Same(v, 9, 3));
  v.Diff(v);
  EXPECT_TRUE(Same(v, 0, 0));
}

TEST(dVect2D, IndexReachesTheComponents) {
  dVect2D v(1.0F, 2.0F);
  v[0] = 5.0F;
  v[1] = 6.0F;
  EXPECT_TRUE(Same(v, 5, 6));
  const dVect2D& constant = v;
  EXPECT_EQ(&constant[0], &v.x);
  EXPECT_EQ(&constant[1], &v.y);
}

TEST(dVect2D, IndexOutsideGivesTheNearestComponent) {
  dVect2D v;
  const dVect2D& constant = v;
  for (const int below : {-1, std::numeric_limits<int>::min()}) {
    EXPECT_EQ(&v[below], &v.x);
    EXPECT_EQ(&constant[below], &v.x);
  }
  for (const int above : {2, std::numeric_limits<int>::max()}) {
    EXPECT_EQ(&v[above], &v.y);
    EXPECT_EQ(&constant[above], &v.y);
  }
}

TEST(dVect2D, AddsAndSubtractsComponentwise) {
  dVect2D v(1.0F, 2.0F);
  EXPECT_EQ(&(v += dVect2D(10.0F, 20.0F)), &v);
  EXPECT_TRUE(Same(v, 11, 22));
  EXPECT_EQ(&(v -= dVect2D(1.0F, 5.0F)), &v);
  EXPECT_TRUE(Same(v, 10, 17));
  v.Add(dVect2D(1.0F, -1.0F));
  EXPECT_TRUE(Same(v, 11, 16));
  v.Add(0.5, 2);
  EXPECT_TRUE(Same(v, 11.5, 18));
  v -= v;
  EXPECT_TRUE(Same(v, 0, 0));
}

TEST(dVect2D, AddsAndSubtractsIntegerPoints) {
  const tagPOINT point = {3, -4};
  dVect2D v(1.0F, 2.0F);
  EXPECT_EQ(&(v += point), &v);
  EXPECT_TRUE(Same(v, 4, -2));
  EXPECT_EQ(&(v -= point), &v);
  EXPECT_TRUE(Same(v, 1, 2));
  // The extreme point has no negative in its own type.
  v -= tagPOINT{std::numeric_limits<LONG>::min(), 0};
  EXPECT_TRUE(Same(v, 2147483649.0, 2));
}

TEST(dVect2D, AddsDoublesBeforeRounding) {
  // 1 + 2^-24 lies half way between 1 and the next number, the rest decides; rounding the summand
  // first would lose it.
  dVect2D v(1.0F, 1.0F);
  const double half = std::ldexp(1.0, -24);
  v.Add(half + std::ldexp(1.0, -50), half - std::ldexp(1.0, -50));
  EXPECT_TRUE(Same(v, 1.0 + 2.0 * half, 1.0));
}

TEST(dVect2D, MultipliesByTheFactorRoundedToSingle) {
  Numbers numbers(1);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect2D v = numbers.Next2D();
    const double factor = numbers.NextDouble();
    const double rounded = Round(factor);
    dVect2D multiplied(v);
    EXPECT_EQ(&(multiplied *= factor), &multiplied);
    dVect2D scaled(v);
    scaled.Scale(factor);
    ASSERT_TRUE(Same(multiplied, v.x * rounded, v.y * rounded));
    ASSERT_TRUE(Same(scaled, multiplied));
    ASSERT_TRUE(Same(v * factor, multiplied));
    differing += multiplied.x != Round(v.x * factor);
  }
  EXPECT_GT(differing, 0);  // the rounding of the factor shows
}

TEST(dVect2D, ScalesEachComponentByItsUnroundedFactor) {
  Numbers numbers(2);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect2D v = numbers.Next2D();
    const double fx = numbers.NextDouble();
    const double fy = numbers.NextDouble();
    dVect2D scaled(v);
    scaled.Scale(fx, fy);
    ASSERT_TRUE(Same(scaled, v.x * fx, v.y * fy));
    differing += scaled.x != Round(v.x * static_cast<double>(Round(fx)));
  }
  EXPECT_GT(differing, 0);
}

TEST(dVect2D, DividesByTheDivisorRoundedToSingle) {
  Numbers numbers(3);
  for (int i = 0; i < 1000; ++i) {
    const dVect2D v = numbers.Next2D();
    const double divisor = numbers.NextDouble();
    dVect2D divided(v);
    EXPECT_EQ(&(divided /= divisor), &divided);
    const double rounded = Round(divisor);
    ASSERT_TRUE(Same(divided, v.x / rounded, v.y / rounded));
  }
}

TEST(dVect2D, DivisionByZeroChangesNothing) {
  dVect2D v(1.0F, 2.0F);
  v /= 0.0;
  EXPECT_TRUE(Same(v, 1, 2));
  v /= -0.0;
  EXPECT_TRUE(Same(v, 1, 2));
  v /= 1e-60;  // zero once it is rounded
  EXPECT_TRUE(Same(v, 1, 2));
  v /= 1e-30;  // small is not zero
  EXPECT_TRUE(Same(v, 1.0 / Round(1e-30), 2.0 / Round(1e-30)));
}

TEST(dVect2D, ScalingAboutACentreMovesTowardsItForLargeFactors) {
  const dVect2D centre(3.0F, 3.0F);
  dVect2D v(1.0F, 1.0F);
  v.Scale(2, centre);
  EXPECT_TRUE(Same(v, 3, 3));
  v.Set(1, 2);
  v.Scale(0, centre);  // twice as far from the centre
  EXPECT_TRUE(Same(v, -1, 1));
  v.Set(1, 2);
  v.Scale(1, centre);
  EXPECT_TRUE(Same(v, 1, 2));
  v.Set(1, 2);
  v.Scale(3, centre);  // through the centre
  EXPECT_TRUE(Same(v, 5, 4));
}

TEST(dVect2D, ScalingAboutACentreTakesAFactorForEachComponent) {
  dVect2D v(1.0F, 1.0F);
  v.Scale(2, 1.5, dVect2D(3.0F, 5.0F));
  EXPECT_TRUE(Same(v, 3, 3));
  v.Scale(7, 8, v);  // about itself
  EXPECT_TRUE(Same(v, 3, 3));
}

TEST(dVect2D, ScalingAboutACentreIsRoundedOnce) {
  Numbers numbers(4);
  for (int i = 0; i < 1000; ++i) {
    const dVect2D v = numbers.Next2D();
    const dVect2D c = numbers.Next2D();
    const double fx = numbers.NextDouble();
    const double fy = numbers.NextDouble();
    const double x = v.x, y = v.y;
    dVect2D scaled(v);
    scaled.Scale(fx, fy, c);
    ASSERT_TRUE(Same(scaled, x + (fx - 1) * (c.x - x), y + (fy - 1) * (c.y - y)));
    scaled = v;
    scaled.Scale(fx, c);
    ASSERT_TRUE(Same(scaled, x + (fx - 1) * (c.x - x), y + (fx - 1) * (c.y - y)));
  }
}

TEST(dVect2D, EqualWithinTheTolerance) {
  const dVect2D zero;
  EXPECT_TRUE(zero == dVect2D(kJustNearZero, -kJustNearZero));
  EXPECT_FALSE(zero != dVect2D(kJustNearZero, -kJustNearZero));
  EXPECT_FALSE(zero == dVect2D(kBeyond, 0.0F));
  EXPECT_FALSE(zero == dVect2D(0.0F, -kBeyond));
  EXPECT_TRUE(zero != dVect2D(0.0F, kBeyond));
  EXPECT_TRUE(dVect2D(0.0F, kBeyond) == dVect2D(kJustNearZero, kBeyond));
}

TEST(dVect2D, NotANumberEqualsNothing) {
  const dVect2D v(std::numeric_limits<float>::quiet_NaN(), 0.0F);
  EXPECT_FALSE(v == v);
  EXPECT_TRUE(v != v);
  EXPECT_FALSE(v.IsZero());
}

TEST(dVect2D, IsZeroIncludesTheTolerance) {
  EXPECT_TRUE(dVect2D().IsZero());
  EXPECT_TRUE(dVect2D(-kJustNearZero, kJustNearZero).IsZero());
  EXPECT_FALSE(dVect2D(kBeyond, 0.0F).IsZero());
  EXPECT_FALSE(dVect2D(0.0F, -kBeyond).IsZero());
  EXPECT_TRUE(dVect2D(0.5F, -0.5F).IsZero(0.5F));
  EXPECT_FALSE(dVect2D(0.75F, 0.0F).IsZero(0.5F));
  EXPECT_FALSE(dVect2D(0.0F, -0.75F).IsZero(0.5F));
}

TEST(dVect2D, MeasuresLengthsAndDistances) {
  const dVect2D v(3.0F, 4.0F);
  EXPECT_EQ(v.Length(), 5.0);
  EXPECT_EQ(v.Length2(), 25.0);
  const dVect2D other(-3.0F, 12.0F);
  EXPECT_EQ(v.Distance(other), 10.0);
  EXPECT_EQ(v.Distance2(other), 100.0);
}

TEST(dVect2D, MeasuresInDoublePrecision) {
  const dVect2D v(1.0F, 4096.0F);
  EXPECT_EQ(v.Length2(), 16777217.0);  // no single-precision number
  EXPECT_EQ(v.Length(), std::sqrt(16777217.0));
  EXPECT_EQ(dVect2D().Distance2(v), 16777217.0);
  const dVect2D huge(3e38F, 0.0F);
  EXPECT_EQ(huge.Length(), static_cast<double>(3e38F));  // its square has none either
  EXPECT_EQ(huge.Distance(dVect2D(-3e38F, 0.0F)), 2.0 * static_cast<double>(3e38F));
}

TEST(dVect2D, NormalizeDividesByTheLength) {
  dVect2D v(3.0F, 4.0F);
  EXPECT_FALSE(v.IsNormalized());
  EXPECT_TRUE(v.Normalize());
  EXPECT_TRUE(Same(v, 0.6, 0.8));
  EXPECT_TRUE(v.IsNormalized());
}

TEST(dVect2D, NormalizeRoundsTheLengthFirst) {
  Numbers numbers(5);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect2D v = numbers.Next2D();
    const double x = v.x, y = v.y;
    const double length = std::sqrt(x * x + y * y);
    dVect2D unit(v);
    ASSERT_TRUE(unit.Normalize());
    ASSERT_TRUE(Same(unit, x / Round(length), y / Round(length)));
    ASSERT_TRUE(unit.IsNormalized());
    differing += unit.x != Round(x / length);
  }
  EXPECT_GT(differing, 0);
}

TEST(dVect2D, NormalizeRefusesAVectorWithoutLength) {
  dVect2D v(kJustNearZero, 0.0F);
  EXPECT_FALSE(v.Normalize());
  EXPECT_TRUE(Same(v, kJustNearZero, 0));
  v.Set(kBeyond, 0);
  EXPECT_TRUE(v.Normalize());
  EXPECT_TRUE(Same(v, 1, 0));
  // Longer than the tolerance although no component is.
  v.Set(8e-7, 8e-7);
  EXPECT_TRUE(v.Normalize());
  EXPECT_NEAR(v.x, std::sqrt(0.5), 1e-7);
  // The length is compared as it is stored: this one only rounds to the tolerance.
  v.Set(kJustNearZero, 2.6e-10);
  ASSERT_GT(v.Length(), 1e-6);
  EXPECT_FALSE(v.Normalize());
  EXPECT_TRUE(Same(v, kJustNearZero, 2.6e-10));
}

TEST(dVect2D, IsNormalizedComparesTheLength) {
  const float unit = std::ldexp(1.0F, -23);
  EXPECT_TRUE(dVect2D(1.0F + 8.0F * unit, 0.0F).IsNormalized());   // 9.54e-7 too long
  EXPECT_FALSE(dVect2D(1.0F + 9.0F * unit, 0.0F).IsNormalized());  // 1.07e-6
  EXPECT_TRUE(dVect2D(0.0F, -1.0F + 8.0F * unit).IsNormalized());
  EXPECT_FALSE(dVect2D(0.0F, -1.0F + 9.0F * unit).IsNormalized());
  EXPECT_FALSE(dVect2D().IsNormalized());
}

TEST(dVect2D, MultipliesVectors) {
  const dVect2D a(2.0F, 3.0F);
  const dVect2D b(5.0F, -7.0F);
  EXPECT_EQ(a.Product(b), -11.0);
  EXPECT_EQ(a.CrossProduct(b), -29.0);
  EXPECT_EQ(b.CrossProduct(a), 29.0);
  // Differences that single precision would lose.
  EXPECT_EQ(dVect2D(4097.0F, 4096.0F).CrossProduct(dVect2D(4096.0F, 4095.0F)), -1.0);
  EXPECT_EQ(dVect2D(4097.0F, 4096.0F).Product(dVect2D(4095.0F, -4096.0F)), -1.0);
}

TEST(dVect2D, SumsDifferencesAndCopiesAreNewVectors) {
  const dVect2D a(2.0F, 3.0F);
  const dVect2D b(5.0F, -7.0F);
  EXPECT_TRUE(Same(a + b, 7, -4));
  EXPECT_TRUE(Same(a - b, -3, 10));
  EXPECT_TRUE(Same(a * 2, 4, 6));
  EXPECT_TRUE(Same(a, 2, 3));
}

TEST(dVect2D, ProductOfTwoIsAPairOfOppositeNumbers) {
  EXPECT_TRUE(Same(dVect2D(2.0F, 3.0F) * dVect2D(5.0F, -7.0F), -29, 29));
}

TEST(dVect2D, ProductOfTwoTurnsNearZeroIntoZero) {
  const dVect2D along(1.0F, 0.0F);
  EXPECT_TRUE(Same(along * dVect2D(0.0F, kJustNearZero), 0, 0));
  EXPECT_TRUE(Same(along * dVect2D(0.0F, kBeyond), kBeyond, -kBeyond));
  EXPECT_TRUE(Same(along * dVect2D(4.0F, 0.0F), 0, 0));  // no negative zero either
  // A component is judged as it is stored: this product only rounds to the tolerance.
  const dVect2D a(kJustNearZero, 3e-14F), b(-1.0F, 1.0F);
  ASSERT_GT(a.CrossProduct(b), 1e-6);
  EXPECT_TRUE(Same(a * b, 0, 0));
}

}  // namespace
