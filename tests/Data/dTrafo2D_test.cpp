#include <vorl/Data/dTrafo.h>

#include <gtest/gtest.h>

#include <cmath>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Round;
using geometry_testing::Same;

const dVect2D kZero;

/// Different numbers everywhere, the two directions unrelated.
dTrafo2D Sample() {
  dTrafo2D t;
  t.s2t[0].Set(2, 3);
  t.s2t[1].Set(5, 7);
  t.transS2T.Set(11, 13);
  t.t2s[0].Set(-2, 17);
  t.t2s[1].Set(19, -3);
  t.transT2S.Set(23, 29);
  return t;
}

void ExpectSame(const dTrafo2D& actual, const dTrafo2D& expected) {
  EXPECT_TRUE(Same(actual.s2t[0], expected.s2t[0]));
  EXPECT_TRUE(Same(actual.s2t[1], expected.s2t[1]));
  EXPECT_TRUE(Same(actual.transS2T, expected.transS2T));
  EXPECT_TRUE(Same(actual.t2s[0], expected.t2s[0]));
  EXPECT_TRUE(Same(actual.t2s[1], expected.t2s[1]));
  EXPECT_TRUE(Same(actual.transT2S, expected.transT2S));
}

TEST(dTrafo2D, IsAllZeroAfterConstruction) {
  dTrafo2D trafo;
  for (const dVect2D* v : {&trafo.s2t[0], &trafo.s2t[1], &trafo.transS2T, &trafo.t2s[0],
                           &trafo.t2s[1], &trafo.transT2S}) {
    EXPECT_TRUE(Same(*v, 0, 0));
  }
  EXPECT_TRUE(trafo.IsValid());
}

TEST(dTrafo2D, ResetGivesTheIdentity) {
  dTrafo2D trafo = Sample();
  trafo.Reset();
  EXPECT_TRUE(Same(trafo.s2t[0], 1, 0));
  EXPECT_TRUE(Same(trafo.s2t[1], 0, 1));
  EXPECT_TRUE(Same(trafo.transS2T, 0, 0));
  EXPECT_TRUE(Same(trafo.t2s[0], 1, 0));
  EXPECT_TRUE(Same(trafo.t2s[1], 0, 1));
  EXPECT_TRUE(Same(trafo.transT2S, 0, 0));
}

TEST(dTrafo2D, Copies) {
  const dTrafo2D source = Sample();
  ExpectSame(dTrafo2D(source), source);
  dTrafo2D assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  ExpectSame(assigned, source);
}

TEST(dTrafo2D, EachConversionUsesItsOwnMatrix) {
  const dTrafo2D trafo = Sample();
  const dVect2D in(10.0F, 100.0F);
  dVect2D out;
  trafo.vS2T(in, out);
  EXPECT_TRUE(Same(out, 520, 730));
  trafo.pS2T(in, out);
  EXPECT_TRUE(Same(out, 531, 743));
  trafo.vT2S(in, out);
  EXPECT_TRUE(Same(out, 1880, -130));
  trafo.pT2S(in, out);
  EXPECT_TRUE(Same(out, 1903, -101));
}

using Separate = void (dTrafo2D::*)(const dVect2D&, dVect2D&) const;
using InPlace = void (dTrafo2D::*)(dVect2D&) const;

struct Conversion {
  Separate separate;
  InPlace inPlace;
};

const Conversion kConversions[] = {{&dTrafo2D::vS2T, &dTrafo2D::vS2T},
                                   {&dTrafo2D::pS2T, &dTrafo2D::pS2T},
                                   {&dTrafo2D::vT2S, &dTrafo2D::vT2S},
                                   {&dTrafo2D::pT2S, &dTrafo2D::pT2S}};

TEST(dTrafo2D, ConversionsInPlaceGiveTheSame) {
  const dTrafo2D trafo = Sample();
  const dVect2D in(1.5F, -2.25F);
  for (const Conversion& conversion : kConversions) {
    dVect2D out, inPlace(in), oneObject(in);
    (trafo.*conversion.separate)(in, out);
    (trafo.*conversion.inPlace)(inPlace);
    (trafo.*conversion.separate)(oneObject, oneObject);
    EXPECT_TRUE(Same(inPlace, out));
    EXPECT_TRUE(Same(oneObject, out));
  }
}

TEST(dTrafo2D, ConversionsAreRoundedOnce) {
  Numbers numbers(51);
  for (int i = 0; i < 1000; ++i) {
    dTrafo2D t;
    t.s2t[0] = numbers.Next2D();
    t.s2t[1] = numbers.Next2D();
    t.transS2T = numbers.Next2D();
    const dVect2D in = numbers.Next2D();
    const double x = in.x, y = in.y;
    dVect2D out;
    t.vS2T(in, out);
    ASSERT_TRUE(Same(out, x * t.s2t[0].x + y * t.s2t[1].x, x * t.s2t[0].y + y * t.s2t[1].y));
    t.pS2T(in, out);
    ASSERT_TRUE(Same(out, x * t.s2t[0].x + y * t.s2t[1].x + t.transS2T.x,
                     x * t.s2t[0].y + y * t.s2t[1].y + t.transS2T.y));
  }
}

TEST(dTrafo2D, SetTranslationMapsThePointsOntoEachOther) {
  dTrafo2D trafo = Sample();
  trafo.SetTranslation(dVect2D(10.0F, 100.0F), dVect2D(1.0F, 2.0F));
  EXPECT_TRUE(Same(trafo.transS2T, 1 - 520, 2 - 730));
  EXPECT_TRUE(Same(trafo.transT2S, 10 - (-2 + 38), 100 - (17 - 6)));
  EXPECT_TRUE(Same(trafo.s2t[0], 2, 3));  // the matrices stay
  EXPECT_TRUE(Same(trafo.t2s[1], 19, -3));
  dVect2D p(10.0F, 100.0F);
  trafo.pS2T(p);
  EXPECT_TRUE(Same(p, 1, 2));
  trafo.pT2S(p);
  EXPECT_TRUE(Same(p, 10, 100));
}

TEST(dTrafo2D, SetTranslationTakesItsOwnVectors) {
  dTrafo2D expected = Sample(), trafo = Sample();
  expected.SetTranslation(dVect2D(Sample().transT2S), dVect2D(Sample().transS2T));
  trafo.SetTranslation(trafo.transT2S, trafo.transS2T);
  ExpectSame(trafo, expected);
}

TEST(dTrafo2D, InitConvertsBetweenOrthogonalSystems) {
  const dCoordSys2D s(kZero, dVect2D(2.0F, 0.0F), dVect2D(0.0F, 4.0F));
  const dCoordSys2D t(kZero, dVect2D(0.0F, 8.0F), dVect2D(-1.0F, 0.0F));
  dTrafo2D trafo;
  EXPECT_TRUE(trafo.Init(s, t, dVect2D(1.0F, 1.0F), dVect2D(10.0F, 20.0F)));
  // World (2, 0) is -2 along t's y; world (0, 4) is 0.5 along its x.
  EXPECT_TRUE(Same(trafo.s2t[0], 0, -2));
  EXPECT_TRUE(Same(trafo.s2t[1], 0.5, 0));
  EXPECT_TRUE(Same(trafo.t2s[0], 0, 2));
  EXPECT_TRUE(Same(trafo.t2s[1], -0.5, 0));
  EXPECT_TRUE(Same(trafo.transS2T, 10 - 0.5, 20 + 2));
  EXPECT_TRUE(Same(trafo.transT2S, 1 + 10, 1 - 20));
}

TEST(dTrafo2D, InitDoesNotUseTheOrigins) {
  const dVect2D x(1.0F, 0.0F), y(0.0F, 1.0F);
  const dTrafo2D trafo(dCoordSys2D(dVect2D(5.0F, 5.0F), x, y),
                       dCoordSys2D(dVect2D(-3.0F, 9.0F), x, y));
  dVect2D p;
  trafo.pS2T(p);
  EXPECT_TRUE(Same(p, 0, 0));
  trafo.pT2S(p);
  EXPECT_TRUE(Same(p, 0, 0));
}

TEST(dTrafo2D, InitProjectsOntoSkewAxesToo) {
  // Exact coordinates of (1, 0) in the target would be (1, 0); the projections are (1, 1/2).
  const dCoordSys2D t(kZero, dVect2D(1.0F, 0.0F), dVect2D(1.0F, 1.0F));
  const dTrafo2D trafo(dCoordSys2D(), t);
  EXPECT_TRUE(Same(trafo.s2t[0], 1, 0.5));
  EXPECT_TRUE(Same(trafo.s2t[1], 0, 0.5));
  EXPECT_TRUE(Same(trafo.t2s[0], 1, 0));
  EXPECT_TRUE(Same(trafo.t2s[1], 1, 1));
}

TEST(dTrafo2D, InitRoundsEachEntryOnce) {
  Numbers numbers(52);
  const auto projected = [](const dVect2D& v, const dVect2D& axis) {
    const double x = axis.x, y = axis.y;
    return (v.x * x + v.y * y) / (x * x + y * y);
  };
  for (int i = 0; i < 1000; ++i) {
    const dVect2D sx = numbers.Next2D(), sy = numbers.Next2D();
    const dVect2D tx = numbers.Next2D(), ty = numbers.Next2D();
    const dTrafo2D trafo(dCoordSys2D(kZero, sx, sy), dCoordSys2D(kZero, tx, ty));
    ASSERT_TRUE(Same(trafo.s2t[0], projected(sx, tx), projected(sx, ty)));
    ASSERT_TRUE(Same(trafo.s2t[1], projected(sy, tx), projected(sy, ty)));
    ASSERT_TRUE(Same(trafo.t2s[0], projected(tx, sx), projected(tx, sy)));
    ASSERT_TRUE(Same(trafo.t2s[1], projected(ty, sx), projected(ty, sy)));
    ASSERT_TRUE(Same(trafo.transS2T, 0, 0));
    ASSERT_TRUE(Same(trafo.transT2S, 0, 0));
  }
}

TEST(dTrafo2D, ConstructorsInitialiseAlike) {
  const dCoordSys2D s(kZero, dVect2D(2.0F, 1.0F), dVect2D(-1.0F, 4.0F));
  const dCoordSys2D t(kZero, dVect2D(0.0F, 8.0F), dVect2D(-1.0F, 3.0F));
  const dVect2D ps(1.0F, 2.0F), pt(3.0F, 4.0F);
  dTrafo2D expected;
  expected.Init(s, t);
  ExpectSame(dTrafo2D(s, t), expected);
  dTrafo2D again = Sample();  // nothing is left of an earlier translation
  EXPECT_TRUE(again.Init(s, t));
  ExpectSame(again, expected);
  expected.SetTranslation(ps, pt);
  ExpectSame(dTrafo2D(s, t, ps, pt), expected);
}

TEST(dTrafo2D, AnAxisWithoutLengthGivesNaN) {
  dTrafo2D trafo;
  EXPECT_TRUE(trafo.Init(dCoordSys2D(), dCoordSys2D(kZero, kZero, dVect2D(0.0F, 1.0F))));
  EXPECT_TRUE(std::isnan(trafo.s2t[0].x));
  EXPECT_EQ(trafo.s2t[0].y, 0.0F);
  EXPECT_TRUE(Same(trafo.t2s[1], 0, 1));
}

}  // namespace
