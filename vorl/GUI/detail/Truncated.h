#ifndef VORL_GUI_DETAIL_TRUNCATED_H
#define VORL_GUI_DETAIL_TRUNCATED_H

/// @file
/// The one conversion of mapped coordinates to integers.

#include <cmath>
#include <concepts>
#include <limits>

inline namespace vorl {
namespace vorl_detail {

/// Cuts off the decimals. A value beyond the range gives the nearest limit, NaN gives 0: the plain
/// conversion is undefined for both.
template <std::signed_integral Integer>
Integer Truncated(double value) {
  using Limits = std::numeric_limits<Integer>;
  // The lowest value is a power of two and exact; the largest one of a 64-bit type is not.
  constexpr auto kLowest = static_cast<double>(Limits::min());
  if (std::isnan(value)) {
    return 0;
  }
  const double whole = std::trunc(value);
  if (whole < kLowest) {
    return Limits::min();
  }
  return whole >= -kLowest ? Limits::max() : static_cast<Integer>(whole);
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
