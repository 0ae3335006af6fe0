#include <vorl/Data/dImaDescriptorDIB.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "../Support/LogRecorder.h"
#include "BitmapTesting.h"

namespace {

TEST(dImaDescriptorDIB, DescribesAnEightBitImageByItsPaddedRows) {
  dImage image = MakeImage(3, 5, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor;
  const tagBITMAPINFO* block = descriptor.Init(image);
  ASSERT_NE(block, nullptr);
  EXPECT_EQ(block, descriptor.GetHeader());
  const BITMAPINFOHEADER& header = block->bmiHeader;
  EXPECT_EQ(header.biSize, 40U);
  EXPECT_EQ(header.biWidth, 4);
  EXPECT_EQ(header.biHeight, -5);
  EXPECT_EQ(header.biPlanes, 1);
  EXPECT_EQ(header.biBitCount, 8);
  EXPECT_EQ(header.biCompression, 0U);
  EXPECT_EQ(header.biSizeImage, 20U);
  EXPECT_EQ(header.biXPelsPerMeter, 0);
  EXPECT_EQ(header.biYPelsPerMeter, 0);
  EXPECT_EQ(header.biClrUsed, 256U);
  EXPECT_EQ(header.biClrImportant, 256U);
  EXPECT_EQ(descriptor.GetPixelData(), image.GetDataPtr());
  EXPECT_TRUE(descriptor.IsValid());
  EXPECT_EQ(descriptor.GetStatus(), 0);
}

struct Layout {
  const char* name;
  unsigned short dataType;
  const char* sequence;
  int bitCount;
  int paddedWidth;  // of an image 10 pixels wide with rows aligned to 4 bytes
  unsigned paletteSize;
};

class dImaDescriptorDIBLayout : public testing::TestWithParam<Layout> {};

TEST_P(dImaDescriptorDIBLayout, IsAcceptedWithItsBitCountAndColourTable) {
  const Layout& layout = GetParam();
  dImage image = MakeImage(10, 2, layout.dataType, layout.sequence);
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.IsValid());
  const BITMAPINFOHEADER& header = descriptor.GetHeader()->bmiHeader;
  EXPECT_EQ(header.biBitCount, layout.bitCount);
  EXPECT_EQ(header.biWidth, layout.paddedWidth);
  EXPECT_EQ(header.biClrUsed, layout.paletteSize);
  EXPECT_EQ(header.biClrImportant, layout.paletteSize);
  EXPECT_EQ(descriptor.GetPaletteSize(), layout.paletteSize);
  EXPECT_EQ(descriptor.GetPalette() != nullptr, layout.paletteSize != 0);
  EXPECT_EQ(descriptor.ResetPalette(true), layout.paletteSize != 0);
}

INSTANTIATE_TEST_SUITE_P(All, dImaDescriptorDIBLayout,
                         testing::Values(Layout{"OneBit", 1, "K", 1, 32, 2},
                                         Layout{"EightBit", 8, "G", 8, 12, 256},
                                         Layout{"ThreeChannels", 8, "BGR", 24, 10, 0},
                                         Layout{"ThreeChannelsOfAnyName", 8, "YCrCb", 24, 10, 0},
                                         Layout{"FourChannels", 8, "BGRA", 32, 10, 0}),
                         [](const auto& test) { return std::string(test.param.name); });

TEST(dImaDescriptorDIB, ColourTableIsAGreyRamp) {
  dImage image = MakeImage(4, 1, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  const tagRGBQUAD* palette = descriptor.GetPalette();
  ASSERT_NE(palette, nullptr);
  for (int i = 0; i < 256; ++i) {
    EXPECT_EQ(palette[i].rgbBlue, i);
    EXPECT_EQ(palette[i].rgbGreen, i);
    EXPECT_EQ(palette[i].rgbRed, i);
    EXPECT_EQ(palette[i].rgbReserved, 0);
  }
  descriptor.ResetPalette(false);
  for (int i = 0; i < 256; ++i) {
    EXPECT_EQ(palette[i].rgbBlue, 255 - i);
    EXPECT_EQ(palette[i].rgbGreen, 255 - i);
    EXPECT_EQ(palette[i].rgbRed, 255 - i);
    EXPECT_EQ(palette[i].rgbReserved, 0);
  }
}

TEST(dImaDescriptorDIB, OneBitColourTableIsBlackAndWhite) {
  dImage image = MakeImage(4, 1, ImageDataType_U1, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_EQ(descriptor.GetPalette()[0].rgbRed, 0);
  EXPECT_EQ(descriptor.GetPalette()[1].rgbRed, 255);
  descriptor.ResetPalette(false);
  EXPECT_EQ(descriptor.GetPalette()[0].rgbRed, 255);
  EXPECT_EQ(descriptor.GetPalette()[1].rgbRed, 0);
}

TEST(dImaDescriptorDIB, IsRegisteredUnderDataBase) {
  EXPECT_STREQ(dImaDescriptorDIB::CI().name, "dImaDescriptorDIB");
  EXPECT_EQ(dImaDescriptorDIB::CI().parents[0], &DataBase::CI());
  EXPECT_EQ(dImaDescriptorDIB::CI().parents[1], nullptr);
  BaseClass* object = dImaDescriptorDIB::CI().Create();
  ASSERT_NE(object, nullptr);
  EXPECT_STREQ(object->ClassName(), "dImaDescriptorDIB");
  object->Release();
}

TEST(dImaDescriptorDIB, LogsWhyAnImageIsRefused) {
  dImage image;
  dImaDescriptorDIB descriptor;
  LogRecorder log;
  descriptor.Init(image);
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dImaDescriptorDIB::CheckImage: uninitialized image"});
  EXPECT_EQ(log.entries,
            (std::vector<std::string>{"dImaDescriptorDIB::Init", "dImaDescriptorDIB::CheckImage"}));
}

TEST(dImaDescriptorDIB, AssignmentHasAnInformationBlockOfItsOwn) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB source(image);
  dImaDescriptorDIB copy;
  copy = source;
  source.Reset();
  ASSERT_TRUE(copy.IsValid());
  EXPECT_EQ(copy.GetHeader()->bmiHeader.biHeight, -2);
  EXPECT_EQ(copy.GetPixelData(), image.GetDataPtr());
  EXPECT_EQ(copy.GetStatus(), 0);
}

class DescriptorOfNothing : public dImaDescriptorDIB {
 public:
  bool CheckNull() { return CheckImage(nullptr); }
};

TEST(dImaDescriptorDIB, NoImageIsNoBitmap) {
  DescriptorOfNothing descriptor;
  EXPECT_FALSE(descriptor.CheckNull());
  EXPECT_STREQ(descriptor.GetStatus(), "uninitialized image");
}

TEST(dImaDescriptorDIB, RefusesAnImageWithoutPixels) {
  dImage image;
  dImaDescriptorDIB descriptor;
  EXPECT_EQ(descriptor.Init(image), nullptr);
  EXPECT_EQ(descriptor.GetStatus(), -1);
  EXPECT_STREQ(descriptor.GetStatus(), "uninitialized image");
  EXPECT_FALSE(descriptor.IsValid());
}

TEST(dImaDescriptorDIB, RefusesRowsThatAreNotAMultipleOfFourBytes) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G", 1);
  dImaDescriptorDIB descriptor(image);
  EXPECT_STREQ(descriptor.GetStatus(), "image rows are not 4 byte aligned");
  EXPECT_FALSE(descriptor.IsValid());
}

TEST(dImaDescriptorDIB, RowsAreLookedAtBeforeTheLayout) {
  dImage image = MakeImage(3, 2, ImageDataType_U16, "G", 2);
  dImaDescriptorDIB descriptor(image);
  EXPECT_STREQ(descriptor.GetStatus(), "image rows are not 4 byte aligned");
}

TEST(dImaDescriptorDIB, ResetForgetsTheImage) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_TRUE(descriptor.IsCurrent());
  descriptor.Reset();
  EXPECT_FALSE(descriptor.IsValid());
  EXPECT_FALSE(descriptor.IsCurrent());
  EXPECT_EQ(descriptor.GetHeader(), nullptr);
  EXPECT_EQ(descriptor.GetPixelData(), nullptr);
  EXPECT_EQ(descriptor.GetPalette(), nullptr);
  EXPECT_EQ(descriptor.GetPaletteSize(), 0);
  EXPECT_FALSE(descriptor.ResetPalette(true));
  EXPECT_TRUE(image.IsValid());
}

TEST(dImaDescriptorDIB, RefusesOtherLayoutsByName) {
  const auto reasonFor = [](unsigned short type, const char* sequence, unsigned short order) {
    dImage image;
    EXPECT_TRUE(image.Init(4, 2, type, sequence, order, 4));
    dImaDescriptorDIB descriptor(image);
    EXPECT_FALSE(descriptor.IsValid());
    return std::string(static_cast<const char*>(descriptor.GetStatus()));
  };
  EXPECT_EQ(reasonFor(8, "BGR", 1), "not a 'Bitmap' format: 3 x 8 bit - 'BGR' - plane order");
  EXPECT_EQ(reasonFor(8, "RGBA", 0), "not a 'Bitmap' format: 4 x 8 bit - 'RGBA' - pixel order");
  EXPECT_EQ(reasonFor(8, "GA", 0), "not a 'Bitmap' format: 2 x 8 bit - 'GA' - pixel order");
  EXPECT_EQ(reasonFor(16, "G", 0), "not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order");
  EXPECT_EQ(reasonFor(0x1008, "G", 0), "not a 'Bitmap' format: 1 x 4104 bit - 'G' - pixel order");
}

TEST(dImaDescriptorDIB, RefusesRowsOfMorePixelsThanAHeaderCanState) {
  ClaimingImage widest(0x7FFFFFE0, 1, ImageDataType_U1);
  dImaDescriptorDIB descriptor;
  const tagBITMAPINFO* const block = descriptor.Init(widest);
  ASSERT_NE(block, nullptr);
  EXPECT_EQ(block->bmiHeader.biWidth, 0x7FFFFFE0);
  ClaimingImage wider(0x80000000, 1, ImageDataType_U1);
  EXPECT_EQ(descriptor.Init(wider), nullptr);
  EXPECT_STREQ(descriptor.GetStatus(), "not a 'Bitmap' format: 1 x 1 bit - 'G' - pixel order");
}

TEST(dImaDescriptorDIB, KnowsWhenItsImageIsAnother) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_TRUE(descriptor.IsCurrent());
  ASSERT_TRUE(image.Init(2, 2, ImageDataType_U8, "G", ImageDataOrder_Pixel, 4));
  EXPECT_EQ(image.GetDataPtr(), descriptor.GetPixelData()) << "the same pixels, fewer of a row";
  EXPECT_FALSE(descriptor.IsCurrent());
  ASSERT_TRUE(image.Init(3, 2, ImageDataType_U8, "G", ImageDataOrder_Pixel, 4));
  EXPECT_TRUE(descriptor.IsCurrent());
  dImage other = MakeImage(3, 2, ImageDataType_U8, "G");
  image <<= other;
  EXPECT_NE(image.GetDataPtr(), descriptor.GetPixelData());
  EXPECT_FALSE(descriptor.IsCurrent());
}

TEST(dImaDescriptorDIB, BlockThatWasWrittenIntoIsNotCurrent) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G", 32);
  dImaDescriptorDIB descriptor(image);
  const BITMAPINFOHEADER header = descriptor.GetHeader()->bmiHeader;
  BITMAPINFOHEADER& changed = descriptor.GetHeader()->bmiHeader;
  changed.biSize = 108;
  EXPECT_FALSE(descriptor.IsCurrent());
  changed = header;
  changed.biCompression = 1;
  EXPECT_FALSE(descriptor.IsCurrent());
  changed = header;
  changed.biHeight = -1;  // fewer rows
  EXPECT_FALSE(descriptor.IsCurrent());
  changed = header;
  changed.biWidth = 4;  // shorter rows
  EXPECT_FALSE(descriptor.IsCurrent());
  changed = header;
  changed.biBitCount = 4;  // the same rows, of pixels that are others
  changed.biWidth = 64;
  EXPECT_FALSE(descriptor.IsCurrent());
  changed = header;
  changed.biHeight = 2;  // upside down: still the image's rows
  EXPECT_TRUE(descriptor.IsCurrent());
}

TEST(dImaDescriptorDIB, FailedInitForgetsTheImageDescribedBefore) {
  dImage good = MakeImage(4, 2, ImageDataType_U8, "G");
  dImage bad;
  dImaDescriptorDIB descriptor(good);
  EXPECT_EQ(descriptor.Init(bad), nullptr);
  EXPECT_EQ(descriptor.GetHeader(), nullptr);
  EXPECT_EQ(descriptor.GetPixelData(), nullptr);
  EXPECT_EQ(descriptor.GetPalette(), nullptr);
  EXPECT_EQ(descriptor.GetPaletteSize(), 0);
}

TEST(dImaDescriptorDIB, CopyHasAnInformationBlockOfItsOwn) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB source(image);
  dImaDescriptorDIB copy(source);
  EXPECT_NE(copy.GetHeader(), source.GetHeader());
  EXPECT_EQ(copy.GetPixelData(), source.GetPixelData());
  source.Reset();
  EXPECT_FALSE(source.IsValid());
  ASSERT_TRUE(copy.IsValid());
  EXPECT_EQ(copy.GetHeader()->bmiHeader.biHeight, -2);
  EXPECT_EQ(copy.GetPalette()[200].rgbRed, 200);
}

}  // namespace
