#ifndef VORL_GUI_VGPOINT_H
#define VORL_GUI_VGPOINT_H

/// @file
/// Points and their views.

#include <vorl/GUI/VGAnchorView.h>

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

/// A point that is shown and dragged: see `VGAnchorView`. The dot that selects it is 5 wide, and
/// does not show on one that is larger.
///
/// After a change with the functions of `VGPoint`, `Transform(false)` refreshes the view.
class VORL_API VGPointView : public VGPoint, public VGAnchorView {
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
  /// Maps the point anew through the viewport and draws it as a dot, as wide as the pen.
  void DrawGraphic(HDC dc, GraphicViewPort& viewPort) override;
  /// The same without mapping.
  void DrawGraphic(HDC dc) override;

  /// Sets the point in graphic coordinates.
  void SetData(const VGPoint& point);
  /// Sets the point in view coordinates.
  void SetViewData(const VGPoint& point);
  /// The point in view coordinates.
  VGPoint GetViewData() const;
  void GetViewData(VGPoint& point) const;
};

}  // namespace vorl

#endif
