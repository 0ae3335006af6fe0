// What points and texts have in common.
#include <vorl/GUI/VGPoint.h>
#include <vorl/GUI/VGText.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::Hand;
using gui_testing::IsHit;
using gui_testing::Lit;
using gui_testing::StateAt;
using Pixels = std::set<std::pair<int, int>>;

void Place(VGPoint& point, const dVect2D& pos) {
  point = pos;
}

void Place(VGText& text, const dVect2D& pos) {
  text = "";
  text.SetPos(pos, 0);
}

std::string PlaceOf(const VGPoint& point) {
  return At(point);
}

std::string PlaceOf(const VGText& text) {
  return At(text.GetPos());
}

template <class View>
class VGAnchorViewTest : public ::testing::Test {
 protected:
  VGAnchorViewTest() {
    Place(anchored, dVect2D(10, 10));
    anchored.Transform(false);
    anchored.SetViewState(VGViewState_Visible);
    anchored.Enable(VGOperation_Select | VGOperation_Move);
  }

  View anchored;
};

using Views = ::testing::Types<VGPointView, VGTextView>;
TYPED_TEST_SUITE(VGAnchorViewTest, Views);

TYPED_TEST(VGAnchorViewTest, IsHitAndGrabbedAroundItsAnchorOnly) {
  auto& view = this->anchored;
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

TYPED_TEST(VGAnchorViewTest, BoxIsTheAnchor) {
  Scale2D scale(2, 3, 0, 0);
  this->anchored.SetTransformation(&scale);
  EXPECT_EQ(BoxOf(this->anchored), "20 30 20 30");
}

TYPED_TEST(VGAnchorViewTest, DragPutsTheAnchorUnderTheMouse) {
  auto& view = this->anchored;
  Scale2D scale(2, 2, 0, 0);
  Hand hand(view);
  hand.handler.SetTransformation(&scale);
  EXPECT_TRUE(hand.Down(22, 20));
  EXPECT_EQ(view.GetROPMode(), 7);
  EXPECT_EQ(view.GetOpState(), 8);
  EXPECT_EQ(PlaceOf(view), "10 10");
  EXPECT_TRUE(hand.Move(32, 40));
  EXPECT_EQ(PlaceOf(view), "16 20");
  EXPECT_EQ(BoxOf(view), "32 40 32 40");
  EXPECT_TRUE(hand.Up(90, 90));
  EXPECT_EQ(PlaceOf(view), "16 20");
  EXPECT_EQ(view.GetROPMode(), 13);
  EXPECT_EQ(view.GetOpState(), 0);
}

TYPED_TEST(VGAnchorViewTest, ClickCreatesItAtOnce) {
  Scale2D scale(2, 2, 0, 0);
  TypeParam created;
  created.SetTransformation(&scale);
  created.Enable(VGOperation_All);
  VGObjectView& view = created;
  dVect2D p(20, 40);
  EXPECT_TRUE(view.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_EQ(PlaceOf(created), "10 20");
  EXPECT_TRUE(view.IsVisible());
  EXPECT_TRUE(view.IsSelected());
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_EQ(view.GetROPMode(), 13);
  dVect2D away(60, 60);
  EXPECT_FALSE(view.ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, away));
  EXPECT_EQ(PlaceOf(created), "10 20");
}

TYPED_TEST(VGAnchorViewTest, CreationNeedsOnlyTheClick) {
  TypeParam view;
  dVect2D p(20, 40);
  EXPECT_FALSE(view.OnCreate(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonUp, MK_LBUTTON, p));
  EXPECT_EQ(PlaceOf(view), "0 0");
  EXPECT_FALSE(view.IsVisible());
  EXPECT_TRUE(view.OnCreate(MouseEvent_ButtonDown, 0, p));
  EXPECT_EQ(PlaceOf(view), "20 40");
}

TYPED_TEST(VGAnchorViewTest, SelectionIsADotOfWidthFive) {
  auto& view = this->anchored;
  Place(view, dVect2D(12.9F, 20.1F));
  view.Transform(false);
  view.SetPenThickness(9);
  view.SetPenColor(0x0000FF);
  Canvas canvas(32, 32);
  canvas.Fill(0);
  view.DrawSelection(canvas);
  Canvas expected(32, 32);
  expected.Fill(0);
  HPEN pen = CreatePen(PS_SOLID, 5, 0x0000FF);
  HGDIOBJ old = SelectObject(expected, pen);
  MoveToEx(expected, 12, 20, nullptr);
  LineTo(expected, 12, 20);
  SelectObject(expected, old);
  DeleteObject(pen);
  EXPECT_FALSE(Lit(expected).empty());
  EXPECT_EQ(Lit(canvas), Lit(expected));
  EXPECT_EQ(canvas.At(12, 20), 0x0000FFU);
  view.SetROPMode(R2_XORPEN);
  view.DrawSelection(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{}) << "drawn twice, it is gone";
}

TYPED_TEST(VGAnchorViewTest, PlacesOutOfReachDoNoHarm) {
  auto& view = this->anchored;
  Canvas canvas(8, 8);
  canvas.Fill(0);
  for (const float distant : {1e30F, -3e38F, INFINITY, NAN}) {
    Place(view, dVect2D(distant, distant));
    view.Transform(false);
    view.Select(true);
    static_cast<VGObjectView&>(view).Draw(canvas);
    EXPECT_FALSE(IsHit(view, 4, 4, 100));
  }
  view.DrawGraphic(nullptr);
  view.DrawSelection(nullptr);
}

}  // namespace
