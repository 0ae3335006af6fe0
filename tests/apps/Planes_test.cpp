#include "TestStudies.h"

#include <gtest/gtest.h>
#include <study/Planes.h>

#include <cmath>

using namespace study;
using namespace study_test;

namespace {

void ExpectNear(const Vec3& a, const Vec3& b, const char* what) {
  EXPECT_NEAR(a.x, b.x, 1e-4) << what;
  EXPECT_NEAR(a.y, b.y, 1e-4) << what;
  EXPECT_NEAR(a.z, b.z, 1e-4) << what;
}

void ExpectAxes(const PlaneGeometry& plane, const Vec3& right, const Vec3& down,
                const Vec3& normal) {
  ExpectNear(ToVec3(plane.coordinates.axisX), right, "right");
  ExpectNear(ToVec3(plane.coordinates.axisY), down, "down");
  ExpectNear(Normalised(ToVec3(plane.coordinates.axisZ)), normal, "normal");
}

/// 10 x 8 x 4 voxels of 2 x 3 x 5 mm; cells from (9, 18.5, 27.5) to (29, 42.5, 47.5).
std::unique_ptr<Study> Pattern() {
  return MakePatternStudy(10, 8, 4);
}

TEST(Planes, AxialShowsTheVolumeFromTheFeet) {
  const PlaneGeometry plane = MakePlane(*Pattern(), {});
  EXPECT_EQ(plane.width, 10);
  EXPECT_EQ(plane.height, 12);
  EXPECT_EQ(plane.spacing, 2);
  ExpectAxes(plane, {2, 0, 0}, {0, 2, 0}, {0, 0, 1});
  // The first pixel's centre; the middle of slice 2.
  ExpectNear(ToVec3(plane.coordinates.origin), {10, 19.5, 40}, "origin");
}

TEST(Planes, CoronalHasTheHeadUp) {
  PlaneRequest request;
  request.plane = Plane::Coronal;
  const PlaneGeometry plane = MakePlane(*Pattern(), request);
  EXPECT_EQ(plane.width, 10);
  EXPECT_EQ(plane.height, 10);
  ExpectAxes(plane, {2, 0, 0}, {0, 0, -2}, {0, 1, 0});
  ExpectNear(ToVec3(plane.coordinates.origin), {10, 32, 46.5}, "origin");
}

TEST(Planes, SagittalLooksFromTheLeft) {
  PlaneRequest request;
  request.plane = Plane::Sagittal;
  const PlaneGeometry plane = MakePlane(*Pattern(), request);
  EXPECT_EQ(plane.width, 12);
  EXPECT_EQ(plane.height, 10);
  ExpectAxes(plane, {0, 2, 0}, {0, 0, -2}, {-1, 0, 0});
  ExpectNear(ToVec3(plane.coordinates.origin), {20, 19.5, 46.5}, "origin");
}

TEST(Planes, OwnSizeIsCentredOnTheCentre) {
  PlaneRequest request;
  request.centre = Vec3{1, 2, 3};
  request.width = 5;
  request.height = 2;
  request.spacing = 0.5;
  const PlaneGeometry plane = MakePlane(*Pattern(), request);
  EXPECT_EQ(plane.width, 5);
  EXPECT_EQ(plane.height, 2);
  ExpectNear(ToVec3(plane.coordinates.origin), {0, 1.75, 3}, "origin");
}

TEST(Planes, CentreWithoutSizeMovesThePlaneOnly) {
  PlaneRequest request;
  request.centre = Vec3{500, 500, 33};
  const PlaneGeometry plane = MakePlane(*Pattern(), request);
  EXPECT_EQ(plane.width, 10);
  ExpectNear(ToVec3(plane.coordinates.origin), {10, 19.5, 33}, "origin");
}

TEST(Planes, PicturesOfObliqueVolumesAreUprightAndUndistorted) {
  // A sagittal acquisition: rows run from front to back, columns from head to feet.
  const auto study = Pattern();
  PlaceVolume(*study, {0, 0, 0}, {0, 2, 0}, {0, 0, -3}, {-5, 0, 0});
  const PlaneGeometry plane = MakePlane(*study, {});
  ExpectAxes(plane, {2, 0, 0}, {0, 2, 0}, {0, 0, 1});
  EXPECT_EQ(plane.width, 10);   // 4 x 5 mm
  EXPECT_EQ(plane.height, 10);  // 10 x 2 mm
}

TEST(Planes, TiltedStackIsCoveredWhole) {
  const auto study = Pattern();
  PlaceVolume(*study, {0, 0, 0}, {2, 0, 0}, {0, 3, 0}, {0, 2, 5});
  EXPECT_EQ(MakePlane(*study, {}).height, 16);  // 8 x 3 mm and 4 x 2 mm
}

TEST(Planes, TurnsAreRightHandedAndInOrder) {
  PlaneRequest request;
  request.turnAboutRight = 90;
  ExpectAxes(MakePlane(*Pattern(), request), {2, 0, 0}, {0, 0, 2}, {0, -1, 0});
  request = {};
  request.turnAboutDown = 90;
  ExpectAxes(MakePlane(*Pattern(), request), {0, 0, -2}, {0, 2, 0}, {1, 0, 0});
  request = {};
  request.turnAboutNormal = 90;
  ExpectAxes(MakePlane(*Pattern(), request), {0, 2, 0}, {-2, 0, 0}, {0, 0, 1});
  // After the turn about right, the plane's own down is (0, 0, 1): about it, right becomes (0, 1,
  // 0).
  request = {};
  request.turnAboutRight = 90;
  request.turnAboutDown = 90;
  ExpectAxes(MakePlane(*Pattern(), request), {0, 2, 0}, {0, 0, 2}, {1, 0, 0});
}

TEST(Planes, ThicknessIsTheLengthOfTheNormalAxis) {
  PlaneRequest request;
  request.thickness = 7;
  EXPECT_NEAR(Length(ToVec3(MakePlane(*Pattern(), request).coordinates.axisZ)), 7, 1e-5);
}

TEST(Planes, ThinPlanesStayInvertibleAtAnySpacing) {
  for (const double spacing : {1e-4, 0.001, 0.01, 1.0, 100.0}) {
    PlaneRequest request;
    request.width = 4;
    request.height = 4;
    request.spacing = spacing;
    EXPECT_EQ(PlacementProblem(MakePlane(*Pattern(), request).coordinates), "") << spacing;
  }
}

TEST(Planes, RefusesWhatMakesNoSense) {
  const auto study = Pattern();
  const auto error = [&](auto change) {
    PlaneRequest request;
    change(request);
    return ErrorOf([&] { MakePlane(*study, request); });
  };
  EXPECT_EQ(error([](PlaneRequest& r) { r.turnAboutDown = std::nan(""); }),
            "the angles of the plane are not finite");
  EXPECT_EQ(error([](PlaneRequest& r) {
              r.centre = Vec3{0, 0, 1e300};
            }),
            "the centre of the plane is not within a kilometre");
  EXPECT_EQ(error([](PlaneRequest& r) { r.thickness = -1; }),
            "the spacing and thickness of the plane must be positive numbers of millimetres");
  EXPECT_EQ(error([](PlaneRequest& r) { r.spacing = std::nan(""); }),
            "the spacing and thickness of the plane must be positive numbers of millimetres");
  EXPECT_EQ(error([](PlaneRequest& r) { r.spacing = 1e-5; }),
            "the spacing of the plane is less than 0.0001 mm");
  EXPECT_EQ(error([](PlaneRequest& r) { r.width = -1; }), "the size of the plane is negative");
  EXPECT_EQ(error([](PlaneRequest& r) { r.height = 32768; }),
            "the picture would have more than 32767 pixels on a side");
  EXPECT_EQ(error([](PlaneRequest& r) { r.spacing = 0.0002; }),
            "the picture would have more than 32767 pixels on a side");
  EXPECT_EQ(ErrorOf([] { MakePlane(Study(), {}); }), "the study is empty");
}

TEST(Planes, ForTrilinearMovesByHalfAVoxel) {
  const auto study = Pattern();
  const PlaneGeometry plane = MakePlane(*study, {});
  const dCoordSys3D moved = ForTrilinear(*study, plane.coordinates);
  ExpectNear(ToVec3(moved.origin), ToVec3(plane.coordinates.origin) - Vec3{1, 1.5, 2.5}, "origin");
  EXPECT_EQ(ToVec3(moved.axisX), ToVec3(plane.coordinates.axisX));
}

TEST(Planes, StackIsCentredOnThePlane) {
  const PlaneGeometry plane = MakePlane(*Pattern(), {});
  const auto stack = StackPlanes(plane, 3, 4);
  ASSERT_EQ(stack.size(), 3u);
  const Vec3 middle = ToVec3(plane.coordinates.origin);
  ExpectNear(ToVec3(stack[0].coordinates.origin), middle - Vec3{0, 0, 4}, "first");
  ExpectNear(ToVec3(stack[1].coordinates.origin), middle, "second");
  ExpectNear(ToVec3(stack[2].coordinates.origin), middle + Vec3{0, 0, 4}, "third");
  EXPECT_EQ(stack[2].width, plane.width);
}

TEST(Planes, ExtentSpansAllCells) {
  const Extent extent = ExtentAlong(*Pattern(), {0, 0, -1});
  EXPECT_NEAR(extent.minimum, -47.5, 1e-5);
  EXPECT_NEAR(extent.maximum, -27.5, 1e-5);
}

TEST(Planes, DirectionLettersFollowThePatient) {
  EXPECT_EQ(DirectionLetter({1, 0, 0}), 'L');
  EXPECT_EQ(DirectionLetter({-1, 0.2, 0}), 'R');
  EXPECT_EQ(DirectionLetter({0.5, 0.8, 0}), 'P');
  EXPECT_EQ(DirectionLetter({0, -1, 0}), 'A');
  EXPECT_EQ(DirectionLetter({0, 0, 1}), 'H');
  EXPECT_EQ(DirectionLetter({0.1, 0, -1}), 'F');
}

TEST(Study, ConvertsBetweenVoxelsAndTheWorld) {
  const auto study = Pattern();
  PlaceVolume(*study, {1, 2, 3}, {2, 0.5, 0}, {0, 3, 0.25}, {0.5, 1, 5});
  ExpectNear(WorldFromVoxel(*study, {0.5, 0.5, 0.5}), {1, 2, 3}, "centre of the first voxel");
  ExpectNear(WorldFromVoxel(*study, {1.5, 0.5, 0.5}), {3, 2.5, 3}, "one step along x");
  const Vec3 voxel{3.25, 6.5, 1.75};
  ExpectNear(VoxelFromWorld(*study, WorldFromVoxel(*study, voxel)), voxel, "there and back");
}

TEST(Study, SlicesFollowTheVolume) {
  const auto study = Pattern();
  PlaceVolume(*study, {1, 2, 3}, {2, 0, 0}, {0, 3, 0}, {0.5, 1, 5});
  const Vec3 first = ToVec3(study->volume.GetCoordinates().origin);
  ExpectNear(ToVec3(study->volume.GetSlice(3)->GetCoordinates().origin), first + Vec3{1.5, 3, 15},
             "slice 3");
}

TEST(Study, ReadsRealValuesAtPoints) {
  const auto study = Pattern();
  study->scale = 2;
  // Voxel (4, 5, 1): its cell begins at (17, 33.5, 32.5).
  const double expected = PatternValue(4, 5, 1) * 2 - 1024;
  EXPECT_EQ(RealValueAt(*study, {17.01, 33.51, 32.51}), expected);
  EXPECT_EQ(RealValueAt(*study, {18.99, 36.49, 37.49}), expected);
  EXPECT_EQ(RealValueAt(*study, {8.9, 30, 30}), std::nullopt);
  EXPECT_EQ(RealValueAt(*study, {29.1, 30, 30}), std::nullopt);
  EXPECT_EQ(RealValueAt(*study, {20, 30, 47.6}), std::nullopt);
}

TEST(Study, StoredAndRealValuesAreInverse) {
  const auto study = Pattern();
  study->scale = 0.5;
  EXPECT_EQ(study->RealValue(0), -1024);
  EXPECT_EQ(study->RealValue(100), -974);
  EXPECT_EQ(study->StoredValue(-974), 100);
}

TEST(Study, RefusesPlacementsThatCannotBeUsed) {
  const auto study = Pattern();
  const Vec3 x{1, 0, 0}, y{0, 1, 0}, z{0, 0, 1};
  EXPECT_EQ(ErrorOf([&] {
              PlaceVolume(*study, {std::nan(""), 0, 0}, x, y, z);
            }),
            "the position of the volume is not finite");
  EXPECT_EQ(ErrorOf([&] { PlaceVolume(*study, {}, x, x, z); }),
            "the voxels are too small or flat (more than 0.000001 cubic millimetres are needed)");
  EXPECT_EQ(ErrorOf([&] { PlaceVolume(*study, {}, x * 0.01, y * 0.01, z * 0.01); }),
            "the voxels are too small or flat (more than 0.000001 cubic millimetres are needed)");
  EXPECT_EQ(ErrorOf([&] {
              PlaceVolume(*study, {0, 2e6, 0}, x, y, z);
            }),
            "the volume reaches beyond a kilometre");
  EXPECT_EQ(ErrorOf([&] { PlaceVolume(*study, {}, x, y, z * 1e30); }),
            "the volume reaches beyond a kilometre");
}

TEST(Study, SlicesOfAnotherSizeAreRefused) {
  const auto study = Pattern();
  EXPECT_EQ(ErrorOf([&] { AppendSlice(*study, 10, 9); }),
            "a slice of 10 x 9 voxels does not fit the volume");
}

}  // namespace
