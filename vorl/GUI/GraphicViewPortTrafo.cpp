// How modes, limits and alignment lead to the transformation, and zooming and panning it.

#include <vorl/GUI/GraphicViewPort.h>

#include <algorithm>
#include <cmath>

#include <vorl/Data/detail/Single.h>

inline namespace vorl {

using vorl_detail::Single;

namespace {

/// The scale at which `extent` graphic units fill so many pixels. Scales are single precision
/// throughout: one that has been reached is recognised as such.
float ScaleOf(double pixels, double extent, float original) {
  return Single(std::abs(pixels / (extent * original)));
}

/// The scale that a mode asks for. An area without extent fits any scale.
float TargetScale(std::uint8_t mode, float current, float fit, float minimum, float maximum) {
  switch (mode) {
    case ViewMode_Fit:
      return std::isfinite(fit) ? fit : current;
    case ViewMode_Original:
      return 1.0F;
    case ViewMode_Maximum:
      return maximum;
    case ViewMode_Minimum:
      return minimum;
    default:
      return current;
  }
}

void Widen(float& minimum, float& maximum, float scale) {
  minimum = scale < minimum ? scale : minimum;
  maximum = scale > maximum ? scale : maximum;
}

/// How the size of the window has to change for its scale to change. Scales of 0 or beyond all
/// numbers cannot be reached: the size stays.
float SizeFactor(float current, float target) {
  const float factor = current / target;
  return std::isfinite(factor) && factor > 0.0F ? factor : 1.0F;
}

/// The minimum has the last word.
float Limited(float scale, float minimum, float maximum) {
  scale = scale > maximum ? maximum : scale;
  return scale < minimum ? minimum : scale;
}

/// What takes a window back that sticks out of the range on one side only: the shorter way of the
/// two. `first` and `second` are the ways from its edges to those of the range.
double WayInside(double first, double second) {
  if (!(first * second > 0.0)) {
    return 0.0;
  }
  return std::abs(second) <= std::abs(first) ? second : first;
}

/// The way to the first edge (rule 1), the second (2) or the centre (3) of the range.
double AlignedWay(int rule, double first, double second, double otherwise) {
  switch (rule) {
    case 1:
      return first;
    case 2:
      return second;
    case 3:
      return (first + second) * 0.5;
    default:
      return otherwise;
  }
}

}  // namespace

void GraphicViewPort::UpdateTransformation() {
  UpdateTransformation(m_graphicWin, m_viewWin);
}

void GraphicViewPort::UpdateTransformation(Rect2D& window, const Rect2D& view) {
  const Rect2D newView(view);  // both may be one rectangle
  const Rect2D draw = WithoutBorders(newView);
  if (newView.IsEmpty() || draw.IsEmpty()) {
    return;
  }
  if (window.IsEmpty()) {
    if (m_graphicArea.IsEmpty()) {
      m_graphicArea = draw;
    }
    window = m_graphicArea;
  }
  CorrectSize(window, draw);
  CorrectPosition(window);
  m_graphicWin = window;
  m_viewWin = newView;
  m_trafo.Set(m_graphicWin, draw);
  TakeMapFromHandlers();
  if (m_interface != nullptr) {
    m_interface->OnTrafoChanged(this);
  }
}

Rect2D GraphicViewPort::WithoutBorders(const Rect2D& view) const {
  const dVect2D topLeft = view.GetTL();
  const dVect2D bottomRight = view.GetBR();
  return Rect2D(topLeft.x + static_cast<float>(m_leftBorder),
                topLeft.y + static_cast<float>(m_topBorder),
                bottomRight.x - static_cast<float>(m_rightBorder),
                bottomRight.y - static_cast<float>(m_bottomBorder));
}

bool GraphicViewPort::CorrectSize(Rect2D& window, const Rect2D& draw) {
  const float currentX = ScaleOf(draw.Width(), window.Width(), m_origScaleX);
  const float currentY = ScaleOf(draw.Height(), window.Height(), m_origScaleY);
  const float fitX = ScaleOf(draw.Width(), m_graphicArea.Width(), m_origScaleX);
  const float fitY = ScaleOf(draw.Height(), m_graphicArea.Height(), m_origScaleY);
  float x = TargetScale(m_widthMode, currentX, fitX, m_minScaleX, m_maxScaleX);
  float y = TargetScale(m_heightMode, currentY, fitY, m_minScaleY, m_maxScaleY);
  if (IsEnabled(ViewPortFlag_Proportional)) {
    x = y = std::min(x, y);
    m_minScaleX = m_minScaleY = std::min(m_minScaleX, m_minScaleY);
    m_maxScaleX = m_maxScaleY = std::max(m_maxScaleX, m_maxScaleY);
  }
  if (m_widthMode == ViewMode_Fit || m_widthMode == ViewMode_Original) {
    Widen(m_minScaleX, m_maxScaleX, x);
  }
  if (m_heightMode == ViewMode_Fit || m_heightMode == ViewMode_Original) {
    Widen(m_minScaleY, m_maxScaleY, y);
  }
  x = Limited(x, m_minScaleX, m_maxScaleX);
  y = Limited(y, m_minScaleY, m_maxScaleY);
  if (currentX == x && currentY == y) {
    return false;
  }
  window.Scale(SizeFactor(currentX, x), SizeFactor(currentY, y));
  return true;
}

Rect2D GraphicViewPort::ScrollRange() const {
  return IsEnabled(ViewPortFlag_FixedGraphicArea) ? m_graphicArea : m_graphicArea | m_graphicWin;
}

bool GraphicViewPort::CorrectPosition(Rect2D& window) const {
  const Rect2D united = ScrollRange();
  const Rect2D& rangeX = m_widthMode == ViewMode_Fit ? m_graphicArea : united;
  const Rect2D& rangeY = m_heightMode == ViewMode_Fit ? m_graphicArea : united;
  const double left = static_cast<double>(rangeX.GetTL().x) - window.GetTL().x;
  const double right = static_cast<double>(rangeX.GetBR().x) - window.GetBR().x;
  const double top = static_cast<double>(rangeY.GetTL().y) - window.GetTL().y;
  const double bottom = static_cast<double>(rangeY.GetBR().y) - window.GetBR().y;
  double dx = WayInside(left, right);
  double dy = WayInside(top, bottom);
  if (std::abs(m_graphicWin.Width()) > std::abs(rangeX.Width())) {
    dx = AlignedWay(m_alignment >> 2 & 3, left, right, dx);
  }
  if (std::abs(m_graphicWin.Height()) > std::abs(rangeY.Height())) {
    dy = AlignedWay(m_alignment & 3, top, bottom, dy);
  }
  if (dx == 0.0 && dy == 0.0) {
    return false;
  }
  window.Move(Single(dx), Single(dy));
  return true;
}

void GraphicViewPort::CorrectScaleLimits(const Rect2D& window, const Rect2D& view) {
  Widen(m_minScaleX, m_maxScaleX, Single(view.Width() / (window.Width() * m_origScaleX)));
  Widen(m_minScaleY, m_maxScaleY, Single(view.Height() / (window.Height() * m_origScaleY)));
}

bool GraphicViewPort::DoScale(float factorX, float factorY) {
  factorX = factorX == 0.0F ? 1.0F : factorX;
  factorY = factorY == 0.0F ? 1.0F : factorY;
  if (factorX != 1.0F) {
    m_widthMode = ViewMode_Free;
  }
  if (factorY != 1.0F) {
    m_heightMode = ViewMode_Free;
  }
  // The view window with its borders, and double precision: the limits are not to be passed by
  // however little.
  const double x = std::abs(m_viewWin.Width() / (m_graphicWin.Width() * m_origScaleX)) * factorX;
  const double y = std::abs(m_viewWin.Height() / (m_graphicWin.Height() * m_origScaleY)) * factorY;
  const bool legalX = x >= m_minScaleX && x <= m_maxScaleX;
  const bool legalY = y >= m_minScaleY && y <= m_maxScaleY;
  if (legalX && legalY) {
    m_graphicWin.Scale(1.0F / factorX, 1.0F / factorY, m_graphicRefPos);
  }
  return true;
}

bool GraphicViewPort::DoPan(float fractionX, float fractionY) {
  m_graphicWin.Move(Single(fractionX * m_graphicWin.Width()),
                    Single(fractionY * m_graphicWin.Height()));
  UpdateTransformation();
  return true;
}

bool GraphicViewPort::DoMove(float dx, float dy) {
  m_viewWin.Move(dx, dy);
  UpdateTransformation();
  return true;
}

}  // namespace vorl
