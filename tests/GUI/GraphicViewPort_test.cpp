// Construction, rectangles and borders.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "Canvas.h"
#include "ViewPortTesting.h"

namespace {

const Rect2D kA(1.0F, 2.0F, 31.0F, 42.0F);
const Rect2D kB(5.0F, 6.0F, 7.0F, 8.0F);
const Rect2D kC(10.0F, 20.0F, 110.0F, 220.0F);
const Rect2D kDefault(0.0F, 0.0F, 100.0F, 100.0F);

void ExpectDefaults(GraphicViewPort& v) {
  ExpectEdges(v.GetGraphicArea(), 0, 0, 100, 100);
  ExpectEdges(v.GetGraphicWin(), 0, 0, 100, 100);
  ExpectEdges(v.GetViewWin(), 0, 0, 100, 100);
  EXPECT_EQ(v.GetLeftBorder() + v.GetTopBorder() + v.GetRightBorder() + v.GetBottomBorder(), 0);
  EXPECT_EQ(v.GetBgColor(), 0);
  EXPECT_EQ(v.GetBorderColor(), 0);
  EXPECT_EQ(v.GetOrigSizeScaleX(), 1.0);
  EXPECT_EQ(v.GetOrigSizeScaleY(), 1.0);
  EXPECT_EQ(v.GetMinScaleX(), static_cast<double>(0.1F));
  EXPECT_EQ(v.GetMaxScaleX(), 10.0);
  EXPECT_EQ(v.GetMinScaleY(), static_cast<double>(0.1F));
  EXPECT_EQ(v.GetMaxScaleY(), 10.0);
  ExpectPoint(v.GetViewRefPos(), 0, 0);
  ExpectPoint(v.GetGraphicRefPos(), 0, 0);
  EXPECT_EQ(v.GetWidthMode(), 0);
  EXPECT_EQ(v.GetHeightMode(), 0);
  EXPECT_EQ(v.GetAlignment(), 0);
  EXPECT_TRUE(v.IsEnabled(0x0F0F));
  for (const int off : {0x10, 0x20, 0x40, 0x80, 0x1000, 0x2000, 0x4000}) {
    EXPECT_FALSE(v.IsEnabled(static_cast<short>(off))) << off;
  }
  EXPECT_EQ(v.GetTrafo().GetSx(), 1.0);
  EXPECT_EQ(v.GetTrafo().GetSy(), 1.0);
  EXPECT_EQ(v.GetTrafo().GetTx(), 0.0);
  EXPECT_EQ(v.GetTrafo().GetTy(), 0.0);
}

TEST(GraphicViewPort, StartsWithTheDefaults) {
  GraphicViewPort viewPort;
  ExpectDefaults(viewPort);
}

TEST(GraphicViewPort, ConstructorsTakeAreaWindowAndView) {
  const GraphicViewPort one(kA);
  EXPECT_EQ(one.GetGraphicArea(), kA);
  EXPECT_EQ(one.GetGraphicWin(), kA);
  EXPECT_EQ(one.GetViewWin(), kDefault);
  const GraphicViewPort two(kA, kB);
  EXPECT_EQ(two.GetGraphicArea(), kA);
  EXPECT_EQ(two.GetGraphicWin(), kB);
  EXPECT_EQ(two.GetViewWin(), kDefault);
  const GraphicViewPort three(kA, kB, kC);
  EXPECT_EQ(three.GetGraphicArea(), kA);
  EXPECT_EQ(three.GetGraphicWin(), kB);
  EXPECT_EQ(three.GetViewWin(), kC);
  EXPECT_EQ(three.GetTrafo().GetSx(), 1.0) << "the transformation is not computed";
}

TEST(GraphicViewPort, InitCopiesTheRectanglesAndNothingElse) {
  GraphicViewPort viewPort;
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  viewPort.SetViewMode(3, 4);
  Rect2D area(kA);
  Rect2D window(kB);
  Rect2D view(kC);
  viewPort.Init(area, window, view);
  EXPECT_EQ(viewPort.GetGraphicArea(), kA);
  EXPECT_EQ(viewPort.GetGraphicWin(), kB);
  EXPECT_EQ(viewPort.GetViewWin(), kC);
  EXPECT_EQ(viewPort.GetWidthMode(), 3);
  EXPECT_EQ(viewPort.GetHeightMode(), 4);
  EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0);
  viewPort.Init(kB);
  EXPECT_EQ(viewPort.GetGraphicArea(), kB);
  EXPECT_EQ(viewPort.GetGraphicWin(), kB);
  EXPECT_EQ(viewPort.GetViewWin(), kC);
  viewPort.Init(kA, kDefault);
  EXPECT_EQ(viewPort.GetGraphicArea(), kA);
  EXPECT_EQ(viewPort.GetGraphicWin(), kDefault);
  EXPECT_EQ(viewPort.GetViewWin(), kC);
  EXPECT_EQ(listener.count, 0);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPort, ShorterFormsOfInitGoThroughTheVirtualOne) {
  class Counting : public GraphicViewPort {
   public:
    using GraphicViewPort::Init;
    int count = 0;
    void Init(Rect2D&, Rect2D&, Rect2D&) override { ++count; }
  };
  Counting viewPort;
  viewPort.Init(kA);
  viewPort.Init(kA, kB);
  viewPort.Init(kA, kB, kC);
  EXPECT_EQ(viewPort.count, 3);
}

TEST(GraphicViewPort, ResetRestoresEverythingAndTells) {
  GraphicViewPort viewPort(kA, kB, kC);
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  viewPort.SetBorder(1, 2, 3, 4);
  viewPort.SetBgColor(5);
  viewPort.SetBorderColor(6);
  viewPort.SetScaleFactors(2, 3, 4, 5, 6, 7);
  viewPort.SetViewMode(1, 2);
  viewPort.SetMode(0x3000);
  viewPort.SetAlignment(15);
  viewPort.SetViewRefPos(3, 4);
  viewPort.Reset();
  ExpectDefaults(viewPort);
  EXPECT_EQ(listener.count, 1);
  EXPECT_EQ(listener.last, &viewPort);
  viewPort.SetInterface(nullptr);
}

TEST(GraphicViewPort, ResetSetsTheScalesThroughTheVirtualFunction) {
  class Counting : public GraphicViewPort {
   public:
    int count = 0;
    void SetScaleFactors(float ox, float oy, float x1, float x2, float y1, float y2) override {
      ++count;
      GraphicViewPort::SetScaleFactors(ox, oy, x1, x2, y1, y2);
    }
  };
  Counting viewPort;
  viewPort.Reset();
  EXPECT_EQ(viewPort.count, 1);
  EXPECT_EQ(viewPort.GetMaxScaleY(), 10.0);
  viewPort.SetScaleSizes(1, 1, 1, 1, 1, 1);
  EXPECT_EQ(viewPort.count, 2);
}

TEST(GraphicViewPort, EndsWithOneMoreNotification) {
  TrafoListener listener;
  {
    GraphicViewPort viewPort;
    viewPort.SetInterface(&listener);
  }
  EXPECT_EQ(listener.count, 1);
}

TEST(GraphicViewPort, SettingAreaOrWindowFreesTheModes) {
  GraphicViewPort viewPort;
  const tagRECT rect{1, 2, 31, 42};
  const auto expectFree = [&] {
    EXPECT_EQ(viewPort.GetWidthMode(), 0);
    EXPECT_EQ(viewPort.GetHeightMode(), 0);
    viewPort.SetViewMode(1, 2);
  };
  viewPort.SetViewMode(1, 2);
  viewPort.SetGraphicArea(kA);
  EXPECT_EQ(viewPort.GetGraphicArea(), kA);
  expectFree();
  viewPort.SetGraphicArea(5.0F, 6.0F, 7.0F, 8.0F);
  EXPECT_EQ(viewPort.GetGraphicArea(), kB);
  expectFree();
  viewPort.SetGraphicArea(rect);
  EXPECT_EQ(viewPort.GetGraphicArea(), kA);
  expectFree();
  EXPECT_EQ(viewPort.GetGraphicWin(), kDefault);
  viewPort.SetGraphicWin(kA);
  EXPECT_EQ(viewPort.GetGraphicWin(), kA);
  expectFree();
  viewPort.SetGraphicWin(5.0F, 6.0F, 7.0F, 8.0F);
  EXPECT_EQ(viewPort.GetGraphicWin(), kB);
  expectFree();
  viewPort.SetGraphicWin(rect);
  EXPECT_EQ(viewPort.GetGraphicWin(), kA);
  expectFree();
  EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0) << "the transformation is not computed";
}

TEST(GraphicViewPort, MovesTheGraphicWindowAndKeepsTheModes) {
  GraphicViewPort viewPort(kA);
  viewPort.SetViewMode(1, 2);
  viewPort.MoveGraphicWin(2.0F, -3.0F);
  ExpectEdges(viewPort.GetGraphicWin(), 3, -1, 33, 39);
  viewPort.MoveGraphicWin(dVect2D(-2.0F, 3.0F));
  ExpectEdges(viewPort.GetGraphicWin(), 1, 2, 31, 42);
  viewPort.SetGraphicPos(10.0F, 20.0F);
  ExpectEdges(viewPort.GetGraphicWin(), 10, 20, 40, 60);
  viewPort.SetGraphicPos(tagPOINT{-5, -6});
  ExpectEdges(viewPort.GetGraphicWin(), -5, -6, 25, 34);
  viewPort.SetGraphicPos(dVect2D(0.5F, 0.25F));
  ExpectEdges(viewPort.GetGraphicWin(), 0.5F, 0.25F, 30.5F, 40.25F);
  EXPECT_EQ(viewPort.GetWidthMode(), 1);
  EXPECT_EQ(viewPort.GetHeightMode(), 2);
  EXPECT_EQ(viewPort.GetGraphicArea(), kA);
}

TEST(GraphicViewPort, CentresTheWindowAlongTheChosenDirections) {
  GraphicViewPort viewPort(kDefault, Rect2D(0, 0, 20, 10));
  viewPort.CenterWin(false, false);
  ExpectEdges(viewPort.GetGraphicWin(), 0, 0, 20, 10);
  viewPort.CenterWin(true, false);
  ExpectEdges(viewPort.GetGraphicWin(), 40, 0, 60, 10);
  viewPort.CenterWin(false, true);
  ExpectEdges(viewPort.GetGraphicWin(), 40, 45, 60, 55);
  EXPECT_EQ(viewPort.GetTrafo().GetSx(), 1.0);
}

TEST(GraphicViewPort, TellsTheViewWindowInWholePixels) {
  GraphicViewPort viewPort(kDefault, kDefault, Rect2D(10.9F, -3.0F, 110.6F, 50.0F));
  tagRECT rect;
  viewPort.GetViewWin(rect);
  EXPECT_EQ(RectText(rect), "10 -3 110 50");
  Rect2D exact;
  viewPort.GetViewWin(exact);
  ExpectEdges(exact, 10.9F, -3.0F, 110.6F, 50.0F);
  EXPECT_EQ(viewPort.GetViewWidth(), 99);
  EXPECT_EQ(viewPort.GetViewHeight(), 53);
}

TEST(GraphicViewPort, DrawWindowIsRoundedOnceWithItsBorders) {
  GraphicViewPort viewPort(kDefault, kDefault, Rect2D(10.4F, 0.0F, 110.6F, 50.0F));
  viewPort.SetBorder(2, 0, 0, 0);
  tagRECT rect;
  viewPort.GetDrawWin(rect);
  EXPECT_EQ(RectText(rect), "12 0 111 50");
  Rect2D asFloats;
  viewPort.GetDrawWin(asFloats);
  ExpectEdges(asFloats, 12, 0, 111, 50);
  // Decimals are cut off towards zero, on the negative side too.
  viewPort.Init(kDefault, kDefault, Rect2D(-20.0F, -7.75F, 5.0F, 30.5F));
  viewPort.SetBorder(1, 3, 10, 4);
  viewPort.GetDrawWin(rect);
  EXPECT_EQ(RectText(rect), "-18 -4 -4 27");
}

TEST(GraphicViewPort, EdgesBeyondTheDeviceBecomeTheNearestOnes) {
  const float nan = std::nanf("");
  GraphicViewPort viewPort(kDefault, kDefault, Rect2D(-1e20F, nan, 1e20F, 1e30F));
  viewPort.SetBorder(65535);
  tagRECT rect;
  viewPort.GetDrawWin(rect);
  EXPECT_EQ(RectText(rect), "-2147483648 0 2147483647 2147483647");
  viewPort.GetViewWin(rect);
  EXPECT_EQ(RectText(rect), "-2147483648 0 2147483647 2147483647");
  EXPECT_EQ(viewPort.GetViewWidth() > 2147483646L, true);
  EXPECT_EQ(viewPort.GetViewHeight(), 0);
}

TEST(GraphicViewPort, BordersAreGivenInThreeForms) {
  GraphicViewPort viewPort;
  const auto text = [&] {
    return RectText({viewPort.GetLeftBorder(), viewPort.GetTopBorder(), viewPort.GetRightBorder(),
                     viewPort.GetBottomBorder()});
  };
  viewPort.SetBorder(1, 2, 3, 4);
  EXPECT_EQ(text(), "1 2 3 4");
  viewPort.SetBorder(5, 6);
  EXPECT_EQ(text(), "5 6 5 6");
  viewPort.SetBorder(7);
  EXPECT_EQ(text(), "7 7 7 7");
  viewPort.SetBorder(-1, 65535, 65536, std::numeric_limits<int>::min());
  EXPECT_EQ(text(), "0 65535 65535 0");
}

TEST(GraphicViewPort, KeepsColours) {
  GraphicViewPort viewPort;
  viewPort.SetBgColor(0x123456);
  viewPort.SetBorderColor(0x00ABCDEF);
  EXPECT_EQ(viewPort.GetBgColor(), 0x123456);
  EXPECT_EQ(viewPort.GetBorderColor(), 0xABCDEF);
}

TEST(GraphicViewPort, InsideTheViewWindowMeansOnItsEdgesToo) {
  const GraphicViewPort viewPort(kDefault, kDefault, Rect2D(10, 20, 30, 40));
  for (const tagPOINT inside : {tagPOINT{10, 20}, {30, 40}, {10, 40}, {20, 30}}) {
    EXPECT_TRUE(viewPort.IsInside(inside));
    EXPECT_TRUE(viewPort.IsInside(inside.x, inside.y));
  }
  for (const tagPOINT outside : {tagPOINT{9, 30}, {31, 30}, {20, 19}, {20, 41}}) {
    EXPECT_FALSE(viewPort.IsInside(outside));
    EXPECT_FALSE(viewPort.IsInside(outside.x, outside.y));
  }
}

TEST(GraphicViewPort, InsideADeviceRectangleExcludesRightAndBottom) {
  const OpenViewPort viewPort;
  const tagRECT rect{10, 20, 30, 40};
  for (const tagPOINT inside : {tagPOINT{10, 20}, {29, 39}, {10, 39}, {29, 20}}) {
    EXPECT_TRUE(viewPort.IsInside(inside.x, inside.y, rect));
    EXPECT_TRUE(viewPort.IsInside(inside, rect));
  }
  for (const tagPOINT outside : {tagPOINT{30, 30}, {20, 40}, {9, 30}, {20, 19}}) {
    EXPECT_FALSE(viewPort.IsInside(outside.x, outside.y, rect));
    EXPECT_FALSE(viewPort.IsInside(outside, rect));
  }
}

TEST(GraphicViewPort, CopiesEveryField) {
  std::string log;
  TestHandler handler("a", log);
  TrafoListener listener;
  GraphicViewPort source(kA, kB, kC);
  source.SetInterface(&listener);
  source.SetBorder(1, 2, 3, 4);
  source.SetBgColor(5);
  source.SetBorderColor(6);
  source.SetScaleFactors(2, 3, 0.5F, 50, 0.25F, 70);
  source.SetMode(0x0901);
  source.SetAlignment(9);
  source.AddGraphic(&handler);
  source.UpdateTransformation();
  source.SetViewRefPos(30, 40);
  source.SetViewMode(3, 4);
  const auto expectSame = [&](GraphicViewPort& copy) {
    EXPECT_EQ(copy.GetGraphicArea(), source.GetGraphicArea());
    EXPECT_EQ(copy.GetGraphicWin(), source.GetGraphicWin());
    EXPECT_EQ(copy.GetViewWin(), kC);
    EXPECT_EQ(copy.GetLeftBorder(), 1);
    EXPECT_EQ(copy.GetTopBorder(), 2);
    EXPECT_EQ(copy.GetRightBorder(), 3);
    EXPECT_EQ(copy.GetBottomBorder(), 4);
    EXPECT_EQ(copy.GetBgColor(), 5);
    EXPECT_EQ(copy.GetBorderColor(), 6);
    EXPECT_EQ(copy.GetOrigSizeScaleX(), 2.0);
    EXPECT_EQ(copy.GetOrigSizeScaleY(), 3.0);
    EXPECT_EQ(copy.GetMinScaleX(), 0.5);
    EXPECT_EQ(copy.GetMaxScaleX(), 50.0);
    EXPECT_EQ(copy.GetMinScaleY(), 0.25);
    EXPECT_EQ(copy.GetMaxScaleY(), 70.0);
    EXPECT_TRUE(copy.IsEnabled(0x0901));
    EXPECT_FALSE(copy.IsEnabled(0x0002));
    EXPECT_EQ(copy.GetAlignment(), 9);
    EXPECT_EQ(copy.GetWidthMode(), 3);
    EXPECT_EQ(copy.GetHeightMode(), 4);
    EXPECT_EQ(copy.GetTrafo().GetSx(), source.GetTrafo().GetSx());
    EXPECT_EQ(copy.GetTrafo().GetTy(), source.GetTrafo().GetTy());
    EXPECT_EQ(copy.GetViewRefPos(), source.GetViewRefPos());
    EXPECT_EQ(copy.GetGraphicRefPos(), source.GetGraphicRefPos());
    log.clear();
    EXPECT_FALSE(copy.ProcessKeyEvent(1, 2, 3));
    EXPECT_EQ(log, "a:key1/2/3 ");
    EXPECT_EQ(handler.mapAtEvent, &copy.GetTrafo());
    listener.count = 0;
    copy.UpdateTransformation();
    EXPECT_EQ(listener.count, 1);
    EXPECT_EQ(listener.last, &copy);
  };
  GraphicViewPort constructed(source);
  expectSame(constructed);
  GraphicViewPort assigned;
  assigned = source;
  expectSame(assigned);
  // The lists are separate.
  assigned.RemoveGraphic(&handler);
  EXPECT_FALSE(assigned.ProcessKeyEvent(1, 2, 3));
  log.clear();
  source.ProcessKeyEvent(1, 2, 3);
  EXPECT_EQ(log, "a:key1/2/3 ");
}

}  // namespace
