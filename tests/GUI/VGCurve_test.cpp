#include <vorl/GUI/VGCurve.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::IsHit;
using gui_testing::StateAt;

constexpr float kInf = std::numeric_limits<float>::infinity();
constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();

std::string Text(const VGCurve& curve) {
  std::ostringstream out;
  out << curve.GetFirstXVal() << " + " << curve.GetDeltaX() << ":";
  for (int i = 0; i < curve.GetSize(); ++i) {
    out << " " << curve.GetValue(i);
  }
  return out.str();
}

TEST(VGCurve, StartsEmpty) {
  const VGCurve curve;
  EXPECT_EQ(Text(curve), "0 + 0:");
  EXPECT_EQ(curve.GetData(), nullptr);
  EXPECT_EQ(static_cast<int>(CurveStorageMode_Copy), 1);
}

TEST(VGCurve, CopyModeOwnsItsValues) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  EXPECT_TRUE(curve.SetData(10, 0.5F, 3, values, CurveStorageMode_Copy));
  values[1] = 99;
  EXPECT_EQ(Text(curve), "10 + 0.5: 1 2 3");
  EXPECT_TRUE(curve.SetValue(0, 7));
  EXPECT_EQ(values[0], 1.0F);
  EXPECT_NE(curve.GetData(), values);
}

TEST(VGCurve, AnyOtherModeRefersToTheValues) {
  for (const int mode : {2, 0, 3}) {
    float values[] = {1, 2, 3};
    VGCurve curve;
    EXPECT_TRUE(curve.SetData(10, 0.5F, 3, values, static_cast<CurveStorageMode>(mode)));
    EXPECT_EQ(curve.GetData(), values);
    values[1] = 99;
    EXPECT_EQ(Text(curve), "10 + 0.5: 1 99 3");
    EXPECT_TRUE(curve.SetValue(0, 7));
    EXPECT_EQ(values[0], 7.0F);
    curve.Reset();
    EXPECT_EQ(values[2], 3.0F) << "they stay the caller's";
  }
}

TEST(VGCurve, FailedSetDataLeavesItEmpty) {
  float values[] = {1, 2, 3};
  for (const CurveStorageMode mode : {CurveStorageMode_Copy, CurveStorageMode_Reference}) {
    for (const int count : {0, -1, std::numeric_limits<int>::min()}) {
      VGCurve curve;
      EXPECT_TRUE(curve.SetData(10, 1, 3, values, mode));
      EXPECT_FALSE(curve.SetData(10, 1, count, values, mode));
      EXPECT_EQ(Text(curve), "0 + 0:");
      EXPECT_EQ(curve.GetData(), nullptr);
    }
    VGCurve curve;
    EXPECT_TRUE(curve.SetData(10, 1, 3, values, mode));
    EXPECT_FALSE(curve.SetData(10, 1, 3, nullptr, mode));
    EXPECT_EQ(Text(curve), "0 + 0:");
  }
}

TEST(VGCurve, ItsOwnValuesCanBeCopiedAgainButNotReferredTo) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  curve.SetData(10, 1, 3, values, CurveStorageMode_Copy);
  EXPECT_TRUE(curve.SetData(5, 2, 2, curve.GetData() + 1, CurveStorageMode_Copy));
  EXPECT_EQ(Text(curve), "5 + 2: 2 3");
  EXPECT_FALSE(curve.SetData(5, 2, 1, curve.GetData() + 1, CurveStorageMode_Reference));
  EXPECT_EQ(Text(curve), "0 + 0:");
}

TEST(VGCurve, ResetKeepsTheVector) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  curve.Set(4, 5);
  curve.SetData(10, 1, 3, values, CurveStorageMode_Copy);
  curve.Reset();
  EXPECT_EQ(Text(curve), "0 + 0:");
  EXPECT_EQ(curve.GetData(), nullptr);
  EXPECT_EQ(At(curve), "4 5");
}

TEST(VGCurve, IndicesBeyondTheValuesAreRefused) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  curve.SetData(0, 1, 3, values, CurveStorageMode_Copy);
  EXPECT_TRUE(curve.SetValue(2, 30));
  EXPECT_FALSE(curve.SetValue(3, 40));
  EXPECT_FALSE(curve.SetValue(-1, 40));
  EXPECT_EQ(Text(curve), "0 + 1: 1 2 30");
  EXPECT_EQ(curve.GetValue(-1), 0.0F);
  EXPECT_EQ(curve.GetValue(3), 0.0F);
}

TEST(VGCurve, XValuesAreTruncatedToIndices) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  curve.SetData(10, 2, 3, values, CurveStorageMode_Copy);
  EXPECT_EQ(curve.GetValue(10.0F), 1.0F);
  EXPECT_EQ(curve.GetValue(11.9F), 1.0F);
  EXPECT_EQ(curve.GetValue(12.0F), 2.0F);
  EXPECT_EQ(curve.GetValue(15.9F), 3.0F);
  EXPECT_EQ(curve.GetValue(16.0F), 0.0F);
  EXPECT_EQ(curve.GetValue(8.1F), 1.0F) << "towards zero, also below the first";
  EXPECT_EQ(curve.GetValue(8.0F), 0.0F);
  EXPECT_EQ(curve.GetValue(12.0), 2.0F) << "a double";
  EXPECT_TRUE(curve.SetValue(13.0F, 20));
  EXPECT_TRUE(curve.SetValue(14.0, 30.0F));
  EXPECT_FALSE(curve.SetValue(16.0F, 40));
  EXPECT_EQ(Text(curve), "10 + 2: 1 20 30");
  for (const float x : {kInf, -kInf, kNaN, 1e30F, -1e30F}) {
    EXPECT_EQ(curve.GetValue(x), 0.0F);
    EXPECT_FALSE(curve.SetValue(x, 5));
  }
}

TEST(VGCurve, IndicesAreComputedInSinglePrecision) {
  float values[] = {0, 1, 2, 3, 4, 5, 6, 7};
  VGCurve curve;
  curve.SetData(0, 0.1F, 8, values, CurveStorageMode_Copy);
  EXPECT_EQ(curve.GetValue(0.7F), 7.0F) << "the seventh tenth is no less than seven tenths";
  EXPECT_EQ(curve.GetValue(0.7), 7.0F);
}

TEST(VGCurve, NegativeStepsCountDown) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  curve.SetData(10, -2, 3, values, CurveStorageMode_Copy);
  EXPECT_EQ(curve.GetValue(8.0F), 2.0F);
  EXPECT_EQ(curve.GetValue(13.0F), 0.0F);
}

TEST(VGCurve, WithoutAStepThereIsNothingAtX) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  curve.SetData(10, 0, 3, values, CurveStorageMode_Copy);
  EXPECT_EQ(curve.GetValue(10.0F), 0.0F);
  EXPECT_FALSE(curve.SetValue(10.0F, 5));
  EXPECT_EQ(Text(curve), "10 + 0: 1 2 3");
}

TEST(VGCurve, IsCopiedInTheGivenMode) {
  float values[] = {1, 2, 3};
  VGCurve source;
  source.SetData(10, 2, 3, values, CurveStorageMode_Copy);
  const VGCurve copy(source, CurveStorageMode_Copy);
  const VGCurve reference(source, CurveStorageMode_Reference);
  source.SetValue(0, 50);
  EXPECT_EQ(Text(copy), "10 + 2: 1 2 3");
  EXPECT_EQ(Text(reference), "10 + 2: 50 2 3");
  EXPECT_EQ(reference.GetData(), source.GetData());
}

TEST(VGCurve, PlainCopyStoresAsTheSourceDoes) {
  float values[] = {1, 2, 3};
  VGCurve owner;
  owner.SetData(10, 2, 3, values, CurveStorageMode_Copy);
  owner.Set(4, 5);
  const VGCurve copy(owner);
  EXPECT_NE(copy.GetData(), owner.GetData());
  EXPECT_EQ(Text(copy), "10 + 2: 1 2 3");
  EXPECT_EQ(At(copy), "4 5");
  VGCurve user;
  user.SetData(1, 1, 2, values, CurveStorageMode_Reference);
  VGCurve assigned;
  assigned = owner;
  EXPECT_EQ(Text(assigned), "10 + 2: 1 2 3");
  assigned = user;
  EXPECT_EQ(assigned.GetData(), values);
  const VGCurve& same = owner;
  owner = same;
  EXPECT_EQ(Text(owner), "10 + 2: 1 2 3");
  assigned = VGCurve();
  EXPECT_EQ(Text(assigned), "0 + 0:");
}

TEST(VGCurveView, Defaults) {
  VGCurveView view;
  EXPECT_EQ(view.GetObjType(), 9);
  EXPECT_EQ(view.GetPenThickness(), 2);
  EXPECT_EQ(view.GetPenColor(), 0x00DD00);
  EXPECT_EQ(view.GetDrawMode(), 1);
  EXPECT_EQ(view.GetBarOrigin(), 0.0);
  for (const VGOperation bit : {VGOperation_Create, VGOperation_Select, VGOperation_Modify,
                                VGOperation_Move, VGOperation_Resize, VGOperation_Rotate}) {
    EXPECT_FALSE(view.IsEnabled(bit)) << bit;
  }
  const VGCurveView fromCurve{VGCurve()};
  EXPECT_EQ(fromCurve.GetPenThickness(), 2);
  EXPECT_EQ(fromCurve.GetPenColor(), 0x00DD00);
}

TEST(VGCurveView, CopiesFromCurvesAndViews) {
  float values[] = {1, 2, 3};
  VGCurveView view;
  view.SetData(10, 2, 3, values, CurveStorageMode_Copy);
  view.SetDrawMode(CurveDrawMode_Bars);
  view.SetBarOrigin(7.5);
  view.SetPenColor(5);
  VGCurveView assigned;
  assigned = view;
  for (const VGCurveView& copy : {VGCurveView(view), assigned}) {
    EXPECT_EQ(Text(copy), "10 + 2: 1 2 3");
    EXPECT_EQ(copy.GetDrawMode(), CurveDrawMode_Bars);
    EXPECT_EQ(copy.GetBarOrigin(), 7.5);
    EXPECT_EQ(copy.GetPenColor(), 5);
  }
  view = VGCurve();
  EXPECT_EQ(Text(view), "0 + 0:");
  EXPECT_EQ(view.GetPenColor(), 5);
}

TEST(VGCurveView, TheMouseDoesNothing) {
  float values[] = {10, 10};
  VGCurveView view;
  view.SetData(0, 10, 2, values, CurveStorageMode_Reference);
  view.SetViewState(VGViewState_Visible);
  view.Enable(VGOperation_All);
  EXPECT_EQ(StateAt(view, 0, 10), 0);
  dVect2D p(0, 10);
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_FALSE(view.OnBeginMove(p));
}

TEST(VGCurveView, IsHitWhereItIsDrawn) {
  Scale2D scale(2, 2, 0, 0);
  float values[] = {10, 10, 30};
  VGCurveView view;
  view.SetTransformation(&scale);
  EXPECT_FALSE(IsHit(view, 0, 0, 9)) << "nothing there";
  view.SetData(0, 10, 3, values, CurveStorageMode_Reference);
  // In view coordinates: (0, 20), (20, 20), (40, 60)
  EXPECT_TRUE(IsHit(view, 10, 22, 2));
  EXPECT_FALSE(IsHit(view, 10, 23, 2));
  EXPECT_TRUE(IsHit(view, 30, 40, 2));
  view.SetDrawMode(CurveDrawMode_Dots);
  EXPECT_FALSE(IsHit(view, 10, 20, 2));
  EXPECT_TRUE(IsHit(view, 20, 22, 2));
  view.SetDrawMode(CurveDrawMode_Bars);
  EXPECT_TRUE(IsHit(view, 40, 5, 2));
  EXPECT_FALSE(IsHit(view, 30, 5, 2));
  view.SetBarOrigin(20);
  EXPECT_FALSE(IsHit(view, 40, 5, 2));
}

TEST(VGCurveView, BoxHoldsAllThatIsDrawn) {
  Scale2D scale(2, -2, 0, 0);
  float values[] = {10, kNaN, 30, -5};
  VGCurveView view;
  EXPECT_EQ(BoxOf(view), "0 0 0 0");
  view.SetTransformation(&scale);
  view.SetData(1, 10, 4, values, CurveStorageMode_Reference);
  EXPECT_EQ(BoxOf(view), "2 -60 62 10");
  view.SetBarOrigin(-40);
  EXPECT_EQ(BoxOf(view), "2 -60 62 10");
  view.SetDrawMode(CurveDrawMode_Bars);
  EXPECT_EQ(BoxOf(view), "2 -60 62 80");
}

}  // namespace
