#include <vorl/GUI/VGAnchorView.h>

#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/ShapePen.h>

inline namespace vorl {

namespace {

constexpr int kSelectionWidth = 5;

}  // namespace

VGAnchorView::VGAnchorView() = default;

VGAnchorView::VGAnchorView(const dVect2D& viewPos) : m_viewPos(viewPos) {}

VGAnchorView::VGAnchorView(const VGAnchorView& source) = default;

VGAnchorView& VGAnchorView::operator=(const VGAnchorView& source) {
  VGObjectView::operator=(source);
  return *this;
}

VGAnchorView::~VGAnchorView() = default;

bool VGAnchorView::IsPointOnGraphic(dVect2D& point, int tolerance) {
  return Geom2D::IsPointOnPoint(point, m_viewPos, tolerance);
}

short VGAnchorView::GetSelectionState(int /*flags*/, dVect2D& point) {
  if (!IsVisible() || !IsEnabled(VGOperation_Select)) {
    return VGOperation_None;
  }
  return Geom2D::IsPointOnPoint(point, m_viewPos, GetHandleDistance()) ? VGOperation_Move
                                                                       : VGOperation_None;
}

void VGAnchorView::DrawSelection(HDC dc) {
  const vorl_detail::ShapePen pen(dc, *this, kSelectionWidth);
  const vorl_detail::ShapeROP rop(dc, *this);
  pen.Dot(m_viewPos);
}

void VGAnchorView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  min = m_viewPos;
  max = m_viewPos;
}

// A click is enough, whether creation is enabled or not.
bool VGAnchorView::OnCreate(int event, int /*flags*/, dVect2D& point) {
  if (event != MouseEvent_ButtonDown) {
    return false;
  }
  m_viewPos = point;
  ViewDataChanged();
  AssignViewState(VGViewState_Visible | VGViewState_Selected);
  SetOpState(VGOperation_None);
  return true;
}

bool VGAnchorView::OnBeginMove(dVect2D& /*point*/) {
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGAnchorView::OnMove(dVect2D& point) {
  m_viewPos = point;
  ViewDataChanged();
  return true;
}

bool VGAnchorView::OnEndMove(dVect2D& /*point*/) {
  SetROPMode(R2_COPYPEN);
  SetOpState(VGOperation_None);
  return true;
}

}  // namespace vorl
