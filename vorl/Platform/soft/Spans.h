#ifndef VORL_PLATFORM_SOFT_SPANS_H
#define VORL_PLATFORM_SOFT_SPANS_H

#include <vorl/Platform/Gdi.h>

#include <cstdint>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// A corner of a shape. Corners of wide lines lie outside the 32-bit plane at times.
struct GridPoint {
  std::int64_t x;
  std::int64_t y;
};

/// The pixels of row y from column x0 up to, but without, column x1.
struct Span {
  std::int32_t y;
  std::int32_t x0;
  std::int32_t x1;
  friend bool operator==(const Span&, const Span&) = default;
};

/// Appends what `bounds` leaves of a row's columns.
void AppendClipped(std::vector<Span>& spans, std::int64_t y, std::int64_t x0, std::int64_t x1,
                   const RECT& bounds);

/// Orders spans by row, then by column, and joins those that overlap or touch: each pixel is then
/// in one span only.
void Normalise(std::vector<Span>& spans);

/// The pixels of `spans` that are not in `holes`; both have to be normalised, and so is the result.
std::vector<Span> Difference(const std::vector<Span>& spans, const std::vector<Span>& holes);

}  // namespace vorl_detail
}  // namespace vorl

#endif
