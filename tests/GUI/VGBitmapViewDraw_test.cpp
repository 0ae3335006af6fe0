#include <vorl/GUI/VGBitmapView.h>

#include <gtest/gtest.h>

#include <cmath>

#include "ShapeTesting.h"
#include "ViewPortTesting.h"

namespace {

using gui_testing::Lit;
using gui_testing::RopOf;

constexpr unsigned kUntouched = 0x808080;

class GreyCanvas : public Canvas {
 public:
  GreyCanvas() : Canvas(64, 48) { Fill(static_cast<char>(0x80)); }
};

dImage ColourImage(int width = 20, int height = 12) {
  return NumberedImage(width, height, ImageDataType_U8, "BGR");
}

void ExpectEqual(const Canvas& actual, const Canvas& expected, const std::string& what) {
  int differing = 0;
  for (int y = 0; y < actual.Height(); ++y) {
    for (int x = 0; x < actual.Width(); ++x) {
      if (actual.At(x, y) != expected.At(x, y) && ++differing == 1) {
        ADD_FAILURE() << what << ": first at " << x << ", " << y << " " << std::hex
                      << actual.At(x, y) << " for " << expected.At(x, y);
      }
    }
  }
  EXPECT_EQ(differing, 0) << what;
}

/// An image drawn from a source into a target rectangle.
class Stretched : public GreyCanvas {
 public:
  Stretched(dImage& image, tagRECT source, tagRECT target) {
    vIma2Device device;
    EXPECT_TRUE(device.Init(&image, &source, &target, false, false));
    EXPECT_TRUE(device.Draw(*this));
  }
};

void ShowIn(HDC dc, GraphicViewPort& viewPort, VGBitmapView& view) {
  GraphicHandler handler;
  view.SetViewState(VGViewState_Visible);
  handler.AddObject(&view);
  viewPort.Draw(dc, &handler, nullptr, false);
  handler.DeleteAll();
}

/// How a viewport shows an image: pixel by pixel.
void ExpectShown(int zoom, int panX, int panY, int border, tagPOINT position) {
  const std::string what = "zoom " + std::to_string(zoom) + ", pan " + std::to_string(panX) + " " +
                           std::to_string(panY) + ", border " + std::to_string(border) +
                           ", position " + std::to_string(position.x);
  dImage image = ColourImage();
  image.SetPosition(position.x, position.y);
  VGBitmapView view;
  ASSERT_TRUE(view.Init(&image));
  const int left = 6;
  const int top = 3;
  const int width = 48;
  const int height = 36;
  OpenViewPort viewPort;
  viewPort.SetFixedGraphicArea(false);
  viewPort.Init(
      Rect2D(-500, -500, 500, 500),
      Rect2D(tagRECT{panX, panY, panX + width / zoom, panY + height / zoom}),
      Rect2D(tagRECT{left - border, top - border, left + width + border, top + height + border}));
  viewPort.SetBorder(border);
  viewPort.UpdateTransformation();
  ASSERT_FLOAT_EQ(viewPort.GetScaleX(), static_cast<float>(zoom)) << what;
  const GreyCanvas canvas;
  ShowIn(canvas, viewPort, view);
  int shown = 0;
  for (int y = 0; y < canvas.Height(); ++y) {
    for (int x = 0; x < canvas.Width(); ++x) {
      unsigned expected = kUntouched;
      if (x >= left && x < left + width && y >= top && y < top + height) {
        const int column = panX + (x - left) / zoom - position.x;
        const int row = panY + (y - top) / zoom - position.y;
        if (column >= 0 && column < 20 && row >= 0 && row < 12) {
          expected = PixelOf(image, column, row);
          ++shown;
        }
      }
      ASSERT_EQ(canvas.At(x, y), expected) << what << " at " << x << ", " << y;
    }
  }
  EXPECT_GT(shown, 0) << what;
}

TEST(VGBitmapViewDraw, ViewportZoomsPansAndClips) {
  for (const int zoom : {1, 2, 3, 4, 6}) {
    for (const int pan : {-4, 0, 3, 8}) {
      ExpectShown(zoom, pan, pan - 1, 0, {0, 0});
      ExpectShown(zoom, pan, 1, 2, {0, 0});
    }
  }
}

TEST(VGBitmapViewDraw, PositionOfTheImageIsItsPlace) {
  ExpectShown(1, 0, 0, 0, {7, 4});
  ExpectShown(2, 101, 203, 0, {100, 200});
  ExpectShown(3, -18, -10, 0, {-20, -13});
}

TEST(VGBitmapViewDraw, BaseRectangleStretchesTheImage) {
  dImage image = ColourImage(10, 6);
  VGBitmapView view;
  view.Init(&image, 10, 6, 40, 12);
  OpenViewPort viewPort = Shown(Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48));
  const GreyCanvas canvas;
  ShowIn(canvas, viewPort, view);
  for (int y = 0; y < canvas.Height(); ++y) {
    for (int x = 0; x < canvas.Width(); ++x) {
      const bool isInside = x >= 10 && x < 40 && y >= 6 && y < 12;
      ASSERT_EQ(canvas.At(x, y), isInside ? PixelOf(image, (x - 10) / 3, y - 6) : kUntouched);
    }
  }
}

struct SizeCase {
  const char* name;
  Rect2D base;
  tagRECT target;
};

class VGBitmapViewTarget : public ::testing::TestWithParam<SizeCase> {};

TEST_P(VGBitmapViewTarget, SizesAreRoundedAndAddedToTheTruncatedCorner) {
  const SizeCase& size = GetParam();
  dImage image = ColourImage(8, 8);
  VGBitmapView view;
  view.Init(&image, size.base.GetTL(), size.base.GetBR());
  const Stretched expected(image, {0, 0, 8, 8}, size.target);
  const GreyCanvas plain;
  view.DrawGraphic(plain);
  ExpectEqual(plain, expected, "without a viewport");
  OpenViewPort viewPort = Shown(Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48));
  const GreyCanvas canvas;
  ShowIn(canvas, viewPort, view);
  ExpectEqual(canvas, expected, "with a viewport");
}

INSTANTIATE_TEST_SUITE_P(
    All, VGBitmapViewTarget,
    ::testing::Values(SizeCase{"RoundedUp", Rect2D(2.25F, 3.25F, 5.875F, 9.75F), {2, 3, 6, 10}},
                      SizeCase{"RoundedDown", Rect2D(2.75F, 3.875F, 6.125F, 8.25F), {2, 3, 5, 7}},
                      SizeCase{"HalfRoundsUp", Rect2D(10, 10, 14.5F, 12.5F), {10, 10, 15, 13}},
                      SizeCase{"BelowHalf", Rect2D(10, 10, 14.375F, 12.375F), {10, 10, 14, 12}},
                      SizeCase{"Swapped", Rect2D(14.75F, 12.75F, 10.5F, 10), {10, 10, 14, 13}}),
    [](const auto& instance) { return instance.param.name; });

// The window begins and ends within pixels.
TEST(VGBitmapViewDraw, SourceIsRoundedLikeTheTarget) {
  dImage image = ColourImage();
  VGBitmapView view;
  view.Init(&image);
  OpenViewPort viewPort =
      Shown(Rect2D(0, 0, 20, 12), Rect2D(1.5F, 2.75F, 6, 6), Rect2D(8, 4, 26, 17));
  const GreyCanvas canvas;
  ShowIn(canvas, viewPort, view);
  // 4.5 x 3.25 pixels on 18 x 13
  const Stretched expected(image, {1, 2, 6, 5}, {8, 4, 26, 17});
  ExpectEqual(canvas, expected, "zoom 4");
}

TEST(VGBitmapViewDraw, NothingIsDrawnOutsideTheDrawWindow) {
  dImage image = ColourImage();
  VGBitmapView view;
  view.Init(&image, 200, 200, 220, 212);
  OpenViewPort viewPort = Shown(Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48));
  const GreyCanvas canvas;
  ShowIn(canvas, viewPort, view);
  ExpectEqual(canvas, GreyCanvas(), "apart");
  // By its own clipping, not by that of the device.
  view.Init(&image, 0, 0, 20, 12);
  viewPort.SetViewWin(Rect2D(0, 0, 5, 5), false);
  view.DrawGraphic(canvas, viewPort);
  const Stretched expected(image, {0, 0, 5, 5}, {0, 0, 5, 5});
  ExpectEqual(canvas, expected, "cut");
}

TEST(VGBitmapViewDraw, TooSmallForAPixelDrawsNothing) {
  dImage image = ColourImage();
  VGBitmapView view;
  view.Init(&image, 10, 10, 10.25F, 10.25F);
  const GreyCanvas canvas;
  view.DrawGraphic(canvas);
  ExpectEqual(canvas, GreyCanvas(), "a quarter of a pixel");
}

TEST(VGBitmapViewDraw, WithoutAnImageTheBackgroundShows) {
  OpenViewPort viewPort = Shown(Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48));
  viewPort.SetBgColor(0x302010);
  VGBitmapView view;
  EXPECT_TRUE(view.Init(nullptr, 10, 10, 14.5F, 12));
  const GreyCanvas canvas;
  ShowIn(canvas, viewPort, view);
  const GreyCanvas plain;
  view.DrawGraphic(plain);
  for (int y = 0; y < canvas.Height(); ++y) {
    for (int x = 0; x < canvas.Width(); ++x) {
      const bool isInside = x >= 10 && x < 15 && y >= 10 && y < 12;
      ASSERT_EQ(canvas.At(x, y), isInside ? 0x302010u : kUntouched);
      ASSERT_EQ(plain.At(x, y), isInside ? 0u : kUntouched);
    }
  }
}

TEST(VGBitmapViewDraw, ImageThatCannotBeDrawnIsBackground) {
  dImage words;
  ASSERT_TRUE(words.Init(4, 4, ImageDataType_U16, "G", ImageDataOrder_Pixel, 4));
  VGBitmapView view;
  EXPECT_FALSE(view.Init(&words));
  const GreyCanvas canvas;
  view.DrawGraphic(canvas);
  EXPECT_EQ(canvas.At(3, 3), 0u);
  EXPECT_EQ(canvas.At(4, 3), kUntouched);
}

TEST(VGBitmapViewDraw, NothingHappensWithoutADevice) {
  dImage image = ColourImage();
  VGBitmapView view;
  view.Init(&image);
  GraphicViewPort viewPort;
  view.DrawGraphic(nullptr);
  view.DrawGraphic(nullptr, viewPort);
  EXPECT_TRUE(view.GetStatus().IsOK());
}

TEST(VGBitmapViewDraw, TransparencyGoesToTheRenderer) {
  dImage image = ColourImage();
  VGBitmapView view;
  view.Init(&image);
  const auto drawn = [&view](int x, int y) {
    const GreyCanvas canvas;
    view.DrawGraphic(canvas);
    return canvas.At(x, y);
  };
  const unsigned colour = PixelOf(image, 3, 2);
  view.EnableTransparency(static_cast<unsigned long>(colour));
  EXPECT_EQ(drawn(3, 2), kUntouched);
  EXPECT_EQ(drawn(4, 2), PixelOf(image, 4, 2));
  view.EnableTransparency(4, 2);
  EXPECT_EQ(drawn(3, 2), colour);
  EXPECT_EQ(drawn(4, 2), kUntouched);
  view.Init(&image);
  EXPECT_EQ(drawn(4, 2), kUntouched) << "it stays";
  view.DisableTransparency();
  EXPECT_EQ(drawn(4, 2), PixelOf(image, 4, 2));
}

TEST(VGBitmapViewDraw, PaletteIsDrawnWith) {
  dImage image = NumberedImage(8, 4, ImageDataType_U8, "G");
  VGBitmapView view;
  view.Init(&image);
  const GreyCanvas ascending;
  view.DrawGraphic(ascending);
  EXPECT_EQ(ascending.At(2, 1), 0x0B0B0Bu) << "1 + 2 + 8";
  EXPECT_TRUE(view.ResetPalette(false));
  const GreyCanvas descending;
  view.DrawGraphic(descending);
  EXPECT_EQ(descending.At(2, 1), 0xF4F4F4u);
}

TEST(VGBitmapViewDraw, SelectionIsADotAtEachHandle) {
  Canvas canvas(64, 64);
  canvas.Fill(0);
  Canvas expected(64, 64);
  expected.Fill(0);
  VGBitmapView view;
  view.Init(nullptr, 10.9F, 10, 35.9F, 41);
  view.SetPenColor(0x0000FF);
  view.DrawSelection(canvas);
  HPEN pen = CreatePen(PS_SOLID, 5, 0x0000FF);
  HGDIOBJ old = SelectObject(expected, pen);
  const int dots[][2] = {{10, 10}, {22, 10}, {35, 10}, {35, 25},
                         {35, 41}, {23, 41}, {10, 41}, {10, 26}};
  for (const auto& dot : dots) {
    MoveToEx(expected, dot[0], dot[1], nullptr);
    LineTo(expected, dot[0], dot[1]);
  }
  SelectObject(expected, old);
  DeleteObject(pen);
  EXPECT_EQ(Lit(canvas), Lit(expected));
  EXPECT_FALSE(Lit(canvas).empty());
  EXPECT_EQ(RopOf(canvas), R2_COPYPEN);
}

TEST(VGBitmapViewDraw, DegenerateNumbersDoNoHarm) {
  dImage image = ColourImage();
  VGBitmapView view;
  const GreyCanvas canvas;
  OpenViewPort viewPort = Shown(Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48), Rect2D(0, 0, 64, 48));
  const float nan = std::nanf("");
  for (const Rect2D& base : {Rect2D(-1e30F, -1e30F, 1e30F, 1e30F), Rect2D(nan, 0, 5, nan),
                             Rect2D(0, 0, 1e-30F, 1e-30F), Rect2D(1e30F, 1e30F, -1e30F, -1e30F)}) {
    view.Init(&image, base.GetTL(), base.GetBR());
    view.Select(true);
    ShowIn(canvas, viewPort, view);
  }
  EXPECT_EQ(RopOf(canvas), R2_COPYPEN);
}

}  // namespace
