// What becomes of images, volumes and operators when there is no memory left.
#include <gtest/gtest.h>
#include <tests/Support/Allocation.h>
#include <vorl/Data/dDIB.h>
#include <vorl/Data/dVolume.h>
#include <vorl/GUI/vIma2Device.h>
#include <vorl/IO/File/opDIB2Ima.h>
#include <vorl/Operators/IP/opMPR.h>

#include <string>
#include <vector>

#include "../Support/LogRecorder.h"

namespace {

// Long enough not to fit into the text object itself.
const std::string kLongSequence = "Cyan" + std::string(40, 'x');

void MakeSlice(dSlice& slice) {
  ASSERT_TRUE(slice.GetImage().Init(4, 4, ImageDataType_U16, "G", 0, 2));
  slice.GetImage().Fill(7);
}

TEST(DataOutOfMemory, ImageCannotBeFormatted) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U8, "G", 0, 4));
  {
    const AllocationFailure failure;
    EXPECT_FALSE(image.Init(4, 4, ImageDataType_U8, kLongSequence.c_str(), 0, 4));
  }
  EXPECT_FALSE(image.IsValid());
  EXPECT_TRUE(image.GetStatus() == -1);
}

TEST(DataOutOfMemory, ImageThatCannotBeMovedStays) {
  dImage source;
  dImage target;
  ASSERT_TRUE(source.Init(4, 4, ImageDataType_U8, kLongSequence.c_str(), 0, 4));
  {
    const AllocationFailure failure;
    target <<= source;
    EXPECT_FALSE(target.Init(DTM_TakeOver, source));
  }
  EXPECT_TRUE(source.IsValid());
  EXPECT_FALSE(target.IsValid());
  EXPECT_TRUE(target.GetStatus() == -1);
}

TEST(DataOutOfMemory, FactoryGivesNothing) {
  const AllocationFailure failure;
  EXPECT_EQ(dImage::Create(), nullptr);
  EXPECT_EQ(dVolume::Create(), nullptr);
}

TEST(DataOutOfMemory, SliceThatCannotBeAddedKeepsItsPixels) {
  dVolume volume;
  dSlice slice;
  MakeSlice(slice);
  {
    const AllocationFailure failure;
    EXPECT_EQ(volume.AddSlice(slice), -1);
  }
  EXPECT_TRUE(slice.IsValid());
  EXPECT_EQ(volume.GetSliceCount(), 0);
}

TEST(DataOutOfMemory, VolumeThatCannotBeCopiedIsEmpty) {
  dVolume source;
  dVolume target;
  dSlice slice;
  MakeSlice(slice);
  ASSERT_EQ(source.AddSlice(slice), 0);
  MakeSlice(slice);
  ASSERT_EQ(target.AddSlice(slice), 0);
  {
    const AllocationFailure failure;
    target = source;
    EXPECT_EQ(dVolume(source).GetSliceCount(), 0);
  }
  EXPECT_EQ(target.GetSliceCount(), 0);
  EXPECT_EQ(source.GetSliceCount(), 1);
}

TEST(DataOutOfMemory, BitmapCannotBeDescribed) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U8, "G", 0, 4));
  dImaDescriptorDIB descriptor;
  const dImaDescriptorDIB good(image);
  {
    const AllocationFailure failure;
    EXPECT_EQ(descriptor.Init(image), nullptr);
    EXPECT_FALSE(descriptor.IsValid());
    EXPECT_TRUE(descriptor.GetStatus() == -1);
    EXPECT_FALSE(dImaDescriptorDIB(good).IsValid());
  }
}

// Small things find memory: the text, for example.
TEST(DataOutOfMemory, BitmapThatCannotBeDescribedTellsWhy) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U8, "G", 0, 4));
  dImaDescriptorDIB descriptor;
  const dImaDescriptorDIB good(image);
  const char* const text =
      "unable to convert into 'Bitmap':\n\t no memory for 'BITMAPINFO' structure";
  LogRecorder log;
  {
    const LargeAllocationFailure failure(1000);
    EXPECT_EQ(descriptor.Init(image), nullptr);
    EXPECT_STREQ(dImaDescriptorDIB(good).GetStatus(), text);
  }
  EXPECT_STREQ(descriptor.GetStatus(), text);
  ASSERT_EQ(log.errors.size(), 1U);
  EXPECT_EQ(log.errors[0], std::string("dImaDescriptorDIB::Init: ").append(text));
  EXPECT_EQ(descriptor.GetHeader(), nullptr);
}

TEST(DataOutOfMemory, SectionCannotBeCreated) {
  dDIB dib(4, 4, 1, 8);
  {
    const AllocationFailure failure;
#if !defined(_WIN32)  // the system has memory of its own for sections
    EXPECT_FALSE(dib.Init(8, 8, 3, 8));
#endif
    EXPECT_FALSE(dib.Init(8UL, 8UL, ImageDataType_U8, kLongSequence.c_str(), 0, 4));
    EXPECT_EQ(dDIB::Create(), nullptr);
  }
  EXPECT_FALSE(dib.IsValid());
  EXPECT_EQ(dib.GetHandle(), nullptr);
  EXPECT_TRUE(dib.GetStatus() == -1);
  EXPECT_TRUE(dib.Init(8, 8, 3, 8));
}

TEST(DataOutOfMemory, BitmapThatCannotBeDescribedIsNotTaken) {
  dDIB source(4, 4, 1, 8);
  dDIB target;
  dImage image;
  {
    const AllocationFailure failure;
    target <<= source;
    EXPECT_FALSE(target.Init(DTM_Reference, source));
    EXPECT_FALSE(dDIB(source).IsValid());
  }
  EXPECT_TRUE(source.IsValid());
  EXPECT_NE(source.GetHandle(), nullptr);
  EXPECT_FALSE(target.IsValid());
  EXPECT_EQ(target.GetHandle(), nullptr);
}

TEST(DataOutOfMemory, BitmapIsNeitherImportedNorDrawn) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U8, "BGR", 0, 4));
  const tagBITMAPINFO info{{40, 4, 4, 1, 24, 0, 0, 0, 0, 0, 0}, {}};
  const unsigned char bits[48] = {};
  dDIB dib;
  opDIB2Ima op;
  vIma2Device renderer;
  {
    const AllocationFailure failure;
    EXPECT_FALSE(op.Convert(&info, bits, dib));
    EXPECT_FALSE(renderer.Init(&image, nullptr, nullptr, false, false));
  }
  EXPECT_TRUE(op.GetStatus() == -1);
  EXPECT_FALSE(dib.IsValid());
  EXPECT_TRUE(renderer.GetStatus() == -1);
  EXPECT_FALSE(renderer.IsInitialized());
}

TEST(DataOutOfMemory, OperatorFails) {
  dVolume volume;
  dSlice slice;
  MakeSlice(slice);
  ASSERT_EQ(volume.AddSlice(slice), 0);
  MakeSlice(slice);
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  {
    const AllocationFailure failure;
    EXPECT_FALSE(op.Run());
  }
  EXPECT_TRUE(op.GetStatus() == -1);
  EXPECT_STREQ(op.GetStatus(), "out of memory");
  EXPECT_TRUE(op.Run());
}

}  // namespace
