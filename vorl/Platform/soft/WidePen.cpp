// The outline is the union of a round dot at every point and, for every line, of the four-sided
// body between the dots of its ends. The shapes were measured on the system's device:
//
//      . # # .      A dot of width w is what a midpoint circle of diameter w - 1 encloses. For even
//      # # # #      widths its centre lies half a pixel above and to the left of the point.
//      # # # #
//      . # # .
//
// The body's sides run parallel to the line. Its width is split between the two sides in whole
// pixels, the odd one on the lower or the right side where the line runs along an axis.

#include <vorl/Platform/soft/WidePen.h>

#include <vorl/Platform/soft/ExactMath.h>
#include <vorl/Platform/soft/PolygonScan.h>

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdlib>

inline namespace vorl {
namespace vorl_detail {

namespace {

// The largest integer below sqrt(radius^2 - leg^2); `leg` is smaller than `radius`.
std::int64_t OtherLeg(std::int64_t radius, std::int64_t leg) {
  const auto square = static_cast<std::uint64_t>(radius * radius - leg * leg);
  return static_cast<std::int64_t>(SquareRootFloor(square - 1));
}

// The largest number not above `value` that is as odd or even as `like`.
std::int64_t SameParity(std::int64_t value, std::int64_t like) {
  return value - ((value - like) & 1);
}

// Half the width of a dot's row, in half pixels from the centre, as are `radius` and `row`, which
// are both odd or both even.
//
// A point (x, y) is inside when (a, b - 1), with a the smaller and b the larger coordinate, lies
// inside the circle: the midpoint circle takes the pixel whose inner midpoint the circle encloses.
std::int64_t DotExtent(std::int64_t radius, std::int64_t row) {
  if (radius == 1) {
    return 1;  // two by two pixels, which have no midpoint inside
  }
  if (row < radius) {
    const std::int64_t extent = SameParity(OtherLeg(radius, row) + 1, radius);
    if (extent >= row) {
      return extent;
    }
  }
  return SameParity(OtherLeg(radius, row - 1), radius);
}

void AppendDot(std::vector<Span>& spans, GridPoint centre, std::int64_t width, const RECT& bounds) {
  const std::int64_t radius = width - 1;
  const GridPoint corner{centre.x - width / 2, centre.y - width / 2};
  const std::int64_t top = std::max<std::int64_t>(corner.y, bounds.top);
  const std::int64_t bottom = std::min<std::int64_t>(corner.y + width, bounds.bottom);
  for (std::int64_t y = top; y < bottom; ++y) {
    const std::int64_t extent = DotExtent(radius, std::llabs(2 * (y - corner.y) - radius));
    AppendClipped(spans, y, corner.x + (radius - extent) / 2, corner.x + (radius + extent) / 2 + 1,
                  bounds);
  }
}

// The steps from a line's end to the two corners of its body beside it.
struct Sides {
  GridPoint right;  // or below, for a horizontal line
  GridPoint left;
};

Sides SidesOf(GridPoint delta, std::int64_t width) {
  const std::int64_t less = width / 2;
  const std::int64_t more = width - less;
  if (delta.x == 0) {
    return {{more, 0}, {-less, 0}};
  }
  if (delta.y == 0) {
    return {{0, more}, {0, -less}};
  }
  // The corners lie `across` columns and `along` rows from each other, always rounded up, to the
  // next whole number even from a whole number.
  const auto w = static_cast<std::uint64_t>(width);
  const auto dx = static_cast<std::uint64_t>(std::llabs(delta.x));
  const auto dy = static_cast<std::uint64_t>(std::llabs(delta.y));
  const std::int64_t across = ShareOfDiagonal(w, dy, dx) + 1;
  const std::int64_t along = ShareOfDiagonal(w, dx, dy) + 1;
  const bool isFalling = (delta.x > 0) == (delta.y > 0);
  const std::int64_t rightRow = isFalling ? -(along - along / 2) : along - along / 2;
  const std::int64_t leftRow = isFalling ? along / 2 : -(along / 2);
  return {{across - across / 2, rightRow}, {-(across / 2), leftRow}};
}

void AppendBody(std::vector<Span>& spans, GridPoint from, GridPoint to, std::int64_t width,
                const RECT& bounds) {
  const Sides sides = SidesOf({to.x - from.x, to.y - from.y}, width);
  const std::array<GridPoint, 4> corners{GridPoint{from.x + sides.right.x, from.y + sides.right.y},
                                         GridPoint{to.x + sides.right.x, to.y + sides.right.y},
                                         GridPoint{to.x + sides.left.x, to.y + sides.left.y},
                                         GridPoint{from.x + sides.left.x, from.y + sides.left.y}};
  AppendPolygon(spans, corners, ALTERNATE, bounds);
}

}  // namespace

std::vector<Span> WideOutline(std::span<const GridPoint> points, bool isClosed, std::int64_t width,
                              const RECT& bounds) {
  std::vector<Span> spans;
  const std::size_t lines = isClosed ? points.size() : points.size() - (points.empty() ? 0 : 1);
  for (const GridPoint& point : points) {
    AppendDot(spans, point, width, bounds);
  }
  for (std::size_t i = 0; i < lines; ++i) {
    const GridPoint& to = points[i + 1 < points.size() ? i + 1 : 0];
    if (points[i].x != to.x || points[i].y != to.y) {
      AppendBody(spans, points[i], to, width, bounds);
    }
  }
  Normalise(spans);
  return spans;
}

}  // namespace vorl_detail
}  // namespace vorl
