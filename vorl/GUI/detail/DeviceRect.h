#ifndef VORL_GUI_DETAIL_DEVICERECT_H
#define VORL_GUI_DETAIL_DEVICERECT_H

/// @file
/// The arithmetic of device rectangles, whose edges may be any 32-bit numbers.

#include <vorl/Platform/Gdi.h>

#include <algorithm>
#include <cstdint>
#include <limits>

inline namespace vorl {
namespace vorl_detail {

/// The nearest number that a device coordinate can be.
inline int ToDevice(std::int64_t value) {
  return static_cast<int>(std::clamp<std::int64_t>(value, std::numeric_limits<int>::min(),
                                                   std::numeric_limits<int>::max()));
}

/// The way from the left to the right edge; negative where they are swapped.
inline int WidthOf(const tagRECT& rect) {
  return ToDevice(std::int64_t{rect.right} - rect.left);
}

/// The way from the top to the bottom edge; negative where they are swapped.
inline int HeightOf(const tagRECT& rect) {
  return ToDevice(std::int64_t{rect.bottom} - rect.top);
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
