// Creating objects by clicks.

#include <vorl/GUI/GraphicHandler.h>

#include <gtest/gtest.h>

#include "HandlerTesting.h"

namespace {

using gui_testing::Layer;
using gui_testing::Lines;
using gui_testing::RecordingView;

TEST(GraphicHandlerCreate, ClickOnNothingCreatesOneObject) {
  Layer layer;
  layer.handler.SetCreateMode(VGType_Line, 42);
  EXPECT_TRUE(layer.Down(30, 40));
  EXPECT_EQ(layer.Take(), (Lines{"CreateObject 2", "new: to view", "new: create 4098 1 (30, 40)",
                                 "OnCreateObject 99"}));
  VGObjectView* const object = layer.handler.GetObject(42);
  ASSERT_NE(object, nullptr);
  EXPECT_EQ(layer.handler.GetActiveObject(), object);
  EXPECT_TRUE(object->IsEnabled(0x3F));
  EXPECT_TRUE(object->IsSelected());
  EXPECT_TRUE(object->IsVisible());
  EXPECT_EQ(object->GetOpState(), 1);
  EXPECT_TRUE(layer.Move(31, 41));
  EXPECT_EQ(layer.Take(), (Lines{"new: create 4097 1 (31, 41)", "OnModifyObject 99"}));
  EXPECT_TRUE(layer.Up(32, 42));
  EXPECT_EQ(layer.Take(), (Lines{"new: create 4099 1 (32, 42)", "OnObjectModified 99"}));
  static_cast<RecordingView*>(object)->answer = false;  // has no use for further events
  EXPECT_FALSE(layer.Down(80, 80));
  EXPECT_EQ(layer.Take(), (Lines{"new: create 4098 1 (80, 80)", "OnSelectObject null"}))
      << "one click creates one object";
}

TEST(GraphicHandlerCreate, CreateIdIsForOneObject) {
  Layer layer;
  layer.handler.SetCreateMode(VGType_Line, 42);
  layer.Down(30, 40);
  VGObjectView* const first = layer.handler.GetActiveObject();
  ASSERT_NE(first, nullptr);
  layer.handler.DeleteActive();
  layer.handler.SetCreateMode(VGType_Rect, -1);
  layer.Down(70, 70);
  VGObjectView* const second = layer.handler.GetActiveObject();
  ASSERT_NE(second, nullptr);
  EXPECT_EQ(second->GetObjID(), static_cast<long>(reinterpret_cast<std::uintptr_t>(second)));
}

TEST(GraphicHandlerCreate, ClickOnAnObjectLeavesCreationPending) {
  Layer layer;
  layer.Add(1, 0, 0);
  layer.handler.SetCreateMode(VGType_Line, -1);
  EXPECT_TRUE(layer.Down(5, 5));
  EXPECT_EQ(layer.Take(), (Lines{"1: move (5, 5)", "OnSelectObject 1"}));
  layer.Up(5, 5);
  layer.Take();
  EXPECT_TRUE(layer.Down(50, 50));
  EXPECT_EQ(layer.Take().front(), "CreateObject 2");
}

TEST(GraphicHandlerCreate, CreationThatFailsSelectsNothing) {
  Layer layer;
  layer.handler.createsNothing = true;
  layer.handler.SetCreateMode(VGType_Line, 42);
  EXPECT_FALSE(layer.Down(30, 40));
  EXPECT_EQ(layer.Take(), (Lines{"CreateObject 2", "OnSelectObject null"}));
  EXPECT_FALSE(layer.Down(30, 40));
  EXPECT_EQ(layer.Take(), Lines{"OnSelectObject null"}) << "the create mode is used up";
  layer.handler.createsNothing = false;
  layer.handler.SetCreateMode(VGType_Line, -1);
  layer.Down(30, 40);
  EXPECT_EQ(layer.handler.GetObject(42), nullptr);
}

TEST(GraphicHandlerCreate, CreatedObjectThatIsNotListedIsDestroyed) {
  Layer layer;
  layer.handler.acceptsObjects = false;
  layer.handler.SetCreateMode(VGType_Line, -1);
  EXPECT_FALSE(layer.Down(30, 40));
  EXPECT_EQ(layer.Take(), (Lines{"CreateObject 2", "new: end", "OnSelectObject null"}));
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
}

TEST(GraphicHandlerCreate, CreatedObjectGetsTheTransformationBeforeTheClick) {
  Layer layer;
  Translate2D trafo(1, 2);
  layer.handler.SetTransformation(&trafo);
  layer.handler.SetCreateMode(VGType_Line, -1);
  layer.Down(30, 40);
  ASSERT_NE(layer.handler.GetActiveObject(), nullptr);
  EXPECT_EQ(layer.handler.GetActiveObject()->GetTransformation(), &trafo);
}

}  // namespace
