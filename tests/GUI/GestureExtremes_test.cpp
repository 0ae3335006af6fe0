// Sessions with numbers beyond all reason: rectangles, scales, events and clips that no user makes,
// while layers and objects come and go. They mean most under the sanitizers. What has to hold is
// that they end, that a button that goes up lets everything go, and that the viewport comes back.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "GestureRules.h"
#include "GestureTesting.h"

namespace {

using gui_testing::Dice;
using gui_testing::GestureLayer;
using gui_testing::GestureScene;
using gui_testing::Screen;

/// Does anything to a scene.
class WildUser : private Dice {
 public:
  explicit WildUser(unsigned seed) : Dice(seed) {}

  void Step() {
    switch (Number(0, 9)) {
      case 0:
        ChangeRectangles();
        break;
      case 1:
        ChangeScalesAndModes();
        break;
      case 2:
        Navigate();
        break;
      case 3:
        ChangeLayers();
        break;
      case 4:
        Draw();
        break;
      case 5:
        Ask();
        break;
      default:
        SendEvent();
    }
  }
  /// Back to a viewport that shows something: whatever came before, it is in order.
  void Recover() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    viewPort.Reset();
    gui_testing::ExpectViewportInOrder(viewPort);
    EXPECT_EQ(viewPort.GetActiveGraphicObject(), nullptr);
    EXPECT_FALSE(viewPort.ProcessMouseEvent(MouseEvent_ButtonUp, 0, {50, 50}));
    EXPECT_EQ(viewPort.GetScaleX(), 1.0F);
    m_screen.Paint(viewPort);
    Screen fresh;
    fresh.Paint(viewPort);
    EXPECT_TRUE(m_screen.Pixels() == fresh.Pixels());
  }

 private:
  float OddFloat() {
    constexpr float kInf = std::numeric_limits<float>::infinity();
    constexpr float kMax = std::numeric_limits<float>::max();
    constexpr float kTiny = std::numeric_limits<float>::denorm_min();
    const float odd[] = {std::nanf(""), kInf,  -kInf, kMax,        -kMax,  kTiny,
                         0.0F,          -0.0F, 3e9F,  -2147483648, 1e-30F, -1e20F};
    return Chance(3) ? odd[Number(0, 11)] : static_cast<float>(Number(-20, 120));
  }
  int OddInt() {
    constexpr int kMin = std::numeric_limits<int>::min();
    constexpr int kMax = std::numeric_limits<int>::max();
    const int odd[] = {kMin, kMax, kMin + 1, kMax - 1, 1 << 24, -(1 << 27), 0, -1};
    return Chance(4) ? odd[Number(0, 7)] : Number(-10, 110);
  }
  Rect2D OddRect() {
    const float left = OddFloat();
    const float top = OddFloat();
    const float right = OddFloat();
    return Rect2D(left, top, right, OddFloat());
  }
  GestureLayer& AnyLayer() { return *m_scene.layers[Number(0, 2)]; }
  short AnyFlags() { return static_cast<short>(Number(-32768, 32767)); }

  void ChangeRectangles() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    viewPort.SetBorder(OddInt(), OddInt(), OddInt(), OddInt());
    if (Chance(2)) {
      viewPort.SetBorder(Number(0, 3));
    }
    switch (Number(0, 4)) {
      case 0:
        viewPort.SetViewWin(OddRect(), Chance(2));
        break;
      case 1:
        viewPort.SetGraphicWin(OddRect());
        break;
      case 2:
        viewPort.SetGraphicArea(OddRect());
        break;
      case 3:
        viewPort.SetViewPos(OddInt(), OddInt(), false);
        viewPort.MoveViewWin(OddInt(), OddInt(), false);
        break;
      default:
        viewPort.Init(GestureScene::Area(), GestureScene::Area(), Rect2D(5, 4, 95, 76));
        viewPort.SetScaleFactors(1.5F, 1.5F, 0.25F, 8, 0.25F, 8);
    }
    viewPort.UpdateTransformation();
  }

  void ChangeScalesAndModes() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    if (Chance(2)) {
      viewPort.SetScaleFactors(OddFloat(), OddFloat(), OddFloat(), OddFloat(), OddFloat(),
                               OddFloat());
    } else {
      viewPort.SetScaleSizes(OddFloat(), OddFloat(), OddFloat(), OddFloat(), OddFloat(),
                             OddFloat());
    }
    viewPort.SetMode(AnyFlags());
    viewPort.Enable(ViewPortFlag_Visible);
    viewPort.SetViewMode(static_cast<unsigned char>(Number(0, 5)),
                         static_cast<unsigned char>(Number(0, 255)));
    viewPort.SetAlignment(static_cast<unsigned char>(Number(0, 255)));
    viewPort.UpdateTransformation();
  }

  void Navigate() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    EXPECT_TRUE(viewPort.DoScale(OddFloat(), OddFloat()));
    EXPECT_TRUE(viewPort.DoPan(OddFloat(), OddFloat()));
    EXPECT_TRUE(viewPort.DoMove(OddFloat(), OddFloat()));
    viewPort.SetScrollPos(OddFloat(), OddFloat());
    viewPort.CenterWin(Chance(2), Chance(2));
    viewPort.SetViewRefPos(OddFloat(), OddFloat());
    viewPort.SetGraphicRefPos(OddFloat(), OddFloat());
    viewPort.UpdateTransformation();
  }

  void ChangeLayers() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    GestureLayer& layer = AnyLayer();
    switch (Number(0, 5)) {
      case 0:
        viewPort.RemoveGraphic(&layer);
        viewPort.AddGraphic(&layer);
        break;
      case 1:
        viewPort.AddGraphic(&layer);
        break;
      case 2: {
        GraphicViewPort copy(viewPort);
        copy.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, {OddInt(), OddInt()});
        viewPort = copy;
        break;
      }
      case 3:
        layer.DeleteActive();
        break;
      case 4:
        layer.Disable(AnyFlags());
        layer.Enable(GraphicHandlerFlag_Default);
        break;
      default:
        m_scene.sketches.DeleteAll();
        m_scene.sketches.SetCreateMode(static_cast<VGType>(Number(0, 11)), OddInt());
    }
  }

  void Draw() {
    GraphicViewPort& viewPort = m_scene.viewPort;
    m_screen.Paint(viewPort);
    m_screen.PaintActiveObject(viewPort);
    Rect2D clip = OddRect();
    const int saved = SaveDC(m_screen.Context());
    viewPort.EraseBkgnd(m_screen.Context(), &clip, Chance(2));
    viewPort.Draw(m_screen.Context(), &AnyLayer(), &clip, Chance(2));
    RestoreDC(m_screen.Context(), saved);
  }

  void Ask() {
    GestureLayer& layer = AnyLayer();
    dVect2D point(OddFloat(), OddFloat());
    VGObjectView* const hit = layer.HitTest(point, OddInt());
    EXPECT_TRUE(hit == nullptr || layer.Holds(hit));
    dVect2D other;
    layer.CalcBoundingBox(m_screen.Context(), point, other);
    tagRECT rect{OddInt(), OddInt(), OddInt(), OddInt()};
    m_scene.viewPort.ViewToGraphic(rect);
    m_scene.viewPort.GraphicToView(rect);
    m_scene.viewPort.GetDrawWin(rect);
  }

  void SendEvent() {
    const int events[] = {MouseEvent_ButtonDown, MouseEvent_ButtonDown, MouseEvent_Move,
                          MouseEvent_Move,       MouseEvent_ButtonUp,   OddInt()};
    const int event = events[Number(0, 5)];
    const int flags = Chance(3) ? OddInt() : MK_LBUTTON;
    GraphicViewPort& viewPort = m_scene.viewPort;
    viewPort.ProcessMouseEvent(event, flags, {OddInt(), OddInt()});
    viewPort.ProcessKeyEvent(event, flags, OddInt());
    if (event == MouseEvent_ButtonUp) {
      EXPECT_EQ(viewPort.GetActiveGraphicObject(), nullptr);
    }
    if (Chance(3)) {
      viewPort.UpdateTransformation();
    }
  }

  GestureScene m_scene;
  Screen m_screen;
};

TEST(GestureExtremes, EndAndLeaveTheViewportUsable) {
  for (unsigned seed = 1; seed <= 8; ++seed) {
    SCOPED_TRACE(seed);
    WildUser user(seed);
    for (int step = 0; step < 400 && !HasFailure(); ++step) {
      user.Step();
      if (step % 100 == 99) {
        user.Recover();
      }
    }
  }
}

}  // namespace
