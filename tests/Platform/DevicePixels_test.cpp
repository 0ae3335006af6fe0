// What drawing does to pixels, against slow models; what the stored scenes cannot show, because the
// program that made them departs from the published behaviour.

#include "DeviceTesting.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <vector>

namespace {

std::vector<std::uint32_t> Fill(TestSection& section, std::uint32_t seed) {
  std::mt19937 random(seed);
  std::vector<std::uint32_t> pixels;
  for (int y = 0; y < std::abs(section.info.header.biHeight); ++y) {
    for (int x = 0; x < section.info.header.biWidth; ++x) {
      pixels.push_back(static_cast<std::uint32_t>(random()));
      section.Set(x, y, pixels.back());
    }
  }
  return pixels;
}

TEST(DevicePixels, OutsideIsNoColour) {
  TestSection s(4, -4, 32);
  EXPECT_EQ(SetPixel(s.dc, 3, 3, RGB(1, 2, 3)), RGB(1, 2, 3));
  EXPECT_EQ(SetPixel(s.dc, 4, 0, 0), CLR_INVALID);
  EXPECT_EQ(SetPixel(s.dc, 0, -1, 0), CLR_INVALID);
  EXPECT_EQ(GetPixel(s.dc, 0, 4), CLR_INVALID);
  IntersectClipRect(s.dc, 0, 0, 3, 3);
  EXPECT_EQ(SetPixel(s.dc, 3, 3, 0), CLR_INVALID);
  EXPECT_EQ(GetPixel(s.dc, 3, 3), CLR_INVALID);
  EXPECT_EQ(s.At(3, 3), 0x010203U);
}

// Each bit of the index is the result for one combination of pattern, source and destination.
TEST(DevicePixels, All256OperationsFollowTheirTruthTable) {
  const std::uint32_t pattern = 0x00563412;
  HBRUSH brush = CreateSolidBrush(RGB(0x56, 0x34, 0x12));
  for (unsigned index = 0; index < 256; ++index) {
    TestSection a(8, -2, 32);
    TestSection p(8, -2, 32);
    const auto source = Fill(a, index);
    const auto before = Fill(p, index + 1000);
    HGDIOBJ old = SelectObject(p.dc, brush);
    ASSERT_TRUE(BitBlt(p.dc, 0, 0, 8, 2, a.dc, 0, 0, index << 16U));
    SelectObject(p.dc, old);
    for (std::size_t i = 0; i < source.size(); ++i) {
      std::uint32_t expected = 0;
      for (unsigned bit = 0; bit < 32; ++bit) {
        const unsigned row =
            (pattern >> bit & 1U) << 2U | (source[i] >> bit & 1U) << 1U | (before[i] >> bit & 1U);
        expected |= (index >> row & 1U) << bit;
      }
      ASSERT_EQ(p.At(static_cast<int>(i % 8), static_cast<int>(i / 8)), expected) << index;
    }
  }
  DeleteObject(brush);
}

TEST(DevicePixels, TrueColoursBecomeTheNearestOfATable) {
  std::mt19937 random(7);
  TestSection a(64, -4, 32);
  const auto source = Fill(a, 8);
  TestSection p(64, -4, 8);
  TestInfo info(64, -4, 8);
  for (RGBQUAD& c : info.colours) {
    c = RGBQUAD{static_cast<BYTE>(random()), static_cast<BYTE>(random()),
                static_cast<BYTE>(random()), 0};
  }
  void* memory = nullptr;
  HBITMAP bitmap = CreateDIBSection(nullptr, info.Get(), DIB_RGB_COLORS, &memory, nullptr, 0);
  HGDIOBJ old = SelectObject(p.dc, bitmap);
  ASSERT_TRUE(BitBlt(p.dc, 0, 0, 64, 4, a.dc, 0, 0, SRCCOPY));
  const auto* result = static_cast<const std::uint8_t*>(memory);
  for (std::size_t i = 0; i < source.size(); ++i) {
    const auto distance = [&](const RGBQUAD& c) {
      const int blue = static_cast<int>(source[i] & 255U) - c.rgbBlue;
      const int green = static_cast<int>(source[i] >> 8U & 255U) - c.rgbGreen;
      const int red = static_cast<int>(source[i] >> 16U & 255U) - c.rgbRed;
      return blue * blue + green * green + red * red;
    };
    const auto* nearest = std::min_element(std::begin(info.colours), std::end(info.colours),
                                           [&](const RGBQUAD& left, const RGBQUAD& right) {
                                             return distance(left) < distance(right);
                                           });
    ASSERT_EQ(result[i], nearest - info.colours) << i;
  }
  SelectObject(p.dc, old);
  DeleteObject(bitmap);
}

// Bits of a row, the first pixel in the highest bits.
unsigned Get(const std::uint8_t* row, int x, int bits) {
  return static_cast<unsigned>(row[x * bits / 8]) >> (8 - bits - x * bits % 8) &
         ((1U << bits) - 1U);
}

TEST(DevicePixels, MovesInsideSmallPixelsReadWhatWasThere) {
  for (const int bits : {1, 4}) {
    for (int dy = -2; dy <= 2; ++dy) {
      for (int dx = -9; dx <= 9; ++dx) {
        const TestSection s(60, -20, bits);
        std::mt19937 random(static_cast<unsigned>(bits * 1000 + dy * 50 + dx + 500));
        std::generate_n(s.pixels, s.Bytes(), [&] { return static_cast<std::uint8_t>(random()); });
        const std::vector<std::uint8_t> before(s.pixels, s.pixels + s.Bytes());
        ASSERT_TRUE(BitBlt(s.dc, 10 + dx, 4 + dy, 37, 11, s.dc, 10, 4, SRCCOPY));
        for (int y = 0; y < 20; ++y) {
          for (int x = 0; x < 60; ++x) {
            const bool moved = x >= 10 + dx && x < 47 + dx && y >= 4 + dy && y < 15 + dy;
            const int fromX = moved ? x - dx : x;
            const int fromY = moved ? y - dy : y;
            const std::size_t row = s.RowBytes();
            ASSERT_EQ(Get(s.pixels + row * static_cast<std::size_t>(y), x, bits),
                      Get(before.data() + row * static_cast<std::size_t>(fromY), fromX, bits))
                << bits << " bits, move " << dx << ", " << dy << " at " << x << ", " << y;
          }
        }
      }
    }
  }
}

TEST(DevicePixels, TheMemoryOfASectionMayBeTheSourceOfItsOwnStretch) {
  TestSection s(8, -8, 32);
  const auto before = Fill(s, 3);
  EXPECT_EQ(StretchDIBits(s.dc, 0, 1, 8, 7, 0, 1, 8, 7, s.pixels, s.info.Get(), 0, SRCCOPY), 8);
  for (int y = 1; y < 8; ++y) {
    for (int x = 0; x < 8; ++x) {
      EXPECT_EQ(s.At(x, y), before[static_cast<std::size_t>((y - 1) * 8 + x)]);
    }
  }
}

TEST(DevicePixels, RowsOfATopDownPictureCountFromTheBottom) {
  TestSection a(2, -6, 32);
  TestSection p(2, -6, 32);
  const auto source = Fill(a, 4);
  EXPECT_EQ(StretchDIBits(p.dc, 0, 0, 2, 3, 0, 1, 2, 3, a.pixels, a.info.Get(), 0, SRCCOPY), 6);
  for (int y = 0; y < 3; ++y) {
    EXPECT_EQ(p.At(1, y), source[static_cast<std::size_t>((y + 2) * 2 + 1)]) << y;
  }
  EXPECT_EQ(p.At(1, 3), 0U);
}

struct Stretch {
  int x, width, sourceX, sourceWidth;
};

// Which source column a target column shows, by searching: -1 for none.
int SourceColumn(const Stretch& s, int target, int sourceSize) {
  const int count = std::abs(s.width);
  // Stretched to one column, a picture goes without its last one.
  const int sourceCount = std::abs(s.sourceWidth) - (s.width == 1 && s.sourceWidth > 1 ? 1 : 0);
  const int t = s.width < 0 ? s.x - target : target - s.x;
  if (t < 0 || t >= count) {
    return -1;
  }
  int found = -1;
  for (int i = 0; i < sourceCount; ++i) {
    const int column = s.sourceWidth < 0 ? s.sourceX - i : s.sourceX + i;
    // Larger: the target's centre lies in the source pixel, or on its right edge. Smaller: the
    // source's centre lies in the target pixel, or on its right edge; the last one stays.
    const bool shown = sourceCount <= count ? 2 * i * count < (2 * t + 1) * sourceCount &&
                                                  (2 * t + 1) * sourceCount <= 2 * (i + 1) * count
                                            : 2 * t * sourceCount < (2 * i + 1) * count &&
                                                  (2 * i + 1) * count <= 2 * (t + 1) * sourceCount;
    if (shown && column >= 0 && column < sourceSize) {
      found = column;
    }
  }
  return found;
}

TEST(DevicePixels, MirroredAndCroppedStretchesKeepTheirGeometry) {
  std::mt19937 random(11);
  const auto in = [&](int low, int high) {
    return std::uniform_int_distribution<int>(low, high)(random);
  };
  TestSection a(9, -1, 32);
  const auto source = Fill(a, 5);
  for (int n = 0; n < 3000; ++n) {
    const Stretch s{in(-10, 30), in(-25, 25), in(-6, 14), in(-14, 14)};
    TestSection p(24, -1, 32);
    SetStretchBltMode(p.dc, COLORONCOLOR);
    ASSERT_TRUE(
        StretchBlt(p.dc, s.x, 0, s.width, 1, a.dc, s.sourceX, 0, s.sourceWidth, 1, SRCCOPY));
    for (int x = 0; x < 24; ++x) {
      const int column = SourceColumn(s, x, 9);
      ASSERT_EQ(p.At(x, 0), column < 0 ? 0U : source[static_cast<std::size_t>(column)])
          << s.x << ' ' << s.width << ' ' << s.sourceX << ' ' << s.sourceWidth << " at " << x;
    }
  }
}

TEST(DevicePixels, HalftoneWorksLikeColourOnColour) {
  TestSection source(9, 7, 8);
  for (std::size_t i = 0; i < source.Bytes(); ++i) {
    source.pixels[i] = static_cast<std::uint8_t>(i * 37 + 11);
  }
  for (const int width : {3, 20}) {
    const TestSection halftone(20, 20, 32);
    const TestSection colours(20, 20, 32);
    EXPECT_EQ(SetStretchBltMode(halftone.dc, HALFTONE), BLACKONWHITE);
    EXPECT_EQ(SetStretchBltMode(colours.dc, COLORONCOLOR), BLACKONWHITE);
    for (const TestSection* section : {&halftone, &colours}) {
      EXPECT_TRUE(StretchBlt(section->dc, 0, 0, width, width, source.dc, 0, 0, 9, 7, SRCCOPY));
    }
    EXPECT_EQ(std::memcmp(halftone.pixels, colours.pixels, colours.Bytes()), 0) << width;
    EXPECT_EQ(SetStretchBltMode(halftone.dc, COLORONCOLOR), HALFTONE);
  }
}

TEST(DevicePixels, MasksOfSixteenBits) {
  TestInfo info(2, -1, 16);
  info.header.biCompression = BI_BITFIELDS;
  const DWORD masks[3] = {0xF800, 0x07E0, 0x001F};
  std::memcpy(info.colours, masks, sizeof masks);
  void* memory = nullptr;
  HBITMAP bitmap = CreateDIBSection(nullptr, info.Get(), DIB_RGB_COLORS, &memory, nullptr, 0);
  ASSERT_NE(bitmap, nullptr);
  HDC dc = CreateCompatibleDC(nullptr);
  SelectObject(dc, bitmap);
  // 8 bits lose their low ones; 5 and 6 are repeated to fill 8.
  EXPECT_EQ(SetPixel(dc, 0, 0, RGB(0xFF, 0x85, 0x0F)), RGB(0xFF, 0x86, 0x08));
  std::uint16_t pixel = 0;
  std::memcpy(&pixel, memory, 2);
  EXPECT_EQ(pixel, 0x1F << 11 | 0x21 << 5 | 0x01);
  DIBSECTION facts{};
  EXPECT_EQ(GetObjectA(bitmap, sizeof facts, &facts), int{sizeof facts});
  EXPECT_EQ(facts.dsBitfields[1], 0x07E0U);
  DeleteDC(dc);
  DeleteObject(bitmap);
}

TEST(DevicePixels, TheScreenTakesDrawingWithoutEffect) {
  TestSection a(4, -4, 32);
  HDC screen = GetDC(nullptr);
  RECT box{1, 1, 1, 1};
  EXPECT_EQ(GetClipBox(screen, &box), NULLREGION);
  EXPECT_TRUE(BitBlt(screen, 0, 0, 4, 4, a.dc, 0, 0, SRCCOPY));
  EXPECT_TRUE(BitBlt(a.dc, 0, 0, 4, 4, screen, 0, 0, SRCCOPY));
  EXPECT_EQ(GetPixel(screen, 0, 0), CLR_INVALID);
  EXPECT_EQ(ReleaseDC(nullptr, screen), 1);
}

TEST(DevicePixels, NewContextsHaveAPixelOfTheirOwn) {
  HDC first = CreateCompatibleDC(nullptr);
  HDC second = CreateCompatibleDC(nullptr);
  EXPECT_EQ(SetPixel(first, 0, 0, RGB(255, 255, 255)), RGB(255, 255, 255));
  EXPECT_EQ(GetPixel(first, 0, 0), RGB(255, 255, 255));
  EXPECT_EQ(GetPixel(second, 0, 0), RGB(0, 0, 0));
  DeleteDC(first);
  DeleteDC(second);
}

}  // namespace
