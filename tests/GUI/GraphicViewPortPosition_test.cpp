// Where the graphic window stands over the graphic area.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include "ViewPortTesting.h"

namespace {

const Rect2D kSquare(0, 0, 100, 100);

struct PositionCase {
  const char* what;
  Rect2D window;
  float left;
  float top;
  bool moved;
};

TEST(GraphicViewPortPosition, WindowThatSticksOutOnOneSideComesBack) {
  const PositionCase cases[] = {
      {"inside", Rect2D(10, 20, 60, 70), 10, 20, false},
      {"at the edges", Rect2D(0, 50, 50, 100), 0, 50, false},
      {"left", Rect2D(-10, 20, 40, 70), 0, 20, true},
      {"right", Rect2D(70, 20, 120, 70), 50, 20, true},
      {"top", Rect2D(10, -1, 60, 49), 10, 0, true},
      {"bottom", Rect2D(10, 90, 60, 140), 10, 50, true},
      {"far outside", Rect2D(500, -300, 550, -250), 50, 0, true},
      {"larger on both sides", Rect2D(-10, 20, 120, 70), -10, 20, false},
      {"larger, left", Rect2D(10, 20, 140, 70), 0, 20, true},
      {"larger, right", Rect2D(-40, 20, 90, 70), -30, 20, true},
  };
  for (const PositionCase& c : cases) {
    OpenViewPort viewPort(kSquare);
    Rect2D window(c.window);
    EXPECT_EQ(viewPort.CorrectPosition(window), c.moved) << c.what;
    ExpectEdges(window, c.left, c.top, c.left + static_cast<float>(c.window.Width()),
                c.top + static_cast<float>(c.window.Height()));
  }
}

TEST(GraphicViewPortPosition, FreeAreaIsUnitedWithTheStoredWindow) {
  OpenViewPort viewPort(kSquare, Rect2D(-50, 80, 0, 150));
  viewPort.SetFixedGraphicArea(false);
  Rect2D window(-70, 90, -20, 160);
  EXPECT_TRUE(viewPort.CorrectPosition(window));
  ExpectEdges(window, -50, 80, 0, 150);
  EXPECT_FALSE(viewPort.CorrectPosition(window));
  // A fitted direction ranges over the area alone.
  viewPort.SetViewMode(1, 0);
  EXPECT_TRUE(viewPort.CorrectPosition(window));
  ExpectEdges(window, 0, 80, 50, 150);
  viewPort.SetViewMode(0, 1);
  window.Set(-50, 80, 0, 150);
  EXPECT_TRUE(viewPort.CorrectPosition(window));
  ExpectEdges(window, -50, 30, 0, 100);
}

TEST(GraphicViewPortPosition, FreeAreaLetsTheWindowGoAnywhere) {
  OpenViewPort viewPort(kSquare, Rect2D(500, -700, 600, -600), kSquare);
  viewPort.SetFixedGraphicArea(false);
  viewPort.UpdateTransformation();
  ExpectEdges(viewPort.GetGraphicWin(), 500, -700, 600, -600);
  viewPort.SetFixedGraphicArea(true);
  viewPort.UpdateTransformation();
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
}

TEST(GraphicViewPortPosition, AlignmentPlacesAWindowThatIsLargerThanTheRange) {
  struct Case {
    unsigned char alignment;
    float left;
    float top;
  };
  for (const Case& c : {Case{0, -30, -60},
                        {4, 0, -60},
                        {8, -100, -60},
                        {12, -50, -60},
                        {1, -30, 0},
                        {2, -30, -100},
                        {3, -30, -50},
                        {15, -50, -50},
                        {6, 0, -100},
                        {0xF9, -100, 0}}) {
    OpenViewPort viewPort(kSquare, Rect2D(-30, -60, 170, 140), Rect2D(0, 0, 200, 200));
    viewPort.SetAlignment(c.alignment);
    viewPort.UpdateTransformation();
    ExpectEdges(viewPort.GetGraphicWin(), c.left, c.top, c.left + 200, c.top + 200);
    ExpectMapsWindowTo(viewPort, 0, 0, 200, 200);
  }
}

TEST(GraphicViewPortPosition, AlignmentGoesByTheGraphicWindowsOwnSize) {
  // The same size as the range is not larger.
  OpenViewPort same(kSquare, kSquare);
  same.SetAlignment(5);
  Rect2D window(-50, -50, 150, 150);
  EXPECT_FALSE(same.CorrectPosition(window)) << "the stored window is no larger than the range";
  OpenViewPort larger(kSquare, Rect2D(0, 0, 101, 101));
  larger.SetAlignment(5);
  window.Set(-20, -10, 40, 50);
  EXPECT_TRUE(larger.CorrectPosition(window));
  ExpectEdges(window, 0, 0, 60, 60);
  window.Set(30, 40, 50, 60);
  EXPECT_TRUE(larger.CorrectPosition(window)) << "aligned although it lies inside";
  ExpectEdges(window, 0, 0, 20, 20);
}

TEST(GraphicViewPortPosition, AlignmentOfMirroredRectanglesGoesByTheirSizes) {
  // Larger than the area, from the right to the left and from below.
  OpenViewPort larger(kSquare, Rect2D(150, 160, -30, -20));
  larger.SetAlignment(5);
  Rect2D window(larger.GetGraphicWin());
  EXPECT_TRUE(larger.CorrectPosition(window));
  ExpectEdges(window, 0, 0, -180, -180);
  // Smaller than a mirrored area.
  OpenViewPort smaller(Rect2D(100, 100, 0, 0), Rect2D(20, 20, 70, 70));
  smaller.SetAlignment(5);
  window = smaller.GetGraphicWin();
  EXPECT_FALSE(smaller.CorrectPosition(window));
}

TEST(GraphicViewPortPosition, AlignmentSeesTheSizeThatTheLimitsLeave) {
  // 50 units at scale 2; the maximum shows twice the area.
  OpenViewPort viewPort(kSquare, Rect2D(20, 20, 70, 70), kSquare);
  viewPort.SetScaleFactors(1, 1, 0.1F, 0.5F, 0.1F, 0.5F);
  viewPort.SetAlignment(5);
  viewPort.UpdateTransformation();
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 200, 200);
}

}  // namespace
