#include "CutFixture.h"

#include <cmath>

namespace {

using cli_test::CutFixture;
using cli_test::ExpectCut;
using cli_test::PhantomModel;
using cli_test::PlaneModel;
using cli_test::Point;
using cli_test::VolumeModel;

/// 48 x 40 x 30 voxels of 8.33 x 10 x 10.67 mm.
class MprPlanes : public CutFixture {
 protected:
  static constexpr const char* kPhantom = "--phantom=48x40x30";

  /// As many pixels of the smallest spacing as show the whole phantom.
  static PlaneModel WholePhantom(PlaneModel plane, double widthMm, double heightMm) {
    plane.spacing = 400.0 / 48;
    plane.width = static_cast<int>(std::ceil(widthMm / plane.spacing - 1e-3));
    plane.height = static_cast<int>(std::ceil(heightMm / plane.spacing - 1e-3));
    return plane;
  }

  VolumeModel m_phantom = PhantomModel(48, 40, 30);
  /// The centre of the middle voxel (24, 20, 15).
  Point m_middle{400.0 / 48 / 2, 5, 320.0 / 30 / 2};
};

TEST_F(MprPlanes, AxialGoesThroughTheMiddleVoxelAndShowsTheWholeVolume) {
  PlaneModel plane = WholePhantom(cli_test::AxialPlane(), 400, 400);
  plane.centre = {0, 0, m_middle[2]};
  ExpectCut(*CutSlice({kPhantom}), m_phantom, plane, 0);
  ExpectCut(*CutSlice({kPhantom, "--plane", "axial"}), m_phantom, plane, 0);
}

TEST_F(MprPlanes, CoronalHasTheHeadUp) {
  PlaneModel plane = WholePhantom(cli_test::CoronalPlane(), 400, 320);
  plane.centre = {0, m_middle[1], 0};
  ExpectCut(*CutSlice({kPhantom, "--plane", "coronal"}), m_phantom, plane, 0.1);
}

TEST_F(MprPlanes, SagittalHasTheBackOnTheRight) {
  PlaneModel plane = WholePhantom(cli_test::SagittalPlane(), 400, 320);
  plane.centre = {m_middle[0], 0, 0};
  ExpectCut(*CutSlice({kPhantom, "--plane", "sagittal"}), m_phantom, plane, 0.1);
}

/// The box of the phantom is symmetric: along a direction it reaches as far as its corners do.
double ReachAlong(const Point& direction) {
  return 2 * (200 * std::abs(direction[0]) + 200 * std::abs(direction[1]) +
              160 * std::abs(direction[2]));
}

TEST_F(MprPlanes, ObliqueIsAxialTurnedByThirtyAndTwentyDegrees) {
  PlaneModel plane = cli_test::AxialPlane().Turned(30, 20, 0);
  plane = WholePhantom(plane, ReachAlong(plane.right), ReachAlong(plane.down));
  // The picture shows the whole volume; only along its normal it goes through the middle voxel.
  const Point normal{plane.right[1] * plane.down[2] - plane.right[2] * plane.down[1],
                     plane.right[2] * plane.down[0] - plane.right[0] * plane.down[2],
                     plane.right[0] * plane.down[1] - plane.right[1] * plane.down[0]};
  const double along = normal[0] * m_middle[0] + normal[1] * m_middle[1] + normal[2] * m_middle[2];
  plane.centre = {normal[0] * along, normal[1] * along, normal[2] * along};
  ExpectCut(*CutSlice({kPhantom, "--plane", "oblique"}), m_phantom, plane, 0.02);
}

TEST_F(MprPlanes, AllPlanesTakeCentreSizeSpacingAndRotation) {
  struct Case {
    const char* name;
    PlaneModel plane;
  };
  for (const Case& one :
       {Case{"axial", cli_test::AxialPlane()}, Case{"coronal", cli_test::CoronalPlane()},
        Case{"sagittal", cli_test::SagittalPlane()}, Case{"oblique", cli_test::AxialPlane()}}) {
    SCOPED_TRACE(one.name);
    PlaneModel plane = one.plane.Turned(-12.5, 33, 71);
    plane.centre = {-20.3, 14.7, 31.9};
    plane.width = 61;
    plane.height = 43;
    plane.spacing = 3.3;
    ExpectCut(*CutSlice({kPhantom, "--plane", one.name, "--center", "-20.3,14.7,31.9", "--size",
                         "61x43", "--spacing", "3.3", "--rotate", "-12.5,33,71"}),
              m_phantom, plane, 0.02);
  }
}

TEST_F(MprPlanes, EachAngleTurnsAboutItsOwnAxis) {
  struct Case {
    const char* angles;
    PlaneModel plane;
  };
  for (const Case& one : {Case{"25,0,0", cli_test::CoronalPlane().Turned(25, 0, 0)},
                          Case{"0,25,0", cli_test::CoronalPlane().Turned(0, 25, 0)},
                          Case{"0,0,25", cli_test::CoronalPlane().Turned(0, 0, 25)}}) {
    SCOPED_TRACE(one.angles);
    PlaneModel plane = one.plane;
    plane.centre = {1.1, 2.3, 3.7};
    plane.width = plane.height = 50;
    plane.spacing = 5.1;
    ExpectCut(*CutSlice({kPhantom, "--plane", "coronal", "--center", "1.1,2.3,3.7", "--size",
                         "50x50", "--spacing", "5.1", "--rotate", one.angles}),
              m_phantom, plane, 0.02);
  }
}

TEST_F(MprPlanes, AcquisitionsOfAnyDirectionAreShownTheSameWay) {
  // Rows run to the head, columns to the right, slices to the front: nothing is as in the axial
  // case.
  VolumeModel volume;
  volume.size = {12, 15, 9};
  volume.firstVoxel = {30, 40, -50};
  volume.step = {Point{0, 0, 2}, Point{-1.5, 0, 0}, Point{0, -4, 0}};
  volume.stored = [](int i, int j, int k) { return 1 + i + 20 * j + 400 * k; };
  cli_test::WriteVolume(volume, m_folder / "turned.bdf");
  PlaneModel plane = cli_test::AxialPlane();
  plane.centre = {19.6, 23.9, -38.3};
  plane.width = 40;
  plane.height = 50;
  plane.spacing = 0.9;
  ExpectCut(*CutSlice({PathOf("turned.bdf"), "--center", "19.6,23.9,-38.3", "--size", "40x50",
                       "--spacing", "0.9"}),
            volume, plane, 0.02);
}

TEST_F(MprPlanes, TiltedVolumesAreSampledWhereTheyLie) {
  VolumeModel volume;
  volume.size = {20, 16, 11};
  volume.firstVoxel = {-7, 3, 100};
  volume.step = {Point{1.1, 0.2, 0}, Point{-0.2, 1.1, 0.1}, Point{0.1, -0.6, 2.5}};
  volume.stored = [](int i, int j, int k) { return 1 + i + 30 * j + 600 * k; };
  cli_test::WriteVolume(volume, m_folder / "tilted.bdf");
  PlaneModel plane = cli_test::SagittalPlane();
  plane.centre = {2.2, 8.1, 113};
  plane.width = 50;
  plane.height = 60;
  plane.spacing = 0.51;
  ExpectCut(*CutSlice({PathOf("tilted.bdf"), "--plane", "sagittal", "--center", "2.2,8.1,113",
                       "--size", "50x60", "--spacing", "0.51"}),
            volume, plane, 0.02);
}

TEST_F(MprPlanes, APlaneBesideTheVolumeIsBlackAndNoted) {
  const std::string path = PathOf("far.bdf");
  const cli_test::Outcome outcome =
      cli_test::RunTool({"mpr", "--phantom=8x8x8", "--center", "0,0,500", "--save-slice", path});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "vorl: note: the plane does not meet the volume\n");
  const std::string info = cli_test::RunTool({"info", path}).output;
  EXPECT_NE(info.find("Stored range: 0 to 0\n"), std::string::npos);
}

TEST_F(MprPlanes, APlaneThatReachesTooFarIsRefused) {
  // 30000 pixels of 60 mm on voxels of 50 mm: beyond the reach of the reconstruction.
  const cli_test::Outcome outcome =
      cli_test::RunTool({"mpr", "--phantom=8x8x8", "--center", "1000000,0,0", "--size", "30000x2",
                         "--spacing", "60", "-o", PathOf("x.png")});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: the plane reaches more than 32767 voxels away\n");
  EXPECT_TRUE(m_folder.Names().empty());
}

}  // namespace
