#include <vorl/Data/dRect.h>

#include <algorithm>
#include <limits>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Platform/Gdi.h>

inline namespace vorl {

namespace {

constexpr std::int64_t kSmallestPosition = std::numeric_limits<std::int32_t>::min();
constexpr std::int64_t kLargestPosition = std::numeric_limits<std::int32_t>::max();
constexpr std::int64_t kLargestSize = std::numeric_limits<std::uint32_t>::max();

/// A rectangle by its edges, wide enough for every sum of a position and a size.
struct Edges {
  std::int64_t left;
  std::int64_t top;
  std::int64_t right;
  std::int64_t bottom;
};

Edges EdgesOf(const dRect& rect) {
  return {rect.x, rect.y, std::int64_t{rect.x} + rect.width, std::int64_t{rect.y} + rect.height};
}

/// The rectangle with these edges; empty where no rectangle can begin.
dRect RectOf(const Edges& edges) {
  dRect rect;
  if (edges.left <= kLargestPosition && edges.top <= kLargestPosition) {
    rect.Set(static_cast<std::int32_t>(edges.left), static_cast<std::int32_t>(edges.top),
             static_cast<std::uint32_t>(std::min(edges.right - edges.left, kLargestSize)),
             static_cast<std::uint32_t>(std::min(edges.bottom - edges.top, kLargestSize)));
  }
  return rect;
}

std::int32_t Moved(std::int32_t position, int distance) {
  return static_cast<std::int32_t>(
      std::clamp(std::int64_t{position} + distance, kSmallestPosition, kLargestPosition));
}

}  // namespace

VORL_REGISTER_CLASS(dRect, DataBase);

dRect::dRect() = default;

dRect::dRect(int newX, int newY, unsigned int newWidth, unsigned int newHeight)
    : x(newX), y(newY), width(newWidth), height(newHeight) {}

dRect::dRect(const dRect& source) = default;

dRect& dRect::operator=(const dRect& source) = default;

dRect& dRect::operator=(const tagRECT& rect) {
  *this = RectOf({std::min(rect.left, rect.right), std::min(rect.top, rect.bottom),
                  std::max(rect.left, rect.right), std::max(rect.top, rect.bottom)});
  return *this;
}

dRect::~dRect() = default;

void dRect::Reset() {
  Set(0, 0, 0, 0);
}

void dRect::Write(BinaryDataOut& out) {
  out.WriteS32(x);
  out.WriteS32(y);
  out.WriteU32(width);
  out.WriteU32(height);
}

void dRect::Read(BinaryDataIn& in) {
  dRect read;  // each reader may throw, and half a rectangle is none
  in.ReadS32(read.x);
  in.ReadS32(read.y);
  in.ReadU32(read.width);
  in.ReadU32(read.height);
  *this = read;
}

void dRect::Set(int newX, int newY, unsigned int newWidth, unsigned int newHeight) {
  x = newX;
  y = newY;
  width = newWidth;
  height = newHeight;
}

void dRect::SetPos(int newX, int newY) {
  x = newX;
  y = newY;
}

void dRect::Move(int dx, int dy) {
  x = Moved(x, dx);
  y = Moved(y, dy);
}

bool dRect::operator==(const dRect& other) const {
  return x == other.x && y == other.y && width == other.width && height == other.height;
}

bool dRect::operator!=(const dRect& other) const {
  return !(*this == other);
}

bool dRect::IsEmpty() const {
  return width == 0 || height == 0;
}

bool dRect::IsInside(int px, int py) const {
  const Edges edges = EdgesOf(*this);
  return edges.left <= px && px < edges.right && edges.top <= py && py < edges.bottom;
}

dRect& dRect::operator&=(const dRect& other) {
  const Edges a = EdgesOf(*this);
  const Edges b = EdgesOf(other);
  const Edges overlap = {std::max(a.left, b.left), std::max(a.top, b.top),
                         std::min(a.right, b.right), std::min(a.bottom, b.bottom)};
  if (IsEmpty() || other.IsEmpty() || overlap.left >= overlap.right ||
      overlap.top >= overlap.bottom) {
    Reset();
  } else {
    *this = RectOf(overlap);
  }
  return *this;
}

dRect& dRect::operator|=(const dRect& other) {
  if (other.IsEmpty()) {
    return *this;
  }
  if (IsEmpty()) {
    *this = other;
    return *this;
  }
  const Edges a = EdgesOf(*this);
  const Edges b = EdgesOf(other);
  *this = RectOf({std::min(a.left, b.left), std::min(a.top, b.top), std::max(a.right, b.right),
                  std::max(a.bottom, b.bottom)});
  return *this;
}

bool dRect::SubRect(const dRect& other, dRect& r1, dRect& r2, dRect& r3, dRect& r4) const {
  const dRect whole(*this);  // the parts may be these rectangles
  const dRect overlap = whole & other;
  for (dRect* part : {&r1, &r2, &r3, &r4}) {
    part->Reset();
  }
  if (overlap == whole) {
    return false;
  }
  if (overlap.IsEmpty()) {
    r1 = whole;
    return true;
  }
  const Edges outer = EdgesOf(whole);
  const Edges inner = EdgesOf(overlap);
  if (inner.top > outer.top) {
    r1 = RectOf({outer.left, outer.top, outer.right, inner.top});
  }
  if (inner.bottom < outer.bottom) {
    r2 = RectOf({outer.left, inner.bottom, outer.right, outer.bottom});
  }
  if (inner.left > outer.left) {
    r3 = RectOf({outer.left, inner.top, inner.left, inner.bottom});
  }
  if (inner.right < outer.right) {
    r4 = RectOf({inner.right, inner.top, outer.right, inner.bottom});
  }
  return true;
}

dRect operator&(const dRect& a, const dRect& b) {
  dRect overlap(a);
  overlap &= b;
  return overlap;
}

dRect operator|(const dRect& a, const dRect& b) {
  dRect bounds(a);
  bounds |= b;
  return bounds;
}

}  // namespace vorl
