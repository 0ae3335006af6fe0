#ifndef VORL_GUI_DETAIL_SHAPEPEN_H
#define VORL_GUI_DETAIL_SHAPEPEN_H

/// @file
/// What the shapes draw with.

#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/VGObjectView.h>
#include <vorl/GUI/detail/DeviceRect.h>
#include <vorl/GUI/detail/Truncated.h>

#include <algorithm>
#include <cmath>

inline namespace vorl {
namespace vorl_detail {

/// The width of the pen that draws the handles of a line.
inline int HandleWidth(int thickness) {
  return ToDevice(std::int64_t{thickness} * 2 + 3);
}

/// Another point of the infinite line through a position, at least as far away as a screen is wide
/// and as the origin is: one close by would lose the direction when it is rounded to single
/// precision. A power of two keeps the ratio of the components exactly.
inline dVect2D FarPoint(const dVect2D& pos, const dVect2D& direction) {
  const double length = direction.Length();
  const double reach = std::max({2048.0, std::fabs(double{pos.x}), std::fabs(double{pos.y})});
  const bool isRegular = std::isnormal(length) && std::isfinite(reach);
  const int exponent = isRegular ? std::ilogb(reach) - std::ilogb(length) : 0;
  dVect2D point;
  point.Set(pos.x + std::ldexp(double{direction.x}, exponent),
            pos.y + std::ldexp(double{direction.y}, exponent));
  return point;
}

/// The raster operation of a device context while a shape is drawn.
class ShapeROP {
 public:
  ShapeROP(HDC dc, const VGObjectView& view) : m_dc(dc), m_old(SetROP2(dc, view.GetROPMode())) {}
  ShapeROP(const ShapeROP&) = delete;
  ShapeROP& operator=(const ShapeROP&) = delete;
  ~ShapeROP() {
    if (m_old != 0) {
      SetROP2(m_dc, m_old);
    }
  }

 private:
  HDC m_dc;
  int m_old;
};

/// Leaves the gaps of broken lines as they are, instead of filling them with the background colour
/// of the device context.
class TransparentGaps {
 public:
  explicit TransparentGaps(HDC dc) : m_dc(dc), m_old(SetBkMode(dc, TRANSPARENT)) {}
  TransparentGaps(const TransparentGaps&) = delete;
  TransparentGaps& operator=(const TransparentGaps&) = delete;
  ~TransparentGaps() {
    if (m_old != 0) {
      SetBkMode(m_dc, m_old);
    }
  }

 private:
  HDC m_dc;
  int m_old;
};

/// A pen of a shape's style in a device context, in the shape's colour where no other is given.
class ShapePen {
 public:
  ShapePen(HDC dc, const VGObjectView& view, int width)
      : ShapePen(dc, view, width, static_cast<COLORREF>(view.GetPenColor())) {}
  ShapePen(HDC dc, const VGObjectView& view, int width, COLORREF color)
      : m_dc(dc),
        m_pen(CreatePen(view.GetPenStyle(), width, color)),
        m_old(SelectObject(dc, m_pen)) {}
  ShapePen(const ShapePen&) = delete;
  ShapePen& operator=(const ShapePen&) = delete;
  ~ShapePen() {
    if (m_old != nullptr) {
      SelectObject(m_dc, m_old);
    }
    DeleteObject(m_pen);
  }

  void Line(int x1, int y1, int x2, int y2) const {
    MoveToEx(m_dc, x1, y1, nullptr);
    LineTo(m_dc, x2, y2);
  }
  /// Without decimals.
  void Line(const dVect2D& start, const dVect2D& end) const {
    Line(Truncated<int>(start.x), Truncated<int>(start.y), Truncated<int>(end.x),
         Truncated<int>(end.y));
  }
  /// The part of an infinite line that lies in a rectangle.
  void LineThrough(const dVect2D& pos, const dVect2D& direction, const tagRECT& clip) const {
    dVect2D start;
    dVect2D end;
    if (Geom2D::ClipLine(pos, FarPoint(pos, direction), clip, start, end)) {
      Line(start, end);
    }
  }
  /// A line without length, which the pen makes as large as it is wide.
  void Dot(int x, int y) const { Line(x, y, x, y); }
  void Dot(const dVect2D& pos) const { Line(pos, pos); }

 private:
  HDC m_dc;
  HPEN m_pen;
  HGDIOBJ m_old;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
