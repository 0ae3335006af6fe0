// The part of a volume that a pass looks at: regions, and what edges leave out.

#include <vorl/Operators/IP/kernels/VoxelClasses.h>

#include <gtest/gtest.h>

#include <array>

#include "../Volumes.h"
#include "../VoxelLists.h"

namespace {

using vorl_detail::VoxelBox;
using Entries = std::vector<std::uint32_t>;

/// The voxels that are visited, in their order.
Entries Visited(const dVolume& volume, const dVOI* region, std::uint32_t neighbours) {
  Entries entries;
  const std::atomic<bool> stopRequested{false};
  std::atomic<double> progress{0.0};
  const auto visit = [&](const vorl_detail::VoxelRow<std::uint16_t>& row) {
    for (std::uint32_t x = row.firstX; x < row.endX; ++x) {
      entries.push_back(voxel_lists::Pack(x, row.y, row.z));
      // A counting volume says itself where a voxel lies.
      EXPECT_EQ(row.voxels[x], 1 + x + 10 * row.y + 100 * row.z);
      if (neighbours != 0) {
        EXPECT_EQ(row.voxels[x + 1], row.voxels[x] + 1);
        EXPECT_EQ(row.below[x], row.voxels[x] + 10);
      }
    }
  };
  EXPECT_TRUE(vorl_detail::ForEachVoxelRow<std::uint16_t>(
      {stopRequested, progress, true}, volume, VoxelBox(volume, region, neighbours), visit));
  EXPECT_EQ(progress, 1.0);
  return entries;
}

/// The voxels of a volume of 4 x 3 x 3 that lie in a region, less those whose neighbours do not lie
/// in the volume.
Entries Expected(const dVOI& region, bool needsNeighbours) {
  Entries entries;
  const auto isIn = [](std::uint64_t i, std::uint64_t first, std::uint64_t size) {
    return i >= first && i < first + size;
  };
  for (std::uint32_t z = 0; z < 3; ++z) {
    for (std::uint32_t y = 0; y < 3; ++y) {
      for (std::uint32_t x = 0; x < 4; ++x) {
        const bool hasNeighbours = x + 1 < 4 && y + 1 < 3;
        if (isIn(x, region.firstX, region.sizeX) && isIn(y, region.firstY, region.sizeY) &&
            isIn(z, region.firstZ, region.sizeZ) && (hasNeighbours || !needsNeighbours)) {
          entries.push_back(voxel_lists::Pack(x, y, z));
        }
      }
    }
  }
  return entries;
}

class VoxelClasses : public testing::Test {
 protected:
  void SetUp() override { rasters::MakeCounting(m_volume, 4, 3, 3); }
  dVolume m_volume;
};

TEST_F(VoxelClasses, WithoutARegionTheWholeVolumeIsVisited) {
  EXPECT_EQ(Visited(m_volume, nullptr, 0), Expected({0, 0, 0, 4, 3, 3}, false));
  EXPECT_EQ(Visited(m_volume, nullptr, 1), Expected({0, 0, 0, 4, 3, 3}, true));
}

// A region that ends before the last column or row has all its neighbours.
TEST_F(VoxelClasses, RegionsThatReachTheLastColumnOrRowLeaveItOut) {
  const dVOI inner = {1, 0, 1, 2, 2, 2};
  EXPECT_EQ(Visited(m_volume, &inner, 1).size(), 8U);
  const dVOI toLastColumn = {1, 0, 1, 3, 2, 2};
  EXPECT_EQ(Visited(m_volume, &toLastColumn, 1), Visited(m_volume, &inner, 1));
  const dVOI toLastRow = {1, 0, 1, 2, 3, 2};
  EXPECT_EQ(Visited(m_volume, &toLastRow, 1), Visited(m_volume, &inner, 1));
  EXPECT_EQ(Visited(m_volume, &toLastRow, 0).size(), 12U);
}

TEST_F(VoxelClasses, EveryRegionIsCutToTheVolume) {
  constexpr std::array<std::uint32_t, 6> kFirst = {0, 1, 2, 3, 4, 0xFFFFFFFF};
  constexpr std::array<std::uint32_t, 5> kSize = {0, 1, 2, 4, 0xFFFFFFFF};
  rasters::Random random(61);
  for (int i = 0; i < 1000; ++i) {
    const auto first = [&] { return random.Pick(kFirst); };
    const auto size = [&] { return random.Pick(kSize); };
    const dVOI region = {first(), first(), first(), size(), size(), size()};
    EXPECT_EQ(Visited(m_volume, &region, 0), Expected(region, false));
    EXPECT_EQ(Visited(m_volume, &region, 1), Expected(region, true));
  }
}

TEST_F(VoxelClasses, StopRequestsEndBeforeTheNextRow) {
  std::atomic<bool> stopRequested{false};
  std::atomic<double> progress{0.0};
  int rows = 0;
  const auto visit = [&](const vorl_detail::VoxelRow<std::uint16_t>&) {
    stopRequested = ++rows == 2;
  };
  EXPECT_FALSE(vorl_detail::ForEachVoxelRow<std::uint16_t>(
      {stopRequested, progress, true}, m_volume, VoxelBox(m_volume, nullptr, 0), visit));
  EXPECT_EQ(rows, 2);
  EXPECT_EQ(progress, 2.0 / 9.0);
}

}  // namespace
