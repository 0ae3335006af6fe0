#include <vorl/Platform/Gdi.h>
#include <vorl/Platform/soft/Region.h>

#include <algorithm>
#include <cstdint>
#include <limits>
#include <new>
#include <utility>

inline namespace vorl {
namespace vorl_detail {
namespace {

LONG Clamped(std::int64_t value) {
  using Limits = std::numeric_limits<LONG>;
  return static_cast<LONG>(std::clamp<std::int64_t>(value, Limits::min(), Limits::max()));
}

void Check(pixman_bool_t done) {
  if (done == 0) {
    throw std::bad_alloc();
  }
}

void InitRect(pixman_region32_t* region, const RECT& rect) {
  if (IsEmpty(rect)) {
    pixman_region32_init(region);  // pixman reports empty extents on the standard error stream
    return;
  }
  pixman_box32_t box{rect.left, rect.top, rect.right, rect.bottom};
  pixman_region32_init_with_extents(region, &box);
}

}  // namespace

RECT Ordered(std::int64_t left, std::int64_t top, std::int64_t right, std::int64_t bottom) {
  return RECT{Clamped(std::min(left, right)), Clamped(std::min(top, bottom)),
              Clamped(std::max(left, right)), Clamped(std::max(top, bottom))};
}

RECT Intersection(const RECT& a, const RECT& b) {
  const RECT shared{std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
                    std::min(a.bottom, b.bottom)};
  return IsEmpty(shared) ? RECT{0, 0, 0, 0} : shared;
}

Region::Region() {
  pixman_region32_init(&m_region);
}

Region::Region(const RECT& rect) {
  InitRect(&m_region, rect);
}

Region::Region(const Region& other) : Region() {
  Check(pixman_region32_copy(&m_region, &other.m_region));
}

Region::Region(Region&& other) noexcept : Region() {
  std::swap(m_region, other.m_region);
}

Region::~Region() {
  pixman_region32_fini(&m_region);
}

Region& Region::operator=(const Region& other) {
  Check(pixman_region32_copy(&m_region, &other.m_region));
  return *this;
}

Region& Region::operator=(Region&& other) noexcept {
  std::swap(m_region, other.m_region);
  return *this;
}

void Region::Intersect(const Region& other) {
  Check(pixman_region32_intersect(&m_region, &m_region, &other.m_region));
}

void Region::Intersect(const RECT& rect) {
  Intersect(Region(rect));
}

void Region::Subtract(const RECT& rect) {
  const Region other(rect);
  Check(pixman_region32_subtract(&m_region, &m_region, &other.m_region));
}

void Region::Unite(const Region& other) {
  Check(pixman_region32_union(&m_region, &m_region, &other.m_region));
}

void Region::Unite(const RECT& rect) {
  Unite(Region(rect));
}

bool Region::Contains(int x, int y) const {
  return pixman_region32_contains_point(&m_region, x, y, nullptr) != 0;
}

RECT Region::Extents() const {
  const pixman_box32_t* box = pixman_region32_extents(&m_region);
  return RECT{box->x1, box->y1, box->x2, box->y2};
}

std::span<const pixman_box32_t> Region::Boxes() const {
  int count = 0;
  const pixman_box32_t* boxes = pixman_region32_rectangles(&m_region, &count);
  return {boxes, static_cast<std::size_t>(count)};
}

int Region::Complexity() const {
  const std::size_t count = Boxes().size();
  return count == 0 ? NULLREGION : count == 1 ? SIMPLEREGION : COMPLEXREGION;
}

}  // namespace vorl_detail
}  // namespace vorl
