// How many voxels a selection may list.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <limits>

#include "ClassificationBench.h"

namespace {

using classification_bench::Workbench;

constexpr std::uint32_t kLargest = 0xFFFFFFFF;

TEST(opVoxelSelectionLimit, IntegersOfEveryKindAreNumbersOfVoxels) {
  Workbench bench;  // of 12 voxels, so that percentages would show
  opVoxelClassification& op = bench.op;
  op.SetSelectionLimit(11);
  EXPECT_EQ(op.selectionLimit, 11U);
  op.SetSelectionLimit(12L);
  EXPECT_EQ(op.selectionLimit, 12U);
  op.SetSelectionLimit(13U);
  EXPECT_EQ(op.selectionLimit, 13U);
  op.SetSelectionLimit(14UL);
  EXPECT_EQ(op.selectionLimit, 14U);
  op.SetSelectionLimit(16ULL);
  EXPECT_EQ(op.selectionLimit, 16U);
  op.SetSelectionLimit(static_cast<short>(15));
  EXPECT_EQ(op.selectionLimit, 15U);
  op.SetSelectionLimit(std::uint32_t{0xFFFFFFFF});
  EXPECT_EQ(op.selectionLimit, kLargest);
  op.SetSelectionLimit(0);
  EXPECT_EQ(op.selectionLimit, 0U);
}

TEST(opVoxelSelectionLimit, IntegersNeedNoVolume) {
  opVoxelClassification op;
  op.SetSelectionLimit(7);
  EXPECT_EQ(op.selectionLimit, 7U);
}

TEST(opVoxelSelectionLimit, NumbersThatDoNotFitAreAListThatCannotBeHad) {
  Workbench bench;
  bench.Classify(401);
  bench.op.SelectAlgo(403);
  const auto expectRefused = [&] {
    EXPECT_EQ(bench.op.selectionLimit, kLargest);
    EXPECT_FALSE(bench.op.Run());
    EXPECT_EQ(rasters::MessageOf(bench.op), "can't create voxel list[Size: 4294967295]");
    bench.op.SetSelectionLimit(1);
  };
  bench.op.SetSelectionLimit(std::numeric_limits<unsigned long>::max());
  expectRefused();
  if constexpr (sizeof(long) > 4) {
    bench.op.SetSelectionLimit(static_cast<long>(0x100000001LL));
    expectRefused();
    bench.op.SetSelectionLimit(-1);
    expectRefused();
    bench.op.SetSelectionLimit(-5L);
    expectRefused();
  }
}

TEST(opVoxelSelectionLimit, RealNumbersArePercentagesOfTheVolume) {
  dVolume volume;
  rasters::MakeCounting(volume, 100, 100, 10);
  opVoxelClassification op;
  op.volume = &volume;
  op.SetSelectionLimit(10.0);
  EXPECT_EQ(op.selectionLimit, 10000U);
  op.SetSelectionLimit(50.0F);
  EXPECT_EQ(op.selectionLimit, 50000U);
  op.SetSelectionLimit(100.0);
  EXPECT_EQ(op.selectionLimit, 100000U);
  op.SetSelectionLimit(250.0);
  EXPECT_EQ(op.selectionLimit, 250000U);
  op.SetSelectionLimit(0.0);
  EXPECT_EQ(op.selectionLimit, 0U);
}

TEST(opVoxelSelectionLimit, PercentagesAreTruncated) {
  Workbench bench;  // 12 voxels
  bench.op.SetSelectionLimit(24.0);
  EXPECT_EQ(bench.op.selectionLimit, 2U);  // 2.88
  bench.op.SetSelectionLimit(25.0);
  EXPECT_EQ(bench.op.selectionLimit, 3U);
  bench.op.SetSelectionLimit(8.0);
  EXPECT_EQ(bench.op.selectionLimit, 0U);  // 0.96
}

// 0.29 is not exact: 100 of it are less than 29.
TEST(opVoxelSelectionLimit, PercentagesAreDividedBeforeTheyAreMultiplied) {
  dVolume volume;
  rasters::MakeCounting(volume, 10, 10, 1);
  opVoxelClassification op;
  op.volume = &volume;
  op.SetSelectionLimit(29.0);
  EXPECT_EQ(op.selectionLimit, 28U);
}

TEST(opVoxelSelectionLimit, PercentagesWithoutAVolumeHaveNoEffect) {
  opVoxelClassification op;
  op.SetSelectionLimit(7);
  op.SetSelectionLimit(10.0);
  EXPECT_EQ(op.selectionLimit, 7U);
}

TEST(opVoxelSelectionLimit, PercentagesOfAnEmptyVolumeAreNothing) {
  dVolume empty;
  opVoxelClassification op;
  op.volume = &empty;
  op.SetSelectionLimit(7);
  op.SetSelectionLimit(10.0);
  EXPECT_EQ(op.selectionLimit, 0U);
}

TEST(opVoxelSelectionLimit, PercentagesBeyondTheFieldBecomeItsEnds) {
  Workbench bench;
  bench.op.SetSelectionLimit(-10.0);
  EXPECT_EQ(bench.op.selectionLimit, 0U);
  bench.op.SetSelectionLimit(1e300);
  EXPECT_EQ(bench.op.selectionLimit, kLargest);
  bench.op.SetSelectionLimit(std::numeric_limits<double>::infinity());
  EXPECT_EQ(bench.op.selectionLimit, kLargest);
  bench.op.SetSelectionLimit(-std::numeric_limits<double>::infinity());
  EXPECT_EQ(bench.op.selectionLimit, 0U);
}

TEST(opVoxelSelectionLimit, WhatIsNoPercentageHasNoEffect) {
  Workbench bench;
  bench.op.SetSelectionLimit(7);
  bench.op.SetSelectionLimit(std::numeric_limits<double>::quiet_NaN());
  EXPECT_EQ(bench.op.selectionLimit, 7U);
  dVolume empty;
  bench.op.volume = &empty;
  bench.op.SetSelectionLimit(std::numeric_limits<double>::infinity());  // of nothing
  EXPECT_EQ(bench.op.selectionLimit, 7U);
}

// 2^20 x 2^6 x 65 voxels are 2^32 + 2^26. The slices, of one bit per pixel, share one block.
TEST(opVoxelSelectionLimit, NumbersOfVoxelsWrapAtThirtyTwoBits) {
  constexpr unsigned long kBytes = (1UL << 26) / 8;
  std::vector<unsigned char> pixels(kBytes);
  dVolume volume;
  for (int z = 0; z < 65; ++z) {
    dSlice slice;
    rasters::Make(slice.GetImage(),
                  {.width = 1UL << 20, .height = 1UL << 6, .type = ImageDataType_U1});
    slice.GetImage().GetDataBuffer().Init(pixels.data(), kBytes, DTM_Reference);
    ASSERT_EQ(volume.AddSlice(slice), z);
  }
  opVoxelClassification op;
  op.volume = &volume;
  op.SetSelectionLimit(100.0);
  EXPECT_EQ(op.selectionLimit, 1U << 26);
}

}  // namespace
