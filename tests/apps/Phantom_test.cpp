#include "TestStudies.h"

#include <gtest/gtest.h>
#include <study/Error.h>
#include <study/Phantom.h>

#include <algorithm>
#include <array>
#include <cmath>

using namespace study;
using namespace study_test;

namespace {

const Study& Torso() {
  static const auto study = MakePhantom(128, 128, 80);
  return *study;
}

double ValueAt(double x, double y, double z) {
  return RealValueAt(Torso(), {x, y, z}).value_or(-99999);
}

/// The mean real value of the voxels whose indices `choose` admits.
template <class Choose>
double MeanWhere(const Study& study, Choose choose) {
  double sum = 0;
  double count = 0;
  for (int k = 0; k < study.volume.GetSizeZ(); ++k) {
    const auto samples = SamplesOf(*study.volume.GetSlice(k));
    std::size_t at = 0;
    for (int j = 0; j < study.volume.GetSizeY(); ++j) {
      for (int i = 0; i < study.volume.GetSizeX(); ++i, ++at) {
        if (choose(i, j, k)) {
          sum += study.RealValue(samples[at]);
          count += 1;
        }
      }
    }
  }
  return sum / count;
}

/// How many voxels differ from their mirror image along one axis by more than the noise.
long AsymmetricVoxels(const Study& study, int axis) {
  const std::array<int, 3> size{study.volume.GetSizeX(), study.volume.GetSizeY(),
                                study.volume.GetSizeZ()};
  const auto at = [&study](std::array<int, 3> p) {
    const auto samples = SamplesOf(*study.volume.GetSlice(p[2]));
    return int{samples[static_cast<std::size_t>(p[1] * study.volume.GetSizeX() + p[0])]};
  };
  long different = 0;
  for (int k = 0; k < size[2]; ++k) {
    for (int j = 0; j < size[1]; ++j) {
      for (int i = 0; i < size[0]; ++i) {
        std::array<int, 3> mirrored{i, j, k};
        const auto n = static_cast<std::size_t>(axis);
        mirrored[n] = size[n] - 1 - mirrored[n];
        different += std::abs(at({i, j, k}) - at(mirrored)) > 40 ? 1 : 0;
      }
    }
  }
  return different;
}

TEST(Phantom, HasTheAskedSizeInOneFieldOfView) {
  const auto study = MakePhantom(40, 20, 16);
  EXPECT_EQ(study->volume.GetSizeX(), 40);
  EXPECT_EQ(study->volume.GetSizeY(), 20);
  EXPECT_EQ(study->volume.GetSizeZ(), 16);
  const dCoordSys3D& c = study->volume.GetCoordinates();
  EXPECT_EQ(ToVec3(c.origin), (Vec3{-200, -200, -160}));
  EXPECT_EQ(ToVec3(c.axisX), (Vec3{10, 0, 0}));
  EXPECT_EQ(ToVec3(c.axisY), (Vec3{0, 20, 0}));
  EXPECT_EQ(ToVec3(c.axisZ), (Vec3{0, 0, 20}));
  EXPECT_EQ(study->unit, "HU");
  EXPECT_EQ(study->modality, "CT");
}

TEST(Phantom, IsTheSameTwice) {
  EXPECT_EQ(StoredValues(*MakePhantom(33, 47, 21)), StoredValues(*MakePhantom(33, 47, 21)));
}

TEST(Phantom, ValuesSpanTheHounsfieldScale) {
  const auto values = RealValues(Torso());
  const auto [smallest, largest] = std::minmax_element(values.begin(), values.end());
  EXPECT_EQ(*smallest, -1024);
  EXPECT_GE(*largest, 2900);
  EXPECT_LE(*largest, 3000);
  const auto stored = StoredValues(Torso());
  EXPECT_EQ(*std::min_element(stored.begin(), stored.end()), 0);
}

TEST(Phantom, AirLiesAroundTheBodyInsideTheFieldOfView) {
  EXPECT_NEAR(ValueAt(-180, 0, 0), -1000, 8);
  EXPECT_NEAR(ValueAt(0, -180, 0), -1000, 8);
  EXPECT_EQ(ValueAt(-190, -190, 0), -1024);
  EXPECT_EQ(ValueAt(190, 190, -150), -1024);
}

TEST(Phantom, BodyIsLayeredFromSkinToOrgans) {
  EXPECT_NEAR(ValueAt(-154, 0, 150), -100, 8);  // fat
  EXPECT_NEAR(ValueAt(-134, 0, -95), 55, 8);    // muscle
  EXPECT_NEAR(ValueAt(-95, 5, -62), 105, 8);    // liver, on the right
  EXPECT_NEAR(ValueAt(62, -46, -54), -960, 8);  // air in the stomach, on the left
  EXPECT_NEAR(ValueAt(96, 34, -52), 115, 8);    // spleen
  EXPECT_NEAR(ValueAt(34, -28, 2), 320, 8);     // heart with contrast medium
  EXPECT_NEAR(ValueAt(17, 40, -30), 340, 8);    // aorta
  EXPECT_NEAR(ValueAt(-100, -30, 60), -860, 60) << "lung, or a thin vessel in it";
}

TEST(Phantom, SpongyBoneIsGrainyInsideCompactBone) {
  double smallest = 9999;
  double largest = -9999;
  for (double x = -15; x <= 15; x += 3) {
    const double value = ValueAt(x, 62, -130);
    smallest = std::min(smallest, value);
    largest = std::max(largest, value);
  }
  EXPECT_GE(smallest, 230 - 98);
  EXPECT_LE(largest, 230 + 98);
  EXPECT_GT(largest - smallest, 30);
  // The rim is 2.5 mm wide: fine voxels are needed to meet it.
  const auto fine = MakePhantom(400, 400, 32);
  EXPECT_NEAR(RealValueAt(*fine, {-20.9, 62, -155}).value_or(0), 850, 8);
}

TEST(Phantom, LinePairsAlternateOnTheLeftOnly) {
  const auto fine = MakePhantom(400, 400, 32);
  const auto at = [&fine](double x, double z) {
    return RealValueAt(*fine, {x, -140.5, z}).value_or(-99999);
  };
  // The coarsest group: bars of 6 mm from x = 94 on, 6 mm apart.
  for (int bar = 0; bar < 5; ++bar) {
    EXPECT_NEAR(at(97 + 12 * bar, -105), 1200, 8) << bar;
    EXPECT_NEAR(at(103 + 12 * bar, -105), 120, 8) << bar;
  }
  EXPECT_NEAR(at(-97, -105), -1000, 8);
}

TEST(Phantom, LooksDifferentFromEverySide) {
  for (int axis = 0; axis < 3; ++axis) {
    EXPECT_GT(AsymmetricVoxels(Torso(), axis), 128 * 128 * 80 / 50) << axis;
  }
}

TEST(Phantom, MetalBeadLiesOnTheRightFrontUpperSide) {
  EXPECT_NEAR(ValueAt(-130, -120, 105), 3000, 16);
  EXPECT_LT(ValueAt(130, -120, 105), 1300) << "the line pairs of the other side";
}

TEST(Phantom, SizesShowTheSameBody) {
  // The mean of the whole is that of the body, whatever the grid.
  const auto all = [](int, int, int) { return true; };
  const double mean = MeanWhere(Torso(), all);
  EXPECT_NEAR(MeanWhere(*MakePhantom(64, 64, 64), all), mean, 10);
  EXPECT_NEAR(MeanWhere(*MakePhantom(100, 50, 25), all), mean, 20);
}

TEST(Phantom, SingleVoxelAndThinShapesWork) {
  EXPECT_EQ(StoredValues(*MakePhantom(1, 1, 1)), std::vector<std::uint16_t>{0});
  EXPECT_EQ(MakePhantom(200, 1, 1)->volume.GetSizeX(), 200);
  EXPECT_EQ(MakePhantom(1, 200, 1)->volume.GetSizeY(), 200);
  EXPECT_EQ(MakePhantom(1, 1, 200)->volume.GetSizeZ(), 200);
}

TEST(Phantom, RefusesImpossibleSizes) {
  EXPECT_EQ(ErrorOf([] { MakePhantom(0, 1, 1); }),
            "a phantom of 0 x 1 x 1 voxels: each side must be from 1 to 32767");
  EXPECT_EQ(ErrorOf([] { MakePhantom(1, 1, 32768); }),
            "a phantom of 1 x 1 x 32768 voxels: each side must be from 1 to 32767");
  EXPECT_EQ(ErrorOf([] { MakePhantom(1, -5, 1); }),
            "a phantom of 1 x -5 x 1 voxels: each side must be from 1 to 32767");
  EXPECT_EQ(ErrorOf([] { MakePhantom(2000, 2000, 2000); }),
            "a phantom of 2000 x 2000 x 2000 voxels has more than 2147483648 of them");
}

TEST(Phantom, CanBeCancelled) {
  EXPECT_THROW(MakePhantom(8, 8, 8, [](double f, const std::string&) { return f < 0.5; }),
               Cancelled);
}

}  // namespace
