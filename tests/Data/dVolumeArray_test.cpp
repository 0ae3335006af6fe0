// The array of slice data pointers, and what copies of a volume do with it.

#include <vorl/Data/dVolume.h>

#include <gtest/gtest.h>

#include <memory>
#include <vector>

#include "ImageTesting.h"
#include "VolumeTesting.h"

namespace {

/// The data pointers of the slices between two guards: the first and the last again.
std::vector<void*> GuardedPointers(dVolume& volume) {
  std::vector<void*> pointers = {volume.GetSlice(0)->GetImage().GetDataPtr()};
  for (int k = 0; k < volume.GetSliceCount(); ++k) {
    pointers.push_back(volume.GetSlice(k)->GetImage().GetDataPtr());
  }
  pointers.push_back(pointers.back());
  return pointers;
}

std::vector<void*> GuardedArray(dVolume& volume) {
  void** array = volume.GetSliceDataArray();
  return std::vector<void*>(array - 1, array + volume.GetSliceCount() + 1);
}

TEST(dVolumeArray, ListsTheSlicesBetweenGuards) {
  dVolume volume;
  for (int count = 1; count <= 5; ++count) {
    AddSlices(volume, 1);
    EXPECT_EQ(GuardedArray(volume), GuardedPointers(volume)) << count;
  }
  dVolume three;
  AddSlices(three, 3);
  void** const a = three.GetSliceDataArray();
  EXPECT_EQ(a[-1], a[0]);
  EXPECT_EQ(a[3], a[2]);
  EXPECT_NE(a[0], a[1]);
  EXPECT_EQ(three.GetSliceDataArray(), a);
}

TEST(dVolumeArray, IsBuiltAnewOnlyWhenTheCountChanges) {
  dVolume volume;
  AddSlices(volume, 3);
  const std::vector<void*> before = GuardedArray(volume);
  dSlice other;
  MakeSlice(other, 4, 3, ImageDataType_U16, 9);
  volume.GetSlice(1)->GetImage() <<= other.GetImage();
  EXPECT_EQ(GuardedArray(volume), before);
  EXPECT_NE(before, GuardedPointers(volume));
  AddSlices(volume, 1);
  EXPECT_EQ(GuardedArray(volume), GuardedPointers(volume));
  volume.GetSliceList().pop_back();
  EXPECT_EQ(GuardedArray(volume), GuardedPointers(volume));
}

TEST(dVolumeArray, IsFreedWithTheLastSlice) {
  dVolume volume;
  AddSlices(volume, 2);
  ASSERT_NE(volume.GetSliceDataArray(), nullptr);
  volume.GetSliceList().clear();
  EXPECT_EQ(volume.GetSliceDataArray(), nullptr);
  AddSlices(volume, 2);
  EXPECT_EQ(GuardedArray(volume), GuardedPointers(volume));
}

void ExpectCopy(dVolume& copy, dVolume& source) {
  ExpectSameCoordinates(copy.GetCoordinates(), source.GetCoordinates());
  ASSERT_EQ(copy.GetSliceCount(), source.GetSliceCount());
  for (int k = 0; k < source.GetSliceCount(); ++k) {
    const dSlice& slice = *copy.GetSlice(k);
    const dSlice& original = *source.GetSlice(k);
    ExpectSameCoordinates(slice.GetCoordinates(), original.GetCoordinates());
    ExpectSameFormat(slice.GetImage(), original.GetImage());
    EXPECT_EQ(BytesOf(slice.GetImage()), BytesOf(original.GetImage()));
    EXPECT_NE(slice.GetImage().GetDataPtr(), original.GetImage().GetDataPtr());
  }
}

TEST(dVolumeArray, ACopyHasSlicesOfItsOwn) {
  dVolume volume;
  AddSlices(volume, 3);
  volume.SetCoordinates(SampleCoordinates());
  dVolume copy(volume);
  ExpectCopy(copy, volume);
  dVolume assigned;
  AddSlices(assigned, 5);
  assigned = volume;
  ExpectCopy(assigned, volume);
  // The array was never asked of the source, so the copies build their own.
  EXPECT_EQ(GuardedArray(copy), GuardedPointers(copy));
  EXPECT_EQ(GuardedArray(assigned), GuardedPointers(assigned));
}

TEST(dVolumeArray, TheArrayOfACopyShowsTheSourceUntilTheCountChanges) {
  dVolume volume;
  AddSlices(volume, 3);
  const std::vector<void*> sourceArray = GuardedArray(volume);
  dVolume copy(volume);
  dVolume assigned;
  assigned = volume;
  for (dVolume* other : {&copy, &assigned}) {
    EXPECT_EQ(GuardedArray(*other), sourceArray);
    EXPECT_NE(other->GetSliceDataArray(), volume.GetSliceDataArray());
    AddSlices(*other, 1);
    EXPECT_EQ(GuardedArray(*other), GuardedPointers(*other));
  }
}

TEST(dVolumeArray, AVolumeAndItsCopyEachFreeTheirArray) {
  auto volume = std::make_unique<dVolume>();
  AddSlices(*volume, 3);
  ASSERT_NE(volume->GetSliceDataArray(), nullptr);
  auto copy = std::make_unique<dVolume>(*volume);
  volume.reset();
  AddSlices(*copy, 1);
  EXPECT_EQ(GuardedArray(*copy), GuardedPointers(*copy));
}

TEST(dVolumeArray, AssigningAVolumeToItselfChangesNothing) {
  dVolume volume;
  AddSlices(volume, 3);
  const std::vector<void*> pointers = GuardedPointers(volume);
  const dVolume& same = volume;
  volume = same;
  EXPECT_EQ(GuardedPointers(volume), pointers);
}

TEST(dVolumeArray, AssigningAnEmptyVolumeEmpties) {
  dVolume volume;
  AddSlices(volume, 3);
  ASSERT_NE(volume.GetSliceDataArray(), nullptr);
  volume = dVolume();
  EXPECT_FALSE(volume.IsValid());
  EXPECT_EQ(volume.GetSliceDataArray(), nullptr);
}

// Slices that refer to pixels elsewhere are replaced, not written through.
TEST(dVolumeArray, AssignmentLeavesReferredPixelsAlone) {
  dImage memory;
  ASSERT_TRUE(memory.Init(4, 3, ImageDataType_U16, "G", 0, 1));
  memory.Fill(100);
  dVolume volume;
  AddSlices(volume, 1);
  volume.GetSlice(0)->GetImage().Init(DTM_Reference, memory);
  dVolume source;
  AddSlices(source, 1);
  volume = source;
  EXPECT_EQ(BytesOf(memory), Bytes(24, 100));
  ExpectCopy(volume, source);
}

TEST(dVolumeArray, AVolumeMayBeAssignedOneThatShowsItsPixels) {
  dVolume volume;
  AddSlices(volume, 1);
  dVolume source;
  AddSlices(source, 1);
  source.GetSlice(0)->GetImage().Init(DTM_Reference, volume.GetSlice(0)->GetImage());
  volume = source;
  EXPECT_EQ(BytesOf(volume.GetSlice(0)->GetImage()), Bytes(24, 1));
  EXPECT_FALSE(volume.GetSlice(0)->GetImage().GetDataBuffer().IsReference());
}

}  // namespace
