// How axes are drawn. Texts are compared with what the device draws by itself, because fonts differ
// from machine to machine.
#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/VGAxis.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "ShapeTesting.h"

namespace {

using gui_testing::Lit;
using gui_testing::RopOf;
using Pixels = std::set<std::pair<int, int>>;

constexpr int kSize = 240;

/// From x = 10 to 220 at y = 20, so that main ticks stand at 100 and 200.
VGAxisView AxisView(int flags) {
  VGAxis axis;
  axis.Init(dVect2D(10, 20), 210, TAxis_X, "mm");
  VGAxisView view(axis);
  view.SetViewState(VGViewState_Visible);
  view.SetDisplayFlags(static_cast<unsigned char>(flags));
  return view;
}

Pixels Drawn(VGAxisView& view) {
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  view.VGObjectView::Draw(canvas);
  return Lit(canvas);
}

tagRECT SizeOf(const std::string& text) {
  Canvas canvas(1, 1);
  tagRECT size{0, 0, 0, 0};
  DrawTextA(canvas, text.c_str(), -1, &size, DT_CALCRECT);
  return size;
}

/// A text whose box begins at a place.
Pixels TextAt(const std::string& text, int left, int top) {
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  SetBkMode(canvas, TRANSPARENT);
  SetTextColor(canvas, 0xFFFFFF);
  tagRECT rect{left, top, 2 * kSize, 2 * kSize};
  DrawTextA(canvas, text.c_str(), -1, &rect, 0);
  EXPECT_FALSE(Lit(canvas).empty());
  return Lit(canvas);
}

/// A label below the axis, centred on x.
Pixels LabelAt(const std::string& text, int x) {
  return TextAt(text, static_cast<int>(x + 0.001 - SizeOf(text).right / 2.0), 30);
}

Pixels Line(int x1, int y1, int x2, int y2) {
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  SelectObject(canvas, GetStockObject(WHITE_PEN));
  MoveToEx(canvas, x1, y1, nullptr);
  LineTo(canvas, x2, y2);
  return Lit(canvas);
}

Pixels operator+(Pixels a, Pixels b) {
  a.merge(b);
  return a;
}

TEST(VGAxisViewDraw, NothingWithoutFlagsOrDevice) {
  VGAxisView view = AxisView(0);
  view.EnableHLValue(true, 0);
  view.SetHLValue(50, 0);
  EXPECT_EQ(Drawn(view), Pixels{});
  AxisView(31).DrawGraphic(nullptr);
}

TEST(VGAxisViewDraw, LineAndArrow) {
  VGAxisView line = AxisView(VGAxisDisplay_Line);
  EXPECT_EQ(Drawn(line), Line(10, 20, 220, 20));
  VGAxisView arrow = AxisView(VGAxisDisplay_Arrow);
  EXPECT_EQ(Drawn(arrow), Line(220, 20, 212, 24) + Line(220, 20, 212, 16));
}

TEST(VGAxisViewDraw, MainTicksAreLongerThanTheOthers) {
  VGAxisView view = AxisView(VGAxisDisplay_Ticks);
  Pixels expected;
  for (int x = 20; x <= 220; x += 20) {
    expected = expected + Line(x, 20, x, x % 100 == 0 ? 29 : 25);
  }
  EXPECT_EQ(Drawn(view), expected);
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  view.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(100, 24), 0x00E0E0u);
  EXPECT_EQ(canvas.At(80, 24), 0x808080u);
}

TEST(VGAxisViewDraw, VerticalTicksPointLeft) {
  VGAxis axis;
  axis.Init(dVect2D(50, 10), 210, TAxis_Y, "");
  VGAxisView view(axis);
  view.SetViewState(VGViewState_Visible);
  view.SetDisplayFlags(VGAxisDisplay_Ticks);
  Pixels expected;
  for (int y = 20; y <= 220; y += 20) {
    expected = expected + Line(50, y, y % 100 == 0 ? 41 : 45, y);
  }
  EXPECT_EQ(Drawn(view), expected);
  view.SetDisplayFlags(VGAxisDisplay_Labels);
  const tagRECT size = SizeOf("100");
  const auto top = [&](int y) { return static_cast<int>(y + 0.001 - size.bottom / 2.0); };
  EXPECT_EQ(Drawn(view),
            TextAt("100", 40 - size.right, top(100)) + TextAt("200", 40 - size.right, top(200)));
}

TEST(VGAxisViewDraw, NarrowTicksAreSpreadByTens) {
  VGAxisView view = AxisView(VGAxisDisplay_Ticks);
  view.DefineAxisScala(0.001F, 0);
  // Ten units are the first round step of at least four; a fifth of it cannot be seen.
  Pixels expected;
  for (int x = 10; x <= 220; x += 10) {
    expected = expected + Line(x, 20, x, 29);
  }
  EXPECT_EQ(Drawn(view), expected);
}

TEST(VGAxisViewDraw, LabelsStandBelowMainTicks) {
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  EXPECT_EQ(Drawn(view), LabelAt("100", 100) + LabelAt("200", 200));
}

TEST(VGAxisViewDraw, LabelsShowTheDecimalsThatTellThemApart) {
  VGAxis axis;
  axis.Init(dVect2D(10, 20), 2, TAxis_X, "");
  VGAxisView view(axis);
  Scale2D scale(200, 1, 10, 0);
  view.SetTransformation(&scale);
  view.SetViewState(VGViewState_Visible);
  view.SetDisplayFlags(VGAxisDisplay_Labels);
  ASSERT_EQ(view.CalcScalaValueDistance(), 0.5);
  // 10.0 would begin left of the clip box.
  ASSERT_GT(SizeOf("10.0").right, 20);
  EXPECT_EQ(Drawn(view), LabelAt("10.5", 110) + LabelAt("11.0", 210));
}

TEST(VGAxisViewDraw, LabelsShowTheUnit) {
  UnitTrafo unit;
  unit.SetUnitTrafo(0, 10.0, 0.0);
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  view.SetAxisUnit(&unit);
  EXPECT_EQ(Drawn(view), LabelAt("1000", 100) + LabelAt("2000", 200));
}

TEST(VGAxisViewDraw, LabelsStayInsideTheClipBox) {
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  IntersectClipRect(canvas, 0, 0, 202, kSize);
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), LabelAt("100", 100));
}

TEST(VGAxisViewDraw, LabelsDoNotOverlap) {
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  view.DefineAxisScala(5, 0);
  Pixels expected;
  int free = 0;
  int numLabels = 0;
  for (int x = 10; x <= 220; x += 5) {
    const std::string text = std::to_string(x);
    const int width = SizeOf(text).right;
    const int left = static_cast<int>(x + 0.001 - width / 2.0);
    if (left >= free && left + width <= kSize) {
      expected = expected + LabelAt(text, x);
      free = left + width + 2;
      ++numLabels;
    }
  }
  ASSERT_GT(numLabels, 2);
  ASSERT_LT(numLabels, 43);
  EXPECT_EQ(Drawn(view), expected);
}

TEST(VGAxisViewDraw, UnitTextStandsAtTheEnd) {
  VGAxisView view = AxisView(VGAxisDisplay_UnitText);
  const tagRECT size = SizeOf("mm");
  ASSERT_GT(size.bottom, 14);
  EXPECT_EQ(Drawn(view), Pixels{}) << "it would be cut by the upper edge";
  view.SetPos(dVect2D(10, 60));
  view.Transform(false);
  EXPECT_EQ(Drawn(view), TextAt("mm", 220 - size.right, 54 - size.bottom));
  view.SetPos(dVect2D(10, 20));
  view.Transform(false);
  view.SetUnitTextAttributes(dVect2D(-100, 50), 0, 0x0000FF);
  EXPECT_EQ(Drawn(view), TextAt("mm", 120, 70));
  UnitTrafo unit;
  unit.SetUnitText(0, "HU", "");
  view.SetAxisUnit(&unit);
  EXPECT_EQ(Drawn(view), TextAt("HU", 120, 70)) << "the unit has a text of its own";
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  view.DrawGraphic(canvas);
  for (const auto& [x, y] : Lit(canvas)) {
    EXPECT_EQ(canvas.At(x, y) & 0xFFFF00U, 0u);
  }
}

TEST(VGAxisViewDraw, LabelsGiveWayToTheUnitText) {
  VGAxisView view = AxisView(VGAxisDisplay_UnitText | VGAxisDisplay_Labels);
  view.SetUnitTextAttributes(dVect2D(-20, 10), 12, 0xFFFFFF);
  EXPECT_EQ(Drawn(view), LabelAt("100", 100) + LabelAt("mm", 200));
}

TEST(VGAxisViewDraw, HighlightedValueHasAMarkAndItsValue) {
  VGAxisView view = AxisView(0x80);  // a flag that draws nothing
  view.SetHLValue(50, 0);
  EXPECT_EQ(Drawn(view), Pixels{}) << "not enabled";
  view.EnableHLValue(true, 0);
  view.SetHLColors(0x0000FF, 0x00FF00, 0);
  view.SetHLValueType(VGAxisHLType_Mark, 0);
  EXPECT_EQ(Drawn(view), Line(50, 10, 50, 31));
  view.SetHLValueType(VGAxisHLType_Value, 0);
  const tagRECT size = SizeOf("50.0");
  const int left = static_cast<int>(50 + 0.001 - size.right / 2.0);
  view.SetPos(dVect2D(10, 100));
  view.Transform(false);
  const Pixels value = Drawn(view);
  EXPECT_EQ(value.size(), static_cast<std::size_t>(size.right * size.bottom));
  EXPECT_EQ(*value.begin(), std::make_pair(left, 88 - static_cast<int>(size.bottom)));
  view.SetHLValueType(VGAxisHLType_MarkAndValue, 0);
  EXPECT_EQ(Drawn(view), value + Line(50, 90, 50, 111));
}

TEST(VGAxisViewDraw, HighlightedValueBeyondTheAxisIsNotDrawn) {
  VGAxisView view = AxisView(0x80);
  view.SetHLValueType(VGAxisHLType_Mark, 1);
  view.EnableHLValue(true, 1);
  for (const double value : {9.0, 221.0, std::nan("")}) {
    view.SetHLValue(value, 1);
    EXPECT_EQ(Drawn(view), Pixels{}) << value;
  }
  view.SetHLValue(10, 1);
  EXPECT_EQ(Drawn(view), Line(10, 10, 10, 31));
}

TEST(VGAxisViewDraw, DeviceContextIsRestored) {
  Canvas canvas(kSize, kSize);
  HGDIOBJ font = GetCurrentObject(canvas, OBJ_FONT);
  HGDIOBJ pen = GetCurrentObject(canvas, OBJ_PEN);
  SetROP2(canvas, R2_NOT);
  SetBkMode(canvas, OPAQUE);
  SetTextColor(canvas, 0x010203);
  SetBkColor(canvas, 0x040506);
  VGAxisView view = AxisView(31);
  view.SetAxisFonts(static_cast<HFONT>(GetStockObject(ANSI_FIXED_FONT)),
                    static_cast<HFONT>(GetStockObject(ANSI_VAR_FONT)));
  view.EnableHLValue(true, 0);
  view.SetHLValue(50, 0);
  view.DrawGraphic(canvas);
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_FONT), font);
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_PEN), pen);
  EXPECT_EQ(RopOf(canvas), R2_NOT);
  EXPECT_EQ(SetBkMode(canvas, TRANSPARENT), OPAQUE);
  EXPECT_EQ(SetTextColor(canvas, 0), 0x010203u);
  EXPECT_EQ(SetBkColor(canvas, 0), 0x040506u);
}

TEST(VGAxisViewDraw, ExtremeAxesAreDrawnWithoutHarm) {
  for (const float pos : {0.0F, 1e30F, -3e38F, INFINITY, NAN}) {
    for (const float length : {0.0F, 1e-30F, -1e30F, 3e38F, INFINITY, NAN}) {
      VGAxisView view = AxisView(31);
      view.SetPos(dVect2D(pos, 20));
      view.SetVector(dVect2D(length, 0));
      view.Transform(false);
      view.EnableHLValue(true, 0);
      view.SetHLValue(1e300, 0);
      Canvas canvas(32, 32);
      SetROP2(canvas, R2_NOT);
      view.DrawGraphic(canvas);
      EXPECT_EQ(RopOf(canvas), R2_NOT);
    }
  }
}

}  // namespace
