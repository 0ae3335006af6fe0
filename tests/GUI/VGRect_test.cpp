#include <vorl/Data/dRect.h>
#include <vorl/GUI/VGRect.h>

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

std::string Corners(const VGRect& rect) {
  return At(rect.TopLeft()) + " - " + At(rect.BottomRight());
}

/// A visible, selectable rectangle that may be moved and modified.
VGRectView RectView(float x1, float y1, float x2, float y2) {
  VGRect rect;
  rect.Init(x1, y1, x2, y2);
  VGRectView view(rect);
  view.SetViewState(VGViewState_Visible);
  view.SetPenColor(0x0000FF);
  view.Enable(VGOperation_Select | VGOperation_Move | VGOperation_Modify);
  return view;
}

TEST(VGRect, HoldsTwoCornersInAnyOrder) {
  VGRect rect;
  EXPECT_EQ(Corners(rect), "0 0 - 0 0");
  rect.Init(9.0F, 8.0F, 1.0F, 2.0F);
  EXPECT_EQ(Corners(rect), "9 8 - 1 2");
  rect.Init(dVect2D(1, 2), dVect2D(3, 4));
  EXPECT_EQ(Corners(rect), "1 2 - 3 4");
  rect.Init(tagPOINT{5, 6}, tagPOINT{-7, 8});
  EXPECT_EQ(Corners(rect), "5 6 - -7 8");
  rect.Init(dRect(1, 2, 30, 40));
  EXPECT_EQ(Corners(rect), "1 2 - 31 42");
  rect.TopLeft().x = -1;
  rect.BottomRight() = dVect2D(5, 5);
  EXPECT_EQ(Corners(rect), "-1 2 - 5 5");
}

TEST(VGRect, CenterLiesHalfway) {
  VGRect rect;
  rect.Init(10, 4, 1, 20);
  dVect2D center;
  rect.CenterPos(center);
  EXPECT_EQ(At(center), "5.5 12");
}

TEST(VGRect, TransformMapsBothCorners) {
  Scale2D mirror(-2, 3, 0, 0);
  VGRect rect;
  rect.Init(1, 2, 3, 4);
  rect.Transform(&mirror, false);
  EXPECT_EQ(Corners(rect), "-2 6 - -6 12") << "in their order";
  rect.Transform(nullptr, false);
  EXPECT_EQ(Corners(rect), "-2 6 - -6 12");
  rect.Transform(&mirror, true);
  EXPECT_EQ(Corners(rect), "1 2 - 3 4");
}

TEST(VGRectView, IsARectangleInViewCoordinates) {
  Scale2D scale(2, 2, 0, 0);
  VGRectView view = RectView(5, 2, 4, 6);
  EXPECT_EQ(view.GetObjType(), 3);
  view.SetTransformation(&scale);
  EXPECT_EQ(Corners(view.GetViewData()), "10 4 - 8 12");
  EXPECT_EQ(BoxOf(view), "8 4 10 12");
  VGRect rect;
  rect.Init(20, 20, 30, 40);
  view.SetViewData(rect);
  EXPECT_EQ(Corners(view), "10 10 - 15 20");
  view.SetData(rect);
  EXPECT_EQ(Corners(view.GetViewData()), "40 40 - 60 80");
  const VGRectView copy(view);
  EXPECT_EQ(Corners(copy.GetViewData()), "40 40 - 60 80");
  VGRectView assigned;
  assigned = view;
  EXPECT_EQ(Corners(assigned.GetViewData()), "20 20 - 30 40");
  assigned = VGRect();
  EXPECT_EQ(Corners(assigned.GetViewData()), "0 0 - 0 0");
}

TEST(VGRectView, OutlineIsHitNotTheInside) {
  VGRectView view = RectView(10, 20, 50, 60);
  EXPECT_TRUE(IsHit(view, 30, 18, 2));
  EXPECT_FALSE(IsHit(view, 30, 17, 2));
  EXPECT_TRUE(IsHit(view, 52, 40, 2));
  EXPECT_FALSE(IsHit(view, 53, 40, 2));
  EXPECT_TRUE(IsHit(view, 30, 62, 2));
  EXPECT_FALSE(IsHit(view, 30, 63, 2));
  EXPECT_TRUE(IsHit(view, 8, 40, 2));
  EXPECT_FALSE(IsHit(view, 7, 40, 2));
  EXPECT_FALSE(IsHit(view, 30, 40, 2));
}

struct HandleCase {
  const char* name;
  float x;
  float y;
  const char* after;  ///< a drag by (3, 5)
};

class VGRectViewHandle : public ::testing::TestWithParam<HandleCase> {};

TEST_P(VGRectViewHandle, PullsItsEdges) {
  const HandleCase& handle = GetParam();
  VGRectView view = RectView(10, 20, 50, 80);
  EXPECT_EQ(StateAt(view, handle.x, handle.y), 4);
  Hand hand(view);
  EXPECT_TRUE(hand.Down(handle.x, handle.y));
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_EQ(view.GetOpState(), 4);
  EXPECT_TRUE(hand.Move(handle.x + 3, handle.y + 5));
  EXPECT_TRUE(hand.Up(handle.x + 3, handle.y + 5));
  EXPECT_EQ(Corners(view), handle.after);
  EXPECT_EQ(view.GetROPMode(), 13);
  EXPECT_EQ(view.GetOpState(), 0);
}

INSTANTIATE_TEST_SUITE_P(All, VGRectViewHandle,
                         ::testing::Values(HandleCase{"TopLeft", 10, 20, "13 25 - 50 80"},
                                           HandleCase{"TopMiddle", 30, 20, "10 25 - 50 80"},
                                           HandleCase{"TopRight", 50, 20, "10 25 - 53 80"},
                                           HandleCase{"RightMiddle", 50, 50, "10 20 - 53 80"},
                                           HandleCase{"BottomRight", 50, 80, "10 20 - 53 85"},
                                           HandleCase{"BottomMiddle", 30, 80, "10 20 - 50 85"},
                                           HandleCase{"BottomLeft", 10, 80, "13 20 - 50 85"},
                                           HandleCase{"LeftMiddle", 10, 50, "13 20 - 50 80"}),
                         [](const auto& instance) { return instance.param.name; });

TEST(VGRectView, EdgesAreGrabbedBetweenTheHandles) {
  VGRectView view = RectView(10, 20, 50, 80);
  EXPECT_EQ(StateAt(view, 14, 20), 4);
  EXPECT_EQ(StateAt(view, 15, 20), 8);
  EXPECT_EQ(StateAt(view, 20, 22), 8);
  EXPECT_EQ(StateAt(view, 20, 23), 0);
  EXPECT_EQ(StateAt(view, 30, 50), 0);
  view.Disable(2);
  EXPECT_EQ(StateAt(view, 10, 20), 0);
  view.Enable(2);
  view.ResetViewState(2);
  EXPECT_EQ(StateAt(view, 10, 20), 0);
}

TEST(VGRectView, FirstOfTwoHandlesWins) {
  VGRectView narrow = RectView(10, 20, 14, 80);
  Hand hand(narrow);
  hand.Drag(11, 20, 0, 0);
  EXPECT_EQ(Corners(narrow), "0 0 - 14 80");
}

TEST(VGRectView, EdgePulledOverTheOtherInvertsTheRectangle) {
  VGRectView view = RectView(10, 20, 50, 80);
  Hand hand(view);
  hand.Drag(30, 20, 99, 90);
  EXPECT_EQ(Corners(view), "10 90 - 50 80");
}

TEST(VGRectView, SelectionForgetsTheEdges) {
  VGRectView view = RectView(10, 20, 50, 80);
  EXPECT_EQ(StateAt(view, 10, 20), 4);
  EXPECT_EQ(StateAt(view, 200, 200), 0);
  dVect2D p(0, 0);
  EXPECT_TRUE(view.OnModify(p));
  EXPECT_EQ(Corners(view), "10 20 - 50 80");
  EXPECT_EQ(StateAt(view, 10, 20), 4);
  view.ResetViewState(VGViewState_Visible);
  EXPECT_EQ(StateAt(view, 10, 20), 0);
  EXPECT_TRUE(view.OnModify(p));
  EXPECT_EQ(Corners(view), "10 20 - 50 80") << "nor while it is not seen";
  view.SetViewState(VGViewState_Visible);
  EXPECT_EQ(StateAt(view, 10, 20), 4);
  EXPECT_TRUE(view.OnEndModify(p));
  EXPECT_TRUE(view.OnModify(p));
  EXPECT_EQ(Corners(view), "10 20 - 50 80");
}

TEST(VGRectView, MoveKeepsTheSize) {
  Scale2D scale(2, 2, 0, 0);
  VGRectView view = RectView(10, 20, 50, 80);
  Hand hand(view);
  hand.handler.SetTransformation(&scale);
  EXPECT_TRUE(hand.Down(40, 41));
  EXPECT_EQ(view.GetOpState(), 8);
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_TRUE(hand.Move(50, 51));
  EXPECT_TRUE(hand.Move(60, 51));
  EXPECT_TRUE(hand.Up(60, 51));
  EXPECT_EQ(Corners(view), "20 25 - 60 85");
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_EQ(view.GetROPMode(), 13);
}

TEST(VGRectView, CreatingDragPullsTheBottomRightCorner) {
  VGRectView view;
  view.Enable(VGOperation_Create);
  dVect2D p(20, 40);
  EXPECT_TRUE(view.VGObjectView::ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_EQ(Corners(view), "20 40 - 21 41");
  EXPECT_EQ(view.GetOpState(), 4);
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_TRUE(view.IsVisible());
  EXPECT_TRUE(view.IsSelected());
  EXPECT_TRUE(view.IsEnabled(4));
  dVect2D end(60, 30);
  EXPECT_TRUE(view.VGObjectView::ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, end));
  EXPECT_TRUE(view.VGObjectView::ProcessMouseEvent(MouseEvent_ButtonUp, MK_LBUTTON, end));
  EXPECT_EQ(Corners(view), "20 40 - 60 30");
  EXPECT_EQ(view.GetOpState(), 0);
}

TEST(VGRectView, CreationNeedsItsBitAndAClick) {
  VGRectView view;
  dVect2D p(20, 40);
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonDown, MK_LBUTTON, p));
  view.Enable(1);
  EXPECT_FALSE(view.OnCreate(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_EQ(Corners(view), "0 0 - 0 0");
  EXPECT_FALSE(view.IsVisible());
}

TEST(VGRectView, OutlineIsDrawnWithoutDecimals) {
  Canvas canvas(16, 16);
  canvas.Fill(0);
  VGRectView view = RectView(3.9F, 4.9F, 6.1F, 7.9F);
  HGDIOBJ pen = GetCurrentObject(canvas, OBJ_PEN);
  view.VGObjectView::Draw(canvas);
  EXPECT_EQ(Lit(canvas), (Pixels{{3, 4},
                                 {4, 4},
                                 {5, 4},
                                 {6, 4},
                                 {6, 5},
                                 {6, 6},
                                 {6, 7},
                                 {5, 7},
                                 {4, 7},
                                 {3, 7},
                                 {3, 6},
                                 {3, 5}}));
  EXPECT_EQ(canvas.At(3, 4), 0x0000FFu);
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_PEN), pen);
  EXPECT_EQ(RopOf(canvas), R2_COPYPEN);
}

TEST(VGRectView, HandlesAreDotsOfWidthFive) {
  Canvas canvas(64, 64);
  canvas.Fill(0);
  Canvas expected(64, 64);
  expected.Fill(0);
  VGRectView view = RectView(10, 10, 35, 41);  // odd extents: 25 and 31
  view.SetPenThickness(9);
  view.DrawSelection(canvas);
  HPEN pen = CreatePen(PS_SOLID, 5, 0x0000FF);
  HGDIOBJ old = SelectObject(expected, pen);
  const int dots[][2] = {{10, 10}, {22, 10}, {35, 10}, {35, 25},
                         {35, 41}, {23, 41}, {10, 41}, {10, 26}};
  for (const auto& dot : dots) {
    MoveToEx(expected, dot[0], dot[1], nullptr);
    LineTo(expected, dot[0], dot[1]);
  }
  SelectObject(expected, old);
  DeleteObject(pen);
  EXPECT_EQ(Lit(canvas), Lit(expected));
  EXPECT_FALSE(Lit(canvas).empty());
}

TEST(VGRectView, HugeCoordinatesAreDrawnWithoutHarm) {
  Canvas canvas(16, 16);
  canvas.Fill(0);
  VGRectView view = RectView(-1e30F, -1e30F, 1e30F, 1e30F);
  view.Select(true);
  view.VGObjectView::Draw(canvas);
  EXPECT_EQ(RopOf(canvas), R2_COPYPEN);
}

TEST(VGRectView, DragInXorLeavesNoTrace) {
  Canvas canvas(64, 64);
  canvas.Fill(0);
  VGRectView view = RectView(10, 10, 30, 30);
  view.SetPenThickness(3);
  view.SetROPMode(R2_XORPEN);
  view.Select(true);
  view.VGObjectView::Draw(canvas);
  EXPECT_EQ(canvas.At(15, 9), 0x0000FFU);
  EXPECT_EQ(canvas.At(15, 11), 0x0000FFU);
  EXPECT_EQ(canvas.At(15, 12), 0U);
  view.VGObjectView::Draw(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{});
}

}  // namespace
