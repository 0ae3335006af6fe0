#ifndef VORL_GUI_VGRECT_H
#define VORL_GUI_VGRECT_H

/// @file
/// Rectangles and their views.

#include <vorl/GUI/VGObjectView.h>
#include <vorl/Platform/GdiFwd.h>

#include <cstdint>

inline namespace vorl {

/// Two corners, in graphic coordinates. Their order is kept: the top left one may lie below or
/// right of the other.
class VORL_API VGRect : public VGObject {
 public:
  /// Both corners (0, 0).
  VGRect();
  VGRect(const VGRect& source);
  VGRect& operator=(const VGRect& source);
  ~VGRect() override;

  /// Sets the corners: top left (x1, y1), bottom right (x2, y2).
  void Init(float x1, float y1, float x2, float y2);
  void Init(const dVect2D& topLeft, const dVect2D& bottomRight);
  void Init(const tagPOINT& topLeft, const tagPOINT& bottomRight);
  /// The bottom right corner becomes (x + width, y + height).
  void Init(const dRect& rect);

  dVect2D& TopLeft();
  const dVect2D& TopLeft() const;
  dVect2D& BottomRight();
  const dVect2D& BottomRight() const;
  /// Halfway between the corners.
  void CenterPos(dVect2D& center) const;

  /// Maps both corners from A to B, or with true from B to A. Null changes nothing.
  void Transform(Trafo2DBase* trafo, bool toGraphic);

 private:
  dVect2D m_topLeft;
  dVect2D m_bottomRight;
};

/// A rectangle that is shown and edited: dragged by its outline, pulled by its corners and by the
/// middles of its edges. An edge that is pulled over the opposite one inverts the rectangle. While
/// it is dragged it is drawn with `R2_XORPEN`.
///
/// After a change with the functions of `VGRect`, `Transform(false)` refreshes the view.
class VORL_API VGRectView : public VGRect, public VGObjectView {
 public:
  VGRectView();
  explicit VGRectView(const VGRect& rect);
  VGRectView(const VGRectView& source);
  /// As `SetData`.
  VGRectView& operator=(const VGRect& rect);
  /// Takes the rectangle and the look; see `VGObjectView` for what stays.
  VGRectView& operator=(const VGRectView& source);
  ~VGRectView() override;

  VGType GetObjType() override;
  using VGRect::Transform;
  void Transform(bool toGraphic) override;
  using VGObjectView::IsPointOnGraphic;
  /// The point lies on the outline.
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::GetSelectionState;
  /// Also chooses the edges that `OnModify` pulls.
  short GetSelectionState(int flags, dVect2D& point) override;
  using VGObjectView::DrawGraphic;
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

  /// Sets the rectangle in graphic coordinates.
  void SetData(const VGRect& rect);
  /// Sets the rectangle in view coordinates.
  void SetViewData(const VGRect& rect);
  /// The rectangle in view coordinates.
  VGRect GetViewData() const;
  void GetViewData(VGRect& rect) const;

 private:
  bool EndOperation();

  VGRect m_view;
  dVect2D m_reference;       ///< where the last event of a move was
  std::uint8_t m_edges = 0;  ///< which a modification pulls
};

}  // namespace vorl

#endif
