// The list of a handler: finding, deleting and owning objects, and copies of handlers.

#include <vorl/GUI/GraphicHandler.h>

#include <gtest/gtest.h>

#include <memory>

#include "HandlerTesting.h"

namespace {

using gui_testing::Layer;
using gui_testing::Lines;
using gui_testing::RecordingView;

TEST(GraphicHandlerObjects, AddObjectGivesTheTransformation) {
  Layer layer;
  Translate2D trafo(1, 2);
  layer.handler.SetTransformation(&trafo);
  RecordingView view(layer.lines, "v");
  EXPECT_TRUE(layer.handler.AddObject(&view));
  EXPECT_EQ(view.GetTransformation(), &trafo);
  EXPECT_EQ(layer.Take(), Lines{"v: to view"});
  EXPECT_FALSE(layer.handler.AddObject(nullptr));
}

TEST(GraphicHandlerObjects, ObjectMayStandInTheListTwice) {
  Layer layer;
  RecordingView& view = layer.Add(1, 0, 0);
  EXPECT_TRUE(layer.handler.AddObject(&view));
  layer.Take();
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "1: draw"}));
  EXPECT_TRUE(layer.handler.DeleteObject(&view));
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), Lines{});
}

TEST(GraphicHandlerObjects, OwnedObjectThatStandsTwiceIsDestroyedOnce) {
  Layer layer;
  RecordingView& view = layer.AddOwned(1, 0, 0);
  layer.Add(2, 0, 0);
  layer.handler.AddObject(&view);
  layer.Take();
  EXPECT_TRUE(layer.handler.DeleteAll());
  EXPECT_EQ(layer.Take(), (Lines{"OnDeleteObject 1", "1: end"}));
}

TEST(GraphicHandlerObjects, FirstMatchIsFound) {
  Layer layer;
  RecordingView& first = layer.Add(1, 0, 0);
  RecordingView& second = layer.Add(2, 0, 0);
  RecordingView& third = layer.Add(2, 0, 0);
  third.type = VGType_Line;
  EXPECT_EQ(layer.handler.GetObject(1), &first);
  EXPECT_EQ(layer.handler.GetObject(2), &second);
  EXPECT_EQ(layer.handler.GetObject(3), nullptr);
  EXPECT_EQ(layer.handler.GetObject(VGType_Line, 2), &third);
  EXPECT_EQ(layer.handler.GetObject(VGType_Rect, 2), &second);
  EXPECT_EQ(layer.handler.GetObject(VGType_Line, 1), nullptr);
  EXPECT_EQ(layer.handler.GetObject(VGType_None, 1), nullptr);
  third.SetUserData(1);
  EXPECT_EQ(layer.handler.GetObjectByUserData(1), &first);
  EXPECT_EQ(layer.handler.GetObjectByUserData(2), &second);
  EXPECT_EQ(layer.handler.GetObjectByUserData(3), nullptr);
}

TEST(GraphicHandlerObjects, EmptyListHasNothingToFindOrDelete) {
  GraphicHandler handler;
  EXPECT_EQ(handler.GetObject(0), nullptr);
  EXPECT_EQ(handler.GetObject(VGType_Line, 0), nullptr);
  EXPECT_EQ(handler.GetObjectByUserData(0), nullptr);
  EXPECT_FALSE(handler.DeleteObject(0));
  EXPECT_FALSE(handler.DeleteObject(nullptr));
  EXPECT_FALSE(handler.DeleteObjects(VGType_Line, -1));
  EXPECT_FALSE(handler.DeleteSelected());
  EXPECT_FALSE(handler.DeleteActive());
  EXPECT_TRUE(handler.DeleteAll());
  Lines lines;
  RecordingView stranger(lines, "v");
  EXPECT_FALSE(handler.DeleteObject(&stranger));
}

TEST(GraphicHandlerObjects, DeletingAForeignObjectOnlyUnlinksIt) {
  Layer layer;
  RecordingView& view = layer.Add(1, 0, 0);
  Translate2D trafo(1, 2);
  layer.handler.SetTransformation(&trafo);
  layer.Down(5, 5);
  layer.Take();
  EXPECT_TRUE(layer.handler.DeleteObject(&view));
  EXPECT_EQ(layer.Take(), Lines{});
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
  EXPECT_EQ(layer.handler.GetObject(1), nullptr);
  EXPECT_EQ(view.GetTransformation(), &trafo);
}

TEST(GraphicHandlerObjects, DeletingAnOwnedObjectTellsAndDestroys) {
  Layer layer;
  RecordingView& view = layer.AddOwned(1, 0, 0);
  layer.Add(2, 20, 0);
  layer.Down(5, 5);
  layer.Take();
  layer.client.actions["OnDeleteObject"] = [&](GraphicHandler* handler, VGObjectView* object) {
    EXPECT_EQ(handler, &layer.handler);
    EXPECT_EQ(object, &view);
    EXPECT_EQ(handler->GetActiveObject(), nullptr);
    EXPECT_EQ(handler->GetObject(1), nullptr);
  };
  EXPECT_TRUE(layer.handler.DeleteObject(&view));
  EXPECT_EQ(layer.Take(), (Lines{"OnDeleteObject 1", "1: end"}));
}

TEST(GraphicHandlerObjects, OwnershipMayBeGivenLater) {
  Layer layer;
  auto* view = new RecordingView(layer.lines, "v");
  view->recordsEnd = true;
  layer.handler.AddObject(view);
  view->SetDynamicCreationFlag();
  layer.Take();
  EXPECT_TRUE(layer.handler.DeleteAll());
  EXPECT_EQ(layer.Take(), (Lines{"OnDeleteObject 0", "v: end"}));
}

TEST(GraphicHandlerObjects, ObjectOutsideTheListIsLeftAlone) {
  Layer layer;
  layer.Add(1, 0, 0);
  auto stranger = std::make_unique<RecordingView>(layer.lines, "stranger");
  stranger->recordsEnd = true;
  stranger->SetDynamicCreationFlag();
  EXPECT_TRUE(layer.handler.DeleteObject(stranger.get()));
  EXPECT_EQ(layer.Take(), Lines{});
}

TEST(GraphicHandlerObjects, DeletingByIdGoesThroughTheVirtualForm) {
  class Counting : public GraphicHandler {
   public:
    using GraphicHandler::DeleteObject;
    bool DeleteObject(VGObjectView* object) override {
      ++count;
      return GraphicHandler::DeleteObject(object);
    }
    int count = 0;
  };
  Lines lines;
  RecordingView first(lines, "1");
  RecordingView second(lines, "2");
  first.SetObjID(7);
  second.SetObjID(7);
  Counting handler;
  handler.AddObject(&first);
  handler.AddObject(&second);
  EXPECT_TRUE(handler.DeleteObject(7));
  EXPECT_EQ(handler.count, 1);
  EXPECT_EQ(handler.GetObject(7), &second);
  EXPECT_FALSE(handler.DeleteObject(8));
  EXPECT_EQ(handler.count, 1);
  dVect2D p(5, 5);
  handler.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p);
  EXPECT_TRUE(handler.DeleteActive());
  EXPECT_EQ(handler.count, 2);
  EXPECT_FALSE(handler.DeleteActive());
  EXPECT_EQ(handler.GetObject(7), nullptr);
}

/// The user data of the objects that are left.
std::string Rest(GraphicHandler& handler) {
  std::string rest;
  for (int number = 1; number <= 9; ++number) {
    if (handler.GetObjectByUserData(number) != nullptr) {
      rest += std::to_string(number);
    }
  }
  return rest;
}

/// Lines 1 and 2, rectangle 3, and 4 of no type, whose IDs are 5, 6, 5 and 6.
class GraphicHandlerDeleteObjects : public ::testing::Test {
 protected:
  GraphicHandlerDeleteObjects() {
    for (int number = 1; number <= 4; ++number) {
      RecordingView& view = layer.Add(number, 0, 0);
      view.type = number <= 2 ? VGType_Line : number == 3 ? VGType_Rect : VGType_None;
      view.SetObjID(number % 2 == 1 ? 5 : 6);
    }
  }
  Layer layer;
};

TEST_F(GraphicHandlerDeleteObjects, AnyIdMeansAllOfTheType) {
  EXPECT_TRUE(layer.handler.DeleteObjects(VGType_Line, -1));
  EXPECT_EQ(Rest(layer.handler), "3");
}

TEST_F(GraphicHandlerDeleteObjects, IdAndTypeMustMatch) {
  EXPECT_TRUE(layer.handler.DeleteObjects(VGType_Line, 5));
  EXPECT_EQ(Rest(layer.handler), "234");
}

TEST_F(GraphicHandlerDeleteObjects, ObjectWithoutTypeIsOfEveryType) {
  EXPECT_TRUE(layer.handler.DeleteObjects(VGType_Curve, 6));
  EXPECT_EQ(Rest(layer.handler), "123");
  EXPECT_FALSE(layer.handler.DeleteObjects(VGType_Curve, 6));
}

TEST_F(GraphicHandlerDeleteObjects, NoTypeNamesOnlyObjectsWithoutOne) {
  EXPECT_FALSE(layer.handler.DeleteObjects(VGType_None, 5));
  EXPECT_EQ(Rest(layer.handler), "1234");
  EXPECT_TRUE(layer.handler.DeleteObjects(VGType_None, -1));
  EXPECT_EQ(Rest(layer.handler), "123");
}

TEST_F(GraphicHandlerDeleteObjects, UnknownIdDeletesNothing) {
  EXPECT_FALSE(layer.handler.DeleteObjects(VGType_Line, 7));
  EXPECT_EQ(Rest(layer.handler), "1234");
}

TEST_F(GraphicHandlerDeleteObjects, SelectedOnesGoTogether) {
  layer.handler.GetObjectByUserData(1)->Select(true);
  layer.handler.GetObjectByUserData(4)->Select(true);
  EXPECT_TRUE(layer.handler.DeleteSelected());
  EXPECT_EQ(Rest(layer.handler), "23");
  EXPECT_FALSE(layer.handler.DeleteSelected());
}

TEST_F(GraphicHandlerDeleteObjects, DeleteAllLeavesNoneActive) {
  layer.Down(5, 5);
  EXPECT_NE(layer.handler.GetActiveObject(), nullptr);
  EXPECT_TRUE(layer.handler.DeleteAll());
  EXPECT_EQ(Rest(layer.handler), "");
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
}

TEST(GraphicHandlerOwnership, EndOfTheHandlerIsTheEndOfItsObjects) {
  Lines lines;
  gui_testing::RecordingClient client(lines);
  RecordingView foreign(lines, "foreign");
  {
    GraphicHandler handler;
    handler.SetInterface(&client);
    auto* owned = new RecordingView(lines, "owned");
    owned->recordsEnd = true;
    owned->SetDynamicCreationFlag();
    foreign.recordsEnd = true;
    handler.AddObject(owned);
    handler.AddObject(&foreign);
    lines.clear();
  }
  EXPECT_EQ(lines, Lines{"owned: end"}) << "the interface may be gone, and is not told";
  foreign.recordsEnd = false;
}

TEST(GraphicHandlerOwnership, ObjectThatIsDestroyedLeavesItsLists) {
  Layer layer;
  GraphicHandler other;
  {
    RecordingView view(layer.lines, "v");
    view.Enable(8);
    layer.handler.AddObject(&view);
    other.AddObject(&view);
    layer.Down(5, 5);
    EXPECT_EQ(layer.handler.GetActiveObject(), &view);
  }
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
  layer.Take();
  layer.handler.Draw(nullptr);
  other.Draw(nullptr);
  EXPECT_EQ(layer.Take(), Lines{});
}

TEST(GraphicHandlerOwnership, CopyListsTheObjectsAndOwnsNone) {
  Layer layer;
  RecordingView& owned = layer.AddOwned(1, 0, 0);
  RecordingView& foreign = layer.Add(2, 20, 0);
  layer.Down(5, 5);
  layer.Take();
  {
    GraphicHandler copy(layer.handler);
    EXPECT_EQ(copy.GetObject(1), &owned);
    EXPECT_EQ(copy.GetObject(2), &foreign);
    EXPECT_EQ(copy.GetActiveObject(), &owned);
    EXPECT_TRUE(copy.DeleteObject(&owned));
    EXPECT_EQ(copy.GetObject(1), nullptr);
    EXPECT_EQ(copy.GetActiveObject(), nullptr);
    EXPECT_EQ(layer.Take(), Lines{}) << "neither told nor destroyed";
    GraphicHandler second(layer.handler);
  }
  EXPECT_EQ(layer.Take(), Lines{});
  EXPECT_EQ(layer.handler.GetObject(1), &owned);
}

TEST(GraphicHandlerOwnership, CopyLosesWhatTheFirstDestroys) {
  Layer layer;
  layer.AddOwned(1, 0, 0);
  layer.Down(5, 5);
  GraphicHandler copy(layer.handler);
  layer.handler.DeleteAll();
  EXPECT_EQ(copy.GetActiveObject(), nullptr);
  EXPECT_EQ(copy.GetObject(1), nullptr);
}

TEST(GraphicHandlerOwnership, CopyOwnsWhatItIsGiven) {
  Layer layer;
  layer.AddOwned(1, 0, 0);
  GraphicHandler copy(layer.handler);
  copy.SetInterface(nullptr);
  auto* own = new RecordingView(layer.lines, "own");
  own->recordsEnd = true;
  own->SetDynamicCreationFlag();
  copy.AddObject(own);
  layer.Take();
  copy.DeleteAll();
  EXPECT_EQ(layer.Take(), Lines{"own: end"});
}

TEST(GraphicHandlerOwnership, CopyHasTheStateButNoTransformation) {
  Layer layer;
  Translate2D trafo(1, 2);
  layer.handler.SetTransformation(&trafo);
  layer.handler.Disable(4);
  layer.handler.SetCreateMode(VGType_Line, 42);
  layer.handler.SelectUnitX(2);
  layer.handler.SelectUnitY(3);
  gui_testing::CreatingHandler copy(layer.handler);
  EXPECT_FALSE(copy.IsEnabled(4));
  EXPECT_EQ(copy.GetUnitTrafoX().GetUnitID(), 2);
  EXPECT_EQ(copy.GetUnitTrafoY().GetUnitID(), 3);
  dVect2D p(5, 5);
  EXPECT_TRUE(copy.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_EQ(layer.Take(), (Lines{"CreateObject 2", "new: to view", "new: create 4098 1 (5, 5)",
                                 "OnCreateObject 99"}));
  ASSERT_NE(copy.GetObject(42), nullptr);
  EXPECT_NE(copy.GetObject(42)->GetTransformation(), &trafo);
}

TEST(GraphicHandlerOwnership, AssignmentReplacesTheObjects) {
  Layer layer;
  layer.AddOwned(1, 0, 0);
  Layer target;
  target.AddOwned(2, 0, 0);
  target.Add(3, 0, 0);
  GraphicHandler& handler = target.handler;
  handler = static_cast<GraphicHandler&>(layer.handler);
  EXPECT_EQ(target.Take(), (Lines{"OnDeleteObject 2", "2: end"}));
  EXPECT_EQ(Rest(handler), "1");
  handler = GraphicHandler();
  EXPECT_EQ(Rest(handler), "");
  EXPECT_EQ(Rest(layer.handler), "1");
  EXPECT_EQ(layer.Take(), Lines{});
}

TEST(GraphicHandlerOwnership, AssignmentOfItsOwnCopyKeepsTheObjects) {
  Layer layer;
  layer.AddOwned(1, 0, 0);
  layer.AddOwned(2, 0, 0);
  GraphicHandler copy(layer.handler);
  copy.DeleteObject(1);
  GraphicHandler& handler = layer.handler;
  handler = copy;
  EXPECT_EQ(layer.Take(), (Lines{"OnDeleteObject 1", "1: end"}));
  EXPECT_EQ(Rest(handler), "2");
  const GraphicHandler& same = handler;
  handler = same;
  EXPECT_EQ(Rest(handler), "2");
  handler.DeleteAll();
  EXPECT_EQ(layer.Take(), (Lines{"OnDeleteObject 2", "2: end"})) << "it still owns it";
  EXPECT_EQ(Rest(copy), "");
}

}  // namespace
