#ifndef VORL_PLATFORM_SOFT_EXACTMATH_H
#define VORL_PLATFORM_SOFT_EXACTMATH_H

/// @file
/// Integer arithmetic for shapes whose corners may stand anywhere in the 32-bit plane: products of
/// two coordinate differences do not fit 64 bits.

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// The largest integer whose square is not above `value`.
std::uint64_t SquareRootFloor(std::uint64_t value);

/// The largest integer below or equal to `factor * side / sqrt(side^2 + other^2)`. `factor` is
/// at most 2^31, the sides are below 2^32 and not both 0.
std::int64_t ShareOfDiagonal(std::uint64_t factor, std::uint64_t side, std::uint64_t other);

/// The values ceil((k * slope + shift) / divisor) for successive k: where a line crosses successive
/// rows. After the first value only additions are needed.
class CeilingRamp {
 public:
  /// Starts at k = `first`. `divisor` is positive; magnitudes: `first`, `divisor` and `slope` up to
  /// 2^36, `shift` up to 2^62.
  CeilingRamp(std::int64_t first, std::int64_t slope, std::int64_t shift, std::int64_t divisor);

  std::int64_t Value() const { return m_floor + (m_rest > 0 ? 1 : 0); }
  void Next();

 private:
  std::int64_t m_divisor;
  std::int64_t m_floorStep;  // slope = m_floorStep * divisor + m_restStep
  std::int64_t m_restStep;
  std::int64_t m_floor;  // the value is m_floor + m_rest / divisor, 0 <= m_rest < divisor
  std::int64_t m_rest;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
