// The volume drawn in front of the depths, worked out by hand.

#include <vorl/Operators/IP/opSliceProjection.h>

#include <gtest/gtest.h>

#include <array>
#include <limits>

#include "ProjectionBench.h"

namespace {

using projection_bench::Drawing;
using Unsigned = std::vector<std::uint16_t>;
using Signed = std::vector<std::int16_t>;
using Depths = std::vector<std::int16_t>;

template <class T>
void MakeColumn(dVolume& volume, unsigned short type, const std::vector<T>& values) {
  for (const T value : values) {
    rasters::AddSlice<T>(volume, {.type = type}, {value});
  }
}

template <class T>
void SetDepths(Drawing<T>& drawing, std::int16_t depth) {
  auto* depths = static_cast<std::int16_t*>(drawing.op.zBuffer.GetDataPtr());
  std::fill_n(depths, drawing.op.zBuffer.GetNumDataSamples(), depth);
}

/// Which of six slices, 0 to 6 along z, are seen by a plane at z = `position` with this thickness
/// and depth: one after the other is made the brightest.
std::vector<int> SeenSlices(float position, float thickness, std::int16_t depth) {
  std::vector<int> seen;
  for (int bright = 0; bright < 6; ++bright) {
    dVolume volume;
    Unsigned values(6, 1);
    values[static_cast<std::size_t>(bright)] = 9;
    MakeColumn(volume, ImageDataType_U16, values);
    Drawing<std::uint16_t> drawing(1, 1);
    drawing.plane.SetPosition(dVect3D(0, 0, position));
    drawing.plane.GetCoordinates().axisZ = dVect3D(0, 0, thickness);
    SetDepths(drawing, depth);
    drawing.DrawVolume(volume);
    EXPECT_EQ(drawing.Depths(), Depths{depth});
    if (drawing.Pixels() == Unsigned{9}) {
      seen.push_back(bright);
    }
  }
  return seen;
}

// A plane at 3.5 takes its first sample, step 0, at 3, half a thickness behind.
TEST(opBackProjection, FarthestDepthCoversTheWholeRayInTheBox) {
  EXPECT_EQ(SeenSlices(3.5F, 1, 32767), (std::vector<int>{0, 1, 2, 3, 4, 5}));
}

TEST(opBackProjection, DepthZeroCoversTheStepsBelowZero) {
  EXPECT_EQ(SeenSlices(3.5F, 1, 0), (std::vector<int>{0, 1, 2}));
}

TEST(opBackProjection, RaysEndBeforeTheDepth) {
  EXPECT_EQ(SeenSlices(3.5F, 1, 1), (std::vector<int>{0, 1, 2, 3}));
  EXPECT_EQ(SeenSlices(3.5F, 1, -2), (std::vector<int>{0}));
  EXPECT_EQ(SeenSlices(3.5F, 1, -3), std::vector<int>{});
  EXPECT_EQ(SeenSlices(3.5F, 1, -32768), std::vector<int>{});
}

TEST(opBackProjection, StepsAreWholeThicknesses) {
  EXPECT_EQ(SeenSlices(1, 2, 32767), (std::vector<int>{0, 2, 4}));
  EXPECT_EQ(SeenSlices(0.5F, 0.25F, 32767), (std::vector<int>{0, 1, 2, 3, 4, 5}));
}

TEST(opBackProjection, MirroredNormalsSeeFromTheOtherSide) {
  // Step 0 at 3.5, step t at 3.5 - t.
  EXPECT_EQ(SeenSlices(3, -1, 0), (std::vector<int>{4, 5}));
  EXPECT_EQ(SeenSlices(3, -1, 2), (std::vector<int>{2, 3, 4, 5}));
}

// With 3.5 steps from the first sample to the far end, three are whole and the last of them ends
// the ray: what lies at it is not seen.
TEST(opBackProjection, RaysEndBeforeTheirLastWholeStep) {
  EXPECT_EQ(SeenSlices(3, 1, 32767), (std::vector<int>{0, 1, 2, 3, 4}));
}

TEST(opBackProjection, BrighterDrawingsStay) {
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {20, 30, 10});
  for (const auto& [before, after] : {std::pair(29, 30), {30, 30}, {31, 31}, {65535, 65535}}) {
    Drawing<std::uint16_t> drawing(1, 1);
    drawing.plane.GetImage().GetDataBuffer().Set(static_cast<unsigned short>(before));
    drawing.plane.SetPosition(dVect3D(0, 0, 0.5F));
    drawing.DrawVolume(volume);
    EXPECT_EQ(drawing.Pixels(), Unsigned{static_cast<std::uint16_t>(after)});
  }
}

TEST(opBackProjection, NegativeValuesAreNotFloored) {
  dVolume volume;
  MakeColumn<std::int16_t>(volume, ImageDataType_S16, {-32768, -3, -7});
  for (const auto& [before, after] : {std::pair(-5, -3), {-2, -2}, {-32768, -3}, {0, 0}}) {
    Drawing<std::int16_t> drawing(1, 1, ImageDataType_S16);
    drawing.plane.GetImage().GetDataBuffer().Set(static_cast<unsigned short>(before));
    drawing.plane.SetPosition(dVect3D(0, 0, 0.5F));
    drawing.DrawVolume(volume);
    EXPECT_EQ(drawing.Pixels(), Signed{static_cast<std::int16_t>(after)});
  }
}

TEST(opBackProjection, RaysBesideTheVolumeLeaveThePlane) {
  dVolume volume;
  rasters::MakeCounting(volume, 2, 2, 2);
  Drawing<std::uint16_t> drawing(4, 4);
  drawing.plane.SetPosition(dVect3D(-1, -1, 0.5F));
  drawing.DrawVolume(volume);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{0, 0, 0, 0, 0, 101, 102, 0, 0, 111, 112, 0, 0, 0, 0, 0}));
}

TEST(opBackProjection, RaysAcrossTheVolumeSeeItFromTheSide) {
  dVolume volume;
  rasters::MakeCounting(volume, 3, 2, 2);
  Drawing<std::uint16_t> drawing(2, 2);  // columns along y, rows along z, rays along x
  drawing.plane.SetCoordinates(dVect3D(0.5F, 0, 0), dVect3D(0, 1, 0), dVect3D(0, 0, 1),
                               dVect3D(1, 0, 0));
  drawing.DrawVolume(volume);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{3, 13, 103, 113}));
}

// A thickness of less than 1/65536 voxel: all steps of the ray are where it begins.
TEST(opBackProjection, RaysWithoutAStepSeeTheVoxelWhereTheyBegin) {
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {1, 2, 3});
  Drawing<std::uint16_t> drawing(2, 1);
  drawing.plane.GetCoordinates().axisZ = dVect3D(0, 0, 1e-5F);
  drawing.plane.SetPosition(dVect3D(0, 0, 1.5F));
  drawing.DrawVolume(volume);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{2, 0}));
}

// There is no way back from a plane without a thickness, and its transform becomes the identity:
// steps of one voxel from 1.5 on, of which -1 and 0 count.
TEST(opBackProjection, PlanesWithoutAThicknessSeeAlongTheAxesOfTheVolume) {
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {1, 2, 3});
  Drawing<std::uint16_t> drawing(2, 1);
  drawing.plane.GetCoordinates().axisZ = dVect3D(0, 0, 0);
  drawing.plane.SetPosition(dVect3D(0, 0, 2));
  drawing.DrawVolume(volume);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{2, 0}));
}

TEST(opBackProjection, PlanesWithoutAPlaceSeeNothing) {
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {1, 2, 3});
  Drawing<std::uint16_t> drawing(1, 1);
  const float nan = std::numeric_limits<float>::quiet_NaN();
  drawing.plane.SetPosition(dVect3D(nan, 0, 0));
  drawing.DrawVolume(volume);
  EXPECT_EQ(drawing.Pixels(), Unsigned{0});
}

// A ray of the smallest step reaches half a voxel back: that far behind the plane it begins.
TEST(opBackProjection, RaysBegin32768StepsBehindThePlane) {
  constexpr float kStep = 1.0F / 65536;
  dVolume volume;
  MakeColumn<std::uint16_t>(volume, ImageDataType_U16, {9, 5});
  for (const auto& [steps, brightest] : {std::pair(32768, 9), {32769, 5}}) {
    Drawing<std::uint16_t> drawing(1, 1);
    drawing.plane.GetCoordinates().axisZ = dVect3D(0, 0, kStep);
    // Half a step less is where the ray is counted from, cut to a whole one.
    drawing.plane.SetPosition(dVect3D(0, 0, static_cast<float>(65536 + steps) * kStep));
    drawing.DrawVolume(volume);
    EXPECT_EQ(drawing.Pixels(), Unsigned{static_cast<std::uint16_t>(brightest)}) << steps;
  }
}

// Positions at the ends of what 32 bits hold, and the smallest steps.
TEST(opBackProjection, ExtremePlacesAreSurvived) {
  dVolume volume;
  rasters::MakeCounting(volume, 2, 2, 2);
  for (const float place : {-32768.0F, 32767.99F, -1e30F, 1e30F, 0.0F}) {
    for (const float step : {1.0F / 65536, -1.0F / 65536, 32767.0F, -32768.0F, 1e30F}) {
      Drawing<std::uint16_t> drawing(2, 2);
      drawing.plane.SetPosition(dVect3D(place, 0, place));
      drawing.plane.GetCoordinates().axisX = dVect3D(step, 0, 0);
      drawing.plane.GetCoordinates().axisZ = dVect3D(step, step, step);
      drawing.DrawVolume(volume);
      for (const std::uint16_t pixel : drawing.Pixels()) {
        EXPECT_LE(pixel, 112);
      }
    }
  }
}

}  // namespace
