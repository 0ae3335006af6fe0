#ifndef VORL_GUI_VGANCHORVIEW_H
#define VORL_GUI_VGANCHORVIEW_H

/// @file
/// What the views of points and texts have in common.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/VGObjectView.h>

inline namespace vorl {

/// A view of an object that is placed by a single position, its anchor: it is hit and grabbed
/// there, and while it is dragged the anchor lies under the mouse. A drag is drawn with
/// `R2_XORPEN`.
///
/// A derived class adds what is drawn, and maps its position from and to the anchor in `Transform`.
class VORL_API VGAnchorView : public VGObjectView {
 public:
  ~VGAnchorView() override;

  using VGObjectView::IsPointOnGraphic;
  /// The point is near the anchor.
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::GetSelectionState;
  short GetSelectionState(int flags, dVect2D& point) override;
  using VGObjectView::DrawSelection;
  /// A dot at the anchor.
  void DrawSelection(HDC dc) override;
  /// The anchor as both corners.
  void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) override;

  /// Puts the anchor where the click is; that is all.
  bool OnCreate(int event, int flags, dVect2D& point) override;
  bool OnBeginMove(dVect2D& point) override;
  bool OnMove(dVect2D& point) override;
  bool OnEndMove(dVect2D& point) override;

 protected:
  /// At (0, 0).
  VGAnchorView();
  explicit VGAnchorView(const dVect2D& viewPos);
  VGAnchorView(const VGAnchorView& source);
  /// Takes the look; see `VGObjectView` for what stays. The anchor stays, too.
  VGAnchorView& operator=(const VGAnchorView& source);

  dVect2D m_viewPos;  ///< the anchor in view coordinates
};

}  // namespace vorl

#endif
