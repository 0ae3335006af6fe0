#include <vorl/Data/dVect3D.h>

#include <gtest/gtest.h>

#include <cmath>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Round;
using geometry_testing::Same;

const double kQuarter = std::acos(0.0);

/// Three single-precision numbers, with every rounding written out.
struct Triple {
  float x, y, z;
};

Triple Rounded(double x, double y, double z) {
  return {Round(x), Round(y), Round(z)};
}

Triple Plus(const Triple& a, const Triple& b) {
  return Rounded(double{a.x} + b.x, double{a.y} + b.y, double{a.z} + b.z);
}

Triple Minus(const Triple& a, const Triple& b) {
  return Rounded(double{a.x} - b.x, double{a.y} - b.y, double{a.z} - b.z);
}

Triple Times(const Triple& a, float f) {
  return Rounded(double{a.x} * f, double{a.y} * f, double{a.z} * f);
}

float CutNearZero(double value) {
  return std::abs(double{Round(value)}) <= 1e-6 ? 0.0F : Round(value);
}

Triple Cross(const Triple& a, const Triple& b) {
  return {CutNearZero(double{a.y} * b.z - double{a.z} * b.y),
          CutNearZero(double{a.z} * b.x - double{a.x} * b.z),
          CutNearZero(double{a.x} * b.y - double{a.y} * b.x)};
}

/// The rotation in its given steps.
Triple RotationModel(const Triple& v, const Triple& axis, double angle) {
  const float length =
      Round(std::sqrt(double{axis.x} * axis.x + double{axis.y} * axis.y + double{axis.z} * axis.z));
  const Triple n =
      Rounded(double{axis.x} / length, double{axis.y} / length, double{axis.z} / length);
  const float dot = Round(double{v.x} * n.x + double{v.y} * n.y + double{v.z} * n.z);
  const Triple p = Times(n, dot);
  const Triple w = Minus(v, p);
  const Triple c = Cross(n, w);
  return Plus(Plus(p, Times(w, Round(std::cos(angle)))), Times(c, Round(std::sin(angle))));
}

Triple Of(const dVect3D& v) {
  return {v.x, v.y, v.z};
}

TEST(dVect3DRotation, FollowsTheRightHandRule) {
  const dVect3D x(1.0F, 0.0F, 0.0F), y(0.0F, 1.0F, 0.0F), z(0.0F, 0.0F, 1.0F);
  dVect3D v(x);
  v.vRotate(z, kQuarter);
  EXPECT_TRUE(v == y);
  v.vRotate(x, kQuarter);
  EXPECT_TRUE(v == z);
  v.vRotate(y, kQuarter);
  EXPECT_TRUE(v == x);
  v.vRotate(z, -kQuarter);
  EXPECT_TRUE(v == dVect3D(0.0F, -1.0F, 0.0F));
}

TEST(dVect3DRotation, TakesAnAxisOfAnyLength) {
  dVect3D v(5.0F, 0.0F, 7.0F);
  v.vRotate(dVect3D(0.0F, 0.0F, 100.0F), kQuarter);
  EXPECT_TRUE(v == dVect3D(0.0F, 5.0F, 7.0F));
  v.vRotate(dVect3D(0.0F, 0.0F, -0.01F), kQuarter);
  EXPECT_TRUE(v == dVect3D(5.0F, 0.0F, 7.0F));
}

TEST(dVect3DRotation, EachStepIsRounded) {
  Numbers numbers(21);
  for (int i = 0; i < 5000; ++i) {
    const dVect3D v = numbers.Next3D();
    const dVect3D axis = numbers.Next3D();
    const double angle = numbers.NextDouble();
    const Triple expected = RotationModel(Of(v), Of(axis), angle);
    dVect3D rotated(v);
    rotated.vRotate(axis, angle);
    ASSERT_TRUE(Same(rotated, expected.x, expected.y, expected.z)) << i;
  }
}

TEST(dVect3DRotation, AgreesWithTheRotationMatrix) {
  Numbers numbers(22);
  for (int i = 0; i < 1000; ++i) {
    const dVect3D v = numbers.Next3D();
    const dVect3D axis = numbers.Next3D();
    const double angle = numbers.NextDouble();
    const double length = axis.Length(), c = std::cos(angle), s = std::sin(angle);
    const double nx = axis.x / length, ny = axis.y / length, nz = axis.z / length, u = 1 - c;
    dVect3D rotated(v);
    rotated.vRotate(axis, angle);
    const double tolerance = 1e-6 * (1.0 + v.Length());
    ASSERT_NEAR(
        rotated.x,
        (c + nx * nx * u) * v.x + (nx * ny * u - nz * s) * v.y + (nx * nz * u + ny * s) * v.z,
        tolerance);
    ASSERT_NEAR(
        rotated.y,
        (ny * nx * u + nz * s) * v.x + (c + ny * ny * u) * v.y + (ny * nz * u - nx * s) * v.z,
        tolerance);
    ASSERT_NEAR(
        rotated.z,
        (nz * nx * u - ny * s) * v.x + (nz * ny * u + nx * s) * v.y + (c + nz * nz * u) * v.z,
        tolerance);
  }
}

TEST(dVect3DRotation, PartAcrossIsCutWhereItIsNearZero) {
  // The turned part of so short a vector is near zero, and vanishes.
  dVect3D v(1e-6F, 0.0F, 0.0F);
  v.vRotate(dVect3D(0.0F, 0.0F, 1.0F), kQuarter / 2.0);
  EXPECT_TRUE(Same(v, double{1e-6F} * Round(std::cos(kQuarter / 2.0)), 0, 0));
}

TEST(dVect3DRotation, AxisOrAngleNearZeroChangesNothing) {
  dVect3D v(1.0F, 2.0F, 3.0F);
  v.vRotate(dVect3D(), 1.0);
  EXPECT_TRUE(Same(v, 1, 2, 3));
  v.vRotate(dVect3D(1e-6F, 1e-6F, -1e-6F), 1.0);  // longer than the tolerance, but near zero
  EXPECT_TRUE(Same(v, 1, 2, 3));
  v.vRotate(dVect3D(0.0F, 0.0F, 1.0F), 1e-6);
  EXPECT_TRUE(Same(v, 1, 2, 3));
  v.vRotate(dVect3D(0.0F, 0.0F, 1.0F), -1e-6);
  EXPECT_TRUE(Same(v, 1, 2, 3));
  v.Set(1, 0, 0);
  v.vRotate(dVect3D(0.0F, 0.0F, 1.0F), std::nextafter(1e-6, 1.0));
  EXPECT_TRUE(Same(v, 1, 1e-6F, 0));
  v.Set(1, 0, 0);
  v.vRotate(dVect3D(0.0F, 0.0F, 2e-6F), kQuarter);
  EXPECT_TRUE(v == dVect3D(0.0F, 1.0F, 0.0F));
}

TEST(dVect3DRotation, AboutItselfChangesNothing) {
  dVect3D v(1.0F, 2.0F, 3.0F);
  v.vRotate(v, 1.0);
  EXPECT_TRUE(v == dVect3D(1.0F, 2.0F, 3.0F));
}

TEST(dVect3DRotation, RotatesAPointAboutALine) {
  dVect3D p(3.0F, 1.0F, 9.0F);
  p.pRotate(dVect3D(1.0F, 1.0F, 5.0F), dVect3D(0.0F, 0.0F, 1.0F), kQuarter);
  EXPECT_TRUE(p == dVect3D(1.0F, 3.0F, 9.0F));
}

TEST(dVect3DRotation, AboutALineRoundsEachStep) {
  Numbers numbers(23);
  for (int i = 0; i < 1000; ++i) {
    const dVect3D p = numbers.Next3D(), centre = numbers.Next3D(), axis = numbers.Next3D();
    const double angle = numbers.NextDouble();
    const Triple expected =
        Plus(RotationModel(Minus(Of(p), Of(centre)), Of(axis), angle), Of(centre));
    dVect3D rotated(p);
    rotated.pRotate(centre, axis, angle);
    ASSERT_TRUE(Same(rotated, expected.x, expected.y, expected.z)) << i;
  }
}

TEST(dVect3DRotation, CentreAndAxisMayBeThePointItself) {
  const dVect3D start(1.0F, 2.0F, 3.0F);
  dVect3D p(start);
  p.pRotate(p, dVect3D(0.0F, 0.0F, 1.0F), 1.0);
  EXPECT_TRUE(Same(p, start));
  p.pRotate(dVect3D(4.0F, 0.0F, 0.0F), p, 1.0);
  dVect3D expected(start);
  expected.pRotate(dVect3D(4.0F, 0.0F, 0.0F), start, 1.0);
  EXPECT_TRUE(Same(p, expected));
}

}  // namespace
