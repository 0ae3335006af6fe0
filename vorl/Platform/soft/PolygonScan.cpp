// Row by row from top to bottom:
// 1. edges that start in the row enter the list of active edges, those that have ended leave it;
// 2. the active edges are ordered by the column where they cross the row;
// 3. between two crossings the row is filled where the fill mode says that it is inside.

#include <vorl/Platform/soft/PolygonScan.h>

#include <vorl/Platform/soft/ExactMath.h>

#include <algorithm>
#include <cstddef>
#include <utility>

inline namespace vorl {
namespace vorl_detail {

namespace {

// An edge that is not horizontal, from its upper end on; the row of the lower end is not part of
// it.
struct Edge {
  std::int64_t firstRow;  // inside the bounds
  std::int64_t endRow;
  std::int64_t topColumn;
  int winding;  // 1 downwards, -1 upwards
  CeilingRamp offset;

  std::int64_t Column() const { return topColumn + offset.Value(); }
};

std::vector<Edge> VisibleEdges(std::span<const GridPoint> corners, const RECT& bounds) {
  std::vector<Edge> edges;
  edges.reserve(corners.size());
  for (std::size_t i = 0; i < corners.size(); ++i) {
    GridPoint upper = corners[i];
    GridPoint lower = corners[i + 1 < corners.size() ? i + 1 : 0];
    const int winding = upper.y < lower.y ? 1 : -1;
    if (winding < 0) {
      std::swap(upper, lower);
    }
    const auto firstRow = std::max<std::int64_t>(upper.y, bounds.top);
    const auto endRow = std::min<std::int64_t>(lower.y, bounds.bottom);
    if (firstRow < endRow) {
      edges.push_back({firstRow, endRow, upper.x, winding,
                       CeilingRamp(firstRow - upper.y, lower.x - upper.x, 0, lower.y - upper.y)});
    }
  }
  std::sort(edges.begin(), edges.end(),
            [](const Edge& a, const Edge& b) { return a.firstRow < b.firstRow; });
  return edges;
}

// Between edges that cross at the same column nothing is filled: their order does not matter.
void SortByColumn(std::vector<Edge>& active) {
  std::sort(active.begin(), active.end(),
            [](const Edge& a, const Edge& b) { return a.Column() < b.Column(); });
}

void FillRow(std::vector<Span>& spans, const std::vector<Edge>& active, std::int64_t row,
             int fillMode, const RECT& bounds) {
  int count = 0;
  int winding = 0;
  for (std::size_t i = 0; i + 1 < active.size(); ++i) {
    ++count;
    winding += active[i].winding;
    const bool isInside = fillMode == WINDING ? winding != 0 : count % 2 != 0;
    if (isInside) {
      AppendClipped(spans, row, active[i].Column(), active[i + 1].Column(), bounds);
    }
  }
}

}  // namespace

void AppendPolygon(std::vector<Span>& spans, std::span<const GridPoint> corners, int fillMode,
                   const RECT& bounds) {
  const std::vector<Edge> edges = VisibleEdges(corners, bounds);
  std::vector<Edge> active;
  std::size_t next = 0;
  std::int64_t row = 0;
  while (next < edges.size() || !active.empty()) {
    if (active.empty()) {
      row = edges[next].firstRow;
    }
    for (; next < edges.size() && edges[next].firstRow == row; ++next) {
      active.push_back(edges[next]);
    }
    SortByColumn(active);
    FillRow(spans, active, row, fillMode, bounds);
    ++row;
    std::erase_if(active, [row](const Edge& edge) { return edge.endRow <= row; });
    for (Edge& edge : active) {
      edge.offset.Next();
    }
  }
}

}  // namespace vorl_detail
}  // namespace vorl
