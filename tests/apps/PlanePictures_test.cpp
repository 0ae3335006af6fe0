#include "TestStudies.h"

#include <gtest/gtest.h>
#include <study/Planes.h>
#include <vorl/Operators/IP/opMPR.h>

using namespace study;
using namespace study_test;

namespace {

constexpr int kNearest = 102;
constexpr int kTrilinear = 101;

/// The plane's picture as the operator makes it.
class Picture {
 public:
  Picture(Study& study, const PlaneGeometry& plane, int algorithm) : m_width(plane.width) {
    m_slice.GetImage().Init(static_cast<unsigned long>(plane.width),
                            static_cast<unsigned long>(plane.height), ImageDataType_U16, "G", 0, 2);
    m_slice.SetCoordinates(algorithm == kTrilinear ? ForTrilinear(study, plane.coordinates)
                                                   : plane.coordinates);
    opMPR mpr;
    mpr.volume = &study.volume;
    mpr.mprSlice = &m_slice;
    mpr.SelectAlgo(algorithm);
    m_made = mpr.Run();
  }

  bool IsMade() const { return m_made; }
  int At(int x, int y) const {
    return SamplesOf(m_slice)[static_cast<std::size_t>(y * m_width + x)];
  }

 private:
  dSlice m_slice;
  int m_width;
  bool m_made = false;
};

/// Cubic voxels of 0.7 mm far from the world's origin, where single precision is coarse.
std::unique_ptr<Study> CubicStudy() {
  auto study = MakePatternStudy(9, 7, 5);
  PlaceVolume(*study, {-311.3, 257.9, 1203.1}, {0.7, 0, 0}, {0, 0.7, 0}, {0, 0, 0.7});
  return study;
}

TEST(PlanePictures, AxialPictureIsTheMiddleSlice) {
  const auto study = CubicStudy();
  for (const int algorithm : {kNearest, kTrilinear}) {
    const PlaneGeometry plane = MakePlane(*study, {});
    ASSERT_EQ(plane.width, 9);
    ASSERT_EQ(plane.height, 7);
    const Picture picture(*study, plane, algorithm);
    ASSERT_TRUE(picture.IsMade());
    for (int y = 0; y < 7; ++y) {
      for (int x = 0; x < 9; ++x) {
        // Interpolation is exact but for the coordinates' last bits.
        ASSERT_NEAR(picture.At(x, y), PatternValue(x, y, 2), algorithm == kNearest ? 0 : 2)
            << x << ", " << y << ", " << algorithm;
      }
    }
  }
}

TEST(PlanePictures, CoronalPictureHasTheLastSliceOnTop) {
  const auto study = CubicStudy();
  PlaneRequest request;
  request.plane = Plane::Coronal;
  const PlaneGeometry plane = MakePlane(*study, request);
  ASSERT_EQ(plane.width, 9);
  ASSERT_EQ(plane.height, 5);
  const Picture picture(*study, plane, kNearest);
  for (int y = 0; y < 5; ++y) {
    for (int x = 0; x < 9; ++x) {
      ASSERT_EQ(picture.At(x, y), PatternValue(x, 3, 4 - y)) << x << ", " << y;
    }
  }
}

TEST(PlanePictures, SagittalPictureHasTheFrontOnTheLeft) {
  const auto study = CubicStudy();
  PlaneRequest request;
  request.plane = Plane::Sagittal;
  const PlaneGeometry plane = MakePlane(*study, request);
  ASSERT_EQ(plane.width, 7);
  ASSERT_EQ(plane.height, 5);
  const Picture picture(*study, plane, kNearest);
  for (int y = 0; y < 5; ++y) {
    for (int x = 0; x < 7; ++x) {
      ASSERT_EQ(picture.At(x, y), PatternValue(4, x, 4 - y)) << x << ", " << y;
    }
  }
}

TEST(PlanePictures, SagittalAcquisitionIsShownUpright) {
  // Columns run from front to back, rows from head to feet, slices from left to right.
  const auto study = MakePatternStudy(7, 5, 9);
  PlaceVolume(*study, {40, -30, 20}, {0, 1, 0}, {0, 0, -1}, {-1, 0, 0});
  const PlaneGeometry plane = MakePlane(*study, {});  // axial
  ASSERT_EQ(plane.width, 9);
  ASSERT_EQ(plane.height, 7);
  const Picture picture(*study, plane, kNearest);
  for (int y = 0; y < 7; ++y) {
    for (int x = 0; x < 9; ++x) {
      ASSERT_EQ(picture.At(x, y), PatternValue(y, 2, 8 - x)) << x << ", " << y;
    }
  }
}

TEST(PlanePictures, TrilinearAndNearestShowThingsAtTheSamePlace) {
  // One bright voxel among black ones: both pictures are brightest at its centre.
  auto study = std::make_unique<Study>();
  for (int k = 0; k < 9; ++k) {
    auto samples = AppendSlice(*study, 9, 9);
    if (k == 4) {
      samples[4 * 9 + 3] = 1000;
    }
  }
  PlaceVolume(*study, {0, 0, 0}, {4, 0, 0}, {0, 4, 0}, {0, 0, 4});
  PlaneRequest request;
  request.centre = Vec3{12, 16, 16};
  request.width = 33;
  request.height = 33;
  request.spacing = 0.5;
  const PlaneGeometry plane = MakePlane(*study, request);
  const Picture nearest(*study, plane, kNearest);
  const Picture trilinear(*study, plane, kTrilinear);
  EXPECT_EQ(nearest.At(16, 16), 1000);
  EXPECT_EQ(trilinear.At(16, 16), 1000);
  for (int d = 1; d <= 8; ++d) {
    EXPECT_EQ(nearest.At(16 - d, 16), d <= 4 ? 1000 : 0) << d;
    EXPECT_NEAR(trilinear.At(16 - d, 16), 1000 - 125 * d, 2) << d;
    EXPECT_NEAR(trilinear.At(16 + d, 16), 1000 - 125 * d, 2) << d;
  }
}

}  // namespace
