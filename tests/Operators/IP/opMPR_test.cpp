// How reconstruction reads volumes of unusual form. What it refuses is in
// SamplingOperator_test.cpp.

#include <vorl/Operators/IP/opMPR.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <numeric>
#include <vector>

#include "SamplingBench.h"

namespace {

// Rows are taken as far apart as those of slice 0, in every slice.
TEST(opMPR, ReadsASliceWithLongerRowsAtTheFirstSlicesPitch) {
  dVolume volume;
  for (const unsigned short alignment : std::to_array<unsigned short>({2, 32})) {
    dSlice slice;
    dImage& image = slice.GetImage();
    rasters::Make(image,
                  {.width = 2, .height = 2, .type = ImageDataType_U16, .alignment = alignment});
    auto* samples = static_cast<std::uint16_t*>(image.GetDataPtr());
    std::iota(samples, samples + image.GetImageSize() / 2, std::uint16_t{alignment});
    ASSERT_GE(volume.AddSlice(slice), 0);
  }
  sampling_bench::Workbench<sampling_bench::Mpr> bench;
  bench.op.volume = &volume;
  for (const int algo : {101, 102}) {
    bench.op.SelectAlgo(algo);
    bench.slice.SetPosition(dVect3D(0, 0, 0));
    EXPECT_TRUE(bench.op.Run());
    EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(bench.slice.GetImage()),
              (std::vector<std::uint16_t>{2, 3, 4, 5}));
    bench.slice.SetPosition(dVect3D(0, 0, 1));
    EXPECT_TRUE(bench.op.Run());
    EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(bench.slice.GetImage()),
              (std::vector<std::uint16_t>{32, 33, 34, 35}));
  }
}

/// The samples of row 0 of a 1 x 1 x 1 step walk through a volume of `width` x 1 x 1 voxels,
/// each 7.
std::vector<std::uint16_t> RowThrough(unsigned long width, float firstX, unsigned long count) {
  dVolume volume;
  dSlice added;
  EXPECT_TRUE(added.GetImage().Init(width, 1, ImageDataType_U16, "G", 0, 2));
  added.GetImage().GetDataBuffer().Set(static_cast<unsigned short>(7));
  EXPECT_EQ(volume.AddSlice(added), 0);
  dSlice slice;
  EXPECT_TRUE(slice.GetImage().Init(count, 1, ImageDataType_U16, "G", 0, 2));
  slice.SetPosition(dVect3D(firstX, 0, 0));
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  EXPECT_TRUE(op.Run());
  const auto* samples = static_cast<const std::uint16_t*>(slice.GetImage().GetDataPtr());
  return {samples, samples + count};
}

TEST(opMPR, VolumesOf32768VoxelsAndMoreWrapTheirLimits) {
  EXPECT_EQ(RowThrough(32767, 32765, 3), (std::vector<std::uint16_t>{7, 7, 0}));
  EXPECT_EQ(RowThrough(32768, 0, 3), (std::vector<std::uint16_t>{0, 0, 0}));
  EXPECT_EQ(RowThrough(65536 + 5, 3, 4), (std::vector<std::uint16_t>{7, 7, 0, 0}));
}

}  // namespace
