// Drawing, hitting, selecting and dragging through a handler.

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include "HandlerTesting.h"

namespace {

using gui_testing::CreatingHandler;
using gui_testing::Layer;
using gui_testing::Lines;
using gui_testing::RecordingView;

TEST(GraphicHandler, StartsVisibleInteractiveAndEmpty) {
  GraphicHandler handler;
  EXPECT_TRUE(handler.IsEnabled(7));
  EXPECT_FALSE(handler.IsEnabled(8));
  EXPECT_EQ(handler.GetActiveObject(), nullptr);
  EXPECT_EQ(handler.GetUnitTrafoX().GetUnitID(), 0);
  EXPECT_EQ(handler.GetUnitTrafoY().GetUnitID(), 0);
  EXPECT_EQ(handler.CreateObject(VGType_Line), nullptr);
}

TEST(GraphicHandler, FlagsAreAskedTogether) {
  GraphicHandler handler;
  handler.Disable(2);
  EXPECT_TRUE(handler.IsEnabled(1 | 4));
  EXPECT_FALSE(handler.IsEnabled(1 | 2));
  handler.Enable(2 | 16);
  EXPECT_TRUE(handler.IsEnabled(7 | 16));
}

TEST(GraphicHandler, UnitsAreKeptForEachAxis) {
  GraphicHandler handler;
  UnitTrafo x;
  x.SetUnitTrafo(1, 2.0, 0.0);
  UnitTrafo y;
  y.SetUnitTrafo(3, 5.0, 0.0);
  handler.SetUnitTrafo(x, y);
  handler.SelectUnitX(1);
  handler.SelectUnitY(3);
  EXPECT_EQ(handler.GetUnitTrafoX().A2B(1.0), 2.0);
  EXPECT_EQ(handler.GetUnitTrafoY().A2B(1.0), 5.0);
  handler.SetUnitTrafo(handler.GetUnitTrafoY(), handler.GetUnitTrafoX());
  EXPECT_EQ(handler.GetUnitTrafoX().A2B(1.0), 5.0);
  EXPECT_EQ(handler.GetUnitTrafoY().A2B(1.0), 2.0);
}

TEST(GraphicHandler, DrawsTheActiveObjectLast) {
  Layer layer;
  layer.Add(1, 0, 0);
  layer.Add(2, 20, 0);
  layer.Add(3, 40, 0);
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "2: draw", "3: draw"}));
  layer.Down(25, 5);
  layer.Take();
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "3: draw", "2: draw", "2: draw selection"}));
}

TEST(GraphicHandler, DrawsNothingUnlessVisible) {
  Layer layer;
  layer.Add(1, 0, 0);
  layer.Down(5, 5);
  layer.Take();
  layer.handler.Disable(1);
  layer.handler.Draw(nullptr);
  layer.handler.DrawActiveObject(nullptr);
  EXPECT_EQ(layer.Take(), Lines{});
}

TEST(GraphicHandler, DrawsTheActiveObjectAlone) {
  Layer layer;
  layer.Add(1, 0, 0);
  layer.Add(2, 20, 0);
  layer.handler.DrawActiveObject(nullptr);
  EXPECT_EQ(layer.Take(), Lines{});
  layer.Down(25, 5);
  layer.Take();
  layer.handler.DrawActiveObject(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"2: draw", "2: draw selection"}));
}

TEST(GraphicHandler, DrawsWithAViewportInTheSameOrder) {
  Layer layer;
  GraphicViewPort viewPort;
  layer.Add(1, 0, 0);
  layer.Add(2, 20, 0);
  layer.Down(5, 5);
  layer.Take();
  layer.handler.Draw(nullptr, viewPort);
  EXPECT_EQ(layer.Take(), (Lines{"2: draw", "1: draw", "1: draw selection"}));
  layer.handler.DrawActiveObject(nullptr, viewPort);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "1: draw selection"}));
  layer.handler.Disable(1);
  layer.handler.Draw(nullptr, viewPort);
  layer.handler.DrawActiveObject(nullptr, viewPort);
  EXPECT_EQ(layer.Take(), Lines{});
}

TEST(GraphicHandler, TakesTheWholeWayFromTheViewport) {
  Layer layer;
  RecordingView& view = layer.Add(1, 0, 0);
  GraphicViewPort viewPort(Rect2D(0, 0, 100, 100), Rect2D(0, 0, 100, 100), Rect2D(0, 0, 100, 100));
  viewPort.AddGraphic(&layer.handler);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, tagPOINT{5, 5}));
  EXPECT_EQ(viewPort.GetActiveGraphicObject(), &view);
  EXPECT_EQ(view.GetTransformation(), &viewPort.GetTrafo());
  EXPECT_TRUE(viewPort.ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, tagPOINT{6, 7}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(MouseEvent_ButtonUp, MK_LBUTTON, tagPOINT{6, 7}));
  EXPECT_EQ(layer.Take(),
            (Lines{"1: to view", "1: move (5, 5)", "OnSelectObject 1", "1: moving (6, 7)",
                   "OnModifyObject 1", "1: moved (6, 7)", "OnObjectModified 1"}));
  viewPort.RemoveGraphic(&layer.handler);
  EXPECT_NE(view.GetTransformation(), &viewPort.GetTrafo());
}

TEST(GraphicHandler, HitTestGivesTheFirstVisibleObject) {
  Layer layer;
  RecordingView& first = layer.Add(1, 0, 0);
  RecordingView& second = layer.Add(2, 5, 5);
  dVect2D p(7, 7);
  layer.Down(7, 7);
  EXPECT_EQ(layer.handler.GetActiveObject(), &second);
  EXPECT_EQ(layer.handler.HitTest(p, 0), &first) << "the active one has no preference";
  first.ResetViewState(2);
  EXPECT_EQ(layer.handler.HitTest(p, 0), &second);
  dVect2D left(4, 7);
  EXPECT_EQ(layer.handler.HitTest(left, 0), nullptr);
  EXPECT_EQ(layer.handler.HitTest(left, 1), &second);
  layer.handler.Disable(2);
  EXPECT_EQ(layer.handler.HitTest(p, 0), &second) << "need not be interactive";
  layer.handler.Disable(1);
  EXPECT_EQ(layer.handler.HitTest(p, 0), nullptr);
}

TEST(GraphicHandler, HitTestInAnEmptyListGivesNothing) {
  GraphicHandler handler;
  dVect2D p;
  EXPECT_EQ(handler.HitTest(p, 100), nullptr);
}

TEST(GraphicHandler, ClickSelectsAllUnderTheMouseAndActivatesTheLast) {
  Layer layer;
  RecordingView& first = layer.Add(1, 0, 0);
  RecordingView& second = layer.Add(2, 5, 5);
  RecordingView& third = layer.Add(3, 40, 40);
  EXPECT_TRUE(layer.Down(7, 7));
  EXPECT_TRUE(first.IsSelected());
  EXPECT_TRUE(second.IsSelected());
  EXPECT_FALSE(third.IsSelected());
  EXPECT_EQ(layer.handler.GetActiveObject(), &second);
}

TEST(GraphicHandler, SelectionTakesTheBitFromTheActiveObjectOnly) {
  Layer layer;
  RecordingView& first = layer.Add(1, 0, 0);
  RecordingView& second = layer.Add(2, 5, 5);
  dVect2D overlap(7, 7);
  dVect2D nowhere(100, 100);
  EXPECT_TRUE(layer.handler.SelectObject(0, overlap));
  EXPECT_FALSE(layer.handler.SelectObject(0, nowhere));
  EXPECT_TRUE(first.IsSelected());
  EXPECT_FALSE(second.IsSelected());
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
}

TEST(GraphicHandler, SelectionNeedsVisibleAndInteractive) {
  for (const short flag : {short{1}, short{2}}) {
    Layer layer;
    RecordingView& view = layer.Add(1, 0, 0);
    dVect2D p(5, 5);
    layer.handler.Disable(flag);
    EXPECT_FALSE(layer.handler.SelectObject(0, p));
    EXPECT_FALSE(view.IsSelected());
    EXPECT_FALSE(layer.Down(5, 5));
    layer.handler.Enable(flag);
    EXPECT_TRUE(layer.handler.SelectObject(0, p));
    layer.handler.Disable(flag);
    EXPECT_FALSE(layer.handler.SelectObject(0, p)) << "though an object is active";
    EXPECT_FALSE(layer.Down(5, 5));
    EXPECT_EQ(layer.Take(), Lines{});
  }
}

TEST(GraphicHandler, DragIsReportedByObjectAndLayer) {
  Layer layer;
  RecordingView& view = layer.Add(1, 0, 0);
  view.SetInterface(&layer.viewClient);
  EXPECT_TRUE(layer.Down(5, 5));
  EXPECT_EQ(layer.Take(), (Lines{"1: move (5, 5)", "OnBeginGraphicOp 1 8", "OnSelectObject 1"}));
  EXPECT_TRUE(layer.Move(6, 5));
  EXPECT_EQ(layer.Take(), (Lines{"1: moving (6, 5)", "OnGraphicChanged 1 8", "OnModifyObject 1"}));
  EXPECT_TRUE(layer.Up(7, 5));
  EXPECT_EQ(layer.Take(), (Lines{"1: moved (7, 5)", "OnEndGraphicOp 1 8", "OnObjectModified 1"}));
  EXPECT_FALSE(layer.Move(8, 5));
  EXPECT_FALSE(layer.Up(8, 5));
  EXPECT_EQ(layer.Take(), Lines{});
}

TEST(GraphicHandler, ActiveObjectIsOfferedTheClickFirst) {
  Layer layer;
  layer.Add(1, 0, 0);
  layer.Add(2, 5, 5);
  layer.Down(2, 2);
  layer.Up(2, 2);
  layer.Take();
  EXPECT_TRUE(layer.Down(7, 7));
  EXPECT_EQ(layer.Take(), Lines{"1: move (7, 7)"}) << "it accepts, so nothing else is selected";
}

TEST(GraphicHandler, ClickThatTheActiveObjectDeclinesSelectsAnew) {
  Layer layer;
  RecordingView& first = layer.Add(1, 0, 0);
  layer.Add(2, 20, 0);
  layer.Down(5, 5);
  layer.Up(5, 5);
  layer.Take();
  EXPECT_TRUE(layer.Down(25, 5));
  EXPECT_EQ(layer.Take(), (Lines{"2: move (25, 5)", "OnSelectObject 2"}));
  EXPECT_FALSE(first.IsSelected());
  layer.Up(25, 5);
  layer.Take();
  EXPECT_FALSE(layer.Down(100, 100));
  EXPECT_EQ(layer.Take(), Lines{"OnSelectObject null"});
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
}

TEST(GraphicHandler, ClickIsUsedEvenIfTheObjectDeclinesIt) {
  Layer layer;
  RecordingView& view = layer.Add(1, 0, 0);
  view.answer = false;
  EXPECT_TRUE(layer.Down(5, 5));
  EXPECT_EQ(layer.Take(), (Lines{"1: move (5, 5)", "OnSelectObject 1"}));
}

TEST(GraphicHandler, RightClickSelectsWithoutDragging) {
  Layer layer;
  RecordingView& view = layer.Add(1, 0, 0);
  EXPECT_TRUE(layer.Mouse(MouseEvent_ButtonDown, MK_RBUTTON, 5, 5));
  EXPECT_EQ(layer.Take(), Lines{"OnSelectObject 1"});
  EXPECT_TRUE(view.IsSelected());
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_FALSE(layer.Mouse(MouseEvent_ButtonDown, MK_RBUTTON, 50, 5));
  EXPECT_EQ(layer.Take(), Lines{"OnSelectObject null"});
  EXPECT_FALSE(view.IsSelected());
}

TEST(GraphicHandler, ClicksSelectThroughTheVirtualFunction) {
  class Choosy : public GraphicHandler {
   public:
    bool SelectObject(int flags, dVect2D& /*point*/) override {
      asked.push_back(std::to_string(flags));
      return false;
    }
    Lines asked;
  };
  Choosy handler;
  dVect2D p(5, 5);
  EXPECT_FALSE(handler.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_FALSE(handler.ProcessMouseEvent(MouseEvent_ButtonDown, MK_RBUTTON | MK_SHIFT, p));
  EXPECT_EQ(handler.asked, (Lines{"1", "6"}));
}

TEST(GraphicHandler, WorksWithoutAnInterface) {
  Layer layer;
  layer.handler.SetInterface(nullptr);
  layer.Add(1, 0, 0);
  EXPECT_TRUE(layer.Down(5, 5));
  EXPECT_TRUE(layer.Move(5, 5));
  EXPECT_TRUE(layer.Up(5, 5));
  EXPECT_FALSE(layer.Down(50, 5));
  EXPECT_FALSE(layer.Mouse(MouseEvent_ButtonDown, MK_RBUTTON, 50, 5));
  layer.handler.SetCreateMode(VGType_Line, -1);
  EXPECT_TRUE(layer.Down(50, 5));
  EXPECT_TRUE(layer.handler.DeleteAll());
}

TEST(GraphicHandler, TransformationGoesToAllObjectsOnce) {
  Layer layer;
  RecordingView& first = layer.Add(1, 0, 0);
  layer.Add(2, 20, 0);
  Trafo2DBase* const identity = first.GetTransformation();
  Translate2D trafo(1, 2);
  layer.handler.SetTransformation(nullptr);
  EXPECT_EQ(layer.Take(), Lines{}) << "there was none before";
  layer.handler.SetTransformation(&trafo);
  EXPECT_EQ(layer.Take(), (Lines{"1: to view", "2: to view"}));
  EXPECT_EQ(first.GetTransformation(), &trafo);
  layer.handler.SetTransformation(&trafo);
  EXPECT_EQ(layer.Take(), Lines{});
  layer.handler.SetTransformation(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: to view", "2: to view"}));
  EXPECT_EQ(first.GetTransformation(), identity);
}

TEST(GraphicHandler, BoundingBoxEnclosesAllObjectsAndNothingElse) {
  Layer layer;
  dVect2D min(9, 9);
  dVect2D max(9, 9);
  layer.handler.CalcBoundingBox(nullptr, min, max);
  EXPECT_EQ(gui_testing::Text(min) + gui_testing::Text(max), "(0, 0)(0, 0)");
  layer.Add(1, 5, 5);
  layer.handler.CalcBoundingBox(nullptr, min, max);
  EXPECT_EQ(gui_testing::Text(min) + gui_testing::Text(max), "(5, 5)(15, 15)");
  layer.Add(2, 30, 2).ResetViewState(2);
  layer.Add(3, 3, 40);
  layer.handler.CalcBoundingBox(nullptr, min, max);
  EXPECT_EQ(gui_testing::Text(min) + gui_testing::Text(max), "(3, 2)(40, 50)");
}

TEST(GraphicHandler, IntegerPointsReachTheObjects) {
  Layer layer;
  layer.Add(1, 0, 0);
  tagPOINT p{5, 6};
  EXPECT_TRUE(static_cast<InputEventHandler&>(layer.handler)
                  .ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_EQ(layer.Take(), (Lines{"1: move (5, 6)", "OnSelectObject 1"}));
}

TEST(IGraphicHandler, DoesNothingByDefault) {
  IGraphicHandler client;
  GraphicHandler handler;
  client.OnCreateObject(&handler, nullptr);
  client.OnDeleteObject(&handler, nullptr);
  client.OnSelectObject(&handler, nullptr);
  client.OnModifyObject(&handler, nullptr);
  client.OnObjectModified(&handler, nullptr);
  client.GHEvent(&handler, 1, nullptr);
  EXPECT_TRUE(handler.IsEnabled(7));
}

}  // namespace
