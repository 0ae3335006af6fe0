#ifndef VORL_GUI_VGBITMAPVIEW_H
#define VORL_GUI_VGBITMAPVIEW_H

/// @file
/// Images as graphic objects.

#include <vorl/GUI/Rect2D.h>
#include <vorl/GUI/Trafo2D.h>
#include <vorl/GUI/VGObjectView.h>
#include <vorl/GUI/vIma2Device.h>

#include <cstdint>

inline namespace vorl {

/// An image that lies on a rectangle of the graphic plane, the base rectangle, and that scrolls and
/// zooms with it. Dragged by its inside, and pulled larger and smaller by its corners and the
/// middles of its edges.
///
/// *Frame.* The base rectangle is in graphic coordinates; the view rectangle is the same in view
/// coordinates. The bitmap transformation leads from graphic coordinates (A) to pixels (B), which
/// count from the image's position: it maps the base rectangle onto (x, y)-(x + width, y + height).
/// An image is drawn upright wherever its rectangle lies, also where the corners are swapped.
///
/// *Changes.* After a change through `BaseRect()`, `UpdateBitmapTrafo()` and `Transform(false)`
/// bring the rest up to date; after the image was formatted anew or replaced, `Init` or
/// `UpdateBitmapTrafo()` and `UpdateViewer()`.
///
/// *Ownership.* The image belongs to the caller and must outlive its use here. It has one of the
/// layouts of `dImaDescriptorDIB`; with any other, and with none, the background is shown in its
/// place.
class VORL_API VGBitmapView : public VGObjectView {
 public:
  /// No image, on an empty rectangle.
  VGBitmapView();
  /// A copy shows the same image in the same way.
  VGBitmapView(const VGBitmapView& source);
  /// Takes the image, its rectangle and the look; see `VGObjectView` for what stays.
  VGBitmapView& operator=(const VGBitmapView& source);
  ~VGBitmapView() override;

  /// Shows an image on its own pixel rectangle: its position and its size. Null: none, on an empty
  /// rectangle. False, with the reason in the status, for an image that cannot be drawn.
  bool Init(dImage* image);
  /// The same on a given base rectangle, also for null.
  bool Init(dImage* image, float left, float top, float right, float bottom);
  bool Init(dImage* image, const dVect2D& topLeft, const dVect2D& bottomRight);
  bool Init(dImage* image, const tagPOINT& topLeft, const tagPOINT& bottomRight);
  dImage* GetImage() const;
  Rect2D& BaseRect();
  const Rect2D& BaseRect() const;
  void BaseRect(Rect2D& rect) const;
  void ViewRect(Rect2D& rect) const;

  /// Map from graphic coordinates to pixels, in place or into `target`. Integers are mapped as the
  /// maps of the plane do: 0.5 is added first, the decimals are cut off in the end.
  void Graphic2Bitmap(dVect2D& point) const;
  void Graphic2Bitmap(tagPOINT& point) const;
  void Graphic2Bitmap(Rect2D& rect) const;
  void Graphic2Bitmap(tagRECT& rect) const;
  void Graphic2Bitmap(const dVect2D& source, dVect2D& target) const;
  void Graphic2Bitmap(const tagPOINT& source, tagPOINT& target) const;
  void Graphic2Bitmap(const Rect2D& source, Rect2D& target) const;
  void Graphic2Bitmap(const tagRECT& source, tagRECT& target) const;
  /// The way back.
  void Bitmap2Graphic(dVect2D& point) const;
  void Bitmap2Graphic(tagPOINT& point) const;
  void Bitmap2Graphic(Rect2D& rect) const;
  void Bitmap2Graphic(tagRECT& rect) const;
  void Bitmap2Graphic(const dVect2D& source, dVect2D& target) const;
  void Bitmap2Graphic(const tagPOINT& source, tagPOINT& target) const;
  void Bitmap2Graphic(const Rect2D& source, Rect2D& target) const;
  void Bitmap2Graphic(const tagRECT& source, tagRECT& target) const;

  /// What is transparent: see `vIma2Device`. Another image changes nothing in that.
  void EnableTransparency(unsigned long colour);
  void EnableTransparency(int x, int y);
  void DisableTransparency();
  /// The colour table by which 1-bit and 8-bit images are drawn: see `dImaDescriptorDIB`. It begins
  /// as a grey ramp, also with each `Init` and `UpdateViewer`.
  tagRGBQUAD* GetPalette() const;
  unsigned short GetPaletteSize() const;
  bool ResetPalette(bool ascending);
  /// Prepares drawing the image as it is now. False, with the reason in the status, when it cannot
  /// be drawn.
  bool UpdateViewer();
  /// Computes the bitmap transformation; the identity without an image, and when the base rectangle
  /// has no area.
  void UpdateBitmapTrafo();
  /// How preparing or drawing the image went: see `vIma2Device`.
  const dStatus& GetStatus() const;

  VGType GetObjType() override;
  /// With true, the bitmap transformation follows the base rectangle.
  void Transform(bool toGraphic) override;
  using VGObjectView::IsPointOnGraphic;
  /// The point lies in the view rectangle or on its edge, whatever the tolerance.
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::GetSelectionState;
  /// Also chooses the edges that `OnModify` pulls.
  short GetSelectionState(int flags, dVect2D& point) override;
  /// The part of the image that the draw window of the viewport shows. Left and top are rounded
  /// towards zero, both on the device and in the image, and sizes to the nearest number. Without an
  /// image that can be drawn, the viewport's background. Nothing without a device context.
  void DrawGraphic(HDC dc, GraphicViewPort& viewPort) override;
  /// The same with all of the image, and a black background.
  void DrawGraphic(HDC dc) override;
  using VGObjectView::DrawSelection;
  /// A dot at each of the eight handles.
  void DrawSelection(HDC dc) override;
  void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) override;

  /// Begins a rectangle, whose bottom right corner is pulled from then on.
  bool OnCreate(int event, int flags, dVect2D& point) override;
  bool OnBeginMove(dVect2D& point) override;
  bool OnMove(dVect2D& point) override;
  bool OnEndMove(dVect2D& point) override;
  bool OnBeginModify(dVect2D& point) override;
  bool OnModify(dVect2D& point) override;
  bool OnEndModify(dVect2D& point) override;

 private:
  bool Show(dImage* image, const Rect2D& rect);
  void DrawPart(HDC dc, const Rect2D& target, Trafo2DBase& map, unsigned long background);

  dImage* m_pImage = nullptr;
  Rect2D m_baseRect;
  Rect2D m_viewRect;
  TrafoST2D m_bitmapTrafo;
  vIma2Device m_viewer;
  dVect2D m_reference;       ///< where the last event of a move was
  std::uint8_t m_edges = 0;  ///< which a modification pulls
};

}  // namespace vorl

#endif
