// Long random sessions of a user before a viewport with layers of every kind of object, whose rules
// hold after every step: what the mouse grabs follows it, what it lets go comes to rest, and what
// is on the screen is what a fresh drawing of the same state shows.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>
#include <sstream>
#include <string>

#include "GestureRules.h"
#include "GestureTesting.h"

namespace {

using gui_testing::Box;
using gui_testing::BoxOf;
using gui_testing::Dice;
using gui_testing::ExpectAtRest;
using gui_testing::ExpectClose;
using gui_testing::ExpectViewportInOrder;
using gui_testing::GestureLayer;
using gui_testing::GestureScene;
using gui_testing::RubberBand;
using gui_testing::Screen;

constexpr int kButtons = MK_LBUTTON | MK_RBUTTON | MK_MBUTTON;

/// A user who drags, clicks, zooms, pans, creates and deletes.
class GestureUser : private Dice {
 public:
  explicit GestureUser(unsigned seed) : Dice(seed) { m_screen.Paint(m_scene.viewPort); }

  void Step() {
    m_what.str("");
    if (m_held != 0 || !Chance(3)) {
      UseMouse();
    } else if (Chance(3)) {
      HoverOrClickBeside();
    } else {
      ChangeSomething();
    }
    ExpectViewportInOrder(m_scene.viewPort);
    ExpectActiveObjects();
    if (m_held == 0 && Chance(4)) {
      ExpectScreenShowsTheState();
    }
  }
  std::string What() const { return m_what.str(); }
  /// How often something was seen, by its name.
  std::map<std::string, int> seen;

 private:
  GestureLayer& AnyLayer() { return *m_scene.layers[Number(0, 2)]; }
  VGObjectView* AnyObject(const GestureLayer& layer) {
    return layer.objects.empty() ? nullptr
                                 : layer.objects[static_cast<std::size_t>(
                                       Number(0, static_cast<int>(layer.objects.size()) - 1))];
  }

  void UseMouse() {
    if (m_held == 0) {
      Press(Chance(6) ? MK_RBUTTON : Chance(12) ? MK_MBUTTON : MK_LBUTTON);
    } else if (Chance(5)) {
      Release();
    } else if (Chance(40)) {
      const int other = Chance(2) ? MK_RBUTTON : MK_LBUTTON;
      if ((m_held & other) == 0) {
        Press(other);
      }
    } else if (Chance(60)) {
      Resize();
    } else if (Chance(80) && m_captured != nullptr) {
      m_captured->DeleteActive();
      ++seen["deleted while dragged"];
      Settle();
    } else {
      const int reach = Chance(10) ? 60 : 6;
      const LONG x = m_pos.x + Number(-reach, reach);
      const LONG y = m_pos.y + Number(-reach, reach);
      Send(MouseEvent_Move, std::clamp<LONG>(x, -15, 115), std::clamp<LONG>(y, -15, 95));
    }
  }

  void Press(int button) {
    m_keys = Chance(4) ? MK_SHIFT : Chance(5) ? MK_CONTROL : 0;
    if (m_held == 0) {
      m_pos = Chance(3) ? AnyPlace() : PlaceOnAnObject();
    }
    m_held |= button;
    Send(MouseEvent_ButtonDown, m_pos.x, m_pos.y);
  }

  void Release() {
    const int first = (m_held & MK_LBUTTON) != 0 ? MK_LBUTTON : m_held & kButtons;
    m_held &= ~first;
    Send(MouseEvent_ButtonUp, m_pos.x, m_pos.y);
  }

  void HoverOrClickBeside() {
    const int events[] = {MouseEvent_Move, MouseEvent_Move, MouseEvent_ButtonUp, 0, 4100};
    const tagPOINT place = AnyPlace();
    Send(events[Number(0, 4)], place.x, place.y);
  }

  tagPOINT AnyPlace() { return {Number(-10, Screen::kWidth + 10), Number(-10, 90)}; }

  /// On the outline of an object's box, mostly, or a few pixels beside.
  tagPOINT PlaceOnAnObject() {
    GestureLayer& layer = AnyLayer();
    VGObjectView* const object = AnyObject(layer);
    if (object == nullptr) {
      return AnyPlace();
    }
    layer.SetTransformation(&m_scene.viewPort.GetTrafo());
    const Box box = BoxOf(*object, m_screen.Context());
    const auto between = [&](float a, float b, int eighths) {
      const double place = a + eighths / 8.0 * (static_cast<double>(b) - a) + Number(-1, 1);
      return static_cast<LONG>(std::clamp(place, -20.0, 120.0));
    };
    const int across = Number(0, 8);
    const int down = Chance(3) ? Number(0, 8) : 8 * Number(0, 1);
    return Chance(2) ? tagPOINT{between(box.min.x, box.max.x, across),
                                between(box.min.y, box.max.y, down)}
                     : tagPOINT{between(box.min.x, box.max.x, down),
                                between(box.min.y, box.max.y, across)};
  }

  /// Passes an event on, as an application does: an object that is drawn with XOR is taken from the
  /// screen first, and drawn again after it.
  void Send(int event, LONG x, LONG y) {
    m_pos = {x, y};
    const int flags = m_held | m_keys;
    m_what << event << "/" << flags << " at " << x << " " << y;
    seen["bands lifted"] += m_band.Lift() ? 1 : 0;
    GestureLayer* const before = m_captured;
    for (GestureLayer* layer : m_scene.layers) {
      layer->received = 0;
    }
    const bool isUsed = m_scene.viewPort.ProcessMouseEvent(event, flags, m_pos);
    ExpectDelivered(event, isUsed);
    if (isUsed && m_captured == nullptr) {
      CountOwnOperation(event);
      m_scene.viewPort.UpdateTransformation();
    }
    if (event == MouseEvent_ButtonDown) {
      CountCreated();
      Follow(before);
    } else if (event == MouseEvent_Move && isUsed) {
      ExpectFollowed();
    }
    if (event == MouseEvent_ButtonUp) {
      m_dragged = nullptr;
      EXPECT_EQ(m_scene.viewPort.GetActiveGraphicObject(), nullptr);
    }
    DropBand();
  }

  /// At most one layer has had the event, but for a button that goes down, which is offered until
  /// one takes it.
  void ExpectDelivered(int event, bool isUsed) {
    if (event == MouseEvent_ButtonDown) {
      m_captured = nullptr;
      for (GestureLayer* layer : m_scene.layers) {
        EXPECT_LE(layer->received, m_captured == nullptr ? 1 : 0) << "offered behind a taker";
        m_captured = layer->received != 0 && layer->isUsed ? layer : m_captured;
      }
      EXPECT_TRUE(isUsed || m_captured == nullptr);
      return;
    }
    for (const GestureLayer* layer : m_scene.layers) {
      EXPECT_EQ(layer->received, layer == m_captured ? 1 : 0);
    }
    if (event == MouseEvent_ButtonUp) {
      EXPECT_TRUE(isUsed || m_captured == nullptr);
      m_abandoned.erase(m_captured);
      m_captured = nullptr;
    }
  }

  void CountOwnOperation(int event) {
    if (event == MouseEvent_Move) {
      const bool isZoom = (m_keys & MK_SHIFT) != 0;
      ++seen[isZoom ? "zoomed" : (m_keys & MK_CONTROL) != 0 ? "view moved" : "panned"];
    }
  }

  void CountCreated() {
    seen["created"] += m_scene.sketches.created;
    m_scene.sketches.created = 0;
  }

  void Follow(GestureLayer* before) {
    m_dragged = nullptr;
    if (before != nullptr && before != m_captured) {
      m_abandoned.insert(before);  // a second button has taken the mouse from it
      ++seen["abandoned"];
    }
    VGObjectView* const active = m_scene.viewPort.GetActiveGraphicObject();
    if (active == nullptr) {
      return;
    }
    ++seen["grabbed for " + std::to_string(active->GetOpState()) + " of " +
           std::to_string(active->GetObjType())];
    m_dragged = active->GetOpState() == VGOperation_Move ? active : nullptr;
    m_start = BoxOf(*active, m_screen.Context());
    m_pressed = m_pos;
  }

  void ExpectFollowed() {
    if (m_dragged == nullptr || m_captured == nullptr || !m_captured->Holds(m_dragged)) {
      return;
    }
    const Box box = BoxOf(*m_dragged, m_screen.Context());
    const VGType type = m_dragged->GetObjType();
    if (type == VGType_Point || type == VGType_Text || type == VGType_CrossCursor) {
      ExpectClose(box.min, m_pos.x, m_pos.y, "lies under the mouse");
      return;
    }
    const double dx = static_cast<double>(m_pos.x) - m_pressed.x;
    const double dy = static_cast<double>(m_pos.y) - m_pressed.y;
    ExpectClose(box.min, m_start.min.x + dx, m_start.min.y + dy, "goes the mouse's way");
    ExpectClose(box.max, m_start.max.x + dx, m_start.max.y + dy, "goes the mouse's way");
  }

  /// After something else than the mouse has changed the picture.
  void Settle() {
    m_dragged = nullptr;
    m_band.Renew();
    DropBand();
  }
  void DropBand() {
    if (m_band.Drop() && Chance(6)) {
      m_band.ExpectSameAsFresh();
      ++seen["bands compared"];
    }
  }

  void ExpectScreenShowsTheState() {
    const Rect2D window = m_scene.viewPort.GetGraphicWin();
    m_screen.Paint(m_scene.viewPort);
    Screen fresh;
    fresh.Paint(m_scene.viewPort);
    EXPECT_TRUE(m_screen.Pixels() == fresh.Pixels()) << "not what a fresh drawing shows";
    EXPECT_EQ(m_scene.viewPort.GetGraphicWin(), window);
    ++seen["pictures compared"];
  }

  void ChangeSomething() {
    switch (Number(0, 4)) {
      case 0:
        Resize();
        break;
      case 1:
        ChangeModes();
        break;
      case 2:
        Create();
        break;
      case 3:
        Delete();
        break;
      default:
        ChangeObject();
    }
  }

  void Resize() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    const auto edge = [&] { return static_cast<float>(Number(-20, 120)); };
    const float left = static_cast<float>(Number(0, 30));
    const float top = static_cast<float>(Number(0, 30));
    m_what << "resize ";
    viewPort.SetBorder(Number(0, 4), Number(0, 4), Number(0, 4), Number(0, 4));
    if (Chance(6)) {  // turned inside out, or without any size
      viewPort.SetViewWin(edge(), edge(), edge(), Chance(2) ? top : edge(), false);
      viewPort.UpdateTransformation();
      ++seen["odd windows"];
    }
    viewPort.SetViewWin(left, top, left + static_cast<float>(Number(30, 70)),
                        top + static_cast<float>(Number(30, 50)), Chance(2));
    viewPort.UpdateTransformation();
    Settle();
  }

  void ChangeModes() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    m_what << "modes";
    viewPort.SetProportional(!Chance(3));
    viewPort.SetFixedGraphicArea(!Chance(5));
    viewPort.ClipBorders(!Chance(3));
    viewPort.EnableMove(!Chance(3), !Chance(3));
    viewPort.EnableScale(!Chance(4), !Chance(4));
    viewPort.SetAlignment(static_cast<unsigned char>(Number(0, 15)));
    viewPort.SetViewMode(static_cast<unsigned char>(Number(0, 4)),
                         static_cast<unsigned char>(Number(0, 4)));
    viewPort.SetScaleFactors(1.5F, 1.5F, 0.25F, 8, 0.25F, 8);
    viewPort.UpdateTransformation();
    Settle();
  }

  void Create() {
    const VGType types[] = {VGType_Point, VGType_Line,   VGType_Rect,
                            VGType_Text,  VGType_Bitmap, VGType_CrossCursor};
    m_what << "create";
    if (m_scene.sketches.objects.size() < 8) {
      m_scene.sketches.SetCreateMode(types[Number(0, 5)], Chance(2) ? Number(1, 9) : -1);
    }
  }

  void Delete() {
    m_what << "delete";
    GestureLayer& layer = m_scene.sketches;
    if (Chance(3)) {
      layer.DeleteSelected();
    } else if (Chance(2)) {
      layer.DeleteObjects(static_cast<VGType>(Number(1, 10)), Chance(2) ? Number(1, 9) : -1);
    } else {
      layer.DeleteActive();
    }
  }

  void ChangeObject() {
    m_what << "object";
    GestureLayer& layer = AnyLayer();
    VGObjectView* const object = AnyObject(layer);
    if (object == nullptr || object == layer.GetActiveObject()) {
      return;
    }
    object->SetPenThickness(Number(0, 4));
    object->SetPenColor(Number(0, 0xFFFFFF));
    object->Select(Chance(3));
    Chance(5) ? object->ResetViewState(VGViewState_Visible)
              : object->SetViewState(VGViewState_Visible);
  }

  void ExpectActiveObjects() {
    EXPECT_EQ(m_scene.viewPort.GetActiveGraphicObject(),
              m_captured != nullptr ? m_captured->GetActiveObject() : nullptr);
    for (GestureLayer* layer : m_scene.layers) {
      VGObjectView* const active = layer->GetActiveObject();
      EXPECT_TRUE(active == nullptr || (layer->Holds(active) && active->IsSelected()));
      if (m_held == 0 && m_abandoned.count(layer) == 0) {
        layer->SetTransformation(&m_scene.viewPort.GetTrafo());
        ExpectAtRest(*layer, m_screen.Context());
      }
    }
  }

  std::ostringstream m_what;
  GestureScene m_scene;
  Screen m_screen;
  tagPOINT m_pos{};
  int m_held = 0;  ///< buttons
  int m_keys = 0;
  GestureLayer* m_captured = nullptr;
  std::set<GestureLayer*> m_abandoned;  ///< lost the mouse in the middle of an operation
  VGObjectView* m_dragged = nullptr;    ///< what is moved, from `m_start` and `m_pressed` on
  Box m_start;
  tagPOINT m_pressed{};
  RubberBand m_band{m_scene.viewPort, m_screen};
};

TEST(GestureSequences, KeepEverythingInOrder) {
  constexpr unsigned kSeeds = 5;
  constexpr int kSteps = 3000;
  std::map<std::string, int> seen;
  for (unsigned seed = 1; seed <= kSeeds && !HasFailure(); ++seed) {
    GestureUser user(seed);
    for (int step = 0; step < kSteps && !HasFailure(); ++step) {
      user.Step();
      if (HasFailure()) {
        ADD_FAILURE() << "in step " << step << " of seed " << seed << ": " << user.What();
      }
    }
    for (const auto& [what, count] : user.seen) {
      seen[what] += count;
    }
  }
  // The sessions have to have seen something of everything.
  for (const char* what : {"panned", "zoomed", "view moved", "bands compared", "created",
                           "pictures compared", "odd windows", "deleted while dragged"}) {
    EXPECT_GT(seen[what], 8) << what;
  }
  for (const VGType type :
       {VGType_Point, VGType_Line, VGType_Rect, VGType_Bitmap, VGType_Text, VGType_CrossCursor}) {
    EXPECT_GT(seen["grabbed for 8 of " + std::to_string(type)], 0);
  }
  for (const char* what : {"grabbed for 4 of 2", "grabbed for 4 of 3", "grabbed for 4 of 4",
                           "grabbed for 32 of 2", "grabbed for 32 of 10"}) {
    EXPECT_GT(seen[what], 0) << what;
  }
}

}  // namespace
