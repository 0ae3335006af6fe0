#include <vorl/GUI/VGCurve.h>

#include <gtest/gtest.h>

#include <limits>
#include <vector>

#include "ShapeTesting.h"

namespace {

using gui_testing::Lit;
using gui_testing::RopOf;
using Pixels = std::set<std::pair<int, int>>;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();

/// A thin red curve whose samples start at x = 2, 4 apart.
VGCurveView CurveView(std::vector<float> values, CurveDrawMode mode = CurveDrawMode_Polyline) {
  VGCurveView view;
  view.SetData(2, 4, static_cast<int>(values.size()), values.data(), CurveStorageMode_Copy);
  view.SetDrawMode(mode);
  view.SetViewState(VGViewState_Visible);
  view.SetPenThickness(1);
  view.SetPenColor(0x0000FF);
  return view;
}

Pixels Drawn(VGCurveView& view) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  view.VGObjectView::Draw(canvas);
  return Lit(canvas);
}

/// Lines of a pen between points, each drawn by itself.
Pixels Lines(int width, const std::vector<std::pair<int, int>>& points) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  HPEN pen = CreatePen(PS_SOLID, width, 0x0000FF);
  HGDIOBJ old = SelectObject(canvas, pen);
  for (std::size_t i = 0; i + 1 < points.size(); ++i) {
    MoveToEx(canvas, points[i].first, points[i].second, nullptr);
    LineTo(canvas, points[i + 1].first, points[i + 1].second);
  }
  SelectObject(canvas, old);
  DeleteObject(pen);
  EXPECT_FALSE(Lit(canvas).empty());
  return Lit(canvas);
}

TEST(VGCurveViewDraw, PolylineJoinsTheSamples) {
  VGCurveView view = CurveView({5, 5, 9});
  EXPECT_EQ(Drawn(view), (Pixels{{2, 5}, {3, 5}, {4, 5}, {5, 5}, {6, 5}, {7, 6}, {8, 7}, {9, 8}}));
  Canvas canvas(32, 32);
  canvas.Fill(0);
  view.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(2, 5), 0x0000FFu);
}

TEST(VGCurveViewDraw, SamplesAreMapped) {
  Scale2D scale(2, 0.5, 0, 0);
  VGCurveView view = CurveView({10, 10});
  view.SetTransformation(&scale);
  // From (2, 10) and (6, 10)
  EXPECT_EQ(Drawn(view), Lines(1, {{4, 5}, {12, 5}}));
  view.SetValue(0, 20);
  view.SetValue(1, 20);
  EXPECT_EQ(Drawn(view), Lines(1, {{4, 10}, {12, 10}})) << "changes show at once";
}

TEST(VGCurveViewDraw, OtherModesDrawThePolyline) {
  VGCurveView view = CurveView({5, 9, 5});
  const Pixels expected = Drawn(view);
  EXPECT_EQ(expected, Lines(1, {{2, 5}, {6, 9}, {10, 5}}));
  view.SetDrawMode(static_cast<CurveDrawMode>(0));
  EXPECT_EQ(Drawn(view), expected);
  view.SetDrawMode(static_cast<CurveDrawMode>(4));
  EXPECT_EQ(Drawn(view), expected);
}

TEST(VGCurveViewDraw, SampleThatIsNoNumberPartsThePolyline) {
  VGCurveView view = CurveView({5, 5, kNaN, 7, kNaN, 9, 9});
  Pixels expected = Lines(1, {{2, 5}, {6, 5}});
  expected.insert({14, 7});
  expected.merge(Lines(1, {{22, 9}, {26, 9}}));
  EXPECT_EQ(Drawn(view), expected);
}

TEST(VGCurveViewDraw, SingleSampleIsADot) {
  VGCurveView view = CurveView({5});
  EXPECT_EQ(Drawn(view), (Pixels{{2, 5}}));
  view = CurveView({kNaN, 5});
  EXPECT_EQ(Drawn(view), (Pixels{{6, 5}}));
  view = CurveView({kNaN});
  EXPECT_EQ(Drawn(view), Pixels{});
  VGCurveView empty;
  empty.SetViewState(VGViewState_Visible);
  EXPECT_EQ(Drawn(empty), Pixels{});
}

TEST(VGCurveViewDraw, BarsGoFromTheSamplesToTheOrigin) {
  VGCurveView view = CurveView({5, 7, 2}, CurveDrawMode_Bars);
  view.SetBarOrigin(4.0);
  EXPECT_EQ(Drawn(view), (Pixels{{2, 5}, {6, 7}, {6, 6}, {6, 5}, {10, 2}, {10, 3}}));
  view = CurveView({2}, CurveDrawMode_Bars);
  EXPECT_EQ(Drawn(view), (Pixels{{2, 2}, {2, 1}}));
}

TEST(VGCurveViewDraw, DotsStandAtTheSamples) {
  VGCurveView view = CurveView({5, 9.9F, kNaN, 7}, CurveDrawMode_Dots);
  EXPECT_EQ(Drawn(view), (Pixels{{2, 5}, {6, 9}, {14, 7}}));
  view.SetPenStyle(PS_NULL);
  EXPECT_EQ(Drawn(view), Pixels{});
  view = CurveView({9}, CurveDrawMode_Dots);
  view.SetPenThickness(5);
  EXPECT_EQ(Drawn(view), Lines(5, {{2, 9}, {2, 9}}));
}

TEST(VGCurveViewDraw, DotsOutsideTheClipBoxAreNotDrawn) {
  VGCurveView view = CurveView({9, 9, 9, 9}, CurveDrawMode_Dots);  // x = 2, 6, 10, 14
  view.SetPenThickness(5);
  Canvas canvas(32, 32);
  canvas.Fill(0);
  IntersectClipRect(canvas, 3, 0, 14, 32);
  view.DrawGraphic(canvas);
  Pixels expected = Lines(5, {{6, 9}, {6, 9}});
  expected.merge(Lines(5, {{10, 9}, {10, 9}}));
  EXPECT_EQ(Lit(canvas), expected) << "not even where they would reach into it";
}

TEST(VGCurveViewDraw, LinesAreDrawnAsFarAsTheClipBoxShowsThem) {
  VGCurveView view = CurveView({-40, 40, 9, 9, 9});
  view.SetPenThickness(3);
  Canvas canvas(32, 32);
  canvas.Fill(0);
  IntersectClipRect(canvas, 0, 0, 14, 8);
  view.DrawGraphic(canvas);
  Pixels expected;
  for (const auto& pixel : Lines(3, {{2, -40}, {6, 40}, {10, 9}, {14, 9}, {18, 9}})) {
    if (pixel.first < 14 && pixel.second < 8) {
      expected.insert(pixel);
    }
  }
  EXPECT_FALSE(expected.empty());
  EXPECT_EQ(Lit(canvas), expected);
}

TEST(VGCurveViewDraw, RasterOperationIsUsedAndRestored) {
  for (const CurveDrawMode mode :
       {CurveDrawMode_Polyline, CurveDrawMode_Bars, CurveDrawMode_Dots}) {
    VGCurveView view = CurveView({5, 9}, mode);
    view.SetROPMode(R2_XORPEN);
    Canvas canvas(32, 32);
    canvas.Fill(0);
    HGDIOBJ pen = GetCurrentObject(canvas, OBJ_PEN);
    SetROP2(canvas, R2_NOT);
    view.DrawGraphic(canvas);
    EXPECT_FALSE(Lit(canvas).empty());
    EXPECT_EQ(RopOf(canvas), R2_NOT);
    EXPECT_EQ(GetCurrentObject(canvas, OBJ_PEN), pen);
    view.DrawGraphic(canvas);
    EXPECT_EQ(Lit(canvas), Pixels{}) << "drawn twice, it is gone";
  }
}

TEST(VGCurveViewDraw, GapsOfABrokenLineAreNotFilled) {
  VGCurveView view = CurveView({9, 9, 9, 9, 9, 9});
  view.SetPenStyle(PS_DOT);
  Canvas canvas(32, 32);
  canvas.Fill(0);
  SetBkMode(canvas, OPAQUE);
  SetBkColor(canvas, 0xFFFFFF);
  view.DrawGraphic(canvas);
  const Pixels lit = Lit(canvas);
  EXPECT_GT(lit.size(), 5U);
  EXPECT_LT(lit.size(), 20U);
  for (const auto& [x, y] : lit) {
    EXPECT_EQ(canvas.At(x, y), 0x0000FFU);
  }
  EXPECT_EQ(SetBkMode(canvas, TRANSPARENT), OPAQUE);
}

TEST(VGCurveViewDraw, HugeCoordinatesAreDrawnWithoutHarm) {
  for (const CurveDrawMode mode :
       {CurveDrawMode_Polyline, CurveDrawMode_Bars, CurveDrawMode_Dots}) {
    VGCurveView view = CurveView({-1e38F, 1e38F, INFINITY, 5, 1e30F}, mode);
    view.SetBarOrigin(1e300);
    view.SetPenThickness(std::numeric_limits<int>::min());
    Canvas canvas(32, 32);
    SetROP2(canvas, R2_NOT);
    view.DrawGraphic(canvas);
    EXPECT_EQ(RopOf(canvas), R2_NOT);
    view.DrawGraphic(nullptr);
  }
}

}  // namespace
