#ifndef VORL_GUI_VGPOINT_H
#define VORL_GUI_VGPOINT_H

/// @file
/// Points and their views.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/VGObjectView.h>

inline namespace vorl {

/// A position, in graphic coordinates.
class VORL_API VGPoint : public VGObject, public dVect2D {
 public:
  /// (0, 0).
  VGPoint();
  explicit VGPoint(const dVect2D& pos);
  VGPoint(const VGPoint& source);
  VGPoint& operator=(const VGPoint& source);
  VGPoint& operator=(const dVect2D& pos);
  ~VGPoint() override;

  /// Maps the point from A to B, or with true from B to A. Null changes nothing.
  void Transform(Trafo2DBase* trafo, bool toGraphic);
};

/// A point that is shown and dragged. While it is dragged it lies under the mouse, and is drawn
/// with `R2_XORPEN`.
///
/// After a change with the functions of `VGPoint`, `Transform(false)` refreshes the view.
class VORL_API VGPointView : public VGPoint, public VGObjectView {
 public:
  VGPointView();
  explicit VGPointView(const VGPoint& point);
  VGPointView(const VGPointView& source);
  /// As `SetData`.
  VGPointView& operator=(const VGPoint& point);
  /// Takes the point and the look; see `VGObjectView` for what stays.
  VGPointView& operator=(const VGPointView& source);
  ~VGPointView() override;

  VGType GetObjType() override;
  using VGPoint::Transform;
  void Transform(bool toGraphic) override;
  using VGObjectView::IsPointOnGraphic;
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::GetSelectionState;
  short GetSelectionState(int flags, dVect2D& point) override;
  /// Maps the point anew through the viewport and draws it as a dot, as wide as the pen.
  void DrawGraphic(HDC dc, GraphicViewPort& viewPort) override;
  /// The same without mapping.
  void DrawGraphic(HDC dc) override;
  using VGObjectView::DrawSelection;
  /// A larger dot.
  void DrawSelection(HDC dc) override;
  /// The point as both corners.
  void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) override;

  /// Puts the point where the click is; that is all.
  bool OnCreate(int event, int flags, dVect2D& point) override;
  bool OnBeginMove(dVect2D& point) override;
  bool OnMove(dVect2D& point) override;
  bool OnEndMove(dVect2D& point) override;

  /// Sets the point in graphic coordinates.
  void SetData(const VGPoint& point);
  /// Sets the point in view coordinates.
  void SetViewData(const VGPoint& point);
  /// The point in view coordinates.
  VGPoint GetViewData() const;
  void GetViewData(VGPoint& point) const;

 private:
  dVect2D m_viewPos;
};

}  // namespace vorl

#endif
