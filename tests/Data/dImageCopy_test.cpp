#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"

namespace {

void MakeSource(HookedImage& source) {
  ASSERT_TRUE(source.Init(3, 2, ImageDataType_S16, "RGB", ImageDataOrder_Plane, 8));
  FillWithPattern(source);
  source.SetPosition(11, -12);
  ASSERT_FALSE(source.CheckPixelAccess(3, 0, 0));
}

TEST(dImageCopy, AssignmentCopiesFormatPixelsAndStatusButNotThePosition) {
  HookedImage source;
  MakeSource(source);
  HookedImage image;
  image = static_cast<const dImage&>(source);
  ExpectSameFormat(image, source);
  EXPECT_EQ(BytesOf(image), BytesOf(source));
  EXPECT_NE(image.GetDataPtr(), source.GetDataPtr());
  EXPECT_EQ(image.GetPosX(), 0);
  EXPECT_EQ(image.GetPosY(), 0);
  ExpectStatus(image.GetStatus(), -1, "invalid pixel coordinates: 3/0");
  EXPECT_EQ(image.trail, "RI");
  EXPECT_EQ(image.formatCalls, 1);
}

TEST(dImageCopy, AssignmentOfAnEqualByteSizeOverwritesInPlace) {
  HookedImage source;
  MakeSource(source);
  dImage memory;
  ASSERT_TRUE(memory.Init(48, 1, 8, "G", 0, 1));
  dImage image;
  ASSERT_TRUE(image.Init(DTM_Reference, memory));
  image = source;
  ExpectSameFormat(image, source);
  EXPECT_EQ(image.GetDataPtr(), memory.GetDataPtr());
  EXPECT_EQ(BytesOf(memory), BytesOf(source));
}

TEST(dImageCopy, AssignmentOfAnInvalidImageResets) {
  HookedImage image;
  MakeSource(image);
  image.trail.clear();
  const dImage empty;
  image = empty;
  ExpectReset(image);
  EXPECT_EQ(image.trail, "R");
  ExpectStatus(image.GetStatus(), -1, "invalid pixel coordinates: 3/0");
}

TEST(dImageCopy, AssignmentOfTheImageItselfChangesNothing) {
  HookedImage image;
  MakeSource(image);
  image.trail.clear();
  const Bytes pixels = BytesOf(image);
  const dImage& same = image;
  image = same;
  EXPECT_EQ(BytesOf(image), pixels);
  EXPECT_EQ(image.GetPosX(), 11);
  EXPECT_EQ(image.trail, "");
}

TEST(dImageCopy, AssignmentStopsWhereFormattingFails) {
  HookedImage source;
  MakeSource(source);
  HookedImage image;
  image.failOnInit = true;
  image = static_cast<const dImage&>(source);
  ExpectStatus(image.GetStatus(), -7, "refused");
}

TEST(dImageCopy, AReferenceMayBeAssignedToTheImageWhosePixelsItShows) {
  HookedImage image;
  MakeSource(image);
  const Bytes pixels = BytesOf(image);
  dImage view;
  ASSERT_TRUE(view.Init(DTM_Reference, image));
  image = static_cast<const dImage&>(view);
  EXPECT_EQ(BytesOf(image), pixels);

  // A view of the second plane only: the old pixels end while it is copied.
  dImage plane;
  ASSERT_TRUE(plane.Init(3, 2, ImageDataType_S16, "G", 0, 8));
  plane.GetDataBuffer().Init(image.GetDataPtr(0, 0, 1), 16, DTM_Reference);
  image = static_cast<const dImage&>(plane);
  EXPECT_EQ(BytesOf(image), Bytes(pixels.begin() + 16, pixels.begin() + 32));
  EXPECT_EQ(image.GetNumChannels(), 1);
}

TEST(dImageCopy, TheCopyConstructorAssigns) {
  HookedImage source;
  MakeSource(source);
  const dImage image(source);
  ExpectSameFormat(image, source);
  EXPECT_EQ(BytesOf(image), BytesOf(source));
  EXPECT_NE(image.GetDataPtr(), source.GetDataPtr());
  EXPECT_EQ(image.GetPosX(), 0);
  ExpectStatus(image.GetStatus(), -1, "invalid pixel coordinates: 3/0");
}

TEST(dImageCopy, ACopyOfAReferenceOwnsItsPixels) {
  HookedImage source;
  MakeSource(source);
  dImage view;
  ASSERT_TRUE(view.Init(DTM_Reference, source));
  const dImage image(view);
  EXPECT_FALSE(image.GetDataBuffer().IsReference());
  EXPECT_EQ(BytesOf(image), BytesOf(source));
}

TEST(dImageCopy, ACopyOfAnEmptyImageHasNoMessage) {
  const dImage empty;
  const dImage image(empty);
  ExpectReset(image);
  EXPECT_STREQ(static_cast<const char*>(image.GetStatus()), "");
}

}  // namespace
