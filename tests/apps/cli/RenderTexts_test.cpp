#include "RenderFixture.h"

#include <study/StudyFile.h>

#include <algorithm>
#include <vector>

// What is written around the pictures of a sheet.

namespace {

using cli_test::Arguments;
using cli_test::ColourPicture;
using cli_test::FindFrames;
using cli_test::Frame;
using cli_test::Frames;
using cli_test::kAxialColour;
using cli_test::kSheetColour;
using cli_test::kTextColour;
using cli_test::Point;
using cli_test::VolumeModel;

using RenderTexts = cli_test::Render;

constexpr unsigned kMeasuredColour = 0xFFAA30;
constexpr unsigned kWhite = 0xFFFFFF;

std::vector<Frame> All(const Frames& frames) {
  return {frames.axial, frames.projection, frames.coronal, frames.sagittal};
}

int Count(const ColourPicture& sheet, const Frame& box, unsigned colour) {
  int count = 0;
  for (int y = box.top; y < box.bottom; ++y) {
    for (int x = box.left; x < box.right; ++x) {
      count += sheet.At(x, y) == colour ? 1 : 0;
    }
  }
  return count;
}

/// Nothing in the colour of the rulers is in the pictures, and each main tick but those at the ends
/// has its label at its left.
void ExpectRulersBeside(const ColourPicture& sheet) {
  constexpr int kBehindMinorTicks = 7;
  constexpr int kEnd = 10;
  for (const Frame& frame : All(FindFrames(sheet))) {
    EXPECT_EQ(Count(sheet, frame, kTextColour), 0);
    int ticks = 0;
    for (int y = frame.top + kEnd; y < frame.bottom - kEnd; ++y) {
      if (sheet.At(frame.left - 1 - kBehindMinorTicks, y) == kTextColour) {
        ++ticks;
        const Frame label{frame.left - 22, y - 5, frame.left - 14, y + 6};
        EXPECT_GT(8 * 11 - Count(sheet, label, kSheetColour), 5) << y;
      }
    }
    EXPECT_GT(ticks, 0);
  }
}

TEST_F(RenderTexts, RulersStandOutsideOfLargePicturesToo) {
  const ColourPicture sheet = BoxSheet({"--size", "4600x4600"});
  int left = 0;  // of the axial picture
  while (left < sheet.width &&
         Count(sheet, {left, 0, left + 1, sheet.height}, kAxialColour) < 500) {
    ++left;
  }
  ASSERT_GT(left, 140);
  ASSERT_LT(left, 1000);
  const Frame beside{left - 140, 200, left - 20, 1000};
  EXPECT_GT(Count(sheet, beside, kTextColour), 100);
  EXPECT_EQ(Count(sheet, {left + 10, 200, left + 200, 1000}, kTextColour), 0);
}

TEST_F(RenderTexts, RulersHaveRoomForLabelsBeyondTheVolume) {
  VolumeModel volume;  // from -96 to 96 mm in height, in pictures that show more than -100 to 100
  volume.size = {40, 20, 16};
  volume.firstVoxel = {-97.5, -47.5, -90};
  volume.step = {Point{5, 0, 0}, Point{0, 5, 0}, Point{0, 0, 12}};
  volume.stored = [](int i, int, int) { return i < 20 ? 0 : 2000; };
  WriteVolume(volume, PathOf("low.bdf"));
  for (const char* layout : {"2x2", "row", "column", "main"}) {
    SCOPED_TRACE(layout);
    ExpectRulersBeside(Sheet("low.bdf", {"--layout", layout, "--size", "1500x900"}));
  }
}

TEST_F(RenderTexts, RulersHaveRoomForTheDecimalsOfSmallVolumes) {
  for (const double spacing : {1.0, 0.2, 0.05}) {
    SCOPED_TRACE(spacing);
    VolumeModel volume;
    volume.size = {10, 10, 10};
    volume.step = {Point{spacing, 0, 0}, Point{0, spacing, 0}, Point{0, 0, spacing}};
    volume.stored = [](int, int, int) { return 1500; };
    WriteVolume(volume, PathOf("small.bdf"));
    ExpectRulersBeside(Sheet("small.bdf"));
  }
}

/// What lies at the right of all pictures.
Frame PanelOf(const ColourPicture& sheet) {
  int left = 0;
  for (const Frame& frame : All(FindFrames(sheet))) {
    left = std::max(left, frame.right + 2);
  }
  return {left, 0, sheet.width, sheet.height};
}

TEST_F(RenderTexts, ThePictureShowsInTheGapsOfTheWindowsLimits) {
  const ColourPicture sheet = Sheet("box.bdf", {"--window", "0,1000"});
  const Frame panel = PanelOf(sheet);
  EXPECT_GT(Count(sheet, panel, kMeasuredColour), 200);
  EXPECT_EQ(Count(sheet, panel, kWhite), 0);
}

TEST_F(RenderTexts, TheFirstTickOfTheHistogramHasItsLabel) {
  const ColourPicture sheet = Sheet("box.bdf", {"--window", "0,1000"});
  const Frame panel = PanelOf(sheet);
  // The axis is the only long line in the colour of text; main ticks are its longest ones.
  int axis = 0;
  for (int y = panel.top; y < panel.bottom; ++y) {
    if (Count(sheet, {panel.left, y, panel.right, y + 1}, kTextColour) > 150) {
      axis = y;
    }
  }
  ASSERT_GT(axis, 0);
  int tick = panel.left;
  while (tick < panel.right && sheet.At(tick, axis + 8) != kTextColour) {
    ++tick;
  }
  ASSERT_LT(tick, panel.right);
  const Frame label{tick - 10, axis + 11, tick + 11, axis + 28};
  EXPECT_GT(21 * 17 - Count(sheet, label, kSheetColour), 30);
}

/// The pixels above a picture, where its name and its window stand.
std::vector<unsigned> TitleOf(const ColourPicture& sheet, const Frame& frame) {
  std::vector<unsigned> pixels;
  for (int y = frame.top - 20; y < frame.top - 2; ++y) {
    for (int x = frame.left; x < frame.right; ++x) {
      pixels.push_back(sheet.At(x, y));
    }
  }
  return pixels;
}

TEST_F(RenderTexts, NarrowPicturesTellTheirWindowTooByShorteningTheName) {
  const auto title = [&](const char* window) {
    const ColourPicture sheet = Sheet("box.bdf", {"--layout", "row", "--window", window});
    return TitleOf(sheet, FindFrames(sheet).projection);
  };
  EXPECT_NE(title("-5001.5,20001.5"), title("-5001.5,20002.5"));
}

TEST_F(RenderTexts, WindowsOfSmallValuesAreTold) {
  const ColourPicture one = Sheet("box.bdf", {"--window", "0.31,0.52"});
  const ColourPicture other = Sheet("box.bdf", {"--window", "0.31,0.54"});
  for (const Frame& frame : All(FindFrames(one))) {
    EXPECT_NE(TitleOf(one, frame), TitleOf(other, frame));
  }
}

/// 10 x 10 x 10 voxels of 0.02 mm with values from 0.001 to 0.1 in each slice.
TEST_F(RenderTexts, SmallVoxelsAndValuesHaveTheDecimalsThatTheyNeed) {
  study::Study study;
  for (int k = 0; k < 10; ++k) {
    const auto samples = study::AppendSlice(study, 10, 10);
    std::uint16_t value = 0;
    for (std::uint16_t& sample : samples) {
      sample = ++value;
    }
  }
  study.scale = 0.001;
  study.unit = "g/ml";
  study::PlaceVolume(study, {0, 0, 0}, {0.02, 0, 0}, {0, 0.02, 0}, {0, 0, 0.02});
  study::WriteStudyFile(study, PathOf("small.bdf"));
  Sheet("small.bdf", {"--line", "0,0,0.03,0.04", "--region", "-0.01,-0.01,0.19,0.01"});
  EXPECT_EQ(m_results["Line"], "0.05 mm");
  EXPECT_EQ(m_results["Region"], "0.20 x 0.02 mm");
  EXPECT_EQ(m_results["Voxels"], "10");
  // Of 0.001 to 0.010; the root of 8.25 is 2.87.
  EXPECT_EQ(m_results["Mean"], "0.0055 g/ml");
  EXPECT_EQ(m_results["SD"], "0.0029 g/ml");
  EXPECT_EQ(m_results["Range"], "0.001 to 0.01 g/ml");
}

}  // namespace
