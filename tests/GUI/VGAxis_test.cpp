#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/VGAxis.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::IsHit;
using gui_testing::StateAt;

VGAxisView AxisView(float start, float end, TAxis type = TAxis_X) {
  VGAxis axis;
  const bool isX = type == TAxis_X;
  axis.Init(isX ? dVect2D(start, 7) : dVect2D(7, start), end - start, type, "mm");
  return VGAxisView(axis);
}

std::string FormatOf(const VGAxisView& view, double value) {
  char format[16] = "";
  view.CalcValueFormat(value, format);
  return format;
}

TEST(VGAxis, StartsHorizontal) {
  const VGAxis axis;
  EXPECT_EQ(axis.GetType(), 1);
  EXPECT_EQ(At(axis.GetPos()), "0 0");
  EXPECT_EQ(At(axis.GetVector()), "1 0");
  EXPECT_STREQ(axis.GetUnitText(), "");
}

TEST(VGAxis, InitSetsTheVectorByTheType) {
  VGAxis axis;
  axis.Init(dVect2D(1, 2), 30, TAxis_X, "mm");
  EXPECT_EQ(At(axis.GetPos()) + " " + At(axis.GetVector()), "1 2 30 0");
  EXPECT_STREQ(axis.GetUnitText(), "mm");
  EXPECT_EQ(axis.GetLength(), 30.0);
  axis.Init(dVect2D(3, 4), 50, TAxis_Y, nullptr);
  EXPECT_EQ(At(axis.GetPos()) + " " + At(axis.GetVector()), "3 4 0 50");
  EXPECT_STREQ(axis.GetUnitText(), "");
  axis.Init(dVect2D(3, 4), 5, static_cast<TAxis>(0), "");
  EXPECT_EQ(At(axis.GetVector()), "0 5") << "any other type is vertical";
}

TEST(VGAxis, LengthKeepsTheDirection) {
  VGAxis axis;
  axis.SetVector(dVect2D(3, 4));
  axis.SetLength(10);
  EXPECT_EQ(At(axis.GetVector()), "6 8");
  axis.SetLength(0);
  axis.SetLength(5);
  EXPECT_EQ(At(axis.GetVector()), "5 0");
  axis.SetType(TAxis_Y);
  axis.SetLength(0);
  axis.SetLength(5);
  EXPECT_EQ(At(axis.GetVector()), "0 5");
}

TEST(VGAxis, TransformMapsPositionAndVector) {
  Translate2D move(10, 20);
  VGAxis axis;
  axis.SetPos(dVect2D(1, 2));
  axis.Transform(&move, false);
  EXPECT_EQ(At(axis.GetPos()) + " " + At(axis.GetVector()), "11 22 1 0");
  axis.Transform(nullptr, true);
  axis.Transform(&move, true);
  EXPECT_EQ(At(axis.GetPos()), "1 2");
}

TEST(VGAxisView, Defaults) {
  VGAxisView view;
  EXPECT_EQ(view.GetObjType(), 8);
  EXPECT_EQ(view.GetDisplayFlags(), 31);
  EXPECT_EQ(view.GetPenColor(), 0x00E0E0);
  EXPECT_EQ(view.GetAxisUnit(), nullptr);
  for (const int i : {0, 1}) {
    EXPECT_FALSE(view.IsHLValueEnabled(i));
    EXPECT_EQ(view.GetHLValue(i), 0.0);
  }
}

TEST(VGAxisView, IsAnAxisInViewCoordinates) {
  Scale2D scale(2, 2, 0, 0);
  VGAxisView view = AxisView(10, 30);
  view.SetTransformation(&scale);
  EXPECT_EQ(BoxOf(view), "20 14 60 14");
  EXPECT_TRUE(IsHit(view, 40, 16, 2));
  EXPECT_FALSE(IsHit(view, 40, 17, 2));
  EXPECT_FALSE(IsHit(view, 65, 14, 2));
  view.SetViewState(VGViewState_Visible);
  view.Enable(VGOperation_All);
  EXPECT_EQ(StateAt(view, 40, 14), 0) << "the mouse does nothing with it";
  view.Transform(true);
  EXPECT_EQ(At(view.GetPos()) + " " + At(view.GetVector()), "10 7 20 0");
}

TEST(VGAxisView, CopiesFromAxesAndViews) {
  VGAxisView view = AxisView(10, 30);
  view.SetDisplayFlags(3);
  view.DefineAxisScala(5, 0);
  view.EnableHLValue(true, 1);
  view.SetHLValue(12, 1);
  VGAxisView assigned;
  assigned = view;
  for (VGAxisView copy : {VGAxisView(view), assigned}) {
    EXPECT_EQ(copy.GetDisplayFlags(), 3);
    EXPECT_EQ(copy.CalcScalaValueDistance(), 5.0);
    EXPECT_TRUE(copy.IsHLValueEnabled(1));
    EXPECT_EQ(copy.GetHLValue(1), 12.0);
    EXPECT_EQ(BoxOf(copy), "10 7 30 7");
    EXPECT_STREQ(copy.GetUnitText(), "mm");
  }
  view = VGAxis();
  EXPECT_EQ(BoxOf(view), "0 0 1 0");
  EXPECT_EQ(view.GetDisplayFlags(), 3);
}

TEST(VGAxisView, HighlightedValuesAreTwo) {
  VGAxisView view;
  view.EnableHLValue(true, 0);
  view.SetHLValue(3, 0);
  view.SetHLValue(4, 1);
  for (const int i : {-1, 2}) {
    view.EnableHLValue(true, i);
    view.SetHLValue(9, i);
    view.SetHLValueType(1, i);
    view.SetHLColors(1, 2, i);
    EXPECT_FALSE(view.IsHLValueEnabled(i));
    EXPECT_EQ(view.GetHLValue(i), 0.0);
  }
  EXPECT_TRUE(view.IsHLValueEnabled(0));
  EXPECT_FALSE(view.IsHLValueEnabled(1));
  EXPECT_EQ(view.GetHLValue(0), 3.0);
  EXPECT_EQ(view.GetHLValue(1), 4.0);
}

TEST(VGAxisView, ValueRangeFollowsTypeAndUnit) {
  double start = 0;
  double end = 0;
  AxisView(10, 30).GetValueRange(start, end);
  EXPECT_EQ(start, 10.0);
  EXPECT_EQ(end, 30.0);
  VGAxisView view = AxisView(5, -15, TAxis_Y);
  UnitTrafo unit;
  unit.SetUnitTrafo(1, 2.0, 100.0);
  unit.SelectUnit(1);
  view.SetAxisUnit(&unit);
  view.GetValueRange(start, end);
  EXPECT_EQ(start, 110.0);
  EXPECT_EQ(end, 70.0);
}

/// The step where the desired distance spans `raw` values.
double StepOf(float raw, float minStep = 0.0F) {
  VGAxisView view = AxisView(0, 64);
  view.DefineAxisScala(raw, minStep);
  return view.CalcScalaValueDistance();
}

TEST(VGAxisView, StepIsTheNextRoundNumber) {
  EXPECT_DOUBLE_EQ(StepOf(1.0F), 1.0);
  EXPECT_DOUBLE_EQ(StepOf(1.0005F), 1.0) << "a hair above a power of ten";
  EXPECT_DOUBLE_EQ(StepOf(1.002F), 2.0);
  EXPECT_DOUBLE_EQ(StepOf(2.0F), 2.0);
  EXPECT_DOUBLE_EQ(StepOf(2.01F), 5.0);
  EXPECT_DOUBLE_EQ(StepOf(4.9F), 5.0);
  EXPECT_DOUBLE_EQ(StepOf(5.0F), 5.0);
  EXPECT_DOUBLE_EQ(StepOf(5.1F), 10.0);
  EXPECT_DOUBLE_EQ(StepOf(10.0F), 10.0);
  EXPECT_DOUBLE_EQ(StepOf(130.0F), 200.0);
  EXPECT_DOUBLE_EQ(StepOf(0.5F), 0.5);
  EXPECT_DOUBLE_EQ(StepOf(0.3F), 0.5);
  EXPECT_DOUBLE_EQ(StepOf(0.015F), 0.02);
  EXPECT_DOUBLE_EQ(StepOf(-3.0F), 5.0) << "the sign does not count";
}

TEST(VGAxisView, StepIsNoSmallerThanAsked) {
  EXPECT_DOUBLE_EQ(StepOf(0.1F, 0.5F), 0.5);
  EXPECT_DOUBLE_EQ(StepOf(0.1F, -0.5F), 0.5);
  EXPECT_DOUBLE_EQ(StepOf(3.0F, 0.5F), 5.0);
}

TEST(VGAxisView, StepFollowsScaleAndUnit) {
  Scale2D scale(10, 10, 0, 0);
  VGAxisView view = AxisView(64, 0);
  EXPECT_DOUBLE_EQ(view.CalcScalaValueDistance(), 100.0);
  view.SetTransformation(&scale);
  EXPECT_DOUBLE_EQ(view.CalcScalaValueDistance(), 10.0);
  UnitTrafo unit;
  unit.SetUnitTrafo(0, -0.25, 7.0);
  view.SetAxisUnit(&unit);
  EXPECT_DOUBLE_EQ(view.CalcScalaValueDistance(), 5.0);
}

TEST(VGAxisView, AxisWithoutValuesHasNoStep) {
  EXPECT_EQ(StepOf(0.0F), 0.0);
  EXPECT_EQ(AxisView(5, 5).CalcScalaValueDistance(), 0.0);
  VGAxisView vertical = AxisView(0, 64);
  vertical.SetType(TAxis_Y);
  EXPECT_EQ(vertical.CalcScalaValueDistance(), 0.0) << "it spans no y";
  EXPECT_EQ(StepOf(std::numeric_limits<float>::infinity()), 0.0);
}

TEST(VGAxisView, FormatSuitsRangeAndValue) {
  EXPECT_EQ(FormatOf(AxisView(10, 100), 0.25), "%2.0f");
  EXPECT_EQ(FormatOf(AxisView(1, 5), 0.25), "%1.1f");
  EXPECT_EQ(FormatOf(AxisView(1, 5, TAxis_Y), 0.25), "%1.1f");
  EXPECT_EQ(FormatOf(AxisView(1, 5), 0.01), "%3.3f");
  EXPECT_EQ(FormatOf(AxisView(1000, -10), 0.01), "%5.2f");
  EXPECT_EQ(FormatOf(AxisView(1, 5), -250.0), "%1.1f");
  EXPECT_EQ(FormatOf(AxisView(0, 100), 20.0), "%2.0f") << "0 has no digits";
  EXPECT_EQ(FormatOf(AxisView(0, 0), 20.0), "%1.1f");
  EXPECT_EQ(FormatOf(AxisView(0, 0.01F), 0.25), "%-2.0f");
  EXPECT_EQ(FormatOf(AxisView(1, 5), 0.0), "%1.1f");
  EXPECT_EQ(FormatOf(AxisView(1, 5), NAN), "%1.1f");
  AxisView(1, 5).CalcValueFormat(1.0, nullptr);
}

TEST(VGAxisView, FormatMapsTheValue) {
  Scale2D scale(0.125, 10, 0, 0);
  VGAxisView view = AxisView(10, 100);
  view.SetTransformation(&scale);
  EXPECT_EQ(FormatOf(view, 0.125), "%3.1f");  // 0.015625
  VGAxisView vertical = AxisView(10, 100, TAxis_Y);
  vertical.SetTransformation(&scale);
  EXPECT_EQ(FormatOf(vertical, 0.125), "%2.0f");  // 1.25
}

// A tenth has no exact counterpart in single precision: there it is a little larger.
TEST(VGAxisView, FormatMapsTheValueInDoublePrecision) {
  Scale2D scale(0.4, 0.4, 0, 0);
  VGAxisView view = AxisView(10, 100);
  EXPECT_EQ(FormatOf(view, 0.1), "%3.1f");
  view.SetTransformation(&scale);
  EXPECT_EQ(FormatOf(view, 0.25), "%3.1f");
}

TEST(VGAxisView, FormatFollowsTheUnit) {
  UnitTrafo unit;
  unit.SetUnitTrafo(0, 0.001, 0.0);
  VGAxisView view = AxisView(1000, 5000);
  view.SetAxisUnit(&unit);
  EXPECT_EQ(FormatOf(view, 50.0), "%2.2f");
  unit.SetUnitTrafo(0, 0.001, 3.0);
  EXPECT_EQ(FormatOf(view, 50.0), "%1.1f") << "3.05";
  unit.SetIntegerUnit(0, true);
  EXPECT_EQ(FormatOf(view, 50.0), "%0.0f");
}

}  // namespace
