// Coordinates of the device, of the graphics and of scroll bars; zooming, panning and moving.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "Canvas.h"
#include "ViewPortTesting.h"

namespace {

const Rect2D kSquare(0, 0, 100, 100);

/// Graphic (10, 20)-(60, 45) shown in (100, 200)-(200, 250): scale 2.
OpenViewPort Doubled() {
  return Shown(Rect2D(0, 0, 400, 400), Rect2D(10, 20, 60, 45), Rect2D(100, 200, 200, 250));
}

TEST(GraphicViewPortCoords, MapsPointsAndRectanglesBothWays) {
  const OpenViewPort viewPort = Doubled();
  dVect2D point(110, 230);
  viewPort.ViewToGraphic(point);
  ExpectPoint(point, 15, 35);
  viewPort.GraphicToView(point);
  ExpectPoint(point, 110, 230);
  dVect2D target;
  viewPort.ViewToGraphic(dVect2D(200, 250), target);
  ExpectPoint(target, 60, 45);
  viewPort.GraphicToView(dVect2D(0, 0), target);
  ExpectPoint(target, 80, 160);
  Rect2D rect(110, 230, 120, 260);
  viewPort.ViewToGraphic(rect);
  ExpectEdges(rect, 15, 35, 20, 50);
  viewPort.GraphicToView(rect);
  ExpectEdges(rect, 110, 230, 120, 260);
  Rect2D other;
  viewPort.ViewToGraphic(rect, other);
  ExpectEdges(other, 15, 35, 20, 50);
  viewPort.GraphicToView(other, rect);
  ExpectEdges(rect, 110, 230, 120, 260);
}

TEST(GraphicViewPortCoords, IntegersAreMappedByTheCentresOfTheirPixels) {
  const OpenViewPort viewPort = Doubled();
  // 111.5 is 15.75, 230.5 is 35.25.
  tagPOINT point{111, 230};
  viewPort.ViewToGraphic(point);
  EXPECT_EQ(point.x, 15);
  EXPECT_EQ(point.y, 35);
  // 15.5 is 111, 35.5 is 231.
  viewPort.GraphicToView(point);
  EXPECT_EQ(point.x, 111);
  EXPECT_EQ(point.y, 231);
  tagPOINT target{};
  viewPort.ViewToGraphic(tagPOINT{199, 249}, target);
  EXPECT_EQ(target.x, 59);
  EXPECT_EQ(target.y, 44);
  viewPort.GraphicToView(tagPOINT{0, 0}, target);
  EXPECT_EQ(target.x, 81);
  EXPECT_EQ(target.y, 161);
  tagRECT rect{111, 230, 120, 261};
  viewPort.ViewToGraphic(rect);
  EXPECT_EQ(RectText(rect), "15 35 20 50");
  viewPort.GraphicToView(rect);
  EXPECT_EQ(RectText(rect), "111 231 121 261");
  tagRECT other{};
  viewPort.ViewToGraphic(rect, other);
  EXPECT_EQ(RectText(other), "15 35 20 50");
  viewPort.GraphicToView(other, rect);
  EXPECT_EQ(RectText(rect), "111 231 121 261");
}

TEST(GraphicViewPortCoords, ReferencePositionsFollowEachOther) {
  OpenViewPort viewPort = Doubled();
  viewPort.SetViewRefPos(110, 230);
  ExpectPoint(viewPort.GetViewRefPos(), 110, 230);
  ExpectPoint(viewPort.GetGraphicRefPos(), 15, 35);
  viewPort.SetGraphicRefPos(0, 1);
  ExpectPoint(viewPort.GetGraphicRefPos(), 0, 1);
  ExpectPoint(viewPort.GetViewRefPos(), 80, 162);
}

TEST(GraphicViewPortCoords, ScrollPositionRunsFromZeroToOne) {
  GraphicViewPort viewPort(Rect2D(-100, 0, 300, 200), Rect2D(0, 0, 100, 50));
  EXPECT_FLOAT_EQ(viewPort.GetScrollPosX(), 100.0F / 300.0F);
  EXPECT_FLOAT_EQ(viewPort.GetScrollPosY(), 0.0F);
  EXPECT_EQ(viewPort.GetScrollFactorX(), 4.0F);
  EXPECT_EQ(viewPort.GetScrollFactorY(), 4.0F);
  viewPort.SetGraphicPos(200, 75);
  EXPECT_EQ(viewPort.GetScrollPosX(), 1.0F);
  EXPECT_EQ(viewPort.GetScrollPosY(), 0.5F);
}

TEST(GraphicViewPortCoords, ScrollingMovesTheWindowAndKeepsItsSize) {
  GraphicViewPort viewPort(Rect2D(-100, 0, 300, 200), Rect2D(0, 10, 100, 60));
  viewPort.SetScrollPosX(0.5F);
  ExpectEdges(viewPort.GetGraphicWin(), 50, 10, 150, 60);
  viewPort.SetScrollPosY(1.0F);
  ExpectEdges(viewPort.GetGraphicWin(), 50, 150, 150, 200);
  viewPort.SetScrollPos(0.0F, 0.0F);
  ExpectEdges(viewPort.GetGraphicWin(), -100, 0, 0, 50);
  viewPort.SetScrollPos(1.0F, 0.5F);
  ExpectEdges(viewPort.GetGraphicWin(), 200, 75, 300, 125);
  EXPECT_EQ(viewPort.GetTrafo().GetTx(), 0.0) << "the transformation is not computed";
}

TEST(GraphicViewPortCoords, ScrollPositionsOutsideAreTheNearestInside) {
  GraphicViewPort viewPort(kSquare, Rect2D(20, 20, 40, 40));
  viewPort.SetScrollPosX(1.5F);
  ExpectEdges(viewPort.GetGraphicWin(), 80, 20, 100, 40);
  viewPort.SetScrollPosY(1.5F);
  ExpectEdges(viewPort.GetGraphicWin(), 80, 80, 100, 100);
  viewPort.SetScrollPosX(-0.1F);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 80, 20, 100);
  viewPort.SetScrollPosY(-0.1F);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 20, 20);
  viewPort.SetGraphicPos(50, 50);
  viewPort.SetScrollPos(std::nanf(""), std::nanf(""));
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 20, 20);
}

TEST(GraphicViewPortCoords, WindowNoSmallerThanTheRangeDoesNotScroll) {
  GraphicViewPort wider(kSquare, Rect2D(-50, -60, 150, 140));
  wider.SetScrollPos(1.0F, 0.7F);
  wider.SetScrollPosX(0.5F);
  wider.SetScrollPosY(0.5F);
  ExpectEdges(wider.GetGraphicWin(), -50, -60, 150, 140);
  EXPECT_EQ(wider.GetScrollPosX(), 0.5F) << "-50 of -100";
  GraphicViewPort same(kSquare, Rect2D(10, 20, 110, 120));
  EXPECT_EQ(same.GetScrollPosX(), 0.0F);
  EXPECT_EQ(same.GetScrollPosY(), 0.0F);
  same.SetScrollPos(1.0F, 1.0F);
  ExpectEdges(same.GetGraphicWin(), 10, 20, 110, 120);
}

TEST(GraphicViewPortCoords, FreeAreaScrollsOverAreaAndWindow) {
  GraphicViewPort viewPort(kSquare, Rect2D(-50, 50, 50, 150));
  viewPort.FitSize();  // has no say here
  EXPECT_FLOAT_EQ(viewPort.GetScrollFactorX(), 1.0F);
  viewPort.SetFixedGraphicArea(false);
  EXPECT_FLOAT_EQ(viewPort.GetScrollFactorX(), 1.5F);
  EXPECT_FLOAT_EQ(viewPort.GetScrollFactorY(), 1.5F);
  EXPECT_FLOAT_EQ(viewPort.GetScrollPosX(), 0.0F);
  EXPECT_FLOAT_EQ(viewPort.GetScrollPosY(), 1.0F);
  viewPort.SetScrollPosX(1.0F);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 50, 100, 150);
}

TEST(GraphicViewPortZoom, ScalesTheWindowAboutTheGraphicReference) {
  OpenViewPort viewPort = Shown(kSquare, kSquare, kSquare);
  viewPort.SetViewMode(1, 1);
  viewPort.SetGraphicRefPos(20, 40);
  EXPECT_TRUE(viewPort.DoScale(2.0F, 4.0F));
  ExpectEdges(viewPort.GetGraphicWin(), 10, 30, 60, 55);
  EXPECT_EQ(viewPort.GetWidthMode(), 0);
  EXPECT_EQ(viewPort.GetHeightMode(), 0);
  EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0) << "the transformation is not computed";
}

TEST(GraphicViewPortZoom, FactorZeroCountsAsOne) {
  OpenViewPort viewPort = Shown(kSquare, Rect2D(10, 10, 43, 43), kSquare);
  viewPort.SetGraphicRefPos(17.3F, 25.1F);
  const Rect2D before = viewPort.GetGraphicWin();
  viewPort.SetViewMode(3, 4);
  for (const float factor : {0.0F, 1.0F, -0.0F}) {
    EXPECT_TRUE(viewPort.DoScale(factor, factor));
    EXPECT_EQ(viewPort.GetGraphicWin().GetTL().x, before.GetTL().x);
    EXPECT_EQ(viewPort.GetGraphicWin().GetBR().y, before.GetBR().y);
    EXPECT_EQ(viewPort.GetWidthMode(), 3);
    EXPECT_EQ(viewPort.GetHeightMode(), 4);
  }
  EXPECT_TRUE(viewPort.DoScale(0.0F, 1.5F));
  EXPECT_EQ(viewPort.GetWidthMode(), 3);
  EXPECT_EQ(viewPort.GetHeightMode(), 0);
  viewPort.SetViewMode(3, 4);
  EXPECT_TRUE(viewPort.DoScale(1.5F, 0.0F));
  EXPECT_EQ(viewPort.GetWidthMode(), 0);
  EXPECT_EQ(viewPort.GetHeightMode(), 4);
}

TEST(GraphicViewPortZoom, BeyondALimitNothingIsZoomed) {
  struct Case {
    float x;
    float y;
    bool legal;
  };
  const float above = std::nextafter(4.0F, 5.0F);
  const float below = std::nextafter(0.5F, 0.0F);
  for (const Case& c : {Case{4, 4, true},
                        {0.5F, 0.5F, true},
                        {above, 1, false},
                        {1, above, false},
                        {below, 1, false},
                        {1, below, false},
                        {2, above, false},
                        {-1, 1, false},
                        {std::nanf(""), 1, false},
                        {1, 1e30F, false}}) {
    OpenViewPort viewPort = Shown(kSquare, kSquare, kSquare);
    viewPort.SetScaleFactors(1, 1, 0.5F, 4, 0.5F, 4);
    EXPECT_TRUE(viewPort.DoScale(c.x, c.y));
    if (c.legal) {
      ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100 / c.x, 100 / c.y);
    } else {
      ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
    }
  }
}

TEST(GraphicViewPortZoom, ModesBecomeFreeEvenWhenTheZoomIsIgnored) {
  OpenViewPort viewPort = Shown(kSquare, kSquare, kSquare);
  viewPort.SetViewMode(1, 2);
  EXPECT_TRUE(viewPort.DoScale(1000.0F, 1000.0F));
  EXPECT_EQ(viewPort.GetWidthMode(), 0);
  EXPECT_EQ(viewPort.GetHeightMode(), 0);
}

TEST(GraphicViewPortZoom, LimitsAreComparedWithTheScaleOfTheWholeViewWindow) {
  // 100 pixels for 50 units: 2 with the borders, 1 without.
  OpenViewPort viewPort(Rect2D(0, 0, 400, 400), Rect2D(0, 0, 50, 50), kSquare);
  viewPort.SetBorder(25);
  viewPort.UpdateTransformation();
  EXPECT_EQ(viewPort.GetScaleX(), 1.0F);
  viewPort.SetScaleFactors(1, 1, 0.5F, 3, 0.5F, 3);
  viewPort.DoScale(2.0F, 2.0F);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 50, 50);
  viewPort.DoScale(1.5F, 1.5F);
  EXPECT_FLOAT_EQ(static_cast<float>(viewPort.GetGraphicWin().Width()), 50 / 1.5F);
  // Original scales count: 100 pixels for 40 units at 2.5 pixels each.
  viewPort.SetGraphicWin(0, 0, 40, 40);
  viewPort.SetScaleFactors(2.5F, 2.5F, 1, 1.25F, 1, 1.25F);
  viewPort.DoScale(1.25F, 1.25F);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 32, 32);
}

TEST(GraphicViewPortPan, ShiftsByFractionsOfTheWindow) {
  OpenViewPort viewPort = Shown(Rect2D(0, 0, 400, 400), kSquare, Rect2D(0, 0, 200, 200));
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  EXPECT_TRUE(viewPort.DoPan(0.5F, 0.25F));
  ExpectEdges(viewPort.GetGraphicWin(), 50, 25, 150, 125);
  EXPECT_EQ(viewPort.GetTrafo().GetTx(), -100.0);
  EXPECT_EQ(listener.count, 1);
  EXPECT_TRUE(viewPort.DoPan(-1.0F, 10.0F));
  ExpectEdges(viewPort.GetGraphicWin(), 0, 300, 100, 400);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPortMove, ShiftsTheViewWindowAndNotWhatItShows) {
  OpenViewPort viewPort = Shown(Rect2D(0, 0, 400, 400), kSquare, Rect2D(0, 0, 200, 200));
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  EXPECT_TRUE(viewPort.DoMove(10.5F, -20.0F));
  ExpectEdges(viewPort.GetViewWin(), 10.5F, -20, 210.5F, 180);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 100, 100);
  EXPECT_EQ(viewPort.GetTrafo().GetTx(), 10.5);
  EXPECT_EQ(viewPort.GetTrafo().GetTy(), -20.0);
  EXPECT_EQ(listener.count, 1);
  viewPort.SetInterface(nullptr);
}

}  // namespace
