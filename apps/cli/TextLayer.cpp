#include <cli/TextLayer.h>
#include <vorl/GUI/VGText.h>

#include <algorithm>

namespace cli {
namespace {

constexpr int kLinePerGap = 3;  ///< to the left and right of texts

}  // namespace

TextLayer::TextLayer(const SheetCanvas& canvas, const tagRECT& bounds)
    : m_canvas(canvas),
      m_bounds(bounds),
      m_viewPort(Rect2D(bounds), Rect2D(bounds), Rect2D(bounds)) {
  m_viewPort.UpdateTransformation();  // graphic coordinates are pixels
  m_viewPort.AddGraphic(&m_layer);
}

bool TextLayer::IsFree(const tagRECT& box) const {
  const int gap = m_canvas.GetLineHeight() / kLinePerGap;
  return box.left >= m_bounds.left && box.right <= m_bounds.right && box.top >= m_bounds.top &&
         box.bottom <= m_bounds.bottom &&
         std::none_of(m_taken.begin(), m_taken.end(), [&box, gap](const tagRECT& taken) {
           return box.left < taken.right + gap && taken.left < box.right + gap &&
                  box.top < taken.bottom && taken.top < box.bottom;
         });
}

bool TextLayer::Write(const std::string& text, int x, int y, const TextLook& look) {
  const TextSize size = m_canvas.SizeOf(text, look.isBold);
  const tagRECT box{x, y, x + size.width, y + size.height};
  if (!IsFree(box)) {
    return false;
  }
  auto& view = AddTo<VGTextView>(m_layer, look.colour);
  view = text.c_str();
  view.SetFont(m_canvas.GetFont(look.isBold));
  view.SetTransparent(!look.isBacked);
  view.SetBgColor(static_cast<long>(colour::kPicture));
  // In the middle of the pixel, which no rounding moves.
  view.SetPos(static_cast<float>(x) + 0.5F, static_cast<float>(y) + 0.5F, 0);
  Take(box);
  return true;
}

bool TextLayer::WriteBefore(const std::string& text, int right, int y, const TextLook& look) {
  return Write(text, right - m_canvas.SizeOf(text, look.isBold).width, y, look);
}

void TextLayer::Draw() {
  const SavedState state(m_canvas.GetDC());
  m_viewPort.Draw(m_canvas.GetDC(), nullptr, false);
}

}  // namespace cli
