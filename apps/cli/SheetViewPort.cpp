#include <cli/SheetViewPort.h>

namespace cli {
namespace {

constexpr float kScaleLimit = 1e6F;

}  // namespace

tagRECT WithoutMargins(const tagRECT& rect, const Margins& margins) {
  return {rect.left + margins.left, rect.top + margins.top, rect.right - margins.right,
          rect.bottom - margins.bottom};
}

void SheetViewPort::Place(const Rect2D& shown, const tagRECT& rect, const Margins& margins,
                          bool isProportional) {
  m_viewPort.Init(shown, shown, Rect2D(rect));
  m_viewPort.SetBorder(margins.left, margins.top, margins.right, margins.bottom);
  m_viewPort.SetBgColor(static_cast<long>(colour::kPicture));
  m_viewPort.SetBorderColor(static_cast<long>(colour::kSheet));
  m_viewPort.SetProportional(isProportional);
  m_viewPort.SetScaleFactors(1, 1, 1 / kScaleLimit, kScaleLimit, 1 / kScaleLimit, kScaleLimit);
  m_viewPort.UpdateTransformation();
}

// Each step begins with the whole sheet to draw on.
void SheetViewPort::Draw() {
  const HDC dc = m_canvas.GetDC();
  {
    const SavedState state(dc);
    m_viewPort.EraseBkgnd(dc, nullptr, false);
  }
  {
    const SavedState state(dc);
    m_viewPort.ClipBorders(true);
    m_viewPort.Draw(dc, &m_inside, nullptr, false);
  }
  const SavedState state(dc);
  m_viewPort.ClipBorders(false);
  m_viewPort.Draw(dc, &m_around, nullptr, false);
}

}  // namespace cli
