#ifndef VORL_PLATFORM_SOFT_POLYGONSCAN_H
#define VORL_PLATFORM_SOFT_POLYGONSCAN_H

#include <vorl/Platform/soft/Spans.h>

#include <span>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Appends the pixels inside a polygon, closed from its last corner to its first, as far as they
/// lie inside `bounds`. `fillMode` is ALTERNATE (inside where an odd number of edges lies to the
/// left) or WINDING (inside where the edges to the left do not cancel out).
///
/// A pixel counts as its grid point. Points on a left or upper edge are inside, those on a right or
/// lower edge are not, so that polygons that share an edge neither overlap nor leave a gap.
void AppendPolygon(std::vector<Span>& spans, std::span<const GridPoint> corners, int fillMode,
                   const RECT& bounds);

}  // namespace vorl_detail
}  // namespace vorl

#endif
