#include <vorl/GUI/detail/RectHandles.h>

#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/detail/DeviceRect.h>
#include <vorl/GUI/detail/ShapePen.h>
#include <vorl/GUI/detail/Truncated.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

// The handles are as large on a thick outline as on a thin one.
constexpr int kHandleWidth = 5;

}  // namespace

std::uint8_t EdgesAt(const dVect2D& point, const dVect2D& topLeft, const dVect2D& bottomRight,
                     int distance) {
  const double left = topLeft.x;
  const double top = topLeft.y;
  const double right = bottomRight.x;
  const double bottom = bottomRight.y;
  const double width = right - left;
  const double height = bottom - top;
  const struct {
    double x;
    double y;
    int edges;
  } handles[] = {{left, top, RectEdge_Left | RectEdge_Top},
                 {left + width * 0.5, top, RectEdge_Top},
                 {left + width, top, RectEdge_Right | RectEdge_Top},
                 {right, top + height * 0.5, RectEdge_Right},
                 {right, top + height, RectEdge_Right | RectEdge_Bottom},
                 {right - width * 0.5, bottom, RectEdge_Bottom},
                 {left, bottom, RectEdge_Left | RectEdge_Bottom},
                 {left, bottom - height * 0.5, RectEdge_Left}};
  for (const auto& handle : handles) {
    dVect2D pos;
    pos.Set(handle.x, handle.y);
    if (Geom2D::IsPointOnPoint(point, pos, distance)) {
      return static_cast<std::uint8_t>(handle.edges);
    }
  }
  return RectEdge_None;
}

void PullEdges(std::uint8_t edges, const dVect2D& point, dVect2D& topLeft, dVect2D& bottomRight) {
  if ((edges & (RectEdge_Left | RectEdge_Right)) != 0) {
    ((edges & RectEdge_Left) != 0 ? topLeft : bottomRight).x = point.x;
  }
  if ((edges & (RectEdge_Top | RectEdge_Bottom)) != 0) {
    ((edges & RectEdge_Top) != 0 ? topLeft : bottomRight).y = point.y;
  }
}

void DrawRectHandles(HDC dc, const VGObjectView& view, const tagRECT& rect) {
  const int halfWidth = WidthOf(rect) / 2;
  const int halfHeight = HeightOf(rect) / 2;
  const ShapePen pen(dc, view, kHandleWidth);
  const ShapeROP rop(dc, view);
  pen.Dot(rect.left, rect.top);
  pen.Dot(rect.left + halfWidth, rect.top);
  pen.Dot(rect.right, rect.top);
  pen.Dot(rect.right, rect.top + halfHeight);
  pen.Dot(rect.right, rect.bottom);
  // The middles of these two edges count from the far corner.
  pen.Dot(rect.right - halfWidth, rect.bottom);
  pen.Dot(rect.left, rect.bottom);
  pen.Dot(rect.left, rect.bottom - halfHeight);
}

tagRECT TruncatedRect(const dVect2D& topLeft, const dVect2D& bottomRight) {
  return {Truncated<int>(topLeft.x), Truncated<int>(topLeft.y), Truncated<int>(bottomRight.x),
          Truncated<int>(bottomRight.y)};
}

}  // namespace vorl_detail
}  // namespace vorl
