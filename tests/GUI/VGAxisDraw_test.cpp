// How the lines of axes are drawn.
#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/VGAxis.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "AxisTesting.h"

namespace {

using gui_testing::AxisView;
using gui_testing::Drawn;
using gui_testing::kSize;
using gui_testing::Line;
using gui_testing::Lit;
using gui_testing::Pixels;
using gui_testing::RopOf;
using gui_testing::SizeOf;
using gui_testing::TextAt;
using gui_testing::operator+;

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

TEST(VGAxisViewDraw, ColoursAreKeptByAssignment) {
  VGAxisView source = AxisView(31);
  source.SetPenColor(0x0000FF);
  source.SetGrayColor(0x00FF00);
  VGAxisView view;
  view = source;
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  view.SetDisplayFlags(VGAxisDisplay_Ticks);
  view.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(80, 24), 0x00FF00U);
  canvas.Fill(0);
  view.SetDisplayFlags(VGAxisDisplay_Labels);
  view.DrawGraphic(canvas);
  ASSERT_FALSE(Lit(canvas).empty());
  for (const auto& [x, y] : Lit(canvas)) {
    EXPECT_EQ(canvas.At(x, y) & 0xFFFF00U, 0U) << "labels have the colour of the pen";
  }
}

TEST(VGAxisViewDraw, SlantedAxisNeedsRoomAtBothEnds) {
  for (const float slope : {30.0F, -30.0F}) {
    VGAxisView view = AxisView(VGAxisDisplay_Labels | VGAxisDisplay_Ticks);
    view.SetPos(dVect2D(10, static_cast<float>(kSize - 20) - std::max(slope, 0.0F)));
    view.SetVector(dVect2D(210, slope));
    view.Transform(false);
    Canvas canvas(kSize, kSize);
    canvas.Fill(0);
    view.DrawGraphic(canvas);
    const int y = static_cast<int>(view.GetPos().y + slope * 90.0F / 210.0F);
    EXPECT_NE(canvas.At(100, y - 7), 0U) << slope;
    EXPECT_EQ(canvas.At(100, y + 7), 0U) << slope;
  }
}

TEST(VGAxisViewDraw, IntegerUnitHasTicksAtWholeNumbersOnly) {
  UnitTrafo unit;
  unit.SetUnitTrafo(0, 0.05, 0.0);
  unit.SetIntegerUnit(0, true);
  VGAxisView view = AxisView(VGAxisDisplay_Ticks);
  view.SetAxisUnit(&unit);
  view.DefineAxisScala(5, 0);
  ASSERT_EQ(view.CalcScalaValueDistance(), 0.5) << "0.25 values";
  Pixels ones;
  for (int x = 20; x <= 220; x += 20) {
    ones = ones + Line(x, 20, x, 29);
  }
  EXPECT_EQ(Drawn(view), ones);
  view.DefineAxisScala(40, 0);
  Pixels twos;
  for (int x = 20; x <= 220; x += 20) {
    twos = twos + Line(x, 20, x, x % 40 == 0 ? 29 : 25);
  }
  EXPECT_EQ(Drawn(view), twos) << "parted by the odd numbers alone";
  view.SetDisplayFlags(0x80);
  view.SetPos(dVect2D(10, 100));
  view.Transform(false);
  view.EnableHLValue(true, 0);
  view.SetHLValueType(VGAxisHLType_Value, 0);
  view.SetHLColors(0xFFFFFF, 0x00FF00, 0);
  view.SetHLValue(7.0, 0);
  const tagRECT size = SizeOf("7");
  EXPECT_EQ(Drawn(view).size(), static_cast<std::size_t>(size.right * size.bottom))
      << "without decimals";
}

TEST(VGAxisViewDraw, PenIsThatOfTheView) {
  VGAxisView view = AxisView(VGAxisDisplay_Line | VGAxisDisplay_Ticks | VGAxisDisplay_Arrow);
  view.SetPenThickness(3);
  view.SetPenColor(0x0000FF);
  view.SetGrayColor(0x00FF00);
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  view.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(60, 19), 0x0000FFU);
  EXPECT_EQ(canvas.At(60, 21), 0x0000FFU) << "the line is drawn over its ticks";
  EXPECT_EQ(canvas.At(60, 23), 0x00FF00U);
  EXPECT_EQ(canvas.At(101, 26), 0x0000FFU);
  canvas.Fill(0);
  view.SetDisplayFlags(VGAxisDisplay_Line);
  view.SetPenThickness(1);
  view.SetPenStyle(PS_DOT);
  view.SetROPMode(R2_XORPEN);
  view.DrawGraphic(canvas);
  EXPECT_GT(Lit(canvas).size(), 50U);
  EXPECT_LT(Lit(canvas).size(), 180U) << "the gaps are not filled";
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{}) << "drawn twice, it is gone";
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
