#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"

namespace {

/// A source with every field away from its default, a position included.
void MakeSource(HookedImage& source) {
  ASSERT_TRUE(source.Init(3, 2, ImageDataType_S16, "RGB", ImageDataOrder_Plane, 8));
  FillWithPattern(source);
  source.SetPosition(11, -12);
  ASSERT_FALSE(source.CheckPixelAccess(3, 0, 0));
  source.trail.clear();
}

constexpr char kSourceMessage[] = "invalid pixel coordinates: 3/0";

/// The destination has pixels of its own, which end.
void MakeDestination(HookedImage& destination) {
  ASSERT_TRUE(destination.Init(5, 5, ImageDataType_U8, "G", ImageDataOrder_Pixel, 1));
  destination.trail.clear();
}

dImage FormatOfSource() {
  dImage format;
  EXPECT_TRUE(format.Init(3, 2, ImageDataType_S16, "RGB", ImageDataOrder_Plane, 8));
  return format;
}

void ExpectTransferred(const dImage& image, const Bytes& pixels) {
  ExpectSameFormat(image, FormatOfSource());
  EXPECT_EQ(image.GetPosX(), 11);
  EXPECT_EQ(image.GetPosY(), -12);
  EXPECT_EQ(BytesOf(image), pixels);
  ExpectStatus(image.GetStatus(), -1, kSourceMessage);
}

TEST(dImageTransfer, CopyModeGivesPixelsOfItsOwn) {
  HookedImage source;
  MakeSource(source);
  HookedImage image;
  MakeDestination(image);
  const Bytes pixels = BytesOf(source);
  EXPECT_TRUE(image.Init(DTM_Copy, source));
  ExpectTransferred(image, pixels);
  ExpectTransferred(source, pixels);
  EXPECT_NE(image.GetDataPtr(), source.GetDataPtr());
  EXPECT_FALSE(image.GetDataBuffer().IsReference());
  EXPECT_EQ(image.trail, "RI");
  EXPECT_TRUE(image.wasValidAtInit);
  EXPECT_EQ(source.trail, "");
}

TEST(dImageTransfer, TakeOverModeMovesThePixelsAndResetsTheSource) {
  HookedImage source;
  MakeSource(source);
  HookedImage image;
  MakeDestination(image);
  const Bytes pixels = BytesOf(source);
  const void* const address = source.GetDataPtr();
  EXPECT_TRUE(image.Init(DTM_TakeOver, source));
  ExpectTransferred(image, pixels);
  EXPECT_EQ(image.GetDataPtr(), address);
  EXPECT_EQ(image.trail, "RI");
  ExpectReset(source);
  EXPECT_EQ(source.trail, "R");
}

TEST(dImageTransfer, ReferenceModeShowsTheSourcesPixels) {
  HookedImage source;
  MakeSource(source);
  HookedImage image;
  MakeDestination(image);
  const Bytes pixels = BytesOf(source);
  EXPECT_TRUE(image.Init(DTM_Reference, source));
  ExpectTransferred(image, pixels);
  EXPECT_EQ(image.GetDataPtr(), source.GetDataPtr());
  EXPECT_TRUE(image.GetDataBuffer().IsReference());
  EXPECT_EQ(image.trail, "RI");
  EXPECT_EQ(source.trail, "");
  image.Reset();
  EXPECT_EQ(BytesOf(source), pixels);
}

TEST(dImageTransfer, AnotherModeTakesTheFormatWithoutPixels) {
  for (const int mode : {-1, 0, 4}) {
    HookedImage source;
    MakeSource(source);
    HookedImage image;
    MakeDestination(image);
    EXPECT_FALSE(image.Init(static_cast<DataTransferMode>(mode), source));
    ExpectSameFormat(image, FormatOfSource());
    EXPECT_FALSE(image.IsValid());
    EXPECT_EQ(image.trail, "RI");
    EXPECT_TRUE(source.IsValid());
  }
}

TEST(dImageTransfer, AnInvalidSourceGivesAnInvalidImage) {
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    HookedImage source;
    HookedImage image;
    MakeDestination(image);
    const LogRecorder log;
    EXPECT_FALSE(image.Init(mode, source));
    ExpectReset(image);
    EXPECT_EQ(image.trail, "RI");
    ExpectStatus(image.GetStatus(), -1, "not initialized");
    EXPECT_TRUE(log.errors.empty());
  }
}

TEST(dImageTransfer, EveryModeLeavesTheImageItselfUnchanged) {
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    HookedImage image;
    MakeSource(image);
    const Bytes pixels = BytesOf(image);
    const void* const address = image.GetDataPtr();
    EXPECT_TRUE(image.Init(mode, image));
    ExpectTransferred(image, pixels);
    EXPECT_EQ(image.GetDataPtr(), address);
    EXPECT_EQ(image.trail, "");
    HookedImage empty;
    EXPECT_FALSE(empty.Init(mode, empty));
    EXPECT_EQ(empty.trail, "");
  }
}

TEST(dImageTransfer, TheOperatorsMoveAndResetTheGivingSide) {
  HookedImage a;
  MakeDestination(a);
  HookedImage b;
  MakeSource(b);
  const Bytes pixels = BytesOf(b);
  const void* const address = b.GetDataPtr();
  a <<= b;
  ExpectTransferred(a, pixels);
  EXPECT_EQ(a.GetDataPtr(), address);
  EXPECT_EQ(a.trail, "RI");
  ExpectReset(b);
  EXPECT_EQ(b.trail, "R");

  HookedImage c;
  MakeDestination(c);
  a.trail.clear();
  a >>= c;
  ExpectTransferred(c, pixels);
  EXPECT_EQ(c.GetDataPtr(), address);
  EXPECT_EQ(c.trail, "RI");
  ExpectReset(a);
  EXPECT_EQ(a.trail, "R");
}

TEST(dImageTransfer, TheOperatorsMoveAReferenceAsAReference) {
  HookedImage source;
  MakeSource(source);
  dImage view;
  ASSERT_TRUE(view.Init(DTM_Reference, source));
  dImage image;
  image <<= view;
  EXPECT_TRUE(image.GetDataBuffer().IsReference());
  EXPECT_EQ(image.GetDataPtr(), source.GetDataPtr());
  ExpectReset(view);
}

TEST(dImageTransfer, MovingAnImageIntoItselfChangesNothing) {
  HookedImage image;
  MakeSource(image);
  const Bytes pixels = BytesOf(image);
  image <<= image;
  image >>= image;
  ExpectTransferred(image, pixels);
  EXPECT_EQ(image.trail, "");
}

// A reference to an image's pixels may be given back to that image.
TEST(dImageTransfer, TakingAReferenceToTheOwnPixelsCopiesThem) {
  for (const int way : {1, 2, 3, 4}) {
    HookedImage image;
    MakeSource(image);
    const Bytes pixels = BytesOf(image);
    dImage view;
    ASSERT_TRUE(view.Init(DTM_Reference, image));
    if (way == 4) {
      image <<= view;
    } else {
      EXPECT_TRUE(image.Init(static_cast<DataTransferMode>(way), view));
    }
    ExpectTransferred(image, pixels);
    EXPECT_FALSE(image.GetDataBuffer().IsReference());
  }
}

TEST(dImageTransfer, AFailedCopyLeavesTheImageReset) {
  HookedImage source;
  MakeSource(source);
  char byte = 0;
  source.GetDataBuffer().Init(&byte, 0xFFFFFFFFUL, DTM_Reference);
  HookedImage image;
  MakeDestination(image);
  const LogRecorder log;
  EXPECT_FALSE(image.Init(DTM_Copy, source));
  ExpectReset(image);
  EXPECT_EQ(image.trail, "RR");
  ExpectStatus(image.GetStatus(), -1, "no memory(4294967295 bytes required)");
  ASSERT_EQ(log.errors.size(), 2u);
  EXPECT_EQ(log.errors[1], "dImage::Init: no memory(4294967295 bytes required)");
  source.Reset();
}

}  // namespace
