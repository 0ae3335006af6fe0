#ifndef VORL_PLATFORM_SOFT_WIDEPEN_H
#define VORL_PLATFORM_SOFT_WIDEPEN_H

#include <vorl/Platform/soft/Spans.h>

#include <cstdint>
#include <span>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// The pixels inside `bounds` that a pen of two or more pixels' width covers on its way along
/// `points`, back to the first one when the way is closed. The spans are normalised: where parts of
/// the way overlap, a pixel is still listed once.
///
/// The ends and corners are round. A way without length is one round dot.
std::vector<Span> WideOutline(std::span<const GridPoint> points, bool isClosed, std::int64_t width,
                              const RECT& bounds);

}  // namespace vorl_detail
}  // namespace vorl

#endif
