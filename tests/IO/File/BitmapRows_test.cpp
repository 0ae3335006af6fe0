// The rows' conversions themselves, which are internal.
#include <vorl/IO/File/detail/BitmapRows.h>

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <vector>

#include "../../Support/LogRecorder.h"

namespace {

using vorl_detail::ExpandPalette;
using vorl_detail::ExpandRGB16;
using vorl_detail::IsGrayScalePalette;

using Lines = std::vector<std::string>;

constexpr tagRGBQUAD kGrey{7, 7, 7, 0};

TEST(BitmapRows, PaletteIsGreyWhenEveryEntryIs) {
  const tagRGBQUAD colours[] = {kGrey, {0, 0, 0, 9}, {255, 255, 255, 0}, {1, 1, 2, 0}};
  EXPECT_TRUE(IsGrayScalePalette(colours, 3));
  EXPECT_FALSE(IsGrayScalePalette(colours, 4));
  const tagRGBQUAD others[] = {{1, 2, 2, 0}, {2, 1, 2, 0}};
  EXPECT_FALSE(IsGrayScalePalette(others, 1));
  EXPECT_FALSE(IsGrayScalePalette(others + 1, 1));
  EXPECT_TRUE(IsGrayScalePalette(others, 0));
}

TEST(BitmapRows, NoPaletteIsNotGrey) {
  LogRecorder log;
  EXPECT_FALSE(IsGrayScalePalette(nullptr, 0));
  EXPECT_EQ(log.errors, Lines{"IsGrayScalePalette: invalid parameter(s)"});
}

TEST(BitmapRows, IndicesStandInTheHighestBitsFirst) {
  std::vector<tagRGBQUAD> palette;
  for (int i = 0; i < 256; ++i) {
    palette.push_back(
        {static_cast<BYTE>(i), static_cast<BYTE>(i + 1), static_cast<BYTE>(i + 2), 0});
  }
  const unsigned char source[] = {0xB1, 0x4E};
  const struct {
    int bits;
    std::vector<unsigned char> indices;
  } kCases[] = {{1, {1, 0, 1, 1, 0, 0, 0, 1, 0, 1}},
                {2, {2, 3, 0, 1, 1, 0, 3}},
                {4, {0xB, 1, 4}},
                {8, {0xB1, 0x4E}}};
  for (const auto& one : kCases) {
    std::vector<unsigned char> grey(one.indices.size());
    EXPECT_TRUE(ExpandPalette(grey.data(), one.bits, 8, source, grey.size(), palette.data()));
    EXPECT_EQ(grey, one.indices) << one.bits;
    std::vector<unsigned char> colour(3 * one.indices.size());
    EXPECT_TRUE(ExpandPalette(colour.data(), one.bits, 24, source, grey.size(), palette.data()));
    for (std::size_t x = 0; x < one.indices.size(); ++x) {
      EXPECT_EQ(colour[3 * x], one.indices[x]);
      EXPECT_EQ(colour[3 * x + 1], one.indices[x] + 1);
      EXPECT_EQ(colour[3 * x + 2], one.indices[x] + 2);
    }
  }
}

TEST(BitmapRows, RowPaletteAndWidthMustBeGiven) {
  unsigned char row[4] = {};
  LogRecorder log;
  EXPECT_FALSE(ExpandPalette(nullptr, 8, 8, row, 1, &kGrey));
  EXPECT_FALSE(ExpandPalette(row, 8, 8, nullptr, 1, &kGrey));
  EXPECT_FALSE(ExpandPalette(row, 8, 8, row, 1, nullptr));
  EXPECT_FALSE(ExpandPalette(row, 8, 8, row, 0, &kGrey));
  EXPECT_EQ(log.errors, Lines(4, "ExpandPalette: invalid parameter(s)"));
}

TEST(BitmapRows, SourceDepthMustBeOneOfIndices) {
  unsigned char row[4] = {};
  for (const int bits : {-1, 0, 3, 9, 16, 24}) {
    LogRecorder log;
    EXPECT_FALSE(ExpandPalette(row, bits, 8, row, 1, &kGrey));
    EXPECT_EQ(log.errors, Lines{"ExpandPalette: unsupported source pixel depth: " +
                                std::to_string(bits) + "(must be 8)"});
  }
}

TEST(BitmapRows, TargetDepthMustBeGreyOrColour) {
  unsigned char row[4] = {};
  for (const int bits : {0, 1, 16, 32}) {
    LogRecorder log;
    EXPECT_FALSE(ExpandPalette(row, 8, bits, row, 1, &kGrey));
    EXPECT_EQ(log.errors, Lines{"ExpandPalette: unsupported target pixel depth: " +
                                std::to_string(bits) + "(must be 8 or 24)"});
  }
}

TEST(BitmapRows, SixteenBitsAreBlueGreenAndRedFromBelow) {
  const unsigned char source[] = {0xFF, 0x7F, 0x41, 0x0C};
  unsigned char target[6] = {};
  EXPECT_TRUE(ExpandRGB16(2, target, source));
  const unsigned char expected[] = {248, 248, 248, 8, 16, 24};
  EXPECT_EQ(std::memcmp(target, expected, 6), 0);
}

TEST(BitmapRows, SixteenBitRowsMustBeGiven) {
  unsigned char row[4] = {};
  LogRecorder log;
  EXPECT_FALSE(ExpandRGB16(1, nullptr, row));
  EXPECT_FALSE(ExpandRGB16(1, row, nullptr));
  EXPECT_EQ(log.errors, Lines(2, "ExpandRGB16: invalid parameter(s)"));
}

}  // namespace
