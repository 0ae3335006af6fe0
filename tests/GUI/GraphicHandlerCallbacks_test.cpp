// What the handler calls may delete anything in its list. These tests mean most under a memory
// checker.

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include "HandlerTesting.h"

namespace {

using gui_testing::Layer;
using gui_testing::Lines;
using gui_testing::RecordingView;

/// Three owned objects side by side, the first of which tells the interface.
class GraphicHandlerCallbacks : public ::testing::Test {
 protected:
  GraphicHandlerCallbacks()
      : first(layer.AddOwned(1, 0, 0)),
        second(layer.AddOwned(2, 5, 0)),
        third(layer.AddOwned(3, 20, 0)) {
    first.SetInterface(&layer.viewClient);
    layer.client.actions["OnDeleteObject"] = [](GraphicHandler* handler, VGObjectView* object) {
      handler->DeleteObject(object);  // once more does no harm
      EXPECT_FALSE(handler->AddObject(object)) << "it is beyond saving";
    };
  }
  Layer layer;
  RecordingView& first;
  RecordingView& second;
  RecordingView& third;
};

TEST_F(GraphicHandlerCallbacks, BeginOfAnOperationMayDeleteTheObject) {
  layer.viewClient.actions["OnBeginGraphicOp"] = [&](VGObjectView* object) {
    layer.handler.DeleteObject(object);
  };
  EXPECT_TRUE(layer.Down(2, 2));
  EXPECT_EQ(layer.Take(), (Lines{"1: move (2, 2)", "OnBeginGraphicOp 1 8", "OnDeleteObject 1",
                                 "1: end", "OnSelectObject null"}));
}

TEST_F(GraphicHandlerCallbacks, MoveMayDeleteTheObject) {
  layer.viewClient.actions["OnGraphicChanged"] = [&](VGObjectView* object) {
    layer.handler.DeleteObject(object);
  };
  layer.Down(2, 2);
  layer.Take();
  EXPECT_TRUE(layer.Move(3, 3));
  EXPECT_EQ(layer.Take(),
            (Lines{"1: moving (3, 3)", "OnGraphicChanged 1 8", "OnDeleteObject 1", "1: end"}))
      << "nothing is modified any more";
}

TEST_F(GraphicHandlerCallbacks, EndOfAnOperationMayDestroyTheObjectItself) {
  layer.viewClient.actions["OnEndGraphicOp"] = [](VGObjectView* object) { delete object; };
  layer.Down(2, 2);
  layer.Take();
  EXPECT_TRUE(layer.Up(3, 3));
  EXPECT_EQ(layer.Take(), (Lines{"1: moved (3, 3)", "OnEndGraphicOp 1 8", "1: end"}));
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
  EXPECT_EQ(layer.handler.GetObject(1), nullptr);
}

TEST_F(GraphicHandlerCallbacks, ModificationMayDeleteAll) {
  for (const char* call : {"OnModifyObject", "OnObjectModified", "OnSelectObject"}) {
    layer.client.actions[call] = [](GraphicHandler* handler, VGObjectView*) {
      handler->DeleteAll();
    };
  }
  EXPECT_TRUE(layer.Down(2, 2)) << "the object was there";
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
  EXPECT_EQ(layer.handler.GetObject(3), nullptr);
  layer.AddOwned(4, 0, 0);
  layer.client.actions.erase("OnSelectObject");
  layer.Down(2, 2);
  EXPECT_TRUE(layer.Move(3, 3));
  EXPECT_EQ(layer.handler.GetObject(4), nullptr);
  layer.client.actions.erase("OnModifyObject");
  layer.AddOwned(5, 0, 0);
  layer.Down(2, 2);
  EXPECT_TRUE(layer.Up(3, 3));
  EXPECT_EQ(layer.handler.GetObject(5), nullptr);
}

TEST_F(GraphicHandlerCallbacks, RightClickMayDeleteAll) {
  layer.client.actions["OnSelectObject"] = [](GraphicHandler* handler, VGObjectView*) {
    handler->DeleteAll();
  };
  EXPECT_FALSE(layer.Mouse(MouseEvent_ButtonDown, MK_RBUTTON, 2, 2));
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
}

TEST_F(GraphicHandlerCallbacks, DeletionMayDeleteTheOthers) {
  layer.client.actions["OnDeleteObject"] = [](GraphicHandler* handler, VGObjectView*) {
    handler->DeleteAll();
  };
  EXPECT_TRUE(layer.handler.DeleteObjects(VGType_Rect, -1));
  EXPECT_EQ(layer.Take(), (Lines{"OnDeleteObject 1", "OnDeleteObject 2", "OnDeleteObject 3",
                                 "3: end", "2: end", "1: end"}));
}

TEST_F(GraphicHandlerCallbacks, DeletionMayDestroyTheObjectItself) {
  layer.client.actions["OnDeleteObject"] = [](GraphicHandler*, VGObjectView* object) {
    delete object;
  };
  EXPECT_TRUE(layer.handler.DeleteAll());
  EXPECT_EQ(layer.Take(), (Lines{"OnDeleteObject 1", "1: end", "OnDeleteObject 2", "2: end",
                                 "OnDeleteObject 3", "3: end"}));
}

TEST_F(GraphicHandlerCallbacks, DeletionEndsThoughEachOneAddsAnother) {
  layer.client.actions["OnDeleteObject"] = [&](GraphicHandler* handler, VGObjectView*) {
    auto* next = new RecordingView(layer.lines, "next");
    next->SetDynamicCreationFlag();
    next->SetUserData(9);
    handler->AddObject(next);
  };
  EXPECT_TRUE(layer.handler.DeleteAll());
  EXPECT_EQ(layer.handler.GetObject(1), nullptr);
  EXPECT_EQ(layer.handler.GetObject(3), nullptr);
  EXPECT_NE(layer.handler.GetObjectByUserData(9), nullptr);
}

TEST_F(GraphicHandlerCallbacks, DrawingMayDelete) {
  first.onDraw = [&] { layer.handler.DeleteObject(&second); };
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "OnDeleteObject 2", "2: end", "3: draw"}));
}

TEST_F(GraphicHandlerCallbacks, DrawingMayDeleteTheActiveObject) {
  layer.Down(25, 5);
  layer.Take();
  first.onDraw = [&] { layer.handler.DeleteActive(); };
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "OnDeleteObject 3", "3: end", "2: draw"}));
}

TEST_F(GraphicHandlerCallbacks, ObjectAddedWhileDrawingIsDrawnNextTime) {
  RecordingView added(layer.lines, "added");
  first.onDraw = [&] {
    first.onDraw = nullptr;
    layer.handler.AddObject(&added);
  };
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "added: to view", "2: draw", "3: draw"}));
  layer.handler.Draw(nullptr);
  EXPECT_EQ(layer.Take(), (Lines{"1: draw", "2: draw", "3: draw", "added: draw"}));
}

TEST_F(GraphicHandlerCallbacks, SelectingMayDeleteTheOneThatIsAsked) {
  first.recordsEnd = false;
  RecordingView foreign(layer.lines, "foreign");
  layer.handler.AddObject(&foreign);
  foreign.onAsk = [&] { layer.handler.DeleteObject(&foreign); };
  dVect2D p(2, 2);
  EXPECT_TRUE(layer.handler.SelectObject(0, p));
  EXPECT_EQ(layer.handler.GetActiveObject(), &first) << "not one that has left the list";
  layer.handler.AddObject(&foreign);
  layer.handler.DeleteObject(&first);
  EXPECT_EQ(layer.handler.HitTest(p, 0), nullptr);
}

TEST_F(GraphicHandlerCallbacks, CreationMayDeleteTheObject) {
  layer.handler.onCreate = [&](RecordingView& view) { view.SetInterface(&layer.viewClient); };
  layer.client.actions["OnCreateObject"] = [](GraphicHandler* handler, VGObjectView* object) {
    handler->DeleteObject(object);
  };
  layer.handler.SetCreateMode(VGType_Line, -1);
  EXPECT_TRUE(layer.Down(90, 90));
  EXPECT_EQ(layer.Take(), (Lines{"CreateObject 2", "new: to view", "new: create 4098 1 (90, 90)",
                                 "OnCreateObject 99", "OnDeleteObject 99", "new: end"}));
  EXPECT_EQ(layer.handler.GetActiveObject(), nullptr);
}

TEST_F(GraphicHandlerCallbacks, ObjectDeletedByItsFirstClickIsNotReported) {
  layer.handler.onCreate = [&](RecordingView& view) {
    view.SetViewState(VGViewState_Visible);  // so the click grabs it instead of creating it
    view.SetInterface(&layer.viewClient);
  };
  layer.viewClient.actions["OnBeginGraphicOp"] = [&](VGObjectView* object) {
    layer.handler.DeleteObject(object);
  };
  layer.handler.DeleteAll();
  layer.Take();
  layer.handler.SetCreateMode(VGType_Line, -1);
  EXPECT_TRUE(layer.Down(5, 5));
  EXPECT_EQ(layer.Take(), (Lines{"CreateObject 2", "new: to view", "new: move (5, 5)",
                                 "OnBeginGraphicOp 99 8", "OnDeleteObject 99", "new: end"}));
}

/// Has itself deleted when it is called for the given time, and counts the calls.
class SelfDeleting : public gui_testing::BareView {
 public:
  SelfDeleting(GraphicHandler& handler, int calls) : m_handler(handler), m_calls(calls) {
    SetDynamicCreationFlag();
    SetViewState(VGViewState_Visible);
    Enable(VGOperation_Select | VGOperation_Move);
    m_handler.AddObject(this);
  }
  using VGObjectView::Draw;
  using VGObjectView::DrawGraphic;
  using VGObjectView::DrawSelection;
  using VGObjectView::GetSelectionState;
  short GetSelectionState(int /*flags*/, dVect2D& /*p*/) override {
    Live();
    return VGOperation_Move;
  }
  bool OnBeginMove(dVect2D& /*p*/) override { return Live(); }
  bool OnMove(dVect2D& /*p*/) override { return Live(); }
  bool OnEndMove(dVect2D& /*p*/) override { return Live(); }
  void DrawGraphic(HDC /*dc*/) override { Live(); }
  void DrawSelection(HDC /*dc*/) override { Live(); }

 private:
  bool Live() { return --m_calls != 0 || m_handler.DeleteObject(this); }

  GraphicHandler& m_handler;
  int m_calls;
};

TEST(GraphicHandlerSelfDeletion, ObjectMayDeleteItselfWhateverItIsCalledFor) {
  // Selecting asks once, and the click once more before the move begins.
  const char* const told[] = {"",
                              "OnSelectObject null",
                              "OnSelectObject null",
                              "OnSelectObject null",
                              "OnBeginGraphicOp 7 8|OnSelectObject 7",
                              "OnBeginGraphicOp 7 8|OnSelectObject 7|OnGraphicChanged 7 8|"
                              "OnModifyObject 7"};
  for (int calls = 1; calls <= 5; ++calls) {
    Lines lines;
    gui_testing::RecordingClient client(lines);
    gui_testing::RecordingViewClient viewClient(lines);
    GraphicHandler handler;
    auto* const object = new SelfDeleting(handler, calls);
    object->SetUserData(7);
    object->SetInterface(&viewClient);
    handler.SetInterface(&client);
    dVect2D p(1, 1);
    const int events[] = {MouseEvent_ButtonDown, MouseEvent_Move, MouseEvent_ButtonUp};
    for (const int event : events) {
      handler.ProcessMouseEvent(event, MK_LBUTTON, p);
    }
    std::string all;
    for (const std::string& line : lines) {
      if (line != "OnDeleteObject 7") {
        all += (all.empty() ? "" : "|") + line;
      }
    }
    EXPECT_EQ(all, told[calls]) << "in call " << calls;
    EXPECT_EQ(handler.GetObjectByUserData(7), nullptr) << "in call " << calls;
  }
}

TEST(GraphicHandlerSelfDeletion, ObjectMayDeleteItselfWhileItIsDrawn) {
  GraphicViewPort viewPort;
  for (const bool isInViewPort : {false, true}) {
    for (int calls = 1; calls <= 2; ++calls) {
      GraphicHandler handler;
      auto* const object = new SelfDeleting(handler, calls);
      object->SetUserData(7);
      object->Select(true);
      if (isInViewPort) {
        handler.Draw(nullptr, viewPort);
      } else {
        handler.Draw(nullptr);
      }
      EXPECT_EQ(handler.GetObjectByUserData(7), nullptr) << "in call " << calls;
    }
  }
}

}  // namespace
