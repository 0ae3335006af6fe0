#include <vorl/GUI/VGCrossCursorView.h>

#include <gtest/gtest.h>

#include <cmath>

#include "ShapeTesting.h"

namespace {

using gui_testing::Lit;
using gui_testing::RopOf;
using Pixels = std::set<std::pair<int, int>>;

constexpr int kSize = 32;

/// A cursor with a red first and a green second line and a blue dot.
class ColourCursor : public VGCrossCursorView {
 public:
  ColourCursor(float posX, float posY, short mode) {
    Set(posX, posY);
    SetViewState(VGViewState_Visible);
    SetCursorColors(0x0000FF, 0x00FF00);
    SetPenColor(0xFF0000);
    SetCursorMode(mode);
  }
};

class BlackCanvas : public Canvas {
 public:
  BlackCanvas() : Canvas(kSize, kSize) { Fill(0); }
};

Pixels PixelsOf(const Canvas& canvas, unsigned colour) {
  Pixels pixels;
  for (const auto& [x, y] : Lit(canvas)) {
    if (canvas.At(x, y) == colour) {
      pixels.insert({x, y});
    }
  }
  return pixels;
}

Pixels Row(int y, int first = 0, int end = kSize) {
  Pixels pixels;
  for (int x = first; x < end; ++x) {
    pixels.insert({x, y});
  }
  return pixels;
}

Pixels Column(int x) {
  Pixels pixels;
  for (int y = 0; y < kSize; ++y) {
    pixels.insert({x, y});
  }
  return pixels;
}

/// What one line of a pen covers.
Pixels Drawn(int style, int width, int x1, int y1, int x2, int y2) {
  const BlackCanvas canvas;
  HPEN pen = CreatePen(style, width, 0xFFFFFF);
  HGDIOBJ old = SelectObject(canvas, pen);
  MoveToEx(canvas, x1, y1, nullptr);
  LineTo(canvas, x2, y2);
  SelectObject(canvas, old);
  DeleteObject(pen);
  EXPECT_FALSE(Lit(canvas).empty());
  return Lit(canvas);
}

TEST(VGCrossCursorViewDraw, EachLineHasItsBitAndColour) {
  const BlackCanvas first;
  ColourCursor cursor(10.9F, 7.9F, 1);
  cursor.VGObjectView::Draw(first);
  EXPECT_EQ(Lit(first), Row(7)) << "without decimals, and no dot";
  EXPECT_EQ(first.At(10, 7), 0x0000FFu);
  const BlackCanvas second;
  cursor.SetCursorMode(2);
  cursor.VGObjectView::Draw(second);
  EXPECT_EQ(Lit(second), Column(10));
  EXPECT_EQ(second.At(10, 7), 0x00FF00u);
  const BlackCanvas none;
  cursor.SetCursorMode(4);
  cursor.VGObjectView::Draw(none);
  EXPECT_EQ(Lit(none), Pixels{});
}

TEST(VGCrossCursorViewDraw, DotIsDrawnInModeThree) {
  const BlackCanvas canvas;
  ColourCursor cursor(10, 7, 3);
  cursor.VGObjectView::Draw(canvas);
  EXPECT_EQ(PixelsOf(canvas, 0xFF0000), Drawn(PS_SOLID, 2 * 1 + 3, 10, 7, 10, 7));
  EXPECT_EQ(canvas.At(0, 7), 0x0000FFu);
  EXPECT_EQ(canvas.At(10, 0), 0x00FF00u);
  EXPECT_EQ(canvas.At(30, 30), 0u);
}

TEST(VGCrossCursorViewDraw, OtherModesWithBothBitsHaveNoDot) {
  const BlackCanvas canvas;
  ColourCursor cursor(10, 7, 7);
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(PixelsOf(canvas, 0xFF0000), Pixels{});
  EXPECT_EQ(PixelsOf(canvas, 0x00FF00), Column(10)) << "over the first";
  EXPECT_EQ(PixelsOf(canvas, 0x0000FF).size(), kSize - 1u);
}

TEST(VGCrossCursorViewDraw, DotGrowsWithThePen) {
  const BlackCanvas canvas;
  ColourCursor cursor(16, 16, 3);
  cursor.SetPenThickness(3);
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(PixelsOf(canvas, 0xFF0000), Drawn(PS_SOLID, 9, 16, 16, 16, 16));
  EXPECT_EQ(canvas.At(1, 17), 0x0000FFu);
  EXPECT_EQ(canvas.At(1, 18), 0u);
}

TEST(VGCrossCursorViewDraw, LinesHaveThePenStyle) {
  const BlackCanvas canvas;
  ColourCursor cursor(0, 7, 1);
  cursor.SetPenStyle(PS_DASH);
  SetBkMode(canvas, TRANSPARENT);
  cursor.DrawGraphic(canvas);
  EXPECT_GT(Lit(canvas).size(), 0u);
  EXPECT_LT(Lit(canvas).size(), unsigned{kSize});
}

// Round ends inside the picture would show: the line begins and ends two pixels outside.
TEST(VGCrossCursorViewDraw, LinesReachTwoPixelsBeyondTheClipBox) {
  const BlackCanvas canvas;
  ColourCursor cursor(10, 16, 1);
  cursor.SetPenThickness(5);
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Drawn(PS_SOLID, 5, -2, 16, kSize + 2, 16));
  // A line just outside of the clip box still shows half of its width, one further out nothing.
  const BlackCanvas outside;
  cursor.Set(10.0, -2.0);
  cursor.DrawGraphic(outside);
  EXPECT_EQ(Lit(outside), Row(0));
  const BlackCanvas beyond;
  cursor.SetPenThickness(9);
  cursor.Set(10.0, -3.0);
  cursor.DrawGraphic(beyond);
  EXPECT_EQ(Lit(beyond), Pixels{}) << "clipped to the box, not to what the pen would reach";
}

TEST(VGCrossCursorViewDraw, LinesStayInTheClipRegion) {
  const BlackCanvas canvas;
  IntersectClipRect(canvas, 3, 0, 30, kSize);
  ColourCursor cursor(10, 7, 1);
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Row(7, 3, 30));
}

TEST(VGCrossCursorViewDraw, DrawingRefreshesTheViewPosition) {
  Scale2D scale(2, 3, 0, 0);
  const BlackCanvas canvas;
  ColourCursor cursor(1, 1, 3);
  cursor.SetTransformation(&scale);
  cursor.Set(5.0, 4.0);
  cursor.SetViewPos(dVect2D(0, 0));
  cursor.DrawGraphic(canvas);
  EXPECT_TRUE(cursor.GetViewPos() == dVect2D(10, 12));
  EXPECT_EQ(canvas.At(10, 12), 0xFF0000u);
}

TEST(VGCrossCursorViewDraw, NothingHappensWithoutADeviceOrAClipRegion) {
  const BlackCanvas canvas;
  ColourCursor cursor(5, 4, 3);
  cursor.DrawGraphic(HDC{nullptr});
  IntersectClipRect(canvas, 3, 3, 3, 3);
  cursor.DrawGraphic(canvas);
  EXPECT_TRUE(cursor.GetViewPos() == dVect2D(0, 0));
  EXPECT_EQ(Lit(canvas), Pixels{});
}

TEST(VGCrossCursorViewDraw, DirectionsAreMappedAsVectors) {
  Scale2D scale(1, 2, 100, -7);  // about a centre, so that points are shifted
  const BlackCanvas canvas;
  ColourCursor cursor(4, 0, 1);
  cursor.SetCursorOrientation(1, dVect2D(1, 1));
  cursor.SetTransformation(&scale);
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(4, 7), 0x0000FFu) << "(0 - -7) * 2 - 7";
  EXPECT_EQ(canvas.At(9, 17), 0x0000FFu);
  EXPECT_EQ(canvas.At(14, 27), 0x0000FFu);
}

// Single precision does not know the point that such a direction leads to.
TEST(VGCrossCursorViewDraw, ShortDirectionsAreNotLost) {
  const BlackCanvas canvas;
  ColourCursor cursor(16, 16, 1);
  cursor.SetCursorOrientation(1, dVect2D(1e-7F, -1e-7F));
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(16, 16), 0x0000FFu);
  EXPECT_EQ(canvas.At(2, 30), 0x0000FFu);
  EXPECT_EQ(canvas.At(30, 2), 0x0000FFu);
}

// Deep in a zoomed picture the cursor may be far outside of what is seen.
TEST(VGCrossCursorViewDraw, FarPositionsKeepTheSlope) {
  const BlackCanvas canvas;
  ColourCursor cursor(16 - 3e6F, 16 - 1e6F, 1);
  cursor.SetCursorOrientation(1, dVect2D(0.3F, 0.1F));
  cursor.DrawGraphic(canvas);
  EXPECT_TRUE(canvas.At(16, 15) != 0 || canvas.At(16, 16) != 0 || canvas.At(16, 17) != 0);
  EXPECT_EQ(Lit(canvas).size(), unsigned{kSize});
}

TEST(VGCrossCursorViewDraw, DegenerateNumbersDoNoHarm) {
  BlackCanvas canvas;
  ColourCursor cursor(1e30F, -1e30F, 3);
  cursor.SetCursorOrientation(dVect2D(0, 0), dVect2D(1e38F, 1e38F));
  cursor.DrawGraphic(canvas);
  cursor.SetCursorOrientation(2, dVect2D(1, 2));
  cursor.Set(HUGE_VAL, std::nan(""));
  cursor.DrawGraphic(canvas);
  cursor.SetCursorOrientation(1, dVect2D(0, 0));
  cursor.Set(16.0, 16.0);
  cursor.SetCursorMode(1);
  cursor.DrawGraphic(canvas);
  canvas.Fill(0);
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{}) << "no direction, no line";
}

TEST(VGCrossCursorViewDraw, DeviceIsLeftAsItWas) {
  const BlackCanvas canvas;
  HGDIOBJ pen = GetCurrentObject(canvas, OBJ_PEN);
  ColourCursor cursor(10, 7, 3);
  cursor.SetROPMode(R2_XORPEN);
  cursor.DrawGraphic(canvas);
  EXPECT_FALSE(Lit(canvas).empty());
  cursor.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), Pixels{}) << "drawn twice in xor";
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_PEN), pen);
  EXPECT_EQ(RopOf(canvas), R2_COPYPEN);
}

}  // namespace
