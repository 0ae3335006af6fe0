// What a viewport draws, pixel by pixel.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "Canvas.h"
#include "ViewPortTesting.h"

namespace {

constexpr int kWidth = 40;
constexpr int kHeight = 30;
constexpr unsigned kBlank = 0;
constexpr long kGround = 0x112233;
constexpr long kBorder = 0x445566;
constexpr unsigned kInk = 0x0000FF;

void FillAll(HDC dc, unsigned color) {
  const HBRUSH brush = CreateSolidBrush(color);
  const tagRECT all{0, 0, kWidth, kHeight};
  FillRect(dc, &all, brush);
  DeleteObject(brush);
}

bool Holds(const tagRECT& rect, int x, int y) {
  return x >= rect.left && x < rect.right && y >= rect.top && y < rect.bottom;
}

/// Compares every pixel with what a function of its place expects.
void ExpectPixels(const Canvas& canvas, const std::function<unsigned(int, int)>& expected) {
  int wrong = 0;
  for (int y = 0; y < kHeight; ++y) {
    for (int x = 0; x < kWidth; ++x) {
      if (canvas.At(x, y) != expected(x, y) && ++wrong == 1) {
        ADD_FAILURE() << "at " << x << " " << y << ": " << std::hex << canvas.At(x, y)
                      << " instead of " << expected(x, y);
      }
    }
  }
  EXPECT_EQ(wrong, 0);
}

/// One colour inside a rectangle, nothing outside.
void ExpectOnly(const Canvas& canvas, const tagRECT& rect, unsigned color) {
  ExpectPixels(canvas, [&](int x, int y) { return Holds(rect, x, y) ? color : kBlank; });
}

/// A viewport over (5, 4)-(35, 24) with borders of 2, 3, 4 and 1, and handlers that fill whatever
/// they may.
class GraphicViewPortDraw : public ::testing::Test {
 protected:
  GraphicViewPortDraw() {
    viewPort.Init(Rect2D(0, 0, 48, 32), Rect2D(0, 0, 48, 32), Rect2D(5, 4, 35, 24));
    viewPort.SetBorder(2, 3, 4, 1);
    viewPort.SetBgColor(kGround);
    viewPort.SetBorderColor(kBorder);
    viewPort.UpdateTransformation();
    viewPort.AddGraphic(&handler);
    canvas.Fill(0);
    handler.draw = [](HDC dc) { FillAll(dc, kInk); };
  }

  const tagRECT view{5, 4, 35, 24};
  const tagRECT draw{7, 7, 31, 23};
  std::string log;
  TestHandler handler{"h", log};
  OpenViewPort viewPort;
  Canvas canvas{kWidth, kHeight};
};

TEST_F(GraphicViewPortDraw, IsClippedToTheDrawWindow) {
  viewPort.Draw(canvas, nullptr, false);
  ExpectOnly(canvas, draw, kInk);
  EXPECT_EQ(log, "h:draw ");
}

TEST_F(GraphicViewPortDraw, IsClippedToTheViewWindowWithoutTheFlag) {
  viewPort.ClipBorders(false);
  viewPort.Draw(canvas, nullptr, false);
  ExpectOnly(canvas, view, kInk);
}

TEST_F(GraphicViewPortDraw, EdgesOfBothWindowsAreRounded) {
  viewPort.Init(Rect2D(0, 0, 48, 32), Rect2D(0, 0, 48, 32), Rect2D(4.5F, 4.4F, 34.6F, 24.4F));
  viewPort.UpdateTransformation();
  viewPort.Draw(canvas, nullptr, false);
  ExpectOnly(canvas, draw, kInk);
  Canvas other(kWidth, kHeight);
  other.Fill(0);
  viewPort.ClipBorders(false);
  viewPort.Draw(other, nullptr, false);
  ExpectOnly(other, view, kInk);
}

TEST_F(GraphicViewPortDraw, ClipRectangleIsRounded) {
  Rect2D clip(9.5F, 0.0F, 20.4F, 10.6F);
  viewPort.Draw(canvas, &clip, false);
  ExpectOnly(canvas, {10, 7, 20, 11}, kInk);
  ExpectEdges(clip, 9.5F, 0.0F, 20.4F, 10.6F);
}

TEST_F(GraphicViewPortDraw, GraphicClipRectangleIsMappedInPlace) {
  // Half a pixel per unit: (4, 8)-(20, 24) is (9, 11)-(17, 19).
  Rect2D clip(4, 8, 20, 24);
  viewPort.Draw(canvas, &clip, true);
  ExpectOnly(canvas, {9, 11, 17, 19}, kInk);
  ExpectEdges(clip, 9, 11, 17, 19);
}

TEST_F(GraphicViewPortDraw, ClipRectangleIsMappedOnceForAllHandlers) {
  TestHandler second("s", log);
  viewPort.AddGraphic(&second);
  Rect2D clip(4, 8, 20, 24);
  viewPort.Draw(canvas, &clip, true);
  ExpectEdges(clip, 9, 11, 17, 19);
  EXPECT_EQ(log, "h:draw s:draw ");
  viewPort.RemoveGraphic(&second);
}

TEST_F(GraphicViewPortDraw, ClipRectangleOutsideLeavesNothing) {
  Rect2D clip(100, 100, 200, 200);
  viewPort.Draw(canvas, &clip, false);
  ExpectOnly(canvas, {}, kInk);
  Rect2D huge(-1e30F, -1e30F, 1e30F, 1e30F);
  Canvas other(kWidth, kHeight);
  other.Fill(0);
  viewPort.Draw(other, &huge, false);
  ExpectOnly(other, draw, kInk);
}

TEST_F(GraphicViewPortDraw, HandlersDrawInOrder) {
  TestHandler second("s", log);
  second.draw = [](HDC dc) {
    const HBRUSH brush = CreateSolidBrush(0x00FF00);
    const tagRECT left{0, 0, 15, kHeight};
    FillRect(dc, &left, brush);
    DeleteObject(brush);
  };
  viewPort.AddGraphic(&second);
  viewPort.Draw(canvas, nullptr, false);
  EXPECT_EQ(log, "h:draw s:draw ");
  ExpectPixels(canvas, [&](int x, int y) {
    return !Holds(draw, x, y) ? kBlank : x < 15 ? 0x00FF00U : kInk;
  });
  viewPort.RemoveGraphic(&second);
}

TEST_F(GraphicViewPortDraw, OneHandlerIsDrawnAloneWhetherListedOrNot) {
  TestHandler stranger("s", log);
  stranger.draw = handler.draw;
  viewPort.Draw(canvas, &stranger, nullptr, false);
  EXPECT_EQ(log, "s:draw ");
  ExpectOnly(canvas, draw, kInk);
  log.clear();
  viewPort.Draw(canvas, static_cast<GraphicHandler*>(nullptr), nullptr, false);
  EXPECT_EQ(log, "");
}

TEST_F(GraphicViewPortDraw, OneHandlerIsClippedAsAllAre) {
  Rect2D clip(4, 8, 20, 24);
  viewPort.Draw(canvas, &handler, &clip, true);
  ExpectOnly(canvas, {9, 11, 17, 19}, kInk);
  ExpectEdges(clip, 9, 11, 17, 19);
}

TEST_F(GraphicViewPortDraw, NothingIsDrawnWhenNotVisible) {
  viewPort.SetVisible(false);
  Rect2D clip(4, 8, 20, 24);
  viewPort.Draw(canvas, &clip, true);
  viewPort.Draw(canvas, &handler, &clip, true);
  viewPort.EraseBkgnd(canvas, &clip, true);
  EXPECT_EQ(log, "");
  ExpectEdges(clip, 4, 8, 20, 24);
  FillAll(canvas, kInk);
  ExpectOnly(canvas, {0, 0, kWidth, kHeight}, kInk);
}

TEST_F(GraphicViewPortDraw, ClipRegionIsCutDownAndStays) {
  IntersectClipRect(canvas, 0, 0, 20, kHeight);
  viewPort.Draw(canvas, nullptr, false);
  ExpectOnly(canvas, {7, 7, 20, 23}, kInk);
  FillAll(canvas, 0x00FF00);
  ExpectOnly(canvas, {7, 7, 20, 23}, 0x00FF00);
}

TEST_F(GraphicViewPortDraw, DrawingChangesNoGeometry) {
  const Rect2D window = viewPort.GetGraphicWin();
  TrafoListener listener;
  viewPort.SetInterface(&listener);
  viewPort.Draw(canvas, nullptr, false);
  viewPort.EraseBkgnd(canvas, nullptr, false);
  EXPECT_EQ(viewPort.GetGraphicWin(), window);
  EXPECT_EQ(listener.count, 0);
  viewPort.SetInterface(nullptr);
}

TEST_F(GraphicViewPortDraw, BackgroundAndBorderHaveTheirColours) {
  viewPort.EraseBkgnd(canvas, nullptr, false);
  ExpectPixels(canvas, [&](int x, int y) {
    return Holds(draw, x, y)   ? static_cast<unsigned>(kGround)
           : Holds(view, x, y) ? static_cast<unsigned>(kBorder)
                               : kBlank;
  });
  FillAll(canvas, kInk);
  ExpectPixels(canvas, [&](int x, int y) {
    return Holds(draw, x, y) ? static_cast<unsigned>(kGround) : Holds(view, x, y) ? kInk : kBlank;
  });
}

TEST_F(GraphicViewPortDraw, AnySingleBorderIsFilled) {
  for (int side = 0; side < 4; ++side) {
    Canvas fresh(kWidth, kHeight);
    fresh.Fill(0);
    const auto width = [side](int which) { return which == side ? 3 : 0; };
    viewPort.SetBorder(width(0), width(1), width(2), width(3));
    const tagRECT inner{5 + width(0), 4 + width(1), 35 - width(2), 24 - width(3)};
    viewPort.EraseBkgnd(fresh, nullptr, false);
    ExpectPixels(fresh, [&](int x, int y) {
      return Holds(inner, x, y)  ? static_cast<unsigned>(kGround)
             : Holds(view, x, y) ? static_cast<unsigned>(kBorder)
                                 : kBlank;
    });
  }
}

TEST_F(GraphicViewPortDraw, WithoutBordersTheClipRegionKeepsTheDrawWindow) {
  viewPort.SetBorder(0);
  viewPort.EraseBkgnd(canvas, nullptr, false);
  ExpectOnly(canvas, view, kGround);
  FillAll(canvas, kInk);
  ExpectOnly(canvas, view, kInk);
}

TEST_F(GraphicViewPortDraw, ErasingIsClippedToo) {
  Rect2D clip(5.6F, 0.0F, 9.4F, 100.0F);
  viewPort.EraseBkgnd(canvas, &clip, false);
  ExpectPixels(canvas, [&](int x, int y) {
    return x < 6 || x >= 9     ? kBlank
           : Holds(draw, x, y) ? static_cast<unsigned>(kGround)
           : Holds(view, x, y) ? static_cast<unsigned>(kBorder)
                               : kBlank;
  });
  Canvas other(kWidth, kHeight);
  other.Fill(0);
  Rect2D graphic(4, 8, 20, 24);
  viewPort.EraseBkgnd(other, &graphic, true);
  ExpectOnly(other, {9, 11, 17, 19}, kGround);
  ExpectEdges(graphic, 9, 11, 17, 19);
}

TEST_F(GraphicViewPortDraw, ActiveObjectIsDrawnForTheCapturedHandlerOnly) {
  viewPort.DrawActiveObject(canvas);
  EXPECT_EQ(log, "");
  handler.takesDown = true;
  viewPort.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, {10, 10});
  log.clear();
  IntersectClipRect(canvas, 0, 0, 10, 10);
  viewPort.DrawActiveObject(canvas);
  EXPECT_EQ(log, "h:active ");
  ExpectOnly(canvas, draw, kInk);  // whatever the clip region was
  FillAll(canvas, 0x00FF00);
  ExpectOnly(canvas, {0, 0, kWidth, kHeight}, 0x00FF00);
}

TEST_F(GraphicViewPortDraw, ActiveObjectIsClippedToTheViewWindowWithoutTheFlag) {
  handler.takesDown = true;
  viewPort.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, {10, 10});
  viewPort.ClipBorders(false);
  viewPort.DrawActiveObject(canvas);
  ExpectOnly(canvas, view, kInk);
  log.clear();
  viewPort.SetVisible(false);
  viewPort.DrawActiveObject(canvas);
  EXPECT_EQ(log, "");
}

TEST_F(GraphicViewPortDraw, BordersThatOverlapFillTheWholeViewWindow) {
  for (const int side : {0, 1}) {
    viewPort.SetBorder(side == 0 ? 100 : 0, side == 1 ? 100 : 0);
    Canvas fresh(kWidth, kHeight);
    fresh.Fill(0);
    viewPort.EraseBkgnd(fresh, nullptr, false);
    ExpectOnly(fresh, view, kBorder);
    Canvas other(kWidth, kHeight);
    other.Fill(0);
    viewPort.Draw(other, nullptr, false);
    ExpectOnly(other, {}, kInk);
  }
}

TEST_F(GraphicViewPortDraw, MirroredViewWindowIsDrawnAsItsPixels) {
  viewPort.SetBorder(0);
  viewPort.Init(Rect2D(0, 0, 48, 32), Rect2D(0, 0, 48, 32), Rect2D(35, 24, 5, 4));
  viewPort.Draw(canvas, nullptr, false);
  ExpectOnly(canvas, view, kInk);
}

TEST_F(GraphicViewPortDraw, NoDeviceIsHarmless) {
  viewPort.EraseBkgnd(nullptr, nullptr, false);
  handler.takesDown = true;
  viewPort.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, {10, 10});
  log.clear();
  viewPort.DrawActiveObject(nullptr);
  viewPort.Draw(nullptr, nullptr, false);
  EXPECT_EQ(log, "h:active h:draw ");
}

}  // namespace
