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

/// The way from one edge to the other; negative where they are swapped. It can be mirrored: the
/// lowest number, whose opposite is none, is left out. Devices have been seen to divide by zero
/// when they are given it.
inline int ExtentOf(std::int64_t from, std::int64_t to) {
  return std::max(ToDevice(to - from), -std::numeric_limits<int>::max());
}

inline int WidthOf(const tagRECT& rect) {
  return ExtentOf(rect.left, rect.right);
}

inline int HeightOf(const tagRECT& rect) {
  return ExtentOf(rect.top, rect.bottom);
}

/// The rectangle with all four edges moved outwards.
inline tagRECT Enlarged(const tagRECT& rect, int margin) {
  return {ToDevice(std::int64_t{rect.left} - margin), ToDevice(std::int64_t{rect.top} - margin),
          ToDevice(std::int64_t{rect.right} + margin),
          ToDevice(std::int64_t{rect.bottom} + margin)};
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
