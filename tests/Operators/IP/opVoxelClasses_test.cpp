// How voxels are counted by class.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <gtest/gtest.h>

#include "ClassificationBench.h"

namespace {

using classification_bench::CountersOf;
using classification_bench::Counts;
using classification_bench::CountsOf;
using classification_bench::Workbench;

TEST(opVoxelClasses, UnsignedValuesAreCounted) {
  Workbench bench(ImageDataType_U16, 3, std::vector<std::uint16_t>{0, 65535, 7, 7, 32768, 0});
  bench.Classify(401);
  EXPECT_EQ(bench.op.classCounters.GetSize(), 65536U * 4U);
  EXPECT_EQ(CountsOf(bench.op), (Counts{{0, 2}, {7, 2}, {32768, 1}, {65535, 1}}));
}

TEST(opVoxelClasses, SignedValuesAreCountedFromTheMiddleOn) {
  Workbench bench(ImageDataType_S16, 3, std::vector<std::int16_t>{0, -1, 7, 32767, -32768, -1});
  bench.Classify(401);
  EXPECT_EQ(bench.op.classCounters.GetSize(), 65536U * 4U);
  EXPECT_EQ(CountsOf(bench.op, 32768), (Counts{{-32768, 1}, {-1, 2}, {0, 1}, {7, 1}, {32767, 1}}));
}

TEST(opVoxelClasses, EverySliceIsCounted) {
  Workbench bench;
  rasters::MakeCounting(bench.volume, 2, 2, 1);  // behind the three marked slices
  bench.Classify(401);
  EXPECT_EQ(CountsOf(bench.op), (Counts{{0x5A5A, 12}, {1, 1}, {2, 1}, {11, 1}, {12, 1}}));
}

TEST(opVoxelClasses, CountingAgainStartsAfresh) {
  Workbench bench(ImageDataType_U16, 2, std::vector<std::uint16_t>{9, 9});
  for (int i = 0; i < 3; ++i) {
    bench.Classify(401);
    EXPECT_EQ(CountsOf(bench.op), (Counts{{9, 2}}));
  }
  bench.Classify(402);
  EXPECT_EQ(CountsOf(bench.op), Counts{});
}

TEST(opVoxelClasses, PaddingIsNotCounted) {
  dVolume volume;
  dSlice slice;
  rasters::Make(slice.GetImage(),
                {.width = 2, .height = 3, .type = ImageDataType_U16, .alignment = 32});
  slice.GetImage().Fill(1);
  for (int y = 0; y < 3; ++y) {
    auto* row = static_cast<std::uint16_t*>(slice.GetImage().GetRowPtr(y));
    row[0] = 5;
    row[1] = static_cast<std::uint16_t>(10 + y);
  }
  volume.AddSlice(slice);
  opVoxelClassification op;
  op.volume = &volume;
  op.SelectAlgo(401);
  EXPECT_TRUE(op.Run());
  EXPECT_EQ(CountsOf(op), (Counts{{5, 3}, {10, 1}, {11, 1}, {12, 1}}));
}

// 9 5    right: 5, below: 8: rises 9 - 5 = 4
// 8 0
TEST(opVoxelClasses, EdgesRiseAboveTheLowerNeighbour) {
  Workbench right(ImageDataType_U16, 2, std::vector<std::uint16_t>{9, 5, 8, 0});
  right.Classify(402);
  EXPECT_EQ(CountsOf(right.op), (Counts{{4, 1}}));
  Workbench below(ImageDataType_U16, 2, std::vector<std::uint16_t>{9, 8, 3, 0});
  below.Classify(402);
  EXPECT_EQ(CountsOf(below.op), (Counts{{6, 1}}));
}

TEST(opVoxelClasses, VoxelsThatDoNotRiseAreCountedAsZero) {
  // 9 against 9 and 9; 0 against 9 and 9, which is below
  Workbench flat(ImageDataType_U16, 2, std::vector<std::uint16_t>{9, 9, 9, 0});
  flat.Classify(402);
  EXPECT_EQ(CountsOf(flat.op), (Counts{{0, 1}}));
  Workbench falling(ImageDataType_U16, 2, std::vector<std::uint16_t>{0, 9, 9, 0});
  falling.Classify(402);
  EXPECT_EQ(CountsOf(falling.op), (Counts{{0, 1}}));
}

TEST(opVoxelClasses, EdgesLookAtTheLowTwelveBitsOnly) {
  // 0x1009 is 9, 0xF005 is 5, 0x4003 is 3
  Workbench bench(ImageDataType_U16, 2, std::vector<std::uint16_t>{0x1009, 0xF005, 0x4003, 0});
  bench.Classify(402);
  EXPECT_EQ(CountsOf(bench.op), (Counts{{6, 1}}));
  // -1 is 0xFFF, -4096 is 0, so an edge is at most 4095
  Workbench negative(ImageDataType_S16, 2, std::vector<std::int16_t>{-1, 100, -4096, 0});
  negative.Classify(402);
  EXPECT_EQ(CountsOf(negative.op), (Counts{{4095, 1}}));
}

// The classes of signed edges start at the first counter, unlike those of signed values.
TEST(opVoxelClasses, EdgesLeaveOutTheLastColumnAndRow) {
  // rows of 8 4 2 1, the next row one higher
  Workbench bench(ImageDataType_S16, 4,
                  std::vector<std::int16_t>{8, 4, 2, 1, 9, 5, 3, 2, 10, 6, 4, 3});
  bench.Classify(402);
  EXPECT_EQ(CountsOf(bench.op), (Counts{{4, 2}, {2, 2}, {1, 2}}));
}

TEST(opVoxelClasses, EdgesAreSoughtInEverySlice) {
  Workbench bench;
  bench.Classify(402);
  EXPECT_EQ(CountsOf(bench.op), (Counts{{0, 3}}));
}

TEST(opVoxelClasses, SingleColumnsAndRowsHaveNoEdges) {
  for (const unsigned long width : {1UL, 6UL}) {
    Workbench bench(ImageDataType_U16, width, std::vector<std::uint16_t>{9, 7, 5, 3, 1, 0});
    bench.Classify(402);
    EXPECT_EQ(CountersOf(bench.op), std::vector<std::uint32_t>(65536, 0));
    EXPECT_EQ(bench.op.classifiedBy, 402);
    EXPECT_EQ(bench.op.GetProgress(), 1.0);
    EXPECT_EQ(bench.Select(10), std::vector<std::uint32_t>{});
  }
}

}  // namespace
