#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <string>

#include "../Support/LogRecorder.h"
#include "ImageFile.h"
#include "ImageTesting.h"

namespace {

class dImageIO : public ImageFile {};

TEST_F(dImageIO, WritesItemByItem) {
  dImage image;
  ASSERT_TRUE(image.Init(3, 1, ImageDataType_S16, "YCrCb", ImageDataOrder_Plane, 8));
  FillWithPattern(image, 0xF0);
  image.SetPosition(-2, 258);
  ASSERT_TRUE(image.WriteFile(m_path.c_str(), "Ima"));

  const Bytes expected = {0x42, 0x44, 0x46, 0x00, 'I',  'm',  'a',  0x00,  // magic and type
                          0xF0,                          // the rectangle is a block
                          0x06, 0xFE, 0xFF, 0xFF, 0xFF,  // x
                          0x06, 0x02, 0x01, 0x00, 0x00,  // y
                          0x05, 0x03, 0x00, 0x00, 0x00,  // width
                          0x05, 0x01, 0x00, 0x00, 0x00,  // height
                          0x00,                          // end of the block
                          0x03, 0x10, 0x10,              // data type
                          0x03, 0x01, 0x00,              // data order
                          0x03, 0x08, 0x00,              // row alignment
                          0xE1, 0x06, 0x01, 'Y',  'C',  'r',  'C',  'b',  0x00,  // channel sequence
                          0xE1, 0x18, 0x01,  // three rows of eight bytes
                          0xF0, 0xF7, 0xFE, 0x05, 0x0C, 0x13, 0x1A, 0x21,  //
                          0x28, 0x2F, 0x36, 0x3D, 0x44, 0x4B, 0x52, 0x59,  //
                          0x60, 0x67, 0x6E, 0x75, 0x7C, 0x83, 0x8A, 0x91};
  EXPECT_EQ(Stored(), expected);
}

TEST_F(dImageIO, WritesTheRaisedRowAlignmentAndLongLengths) {
  dImage image;
  ASSERT_TRUE(image.Init(64, 1, ImageDataType_F32, "G", ImageDataOrder_Pixel, 1));
  image.Fill(0x5A);
  ASSERT_TRUE(image.WriteFile(m_path.c_str(), "dImage"));
  ImageItems items;
  items.width = 64;
  items.height = 1;
  items.dataType = 0x2020;
  items.dataOrder = 0;
  items.rowAlignment = 4;
  items.sequence = std::string("G\0", 2);
  items.sequenceLength = 2;
  items.pixels = Bytes(256, 0x5A);
  items.pixelLength = 256;
  EXPECT_EQ(Stored(), items.File());

  ASSERT_TRUE(image.Init(64, 256, ImageDataType_F32, "G", ImageDataOrder_Pixel, 1));
  image.Fill(0x5A);
  ASSERT_TRUE(image.WriteFile(m_path.c_str(), "dImage"));
  items.height = 256;
  items.pixels = Bytes(65536, 0x5A);
  items.pixelLength = 65536;
  EXPECT_EQ(Stored(), items.File());
}

TEST_F(dImageIO, ReadsFormatAndPixelsToPositionZero) {
  ImageItems items;
  items.x = 17;
  items.y = 0xFFFFFFF0;
  for (std::size_t i = 0; i < items.pixels.size(); ++i) {
    items.pixels[i] = static_cast<unsigned char>(3 * i);
  }
  Store(items.File());
  HookedImage image;
  EXPECT_TRUE(image.ReadFile(m_path.c_str(), "dImage"));
  EXPECT_EQ(image.GetWidth(), 3u);
  EXPECT_EQ(image.GetHeight(), 2u);
  EXPECT_EQ(image.GetDataType(), ImageDataType_S16);
  EXPECT_EQ(image.GetDataOrder(), ImageDataOrder_Plane);
  EXPECT_EQ(image.GetRowAlignment(), 8);
  EXPECT_STREQ(image.GetChannelSequence(), "RGB");
  EXPECT_EQ(image.GetNumChannels(), 3);
  EXPECT_EQ(image.GetBytesPerRow(), 8u);
  EXPECT_EQ(image.GetChannelOffset(), 128u);
  EXPECT_EQ(BytesOf(image), items.pixels);
  EXPECT_EQ(image.GetPosX(), 0);
  EXPECT_EQ(image.GetPosY(), 0);
  ExpectStatus(image.GetStatus(), 0, "");
  EXPECT_EQ(image.trail, "RI");
  EXPECT_EQ(image.formatCalls, 1);
}

TEST_F(dImageIO, ReadsIntoPixelsOfTheSameByteSizeInPlace) {
  Store(ImageItems().File());
  dImage image;
  ASSERT_TRUE(image.Init(48, 1, 8, "G", 0, 1));
  const void* const address = image.GetDataPtr();
  EXPECT_TRUE(image.ReadFile(m_path.c_str(), nullptr));
  EXPECT_EQ(image.GetDataPtr(), address);
  EXPECT_EQ(BytesOf(image), Bytes(48, 0x5A));
}

TEST_F(dImageIO, RoundTripsEveryTypeAndOrder) {
  for (const int type :
       {0x01, 0x08, 0x10, 0x20, 0x40, 0x1008, 0x1010, 0x1020, 0x1040, 0x2020, 0x2040}) {
    for (const int order : {0, 1}) {
      SCOPED_TRACE(testing::Message() << "type " << type << " order " << order);
      dImage image;
      ASSERT_TRUE(image.Init(7, 5, static_cast<unsigned short>(type), "BGRA",
                             static_cast<unsigned short>(order), 2));
      FillWithPattern(image);
      ASSERT_TRUE(image.WriteFile(m_path.c_str(), "dImage"));
      const Bytes written = Stored();
      dImage read;
      ASSERT_TRUE(read.ReadFile(m_path.c_str(), "dImage"));
      ExpectSameFormat(read, image);
      EXPECT_EQ(BytesOf(read), BytesOf(image));
      ASSERT_TRUE(read.WriteFile(m_path.c_str(), "dImage"));
      EXPECT_EQ(Stored(), written);
    }
  }
}

TEST_F(dImageIO, NestsInABlock) {
  dImage image;
  ASSERT_TRUE(image.Init(2, 2, 8, "G", 0, 1));
  FillWithPattern(image);
  {
    BinaryDataOut out(m_path.c_str(), "two");
    out.Write(&image);
    out.WriteU8(7);
  }
  BinaryDataIn in(m_path.c_str(), "two");
  dImage read;
  EXPECT_TRUE(in.Read(&read));
  EXPECT_EQ(BytesOf(read), BytesOf(image));
  unsigned char behind = 0;
  in.ReadU8(behind);
  EXPECT_EQ(behind, 7);
}

TEST_F(dImageIO, AnEmptyImageComesBackEmpty) {
  dImage empty;
  ASSERT_TRUE(empty.WriteFile(m_path.c_str(), "dImage"));
  ImageItems items;
  items.width = 0;
  items.height = 0;
  items.dataType = 8;
  items.dataOrder = 0;
  items.rowAlignment = 1;
  items.sequence = std::string(1, '\0');
  items.sequenceLength = 1;
  items.pixels.clear();
  items.pixelLength = 0;
  EXPECT_EQ(Stored(), items.File());

  dImage image;
  ASSERT_TRUE(image.Init(3, 3, 8, "G", 0, 1));
  const LogRecorder log;
  EXPECT_TRUE(image.ReadFile(m_path.c_str(), "dImage"));
  ExpectReset(image);
  ASSERT_EQ(log.errors.size(), 1u);
  EXPECT_EQ(log.errors[0], "dImage::Init: invalid 'ChannelSequence':''");
}

TEST_F(dImageIO, AFormatWithoutPixelsIsReadWhateverTheStatusWas) {
  ImageItems items;
  items.height = 0;
  items.pixels.clear();
  items.pixelLength = 0;
  Store(items.File());
  dImage fresh;
  EXPECT_TRUE(fresh.ReadFile(m_path.c_str(), "dImage"));
  EXPECT_FALSE(fresh.IsValid());
  EXPECT_EQ(fresh.GetWidth(), 3u);
  EXPECT_STREQ(fresh.GetChannelSequence(), "RGB");

  HookedImage image;
  ASSERT_TRUE(image.Init(3, 3, 8, "G", 0, 1));
  ASSERT_FALSE(image.CheckPixelAccess(3, 0, 0));
  EXPECT_TRUE(image.ReadFile(m_path.c_str(), "dImage"));
  EXPECT_FALSE(image.IsValid());
  ExpectStatus(image.GetStatus(), 0, "");
}

TEST_F(dImageIO, AFileThatIsNotOpenedLeavesTheImageAsItWas) {
  Store(ImageItems().File());
  dImage image;
  ASSERT_TRUE(image.Init(2, 2, 8, "G", 0, 1));
  FillWithPattern(image);
  const Bytes pixels = BytesOf(image);
  EXPECT_FALSE(image.ReadFile(m_path.c_str(), "another"));
  EXPECT_FALSE(image.ReadFile((m_path + ".none").c_str(), "dImage"));
  EXPECT_FALSE(image.ReadFile(nullptr, "dImage"));
  EXPECT_FALSE(image.WriteFile((m_folder / "none" / "image").string().c_str(), "dImage"));
  EXPECT_EQ(BytesOf(image), pixels);
  ExpectStatus(image.GetStatus(), 0, "");
}

}  // namespace
