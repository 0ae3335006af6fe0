// What the mouse does with the viewport itself: whole gestures.

#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/Platform/Gdi.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "ViewPortTesting.h"

namespace {

constexpr int kMove = 4097;
constexpr int kDown = 4098;
constexpr int kUp = 4099;
constexpr int kLeft = MK_LBUTTON;
constexpr int kMoveDrag = MK_LBUTTON | MK_CONTROL;
constexpr int kScaleDrag = MK_LBUTTON | MK_SHIFT;

const Rect2D kArea(0, 0, 400, 400);

/// Graphic (100, 100)-(200, 200) in (0, 0)-(200, 200): scale 2.
OpenViewPort Middle() {
  OpenViewPort viewPort = Shown(kArea, Rect2D(100, 100, 200, 200), Rect2D(0, 0, 200, 200));
  viewPort.EnableMove(true, true);
  return viewPort;
}

TEST(GraphicViewPortGestures, PanFollowsTheMouse) {
  OpenViewPort viewPort = Middle();
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kLeft, {50, 60}));
  EXPECT_EQ(listener.count, 0);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kLeft, {30, 100}));
  ExpectEdges(viewPort.GetGraphicWin(), 110, 80, 210, 180);
  EXPECT_EQ(listener.count, 1);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kLeft, {31, 99}));
  ExpectEdges(viewPort.GetGraphicWin(), 109.5F, 80.5F, 209.5F, 180.5F);
  EXPECT_EQ(viewPort.GetTrafo().GetTx(), -219.0);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kUp, 0, {31, 99}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kMove, 0, {80, 80}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kUp, 0, {80, 80}));
  ExpectEdges(viewPort.GetGraphicWin(), 109.5F, 80.5F, 209.5F, 180.5F);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPortGestures, PanStopsAtTheAreaAndStartsFromTheMouseAgain) {
  OpenViewPort viewPort = Middle();
  viewPort.ProcessMouseEvent(kDown, kLeft, {0, 0});
  viewPort.ProcessMouseEvent(kMove, kLeft, {1000, 0});
  ExpectEdges(viewPort.GetGraphicWin(), 0, 100, 100, 200);
  viewPort.ProcessMouseEvent(kMove, kLeft, {980, 0});
  ExpectEdges(viewPort.GetGraphicWin(), 10, 100, 110, 200);
}

TEST(GraphicViewPortGestures, PanGoesInTheEnabledDirectionsOnly) {
  OpenViewPort viewPort = Middle();
  viewPort.EnablePan(true, false);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kLeft, {50, 50}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kLeft, {60, 70}));
  ExpectEdges(viewPort.GetGraphicWin(), 95, 100, 195, 200);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kUp, 0, {60, 70}));
  viewPort.EnablePan(false, true);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kLeft, {60, 70}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kLeft, {100, 72}));
  ExpectEdges(viewPort.GetGraphicWin(), 95, 99, 195, 199);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kUp, 0, {100, 72}));
  viewPort.EnablePan(false, false);
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kDown, kLeft, {60, 70}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kMove, kLeft, {100, 72}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kUp, 0, {100, 72}));
}

TEST(GraphicViewPortGestures, PanFreesFittedModesAndOnlyThose) {
  struct Case {
    unsigned char before;
    unsigned char after;
  };
  for (const Case& c : {Case{0, 0}, {1, 0}, {2, 2}, {3, 3}, {4, 4}}) {
    OpenViewPort viewPort = Middle();
    viewPort.EnablePan(true, false);
    viewPort.SetViewMode(c.before, 1);
    EXPECT_TRUE(viewPort.StartInteractiveOp(tagPOINT{50, 50}, kLeft));
    EXPECT_EQ(viewPort.GetWidthMode(), c.after);
    EXPECT_EQ(viewPort.GetHeightMode(), 0);
    viewPort.SetViewMode(1, c.before);
    EXPECT_TRUE(viewPort.StartInteractiveOp(tagPOINT{50, 50}, kLeft));
    EXPECT_EQ(viewPort.GetWidthMode(), 0);
    EXPECT_EQ(viewPort.GetHeightMode(), c.after);
  }
}

TEST(GraphicViewPortGestures, ButtonOtherThanTheLeftStartsNothing) {
  OpenViewPort viewPort = Middle();
  for (const int flags : {0, MK_RBUTTON, MK_MBUTTON, MK_SHIFT, MK_RBUTTON | MK_CONTROL}) {
    EXPECT_FALSE(viewPort.ProcessMouseEvent(kDown, flags, {50, 50}));
    EXPECT_FALSE(viewPort.ProcessMouseEvent(kMove, flags, {60, 60}));
    EXPECT_FALSE(viewPort.ProcessMouseEvent(kUp, flags, {60, 60}));
  }
  ExpectPoint(viewPort.GetViewRefPos(), 0, 0);
  ExpectEdges(viewPort.GetGraphicWin(), 100, 100, 200, 200);
}

TEST(GraphicViewPortGestures, StartSetsBothReferencePositions) {
  OpenViewPort viewPort = Middle();
  viewPort.ProcessMouseEvent(kDown, kLeft, {50, 70});
  ExpectPoint(viewPort.GetViewRefPos(), 50, 70);
  ExpectPoint(viewPort.GetGraphicRefPos(), 125, 135);
}

TEST(GraphicViewPortGestures, EventsOutsideCountOnlyDuringAnOperation) {
  OpenViewPort viewPort = Middle();
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kDown, kLeft, {201, 50}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kMove, kLeft, {50, 50}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kLeft, {200, 50})) << "the edge is inside";
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kLeft, {300, 50}));
  ExpectEdges(viewPort.GetGraphicWin(), 50, 100, 150, 200);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kUp, 0, {300, 50}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kUp, 0, {300, 50}));
}

TEST(GraphicViewPortGestures, OtherEventCodesAreRefused) {
  OpenViewPort viewPort = Middle();
  for (const int event : {0, 4096, 4100, -1}) {
    EXPECT_FALSE(viewPort.ProcessMouseEvent(event, kLeft, {50, 50}));
  }
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kLeft, {50, 50}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(4100, kLeft, {60, 60}));
  ExpectEdges(viewPort.GetGraphicWin(), 100, 100, 200, 200);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kUp, kLeft, {60, 60})) << "the operation is still there";
}

TEST(GraphicViewPortGestures, ControlMovesTheViewWindowByTheWholeDrag) {
  OpenViewPort viewPort = Middle();
  viewPort.SetViewWin(10.75F, 20.0F, 210.75F, 220.0F, false);
  viewPort.UpdateTransformation();
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kMoveDrag, {50, 60}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kMoveDrag, {55, 80}));
  ExpectEdges(viewPort.GetViewWin(), 15, 40, 215, 240);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kMoveDrag, {51, 57}));
  ExpectEdges(viewPort.GetViewWin(), 11, 17, 211, 217);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kUp, kMoveDrag, {51, 57}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kMove, kMoveDrag, {90, 90}));
  ExpectEdges(viewPort.GetViewWin(), 11, 17, 211, 217);
}

TEST(GraphicViewPortGestures, MovedViewShowsWhatLiesBelowIt) {
  OpenViewPort viewPort = Middle();
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  viewPort.ProcessMouseEvent(kDown, kMoveDrag, {50, 50});
  viewPort.ProcessMouseEvent(kMove, kMoveDrag, {60, 30});
  ExpectEdges(viewPort.GetViewWin(), 10, -20, 210, 180);
  ExpectEdges(viewPort.GetGraphicWin(), 105, 90, 205, 190);
  EXPECT_EQ(listener.count, 1);
  Rect2D mapped;
  viewPort.GraphicToView(viewPort.GetGraphicWin(), mapped);
  ExpectEdges(mapped, 10, -20, 210, 180);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPortGestures, MoveGoesInTheEnabledDirectionsOnly) {
  OpenViewPort viewPort = Middle();
  viewPort.EnableMove(true, false);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kMoveDrag, {50, 60}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kMoveDrag, {55, 80}));
  ExpectEdges(viewPort.GetViewWin(), 5, 0, 205, 200);
  viewPort.ProcessMouseEvent(kUp, 0, {55, 80});
  viewPort.EnableMove(false, true);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kMoveDrag, {55, 80}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kMoveDrag, {75, 83}));
  ExpectEdges(viewPort.GetViewWin(), 5, 3, 205, 203);
}

TEST(GraphicViewPortGestures, ControlPreventsPanningWhenMovingIsOff) {
  OpenViewPort viewPort = Middle();
  viewPort.EnableMove(false, false);
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kDown, kMoveDrag, {50, 60}));
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kMove, kMoveDrag, {55, 80}));
}

TEST(GraphicViewPortGestures, KeysCountOnlyInsideTheGraphicWindow) {
  // The border of the view window lies outside the graphic window: it always pans.
  for (const int flags : {kMoveDrag, kScaleDrag}) {
    OpenViewPort viewPort = Middle();
    viewPort.SetBorder(20);
    viewPort.UpdateTransformation();
    const Rect2D view = viewPort.GetViewWin();
    const Rect2D window = viewPort.GetGraphicWin();
    EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, flags, {5, 100}));
    EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, flags, {15, 100}));
    EXPECT_EQ(viewPort.GetViewWin(), view);
    EXPECT_LT(viewPort.GetGraphicWin().GetTL().x, window.GetTL().x);
    EXPECT_FLOAT_EQ(static_cast<float>(viewPort.GetGraphicWin().Width()),
                    static_cast<float>(window.Width()));
  }
}

TEST(GraphicViewPortGestures, ShiftWinsOverControl) {
  OpenViewPort viewPort = Middle();
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kMoveDrag | MK_SHIFT, {100, 100}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kMoveDrag | MK_SHIFT, {105, 100}));
  ExpectEdges(viewPort.GetViewWin(), 0, 0, 200, 200);
  EXPECT_FLOAT_EQ(static_cast<float>(viewPort.GetGraphicWin().Width()), 100 / 1.02F);
  viewPort.ProcessMouseEvent(kUp, 0, {105, 100});
  viewPort.EnableScale(false, false);
  EXPECT_FALSE(viewPort.ProcessMouseEvent(kDown, kMoveDrag | MK_SHIFT, {100, 100}));
}

/// Writes down the factors.
class FactorPort : public OpenViewPort {
 public:
  using OpenViewPort::OpenViewPort;
  float x = 0;
  float y = 0;
  int count = 0;
  bool DoScale(float factorX, float factorY) override {
    x = factorX;
    y = factorY;
    ++count;
    return true;
  }
};

struct ZoomCase {
  int dx;
  int dy;
  float x;  // the factors of independent directions
  float y;
  float both;  // the factor when proportional
};

constexpr ZoomCase kZooms[] = {
    {3, 0, 1.02F, 1.0F, 1.02F},    {-3, 0, 0.98F, 1.0F, 0.98F},   {0, -3, 1.0F, 1.02F, 1.02F},
    {0, 3, 1.0F, 0.98F, 0.98F},    {3, -3, 1.02F, 1.02F, 1.02F},  {3, 3, 1.02F, 0.98F, 0.98F},
    {-3, 3, 0.98F, 0.98F, 0.98F},  {-3, -3, 0.98F, 1.02F, 1.02F}, {4, 3, 1.02F, 0.98F, 1.02F},
    {-4, -3, 0.98F, 1.02F, 0.98F}, {3, 4, 1.02F, 0.98F, 0.98F},   {0, 0, 1.0F, 1.0F, 1.0F},
    {500, 1, 1.02F, 0.98F, 1.02F},
};

TEST(GraphicViewPortGestures, EachStepOfAScaleDragHasItsFactors) {
  for (const ZoomCase& c : kZooms) {
    FactorPort viewPort;
    ASSERT_TRUE(viewPort.ProcessMouseEvent(kDown, kScaleDrag, {50, 50}));
    EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kScaleDrag, {50 + c.dx, 50 + c.dy}));
    EXPECT_EQ(viewPort.x, c.both) << c.dx << " " << c.dy;
    EXPECT_EQ(viewPort.y, c.both) << c.dx << " " << c.dy;
    viewPort.SetProportional(false);
    EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kScaleDrag, {50 + 2 * c.dx, 50 + 2 * c.dy}));
    EXPECT_EQ(viewPort.x, c.x) << c.dx << " " << c.dy << ": steps count from the last position";
    EXPECT_EQ(viewPort.y, c.y) << c.dx << " " << c.dy;
    EXPECT_EQ(viewPort.count, 2);
  }
}

TEST(GraphicViewPortGestures, ScaleDragGoesInTheEnabledDirectionsOnly) {
  FactorPort viewPort;
  viewPort.EnableScale(true, false);
  viewPort.SetProportional(false);
  viewPort.SetViewMode(1, 2);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kScaleDrag, {50, 50}));
  EXPECT_EQ(viewPort.GetWidthMode(), 0);
  EXPECT_EQ(viewPort.GetHeightMode(), 2);
  viewPort.ProcessMouseEvent(kMove, kScaleDrag, {60, 60});
  EXPECT_EQ(viewPort.x, 1.02F);
  EXPECT_EQ(viewPort.y, 1.0F);
  viewPort.SetProportional(true);
  viewPort.ProcessMouseEvent(kMove, kScaleDrag, {70, 70});
  EXPECT_EQ(viewPort.x, 1.0F) << "an equal way goes by y, which does not zoom";
  EXPECT_EQ(viewPort.y, 1.0F);
  viewPort.ProcessMouseEvent(kUp, 0, {70, 70});
  viewPort.EnableScale(false, true);
  viewPort.SetProportional(false);
  viewPort.SetViewMode(3, 4);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kScaleDrag, {50, 50}));
  EXPECT_EQ(viewPort.GetWidthMode(), 3);
  EXPECT_EQ(viewPort.GetHeightMode(), 0);
  viewPort.ProcessMouseEvent(kMove, kScaleDrag, {60, 60});
  EXPECT_EQ(viewPort.x, 1.0F);
  EXPECT_EQ(viewPort.y, 0.98F);
}

TEST(GraphicViewPortGestures, ScaleDragZoomsAboutThePressedPoint) {
  OpenViewPort viewPort = Middle();
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kDown, kScaleDrag, {50, 100}));
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kScaleDrag, {53, 98}));
  ExpectPoint(viewPort.GetViewRefPos(), 53.5F, 98.5F);
  ExpectPoint(viewPort.GetGraphicRefPos(), 125, 150);
  const float factor = 1 / 1.02F;
  ExpectEdges(viewPort.GetGraphicWin(), 125 - 25 * factor, 150 - 50 * factor, 125 + 75 * factor,
              150 + 50 * factor);
  EXPECT_EQ(viewPort.GetScaleX(), 2.0F) << "the transformation is left to the caller";
  EXPECT_EQ(listener.count, 0);
  viewPort.UpdateTransformation();
  EXPECT_FLOAT_EQ(viewPort.GetScaleX(), 2.04F);
  tagPOINT pressed{50, 100};
  dVect2D graphic(125, 150);
  viewPort.GraphicToView(graphic);
  EXPECT_NEAR(graphic.x, static_cast<float>(pressed.x), 0.001);
  EXPECT_NEAR(graphic.y, static_cast<float>(pressed.y), 0.001);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPortGestures, OperationsKeepTheirKindWhenFlagsChange) {
  OpenViewPort viewPort = Middle();
  viewPort.ProcessMouseEvent(kDown, kLeft, {50, 50});
  viewPort.SetMode(0);
  EXPECT_TRUE(viewPort.ProcessMouseEvent(kMove, kScaleDrag, {48, 50}));
  ExpectEdges(viewPort.GetGraphicWin(), 101, 100, 201, 200);
}

TEST(GraphicViewPortGestures, TheThreeStepsReportWhetherSomethingRuns) {
  OpenViewPort viewPort = Middle();
  const tagPOINT point{50, 50};
  EXPECT_FALSE(viewPort.ProcessInteractiveOp(point));
  EXPECT_FALSE(viewPort.StopInteractiveOp(point));
  EXPECT_TRUE(viewPort.StartInteractiveOp(point, kLeft));
  EXPECT_TRUE(viewPort.ProcessInteractiveOp(point));
  EXPECT_TRUE(viewPort.StopInteractiveOp(point));
  EXPECT_FALSE(viewPort.ProcessInteractiveOp(point));
  EXPECT_FALSE(viewPort.StopInteractiveOp(point));
  EXPECT_TRUE(viewPort.StartInteractiveOp(point, kLeft));
  viewPort.Reset();
  EXPECT_FALSE(viewPort.StopInteractiveOp(point));
}

TEST(GraphicViewPortGestures, FarthestDragsOfTheDeviceAreHarmless) {
  constexpr LONG kMin = std::numeric_limits<LONG>::min();
  constexpr LONG kMax = std::numeric_limits<LONG>::max();
  for (const int flags : {kLeft, kMoveDrag, kScaleDrag}) {
    for (const tagPOINT from : {tagPOINT{kMin, kMin}, {kMax, kMin}, {0, kMax}}) {
      OpenViewPort viewPort = Middle();
      viewPort.StartInteractiveOp(from, flags);
      for (const tagPOINT to : {tagPOINT{kMax, kMax}, {kMin, 0}, {kMin, kMax}, {kMax, kMin}}) {
        viewPort.ProcessInteractiveOp(to);
        viewPort.UpdateTransformation();
        // Sizes are rounded that far out, but stay sizes, and scales stay inside the limits.
        EXPECT_TRUE(viewPort.IsVisible());
        EXPECT_GE(viewPort.GetScaleX(), 0.0999F);
        EXPECT_LE(viewPort.GetScaleX(), 10.001F);
        EXPECT_TRUE(std::isfinite(viewPort.GetTrafo().GetTx()));
        EXPECT_TRUE(std::isfinite(viewPort.GetTrafo().GetTy()));
      }
    }
  }
}

}  // namespace
