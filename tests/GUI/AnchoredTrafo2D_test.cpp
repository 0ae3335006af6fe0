// The anchor that scaling, rotation and translation share: what each setter keeps in its place.

#include <vorl/GUI/Trafo2D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <type_traits>

#include <vorl/Platform/Gdi.h>

#include "TrafoTesting.h"

namespace {

using geometry_testing::Numbers;
using gui_testing::Is;
using gui_testing::IsNear;
using gui_testing::NextScale;
using gui_testing::PointA2B;
using gui_testing::PointB2A;
using gui_testing::VectorA2B;

static_assert(std::is_abstract_v<AnchoredTrafo2D>);

/// The setters work alike in both classes.
template <typename Trafo>
class AnchoredTrafo : public ::testing::Test {};

using Classes = ::testing::Types<TrafoST2D, TrafoSRT2D>;
TYPED_TEST_SUITE(AnchoredTrafo, Classes, );

template <typename Trafo>
void ExpectNumbers(const Trafo& trafo, double sx, double sy, double tx, double ty) {
  EXPECT_EQ(trafo.GetSx(), sx);
  EXPECT_EQ(trafo.GetSy(), sy);
  EXPECT_EQ(trafo.GetTx(), tx);
  EXPECT_EQ(trafo.GetTy(), ty);
}

TYPED_TEST(AnchoredTrafo, IsTheIdentityAfterConstruction) {
  TypeParam trafo;
  ExpectNumbers(trafo, 1, 1, 0, 0);
  EXPECT_TRUE(Is(PointA2B(trafo, 3, 4), 3, 4));
  trafo.SetScale(2, 3);  // about the origin
  ExpectNumbers(trafo, 2, 3, 0, 0);
}

TYPED_TEST(AnchoredTrafo, SetTakesTwoPointsToTwoPoints) {
  TypeParam trafo;
  trafo.Set(0, 0, 10, 10, 100, 200, 120, 240);
  ExpectNumbers(trafo, 2, 4, 100, 200);
  EXPECT_TRUE(Is(PointA2B(trafo, 5, 5), 110, 220));
  EXPECT_TRUE(Is(PointA2B(trafo, 10, 10), 120, 240));
}

TYPED_TEST(AnchoredTrafo, UpdateScaleMultipliesAndKeepsTheAnchor) {
  TypeParam trafo;
  trafo.Set(0, 0, 10, 10, 100, 200, 120, 240);
  trafo.UpdateScale(2, 2);
  EXPECT_TRUE(Is(PointA2B(trafo, 0, 0), 100, 200));
  ExpectNumbers(trafo, 4, 8, 100, 200);
}

TYPED_TEST(AnchoredTrafo, TheAnchorOfSetIsTheFirstPoint) {
  TypeParam trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  trafo.SetScale(-3, 0.5);
  EXPECT_TRUE(Is(PointA2B(trafo, 5, 7), 100, 200));
  EXPECT_TRUE(Is(PointA2B(trafo, 6, 9), 97, 201));
  trafo.UpdateScale(2, 4);
  EXPECT_TRUE(Is(PointA2B(trafo, 5, 7), 100, 200));
  EXPECT_TRUE(Is(PointA2B(trafo, 6, 9), 94, 204));
}

TYPED_TEST(AnchoredTrafo, SetTranslationAnchorsTheOrigin) {
  TypeParam trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  trafo.SetTranslation(30, 40);
  ExpectNumbers(trafo, 2, 4, 30, 40);
  trafo.SetScale(9, 9);
  ExpectNumbers(trafo, 9, 9, 30, 40);
}

TYPED_TEST(AnchoredTrafo, UpdateTranslationAddsAndAnchorsTheOrigin) {
  TypeParam trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  ExpectNumbers(trafo, 2, 4, 90, 172);
  trafo.UpdateTranslation(10, -2);
  ExpectNumbers(trafo, 2, 4, 100, 170);
  trafo.UpdateScale(3, 3);
  ExpectNumbers(trafo, 6, 12, 100, 170);
}

TYPED_TEST(AnchoredTrafo, SetTranslationOfFourTakesThePointThenItsPlace) {
  TypeParam trafo;
  trafo.SetScale(2, 4);
  trafo.SetTranslation(1, 2, 100, 200);
  ExpectNumbers(trafo, 2, 4, 98, 192);
  EXPECT_TRUE(Is(PointA2B(trafo, 1, 2), 100, 200));
  trafo.UpdateScale(5, 0.25);
  EXPECT_TRUE(Is(PointA2B(trafo, 1, 2), 100, 200));
  ExpectNumbers(trafo, 10, 1, 90, 198);
}

TYPED_TEST(AnchoredTrafo, SetTakesEveryPairOfRectangles) {
  TypeParam trafo;
  const Rect2D a(5, 7, 15, 17), b(100, 200, 120, 240);
  const tagRECT aPixels = {5, 7, 15, 17}, bPixels = {100, 200, 120, 240};
  trafo.Set(a, b);
  ExpectNumbers(trafo, 2, 4, 90, 172);
  trafo.Reset();
  trafo.Set(aPixels, bPixels);
  ExpectNumbers(trafo, 2, 4, 90, 172);
  trafo.Reset();
  trafo.Set(a, bPixels);
  ExpectNumbers(trafo, 2, 4, 90, 172);
  trafo.Reset();
  trafo.Set(aPixels, b);
  ExpectNumbers(trafo, 2, 4, 90, 172);
  trafo.SetScale(1, 1);  // the top left corners are the anchor
  EXPECT_TRUE(Is(PointA2B(trafo, 5, 7), 100, 200));
}

TYPED_TEST(AnchoredTrafo, RectanglesMayBeMirrored) {
  TypeParam trafo;
  trafo.Set(Rect2D(0, 10, 10, 0), Rect2D(100, 200, 120, 240));
  ExpectNumbers(trafo, 2, -4, 100, 240);
}

TYPED_TEST(AnchoredTrafo, IntegerRectanglesAreNotRoundedToSinglePrecision) {
  TypeParam trafo;
  trafo.Set(tagRECT{16777217, 0, 16777218, 1}, tagRECT{0, 0, 1, 1});
  ExpectNumbers(trafo, 1, 1, -16777217, 0);
}

TYPED_TEST(AnchoredTrafo, ResetForgetsTheAnchor) {
  TypeParam trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  trafo.Reset();
  ExpectNumbers(trafo, 1, 1, 0, 0);
  trafo.SetScale(2, 3);
  ExpectNumbers(trafo, 2, 3, 0, 0);
}

TYPED_TEST(AnchoredTrafo, CopiesTheAnchorToo) {
  TypeParam trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  TypeParam copy(trafo), assigned;
  EXPECT_EQ(&(assigned = trafo), &assigned);
  for (TypeParam* taken : {&copy, &assigned}) {
    ExpectNumbers(*taken, 2, 4, 90, 172);
    taken->SetScale(1, 1);
    EXPECT_TRUE(Is(PointA2B(*taken, 5, 7), 100, 200));
  }
}

TYPED_TEST(AnchoredTrafo, SizesOfZeroGiveInfinityOrNaN) {
  TypeParam trafo;
  trafo.Set(5, 7, 5, 7, 100, 200, 120, 200);
  EXPECT_TRUE(std::isinf(trafo.GetSx()));
  EXPECT_TRUE(std::isnan(trafo.GetSy()));
  tagPOINT point = {1, 1};
  trafo.pA2B(point);  // and integers stay defined
  EXPECT_EQ(point.y, 0);
}

TYPED_TEST(AnchoredTrafo, AScaleOfZeroIsNotGuardedOnTheWayBack) {
  TypeParam trafo;
  trafo.SetScale(0, 0);
  EXPECT_TRUE(Is(PointA2B(trafo, 3, 4), 0, 0));
  EXPECT_TRUE(std::isinf(PointB2A(trafo, 1, 1).x));
  EXPECT_TRUE(std::isnan(PointB2A(trafo, 0, 0).y));
  tagPOINT point = {1, 1};
  trafo.pB2A(point);
  EXPECT_EQ(point.x, std::numeric_limits<LONG>::max());
}

/// Opens the calculation of the translation.
template <typename Trafo>
class Open : public Trafo {
 public:
  using Trafo::CalculateTranslation;
};

TYPED_TEST(AnchoredTrafo, TheTranslationIsCalculatedFromTheAnchorAlone) {
  Open<TypeParam> trafo;
  trafo.Set(5, 7, 15, 17, 100, 200, 120, 240);
  trafo.CalculateTranslation();
  trafo.CalculateTranslation();  // nothing of the earlier one goes in
  ExpectNumbers(trafo, 2, 4, 90, 172);
}

TYPED_TEST(AnchoredTrafo, BackUndoesForth) {
  TypeParam trafo;
  Numbers numbers(141);
  for (int i = 0; i < 1000; ++i) {
    const gui_testing::Pair p = {numbers.NextDouble(), numbers.NextDouble()};
    trafo.SetScale(NextScale(numbers), NextScale(numbers));
    trafo.SetTranslation(numbers.Next(), numbers.Next(), numbers.Next(), numbers.Next());
    ASSERT_TRUE(gui_testing::IsUndone(trafo, p, 1e-10));
  }
}

TYPED_TEST(AnchoredTrafo, APointMovesByTheImageOfItsVector) {
  TypeParam trafo;
  Numbers numbers(142);
  for (int i = 0; i < 1000; ++i) {
    const double x = numbers.Next(), y = numbers.Next(), dx = numbers.Next(), dy = numbers.Next();
    trafo.SetScale(NextScale(numbers), NextScale(numbers));
    trafo.SetTranslation(numbers.Next(), numbers.Next());
    const auto from = PointA2B(trafo, x, y);
    const auto to = PointA2B(trafo, x + dx, y + dy);
    ASSERT_TRUE(IsNear(VectorA2B(trafo, dx, dy), to.x - from.x, to.y - from.y, 1e-10));
  }
}

}  // namespace
