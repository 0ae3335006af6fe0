// Pictures of opaque images, pixel for pixel: whole multiples of the source, so that every target
// pixel belongs to one source pixel.
#include <vorl/GUI/vIma2Device.h>

#include <gtest/gtest.h>

#include <string>

#include "Canvas.h"

namespace {

struct Layout {
  const char* name;
  unsigned short type;
  const char* sequence;
  unsigned short alignment;
};

class vIma2DeviceDraw : public testing::TestWithParam<Layout> {
 protected:
  static dImage Image(int width, int height) {
    return NumberedImage(width, height, GetParam().type, GetParam().sequence, GetParam().alignment);
  }
};

constexpr unsigned kUntouched = 0x555555;

/// Compares the picture of the source rectangle, each pixel `factor` times as wide and high, its
/// first pixel at (left, top).
void ExpectPicture(const Canvas& canvas, const dImage& image, const tagRECT& source, int left,
                   int top, int factor, bool flip) {
  const int width = (source.right - source.left) * factor;
  const int height = (source.bottom - source.top) * factor;
  for (int y = 0; y < canvas.Height(); ++y) {
    for (int x = 0; x < canvas.Width(); ++x) {
      const int column = x - left;
      const int row = flip ? height - 1 - (y - top) : y - top;
      const bool isInside = column >= 0 && column < width && row >= 0 && row < height;
      const unsigned expected =
          isInside ? PixelOf(image, source.left + column / factor, source.top + row / factor)
                   : kUntouched;
      ASSERT_EQ(canvas.At(x, y), expected) << x << ", " << y;
    }
  }
}

TEST_P(vIma2DeviceDraw, WholeImageIsUprightAndExact) {
  for (const short channels : {short{3}, short{4}}) {
    for (const int factor : {1, 2, 3}) {
      for (const bool flip : {false, true}) {
        dImage image = Image(7, 5);
        Canvas canvas(30, 20, channels);
        canvas.Fill(0x55);
        const tagRECT target{2, 3, 2 + 7 * factor, 3 + 5 * factor};
        vIma2Device renderer;
        ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, flip));
        ASSERT_TRUE(renderer.Draw(canvas));
        SCOPED_TRACE("factor " + std::to_string(factor) + (flip ? ", flipped" : ""));
        ExpectPicture(canvas, image, {0, 0, 7, 5}, 2, 3, factor, flip);
      }
    }
  }
}

TEST_P(vIma2DeviceDraw, PartOfTheImageIsDrawnAlone) {
  dImage image = Image(9, 8);
  for (const tagRECT& source : {tagRECT{2, 1, 7, 4}, tagRECT{0, 5, 9, 8}, tagRECT{8, 7, 9, 8}}) {
    for (const int factor : {1, 2}) {
      for (const bool flip : {false, true}) {
        Canvas canvas(22, 18);
        canvas.Fill(0x55);
        const tagRECT target{1, 2, 1 + factor * (source.right - source.left),
                             2 + factor * (source.bottom - source.top)};
        vIma2Device renderer;
        ASSERT_TRUE(renderer.Init(&image, &source, &target, false, flip));
        ASSERT_TRUE(renderer.Draw(canvas));
        SCOPED_TRACE(RectText(source) + " times " + std::to_string(factor) +
                     (flip ? ", flipped" : ""));
        ExpectPicture(canvas, image, source, 1, 2, factor, flip);
      }
    }
  }
}

TEST_P(vIma2DeviceDraw, TargetBeyondTheDeviceIsCutOff) {
  dImage image = Image(7, 5);
  Canvas canvas(9, 6);
  canvas.Fill(0x55);
  const tagRECT target{-3, -4, 11, 6};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  ASSERT_TRUE(renderer.Draw(canvas));
  ExpectPicture(canvas, image, {0, 0, 7, 5}, -3, -4, 2, false);
}

INSTANTIATE_TEST_SUITE_P(All, vIma2DeviceDraw,
                         testing::Values(Layout{"OneBit", 1, "G", 4},
                                         Layout{"EightBits", 8, "G", 4},
                                         Layout{"EightBitsInWideRows", 8, "G", 32},
                                         Layout{"ThreeChannels", 8, "BGR", 4},
                                         Layout{"ThreeChannelsInWideRows", 8, "BGR", 32},
                                         Layout{"FourChannels", 8, "BGRA", 4}),
                         [](const auto& test) { return std::string(test.param.name); });

TEST(vIma2DeviceDrawing, TargetWithSwappedSidesMirrors) {
  dImage image = NumberedImage(4, 2, 8, "BGR");
  Canvas canvas(10, 4);
  canvas.Fill(0x55);
  const tagRECT target{6, 1, 2, 3};  // runs to the left from column 6
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  ASSERT_TRUE(renderer.Draw(canvas));
  for (int y = 0; y < 2; ++y) {
    for (int x = 0; x < 4; ++x) {
      EXPECT_EQ(canvas.At(6 - x, 1 + y), PixelOf(image, x, y)) << x << ", " << y;
    }
    EXPECT_EQ(canvas.At(2, 1 + y), kUntouched);
    EXPECT_EQ(canvas.At(7, 1 + y), kUntouched);
  }
}

TEST(vIma2DeviceDrawing, PixelsAreLeftOutWhenTheTargetIsSmaller) {
  dImage image = NumberedImage(8, 8, 8, "BGR");
  Canvas canvas(4, 4);
  vIma2Device renderer;
  const tagRECT target{0, 0, 4, 4};
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  ASSERT_TRUE(renderer.Draw(canvas));
  for (int y = 0; y < 4; ++y) {
    for (int x = 0; x < 4; ++x) {
      bool isOneOfTheFour = false;
      for (int k = 0; k < 4; ++k) {
        isOneOfTheFour |= canvas.At(x, y) == PixelOf(image, 2 * x + k % 2, 2 * y + k / 2);
      }
      EXPECT_TRUE(isOneOfTheFour) << x << ", " << y;
    }
  }
}

TEST(vIma2DeviceDrawing, GreyImageIsDrawnThroughItsPalette) {
  dImage image = NumberedImage(4, 1, 8, "G");
  Canvas canvas(4, 1);
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, false));
  EXPECT_EQ(renderer.GetPaletteSize(), 256);
  ASSERT_TRUE(renderer.ResetPalette(false));
  renderer.GetPalette()[2] = {1, 2, 3, 0};
  ASSERT_TRUE(renderer.Draw(canvas));
  EXPECT_EQ(canvas.At(0, 0), 0xFEFEFEU);
  EXPECT_EQ(canvas.At(1, 0), 0x010203U);
  EXPECT_EQ(canvas.At(2, 0), 0xFCFCFCU);
}

TEST(vIma2DeviceDrawing, DeviceThatIsNoneFails) {
  dImage image = NumberedImage(4, 1, 8, "G");
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, false));
  EXPECT_FALSE(renderer.Draw(nullptr));
  renderer.EnableTransparency(0xFFFFFFUL);
  EXPECT_FALSE(renderer.Draw(nullptr));
}

}  // namespace
