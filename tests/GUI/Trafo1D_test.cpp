#include <vorl/GUI/Trafo1D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <type_traits>

#include "../Data/GeometryTesting.h"

namespace {

using geometry_testing::Numbers;

static_assert(!std::is_polymorphic_v<Trafo1D>);

TEST(Trafo1D, IsTheIdentityAfterConstruction) {
  const Trafo1D trafo;
  EXPECT_EQ(trafo.GetScale(), 1.0);
  EXPECT_EQ(trafo.GetOffset(), 0.0);
  EXPECT_EQ(trafo.A2B(7.25), 7.25);
  EXPECT_EQ(trafo.B2A(7.25), 7.25);
}

TEST(Trafo1D, ScalesAndThenAddsTheOffset) {
  const Trafo1D trafo(2.0, 3.0);
  EXPECT_EQ(trafo.GetScale(), 2.0);
  EXPECT_EQ(trafo.GetOffset(), 3.0);
  EXPECT_EQ(trafo.A2B(5.0), 13.0);
  EXPECT_EQ(trafo.B2A(13.0), 5.0);
}

TEST(Trafo1D, SetReplacesBoth) {
  Trafo1D trafo(2.0, 3.0);
  trafo.Set(-4.0, 0.5);
  EXPECT_EQ(trafo.A2B(1.0), -3.5);
  EXPECT_EQ(trafo.B2A(-3.5), 1.0);
}

TEST(Trafo1D, MapsInPlace) {
  const Trafo1D trafo(2.0, 3.0);
  double x = 5.0;
  trafo.A2B(&x);
  EXPECT_EQ(x, 13.0);
  trafo.B2A(&x);
  EXPECT_EQ(x, 5.0);
}

TEST(Trafo1D, IgnoresANullPointer) {
  const Trafo1D trafo(2.0, 3.0);
  double* const none = nullptr;
  trafo.A2B(none);
  trafo.B2A(none);
  SUCCEED();  // it is the access that would fail
}

TEST(Trafo1D, TakesALiteralZeroForANumber) {
  const Trafo1D trafo(2.0, 3.0);
  EXPECT_EQ(trafo.A2B(0), 3.0);
  EXPECT_EQ(trafo.B2A(0), -1.5);
  EXPECT_EQ(trafo.A2B(5), 13.0);
}

TEST(Trafo1D, Copies) {
  const Trafo1D source(2.0, 3.0);
  EXPECT_EQ(Trafo1D(source).A2B(5.0), 13.0);
  Trafo1D assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_EQ(assigned.A2B(5.0), 13.0);
}

TEST(Trafo1D, AScaleOfZeroIsNotGuarded) {
  const Trafo1D trafo(0.0, 3.0);
  EXPECT_EQ(trafo.A2B(100.0), 3.0);
  EXPECT_TRUE(std::isinf(trafo.B2A(4.0)));
  EXPECT_TRUE(std::isnan(trafo.B2A(3.0)));
}

TEST(Trafo1D, BackFollowsTheFormulaAndUndoesForth) {
  Numbers numbers(101);
  for (int i = 0; i < 1000; ++i) {
    const double scale = numbers.NextDouble(), offset = numbers.NextDouble();
    const double x = numbers.NextDouble();
    const Trafo1D trafo(scale, offset);
    const double there = trafo.A2B(x);
    ASSERT_EQ(there, scale * x + offset);
    ASSERT_EQ(trafo.B2A(there), (there - offset) / scale);
    const double magnitude = std::abs(scale * x) + std::abs(offset);
    ASSERT_NEAR(trafo.B2A(there), x, 1e-14 * magnitude / std::abs(scale));
  }
}

}  // namespace
