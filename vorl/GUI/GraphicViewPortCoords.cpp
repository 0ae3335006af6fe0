// Between the coordinates of the device, of the graphics and of scroll bars.

#include <vorl/GUI/GraphicViewPort.h>

#include <algorithm>

#include <vorl/Data/detail/Single.h>

inline namespace vorl {

using vorl_detail::Single;

namespace {

/// One direction of scrolling: where the window and its range begin, and what of the range the
/// window leaves out.
struct Scroll {
  double windowStart;
  double rangeStart;
  double rest;

  float Position() const { return rest == 0.0 ? 0.0F : Single((windowStart - rangeStart) / rest); }
  /// How far the window has to move.
  float WayTo(float position) const {
    if (!(rest > 0.0)) {
      return 0.0F;
    }
    const double fraction = position > 0.0F ? std::min(position, 1.0F) : 0.0F;
    return Single(rest * fraction + rangeStart - windowStart);
  }
};

Scroll ScrollX(const Rect2D& window, const Rect2D& range) {
  return {window.GetTL().x, range.GetTL().x, range.Width() - window.Width()};
}

Scroll ScrollY(const Rect2D& window, const Rect2D& range) {
  return {window.GetTL().y, range.GetTL().y, range.Height() - window.Height()};
}

}  // namespace

// The mappings of a map are open to classes that count or remember; a copy keeps these const.

void GraphicViewPort::ViewToGraphic(tagPOINT& point) const {
  TrafoST2D(m_trafo).pB2A(point);
}

void GraphicViewPort::ViewToGraphic(dVect2D& point) const {
  TrafoST2D(m_trafo).pB2A(point);
}

void GraphicViewPort::ViewToGraphic(tagRECT& rect) const {
  TrafoST2D(m_trafo).rB2A(rect);
}

void GraphicViewPort::ViewToGraphic(Rect2D& rect) const {
  TrafoST2D(m_trafo).rB2A(rect);
}

void GraphicViewPort::ViewToGraphic(const tagPOINT& source, tagPOINT& target) const {
  TrafoST2D(m_trafo).pB2A(source, target);
}

void GraphicViewPort::ViewToGraphic(const dVect2D& source, dVect2D& target) const {
  TrafoST2D(m_trafo).pB2A(source, target);
}

void GraphicViewPort::ViewToGraphic(const tagRECT& source, tagRECT& target) const {
  TrafoST2D(m_trafo).rB2A(source, target);
}

void GraphicViewPort::ViewToGraphic(const Rect2D& source, Rect2D& target) const {
  TrafoST2D(m_trafo).rB2A(source, target);
}

void GraphicViewPort::GraphicToView(tagPOINT& point) const {
  TrafoST2D(m_trafo).pA2B(point);
}

void GraphicViewPort::GraphicToView(dVect2D& point) const {
  TrafoST2D(m_trafo).pA2B(point);
}

void GraphicViewPort::GraphicToView(tagRECT& rect) const {
  TrafoST2D(m_trafo).rA2B(rect);
}

void GraphicViewPort::GraphicToView(Rect2D& rect) const {
  TrafoST2D(m_trafo).rA2B(rect);
}

void GraphicViewPort::GraphicToView(const tagPOINT& source, tagPOINT& target) const {
  TrafoST2D(m_trafo).pA2B(source, target);
}

void GraphicViewPort::GraphicToView(const dVect2D& source, dVect2D& target) const {
  TrafoST2D(m_trafo).pA2B(source, target);
}

void GraphicViewPort::GraphicToView(const tagRECT& source, tagRECT& target) const {
  TrafoST2D(m_trafo).rA2B(source, target);
}

void GraphicViewPort::GraphicToView(const Rect2D& source, Rect2D& target) const {
  TrafoST2D(m_trafo).rA2B(source, target);
}

float GraphicViewPort::GetScrollPosX() const {
  return ScrollX(m_graphicWin, ScrollRange()).Position();
}

float GraphicViewPort::GetScrollPosY() const {
  return ScrollY(m_graphicWin, ScrollRange()).Position();
}

void GraphicViewPort::SetScrollPos(float x, float y) {
  const Rect2D range = ScrollRange();
  m_graphicWin.Move(ScrollX(m_graphicWin, range).WayTo(x), ScrollY(m_graphicWin, range).WayTo(y));
}

void GraphicViewPort::SetScrollPosX(float x) {
  m_graphicWin.Move(ScrollX(m_graphicWin, ScrollRange()).WayTo(x), 0.0F);
}

void GraphicViewPort::SetScrollPosY(float y) {
  m_graphicWin.Move(0.0F, ScrollY(m_graphicWin, ScrollRange()).WayTo(y));
}

float GraphicViewPort::GetScrollFactorX() const {
  return Single(ScrollRange().Width() / m_graphicWin.Width());
}

float GraphicViewPort::GetScrollFactorY() const {
  return Single(ScrollRange().Height() / m_graphicWin.Height());
}

void GraphicViewPort::SetViewRefPos(float x, float y) {
  m_viewRefPos.Set(x, y);
  m_trafo.pB2A(m_viewRefPos, m_graphicRefPos);
}

void GraphicViewPort::SetGraphicRefPos(float x, float y) {
  m_graphicRefPos.Set(x, y);
  GraphicToView(m_graphicRefPos, m_viewRefPos);
}

const dVect2D& GraphicViewPort::GetViewRefPos() const {
  return m_viewRefPos;
}

const dVect2D& GraphicViewPort::GetGraphicRefPos() const {
  return m_graphicRefPos;
}

TrafoST2D& GraphicViewPort::GetTrafo() {
  return m_trafo;
}

const TrafoST2D& GraphicViewPort::GetTrafo() const {
  return m_trafo;
}

}  // namespace vorl
