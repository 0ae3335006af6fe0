#include <vorl/GUI/GraphicViewPort.h>

#include <algorithm>
#include <limits>

#include <vorl/Data/detail/Single.h>
#include <vorl/GUI/detail/Truncated.h>

inline namespace vorl {

using vorl_detail::Single;
using vorl_detail::Truncated;

namespace {

/// A border holds 16 bits.
std::uint16_t ToBorder(int pixels) {
  return static_cast<std::uint16_t>(
      std::clamp<int>(pixels, 0, std::numeric_limits<std::uint16_t>::max()));
}

/// An edge in whole pixels, `inset` behind where it stands.
LONG WholePixel(double edge, double inset) {
  return Truncated<LONG>(edge + 0.5 + inset);
}

void MoveToCentreOf(Rect2D& rect, const Rect2D& other, bool horizontally, bool vertically) {
  const dVect2D from = rect.GetCenter();
  const dVect2D to = other.GetCenter();
  rect.Move(horizontally ? Single(static_cast<double>(to.x) - from.x) : 0.0F,
            vertically ? Single(static_cast<double>(to.y) - from.y) : 0.0F);
}

}  // namespace

IGraphicViewPort::IGraphicViewPort() = default;

IGraphicViewPort::IGraphicViewPort(const IGraphicViewPort& source) = default;

IGraphicViewPort& IGraphicViewPort::operator=(const IGraphicViewPort& source) = default;

IGraphicViewPort::~IGraphicViewPort() = default;

void IGraphicViewPort::OnTrafoChanged(GraphicViewPort*) {}

GraphicViewPort::GraphicViewPort() {
  GraphicViewPort::Reset();
}

GraphicViewPort::GraphicViewPort(const Rect2D& areaAndWindow) : GraphicViewPort() {
  Init(areaAndWindow);
}

GraphicViewPort::GraphicViewPort(const Rect2D& area, const Rect2D& window) : GraphicViewPort() {
  Init(area, window);
}

GraphicViewPort::GraphicViewPort(const Rect2D& area, const Rect2D& window, const Rect2D& view)
    : GraphicViewPort() {
  Init(area, window, view);
}

GraphicViewPort::GraphicViewPort(const GraphicViewPort& source) = default;

GraphicViewPort& GraphicViewPort::operator=(const GraphicViewPort& source) = default;

GraphicViewPort::~GraphicViewPort() {
  RemoveGraphic(nullptr);
  GraphicViewPort::Reset();
}

void GraphicViewPort::Reset() {
  m_captured = HandlerRef();
  m_viewWin.Set(0.0F, 0.0F, 100.0F, 100.0F);
  m_graphicWin = m_viewWin;
  m_graphicArea = m_viewWin;
  SetBorder(0);
  m_bgColor = 0;
  m_borderColor = 0;
  SetScaleFactors(1.0F, 1.0F, 0.1F, 10.0F, 0.1F, 10.0F);
  m_startPoint = {};
  m_moveOffset = {};
  m_viewRefPos.Reset();
  m_graphicRefPos.Reset();
  SetViewMode(ViewMode_Free, ViewMode_Free);
  m_mode = 0x0F0F;
  m_operation = 0;
  m_alignment = ViewAlignment_None;
  UpdateTransformation();
}

void GraphicViewPort::Init(Rect2D& area, Rect2D& window, Rect2D& view) {
  // Copied first: the arguments may be this viewport's own rectangles.
  const Rect2D newArea(area);
  const Rect2D newWindow(window);
  m_viewWin = view;
  m_graphicWin = newWindow;
  m_graphicArea = newArea;
}

void GraphicViewPort::Init(const Rect2D& areaAndWindow) {
  Init(areaAndWindow, areaAndWindow, m_viewWin);
}

void GraphicViewPort::Init(const Rect2D& area, const Rect2D& window) {
  Init(area, window, m_viewWin);
}

void GraphicViewPort::Init(const Rect2D& area, const Rect2D& window, const Rect2D& view) {
  Rect2D areaCopy(area);
  Rect2D windowCopy(window);
  Rect2D viewCopy(view);
  Init(areaCopy, windowCopy, viewCopy);
}

void GraphicViewPort::SetInterface(IGraphicViewPort* viewPortInterface) {
  m_interface = viewPortInterface;
}

const Rect2D& GraphicViewPort::GetGraphicArea() const {
  return m_graphicArea;
}

void GraphicViewPort::GetGraphicArea(Rect2D& area) const {
  area = m_graphicArea;
}

void GraphicViewPort::SetGraphicArea(const Rect2D& area) {
  m_graphicArea = area;
  SetViewMode(ViewMode_Free, ViewMode_Free);
}

void GraphicViewPort::SetGraphicArea(const tagRECT& area) {
  SetGraphicArea(Rect2D(area));
}

void GraphicViewPort::SetGraphicArea(float left, float top, float right, float bottom) {
  SetGraphicArea(Rect2D(left, top, right, bottom));
}

const Rect2D& GraphicViewPort::GetGraphicWin() const {
  return m_graphicWin;
}

void GraphicViewPort::GetGraphicWin(Rect2D& window) const {
  window = m_graphicWin;
}

void GraphicViewPort::SetGraphicWin(const Rect2D& window) {
  m_graphicWin = window;
  SetViewMode(ViewMode_Free, ViewMode_Free);
}

void GraphicViewPort::SetGraphicWin(const tagRECT& window) {
  SetGraphicWin(Rect2D(window));
}

void GraphicViewPort::SetGraphicWin(float left, float top, float right, float bottom) {
  SetGraphicWin(Rect2D(left, top, right, bottom));
}

void GraphicViewPort::MoveGraphicWin(float dx, float dy) {
  m_graphicWin.Move(dx, dy);
}

void GraphicViewPort::MoveGraphicWin(const dVect2D& way) {
  m_graphicWin.Move(way);
}

void GraphicViewPort::SetGraphicPos(const dVect2D& topLeft) {
  m_graphicWin.SetPos(topLeft);
}

void GraphicViewPort::SetGraphicPos(const tagPOINT& topLeft) {
  SetGraphicPos(dVect2D(topLeft));
}

void GraphicViewPort::SetGraphicPos(float x, float y) {
  SetGraphicPos(dVect2D(x, y));
}

void GraphicViewPort::CenterWin(bool horizontally, bool vertically) {
  MoveToCentreOf(m_graphicWin, m_graphicArea, horizontally, vertically);
}

const Rect2D& GraphicViewPort::GetViewWin() const {
  return m_viewWin;
}

void GraphicViewPort::GetViewWin(Rect2D& view) const {
  view = m_viewWin;
}

void GraphicViewPort::GetViewWin(tagRECT& view) const {
  const dVect2D topLeft = m_viewWin.GetTL();
  const dVect2D bottomRight = m_viewWin.GetBR();
  view = {Truncated<LONG>(topLeft.x), Truncated<LONG>(topLeft.y), Truncated<LONG>(bottomRight.x),
          Truncated<LONG>(bottomRight.y)};
}

long GraphicViewPort::GetViewWidth() const {
  return Truncated<long>(m_viewWin.Width());
}

long GraphicViewPort::GetViewHeight() const {
  return Truncated<long>(m_viewWin.Height());
}

void GraphicViewPort::SetViewWin(const Rect2D& view, bool) {
  m_viewWin = view;
  OnViewWinChanged();
}

void GraphicViewPort::SetViewWin(const tagRECT& view, bool update) {
  SetViewWin(Rect2D(view), update);
}

void GraphicViewPort::SetViewWin(float left, float top, float right, float bottom, bool update) {
  SetViewWin(Rect2D(left, top, right, bottom), update);
}

void GraphicViewPort::MoveViewWin(int dx, int dy, bool) {
  m_viewWin.Move(Single(dx), Single(dy));
  OnViewWinChanged();
}

void GraphicViewPort::SetViewPos(const tagPOINT& topLeft, bool) {
  m_viewWin.SetPos(dVect2D(topLeft));
  OnViewWinChanged();
}

void GraphicViewPort::SetViewPos(int x, int y, bool update) {
  SetViewPos(tagPOINT{x, y}, update);
}

void GraphicViewPort::OnViewWinChanged() {
  m_viewWin.Normalize();
  if (m_widthMode != ViewMode_Fit) {
    m_trafo.rB2A(WithoutBorders(m_viewWin), m_graphicWin);
  }
}

void GraphicViewPort::GetDrawWin(tagRECT& draw) const {
  const dVect2D topLeft = m_viewWin.GetTL();
  const dVect2D bottomRight = m_viewWin.GetBR();
  draw = {WholePixel(topLeft.x, m_leftBorder), WholePixel(topLeft.y, m_topBorder),
          WholePixel(bottomRight.x, -m_rightBorder), WholePixel(bottomRight.y, -m_bottomBorder)};
}

void GraphicViewPort::GetDrawWin(Rect2D& draw) const {
  tagRECT whole;
  GetDrawWin(whole);
  draw.Set(whole);
}

void GraphicViewPort::SetBorder(int left, int top, int right, int bottom) {
  m_leftBorder = ToBorder(left);
  m_topBorder = ToBorder(top);
  m_rightBorder = ToBorder(right);
  m_bottomBorder = ToBorder(bottom);
}

void GraphicViewPort::SetBorder(int horizontal, int vertical) {
  SetBorder(horizontal, vertical, horizontal, vertical);
}

void GraphicViewPort::SetBorder(int all) {
  SetBorder(all, all);
}

unsigned short GraphicViewPort::GetTopBorder() const {
  return m_topBorder;
}

unsigned short GraphicViewPort::GetBottomBorder() const {
  return m_bottomBorder;
}

unsigned short GraphicViewPort::GetLeftBorder() const {
  return m_leftBorder;
}

unsigned short GraphicViewPort::GetRightBorder() const {
  return m_rightBorder;
}

bool GraphicViewPort::IsInside(const tagPOINT& point) const {
  return m_viewWin.IsInside(point);
}

bool GraphicViewPort::IsInside(int x, int y) const {
  return IsInside(tagPOINT{x, y});
}

bool GraphicViewPort::IsInside(int x, int y, const tagRECT& rect) const {
  return x >= rect.left && y >= rect.top && x < rect.right && y < rect.bottom;
}

bool GraphicViewPort::IsInside(const tagPOINT& point, const tagRECT& rect) const {
  return IsInside(point.x, point.y, rect);
}

}  // namespace vorl
