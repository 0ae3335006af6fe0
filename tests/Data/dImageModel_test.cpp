#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"

namespace {

/// 5 x 4 pixels of three 16-bit signed planes, rows of 16 bytes.
void FormatModel(dImage& model) {
  ASSERT_TRUE(model.Init(5, 4, ImageDataType_S16, "YCrCb", ImageDataOrder_Plane, 16));
  FillWithPattern(model);
  model.SetPosition(8, 9);
}

TEST(dImageModel, ZerosAreTakenFromTheModel) {
  dImage model;
  FormatModel(model);
  HookedImage image;
  EXPECT_TRUE(image.Init(model, 0, 0, 0));
  ExpectSameFormat(image, model);
  EXPECT_EQ(image.GetImageSize(), 4u * 16 * 3);
  EXPECT_EQ(image.GetPosX(), 0);
  EXPECT_EQ(image.GetPosY(), 0);
  EXPECT_EQ(image.trail, "RI");
  EXPECT_EQ(image.formatCalls, 1);
}

TEST(dImageModel, GivenSizesAndTypeReplaceTheModels) {
  dImage model;
  FormatModel(model);
  dImage image;
  EXPECT_TRUE(image.Init(model, 7, 0, 0));
  EXPECT_EQ(image.GetWidth(), 7u);
  EXPECT_EQ(image.GetHeight(), 4u);
  EXPECT_EQ(image.GetDataType(), ImageDataType_S16);
  EXPECT_TRUE(image.Init(model, 0, 2, 0));
  EXPECT_EQ(image.GetWidth(), 5u);
  EXPECT_EQ(image.GetHeight(), 2u);
  EXPECT_TRUE(image.Init(model, 0, 0, ImageDataType_U8));
  EXPECT_EQ(image.GetDataType(), ImageDataType_U8);
  EXPECT_STREQ(image.GetChannelSequence(), "YCrCb");
  EXPECT_EQ(image.GetDataOrder(), ImageDataOrder_Plane);
  EXPECT_EQ(image.GetRowAlignment(), 16);
}

TEST(dImageModel, PixelsAreNotCopied) {
  dImage model;
  FormatModel(model);
  dImage image;
  ASSERT_TRUE(image.Init(model, 0, 0, 0));
  image.Fill(77);
  ASSERT_TRUE(image.Init(model, 0, 0, 0));
  EXPECT_EQ(BytesOf(image), Bytes(image.GetImageSize(), 77));
  EXPECT_NE(image.GetDataPtr(), model.GetDataPtr());
}

TEST(dImageModel, FailsLikeTheFormatItAsksFor) {
  const dImage empty;
  HookedImage image;
  ASSERT_TRUE(image.Init(2, 2, 8, "G", 0, 1));
  const LogRecorder log;
  EXPECT_FALSE(image.Init(empty, 2, 2, 8));
  ExpectReset(image);
  ExpectStatus(image.GetStatus(), -1, "invalid 'ChannelSequence':''");
  dImage model;
  FormatModel(model);
  EXPECT_FALSE(image.Init(model, 0, 0, 9));
  ExpectStatus(image.GetStatus(), -1, "invalid 'DataType': 9");
  ASSERT_EQ(log.errors.size(), 2u);
  EXPECT_EQ(log.errors[0], "dImage::Init: invalid 'ChannelSequence':''");
  EXPECT_EQ(log.errors[1], "dImage::Init: invalid 'DataType': 9");
}

TEST(dImageModel, ReturnsTheStatusThatOnInitLeaves) {
  dImage model;
  FormatModel(model);
  HookedImage image;
  image.failOnInit = true;
  EXPECT_FALSE(image.Init(model, 0, 0, 0));
  ExpectStatus(image.GetStatus(), -7, "refused");
}

TEST(dImageModel, AnImageMayBeItsOwnModel) {
  dImage image;
  FormatModel(image);
  const Bytes contents = BytesOf(image);
  EXPECT_TRUE(image.Init(image, 0, 0, 0));
  EXPECT_EQ(BytesOf(image), contents);
  EXPECT_TRUE(image.Init(image, 9, 3, ImageDataType_F32));
  EXPECT_EQ(image.GetImageSize(), 3u * 48 * 3);
  EXPECT_STREQ(image.GetChannelSequence(), "YCrCb");
}

}  // namespace
