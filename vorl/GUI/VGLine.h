#ifndef VORL_GUI_VGLINE_H
#define VORL_GUI_VGLINE_H

/// @file
/// Infinite lines and segments, and their views.

#include <vorl/GUI/VGObjectView.h>
#include <vorl/Platform/GdiFwd.h>

inline namespace vorl {

/// What part of a line there is.
enum TLine : int {
  TLine_Infinite = 1,  ///< all of it
  TLine_Segment = 2    ///< from the position to position + vector
};

/// A position and a vector, in graphic coordinates.
class VORL_API VGLine : public VGObject {
 public:
  /// The infinite line through (0, 0) along (1, 0).
  VGLine();
  VGLine(const VGLine& source);
  VGLine& operator=(const VGLine& source);
  ~VGLine() override;

  /// The line from a position to an end.
  void Init(const dVect2D& pos, const dVect2D& end, TLine type);
  void Init(const tagPOINT& pos, const tagPOINT& end, TLine type);
  /// Another line, mapped (see `Transform`).
  void Init(const VGLine& source, Trafo2DBase* trafo, bool toGraphic);

  TLine GetType() const;
  void SetType(TLine type);
  const dVect2D& GetPos() const;
  /// The vector stays.
  void SetPos(const dVect2D& pos);
  const dVect2D& GetVector() const;
  void SetVector(const dVect2D& vector);
  /// Position + vector.
  dVect2D GetEndPos() const;
  /// The position stays.
  void SetEndPos(const dVect2D& end);
  /// The vector's length.
  float GetLength() const;

  /// Maps the line from A to B, or with true from B to A. Null changes nothing.
  void Transform(Trafo2DBase* trafo, bool toGraphic);

 private:
  TLine m_type = TLine_Infinite;
  dVect2D m_pos;
  dVect2D m_vector{1.0F, 0.0F};
};

/// A line that is shown and edited.
///
/// A segment is dragged by its middle part; its ends are pulled one by one, or, where rotating is
/// allowed, turn it about its midpoint. An infinite line is dragged, or, where rotating is allowed,
/// turned about its position and dragged by that. While it is dragged it is drawn with
/// `R2_XORPEN`.
///
/// After a change with the functions of `VGLine`, `Transform(false)` refreshes the view.
class VORL_API VGLineView : public VGLine, public VGObjectView {
 public:
  VGLineView();
  explicit VGLineView(const VGLine& line);
  VGLineView(const VGLineView& source);
  /// As `SetData`.
  VGLineView& operator=(const VGLine& line);
  /// Takes the line and the look; see `VGObjectView` for what stays.
  VGLineView& operator=(const VGLineView& source);
  ~VGLineView() override;

  VGType GetObjType() override;
  using VGLine::Transform;
  void Transform(bool toGraphic) override;
  using VGObjectView::IsPointOnGraphic;
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::GetSelectionState;
  short GetSelectionState(int flags, dVect2D& point) override;
  using VGObjectView::DrawGraphic;
  /// The line, and a dot where it is turned about if rotating is allowed.
  void DrawGraphic(HDC dc) override;
  using VGObjectView::DrawSelection;
  /// Dots at the ends of a segment.
  void DrawSelection(HDC dc) override;
  /// The box of the position and the end, also for an infinite line.
  void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) override;

  /// Begins a segment, whose end is pulled from then on. It is not to be rotated.
  bool OnCreate(int event, int flags, dVect2D& point) override;
  bool OnBeginMove(dVect2D& point) override;
  bool OnMove(dVect2D& point) override;
  bool OnEndMove(dVect2D& point) override;
  /// Takes hold of the start or the end; of the end where both are near.
  bool OnBeginModify(dVect2D& point) override;
  bool OnModify(dVect2D& point) override;
  bool OnEndModify(dVect2D& point) override;
  bool OnBeginRotate(dVect2D& point) override;
  /// Nothing changes where the point gives no direction.
  bool OnRotate(dVect2D& point) override;
  bool OnEndRotate(dVect2D& point) override;

  /// Sets the line in graphic coordinates, and its type.
  void SetData(const VGLine& line);
  /// Sets the line in view coordinates, and its type.
  void SetViewData(const VGLine& line);
  /// The line in view coordinates.
  VGLine GetViewData() const;
  void GetViewData(VGLine& line) const;

 private:
  enum class Handle { None, Start, End };

  bool IsSegment() const;
  dVect2D ViewEnd() const;
  /// What the line is turned about.
  dVect2D ViewCenter() const;
  bool EndOperation();

  dVect2D m_viewPos;
  dVect2D m_viewVector{1.0F, 0.0F};
  dVect2D m_reference;  ///< where the last event was; the centre of a rotation
  Handle m_handle = Handle::None;
};

}  // namespace vorl

#endif
