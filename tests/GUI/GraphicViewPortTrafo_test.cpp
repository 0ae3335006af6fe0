// How modes, limits and alignment lead to the transformation.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

#include "ViewPortTesting.h"

namespace {

const Rect2D kSquare(0, 0, 100, 100);

TEST(GraphicViewPortTrafo, MapsTheWindowOntoTheDrawWindow) {
  OpenViewPort viewPort;
  viewPort.Init(kSquare, Rect2D(10, 20, 60, 70), Rect2D(100, 200, 215, 330));
  viewPort.SetBorder(10, 20, 5, 10);
  viewPort.UpdateTransformation();
  ExpectEdges(viewPort.GetGraphicWin(), 10, 20, 60, 70);
  ExpectMapsWindowTo(viewPort, 110, 220, 210, 320);
  EXPECT_EQ(viewPort.GetScaleX(), 2.0F);
  EXPECT_EQ(viewPort.GetScaleY(), 2.0F);
}

TEST(GraphicViewPortTrafo, ProportionalTakesTheSmallerScale) {
  const OpenViewPort viewPort = Shown(kSquare, kSquare, Rect2D(0, 0, 200, 100));
  EXPECT_FLOAT_EQ(static_cast<float>(viewPort.GetGraphicWin().Width()), 200.0F);
  EXPECT_FLOAT_EQ(static_cast<float>(viewPort.GetGraphicWin().Height()), 100.0F);
  ExpectEdges(viewPort.GetGraphicWin(), -50, 0, 150, 100);
  EXPECT_EQ(viewPort.GetScaleX(), 1.0F);
  EXPECT_EQ(viewPort.GetScaleY(), 1.0F);
}

TEST(GraphicViewPortTrafo, IndependentDirectionsKeepTheirScales) {
  OpenViewPort viewPort(kSquare, kSquare, Rect2D(0, 0, 200, 100));
  viewPort.SetProportional(false);
  viewPort.UpdateTransformation();
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
  EXPECT_EQ(viewPort.GetScaleX(), 2.0F);
  EXPECT_EQ(viewPort.GetScaleY(), 1.0F);
}

struct ModeCase {
  unsigned char mode;
  float scale;
};

TEST(GraphicViewPortTrafo, EachModeHasItsScale) {
  // A window of half the area in 200 pixels: scale 4 at present, 2 for the whole area.
  for (const ModeCase& c :
       {ModeCase{0, 4.0F}, {1, 2.0F}, {2, 1.0F}, {3, 8.0F}, {4, 0.5F}, {5, 4.0F}, {255, 4.0F}}) {
    for (const bool inX : {true, false}) {
      OpenViewPort viewPort(kSquare, Rect2D(20, 20, 70, 70), Rect2D(0, 0, 200, 200));
      viewPort.SetProportional(false);
      viewPort.SetScaleFactors(1, 1, 0.5F, 8, 0.5F, 8);
      viewPort.SetViewMode(inX ? c.mode : 0, inX ? 0 : c.mode);
      viewPort.UpdateTransformation();
      EXPECT_EQ(viewPort.GetScaleX(), inX ? c.scale : 4.0F) << int{c.mode};
      EXPECT_EQ(viewPort.GetScaleY(), inX ? 4.0F : c.scale) << int{c.mode};
      EXPECT_EQ(viewPort.GetWidthMode(), inX ? c.mode : 0) << "modes stay";
    }
  }
}

TEST(GraphicViewPortTrafo, ScalesCountFromTheOriginalScale) {
  OpenViewPort viewPort(kSquare, kSquare, Rect2D(0, 0, 200, 200));
  viewPort.SetProportional(false);
  viewPort.SetScaleFactors(4, 0.5F, 0.1F, 10, 0.1F, 10);
  viewPort.OrigSize();
  viewPort.UpdateTransformation();
  EXPECT_DOUBLE_EQ(viewPort.GetTrafo().GetSx(), 4.0);
  EXPECT_DOUBLE_EQ(viewPort.GetTrafo().GetSy(), 0.5);
}

TEST(GraphicViewPortTrafo, FittingShowsTheWholeArea) {
  OpenViewPort viewPort(Rect2D(10, 20, 60, 120), Rect2D(30, 30, 40, 40), Rect2D(0, 0, 220, 220));
  viewPort.SetBorder(10);
  viewPort.SetProportional(false);
  viewPort.FitSize();
  viewPort.UpdateTransformation();
  ExpectEdges(viewPort.GetGraphicWin(), 10, 20, 60, 120);
  ExpectMapsWindowTo(viewPort, 10, 10, 210, 210);
}

TEST(GraphicViewPortTrafo, ProportionalViewportsGetCommonLimits) {
  OpenViewPort viewPort(kSquare);
  viewPort.SetScaleFactors(1, 1, 0.5F, 4, 0.25F, 8);
  Rect2D window(kSquare);
  EXPECT_FALSE(viewPort.CorrectSize(window, kSquare));
  EXPECT_EQ(viewPort.GetMinScaleX(), 0.25);
  EXPECT_EQ(viewPort.GetMinScaleY(), 0.25);
  EXPECT_EQ(viewPort.GetMaxScaleX(), 8.0);
  EXPECT_EQ(viewPort.GetMaxScaleY(), 8.0);
}

TEST(GraphicViewPortTrafo, IndependentDirectionsKeepTheirLimits) {
  OpenViewPort viewPort(kSquare);
  viewPort.SetProportional(false);
  viewPort.SetScaleFactors(1, 1, 0.5F, 4, 0.25F, 8);
  Rect2D window(kSquare);
  EXPECT_FALSE(viewPort.CorrectSize(window, kSquare));
  EXPECT_EQ(viewPort.GetMinScaleX(), 0.5);
  EXPECT_EQ(viewPort.GetMaxScaleX(), 4.0);
  EXPECT_EQ(viewPort.GetMinScaleY(), 0.25);
  EXPECT_EQ(viewPort.GetMaxScaleY(), 8.0);
}

TEST(GraphicViewPortTrafo, FitAndOriginalWidenTheLimitsOfTheirDirection) {
  for (const ViewMode mode : {ViewMode_Fit, ViewMode_Original}) {
    for (const bool inX : {true, false}) {
      for (const bool above : {true, false}) {
        OpenViewPort viewPort(kSquare);
        viewPort.SetProportional(false);
        const float low = above ? 0.25F : 3.0F;
        const float high = above ? 0.5F : 6.0F;
        viewPort.SetScaleFactors(1, 1, low, high, low, high);
        viewPort.SetViewMode(inX ? mode : ViewMode_Free, inX ? ViewMode_Free : mode);
        Rect2D window(kSquare);
        viewPort.CorrectSize(window, kSquare);
        const std::string text = std::to_string(mode) + (inX ? " x" : " y");
        EXPECT_EQ(viewPort.GetMinScaleX(), inX && !above ? 1.0 : low) << text;
        EXPECT_EQ(viewPort.GetMaxScaleX(), inX && above ? 1.0 : high) << text;
        EXPECT_EQ(viewPort.GetMinScaleY(), !inX && !above ? 1.0 : low) << text;
        EXPECT_EQ(viewPort.GetMaxScaleY(), !inX && above ? 1.0 : high) << text;
        const double scaleX = 100.0 / window.Width();
        EXPECT_FLOAT_EQ(static_cast<float>(scaleX), inX ? 1.0F : above ? 0.5F : 3.0F) << text;
      }
    }
  }
}

TEST(GraphicViewPortTrafo, MaximumAndMinimumLeaveTheLimits) {
  OpenViewPort viewPort(kSquare);
  viewPort.SetScaleFactors(1, 1, 0.25F, 4, 0.25F, 4);
  viewPort.MaxSize();
  Rect2D window(kSquare);
  EXPECT_TRUE(viewPort.CorrectSize(window, kSquare));
  ExpectEdges(window, 37.5F, 37.5F, 62.5F, 62.5F);
  viewPort.MinSize();
  EXPECT_TRUE(viewPort.CorrectSize(window, kSquare));
  ExpectEdges(window, -150, -150, 250, 250);
  EXPECT_EQ(viewPort.GetMinScaleX(), 0.25);
  EXPECT_EQ(viewPort.GetMaxScaleY(), 4.0);
}

TEST(GraphicViewPortTrafo, FreeScalesAreHeldInsideTheLimits) {
  OpenViewPort viewPort(kSquare);
  viewPort.SetProportional(false);
  viewPort.SetScaleFactors(1, 1, 0.5F, 2, 0.5F, 2);
  Rect2D window(0, 0, 10, 1000);
  EXPECT_TRUE(viewPort.CorrectSize(window, kSquare));
  ExpectEdges(window, -20, 400, 30, 600);
}

TEST(GraphicViewPortTrafo, MinimumAboveTheMaximumWins) {
  OpenViewPort viewPort(kSquare);
  viewPort.SetProportional(false);
  viewPort.SetScaleFactors(1, 1, 4, 2, 4, 2);
  Rect2D window(kSquare);
  EXPECT_TRUE(viewPort.CorrectSize(window, kSquare));
  ExpectEdges(window, 37.5F, 37.5F, 62.5F, 62.5F);
}

TEST(GraphicViewPortTrafo, MirroredRectanglesHavePositiveScales) {
  OpenViewPort viewPort(kSquare);
  Rect2D window(100, 0, 0, 100);
  EXPECT_FALSE(viewPort.CorrectSize(window, kSquare));
  ExpectEdges(window, 100, 0, 0, 100);
  viewPort.SetGraphicWin(window);
  viewPort.UpdateTransformation();
  EXPECT_EQ(viewPort.GetScaleX(), -1.0F);
  EXPECT_EQ(viewPort.GetScaleY(), 1.0F);
}

TEST(GraphicViewPortTrafo, ScalesThatCannotBeReachedKeepTheSize) {
  OpenViewPort viewPort(kSquare);
  viewPort.SetScaleFactors(1, 1, 0, 10, 0, 10);
  viewPort.MinSize();
  viewPort.UpdateTransformation();
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
  for (const float original : {0.0F, std::numeric_limits<float>::infinity(), std::nanf("")}) {
    viewPort.SetScaleFactors(original, original, 0.1F, 10, 0.1F, 10);
    viewPort.SetViewMode(0, 0);
    viewPort.UpdateTransformation();
    ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
    EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0);
  }
}

TEST(GraphicViewPortTrafo, ViewWithoutAreaChangesNothing) {
  OpenViewPort viewPort = Shown(kSquare, kSquare, Rect2D(0, 0, 100, 100));
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  for (const Rect2D& view : {Rect2D(5, 0, 5, 10), Rect2D(0, 5, 10, 5), Rect2D()}) {
    Rect2D window(1, 2, 3, 4);
    viewPort.UpdateTransformation(window, view);
    ExpectEdges(window, 1, 2, 3, 4);
    ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
    ExpectEdges(viewPort.GetViewWin(), 0, 0, 100, 100);
    EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0);
  }
  // Nor does one without area that borders turn inside out, or one that is all border.
  viewPort.SetBorder(5);
  Rect2D window(1, 2, 3, 4);
  viewPort.UpdateTransformation(window, Rect2D(5, 0, 5, 100));
  viewPort.UpdateTransformation(window, Rect2D(0, 5, 100, 5));
  ExpectEdges(window, 1, 2, 3, 4);
  viewPort.SetBorder(50);
  viewPort.UpdateTransformation();
  EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0);
  EXPECT_EQ(listener.count, 0);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPortTrafo, WindowWithoutAreaBecomesTheGraphicArea) {
  for (const Rect2D& empty : {Rect2D(5, 0, 5, 10), Rect2D(0, 5, 10, 5)}) {
    const OpenViewPort viewPort = Shown(Rect2D(10, 20, 60, 70), empty, kSquare);
    ExpectEdges(viewPort.GetGraphicWin(), 10, 20, 60, 70);
    ExpectMapsWindowTo(viewPort, 0, 0, 100, 100);
  }
}

TEST(GraphicViewPortTrafo, AreaWithoutAreaBecomesTheDrawWindow) {
  for (const Rect2D& empty : {Rect2D(5, 0, 5, 10), Rect2D(0, 5, 10, 5)}) {
    OpenViewPort viewPort;
    viewPort.Init(empty, Rect2D(), Rect2D(10, 10, 110, 60));
    viewPort.SetBorder(5, 0);
    viewPort.UpdateTransformation();
    ExpectEdges(viewPort.GetGraphicArea(), 15, 10, 105, 60);
    ExpectEdges(viewPort.GetGraphicWin(), 15, 10, 105, 60);
    EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0);
    EXPECT_EQ(viewPort.GetTrafo().GetTx(), 0.0);
    EXPECT_EQ(viewPort.GetTrafo().GetTy(), 0.0);
    // A window with area keeps even such an area as it is.
    viewPort.Init(empty, kSquare, Rect2D(0, 0, 100, 100));
    viewPort.UpdateTransformation();
    EXPECT_EQ(viewPort.GetGraphicArea(), empty);
  }
}

TEST(GraphicViewPortTrafo, FittingAnAreaWithoutExtentKeepsTheScale) {
  OpenViewPort viewPort(Rect2D(5, 5, 5, 5), Rect2D(0, 0, 50, 50));
  viewPort.FitSize();
  viewPort.UpdateTransformation();
  EXPECT_EQ(viewPort.GetScaleX(), 2.0F);
  EXPECT_EQ(viewPort.GetMaxScaleX(), 10.0);
}

TEST(GraphicViewPortTrafo, GivenRectanglesBecomeTheViewportsOwn) {
  OpenViewPort viewPort(Rect2D(0, 0, 1000, 1000));
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  Rect2D window(-10, 0, 40, 25);
  const Rect2D view(0, 0, 100, 100);
  viewPort.UpdateTransformation(window, view);
  ExpectEdges(window, 0, 0, 50, 50);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 50, 50);
  ExpectEdges(viewPort.GetViewWin(), 0, 0, 100, 100);
  EXPECT_EQ(listener.count, 1);
  EXPECT_EQ(listener.last, &viewPort);
  // Both may be one rectangle: the window that it becomes leaves the view as it was given.
  Rect2D both(-20, 0, 280, 200);
  viewPort.SetViewMode(3, 3);
  viewPort.UpdateTransformation(both, both);
  ExpectEdges(viewPort.GetViewWin(), -20, 0, 280, 200);
  ExpectEdges(both, 115, 90, 145, 110);
  EXPECT_FLOAT_EQ(viewPort.GetScaleX(), 10.0F);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPortTrafo, TakesTheMapFromItsHandlers) {
  std::string log;
  TestHandler handler("a", log);
  OpenViewPort viewPort(kSquare);
  viewPort.AddGraphic(&handler);
  viewPort.ProcessKeyEvent(0, 0, 0);
  EXPECT_EQ(handler.probe.map, &viewPort.GetTrafo());
  viewPort.UpdateTransformation();
  EXPECT_EQ(handler.probe.map, nullptr);
}

TEST(GraphicViewPortTrafo, ScaleLimitsAreWidenedToTheGivenScale) {
  OpenViewPort viewPort;
  const auto limits = [&](const Rect2D& window, const Rect2D& view) {
    viewPort.SetScaleFactors(2, 0.5F, 0.5F, 4, 0.5F, 4);
    viewPort.CorrectScaleLimits(window, view);
    return std::to_string(viewPort.GetMinScaleX()) + " " + std::to_string(viewPort.GetMaxScaleX()) +
           " " + std::to_string(viewPort.GetMinScaleY()) + " " +
           std::to_string(viewPort.GetMaxScaleY());
  };
  EXPECT_EQ(limits(Rect2D(0, 0, 10, 10), Rect2D(0, 0, 20, 20)),
            "0.500000 4.000000 0.500000 4.000000");
  EXPECT_EQ(limits(Rect2D(0, 0, 10, 10), Rect2D(0, 0, 100, 1)),
            "0.500000 5.000000 0.200000 4.000000");
  EXPECT_EQ(limits(Rect2D(0, 0, 10, 10), Rect2D(0, 0, 5, 80)),
            "0.250000 4.000000 0.500000 16.000000");
  // The sign counts here.
  EXPECT_EQ(limits(Rect2D(0, 0, -10, 10), Rect2D(0, 0, 20, 20)),
            "-1.000000 4.000000 0.500000 4.000000");
}

TEST(GraphicViewPortTrafo, ViewWindowUpdateKeepsTheScaleAndShowsMore) {
  OpenViewPort viewPort = Shown(kSquare, Rect2D(0, 0, 50, 50), Rect2D(0, 0, 100, 100));
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  viewPort.SetBorder(10, 20, 30, 40);
  viewPort.SetViewWin(Rect2D(0, 0, 200, 160), true);
  ExpectEdges(viewPort.GetGraphicWin(), 5, 10, 85, 60);
  EXPECT_EQ(viewPort.GetScaleX(), 2.0F);
  EXPECT_EQ(listener.count, 0) << "the transformation is left to the caller";
  viewPort.UpdateTransformation();
  EXPECT_EQ(viewPort.GetScaleX(), 2.0F);
  ExpectEdges(viewPort.GetGraphicWin(), 5, 10, 85, 60);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPortTrafo, FittedWidthKeepsTheGraphicWindow) {
  for (const ViewMode mode :
       {ViewMode_Free, ViewMode_Fit, ViewMode_Original, ViewMode_Maximum, ViewMode_Minimum}) {
    OpenViewPort viewPort = Shown(kSquare, kSquare, kSquare);
    viewPort.SetViewMode(mode, 1);
    viewPort.SetViewWin(0, 0, 50, 60, false);
    if (mode == ViewMode_Fit) {
      ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
    } else {
      ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 50, 60);
    }
  }
}

TEST(GraphicViewPortTrafo, EveryWayOfSettingTheViewWindowUpdates) {
  OpenViewPort viewPort = Shown(kSquare, Rect2D(0, 0, 50, 50), kSquare);
  viewPort.SetViewWin(tagRECT{60, 40, 20, 10}, false);
  ExpectEdges(viewPort.GetViewWin(), 20, 10, 60, 40);
  ExpectEdges(viewPort.GetGraphicWin(), 10, 5, 30, 20);
  viewPort.SetViewWin(4.0F, 8.0F, 14.0F, 2.0F, true);
  ExpectEdges(viewPort.GetViewWin(), 4, 2, 14, 8);
  ExpectEdges(viewPort.GetGraphicWin(), 2, 1, 7, 4);
  viewPort.MoveViewWin(-6, 10, true);
  ExpectEdges(viewPort.GetViewWin(), -2, 12, 8, 18);
  ExpectEdges(viewPort.GetGraphicWin(), -1, 6, 4, 9);
  viewPort.SetViewPos(20, 30, false);
  ExpectEdges(viewPort.GetViewWin(), 20, 30, 30, 36);
  ExpectEdges(viewPort.GetGraphicWin(), 10, 15, 15, 18);
  viewPort.SetViewPos(tagPOINT{0, 2}, false);
  ExpectEdges(viewPort.GetViewWin(), 0, 2, 10, 8);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 1, 5, 4);
}

}  // namespace
