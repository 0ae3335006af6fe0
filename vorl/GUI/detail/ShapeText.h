#ifndef VORL_GUI_DETAIL_SHAPETEXT_H
#define VORL_GUI_DETAIL_SHAPETEXT_H

/// @file
/// What the shapes write with, and where aligned text stands.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/detail/DeviceRect.h>
#include <vorl/GUI/detail/Truncated.h>

inline namespace vorl {
namespace vorl_detail {

/// Colours, background mode and font of a device context while a shape writes. A null font leaves
/// the context's own.
class TextStyle {
 public:
  TextStyle(HDC dc, long color, int bkMode, long bkColor, HFONT font)
      : m_dc(dc),
        m_oldMode(SetBkMode(dc, bkMode)),
        m_oldColor(SetTextColor(dc, static_cast<COLORREF>(color))),
        m_oldBkColor(SetBkColor(dc, static_cast<COLORREF>(bkColor))),
        m_oldFont(font != nullptr ? SelectObject(dc, font) : nullptr) {}
  TextStyle(const TextStyle&) = delete;
  TextStyle& operator=(const TextStyle&) = delete;
  ~TextStyle() {
    if (m_oldFont != nullptr) {
      SelectObject(m_dc, m_oldFont);
    }
    SetBkColor(m_dc, m_oldBkColor);
    SetTextColor(m_dc, m_oldColor);
    if (m_oldMode != 0) {
      SetBkMode(m_dc, m_oldMode);
    }
  }

 private:
  HDC m_dc;
  int m_oldMode;
  COLORREF m_oldColor;
  COLORREF m_oldBkColor;
  HGDIOBJ m_oldFont;
};

/// How much of its extent a text is shifted by the two bits of its alignment: its first edge, its
/// last edge, the first again, or its middle stands at the anchor.
inline double AlignmentFactor(int bits) {
  constexpr double kFactors[] = {0.0, -1.0, 0.0, -0.5};
  return kFactors[static_cast<unsigned>(bits) & 3U];
}

/// The box of a text as the context's font makes it: bits 0 and 1 of the alignment place it
/// vertically, bits 2 and 3 horizontally. The format is the one it will be drawn with.
inline tagRECT TextBox(HDC dc, const char* text, const dVect2D& anchor, int alignment,
                       unsigned format = 0) {
  tagRECT size{0, 0, 0, 0};
  DrawTextA(dc, text, -1, &size, DT_CALCRECT | format);
  const double factorY = AlignmentFactor(alignment);
  const double factorX = AlignmentFactor(static_cast<int>(static_cast<unsigned>(alignment) >> 2U));
  const int top = Truncated<int>(factorY * size.bottom + anchor.y);
  const int left = Truncated<int>(factorX * size.right + anchor.x);
  return {left, top, ToDevice(std::int64_t{left} + size.right),
          ToDevice(std::int64_t{top} + size.bottom)};
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
