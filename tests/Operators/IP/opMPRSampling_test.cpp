// Reconstructions small enough to be checked by hand.

#include <vorl/Operators/IP/opMPR.h>

#include <gtest/gtest.h>

#include <limits>

#include "Volumes.h"

namespace {

using rasters::AddSlice;
using rasters::Format;
using rasters::Make;
using rasters::MakeCounting;
using rasters::MakeSlice;
using rasters::MessageOf;
using rasters::SamplesOf;

constexpr int kTrilinear = MPRAlgo_Trilinear;
constexpr int kNearest = MPRAlgo_Nearest;

struct Options {
  int algo = kNearest;
  int depthSteps = 0;
};

template <class T = std::uint16_t>
std::vector<T> Reconstruct(dVolume& volume, dSlice& slice, Options options = {}) {
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  op.SelectAlgo(options.algo);
  op.SetDepthSteps(options.depthSteps);
  EXPECT_TRUE(op.Run()) << MessageOf(op);
  return SamplesOf<T>(slice.GetImage());
}

/// The value at one point, with a thickness along z.
template <class T = std::uint16_t>
T At(dVolume& volume, const dVect3D& point, Options options = {}, float thickness = 1.0F) {
  dSlice slice;
  MakeSlice(slice, 1, 1, volume.GetDataType());
  slice.SetCoordinates(point, dVect3D(1, 0, 0), dVect3D(0, 1, 0), dVect3D(0, 0, thickness));
  return Reconstruct<T>(volume, slice, options).front();
}

/// A volume of one row in x and y with these voxels along z.
template <class T>
void MakeColumn(dVolume& volume, unsigned short type, const std::vector<T>& voxels) {
  for (const T voxel : voxels) {
    AddSlice<T>(volume, {.type = type}, {voxel});
  }
}

using Samples = std::vector<std::uint16_t>;

TEST(opMPRSampling, TheVolumesOwnPlaneReproducesItsSlices) {
  dVolume volume;
  MakeCounting(volume, 4, 3, 3);
  volume.SetCoordinates(dVect3D(10, -20, 30), dVect3D(0.5F, 0, 0), dVect3D(0, 0.5F, 0),
                        dVect3D(0, 0, 2));
  for (const int algo : {kNearest, kTrilinear}) {
    for (int z = 0; z < 3; ++z) {
      dSlice slice;
      MakeSlice(slice, 4, 3);
      slice.SetCoordinates(volume.GetCoordinates());
      slice.GetPosition().z += 2.0F * static_cast<float>(z);
      EXPECT_EQ(Reconstruct(volume, slice, {algo}),
                SamplesOf<std::uint16_t>(volume.GetSlice(z)->GetImage()));
    }
  }
}

TEST(opMPRSampling, PixelsOutsideTheVolumeAreZero) {
  dVolume volume;
  MakeCounting(volume, 2, 2, 1);
  for (const int algo : {kNearest, kTrilinear}) {
    dSlice slice;
    MakeSlice(slice, 4, 4);
    slice.SetPosition(dVect3D(-1, -1, 0));
    EXPECT_EQ(Reconstruct(volume, slice, {algo}),
              (Samples{0, 0, 0, 0, 0, 1, 2, 0, 0, 11, 12, 0, 0, 0, 0, 0}));
    slice.SetPosition(dVect3D(0, 0, 1));
    EXPECT_EQ(Reconstruct(volume, slice, {algo}), Samples(16, 0));
    slice.SetPosition(dVect3D(0, 0, -0.001F));
    EXPECT_EQ(Reconstruct(volume, slice, {algo}), Samples(16, 0));
  }
}

TEST(opMPRSampling, NearestIsTheVoxelWhoseCellHoldsThePoint) {
  dVolume volume;
  MakeCounting(volume, 3, 3, 3);
  EXPECT_EQ(At(volume, dVect3D(0.999F, 1.0F, 2.0F)), 1 + 0 + 10 + 200);
  EXPECT_EQ(At(volume, dVect3D(2.999F, 0.0F, 2.999F)), 1 + 2 + 0 + 200);
  EXPECT_EQ(At(volume, dVect3D(3.0F, 0.0F, 0.0F)), 0);
  EXPECT_EQ(At(volume, dVect3D(0.0F, 3.0F, 0.0F)), 0);
  EXPECT_EQ(At(volume, dVect3D(0.0F, 0.0F, 3.0F)), 0);
}

TEST(opMPRSampling, AxesMayMirrorSkewAndScale) {
  dVolume volume;
  MakeCounting(volume, 3, 3, 3);
  dSlice slice;
  MakeSlice(slice, 3, 2);
  slice.SetCoordinates(dVect3D(2.5F, 0.5F, 0.5F), dVect3D(-1, 0, 1), dVect3D(0, 2, 0),
                       dVect3D(1, 0, 0));
  EXPECT_EQ(Reconstruct(volume, slice), (Samples{3, 102, 201, 23, 122, 221}));
}

TEST(opMPRSampling, TrilinearWeighsTheUpperNeighbours) {
  dVolume volume;
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 1, .type = ImageDataType_U16}, {0, 100});
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 1, .type = ImageDataType_U16},
                          {200, 1000});
  const Options trilinear = {kTrilinear};
  EXPECT_EQ(At(volume, dVect3D(0.5F, 0, 0), trilinear), 50);
  EXPECT_EQ(At(volume, dVect3D(0, 0, 0.25F), trilinear), 50);
  EXPECT_EQ(At(volume, dVect3D(1.5F, 0, 0.5F), trilinear), 550) << "the last column repeats";
  EXPECT_EQ(At(volume, dVect3D(0, 0.5F, 1.5F), trilinear), 200) << "so do row and slice";
}

TEST(opMPRSampling, TheLowerRowIsWeighedBackwards) {
  dVolume volume;
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 2, .type = ImageDataType_U16},
                          {0, 0, 100, 20});
  // lower = 100 + (100 - 20) / 2 = 140, of which y takes three quarters
  EXPECT_EQ(At(volume, dVect3D(0.5F, 0.75F, 0), {kTrilinear}), 105);
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 2, .type = ImageDataType_U16},
                          {0, 0, 20, 100});
  // above, lower = 20 + (20 - 100) / 2 = -20: 3/4 of it is -15; the result is halfway: 45
  EXPECT_EQ(At(volume, dVect3D(0.5F, 0.75F, 0.5F), {kTrilinear}), 45);
}

TEST(opMPRSampling, ProductsWrapAtThirtyTwoBits) {
  dVolume volume;
  AddSlice<std::uint16_t>(volume, {.width = 2, .height = 1, .type = ImageDataType_U16}, {0, 65535});
  // 65535 * 32768 = 2147450880 still fits; with one step of 1/64 more it is 2214558720, that is
  // -2080408576, and -31745 once shifted: floored.
  EXPECT_EQ(At(volume, dVect3D(0.5F, 0, 0), {kTrilinear}), 32767);
  EXPECT_EQ(At(volume, dVect3D(0.515625F, 0, 0), {kTrilinear}), 0);
}

TEST(opMPRSampling, TrilinearResultsBelowZeroAreStoredAsZero) {
  dVolume volume;
  MakeColumn<std::int16_t>(volume, ImageDataType_S16, {-100, -50, 50, 100});
  const Options trilinear = {kTrilinear};
  EXPECT_EQ(At<std::int16_t>(volume, dVect3D(0, 0, 0.5F), trilinear), 0);
  EXPECT_EQ(At<std::int16_t>(volume, dVect3D(0, 0, 2.5F), trilinear), 75);
  EXPECT_EQ(At<std::int16_t>(volume, dVect3D(0, 0, 0.5F)), -100) << "nearest keeps the sign";
  // Thick: each sample is floored, then averaged: z = 0.5 and 2.5.
  EXPECT_EQ(At<std::int16_t>(volume, dVect3D(0, 0, 1.5F), {kTrilinear, 2}, 2.0F), 37);
}

TEST(opMPRSampling, AHalfVoxelThicknessTakesFirstAndLastSample) {
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {10, 20, 40});
  // z = 0.85 and 1.35; a third sample at 1.1 would give 16
  EXPECT_EQ(At(volume, dVect3D(0, 0, 1.1F), {kNearest, -1}, 0.5F), 15);
  EXPECT_EQ(At(volume, dVect3D(0, 0, 1.1F), {kNearest, 1}, 0.5F), 15) << "1 counts as 2";
  EXPECT_EQ(At(volume, dVect3D(0, 0, 1.1F), {kNearest, 3}, 0.5F), 16);
}

TEST(opMPRSampling, NegativeDepthStepsCountTheVoxelsAcross) {
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {1, 2, 4, 8, 16, 32, 64});
  // A thickness of 3.9 gives three samples: z = 1.55, 3.5, 5.45
  EXPECT_EQ(At(volume, dVect3D(0, 0, 3.5F), {kNearest, -7}, 3.9F), (2 + 8 + 32) / 3);
  EXPECT_EQ(At(volume, dVect3D(0, 0, 3.5F), {kNearest, -7}, -3.9F), (2 + 8 + 32) / 3);
}

TEST(opMPRSampling, TheDominantAxisCounts) {
  dVolume volume;
  MakeCounting(volume, 8, 8, 8);
  dSlice slice;
  MakeSlice(slice, 1, 1);
  slice.SetCoordinates(dVect3D(4.5F, 4.5F, 4.5F), dVect3D(1, 0, 0), dVect3D(0, 0, 1),
                       dVect3D(1.5F, -3.0F, 0.5F));
  // Three samples: (3.75, 6, 4.25), (4.5, 4.5, 4.5), (5.25, 3, 4.75)
  EXPECT_EQ(Reconstruct(volume, slice, {kNearest, -1}), (Samples{(464 + 445 + 436) / 3}));
}

TEST(opMPRSampling, ThickMeansLeaveOutWhatLiesOutside) {
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {10, 21, 40});
  for (const int algo : {kNearest, kTrilinear}) {
    // z = -1, 0, 1
    EXPECT_EQ(At(volume, dVect3D(0, 0, 0), {algo, 3}, 2.0F), (10 + 21) / 2);
    // z = 10 .. 12
    EXPECT_EQ(At(volume, dVect3D(0, 0, 11), {algo, 3}, 2.0F), 0);
  }
}

TEST(opMPRSampling, ThickMeansAreTruncatedTowardsZero) {
  dVolume volume;
  MakeColumn<std::int16_t>(volume, ImageDataType_S16, {-1, -2});
  EXPECT_EQ(At<std::int16_t>(volume, dVect3D(0, 0, 1), {kNearest, 2}, 1.0F), -1);
}

TEST(opMPRSampling, NearestTakesRowsAsTheWidthApartTrilinearAsTheirPitch) {
  dVolume volume;
  dSlice added;
  Make(added.GetImage(), {.width = 2, .height = 2, .type = ImageDataType_U16, .alignment = 8});
  const std::uint16_t pixels[] = {1, 2, 3, 4, 5, 6, 7, 8};
  std::memcpy(added.GetImage().GetDataPtr(), pixels, sizeof pixels);
  ASSERT_EQ(volume.AddSlice(added), 0);
  dSlice slice;
  MakeSlice(slice, 2, 2);
  EXPECT_EQ(Reconstruct(volume, slice), (Samples{1, 2, 3, 4}));
  EXPECT_EQ(Reconstruct(volume, slice, {kTrilinear}), (Samples{1, 2, 5, 6}));
}

TEST(opMPRSampling, ReadsACopiedVolumesOwnPixels) {
  dVolume copy;
  {
    dVolume volume;
    MakeCounting(volume, 2, 1, 2);
    ASSERT_NE(volume.GetSliceDataArray(), nullptr);
    const dVolume second(volume);  // its cached pointers show the source's slices
    copy = second;
  }
  EXPECT_EQ(At(copy, dVect3D(1, 0, 1)), 102);
}

TEST(opMPRSampling, PlanesWithoutAPlaceGiveZeros) {
  const float nan = std::numeric_limits<float>::quiet_NaN();
  const float infinity = std::numeric_limits<float>::infinity();
  dVolume volume;
  MakeCounting(volume, 2, 2, 2);
  for (const Options options : {Options{kNearest, 0}, Options{kTrilinear, 0}, Options{kNearest, 3},
                                Options{kTrilinear, -1}}) {
    for (const float lost : {nan, infinity, -infinity}) {
      dSlice slice;
      MakeSlice(slice, 3, 3);
      slice.GetCoordinates().axisZ = dVect3D(0, 0, lost);
      EXPECT_EQ(Reconstruct(volume, slice, options), Samples(9, 0));
      slice.GetCoordinates().Reset();
      slice.GetCoordinates().axisX = dVect3D(lost, lost, 0);
      EXPECT_EQ(Reconstruct(volume, slice, options), Samples(9, 0));
      slice.GetCoordinates().Reset();
      slice.SetPosition(dVect3D(0, lost, 0));
      EXPECT_EQ(Reconstruct(volume, slice, options), Samples(9, 0));
    }
  }
}

TEST(opMPRSampling, PlanesFarAwayGiveZeros) {
  dVolume volume;
  MakeCounting(volume, 2, 2, 2);
  for (const float far : {40000.0F, -40000.0F, 65536.0F, 1e20F, -1e30F}) {
    dSlice slice;
    MakeSlice(slice, 3, 3);
    slice.SetPosition(dVect3D(0, 0, far));
    EXPECT_EQ(Reconstruct(volume, slice), Samples(9, 0)) << far;
    EXPECT_EQ(Reconstruct(volume, slice, {kTrilinear, 5}), Samples(9, 0)) << far;
  }
}

}  // namespace
