#include <cli/SheetCanvas.h>
#include <study/Error.h>

#include <algorithm>

namespace cli {
namespace {

constexpr int kSmallestText = 11;  ///< pixels; smaller ones can't be read
constexpr int kSheetPerText = 72;
constexpr int kTextPerPen = 18;

HFONT MakeFont(int height, int weight) {
  return CreateFontA(-height, 0, 0, 0, weight, 0, 0, 0, DEFAULT_CHARSET, OUT_DEFAULT_PRECIS,
                     CLIP_DEFAULT_PRECIS, ANTIALIASED_QUALITY, VARIABLE_PITCH | FF_SWISS, "Arial");
}

}  // namespace

SheetCanvas::SheetCanvas(int width, int height)
    : m_bitmap(width, height, 3, 8), m_dc(CreateCompatibleDC(nullptr)) {
  const int text = std::max(kSmallestText, std::min(width, height) / kSheetPerText);
  m_font = MakeFont(text, FW_NORMAL);
  m_bold = MakeFont(text, FW_BOLD);
  if (m_bitmap.GetHandle() != nullptr && m_dc != nullptr) {
    m_oldBitmap = SelectObject(m_dc, m_bitmap.GetHandle());
  }
  if (m_oldBitmap == nullptr || m_font == nullptr || m_bold == nullptr) {
    DeleteDC(m_dc);
    DeleteObject(m_font);
    DeleteObject(m_bold);
    throw study::Error("there is not enough memory for a sheet of " + std::to_string(width) +
                       " x " + std::to_string(height) + " pixels");
  }
  SetBkMode(m_dc, TRANSPARENT);  // what lies below shows in the gaps of dotted lines
  m_lineHeight = std::max(1, SizeOf("Mg").height);
}

SheetCanvas::~SheetCanvas() {
  SelectObject(m_dc, m_oldBitmap);
  DeleteDC(m_dc);
  DeleteObject(m_font);
  DeleteObject(m_bold);
}

TextSize SheetCanvas::SizeOf(const std::string& text, bool isBold) const {
  const HGDIOBJ old = SelectObject(m_dc, GetFont(isBold));
  tagRECT box{0, 0, 0, 0};
  DrawTextA(m_dc, text.c_str(), -1, &box, DT_CALCRECT);
  SelectObject(m_dc, old);
  return {static_cast<int>(box.right), static_cast<int>(box.bottom)};
}

int SheetCanvas::GetPenWidth() const {
  return std::max(1, m_lineHeight / kTextPerPen);
}

const dImage& SheetCanvas::GetPicture() const {
  GdiFlush();
  return m_bitmap;
}

}  // namespace cli
