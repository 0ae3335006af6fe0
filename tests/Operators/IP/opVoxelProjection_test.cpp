// Voxel lists drawn in front of the depths.

#include <vorl/Operators/IP/opSliceProjection.h>

#include <gtest/gtest.h>

#include <array>

#include "ProjectionBench.h"
#include "VoxelLists.h"

namespace {

using projection_bench::Drawing;
using voxel_lists::ListOf;
using voxel_lists::Pack;
using Unsigned = std::vector<std::uint16_t>;
using Signed = std::vector<std::int16_t>;
using Depths = std::vector<std::int16_t>;

template <class T>
void SetDepths(Drawing<T>& drawing, const Depths& depths) {
  ASSERT_EQ(drawing.op.zBuffer.GetImageSize(), depths.size() * 2);
  std::memcpy(drawing.op.zBuffer.GetDataPtr(), depths.data(), depths.size() * 2);
}

TEST(opVoxelProjection, VoxelsAreDrawnWhereTheyProject) {
  dVolume volume;
  rasters::MakeCounting(volume, 3, 2, 2);
  Drawing<std::uint16_t> drawing(3, 2);
  dBuffer list = ListOf({Pack(2, 1, 0), Pack(0, 0, 1), Pack(1, 0, 0)});
  drawing.DrawVoxels(volume, list);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{101, 2, 0, 0, 0, 13}));
}

TEST(opVoxelProjection, PixelsBecomeTheLargerOfThemselvesAndTheVoxel) {
  dVolume volume;
  rasters::AddSlice<std::uint16_t>(volume, {.width = 3, .type = ImageDataType_U16}, {5, 6, 7});
  Drawing<std::uint16_t> drawing(3, 1);
  drawing.plane.GetImage().GetDataBuffer().Set(static_cast<unsigned short>(6));
  dBuffer list = ListOf({0, 1, 2});
  drawing.DrawVoxels(volume, list);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{6, 6, 7}));
}

TEST(opVoxelProjection, SignedPixelsBecomeTheLargerToo) {
  dVolume volume;
  rasters::AddSlice<std::int16_t>(volume, {.width = 3, .type = ImageDataType_S16},
                                  {-32768, -4, 32767});
  Drawing<std::int16_t> drawing(3, 1, ImageDataType_S16);
  drawing.plane.GetImage().GetDataBuffer().Set(static_cast<unsigned short>(-5));
  dBuffer list = ListOf({0, 1, 2});
  drawing.DrawVoxels(volume, list);
  EXPECT_EQ(drawing.Pixels(), (Signed{-5, -4, 32767}));
}

TEST(opVoxelProjection, OrderAndRepetitionDoNotMatter) {
  dVolume volume;
  for (const std::uint16_t value : std::to_array<std::uint16_t>({3, 9, 4})) {
    rasters::AddSlice<std::uint16_t>(volume, {.type = ImageDataType_U16}, {value});
  }
  for (const auto& entries : {std::vector{Pack(0, 0, 0), Pack(0, 0, 1), Pack(0, 0, 2)},
                              {Pack(0, 0, 1), Pack(0, 0, 2), Pack(0, 0, 0), Pack(0, 0, 1)}}) {
    Drawing<std::uint16_t> drawing(1, 1);
    dBuffer list = ListOf(entries);
    drawing.DrawVoxels(volume, list);
    EXPECT_EQ(drawing.Pixels(), Unsigned{9});
  }
}

// Each voxel lies at its slice's index; only those strictly in front of the depth are drawn.
TEST(opVoxelProjection, VoxelsAtOrBehindTheDepthAreHiddenAndTheDepthsStay) {
  dVolume volume;
  for (int z = 0; z < 3; ++z) {
    rasters::AddSlice<std::uint16_t>(volume, {.width = 4, .type = ImageDataType_U16}, {7, 7, 7, 7});
  }
  Drawing<std::uint16_t> drawing(4, 1);
  const Depths depths = {0, 1, 2, 3};
  SetDepths(drawing, depths);
  for (std::uint32_t z = 0; z < 3; ++z) {
    drawing.op.ClearProjectionPlane();
    dBuffer list = ListOf({Pack(0, 0, z), Pack(1, 0, z), Pack(2, 0, z), Pack(3, 0, z)});
    drawing.DrawVoxels(volume, list);
    Unsigned expected(4, 0);
    std::fill(expected.begin() + z + 1, expected.end(), std::uint16_t{7});
    EXPECT_EQ(drawing.Pixels(), expected) << "slice " << z;
    EXPECT_EQ(drawing.Depths(), depths);
  }
}

TEST(opVoxelProjection, VoxelsOutsideThePlaneAreSkipped) {
  dVolume volume;
  rasters::MakeCounting(volume, 4, 4, 1);
  Drawing<std::uint16_t> drawing(2, 2);
  drawing.plane.SetPosition(dVect3D(1, 1, 0));
  std::vector<std::uint32_t> entries;
  for (std::uint32_t i = 0; i < 16; ++i) {
    entries.push_back(Pack(i % 4, i / 4, 0));
  }
  dBuffer list = ListOf(entries);
  drawing.DrawVoxels(volume, list);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{12, 13, 22, 23}));
}

// Also those that would fall onto the plane; the entries behind them keep their places.
TEST(opVoxelProjection, EntriesOutsideTheVolumeAreSkipped) {
  dVolume volume;
  rasters::MakeCounting(volume, 2, 2, 1);
  Drawing<std::uint16_t> drawing(4, 4);
  dBuffer list = ListOf({Pack(2, 0, 0), Pack(0, 2, 0), Pack(0, 0, 1), Pack(2047, 2047, 511),
                         Pack(0, 0, 512), Pack(1, 1, 1023), Pack(1, 0, 0)});
  drawing.DrawVoxels(volume, list);
  Unsigned expected(16, 0);
  expected[1] = 2;
  EXPECT_EQ(drawing.Pixels(), expected);
}

// Slice 512 reads as -512, which no volume has, however many slices it has.
TEST(opVoxelProjection, SlicesFrom512OnReadAsNegative) {
  dVolume volume;
  for (int z = 0; z < 514; ++z) {
    rasters::AddSlice<std::uint16_t>(volume, {.type = ImageDataType_U16},
                                     {static_cast<std::uint16_t>(z)});
  }
  Drawing<std::uint16_t> drawing(1, 1);
  dBuffer list = ListOf({Pack(0, 0, 512), Pack(0, 0, 513)});
  drawing.DrawVoxels(volume, list);
  EXPECT_EQ(drawing.Pixels(), Unsigned{0});
  list = ListOf({Pack(0, 0, 511)});
  drawing.DrawVoxels(volume, list);
  EXPECT_EQ(drawing.Pixels(), Unsigned{511});
}

TEST(opVoxelProjection, ListsOfFewerThanFourBytesDrawNothing) {
  dVolume volume;
  rasters::MakeCounting(volume, 1, 1, 1);
  const std::uint32_t entries[2] = {0, 0};
  for (unsigned long size = 0; size <= 4; ++size) {
    Drawing<std::uint16_t> drawing(1, 1);
    dBuffer list(size);
    if (size > 0) {
      std::memcpy(list.Get(0), entries, size);
    }
    drawing.DrawVoxels(volume, list);
    EXPECT_EQ(drawing.Pixels(), Unsigned{static_cast<std::uint16_t>(size < 4 ? 0 : 1)});
    EXPECT_EQ(drawing.op.GetProgress(), 1.0);
  }
}

// The plane's width is the distance of its rows, whatever their padding: planes are kept unpadded.
TEST(opVoxelProjection, RowsOfThePlaneAreTakenAsUnpadded) {
  dVolume volume;
  rasters::MakeCounting(volume, 3, 3, 1);
  Drawing<std::uint16_t> drawing(3, 3);
  rasters::Make(drawing.plane.GetImage(),
                {.width = 3, .height = 3, .type = ImageDataType_U16, .alignment = 8});
  ASSERT_TRUE(drawing.op.InitZBuffer());
  drawing.op.ClearProjectionPlane();
  auto* depths = static_cast<std::int16_t*>(drawing.op.zBuffer.GetDataPtr());
  depths[3] = 0;  // of the first pixel of row 1
  dBuffer list = ListOf({Pack(0, 1, 0), Pack(1, 1, 0), Pack(2, 2, 0)});
  drawing.DrawVoxels(volume, list);
  const auto* pixels = static_cast<const std::uint16_t*>(drawing.plane.GetImage().GetDataPtr());
  EXPECT_EQ(Unsigned(pixels, pixels + 12), (Unsigned{0, 0, 0, 0, 12, 0, 0, 0, 23, 0, 0, 0}));
}

}  // namespace
