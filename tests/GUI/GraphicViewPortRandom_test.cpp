// Long random sessions of a user, whose course a plain model of the rules foretells. After every
// step the viewport has to be in order.

#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/Platform/Gdi.h>

#include <gtest/gtest.h>

#include <array>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "ViewPortTesting.h"

namespace {

constexpr unsigned kSeed = 20240817;
constexpr int kSteps = 6000;

/// A viewport with three handlers, driven at random.
class RandomUser {
 public:
  RandomUser() {
    m_viewPort.Init(kArea, kArea, Rect2D(0, 0, 300, 200));
    m_viewPort.SetScaleFactors(0.5F, 0.5F, 0.25F, 8, 0.25F, 8);
    m_viewPort.UpdateTransformation();
    for (TestHandler& handler : m_handlers) {
      handler.active = &handler.probe;
      m_viewPort.AddGraphic(&handler);
      m_listed.push_back(&handler);
    }
  }

  void Step() {
    m_what.str("");
    const int action = Number(0, 19);
    if (action == 0) {
      ChangeView();
    } else if (action == 1) {
      ChangeModes();
    } else if (action == 2) {
      ChangeHandlers();
    } else {
      MouseEventAt(action);
    }
    m_viewPort.UpdateTransformation();
    ExpectOrder();
  }
  std::string What() const { return m_what.str(); }

  int pans = 0;
  int moves = 0;
  int zooms = 0;
  int captures = 0;

 private:
  int Number(int from, int to) { return std::uniform_int_distribution<int>(from, to)(m_random); }
  bool Chance(int oneIn) { return Number(1, oneIn) == 1; }

  void ChangeView() {
    const auto left = static_cast<float>(Number(-50, 50));
    const auto top = static_cast<float>(Number(-50, 50));
    const Rect2D view(left, top, left + static_cast<float>(Number(50, 500)),
                      top + static_cast<float>(Number(50, 500)));
    m_viewPort.SetBorder(Number(0, 9), Number(0, 9), Number(0, 9), Number(0, 9));
    m_viewPort.SetViewWin(view, Chance(2));
    m_what << "view";
  }

  void ChangeModes() {
    m_viewPort.SetProportional(!Chance(3));
    m_viewPort.SetFixedGraphicArea(!Chance(4));
    m_viewPort.EnableMove(!Chance(3), !Chance(3));
    m_viewPort.EnablePan(!Chance(4), !Chance(4));
    m_viewPort.EnableScale(!Chance(4), !Chance(4));
    m_viewPort.SetAlignment(static_cast<unsigned char>(Number(0, 15)));
    m_viewPort.SetViewMode(static_cast<unsigned char>(Number(0, 4)),
                           static_cast<unsigned char>(Number(0, 4)));
    m_what << "modes";
  }

  void ChangeHandlers() {
    TestHandler& handler = m_handlers[static_cast<std::size_t>(Number(0, 2))];
    handler.takesDown = Chance(4);
    handler.takesOthers = Chance(2);
    std::erase(m_listed, &handler);
    if (Chance(3)) {
      m_viewPort.RemoveGraphic(&handler);
      m_captured = m_captured == &handler ? nullptr : m_captured;
      m_what << "remove " << handler.name;
    } else {
      m_viewPort.AddGraphic(&handler);
      m_listed.push_back(&handler);
      m_what << "add " << handler.name;
    }
  }

  void MouseEventAt(int action) {
    const int event = action < 5   ? MouseEvent_ButtonDown
                      : action < 8 ? MouseEvent_ButtonUp
                                   : MouseEvent_Move;
    int flags = Chance(8) ? MK_RBUTTON : MK_LBUTTON;
    flags |= Chance(3) ? MK_SHIFT : 0;
    flags |= Chance(3) ? MK_CONTROL : 0;
    const Rect2D view = m_viewPort.GetViewWin();
    const auto around = [&](float edge, double size) {
      return static_cast<LONG>(edge) + Number(-20, static_cast<int>(size) + 20);
    };
    const tagPOINT point{around(view.GetTL().x, view.Width()),
                         around(view.GetTL().y, view.Height())};
    m_what << event << "/" << flags << " at " << point.x << " " << point.y;
    const std::string expected = Foretell(event, flags, point);
    const Rect2D window = m_viewPort.GetGraphicWin();
    m_log.clear();
    const bool used = m_viewPort.ProcessMouseEvent(event, flags, point);
    EXPECT_EQ(m_log + (used ? "used" : "refused"), expected);
    Count(event, used, view, window);
  }

  void Count(int event, bool used, const Rect2D& view, const Rect2D& window) {
    if (event != MouseEvent_Move || !used || m_captured != nullptr) {
      EXPECT_EQ(m_viewPort.GetViewWin(), view);
      EXPECT_EQ(m_viewPort.GetGraphicWin(), window);
      return;
    }
    moves += (m_operation & 0x3000) != 0 ? 1 : 0;
    pans += (m_operation & 0x0C00) != 0 ? 1 : 0;
    zooms += (m_operation & 0x0300) != 0 ? 1 : 0;
  }

  /// What the log and the result have to be. Changes the model's state.
  std::string Foretell(int event, int flags, const tagPOINT& point) {
    const Rect2D view = m_viewPort.GetViewWin();
    const auto x = static_cast<float>(point.x);
    const auto y = static_cast<float>(point.y);
    const bool inView =
        x >= view.GetTL().x && x <= view.GetBR().x && y >= view.GetTL().y && y <= view.GetBR().y;
    if (m_operation == 0 && m_captured == nullptr && !inView) {
      return "refused";
    }
    const auto call = [&](const TestHandler* handler) {
      return handler->name + ":" + std::to_string(event) + "/" + std::to_string(flags) + " ";
    };
    std::string log;
    if (event == MouseEvent_ButtonDown) {
      m_captured = nullptr;
      for (TestHandler* handler : m_listed) {
        log += call(handler);
        if (handler->takesDown) {
          m_captured = handler;
          ++captures;
          return log + "used";
        }
      }
      return log + (StartsOperation(flags, point) ? "used" : "refused");
    }
    if (m_captured != nullptr) {
      log = call(m_captured);
      const bool used = m_captured->takesOthers || event == MouseEvent_ButtonUp;
      m_captured = event == MouseEvent_ButtonUp ? nullptr : m_captured;
      return log + (used ? "used" : "refused");
    }
    const bool runs = m_operation != 0;
    m_operation = event == MouseEvent_ButtonUp ? 0 : m_operation;
    return runs ? "used" : "refused";
  }

  bool StartsOperation(int flags, const tagPOINT& point) {
    if ((flags & MK_LBUTTON) == 0) {
      return false;
    }
    dVect2D graphic(point);
    m_viewPort.ViewToGraphic(graphic);
    const bool inside = m_viewPort.GetGraphicWin().IsInside(graphic);
    int bits = 0x0C00;
    bits = inside && (flags & MK_CONTROL) != 0 ? 0x3000 : bits;
    bits = inside && (flags & MK_SHIFT) != 0 ? 0x0300 : bits;
    m_operation = 0;
    for (int bit = 0x0100; bit <= 0x2000; bit *= 2) {
      m_operation |= (bits & bit) != 0 && m_viewPort.IsEnabled(static_cast<short>(bit)) ? bit : 0;
    }
    return m_operation != 0;
  }

  void ExpectOrder() {
    ExpectLegalScales();
    ExpectWindowFillsDrawWindow();
    ExpectWindowOverArea();
    for (TestHandler& handler : m_handlers) {
      EXPECT_EQ(m_viewPort.GetActiveGraphicObject() == &handler.probe, m_captured == &handler);
      EXPECT_EQ(handler.probe.map, nullptr);
    }
    if (m_operation == 0) {
      OpenViewPort copy(m_viewPort);
      EXPECT_FALSE(copy.StopInteractiveOp(tagPOINT{}));
    }
  }

  void ExpectLegalScales() {
    const auto legal = [](double scale, double minimum, double maximum) {
      return scale >= minimum * 0.999 && scale <= maximum * 1.001;
    };
    EXPECT_TRUE(legal(m_viewPort.GetScaleX(), m_viewPort.GetMinScaleX(), m_viewPort.GetMaxScaleX()))
        << m_viewPort.GetScaleX();
    EXPECT_TRUE(legal(m_viewPort.GetScaleY(), m_viewPort.GetMinScaleY(), m_viewPort.GetMaxScaleY()))
        << m_viewPort.GetScaleY();
    if (m_viewPort.IsEnabled(ViewPortFlag_Proportional) && m_viewPort.GetWidthMode() != 1 &&
        m_viewPort.GetWidthMode() != 2 && m_viewPort.GetHeightMode() != 1 &&
        m_viewPort.GetHeightMode() != 2) {
      EXPECT_NEAR(m_viewPort.GetScaleX() / m_viewPort.GetScaleY(), 1.0, 0.001);
    }
  }

  void ExpectWindowFillsDrawWindow() {
    const Rect2D view = m_viewPort.GetViewWin();
    Rect2D mapped;
    m_viewPort.GraphicToView(m_viewPort.GetGraphicWin(), mapped);
    EXPECT_NEAR(mapped.GetTL().x, view.GetTL().x + m_viewPort.GetLeftBorder(), 0.02);
    EXPECT_NEAR(mapped.GetTL().y, view.GetTL().y + m_viewPort.GetTopBorder(), 0.02);
    EXPECT_NEAR(mapped.GetBR().x, view.GetBR().x - m_viewPort.GetRightBorder(), 0.02);
    EXPECT_NEAR(mapped.GetBR().y, view.GetBR().y - m_viewPort.GetBottomBorder(), 0.02);
  }

  /// A window that is smaller than a fixed area lies inside it.
  void ExpectWindowOverArea() {
    if (!m_viewPort.IsEnabled(ViewPortFlag_FixedGraphicArea)) {
      return;
    }
    const Rect2D window = m_viewPort.GetGraphicWin();
    if (window.Width() <= kArea.Width()) {
      EXPECT_GE(window.GetTL().x, kArea.GetTL().x - 0.01F);
      EXPECT_LE(window.GetBR().x, kArea.GetBR().x + 0.01F);
    }
    if (window.Height() <= kArea.Height()) {
      EXPECT_GE(window.GetTL().y, kArea.GetTL().y - 0.01F);
      EXPECT_LE(window.GetBR().y, kArea.GetBR().y + 0.01F);
    }
  }

  const Rect2D kArea{-100, 50, 900, 650};
  std::mt19937 m_random{kSeed};
  std::ostringstream m_what;
  std::string m_log;
  std::array<TestHandler, 3> m_handlers{TestHandler{"a", m_log}, TestHandler{"b", m_log},
                                        TestHandler{"c", m_log}};
  OpenViewPort m_viewPort;
  std::vector<TestHandler*> m_listed;
  TestHandler* m_captured = nullptr;
  int m_operation = 0;
};

TEST(GraphicViewPortRandom, LongSessionsKeepEverythingInOrder) {
  RandomUser user;
  for (int step = 0; step < kSteps && !::testing::Test::HasFailure(); ++step) {
    user.Step();
    if (::testing::Test::HasFailure()) {
      ADD_FAILURE() << "in step " << step << " (seed " << kSeed << "): " << user.What();
    }
  }
  // The session has to have seen something of everything.
  EXPECT_GT(user.pans, 100);
  EXPECT_GT(user.moves, 100);
  EXPECT_GT(user.zooms, 100);
  EXPECT_GT(user.captures, 100);
}

}  // namespace
