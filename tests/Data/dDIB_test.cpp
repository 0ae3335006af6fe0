// Formatting bitmaps, and the ways in from blocks and files.
#include <vorl/Data/dDIB.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "../IO/BinaryFileTest.h"
#include "../IO/File/BitmapBytes.h"
#include "../Support/LogRecorder.h"
#include "../Support/VirtualSlot.h"
#include "DibTesting.h"

namespace {

struct Depth {
  const char* name;
  short channels;
  short bits;
  const char* sequence;
  unsigned short dataType;
  unsigned short bitsPerPixel;
  unsigned short paletteSize;
  unsigned long bytesPerRow;  ///< of 5 pixels
};

class dDIBDepth : public testing::TestWithParam<Depth> {};

TEST_P(dDIBDepth, IsFormattedWithASection) {
  const Depth& depth = GetParam();
  dDIB dib;
  ASSERT_TRUE(dib.Init(5, 3, depth.channels, depth.bits)) << dib.GetStatus();
  EXPECT_EQ(dib.GetStatus(), 0);
  EXPECT_TRUE(dib.IsValid());
  EXPECT_EQ(dib.GetWidth(), 5U);
  EXPECT_EQ(dib.GetHeight(), 3U);
  EXPECT_EQ(dib.GetDataType(), depth.dataType);
  EXPECT_STREQ(dib.GetChannelSequence(), depth.sequence);
  EXPECT_EQ(dib.GetDataOrder(), ImageDataOrder_Pixel);
  EXPECT_EQ(dib.GetRowAlignment(), 4);
  EXPECT_EQ(dib.GetBytesPerRow(), depth.bytesPerRow);
  EXPECT_EQ(dib.GetImageSize(), 3 * depth.bytesPerRow);
  EXPECT_EQ(dib.GetBitsPerPixel(), depth.bitsPerPixel);
  EXPECT_EQ(dib.GetPaletteSize(), depth.paletteSize);
  EXPECT_EQ(dib.GetPalette() != nullptr, depth.paletteSize != 0);
  EXPECT_EQ(dib.ResetPalette(true), depth.paletteSize != 0);
  ASSERT_NE(dib.GetHeader(), nullptr);
  EXPECT_EQ(dib.GetHeader()->bmiHeader.biHeight, -3);
  ASSERT_NE(dib.GetHandle(), nullptr);
  EXPECT_TRUE(ShowsItsSection(dib));
}

TEST_P(dDIBDepth, FreshPixelsAreZero) {
  dDIB dib(9, 7, GetParam().channels, GetParam().bits);
  ASSERT_TRUE(dib.IsValid());
  const auto* bytes = static_cast<const unsigned char*>(dib.GetDataPtr());
  EXPECT_EQ(std::string(bytes, bytes + dib.GetImageSize()), std::string(dib.GetImageSize(), '\0'));
}

INSTANTIATE_TEST_SUITE_P(All, dDIBDepth,
                         testing::Values(Depth{"OneBit", 1, 1, "G", 1, 1, 2, 4},
                                         Depth{"EightBits", 1, 8, "G", 8, 8, 256, 8},
                                         Depth{"ThreeChannels", 3, 8, "BGR", 8, 24, 0, 16},
                                         Depth{"FourChannels", 4, 8, "BGRA", 8, 32, 0, 20}),
                         [](const auto& test) { return std::string(test.param.name); });

TEST(dDIB, OtherDepthsAreRefused) {
  const short kDepths[][2] = {{2, 8}, {1, 16}, {3, 1},  {4, 16}, {0, 8},   {1, 0},  {5, 8},
                              {1, 4}, {-1, 8}, {1, -8}, {3, 16}, {0, 408}, {2, 108}};
  for (const auto& depth : kDepths) {
    dDIB dib(4, 4, 1, 8);
    LogRecorder log;
    EXPECT_FALSE(dib.Init(4, 4, depth[0], depth[1]));
    const std::string text = "dDIB: unsupported pixel depth: " + std::to_string(depth[0]) + " * " +
                             std::to_string(depth[1]) + " bit";
    EXPECT_EQ(StatusText(dib), text);
    EXPECT_EQ(log.errors, std::vector<std::string>{"dDIB::Init: " + text});
    EXPECT_FALSE(dib.IsValid());
    EXPECT_EQ(dib.GetHandle(), nullptr);
  }
}

TEST(dDIB, SizesThatAreNoneAreRefused) {
  const long kSizes[][2] = {{0, 4}, {4, 0}, {-1, 4}, {4, -1}, {-2147483647L - 1, 1}};
  for (const auto& size : kSizes) {
    dDIB dib(4, 4, 1, 8);
    EXPECT_FALSE(dib.Init(size[0], size[1], 1, 8));
    EXPECT_EQ(StatusText(dib),
              "dDIB: invalid size: " + std::to_string(size[0]) + " x " + std::to_string(size[1]));
    EXPECT_FALSE(dib.IsValid());
  }
}

TEST(dDIB, SixArgumentInitForcesAlignmentAndOrderOfOneChannel) {
  dDIB dib;
  ASSERT_TRUE(dib.Init(5UL, 2UL, ImageDataType_U8, "Gray", ImageDataOrder_Plane, 32));
  EXPECT_EQ(dib.GetRowAlignment(), 4);
  EXPECT_EQ(dib.GetBytesPerRow(), 8U);
  EXPECT_EQ(dib.GetDataOrder(), ImageDataOrder_Pixel);
  EXPECT_STREQ(dib.GetChannelSequence(), "Gray");
  EXPECT_TRUE(dib.Init(5UL, 2UL, ImageDataType_U8, "G", ImageDataOrder_Pixel, 3));  // no alignment
  EXPECT_EQ(dib.GetRowAlignment(), 4);
}

TEST(dDIB, SixArgumentInitTakesItsOwnSequence) {
  dDIB dib;
  ASSERT_TRUE(dib.Init(5UL, 2UL, ImageDataType_U8, "YCrCb", ImageDataOrder_Pixel, 4));
  ASSERT_TRUE(dib.Init(6UL, 2UL, ImageDataType_U8, dib.GetChannelSequence(), 0, 4));
  EXPECT_STREQ(dib.GetChannelSequence(), "YCrCb");
}

TEST(dDIB, ChannelsOfAnyNameMakeTwentyFourBits) {
  dDIB dib;
  ASSERT_TRUE(dib.Init(5UL, 2UL, ImageDataType_U8, "RGB", ImageDataOrder_Pixel, 4));
  EXPECT_EQ(dib.GetBitsPerPixel(), 24);
  EXPECT_STREQ(dib.GetChannelSequence(), "RGB");
}

TEST(dDIB, FormatsOfNoBitmapAreRefused) {
  const struct {
    unsigned long width;
    unsigned short dataType;
    const char* sequence;
    unsigned short order;
    const char* text;
  } kCases[] = {
      {4, 16, "G", 0, "initialization error:not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order"},
      {4, 8, "BGR", 1,
       "initialization error:not a 'Bitmap' format: 3 x 8 bit - 'BGR' - plane order"},
      {4, 8, "RGBA", 0,
       "initialization error:not a 'Bitmap' format: 4 x 8 bit - 'RGBA' - pixel order"},
      {0, 8, "G", 0, "initialization error:uninitialized image"},
      {4, 7, "G", 0, "invalid 'DataType': 7"},
      {4, 8, "bgr", 0, "invalid 'ChannelSequence':'bgr'"},
      {4, 8, nullptr, 0, "invalid 'ChannelSequence':''"},
      {4, 8, "BGR", 2, "invalid 'DataOrder': 2"},
      {0xFFFFFFFF, 8, "BGR", 0, "no memory(25769803776 bytes required)"}};
  for (const auto& one : kCases) {
    dDIB dib(4, 4, 1, 8);
    LogRecorder log;
    EXPECT_FALSE(dib.Init(one.width, 2UL, one.dataType, one.sequence, one.order, 4));
    EXPECT_EQ(StatusText(dib), one.text);
    const bool isRefusedByDescriptor = std::string(one.text).rfind("initialization error:", 0) == 0;
    EXPECT_EQ(log.errors.back(),
              std::string(isRefusedByDescriptor ? "dDIB::Init: " : "dImage::Init: ") + one.text);
    EXPECT_FALSE(dib.IsValid());
    EXPECT_EQ(dib.GetHandle(), nullptr);
    EXPECT_EQ(dib.GetHeader(), nullptr);
    EXPECT_EQ(dib.GetBitsPerPixel(), 0);
    EXPECT_EQ(dib.GetPaletteSize(), 0);
    EXPECT_EQ(dib.GetWidth(), 0U);
  }
}

TEST(dDIB, ReformattingClearsThePixels) {
  dDIB dib(4, 4, 1, 8);
  dib.Fill(0x55);
  ASSERT_TRUE(dib.Init(4, 4, 1, 8));
  EXPECT_EQ(*static_cast<unsigned char*>(dib.GetDataPtr()), 0);
}

TEST(dDIB, ModelGivesWhatIsLeftOut) {
  dImage model;
  ASSERT_TRUE(model.Init(6, 5, ImageDataType_U8, "RGB", 0, 1));
  dDIB dib;
  ASSERT_TRUE(dib.Init(model, 0, 0, 0, 0));
  EXPECT_EQ(dib.GetWidth(), 6U);
  EXPECT_EQ(dib.GetHeight(), 5U);
  EXPECT_STREQ(dib.GetChannelSequence(), "BGR");
  ASSERT_TRUE(dib.Init(model, 7, 8, 1, 1));
  EXPECT_EQ(dib.GetWidth(), 7U);
  EXPECT_EQ(dib.GetHeight(), 8U);
  EXPECT_EQ(dib.GetBitsPerPixel(), 1);
  EXPECT_FALSE(dib.Init(model, 0, 0, 0, 16));
  EXPECT_EQ(StatusText(dib), "dDIB: unsupported pixel depth: 3 * 16 bit");
}

TEST(dDIB, ModelMayBeTheBitmapItself) {
  dDIB dib(6, 5, 3, 8);
  ASSERT_TRUE(dib.Init(dib, 0, 9, 0, 0));
  EXPECT_EQ(dib.GetWidth(), 6U);
  EXPECT_EQ(dib.GetHeight(), 9U);
  EXPECT_EQ(dib.GetBitsPerPixel(), 24);
}

TEST(dDIB, BlockAndBitsAreCopied) {
  dDIB source(5, 3, 3, 8);
  FillWithCount(source);
  const dDIB copy(source.GetHeader(), source.GetDataPtr());
  ASSERT_TRUE(copy.IsValid()) << copy.GetStatus();
  EXPECT_NE(copy.GetHandle(), source.GetHandle());
  // The header states the padded width: 16 bytes hold 5 pixels.
  EXPECT_TRUE(SamePixels(copy, source));
}

TEST(dDIB, BlockAndBitsMayBeItsOwn) {
  dDIB dib(4, 2, 1, 8);
  std::memcpy(dib.GetDataPtr(), "abcdefgh", 8);
  ASSERT_TRUE(dib.Init(dib.GetHeader(), dib.GetDataPtr())) << dib.GetStatus();
  EXPECT_EQ(std::memcmp(dib.GetDataPtr(), "abcdefgh", 8), 0);
  EXPECT_TRUE(ShowsItsSection(dib));
}

#if !defined(_WIN32)  // the system may have the memory
TEST(dDIB, SectionThatTheDeviceRefusesTellsWhy) {
  LogRecorder log;
  dDIB dib(4, 4, 1, 8);
  EXPECT_FALSE(dib.Init(40000, 20000, 4, 8));
  EXPECT_EQ(StatusText(dib), "CreateDIBSection failed");
  EXPECT_EQ(log.errors, std::vector<std::string>{"dDIB::Init: CreateDIBSection failed"});
  EXPECT_FALSE(dib.IsValid());
  EXPECT_EQ(dib.GetHandle(), nullptr);
}
#endif

TEST(dDIB, BlockThatCannotBeReadTellsWhy) {
  const tagBITMAPINFO info{{40, 4, 4, 1, 5, 0, 0, 0, 0, 0, 0}, {}};
  const unsigned char bits[64] = {};
  dDIB dib(4, 4, 1, 8);
  EXPECT_FALSE(dib.Init(&info, bits));
  EXPECT_EQ(StatusText(dib), "initialization error:opDIB2Ima: unsupported pixel depth: 5");
  EXPECT_FALSE(dib.IsValid());
  EXPECT_FALSE(dib.Init(nullptr, bits));
  EXPECT_EQ(StatusText(dib), "initialization error:no bitmap information block specified");
  LogRecorder log;
  EXPECT_FALSE(dib.Init(&info, nullptr));
  EXPECT_EQ(StatusText(dib), "initialization error:no pixel bits specified");
  EXPECT_EQ(log.errors,
            (std::vector<std::string>{"opDIB2Ima::Convert: no pixel bits specified",
                                      "dDIB::Init: initialization error:no pixel bits specified"}));
}

class dDIBFile : public BinaryFileTest {};

TEST_F(dDIBFile, BitmapFileBecomesTheSection) {
  bitmap_test::Bitmap bitmap;
  bitmap.width = 5;
  bitmap.height = 3;
  bitmap.bits = 24;
  MakeFile(bitmap_test::FileOf(bitmap));
  dDIB dib(FileName());
  ASSERT_TRUE(dib.IsValid()) << dib.GetStatus();
  EXPECT_EQ(dib.GetStatus(), 0);
  for (int y = 0; y < 3; ++y) {
    for (int x = 0; x < 5; ++x) {
      EXPECT_EQ(bitmap_test::ColourAt(dib, x, y), bitmap_test::ColourAt(bitmap, x, y));
    }
  }
  EXPECT_TRUE(ShowsItsSection(dib));
}

// Memory that was full of other bytes shows what a file leaves unwritten.
TEST_F(dDIBFile, EveryByteOfTheRowsComesFromTheFile) {
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    bitmap_test::Bitmap bitmap;
    bitmap.width = 5;
    bitmap.height = 300;
    bitmap.bits = bits;
    MakeFile(bitmap_test::FileOf(bitmap));
    std::vector<unsigned char> first;
    for (const char garbage : {'\x11', '\x6E'}) {
      dDIB dib(FileName());
      ASSERT_TRUE(dib.IsValid()) << bits;
      dib.Fill(garbage);
      ASSERT_TRUE(dib.Init(FileName())) << bits;
      const auto* const bytes = static_cast<const unsigned char*>(dib.GetDataPtr());
      const std::vector<unsigned char> all(bytes, bytes + dib.GetImageSize());
      first = first.empty() ? all : first;
      EXPECT_EQ(all, first) << bits;
    }
  }
}

TEST_F(dDIBFile, FormattingAfterAFileClearsThePixels) {
  bitmap_test::Bitmap bitmap;
  bitmap.width = 64;
  bitmap.height = 64;
  bitmap.bits = 32;
  MakeFile(bitmap_test::FileOf(bitmap));
  const auto expectZeros = [](dDIB& dib) {
    dib.Fill(0x55);
    ASSERT_TRUE(dib.Init(64, 64, 4, 8));
    const auto* const bytes = static_cast<const unsigned char*>(dib.GetDataPtr());
    EXPECT_EQ(std::vector<unsigned char>(bytes, bytes + dib.GetImageSize()),
              std::vector<unsigned char>(dib.GetImageSize()));
  };
  dDIB dib(FileName());
  ASSERT_TRUE(dib.IsValid());
  expectZeros(dib);
  EXPECT_FALSE(dib.Init((std::string(FileName()) + "x").c_str()));
  ASSERT_TRUE(dib.Init(64, 64, 4, 8));
  expectZeros(dib);
}

TEST_F(dDIBFile, FileThatCannotBeReadTellsWhy) {
  dDIB dib(4, 4, 1, 8);
  LogRecorder log;
  EXPECT_FALSE(dib.Init(FileName()));
  const std::string text =
      std::string("initialization error:unable to open file '") + FileName() + "'";
  EXPECT_EQ(StatusText(dib), text);
  EXPECT_EQ(log.errors.back(), "dDIB::Init: " + text);
  EXPECT_FALSE(dib.IsValid());
  EXPECT_EQ(dib.GetHandle(), nullptr);
  EXPECT_FALSE(dib.Init(static_cast<const char*>(nullptr)));
  EXPECT_EQ(StatusText(dib), "initialization error:no name for bitmap file specified");
}

TEST_F(dDIBFile, PersistsItselfAsAnImage) {
  dDIB dib(5, 3, 3, 8);
  FillWithCount(dib);
  ASSERT_TRUE(dib.WriteFile(FileName(), "dDIB"));
  dDIB copy;
  ASSERT_TRUE(copy.ReadFile(FileName(), "dDIB"));
  EXPECT_TRUE(SamePixels(copy, dib));
  EXPECT_TRUE(ShowsItsSection(copy));
  dImage image;
  ASSERT_TRUE(image.ReadFile(FileName(), "dDIB"));
  EXPECT_EQ(image.GetWidth(), 5U);
  EXPECT_STREQ(image.GetChannelSequence(), "BGR");
}

TEST_F(dDIBFile, DataOfAnImageThatIsNoBitmapIsNotRead) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U16, "G", 0, 4));
  image.Fill(1);
  ASSERT_TRUE(image.WriteFile(FileName(), "dDIB"));
  dDIB dib(4, 4, 1, 8);
  EXPECT_FALSE(dib.ReadFile(FileName(), "dDIB"));
  EXPECT_FALSE(dib.IsValid());
  EXPECT_EQ(StatusText(dib),
            "initialization error:not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order");
}

TEST_F(dDIBFile, EmptyBitmapIsWrittenAndRead) {
  dDIB empty;
  ASSERT_TRUE(empty.WriteFile(FileName(), "dDIB"));
  dDIB dib(4, 4, 1, 8);
  EXPECT_TRUE(dib.ReadFile(FileName(), "dDIB"));
  EXPECT_FALSE(dib.IsValid());
}

TEST(dDIB, ResetForgetsEverything) {
  dDIB dib(4, 4, 1, 8);
  dib.Reset();
  EXPECT_FALSE(dib.IsValid());
  EXPECT_EQ(dib.GetHandle(), nullptr);
  EXPECT_EQ(dib.GetHeader(), nullptr);
  EXPECT_EQ(dib.GetPalette(), nullptr);
  EXPECT_FALSE(dib.ResetPalette(true));
  dib.Reset();
}

TEST(dDIB, IsRegisteredUnderItsImage) {
  EXPECT_STREQ(dDIB::CI().name, "dDIB");
  EXPECT_EQ(dDIB::CI().parents[0], &dImage::CI());
  BaseClass* object = dDIB::CI().Create();
  ASSERT_NE(object, nullptr);
  EXPECT_STREQ(object->ClassName(), "dDIB");
  object->Release();
}

TEST(dDIB, AnswersForItsValidityAsADataClassToo) {
  dDIB dib(4, 4, 1, 8);
  DataBase& base = dib;
  EXPECT_TRUE(base.IsValid());
  const dImage& image = dib;
  EXPECT_TRUE(image.IsValid());
  dib.Reset();
  EXPECT_FALSE(base.IsValid());
}

TEST(dDIB, AddsNoVirtualFunctions) {
  using IsValid = bool (dDIB::*)() const;
  using Take = bool (dDIB::*)(DataTransferMode, dImage&);
  EXPECT_EQ(VirtualSlot(&dDIB::Reset), 4U);
  EXPECT_EQ(VirtualSlot(static_cast<bool (dDIB::*)()>(&dDIB::IsValid)), 5U);
  EXPECT_EQ(VirtualSlot(static_cast<IsValid>(&dDIB::IsValid)), 6U);
  EXPECT_EQ(VirtualSlot(static_cast<Take>(&dDIB::Init)), 7U);
}

}  // namespace
