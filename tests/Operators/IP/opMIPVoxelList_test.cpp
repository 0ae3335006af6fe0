// Projecting a list of voxels admits only those that fall outside the slice, and draws none of
// them: whatever the list says, the slice stays as it is.

#include <vorl/Operators/IP/opMIP.h>

#include <gtest/gtest.h>

#include <array>

#include "Scenes.h"
#include "VoxelLists.h"

namespace {

using rasters::GuardedMemory;
using rasters::Random;

TEST(opMIPVoxelList, PacksXInElevenBitsYInElevenAndZInTen) {
  EXPECT_EQ(voxel_lists::Pack(5, 7, 3), 12597253U);
}

// Every voxel of the volume would fall onto a pixel of the slice, and brighter than it.
TEST(opMIPVoxelList, VoxelsThatFallOntoTheSliceAreNotDrawn) {
  dVolume volume;
  rasters::MakeCounting(volume, 3, 2, 2);
  dSlice slice;
  rasters::Make(slice.GetImage(), {.width = 3, .height = 2, .type = ImageDataType_U16});
  slice.GetImage().Fill(0);
  std::vector<std::uint32_t> entries;
  for (std::uint32_t i = 0; i < 12; ++i) {
    entries.push_back(voxel_lists::Pack(i % 3, i / 3 % 2, i / 6));
  }
  dBuffer list = voxel_lists::ListOf(entries);
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  op.voxelList = &list;
  op.SelectAlgo(205);
  EXPECT_TRUE(op.Run());
  EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()), std::vector<std::uint16_t>(6, 0));
}

// Beside the slice in one direction only, or in both.
TEST(opMIPVoxelList, VoxelsThatFallBesideTheSliceAreNotDrawn) {
  dVolume volume;
  rasters::MakeCounting(volume, 3, 3, 1);
  dBuffer list = voxel_lists::ListOf({0, 1, 2, 1 << 11, 2 << 11, (2 << 11) + 2});
  for (int x = -4; x <= 4; ++x) {
    for (int y = -4; y <= 4; ++y) {
      dSlice slice;
      GuardedMemory memory;
      memory.PutUnder(slice.GetImage(),
                      {.width = 2, .height = 2, .type = ImageDataType_U16, .alignment = 8});
      slice.SetPosition(dVect3D(static_cast<float>(x), static_cast<float>(y), 0));
      const rasters::Bytes before = rasters::BytesOf(slice.GetImage());
      opMIP op;
      op.volume = &volume;
      op.mipSlice = &slice;
      op.voxelList = &list;
      op.SelectAlgo(205);
      EXPECT_TRUE(op.Run());
      EXPECT_EQ(rasters::BytesOf(slice.GetImage()), before);
      memory.ExpectSurroundingsUntouched();
    }
  }
}

// Entries that name no voxel, slice indices that read as negative, sizes that are no multiple of
// four, odd addresses, any place of the slice: the memory around slice and list is watched.
template <class T>
void CheckHostileLists(unsigned short type, std::uint32_t seed) {
  Random random(seed);
  for (int i = 0; i < 500; ++i) {
    rasters::GuardedVolume volume;
    rasters::MakeRandomVolume(volume, type, random);
    dSlice slice;
    GuardedMemory memory;
    memory.PutUnder(slice.GetImage(), {.width = rasters::RandomSize(random, 12),
                                       .height = rasters::RandomSize(random, 9),
                                       .type = type,
                                       .alignment = rasters::RandomAlignment(random)});
    rasters::PlacePlane(slice, volume, random);
    SCOPED_TRACE(testing::Message() << "case " << i << ": " << rasters::TextOf(volume, slice));
    voxel_lists::HostileList list(volume, random);
    const rasters::Bytes before = rasters::BytesOf(slice.GetImage());
    opMIP op;
    op.volume = &volume;
    op.mipSlice = &slice;
    op.voxelList = &list.Buffer();
    op.SelectAlgo(205);
    ASSERT_TRUE(op.Run());
    ASSERT_EQ(op.GetProgress(), 1.0);
    ASSERT_EQ(rasters::BytesOf(slice.GetImage()), before);
    ASSERT_NO_FATAL_FAILURE(memory.ExpectSurroundingsUntouched());
    ASSERT_NO_FATAL_FAILURE(list.ExpectUntouched());
    ASSERT_NO_FATAL_FAILURE(volume.ExpectUntouched());
  }
}

TEST(opMIPVoxelList, LeavesUnsignedSlicesUnchanged) {
  CheckHostileLists<std::uint16_t>(ImageDataType_U16, 31);
}

TEST(opMIPVoxelList, LeavesSignedSlicesUnchanged) {
  CheckHostileLists<std::int16_t>(ImageDataType_S16, 32);
}

TEST(opMIPVoxelList, ListsOfFewerThanFourBytesHoldNoEntry) {
  dVolume volume;
  rasters::MakeCounting(volume, 2, 2, 1);
  dSlice slice;
  rasters::MakeSlice(slice, 2, 2);
  for (unsigned long size = 1; size < 4; ++size) {
    dBuffer list(size);
    list.Set(0);
    opMIP op;
    op.volume = &volume;
    op.mipSlice = &slice;
    op.voxelList = &list;
    op.SelectAlgo(205);
    EXPECT_TRUE(op.Run());
    EXPECT_EQ(op.GetProgress(), 1.0);
    EXPECT_EQ(rasters::BytesOf(slice.GetImage()), rasters::Bytes(8, 0x5A));
  }
}

}  // namespace
