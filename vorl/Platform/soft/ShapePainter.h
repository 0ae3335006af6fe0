#ifndef VORL_PLATFORM_SOFT_SHAPEPAINTER_H
#define VORL_PLATFORM_SOFT_SHAPEPAINTER_H

#include <vorl/Platform/soft/DeviceContext.h>
#include <vorl/Platform/soft/Spans.h>

#include <cstdint>
#include <span>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Draws shapes with a context's pen and brush.
class ShapePainter {
 public:
  explicit ShapePainter(const DeviceContext& dc);

  /// A line with the pen, without its last point.
  void Line(GridPoint from, GridPoint to) const;
  /// A closed polygon: the inside with the brush, then the outline with the pen on top.
  void Polygon(std::span<const GridPoint> corners) const;
  /// A rectangle between two corners, in any order; the larger ones are excluded.
  void Rectangle(GridPoint corner, GridPoint opposite) const;

 private:
  bool HasPen() const;
  bool IsWide() const;
  // The fill leaves out what a wide pen covers: combined twice, it would come out wrong.
  void FillAndStroke(std::vector<Span> inside, std::span<const GridPoint> corners) const;
  // Lines of one pixel's width; the last point of each is left out.
  void ThinOutline(std::span<const GridPoint> points, bool isClosed) const;
  void PaintSpans(const std::vector<Span>& spans, COLORREF colour) const;

  const DeviceContext& m_dc;
  const RECT m_bounds;
  const std::int64_t m_penWidth;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
