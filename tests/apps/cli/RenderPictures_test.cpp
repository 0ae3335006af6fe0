#include "RenderFixture.h"

#include <algorithm>
#include <cmath>
#include <set>

// Where things are on a sheet.

namespace {

using cli_test::Arguments;
using cli_test::ColourPicture;
using cli_test::FindColumn;
using cli_test::FindFrames;
using cli_test::FindRow;
using cli_test::Frame;
using cli_test::Frames;
using cli_test::IsGrey;
using cli_test::kAxialColour;
using cli_test::kCoronalColour;
using cli_test::kSagittalColour;
using cli_test::Point;
using cli_test::VolumeModel;

using RenderPictures = cli_test::Render;

constexpr const char* kLayouts[] = {"2x2", "row", "column", "main"};

std::vector<Frame> All(const Frames& frames) {
  return {frames.axial, frames.projection, frames.coronal, frames.sagittal};
}

bool IsInside(const Frame& frame, int x, int y) {
  return x >= frame.left && x < frame.right && y >= frame.top && y < frame.bottom;
}

bool Meet(const Frame& a, const Frame& b) {
  return a.left <= b.right && b.left <= a.right && a.top <= b.bottom && b.top <= a.bottom;
}

bool IsBright(unsigned colour) {
  return IsGrey(colour) && (colour & 0xFF) >= 127;
}

/// Around the bright pixels of a picture.
Frame BrightBox(const ColourPicture& sheet, const Frame& frame) {
  Frame box{sheet.width, sheet.height, 0, 0};
  for (int y = frame.top; y < frame.bottom; ++y) {
    for (int x = frame.left; x < frame.right; ++x) {
      if (IsBright(sheet.At(x, y))) {
        box = {std::min(box.left, x), std::min(box.top, y), std::max(box.right, x + 1),
               std::max(box.bottom, y + 1)};
      }
    }
  }
  return box;
}

/// The box lies in the picture where it is in space: the picture's middle is that of the volume.
void ExpectBox(const ColourPicture& sheet, const Frame& frame, double mmPerPixel, double left,
               double top, double right, double bottom) {
  const Frame box = BrightBox(sheet, frame);
  const double x = 0.5 * (frame.left + frame.right);
  const double y = 0.5 * (frame.top + frame.bottom);
  EXPECT_NEAR(box.left, x + left / mmPerPixel, 1.01);
  EXPECT_NEAR(box.right, x + right / mmPerPixel, 1.01);
  EXPECT_NEAR(box.top, y + top / mmPerPixel, 1.01);
  EXPECT_NEAR(box.bottom, y + bottom / mmPerPixel, 1.01);
}

TEST_F(RenderPictures, EveryLayoutShowsFourPicturesApartFromEachOther) {
  for (const char* layout : kLayouts) {
    for (const char* size : {"160x120", "400x300", "800x600", "640x900", "1500x160", "170x1500"}) {
      SCOPED_TRACE(std::string(layout) + " " + size);
      const std::vector<Frame> frames =
          All(FindFrames(BoxSheet({"--layout", layout, "--size", size})));
      for (std::size_t i = 0; i < frames.size(); ++i) {
        for (std::size_t k = 0; k < i; ++k) {
          EXPECT_FALSE(Meet(frames[i], frames[k])) << i << " " << k;
        }
      }
    }
  }
}

TEST_F(RenderPictures, WithoutAnnotationsThereArePicturesAndFramesAlone) {
  for (const char* layout : kLayouts) {
    SCOPED_TRACE(layout);
    const ColourPicture sheet =
        BoxSheet({"--no-annotations", "--layout", layout, "--size", "500x400"});
    const std::vector<Frame> frames = All(FindFrames(sheet));
    for (int y = 0; y < sheet.height; ++y) {
      for (int x = 0; x < sheet.width; ++x) {
        bool isPicture = false;
        bool isFrame = false;
        for (const Frame& frame : frames) {
          isPicture = isPicture || IsInside(frame, x, y);
          isFrame =
              isFrame ||
              IsInside({frame.left - 1, frame.top - 1, frame.right + 1, frame.bottom + 1}, x, y);
        }
        if (isPicture) {
          ASSERT_TRUE(IsGrey(sheet.At(x, y))) << x << " " << y;
        } else if (!isFrame) {
          ASSERT_EQ(sheet.At(x, y), cli_test::kSheetColour) << x << " " << y;
        }
      }
    }
  }
}

TEST_F(RenderPictures, AllPicturesHaveOneScaleInBothDirections) {
  for (const char* layout : {"2x2", "row", "column"}) {
    SCOPED_TRACE(layout);
    const ColourPicture sheet =
        BoxSheet({"--no-annotations", "--layout", layout, "--size", "900x700"});
    const Frames frames = FindFrames(sheet);
    const double scale = 60.0 / BrightBox(sheet, frames.axial).Width();
    ExpectBox(sheet, frames.axial, scale, -30, -30, 30, 20);
    ExpectBox(sheet, frames.coronal, scale, -30, -15, 30, 30);
    ExpectBox(sheet, frames.sagittal, scale, -30, -15, 20, 30);
    ExpectBox(sheet, frames.projection, scale, -30, -15, 30, 30);
  }
}

TEST_F(RenderPictures, TheMainPictureIsTheLargestAndUndistorted) {
  const ColourPicture sheet =
      BoxSheet({"--no-annotations", "--layout", "main", "--size", "900x700"});
  const Frames frames = FindFrames(sheet);
  const double large = 60.0 / BrightBox(sheet, frames.axial).Width();
  const double others = 60.0 / BrightBox(sheet, frames.coronal).Width();
  EXPECT_LT(1.5 * large, others);
  ExpectBox(sheet, frames.axial, large, -30, -30, 30, 20);
  ExpectBox(sheet, frames.coronal, others, -30, -15, 30, 30);
  ExpectBox(sheet, frames.sagittal, others, -30, -15, 20, 30);
  ExpectBox(sheet, frames.projection, others, -30, -15, 30, 30);
}

TEST_F(RenderPictures, PicturesReachToTheEdgesOfTheVolume) {
  VolumeModel full;
  full.size = {12, 10, 4};
  full.firstVoxel = {-55, -45, -45};
  full.step = {Point{10, 0, 0}, Point{0, 10, 0}, Point{0, 0, 30}};
  full.stored = [](int i, int, int) { return i == 0 ? 2000 : 1900; };
  WriteVolume(full, PathOf("full.bdf"));
  const ColourPicture sheet =
      Sheet("full.bdf", {"--no-annotations", "--window", "0,4000", "--size", "900x700"});
  const Frames frames = FindFrames(sheet);
  const double scale = 120.0 / BrightBox(sheet, frames.axial).Width();
  ExpectBox(sheet, frames.axial, scale, -60, -50, 60, 50);
  ExpectBox(sheet, frames.coronal, scale, -60, -60, 60, 60);
  ExpectBox(sheet, frames.sagittal, scale, -50, -60, 50, 60);
  ExpectBox(sheet, frames.projection, scale, -60, -60, 60, 60);
}

/// The cross of each picture lies at the same point of space: 1 mm inside of a corner of the box.
TEST_F(RenderPictures, TheCrossesMeetAtTheCentre) {
  const ColourPicture sheet = BoxSheet({"--center", "29,19,13.5", "--size", "1000x800", "--region",
                                        "-50,-45,-40,-35", "--line", "-50,40,-40,40"});
  const Frames frames = FindFrames(sheet);
  struct Case {
    const char* name;
    Frame frame;
    unsigned across, down;
    int insideX, insideY;  ///< the direction into the box
  };
  for (const Case& one :
       {Case{"axial", frames.axial, kCoronalColour, kSagittalColour, -1, -1},
        Case{"coronal", frames.coronal, kAxialColour, kSagittalColour, -1, 1},
        Case{"sagittal", frames.sagittal, kAxialColour, kCoronalColour, -1, 1},
        Case{"projection", frames.projection, kAxialColour, kSagittalColour, -1, 1}}) {
    SCOPED_TRACE(one.name);
    const int x = FindColumn(sheet, one.frame, one.down);
    const int y = FindRow(sheet, one.frame, one.across);
    constexpr int kAside = 8;
    EXPECT_TRUE(IsBright(sheet.At(x + kAside * one.insideX, y + kAside * one.insideY)));
    EXPECT_FALSE(IsBright(sheet.At(x - kAside * one.insideX, y + kAside * one.insideY)));
    EXPECT_FALSE(IsBright(sheet.At(x + kAside * one.insideX, y - kAside * one.insideY)));
    EXPECT_FALSE(IsBright(sheet.At(x - kAside * one.insideX, y - kAside * one.insideY)));
  }
}

TEST_F(RenderPictures, CrossesMoveTogetherWithTheCentre) {
  const Arguments size{"--size", "1000x800"};
  const ColourPicture one = BoxSheet({"--center", "-20,-10,-5", "--size", "1000x800"});
  const ColourPicture other = BoxSheet({"--center", "20,15,10", "--size", "1000x800"});
  const Frames frames = FindFrames(one);
  const auto columns = [&](const Frame& frame, unsigned colour) {
    return FindColumn(other, frame, colour) - FindColumn(one, frame, colour);
  };
  const auto rows = [&](const Frame& frame, unsigned colour) {
    return FindRow(other, frame, colour) - FindRow(one, frame, colour);
  };
  const int x = columns(frames.axial, kSagittalColour);
  EXPECT_GT(x, 40);
  EXPECT_NEAR(columns(frames.coronal, kSagittalColour), x, 1);
  EXPECT_NEAR(columns(frames.projection, kSagittalColour), x, 1);
  const double perMm = x / 40.0;
  EXPECT_NEAR(rows(frames.axial, kCoronalColour), 25 * perMm, 2);
  EXPECT_NEAR(columns(frames.sagittal, kCoronalColour), 25 * perMm, 2);
  EXPECT_NEAR(rows(frames.coronal, kAxialColour), -15 * perMm, 2);
  EXPECT_NEAR(rows(frames.sagittal, kAxialColour), -15 * perMm, 2);
  EXPECT_NEAR(rows(frames.projection, kAxialColour), -15 * perMm, 2);
}

/// Every tick of the scale stands at a multiple of a round number of the patient's millimetres.
void ExpectScale(const std::vector<int>& ticks, double zero, double mmPerPixel) {
  ASSERT_GE(ticks.size(), 3u);
  const double step =
      (ticks.back() - ticks.front()) * mmPerPixel / static_cast<double>(ticks.size() - 1);
  std::set<double> round;
  for (const double number : {1, 2, 5, 10, 20, 50, 100}) {
    if (std::abs(step / number - 1) < 0.02) {
      round.insert(number);
    }
  }
  ASSERT_EQ(round.size(), 1u) << step;
  for (const int tick : ticks) {
    const double multiple = (tick - zero) * mmPerPixel / *round.begin();
    EXPECT_NEAR(multiple * *round.begin() / mmPerPixel,
                std::round(multiple) * *round.begin() / mmPerPixel, 1.01);
  }
}

TEST_F(RenderPictures, RulersHaveTheirTicksAtRoundMillimetres) {
  const ColourPicture sheet = BoxSheet({"--center", "-40,-40,-50", "--size", "1000x800"});
  const ColourPicture other = BoxSheet({"--center", "40,40,50", "--size", "1000x800"});
  const Frames frames = FindFrames(sheet);
  const int left = FindColumn(sheet, frames.axial, kSagittalColour);
  const double scale = 80.0 / (FindColumn(other, frames.axial, kSagittalColour) - left);
  constexpr int kBehindMinorTicks = 7;
  for (const Frame& frame : All(frames)) {
    std::vector<int> columns;
    for (int x = frame.left - 1; x <= frame.right; ++x) {
      if (sheet.At(x, frame.bottom + kBehindMinorTicks) == cli_test::kTextColour) {
        columns.push_back(x);
      }
    }
    // The middle of each picture is that of the volume, 0 mm in all directions.
    ExpectScale(columns, 0.5 * (frame.left + frame.right), scale);
    std::vector<int> rows;
    for (int y = frame.top - 1; y <= frame.bottom; ++y) {
      if (sheet.At(frame.left - 1 - kBehindMinorTicks, y) == cli_test::kTextColour) {
        rows.push_back(y);
      }
    }
    ExpectScale(rows, 0.5 * (frame.top + frame.bottom), scale);
  }
}

TEST_F(RenderPictures, TheHistogramPlacesValuesAlongItsAxis) {
  // One voxel in ten has a value from 800 to 999, the others have one from 0 to 199.
  VolumeModel volume;
  volume.size = {40, 40, 40};
  volume.step = {Point{1, 0, 0}, Point{0, 1, 0}, Point{0, 0, 1}};
  volume.stored = [](int i, int j, int k) {
    const int number = (k * 40 + j) * 40 + i;
    return number % 10 == 0 ? 800 + number / 10 % 200 : number % 200;
  };
  WriteVolume(volume, PathOf("two.bdf"));
  const ColourPicture sheet = Sheet("two.bdf", {"--window", "-2000,10"});
  std::vector<int> columns;
  std::vector<int> heights(static_cast<std::size_t>(sheet.width));
  for (int x = 0; x < sheet.width; ++x) {
    for (int y = 0; y < sheet.height; ++y) {
      heights[static_cast<std::size_t>(x)] += sheet.At(x, y) == cli_test::kBarColour ? 1 : 0;
    }
    if (heights[static_cast<std::size_t>(x)] > 40) {
      columns.push_back(x);
    }
  }
  ASSERT_GT(columns.size(), 20u);
  std::size_t gap = 0;
  for (std::size_t i = 1; i < columns.size(); ++i) {
    if (columns[i] > columns[i - 1] + 8) {
      EXPECT_EQ(gap, 0u) << "a second gap";
      gap = i;
    }
  }
  ASSERT_GT(gap, 0u);
  const double lower = columns[gap - 1] - columns.front() + 1;
  const double upper = columns.back() - columns[gap] + 1;
  EXPECT_NEAR(lower, upper, 4);
  EXPECT_NEAR((columns[gap] - columns.front()) / lower, 4, 0.25);
  EXPECT_GT(heights[static_cast<std::size_t>(columns.front() + 5)],
            heights[static_cast<std::size_t>(columns.back() - 5)] + 10);
}

TEST_F(RenderPictures, GreyLevelsFollowTheWindow) {
  for (const auto& [window, level] : {std::pair("1000,400", 127), std::pair("0,4000", 191),
                                      std::pair("1100,200", 0), std::pair("900,200", 255)}) {
    const ColourPicture sheet =
        Sheet("box.bdf", {"--no-annotations", "--window", window, "--size", "500x400"});
    for (const Frame& frame : All(FindFrames(sheet))) {
      const unsigned colour =
          sheet.At((frame.left + frame.right) / 2 - 4, (frame.top + frame.bottom) / 2 + 4);
      EXPECT_TRUE(IsGrey(colour));
      EXPECT_NEAR(static_cast<int>(colour & 0xFF), level, 1) << window;
    }
  }
}

TEST_F(RenderPictures, TheBrightestVoxelsAreNotBlackEvenIfManyAreAsBright) {
  const ColourPicture sheet = Sheet("box.bdf");
  const Frame frame = FindFrames(sheet).projection;
  EXPECT_TRUE(
      IsBright(sheet.At((frame.left + frame.right) / 2 - 9, (frame.top + frame.bottom) / 2 + 9)));
  VolumeModel even;
  even.size = {10, 10, 10};
  even.step = {Point{1, 0, 0}, Point{0, 1, 0}, Point{0, 0, 1}};
  even.stored = [](int, int, int) { return 1500; };
  WriteVolume(even, PathOf("even.bdf"));
  const ColourPicture grey = Sheet("even.bdf");
  const Frame picture = FindFrames(grey).projection;
  EXPECT_TRUE(IsBright(
      grey.At((picture.left + picture.right) / 2 - 20, (picture.top + picture.bottom) / 2 + 20)));
}

/// The pixels above a picture, where its name and its window stand.
std::vector<unsigned> Title(const ColourPicture& sheet, const Frame& frame) {
  std::vector<unsigned> pixels;
  for (int y = frame.top - 20; y < frame.top - 2; ++y) {
    for (int x = frame.left; x < frame.right; ++x) {
      pixels.push_back(sheet.At(x, y));
    }
  }
  return pixels;
}

TEST_F(RenderPictures, TheTitleTellsTheWindowInRealValues) {
  const ColourPicture preset = Sheet("box.bdf", {"--window", "bone"});
  const ColourPicture numbers = Sheet("box.bdf", {"--window", "500,2000"});
  const ColourPicture other = Sheet("box.bdf", {"--window", "501,2000"});
  EXPECT_EQ(preset.colours, numbers.colours);
  for (const Frame& frame : All(FindFrames(numbers))) {
    EXPECT_NE(Title(numbers, frame), Title(other, frame));
  }
}

}  // namespace
