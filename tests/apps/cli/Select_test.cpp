#include "CutFixture.h"

#include <study/VoxelListFile.h>

#include <algorithm>
#include <map>

namespace {

using cli_test::Arguments;
using cli_test::Conditions;
using cli_test::Lines;
using cli_test::Outcome;
using cli_test::Picture;
using cli_test::ReadPng;
using cli_test::RunTool;
using cli_test::SmallVolume;
using Names = std::vector<std::string>;

constexpr int kWidth = 12;
constexpr int kHeight = 9;
constexpr int kSlices = 5;

/// 12 x 9 x 5 voxels of 1 x 1 x 2 mm; value = stored - 1000.
class Select : public SmallVolume {
 protected:
  Select() : SmallVolume({kWidth, kHeight, kSlices}, 2, 7, 0, 400) {}

  Outcome Run(const Arguments& more) const {
    Arguments arguments{"select", PathOf("volume.bdf"), "-o", PathOf("list.bdf")};
    arguments.insert(arguments.end(), more.begin(), more.end());
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 0) << outcome.errors;
    return outcome;
  }

  std::vector<std::uint32_t> Listed() const {
    return study::ReadVoxelList(PathOf("list.bdf")).voxels;
  }

  /// The voxels of the highest classes, whole classes only, in the order z, y, x.
  template <class Class>
  std::vector<std::uint32_t> Highest(int width, int height, std::size_t limit, Class&& classOf) {
    std::map<int, std::vector<std::uint32_t>, std::greater<>> classes;
    for (int k = 0; k < kSlices; ++k) {
      for (int j = 0; j < height; ++j) {
        for (int i = 0; i < width; ++i) {
          classes[classOf(i, j, k)].push_back(static_cast<std::uint32_t>(k << 22 | j << 11 | i));
        }
      }
    }
    std::vector<std::uint32_t> voxels;
    for (const auto& [value, members] : classes) {
      if (voxels.size() + members.size() > limit) {
        break;
      }
      voxels.insert(voxels.end(), members.begin(), members.end());
    }
    std::sort(voxels.begin(), voxels.end());
    return voxels;
  }
};

TEST_F(Select, ByValueListsTheHighestValues) {
  for (const std::size_t limit : {10, 20, 100, 539, 540}) {
    EXPECT_EQ(Run({"--limit", std::to_string(limit)}).errors, "");
    const auto expected =
        Highest(kWidth, kHeight, limit, [this](int i, int j, int k) { return At(i, j, k); });
    EXPECT_FALSE(expected.empty());
    EXPECT_EQ(Listed(), expected) << limit;
  }
}

TEST_F(Select, ByEdgeListsTheSteepestRises) {
  EXPECT_EQ(Run({"--by", "edge", "--limit", "50"}).errors, "");
  // The last column and the last row have no neighbours to rise above.
  const auto expected = Highest(kWidth - 1, kHeight - 1, 50, [this](int i, int j, int k) {
    return std::max(0, At(i, j, k) - std::min(At(i + 1, j, k), At(i, j + 1, k)));
  });
  EXPECT_EQ(Listed(), expected);
  EXPECT_EQ(study::ReadVoxelList(PathOf("list.bdf")).criterion, "edge");
}

TEST_F(Select, PercentagesAreOfTheWholeVolumeAndOneIsUsual) {
  Run({"--limit", "10%"});
  EXPECT_EQ(study::ReadVoxelList(PathOf("list.bdf")).limit, 54u);
  const auto ten = Listed();
  Run({"--limit", "54"});
  EXPECT_EQ(Listed(), ten);
  Run({});
  EXPECT_EQ(study::ReadVoxelList(PathOf("list.bdf")).limit, 5u);  // of 5.4
  Run({"--limit", "1e2%"});
  EXPECT_EQ(Listed().size(), 540u);
}

TEST_F(Select, TheListTellsWhereItComesFrom) {
  Run({"--limit", "54"});
  const study::VoxelList list = study::ReadVoxelList(PathOf("list.bdf"));
  EXPECT_EQ(list.size, (std::array<std::uint32_t, 3>{kWidth, kHeight, kSlices}));
  EXPECT_EQ(list.criterion, "value");
  EXPECT_EQ(list.unit, "HU");
  EXPECT_EQ(list.offset, -1000);
  EXPECT_EQ(list.coordinates.axisZ.z, 2);
  std::uint32_t lowest = 65535;
  for (const std::uint32_t voxel : list.voxels) {
    lowest = std::min(lowest, static_cast<std::uint32_t>(At(
                                  int(voxel & 2047), int(voxel >> 11 & 2047), int(voxel >> 22))));
  }
  EXPECT_EQ(list.lowestClass, lowest);
}

TEST_F(Select, TheTableCountsTheClassesFromTheHighestOn) {
  std::fill(m_values.begin(), m_values.end(), 0);
  std::fill_n(m_values.begin(), 5, 900);
  std::fill_n(m_values.begin() + 5, 20, 811);
  Write();
  const Outcome outcome = Run({"--limit", "10"});
  const std::vector<std::string> lines = Lines(outcome.output);
  ASSERT_EQ(lines.size(), 3u + 19u) << outcome.output;
  EXPECT_EQ(lines[0], "Voxels by value in HU");
  EXPECT_EQ(lines[1], "        from          to      voxels         %     sum %      listed");
  EXPECT_EQ(lines[2], "        -100        -100           5     0.926     0.926           5");
  EXPECT_EQ(lines[3], "        -150        -101           0     0.000     0.926           0");
  EXPECT_EQ(lines[4], "        -200        -151          20     3.704     4.630           0");
  EXPECT_EQ(lines[20], "       -1000        -951         515    95.370   100.000           0");
  EXPECT_EQ(lines[21], "Listed: 5 of 540 voxels (limit 10), from -100 on");
}

TEST_F(Select, AClassThatDoesNotFitLeavesTheListEmpty) {
  std::fill(m_values.begin(), m_values.end(), 7);
  Write();
  const Outcome outcome = Run({"--limit", "539", "--draw", PathOf("a.png")});
  EXPECT_EQ(outcome.errors,
            "vorl: note: no voxel is listed: the highest class has more than the limit of 539\n");
  EXPECT_TRUE(Listed().empty());
  EXPECT_EQ(Lines(outcome.output).back(), "Listed: 0 of 540 voxels (limit 539)");
  const Picture picture = ReadPng(PathOf("a.png"));
  EXPECT_TRUE(std::all_of(picture.levels.begin(), picture.levels.end(),
                          [](unsigned char level) { return level == 0; }));
}

TEST_F(Select, TheHighestStorableValueIsNeverListed) {
  m_values[3] = 65535;
  m_values[4] = 65534;
  Write();
  const Outcome outcome = Run({"--limit", "2"});
  EXPECT_EQ(outcome.errors,
            "vorl: note: the voxels of the highest value that can be stored are not listed\n");
  EXPECT_EQ(Listed(), std::vector<std::uint32_t>{4});
}

TEST_F(Select, EdgesBeyondTwelveBitsAreNoted) {
  m_values[3] = 4096;
  Write();
  EXPECT_EQ(Run({"--by", "edge"}).errors,
            "vorl: note: edges are found in the lowest 12 bits of the stored values, which go "
            "beyond\n");
  m_values[3] = 4095;
  Write();
  EXPECT_EQ(Run({"--by", "edge"}).errors, "");
}

TEST_F(Select, ThePictureShowsTheListedVoxelsWithoutHoles) {
  // A block of 3 x 2 x 2 voxels, the second half brighter.
  std::fill(m_values.begin(), m_values.end(), 10);
  for (int k = 1; k < 3; ++k) {
    for (int j = 4; j < 6; ++j) {
      for (int i = 2; i < 5; ++i) {
        At(i, j, k) = k == 1 ? 3000 : 4000;
      }
    }
  }
  Write();
  const Arguments draw{"--limit", "12", "--draw", PathOf("a.png")};
  const auto with = [&draw](const char* plane) {
    Arguments arguments = draw;
    arguments.insert(arguments.end(), {"--plane", plane});
    return arguments;
  };
  Run(with("axial"));
  const Picture axial = ReadPng(PathOf("a.png"));
  ASSERT_EQ(axial.width, kWidth);
  for (int y = 0; y < kHeight; ++y) {
    for (int x = 0; x < kWidth; ++x) {
      const bool inside = x >= 2 && x < 5 && y >= 4 && y < 6;
      EXPECT_EQ(axial.At(x, y) > 0, inside) << x << " " << y;
    }
  }
  Run(with("coronal"));
  const Picture coronal = ReadPng(PathOf("a.png"));
  ASSERT_EQ(coronal.height, 2 * kSlices);
  for (int y = 0; y < 2 * kSlices; ++y) {
    for (int x = 0; x < kWidth; ++x) {
      const int k = kSlices - 1 - y / 2;
      const int level = coronal.At(x, y);
      EXPECT_EQ(level > 0, x >= 2 && x < 5 && (k == 1 || k == 2)) << x << " " << y;
      EXPECT_EQ(level == 255, x >= 2 && x < 5 && k == 2) << x << " " << y;
    }
  }
}

TEST_F(Select, TurnedPicturesHaveNoHolesEither) {
  std::fill(m_values.begin(), m_values.end(), 500);
  m_values[0] = 0;
  Write();
  for (const char* spacing : {"1", "0.3", "2.7"}) {
    Run({"--limit", "539", "--draw", PathOf("a.png"), "--rotate", "33,21,17", "--spacing", spacing,
         "--center", "5.5,4,4", "--size", "3x3"});
    const Picture picture = ReadPng(PathOf("a.png"));
    EXPECT_TRUE(std::all_of(picture.levels.begin(), picture.levels.end(), [](unsigned char level) {
      return level > 0;
    })) << spacing;
  }
}

TEST_F(Select, VolumesBeyondTheListsPackingAreRefused) {
  struct Case {
    const char* size;
    const char* text;
  };
  for (const Case& one : {Case{"2x2x513", "2 x 2 x 513"}, Case{"2049x1x1", "2049 x 1 x 1"},
                          Case{"1x2049x1", "1 x 2049 x 1"}}) {
    const Outcome outcome =
        RunTool({"select", std::string("--phantom=") + one.size, "-o", PathOf("list.bdf")});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.output, "");
    EXPECT_EQ(outcome.errors, std::string("vorl: a volume of ") + one.text +
                                  " voxels is too large for a list of voxels (at most 2048 x 2048 "
                                  "x 512)\n");
  }
  EXPECT_EQ(RunTool({"select", "--phantom=2048x1x512", "-o", PathOf("list.bdf")}).code, 0);
  EXPECT_EQ(m_folder.Names(), (Names{"list.bdf", "volume.bdf"}));
}

TEST_F(Select, APercentageOfLessThanAVoxelIsRefused) {
  const Outcome outcome =
      RunTool({"select", PathOf("volume.bdf"), "-o", PathOf("list.bdf"), "--limit", "0.1%"});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: --limit: 0.1% of 540 voxels are less than one voxel\n");
  EXPECT_EQ(m_folder.Names(), Names{"volume.bdf"});
}

#if !defined(_WIN32)  // no signals, no pseudo terminal, and nothing limits the size of files
TEST_F(Select, InterruptedItLeavesNothing) {
  Conditions conditions;
  conditions.terminalColumns = 80;
  conditions.when = [](const Outcome& soFar) {
    return soFar.errors.find("drawing the view") != std::string::npos;
  };
  const Outcome outcome =
      RunTool({"select", "--phantom=64x64x64", "-o", PathOf("list.bdf"), "--draw", PathOf("a.png"),
               "--limit", "90%", "--rotate", "10,20,30", "--spacing", "0.05", "--size", "9x9"},
              conditions);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_NE(outcome.errors.find("vorl: cancelled"), std::string::npos);
  EXPECT_EQ(m_folder.Names(), Names{"volume.bdf"});
}

TEST_F(Select, FullDisksAreFailuresThatLeaveNothing) {
  Conditions full;
  full.largestFile = 100;
  const Outcome outcome = RunTool({"select", PathOf("volume.bdf"), "-o", PathOf("list.bdf")}, full);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: can't write '" + PathOf("list.bdf") +
                                "': the disk is full, or the writing failed\n");
  EXPECT_EQ(m_folder.Names(), Names{"volume.bdf"});
}

#endif

struct SelectUsage {
  Arguments arguments;
  std::string message;
};

TEST_F(Select, WrongUsageIsToldBeforeAnythingIsOpened) {
  const auto limit = [](const std::string& text) {
    return SelectUsage{{"-o", "x.bdf", "--limit", text},
                       "--limit: '" + text +
                           "' is neither a number of voxels (from 1 to 2147483647) nor a "
                           "percentage (up to 100%)"};
  };
  for (const SelectUsage& one :
       {SelectUsage{{}, "no output is named (-o LIST.bdf)"},
        SelectUsage{{"-o", "x.png"}, "-o: the name 'x.png' does not end in .bdf"},
        SelectUsage{{"-o", "x.bdf", "--by", "colour"}, "--by: 'colour' is not one of value, edge"},
        limit("0"), limit("2147483648"), limit("1.5"), limit("0%"), limit("100.1%"), limit("%"),
        limit("many"),
        SelectUsage{{"-o", "x.bdf", "--draw", "x.jpg"},
                    "--draw: the name 'x.jpg' does not end in .png or .bmp"},
        SelectUsage{{"-o", "x.bdf", "--size", "5x5"}, "--size needs --draw"},
        SelectUsage{{"-o", "x.bdf", "--window", "bone"}, "--window needs --draw"}}) {
    Arguments arguments{"select", "/no/such"};
    arguments.insert(arguments.end(), one.arguments.begin(), one.arguments.end());
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.errors, "vorl: " + one.message + "\nvorl: try 'vorl select --help'\n");
  }
}

}  // namespace
