#include "RenderFixture.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <random>

// What a sheet measures, against computations from the voxels.

namespace {

using cli_test::Point;
using cli_test::Render;
using cli_test::VolumeModel;

using RenderMeasure = Render;
using Results = std::map<std::string, std::string>;

std::string Fixed(double value) {
  char text[64];
  std::snprintf(text, sizeof text, "%.1f", value);
  return text;
}

/// 30 x 20 x 10 voxels of 1.5 x 2 x 2.5 mm, the first at (-10, -5, 100), with values from -1000 to
/// 1000.
class RenderRandom : public Render {
 protected:
  static constexpr int kWidth = 30;
  static constexpr int kHeight = 20;
  static constexpr int kSlices = 10;

  void SetUp() override {
    std::mt19937 random(11);
    std::vector<int> values(std::size_t{kWidth} * kHeight * kSlices);
    for (int& value : values) {
      value = static_cast<int>(random() % 2001);
    }
    values[0] = 0;  // the offset is that of the smallest value
    m_volume.size = {kWidth, kHeight, kSlices};
    m_volume.firstVoxel = {-10, -5, 100};
    m_volume.step = {Point{1.5, 0, 0}, Point{0, 2, 0}, Point{0, 0, 2.5}};
    m_volume.stored = [values](int i, int j, int k) {
      return values[static_cast<std::size_t>((k * kHeight + j) * kWidth + i)];
    };
    WriteVolume(m_volume, PathOf("random.bdf"));
  }

  /// Of the voxels of slice k whose centres lie in the rectangle.
  Results Expected(int k, double left, double top, double right, double bottom) const {
    std::vector<double> values;
    for (int j = 0; j < kHeight; ++j) {
      for (int i = 0; i < kWidth; ++i) {
        const double x = -10 + 1.5 * i;
        const double y = -5 + 2.0 * j;
        if (x >= left && x < right && y >= top && y < bottom) {
          values.push_back(m_volume.stored(i, j, k) - 1000);
        }
      }
    }
    double sum = 0;
    for (const double value : values) {
      sum += value;
    }
    const double mean = sum / static_cast<double>(values.size());
    double squares = 0;
    for (const double value : values) {
      squares += (value - mean) * (value - mean);
    }
    const auto [low, high] = std::minmax_element(values.begin(), values.end());
    return {{"Voxels", std::to_string(values.size())},
            {"Region", Fixed(right - left) + " x " + Fixed(bottom - top) + " mm"},
            {"Mean", Fixed(mean) + " HU"},
            {"SD", Fixed(std::sqrt(squares / static_cast<double>(values.size()))) + " HU"},
            {"Range", std::to_string(std::lround(*low)) + " to " +
                          std::to_string(std::lround(*high)) + " HU"}};
  }

  void ExpectResults(const Results& expected) {
    for (const auto& [name, value] : expected) {
      EXPECT_EQ(m_results[name], value) << name;
    }
  }

  VolumeModel m_volume;
};

TEST_F(RenderRandom, TheRegionCountsTheVoxelsOfTheAxialPlaneWhoseCentresItHolds) {
  Sheet("random.bdf", {"--center", "0,0,112.5", "--region", "-3.3,1.5,12.2,20.9"});
  ExpectResults(Expected(5, -3.3, 1.5, 12.2, 20.9));
  EXPECT_EQ(m_results["Voxels"], "90");
  EXPECT_EQ(m_results["Planes"], "0.0, 0.0, 112.5 mm");
}

TEST_F(RenderRandom, CornersComeInAnyOrderAndThePlaneThroughAnyPointOfItsSlice) {
  Sheet("random.bdf", {"--center", "5,5,106.1", "--region", "30.1,32.2,17.4,-4.1"});
  ExpectResults(Expected(2, 17.4, -4.1, 30.1, 32.2));
}

TEST_F(RenderRandom, StatisticsAreThoseOfOneVoxelAndOfAll) {
  Sheet("random.bdf", {"--region", "-0.2,6.1,1.1,7.9"});
  ExpectResults(Expected(5, -0.2, 6.1, 1.1, 7.9));
  EXPECT_EQ(m_results["Voxels"], "1");
  EXPECT_EQ(m_results["SD"], "0.0 HU");
  Sheet("random.bdf", {"--region", "-100,-100,100,100"});
  ExpectResults(Expected(5, -100, -100, 100, 100));
  EXPECT_EQ(m_results["Voxels"], "600");
}

TEST_F(RenderRandom, ARegionBesideTheVolumeHasNoVoxelsAndNoMean) {
  Sheet("random.bdf", {"--region", "200,200,210,210"});
  EXPECT_EQ(m_results["Voxels"], "0");
  EXPECT_EQ(m_results.count("Mean"), 0u);
}

TEST_F(RenderRandom, NeitherWindowNorSizeNorLayoutChangesWhatIsMeasured) {
  const cli_test::Arguments measure{"--line", "-5,0,20,25", "--region", "0,0,15,20"};
  Sheet("random.bdf", measure);
  const Results expected = m_results;
  ASSERT_EQ(expected.count("Mean"), 1u);
  for (cli_test::Arguments more :
       {cli_test::Arguments{"--window", "bone"}, cli_test::Arguments{"--size", "300x200"},
        cli_test::Arguments{"--layout", "row"}, cli_test::Arguments{"--gamma", "2"}}) {
    more.insert(more.end(), measure.begin(), measure.end());
    Sheet("random.bdf", more);
    EXPECT_EQ(m_results, expected);
  }
}

TEST_F(RenderRandom, TheLineIsAsLongAsItsEndsAreApart) {
  Sheet("random.bdf", {"--line", "-10,5,20.5,-7.25"});
  EXPECT_EQ(m_results["Line"], "32.9 mm");  // the root of 30.5^2 + 12.25^2 is 32.868
  Sheet("random.bdf", {"--line", "3,4,3,4"});
  EXPECT_EQ(m_results["Line"], "0.0 mm");
}

TEST_F(RenderMeasure, WithoutOptionsTheBodyIsMeasured) {
  BoxSheet();
  EXPECT_EQ(m_results["Line"], "60.0 mm");
  EXPECT_EQ(m_results["Mean"], "1000.0 HU");
  EXPECT_EQ(m_results["SD"], "0.0 HU");
  EXPECT_EQ(m_results["Range"], "1000 to 1000 HU");
  EXPECT_GT(std::stoi(m_results["Voxels"]), 4);
}

TEST_F(RenderMeasure, WhereThereIsNoBodyNothingIsMeasured) {
  VolumeModel air;
  air.size = {10, 10, 10};
  air.step = {Point{1, 0, 0}, Point{0, 1, 0}, Point{0, 0, 1}};
  air.stored = [](int, int, int) { return 0; };
  WriteVolume(air, PathOf("air.bdf"));
  Sheet("air.bdf");
  EXPECT_EQ(m_results, (Results{{"Planes", "5.0, 5.0, 5.0 mm"}}));
}

TEST_F(RenderMeasure, InLargeSlicesTheBodyIsMeasuredToThePixel) {
  VolumeModel large;  // a body of 1501 x 901 pixels that is noisy but for a part of it
  large.size = {2503, 1301, 1};
  large.step = {Point{0.2, 0, 0}, Point{0, 0.2, 0}, Point{0, 0, 1}};
  large.stored = [](int i, int j, int) {
    if (i < 501 || i > 2001 || j < 200 || j > 1100) {
      return 0;
    }
    return i >= 1400 && i < 1900 && j >= 700 && j < 1050 ? 1500 : 1200 + 300 * ((i + j) / 5 % 2);
  };
  WriteVolume(large, PathOf("large.bdf"));
  Sheet("large.bdf");
  EXPECT_EQ(m_results["Line"], "300.2 mm");
  EXPECT_EQ(m_results["Mean"], "500.0 HU");
  EXPECT_EQ(m_results["SD"], "0.0 HU");
  EXPECT_GT(std::stoi(m_results["Voxels"]), 10000);
}

TEST_F(RenderMeasure, WithoutAnnotationsNothingIsMeasured) {
  BoxSheet({"--no-annotations"});
  EXPECT_EQ(m_results, Results{});
}

}  // namespace
