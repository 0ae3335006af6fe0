#include <vorl/GUI/VGCrossCursorView.h>

#include <cmath>

#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/ShapePen.h>

inline namespace vorl {

using vorl_detail::Enlarged;
using vorl_detail::HandleWidth;
using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;

namespace {

// Without angles, so that quarter turns are exact.
dVect2D Turned(const dVect2D& direction, double cosine, double sine) {
  dVect2D turned;
  turned.Set(direction.x * cosine - direction.y * sine, direction.x * sine + direction.y * cosine);
  return turned;
}

}  // namespace

VGCrossCursorView::VGCrossCursorView() = default;

VGCrossCursorView::VGCrossCursorView(const VGCrossCursorView& source) = default;

VGCrossCursorView& VGCrossCursorView::operator=(const VGCrossCursorView& source) {
  if (this != &source) {
    VGObjectView::operator=(source);
    m_mode = source.m_mode;
    m_first = source.m_first;
    m_second = source.m_second;
    m_firstColor = source.m_firstColor;
    m_secondColor = source.m_secondColor;
    m_pressed = source.m_pressed;
    m_startFirst = source.m_startFirst;
    m_startSecond = source.m_startSecond;
    dVect2D::operator=(source);
    Transform(false);
  }
  return *this;
}

VGCrossCursorView::~VGCrossCursorView() = default;

VGType VGCrossCursorView::GetObjType() {
  return VGType_CrossCursor;
}

void VGCrossCursorView::Transform(bool toGraphic) {
  if (toGraphic) {
    dVect2D::operator=(m_viewPos);
    GetTransformation()->pB2A(*this);
  } else {
    m_viewPos = *this;
    GetTransformation()->pA2B(m_viewPos);
  }
}

bool VGCrossCursorView::Shows(CursorMode line) const {
  return (m_mode & line) != 0;
}

bool VGCrossCursorView::IsPointOnGraphic(dVect2D& point, int tolerance) {
  const auto isHit = [&](dVect2D direction) {
    GetTransformation()->vA2B(direction);
    return Geom2D::IsPointOnLine(point, m_viewPos, direction, tolerance);
  };
  return (Shows(CursorMode_First) && isHit(m_first)) ||
         (Shows(CursorMode_Second) && isHit(m_second));
}

short VGCrossCursorView::GetSelectionState(int flags, dVect2D& point) {
  if (!IsVisible() || !IsEnabled(VGOperation_Select) ||
      !IsPointOnGraphic(point, GetLineDistance())) {
    return VGOperation_None;
  }
  return (flags & MK_SHIFT) != 0 ? VGOperation_Rotate : VGOperation_Move;
}

void VGCrossCursorView::DrawGraphic(HDC dc) {
  tagRECT clip{};
  if (dc == nullptr || GetClipBox(dc, &clip) <= NULLREGION) {
    return;
  }
  // So that the ends of wide lines stay outside.
  clip = Enlarged(clip, 2);
  Transform(false);
  dVect2D first = m_first;
  dVect2D second = m_second;
  GetTransformation()->vA2B(first);
  GetTransformation()->vA2B(second);
  const ShapeROP rop(dc, *this);
  if (Shows(CursorMode_First)) {
    const ShapePen pen(dc, *this, GetPenThickness(), m_firstColor);
    pen.LineThrough(m_viewPos, first, clip);
  }
  if (Shows(CursorMode_Second)) {
    const ShapePen pen(dc, *this, GetPenThickness(), m_secondColor);
    pen.LineThrough(m_viewPos, second, clip);
  }
  if (m_mode == CursorMode_Both) {
    const ShapePen pen(dc, *this, HandleWidth(GetPenThickness()));
    pen.Dot(m_viewPos);
  }
}

void VGCrossCursorView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  min = m_viewPos;
  max = m_viewPos;
}

bool VGCrossCursorView::EndOperation() {
  SetOpState(VGOperation_None);
  SetROPMode(R2_COPYPEN);
  return true;
}

bool VGCrossCursorView::OnCreate(int event, int /*flags*/, dVect2D& point) {
  if (!IsEnabled(VGOperation_Create) || event != MouseEvent_ButtonDown) {
    return false;
  }
  Disable(VGOperation_Rotate);
  Enable(VGOperation_Move);
  SetOpState(VGOperation_Move);
  AssignViewState(VGViewState_Visible | VGViewState_Selected);
  m_viewPos = point;
  ViewDataChanged();
  return OnBeginMove(point);
}

bool VGCrossCursorView::OnBeginMove(dVect2D& /*point*/) {
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGCrossCursorView::OnMove(dVect2D& point) {
  m_viewPos = point;
  ViewDataChanged();
  return true;
}

bool VGCrossCursorView::OnEndMove(dVect2D& /*point*/) {
  return EndOperation();
}

// Measured in graphic coordinates, where the directions are: a line keeps under the mouse, and two
// that are perpendicular stay so, also where the scales of x and y differ.
dVect2D VGCrossCursorView::WayTo(const dVect2D& point) const {
  dVect2D way(m_viewPos, point);
  GetTransformation()->vB2A(way);
  return way;
}

bool VGCrossCursorView::OnBeginRotate(dVect2D& point) {
  m_pressed = point;
  m_startFirst = m_first;
  m_startSecond = m_second;
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGCrossCursorView::OnRotate(dVect2D& point) {
  const dVect2D to = WayTo(point);
  if (to.IsZero()) {
    return true;
  }
  dVect2D from = WayTo(m_pressed);
  if (from.IsZero()) {
    m_pressed = point;
    from = to;
  }
  const double lengths = from.Length() * to.Length();
  const double cosine = from.Product(to) / lengths;
  const double sine = from.CrossProduct(to) / lengths;
  if (!std::isfinite(cosine) || !std::isfinite(sine)) {
    return true;
  }
  m_first = Turned(m_startFirst, cosine, sine);
  m_second = Turned(m_startSecond, cosine, sine);
  ViewDataChanged();
  return true;
}

bool VGCrossCursorView::OnEndRotate(dVect2D& /*point*/) {
  return EndOperation();
}

void VGCrossCursorView::SetCursorOrientation(short index, const dVect2D& direction) {
  m_first = direction;
  if (index == 2) {
    m_second = m_first;
  }
}

void VGCrossCursorView::SetCursorOrientation(const dVect2D& first, const dVect2D& second) {
  const dVect2D newSecond = second;  // it may be the first one of this cursor
  m_first = first;
  m_second = newSecond;
}

const dVect2D& VGCrossCursorView::GetCursorOrientation(short index) const {
  return index == 2 ? m_second : m_first;
}

void VGCrossCursorView::SetCursorColor(short index, long color) {
  m_firstColor = static_cast<std::uint32_t>(color);
  if (index == 2) {
    m_secondColor = m_firstColor;
  }
}

void VGCrossCursorView::SetCursorColors(long first, long second) {
  m_firstColor = static_cast<std::uint32_t>(first);
  m_secondColor = static_cast<std::uint32_t>(second);
}

long VGCrossCursorView::GetCursorColor(short index) const {
  return static_cast<long>(index == 2 ? m_secondColor : m_firstColor);
}

void VGCrossCursorView::SetCursorMode(short mode) {
  m_mode = mode;
}

short VGCrossCursorView::GetCursorMode() const {
  return m_mode;
}

void VGCrossCursorView::SetViewPos(const dVect2D& pos) {
  m_viewPos = pos;
}

const dVect2D& VGCrossCursorView::GetViewPos() const {
  return m_viewPos;
}

}  // namespace vorl
