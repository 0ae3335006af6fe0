#include <vorl/GUI/VGLine.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::Hand;
using gui_testing::IsHit;
using gui_testing::StateAt;

constexpr short kRotate = 32;

/// Position and end in graphic coordinates.
std::string Ends(const VGLine& line) {
  return At(line.GetPos()) + " - " + At(line.GetEndPos());
}

/// A visible, selectable line that may be moved and modified.
VGLineView LineView(float x1, float y1, float x2, float y2, TLine type) {
  VGLine line;
  line.Init(dVect2D(x1, y1), dVect2D(x2, y2), type);
  VGLineView view(line);
  view.SetViewState(VGViewState_Visible);
  view.Enable(VGOperation_Select | VGOperation_Move | VGOperation_Modify);
  return view;
}

TEST(VGLine, StartsInfiniteAlongX) {
  const VGLine line;
  EXPECT_EQ(line.GetType(), TLine_Infinite);
  EXPECT_EQ(static_cast<int>(TLine_Infinite), 1);
  EXPECT_EQ(static_cast<int>(TLine_Segment), 2);
  EXPECT_EQ(At(line.GetPos()), "0 0");
  EXPECT_EQ(At(line.GetVector()), "1 0");
}

TEST(VGLine, InitTakesPositionAndEnd) {
  VGLine line;
  line.Init(dVect2D(1, 2), dVect2D(4, 6), TLine_Segment);
  EXPECT_EQ(line.GetType(), TLine_Segment);
  EXPECT_EQ(At(line.GetPos()), "1 2");
  EXPECT_EQ(At(line.GetVector()), "3 4");
  EXPECT_EQ(line.GetLength(), 5.0F);
  line.Init(tagPOINT{10, 20}, tagPOINT{11, 18}, TLine_Infinite);
  EXPECT_EQ(line.GetType(), TLine_Infinite);
  EXPECT_EQ(At(line.GetPos()), "10 20");
  EXPECT_EQ(At(line.GetVector()), "1 -2");
}

TEST(VGLine, SettersKeepTheRest) {
  VGLine line;
  line.SetType(TLine_Segment);
  line.SetPos(dVect2D(5, 5));
  EXPECT_EQ(At(line.GetVector()), "1 0");
  line.SetEndPos(dVect2D(7, 9));
  EXPECT_EQ(At(line.GetPos()), "5 5");
  EXPECT_EQ(At(line.GetVector()), "2 4");
  line.SetVector(dVect2D(-1, -1));
  EXPECT_EQ(At(line.GetEndPos()), "4 4");
  EXPECT_EQ(line.GetType(), TLine_Segment);
}

TEST(VGLine, TransformMovesThePositionNotTheVector) {
  Translate2D move(10, 20);
  Scale2D scale(2, 4, 0, 0);
  VGLine line;
  line.Init(dVect2D(1, 2), dVect2D(4, 6), TLine_Segment);
  line.Transform(&move, false);
  EXPECT_EQ(Ends(line), "11 22 - 14 26");
  line.Transform(&move, true);
  line.Transform(&scale, false);
  EXPECT_EQ(At(line.GetPos()) + " " + At(line.GetVector()), "2 8 6 16");
  line.Transform(nullptr, false);
  EXPECT_EQ(Ends(line), "2 8 - 8 24");
  VGLine mapped;
  mapped.Init(line, &scale, true);
  EXPECT_EQ(Ends(mapped), "1 2 - 4 6");
  EXPECT_EQ(mapped.GetType(), TLine_Segment);
}

TEST(VGLineView, IsALineInViewCoordinates) {
  Scale2D scale(2, 2, 0, 0);
  VGLineView view = LineView(1, 2, 4, 6, TLine_Segment);
  EXPECT_EQ(view.GetObjType(), 2);
  view.SetTransformation(&scale);
  EXPECT_EQ(Ends(view), "1 2 - 4 6");
  EXPECT_EQ(Ends(view.GetViewData()), "2 4 - 8 12");
  EXPECT_EQ(BoxOf(view), "2 4 8 12");
  VGLine line;
  line.Init(dVect2D(20, 20), dVect2D(10, 40), TLine_Infinite);
  view.SetViewData(line);
  EXPECT_EQ(Ends(view), "10 10 - 5 20");
  EXPECT_EQ(view.GetType(), TLine_Infinite);
  EXPECT_EQ(BoxOf(view), "10 20 20 40");
  view.SetData(line);
  EXPECT_EQ(Ends(view.GetViewData()), "40 40 - 20 80");
}

TEST(VGLineView, CopiesFromLinesAndViews) {
  Scale2D scale(2, 2, 0, 0);
  VGLineView view = LineView(1, 2, 4, 6, TLine_Segment);
  view.SetTransformation(&scale);
  view.SetPenThickness(9);
  VGLineView copy(view);
  EXPECT_EQ(Ends(copy.GetViewData()), "2 4 - 8 12");
  EXPECT_EQ(copy.GetPenThickness(), 9);
  VGLineView assigned;
  assigned = view;
  EXPECT_EQ(Ends(assigned), "1 2 - 4 6");
  EXPECT_EQ(Ends(assigned.GetViewData()), "1 2 - 4 6") << "it has its own transformation";
  EXPECT_EQ(assigned.GetPenThickness(), 9);
  VGLine line;
  copy = line;
  EXPECT_EQ(Ends(copy.GetViewData()), "0 0 - 2 0");
  EXPECT_EQ(copy.GetPenThickness(), 9);
}

TEST(VGLineView, SegmentIsHitBetweenItsEnds) {
  VGLineView view = LineView(10, 10, 30, 10, TLine_Segment);
  EXPECT_TRUE(IsHit(view, 20, 12, 2));
  EXPECT_FALSE(IsHit(view, 20, 13, 2));
  EXPECT_FALSE(IsHit(view, 40, 10, 2));
  view.SetType(TLine_Infinite);
  EXPECT_TRUE(IsHit(view, 40, 10, 2));
  view.SetType(static_cast<TLine>(3));
  EXPECT_FALSE(IsHit(view, 40, 10, 2)) << "any other type is a segment here";
}

TEST(VGLineView, SegmentIsGrabbedByEndsAndMiddle) {
  VGLineView view = LineView(10, 10, 50, 10, TLine_Segment);
  EXPECT_EQ(StateAt(view, 10, 14), 4);
  EXPECT_EQ(StateAt(view, 10, 15), 0);
  EXPECT_EQ(StateAt(view, 54, 10), 4);
  EXPECT_EQ(StateAt(view, 30, 12), 8);
  EXPECT_EQ(StateAt(view, 30, 13), 0);
  view.Enable(kRotate);
  EXPECT_EQ(StateAt(view, 10, 14), 32);
  EXPECT_EQ(StateAt(view, 54, 10), 32);
  EXPECT_EQ(StateAt(view, 30, 12), 8);
  view.SetSelectionDistances(5, 1);
  EXPECT_EQ(StateAt(view, 10, 14), 8);
  EXPECT_EQ(StateAt(view, 30, 15), 8);
}

TEST(VGLineView, InfiniteLineIsGrabbedByPositionAndRest) {
  VGLineView view = LineView(10, 10, 50, 10, TLine_Infinite);
  EXPECT_EQ(StateAt(view, 10, 14), 8);
  EXPECT_EQ(StateAt(view, 200, 12), 8);
  EXPECT_EQ(StateAt(view, 50, 13), 0);
  view.Enable(kRotate);
  EXPECT_EQ(StateAt(view, 10, 14), 8);
  EXPECT_EQ(StateAt(view, 200, 12), 32);
}

TEST(VGLineView, IsNotGrabbedWhenInvisibleOrNotSelectable) {
  VGLineView view = LineView(10, 10, 50, 10, TLine_Segment);
  view.Disable(2);
  EXPECT_EQ(StateAt(view, 10, 10), 0);
  view.Enable(2);
  view.ResetViewState(2);
  EXPECT_EQ(StateAt(view, 10, 10), 0);
}

TEST(VGLineView, MoveKeepsTheVector) {
  Scale2D scale(2, 2, 0, 0);
  VGLineView view = LineView(10, 10, 30, 10, TLine_Segment);
  Hand hand(view);
  hand.handler.SetTransformation(&scale);
  EXPECT_TRUE(hand.Down(40, 21));
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_EQ(view.GetOpState(), 8);
  EXPECT_TRUE(hand.Move(42, 31));
  EXPECT_TRUE(hand.Move(44, 31));
  EXPECT_EQ(Ends(view), "12 15 - 32 15");
  EXPECT_TRUE(hand.Up(44, 31));
  EXPECT_EQ(view.GetROPMode(), 13);
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_EQ(Ends(view), "12 15 - 32 15");
}

TEST(VGLineView, EndsArePulledOneByOne) {
  VGLineView view = LineView(10, 10, 50, 10, TLine_Segment);
  Hand hand(view);
  EXPECT_TRUE(hand.Down(12, 10));
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_EQ(view.GetOpState(), 4);
  EXPECT_EQ(Ends(view), "10 10 - 50 10");
  EXPECT_TRUE(hand.Move(0, 30));
  EXPECT_EQ(Ends(view), "0 30 - 50 10");
  EXPECT_TRUE(hand.Up(0, 30));
  EXPECT_EQ(view.GetROPMode(), 13);
  EXPECT_EQ(view.GetOpState(), 0);
  hand.Drag(50, 11, 60, 20);
  EXPECT_EQ(Ends(view), "0 30 - 60 20");
}

TEST(VGLineView, EndWinsWhereBothAreNear) {
  VGLineView view = LineView(10, 10, 12, 10, TLine_Segment);
  Hand hand(view);
  hand.Drag(10, 10, 40, 40);
  EXPECT_EQ(Ends(view), "10 10 - 40 40");
}

TEST(VGLineView, ModifyingWithoutAHandleChangesNothing) {
  VGLineView view = LineView(10, 10, 50, 10, TLine_Segment);
  dVect2D beside(30, 10);
  dVect2D away(80, 80);
  EXPECT_TRUE(view.OnBeginModify(beside));
  EXPECT_TRUE(view.OnModify(away));
  EXPECT_EQ(Ends(view), "10 10 - 50 10");
  dVect2D start(10, 10);
  view.OnBeginModify(start);
  view.OnBeginModify(beside);
  EXPECT_TRUE(view.OnModify(away));
  EXPECT_EQ(Ends(view), "10 10 - 50 10") << "each drag chooses anew";
  view.OnBeginModify(start);
  EXPECT_TRUE(view.OnEndModify(start));
  EXPECT_TRUE(view.OnModify(away));
  EXPECT_EQ(Ends(view), "10 10 - 50 10") << "the end of the drag let go of it";
}

TEST(VGLineView, SegmentTurnsAboutItsMidpoint) {
  VGLineView view = LineView(10, 10, 50, 10, TLine_Segment);
  view.Enable(kRotate);
  Hand hand(view);
  EXPECT_TRUE(hand.Down(50, 10));
  EXPECT_EQ(view.GetOpState(), 32);
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_TRUE(hand.Move(30, 100));
  EXPECT_EQ(Ends(view), "30 -10 - 30 30");
  EXPECT_TRUE(hand.Move(27, 6));  // 3 to the left, 4 up
  EXPECT_EQ(Ends(view), "42 26 - 18 -6");
  EXPECT_FLOAT_EQ(view.GetLength(), 40.0F);
  EXPECT_TRUE(hand.Up(27, 6));
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_EQ(view.GetROPMode(), 13);
}

TEST(VGLineView, InfiniteLineTurnsAboutItsPosition) {
  VGLineView view = LineView(10, 10, 50, 10, TLine_Infinite);
  view.Enable(kRotate);
  Hand hand(view);
  hand.Drag(40, 10, 10, 35);
  EXPECT_EQ(At(view.GetPos()), "10 10");
  EXPECT_EQ(At(view.GetVector()), "0 25");
}

TEST(VGLineView, RotationToThePositionOrCentreChangesNothing) {
  for (const TLine type : {TLine_Infinite, TLine_Segment}) {
    VGLineView view = LineView(10, 10, 50, 10, type);
    dVect2D grabbed(50, 10);
    dVect2D position(10, 10);
    EXPECT_TRUE(view.OnBeginRotate(grabbed));
    EXPECT_TRUE(view.OnRotate(position));
    EXPECT_EQ(Ends(view), "10 10 - 50 10");
  }
  VGLineView view = LineView(10, 10, 50, 10, TLine_Segment);
  dVect2D grabbed(50, 10);
  dVect2D center(30, 10);
  view.OnBeginRotate(grabbed);
  EXPECT_TRUE(view.OnRotate(center));
  EXPECT_EQ(Ends(view), "10 10 - 50 10") << "its length is kept";
}

/// Creates lines by click.
class LineHandler : public GraphicHandler {
 public:
  VGObjectView* CreateObject(VGType type) override {
    if (type != VGType_Line) {
      return nullptr;
    }
    auto* const line = new VGLineView();
    line->SetDynamicCreationFlag();
    return line;
  }
};

TEST(VGLineView, CreatingDragPullsTheEnd) {
  LineHandler handler;
  Scale2D scale(2, 2, 0, 0);
  handler.SetTransformation(&scale);
  handler.SetCreateMode(VGType_Line, 42);
  dVect2D p(20, 40);
  EXPECT_TRUE(handler.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  auto* const line = dynamic_cast<VGLineView*>(handler.GetObject(42));
  ASSERT_NE(line, nullptr);
  EXPECT_EQ(line->GetType(), TLine_Segment);
  EXPECT_EQ(At(line->GetPos()) + " " + At(line->GetVector()), "10 20 0.5 0");
  EXPECT_EQ(line->GetOpState(), 4);
  EXPECT_EQ(line->GetROPMode(), 7);
  EXPECT_TRUE(line->IsVisible());
  EXPECT_TRUE(line->IsSelected());
  EXPECT_FALSE(line->IsEnabled(kRotate));
  EXPECT_TRUE(line->IsEnabled(4));
  p.Set(60, 80);
  EXPECT_TRUE(handler.ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_EQ(Ends(*line), "10 20 - 30 40");
  EXPECT_TRUE(handler.ProcessMouseEvent(MouseEvent_ButtonUp, MK_LBUTTON, p));
  EXPECT_EQ(line->GetOpState(), 0);
  EXPECT_EQ(line->GetROPMode(), 13);
  p.Set(200, 200);
  EXPECT_FALSE(handler.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
}

TEST(VGLineView, CreationNeedsItsBitAndAClick) {
  VGLineView view;
  dVect2D p(20, 40);
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonDown, MK_LBUTTON, p));
  view.Enable(1);
  EXPECT_FALSE(view.OnCreate(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonUp, MK_LBUTTON, p));
  EXPECT_EQ(view.GetType(), TLine_Infinite);
  view.Enable(kRotate);
  EXPECT_TRUE(view.OnCreate(MouseEvent_ButtonDown, 0, p));
  EXPECT_TRUE(view.IsEnabled(1 | 4)) << "its end may be pulled";
  EXPECT_FALSE(view.IsEnabled(kRotate));
}

}  // namespace
