#ifndef TESTS_DATA_GEOMETRYTESTING_H
#define TESTS_DATA_GEOMETRYTESTING_H

/// @file
/// Random input and exact comparison for the tests of the geometry values.

#include <vorl/Data/dVect2D.h>
#include <vorl/Data/dVect3D.h>

#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <cstdint>
#include <random>

namespace geometry_testing {

/// Numbers of both signs and very different sizes, the same in every run.
class Numbers {
 public:
  explicit Numbers(std::uint32_t seed) : m_engine(seed) {}

  /// 24 random bits scaled by a power of two between 2^-8 and 2^8.
  float Next() {
    const auto mantissa = static_cast<int>(m_engine() >> 8) - (1 << 23);
    const auto exponent = static_cast<int>(m_engine() % 17U) - 8;
    return std::ldexp(static_cast<float>(mantissa), exponent - 23);
  }
  /// The same with 48 random bits.
  double NextDouble() { return static_cast<double>(Next()) + std::ldexp(Next(), -24); }
  dVect2D Next2D() {
    const float x = Next();
    return {x, Next()};
  }
  dVect3D Next3D() {
    const float x = Next();
    const float y = Next();
    return {x, y, Next()};
  }

 private:
  std::mt19937 m_engine;
};

inline float Round(double value) {
  return static_cast<float>(value);
}

/// The same bits, which `==` of numbers and vectors does not ask for.
inline ::testing::AssertionResult Same(float actual, double expected) {
  const float rounded = Round(expected);
  if (std::bit_cast<std::uint32_t>(actual) == std::bit_cast<std::uint32_t>(rounded)) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure()
         << std::hexfloat << actual << " instead of " << rounded << std::defaultfloat << " ("
         << actual << ", " << rounded << ")";
}

inline ::testing::AssertionResult Same(const dVect2D& v, double x, double y) {
  const auto result = Same(v.x, x);
  return result ? Same(v.y, y) << " in y" : result;
}

inline ::testing::AssertionResult Same(const dVect3D& v, double x, double y, double z) {
  const auto result = Same(v.x, x);
  return result ? (Same(v.y, y) ? Same(v.z, z) << " in z" : Same(v.y, y) << " in y") : result;
}

inline ::testing::AssertionResult Same(const dVect2D& v, const dVect2D& expected) {
  return Same(v, expected.x, expected.y);
}

inline ::testing::AssertionResult Same(const dVect3D& v, const dVect3D& expected) {
  return Same(v, expected.x, expected.y, expected.z);
}

}  // namespace geometry_testing

#endif
