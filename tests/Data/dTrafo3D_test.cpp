#include <vorl/Data/dTrafo.h>

#include <gtest/gtest.h>

#include <cmath>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Same;

/// Different numbers everywhere, the two directions unrelated.
dTrafo3D Sample() {
  dTrafo3D t;
  t.s2t[0].Set(2, 3, 5);
  t.s2t[1].Set(7, 11, 13);
  t.s2t[2].Set(17, 19, 23);
  t.transS2T.Set(29, 31, 37);
  t.t2s[0].Set(-2, 3, -5);
  t.t2s[1].Set(7, -11, 13);
  t.t2s[2].Set(-17, 19, -23);
  t.transT2S.Set(-29, 31, -37);
  return t;
}

void ExpectSame(const dTrafo3D& actual, const dTrafo3D& expected) {
  for (int i = 0; i < 3; ++i) {
    EXPECT_TRUE(Same(actual.s2t[i], expected.s2t[i])) << i;
    EXPECT_TRUE(Same(actual.t2s[i], expected.t2s[i])) << i;
  }
  EXPECT_TRUE(Same(actual.transS2T, expected.transS2T));
  EXPECT_TRUE(Same(actual.transT2S, expected.transT2S));
}

void ExpectIdentityMatrices(const dTrafo3D& trafo) {
  for (const dVect3D* m : {trafo.s2t, trafo.t2s}) {
    EXPECT_TRUE(Same(m[0], 1, 0, 0));
    EXPECT_TRUE(Same(m[1], 0, 1, 0));
    EXPECT_TRUE(Same(m[2], 0, 0, 1));
  }
}

void ExpectIdentity(const dTrafo3D& trafo) {
  ExpectIdentityMatrices(trafo);
  EXPECT_TRUE(trafo.transS2T.IsZero(0.0F));  // of either sign
  EXPECT_TRUE(trafo.transT2S.IsZero(0.0F));
}

TEST(dTrafo3D, IsAllZeroAfterConstruction) {
  dTrafo3D trafo;
  for (int i = 0; i < 3; ++i) {
    EXPECT_TRUE(Same(trafo.s2t[i], 0, 0, 0));
    EXPECT_TRUE(Same(trafo.t2s[i], 0, 0, 0));
  }
  EXPECT_TRUE(Same(trafo.transS2T, 0, 0, 0));
  EXPECT_TRUE(Same(trafo.transT2S, 0, 0, 0));
  EXPECT_TRUE(trafo.IsValid());
}

TEST(dTrafo3D, ResetGivesTheIdentity) {
  dTrafo3D trafo = Sample();
  trafo.Reset();
  ExpectIdentity(trafo);
}

TEST(dTrafo3D, Copies) {
  const dTrafo3D source = Sample();
  ExpectSame(dTrafo3D(source), source);
  dTrafo3D assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  ExpectSame(assigned, source);
}

TEST(dTrafo3D, EachConversionUsesItsOwnMatrix) {
  const dTrafo3D trafo = Sample();
  const dVect3D in(1.0F, 10.0F, 100.0F);
  dVect3D out;
  trafo.vS2T(in, out);
  EXPECT_TRUE(Same(out, 1772, 2013, 2435));
  trafo.pS2T(in, out);
  EXPECT_TRUE(Same(out, 1801, 2044, 2472));
  trafo.vT2S(in, out);
  EXPECT_TRUE(Same(out, -1632, 1793, -2175));
  trafo.pT2S(in, out);
  EXPECT_TRUE(Same(out, -1661, 1824, -2212));
}

using Separate = void (dTrafo3D::*)(const dVect3D&, dVect3D&) const;
using InPlace = void (dTrafo3D::*)(dVect3D&) const;

struct Conversion {
  Separate separate;
  InPlace inPlace;
};

const Conversion kConversions[] = {{&dTrafo3D::vS2T, &dTrafo3D::vS2T},
                                   {&dTrafo3D::pS2T, &dTrafo3D::pS2T},
                                   {&dTrafo3D::vT2S, &dTrafo3D::vT2S},
                                   {&dTrafo3D::pT2S, &dTrafo3D::pT2S}};

TEST(dTrafo3D, ConversionsInPlaceGiveTheSame) {
  const dTrafo3D trafo = Sample();
  const dVect3D in(1.5F, -2.25F, 3.0F);
  for (const Conversion& conversion : kConversions) {
    dVect3D out, inPlace(in), oneObject(in);
    (trafo.*conversion.separate)(in, out);
    (trafo.*conversion.inPlace)(inPlace);
    (trafo.*conversion.separate)(oneObject, oneObject);
    EXPECT_TRUE(Same(inPlace, out));
    EXPECT_TRUE(Same(oneObject, out));
  }
}

TEST(dTrafo3D, ConversionsAreRoundedOnce) {
  Numbers numbers(61);
  for (int i = 0; i < 1000; ++i) {
    dTrafo3D t;
    for (dVect3D* v : {&t.s2t[0], &t.s2t[1], &t.s2t[2], &t.transS2T}) {
      *v = numbers.Next3D();
    }
    const dVect3D &a = t.s2t[0], &b = t.s2t[1], &c = t.s2t[2];
    const dVect3D in = numbers.Next3D();
    const double x = in.x, y = in.y, z = in.z;
    dVect3D out;
    t.vS2T(in, out);
    ASSERT_TRUE(Same(out, x * a.x + y * b.x + z * c.x, x * a.y + y * b.y + z * c.y,
                     x * a.z + y * b.z + z * c.z));
    t.pS2T(in, out);
    ASSERT_TRUE(Same(out, x * a.x + y * b.x + z * c.x + t.transS2T.x,
                     x * a.y + y * b.y + z * c.y + t.transS2T.y,
                     x * a.z + y * b.z + z * c.z + t.transS2T.z));
  }
}

TEST(dTrafo3D, SetTranslationMapsThePointsOntoEachOther) {
  dTrafo3D trafo = Sample();
  const dVect3D ps(1.0F, 10.0F, 100.0F), pt(1.0F, 1.0F, 1.0F);
  trafo.SetTranslation(ps, pt);
  EXPECT_TRUE(Same(trafo.transS2T, 1 - 1772, 1 - 2013, 1 - 2435));
  EXPECT_TRUE(Same(trafo.transT2S, 1 + 12, 10 - 11, 100 + 15));
  dVect3D p(ps);
  trafo.pS2T(p);
  EXPECT_TRUE(Same(p, pt));
  trafo.pT2S(p);
  EXPECT_TRUE(Same(p, ps));
}

TEST(dTrafo3D, SetTranslationTakesItsOwnVectors) {
  dTrafo3D expected = Sample(), trafo = Sample();
  expected.SetTranslation(dVect3D(Sample().transT2S), dVect3D(Sample().transS2T));
  trafo.SetTranslation(trafo.transT2S, trafo.transS2T);
  ExpectSame(trafo, expected);
}

dCoordSys3D Diagonal(const dVect3D& origin, float x, float y, float z) {
  return {origin, dVect3D(x, 0.0F, 0.0F), dVect3D(0.0F, y, 0.0F), dVect3D(0.0F, 0.0F, z)};
}

TEST(dTrafo3D, InitUsesTheAxesAndBothOrigins) {
  const dCoordSys3D s = Diagonal(dVect3D(10.0F, 20.0F, 30.0F), 2.0F, 3.0F, 4.0F);
  const dCoordSys3D t = Diagonal(dVect3D(2.0F, 4.0F, 6.0F), 4.0F, 2.0F, 8.0F);
  dTrafo3D trafo;
  EXPECT_TRUE(trafo.Init(s, t));
  EXPECT_TRUE(Same(trafo.s2t[0], 0.5, 0, 0));
  EXPECT_TRUE(Same(trafo.s2t[1], 0, 1.5, 0));
  EXPECT_TRUE(Same(trafo.s2t[2], 0, 0, 0.5));
  EXPECT_TRUE(Same(trafo.transS2T, 2, 8, 3));
  EXPECT_TRUE(Same(trafo.t2s[0], 2, 0, 0));
  EXPECT_TRUE(trafo.t2s[1] == dVect3D(0.0F, 2.0F / 3.0F, 0.0F));
  EXPECT_TRUE(Same(trafo.t2s[2], 0, 0, 2));
  EXPECT_TRUE(trafo.transT2S == dVect3D(-4.0F, -16.0F / 3.0F, -6.0F));
  ExpectSame(dTrafo3D(s, t), trafo);
}

TEST(dTrafo3D, DiagonalSystemsGiveTheWorldRoundTrip) {
  const dCoordSys3D s = Diagonal(dVect3D(1.0F, -2.0F, 3.0F), 2.0F, 3.0F, 4.0F);
  const dCoordSys3D t = Diagonal(dVect3D(-5.0F, 7.0F, 0.5F), 4.0F, 2.0F, 3.0F);
  const dTrafo3D trafo(s, t);
  Numbers numbers(62);
  for (int i = 0; i < 200; ++i) {
    const dVect3D p = numbers.Next3D();
    dVect3D inTarget, back;
    trafo.pS2T(p, inTarget);
    const double tolerance = 2e-6 * (1.0 + p.Length());
    ASSERT_NEAR(inTarget.x, (1.0 + 2.0 * p.x - -5.0) / 4.0, tolerance);
    ASSERT_NEAR(inTarget.y, (-2.0 + 3.0 * p.y - 7.0) / 2.0, tolerance);
    ASSERT_NEAR(inTarget.z, (3.0 + 4.0 * p.z - 0.5) / 3.0, tolerance);
    trafo.pT2S(inTarget, back);
    ASSERT_NEAR(back.Distance(p), 0.0, tolerance);
  }
}

dCoordSys3D RandomSystem(Numbers& numbers) {
  dCoordSys3D system;
  system.Scale(2, 3, 0.5);
  const dVect3D axis = numbers.Next3D();
  system.Rotate(numbers.NextDouble(), axis);
  system.axisX += system.axisY * 0.25;  // skew
  system.Move(numbers.Next3D());
  return system;
}

TEST(dTrafo3D, SkewSystemsMeetInTheWorld) {
  Numbers numbers(63);
  for (int i = 0; i < 200; ++i) {
    const dCoordSys3D s = RandomSystem(numbers), t = RandomSystem(numbers);
    const dTrafo3D trafo(s, t);
    const dVect3D p = numbers.Next3D();
    dVect3D inTarget, worldOfP, worldOfTarget, back;
    trafo.pS2T(p, inTarget);
    s.pCS2W(p, worldOfP);
    t.pCS2W(inTarget, worldOfTarget);
    const double size = 1.0 + p.Length() + s.origin.Length() + t.origin.Length();
    ASSERT_LT(worldOfP.Distance(worldOfTarget), 2e-5 * size);
    trafo.pT2S(inTarget, back);
    ASSERT_LT(back.Distance(p), 2e-5 * size);
  }
}

TEST(dTrafo3D, ASingularTargetGivesTheIdentity) {
  const dCoordSys3D s = Diagonal(dVect3D(1.0F, 2.0F, 3.0F), 2.0F, 3.0F, 4.0F);
  const dCoordSys3D t = Diagonal(dVect3D(4.0F, 5.0F, 6.0F), 1.0F, 0.0F, 1.0F);
  dTrafo3D trafo = Sample();
  EXPECT_TRUE(trafo.Init(s, t));
  ExpectIdentity(trafo);
}

TEST(dTrafo3D, ASingularSourceGivesTheIdentityWithTranslations) {
  const dCoordSys3D s = Diagonal(dVect3D(1.0F, 2.0F, 3.0F), 2.0F, 0.0F, 4.0F);
  const dCoordSys3D t = Diagonal(dVect3D(5.0F, 5.0F, 5.0F), 2.0F, 4.0F, 8.0F);
  dTrafo3D trafo = Sample();
  EXPECT_TRUE(trafo.Init(s, t));
  ExpectIdentityMatrices(trafo);
  EXPECT_TRUE(Same(trafo.transS2T, -2, -0.75, -0.25));  // the source's origin seen from the target
  EXPECT_TRUE(Same(trafo.transT2S, 2, 0.75, 0.25));
}

}  // namespace
