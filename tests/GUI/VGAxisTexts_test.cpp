// Where the texts of axes stand, and when they are left out.
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
using gui_testing::LabelAt;
using gui_testing::Line;
using gui_testing::Lit;
using gui_testing::Pixels;
using gui_testing::SizeOf;
using gui_testing::TextAt;
using gui_testing::operator+;

TEST(VGAxisViewTexts, LabelsStandBelowMainTicks) {
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  EXPECT_EQ(Drawn(view), LabelAt("100", 100) + LabelAt("200", 200));
}

TEST(VGAxisViewTexts, LabelsShowTheDecimalsThatTellThemApart) {
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

TEST(VGAxisViewTexts, LabelsShowTheUnit) {
  UnitTrafo unit;
  unit.SetUnitTrafo(0, 10.0, 0.0);
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  view.SetAxisUnit(&unit);
  EXPECT_EQ(Drawn(view), LabelAt("1000", 100) + LabelAt("2000", 200));
}

TEST(VGAxisViewTexts, LabelsStayInsideTheClipBox) {
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  IntersectClipRect(canvas, 0, 0, 202, kSize);
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), LabelAt("100", 100));
}

TEST(VGAxisViewTexts, LabelsThatWouldOverlapShowEverySecondFifthOrTenthRoundNumber) {
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  view.DefineAxisScala(5, 0);
  ASSERT_EQ(view.CalcScalaValueDistance(), 5.0);
  const int extent = std::max(SizeOf("10").right, SizeOf("220").right) + 2;
  int distance = 0;
  for (const int round : {100, 50, 20, 10, 5}) {
    distance = round >= extent ? round : distance;
  }
  ASSERT_GT(distance, 5);
  Pixels expected;
  int numLabels = 0;
  for (int x = distance; x <= 220; x += distance) {
    const std::string text = std::to_string(x);
    const int left = static_cast<int>(x + 0.001 - SizeOf(text).right / 2.0);
    if (left >= 0 && left + SizeOf(text).right <= kSize) {
      expected = expected + LabelAt(text, x);
      ++numLabels;
    }
  }
  ASSERT_GT(numLabels, 1);
  EXPECT_EQ(Drawn(view), expected);
}

TEST(VGAxisViewTexts, TicksAndLabelsStandAboveWhereThereIsNoRoomBelow) {
  const int height = SizeOf("100").bottom;
  VGAxisView view = AxisView(VGAxisDisplay_Labels);
  const auto drawnAt = [&](int y) {
    view.SetPos(dVect2D(10, static_cast<float>(y)));
    view.Transform(false);
    return Drawn(view);
  };
  const auto labels = [&](int top) {
    const auto left = [](const char* text, int x) {
      return static_cast<int>(x + 0.001 - SizeOf(text).right / 2.0);
    };
    return TextAt("100", left("100", 100), top) + TextAt("200", left("200", 200), top);
  };
  const int lowest = kSize - 10 - height;
  EXPECT_EQ(drawnAt(lowest), labels(lowest + 10));
  EXPECT_EQ(drawnAt(lowest + 1), labels(lowest + 1 - 10 - height));
  view.SetDisplayFlags(VGAxisDisplay_Labels | VGAxisDisplay_Ticks);
  const Pixels both = drawnAt(kSize - 2);
  EXPECT_TRUE(both.contains({100, kSize - 10}));
  EXPECT_FALSE(both.contains({100, kSize - 1}));
  EXPECT_TRUE(both.contains({120, kSize - 6}));
  EXPECT_FALSE(both.contains({120, kSize - 7}));
  view.SetDisplayFlags(VGAxisDisplay_Ticks);
  EXPECT_TRUE(drawnAt(kSize - 2).contains({100, kSize - 1})) << "without labels they stay below";
}

TEST(VGAxisViewTexts, VerticalLabelsStandOnTheRightWhereThereIsNoRoomOnTheLeft) {
  const tagRECT size = SizeOf("100");
  VGAxis axis;
  axis.Init(dVect2D(3, 10), 210, TAxis_Y, "");
  VGAxisView view(axis);
  view.SetViewState(VGViewState_Visible);
  view.SetDisplayFlags(VGAxisDisplay_Labels);
  const auto top = [&](int y) { return static_cast<int>(y + 0.001 - size.bottom / 2.0); };
  EXPECT_EQ(Drawn(view), TextAt("100", 13, top(100)) + TextAt("200", 13, top(200)));
}

TEST(VGAxisViewTexts, UnitTextStandsAtTheEnd) {
  VGAxisView view = AxisView(VGAxisDisplay_UnitText);
  const tagRECT size = SizeOf("mm");
  ASSERT_GT(size.bottom, 14);
  EXPECT_EQ(Drawn(view), TextAt("mm", 220 - size.right, 30)) << "it would be cut by the upper edge";
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

TEST(VGAxisViewTexts, UnitTextStandsBesideTheArrow) {
  const tagRECT size = SizeOf("mm");
  const auto drawn = [](float x, float y, double length, TAxis type) {
    VGAxis axis;
    axis.Init(dVect2D(x, y), length, type, "mm");
    VGAxisView view(axis);
    view.SetViewState(VGViewState_Visible);
    view.SetDisplayFlags(VGAxisDisplay_UnitText);
    return Drawn(view);
  };
  EXPECT_EQ(drawn(10, 100, 150, TAxis_X), TextAt("mm", 160 - size.right, 94 - size.bottom));
  EXPECT_EQ(drawn(160, 100, -150, TAxis_X), TextAt("mm", 10, 94 - size.bottom));
  EXPECT_EQ(drawn(50, 10, 150, TAxis_Y), TextAt("mm", 56, 160 - size.bottom));
  EXPECT_EQ(drawn(50, 160, -150, TAxis_Y), TextAt("mm", 56, 10));
  const auto right = static_cast<float>(kSize - 7 - size.right);
  EXPECT_FALSE(drawn(right + 1.0F, 160, -150, TAxis_Y).empty());
  EXPECT_EQ(drawn(static_cast<float>(kSize - 5), 160, -150, TAxis_Y),
            TextAt("mm", kSize - 15 - size.right, 10))
      << "on the other side, beyond the ticks";
  EXPECT_EQ(drawn(-200, 100, 150, TAxis_X), Pixels{}) << "its end is out of sight";
}

TEST(VGAxisViewTexts, AmpersandsAreLetters) {
  VGAxisView view = AxisView(VGAxisDisplay_UnitText);
  view.SetUnitText("R&D & more");
  view.SetUnitTextAttributes(dVect2D(-150, 50), 0, 0xFFFFFF);
  Canvas expected(kSize, kSize);
  expected.Fill(0);
  SetBkMode(expected, TRANSPARENT);
  SetTextColor(expected, 0xFFFFFF);
  tagRECT rect{70, 70, 2 * kSize, 2 * kSize};
  DrawTextA(expected, "R&D & more", -1, &rect, DT_NOPREFIX);
  EXPECT_EQ(Drawn(view), Lit(expected));
}

TEST(VGAxisViewTexts, UnitTextHasItsPlaceOnceItIsSet) {
  const tagRECT size = SizeOf("mm");
  VGAxisView placed = AxisView(VGAxisDisplay_UnitText);
  placed.SetUnitTextPos(dVect2D(-30, 80));
  EXPECT_EQ(Drawn(placed), TextAt("mm", 190 - size.right, 100 - size.bottom)) << "alignment 5";
  VGAxisView aligned = AxisView(VGAxisDisplay_UnitText);
  aligned.SetUnitTextAlignment(4);
  EXPECT_EQ(Drawn(aligned), TextAt("mm", 220 - size.right, 14)) << "position (0, -6)";
  VGAxisView copy;
  copy = aligned;
  EXPECT_EQ(Drawn(copy), Drawn(aligned));
}

TEST(VGAxisViewTexts, LabelsGiveWayToTheUnitText) {
  VGAxisView view = AxisView(VGAxisDisplay_UnitText | VGAxisDisplay_Labels);
  view.SetUnitTextAttributes(dVect2D(-20, 10), 12, 0xFFFFFF);
  EXPECT_EQ(Drawn(view), LabelAt("100", 100) + LabelAt("mm", 200));
}

TEST(VGAxisViewTexts, HighlightedValueHasAMarkAndItsValue) {
  VGAxisView view = AxisView(0x80);  // a flag that draws nothing
  view.SetHLValue(50, 0);
  EXPECT_EQ(Drawn(view), Pixels{}) << "not enabled";
  view.EnableHLValue(true, 0);
  view.SetHLColors(0x0000FF, 0x00FF00, 0);
  view.SetHLValueType(VGAxisHLType_Mark, 0);
  EXPECT_EQ(Drawn(view), Line(50, 11, 50, 30));
  view.SetHLValueType(VGAxisHLType_Value, 0);
  const tagRECT size = SizeOf("50.0");
  const int left = static_cast<int>(50 + 0.001 - size.right / 2.0);
  view.SetPos(dVect2D(10, 100));
  view.Transform(false);
  const Pixels value = Drawn(view);
  EXPECT_EQ(value.size(), static_cast<std::size_t>(size.right * size.bottom));
  EXPECT_EQ(*value.begin(), std::make_pair(left, 88 - static_cast<int>(size.bottom)));
  view.SetHLValueType(VGAxisHLType_MarkAndValue, 0);
  EXPECT_EQ(Drawn(view), value + Line(50, 91, 50, 110));
}

TEST(VGAxisViewTexts, HighlightedValuesAreWhiteOnBlack) {
  VGAxisView view = AxisView(0x80);
  view.SetPos(dVect2D(10, 100));
  view.Transform(false);
  for (const int i : {0, 1}) {
    view.SetHLValue(60 + 100 * i, i);
    view.EnableHLValue(true, i);
  }
  Canvas canvas(kSize, kSize);
  canvas.Fill(static_cast<char>(0x80));
  view.DrawGraphic(canvas);
  for (const int x : {60, 160}) {
    EXPECT_EQ(canvas.At(x, 109), 0xFFFFFFU);
    const tagRECT size = SizeOf("60.0");
    EXPECT_EQ(canvas.At(x, 88 - size.bottom), 0U) << "above the letters";
  }
}

TEST(VGAxisViewTexts, HighlightedValueIsMovedIntoSight) {
  VGAxisView view = AxisView(0x80);
  view.SetHLValueType(VGAxisHLType_Value, 0);
  view.SetHLColors(0xFFFFFF, 0x00FF00, 0);
  view.EnableHLValue(true, 0);
  view.SetHLValue(10, 0);
  const tagRECT size = SizeOf("10.0");
  ASSERT_GT(size.right, 20);
  ASSERT_GT(size.bottom, 8);
  const auto box = [](int left, int top, const tagRECT& extent) {
    Pixels pixels;
    for (int y = top; y < top + extent.bottom; ++y) {
      for (int x = left; x < left + extent.right; ++x) {
        pixels.insert({x, y});
      }
    }
    return pixels;
  };
  EXPECT_EQ(Drawn(view), box(0, 32, size)) << "below, as there is no room above";
  view.SetPos(dVect2D(10, 100));
  view.Transform(false);
  EXPECT_EQ(Drawn(view), box(0, 88 - size.bottom, size));
  // The second one, close by, gets out of the way of the first.
  view.SetHLValueType(VGAxisHLType_Value, 1);
  view.SetHLColors(0xFFFFFF, 0x00FF00, 1);
  view.EnableHLValue(true, 1);
  view.SetHLValue(10, 1);
  EXPECT_EQ(Drawn(view), box(0, 88 - size.bottom, size) + box(0, 112, size));
}

TEST(VGAxisViewTexts, LabelsAndUnitTextHaveTheirFonts) {
  HFONT large = CreateFontA(40, 0, 0, 0, FW_NORMAL, 0, 0, 0, DEFAULT_CHARSET, OUT_DEFAULT_PRECIS,
                            CLIP_DEFAULT_PRECIS, DEFAULT_QUALITY, DEFAULT_PITCH, nullptr);
  const auto lowest = [](const Pixels& pixels) {
    int y = 0;
    for (const auto& pixel : pixels) {
      y = std::max(y, pixel.second);
    }
    return y;
  };
  VGAxisView labels = AxisView(VGAxisDisplay_Labels);
  VGAxisView unit = AxisView(VGAxisDisplay_UnitText);
  const int labelHeight = lowest(Drawn(labels));
  const int unitHeight = lowest(Drawn(unit));
  labels.SetAxisFonts(large, nullptr);
  unit.SetAxisFonts(large, nullptr);
  EXPECT_GT(lowest(Drawn(labels)), labelHeight + 5);
  EXPECT_GT(lowest(Drawn(unit)), unitHeight + 5) << "without a font of its own";
  unit.SetAxisFonts(nullptr, large);
  labels.SetAxisFonts(nullptr, large);
  EXPECT_EQ(lowest(Drawn(labels)), labelHeight);
  EXPECT_GT(lowest(Drawn(unit)), unitHeight + 5);
  DeleteObject(large);
}

TEST(VGAxisViewTexts, HighlightedValueBeyondTheAxisIsNotDrawn) {
  VGAxisView view = AxisView(0x80);
  view.SetHLValueType(VGAxisHLType_Mark, 1);
  view.EnableHLValue(true, 1);
  for (const double value : {9.0, 221.0, std::nan("")}) {
    view.SetHLValue(value, 1);
    EXPECT_EQ(Drawn(view), Pixels{}) << value;
  }
  view.SetHLValue(10, 1);
  EXPECT_EQ(Drawn(view), Line(10, 11, 10, 30));
}

}  // namespace
