#include <vorl/Platform/soft/ShapePainter.h>

#include <vorl/Platform/soft/DashPattern.h>
#include <vorl/Platform/soft/LineSteps.h>
#include <vorl/Platform/soft/Painter.h>
#include <vorl/Platform/soft/PolygonScan.h>
#include <vorl/Platform/soft/WidePen.h>

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdlib>
#include <utility>

inline namespace vorl {
namespace vorl_detail {

namespace {

// Joins the points of a line that lie side by side in a row, so that they are painted at once.
class RunPainter {
 public:
  explicit RunPainter(const Painter& painter) : m_painter(painter) {}
  ~RunPainter() { Flush(); }
  RunPainter(const RunPainter&) = delete;
  RunPainter& operator=(const RunPainter&) = delete;

  void Point(std::int32_t x, std::int32_t y) {
    if (y == m_run.y && x == m_run.x1) {
      ++m_run.x1;
    } else if (y == m_run.y && x == m_run.x0 - 1) {
      --m_run.x0;
    } else {
      Flush();
      m_run = {y, x, x + 1};
    }
  }

 private:
  void Flush() {
    if (m_run.x0 < m_run.x1) {
      m_painter.Span(m_run.y, m_run.x0, m_run.x1);
    }
  }

  const Painter& m_painter;
  Span m_run{0, 0, 0};
};

}  // namespace

ShapePainter::ShapePainter(const DeviceContext& dc)
    : m_dc(dc), m_bounds(dc.Visible().Extents()), m_penWidth(dc.state.pen->width) {}

bool ShapePainter::HasPen() const {
  return m_dc.state.pen->style != PS_NULL;
}

bool ShapePainter::IsWide() const {
  return HasPen() && m_penWidth > 1;
}

void ShapePainter::Line(GridPoint from, GridPoint to) const {
  const std::array<GridPoint, 2> points{from, to};
  if (IsWide()) {
    PaintSpans(WideOutline(points, false, m_penWidth, m_bounds), m_dc.state.pen->colour);
  } else {
    ThinOutline(points, false);
  }
}

void ShapePainter::Polygon(std::span<const GridPoint> corners) const {
  std::vector<Span> inside;
  if (m_dc.state.brush->style != BS_NULL) {
    AppendPolygon(inside, corners, m_dc.state.polyFillMode, m_bounds);
  }
  FillAndStroke(std::move(inside), corners);
}

void ShapePainter::Rectangle(GridPoint corner, GridPoint opposite) const {
  auto [left, right] = std::minmax({corner.x, opposite.x});
  auto [top, bottom] = std::minmax({corner.y, opposite.y});
  if (left == right || top == bottom) {
    return;
  }
  if (IsWide() && m_dc.state.pen->style == PS_INSIDEFRAME) {
    // The whole outline stays inside; in a rectangle that is too small for it the sides cross over.
    left += m_penWidth / 2;
    top += m_penWidth / 2;
    right -= (m_penWidth - 1) / 2;
    bottom -= (m_penWidth - 1) / 2;
  }
  std::vector<Span> inside;
  if (m_dc.state.brush->style != BS_NULL) {
    const int edge = HasPen() ? 1 : 0;  // without a pen the inside takes the upper left edges too
    const auto firstRow = std::max<std::int64_t>(top + edge, m_bounds.top);
    const auto endRow = std::min<std::int64_t>(bottom - 1, m_bounds.bottom);
    for (std::int64_t y = firstRow; y < endRow; ++y) {
      AppendClipped(inside, y, left + edge, right - 1, m_bounds);
    }
  }
  // The order of the corners is where a dashed outline starts, and which way round it runs.
  const std::array<GridPoint, 4> corners{GridPoint{right - 1, top}, GridPoint{left, top},
                                         GridPoint{left, bottom - 1},
                                         GridPoint{right - 1, bottom - 1}};
  FillAndStroke(std::move(inside), corners);
}

void ShapePainter::FillAndStroke(std::vector<Span> inside,
                                 std::span<const GridPoint> corners) const {
  std::vector<Span> outline;
  if (IsWide()) {
    outline = WideOutline(corners, true, m_penWidth, m_bounds);
    Normalise(inside);
    inside = Difference(inside, outline);
  }
  PaintSpans(inside, m_dc.state.brush->colour);
  PaintSpans(outline, m_dc.state.pen->colour);
  if (!IsWide()) {
    ThinOutline(corners, true);
  }
}

void ShapePainter::ThinOutline(std::span<const GridPoint> points, bool isClosed) const {
  if (!HasPen()) {
    return;
  }
  const Painter ink(m_dc, m_dc.state.pen->colour);
  const Painter gap(m_dc, m_dc.state.backgroundColour);
  const DashPattern pattern(m_dc.state.pen->style);
  const bool fillsGaps = m_dc.state.backgroundMode == OPAQUE;
  const std::size_t lines = isClosed ? points.size() : points.size() - 1;
  std::int64_t length = 0;
  for (std::size_t i = 0; i < lines; ++i) {
    const GridPoint from = points[i];
    const GridPoint to = points[i + 1 < points.size() ? i + 1 : 0];
    RunPainter inkRuns(ink);
    RunPainter gapRuns(gap);
    for (LineSteps steps(from, to, m_bounds); steps.IsValid(); steps.Next()) {
      if (pattern.IsInk(length + steps.Step())) {
        inkRuns.Point(steps.X(), steps.Y());
      } else if (fillsGaps) {
        gapRuns.Point(steps.X(), steps.Y());
      }
    }
    length += LineSteps::Length(from, to);
  }
}

void ShapePainter::PaintSpans(const std::vector<Span>& spans, COLORREF colour) const {
  const Painter painter(m_dc, colour);
  for (const Span& span : spans) {
    painter.Span(span.y, span.x0, span.x1);
  }
}

}  // namespace vorl_detail
}  // namespace vorl
