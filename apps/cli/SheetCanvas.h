#ifndef VORL_APPS_CLI_SHEETCANVAS_H
#define VORL_APPS_CLI_SHEETCANVAS_H

/// @file
/// What sheets are drawn on and with.

#include <vorl/Data/dDIB.h>
#include <vorl/GUI/GraphicHandler.h>
#include <vorl/Platform/Gdi.h>

#include <memory>
#include <new>
#include <string>

namespace cli {

/// The colours of a sheet, 0x00bbggrr.
namespace colour {
inline constexpr COLORREF kSheet = 0x1E1B1A;
inline constexpr COLORREF kPicture = 0x000000;
inline constexpr COLORREF kFrame = 0x55504C;
inline constexpr COLORREF kQuiet = 0x8C8782;
inline constexpr COLORREF kText = 0xB9B4AF;
inline constexpr COLORREF kStrong = 0xEBE8E6;
inline constexpr COLORREF kAxial = 0x6464DC;
inline constexpr COLORREF kCoronal = 0x78B95F;
inline constexpr COLORREF kSagittal = 0xE69B5A;
inline constexpr COLORREF kMeasured = 0x30AAFF;
}  // namespace colour

/// What a text takes, in pixels.
struct TextSize {
  int width = 0;
  int height = 0;
};

/// A bitmap in memory with a device context on it, and the fonts of a sheet.
class SheetCanvas {
 public:
  /// Throws `study::Error` when there is no memory for it.
  SheetCanvas(int width, int height);
  SheetCanvas(const SheetCanvas&) = delete;
  SheetCanvas& operator=(const SheetCanvas&) = delete;
  ~SheetCanvas();

  HDC GetDC() const { return m_dc; }
  HFONT GetFont(bool isBold = false) const { return isBold ? m_bold : m_font; }
  int GetLineHeight() const { return m_lineHeight; }
  /// Of lines, which grow with the text.
  int GetPenWidth() const;
  /// What a text takes; of several lines, the widest.
  TextSize SizeOf(const std::string& text, bool isBold = false) const;
  /// The sheet as far as it is drawn.
  const dImage& GetPicture() const;

 private:
  dDIB m_bitmap;
  HDC m_dc = nullptr;
  HGDIOBJ m_oldBitmap = nullptr;
  HFONT m_font = nullptr;
  HFONT m_bold = nullptr;
  int m_lineHeight = 0;
};

/// Keeps the state of a device context, the clip region above all, for what follows.
class SavedState {
 public:
  explicit SavedState(HDC dc) : m_dc(dc), m_id(SaveDC(dc)) {}
  SavedState(const SavedState&) = delete;
  SavedState& operator=(const SavedState&) = delete;
  ~SavedState() { RestoreDC(m_dc, m_id); }

 private:
  HDC m_dc;
  int m_id;
};

/// Makes a visible object that the layer owns.
template <class View>
View& AddTo(GraphicHandler& layer, COLORREF colour) {
  auto view = std::make_unique<View>();
  view->SetViewState(VGViewState_Visible);
  view->SetPenColor(static_cast<int>(colour));
  View& added = *view;
  if (!layer.AddObject(view.get())) {
    throw std::bad_alloc();
  }
  view.release()->SetDynamicCreationFlag();
  return added;
}

}  // namespace cli

#endif
