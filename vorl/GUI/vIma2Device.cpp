#include <vorl/GUI/vIma2Device.h>

#include <cmath>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dRect.h>
#include <vorl/GUI/detail/DeviceRect.h>

inline namespace vorl {

using vorl_detail::HeightOf;
using vorl_detail::ToDevice;
using vorl_detail::WidthOf;

namespace {

tagRECT RectOf(const dRect& rect) {
  return {rect.x, rect.y, ToDevice(std::int64_t{rect.x} + rect.width),
          ToDevice(std::int64_t{rect.y} + rect.height)};
}

}  // namespace

VORL_REGISTER_CLASS(vIma2Device, BaseClass);

vIma2Device::vIma2Device() = default;

vIma2Device::vIma2Device(const vIma2Device& source) : BaseClass(source) {
  vIma2Device::operator=(source);
}

vIma2Device& vIma2Device::operator=(const vIma2Device& source) {
  if (this == &source) {
    return *this;
  }
  ResetTransparency(source.m_transparency);  // the bitmaps are made again when they are needed
  m_status = source.m_status;
  m_pImage = source.m_pImage;
  m_descriptor = source.m_descriptor;
  m_imageRect = source.m_imageRect;
  m_sourceRect = source.m_sourceRect;
  m_targetRect = source.m_targetRect;
  m_holdAspectRatio = source.m_holdAspectRatio;
  m_flip = source.m_flip;
  m_transparentColour = source.m_transparentColour;
  m_transparentX = source.m_transparentX;
  m_transparentY = source.m_transparentY;
  return *this;
}

vIma2Device::~vIma2Device() {
  ResetTransparency(Transparency_None);
}

void vIma2Device::Clear() {
  m_pImage = nullptr;
  m_descriptor.Reset();
  m_imageRect = {};
  m_sourceRect = {};
  m_targetRect = {};
}

// Builds the description of the image; false with the status of the descriptor.
bool vIma2Device::Describe() {
  tagBITMAPINFO* const block = m_descriptor.Init(*m_pImage);
  if (block == nullptr) {
    m_status = m_descriptor.GetStatus();
    return false;
  }
  if (m_flip) {
    block->bmiHeader.biHeight = -block->bmiHeader.biHeight;
  }
  m_imageRect = {0, 0, static_cast<LONG>(m_pImage->GetWidth()),
                 static_cast<LONG>(m_pImage->GetHeight())};
  return true;
}

bool vIma2Device::Init(dImage* image, const tagRECT* sourceRect, const tagRECT* targetRect,
                       bool holdAspectRatio, bool flip) {
  LogContext context("vIma2Device::Init", __FILE__, __LINE__, true);
  // Copied: they may be the rectangles of this object.
  const tagRECT source = sourceRect != nullptr ? *sourceRect : tagRECT{};
  const tagRECT target = targetRect != nullptr ? *targetRect : tagRECT{};
  ResetTransparency(m_transparency);
  Clear();
  m_status = true;
  if (image == nullptr) {
    return true;
  }
  m_pImage = image;
  m_flip = flip;
  if (!Describe()) {
    Clear();
    context.Status(__LINE__, m_status);
    return false;
  }
  m_holdAspectRatio = holdAspectRatio;
  SetSourceRect(sourceRect != nullptr ? &source : nullptr);
  SetTargetRect(targetRect != nullptr ? &target : nullptr);
  m_status = true;
  return true;
}

bool vIma2Device::IsInitialized() {
  m_status = true;
  if (m_pImage == nullptr || !static_cast<const dImage*>(m_pImage)->IsValid()) {
    m_status.Set(false, "not initialized");
    return false;
  }
  if (m_descriptor.IsCurrent()) {
    return true;
  }
  ResetTransparency(m_transparency);  // the bitmaps show the image as it was
  return Describe();
}

bool vIma2Device::SetSourceRect(const tagRECT* rect) {
  if (!IsInitialized()) {
    return false;
  }
  m_sourceRect = rect != nullptr ? *rect : m_imageRect;
  return true;
}

bool vIma2Device::SetTargetRect(const tagRECT* rect) {
  if (!IsInitialized()) {
    return false;
  }
  m_targetRect = rect != nullptr ? *rect : m_sourceRect;
  if (rect != nullptr) {
    CorrectTargetRect();
  }
  return true;
}

void vIma2Device::HoldAspectRatio(bool hold) {
  m_holdAspectRatio = hold;
}

const tagRECT* vIma2Device::GetImageRect() const {
  return &m_imageRect;
}
const tagRECT* vIma2Device::GetSourceRect() const {
  return &m_sourceRect;
}
const tagRECT* vIma2Device::GetTargetRect() const {
  return &m_targetRect;
}

unsigned short vIma2Device::GetPaletteSize() const {
  return m_descriptor.GetPaletteSize();
}
tagRGBQUAD* vIma2Device::GetPalette() const {
  return m_descriptor.GetPalette();
}
bool vIma2Device::ResetPalette(bool ascending) {
  return m_descriptor.ResetPalette(ascending);
}

const dStatus& vIma2Device::GetStatus() const {
  return m_status;
}

bool vIma2Device::CorrectTargetRect() {
  if (!m_holdAspectRatio) {
    return false;
  }
  const int sourceWidth = WidthOf(m_sourceRect);
  const int sourceHeight = HeightOf(m_sourceRect);
  int width = WidthOf(m_targetRect);
  int height = HeightOf(m_targetRect);
  if (sourceWidth == width && sourceHeight == height) {
    return true;
  }
  if (sourceWidth == 0 || sourceHeight == 0) {
    return false;
  }
  const double scaleX = std::fabs(static_cast<double>(width) / sourceWidth);
  const double scaleY = std::fabs(static_cast<double>(height) / sourceHeight);
  // The smaller scale fits; the other direction is cut down to it and centred.
  if (scaleY > scaleX) {
    const int fitted = static_cast<int>(
        std::copysign(std::fabs(static_cast<double>(sourceHeight)) * scaleX, height));
    m_targetRect.top += (height - fitted) / 2;
    height = fitted;
  } else if (scaleY < scaleX) {
    const int fitted = static_cast<int>(
        std::copysign(std::fabs(static_cast<double>(sourceWidth)) * scaleY, width));
    m_targetRect.left += (width - fitted) / 2;
    width = fitted;
  }
  m_targetRect.right = ToDevice(std::int64_t{m_targetRect.left} + width);
  m_targetRect.bottom = ToDevice(std::int64_t{m_targetRect.top} + height);
  return true;
}

bool vIma2Device::Draw(HDC dc) {
  if (!IsInitialized()) {
    return false;
  }
  if (m_transparency != Transparency_None) {
    return DrawTransparent(dc);
  }
  const int imageHeight = m_descriptor.GetHeader()->bmiHeader.biHeight;
  int sourceY = m_sourceRect.top;
  int sourceHeight = HeightOf(m_sourceRect);
  int targetY = m_targetRect.top;
  int targetHeight = HeightOf(m_targetRect);
  if (imageHeight < 0) {
    // The device counts rows from the bottom: mirrored twice, the picture is upright.
    sourceY = ToDevice(std::int64_t{1} - imageHeight - sourceY);
    sourceHeight = -sourceHeight;
    targetY = ToDevice(std::int64_t{targetY} + targetHeight - 1);
    targetHeight = -targetHeight;
  }
  SetStretchBltMode(dc, COLORONCOLOR);
  return StretchDIBits(dc, m_targetRect.left, targetY, WidthOf(m_targetRect), targetHeight,
                       m_sourceRect.left, sourceY, WidthOf(m_sourceRect), sourceHeight,
                       m_descriptor.GetPixelData(), m_descriptor.GetHeader(), DIB_RGB_COLORS,
                       SRCCOPY) != 0;
}

bool vIma2Device::FillParts(HDC dc, const tagRECT& region, const tagRECT& excluded, HBRUSH brush) {
  dRect whole;
  dRect hole;
  whole = region;
  hole = excluded;
  if (hole.IsEmpty()) {
    return FillRect(dc, &region, brush) != 0;
  }
  dRect parts[4];
  whole.SubRect(hole, parts[0], parts[1], parts[2], parts[3]);
  bool filled = true;
  for (const dRect& part : parts) {
    if (!part.IsEmpty()) {
      const tagRECT rect = RectOf(part);
      filled = FillRect(dc, &rect, brush) != 0 && filled;
    }
  }
  return filled;
}

bool vIma2Device::EraseBackground(HDC dc, const tagRECT* region, const tagRECT* excluded,
                                  unsigned long colour) {
  LogContext context("vIma2Device::EraseBackground", __FILE__, __LINE__, true);
  if (region == nullptr) {
    m_status.Set(false, "EraseBackground: no region specified");
    context.Status(__LINE__, m_status);
    return false;
  }
  const HBRUSH brush = CreateSolidBrush(static_cast<COLORREF>(colour));
  const bool filled = FillParts(dc, *region, excluded != nullptr ? *excluded : tagRECT{}, brush);
  DeleteObject(brush);
  return dc != nullptr && filled;  // not every device refuses to fill none
}

bool vIma2Device::EraseBackground(HDC dc, const tagRECT* region, unsigned long colour,
                                  bool excludeImage) {
  const bool hasImage = m_pImage != nullptr && static_cast<const dImage*>(m_pImage)->IsValid();
  return EraseBackground(dc, region, excludeImage && hasImage ? &m_targetRect : nullptr, colour);
}

}  // namespace vorl
