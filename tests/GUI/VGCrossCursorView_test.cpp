#include <vorl/GUI/VGCrossCursorView.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::Hand;
using gui_testing::IsHit;
using gui_testing::StateAt;

/// A visible, selectable cursor that may be moved and rotated, at a position.
class Cursor : public VGCrossCursorView {
 public:
  Cursor(float posX, float posY) {
    Set(posX, posY);
    Transform(false);
    SetViewState(VGViewState_Visible);
    VGObjectView::Enable(VGOperation_Select | VGOperation_Move | VGOperation_Rotate);
  }
};

std::string Directions(const VGCrossCursorView& cursor) {
  return At(cursor.GetCursorOrientation(1)) + " / " + At(cursor.GetCursorOrientation(2));
}

/// A drag with the shift key held.
void ShiftDrag(VGObjectView& view, std::initializer_list<dVect2D> points) {
  GraphicHandler handler;
  handler.SetTransformation(view.GetTransformation());
  handler.AddObject(&view);
  int event = MouseEvent_ButtonDown;
  dVect2D p;
  for (const dVect2D& point : points) {
    p = point;
    handler.ProcessMouseEvent(event, MK_LBUTTON | MK_SHIFT, p);
    event = MouseEvent_Move;
  }
  handler.ProcessMouseEvent(MouseEvent_ButtonUp, MK_LBUTTON | MK_SHIFT, p);
}

TEST(VGCrossCursorView, StartsAtTheOriginAlongTheAxes) {
  VGCrossCursorView cursor;
  EXPECT_EQ(cursor.GetObjType(), 10);
  EXPECT_EQ(At(cursor), "0 0");
  EXPECT_EQ(At(cursor.GetViewPos()), "0 0");
  EXPECT_EQ(cursor.GetCursorMode(), 3);
  EXPECT_EQ(Directions(cursor), "1 0 / 0 1");
  EXPECT_EQ(cursor.GetCursorColor(1), 0xE0E0);
  EXPECT_EQ(cursor.GetCursorColor(2), 0xE0E0);
  EXPECT_FALSE(cursor.IsVisible());
}

TEST(VGCrossCursorView, IndexTwoSetsBothDirections) {
  VGCrossCursorView cursor;
  cursor.SetCursorOrientation(1, dVect2D(3, 4));
  EXPECT_EQ(Directions(cursor), "3 4 / 0 1");
  cursor.SetCursorOrientation(2, dVect2D(5, 6));
  EXPECT_EQ(Directions(cursor), "5 6 / 5 6");
  cursor.SetCursorOrientation(0, dVect2D(7, 8));
  EXPECT_EQ(Directions(cursor), "7 8 / 5 6") << "any other index is the first";
  EXPECT_EQ(At(cursor.GetCursorOrientation(0)), "7 8");
  EXPECT_EQ(At(cursor.GetCursorOrientation(-2)), "7 8");
  cursor.SetCursorOrientation(dVect2D(1, 2), dVect2D(3, 4));
  EXPECT_EQ(Directions(cursor), "1 2 / 3 4");
}

TEST(VGCrossCursorView, OwnDirectionsCanBeSwapped) {
  VGCrossCursorView cursor;
  cursor.SetCursorOrientation(cursor.GetCursorOrientation(2), cursor.GetCursorOrientation(1));
  EXPECT_EQ(Directions(cursor), "0 1 / 1 0");
}

TEST(VGCrossCursorView, IndexTwoSetsBothColours) {
  VGCrossCursorView cursor;
  cursor.SetCursorColor(1, 0x010203);
  EXPECT_EQ(cursor.GetCursorColor(1), 0x010203);
  EXPECT_EQ(cursor.GetCursorColor(2), 0xE0E0);
  cursor.SetCursorColor(2, 0x040506);
  EXPECT_EQ(cursor.GetCursorColor(1), 0x040506);
  EXPECT_EQ(cursor.GetCursorColor(2), 0x040506);
  cursor.SetCursorColor(3, 0x070809);
  EXPECT_EQ(cursor.GetCursorColor(0), 0x070809);
  EXPECT_EQ(cursor.GetCursorColor(2), 0x040506);
  cursor.SetCursorColors(11, 12);
  EXPECT_EQ(cursor.GetCursorColor(1), 11);
  EXPECT_EQ(cursor.GetCursorColor(2), 12);
}

TEST(VGCrossCursorView, PositionIsMappedBothWays) {
  Scale2D scale(2, 4, 0, 0);
  Cursor cursor(5, 6);
  cursor.SetTransformation(&scale);
  EXPECT_EQ(At(cursor.GetViewPos()), "10 24");
  EXPECT_EQ(BoxOf(cursor), "10 24 10 24");
  cursor.SetViewPos(dVect2D(20, 8));
  EXPECT_EQ(At(cursor), "5 6") << "only the view position is set";
  cursor.ViewDataChanged();
  EXPECT_EQ(At(cursor), "10 2");
}

TEST(VGCrossCursorView, CopiesAreEqual) {
  Scale2D scale(2, 2, 0, 0);
  Cursor cursor(5, 6);
  cursor.SetTransformation(&scale);
  cursor.SetCursorMode(2);
  cursor.SetCursorOrientation(dVect2D(1, 2), dVect2D(3, 4));
  cursor.SetCursorColors(11, 12);
  const VGCrossCursorView copy(cursor);
  EXPECT_EQ(At(copy.GetViewPos()), "10 12");
  VGCrossCursorView assigned;
  assigned = cursor;
  EXPECT_EQ(At(assigned.GetViewPos()), "5 6") << "by its own map";
  for (const VGCrossCursorView* other : {&copy, static_cast<const VGCrossCursorView*>(&assigned)}) {
    EXPECT_EQ(At(*other), "5 6");
    EXPECT_EQ(other->GetCursorMode(), 2);
    EXPECT_EQ(Directions(*other), "1 2 / 3 4");
    EXPECT_EQ(other->GetCursorColor(1), 11);
    EXPECT_EQ(other->GetCursorColor(2), 12);
    EXPECT_TRUE(other->IsVisible());
  }
}

TEST(VGCrossCursorView, LinesThatAreShownAreHit) {
  Cursor cursor(50, 60);
  EXPECT_TRUE(IsHit(cursor, -1000, 62, 2));
  EXPECT_FALSE(IsHit(cursor, -1000, 63, 2));
  EXPECT_TRUE(IsHit(cursor, 48, 999, 2));
  EXPECT_FALSE(IsHit(cursor, 47, 999, 2));
  cursor.SetCursorMode(1);
  EXPECT_TRUE(IsHit(cursor, 0, 60, 2));
  EXPECT_FALSE(IsHit(cursor, 50, 0, 2));
  cursor.SetCursorMode(2);
  EXPECT_FALSE(IsHit(cursor, 0, 60, 2));
  EXPECT_TRUE(IsHit(cursor, 50, 0, 2));
  cursor.SetCursorMode(0);
  EXPECT_FALSE(IsHit(cursor, 50, 60, 2));
  cursor.SetCursorMode(7);
  EXPECT_TRUE(IsHit(cursor, 0, 60, 2));
  EXPECT_TRUE(IsHit(cursor, 50, 0, 2));
}

TEST(VGCrossCursorView, DirectionsAreMappedBeforeTheyAreHit) {
  Scale2D scale(1, 3, 0, 0);
  Cursor cursor(10, 10);
  cursor.SetCursorMode(1);
  cursor.SetCursorOrientation(1, dVect2D(1, 1));
  cursor.SetTransformation(&scale);
  EXPECT_TRUE(IsHit(cursor, 20, 60, 0));
  EXPECT_FALSE(IsHit(cursor, 20, 40, 2));
}

TEST(VGCrossCursorView, ShiftGrabsForRotating) {
  Cursor cursor(50, 60);
  dVect2D p(0, 62);
  EXPECT_EQ(cursor.VGCrossCursorView::GetSelectionState(0, p), 8);
  EXPECT_EQ(cursor.VGCrossCursorView::GetSelectionState(MK_SHIFT, p), 32);
  EXPECT_EQ(cursor.VGCrossCursorView::GetSelectionState(MK_CONTROL, p), 8);
  EXPECT_EQ(StateAt(cursor, 0, 63), 0);
  cursor.SetSelectionDistances(3, 4);
  EXPECT_EQ(StateAt(cursor, 0, 63), 8);
  cursor.Disable(2);
  EXPECT_EQ(StateAt(cursor, 0, 60), 0);
  cursor.Enable(2);
  cursor.ResetViewState(2);
  EXPECT_EQ(StateAt(cursor, 0, 60), 0);
}

TEST(VGCrossCursorView, MovePutsThePositionUnderTheMouse) {
  Scale2D scale(2, 2, 0, 0);
  Cursor cursor(25, 30);
  Hand hand(cursor);
  hand.handler.SetTransformation(&scale);
  EXPECT_TRUE(hand.Down(10, 61));
  EXPECT_EQ(cursor.GetOpState(), 8);
  EXPECT_EQ(cursor.GetROPMode(), 7);
  EXPECT_EQ(At(cursor), "25 30") << "nothing moves by a click";
  EXPECT_TRUE(hand.Move(12, 70));
  EXPECT_EQ(At(cursor.GetViewPos()), "12 70");
  EXPECT_TRUE(hand.Up(12, 70));
  EXPECT_EQ(At(cursor), "6 35");
  EXPECT_EQ(cursor.GetOpState(), 0);
  EXPECT_EQ(cursor.GetROPMode(), 13);
  EXPECT_EQ(Directions(cursor), "1 0 / 0 1");
}

TEST(VGCrossCursorView, RotateTurnsBothDirectionsAboutThePosition) {
  Cursor cursor(50, 50);
  cursor.SetCursorOrientation(dVect2D(1, 0), dVect2D(0, 3));
  ShiftDrag(cursor, {dVect2D(90, 50), dVect2D(90, 90)});
  EXPECT_EQ(Directions(cursor), "0.71 0.71 / -2.12 2.12") << "by 45 degrees, at their lengths";
  EXPECT_EQ(At(cursor), "50 50");
  EXPECT_EQ(cursor.GetOpState(), 0);
  EXPECT_EQ(cursor.GetROPMode(), 13);
}

TEST(VGCrossCursorView, QuarterTurnsAreExact) {
  Cursor cursor(50, 50);
  ShiftDrag(cursor, {dVect2D(90, 50), dVect2D(61, 47), dVect2D(50, 7)});
  EXPECT_EQ(cursor.GetCursorOrientation(1).x, 0.0F);
  EXPECT_EQ(cursor.GetCursorOrientation(1).y, -1.0F);
  EXPECT_EQ(cursor.GetCursorOrientation(2).x, 1.0F);
  EXPECT_EQ(cursor.GetCursorOrientation(2).y, 0.0F);
}

TEST(VGCrossCursorView, LineKeepsUnderTheMouseWhereScalesDiffer) {
  Scale2D scale(1, 2, 0, 0);
  Cursor cursor(50, 50);
  cursor.SetTransformation(&scale);  // at (50, 100)
  ShiftDrag(cursor, {dVect2D(90, 100), dVect2D(90, 180)});
  EXPECT_EQ(Directions(cursor), "0.71 0.71 / -0.71 0.71") << "perpendicular in graphic coordinates";
  EXPECT_TRUE(IsHit(cursor, 90, 180, 0));
}

TEST(VGCrossCursorView, RotationNeedsADirection) {
  Cursor cursor(50, 50);
  cursor.VGObjectView::Enable(VGOperation_All);
  dVect2D p(50, 50);
  EXPECT_TRUE(cursor.OnBeginRotate(p));
  EXPECT_EQ(cursor.GetROPMode(), 7);
  EXPECT_TRUE(cursor.OnRotate(p));
  EXPECT_EQ(Directions(cursor), "1 0 / 0 1");
  p.Set(50.0, 70.0);
  EXPECT_TRUE(cursor.OnRotate(p));
  EXPECT_EQ(Directions(cursor), "1 0 / 0 1") << "from here on";
  p.Set(30.0, 50.0);
  EXPECT_TRUE(cursor.OnRotate(p));
  EXPECT_EQ(Directions(cursor), "0 1 / -1 0");
  p.Set(50.0, 50.0);
  EXPECT_TRUE(cursor.OnRotate(p));
  EXPECT_EQ(Directions(cursor), "0 1 / -1 0");
  EXPECT_TRUE(cursor.OnEndRotate(p));
  EXPECT_EQ(cursor.GetROPMode(), 13);
}

TEST(VGCrossCursorView, ShiftMovesWhereRotatingIsNotAllowed) {
  Cursor cursor(50, 50);
  cursor.Disable(VGOperation_Rotate);
  ShiftDrag(cursor, {dVect2D(90, 50), dVect2D(20, 30)});
  EXPECT_EQ(At(cursor), "20 30");
  EXPECT_EQ(Directions(cursor), "1 0 / 0 1");
}

TEST(VGCrossCursorView, IsCreatedByTheClickAndDragged) {
  Scale2D scale(2, 2, 0, 0);
  VGCrossCursorView cursor;
  cursor.SetTransformation(&scale);
  cursor.Enable(VGOperation_Create | VGOperation_Rotate);
  VGObjectView& view = cursor;
  dVect2D p(20, 40);
  EXPECT_TRUE(view.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_EQ(At(cursor), "10 20");
  EXPECT_TRUE(cursor.IsVisible());
  EXPECT_TRUE(cursor.IsSelected());
  EXPECT_FALSE(cursor.IsEnabled(32));
  EXPECT_TRUE(cursor.IsEnabled(8));
  EXPECT_EQ(cursor.GetOpState(), 8);
  EXPECT_EQ(cursor.GetROPMode(), 7);
  p.Set(60.0, 30.0);
  EXPECT_TRUE(view.ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_TRUE(view.ProcessMouseEvent(MouseEvent_ButtonUp, MK_LBUTTON, p));
  EXPECT_EQ(At(cursor), "30 15");
  EXPECT_EQ(cursor.GetOpState(), 0);
}

TEST(VGCrossCursorView, CreationNeedsItsBitAndAClick) {
  VGCrossCursorView cursor;
  dVect2D p(20, 40);
  EXPECT_FALSE(cursor.OnCreate(MouseEvent_ButtonDown, MK_LBUTTON, p));
  cursor.Enable(1);
  EXPECT_FALSE(cursor.OnCreate(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_FALSE(cursor.OnCreate(MouseEvent_ButtonUp, MK_LBUTTON, p));
  EXPECT_EQ(At(cursor), "0 0");
  EXPECT_FALSE(cursor.IsVisible());
  EXPECT_FALSE(cursor.IsEnabled(8));
}

}  // namespace
