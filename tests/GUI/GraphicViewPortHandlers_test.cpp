// How events find the handlers of a viewport, and which one keeps them.

#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/Platform/Gdi.h>

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "ViewPortTesting.h"

namespace {

constexpr int kMove = 4097;
constexpr int kDown = 4098;
constexpr int kUp = 4099;
constexpr int kLeft = MK_LBUTTON;

/// Three handlers in a viewport, and what reaches them.
class GraphicViewPortHandlers : public ::testing::Test {
 protected:
  GraphicViewPortHandlers() {
    viewPort.Init(Rect2D(0, 0, 400, 400), Rect2D(100, 100, 200, 200), Rect2D(0, 0, 200, 200));
    viewPort.UpdateTransformation();
    for (TestHandler* handler : {&a, &b, &c}) {
      viewPort.AddGraphic(handler);
    }
  }
  /// What an event adds to the log, and whether it was used.
  std::string Event(int event, int flags = kLeft, tagPOINT point = {50, 60}) {
    log.clear();
    return viewPort.ProcessMouseEvent(event, flags, point) ? log + "used" : log + "refused";
  }
  std::string Key() {
    log.clear();
    return viewPort.ProcessKeyEvent(256, 3, 65) ? log + "used" : log + "refused";
  }

  std::string log;
  TestHandler a{"a", log};
  TestHandler b{"b", log};
  TestHandler c{"c", log};
  OpenViewPort viewPort;
};

TEST_F(GraphicViewPortHandlers, ButtonDownIsOfferedInOrderUntilOneTakesIt) {
  b.takesDown = true;
  c.takesDown = true;
  EXPECT_EQ(Event(kDown), "a:4098/1 b:4098/1 used");
}

TEST_F(GraphicViewPortHandlers, CapturedHandlerReceivesEverythingUntilButtonUp) {
  b.takesDown = true;
  Event(kDown);
  EXPECT_EQ(Event(kMove), "b:4097/1 refused");
  EXPECT_EQ(Event(kMove, kLeft | MK_SHIFT, {9999, -5}), "b:4097/5 refused") << "outside too";
  EXPECT_EQ(Event(4242), "b:4242/1 refused");
  b.takesOthers = true;
  EXPECT_EQ(Event(kMove), "b:4097/1 used");
  b.takesOthers = false;
  EXPECT_EQ(Event(kUp, 0, {-1, -1}), "b:4099/0 used") << "used whatever the handler says";
  EXPECT_EQ(Event(kMove), "refused");
  EXPECT_EQ(Event(kUp), "refused");
}

TEST_F(GraphicViewPortHandlers, ViewportItselfRunsNothingWhileOneIsCaptured) {
  a.takesDown = true;
  Event(kDown);
  Event(kMove, kLeft, {10, 10});
  ExpectEdges(viewPort.GetGraphicWin(), 100, 100, 200, 200);
  EXPECT_FALSE(viewPort.StopInteractiveOp(tagPOINT{}));
}

TEST_F(GraphicViewPortHandlers, WhatNoHandlerTakesIsTheViewportsOwn) {
  EXPECT_EQ(Event(kDown), "a:4098/1 b:4098/1 c:4098/1 used");
  EXPECT_EQ(Event(kMove, kLeft, {30, 60}), "used") << "moves are not offered";
  ExpectEdges(viewPort.GetGraphicWin(), 110, 100, 210, 200);
  EXPECT_EQ(Event(kUp), "used");
  EXPECT_EQ(Event(kUp), "refused");
}

TEST_F(GraphicViewPortHandlers, RightButtonIsOfferedToo) {
  c.takesDown = true;
  EXPECT_EQ(Event(kDown, MK_RBUTTON), "a:4098/2 b:4098/2 c:4098/2 used");
  c.takesDown = false;
  Event(kUp, 0);
  EXPECT_EQ(Event(kDown, MK_RBUTTON), "a:4098/2 b:4098/2 c:4098/2 refused");
}

TEST_F(GraphicViewPortHandlers, NothingIsOfferedOutsideTheViewWindow) {
  a.takesDown = true;
  EXPECT_EQ(Event(kDown, kLeft, {201, 60}), "refused");
  EXPECT_EQ(Event(kDown, kLeft, {200, 200}), "a:4098/1 used");
}

TEST_F(GraphicViewPortHandlers, SecondButtonIsOfferedAnew) {
  c.takesDown = true;
  Event(kDown);
  a.takesDown = true;
  EXPECT_EQ(Event(kDown, kLeft | MK_RBUTTON), "a:4098/3 used");
  EXPECT_EQ(Event(kMove), "a:4097/1 refused");
  // When none takes it the first capture is gone, and the viewport takes over.
  a.takesDown = false;
  c.takesDown = false;
  EXPECT_EQ(Event(kDown), "a:4098/1 b:4098/1 c:4098/1 used");
  EXPECT_EQ(Event(kMove, kLeft, {52, 60}), "used");
  ExpectEdges(viewPort.GetGraphicWin(), 99, 100, 199, 200);
}

TEST_F(GraphicViewPortHandlers, CapturedHandlerThatIsNoLongerShownRefusesButtonDown) {
  b.takesDown = true;
  Event(kDown);
  viewPort.SetGraphic(nullptr);
  EXPECT_EQ(Event(kDown), "refused");
  EXPECT_EQ(Event(kMove), "b:4097/1 refused");
  EXPECT_EQ(Event(kUp), "b:4099/1 used");
  EXPECT_EQ(Event(kMove), "refused");
}

TEST_F(GraphicViewPortHandlers, RemovedHandlerIsNoLongerCaptured) {
  b.takesDown = true;
  Event(kDown);
  viewPort.RemoveGraphic(&a);
  EXPECT_EQ(Event(kMove), "b:4097/1 refused") << "another one";
  viewPort.RemoveGraphic(&b);
  EXPECT_EQ(Event(kMove), "refused");
  c.takesDown = true;
  Event(kDown);
  viewPort.SetGraphic(nullptr);
  viewPort.RemoveGraphic(&c);
  EXPECT_EQ(Event(kMove), "refused") << "also from an empty list";
  viewPort.AddGraphic(&a);
  a.takesDown = true;
  Event(kDown);
  viewPort.RemoveGraphic(nullptr);
  EXPECT_EQ(Event(kMove), "refused");
}

TEST_F(GraphicViewPortHandlers, ResetReleasesTheCapture) {
  a.takesDown = true;
  Event(kDown);
  viewPort.Reset();
  EXPECT_EQ(Event(kMove), "refused");
  EXPECT_EQ(Key(), "a:key256/3/65 b:key256/3/65 c:key256/3/65 refused") << "the list stays";
}

TEST_F(GraphicViewPortHandlers, EachHandlerGetsTheMapAndItsOwnPoint) {
  EXPECT_EQ(Event(kDown), "a:4098/1 b:4098/1 c:4098/1 used");
  for (const TestHandler* handler : {&a, &b, &c}) {
    EXPECT_EQ(handler->mapAtEvent, &viewPort.GetTrafo());
    ExpectPoint(handler->lastPoint, 50, 60);
  }
}

TEST_F(GraphicViewPortHandlers, CapturedHandlerGetsTheMapBackBeforeEachEvent) {
  a.takesDown = true;
  Event(kDown);
  viewPort.UpdateTransformation();
  EXPECT_EQ(a.probe.map, nullptr);
  Event(kMove);
  EXPECT_EQ(a.mapAtEvent, &viewPort.GetTrafo());
}

TEST_F(GraphicViewPortHandlers, KeysAreOfferedInOrderUntilOneTakesThem) {
  EXPECT_EQ(Key(), "a:key256/3/65 b:key256/3/65 c:key256/3/65 refused");
  EXPECT_EQ(c.mapAtEvent, &viewPort.GetTrafo());
  b.takesKeys = true;
  EXPECT_EQ(Key(), "a:key256/3/65 b:key256/3/65 used");
  viewPort.SetGraphic(nullptr);
  EXPECT_EQ(Key(), "refused");
}

TEST_F(GraphicViewPortHandlers, AddedAgainMovesToTheEnd) {
  EXPECT_TRUE(viewPort.AddGraphic(&a));
  EXPECT_EQ(Key(), "b:key256/3/65 c:key256/3/65 a:key256/3/65 refused");
  EXPECT_FALSE(viewPort.AddGraphic(nullptr));
  EXPECT_EQ(Key(), "b:key256/3/65 c:key256/3/65 a:key256/3/65 refused");
}

TEST_F(GraphicViewPortHandlers, SetReplacesAllAndLeavesThemTheirMap) {
  Key();
  viewPort.SetGraphic(&b);
  EXPECT_EQ(a.probe.map, &viewPort.GetTrafo());
  EXPECT_EQ(c.probe.map, &viewPort.GetTrafo());
  EXPECT_EQ(Key(), "b:key256/3/65 refused");
  viewPort.SetGraphic(nullptr);
  EXPECT_EQ(b.probe.map, &viewPort.GetTrafo());
  EXPECT_EQ(Key(), "refused");
}

TEST_F(GraphicViewPortHandlers, RemoveTakesTheMap) {
  Key();
  viewPort.RemoveGraphic(&b);
  EXPECT_EQ(b.probe.map, nullptr);
  EXPECT_EQ(a.probe.map, &viewPort.GetTrafo());
  EXPECT_EQ(Key(), "a:key256/3/65 c:key256/3/65 refused");
  viewPort.RemoveGraphic(nullptr);
  EXPECT_EQ(a.probe.map, nullptr);
  EXPECT_EQ(c.probe.map, nullptr);
  EXPECT_EQ(Key(), "refused");
}

TEST_F(GraphicViewPortHandlers, RemoveTakesTheMapFromStrangersUnlessTheListIsEmpty) {
  TrafoST2D map;
  TestHandler stranger("s", log);
  stranger.SetTransformation(&map);
  viewPort.RemoveGraphic(&stranger);
  EXPECT_EQ(stranger.probe.map, nullptr);
  EXPECT_EQ(Key(), "a:key256/3/65 b:key256/3/65 c:key256/3/65 refused");
  viewPort.RemoveGraphic(nullptr);
  stranger.SetTransformation(&map);
  viewPort.RemoveGraphic(&stranger);
  EXPECT_EQ(stranger.probe.map, &map);
}

TEST_F(GraphicViewPortHandlers, EndOfTheViewportTakesTheMaps) {
  TestHandler own("o", log);
  {
    GraphicViewPort shortLived;
    shortLived.AddGraphic(&own);
    shortLived.ProcessKeyEvent(0, 0, 0);
    EXPECT_EQ(own.probe.map, &shortLived.GetTrafo());
  }
  EXPECT_EQ(own.probe.map, nullptr);
}

TEST_F(GraphicViewPortHandlers, ActiveObjectIsTheCapturedHandlers) {
  a.active = &a.probe;
  b.active = &b.probe;
  EXPECT_EQ(viewPort.GetActiveGraphicObject(), nullptr);
  b.takesDown = true;
  Event(kDown);
  EXPECT_EQ(viewPort.GetActiveGraphicObject(), &b.probe);
  b.active = nullptr;
  EXPECT_EQ(viewPort.GetActiveGraphicObject(), nullptr);
  b.active = &b.probe;
  Event(kUp);
  EXPECT_EQ(viewPort.GetActiveGraphicObject(), nullptr);
}

TEST_F(GraphicViewPortHandlers, HandlerIsCapturedWhileItDecides) {
  a.active = &a.probe;
  VGObjectView* seen = nullptr;
  a.atEvent = [&] { seen = viewPort.GetActiveGraphicObject(); };
  Event(kDown);
  EXPECT_EQ(seen, &a.probe);
}

TEST_F(GraphicViewPortHandlers, HandlerThatLeavesHidesNoneBehindIt) {
  a.atEvent = [&] { viewPort.RemoveGraphic(&a); };
  EXPECT_EQ(Event(kDown), "a:4098/1 b:4098/1 c:4098/1 used");
  viewPort.StopInteractiveOp(tagPOINT{});
  b.atEvent = [&] { viewPort.RemoveGraphic(&c); };
  EXPECT_EQ(Event(kDown), "b:4098/1 used") << "one that is gone is not asked";
}

TEST_F(GraphicViewPortHandlers, HandlerThatMovesToTheTopIsAskedOnce) {
  a.atEvent = [&] { viewPort.AddGraphic(&a); };
  c.atEvent = [&] { viewPort.AddGraphic(&c); };
  EXPECT_EQ(Event(kDown), "a:4098/1 b:4098/1 c:4098/1 used");
  EXPECT_EQ(Key(), "b:key256/3/65 a:key256/3/65 c:key256/3/65 refused");
}

TEST_F(GraphicViewPortHandlers, KeysReachTheOthersWhenAHandlerLeaves) {
  a.atEvent = [&] { viewPort.RemoveGraphic(&a); };
  EXPECT_EQ(Key(), "a:key256/3/65 b:key256/3/65 c:key256/3/65 refused");
  EXPECT_EQ(Key(), "b:key256/3/65 c:key256/3/65 refused");
}

TEST_F(GraphicViewPortHandlers, HandlerMayLeaveWhileItIsGivenTheMap) {
  a.takesDown = true;
  Event(kDown);
  viewPort.UpdateTransformation();
  a.probe.atMap = [&] { viewPort.RemoveGraphic(&a); };
  EXPECT_EQ(Event(kMove), "refused");
  a.probe.atMap = nullptr;
  viewPort.AddGraphic(&a);
  viewPort.UpdateTransformation();
  a.probe.atMap = [&] { viewPort.RemoveGraphic(&a); };
  EXPECT_EQ(Event(kDown), "b:4098/1 c:4098/1 used");
  viewPort.StopInteractiveOp(tagPOINT{});
  viewPort.AddGraphic(&a);
  EXPECT_EQ(Key(), "b:key256/3/65 c:key256/3/65 refused");
  a.probe.atMap = nullptr;
  viewPort.AddGraphic(&a);
  Event(kDown);
  viewPort.UpdateTransformation();
  a.probe.atMap = [&] { viewPort.RemoveGraphic(&a); };
  log.clear();
  viewPort.DrawActiveObject(nullptr);
  EXPECT_EQ(log, "");
  viewPort.AddGraphic(&a);
  log.clear();
  viewPort.Draw(nullptr, nullptr, false);
  EXPECT_EQ(log, "b:draw c:draw ");
}

TEST_F(GraphicViewPortHandlers, AllLoseTheMapThoughOneLeavesMeanwhile) {
  Key();
  a.probe.atMap = [&] { viewPort.RemoveGraphic(&a); };
  viewPort.UpdateTransformation();
  for (const TestHandler* handler : {&a, &b, &c}) {
    EXPECT_EQ(handler->probe.map, nullptr);
  }
}

TEST_F(GraphicViewPortHandlers, DrawingReachesTheOthersWhenAHandlerLeaves) {
  a.draw = [&](HDC) { viewPort.RemoveGraphic(&a); };
  log.clear();
  viewPort.Draw(nullptr, nullptr, false);
  EXPECT_EQ(log, "a:draw b:draw c:draw ");
}

TEST_F(GraphicViewPortHandlers, HandlerThatIsDestroyedLeaves) {
  auto shown = std::make_unique<TestHandler>("s", log);
  shown->takesDown = true;
  shown->active = &a.probe;
  viewPort.SetGraphic(shown.get());
  GraphicViewPort copy(viewPort);
  Event(kDown);
  copy.ProcessMouseEvent(kDown, kLeft, {50, 60});
  EXPECT_EQ(copy.GetActiveGraphicObject(), &a.probe);
  shown.reset();
  for (GraphicViewPort* left : {static_cast<GraphicViewPort*>(&viewPort), &copy}) {
    EXPECT_EQ(left->GetActiveGraphicObject(), nullptr);
    left->DrawActiveObject(nullptr);
    left->Draw(nullptr, nullptr, false);
    left->UpdateTransformation();
    EXPECT_FALSE(left->ProcessKeyEvent(1, 2, 3));
    EXPECT_TRUE(left->ProcessMouseEvent(kDown, kLeft, {50, 60})) << "it pans now";
    EXPECT_TRUE(left->ProcessMouseEvent(kUp, 0, {50, 60}));
  }
  TrafoST2D map;
  a.SetTransformation(&map);
  viewPort.RemoveGraphic(&a);
  EXPECT_EQ(a.probe.map, &map) << "there are no handlers at all";
}

TEST_F(GraphicViewPortHandlers, HandlerMayBeDestroyedByWhatItIsOffered) {
  const auto expectGone = [&](auto&& offer, const std::string& expected) {
    auto mortal = std::make_unique<TestHandler>("m", log);
    a.atEvent = [&] { mortal.reset(); };
    a.draw = [&](HDC) { mortal.reset(); };
    viewPort.SetGraphic(&a);
    viewPort.AddGraphic(mortal.get());
    log.clear();
    offer();
    EXPECT_EQ(log, expected);
    EXPECT_EQ(mortal, nullptr);
  };
  expectGone([&] { viewPort.ProcessKeyEvent(1, 2, 3); }, "a:key1/2/3 ");
  expectGone([&] { viewPort.Draw(nullptr, nullptr, false); }, "a:draw ");
  expectGone([&] { viewPort.ProcessMouseEvent(kDown, kLeft, {50, 60}); }, "a:4098/1 ");
}

TEST_F(GraphicViewPortHandlers, HandlersMayChangeTheListDuringAnEvent) {
  a.atEvent = [&] { viewPort.RemoveGraphic(nullptr); };
  EXPECT_EQ(Event(kDown), "a:4098/1 used") << "the viewport pans";
  Event(kUp);
  viewPort.AddGraphic(&a);
  a.takesDown = true;
  a.atEvent = [&] { viewPort.RemoveGraphic(&a); };
  EXPECT_EQ(Event(kDown), "a:4098/1 used");
  EXPECT_EQ(Event(kMove), "refused") << "removed, it is not captured";
  viewPort.AddGraphic(&a);
  a.atEvent = nullptr;
  Event(kDown);
  a.atEvent = [&] { viewPort.RemoveGraphic(&a); };
  EXPECT_EQ(Event(kUp), "a:4099/1 used");
  EXPECT_EQ(Event(kMove), "refused");
}

}  // namespace
