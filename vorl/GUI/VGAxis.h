#ifndef VORL_GUI_VGAXIS_H
#define VORL_GUI_VGAXIS_H

/// @file
/// Coordinate axes and their views.

#include <vorl/GUI/VGObjectView.h>

#include <cstdint>
#include <string>

inline namespace vorl {

/// Which coordinate the values of an axis are. Any other number is a vertical axis, too.
enum TAxis : int {
  TAxis_X = 1,  ///< horizontal: values run along x
  TAxis_Y = 2   ///< vertical: values run along y
};

/// What of an axis is drawn: the bits of its display flags.
enum VGAxisDisplay : int {
  VGAxisDisplay_Line = 1,
  VGAxisDisplay_Ticks = 2,
  VGAxisDisplay_Labels = 4,
  VGAxisDisplay_Arrow = 8,
  VGAxisDisplay_UnitText = 16,
  VGAxisDisplay_All = 31
};

/// What of a highlighted value is drawn. Any other number draws both.
enum VGAxisHLType : int {
  VGAxisHLType_MarkAndValue = 0,
  VGAxisHLType_Mark = 1,
  VGAxisHLType_Value = 2
};

/// A straight axis in graphic coordinates. Its values are the x or y coordinates that it spans.
class VORL_API VGAxis : public VGObject {
 public:
  /// Horizontal, from (0, 0) along (1, 0), without a unit text.
  VGAxis();
  VGAxis(const VGAxis& source);
  VGAxis& operator=(const VGAxis& source);
  ~VGAxis() override;

  /// An axis of a length along x or y, as the type says, and its unit text (UTF-8, copied; null:
  /// none; empty when there is no memory for it).
  void Init(const dVect2D& pos, double length, TAxis type, const char* unitText);

  TAxis GetType() const;
  /// The vector stays.
  void SetType(TAxis type);
  const dVect2D& GetPos() const;
  void SetPos(const dVect2D& pos);
  const dVect2D& GetVector() const;
  void SetVector(const dVect2D& vector);
  /// The vector's length.
  double GetLength() const;
  /// The direction stays, with a negative length it turns round. A vector without length gets the
  /// direction of the type.
  void SetLength(double length);
  const char* GetUnitText() const;
  void SetUnitText(const char* text);

  /// Maps position and vector from A to B, or with true from B to A. Null changes nothing.
  void Transform(Trafo2DBase* trafo, bool toGraphic);

 protected:
  bool IsHorizontal() const;

 private:
  TAxis m_type = TAxis_X;
  dVect2D m_pos;
  dVect2D m_vector{1.0F, 0.0F};
  std::string m_unitText;
};

/// An axis that is shown with a scale: main ticks at round values, shorter ticks between them,
/// labels, an arrow, a unit text, and up to two highlighted values. The mouse does nothing with it.
///
/// *Values* are graphic coordinates, or with an axis unit what that makes of them. Those of an
/// integer unit have ticks at whole numbers only.
///
/// *Places.* Ticks and labels stand below a horizontal and left of a vertical axis, or on the other
/// side where the clip box has room for labels only there; highlighted values and the unit text
/// stand opposite to them. Labels are at each main tick, or where these are too close at every
/// second, fifth, tenth ... so that they show round numbers at equal distances. No text is drawn
/// over another one or across the edge of the clip box: it is left out.
///
/// After a change with the functions of `VGAxis`, `Transform(false)` refreshes the view.
class VORL_API VGAxisView : public VGAxis, public VGObjectView {
 public:
  VGAxisView();
  explicit VGAxisView(const VGAxis& axis);
  VGAxisView(const VGAxisView& source);
  /// As `SetData`.
  VGAxisView& operator=(const VGAxis& axis);
  /// Takes the axis and the look; see `VGObjectView` for what stays.
  VGAxisView& operator=(const VGAxisView& source);
  ~VGAxisView() override;

  VGType GetObjType() override;
  using VGAxis::Transform;
  void Transform(bool toGraphic) override;
  using VGObjectView::IsPointOnGraphic;
  /// The point lies on the axis' line.
  bool IsPointOnGraphic(dVect2D& point, int tolerance) override;
  using VGObjectView::DrawGraphic;
  /// Nothing where all display flags are clear.
  void DrawGraphic(HDC dc) override;
  /// The box of the line alone.
  void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) override;

  /// Sets the axis in graphic coordinates.
  void SetData(const VGAxis& axis);

  /// Bits of `VGAxisDisplay`, all by default.
  void SetDisplayFlags(unsigned char flags);
  unsigned char GetDisplayFlags() const;
  /// The desired distance of the main ticks in device units, 100 by default, and their smallest
  /// distance in values, 0 by default. Signs do not count.
  void DefineAxisScala(float tickDistance, float minValueStep);
  /// The unit stays the caller's and must live as long as it is set. Null, the default: none.
  void SetAxisUnit(UnitTrafo* unit);
  UnitTrafo* GetAxisUnit() const;
  /// The fonts of labels and unit text stay the caller's. Null, the default: the device context's
  /// for labels, that of the labels for the unit text.
  void SetAxisFonts(HFONT labelFont, HFONT unitFont);

  /// The colour of the shorter ticks, 0x808080 by default.
  void SetGrayColor(long color);

  /// Where the unit text stands, in device units from the end of the axis. Until this or the
  /// alignment is set it stands beside the arrow, on the side that has room; after that, the other
  /// one of the two is (0, -6) or 5.
  void SetUnitTextPos(const dVect2D& pos);
  /// As the alignment of `VGText`.
  void SetUnitTextAlignment(int alignment);
  /// 0x00bbggrr, by default as the axis is.
  void SetUnitTextColor(long color);
  void SetUnitTextAttributes(const dVect2D& pos, int alignment, long color);

  /// Highlighted values: the index is 0 or 1, any other one has no effect. Disabled by default.
  void EnableHLValue(bool enable, int index);
  bool IsHLValueEnabled(int index) const;
  /// One that lies beyond the axis is not drawn.
  void SetHLValue(double value, int index);
  double GetHLValue(int index) const;
  /// One of `VGAxisHLType`.
  void SetHLValueType(int type, int index);
  /// The colour of mark and value, white by default, and the value's background, black by default.
  void SetHLColors(long color, long bgColor, int index);

  /// The values at the start and the end of the axis.
  void GetValueRange(double& start, double& end) const;
  /// The distance of the main ticks in values: the next round number (1, 2 or 5 times a power of
  /// ten) from the desired distance on, where a thousandth above a power of ten still counts as
  /// that. 0 for an axis without values or without length on the device.
  double CalcScalaValueDistance() const;
  /// Writes the `printf` format that suits values of this size into `format`, which holds at least
  /// 16 characters. The width counts neither sign nor point. Null: nothing.
  void CalcValueFormat(double value, char* format) const;

 private:
  struct HLValue {
    double value = 0.0;
    bool isEnabled = false;
    int type = VGAxisHLType_MarkAndValue;
    std::uint32_t color = 0xFFFFFF;
    std::uint32_t bgColor = 0;
  };
  struct Format {
    int width;
    int decimals;
  };
  class Painter;

  Format FormatOf(double value) const;
  HLValue* HLValueAt(int index);
  const HLValue* HLValueAt(int index) const;

  dVect2D m_viewPos;
  dVect2D m_viewVector{1.0F, 0.0F};
  std::uint8_t m_displayFlags = VGAxisDisplay_All;
  float m_tickDistance = 100.0F;
  float m_minValueStep = 0.0F;
  UnitTrafo* m_unit = nullptr;
  HFONT m_labelFont = nullptr;
  HFONT m_unitFont = nullptr;
  bool m_hasUnitTextPlace = false;  ///< one that was set
  dVect2D m_unitTextPos{0.0F, -6.0F};
  int m_unitTextAlignment = 5;
  std::uint32_t m_unitTextColor;
  std::uint32_t m_gray;
  HLValue m_hlValues[2];
};

}  // namespace vorl

#endif
