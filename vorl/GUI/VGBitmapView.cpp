#include <vorl/GUI/VGBitmapView.h>

#include <cmath>

#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/DeviceRect.h>
#include <vorl/GUI/detail/RectHandles.h>
#include <vorl/GUI/detail/Truncated.h>

inline namespace vorl {

using vorl_detail::DrawRectHandles;
using vorl_detail::EdgesAt;
using vorl_detail::PullEdges;
using vorl_detail::RectEdge_Bottom;
using vorl_detail::RectEdge_None;
using vorl_detail::RectEdge_Right;
using vorl_detail::ToDevice;
using vorl_detail::Truncated;
using vorl_detail::TruncatedRect;

namespace {

// Cutting off the decimals of all edges would let the size change by a pixel, and the scale
// flicker, while a picture scrolls.
tagRECT WholeRect(Rect2D rect) {
  rect.Normalize();
  const dVect2D topLeft = rect.GetTL();
  const int left = Truncated<int>(topLeft.x);
  const int top = Truncated<int>(topLeft.y);
  return {left, top, ToDevice(std::int64_t{left} + Truncated<int>(rect.Width() + 0.5)),
          ToDevice(std::int64_t{top} + Truncated<int>(rect.Height() + 0.5))};
}

tagRECT Shifted(const tagRECT& rect, std::int64_t dx, std::int64_t dy) {
  return {ToDevice(rect.left + dx), ToDevice(rect.top + dy), ToDevice(rect.right + dx),
          ToDevice(rect.bottom + dy)};
}

}  // namespace

VGBitmapView::VGBitmapView() = default;

VGBitmapView::VGBitmapView(const VGBitmapView& source) = default;

VGBitmapView& VGBitmapView::operator=(const VGBitmapView& source) {
  if (this != &source) {
    VGObjectView::operator=(source);
    m_pImage = source.m_pImage;
    m_baseRect = source.m_baseRect;
    m_bitmapTrafo = source.m_bitmapTrafo;
    m_viewer = source.m_viewer;
    m_reference = source.m_reference;
    m_edges = source.m_edges;
    Transform(false);
  }
  return *this;
}

VGBitmapView::~VGBitmapView() = default;

bool VGBitmapView::Show(dImage* image, const Rect2D& rect) {
  m_pImage = image;
  m_baseRect = rect;
  UpdateBitmapTrafo();
  Transform(false);
  return UpdateViewer();
}

bool VGBitmapView::Init(dImage* image) {
  Rect2D rect;
  if (image != nullptr) {
    const double left = image->GetPosX();
    const double top = image->GetPosY();
    rect.Set(static_cast<float>(left), static_cast<float>(top),
             static_cast<float>(left + static_cast<double>(image->GetWidth())),
             static_cast<float>(top + static_cast<double>(image->GetHeight())));
  }
  return Show(image, rect);
}

bool VGBitmapView::Init(dImage* image, float left, float top, float right, float bottom) {
  return Show(image, Rect2D(left, top, right, bottom));
}

bool VGBitmapView::Init(dImage* image, const dVect2D& topLeft, const dVect2D& bottomRight) {
  return Show(image, Rect2D(topLeft, bottomRight));
}

bool VGBitmapView::Init(dImage* image, const tagPOINT& topLeft, const tagPOINT& bottomRight) {
  return Show(image, Rect2D(topLeft, bottomRight));
}

dImage* VGBitmapView::GetImage() const {
  return m_pImage;
}

Rect2D& VGBitmapView::BaseRect() {
  return m_baseRect;
}

const Rect2D& VGBitmapView::BaseRect() const {
  return m_baseRect;
}

void VGBitmapView::BaseRect(Rect2D& rect) const {
  rect = m_baseRect;
}

void VGBitmapView::ViewRect(Rect2D& rect) const {
  rect = m_viewRect;
}

// The maps of the plane are not constant: they may be overridden.

void VGBitmapView::Graphic2Bitmap(dVect2D& point) const {
  TrafoST2D(m_bitmapTrafo).pA2B(point);
}
void VGBitmapView::Graphic2Bitmap(tagPOINT& point) const {
  TrafoST2D(m_bitmapTrafo).pA2B(point);
}
void VGBitmapView::Graphic2Bitmap(Rect2D& rect) const {
  TrafoST2D(m_bitmapTrafo).rA2B(rect);
}
void VGBitmapView::Graphic2Bitmap(tagRECT& rect) const {
  TrafoST2D(m_bitmapTrafo).rA2B(rect);
}
void VGBitmapView::Graphic2Bitmap(const dVect2D& source, dVect2D& target) const {
  TrafoST2D(m_bitmapTrafo).pA2B(source, target);
}
void VGBitmapView::Graphic2Bitmap(const tagPOINT& source, tagPOINT& target) const {
  TrafoST2D(m_bitmapTrafo).pA2B(source, target);
}
void VGBitmapView::Graphic2Bitmap(const Rect2D& source, Rect2D& target) const {
  TrafoST2D(m_bitmapTrafo).rA2B(source, target);
}
void VGBitmapView::Graphic2Bitmap(const tagRECT& source, tagRECT& target) const {
  TrafoST2D(m_bitmapTrafo).rA2B(source, target);
}

void VGBitmapView::Bitmap2Graphic(dVect2D& point) const {
  TrafoST2D(m_bitmapTrafo).pB2A(point);
}
void VGBitmapView::Bitmap2Graphic(tagPOINT& point) const {
  TrafoST2D(m_bitmapTrafo).pB2A(point);
}
void VGBitmapView::Bitmap2Graphic(Rect2D& rect) const {
  TrafoST2D(m_bitmapTrafo).rB2A(rect);
}
void VGBitmapView::Bitmap2Graphic(tagRECT& rect) const {
  TrafoST2D(m_bitmapTrafo).rB2A(rect);
}
void VGBitmapView::Bitmap2Graphic(const dVect2D& source, dVect2D& target) const {
  TrafoST2D(m_bitmapTrafo).pB2A(source, target);
}
void VGBitmapView::Bitmap2Graphic(const tagPOINT& source, tagPOINT& target) const {
  TrafoST2D(m_bitmapTrafo).pB2A(source, target);
}
void VGBitmapView::Bitmap2Graphic(const Rect2D& source, Rect2D& target) const {
  TrafoST2D(m_bitmapTrafo).rB2A(source, target);
}
void VGBitmapView::Bitmap2Graphic(const tagRECT& source, tagRECT& target) const {
  TrafoST2D(m_bitmapTrafo).rB2A(source, target);
}

void VGBitmapView::EnableTransparency(unsigned long colour) {
  m_viewer.EnableTransparency(colour);
}

void VGBitmapView::EnableTransparency(int x, int y) {
  m_viewer.EnableTransparency(x, y);
}

void VGBitmapView::DisableTransparency() {
  m_viewer.DisableTransparency();
}

tagRGBQUAD* VGBitmapView::GetPalette() const {
  return m_viewer.GetPalette();
}

unsigned short VGBitmapView::GetPaletteSize() const {
  return m_viewer.GetPaletteSize();
}

bool VGBitmapView::ResetPalette(bool ascending) {
  return m_viewer.ResetPalette(ascending);
}

bool VGBitmapView::UpdateViewer() {
  return m_viewer.Init(m_pImage, nullptr, nullptr, false, false);
}

void VGBitmapView::UpdateBitmapTrafo() {
  if (m_pImage == nullptr || m_baseRect.IsEmpty()) {
    m_bitmapTrafo.Reset();
    return;
  }
  const dVect2D topLeft = m_baseRect.GetTL();
  const dVect2D bottomRight = m_baseRect.GetBR();
  const double left = m_pImage->GetPosX();
  const double top = m_pImage->GetPosY();
  m_bitmapTrafo.Set(topLeft.x, topLeft.y, bottomRight.x, bottomRight.y, left, top,
                    left + static_cast<double>(m_pImage->GetWidth()),
                    top + static_cast<double>(m_pImage->GetHeight()));
}

const dStatus& VGBitmapView::GetStatus() const {
  return m_viewer.GetStatus();
}

VGType VGBitmapView::GetObjType() {
  return VGType_Bitmap;
}

void VGBitmapView::Transform(bool toGraphic) {
  if (toGraphic) {
    m_baseRect = m_viewRect;
    GetTransformation()->rB2A(m_baseRect);
    UpdateBitmapTrafo();
  } else {
    m_viewRect = m_baseRect;
    GetTransformation()->rA2B(m_viewRect);
  }
}

bool VGBitmapView::IsPointOnGraphic(dVect2D& point, int /*tolerance*/) {
  return m_viewRect.IsValid() && m_viewRect.IsInside(point);
}

short VGBitmapView::GetSelectionState(int /*flags*/, dVect2D& point) {
  m_edges = RectEdge_None;
  if (!IsVisible() || !IsEnabled(VGOperation_Select)) {
    return VGOperation_None;
  }
  m_edges = EdgesAt(point, m_viewRect.GetTL(), m_viewRect.GetBR(), GetHandleDistance());
  if (m_edges != RectEdge_None) {
    return VGOperation_Modify;
  }
  return IsPointOnGraphic(point, GetLineDistance()) ? VGOperation_Move : VGOperation_None;
}

void VGBitmapView::DrawPart(HDC dc, const Rect2D& target, Trafo2DBase& map,
                            unsigned long background) {
  if (target.IsEmpty()) {
    return;
  }
  Rect2D source;
  map.rB2A(target, source);
  m_bitmapTrafo.rA2B(source);
  const tagRECT targetRect = WholeRect(target);
  if (!m_viewer.IsInitialized()) {
    m_viewer.EraseBackground(dc, &targetRect, nullptr, background);
    return;
  }
  // The renderer knows no position: its pixels count from the image's corner.
  const tagRECT sourceRect = Shifted(WholeRect(source), -std::int64_t{m_pImage->GetPosX()},
                                     -std::int64_t{m_pImage->GetPosY()});
  m_viewer.SetSourceRect(&sourceRect);
  m_viewer.SetTargetRect(&targetRect);
  m_viewer.Draw(dc);
}

void VGBitmapView::DrawGraphic(HDC dc, GraphicViewPort& viewPort) {
  if (dc == nullptr) {
    return;
  }
  Rect2D target;
  viewPort.GetDrawWin(target);
  DrawPart(dc, m_viewRect & target, viewPort.GetTrafo(),
           static_cast<unsigned long>(viewPort.GetBgColor()));
}

void VGBitmapView::DrawGraphic(HDC dc) {
  if (dc != nullptr) {
    DrawPart(dc, m_viewRect, *GetTransformation(), 0);
  }
}

void VGBitmapView::DrawSelection(HDC dc) {
  DrawRectHandles(dc, *this, TruncatedRect(m_viewRect.GetTL(), m_viewRect.GetBR()));
}

void VGBitmapView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  min = m_viewRect.GetTL();
  max = min;
  UpdateBoundingBox(m_viewRect.GetBR(), min, max);
}

bool VGBitmapView::OnCreate(int event, int /*flags*/, dVect2D& point) {
  if (!IsEnabled(VGOperation_Create) || event != MouseEvent_ButtonDown) {
    return false;
  }
  Enable(VGOperation_Modify);
  SetOpState(VGOperation_Modify);
  AssignViewState(VGViewState_Visible | VGViewState_Selected);
  m_viewRect.Set(point.x, point.y, point.x + 1.0F, point.y + 1.0F);
  m_edges = RectEdge_Right | RectEdge_Bottom;
  ViewDataChanged();
  return OnBeginModify(point);
}

// The raster operation stays, unlike that of shapes: an image cannot be undrawn by drawing it
// again.

bool VGBitmapView::OnBeginMove(dVect2D& point) {
  m_reference = point;
  return true;
}

bool VGBitmapView::OnMove(dVect2D& point) {
  m_viewRect.Move(dVect2D(m_reference, point));
  m_reference = point;
  ViewDataChanged();
  return true;
}

bool VGBitmapView::OnEndMove(dVect2D& /*point*/) {
  SetOpState(VGOperation_None);
  return true;
}

bool VGBitmapView::OnBeginModify(dVect2D& /*point*/) {
  return true;
}

bool VGBitmapView::OnModify(dVect2D& point) {
  dVect2D topLeft = m_viewRect.GetTL();
  dVect2D bottomRight = m_viewRect.GetBR();
  PullEdges(m_edges, point, topLeft, bottomRight);
  m_viewRect.Set(topLeft, bottomRight);
  ViewDataChanged();
  return true;
}

bool VGBitmapView::OnEndModify(dVect2D& /*point*/) {
  m_edges = RectEdge_None;
  SetOpState(VGOperation_None);
  return true;
}

}  // namespace vorl
