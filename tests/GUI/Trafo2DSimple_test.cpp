// Translation, scaling and rotation.

#include <vorl/GUI/Trafo2D.h>

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "TrafoTesting.h"

namespace {

using geometry_testing::Numbers;
using gui_testing::Is;
using gui_testing::IsNear;
using gui_testing::IsUndone;
using gui_testing::NextScale;
using gui_testing::PointA2B;
using gui_testing::PointB2A;
using gui_testing::VectorA2B;
using gui_testing::VectorB2A;

TEST(Translate2D, IsTheIdentityAfterConstruction) {
  Translate2D trafo;
  EXPECT_EQ(trafo.GetTx(), 0.0);
  EXPECT_EQ(trafo.GetTy(), 0.0);
  EXPECT_TRUE(Is(PointA2B(trafo, 3, 4), 3, 4));
  EXPECT_TRUE(Is(PointB2A(trafo, 3, 4), 3, 4));
}

TEST(Translate2D, MovesPointsAndLeavesVectors) {
  Translate2D trafo(1, 2);
  EXPECT_TRUE(Is(PointA2B(trafo, 0, 0), 1, 2));
  EXPECT_TRUE(Is(PointB2A(trafo, 0, 0), -1, -2));
  EXPECT_TRUE(Is(VectorA2B(trafo, 1, 0), 1, 0));
  EXPECT_TRUE(Is(VectorB2A(trafo, 1, 0), 1, 0));
}

TEST(Translate2D, TakesTheWayBetweenTwoPlacesPerDirection) {
  const Translate2D built(10, 13, 20, 15);
  EXPECT_EQ(built.GetTx(), 3.0);
  EXPECT_EQ(built.GetTy(), -5.0);
  Translate2D trafo(100, 100);
  trafo.Init(10, 13, 20, 15);
  EXPECT_TRUE(Is(PointA2B(trafo, 10, 20), 13, 15));
}

TEST(Translate2D, Copies) {
  const Translate2D source(1, 2);
  Translate2D copy(source), assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_TRUE(Is(PointA2B(copy, 0, 0), 1, 2));
  EXPECT_TRUE(Is(PointA2B(assigned, 0, 0), 1, 2));
}

TEST(Scale2D, IsTheIdentityAfterConstruction) {
  Scale2D trafo;
  EXPECT_TRUE(Is(PointA2B(trafo, 3, 4), 3, 4));
  EXPECT_TRUE(Is(PointB2A(trafo, 3, 4), 3, 4));
  EXPECT_EQ(trafo.GetSx(), 1.0);
  EXPECT_EQ(trafo.GetSy(), 1.0);
  EXPECT_EQ(trafo.GetOriginX(), 0.0);
  EXPECT_EQ(trafo.GetOriginY(), 0.0);
}

TEST(Scale2D, KeepsItsCentre) {
  Scale2D trafo;
  trafo.Init(2, 2, 10, 10);
  EXPECT_TRUE(Is(PointA2B(trafo, 10, 10), 10, 10));
  EXPECT_TRUE(Is(PointA2B(trafo, 11, 10), 12, 10));
}

TEST(Scale2D, ScalesEachDirectionByItself) {
  Scale2D trafo(2, 4, 10, 100);
  EXPECT_EQ(trafo.GetSx(), 2.0);
  EXPECT_EQ(trafo.GetSy(), 4.0);
  EXPECT_EQ(trafo.GetOriginX(), -10.0);
  EXPECT_EQ(trafo.GetOriginY(), -300.0);
  EXPECT_TRUE(Is(PointA2B(trafo, 1, 2), -8, -292));
  EXPECT_TRUE(Is(PointB2A(trafo, -8, -292), 1, 2));
  EXPECT_TRUE(Is(VectorA2B(trafo, 1, 2), 2, 8));
  EXPECT_TRUE(Is(VectorB2A(trafo, 2, 8), 1, 2));
}

TEST(Scale2D, TakesTwoPlacesPerDirection) {
  Scale2D trafo;
  trafo.Init(0, 100, 10, 120, 5, 50, 6, 20);
  EXPECT_EQ(trafo.GetSx(), 2.0);
  EXPECT_EQ(trafo.GetSy(), -30.0);
  EXPECT_EQ(trafo.GetOriginX(), 100.0);
  EXPECT_EQ(trafo.GetOriginY(), 200.0);
  EXPECT_TRUE(Is(PointA2B(trafo, 0, 5), 100, 50));
  EXPECT_TRUE(Is(PointA2B(trafo, 10, 6), 120, 20));
}

TEST(Scale2D, PointsComeBackUnchangedFromAScaleOfZero) {
  Scale2D trafo(0, 2, 10, 10);
  EXPECT_TRUE(Is(PointA2B(trafo, 3, 4), 10, -2));
  EXPECT_TRUE(Is(PointB2A(trafo, 7, -2), 7, 4));
  Scale2D other(2, 0, 10, 10);
  EXPECT_TRUE(Is(PointB2A(other, -4, 7), 3, 7));
  Scale2D negativeZero(-0.0, 2, 0, 0);
  EXPECT_TRUE(Is(PointB2A(negativeZero, 7, 4), 7, 2));
}

TEST(Scale2D, OnlyExactlyZeroIsGuarded) {
  Scale2D trafo(1e-300, 1, 0, 0);
  EXPECT_TRUE(Is(PointB2A(trafo, 1e-300, 1), 1, 1));
}

TEST(Scale2D, VectorsAreNotGuardedAgainstAScaleOfZero) {
  Scale2D trafo(0, 0, 10, 10);
  EXPECT_TRUE(std::isinf(VectorB2A(trafo, 1, 0).x));
  EXPECT_TRUE(std::isnan(VectorB2A(trafo, 1, 0).y));
}

TEST(Scale2D, OneAndTheSamePlaceTwiceGivesNoScale) {
  Scale2D trafo;
  trafo.Init(5, 1, 5, 2, 7, 3, 7, 3);
  EXPECT_TRUE(std::isinf(trafo.GetSx()));
  EXPECT_TRUE(std::isnan(trafo.GetSy()));
}

/// Changes the mapping of single coordinates.
class Logarithmic : public Scale2D {
 protected:
  double _X_pA2B(double x) override { return x + 1000.0; }
  double _X_pB2A(double x) override { return x - 1000.0; }
  double _Y_pA2B(double y) override { return y + 2000.0; }
  double _Y_pB2A(double y) override { return y - 2000.0; }
};

TEST(Scale2D, PointsGoThroughTheMappingsOfSingleCoordinates) {
  Logarithmic trafo;
  EXPECT_TRUE(Is(PointA2B(trafo, 1, 2), 1001, 2002));
  EXPECT_TRUE(Is(PointB2A(trafo, 1, 2), -999, -1998));
  EXPECT_TRUE(Is(VectorA2B(trafo, 1, 2), 1, 2));
}

TEST(Scale2D, Copies) {
  const Scale2D source(2, 4, 10, 100);
  Scale2D copy(source), assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_TRUE(Is(PointA2B(copy, 1, 2), -8, -292));
  EXPECT_TRUE(Is(PointA2B(assigned, 1, 2), -8, -292));
}

TEST(Rotate2D, IsTheIdentityAfterConstruction) {
  Rotate2D trafo;
  EXPECT_EQ(trafo.GetAngleRad(), 0.0);
  EXPECT_TRUE(Is(PointA2B(trafo, 3, 4), 3, 4));
  EXPECT_TRUE(Is(VectorB2A(trafo, 3, 4), 3, 4));
}

TEST(Rotate2D, TurnsInTheSameSenseBothWays) {
  Rotate2D trafo;
  trafo.InitDeg(90, 0, 0);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 1, 0), 0, 1));
  EXPECT_TRUE(IsNear(PointB2A(trafo, 1, 0), 0, 1));
  EXPECT_TRUE(IsNear(VectorA2B(trafo, 1, 0), 0, 1));
  EXPECT_TRUE(IsNear(VectorB2A(trafo, 1, 0), 0, 1));
}

TEST(Rotate2D, TurnsPointsAboutItsCentreAndVectorsAboutNone) {
  Rotate2D trafo(std::numbers::pi / 2, 10, 20);
  EXPECT_TRUE(IsNear(PointA2B(trafo, 10, 20), 10, 20));
  EXPECT_TRUE(IsNear(PointA2B(trafo, 13, 24), 6, 23));
  EXPECT_TRUE(IsNear(PointB2A(trafo, 13, 24), 6, 23));
  EXPECT_TRUE(IsNear(VectorA2B(trafo, 3, 4), -4, 3));
  EXPECT_TRUE(IsNear(VectorB2A(trafo, 3, 4), -4, 3));
}

TEST(Rotate2D, TakesRadiansAndTellsItsCentre) {
  const Rotate2D built(0.5, 10, 20);
  Rotate2D set;
  set.InitRad(0.5, 10, 20);
  for (const Rotate2D* trafo : {&built, static_cast<const Rotate2D*>(&set)}) {
    EXPECT_EQ(trafo->GetAngleRad(), 0.5);
    EXPECT_EQ(trafo->GetRx(), 10.0);
    EXPECT_EQ(trafo->GetRy(), 20.0);
  }
}

TEST(Rotate2D, DegreesTakePiForTenDecimals) {
  constexpr double kPi = 3.1415926535;
  EXPECT_EQ(0.017453292519444445, kPi / 180);
  Rotate2D trafo;
  trafo.InitDeg(180, 1, 2);
  EXPECT_EQ(trafo.GetAngleRad(), 180 * (kPi / 180));
  EXPECT_LT(trafo.GetAngleRad(), std::numbers::pi - 8e-11);
  EXPECT_EQ(trafo.GetRx(), 1.0);
  EXPECT_EQ(trafo.GetRy(), 2.0);
  trafo.InitRad(std::numbers::pi, 0, 0);
  EXPECT_EQ(trafo.GetAngleDeg(), std::numbers::pi / (kPi / 180));
  EXPECT_GT(trafo.GetAngleDeg(), 180 + 5e-9);
}

TEST(Rotate2D, Copies) {
  const Rotate2D source(0.5, 10, 20);
  Rotate2D copy(source), assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  for (Rotate2D* trafo : {&copy, &assigned}) {
    EXPECT_EQ(trafo->GetAngleRad(), 0.5);
    EXPECT_EQ(trafo->GetRy(), 20.0);
    EXPECT_TRUE(Is(VectorA2B(*trafo, 1, 0), std::cos(0.5), std::sin(0.5)));
  }
}

TEST(Trafo2DSimple, BackUndoesForth) {
  Numbers numbers(131);
  for (int i = 0; i < 1000; ++i) {
    const gui_testing::Pair p = {numbers.NextDouble(), numbers.NextDouble()};
    Translate2D translate(numbers.NextDouble(), numbers.NextDouble());
    ASSERT_TRUE(IsUndone(translate, p, 1e-12));
    Scale2D scale(NextScale(numbers), NextScale(numbers), numbers.Next(), numbers.Next());
    ASSERT_TRUE(IsUndone(scale, p, 1e-11));
  }
}

TEST(Trafo2DSimple, TheNegatedAngleUndoesARotation) {
  Numbers numbers(132);
  for (int i = 0; i < 1000; ++i) {
    const double angle = numbers.Next(), cx = numbers.Next(), cy = numbers.Next();
    const double x = numbers.NextDouble(), y = numbers.NextDouble();
    Rotate2D trafo(angle, cx, cy), inverse(-angle, cx, cy);
    const auto there = PointA2B(trafo, x, y);
    ASSERT_TRUE(IsNear(PointA2B(inverse, there.x, there.y), x, y, 1e-11));
    ASSERT_NEAR(std::hypot(there.x - cx, there.y - cy), std::hypot(x - cx, y - cy), 1e-11);
    ASSERT_TRUE(Is(PointB2A(trafo, x, y), there.x, there.y));
  }
}

}  // namespace
