#ifndef TESTS_GUI_TRAFOTESTING_H
#define TESTS_GUI_TRAFOTESTING_H

/// @file
/// What the tests of the maps of the plane share.

#include <vorl/GUI/Trafo2D.h>

#include <gtest/gtest.h>

#include <cmath>

#include "../Data/GeometryTesting.h"

namespace gui_testing {

/// A pair of coordinates in double precision.
struct Pair {
  double x;
  double y;
};

inline Pair PointA2B(Trafo2DBase& trafo, double x, double y) {
  Pair out = {};
  trafo.pA2B(x, y, out.x, out.y);
  return out;
}

inline Pair PointB2A(Trafo2DBase& trafo, double x, double y) {
  Pair out = {};
  trafo.pB2A(x, y, out.x, out.y);
  return out;
}

inline Pair VectorA2B(Trafo2DBase& trafo, double x, double y) {
  Pair out = {};
  trafo.vA2B(x, y, out.x, out.y);
  return out;
}

inline Pair VectorB2A(Trafo2DBase& trafo, double x, double y) {
  Pair out = {};
  trafo.vB2A(x, y, out.x, out.y);
  return out;
}

/// Exactly these numbers.
inline ::testing::AssertionResult Is(const Pair& pair, double x, double y) {
  if (pair.x == x && pair.y == y) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure()
         << "(" << pair.x << ", " << pair.y << ") instead of (" << x << ", " << y << ")";
}

/// These numbers to within a tolerance.
inline ::testing::AssertionResult IsNear(const Pair& pair, double x, double y,
                                         double tolerance = 1e-9) {
  if (std::abs(pair.x - x) <= tolerance && std::abs(pair.y - y) <= tolerance) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure()
         << "(" << pair.x << ", " << pair.y << ") instead of (" << x << ", " << y << ")";
}

/// Mapping forth and back leads to where it started, for points and for vectors.
inline ::testing::AssertionResult IsUndone(Trafo2DBase& trafo, const Pair& p, double tolerance) {
  const Pair there = PointA2B(trafo, p.x, p.y);
  auto point = IsNear(PointB2A(trafo, there.x, there.y), p.x, p.y, tolerance);
  if (!point) {
    return point << " as a point";
  }
  const Pair way = VectorA2B(trafo, p.x, p.y);
  return IsNear(VectorB2A(trafo, way.x, way.y), p.x, p.y, tolerance) << " as a vector";
}

/// From 1 to 8, of either sign.
inline double NextScale(geometry_testing::Numbers& numbers) {
  const double x = std::remainder(numbers.NextDouble(), 6.0);
  return x < 0 ? -std::exp2(-x) : std::exp2(x);
}

}  // namespace gui_testing

#endif
