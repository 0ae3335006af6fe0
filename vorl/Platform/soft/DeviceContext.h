#ifndef VORL_PLATFORM_SOFT_DEVICECONTEXT_H
#define VORL_PLATFORM_SOFT_DEVICECONTEXT_H

/// @file
/// What the functions of the interface work on. Which file defines which of them:
///
///   ContextFunctions.cpp  CreateCompatibleDC DeleteDC GetDC ReleaseDC SaveDC RestoreDC GdiFlush
///   StateFunctions.cpp    the setters of modes and colours, MoveToEx
///   ObjectFunctions.cpp   SelectObject DeleteObject GetStockObject GetCurrentObject GetObjectA,
///                         CreateSolidBrush CreatePen CreateRectRgn
///   BitmapFunctions.cpp   CreateDIBSection CreateBitmap CreateCompatibleBitmap CreateDIBitmap
///   DibFunctions.cpp      StretchDIBits GetDIBits
///   BlitFunctions.cpp     BitBlt PatBlt StretchBlt
///   PixelFunctions.cpp    SetPixel GetPixel FillRect
///   ClipFunctions.cpp     the clip region
///   the rest              LineTo Polygon Rectangle (lines and shapes), CreateFontA DrawTextA
///   (text)

#include <vorl/Platform/soft/HandleTable.h>
#include <vorl/Platform/soft/Object.h>

#include <memory>
#include <optional>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// What SaveDC saves.
struct DrawState {
  POINT position{0, 0};
  COLORREF textColour = RGB(0, 0, 0);
  COLORREF backgroundColour = RGB(255, 255, 255);
  int backgroundMode = OPAQUE;
  int rop2 = R2_COPYPEN;
  int stretchMode = BLACKONWHITE;
  int polyFillMode = ALTERNATE;
  Selected<Pen> pen;
  Selected<Brush> brush;
  Selected<Font> font;
  Selected<Bitmap> bitmap;
  std::optional<Region> clip;  ///< none: everything can be drawn on
};

/// A device context. One thread uses it at a time.
class DeviceContext : public Object {
 public:
  static constexpr ObjectKind kKind = ObjectKind::kDeviceContext;

  /// The stock objects and the state of a new context.
  explicit DeviceContext(bool isScreen);

  DrawState state;
  std::vector<DrawState> saved;
  const bool screen;  ///< from GetDC: nothing to draw on

  /// The pixels drawn on.
  const Surface& Target() const { return m_surface; }
  /// Where drawing has an effect: the clip region inside the bitmap.
  const Region& Visible() const { return m_visible; }
  /// Has to be called whenever `state.clip` or `state.bitmap` have changed.
  void Update();

  /// The pixel value in which a colour is drawn.
  std::uint32_t PixelOf(COLORREF colour) const;

 private:
  Surface m_surface;
  Region m_visible;
  std::uint8_t
      m_ownPixel[4]{};  // stands for the stock bitmap, which all new contexts have selected
};

/// The stock object of a number (`WHITE_BRUSH` ...); null when there is none.
std::shared_ptr<Object> StockObject(int index);
/// The monochrome bitmap of one pixel that new contexts have selected.
std::shared_ptr<Bitmap> StockBitmap();

}  // namespace vorl_detail
}  // namespace vorl

#endif
