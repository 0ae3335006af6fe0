#ifndef VORL_GUI_VGCURVE_H
#define VORL_GUI_VGCURVE_H

/// @file
/// Sampled curves and their views.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/VGObjectView.h>

#include <cstdint>
#include <memory>

inline namespace vorl {

/// Whose values a curve shows.
enum CurveStorageMode : int {
  CurveStorageMode_Copy = 1,      ///< a copy of its own
  CurveStorageMode_Reference = 2  ///< the caller's array, which must outlive the curve
};

/// How a curve is drawn.
enum CurveDrawMode : int {
  CurveDrawMode_Polyline = 1,  ///< the samples, joined by lines
  CurveDrawMode_Bars = 2,      ///< a line from the bar origin to each sample
  CurveDrawMode_Dots = 3       ///< a dot at each sample
};

/// Values at equal x steps, in graphic coordinates: sample i stands at x = first x value + i * x
/// step, y = value. The vector that a curve also is stays the application's own.
class VORL_API VGCurve : public dVect2D, public VGObject {
 public:
  /// No values.
  VGCurve();
  /// The other curve's values, copied or referred to (see `SetData`).
  VGCurve(const VGCurve& source, CurveStorageMode mode);
  /// Stores the values as the source does: copies its own ones, refers to others. A copy that finds
  /// no memory is empty.
  VGCurve(const VGCurve& source);
  VGCurve& operator=(const VGCurve& source);
  ~VGCurve() override;
  /// Forgets the values; count, first x value and x step become 0.
  void Reset() override;

  /// Takes `count` values. Mode 1 copies them; any other mode refers to the array, which must
  /// outlive the curve, and which `SetValue` writes to.
  ///
  /// False, with an empty curve, for a count below 1, for null, when there is no memory for the
  /// copy, and for a reference to the copy that this curve has held so far.
  bool SetData(float firstX, float deltaX, int count, float* values, CurveStorageMode mode);
  /// The values; null when there are none.
  float* GetData();
  const float* GetData() const;
  /// The number of values.
  int GetSize() const;
  float GetFirstXVal() const;
  float GetDeltaX() const;

  /// Sets a value by its index. False when there is none.
  bool SetValue(int i, float v);
  /// Sets the value whose index is (x - first x value) / x step without decimals. False when there
  /// is none, or the x step is 0.
  bool SetValue(float xVal, float v);
  bool SetValue(double xVal, float v);
  /// The value that `SetValue` would set; 0 where there is none.
  float GetValue(int i) const;
  float GetValue(float xVal) const;
  float GetValue(double xVal) const;

 private:
  int IndexAt(float xVal) const;

  float m_firstX = 0.0F;
  float m_deltaX = 0.0F;
  std::int32_t m_count = 0;
  float* m_values = nullptr;
  std::unique_ptr<float[]> m_owned;  ///< null where the values are the caller's
};

/// A curve that is shown. The mouse does nothing with it.
///
/// The samples are mapped when they are drawn: changes with the functions of `VGCurve` show without
/// a call of `Transform`. Samples that are not finite are left out, which parts a polyline.
class VORL_API VGCurveView : public VGCurve, public VGObjectView {
 public:
  /// A green polyline of thickness 2, without values.
  VGCurveView();
  /// Stores the values as the curve does.
  explicit VGCurveView(const VGCurve& curve);
  VGCurveView(const VGCurveView& source);
  /// Takes the values alone.
  VGCurveView& operator=(const VGCurve& curve);
  /// Takes the values and the look; see `VGObjectView` for what stays.
  VGCurveView& operator=(const VGCurveView& source);
  ~VGCurveView() override;

  VGType GetObjType() override;
  /// Nothing to do: there is no copy in view coordinates.
  void Transform(bool toGraphic) override;
  using VGObjectView::IsPointOnGraphic;
  /// The point lies on what is drawn.
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::DrawGraphic;
  /// What lies outside the clip box is not drawn.
  void DrawGraphic(HDC dc) override;
  /// The box of what is drawn; (0, 0) twice where that is nothing.
  void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) override;

  /// Any other mode than those of `CurveDrawMode` draws the polyline.
  void SetDrawMode(CurveDrawMode mode);
  CurveDrawMode GetDrawMode() const;
  /// Where the bars begin, in graphic coordinates.
  void SetBarOrigin(double origin);
  double GetBarOrigin() const;

 private:
  bool MapSample(int i, double height, dVect2D& pos) const;
  template <class Visitor>
  void VisitPieces(Visitor&& visit) const;

  CurveDrawMode m_drawMode = CurveDrawMode_Polyline;
  double m_barOrigin = 0.0;
};

}  // namespace vorl

#endif
