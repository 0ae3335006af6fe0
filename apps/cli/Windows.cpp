#include <cli/Command.h>
#include <cli/Histogram.h>
#include <cli/Values.h>
#include <cli/Windows.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <numeric>
#include <vector>

namespace cli {
namespace {

/// In Hounsfield units, as radiologists use them.
struct Preset {
  const char* name;
  RealWindow window;
};
constexpr std::array<Preset, 7> kPresets{{{"bone", {500, 2000}},
                                          {"lung", {-600, 1500}},
                                          {"soft", {40, 400}},
                                          {"brain", {40, 80}},
                                          {"mediastinum", {50, 350}},
                                          {"liver", {60, 160}},
                                          {"angio", {300, 600}}}};

/// How many values a sample can have.
constexpr auto kValues = static_cast<double>(kStoredValues);
constexpr double kAutoTail = 0.005;
constexpr double kProjectionTail = 1e-4;
constexpr double kProjectionHeadroom = 1.1;

/// Where a window is moved that lies too high: far enough up that its lower edge, up to 32768
/// below, stays above 0. Samples that saturate at 0 are below it then, as they should be. (A window
/// that lies too low is moved to 0, and what saturates at 65535 is above it.)
constexpr double kHighCentre = 40000;

double VoxelCount(const study::Study& study) {
  return 1.0 * study.volume.GetSizeX() * study.volume.GetSizeY() * study.volume.GetSizeZ();
}

/// The first value, in the order of the iterators, at which more than `tail` samples have passed.
template <class Iterator>
std::ptrdiff_t PassTail(Iterator begin, Iterator end, double tail) {
  double passed = 0;
  return std::find_if(begin, end,
                      [&](std::uint64_t count) {
                        passed += static_cast<double>(count);
                        return passed > tail;
                      }) -
         begin;
}

}  // namespace

WindowChoice ParseWindow(const std::string& option, const std::string& text) {
  if (text.empty()) {
    return {};
  }
  if (text == "auto") {
    return {WindowChoice::Kind::Auto, {}};
  }
  for (const Preset& preset : kPresets) {
    if (text == preset.name) {
      return {WindowChoice::Kind::Preset, preset.window};
    }
  }
  const std::vector<double> numbers = SplitNumbers(text);
  if (numbers.size() != 2 || numbers[1] <= 0) {
    std::string names;
    for (const Preset& preset : kPresets) {
      names += std::string(", ") + preset.name;
    }
    throw UsageError(option + ": " + study::Quoted(text) +
                     " is neither CENTER,WIDTH (a width greater than 0) nor one of auto" + names);
  }
  return {WindowChoice::Kind::Numbers, {numbers[0], numbers[1]}};
}

std::string PresetList() {
  constexpr std::size_t kPerLine = 3;
  std::string list;
  for (std::size_t i = 0; i < kPresets.size(); ++i) {
    list += std::string(i == 0              ? ""
                        : i % kPerLine == 0 ? ",\n"
                                            : ", ") +
            kPresets[i].name + " " + NumberText(kPresets[i].window.centre) + "," +
            NumberText(kPresets[i].window.width);
  }
  return list;
}

RealWindow AutoWindow(study::Study& study) {
  const Histogram counts = HistogramOf(study);
  const double tail = kAutoTail * VoxelCount(study);
  const auto lowest = static_cast<double>(PassTail(counts.begin(), counts.end(), tail));
  const double highest =
      kValues - 1 - static_cast<double>(PassTail(counts.rbegin(), counts.rend(), tail));
  const double width = std::max(highest - lowest, 2.0);
  return {study.RealValue(0.5 * (lowest + highest)), width * study.scale};
}

RealWindow ProjectionWindow(study::Study& study) {
  const Histogram counts = HistogramOf(study);
  const double voxels = VoxelCount(study);
  const auto fromTop = [&](double tail) {
    return kValues - 1 -
           static_cast<double>(PassTail(counts.rbegin(), counts.rend(), tail * voxels));
  };
  const auto darkest =
      static_cast<double>(PassTail(counts.begin(), counts.end(), kAutoTail * voxels));
  const auto middle = counts.begin() + std::lround(0.5 * (darkest + fromTop(kAutoTail)));
  const double bright = std::accumulate(middle, counts.end(), 0.0);
  const double black = static_cast<double>(middle - counts.begin()) +
                       static_cast<double>(PassTail(middle, counts.end(), 0.5 * bright));
  const double brightest = fromTop(kProjectionTail);
  if (brightest <= black) {  // half of the bright voxels are as bright
    return AutoWindow(study);
  }
  const double width = std::max((brightest - black) * kProjectionHeadroom, 2.0);
  return {study.RealValue(black + 0.5 * width), width * study.scale};
}

std::optional<RealWindow> DrawnWindow(const study::Study& picture) {
  Histogram counts = HistogramOf(picture);
  counts.front() = 0;
  const double drawn = std::accumulate(counts.begin(), counts.end(), 0.0);
  if (drawn == 0) {
    return std::nullopt;
  }
  const auto lowest =
      static_cast<double>(PassTail(counts.begin(), counts.end(), kAutoTail * drawn));
  const double highest =
      kValues - 1 -
      static_cast<double>(PassTail(counts.rbegin(), counts.rend(), kAutoTail * drawn));
  // The darkest third of the levels is left to the black around.
  const double width = std::max(1.5 * (highest - lowest), 2.0);
  return RealWindow{picture.RealValue(highest - 0.5 * width), width * picture.scale};
}

RealWindow ResolveWindow(const WindowChoice& choice, study::Study& study) {
  switch (choice.kind) {
    case WindowChoice::Kind::Preset:
    case WindowChoice::Kind::Numbers:
      return choice.window;
    case WindowChoice::Kind::Input:
      if (study.windowWidth > 0) {
        return {study.windowCentre, study.windowWidth};
      }
      break;
    case WindowChoice::Kind::Auto:
      break;
  }
  return AutoWindow(study);
}

TableWindow PlaceWindow(const RealWindow& window, const study::Study& study) {
  const double width = window.width / study.scale;
  TableWindow placed;
  placed.factor = std::min(1.0, kValues / width);
  const double centre = study.StoredValue(window.centre) * placed.factor;
  const double tableCentre = centre < 0 ? 0 : centre > kValues ? kHighCentre : centre;
  placed.centre = static_cast<int>(std::lround(tableCentre));
  // A centre that fits is rounded, not compensated: samples are whole numbers as well.
  placed.shift = tableCentre == centre ? 0 : tableCentre - centre;
  placed.width = static_cast<int>(std::lround(std::clamp(width * placed.factor, 2.0, kValues)));
  return placed;
}

}  // namespace cli
