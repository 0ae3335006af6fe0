#ifndef VORL_GUI_VGCROSSCURSORVIEW_H
#define VORL_GUI_VGCROSSCURSORVIEW_H

/// @file
/// Cross-hair cursors.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/VGObjectView.h>

#include <cstdint>

inline namespace vorl {

/// Which lines of a cross cursor are shown.
enum CursorMode : short { CursorMode_First = 1, CursorMode_Second = 2, CursorMode_Both = 3 };

/// A position at which two infinite lines cross, and that is shown and edited: dragged by either
/// line, or, with the shift key and where rotating is allowed, turned about the position. While it
/// is dragged it is drawn with `R2_XORPEN`.
///
/// *Frame.* The object is its own position, in graphic coordinates, as are the directions of the
/// lines (their lengths do not matter). After a change of the position, `Transform(false)`
/// refreshes the view position; drawing does so too.
class VORL_API VGCrossCursorView : public dVect2D, public VGObjectView {
 public:
  /// At (0, 0), both lines along the axes and shown, in red 224, green 224, blue 0.
  VGCrossCursorView();
  VGCrossCursorView(const VGCrossCursorView& source);
  /// Takes the cursor and the look; see `VGObjectView` for what stays.
  VGCrossCursorView& operator=(const VGCrossCursorView& source);
  ~VGCrossCursorView() override;

  VGType GetObjType() override;
  void Transform(bool toGraphic) override;
  using VGObjectView::IsPointOnGraphic;
  /// The point lies on a line that is shown.
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::GetSelectionState;
  /// On a line, with the shift key, it is grabbed for rotating, else for moving.
  short GetSelectionState(int flags, dVect2D& point) override;
  using VGObjectView::DrawGraphic;
  /// The lines that are shown, over all of the clip region, and a dot in the pen's colour at the
  /// position when the mode is exactly `CursorMode_Both`. Nothing without a device context.
  void DrawGraphic(HDC dc) override;
  /// The view position as both corners: the lines have no end.
  void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) override;

  /// Puts the cursor where the click is, from where it is moved. It is not to be rotated.
  bool OnCreate(int event, int flags, dVect2D& point) override;
  bool OnBeginMove(dVect2D& point) override;
  /// Puts the position under the mouse.
  bool OnMove(dVect2D& point) override;
  bool OnEndMove(dVect2D& point) override;
  bool OnBeginRotate(dVect2D& point) override;
  /// Turns both directions by the angle, in graphic coordinates, from where the button was pressed
  /// to the point, seen from the position. Nothing changes where the point gives no direction; a
  /// press that gave none is replaced by the first point that does.
  bool OnRotate(dVect2D& point) override;
  bool OnEndRotate(dVect2D& point) override;

  /// Sets the first direction; with index 2 the second one as well.
  void SetCursorOrientation(short index, const dVect2D& direction);
  void SetCursorOrientation(const dVect2D& first, const dVect2D& second);
  /// The second direction for index 2, else the first.
  const dVect2D& GetCursorOrientation(short index) const;
  /// Sets the colour (0x00bbggrr, in the lower 32 bits) of the first line; with index 2 that of the
  /// second one as well.
  void SetCursorColor(short index, long color);
  void SetCursorColors(long first, long second);
  /// That of the second line for index 2, else of the first.
  long GetCursorColor(short index) const;
  /// Bits of `CursorMode`.
  void SetCursorMode(short mode);
  short GetCursorMode() const;
  /// The position in view coordinates. `ViewDataChanged` makes it the position.
  void SetViewPos(const dVect2D& pos);
  const dVect2D& GetViewPos() const;

 private:
  bool Shows(CursorMode line) const;
  bool EndOperation();
  /// The way from the cursor's position to a point of the view, in graphic coordinates.
  dVect2D WayTo(const dVect2D& point) const;

  std::int16_t m_mode = CursorMode_Both;
  dVect2D m_first{1.0F, 0.0F};
  dVect2D m_second{0.0F, 1.0F};
  dVect2D m_viewPos;
  std::uint32_t m_firstColor = 0xE0E0;
  std::uint32_t m_secondColor = 0xE0E0;
  dVect2D m_pressed;     ///< where a rotation began
  dVect2D m_startFirst;  ///< the directions at that time
  dVect2D m_startSecond;
};

}  // namespace vorl

#endif
