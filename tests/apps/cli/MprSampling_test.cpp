#include "CutFixture.h"

#include <algorithm>

namespace {

using cli_test::Arguments;
using cli_test::CutFixture;
using cli_test::ExpectCut;
using cli_test::PlaneModel;
using cli_test::Point;
using cli_test::SamplesOf;
using cli_test::VolumeModel;

/// 20 x 18 x 24 voxels of 1 x 1 x 2 mm, the first at the origin.
class MprSampling : public CutFixture {
 protected:
  void SetUp() override {
    m_volume.size = {20, 18, 24};
    m_volume.step = {Point{1, 0, 0}, Point{0, 1, 0}, Point{0, 0, 2}};
    m_volume.stored = [](int i, int j, int k) { return (i * 131 + j * 337 + k * 977) % 4001; };
    cli_test::WriteVolume(m_volume, PathOf("volume.bdf"));
    m_plane = cli_test::AxialPlane();
    m_plane.centre = {9.3, 8.1, 22.7};
    m_plane.width = 40;
    m_plane.height = 36;
    m_plane.spacing = 0.7;
  }

  /// The arguments for the axial plane of `m_plane`, and more.
  Arguments PlaneArguments(const Arguments& more) const {
    Arguments arguments{
        PathOf("volume.bdf"), "--center", cli_test::TripleText(m_plane.centre), "--size", "40x36",
        "--spacing",          "0.7"};
    arguments.insert(arguments.end(), more.begin(), more.end());
    return arguments;
  }

  VolumeModel m_volume;
  PlaneModel m_plane;
};

TEST_F(MprSampling, NearestIsTheUsualFilter) {
  ExpectCut(*CutSlice(PlaneArguments({})), m_volume, m_plane, 0.1);
  ExpectCut(*CutSlice(PlaneArguments({"--filter", "nearest"})), m_volume, m_plane, 0.1);
}

TEST_F(MprSampling, StepsAreTheSamplesAcrossTheSlab) {
  m_plane.thickness = 11.3;
  for (const int steps : {2, 3, 8, 50}) {
    m_plane.steps = steps;
    ExpectCut(*CutSlice(PlaneArguments({"--thickness", "11.3", "--steps", std::to_string(steps)})),
              m_volume, m_plane, 0.1);
  }
}

TEST_F(MprSampling, WithoutStepsEveryVoxelThatTheSlabCrossesCounts) {
  m_plane.thickness = 11;  // 5.5 voxels
  m_plane.steps = 5;
  ExpectCut(*CutSlice(PlaneArguments({"--thickness", "11"})), m_volume, m_plane, 0.1);
  m_plane.thickness = 1;
  m_plane.steps = 2;  // never fewer
  ExpectCut(*CutSlice(PlaneArguments({"--thickness", "1"})), m_volume, m_plane, 0.1);
}

TEST_F(MprSampling, SlabsAreTurnedWithTheirPlane) {
  PlaneModel plane = m_plane.Turned(40, -25, 10);
  plane.thickness = 9;
  plane.steps = 7;
  ExpectCut(
      *CutSlice(PlaneArguments({"--thickness", "9", "--steps", "7", "--rotate", "40,-25,10"})),
      m_volume, plane, 0.1);
}

TEST_F(MprSampling, LinearRunsEvenlyFromVoxelCentreToVoxelCentre) {
  // Constant in each slice, 100 more from slice to slice: 50 per millimetre, 0 at z = 0.
  m_volume.stored = [](int, int, int k) { return 100 * k; };
  cli_test::WriteVolume(m_volume, PathOf("ramp.bdf"));
  const auto slice = CutSlice({PathOf("ramp.bdf"), "--plane", "coronal", "--filter", "linear",
                               "--center", "9.3,8.1,23", "--size", "3x160", "--spacing", "0.25"});
  const std::vector<std::uint16_t> samples = SamplesOf(*slice);
  ASSERT_EQ(samples.size(), 480u);
  for (int y = 0; y < 160; ++y) {
    const double z = 23 - (y - 79.5) * 0.25;
    EXPECT_NEAR(samples[static_cast<std::size_t>(3 * y + 1)], 50 * z, 1.0) << y;
  }
}

TEST_F(MprSampling, LinearAndNearestShowAThingAtTheSamePlace) {
  // One bright slab: its middle must not move with the filter.
  m_volume.stored = [](int, int, int k) { return k == 12 ? 1000 : 0; };
  cli_test::WriteVolume(m_volume, PathOf("slab.bdf"));
  const auto middleOf = [&](const char* filter) {
    const auto slice = CutSlice({PathOf("slab.bdf"), "--plane", "sagittal", "--filter", filter,
                                 "--center", "9.3,8.1,23", "--size", "1x160", "--spacing", "0.25"});
    double sum = 0;
    double moment = 0;
    double y = 0;
    for (const std::uint16_t sample : SamplesOf(*slice)) {
      sum += sample;
      moment += y++ * sample;
    }
    return moment / sum;
  };
  const double expected = 79.5 - (24 - 23) / 0.25;  // z = 24 is above the centre
  EXPECT_NEAR(middleOf("nearest"), expected, 0.51);
  EXPECT_NEAR(middleOf("linear"), expected, 0.51);
}

TEST_F(MprSampling, LinearSlabsAreMeansOfInterpolatedSamples) {
  m_volume.stored = [](int, int, int k) { return 100 * k; };
  cli_test::WriteVolume(m_volume, PathOf("ramp.bdf"));
  const auto slice = CutSlice({PathOf("ramp.bdf"), "--filter", "linear", "--center", "9.3,8.1,20",
                               "--size", "3x3", "--thickness", "6", "--steps", "5"});
  for (const std::uint16_t sample : SamplesOf(*slice)) {
    EXPECT_NEAR(sample, 1000, 2);  // the mean of a ramp is its value in the middle
  }
}

}  // namespace
