#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/VGPoint.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::Hand;
using gui_testing::IsHit;
using gui_testing::Lit;
using gui_testing::RopOf;
using gui_testing::StateAt;
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

TEST(VGPointView, IsHitAndGrabbedAround) {
  VGPointView view = PointView(10, 10);
  EXPECT_TRUE(IsHit(view, 13, 14, 5));
  EXPECT_FALSE(IsHit(view, 14, 14, 5));
  EXPECT_EQ(StateAt(view, 10, 14), 8);
  EXPECT_EQ(StateAt(view, 10, 15), 0);
  view.Enable(VGOperation_All);
  EXPECT_EQ(StateAt(view, 10, 10), 8) << "for nothing but a move";
  view.SetSelectionDistances(9, 1);
  EXPECT_EQ(StateAt(view, 10, 12), 0);
  view.Disable(2);
  EXPECT_EQ(StateAt(view, 10, 10), 0);
  view.Enable(2);
  view.ResetViewState(2);
  EXPECT_EQ(StateAt(view, 10, 10), 0);
}

TEST(VGPointView, DragPutsItUnderTheMouse) {
  Scale2D scale(2, 2, 0, 0);
  VGPointView view = PointView(10, 10);
  Hand hand(view);
  hand.handler.SetTransformation(&scale);
  EXPECT_TRUE(hand.Down(22, 20));
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_EQ(view.GetOpState(), 8);
  EXPECT_EQ(At(view), "10 10");
  EXPECT_TRUE(hand.Move(32, 40));
  EXPECT_EQ(At(view), "16 20");
  EXPECT_TRUE(hand.Up(90, 90));
  EXPECT_EQ(At(view), "16 20");
  EXPECT_EQ(view.GetROPMode(), 13);
  EXPECT_EQ(view.GetOpState(), 0);
}

TEST(VGPointView, ClickCreatesItAtOnce) {
  Scale2D scale(2, 2, 0, 0);
  VGPointView view;
  view.SetTransformation(&scale);
  view.Enable(VGOperation_All);
  dVect2D p(20, 40);
  EXPECT_TRUE(view.VGObjectView::ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_EQ(At(view), "10 20");
  EXPECT_TRUE(view.IsVisible());
  EXPECT_TRUE(view.IsSelected());
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_EQ(view.GetROPMode(), 13);
  dVect2D away(60, 60);
  EXPECT_FALSE(view.VGObjectView::ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, away));
  EXPECT_EQ(At(view), "10 20");
}

TEST(VGPointView, CreationNeedsOnlyTheClick) {
  VGPointView view;
  dVect2D p(20, 40);
  EXPECT_FALSE(view.OnCreate(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonUp, MK_LBUTTON, p));
  EXPECT_EQ(At(view), "0 0");
  EXPECT_TRUE(view.OnCreate(MouseEvent_ButtonDown, 0, p));
  EXPECT_EQ(At(view), "20 40");
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

TEST(VGPointView, SelectionIsADotOfWidthFive) {
  Canvas canvas(32, 32);
  canvas.Fill(0);
  VGPointView view = PointView(10.9F, 14.9F);
  view.SetPenThickness(9);
  view.DrawSelection(canvas);
  EXPECT_EQ(Lit(canvas), DotOf(5, 10, 14));
  view.SetROPMode(R2_XORPEN);
  view.DrawSelection(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{});
}

}  // namespace
