#include <vorl/GUI/VGLine.h>

#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/ShapePen.h>

inline namespace vorl {

using vorl_detail::Enlarged;
using vorl_detail::HandleWidth;
using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;

VGLine::VGLine() = default;

VGLine::VGLine(const VGLine& source) = default;

VGLine& VGLine::operator=(const VGLine& source) = default;

VGLine::~VGLine() = default;

void VGLine::Init(const dVect2D& pos, const dVect2D& end, TLine type) {
  const dVect2D vector(pos, end);
  m_type = type;
  m_pos = pos;
  m_vector = vector;
}

void VGLine::Init(const tagPOINT& pos, const tagPOINT& end, TLine type) {
  Init(dVect2D(pos), dVect2D(end), type);
}

void VGLine::Init(const VGLine& source, Trafo2DBase* trafo, bool toGraphic) {
  VGLine::operator=(source);
  Transform(trafo, toGraphic);
}

TLine VGLine::GetType() const {
  return m_type;
}

void VGLine::SetType(TLine type) {
  m_type = type;
}

const dVect2D& VGLine::GetPos() const {
  return m_pos;
}

void VGLine::SetPos(const dVect2D& pos) {
  m_pos = pos;
}

const dVect2D& VGLine::GetVector() const {
  return m_vector;
}

void VGLine::SetVector(const dVect2D& vector) {
  m_vector = vector;
}

dVect2D VGLine::GetEndPos() const {
  return m_pos + m_vector;
}

void VGLine::SetEndPos(const dVect2D& end) {
  m_vector.Diff(m_pos, end);
}

float VGLine::GetLength() const {
  return static_cast<float>(m_vector.Length());
}

void VGLine::Transform(Trafo2DBase* trafo, bool toGraphic) {
  if (trafo == nullptr) {
    return;
  }
  if (toGraphic) {
    trafo->pB2A(m_pos);
    trafo->vB2A(m_vector);
  } else {
    trafo->pA2B(m_pos);
    trafo->vA2B(m_vector);
  }
}

VGLineView::VGLineView() = default;

VGLineView::VGLineView(const VGLine& line)
    : VGLine(line), m_viewPos(line.GetPos()), m_viewVector(line.GetVector()) {}

VGLineView::VGLineView(const VGLineView& source) = default;

VGLineView& VGLineView::operator=(const VGLine& line) {
  SetData(line);
  return *this;
}

VGLineView& VGLineView::operator=(const VGLineView& source) {
  if (this != &source) {
    VGObjectView::operator=(source);
    m_reference = source.m_reference;
    m_handle = source.m_handle;
    SetData(source);
  }
  return *this;
}

VGLineView::~VGLineView() = default;

VGType VGLineView::GetObjType() {
  return VGType_Line;
}

void VGLineView::Transform(bool toGraphic) {
  if (toGraphic) {
    SetPos(m_viewPos);
    SetVector(m_viewVector);
    Transform(GetTransformation(), true);
    return;
  }
  VGLine view;
  view.Init(*this, GetTransformation(), false);
  m_viewPos = view.GetPos();
  m_viewVector = view.GetVector();
}

bool VGLineView::IsSegment() const {
  return GetType() != TLine_Infinite;
}

dVect2D VGLineView::ViewEnd() const {
  return m_viewPos + m_viewVector;
}

dVect2D VGLineView::ViewCenter() const {
  return IsSegment() ? m_viewPos + m_viewVector * 0.5 : m_viewPos;
}

bool VGLineView::IsPointOnGraphic(dVect2D& point, int tolerance) {
  if (IsSegment()) {
    return Geom2D::IsPointOnLineSegment(point, m_viewPos, ViewEnd(), tolerance);
  }
  return Geom2D::IsPointOnLine(point, m_viewPos, m_viewVector, tolerance);
}

short VGLineView::GetSelectionState(int /*flags*/, dVect2D& point) {
  if (!IsVisible() || !IsEnabled(VGOperation_Select)) {
    return VGOperation_None;
  }
  const bool mayRotate = IsEnabled(VGOperation_Rotate);
  const bool isAtPos = Geom2D::IsPointOnPoint(point, m_viewPos, GetHandleDistance());
  if (IsSegment()) {
    if (isAtPos || Geom2D::IsPointOnPoint(point, ViewEnd(), GetHandleDistance())) {
      return mayRotate ? VGOperation_Rotate : VGOperation_Modify;
    }
    return IsPointOnGraphic(point, GetLineDistance()) ? VGOperation_Move : VGOperation_None;
  }
  if (isAtPos) {
    return VGOperation_Move;
  }
  if (!IsPointOnGraphic(point, GetLineDistance())) {
    return VGOperation_None;
  }
  return mayRotate ? VGOperation_Rotate : VGOperation_Move;
}

void VGLineView::DrawGraphic(HDC dc) {
  const ShapeROP rop(dc, *this);
  {
    const ShapePen pen(dc, *this, GetPenThickness());
    if (GetType() == TLine_Segment) {
      pen.Line(m_viewPos, ViewEnd());
    } else {
      // A little more than can be seen, so that the ends of a wide line stay outside.
      tagRECT clip{};
      GetClipBox(dc, &clip);
      pen.LineThrough(m_viewPos, m_viewVector, Enlarged(clip, 2));
    }
  }
  if (IsEnabled(VGOperation_Rotate)) {
    const ShapePen pen(dc, *this, HandleWidth(GetPenThickness()));
    pen.Dot(ViewCenter());
  }
}

void VGLineView::DrawSelection(HDC dc) {
  if (!IsSegment()) {
    return;
  }
  const ShapeROP rop(dc, *this);
  const ShapePen pen(dc, *this, HandleWidth(GetPenThickness()));
  pen.Dot(m_viewPos);
  pen.Dot(ViewEnd());
}

void VGLineView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  min = m_viewPos;
  max = m_viewPos;
  UpdateBoundingBox(ViewEnd(), min, max);
}

bool VGLineView::EndOperation() {
  SetROPMode(R2_COPYPEN);
  SetOpState(VGOperation_None);
  return true;
}

bool VGLineView::OnCreate(int event, int /*flags*/, dVect2D& point) {
  if (!IsEnabled(VGOperation_Create) || event != MouseEvent_ButtonDown) {
    return false;
  }
  Disable(VGOperation_Rotate);
  Enable(VGOperation_Modify);
  SetOpState(VGOperation_Modify);
  AssignViewState(VGViewState_Visible | VGViewState_Selected);
  SetType(TLine_Segment);
  m_viewPos = point;
  m_viewVector.Set(1.0, 0.0);
  m_reference = point;
  ViewDataChanged();
  return OnBeginModify(point);
}

bool VGLineView::OnBeginMove(dVect2D& point) {
  m_reference = point;
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGLineView::OnMove(dVect2D& point) {
  m_viewPos += dVect2D(m_reference, point);
  ViewDataChanged();
  m_reference = point;
  return true;
}

bool VGLineView::OnEndMove(dVect2D& /*point*/) {
  return EndOperation();
}

bool VGLineView::OnBeginModify(dVect2D& point) {
  m_handle = Handle::None;
  if (Geom2D::IsPointOnPoint(point, m_viewPos, GetHandleDistance())) {
    m_handle = Handle::Start;
  }
  if (Geom2D::IsPointOnPoint(point, ViewEnd(), GetHandleDistance())) {
    m_handle = Handle::End;
  }
  ViewDataChanged();
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGLineView::OnModify(dVect2D& point) {
  if (m_handle == Handle::Start) {
    m_viewVector.Diff(point, ViewEnd());
    m_viewPos = point;
  } else if (m_handle == Handle::End) {
    m_viewVector.Diff(m_viewPos, point);
  }
  ViewDataChanged();
  return true;
}

bool VGLineView::OnEndModify(dVect2D& /*point*/) {
  m_handle = Handle::None;
  return EndOperation();
}

bool VGLineView::OnBeginRotate(dVect2D& /*point*/) {
  m_reference = ViewCenter();
  SetROPMode(R2_XORPEN);
  return true;
}

bool VGLineView::OnRotate(dVect2D& point) {
  const dVect2D& center = m_reference;
  if (point == m_viewPos || point == center) {
    return true;
  }
  const double length = m_viewVector.Length();
  m_viewVector.Diff(center, point);
  if (IsSegment()) {
    const double factor = length / m_viewVector.Length();
    m_viewVector.Set(m_viewVector.x * factor, m_viewVector.y * factor);
    m_viewPos = center - m_viewVector * 0.5;
  }
  ViewDataChanged();
  return true;
}

bool VGLineView::OnEndRotate(dVect2D& /*point*/) {
  return EndOperation();
}

void VGLineView::SetData(const VGLine& line) {
  VGLine::operator=(line);
  Transform(false);
}

void VGLineView::SetViewData(const VGLine& line) {
  SetType(line.GetType());
  m_viewPos = line.GetPos();
  m_viewVector = line.GetVector();
  Transform(true);
}

VGLine VGLineView::GetViewData() const {
  VGLine line;
  GetViewData(line);
  return line;
}

void VGLineView::GetViewData(VGLine& line) const {
  line.SetType(GetType());
  line.SetPos(m_viewPos);
  line.SetVector(m_viewVector);
}

}  // namespace vorl
