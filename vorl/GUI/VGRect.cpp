#include <vorl/GUI/VGRect.h>

#include <vorl/Data/dRect.h>
#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/RectHandles.h>
#include <vorl/GUI/detail/ShapePen.h>

inline namespace vorl {

using vorl_detail::DrawRectHandles;
using vorl_detail::EdgesAt;
using vorl_detail::PullEdges;
using vorl_detail::RectEdge_Bottom;
using vorl_detail::RectEdge_None;
using vorl_detail::RectEdge_Right;
using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;
using vorl_detail::TruncatedRect;

VGRect::VGRect() = default;

VGRect::VGRect(const VGRect& source) = default;

VGRect& VGRect::operator=(const VGRect& source) = default;

VGRect::~VGRect() = default;

void VGRect::Init(float x1, float y1, float x2, float y2) {
  m_topLeft.Set(x1, y1);
  m_bottomRight.Set(x2, y2);
}

void VGRect::Init(const dVect2D& topLeft, const dVect2D& bottomRight) {
  Init(topLeft.x, topLeft.y, bottomRight.x, bottomRight.y);
}

void VGRect::Init(const tagPOINT& topLeft, const tagPOINT& bottomRight) {
  Init(dVect2D(topLeft), dVect2D(bottomRight));
}

void VGRect::Init(const dRect& rect) {
  m_topLeft.Set(rect.x, rect.y);
  m_bottomRight.Set(static_cast<double>(rect.x) + rect.width,
                    static_cast<double>(rect.y) + rect.height);
}

dVect2D& VGRect::TopLeft() {
  return m_topLeft;
}

const dVect2D& VGRect::TopLeft() const {
  return m_topLeft;
}

dVect2D& VGRect::BottomRight() {
  return m_bottomRight;
}

const dVect2D& VGRect::BottomRight() const {
  return m_bottomRight;
}

void VGRect::CenterPos(dVect2D& center) const {
  center.Set((double{m_topLeft.x} + m_bottomRight.x) * 0.5,
             (double{m_topLeft.y} + m_bottomRight.y) * 0.5);
}

void VGRect::Transform(Trafo2DBase* trafo, bool toGraphic) {
  if (trafo == nullptr) {
    return;
  }
  for (dVect2D* const corner : {&m_topLeft, &m_bottomRight}) {
    if (toGraphic) {
      trafo->pB2A(*corner);
    } else {
      trafo->pA2B(*corner);
    }
  }
}

VGRectView::VGRectView() = default;

VGRectView::VGRectView(const VGRect& rect) : VGRect(rect), m_view(rect) {}

VGRectView::VGRectView(const VGRectView& source) = default;

VGRectView& VGRectView::operator=(const VGRect& rect) {
  SetData(rect);
  return *this;
}

VGRectView& VGRectView::operator=(const VGRectView& source) {
  if (this != &source) {
    VGObjectView::operator=(source);
    m_reference = source.m_reference;
    m_edges = source.m_edges;
    SetData(source);
  }
  return *this;
}

VGRectView::~VGRectView() = default;

VGType VGRectView::GetObjType() {
  return VGType_Rect;
}

void VGRectView::Transform(bool toGraphic) {
  if (toGraphic) {
    VGRect::operator=(m_view);
    Transform(GetTransformation(), true);
  } else {
    m_view = *this;
    m_view.Transform(GetTransformation(), false);
  }
}

bool VGRectView::IsPointOnGraphic(dVect2D& point, int tolerance) {
  const dVect2D& topLeft = m_view.TopLeft();
  const dVect2D& bottomRight = m_view.BottomRight();
  const dVect2D topRight(bottomRight.x, topLeft.y);
  const dVect2D bottomLeft(topLeft.x, bottomRight.y);
  return Geom2D::IsPointOnLineSegment(point, topLeft, topRight, tolerance) ||
         Geom2D::IsPointOnLineSegment(point, topRight, bottomRight, tolerance) ||
         Geom2D::IsPointOnLineSegment(point, bottomRight, bottomLeft, tolerance) ||
         Geom2D::IsPointOnLineSegment(point, bottomLeft, topLeft, tolerance);
}

short VGRectView::GetSelectionState(int /*flags*/, dVect2D& point) {
  m_edges = RectEdge_None;
  if (!IsVisible() || !IsEnabled(VGOperation_Select)) {
    return VGOperation_None;
  }
  m_edges = EdgesAt(point, m_view.TopLeft(), m_view.BottomRight(), GetHandleDistance());
  if (m_edges != RectEdge_None) {
    return VGOperation_Modify;
  }
  return IsPointOnGraphic(point, GetLineDistance()) ? VGOperation_Move : VGOperation_None;
}

void VGRectView::DrawGraphic(HDC dc) {
  const tagRECT rect = TruncatedRect(m_view.TopLeft(), m_view.BottomRight());
  const ShapePen pen(dc, *this, GetPenThickness());
  const ShapeROP rop(dc, *this);
  MoveToEx(dc, rect.left, rect.top, nullptr);
  LineTo(dc, rect.right, rect.top);
  LineTo(dc, rect.right, rect.bottom);
  LineTo(dc, rect.left, rect.bottom);
  LineTo(dc, rect.left, rect.top);
}

void VGRectView::DrawSelection(HDC dc) {
  DrawRectHandles(dc, *this, TruncatedRect(m_view.TopLeft(), m_view.BottomRight()));
}

void VGRectView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  min = m_view.TopLeft();
  max = m_view.TopLeft();
  UpdateBoundingBox(m_view.BottomRight(), min, max);
}

bool VGRectView::EndOperation() {
  SetOpState(VGOperation_None);
  SetROPMode(R2_COPYPEN);
  return true;
}

bool VGRectView::OnCreate(int event, int /*flags*/, dVect2D& point) {
  if (!IsEnabled(VGOperation_Create) || event != MouseEvent_ButtonDown) {
    return false;
  }
  Enable(VGOperation_Modify);
  SetOpState(VGOperation_Modify);
  AssignViewState(VGViewState_Visible | VGViewState_Selected);
  m_view.Init(point.x, point.y, point.x + 1.0F, point.y + 1.0F);
  m_edges = RectEdge_Right | RectEdge_Bottom;
  ViewDataChanged();
  return OnBeginModify(point);
}

bool VGRectView::OnBeginMove(dVect2D& point) {
  m_reference = point;
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGRectView::OnMove(dVect2D& point) {
  Translate2D way(double{point.x} - m_reference.x, double{point.y} - m_reference.y);
  m_view.Transform(&way, false);
  m_reference = point;
  ViewDataChanged();
  return true;
}

bool VGRectView::OnEndMove(dVect2D& /*point*/) {
  return EndOperation();
}

bool VGRectView::OnBeginModify(dVect2D& /*point*/) {
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGRectView::OnModify(dVect2D& point) {
  PullEdges(m_edges, point, m_view.TopLeft(), m_view.BottomRight());
  ViewDataChanged();
  return true;
}

bool VGRectView::OnEndModify(dVect2D& /*point*/) {
  m_edges = RectEdge_None;
  return EndOperation();
}

void VGRectView::SetData(const VGRect& rect) {
  VGRect::operator=(rect);
  Transform(false);
}

void VGRectView::SetViewData(const VGRect& rect) {
  m_view = rect;
  Transform(true);
}

VGRect VGRectView::GetViewData() const {
  return m_view;
}

void VGRectView::GetViewData(VGRect& rect) const {
  rect = m_view;
}

}  // namespace vorl
