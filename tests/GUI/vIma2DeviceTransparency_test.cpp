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

/// An image in its own size on a device with some pixels around it.
class vIma2DeviceTransparent : public testing::Test {
 protected:
  /// Draws; every pixel is the image's, or the device's where the image has the colour.
  void ExpectDrawn(const dImage& drawn, unsigned transparent) {
    m_canvas.Fill(0x55);
    ASSERT_TRUE(m_renderer.Draw(m_canvas));
    ExpectPicture(m_canvas, drawn, *m_renderer.GetImageRect(), 1, false, transparent);
  }
  void ExpectDrawn(unsigned transparent) { ExpectDrawn(m_image, transparent); }
  void Take(dImage& image) {
    ASSERT_TRUE(m_renderer.Init(&image, nullptr, &m_target, false, false));
  }

  dImage m_image = Pattern("BGR");
  const tagRECT m_target{1, 2, 7, 6};
  OpenRenderer m_renderer;
  Canvas m_canvas{10, 8};
};

TEST_F(vIma2DeviceTransparent, OneBitImageCanBeAStencil) {
  m_image = NumberedImage(6, 4, 1, "G");
  Take(m_image);
  for (const unsigned colour : {0U, 0xFFFFFFU}) {
    m_renderer.EnableTransparency(static_cast<unsigned long>(colour));
    ExpectDrawn(colour);
  }
}

TEST_F(vIma2DeviceTransparent, CanBeSwitchedOff) {
  Take(m_image);
  m_renderer.EnableTransparency(0xE0E0E0UL);
  m_renderer.DisableTransparency();
  ExpectDrawn(0xFF000000);
}

TEST_F(vIma2DeviceTransparent, SettingOutlivesTheImage) {
  dImage first = NumberedImage(3, 3, 8, "BGR");
  m_renderer.EnableTransparency(0xE0E0E0UL);
  Take(first);
  ASSERT_TRUE(m_renderer.Draw(m_canvas));
  Take(m_image);
  ExpectDrawn(0xE0E0E0);
}

TEST_F(vIma2DeviceTransparent, PixelOutlivesTheImageToo) {
  dImage first = NumberedImage(6, 4, 8, "BGR");
  m_renderer.EnableTransparency(1, 0);  // of the pattern's second colour
  Take(first);
  ASSERT_TRUE(m_renderer.Draw(m_canvas));
  Take(m_image);
  ExpectDrawn(0xE0E0E0);
}

TEST_F(vIma2DeviceTransparent, NewPixelsAreLookedAtWhenTheTransparencyIsSetAnew) {
  Take(m_image);
  for (const unsigned colour : {0xE0E0E0U, PixelOf(m_image, 0, 0), PixelOf(m_image, 5, 3)}) {
    m_renderer.EnableTransparency(static_cast<unsigned long>(colour));
    ExpectDrawn(colour);
  }
}

TEST_F(vIma2DeviceTransparent, BitmapsAreMadeOnceForAnImage) {
  const dImage before(m_image);
  Take(m_image);
  m_renderer.EnableTransparency(0xE0E0E0UL);
  ASSERT_TRUE(m_renderer.Draw(m_canvas));
  m_image.Fill(0x11);
  ExpectDrawn(before, 0xE0E0E0);  // what the image was
  m_image = Pattern("G");
  ExpectDrawn(0xE0E0E0);  // formatted anew: what it is
}

TEST_F(vIma2DeviceTransparent, CopyLooksAtTheSamePixel) {
  const tagRECT source{0, 0, 6, 3};
  const tagRECT target{1, 2, 7, 5};
  ASSERT_TRUE(m_renderer.Init(&m_image, &source, &target, false, true));
  m_renderer.EnableTransparency(5, 2);
  const vIma2Device first(m_renderer);
  vIma2Device copy(first);
  Canvas other(10, 8);
  ASSERT_TRUE(m_renderer.Draw(m_canvas));
  ASSERT_TRUE(copy.Draw(other));
  for (int y = 0; y < 8; ++y) {
    for (int x = 0; x < 10; ++x) {
      EXPECT_EQ(other.At(x, y), m_canvas.At(x, y)) << x << ", " << y;
    }
  }
}

TEST_F(vIma2DeviceTransparent, ModeForgetsTheSettingOfTheOther) {
  m_image = Pattern("G");
  *static_cast<unsigned char*>(m_image.GetDataPtr(3, 2)) = 0;
  Take(m_image);
  m_renderer.EnableTransparency(0xE0E0E0UL);
  m_renderer.ResetTransparency(Transparency_Color);  // keeps the colour
  ExpectDrawn(0xE0E0E0);
  m_renderer.ResetTransparency(Transparency_None);
  m_renderer.ResetTransparency(Transparency_Color);  // black
  ExpectDrawn(0);
  m_renderer.EnableTransparency(5, 3);
  m_renderer.ResetTransparency(Transparency_Pixel);  // keeps the position
  ExpectDrawn(PixelOf(m_image, 5, 3));
  m_renderer.ResetTransparency(Transparency_Color);  // keeps the colour that was found
  ExpectDrawn(PixelOf(m_image, 5, 3));
  m_renderer.ResetTransparency(Transparency_Pixel);  // the first pixel
  ExpectDrawn(PixelOf(m_image, 0, 0));
}

TEST_F(vIma2DeviceTransparent, StretchModeIsTheCallers) {
  ASSERT_TRUE(m_renderer.Init(&m_image, nullptr, nullptr, false, false));
  SetStretchBltMode(m_canvas, WHITEONBLACK);
  m_renderer.EnableTransparency(0xE0E0E0UL);
  ASSERT_TRUE(m_renderer.Draw(m_canvas));
  EXPECT_EQ(SetStretchBltMode(m_canvas, WHITEONBLACK), WHITEONBLACK);
  m_renderer.DisableTransparency();
  ASSERT_TRUE(m_renderer.Draw(m_canvas));
  EXPECT_EQ(SetStretchBltMode(m_canvas, WHITEONBLACK), COLORONCOLOR);
}

TEST_F(vIma2DeviceTransparent, DevicesColoursAreRestored) {
  Take(m_image);
  m_renderer.EnableTransparency(0xE0E0E0UL);
  SetBkColor(m_canvas, 0x112233);
  SetTextColor(m_canvas, 0x445566);
  ExpectDrawn(0xE0E0E0);
  EXPECT_EQ(SetBkColor(m_canvas, 0), 0x112233U);
  EXPECT_EQ(SetTextColor(m_canvas, 0), 0x445566U);
}

TEST_F(vIma2DeviceTransparent, NothingIsDrawnWithoutAnImage) {
  m_renderer.EnableTransparency(0UL);
  EXPECT_FALSE(m_renderer.Draw(m_canvas));
  EXPECT_FALSE(m_renderer.CreateMask(m_canvas));
  SetBkColor(m_canvas, 0x112233);
  EXPECT_FALSE(m_renderer.DrawTransparent(m_canvas));
  EXPECT_EQ(SetBkColor(m_canvas, 0), 0x112233U);
}

}  // namespace
