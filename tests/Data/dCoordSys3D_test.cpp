#include <vorl/Data/dCoordSys.h>

#include <gtest/gtest.h>

#include <cmath>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Round;
using geometry_testing::Same;

const double kQuarter = std::acos(0.0);
const dVect3D kOrigin(1.0F, 2.0F, 3.0F), kX(4.0F, 5.0F, 6.0F), kY(-7.0F, 8.0F, 9.0F),
    kZ(10.0F, -11.0F, 12.0F);

void ExpectSystem(const dCoordSys3D& system, const dVect3D& origin, const dVect3D& x,
                  const dVect3D& y, const dVect3D& z) {
  EXPECT_TRUE(Same(system.origin, origin));
  EXPECT_TRUE(Same(system.axisX, x));
  EXPECT_TRUE(Same(system.axisY, y));
  EXPECT_TRUE(Same(system.axisZ, z));
}

void ExpectUnit(const dCoordSys3D& system) {
  ExpectSystem(system, dVect3D(), dVect3D(1.0F, 0.0F, 0.0F), dVect3D(0.0F, 1.0F, 0.0F),
               dVect3D(0.0F, 0.0F, 1.0F));
}

dCoordSys3D Random(Numbers& numbers) {
  const dVect3D origin = numbers.Next3D(), x = numbers.Next3D(), y = numbers.Next3D();
  return {origin, x, y, numbers.Next3D()};
}

TEST(dCoordSys3D, StartsWithUnitAxes) {
  dCoordSys3D system;
  ExpectUnit(system);
  EXPECT_TRUE(system.IsValid());
  system.Set(kOrigin, kX, kY, kZ);
  system.Reset();
  ExpectUnit(system);
}

TEST(dCoordSys3D, TakesOriginAndAxes) {
  const dCoordSys3D built(kOrigin, kX, kY, kZ);
  ExpectSystem(built, kOrigin, kX, kY, kZ);
  ExpectSystem(dCoordSys3D(built), kOrigin, kX, kY, kZ);
  dCoordSys3D system;
  system.Set(kOrigin, kX, kY, kZ);
  ExpectSystem(system, kOrigin, kX, kY, kZ);
  dCoordSys3D assigned;
  EXPECT_EQ(&(assigned = system), &assigned);
  ExpectSystem(assigned, kOrigin, kX, kY, kZ);
  system.Set(kOrigin, kX, kX, dVect3D());
  EXPECT_TRUE(system.IsValid());  // whatever the axes
}

TEST(dCoordSys3D, SetTakesItsOwnVectors) {
  dCoordSys3D system(kZ, kOrigin, kX, kY);
  system.Set(system.axisX, system.axisY, system.axisZ, system.origin);
  ExpectSystem(system, kOrigin, kX, kY, kZ);
}

TEST(dCoordSys3D, MovesTheOrigin) {
  dCoordSys3D system(kOrigin, kX, kY, kZ);
  system.Move(10, 20, 30);
  ExpectSystem(system, dVect3D(11.0F, 22.0F, 33.0F), kX, kY, kZ);
  system.Move(dVect3D(-10.0F, -20.0F, -30.0F));
  ExpectSystem(system, kOrigin, kX, kY, kZ);
}

TEST(dCoordSys3D, ScalesTheAxesByFactorsRoundedToSingle) {
  Numbers numbers(41);
  int differing = 0;
  for (int i = 0; i < 1000; ++i) {
    const dCoordSys3D start = Random(numbers);
    const double fx = numbers.NextDouble(), fy = numbers.NextDouble(), fz = numbers.NextDouble();
    const double rx = Round(fx), ry = Round(fy), rz = Round(fz);
    dCoordSys3D system(start);
    system.Scale(fx, fy, fz);
    const dVect3D &x = start.axisX, &y = start.axisY, &z = start.axisZ;
    ASSERT_TRUE(Same(system.origin, start.origin));
    ASSERT_TRUE(Same(system.axisX, x.x * rx, x.y * rx, x.z * rx));
    ASSERT_TRUE(Same(system.axisY, y.x * ry, y.y * ry, y.z * ry));
    ASSERT_TRUE(Same(system.axisZ, z.x * rz, z.y * rz, z.z * rz));
    differing += system.axisX.x != Round(x.x * fx);
  }
  EXPECT_GT(differing, 0);
}

TEST(dCoordSys3D, ScalingAboutACentreMovesTheOriginTowardsIt) {
  dCoordSys3D system(kOrigin, kX, kY, kZ);
  system.Scale(2, 3, 0.5, dVect3D(11.0F, 12.0F, 13.0F));
  ExpectSystem(system, dVect3D(11.0F, 22.0F, -2.0F), dVect3D(8.0F, 10.0F, 12.0F),
               dVect3D(-21.0F, 24.0F, 27.0F), dVect3D(5.0F, -5.5F, 6.0F));
}

TEST(dCoordSys3D, ScalingAboutACentreRoundsTheOriginOnce) {
  Numbers numbers(42);
  for (int i = 0; i < 1000; ++i) {
    const dCoordSys3D start = Random(numbers);
    const dVect3D c = numbers.Next3D();
    const double fx = numbers.NextDouble(), fy = numbers.NextDouble(), fz = numbers.NextDouble();
    const double x = start.origin.x, y = start.origin.y, z = start.origin.z;
    dCoordSys3D system(start);
    system.Scale(fx, fy, fz, c);
    ASSERT_TRUE(Same(system.origin, x + (fx - 1) * (c.x - x), y + (fy - 1) * (c.y - y),
                     z + (fz - 1) * (c.z - z)));
  }
}

TEST(dCoordSys3D, CentreOfScalingMayBeAnAxis) {
  dCoordSys3D system(kOrigin, kX, kY, kZ);
  system.Scale(2, 2, 2, system.axisX);
  EXPECT_TRUE(Same(system.origin, kX));  // as it was before the axes were scaled
}

TEST(dCoordSys3D, RotatesTheAxesAboutADirection) {
  dCoordSys3D system;
  system.Move(5, 6, 7);
  system.Rotate(kQuarter, dVect3D(0.0F, 0.0F, 2.0F));
  EXPECT_TRUE(Same(system.origin, 5, 6, 7));
  EXPECT_TRUE(system.axisX == dVect3D(0.0F, 1.0F, 0.0F));
  EXPECT_TRUE(system.axisY == dVect3D(-1.0F, 0.0F, 0.0F));
  EXPECT_TRUE(system.axisZ == dVect3D(0.0F, 0.0F, 1.0F));
}

TEST(dCoordSys3D, RotatesTheOriginAboutALine) {
  dCoordSys3D system;
  system.Move(5, 6, 7);
  system.Rotate(dVect3D(5.0F, 0.0F, 0.0F), dVect3D(0.0F, 0.0F, 1.0F), kQuarter);
  EXPECT_TRUE(system.origin == dVect3D(-1.0F, 0.0F, 7.0F));
  EXPECT_TRUE(system.axisX == dVect3D(0.0F, 1.0F, 0.0F));
  EXPECT_TRUE(system.axisY == dVect3D(-1.0F, 0.0F, 0.0F));
  EXPECT_TRUE(system.axisZ == dVect3D(0.0F, 0.0F, 1.0F));
}

TEST(dCoordSys3D, RotationIsThatOfTheVectors) {
  Numbers numbers(43);
  for (int i = 0; i < 200; ++i) {
    dCoordSys3D expected = Random(numbers);
    const dVect3D centre = numbers.Next3D(), axis = numbers.Next3D();
    const double angle = numbers.NextDouble();
    dCoordSys3D turned(expected), moved(expected);
    for (dVect3D* v : {&expected.axisX, &expected.axisY, &expected.axisZ}) {
      v->vRotate(axis, angle);
    }
    turned.Rotate(angle, axis);
    ExpectSystem(turned, expected.origin, expected.axisX, expected.axisY, expected.axisZ);
    expected.origin.pRotate(centre, axis, angle);
    moved.Rotate(centre, axis, angle);
    ExpectSystem(moved, expected.origin, expected.axisX, expected.axisY, expected.axisZ);
  }
}

TEST(dCoordSys3D, RotationMayTakeItsOwnVectors) {
  Numbers numbers(45);
  for (int i = 0; i < 100; ++i) {  // rounding moves most axes a little even about themselves
    const dCoordSys3D random = Random(numbers);
    dCoordSys3D expected(random), system(random);
    expected.Rotate(1.0, dVect3D(random.axisX));
    system.Rotate(1.0, system.axisX);
    ExpectSystem(system, expected.origin, expected.axisX, expected.axisY, expected.axisZ);
  }
  const dCoordSys3D start(kOrigin, kX, kY, kZ);
  dCoordSys3D expected(start), system(start);
  expected = system = start;
  expected.Rotate(dVect3D(start.axisZ), dVect3D(start.axisY), 1.0);
  system.Rotate(system.axisZ, system.axisY, 1.0);
  ExpectSystem(system, expected.origin, expected.axisX, expected.axisY, expected.axisZ);
  expected = system = start;
  expected.Rotate(dVect3D(start.origin), dVect3D(start.origin), 1.0);
  system.Rotate(system.origin, system.origin, 1.0);
  ExpectSystem(system, expected.origin, expected.axisX, expected.axisY, expected.axisZ);
}

TEST(dCoordSys3D, VectorsTakeTheAxesAndPointsTheOriginToo) {
  const dCoordSys3D system(kOrigin, kX, kY, kZ);
  const dVect3D in(1.0F, 2.0F, 3.0F);
  dVect3D out;
  system.vCS2W(in, out);  // 1 * x + 2 * y + 3 * z
  EXPECT_TRUE(Same(out, 20, -12, 60));
  system.pCS2W(in, out);
  EXPECT_TRUE(Same(out, 21, -10, 63));
}

TEST(dCoordSys3D, ConversionsAreRoundedOnce) {
  Numbers numbers(44);
  for (int i = 0; i < 1000; ++i) {
    const dCoordSys3D s = Random(numbers);
    const dVect3D in = numbers.Next3D();
    const double x = in.x, y = in.y, z = in.z;
    dVect3D out;
    s.vCS2W(in, out);
    ASSERT_TRUE(Same(out, x * s.axisX.x + y * s.axisY.x + z * s.axisZ.x,
                     x * s.axisX.y + y * s.axisY.y + z * s.axisZ.y,
                     x * s.axisX.z + y * s.axisY.z + z * s.axisZ.z));
    s.pCS2W(in, out);
    ASSERT_TRUE(Same(out, s.origin.x + x * s.axisX.x + y * s.axisY.x + z * s.axisZ.x,
                     s.origin.y + x * s.axisX.y + y * s.axisY.y + z * s.axisZ.y,
                     s.origin.z + x * s.axisX.z + y * s.axisY.z + z * s.axisZ.z));
  }
}

TEST(dCoordSys3D, ConversionsInPlaceGiveTheSame) {
  const dCoordSys3D system(kOrigin, kX, kY, kZ);
  const dVect3D in(1.5F, -2.25F, 3.0F);
  dVect3D out, inPlace(in), oneObject(in);
  system.vCS2W(in, out);
  system.vCS2W(inPlace);
  system.vCS2W(oneObject, oneObject);
  EXPECT_TRUE(Same(inPlace, out));
  EXPECT_TRUE(Same(oneObject, out));
  inPlace = oneObject = in;
  system.pCS2W(in, out);
  system.pCS2W(inPlace);
  system.pCS2W(oneObject, oneObject);
  EXPECT_TRUE(Same(inPlace, out));
  EXPECT_TRUE(Same(oneObject, out));
}

}  // namespace
