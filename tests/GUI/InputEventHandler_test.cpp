#include <vorl/GUI/InputEventHandler.h>
#include <vorl/Platform/Gdi.h>

#include <gtest/gtest.h>

#include <string>

#include "../Support/VirtualSlot.h"

namespace {

/// Writes down which handler was called, and answers as it is told to.
class Listener : public InputEventHandler {
 public:
  std::string called;
  int flags = 0;
  dVect2D point;
  bool answer = true;
  int vectorEvents = 0;

  using InputEventHandler::ProcessMouseEvent;
  bool ProcessMouseEvent(int event, int keys, dVect2D& where) override {
    ++vectorEvents;
    return InputEventHandler::ProcessMouseEvent(event, keys, where);
  }
  bool At(int event, int keys, float x = 0.0F, float y = 0.0F) {
    called.clear();
    dVect2D where(x, y);
    return ProcessMouseEvent(event, keys, where);
  }

 protected:
  bool Note(const char* name, int keys, const dVect2D& where) {
    called += name;
    flags = keys;
    point = where;
    return answer;
  }
  bool OnMouseMove(int f, dVect2D& p) override { return Note("Move", f, p); }
  bool OnMouseMoveL(int f, dVect2D& p) override { return Note("MoveL", f, p); }
  bool OnMouseMoveM(int f, dVect2D& p) override { return Note("MoveM", f, p); }
  bool OnMouseMoveR(int f, dVect2D& p) override { return Note("MoveR", f, p); }
  bool OnMouseDownL(int f, dVect2D& p) override { return Note("DownL", f, p); }
  bool OnMouseDownM(int f, dVect2D& p) override { return Note("DownM", f, p); }
  bool OnMouseDownR(int f, dVect2D& p) override { return Note("DownR", f, p); }
  bool OnMouseUpL(int f, dVect2D& p) override { return Note("UpL", f, p); }
  bool OnMouseUpM(int f, dVect2D& p) override { return Note("UpM", f, p); }
  bool OnMouseUpR(int f, dVect2D& p) override { return Note("UpR", f, p); }
};

struct Case {
  int event;
  int flags;
  const char* handler;  // empty: none, and the event is refused
};

constexpr Case kCases[] = {
    {4097, 0, "Move"},
    {4097, 1, "MoveL"},
    {4097, 2, "MoveR"},
    {4097, 16, "MoveM"},
    {4098, 0, ""},
    {4098, 1, "DownL"},
    {4098, 2, "DownR"},
    {4098, 16, "DownM"},
    {4099, 0, ""},
    {4099, 1, "UpL"},
    {4099, 2, "UpR"},
    {4099, 16, "UpM"},
    // Several buttons: left, then right, then middle.
    {4097, 1 | 2 | 16, "MoveL"},
    {4098, 1 | 16, "DownL"},
    {4098, 2 | 16, "DownR"},
    {4099, 1 | 2, "UpL"},
    // Shift and control are no buttons.
    {4097, 4 | 8, "Move"},
    {4098, 4 | 8, ""},
    {4098, 1 | 4 | 8, "DownL"},
    // No events at all.
    {4096, 1, ""},
    {4100, 1, ""},
    {0, 0, ""},
    {-1, 0, ""},
};

TEST(InputEventHandler, EachEventReachesItsOwnHandlerOnly) {
  for (const Case& c : kCases) {
    Listener listener;
    EXPECT_EQ(listener.At(c.event, c.flags), *c.handler != 0) << c.event << " " << c.flags;
    EXPECT_EQ(listener.called, c.handler) << c.event << " " << c.flags;
  }
}

TEST(InputEventHandler, PassesFlagsAndPointOnAndTheAnswerBack) {
  Listener listener;
  EXPECT_TRUE(listener.At(MouseEvent_ButtonDown, MK_RBUTTON | MK_SHIFT, 1.25F, -7.5F));
  EXPECT_EQ(listener.flags, 2 | 4);
  EXPECT_EQ(listener.point.x, 1.25F);
  EXPECT_EQ(listener.point.y, -7.5F);
  listener.answer = false;
  EXPECT_FALSE(listener.At(MouseEvent_ButtonDown, MK_RBUTTON));
  EXPECT_EQ(listener.called, "DownR");
}

TEST(InputEventHandler, MouseKeysHaveTheSystemsValues) {
  EXPECT_EQ(MK_LBUTTON, 1);
  EXPECT_EQ(MK_RBUTTON, 2);
  EXPECT_EQ(MK_SHIFT, 4);
  EXPECT_EQ(MK_CONTROL, 8);
  EXPECT_EQ(MK_MBUTTON, 16);
  EXPECT_EQ(MouseEvent_Move, 4097);
  EXPECT_EQ(MouseEvent_ButtonDown, 4098);
  EXPECT_EQ(MouseEvent_ButtonUp, 4099);
}

TEST(InputEventHandler, DisabledMouseEventsReachNoHandler) {
  Listener listener;
  EXPECT_TRUE(listener.MouseEventsEnabled());
  listener.EnableMouseEvents(false);
  EXPECT_FALSE(listener.MouseEventsEnabled());
  EXPECT_TRUE(listener.KeyEventsEnabled());
  EXPECT_FALSE(listener.At(4097, 0));
  EXPECT_EQ(listener.called, "");
  tagPOINT point{1, 2};
  EXPECT_FALSE(listener.ProcessMouseEvent(4098, 1, point));
  EXPECT_EQ(listener.called, "");
  listener.EnableMouseEvents(true);
  EXPECT_TRUE(listener.At(4097, 0));
}

TEST(InputEventHandler, KeySwitchLeavesTheMouseAlone) {
  Listener listener;
  listener.EnableKeyEvents(false);
  EXPECT_FALSE(listener.KeyEventsEnabled());
  EXPECT_TRUE(listener.MouseEventsEnabled());
  EXPECT_TRUE(listener.At(4097, 0));
  listener.EnableKeyEvents(true);
  EXPECT_TRUE(listener.KeyEventsEnabled());
}

TEST(InputEventHandler, IntegerPointsGoThroughTheVectorForm) {
  Listener listener;
  tagPOINT point{-3, 70000};
  EXPECT_TRUE(listener.ProcessMouseEvent(4099, MK_MBUTTON, point));
  EXPECT_EQ(listener.vectorEvents, 1);
  EXPECT_EQ(listener.called, "UpM");
  EXPECT_EQ(listener.flags, 16);
  EXPECT_EQ(listener.point.x, -3.0F);
  EXPECT_EQ(listener.point.y, 70000.0F);
  listener.answer = false;
  EXPECT_FALSE(listener.ProcessMouseEvent(4099, MK_MBUTTON, point));
}

TEST(InputEventHandler, HandlersRefuseEverythingByDefault) {
  InputEventHandler handler;
  for (const Case& c : kCases) {
    dVect2D point(1.0F, 2.0F);
    tagPOINT integerPoint{1, 2};
    EXPECT_FALSE(handler.ProcessMouseEvent(c.event, c.flags, point));
    EXPECT_FALSE(handler.ProcessMouseEvent(c.event, c.flags, integerPoint));
  }
  EXPECT_FALSE(handler.ProcessKeyEvent(256, 0, 65));
}

TEST(InputEventHandler, CopiesTheSwitches) {
  InputEventHandler source;
  source.EnableMouseEvents(false);
  source.EnableKeyEvents(false);
  const InputEventHandler copy(source);
  EXPECT_FALSE(copy.MouseEventsEnabled());
  EXPECT_FALSE(copy.KeyEventsEnabled());
  InputEventHandler assigned;
  assigned = source;
  EXPECT_FALSE(assigned.MouseEventsEnabled());
  EXPECT_FALSE(assigned.KeyEventsEnabled());
}

/// Opens the handlers, and adds a function behind them.
class Open : public InputEventHandler {
 public:
  virtual void Next() {}
  static void ExpectHandlersFrom(std::size_t first) {
    using Handler = bool (Open::*)(int, dVect2D&);
    const Handler handlers[] = {&Open::OnMouseMove,  &Open::OnMouseMoveL, &Open::OnMouseMoveM,
                                &Open::OnMouseMoveR, &Open::OnMouseDownL, &Open::OnMouseDownM,
                                &Open::OnMouseDownR, &Open::OnMouseUpL,   &Open::OnMouseUpM,
                                &Open::OnMouseUpR};
    for (std::size_t i = 0; i < 10; ++i) {
      EXPECT_EQ(VirtualSlot(handlers[i]), first + i);
    }
    EXPECT_EQ(VirtualSlot(&Open::Next), first + 10);
  }
};

TEST(InputEventHandlerSlots, StandInOrder) {
  // The destructor takes two places.
  using Vector = bool (InputEventHandler::*)(int, int, dVect2D&);
  using Point = bool (InputEventHandler::*)(int, int, tagPOINT&);
  EXPECT_EQ(VirtualSlot(static_cast<Vector>(&InputEventHandler::ProcessMouseEvent)), 2u);
  EXPECT_EQ(VirtualSlot(static_cast<Point>(&InputEventHandler::ProcessMouseEvent)), 3u);
  EXPECT_EQ(VirtualSlot(&InputEventHandler::ProcessKeyEvent), 4u);
  Open::ExpectHandlersFrom(5);
}

}  // namespace
