#include <vorl/GUI/VGPoint.h>

#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/ShapePen.h>

inline namespace vorl {

using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;

namespace {

constexpr int kSelectionWidth = 5;

}  // namespace

VGPoint::VGPoint() = default;

VGPoint::VGPoint(const dVect2D& pos) : dVect2D(pos) {}

VGPoint::VGPoint(const VGPoint& source) = default;

VGPoint& VGPoint::operator=(const VGPoint& source) = default;

VGPoint& VGPoint::operator=(const dVect2D& pos) {
  Set(pos);
  return *this;
}

VGPoint::~VGPoint() = default;

void VGPoint::Transform(Trafo2DBase* trafo, bool toGraphic) {
  if (trafo == nullptr) {
    return;
  }
  if (toGraphic) {
    trafo->pB2A(static_cast<dVect2D&>(*this));
  } else {
    trafo->pA2B(static_cast<dVect2D&>(*this));
  }
}

VGPointView::VGPointView() = default;

VGPointView::VGPointView(const VGPoint& point) : VGPoint(point), m_viewPos(point) {}

VGPointView::VGPointView(const VGPointView& source) = default;

VGPointView& VGPointView::operator=(const VGPoint& point) {
  SetData(point);
  return *this;
}

VGPointView& VGPointView::operator=(const VGPointView& source) {
  if (this != &source) {
    VGObjectView::operator=(source);
    SetData(source);
  }
  return *this;
}

VGPointView::~VGPointView() = default;

VGType VGPointView::GetObjType() {
  return VGType_Point;
}

void VGPointView::Transform(bool toGraphic) {
  if (toGraphic) {
    Set(m_viewPos);
    Transform(GetTransformation(), true);
    return;
  }
  VGPoint view(*this);
  view.Transform(GetTransformation(), false);
  m_viewPos = view;
}

bool VGPointView::IsPointOnGraphic(dVect2D& point, int tolerance) {
  return Geom2D::IsPointOnPoint(point, m_viewPos, tolerance);
}

short VGPointView::GetSelectionState(int /*flags*/, dVect2D& point) {
  if (!IsVisible() || !IsEnabled(VGOperation_Select)) {
    return VGOperation_None;
  }
  return Geom2D::IsPointOnPoint(point, m_viewPos, GetHandleDistance()) ? VGOperation_Move
                                                                       : VGOperation_None;
}

void VGPointView::DrawGraphic(HDC dc, GraphicViewPort& viewPort) {
  viewPort.GraphicToView(static_cast<const dVect2D&>(*this), m_viewPos);
  DrawGraphic(dc);
}

void VGPointView::DrawGraphic(HDC dc) {
  const ShapePen pen(dc, *this, GetPenThickness());
  const ShapeROP rop(dc, *this);
  pen.Dot(m_viewPos);
}

void VGPointView::DrawSelection(HDC dc) {
  const ShapePen pen(dc, *this, kSelectionWidth);
  const ShapeROP rop(dc, *this);
  pen.Dot(m_viewPos);
}

void VGPointView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  min = m_viewPos;
  max = m_viewPos;
}

// A click is enough, whether creation is enabled or not.
bool VGPointView::OnCreate(int event, int /*flags*/, dVect2D& point) {
  if (event != MouseEvent_ButtonDown) {
    return false;
  }
  m_viewPos = point;
  ViewDataChanged();
  AssignViewState(VGViewState_Visible | VGViewState_Selected);
  SetOpState(VGOperation_None);
  return true;
}

bool VGPointView::OnBeginMove(dVect2D& /*point*/) {
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGPointView::OnMove(dVect2D& point) {
  m_viewPos = point;
  ViewDataChanged();
  return true;
}

bool VGPointView::OnEndMove(dVect2D& /*point*/) {
  SetROPMode(R2_COPYPEN);
  SetOpState(VGOperation_None);
  return true;
}

void VGPointView::SetData(const VGPoint& point) {
  VGPoint::operator=(point);
  Transform(false);
}

void VGPointView::SetViewData(const VGPoint& point) {
  m_viewPos = point;
  Transform(true);
}

VGPoint VGPointView::GetViewData() const {
  return VGPoint(m_viewPos);
}

void VGPointView::GetViewData(VGPoint& point) const {
  point = m_viewPos;
}

}  // namespace vorl
