#ifndef VORL_GUI_VIMA2DEVICE_H
#define VORL_GUI_VIMA2DEVICE_H

/// @file
/// Drawing an image into a device context.

#include <vorl/Common/dStatus.h>
#include <vorl/Data/dImaDescriptorDIB.h>
#include <vorl/Data/dImage.h>
#include <vorl/Platform/Gdi.h>

#include <cstdint>

inline namespace vorl {

/// What is transparent when an image is drawn.
enum TransparencyMode : int {
  Transparency_None = 0,
  Transparency_Color = 1,  ///< the pixels of one colour
  Transparency_Pixel = 2   ///< the pixels that have the colour of one pixel
};

/// Draws a part of an image into a rectangle of a device, stretched, and optionally with one colour
/// left out.
///
/// *Shape.* The image has one of the layouts of `dImaDescriptorDIB`. Its part is the source
/// rectangle, in pixels; where that is drawn is the target rectangle, in device coordinates. The
/// right and bottom edges belong to neither. A target whose edges are swapped mirrors the picture.
///
/// *Ownership.* The image belongs to the caller and must outlive its use here. When it is formatted
/// anew, it is described anew before it is next drawn; the rectangles stay. The bitmaps that
/// transparent drawing needs are made once; `Init` or a change of the transparency has new pixels
/// looked at.
///
/// *Errors.* "not initialized", "EraseBackground: no region specified", and the messages of
/// `dImaDescriptorDIB`.
class VORL_API vIma2Device : public BaseClass {
 public:
  /// Draws nothing.
  vIma2Device();
  /// A copy draws the same image in the same way.
  vIma2Device(const vIma2Device& source);
  vIma2Device& operator=(const vIma2Device& source);

  ClassInfo* GetClassInfo() override;
  ~vIma2Device() override;

  static vIma2Device* Create();
  static ClassInfo& CI();

  /// Takes an image. Null rectangles: the whole image, and a target like the source.
  /// `holdAspectRatio` fits the source into the target without distortion, centred; `flip` draws
  /// the image upside down. A null image: nothing is drawn any more, true. False, with the reason
  /// in the status and nothing to draw, for an image of another layout. The transparency stays.
  bool Init(dImage* image, const tagRECT* sourceRect, const tagRECT* targetRect,
            bool holdAspectRatio, bool flip);
  /// True when there is an image that can be drawn.
  bool IsInitialized();
  /// Sets the part of the image; null for the whole. False without an image.
  bool SetSourceRect(const tagRECT* rect);
  /// Sets where to draw, and fits the rectangle where the aspect ratio is held; null for the source
  /// rectangle as it is. False without an image.
  bool SetTargetRect(const tagRECT* rect);
  /// Takes effect with the next `SetTargetRect`.
  void HoldAspectRatio(bool hold);
  const tagRECT* GetImageRect() const;
  const tagRECT* GetSourceRect() const;
  const tagRECT* GetTargetRect() const;

  /// The colour table by which 1-bit and 8-bit images are drawn: see `dImaDescriptorDIB`.
  unsigned short GetPaletteSize() const;
  tagRGBQUAD* GetPalette() const;
  bool ResetPalette(bool ascending);

  /// Leaves out the pixels of a colour (0x00bbggrr).
  void EnableTransparency(unsigned long colour);
  /// Leaves out the pixels that have the colour of the one at (x, y) of the picture; outside it,
  /// black.
  void EnableTransparency(int x, int y);
  void DisableTransparency();

  /// Draws the image; false without one ("not initialized"), and without a message when the device
  /// refuses.
  bool Draw(HDC dc);
  /// Fills a region with a colour, except for a rectangle (null or empty: none). False without a
  /// region, and when the device refuses.
  bool EraseBackground(HDC dc, const tagRECT* region, const tagRECT* excluded,
                       unsigned long colour);
  /// The same around the target rectangle, if `excludeImage` is set and there is an image.
  bool EraseBackground(HDC dc, const tagRECT* region, unsigned long colour, bool excludeImage);

  /// How the last `Init`, `IsInitialized` or failed `EraseBackground` went; asking `IsInitialized`,
  /// as drawing does, sets it anew.
  const dStatus& GetStatus() const;

 protected:
  /// Gives up the transparency's bitmaps, and the settings that the new mode has no use for.
  void ResetTransparency(int mode);
  /// Shrinks the target rectangle to the source's proportions, centred in it. Swapped edges stay
  /// swapped. False unless the aspect ratio is held, and for a source without area.
  bool CorrectTargetRect();
  /// Makes the transparency's bitmaps.
  bool CreateMask(HDC dc);
  /// Draws the image without its transparent pixels.
  bool DrawTransparent(HDC dc);

 private:
  void Clear();
  bool Describe();
  bool DrawBitmaps(HDC dc);
  bool FillParts(HDC dc, const tagRECT& region, const tagRECT& excluded, HBRUSH brush);

  dStatus m_status;
  dImage* m_pImage = nullptr;
  dImaDescriptorDIB m_descriptor;
  tagRECT m_imageRect{};
  tagRECT m_sourceRect{};
  tagRECT m_targetRect{};
  bool m_holdAspectRatio = false;
  bool m_flip = false;
  HBITMAP m_imageBitmap = nullptr;
  HBITMAP m_maskBitmap = nullptr;
  std::int32_t m_transparency = Transparency_None;
  COLORREF m_transparentColour = 0;
  std::int32_t m_transparentX = 0;
  std::int32_t m_transparentY = 0;
};

}  // namespace vorl

#endif
