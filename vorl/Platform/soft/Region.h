#ifndef VORL_PLATFORM_SOFT_REGION_H
#define VORL_PLATFORM_SOFT_REGION_H

#include <vorl/Platform/GdiTypes.h>

#include <pixman.h>

#include <span>

inline namespace vorl {
namespace vorl_detail {

/// A rectangle with its corners in order: left <= right, top <= bottom, at any coordinates.
RECT Ordered(std::int64_t left, std::int64_t top, std::int64_t right, std::int64_t bottom);

/// The part that two rectangles share; an empty rectangle when they share none.
RECT Intersection(const RECT& a, const RECT& b);

inline bool IsEmpty(const RECT& r) {
  return r.left >= r.right || r.top >= r.bottom;
}

/// A set of pixels, held as rectangles in bands from top to bottom and from left to right.
/// Exhausted memory throws `std::bad_alloc`.
class Region {
 public:
  Region();
  explicit Region(const RECT& rect);
  Region(const Region& other);
  Region(Region&& other) noexcept;
  ~Region();
  Region& operator=(const Region& other);
  Region& operator=(Region&& other) noexcept;

  void Intersect(const Region& other);
  void Intersect(const RECT& rect);
  void Subtract(const RECT& rect);
  void Unite(const Region& other);
  void Unite(const RECT& rect);

  bool Contains(int x, int y) const;
  RECT Extents() const;
  /// Disjoint rectangles, ordered by top, then by left; those of a band share top and bottom.
  std::span<const pixman_box32_t> Boxes() const;
  /// NULLREGION, SIMPLEREGION or COMPLEXREGION.
  int Complexity() const;

 private:
  // pixman takes its regions by non-const pointer even where it only reads.
  mutable pixman_region32_t m_region;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
