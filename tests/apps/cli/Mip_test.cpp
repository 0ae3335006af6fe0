#include "CutFixture.h"
#include "GreyModel.h"

#include <algorithm>

namespace {

using cli_test::Arguments;
using cli_test::Conditions;
using cli_test::Outcome;
using cli_test::Picture;
using cli_test::ReadBmp;
using cli_test::ReadPng;
using cli_test::RunTool;
using cli_test::SmallVolume;
using cli_test::VolumeModel;
using Names = std::vector<std::string>;

constexpr int kWidth = 9;
constexpr int kHeight = 7;
constexpr int kSlices = 6;

/// 9 x 7 x 6 voxels of 1 x 1 x 2 mm, the first at the origin, with values below 256: under the
/// window of `Exact` each value is a grey level of its own.
class Mip : public SmallVolume {
 protected:
  Mip() : SmallVolume({kWidth, kHeight, kSlices}, 2, 20, 0, 256) {}

  Picture Project(const Arguments& more) const {
    Arguments arguments{"mip", PathOf("volume.bdf"), "-o", PathOf("a.png"), "--window", "-873,255"};
    arguments.insert(arguments.end(), more.begin(), more.end());
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 0) << outcome.errors;
    EXPECT_EQ(outcome.output, "");
    return ReadPng(PathOf("a.png"));
  }

  /// The largest value of a row of voxels.
  template <class Value>
  static int Largest(int count, Value&& value) {
    int largest = 0;
    for (int n = 0; n < count; ++n) {
      largest = std::max(largest, value(n));
    }
    return largest;
  }

  int Level(int stored) const { return m_levels[static_cast<std::size_t>(stored)]; }

  std::vector<int> m_levels = cli_test::WindowLevels(127, 255, 256);
};

TEST_F(Mip, AxialIsTheMaximumOverAllSlices) {
  const Picture picture = Project({});
  ASSERT_EQ(picture.width, kWidth);
  ASSERT_EQ(picture.height, kHeight);
  for (int y = 0; y < kHeight; ++y) {
    for (int x = 0; x < kWidth; ++x) {
      EXPECT_EQ(picture.At(x, y), Level(Largest(kSlices, [&](int k) { return At(x, y, k); })));
    }
  }
}

TEST_F(Mip, CoronalIsTheMaximumOverAllRowsWithTheHeadUp) {
  const Picture picture = Project({"--plane", "coronal"});
  ASSERT_EQ(picture.width, kWidth);
  ASSERT_EQ(picture.height, 2 * kSlices);
  for (int y = 0; y < picture.height; ++y) {
    for (int x = 0; x < kWidth; ++x) {
      const int k = kSlices - 1 - y / 2;
      EXPECT_EQ(picture.At(x, y), Level(Largest(kHeight, [&](int j) { return At(x, j, k); })));
    }
  }
}

TEST_F(Mip, SagittalIsTheMaximumOverAllColumnsWithTheBackOnTheRight) {
  const Picture picture = Project({"--plane", "sagittal"});
  ASSERT_EQ(picture.width, kHeight);
  ASSERT_EQ(picture.height, 2 * kSlices);
  for (int y = 0; y < picture.height; ++y) {
    for (int x = 0; x < kHeight; ++x) {
      const int k = kSlices - 1 - y / 2;
      EXPECT_EQ(picture.At(x, y), Level(Largest(kWidth, [&](int i) { return At(i, x, k); })));
    }
  }
}

TEST_F(Mip, LinearMeetsTheVoxelsCentresAlongAnAxis) {
  for (const char* plane : {"axial", "coronal", "sagittal"}) {
    const Picture nearest =
        Project({"--plane", plane, "--spacing", "2", "--size", "3x3", "--center", "4,3,4"});
    const Picture linear = Project({"--plane", plane, "--spacing", "2", "--size", "3x3", "--center",
                                    "4,3,4", "--filter", "linear"});
    for (std::size_t i = 0; i < nearest.levels.size(); ++i) {
      // Each of the three interpolations cuts off; the mean of neighbours would lack dozens.
      EXPECT_NEAR(linear.levels[i], nearest.levels[i], 4) << plane << i;
    }
  }
}

TEST_F(Mip, ASlabTakesItsVoxelsOnly) {
  // Slice k lies around z = 2 k; the slab reaches from 3.2 to 6.8 mm: into slices 2 and 3.
  const Picture picture = Project({"--slab", "3.6", "--center", "0,0,5"});
  for (int y = 0; y < kHeight; ++y) {
    for (int x = 0; x < kWidth; ++x) {
      EXPECT_EQ(picture.At(x, y), Level(std::max(At(x, y, 2), At(x, y, 3))));
    }
  }
}

TEST_F(Mip, NoLayerIsJumpedOverInAThickSlab) {
  // One bright voxel in any slice must be seen whatever the slab's thickness.
  for (int bright = 0; bright < 40; ++bright) {
    VolumeModel volume = Model();
    volume.size = {1, 1, 40};
    volume.stored = [bright](int, int, int k) { return k == bright ? 255 : 0; };
    cli_test::WriteVolume(volume, PathOf("volume.bdf"));
    EXPECT_EQ(Project({"--center", "0,0,39", "--slab", "79"}).At(0, 0), 255) << bright;
    EXPECT_EQ(Project({}).At(0, 0), 255) << bright;
  }
}

TEST_F(Mip, TheUsualWindowLeavesTheMiddleOfAllThatIsNotBackgroundBlack) {
  // Half of the voxels are background, most others tissue of 1000 to 1002, a few are bone, and one
  // in 20,000 is metal.
  VolumeModel volume = Model();
  volume.size = {200, 100, 1};
  volume.stored = [](int i, int j, int) {
    return j < 50 ? (i == 7 && j == 7 ? 30000 : 0) : i < 4 ? 2001 : 1000 + i % 3;
  };
  cli_test::WriteVolume(volume, PathOf("volume.bdf"));
  const Outcome outcome = RunTool({"mip", PathOf("volume.bdf"), "-o", PathOf("a.png")});
  EXPECT_EQ(outcome.errors, "");
  const Picture picture = ReadPng(PathOf("a.png"));
  EXPECT_EQ(picture.At(50, 5), 0);
  EXPECT_EQ(picture.At(100, 60), 0);             // 1001: black begins here
  EXPECT_NEAR(picture.At(2, 60), 255 / 1.1, 2);  // 2001: a tenth below white
  EXPECT_EQ(picture.At(7, 7), 255);
}

TEST_F(Mip, TurntableViewsGoAroundTheBodyFromTheFrontToTheLeft) {
  const Arguments place{"--center", "4,3,5", "--size", "15x14"};
  const auto with = [&place](const Arguments& more) {
    Arguments arguments = more;
    arguments.insert(arguments.end(), place.begin(), place.end());
    return arguments;
  };
  const Picture front = Project(with({"--plane", "coronal"}));
  const Picture left = Project(with({"--plane", "sagittal"}));
  const Picture back = Project(with({"--plane", "coronal", "--rotate", "0,180,0"}));
  study_test::fs::remove(PathOf("a.png"));
  const Outcome outcome =
      RunTool({"mip", PathOf("volume.bdf"), "-o", PathOf("turn.png"), "--window", "-873,255",
               "--turntable", "4", "--center", "4,3,5", "--size", "15x14"});
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  EXPECT_EQ(outcome.errors, "");
  EXPECT_EQ(m_folder.Names(),
            (Names{"turn-001.png", "turn-002.png", "turn-003.png", "turn-004.png", "volume.bdf"}));
  EXPECT_EQ(ReadPng(PathOf("turn-001.png")).levels, front.levels);
  EXPECT_EQ(ReadPng(PathOf("turn-002.png")).levels, left.levels);
  EXPECT_EQ(ReadPng(PathOf("turn-003.png")).levels, back.levels);
}

TEST_F(Mip, TurntableViewsAreOfOneSizeThatHoldsTheVolume) {
  const Outcome outcome = RunTool({"mip", PathOf("volume.bdf"), "-o", PathOf("t.bmp"), "--window",
                                   "-1000,2", "--turntable", "12"});
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  // The farthest corner lies 5 mm across and 4 mm deep from the middle voxel's centre: 6.403 mm,
  // which no view meets exactly; the head-feet reach is 7 mm.
  const Picture first = ReadBmp(PathOf("t-001.bmp"));
  EXPECT_GE(first.width, 10);
  EXPECT_LE(first.width, 13);
  EXPECT_EQ(first.height, 14);
  for (int view = 2; view <= 12; ++view) {
    const std::string name = std::string("t-0") + (view < 10 ? "0" : "") + std::to_string(view);
    const Picture picture = ReadBmp(PathOf(name + ".bmp"));
    EXPECT_EQ(picture.width, first.width) << view;
    EXPECT_EQ(picture.height, first.height) << view;
  }
}

TEST_F(Mip, AVolumeBesideTheSlabIsNoted) {
  const Outcome outcome = RunTool(
      {"mip", PathOf("volume.bdf"), "-o", PathOf("a.png"), "--slab", "2", "--center", "0,0,500"});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "vorl: note: the plane does not meet the volume\n");
}

#if !defined(_WIN32)  // no signals and no pseudo terminal there
TEST_F(Mip, InterruptedATurntableLeavesTheEarlierFilesOnly) {
  study_test::WriteBytes(PathOf("turn-001.png"), "earlier");
  Conditions conditions;
  conditions.terminalColumns = 80;
  conditions.when = [this](const Outcome&) { return m_folder.Names().size() > 3; };
  const Outcome outcome = RunTool(
      {"mip", "--phantom=64x64x64", "-o", PathOf("turn.png"), "--turntable", "3600"}, conditions);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_NE(outcome.errors.find("vorl: cancelled"), std::string::npos);
  EXPECT_EQ(m_folder.Names(), (Names{"turn-001.png", "volume.bdf"}));
  EXPECT_EQ(study_test::ReadBytes(PathOf("turn-001.png")), "earlier");
}

TEST_F(Mip, InterruptedAProjectionEndsTheRun) {
  Conditions conditions;
  conditions.terminalColumns = 80;
  conditions.when = [](const Outcome& soFar) {
    return soFar.errors.find("projecting the volume") != std::string::npos;
  };
  const Outcome outcome = RunTool({"mip", "--phantom=64x64x64", "-o", PathOf("a.png"), "--size",
                                   "10000x10000", "--spacing", "0.04"},
                                  conditions);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_NE(outcome.errors.find("vorl: cancelled"), std::string::npos);
  EXPECT_EQ(m_folder.Names(), Names{"volume.bdf"});
}

#endif

struct MipUsage {
  Arguments arguments;
  const char* message;
};

TEST_F(Mip, WrongUsageIsToldBeforeAnythingIsOpened) {
  for (const MipUsage& one : {
         MipUsage{{}, "no output is named (-o OUT.png or -o OUT.bmp)"},
             MipUsage{{"-o", "x.jpg"}, "-o: the name 'x.jpg' does not end in .png or .bmp"},
             MipUsage{{"-o", "x.png", "--slab", "0"}, "--slab: '0' is not a number greater than 0"},
             MipUsage{{"-o", "x.png", "--turntable", "1"},
                      "--turntable: '1' is not a whole number from 2 to 3600"},
#if !defined(_WIN32)  // devices are no files there
             MipUsage{{"-o", "/dev/null", "--turntable", "4"},
                      "--turntable makes several files, but '/dev/null' is a device"},
#endif
             MipUsage{{"-o", "x.png", "--filter", "cubic"},
                      "--filter: 'cubic' is not one of nearest, linear"},
             MipUsage {
           {"-o", "x.png", "--plane", ""},
               "--plane: '' is not one of axial, coronal, sagittal, oblique"
         }
       }) {
    Arguments arguments{"mip", "/no/such"};
    arguments.insert(arguments.end(), one.arguments.begin(), one.arguments.end());
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.errors,
              std::string("vorl: ") + one.message + "\nvorl: try 'vorl mip --help'\n");
  }
}

TEST_F(Mip, AMissingFolderIsToldBeforeAnythingIsLoaded) {
  const Outcome outcome =
      RunTool({"mip", "/no/such", "-o", PathOf("no/a.png"), "--turntable", "3"});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors,
            "vorl: the folder of '" + PathOf("no/a-001.png") + "' does not exist\n");
}

}  // namespace
