#include "CutFixture.h"
#include "GreyModel.h"

#include <algorithm>

namespace {

using cli_test::Arguments;
using cli_test::Conditions;
using cli_test::Outcome;
using cli_test::Picture;
using cli_test::Point;
using cli_test::ReadPng;
using cli_test::RunTool;
using cli_test::SmallVolume;
using Names = std::vector<std::string>;

constexpr int kSide = 21;
constexpr int kMiddle = 10;

/// 21 x 21 x 21 voxels of 1 mm, the first at the origin, with values from 1 to 250: under the
/// window of `Draw` each value is a grey level of its own, and an outline is white.
class Project : public SmallVolume {
 protected:
  Project() : SmallVolume({kSide, kSide, kSide}, 1, 3, 1, 250) {}

  int Level(int stored) const { return m_levels[static_cast<std::size_t>(stored)]; }

  Picture Draw(const Arguments& more) const {
    Arguments arguments{"project",       PathOf("volume.bdf"), "-o",
                        PathOf("a.png"), "--window",           "-873,255"};
    arguments.insert(arguments.end(), more.begin(), more.end());
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 0) << outcome.errors;
    EXPECT_EQ(outcome.errors, "");
    EXPECT_EQ(outcome.output, "");
    return ReadPng(PathOf("a.png"));
  }

  std::vector<int> m_levels = cli_test::WindowLevels(127, 255, 256);
};

/// The outline, and a square inside it at the first pixel.
bool IsWhite(int x, int y) {
  return x == 0 || y == 0 || x == kSide - 1 || y == kSide - 1 || (x < 8 && y < 8);
}

TEST_F(Project, ASliceSeenAlongItsNormalHasOutlineMarkAndItsVoxels) {
  struct Case {
    const char* plane;
    std::function<int(int x, int y)> stored;
  };
  for (const Case& one :
       {Case{"axial", [this](int x, int y) { return At(x, y, kMiddle); }},
        Case{"coronal", [this](int x, int y) { return At(x, kMiddle, kSide - 1 - y); }},
        Case{"sagittal", [this](int x, int y) { return At(kMiddle, x, kSide - 1 - y); }}}) {
    for (const char* volume : {"none", "behind"}) {
      const Picture picture =
          Draw({"--plane", one.plane, "--slices", one.plane, "--volume", volume});
      ASSERT_EQ(picture.width, kSide);
      ASSERT_EQ(picture.height, kSide);
      for (int y = 0; y < kSide; ++y) {
        for (int x = 0; x < kSide; ++x) {
          ASSERT_EQ(picture.At(x, y), IsWhite(x, y) ? 255 : Level(one.stored(x, y)))
              << one.plane << " " << x << " " << y;
        }
      }
    }
  }
}

TEST_F(Project, AllAddsBrighterVoxelsInFrontOfASlice) {
  const Picture picture = Draw({"--plane", "axial", "--slices", "axial", "--volume", "all"});
  for (int y = 0; y < kSide; ++y) {
    for (int x = 0; x < kSide; ++x) {
      // Seen from the feet: slices below the middle one lie in front of it.
      int largest = At(x, y, kMiddle);
      for (int k = 0; k < kMiddle; ++k) {
        largest = std::max(largest, At(x, y, k));
      }
      ASSERT_EQ(picture.At(x, y), IsWhite(x, y) ? 255 : Level(largest)) << x << " " << y;
    }
  }
}

TEST_F(Project, WhereNoSliceIsTheWholeVolumeIsProjected) {
  // Seen from the front, the axial slice is a line and the sagittal one a column; what is nearer
  // than the lines' pixels plays no part.
  const Picture picture = Draw({"--plane", "coronal", "--slices", "axial"});
  for (int y = 0; y < kSide; ++y) {
    for (int x = 0; x < kSide; ++x) {
      if (std::abs(y - kMiddle) <= 3) {
        continue;
      }
      int largest = 0;
      for (int j = 0; j < kSide; ++j) {
        largest = std::max(largest, At(x, j, kSide - 1 - y));
      }
      ASSERT_EQ(picture.At(x, y), Level(largest)) << x << " " << y;
    }
  }
  for (int x = 0; x < kSide; ++x) {
    EXPECT_EQ(picture.At(x, kMiddle), 255) << x;
  }
}

TEST_F(Project, NearerPartsHideFartherOnes) {
  // Seen from the front and 45 degrees above: the upper half of the coronal slice lies in front of
  // the rear half of the axial one, whose front half hides the lower half of the coronal one.
  for (int j = 0; j < kSide; ++j) {
    for (int i = 0; i < kSide; ++i) {
      for (int k = 0; k < kSide; ++k) {
        At(i, j, k) = k == kMiddle ? 50 : j == kMiddle ? 150 : 1;
      }
    }
  }
  Write();
  for (const char* slices : {"axial,coronal", "coronal,axial"}) {
    const Picture picture = Draw({"--rotate", "-45,0,0", "--slices", slices, "--volume", "none",
                                  "--center", "10,10,10", "--size", "21x31"});
    const int middle = 15;
    // 5 mm from the centre in either slice are 3.5 pixels. The rear of the axial slice and the
    // upper part of the coronal one are seen at the same place, as are front and lower part.
    EXPECT_EQ(picture.At(kMiddle, middle - 4), Level(150)) << slices;
    EXPECT_EQ(picture.At(kMiddle, middle + 4), Level(50)) << slices;
    EXPECT_EQ(picture.At(15, middle - 4), Level(150)) << slices;
    EXPECT_EQ(picture.At(15, middle + 4), Level(50)) << slices;
  }
}

TEST_F(Project, TheUsualViewIsFromAboveAndThePatientsLeftWithClosedOutlines) {
  // What lies high, in front, or on the left must be seen: a bright voxel block at each place.
  const auto blockAt = [this](int x, int y, int z) {
    std::fill(m_values.begin(), m_values.end(), 1);
    for (int k = z - 1; k <= z + 1; ++k) {
      for (int j = y - 1; j <= y + 1; ++j) {
        for (int i = x - 1; i <= x + 1; ++i) {
          At(i, j, k) = 200;
        }
      }
    }
    Write();
    const Picture picture = Draw({"--slices", "axial", "--volume", "none", "--size", "61x61",
                                  "--spacing", "0.5", "--center", "10,10,10"});
    double sumX = 0;
    double sumY = 0;
    double count = 0;
    for (int v = 0; v < 61; ++v) {
      for (int u = 0; u < 61; ++u) {
        if (picture.At(u, v) == Level(200)) {
          sumX += u;
          sumY += v;
          count += 1;
        }
      }
    }
    EXPECT_GT(count, 0);
    return Point{sumX / count - 30, sumY / count - 30, 0};
  };
  // From the patient's left, the front turns to the left of the picture; from above, it is low.
  const Point front = blockAt(10, 4, 10);
  EXPECT_LT(front[0], -3);
  EXPECT_GT(front[1], 2);
  // The patient's left is on the right and, turned to the viewer, low as well.
  const Point left = blockAt(16, 10, 10);
  EXPECT_GT(left[0], 7);
  EXPECT_GT(left[1], 1);
}

TEST_F(Project, SlicesInTurnedViewsHaveNoHoles) {
  std::fill(m_values.begin(), m_values.end(), 120);
  Write();
  for (const char* spacing : {"1", "0.4", "2.2"}) {
    const Picture picture =
        Draw({"--rotate", "33,27,15", "--slices", "axial,coronal,sagittal", "--volume", "none",
              "--size", "5x5", "--center", "10,10,10", "--spacing", spacing});
    for (const unsigned char level : picture.levels) {
      EXPECT_GE(level, Level(120)) << spacing;
    }
  }
}

TEST_F(Project, SlicesGoThroughTheCentre) {
  const Picture picture =
      Draw({"--plane", "axial", "--slices", "axial", "--volume", "none", "--center", "3,4,17"});
  EXPECT_EQ(picture.At(12, 13), Level(At(12, 13, 17)));
  EXPECT_EQ(picture.At(9, 9), Level(At(9, 9, 17)));
}

#if !defined(_WIN32)  // no signals and no pseudo terminal there
TEST_F(Project, InterruptedItLeavesTheEarlierFile) {
  study_test::WriteBytes(PathOf("a.png"), "earlier");
  Conditions conditions;
  conditions.terminalColumns = 80;
  conditions.when = [](const Outcome& soFar) {
    return soFar.errors.find("drawing the view") != std::string::npos;
  };
  const Outcome outcome = RunTool({"project", "--phantom=64x64x64", "-o", PathOf("a.png"), "--size",
                                   "9000x9000", "--spacing", "0.04"},
                                  conditions);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_NE(outcome.errors.find("vorl: cancelled"), std::string::npos);
  EXPECT_EQ(m_folder.Names(), (Names{"a.png", "volume.bdf"}));
  EXPECT_EQ(study_test::ReadBytes(PathOf("a.png")), "earlier");
}

#endif

TEST_F(Project, AVolumeFarBeyondThePictureIsRefused) {
  const Outcome outcome = RunTool(
      {"project", "--phantom=8x8x8", "-o", PathOf("a.png"), "--size", "9x9", "--spacing", "0.005"});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors,
            "vorl: the volume reaches more than 32767 pixels away from the picture's first one\n");
  EXPECT_EQ(m_folder.Names(), Names{"volume.bdf"});
}

struct ProjectUsage {
  Arguments arguments;
  const char* message;
};

TEST_F(Project, WrongUsageIsToldBeforeAnythingIsOpened) {
  for (const ProjectUsage& one :
       {ProjectUsage{{}, "no output is named (-o OUT.png or -o OUT.bmp)"},
        ProjectUsage{{"-o", "x.bdf"}, "-o: the name 'x.bdf' does not end in .png or .bmp"},
        ProjectUsage{{"-o", "x.png", "--slices", "axial,oblique"},
                     "--slices: 'oblique' is not one of axial, coronal, sagittal"},
        ProjectUsage{{"-o", "x.png", "--slices", "axial,"},
                     "--slices: '' is not one of axial, coronal, sagittal"},
        ProjectUsage{{"-o", "x.png", "--slices", "axial,axial"},
                     "--slices: 'axial' is named twice"},
        ProjectUsage{{"-o", "x.png", "--volume", "front"},
                     "--volume: 'front' is not one of behind, all, none"},
        ProjectUsage{{"-o", "x.png", "--rotate", "1"},
                     "--rotate: '1' is not X,Y,Z (three numbers with commas between them)"}}) {
    Arguments arguments{"project", "/no/such"};
    arguments.insert(arguments.end(), one.arguments.begin(), one.arguments.end());
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.errors,
              std::string("vorl: ") + one.message + "\nvorl: try 'vorl project --help'\n");
  }
}

}  // namespace
