#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/VGPoint.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::Lit;
using gui_testing::RopOf;
using Pixels = std::set<std::pair<int, int>>;

VGPointView PointView(float x, float y) {
  VGPointView view(VGPoint(dVect2D(x, y)));
  view.SetViewState(VGViewState_Visible);
  view.SetPenColor(0x0000FF);
  view.Enable(VGOperation_Select | VGOperation_Move);
  return view;
}

TEST(VGPoint, IsAPosition) {
  VGPoint point;
  EXPECT_EQ(At(point), "0 0");
  point = dVect2D(3, 4);
  EXPECT_EQ(At(point), "3 4");
  Scale2D scale(2, 3, 0, 0);
  point.Transform(&scale, false);
  EXPECT_EQ(At(point), "6 12");
  point.Transform(nullptr, true);
  EXPECT_EQ(At(point), "6 12");
  point.Transform(&scale, true);
  EXPECT_EQ(At(point), "3 4");
  Translate2D move(1, 1);
  point.Transform(&move, false);
  EXPECT_EQ(At(point), "4 5") << "a point, not a vector";
}

TEST(VGPointView, IsAPointInViewCoordinates) {
  Scale2D scale(2, 2, 0, 0);
  VGPointView view = PointView(3, 4);
  EXPECT_EQ(view.GetObjType(), 1);
  view.SetTransformation(&scale);
  EXPECT_EQ(At(view.GetViewData()), "6 8");
  EXPECT_EQ(BoxOf(view), "6 8 6 8");
  view.SetViewData(VGPoint(dVect2D(20, 30)));
  EXPECT_EQ(At(view), "10 15");
  view.SetData(VGPoint(dVect2D(1, 2)));
  EXPECT_EQ(At(view.GetViewData()), "2 4");
  VGPointView copy(view);
  EXPECT_EQ(At(copy.GetViewData()), "2 4");
  VGPointView assigned;
  assigned = view;
  EXPECT_EQ(At(assigned.GetViewData()), "1 2");
  copy = VGPoint(dVect2D(5, 5));
  EXPECT_EQ(At(copy.GetViewData()), "10 10");
}

/// A dot of the device's pen.
Pixels DotOf(int width, int x, int y) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  HPEN pen = CreatePen(PS_SOLID, width, 0x0000FF);
  HGDIOBJ old = SelectObject(canvas, pen);
  MoveToEx(canvas, x, y, nullptr);
  LineTo(canvas, x, y);
  SelectObject(canvas, old);
  DeleteObject(pen);
  EXPECT_FALSE(Lit(canvas).empty());
  return Lit(canvas);
}

TEST(VGPointView, IsDrawnAsADotWhereTheViewportShowsIt) {
  GraphicViewPort viewPort(Rect2D(0, 0, 100, 100), Rect2D(0, 0, 16, 16), Rect2D(0, 0, 32, 32));
  viewPort.UpdateTransformation();
  const dVect2D pos(5, 7);
  dVect2D shown;
  viewPort.GraphicToView(pos, shown);
  ASSERT_EQ(At(shown), "10 14");
  Canvas canvas(32, 32);
  canvas.Fill(0);
  HGDIOBJ pen = GetCurrentObject(canvas, OBJ_PEN);
  VGPointView view = PointView(5, 7);
  view.SetPenThickness(7);
  view.VGObjectView::Draw(canvas, viewPort);
  EXPECT_EQ(Lit(canvas), DotOf(7, 10, 14));
  EXPECT_EQ(At(view.GetViewData()), "10 14");
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_PEN), pen);
  EXPECT_EQ(RopOf(canvas), R2_COPYPEN);
  canvas.Fill(0);
  view.SetROPMode(R2_XORPEN);
  view.DrawGraphic(canvas);
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{}) << "drawn twice, it is gone";
}

}  // namespace
