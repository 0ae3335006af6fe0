// Bitmaps that can be read, pixel for pixel.
#include <vorl/IO/File/opDIB2Ima.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <string>

#include "../../Support/LogRecorder.h"
#include "../BinaryFileTest.h"
#include "BitmapBytes.h"

namespace {

using bitmap_test::Bitmap;
using bitmap_test::Colour;
using bitmap_test::ColourAt;
using bitmap_test::FileOf;
using bitmap_test::Ramp;

struct Case {
  const char* name;
  int bits;
  int colours;  ///< of the palette
  bool grey;
  unsigned short dataType;
  const char* sequence;
};

void PrintTo(const Case& one, std::ostream* out) {
  *out << one.name;
}

class opDIB2ImaDepth : public BinaryFileTest, public testing::WithParamInterface<Case> {
 protected:
  static Bitmap Make(int width, int height) {
    Bitmap bitmap;
    bitmap.width = width;
    bitmap.height = height;
    bitmap.bits = GetParam().bits;
    bitmap.palette = Ramp(GetParam().colours, GetParam().grey);
    return bitmap;
  }

  static void ExpectFormat(const dImage& image, int width, int height) {
    const Case& wanted = GetParam();
    ASSERT_TRUE(image.IsValid());
    EXPECT_EQ(image.GetWidth(), static_cast<unsigned long>(width));
    EXPECT_EQ(image.GetHeight(), static_cast<unsigned long>(height));
    EXPECT_EQ(image.GetDataType(), wanted.dataType);
    EXPECT_STREQ(image.GetChannelSequence(), wanted.sequence);
    EXPECT_EQ(image.GetDataOrder(), ImageDataOrder_Pixel);
    EXPECT_EQ(image.GetRowAlignment(), 4);
  }

  static void ExpectPixels(const dImage& image, const Bitmap& bitmap) {
    for (int y = 0; y < std::abs(bitmap.height); ++y) {
      const auto* row = static_cast<const unsigned char*>(image.GetRowPtr(y));
      for (int x = 0; x < bitmap.width; ++x) {
        if (image.GetDataType() == ImageDataType_U1) {
          EXPECT_EQ(row[x / 8] >> (7 - x % 8) & 1, IndexAt(bitmap, x, y)) << x << ", " << y;
        } else {
          EXPECT_EQ(ColourAt(image, x, y), ColourAt(bitmap, x, y)) << x << ", " << y;
        }
        if (image.GetNumChannels() == 4) {
          EXPECT_EQ(row[4 * x + 3], ByteAt(bitmap, x, y, 3)) << x << ", " << y;
        }
      }
    }
  }
};

TEST_P(opDIB2ImaDepth, FileIsReadPixelForPixelInBothRowOrders) {
  for (const int width : {1, 2, 3, 4, 5, 7, 8, 9, 31, 32, 33}) {
    for (const int height : {3, -3}) {
      const Bitmap bitmap = Make(width, height);
      MakeFile(FileOf(bitmap));
      dImage image;
      opDIB2Ima op;
      ASSERT_TRUE(op.Convert(FileName(), image)) << op.GetStatus();
      EXPECT_EQ(op.GetStatus(), 0);
      SCOPED_TRACE(std::to_string(width) + " x " + std::to_string(height));
      ExpectFormat(image, width, 3);
      ExpectPixels(image, bitmap);
    }
  }
}

TEST_P(opDIB2ImaDepth, BlockInMemoryIsReadPixelForPixel) {
  for (const int height : {2, -2}) {
    const Bitmap bitmap = Make(5, height);
    std::vector<tagBITMAPINFO> info(bitmap_test::InfoBytes(bitmap).size() / sizeof(tagBITMAPINFO) +
                                    1);
    std::memcpy(info.data(), bitmap_test::InfoBytes(bitmap).data(),
                bitmap_test::InfoBytes(bitmap).size());
    auto rows = bitmap_test::MadeUpRows(bitmap);
    dImage image;
    opDIB2Ima op(info.data(), rows.data(), image);
    EXPECT_EQ(op.GetStatus(), 0) << op.GetStatus();
    ExpectFormat(image, 5, 2);
    ExpectPixels(image, bitmap);
  }
}

INSTANTIATE_TEST_SUITE_P(
    All, opDIB2ImaDepth,
    testing::Values(Case{"OneBit", 1, 2, true, ImageDataType_U1, "G"},
                    Case{"OneBitInColour", 1, 2, false, ImageDataType_U1, "G"},
                    Case{"TwoBitsGrey", 2, 4, true, ImageDataType_U8, "G"},
                    Case{"TwoBitsInColour", 2, 4, false, ImageDataType_U8, "BGR"},
                    Case{"FourBitsGrey", 4, 16, true, ImageDataType_U8, "G"},
                    Case{"FourBitsInColour", 4, 16, false, ImageDataType_U8, "BGR"},
                    Case{"EightBitsGrey", 8, 256, true, ImageDataType_U8, "G"},
                    Case{"EightBitsInColour", 8, 256, false, ImageDataType_U8, "BGR"},
                    Case{"SixteenBits", 16, 0, false, ImageDataType_U8, "BGR"},
                    Case{"TwentyFourBits", 24, 0, false, ImageDataType_U8, "BGR"},
                    Case{"ThirtyTwoBits", 32, 0, false, ImageDataType_U8, "BGRA"}),
    [](const auto& test) { return std::string(test.param.name); });

class opDIB2ImaFile : public BinaryFileTest {
 protected:
  dImage Read(const Bitmap& bitmap) {
    MakeFile(FileOf(bitmap));
    dImage image;
    opDIB2Ima op;
    EXPECT_TRUE(op.Convert(FileName(), image)) << op.GetStatus();
    return image;
  }
};

Bitmap EightBit(std::vector<Colour> palette, std::vector<unsigned char> row) {
  Bitmap bitmap;
  bitmap.width = static_cast<std::int32_t>(row.size());
  bitmap.height = 1;
  bitmap.bits = 8;
  bitmap.palette = std::move(palette);
  bitmap.rows = std::move(row);
  return bitmap;
}

TEST_F(opDIB2ImaFile, SixteenBitPixelHasFiveBitsPerColourAndNoMore) {
  Bitmap bitmap;
  bitmap.width = 4;
  bitmap.height = 1;
  bitmap.bits = 16;
  bitmap.rows = {0xFF, 0x7F, 0x1F, 0x00, 0xE0, 0x03, 0x00, 0xFC};
  const dImage image = Read(bitmap);
  EXPECT_EQ(ColourAt(image, 0, 0), (Colour{248, 248, 248}));
  EXPECT_EQ(ColourAt(image, 1, 0), (Colour{248, 0, 0}));
  EXPECT_EQ(ColourAt(image, 2, 0), (Colour{0, 248, 0}));
  EXPECT_EQ(ColourAt(image, 3, 0), (Colour{0, 0, 248}));  // the top bit is no colour
}

TEST_F(opDIB2ImaFile, SixteenBitMasksAreNotLookedAt) {
  Bitmap bitmap;
  bitmap.width = 2;
  bitmap.height = 1;
  bitmap.bits = 16;
  bitmap.compression = 3;
  bitmap.gap = {0, 0xF8, 0, 0, 0xE0, 7, 0, 0, 0x1F, 0, 0, 0};  // 5-6-5
  bitmap.rows = {0xFF, 0x7F, 0x1F, 0x7C};
  const dImage image = Read(bitmap);
  EXPECT_EQ(ColourAt(image, 0, 0), (Colour{248, 248, 248}));
  EXPECT_EQ(ColourAt(image, 1, 0), (Colour{248, 0, 248}));
}

TEST_F(opDIB2ImaFile, ThirtyTwoBitMasksOfPlainPixelsAreRead) {
  Bitmap bitmap;
  bitmap.width = 1;
  bitmap.height = 1;
  bitmap.bits = 32;
  bitmap.compression = 3;
  bitmap.gap = {0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0};
  bitmap.rows = {1, 2, 3, 4};
  const dImage image = Read(bitmap);
  EXPECT_STREQ(image.GetChannelSequence(), "BGRA");
  EXPECT_EQ(ColourAt(image, 0, 0), (Colour{1, 2, 3}));
}

// Masks stand at the same place, whether as part of the header or behind it; the palette does not.
TEST_F(opDIB2ImaFile, LongerHeadersAreRead) {
  for (const std::uint32_t size : {52U, 56U, 108U, 124U}) {
    Bitmap bitmap;
    bitmap.width = 5;
    bitmap.height = -2;
    bitmap.infoSize = size;
    bitmap.infoRest.assign(size - 40, 0xA5);
    for (const int bits : {4, 8, 24}) {
      bitmap.bits = bits;
      bitmap.palette = Ramp(bits <= 8 ? 1 << bits : 0, false);
      const dImage image = Read(bitmap);
      for (int x = 0; x < 5; ++x) {
        EXPECT_EQ(ColourAt(image, x, 1), ColourAt(bitmap, x, 1)) << size << ": " << x;
      }
    }
    const Bytes masks = {0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0};
    std::copy(masks.begin(), masks.end(), bitmap.infoRest.begin());
    bitmap.bits = 32;
    bitmap.palette.clear();
    bitmap.compression = 3;
    const dImage image = Read(bitmap);
    EXPECT_EQ(ColourAt(image, 4, 0), ColourAt(bitmap, 4, 0));
  }
}

TEST_F(opDIB2ImaFile, BothRowOrdersOfOnePictureGiveTheSameImage) {
  Bitmap up;
  up.width = 2;
  up.height = 2;
  up.bits = 24;
  up.rows = {7, 8, 9, 10, 11, 12, 0, 0, 1, 2, 3, 4, 5, 6, 0, 0};
  Bitmap down = up;
  down.height = -2;
  down.rows = {1, 2, 3, 4, 5, 6, 0, 0, 7, 8, 9, 10, 11, 12, 0, 0};
  const dImage first = Read(up);
  const dImage second = Read(down);
  ASSERT_EQ(first.GetImageSize(), 16U);
  EXPECT_EQ(std::memcmp(first.GetDataPtr(), second.GetDataPtr(), 16), 0);
  EXPECT_EQ(ColourAt(first, 0, 0), (Colour{1, 2, 3}));
  EXPECT_EQ(ColourAt(first, 1, 1), (Colour{10, 11, 12}));
}

TEST_F(opDIB2ImaFile, PaletteHasTheColoursThatTheHeaderStates) {
  // The third entry is in colour, but not one of the two that are used.
  Bitmap bitmap = EightBit({{5, 5, 5}, {9, 9, 9}, {1, 2, 3}}, {0, 1, 2, 255});
  bitmap.coloursUsed = 2;
  const dImage image = Read(bitmap);
  ASSERT_STREQ(image.GetChannelSequence(), "G");
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "\x05\x09\x00\x00", 4), 0);
}

TEST_F(opDIB2ImaFile, PaletteEndsWhereThePixelsBegin) {
  for (const std::uint32_t stated : {0U, 256U, 0xFFFFFFFFU}) {
    Bitmap bitmap = EightBit({{1, 2, 3}, {4, 5, 6}}, {1, 0, 2, 255});
    bitmap.coloursUsed = stated;
    const dImage image = Read(bitmap);
    ASSERT_STREQ(image.GetChannelSequence(), "BGR");
    EXPECT_EQ(ColourAt(image, 0, 0), (Colour{4, 5, 6}));
    EXPECT_EQ(ColourAt(image, 1, 0), (Colour{1, 2, 3}));
    EXPECT_EQ(ColourAt(image, 2, 0), (Colour{0, 0, 0}));
    EXPECT_EQ(ColourAt(image, 3, 0), (Colour{0, 0, 0}));
  }
}

TEST_F(opDIB2ImaFile, PaletteLongerThanTheIndicesReachIsReadAsFarAsTheyDo) {
  std::vector<Colour> palette(300, Colour{7, 7, 7});
  palette[290] = {1, 2, 3};
  Bitmap bitmap = EightBit(palette, {0, 255, 1, 2});
  bitmap.coloursUsed = 300;
  const dImage image = Read(bitmap);
  ASSERT_STREQ(image.GetChannelSequence(), "G");
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "\x07\x07\x07\x07", 4), 0);
}

TEST_F(opDIB2ImaFile, UsualGreyPaletteLeavesTheIndicesAsTheyAre) {
  std::vector<Colour> palette = Ramp(256, true);
  std::reverse(palette.begin(), palette.end());
  const Bitmap bitmap = EightBit(palette, {0, 77, 254, 255});
  const dImage image = Read(bitmap);
  ASSERT_STREQ(image.GetChannelSequence(), "G");
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "\x00\x4D\xFE\xFF", 4), 0);
  // One entry that differs, and none of the indices is copied.
  palette[255] = {254, 254, 254};
  EXPECT_EQ(
      std::memcmp(Read(EightBit(palette, {0, 77, 254, 255})).GetDataPtr(), "\x00\x4D\xFE\xFE", 4),
      0);
}

TEST_F(opDIB2ImaFile, NoPaletteAtAllIsGreyAndBlack) {
  const dImage image = Read(EightBit({}, {0, 1, 2, 255}));
  ASSERT_STREQ(image.GetChannelSequence(), "G");
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "\0\0\0\0", 4), 0);
}

TEST_F(opDIB2ImaFile, GapBeforeAndBytesBehindThePixelsAreLeftOut) {
  Bitmap bitmap = EightBit(Ramp(256, true), {10, 20, 30, 40});
  bitmap.gap.assign(100, 0xEE);
  auto bytes = FileOf(bitmap);
  bytes.insert(bytes.end(), 1000, 0xDD);
  MakeFile(bytes);
  dImage image;
  opDIB2Ima op;
  ASSERT_TRUE(op.Convert(FileName(), image)) << op.GetStatus();
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "\xF5\xEB\xE1\xD7", 4), 0);
}

TEST_F(opDIB2ImaFile, RowPaddingOfExpandedRowsIsZero) {
  Bitmap bitmap = EightBit({{1, 2, 3}}, {0, 0, 0, 0});
  bitmap.width = 1;
  dImage image;
  ASSERT_TRUE(image.Init(1, 1, ImageDataType_U8, "BGR", 0, 4));
  image.Fill(0x55);  // an image of the same size keeps its bytes
  MakeFile(FileOf(bitmap));
  opDIB2Ima op(FileName(), image);
  ASSERT_TRUE(image.IsValid()) << op.GetStatus();
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "\x01\x02\x03\x00", 4), 0);
}

TEST_F(opDIB2ImaFile, NegativeWidthCountsAsItsMagnitude) {
  Bitmap bitmap = EightBit(Ramp(256, true), {255, 254, 253, 252});
  bitmap.width = -3;
  const dImage image = Read(bitmap);
  ASSERT_EQ(image.GetWidth(), 3U);
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "\0\x01\x02", 3), 0);
}

TEST(opDIB2Ima, BitsMayBeTheImagesOwn) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 3, ImageDataType_U8, "G", 0, 4));
  std::memcpy(image.GetDataPtr(), "abcdefghijkl", 12);
  std::vector<tagBITMAPINFO> info(30);
  info[0].bmiHeader = {40, 4, 3, 1, 8, 0, 0, 0, 0, 0, 0};
  auto* palette = reinterpret_cast<unsigned char*>(info.data()) + 40;
  for (int i = 0; i < 256; ++i) {
    std::memset(palette + 4 * i, i, 3);
  }
  opDIB2Ima op;
  ASSERT_TRUE(op.Convert(info.data(), image.GetDataPtr(), image)) << op.GetStatus();
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), "ijklefghabcd", 12), 0);
}

TEST(opDIB2Ima, IsAnOperatorThatDoesNothing) {
  opDIB2Ima op;
  EXPECT_TRUE(op.Reset());
  EXPECT_TRUE(op.Run());
  EXPECT_STREQ(op.GetStatus(), "success");
  EXPECT_STREQ(opDIB2Ima::CI().name, "opDIB2Ima");
  EXPECT_EQ(opDIB2Ima::CI().parents[0], &OpBase::CI());
  BaseClass* object = opDIB2Ima::CI().Create();
  ASSERT_NE(object, nullptr);
  EXPECT_STREQ(object->ClassName(), "opDIB2Ima");
  object->Release();
}

TEST(opDIB2Ima, CopyHasTheStatus) {
  dImage image;
  opDIB2Ima op(static_cast<const char*>(nullptr), image);
  const opDIB2Ima copy(op);
  EXPECT_STREQ(copy.GetStatus(), "no name for bitmap file specified");
  opDIB2Ima assigned;
  assigned = op;
  EXPECT_STREQ(assigned.GetStatus(), "no name for bitmap file specified");
}

class OpenOperator : public opDIB2Ima {
 public:
  using opDIB2Ima::InitOutputImage;
};

TEST(opDIB2Ima, OutputImageHasItsSizeWithoutSigns) {
  OpenOperator op;
  dImage image;
  ASSERT_TRUE(op.InitOutputImage(image, -5, -7, 24));
  EXPECT_EQ(image.GetWidth(), 5U);
  EXPECT_EQ(image.GetHeight(), 7U);
  EXPECT_STREQ(image.GetChannelSequence(), "BGR");
  EXPECT_EQ(image.GetBytesPerRow(), 16U);
}

TEST(opDIB2Ima, OutputImageOfAnotherDepthIsRefused) {
  for (const int bits : {-1, 0, 2, 4, 16, 33}) {
    OpenOperator op;
    dImage image;
    LogRecorder log;
    EXPECT_FALSE(op.InitOutputImage(image, 5, 7, bits));
    const std::string message = "opDIB2Ima: unsupported pixel depth: " + std::to_string(bits);
    EXPECT_STREQ(op.GetStatus(), message.c_str());
    EXPECT_EQ(log.errors, std::vector<std::string>{"opDIB2Ima::InitOutputImage: " + message});
  }
}

}  // namespace
