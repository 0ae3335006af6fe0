#include <vorl/GUI/VGRect.h>

#include <vorl/Data/dRect.h>
#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/ShapePen.h>

inline namespace vorl {

using vorl_detail::HeightOf;
using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;
using vorl_detail::Truncated;
using vorl_detail::WidthOf;

namespace {

// The handles are as large on a thick outline as on a thin one.
constexpr int kHandleWidth = 5;

tagRECT DeviceRectOf(const VGRect& rect) {
  return {Truncated<int>(rect.TopLeft().x), Truncated<int>(rect.TopLeft().y),
          Truncated<int>(rect.BottomRight().x), Truncated<int>(rect.BottomRight().y)};
}

}  // namespace

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
    m_edgeX = source.m_edgeX;
    m_edgeY = source.m_edgeY;
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
  m_edgeX = EdgeX::None;
  m_edgeY = EdgeY::None;
  if (!IsVisible() || !IsEnabled(VGOperation_Select)) {
    return VGOperation_None;
  }
  if (GrabHandle(point)) {
    return VGOperation_Modify;
  }
  return IsPointOnGraphic(point, GetLineDistance()) ? VGOperation_Move : VGOperation_None;
}

// Where handles lie close together, the first of them wins.
bool VGRectView::GrabHandle(const dVect2D& point) {
  const double left = m_view.TopLeft().x;
  const double top = m_view.TopLeft().y;
  const double right = m_view.BottomRight().x;
  const double bottom = m_view.BottomRight().y;
  const double width = right - left;
  const double height = bottom - top;
  const struct {
    double x;
    double y;
    EdgeX edgeX;
    EdgeY edgeY;
  } handles[] = {{left, top, EdgeX::Left, EdgeY::Top},
                 {left + width * 0.5, top, EdgeX::None, EdgeY::Top},
                 {left + width, top, EdgeX::Right, EdgeY::Top},
                 {right, top + height * 0.5, EdgeX::Right, EdgeY::None},
                 {right, top + height, EdgeX::Right, EdgeY::Bottom},
                 {right - width * 0.5, bottom, EdgeX::None, EdgeY::Bottom},
                 {left, bottom, EdgeX::Left, EdgeY::Bottom},
                 {left, bottom - height * 0.5, EdgeX::Left, EdgeY::None}};
  for (const auto& handle : handles) {
    dVect2D pos;
    pos.Set(handle.x, handle.y);
    if (Geom2D::IsPointOnPoint(point, pos, GetHandleDistance())) {
      m_edgeX = handle.edgeX;
      m_edgeY = handle.edgeY;
      return true;
    }
  }
  return false;
}

void VGRectView::DrawGraphic(HDC dc) {
  const tagRECT rect = DeviceRectOf(m_view);
  const ShapePen pen(dc, *this, GetPenThickness());
  const ShapeROP rop(dc, *this);
  MoveToEx(dc, rect.left, rect.top, nullptr);
  LineTo(dc, rect.right, rect.top);
  LineTo(dc, rect.right, rect.bottom);
  LineTo(dc, rect.left, rect.bottom);
  LineTo(dc, rect.left, rect.top);
}

void VGRectView::DrawSelection(HDC dc) {
  const tagRECT rect = DeviceRectOf(m_view);
  const int halfWidth = WidthOf(rect) / 2;
  const int halfHeight = HeightOf(rect) / 2;
  const ShapePen pen(dc, *this, kHandleWidth);
  const ShapeROP rop(dc, *this);
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
  m_edgeX = EdgeX::Right;
  m_edgeY = EdgeY::Bottom;
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
  if (m_edgeX != EdgeX::None) {
    (m_edgeX == EdgeX::Left ? m_view.TopLeft() : m_view.BottomRight()).x = point.x;
  }
  if (m_edgeY != EdgeY::None) {
    (m_edgeY == EdgeY::Top ? m_view.TopLeft() : m_view.BottomRight()).y = point.y;
  }
  ViewDataChanged();
  return true;
}

bool VGRectView::OnEndModify(dVect2D& /*point*/) {
  m_edgeX = EdgeX::None;
  m_edgeY = EdgeY::None;
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
