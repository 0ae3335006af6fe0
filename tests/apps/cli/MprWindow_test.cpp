#include "CutFixture.h"
#include "GreyModel.h"

#include <study/StudyFile.h>

#include <string>

namespace {

using cli_test::Arguments;
using cli_test::CutFixture;
using cli_test::Picture;
using cli_test::Point;
using cli_test::VolumeModel;

/// A volume of one slice of 64 x 64 voxels: the stored values are 0, 1, 2 ... or multiples.
class MprWindow : public CutFixture {
 protected:
  static constexpr int kSide = 64;
  static constexpr int kOffset = -1000;  // of the written volume

  void WriteRamp(int factor) {
    VolumeModel volume;
    volume.size = {kSide, kSide, 1};
    volume.step = {Point{1, 0, 0}, Point{0, 1, 0}, Point{0, 0, 1}};
    volume.stored = [factor](int i, int j, int) { return factor * (j * kSide + i); };
    cli_test::WriteVolume(volume, PathOf("ramp.bdf"));
  }

  std::vector<int> LevelsWith(const Arguments& options) const {
    Arguments arguments{PathOf("ramp.bdf")};
    arguments.insert(arguments.end(), options.begin(), options.end());
    const Picture picture = CutPicture(arguments);
    EXPECT_EQ(picture.width, kSide);
    EXPECT_EQ(picture.height, kSide);
    return {picture.levels.begin(), picture.levels.end()};
  }

  /// What a window in real values must show of the ramp.
  static std::vector<int> ExpectedLevels(long centre, long width, int factor) {
    const std::vector<int> table = cli_test::WindowLevels(centre - kOffset, width, 65536);
    std::vector<int> levels;
    for (int n = 0; n < kSide * kSide; ++n) {
      levels.push_back(table[static_cast<std::size_t>(n * factor)]);
    }
    return levels;
  }
};

TEST_F(MprWindow, NumbersAreInRealValues) {
  WriteRamp(1);
  EXPECT_EQ(LevelsWith({"--window", "40,400"}), ExpectedLevels(40, 400, 1));
  EXPECT_EQ(LevelsWith({"--window", "1500.4,777"}), ExpectedLevels(1500, 777, 1));
}

TEST_F(MprWindow, PresetsAreTheirNumbers) {
  WriteRamp(1);
  EXPECT_EQ(LevelsWith({"--window", "bone"}), ExpectedLevels(500, 2000, 1));
  EXPECT_EQ(LevelsWith({"--window", "lung"}), ExpectedLevels(-600, 1500, 1));
  EXPECT_EQ(LevelsWith({"--window", "soft"}), ExpectedLevels(40, 400, 1));
  EXPECT_EQ(LevelsWith({"--window", "brain"}), ExpectedLevels(40, 80, 1));
  EXPECT_EQ(LevelsWith({"--window", "mediastinum"}), ExpectedLevels(50, 350, 1));
  EXPECT_EQ(LevelsWith({"--window", "liver"}), ExpectedLevels(60, 160, 1));
  EXPECT_EQ(LevelsWith({"--window", "angio"}), ExpectedLevels(300, 600, 1));
}

TEST_F(MprWindow, MayBeginBelowTheSmallestStoredValue) {
  WriteRamp(1);  // the smallest real value is -1000
  EXPECT_EQ(LevelsWith({"--window", "-800,1500"}), ExpectedLevels(-800, 1500, 1));
}

TEST_F(MprWindow, MayHaveItsCentreBelowTheSmallestStoredValue) {
  WriteRamp(1);
  EXPECT_EQ(LevelsWith({"--window", "-1200,3000"}), ExpectedLevels(-1200, 3000, 1));
  EXPECT_EQ(LevelsWith({"--window", "-30000,60000"}), ExpectedLevels(-30000, 60000, 1));
}

TEST_F(MprWindow, MayLieBesideAllValues) {
  WriteRamp(1);
  EXPECT_EQ(LevelsWith({"--window", "-50000,100"}), std::vector<int>(kSide * kSide, 255));
  EXPECT_EQ(LevelsWith({"--window", "-1e300,1"}), std::vector<int>(kSide * kSide, 255));
  EXPECT_EQ(LevelsWith({"--window", "90000,100"}), std::vector<int>(kSide * kSide, 0));
  EXPECT_EQ(LevelsWith({"--window", "1e300,1"}), std::vector<int>(kSide * kSide, 0));
}

TEST_F(MprWindow, MayHaveItsCentreAboveTheLargestStoredValue) {
  WriteRamp(16);  // up to 65520
  EXPECT_EQ(LevelsWith({"--window", "70000,60000"}), ExpectedLevels(70000, 60000, 16));
}

TEST_F(MprWindow, MayBeWiderThanAllStoredValues) {
  WriteRamp(16);
  const std::vector<int> expected = ExpectedLevels(31000, 200000, 16);
  const std::vector<int> levels = LevelsWith({"--window", "31000,200000"});
  ASSERT_EQ(levels.size(), expected.size());
  for (std::size_t i = 0; i < levels.size(); ++i) {
    ASSERT_NEAR(levels[i], expected[i], 1) << i;  // the samples are rounded first
  }
}

TEST_F(MprWindow, AutoLeavesHalfAPercentOnEitherSide) {
  WriteRamp(1);
  // 4096 different values: 20 of them may lie below, and 20 above, which leaves 20 to 4075.
  EXPECT_EQ(LevelsWith({"--window", "auto"}), ExpectedLevels(2048 + kOffset, 4055, 1));
}

TEST_F(MprWindow, AutoTakesAVolumeOfOneValue) {
  WriteRamp(0);
  const std::vector<int> levels = LevelsWith({"--window", "auto"});
  EXPECT_EQ(levels, std::vector<int>(kSide * kSide, 128));
}

TEST_F(MprWindow, AnInputWithoutAWindowIsShownAsWithAuto) {
  WriteRamp(1);
  EXPECT_EQ(LevelsWith({}), LevelsWith({"--window", "auto"}));
}

TEST_F(MprWindow, AnInputsOwnWindowIsTheUsualOne) {
  const Arguments phantom{"--phantom=16x16x12"};
  const Picture usual = CutPicture(phantom);
  EXPECT_EQ(usual.levels, CutPicture({phantom[0], "--window", "40,400"}).levels);
  EXPECT_NE(usual.levels, CutPicture({phantom[0], "--window", "auto"}).levels);
}

TEST_F(MprWindow, BrightnessContrastAndGammaBendTheLevelsInsideTheWindow) {
  WriteRamp(1);
  const std::vector<int> levels = cli_test::WindowLevels(2000, 3000, kSide * kSide);
  struct Case {
    double brightness, contrast, gamma;
  };
  for (const Case& one : {Case{0.3, 0, 1}, Case{-0.3, 0, 1}, Case{0, 0.4, 1}, Case{0, -0.4, 1},
                          Case{0, 0, 2.2}, Case{0, 0, 0.5}, Case{0.1, 0.2, 1.5}}) {
    const std::vector<int> stage = cli_test::SecondStage(one.brightness, one.contrast, one.gamma);
    std::vector<int> expected;
    for (int n = 0; n < kSide * kSide; ++n) {
      const int level = levels[static_cast<std::size_t>(n)];
      expected.push_back(n >= 500 && n < 3500 ? stage[static_cast<std::size_t>(level)] : level);
    }
    EXPECT_EQ(LevelsWith({"--window", "1000,3000", "--brightness", std::to_string(one.brightness),
                          "--contrast", std::to_string(one.contrast), "--gamma",
                          std::to_string(one.gamma)}),
              expected)
        << one.brightness << " " << one.contrast << " " << one.gamma;
  }
}

TEST_F(MprWindow, NeutralLevelsLeaveTheWindowExact) {
  WriteRamp(1);
  EXPECT_EQ(
      LevelsWith({"--window", "1000,3000", "--brightness", "0", "--contrast", "0", "--gamma", "1"}),
      ExpectedLevels(1000, 3000, 1));
}

TEST_F(MprWindow, APresetForOtherUnitsIsNoted) {
  study::Study study;
  study::AppendSlice(study, 4, 4);
  study::PlaceVolume(study, {}, {1, 0, 0}, {0, 1, 0}, {0, 0, 1});
  study::WriteStudyFile(study, PathOf("plain.bdf"));
  const Arguments arguments{"mpr", PathOf("plain.bdf"), "-o", PathOf("a.png"), "--window", "bone"};
  EXPECT_EQ(cli_test::RunTool(arguments).errors,
            "vorl: note: the window 'bone' is meant for Hounsfield units, the values are in no "
            "unit\n");
  WriteRamp(1);
  EXPECT_EQ(
      cli_test::RunTool({"mpr", PathOf("ramp.bdf"), "-o", PathOf("a.png"), "--window", "bone"})
          .errors,
      "");
}

}  // namespace
