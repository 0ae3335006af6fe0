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
  /// A copy draws the same image in the same way. It makes bitmaps of its own for transparency.
  vIma2Device(const vIma2Device& source);
  /// Draws from now on what `source` draws; the status is copied, too.
  vIma2Device& operator=(const vIma2Device& source);

  /// The record of the object's class: `CI()`, unless a derived class overrides it.
  ClassInfo* GetClassInfo() override;
  /// Deletes the bitmaps of the transparency; the image stays.
  ~vIma2Device() override;

  /// A new object, which the caller deletes; null without memory.
  static vIma2Device* Create();
  /// The record of this class.
  static ClassInfo& CI();

  /// Takes an image. Null rectangles: the whole image, and a target like the source.
  /// `holdAspectRatio` fits the source into the target without distortion, centred; `flip` draws
  /// the image upside down. A null image: nothing is drawn any more, true. False, with the reason
  /// in the status and nothing to draw, for an image of another layout. The transparency stays.
  bool Init(dImage* image, const tagRECT* sourceRect, const tagRECT* targetRect,
            bool holdAspectRatio, bool flip);
  /// True when there is an image that can be drawn; an image that was formatted anew is described
  /// anew, which makes its colour table an ascending ramp again. Sets the status: success, "not
  /// initialized", or the descriptor's reason, which the descriptor alone logs.
  bool IsInitialized();
  /// Sets the part of the image that is drawn, in pixels; null for the whole. It may reach beyond
  /// the image: what is missing is left out. The target stays as it is. False without an image
  /// ("not initialized"): nothing changes.
  bool SetSourceRect(const tagRECT* rect);
  /// Sets where to draw, in device coordinates, and fits the rectangle where the aspect ratio is
  /// held; null for the source rectangle as it is. False without an image ("not initialized"):
  /// nothing changes.
  bool SetTargetRect(const tagRECT* rect);
  /// Takes effect with the next `SetTargetRect`.
  void HoldAspectRatio(bool hold);
  /// (0, 0, width, height) of the image when it was described last; all zeros without one. Like the
  /// two below it is the object's own: it lives as long, and shows every later change.
  const tagRECT* GetImageRect() const;
  /// The part of the image that is drawn, in pixels; all zeros without an image.
  const tagRECT* GetSourceRect() const;
  /// Where it is drawn, in device coordinates, after fitting; all zeros without an image.
  const tagRECT* GetTargetRect() const;

  /// The entries of the colour table by which 1-bit and 8-bit images are drawn: 2 or 256; 0 for
  /// other images and without one.
  unsigned short GetPaletteSize() const;
  /// That colour table, to be read and changed; null without one. Valid until the image is
  /// described anew: by `Init`, or when it was formatted anew and is drawn.
  tagRGBQUAD* GetPalette() const;
  /// Makes the colour table a grey ramp from black to white, or from white to black. False without
  /// one. What transparency has made of the image stays as it is until it is set anew.
  bool ResetPalette(bool ascending);

  /// Leaves out the pixels of a colour (0x00bbggrr), as the device shows it.
  void EnableTransparency(unsigned long colour);
  /// Leaves out the pixels that have the colour of the one at (x, y) of the picture, the top row
  /// being 0 (of a flipped image the bottom row); outside it, black.
  void EnableTransparency(int x, int y);
  /// Draws all pixels again.
  void DisableTransparency();

  /// Draws the source rectangle into the target rectangle, within the clip region. Pixels that have
  /// no place are left out (the stretch mode becomes COLORONCOLOR); with transparency the device's
  /// stretch mode decides, and its colours are restored. False without an image ("not
  /// initialized"), and without a message when the device refuses.
  bool Draw(HDC dc);
  /// Fills a region with a colour (0x00bbggrr), except for a rectangle (null or empty: none), both
  /// in device coordinates. Needs no image. False without a region ("EraseBackground: no region
  /// specified", logged), and without a message when the device refuses.
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
