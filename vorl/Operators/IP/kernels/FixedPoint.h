#ifndef VORL_OPERATORS_IP_KERNELS_FIXEDPOINT_H
#define VORL_OPERATORS_IP_KERNELS_FIXEDPOINT_H

/// @file
/// The 16.16 fixed-point arithmetic in which the volume operators walk through a volume.
///
/// Positions and products wrap at 32 bits; wrapping is computed in unsigned arithmetic.

#include <vorl/Data/dVect3D.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>

inline namespace vorl {
namespace vorl_detail {

inline std::int32_t WrapAdd(std::int32_t a, std::int32_t b) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) + static_cast<std::uint32_t>(b));
}

inline std::int32_t WrapSubtract(std::int32_t a, std::int32_t b) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) - static_cast<std::uint32_t>(b));
}

inline std::int32_t WrapMultiply(std::int32_t a, std::int32_t b) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) * static_cast<std::uint32_t>(b));
}

/// A number of voxels or pixels in 16.16. From 32,768 on it wraps as the positions do; it is then
/// at most the size, so nothing outside is ever taken for inside.
inline std::int32_t FixedSize(std::int32_t size) {
  return WrapMultiply(size, 65536);
}

/// The value times 65536, truncated towards zero. A value that does not fit becomes the nearest one
/// that does; one that is not a number becomes 0.
inline std::int32_t ToFixed(double value) {
  constexpr double kLow = std::numeric_limits<std::int32_t>::min();
  constexpr double kHigh = std::numeric_limits<std::int32_t>::max();
  const double scaled = value * 65536.0;
  return std::isnan(scaled) ? 0 : static_cast<std::int32_t>(std::clamp(scaled, kLow, kHigh));
}

/// A point or a step in voxel coordinates, 16.16 each.
struct FixedVector {
  std::int32_t x = 0;
  std::int32_t y = 0;
  std::int32_t z = 0;

  static FixedVector Of(const dVect3D& vector) {
    return {ToFixed(vector.x), ToFixed(vector.y), ToFixed(vector.z)};
  }

  /// A point outside every volume and raster.
  static FixedVector Outside() {
    constexpr std::int32_t kOutside = std::numeric_limits<std::int32_t>::min();
    return {kOutside, kOutside, kOutside};
  }

  void operator+=(const FixedVector& step) {
    x = WrapAdd(x, step.x);
    y = WrapAdd(y, step.y);
    z = WrapAdd(z, step.z);
  }

  /// This vector `count` times.
  FixedVector Times(std::int32_t count) const {
    return {WrapMultiply(x, count), WrapMultiply(y, count), WrapMultiply(z, count)};
  }

  /// Each component divided by a positive number, truncated towards zero.
  FixedVector DividedBy(std::int32_t divisor) const {
    return {x / divisor, y / divisor, z / divisor};
  }
};

inline FixedVector operator-(const FixedVector& a, const FixedVector& b) {
  return {WrapSubtract(a.x, b.x), WrapSubtract(a.y, b.y), WrapSubtract(a.z, b.z)};
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
