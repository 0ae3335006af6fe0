#include <vorl/Data/dVect3D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Round;
using geometry_testing::Same;

constexpr float kJustNearZero = 1e-6F;              // 9.99999997e-7
const float kBeyond = std::nextafter(1e-6F, 1.0F);  // 1.00000011e-6

TEST(dVect3D, IsZeroAfterConstructionAndReset) {
  dVect3D v;
  EXPECT_TRUE(Same(v, 0, 0, 0));
  v.Set(1, 2, 3);
  v.Reset();
  EXPECT_TRUE(Same(v, 0, 0, 0));
}

TEST(dVect3D, TakesComponents) {
  EXPECT_TRUE(Same(dVect3D(1.5F, -2.5F, 4.0F), 1.5, -2.5, 4));
  dVect3D v;
  v.Set(0.1, 0.2, 0.3);
  EXPECT_TRUE(Same(v, 0.1F, 0.2F, 0.3F));
}

TEST(dVect3D, CopiesAllComponents) {
  const dVect3D source(3.0F, -4.0F, 5.0F);
  const dVect3D copy(source);
  EXPECT_TRUE(Same(copy, source));
  dVect3D assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_TRUE(Same(assigned, source));
  dVect3D set;
  set.Set(source);
  EXPECT_TRUE(Same(set, 3, -4, 5));
}

TEST(dVect3D, DifferencesHaveTheOrdersOfThePlane) {
  const dVect3D a(1.0F, 2.0F, 3.0F);
  const dVect3D b(10.0F, 5.0F, 1.0F);
  EXPECT_TRUE(Same(dVect3D(a, b), 9, 3, -2));
  dVect3D v;
  v.Diff(a, b);
  EXPECT_TRUE(Same(v, 9, 3, -2));
  v = a;
  v.Diff(b);  // the argument minus this
  EXPECT_TRUE(Same(v, 9, 3, -2));
  v.Diff(v);
  EXPECT_TRUE(Same(v, 0, 0, 0));
}

TEST(dVect3D, IndexReachesTheComponentsAndClampsOutside) {
  dVect3D v;
  const dVect3D& constant = v;
  v[0] = 1.0F;
  v[1] = 2.0F;
  v[2] = 3.0F;
  EXPECT_TRUE(Same(v, 1, 2, 3));
  EXPECT_EQ(&constant[0], &v.x);
  EXPECT_EQ(&constant[1], &v.y);
  EXPECT_EQ(&constant[2], &v.z);
  EXPECT_EQ(&v[-1], &v.x);
  EXPECT_EQ(&constant[std::numeric_limits<int>::min()], &v.x);
  EXPECT_EQ(&v[3], &v.z);
  EXPECT_EQ(&constant[std::numeric_limits<int>::max()], &v.z);
}

TEST(dVect3D, AddsAndSubtractsComponentwise) {
  dVect3D v(1.0F, 2.0F, 3.0F);
  EXPECT_EQ(&(v += dVect3D(10.0F, 20.0F, 30.0F)), &v);
  EXPECT_TRUE(Same(v, 11, 22, 33));
  EXPECT_EQ(&(v -= dVect3D(1.0F, 5.0F, 30.0F)), &v);
  EXPECT_TRUE(Same(v, 10, 17, 3));
  v.Move(dVect3D(1.0F, -1.0F, 2.0F));
  EXPECT_TRUE(Same(v, 11, 16, 5));
  v.Move(0.5, 2, -5);
  EXPECT_TRUE(Same(v, 11.5, 18, 0));
}

TEST(dVect3D, MovesByDoublesBeforeRounding) {
  const double half = std::ldexp(1.0, -24);
  const double little = std::ldexp(1.0, -50);
  dVect3D v(1.0F, 1.0F, 1.0F);
  v.Move(half + little, half - little, half + little);
  EXPECT_TRUE(Same(v, 1.0 + 2.0 * half, 1.0, 1.0 + 2.0 * half));
}

TEST(dVect3D, MultipliesByTheFactorRoundedToSingle) {
  Numbers numbers(11);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect3D v = numbers.Next3D();
    const double factor = numbers.NextDouble();
    const double rounded = Round(factor);
    dVect3D multiplied(v);
    EXPECT_EQ(&(multiplied *= factor), &multiplied);
    dVect3D scaled(v);
    scaled.Scale(factor);
    ASSERT_TRUE(Same(multiplied, v.x * rounded, v.y * rounded, v.z * rounded));
    ASSERT_TRUE(Same(scaled, multiplied));
    ASSERT_TRUE(Same(v * factor, multiplied));
    differing += multiplied.z != Round(v.z * factor);
  }
  EXPECT_GT(differing, 0);
}

TEST(dVect3D, ScalesEachComponentByItsUnroundedFactor) {
  Numbers numbers(12);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect3D v = numbers.Next3D();
    const double fx = numbers.NextDouble(), fy = numbers.NextDouble(), fz = numbers.NextDouble();
    dVect3D scaled(v);
    scaled.Scale(fx, fy, fz);
    ASSERT_TRUE(Same(scaled, v.x * fx, v.y * fy, v.z * fz));
    differing += scaled.z != Round(v.z * static_cast<double>(Round(fz)));
  }
  EXPECT_GT(differing, 0);
}

TEST(dVect3D, DividesByTheDivisorRoundedToSingle) {
  Numbers numbers(13);
  for (int i = 0; i < 1000; ++i) {
    const dVect3D v = numbers.Next3D();
    const double divisor = numbers.NextDouble();
    const double rounded = Round(divisor);
    dVect3D divided(v);
    EXPECT_EQ(&(divided /= divisor), &divided);
    ASSERT_TRUE(Same(divided, v.x / rounded, v.y / rounded, v.z / rounded));
  }
}

TEST(dVect3D, DivisionByZeroChangesNothing) {
  dVect3D v(1.0F, 2.0F, 3.0F);
  v /= 0.0;
  v /= -0.0;
  v /= 1e-60;  // zero once it is rounded
  EXPECT_TRUE(Same(v, 1, 2, 3));
}

TEST(dVect3D, ScalingAboutACentreMovesTowardsItForLargeFactors) {
  const dVect3D centre(3.0F, 3.0F, 3.0F);
  dVect3D v(1.0F, 1.0F, 2.0F);
  v.Scale(2, centre);
  EXPECT_TRUE(Same(v, centre));
  v.Set(1, 2, 3);
  v.Scale(0, centre);
  EXPECT_TRUE(Same(v, -1, 1, 3));
  v.Set(1, 2, 5);
  v.Scale(3, 1, 2, centre);
  EXPECT_TRUE(Same(v, 5, 2, 3));
}

TEST(dVect3D, ScalingAboutACentreIsRoundedOnce) {
  Numbers numbers(14);
  for (int i = 0; i < 1000; ++i) {
    const dVect3D v = numbers.Next3D(), c = numbers.Next3D();
    const double fx = numbers.NextDouble(), fy = numbers.NextDouble(), fz = numbers.NextDouble();
    const double x = v.x, y = v.y, z = v.z;
    dVect3D scaled(v);
    scaled.Scale(fx, fy, fz, c);
    ASSERT_TRUE(
        Same(scaled, x + (fx - 1) * (c.x - x), y + (fy - 1) * (c.y - y), z + (fz - 1) * (c.z - z)));
    scaled = v;
    scaled.Scale(fx, c);
    ASSERT_TRUE(
        Same(scaled, x + (fx - 1) * (c.x - x), y + (fx - 1) * (c.y - y), z + (fx - 1) * (c.z - z)));
  }
}

TEST(dVect3D, EqualWithinTheTolerance) {
  const dVect3D zero;
  EXPECT_TRUE(zero == dVect3D(kJustNearZero, -kJustNearZero, kJustNearZero));
  EXPECT_FALSE(zero != dVect3D(kJustNearZero, -kJustNearZero, kJustNearZero));
  for (int i = 0; i < 3; ++i) {
    dVect3D v;
    v[i] = -kBeyond;
    EXPECT_FALSE(zero == v) << i;
    EXPECT_TRUE(zero != v) << i;
    EXPECT_FALSE(v.IsZero()) << i;
    v[i] = std::numeric_limits<float>::quiet_NaN();
    EXPECT_FALSE(v == v) << i;
  }
}

TEST(dVect3D, IsZeroIncludesTheTolerance) {
  EXPECT_TRUE(dVect3D(kJustNearZero, -kJustNearZero, kJustNearZero).IsZero());
  EXPECT_TRUE(dVect3D(0.5F, -0.5F, 0.5F).IsZero(0.5F));
  for (int i = 0; i < 3; ++i) {
    dVect3D v;
    v[i] = -0.75F;
    EXPECT_FALSE(v.IsZero(0.5F)) << i;
  }
}

TEST(dVect3D, MeasuresLengthsAndDistancesInDouble) {
  const dVect3D v(2.0F, 3.0F, 6.0F);
  EXPECT_EQ(v.Length(), 7.0);
  EXPECT_EQ(v.Length2(), 49.0);
  const dVect3D other(4.0F, 0.0F, 12.0F);
  EXPECT_EQ(v.Distance(other), 7.0);
  EXPECT_EQ(v.Distance2(other), 49.0);
  EXPECT_EQ(dVect3D(1.0F, 0.0F, 4096.0F).Length2(), 16777217.0);
  EXPECT_EQ(dVect3D(1.0F, 0.0F, 4096.0F).Distance2(dVect3D()), 16777217.0);
}

TEST(dVect3D, NormalizeRoundsTheLengthFirst) {
  Numbers numbers(15);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dVect3D v = numbers.Next3D();
    const double x = v.x, y = v.y, z = v.z;
    const double length = std::sqrt(x * x + y * y + z * z);
    dVect3D unit(v);
    ASSERT_TRUE(unit.Normalize());
    ASSERT_TRUE(Same(unit, x / Round(length), y / Round(length), z / Round(length)));
    ASSERT_TRUE(unit.IsNormalized());
    differing += unit.x != Round(x / length);
  }
  EXPECT_GT(differing, 0);
}

TEST(dVect3D, NormalizeRefusesAVectorWithoutLength) {
  dVect3D v(0.0F, kJustNearZero, 0.0F);
  EXPECT_FALSE(v.Normalize());
  EXPECT_TRUE(Same(v, 0, kJustNearZero, 0));
  v.Set(0, kBeyond, 0);
  EXPECT_TRUE(v.Normalize());
  EXPECT_TRUE(Same(v, 0, 1, 0));
  // The length is compared as it is stored: this one only rounds to the tolerance.
  v.Set(0, kJustNearZero, 2.6e-10);
  ASSERT_GT(v.Length(), 1e-6);
  EXPECT_FALSE(v.Normalize());
}

TEST(dVect3D, IsNormalizedComparesTheSquaredLength) {
  EXPECT_FALSE(dVect3D(0.9995F, 0.0F, 0.0F).IsNormalized());
  const float unit = std::ldexp(1.0F, -23);
  EXPECT_TRUE(dVect3D(1.0F + 4.0F * unit, 0.0F, 0.0F).IsNormalized());  // squared: 9.54e-7 more
  // The length itself is 5.96e-7 too long, its square 1.19e-6.
  EXPECT_FALSE(dVect3D(1.0F + 5.0F * unit, 0.0F, 0.0F).IsNormalized());
  EXPECT_TRUE(dVect3D(0.0F, 0.0F, -1.0F).IsNormalized());
}

TEST(dVect3D, DotProduct) {
  EXPECT_EQ(dVect3D(1.0F, 2.0F, 3.0F).Product(dVect3D(4.0F, -5.0F, 6.0F)), 12.0);
  EXPECT_EQ(dVect3D(4097.0F, 4096.0F, 0.0F).Product(dVect3D(4095.0F, -4096.0F, 9.0F)), -1.0);
}

TEST(dVect3D, CrossProductMethodIsTheSumOfTheComponents) {
  // (1, 2, 3) x (4, -5, 6) = (27, 6, -13)
  EXPECT_EQ(dVect3D(1.0F, 2.0F, 3.0F).CrossProduct(dVect3D(4.0F, -5.0F, 6.0F)), 20.0);
  // Nothing is cut to zero on the way: (0, 0, 1e-7).
  EXPECT_EQ(dVect3D(1.0F, 0.0F, 0.0F).CrossProduct(dVect3D(0.0F, 1e-7F, 0.0F)),
            static_cast<double>(1e-7F));
}

TEST(dVect3D, ProductOfTwoIsTheCrossProduct) {
  EXPECT_TRUE(Same(dVect3D(1.0F, 2.0F, 3.0F) * dVect3D(4.0F, -5.0F, 6.0F), 27, 6, -13));
  const dVect3D x(1.0F, 0.0F, 0.0F), y(0.0F, 1.0F, 0.0F), z(0.0F, 0.0F, 1.0F);
  EXPECT_TRUE(Same(x * y, z));
  EXPECT_TRUE(Same(y * z, x));
  EXPECT_TRUE(Same(z * x, y));
  EXPECT_TRUE(Same(y * x, 0, 0, -1));
}

TEST(dVect3D, ProductOfTwoTurnsNearZeroIntoZero) {
  const dVect3D x(1.0F, 0.0F, 0.0F);
  EXPECT_TRUE(Same(x * dVect3D(0.0F, kJustNearZero, -kJustNearZero), 0, 0, 0));
  EXPECT_TRUE(Same(x * dVect3D(0.0F, kBeyond, -kBeyond), 0, kBeyond, kBeyond));
  const dVect3D y(0.0F, 1.0F, 0.0F);
  EXPECT_TRUE(Same(y * dVect3D(0.0F, 0.0F, kJustNearZero), 0, 0, 0));
  EXPECT_TRUE(Same(y * dVect3D(0.0F, 0.0F, kBeyond), kBeyond, 0, 0));
}

TEST(dVect3D, SumsAndDifferencesAreNewVectors) {
  const dVect3D a(1.0F, 2.0F, 3.0F), b(4.0F, -5.0F, 6.0F);
  EXPECT_TRUE(Same(a + b, 5, -3, 9));
  EXPECT_TRUE(Same(a - b, -3, 7, -3));
  EXPECT_TRUE(Same(a * 2, 2, 4, 6));
  EXPECT_TRUE(Same(a, 1, 2, 3));
}

}  // namespace
