// Drawing an image without the pixels of one colour.
//
// 1. The image becomes a device bitmap.
// 2. A monochrome mask becomes white where the bitmap has the transparent colour.
// 3. The bitmap is made black there.
// 4. On the device the mask is combined by and: it leaves the pixels below the transparent ones and
//    blackens the others. The bitmap is then combined by or.

#include <vorl/GUI/vIma2Device.h>

#include <vorl/GUI/detail/DeviceRect.h>
#include <vorl/Platform/detail/MemoryContext.h>

inline namespace vorl {

using vorl_detail::HeightOf;
using vorl_detail::MemoryContext;
using vorl_detail::ToDevice;
using vorl_detail::WidthOf;

namespace {

constexpr COLORREF kBlack = 0;
constexpr COLORREF kWhite = 0xFFFFFF;

/// Black text on a white background, for the length of a scope: the colours of a mask's pixels.
class MaskColours {
 public:
  explicit MaskColours(HDC dc)
      : m_dc(dc), m_background(SetBkColor(dc, kWhite)), m_text(SetTextColor(dc, kBlack)) {}
  MaskColours(const MaskColours&) = delete;
  MaskColours& operator=(const MaskColours&) = delete;
  bool AreSet() const { return m_background != CLR_INVALID; }
  ~MaskColours() {
    SetTextColor(m_dc, m_text);
    SetBkColor(m_dc, m_background);
  }

 private:
  HDC m_dc;
  COLORREF m_background;
  COLORREF m_text;
};

void DeleteBitmap(HBITMAP& bitmap) {
  if (bitmap != nullptr) {
    DeleteObject(bitmap);
    bitmap = nullptr;
  }
}

}  // namespace

void vIma2Device::ResetTransparency(int mode) {
  DeleteBitmap(m_imageBitmap);
  DeleteBitmap(m_maskBitmap);
  if (mode != Transparency_Color) {
    m_transparentColour = 0;
  }
  if (mode != Transparency_Pixel) {
    m_transparentX = 0;
    m_transparentY = 0;
  }
  m_transparency = mode;
}

void vIma2Device::EnableTransparency(unsigned long colour) {
  ResetTransparency(Transparency_Color);
  m_transparentColour = static_cast<COLORREF>(colour);
}

void vIma2Device::EnableTransparency(int x, int y) {
  ResetTransparency(Transparency_Pixel);
  m_transparentX = x;
  m_transparentY = y;
}

void vIma2Device::DisableTransparency() {
  ResetTransparency(Transparency_None);
}

bool vIma2Device::CreateMask(HDC dc) {
  if (!IsInitialized()) {
    return false;
  }
  DeleteBitmap(m_imageBitmap);
  DeleteBitmap(m_maskBitmap);
  const tagBITMAPINFO* const block = m_descriptor.GetHeader();
  const int width = m_imageRect.right;
  const int height = m_imageRect.bottom;
  m_imageBitmap = CreateDIBitmap(dc, &block->bmiHeader, CBM_INIT, m_descriptor.GetPixelData(),
                                 block, DIB_RGB_COLORS);
  m_maskBitmap = CreateBitmap(width, height, 1, 1, nullptr);
  if (m_imageBitmap == nullptr || m_maskBitmap == nullptr) {
    DeleteBitmap(m_imageBitmap);
    DeleteBitmap(m_maskBitmap);
    return false;
  }
  const MemoryContext image(dc, m_imageBitmap);
  const MemoryContext mask(nullptr, m_maskBitmap);
  if (m_transparency == Transparency_Pixel) {
    const COLORREF colour = GetPixel(image.Get(), m_transparentX, m_transparentY);
    m_transparentColour = colour != CLR_INVALID ? colour : kBlack;
  }
  SetBkColor(image.Get(), m_transparentColour);
  BitBlt(mask.Get(), 0, 0, width, height, image.Get(), 0, 0, SRCCOPY);
  SetBkColor(mask.Get(), m_transparentColour);
  BitBlt(image.Get(), 0, 0, width, height, mask.Get(), 0, 0, SRCINVERT);
  return true;
}

bool vIma2Device::DrawTransparent(HDC dc) {
  const MaskColours colours(dc);
  if (!colours.AreSet()) {
    return false;  // no device: bitmaps made for none would be kept for those to come
  }
  if ((m_imageBitmap == nullptr || m_maskBitmap == nullptr) && !CreateMask(dc)) {
    return false;
  }
  return DrawBitmaps(dc);
}

bool vIma2Device::DrawBitmaps(HDC dc) {
  const auto stretch = [&](HDC source, DWORD rop) {
    const std::int64_t bottom = m_sourceRect.bottom;
    // The bitmaps of a flipped image stand upside down.
    const int top = m_flip ? ToDevice(m_imageRect.bottom - bottom) : m_sourceRect.top;
    StretchBlt(dc, m_targetRect.left, m_targetRect.top, WidthOf(m_targetRect),
               HeightOf(m_targetRect), source, m_sourceRect.left, top, WidthOf(m_sourceRect),
               HeightOf(m_sourceRect), rop);
  };
  MemoryContext source(dc, m_maskBitmap);
  stretch(source.Get(), SRCAND);
  source.Select(m_imageBitmap);
  stretch(source.Get(), SRCPAINT);
  return true;
}

}  // namespace vorl
