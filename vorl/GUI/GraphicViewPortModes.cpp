// Scales, limits, modes and flags.

#include <vorl/GUI/GraphicViewPort.h>

#include <vorl/Data/detail/Single.h>

inline namespace vorl {

using vorl_detail::Single;

namespace {

/// Flag words are given as `short`, whose sign means nothing.
std::uint16_t ToFlags(short flags) {
  return static_cast<std::uint16_t>(flags);
}

}  // namespace

void GraphicViewPort::SetScaleFactors(float origX, float origY, float minX, float maxX, float minY,
                                      float maxY) {
  m_origScaleX = origX;
  m_origScaleY = origY;
  m_minScaleX = minX;
  m_maxScaleX = maxX;
  m_minScaleY = minY;
  m_maxScaleY = maxY;
}

void GraphicViewPort::SetScaleSizes(float origWidth, float origHeight, float minWidth,
                                    float maxWidth, float minHeight, float maxHeight) {
  SetScaleFactors(Single(origWidth / m_graphicArea.Width()),
                  Single(origHeight / m_graphicArea.Height()), minWidth / origWidth,
                  maxWidth / origWidth, minHeight / origHeight, maxHeight / origHeight);
}

float GraphicViewPort::GetScaleX() const {
  return Single(m_trafo.GetSx() / m_origScaleX);
}

float GraphicViewPort::GetScaleY() const {
  return Single(m_trafo.GetSy() / m_origScaleY);
}

double GraphicViewPort::GetOrigSizeScaleX() const {
  return m_origScaleX;
}

double GraphicViewPort::GetOrigSizeScaleY() const {
  return m_origScaleY;
}

double GraphicViewPort::GetMinScaleX() const {
  return m_minScaleX;
}

double GraphicViewPort::GetMinScaleY() const {
  return m_minScaleY;
}

double GraphicViewPort::GetMaxScaleX() const {
  return m_maxScaleX;
}

double GraphicViewPort::GetMaxScaleY() const {
  return m_maxScaleY;
}

double GraphicViewPort::GetOrigSizeX() const {
  return m_graphicArea.Width() * m_origScaleX;
}

double GraphicViewPort::GetOrigSizeY() const {
  return m_graphicArea.Height() * m_origScaleY;
}

double GraphicViewPort::GetMinSizeX() const {
  return GetOrigSizeX() * m_minScaleX;
}

double GraphicViewPort::GetMinSizeY() const {
  return GetOrigSizeY() * m_minScaleY;
}

double GraphicViewPort::GetMaxSizeX() const {
  return GetOrigSizeX() * m_maxScaleX;
}

double GraphicViewPort::GetMaxSizeY() const {
  return GetOrigSizeY() * m_maxScaleY;
}

void GraphicViewPort::SetViewMode(unsigned char widthMode, unsigned char heightMode) {
  m_widthMode = widthMode;
  m_heightMode = heightMode;
}

void GraphicViewPort::SetWidthMode(unsigned char mode) {
  m_widthMode = mode;
  if (IsEnabled(ViewPortFlag_Proportional)) {
    m_heightMode = mode;
  }
}

void GraphicViewPort::SetHeightMode(unsigned char mode) {
  m_heightMode = mode;
  if (IsEnabled(ViewPortFlag_Proportional)) {
    m_widthMode = mode;
  }
}

unsigned char GraphicViewPort::GetWidthMode() const {
  return m_widthMode;
}

unsigned char GraphicViewPort::GetHeightMode() const {
  return m_heightMode;
}

void GraphicViewPort::FitWidth() {
  SetWidthMode(ViewMode_Fit);
}

void GraphicViewPort::FitHeight() {
  SetHeightMode(ViewMode_Fit);
}

void GraphicViewPort::FitSize() {
  SetViewMode(ViewMode_Fit, ViewMode_Fit);
}

void GraphicViewPort::OrigWidth() {
  SetWidthMode(ViewMode_Original);
}

void GraphicViewPort::OrigHeight() {
  SetHeightMode(ViewMode_Original);
}

void GraphicViewPort::OrigSize() {
  SetViewMode(ViewMode_Original, ViewMode_Original);
}

void GraphicViewPort::MaxWidth() {
  SetWidthMode(ViewMode_Maximum);
}

void GraphicViewPort::MaxHeight() {
  SetHeightMode(ViewMode_Maximum);
}

void GraphicViewPort::MaxSize() {
  SetViewMode(ViewMode_Maximum, ViewMode_Maximum);
}

void GraphicViewPort::MinWidth() {
  SetWidthMode(ViewMode_Minimum);
}

void GraphicViewPort::MinHeight() {
  SetHeightMode(ViewMode_Minimum);
}

void GraphicViewPort::MinSize() {
  SetViewMode(ViewMode_Minimum, ViewMode_Minimum);
}

void GraphicViewPort::SetAlignment(unsigned char alignment) {
  m_alignment = alignment;
}

unsigned char GraphicViewPort::GetAlignment() const {
  return m_alignment;
}

void GraphicViewPort::SetMode(short flags) {
  m_mode = ToFlags(flags);
}

void GraphicViewPort::Enable(short flags) {
  m_mode = static_cast<std::uint16_t>(m_mode | ToFlags(flags));
}

void GraphicViewPort::Disable(short flags) {
  m_mode = static_cast<std::uint16_t>(m_mode & ~ToFlags(flags));
}

bool GraphicViewPort::IsEnabled(short flags) const {
  return (m_mode & ToFlags(flags)) == ToFlags(flags);
}

void GraphicViewPort::SetFlag(short flag, bool on) {
  if (on) {
    Enable(flag);
  } else {
    Disable(flag);
  }
}

void GraphicViewPort::EnableScale(bool x, bool y) {
  SetFlag(ViewPortFlag_ScaleX, x);
  SetFlag(ViewPortFlag_ScaleY, y);
}

void GraphicViewPort::EnablePan(bool x, bool y) {
  SetFlag(ViewPortFlag_PanX, x);
  SetFlag(ViewPortFlag_PanY, y);
}

void GraphicViewPort::EnableMove(bool x, bool y) {
  SetFlag(ViewPortFlag_MoveX, x);
  SetFlag(ViewPortFlag_MoveY, y);
}

void GraphicViewPort::SetProportional(bool proportional) {
  SetFlag(ViewPortFlag_Proportional, proportional);
}

void GraphicViewPort::SetVisible(bool visible) {
  SetFlag(ViewPortFlag_Visible, visible);
}

void GraphicViewPort::ClipBorders(bool clip) {
  SetFlag(ViewPortFlag_ClipBorders, clip);
}

void GraphicViewPort::SetFixedGraphicArea(bool fixed) {
  SetFlag(ViewPortFlag_FixedGraphicArea, fixed);
}

bool GraphicViewPort::IsVisible() {
  return m_viewWin.IsValid() && m_graphicWin.IsValid() && IsEnabled(ViewPortFlag_Visible);
}

}  // namespace vorl
