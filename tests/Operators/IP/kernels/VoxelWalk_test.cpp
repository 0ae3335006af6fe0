// The walk through a voxel list: every entry once, in pieces that can be stopped between.

#include <vorl/Operators/IP/kernels/VolumeProjection.h>

#include <gtest/gtest.h>

#include <vector>

namespace {

using vorl_detail::ForEachVoxel;

class VoxelWalk : public testing::Test {
 protected:
  vorl_detail::RunControl Control() { return {m_stopRequested, m_progress, true}; }

  std::atomic<bool> m_stopRequested{false};
  std::atomic<double> m_progress{0.0};
};

TEST_F(VoxelWalk, VisitsEveryEntryOnceInOrder) {
  for (const std::size_t count : {0UL, 1UL, 4095UL, 4096UL, 4097UL, 10000UL}) {
    std::size_t next = 0;
    m_progress = 0.0;
    EXPECT_TRUE(ForEachVoxel(Control(), count, [&](std::size_t i) {
      EXPECT_EQ(i, next);
      ++next;
    }));
    EXPECT_EQ(next, count);
    EXPECT_EQ(m_progress, 1.0);
  }
}

TEST_F(VoxelWalk, ProgressRisesPieceByPiece) {
  std::vector<double> seen;
  ForEachVoxel(Control(), 4 * 4096, [&](std::size_t i) {
    if (i % 4096 == 4095) {
      seen.push_back(m_progress);
    }
  });
  EXPECT_EQ(seen, (std::vector<double>{0.0, 0.25, 0.5, 0.75}));
}

TEST_F(VoxelWalk, StopsAtTheEndOfTheCurrentPiece) {
  std::size_t visited = 0;
  EXPECT_FALSE(ForEachVoxel(Control(), 4 * 4096, [&](std::size_t i) {
    ++visited;
    if (i == 5000) {
      m_stopRequested = true;
    }
  }));
  EXPECT_EQ(visited, 2U * 4096U);
  EXPECT_EQ(m_progress, 0.5);
}

}  // namespace
