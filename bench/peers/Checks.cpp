// The checks of images and files; those of cuts through the volume are in PlaneChecks.cpp.
#include "Checks.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>
#include <vector>

namespace peers {
namespace {

std::string Wrong(std::size_t index, double actual, double expected) {
  char text[96];
  std::snprintf(text, sizeof text, "wrong: %.9g instead of %.9g at %zu", actual, expected, index);
  return text;
}

/// Element by element; `expected` gives that of an index.
template <class T, class Expected>
std::string Compare(const T* actual, std::size_t count, double tolerance, Expected expected) {
  for (std::size_t i = 0; i < count; ++i) {
    const double value = expected(i);
    if (!(std::abs(actual[i] - value) <= tolerance)) {
      return Wrong(i, static_cast<double>(actual[i]), value);
    }
  }
  return "";
}

template <class T>
std::string CompareRescaled(const RescaleWork& work, const void* values, const Samples<T>& source) {
  const double highest = work.bits == 8 ? 255 : 65535;
  return Compare(static_cast<const T*>(values), kImagePixels, 1, [&](std::size_t i) {
    return std::clamp(source[i] * work.scale + work.shift, 0.0, highest);
  });
}

using Counts = std::array<std::uint32_t, kValues>;

/// The edge strength of a voxel, or -1 where it has no neighbours.
int EdgeOf(std::size_t voxel) {
  const std::size_t column = voxel % kWidth;
  const std::size_t row = voxel / kWidth % kHeight;
  if (column + 1 == kWidth || row + 1 == kHeight) {
    return -1;
  }
  const Samples<std::uint16_t>& volume = Volume();
  const int lower = std::min(volume[voxel + 1], volume[voxel + kWidth]);
  return std::max(volume[voxel] - lower, 0);
}

int ValueOf(std::size_t voxel) {
  return Volume()[voxel];
}

using ClassOf = int (*)(std::size_t voxel);

const Counts& Count(ClassOf classOf) {
  static Counts counts;
  static ClassOf counted = nullptr;
  if (counted != classOf) {
    counted = classOf;
    counts.fill(0);
    for (std::size_t i = 0; i < kVoxels; ++i) {
      const int voxelClass = classOf(i);
      if (voxelClass >= 0) {
        ++counts[static_cast<std::size_t>(voxelClass)];
      }
    }
  }
  return counts;
}

std::string CheckCounts(ClassOf classOf, const std::uint32_t* counts) {
  const Counts& expected = Count(classOf);
  return Compare(counts, expected.size(), 0,
                 [&](std::size_t i) { return static_cast<double>(expected[i]); });
}

/// The lowest class of those that fit under the limit together.
int LowestSelected(const Counts& counts) {
  int lowest = kValues;
  std::uint64_t sum = 0;
  while (lowest > 0) {
    sum += counts[static_cast<std::size_t>(lowest - 1)];
    if (sum > SelectionLimit()) {
      break;
    }
    --lowest;
  }
  return lowest;
}

template <class T>
bool IsNear(const StretchWork& work, const T* source, int column, int row, T pixel) {
  for (int y = std::max(row - 1, 0); y <= std::min(row + 1, work.sourceEdge - 1); ++y) {
    for (int x = std::max(column - 1, 0); x <= std::min(column + 1, work.sourceEdge - 1); ++x) {
      if (source[y * work.sourceEdge + x] == pixel) {
        return true;
      }
    }
  }
  return false;
}

template <class T>
std::string CompareStretched(const StretchWork& work, const T* pixels) {
  const auto* const source = static_cast<const T*>(SourceOf(work));
  for (int y = 0; y < kScreenHeight; ++y) {
    const int row = (2 * y + 1) * work.sourceEdge / (2 * kScreenHeight);
    for (int x = 0; x < kScreenWidth; ++x) {
      const int column = (2 * x + 1) * work.sourceEdge / (2 * kScreenWidth);
      const std::size_t i = static_cast<std::size_t>(y) * kScreenWidth + static_cast<unsigned>(x);
      if (!IsNear(work, source, column, row, pixels[i])) {
        return Wrong(i, pixels[i], source[row * work.sourceEdge + column]);
      }
    }
  }
  return "";
}

}  // namespace

std::string CheckWindow(const std::uint8_t* levels) {
  const WindowWork& window = TheWindow();
  const Samples<std::uint16_t>& source = Image16();
  const double low = window.centre - 0.5 * window.width;
  return Compare(levels, kImagePixels, 1, [&](std::size_t i) {
    return std::clamp((source[i] - low) * 255 / window.width, 0.0, 255.0);
  });
}

std::string CheckExtremes(const ExtremesWork& work, double lowest, double highest) {
  const auto [low, high] = std::minmax_element(work.samples().begin(), work.samples().end());
  const double actual[] = {lowest, highest};
  const double expected[] = {static_cast<double>(*low), static_cast<double>(*high)};
  return Compare(actual, 2, 0, [&](std::size_t i) { return expected[i]; });
}

std::string CheckRescale(const RescaleWork& work, const void* values) {
  return work.bits == 8 ? CompareRescaled(work, values, Image8(kImageEdge))
                        : CompareRescaled(work, values, Image16());
}

std::string CheckHistogram(const std::uint32_t* counts) {
  return CheckCounts(ValueOf, counts);
}

std::string CheckEdges(const std::uint32_t* counts) {
  return CheckCounts(EdgeOf, counts);
}

std::uint32_t SelectionLimit() {
  return static_cast<std::uint32_t>(kVoxels / 100);
}

std::string CheckSelection(bool isByEdge, const std::uint32_t* places, std::size_t count) {
  const ClassOf classOf = isByEdge ? EdgeOf : ValueOf;
  const int lowest = LowestSelected(Count(classOf));
  std::size_t found = 0;
  for (std::size_t i = 0; i < kVoxels; ++i) {
    if (classOf(i) < lowest) {
      continue;
    }
    const auto place = static_cast<std::uint32_t>(i / kSliceVoxels << 22 |
                                                  i / kWidth % kHeight << 11 | i % kWidth);
    if (found == count || places[found] != place) {
      return Wrong(found, found < count ? places[found] : -1.0, place);
    }
    ++found;
  }
  return found == count ? "" : Wrong(found, places[found], -1);
}

std::string CheckStretch(const StretchWork& work, const void* pixels) {
  return work.bytes == 1 ? CompareStretched(work, static_cast<const std::uint8_t*>(pixels))
                         : CompareStretched(work, static_cast<const std::uint32_t*>(pixels));
}

std::string CheckBitmap(const std::uint8_t* pixels) {
  const Samples<std::uint8_t>& image = Image24();
  return Compare(pixels, image.size(), 0,
                 [&](std::size_t i) { return static_cast<double>(image[i]); });
}

// The fields that say where the pixels are; in a file the lowest row comes first.
std::string CheckBitmapFile(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  const std::vector<char> bytes{std::istreambuf_iterator<char>(file), {}};
  const auto number = [&bytes](std::size_t offset) {
    std::int32_t value = 0;
    std::memcpy(&value, &bytes[offset], sizeof value);
    return value;
  };
  constexpr std::size_t kHeader = 54;
  constexpr std::size_t kRow = std::size_t{kImageEdge} * 3;
  constexpr int kOnePlane24Bits = 24 << 16 | 1;
  if (bytes.size() < kHeader || number(18) != kImageEdge || number(22) != kImageEdge ||
      number(26) != kOnePlane24Bits || bytes.size() < number(10) + kRow * kImageEdge) {
    return "wrong: no bitmap file of this size";
  }
  std::vector<std::uint8_t> pixels;
  for (std::size_t row = kImageEdge; row-- > 0;) {
    const auto begin = bytes.begin() + number(10) + static_cast<std::ptrdiff_t>(row * kRow);
    pixels.insert(pixels.end(), begin, begin + kRow);
  }
  return CheckBitmap(pixels.data());
}

}  // namespace peers
