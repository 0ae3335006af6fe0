#include <vorl/GUI/VGLine.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::Lit;
using gui_testing::RopOf;
using Pixels = std::set<std::pair<int, int>>;

VGLineView LineView(float x1, float y1, float x2, float y2, TLine type) {
  VGLine line;
  line.Init(dVect2D(x1, y1), dVect2D(x2, y2), type);
  VGLineView view(line);
  view.SetViewState(VGViewState_Visible);
  view.SetPenColor(0x0000FF);
  return view;
}

/// What a dot of a solid pen of this width covers.
Pixels DotOf(int width, int x, int y) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  HPEN pen = CreatePen(PS_SOLID, width, 0xFFFFFF);
  HGDIOBJ old = SelectObject(canvas, pen);
  MoveToEx(canvas, x, y, nullptr);
  LineTo(canvas, x, y);
  SelectObject(canvas, old);
  DeleteObject(pen);
  EXPECT_FALSE(Lit(canvas).empty());
  return Lit(canvas);
}

TEST(VGLineViewDraw, SegmentGoesFromStartToEndWithoutDecimals) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGLineView view = LineView(4.9F, 5.9F, 8.9F, 5.1F, TLine_Segment);
  view.VGObjectView::Draw(canvas);
  EXPECT_EQ(Lit(canvas), (Pixels{{4, 5}, {5, 5}, {6, 5}, {7, 5}}));
  EXPECT_EQ(canvas.At(4, 5), 0x0000FFu);
}

TEST(VGLineViewDraw, InfiniteLineReachesAllOfTheClipRegion) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  IntersectClipRect(canvas, 3, 0, 30, 32);
  VGLineView view = LineView(10, 7, 11, 7, TLine_Infinite);
  view.DrawGraphic(canvas);
  Pixels expected;
  for (int x = 3; x < 30; ++x) {
    expected.insert({x, 7});
  }
  EXPECT_EQ(Lit(canvas), expected);
}

TEST(VGLineViewDraw, OtherTypesAreDrawnInfinite) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGLineView view = LineView(10, 7, 11, 7, static_cast<TLine>(3));
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas).size(), 32u);
}

TEST(VGLineViewDraw, LineOutsideTheClipRegionIsNotDrawn) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGLineView view = LineView(10, 70, 11, 70, TLine_Infinite);
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{});
}

// In a picture that is shown very small, a line may be a fraction of a pixel long; single precision
// does not know where it would end.
TEST(VGLineViewDraw, InfiniteLineKeepsItsSlopeWhereverItsPositionIs) {
  VGLine line;
  line.SetPos(dVect2D(16 - 3e6F, 16 - 1e6F));
  line.SetVector(dVect2D(0.3F, 0.1F));
  VGLineView distant(line);
  distant.SetPenColor(0x0000FF);
  Canvas canvas(32, 32);
  canvas.Fill(0);
  distant.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas).size(), 32U);
  EXPECT_TRUE(canvas.At(16, 15) != 0 || canvas.At(16, 16) != 0 || canvas.At(16, 17) != 0);
  line.SetPos(dVect2D(16, 16));
  line.SetVector(dVect2D(1e-7F, -1e-7F));
  VGLineView tiny(line);
  tiny.SetPenColor(0x0000FF);
  canvas.Fill(0);
  tiny.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(2, 30), 0x0000FFU);
  EXPECT_EQ(canvas.At(30, 2), 0x0000FFU);
}

TEST(VGLineViewDraw, PenIsThatOfTheView) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGLineView view = LineView(6, 9, 26, 9, TLine_Segment);
  view.SetPenThickness(3);
  view.Enable(32);
  view.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(10, 8), 0x0000FFU);
  EXPECT_EQ(canvas.At(10, 10), 0x0000FFU);
  EXPECT_EQ(canvas.At(10, 7), 0U);
  for (const auto& [x, y] : DotOf(2 * 3 + 3, 16, 9)) {
    EXPECT_NE(canvas.At(x, y), 0U) << x << " " << y;
  }
  canvas.Fill(0);
  view.Disable(32);
  view.SetPenThickness(1);
  view.SetPenStyle(PS_NULL);
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{});
}

TEST(VGLineViewDraw, NumbersWithoutAPlaceDoNoHarm) {
  Canvas canvas(32, 32);
  for (const float x : {1e30F, -3e38F, INFINITY, NAN}) {
    for (const TLine type : {TLine_Infinite, TLine_Segment}) {
      VGLineView view = LineView(x, 5, -x, NAN, type);
      view.Enable(VGOperation_All);
      view.Select(true);
      view.VGObjectView::Draw(canvas);
      dVect2D p(x, x);
      EXPECT_TRUE(view.OnBeginRotate(p));
      EXPECT_TRUE(view.OnRotate(p));
      EXPECT_TRUE(view.OnEndRotate(p));
    }
  }
  canvas.Fill(0);
  VGLineView(VGLine()).DrawGraphic(nullptr);
  VGLine line;
  line.SetVector(dVect2D(0, 0));
  VGLineView(line).DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{}) << "no direction, no line";
  EXPECT_EQ(RopOf(canvas), R2_COPYPEN);
}

TEST(VGLineViewDraw, RotationHandleIsADot) {
  const Pixels dot = DotOf(2 * 1 + 3, 16, 9);
  Canvas segment(32, 32);
  segment.Fill(0);
  VGLineView view = LineView(6, 9, 26, 9, TLine_Segment);
  view.Enable(32);
  view.DrawGraphic(segment);
  for (const auto& [x, y] : dot) {
    EXPECT_NE(segment.At(x, y), 0u) << x << " " << y;
  }
  EXPECT_EQ(segment.At(6, 10), 0u) << "none at the start";
  Canvas infinite(32, 32);
  infinite.Fill(0);
  VGLineView other = LineView(16, 9, 20, 9, TLine_Infinite);
  other.Enable(32);
  other.DrawGraphic(infinite);
  Pixels expected = dot;
  for (int x = 0; x < 32; ++x) {
    expected.insert({x, 9});
  }
  EXPECT_EQ(Lit(infinite), expected);
}

TEST(VGLineViewDraw, SelectedSegmentHasDotsAtItsEnds) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGLineView view = LineView(6, 9, 24, 20, TLine_Segment);
  view.SetPenThickness(2);
  view.DrawSelection(canvas);
  Pixels expected = DotOf(7, 6, 9);
  expected.merge(DotOf(7, 24, 20));
  EXPECT_EQ(Lit(canvas), expected);
}

TEST(VGLineViewDraw, SelectedInfiniteLineHasNoDots) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGLineView view = LineView(6, 9, 24, 20, TLine_Infinite);
  view.DrawSelection(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{});
}

TEST(VGLineViewDraw, RasterOperationIsUsedAndRestored) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGLineView view = LineView(6, 9, 24, 9, TLine_Segment);
  view.Select(true);
  view.Enable(32);
  view.SetROPMode(R2_XORPEN);
  HGDIOBJ pen = GetCurrentObject(canvas, OBJ_PEN);
  SetROP2(canvas, R2_NOT);
  view.VGObjectView::Draw(canvas);
  EXPECT_FALSE(Lit(canvas).empty());
  EXPECT_EQ(RopOf(canvas), R2_NOT);
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_PEN), pen);
  view.VGObjectView::Draw(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{}) << "drawn twice, it is gone";
}

}  // namespace
