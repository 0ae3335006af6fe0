#include "RenderFixture.h"

#include <algorithm>
#include <optional>

namespace cli_test {
namespace {

constexpr int kLeast = 12;

int RunRight(const ColourPicture& sheet, int x, int y) {
  const unsigned colour = sheet.At(x, y);
  int end = x;
  while (end < sheet.width && sheet.At(end, y) == colour) {
    ++end;
  }
  return end - x;
}

int RunDown(const ColourPicture& sheet, int x, int y) {
  const unsigned colour = sheet.At(x, y);
  int end = y;
  while (end < sheet.height && sheet.At(x, end) == colour) {
    ++end;
  }
  return end - y;
}

/// The frame whose outline has its upper left corner here.
std::optional<Frame> FrameAt(const ColourPicture& sheet, int x, int y) {
  const int width = RunRight(sheet, x, y);
  const int height = RunDown(sheet, x, y);
  if (width < kLeast || height < kLeast || RunRight(sheet, x, y + height - 1) < width ||
      RunDown(sheet, x + width - 1, y) < height) {
    return std::nullopt;
  }
  return Frame{x + 1, y + 1, x + width - 1, y + height - 1};
}

}  // namespace

Frame FindFrame(const ColourPicture& sheet, unsigned colour) {
  std::vector<Frame> found;
  for (int y = 0; y < sheet.height; ++y) {
    for (int x = 0; x < sheet.width; ++x) {
      const bool isCorner = sheet.At(x, y) == colour && (x == 0 || sheet.At(x - 1, y) != colour) &&
                            (y == 0 || sheet.At(x, y - 1) != colour);
      if (const auto frame = isCorner ? FrameAt(sheet, x, y) : std::nullopt) {
        found.push_back(*frame);
      }
    }
  }
  EXPECT_EQ(found.size(), 1u) << std::hex << colour;
  return found.empty() ? Frame{} : found.front();
}

Frames FindFrames(const ColourPicture& sheet) {
  return {FindFrame(sheet, kAxialColour), FindFrame(sheet, kProjectionColour),
          FindFrame(sheet, kCoronalColour), FindFrame(sheet, kSagittalColour)};
}

int FindColumn(const ColourPicture& sheet, const Frame& frame, unsigned colour) {
  int best = 0;
  int most = 0;
  for (int x = frame.left; x < frame.right; ++x) {
    int count = 0;
    for (int y = frame.top; y < frame.bottom; ++y) {
      count += sheet.At(x, y) == colour ? 1 : 0;
    }
    if (count > most) {
      most = count;
      best = x;
    }
  }
  EXPECT_GT(2 * most, frame.Height()) << std::hex << colour;
  return best;
}

int FindRow(const ColourPicture& sheet, const Frame& frame, unsigned colour) {
  int best = 0;
  int most = 0;
  for (int y = frame.top; y < frame.bottom; ++y) {
    int count = 0;
    for (int x = frame.left; x < frame.right; ++x) {
      count += sheet.At(x, y) == colour ? 1 : 0;
    }
    if (count > most) {
      most = count;
      best = y;
    }
  }
  EXPECT_GT(2 * most, frame.Width()) << std::hex << colour;
  return best;
}

void Render::SetUp() {
  VolumeModel volume;
  volume.size = {60, 50, 40};
  volume.firstVoxel = {-59, -49, -58.5};
  volume.step = {Point{2, 0, 0}, Point{0, 2, 0}, Point{0, 0, 3}};
  volume.stored = [](int i, int j, int k) {
    return i >= 15 && i < 45 && j >= 10 && j < 35 && k >= 10 && k < 25 ? 2000 : 0;
  };
  WriteVolume(volume, PathOf("box.bdf"));
}

ColourPicture Render::Sheet(const std::string& volume, Arguments more) {
  Arguments arguments{"render", PathOf(volume), "-o", PathOf("sheet.png")};
  arguments.insert(arguments.end(), more.begin(), more.end());
  const Outcome outcome = RunTool(arguments);
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  EXPECT_EQ(outcome.errors, "");
  m_results.clear();
  for (const std::string& line : Lines(outcome.output)) {
    const std::size_t colon = line.find(':');
    const std::size_t value = line.find_first_not_of(' ', colon + 1);
    EXPECT_NE(value, std::string::npos) << line;
    m_results[line.substr(0, colon)] = line.substr(std::min(value, line.size()));
  }
  return ReadColourPng(PathOf("sheet.png"));
}

ColourPicture Render::BoxSheet(Arguments more) {
  more.insert(more.begin(), {"--window", "0,4000"});
  return Sheet("box.bdf", more);
}

}  // namespace cli_test
