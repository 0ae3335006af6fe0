// Which samples a projection takes, worked out by hand.

#include <vorl/Operators/IP/opMIP.h>

#include <gtest/gtest.h>

#include <array>

#include "Volumes.h"

namespace {

using rasters::AddSlice;
using rasters::MakeSlice;
using Signed = std::vector<std::int16_t>;
using Unsigned = std::vector<std::uint16_t>;

/// Projects through a slab of this thickness about z = `centre` of a volume in identity
/// coordinates, into one row of pixels.
template <class T>
std::vector<T> Project(dVolume& volume, unsigned long width, float centre, float thickness,
                       int steps, int algo = MIPAlgo_Nearest) {
  dSlice slice;
  MakeSlice(slice, width, 1, volume.GetDataType());
  slice.SetPosition(dVect3D(0, 0, centre));
  slice.GetCoordinates().axisZ = dVect3D(0, 0, thickness);
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  op.SelectAlgo(algo);
  op.SetDepthSteps(steps);
  EXPECT_TRUE(op.Run());
  return rasters::SamplesOf<T>(slice.GetImage());
}

/// One voxel per slice.
template <class T>
void MakeColumn(dVolume& volume, unsigned short type, const std::vector<T>& values) {
  for (const T value : values) {
    AddSlice<T>(volume, {.type = type}, {value});
  }
}

TEST(opMIPSlab, NegativeVoxelsGiveZero) {
  dVolume volume;
  MakeColumn<std::int16_t>(volume, ImageDataType_S16, {-100, -100, -100});
  for (const int algo : {201, 202}) {
    EXPECT_EQ(Project<std::int16_t>(volume, 1, 1.5F, 3, -1, algo), Signed{0});
  }
}

TEST(opMIPSlab, TakesTheLargestAlsoAmongNegativeAndExtremeVoxels) {
  dVolume volume;
  MakeColumn<std::int16_t>(volume, ImageDataType_S16, {-32768, 5, -7, 3});
  EXPECT_EQ(Project<std::int16_t>(volume, 1, 2, 4, 9), Signed{5});
  dVolume largest;
  MakeColumn<std::int16_t>(largest, ImageDataType_S16, {-1, 32767, 0});
  EXPECT_EQ(Project<std::int16_t>(largest, 1, 1.5F, 3, 9), Signed{32767});
  dVolume large;
  MakeColumn<std::uint16_t>(large, ImageDataType_U16, {1, 65535, 32768});
  EXPECT_EQ(Project<std::uint16_t>(large, 1, 1.5F, 3, 9), Unsigned{65535});
}

TEST(opMIPSlab, PixelsWithoutASampleInsideAreZero) {
  dVolume volume;
  AddSlice<std::uint16_t>(volume, {.width = 2, .type = ImageDataType_U16}, {7, 8});
  EXPECT_EQ(Project<std::uint16_t>(volume, 4, 0.5F, 1, 2), (Unsigned{7, 8, 0, 0}));
  EXPECT_EQ(Project<std::uint16_t>(volume, 4, 20, 1, 2), (Unsigned{0, 0, 0, 0}));
  EXPECT_EQ(Project<std::uint16_t>(volume, 4, -20, 1, 2), (Unsigned{0, 0, 0, 0}));
}

class opMIPSlabSteps : public testing::Test {
 protected:
  // Which of eight slices are sampled: one after the other is made the brightest.
  std::vector<int> SampledSlices(int steps, float centre, float thickness) {
    std::vector<int> sampled;
    for (int bright = 0; bright < 8; ++bright) {
      dVolume volume;
      std::vector<std::uint16_t> values(8, 1);
      values[static_cast<std::size_t>(bright)] = 9;
      MakeColumn(volume, ImageDataType_U16, values);
      if (Project<std::uint16_t>(volume, 1, centre, thickness, steps) == Unsigned{9}) {
        sampled.push_back(bright);
      }
    }
    return sampled;
  }
};

TEST_F(opMIPSlabSteps, FewerThanTwoAreRaisedToTwo) {
  const std::vector<int> ends = {0, 4};
  EXPECT_EQ(SampledSlices(0, 2, 4), ends);
  EXPECT_EQ(SampledSlices(1, 2, 4), ends);
  EXPECT_EQ(SampledSlices(2, 2, 4), ends);
}

TEST_F(opMIPSlabSteps, FiveSpanExactlyOneThickness) {
  EXPECT_EQ(SampledSlices(5, 2, 4), (std::vector<int>{0, 1, 2, 3, 4}));
  EXPECT_EQ(SampledSlices(5, 4, 4), (std::vector<int>{2, 3, 4, 5, 6}));
  EXPECT_EQ(SampledSlices(3, 2, 4), (std::vector<int>{0, 2, 4}));
}

TEST_F(opMIPSlabSteps, NegativeTakesOnePerVoxelOfTheThickness) {
  // Four voxels across: samples at 0, 4/3, 8/3 and 4 (less what truncation takes off).
  EXPECT_EQ(SampledSlices(-1, 2, 4), (std::vector<int>{0, 1, 2, 3}));
  EXPECT_EQ(SampledSlices(-9, 2, 4), (std::vector<int>{0, 1, 2, 3}));
  // Half a voxel across: two samples.
  EXPECT_EQ(SampledSlices(-1, 3, 0.5F), (std::vector<int>{2, 3}));
}

TEST_F(opMIPSlabSteps, MirroredNormalTakesTheSlabFromTheOtherSide) {
  EXPECT_EQ(SampledSlices(3, 2, -4), (std::vector<int>{0, 2, 4}));
}

TEST(opMIPSlab, TrilinearSamplesLieBetweenTheVoxels) {
  dVolume volume;
  AddSlice<std::uint16_t>(volume, {.width = 2, .type = ImageDataType_U16}, {100, 300});
  AddSlice<std::uint16_t>(volume, {.width = 2, .type = ImageDataType_U16}, {200, 0});
  // Samples at z = 0.25 and 0.75: 125 and 175; 225 and 75.
  EXPECT_EQ(Project<std::uint16_t>(volume, 2, 0.5F, 0.5F, 2, 202), (Unsigned{175, 225}));
  EXPECT_EQ(Project<std::uint16_t>(volume, 2, 0.5F, 0.5F, 2, 201), (Unsigned{100, 300}));
}

// Half-way, the upper row gives 0, the lower one 0 + (0 - 65535) / 2: their mean lies below 0.
TEST(opMIPSlab, NegativeInterpolationsAreZero) {
  dVolume volume;
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 2, .type = ImageDataType_U16},
                          {0, 0, 0, 65535});
  dSlice slice;
  MakeSlice(slice, 1, 1);
  slice.SetPosition(dVect3D(0.5F, 0.5F, 0.5F));
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  op.SelectAlgo(202);
  ASSERT_TRUE(op.Run());
  EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()), Unsigned{0});
}

// An interpolated value may leave the type: it is compared whole and cut when it is stored.
// Half-way, the upper row gives 65535, the lower one 65535 + (65535 - 0) / 2 = 98302; of their
// mean, 81918, 16 bits are kept. The other end of the slab has 20000.
TEST(opMIPSlab, ValuesBeyondTheTypeAreCutWhenStored) {
  dVolume volume;
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 2, .type = ImageDataType_U16},
                          {65535, 65535, 65535, 0});
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 2, .type = ImageDataType_U16},
                          {20000, 20000, 20000, 20000});
  dSlice slice;
  MakeSlice(slice, 1, 1);
  slice.SetPosition(dVect3D(0.5F, 0.5F, 0.5F));
  slice.GetCoordinates().axisZ = dVect3D(0, 0, 1);
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  op.SelectAlgo(202);
  ASSERT_TRUE(op.Run());
  EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()), Unsigned{81918 - 65536});
}

TEST(opMIPSlab, VolumesOf32768VoxelsAndMoreWrapTheirLimits) {
  const auto row = [](unsigned long width, float first) {
    dVolume volume;
    AddSlice(volume, {.width = width, .type = ImageDataType_U16}, Unsigned(width, 7));
    dSlice slice;
    MakeSlice(slice, 3, 1);
    slice.SetPosition(dVect3D(first, 0, 0.5F));
    opMIP op;
    op.volume = &volume;
    op.mipSlice = &slice;
    EXPECT_TRUE(op.Run());
    return rasters::SamplesOf<std::uint16_t>(slice.GetImage());
  };
  EXPECT_EQ(row(32767, 32765), (Unsigned{7, 7, 0}));
  EXPECT_EQ(row(32768, 0), (Unsigned{0, 0, 0}));
  EXPECT_EQ(row(65536 + 5, 3), (Unsigned{7, 7, 0}));
}

TEST(opMIPSlab, EveryPixelOfThePlaneIsWritten) {
  dVolume volume;
  rasters::MakeCounting(volume, 3, 2, 2);
  dSlice slice;
  MakeSlice(slice, 4, 3);
  slice.SetPosition(dVect3D(0, 0, 1));
  slice.GetCoordinates().axisZ = dVect3D(0, 0, 1);
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  ASSERT_TRUE(op.Run());
  EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()),
            (Unsigned{101, 102, 103, 0, 111, 112, 113, 0, 0, 0, 0, 0}));
}

}  // namespace
