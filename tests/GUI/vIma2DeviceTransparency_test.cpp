// Pictures of images with a colour left out.
#include <vorl/GUI/vIma2Device.h>

#include <gtest/gtest.h>

#include <string>

#include "Canvas.h"

namespace {

constexpr unsigned kBackground = 0x555555;

/// An image of two colours in a pattern of its own, and a third one.
dImage Pattern(const char* sequence) {
  dImage image = NumberedImage(6, 4, 8, sequence);
  const int channels = image.GetNumChannels();
  for (int y = 0; y < 4; ++y) {
    auto* row = static_cast<unsigned char*>(image.GetRowPtr(y));
    for (int x = 0; x < 6; ++x) {
      if ((x * 5 + y * 3) % 4 == 1) {
        for (int channel = 0; channel < channels; ++channel) {
          row[x * channels + channel] = channel == 3 ? 0 : static_cast<unsigned char>(0xE0);
        }
      }
    }
  }
  return image;
}

class vIma2DeviceTransparency : public testing::TestWithParam<const char*> {};

void ExpectPicture(const Canvas& canvas, const dImage& image, const tagRECT& source, int factor,
                   bool flip, unsigned transparent) {
  const int width = (source.right - source.left) * factor;
  const int height = (source.bottom - source.top) * factor;
  for (int y = 0; y < canvas.Height(); ++y) {
    for (int x = 0; x < canvas.Width(); ++x) {
      unsigned expected = kBackground;
      if (x >= 1 && x < 1 + width && y >= 2 && y < 2 + height) {
        const int row = flip ? height - 1 - (y - 2) : y - 2;
        const unsigned colour =
            PixelOf(image, source.left + (x - 1) / factor, source.top + row / factor);
        expected = colour != transparent ? colour : kBackground;
      }
      ASSERT_EQ(canvas.At(x, y), expected) << x << ", " << y;
    }
  }
}

TEST_P(vIma2DeviceTransparency, PixelsOfTheColourAreLeftOut) {
  for (const short channels : {short{3}, short{4}}) {
    for (const tagRECT& source : {tagRECT{0, 0, 6, 4}, tagRECT{1, 0, 5, 3}, tagRECT{2, 2, 6, 3}}) {
      for (const int factor : {1, 2}) {
        for (const bool flip : {false, true}) {
          dImage image = Pattern(GetParam());
          Canvas canvas(16, 12, channels);
          canvas.Fill(0x55);
          const tagRECT target{1, 2, 1 + factor * (source.right - source.left),
                               2 + factor * (source.bottom - source.top)};
          vIma2Device renderer;
          ASSERT_TRUE(renderer.Init(&image, &source, &target, false, flip));
          renderer.EnableTransparency(0xE0E0E0UL);
          SCOPED_TRACE(RectText(source) + (flip ? " flipped " : " ") + std::to_string(factor));
          ASSERT_TRUE(renderer.Draw(canvas));
          ExpectPicture(canvas, image, source, factor, flip, 0xE0E0E0);
          canvas.Fill(0x55);
          ASSERT_TRUE(renderer.Draw(canvas));  // with the mask that is there
          ExpectPicture(canvas, image, source, factor, flip, 0xE0E0E0);
        }
      }
    }
  }
}

TEST_P(vIma2DeviceTransparency, ColourCanBeThatOfAPixel) {
  dImage image = Pattern(GetParam());
  vIma2Device renderer;
  const tagRECT target{1, 2, 7, 6};
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  for (const auto& [x, y] : {std::pair{1, 0}, {0, 0}, {5, 3}}) {
    Canvas canvas(10, 8);
    canvas.Fill(0x55);
    renderer.EnableTransparency(x, y);
    ASSERT_TRUE(renderer.Draw(canvas));
    ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, PixelOf(image, x, y));
  }
}

TEST_P(vIma2DeviceTransparency, PixelOutsideTheImageStandsForBlack) {
  dImage image = Pattern(GetParam());
  for (int channel = 0; channel < image.GetNumChannels(); ++channel) {
    *static_cast<unsigned char*>(image.GetDataPtr(3, 2, channel)) = 0;
  }
  const tagRECT target{1, 2, 7, 6};
  for (const auto& [x, y] : {std::pair{-1, 0}, {0, 4}, {99, 99}}) {
    vIma2Device renderer;
    ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
    Canvas canvas(10, 8);
    canvas.Fill(0x55);
    renderer.EnableTransparency(x, y);
    ASSERT_TRUE(renderer.Draw(canvas));
    ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, 0);
  }
}

INSTANTIATE_TEST_SUITE_P(All, vIma2DeviceTransparency, testing::Values("G", "BGR", "BGRA"),
                         [](const auto& test) { return std::string(test.param); });

class OpenRenderer : public vIma2Device {
 public:
  using vIma2Device::CreateMask;
  using vIma2Device::DrawTransparent;
  using vIma2Device::ResetTransparency;
};

TEST(vIma2DeviceTransparent, OneBitImageCanBeAStencil) {
  dImage image = NumberedImage(6, 4, 1, "G");
  const tagRECT target{1, 2, 7, 6};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  for (const unsigned colour : {0U, 0xFFFFFFU}) {
    Canvas canvas(10, 8);
    canvas.Fill(0x55);
    renderer.EnableTransparency(static_cast<unsigned long>(colour));
    ASSERT_TRUE(renderer.Draw(canvas));
    ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, colour);
  }
}

TEST(vIma2DeviceTransparent, CanBeSwitchedOff) {
  dImage image = Pattern("BGR");
  const tagRECT target{1, 2, 7, 6};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  renderer.EnableTransparency(0xE0E0E0UL);
  renderer.DisableTransparency();
  Canvas canvas(10, 8);
  canvas.Fill(0x55);
  ASSERT_TRUE(renderer.Draw(canvas));
  ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, 0xFF000000);
}

TEST(vIma2DeviceTransparent, SettingOutlivesTheImage) {
  dImage first = NumberedImage(3, 3, 8, "BGR");
  dImage image = Pattern("BGR");
  const tagRECT target{1, 2, 7, 6};
  vIma2Device renderer;
  renderer.EnableTransparency(0xE0E0E0UL);
  Canvas canvas(10, 8);
  ASSERT_TRUE(renderer.Init(&first, nullptr, &target, false, false));
  ASSERT_TRUE(renderer.Draw(canvas));
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  canvas.Fill(0x55);
  ASSERT_TRUE(renderer.Draw(canvas));
  ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, 0xE0E0E0);
}

TEST(vIma2DeviceTransparent, PixelOutlivesTheImageToo) {
  dImage first = NumberedImage(6, 4, 8, "BGR");
  dImage image = Pattern("BGR");
  const tagRECT target{1, 2, 7, 6};
  vIma2Device renderer;
  renderer.EnableTransparency(1, 0);  // of the pattern's second colour
  Canvas canvas(10, 8);
  ASSERT_TRUE(renderer.Init(&first, nullptr, &target, false, false));
  ASSERT_TRUE(renderer.Draw(canvas));
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  canvas.Fill(0x55);
  ASSERT_TRUE(renderer.Draw(canvas));
  ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, 0xE0E0E0);
}

TEST(vIma2DeviceTransparent, NewPixelsAreLookedAtWhenTheTransparencyIsSetAnew) {
  dImage image = Pattern("BGR");
  const tagRECT target{1, 2, 7, 6};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  Canvas canvas(10, 8);
  for (const unsigned colour : {0xE0E0E0U, PixelOf(image, 0, 0), PixelOf(image, 5, 3)}) {
    renderer.EnableTransparency(static_cast<unsigned long>(colour));
    canvas.Fill(0x55);
    ASSERT_TRUE(renderer.Draw(canvas));
    ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, colour);
  }
}

TEST(vIma2DeviceTransparent, BitmapsAreMadeOnceForAnImage) {
  dImage image = Pattern("BGR");
  const dImage before(image);
  const tagRECT target{1, 2, 7, 6};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  renderer.EnableTransparency(0xE0E0E0UL);
  Canvas canvas(10, 8);
  canvas.Fill(0x55);
  ASSERT_TRUE(renderer.Draw(canvas));
  image.Fill(0x11);
  canvas.Fill(0x55);
  ASSERT_TRUE(renderer.Draw(canvas));  // what the image was
  ExpectPicture(canvas, before, *renderer.GetImageRect(), 1, false, 0xE0E0E0);
  image = Pattern("G");  // formatted anew: what it is
  canvas.Fill(0x55);
  ASSERT_TRUE(renderer.Draw(canvas));
  ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, 0xE0E0E0);
}

TEST(vIma2DeviceTransparent, CopyLooksAtTheSamePixel) {
  dImage image = Pattern("BGR");
  const tagRECT source{0, 0, 6, 3};
  const tagRECT target{1, 2, 7, 5};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, &source, &target, false, true));
  renderer.EnableTransparency(5, 2);
  const vIma2Device first(renderer);
  vIma2Device copy(first);
  Canvas canvas(10, 8);
  Canvas other(10, 8);
  ASSERT_TRUE(renderer.Draw(canvas));
  ASSERT_TRUE(copy.Draw(other));
  for (int y = 0; y < 8; ++y) {
    for (int x = 0; x < 10; ++x) {
      EXPECT_EQ(other.At(x, y), canvas.At(x, y)) << x << ", " << y;
    }
  }
}

TEST(vIma2DeviceTransparent, ModeForgetsTheSettingOfTheOther) {
  dImage image = Pattern("G");
  *static_cast<unsigned char*>(image.GetDataPtr(3, 2)) = 0;
  const tagRECT target{1, 2, 7, 6};
  OpenRenderer renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  const auto draw = [&](unsigned transparent) {
    Canvas canvas(10, 8);
    canvas.Fill(0x55);
    ASSERT_TRUE(renderer.Draw(canvas));
    ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, transparent);
  };
  renderer.EnableTransparency(0xE0E0E0UL);
  renderer.ResetTransparency(Transparency_Color);  // keeps the colour
  draw(0xE0E0E0);
  renderer.ResetTransparency(Transparency_None);
  renderer.ResetTransparency(Transparency_Color);  // black
  draw(0);
  renderer.EnableTransparency(5, 3);
  renderer.ResetTransparency(Transparency_Pixel);  // keeps the position
  draw(PixelOf(image, 5, 3));
  renderer.ResetTransparency(Transparency_Color);  // keeps the colour that was found
  draw(PixelOf(image, 5, 3));
  renderer.ResetTransparency(Transparency_Pixel);  // the first pixel
  draw(PixelOf(image, 0, 0));
}

TEST(vIma2DeviceTransparent, StretchModeIsTheCallers) {
  dImage image = Pattern("BGR");
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, false));
  Canvas canvas(10, 8);
  SetStretchBltMode(canvas, WHITEONBLACK);
  renderer.EnableTransparency(0xE0E0E0UL);
  ASSERT_TRUE(renderer.Draw(canvas));
  EXPECT_EQ(SetStretchBltMode(canvas, WHITEONBLACK), WHITEONBLACK);
  renderer.DisableTransparency();
  ASSERT_TRUE(renderer.Draw(canvas));
  EXPECT_EQ(SetStretchBltMode(canvas, WHITEONBLACK), COLORONCOLOR);
}

TEST(vIma2DeviceTransparent, DevicesColoursAreRestored) {
  dImage image = Pattern("BGR");
  const tagRECT target{1, 2, 7, 6};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  renderer.EnableTransparency(0xE0E0E0UL);
  Canvas canvas(10, 8);
  canvas.Fill(0x55);
  SetBkColor(canvas, 0x112233);
  SetTextColor(canvas, 0x445566);
  ASSERT_TRUE(renderer.Draw(canvas));
  EXPECT_EQ(SetBkColor(canvas, 0), 0x112233U);
  EXPECT_EQ(SetTextColor(canvas, 0), 0x445566U);
  ExpectPicture(canvas, image, *renderer.GetImageRect(), 1, false, 0xE0E0E0);
}

TEST(vIma2DeviceTransparent, NothingIsDrawnWithoutAnImage) {
  OpenRenderer renderer;
  Canvas canvas(4, 4);
  renderer.EnableTransparency(0UL);
  EXPECT_FALSE(renderer.Draw(canvas));
  EXPECT_FALSE(renderer.CreateMask(canvas));
  SetBkColor(canvas, 0x112233);
  EXPECT_FALSE(renderer.DrawTransparent(canvas));
  EXPECT_EQ(SetBkColor(canvas, 0), 0x112233U);
}

}  // namespace
