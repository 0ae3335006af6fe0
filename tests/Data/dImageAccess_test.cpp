#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <string>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"

namespace {

TEST(dImageAccess, DataTypeTellsDepthLevelsSignAndFloat) {
  struct Row {
    unsigned short type;
    unsigned short depth;
    unsigned short levels;  // 2 to the depth, the shift modulo 32, the result modulo 65536
    bool isSigned;
    bool isFloat;
  };
  const Row rows[] = {
      {0x0001, 1, 2, false, false},  {0x0008, 8, 256, false, false}, {0x0010, 16, 0, false, false},
      {0x0020, 32, 1, false, false}, {0x0040, 64, 1, false, false},  {0x1008, 8, 256, true, false},
      {0x1010, 16, 0, true, false},  {0x1020, 32, 1, true, false},   {0x1040, 64, 1, true, false},
      {0x2020, 32, 1, true, true},   {0x2040, 64, 1, true, true}};
  for (const Row& row : rows) {
    SCOPED_TRACE(row.type);
    dImage image;
    ASSERT_TRUE(image.Init(2, 2, row.type, "G", 0, 1));
    EXPECT_EQ(image.GetDataType(), row.type);
    EXPECT_EQ(image.GetChannelDepth(), row.depth);
    EXPECT_EQ(image.GetChannelLevels(), row.levels);
    EXPECT_EQ(image.IsSigned(), row.isSigned);
    EXPECT_EQ(image.IsFloat(), row.isFloat);
  }
}

TEST(dImageAccess, OffsetsAreInBits) {
  dImage image;
  ASSERT_TRUE(image.Init(3, 2, ImageDataType_U16, "RGBA", ImageDataOrder_Pixel, 16));
  EXPECT_EQ(image.GetChannelOffset(), 16u);
  EXPECT_EQ(image.GetColumnOffset(), 64u);
  EXPECT_EQ(image.GetRowOffset(), 256u);
  EXPECT_EQ(image.GetBytesPerRow(), 32u);
  EXPECT_EQ(image.GetImageSize(), 64u);
}

TEST(dImageAccess, SampleCountsIncludeThePaddingExceptWithinARow) {
  dImage image;
  ASSERT_TRUE(image.Init(3, 2, ImageDataType_U16, "RGB", ImageDataOrder_Pixel, 8));
  EXPECT_EQ(image.GetBytesPerRow(), 24u);  // 18, padded
  EXPECT_EQ(image.GetNumDataSamples(), 24u);
  EXPECT_EQ(image.GetDataSamplesPerRow(), 12u);
  EXPECT_EQ(image.GetDataSamplesInRow(), 9u);
  EXPECT_EQ(image.GetNumPlanes(), 1u);
  EXPECT_EQ(image.GetNumRows(), 2u);

  ASSERT_TRUE(image.Init(3, 2, ImageDataType_U16, "RGB", ImageDataOrder_Plane, 8));
  EXPECT_EQ(image.GetNumDataSamples(), 24u);  // 3 planes of 2 rows of 8 bytes
  EXPECT_EQ(image.GetDataSamplesPerRow(), 4u);
  EXPECT_EQ(image.GetDataSamplesInRow(), 3u);
  EXPECT_EQ(image.GetNumPlanes(), 3u);
  EXPECT_EQ(image.GetNumRows(), 6u);
}

TEST(dImageAccess, AnEmptyImageHasNoSamples) {
  const dImage image;
  EXPECT_EQ(image.GetNumDataSamples(), 0u);
  EXPECT_EQ(image.GetDataSamplesPerRow(), 0u);
  EXPECT_EQ(image.GetDataSamplesInRow(), 0u);
  EXPECT_EQ(image.GetNumRows(), 0u);
  EXPECT_EQ(image.GetFormatID(), 8u);
}

TEST(dImageAccess, FormatIDKnowsChannelsDepthAndPlanesButNotTheKindOfNumber) {
  dImage image;
  ASSERT_TRUE(image.Init(1, 1, ImageDataType_U8, "RGB", ImageDataOrder_Pixel, 1));
  EXPECT_EQ(image.GetFormatID(), 0x308u);
  ASSERT_TRUE(image.Init(1, 1, ImageDataType_S8, "RGB", ImageDataOrder_Pixel, 1));
  EXPECT_EQ(image.GetFormatID(), 0x308u);
  ASSERT_TRUE(image.Init(1, 1, ImageDataType_F32, "G", ImageDataOrder_Pixel, 1));
  EXPECT_EQ(image.GetFormatID(), 0x120u);
  ASSERT_TRUE(image.Init(1, 1, ImageDataType_S64, "GA", ImageDataOrder_Plane, 1));
  EXPECT_EQ(image.GetFormatID(), 0x10240u);
}

TEST(dImageAccess, PositionMovesTheRectangle) {
  dImage image;
  ASSERT_TRUE(image.Init(3, 2, 8, "G", 0, 1));
  image.SetPosition(-4, 7);
  EXPECT_EQ(image.GetPosX(), -4);
  EXPECT_EQ(image.GetPosY(), 7);
  dRect copy;
  image.GetImaRect(copy);
  EXPECT_EQ(copy, dRect(-4, 7, 3, 2));
  const dImage& constant = image;
  EXPECT_EQ(static_cast<const dRect&>(constant), dRect(-4, 7, 3, 2));
  static_cast<dRect&>(image).Move(1, 1);
  EXPECT_EQ(image.GetPosX(), -3);
  EXPECT_EQ(image.GetWidth(), 3u);
  EXPECT_EQ(image.GetHeight(), 2u);
}

TEST(dImageAccess, PointersFollowRowsPixelsAndChannels) {
  dImage image;
  ASSERT_TRUE(image.Init(3, 2, ImageDataType_U16, "RGB", ImageDataOrder_Pixel, 32));
  auto* const start = static_cast<unsigned char*>(image.GetDataPtr());
  EXPECT_EQ(image.GetDataBuffer().Get(0), start);
  EXPECT_EQ(image.GetRowPtr(1), start + 32);
  EXPECT_EQ(image.GetDataPtr(2, 1), start + 32 + 12);
  EXPECT_EQ(image.GetDataPtr(2, 1, 1), start + 32 + 12 + 2);
  ASSERT_TRUE(image.Init(3, 2, ImageDataType_U16, "RGB", ImageDataOrder_Plane, 32));
  auto* const planes = static_cast<unsigned char*>(image.GetDataPtr());
  EXPECT_EQ(image.GetDataPtr(2, 1, 2), planes + 2 * 64 + 32 + 4);
  EXPECT_EQ(image.GetRowPtr(5), planes + 2 * 64 + 32);  // the last row of the last plane
}

TEST(dImageAccess, PixelsOfOneBitAreAddressedByTheirRow) {
  dImage image;
  ASSERT_TRUE(image.Init(17, 2, ImageDataType_U1, "G", 0, 2));
  EXPECT_EQ(image.GetColumnOffset(), 1u);
  EXPECT_EQ(image.GetBytesPerRow(), 4u);
  EXPECT_EQ(image.GetNumDataSamples(), 64u);
  EXPECT_EQ(image.GetDataPtr(16, 1), image.GetRowPtr(1));
}

TEST(dImageAccess, AnImageWithoutPixelsGivesNullPointers) {
  dImage image;
  EXPECT_EQ(image.GetDataPtr(), nullptr);
  EXPECT_EQ(image.GetDataPtr(1, 2), nullptr);
  EXPECT_EQ(image.GetDataPtr(1, 2, 3), nullptr);
  EXPECT_EQ(image.GetRowPtr(4), nullptr);
}

TEST(dImageAccess, FillSetsEveryByteIncludingThePadding) {
  dImage image;
  EXPECT_FALSE(image.Fill(1));
  ASSERT_TRUE(image.Init(3, 2, 8, "G", 0, 8));
  EXPECT_TRUE(image.Fill(-2));
  EXPECT_EQ(BytesOf(image), Bytes(16, 0xFE));
}

// Validity is asked of the image itself; through the base it is that of the base.
TEST(dImageAccess, IsValidIsTrueWithPixelsOnly) {
  dImage image;
  EXPECT_FALSE(image.IsValid());
  ASSERT_TRUE(image.Init(1, 1, 8, "G", 0, 1));
  EXPECT_TRUE(image.IsValid());
  DataBase& base = image;
  EXPECT_FALSE(base.IsValid());
}

TEST(dImageAccess, CheckPixelAccessTakesWhatIsInside) {
  HookedImage image;
  ASSERT_TRUE(image.Init(3, 2, 8, "RGB", 1, 1));
  const LogRecorder log;
  EXPECT_TRUE(image.CheckPixelAccess(0, 0, 0));
  EXPECT_TRUE(image.CheckPixelAccess(2, 1, 2));
  EXPECT_TRUE(log.errors.empty());
  ExpectStatus(image.GetStatus(), 0, "");
}

TEST(dImageAccess, CheckPixelAccessRefusesWithItsMessages) {
  struct Case {
    int x;
    int y;
    int channel;
    const char* message;
  };
  const Case cases[] = {
      {-1, 0, 0, "invalid pixel coordinates: -1/0"}, {3, 0, 0, "invalid pixel coordinates: 3/0"},
      {0, -1, 0, "invalid pixel coordinates: 0/-1"}, {2, 2, 9, "invalid pixel coordinates: 2/2"},
      {0, 0, -1, "invalid channel index: -1"},       {2, 1, 3, "invalid channel index: 3"}};
  for (const Case& c : cases) {
    SCOPED_TRACE(c.message);
    HookedImage image;
    ASSERT_TRUE(image.Init(3, 2, 8, "RGB", 1, 1));
    const LogRecorder log;
    EXPECT_FALSE(image.CheckPixelAccess(c.x, c.y, c.channel));
    ExpectStatus(image.GetStatus(), -1, c.message);
    ASSERT_EQ(log.errors.size(), 1u);
    EXPECT_EQ(log.errors[0], std::string("dImage::CheckPixelAccess: ") + c.message);
    EXPECT_TRUE(image.IsValid());
  }
  HookedImage empty;
  const LogRecorder log;
  EXPECT_FALSE(empty.CheckPixelAccess(-1, 0, 0));
  ExpectStatus(empty.GetStatus(), -1, "uninitialized image object");
  ASSERT_EQ(log.errors.size(), 1u);
  EXPECT_EQ(log.errors[0], "dImage::CheckPixelAccess: uninitialized image object");
}

}  // namespace
