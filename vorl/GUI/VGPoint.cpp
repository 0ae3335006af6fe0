#include <vorl/GUI/VGPoint.h>

#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/detail/ShapePen.h>

inline namespace vorl {

using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;

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

VGPointView::VGPointView(const VGPoint& point) : VGPoint(point), VGAnchorView(point) {}

VGPointView::VGPointView(const VGPointView& source) = default;

VGPointView& VGPointView::operator=(const VGPoint& point) {
  SetData(point);
  return *this;
}

VGPointView& VGPointView::operator=(const VGPointView& source) {
  if (this != &source) {
    VGAnchorView::operator=(source);
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

void VGPointView::DrawGraphic(HDC dc, GraphicViewPort& viewPort) {
  viewPort.GraphicToView(static_cast<const dVect2D&>(*this), m_viewPos);
  DrawGraphic(dc);
}

void VGPointView::DrawGraphic(HDC dc) {
  const ShapePen pen(dc, *this, GetPenThickness());
  const ShapeROP rop(dc, *this);
  pen.Dot(m_viewPos);
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
