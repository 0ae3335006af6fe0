#include <vorl/Platform/soft/Spans.h>

#include <algorithm>
#include <cstddef>
#include <tuple>

inline namespace vorl {
namespace vorl_detail {

void AppendClipped(std::vector<Span>& spans, std::int64_t y, std::int64_t x0, std::int64_t x1,
                   const RECT& bounds) {
  x0 = std::max<std::int64_t>(x0, bounds.left);
  x1 = std::min<std::int64_t>(x1, bounds.right);
  if (x0 < x1 && y >= bounds.top && y < bounds.bottom) {
    spans.push_back({static_cast<std::int32_t>(y), static_cast<std::int32_t>(x0),
                     static_cast<std::int32_t>(x1)});
  }
}

void Normalise(std::vector<Span>& spans) {
  std::sort(spans.begin(), spans.end(),
            [](const Span& a, const Span& b) { return std::tie(a.y, a.x0) < std::tie(b.y, b.x0); });
  std::size_t count = 0;
  for (const Span& span : spans) {
    Span* last = count > 0 ? &spans[count - 1] : nullptr;
    if (last != nullptr && last->y == span.y && span.x0 <= last->x1) {
      last->x1 = std::max(last->x1, span.x1);
    } else {
      spans[count++] = span;
    }
  }
  spans.resize(count);
}

std::vector<Span> Difference(const std::vector<Span>& spans, const std::vector<Span>& holes) {
  std::vector<Span> result;
  auto firstHole = holes.begin();
  for (Span span : spans) {
    const auto isBefore = [&span](const Span& hole) {
      return hole.y < span.y || (hole.y == span.y && hole.x1 <= span.x0);
    };
    firstHole = std::find_if_not(firstHole, holes.end(), isBefore);
    for (auto hole = firstHole; hole != holes.end() && hole->y == span.y && hole->x0 < span.x1;
         ++hole) {
      if (span.x0 < hole->x0) {
        result.push_back({span.y, span.x0, hole->x0});
      }
      span.x0 = std::min(hole->x1, span.x1);
    }
    if (span.x0 < span.x1) {
      result.push_back(span);
    }
  }
  return result;
}

}  // namespace vorl_detail
}  // namespace vorl
