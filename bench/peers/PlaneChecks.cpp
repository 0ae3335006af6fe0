// The checks of cuts and projections. Each pixel is computed as the range of what it may be.
#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>

#include "Checks.h"

namespace peers {
namespace {

constexpr double kAside = 0.02;  ///< so far a position may be off, in voxels
constexpr double kBelow = 3;     ///< by which interpolated samples may be off
constexpr double kAbove = 1;

struct Range {
  double low = 0;
  double high = 0;
  bool isSample = false;  ///< or lies outside
  bool isSure = true;     ///< or anything goes
};

constexpr std::array<double, 3> kSizes{kWidth, kHeight, kDepth};

double Voxel(int x, int y, int z) {
  return Volume()[(static_cast<std::size_t>(z) * kHeight + static_cast<std::size_t>(y)) * kWidth +
                  static_cast<std::size_t>(x)];
}

/// All voxels that may be the nearest one.
Range Nearest(const Position& at) {
  const auto first = [&at](std::size_t axis) {
    return static_cast<int>(std::floor(at[axis] + 0.5 - kAside));
  };
  const auto last = [&at](std::size_t axis) {
    return static_cast<int>(std::floor(at[axis] + 0.5 + kAside));
  };
  Range range{kValues, 0, true, true};
  for (int z = first(2); z <= last(2); ++z) {
    for (int y = first(1); y <= last(1); ++y) {
      for (int x = first(0); x <= last(0); ++x) {
        range.low = std::min(range.low, Voxel(x, y, z));
        range.high = std::max(range.high, Voxel(x, y, z));
      }
    }
  }
  return range;
}

/// Where a coordinate may be: at the ends of some intervals, none of which reaches across a voxel.
struct Places {
  explicit Places(double at) {
    const double first = std::floor(at - kAside);
    const double last = std::floor(at + kAside);
    Add(first, at - kAside - first);
    if (first != last) {
      Add(first, 1);
      Add(last, 0);
    }
    Add(last, at + kAside - last);
  }

  int voxel[4];
  double fraction[4];
  int count = 0;

 private:
  void Add(double whole, double part) {
    voxel[count] = static_cast<int>(whole);
    fraction[count++] = part;
  }
};

/// Between the two rows of voxels that lie right of this one.
double InSlice(int x, int y, int z, double right, double down, LinearRule rule) {
  const double sign = rule == LinearRule::Vorl ? -1 : 1;
  const double start = Voxel(x, y + 1, z);
  const double upper = std::lerp(Voxel(x, y, z), Voxel(x + 1, y, z), right);
  const double lower = start + sign * (Voxel(x + 1, y + 1, z) - start) * right;
  return std::lerp(upper, lower, down);
}

/// Samples change linearly along each axis: they lie between those at the ends.
Range Linear(const Position& at, LinearRule rule) {
  const Places x(at[0]);
  const Places y(at[1]);
  const Places z(at[2]);
  Range range{kValues, 0, true, true};
  for (int i = 0; i < x.count * y.count * z.count; ++i) {
    const int right = i % x.count;
    const int down = i / x.count % y.count;
    const int through = i / x.count / y.count;
    const auto inSlice = [&](int slice) {
      return InSlice(x.voxel[right], y.voxel[down], slice, x.fraction[right], y.fraction[down],
                     rule);
    };
    const int slice = z.voxel[through];
    const double sample =
        std::max(std::lerp(inSlice(slice), inSlice(slice + 1), z.fraction[through]), 0.0);
    range.low = std::min(range.low, sample - kBelow);
    range.high = std::max(range.high, sample + kAbove);
  }
  return range;
}

Range SampleAt(const Position& at, bool isLinear, LinearRule rule) {
  bool isInside = true;
  for (std::size_t axis = 0; axis < 3; ++axis) {
    if (at[axis] < -1 || at[axis] > kSizes[axis]) {
      return {};
    }
    isInside = isInside && at[axis] >= 1 && at[axis] <= kSizes[axis] - 2;
  }
  if (!isInside) {
    return {0, kValues, true, false};
  }
  return isLinear ? Linear(at, rule) : Nearest(at);
}

Range PixelOf(const PlaneWork& work, int column, int row, LinearRule rule) {
  Range sum;
  int samples = 0;
  for (int i = 0; i < work.samples; ++i) {
    const Range sample = SampleAt(PositionOf(work, column, row, i), work.isLinear, rule);
    samples += sample.isSample ? 1 : 0;
    sum.isSure = sum.isSure && sample.isSure;
    if (work.mode == Mode::Mean) {
      sum.low += sample.low / work.samples;
      sum.high += sample.high / work.samples;
    } else {
      sum.low = std::max(sum.low, sample.low);
      sum.high = std::max(sum.high, sample.high);
    }
  }
  // Libraries share the mean among all samples, or among those inside.
  const bool isPartlyOutside = samples > 0 && samples < work.samples;
  return work.mode == Mode::Mean && isPartlyOutside ? Range{0, kValues, true, false} : sum;
}

}  // namespace

std::string CheckPlane(const PlaneWork& work, const std::uint16_t* pixels, LinearRule rule) {
  const int step = work.samples > 1 ? 5 : 1;
  int count = 0;
  int sure = 0;
  for (int y = 0; y < work.edge; y += step) {
    for (int x = 0; x < work.edge; x += step) {
      const Range range = PixelOf(work, x, y, rule);
      const double pixel = pixels[static_cast<std::size_t>(y) * static_cast<unsigned>(work.edge) +
                                  static_cast<unsigned>(x)];
      ++count;
      sure += range.isSure ? 1 : 0;
      if (range.isSure && (pixel < range.low || pixel > range.high)) {
        char text[128];
        std::snprintf(text, sizeof text, "wrong: %g instead of %.1f to %.1f at (%d, %d)", pixel,
                      range.low, range.high, x, y);
        return text;
      }
    }
  }
  return 2 * sure >= count ? "" : "wrong: too few pixels can be compared";
}

std::string CheckDepth(const DepthWork& work, const std::uint16_t* pixels) {
  const DepthSize size = SizeOf(work);
  for (int row = 0; row < size.height; ++row) {
    for (int column = 0; column < size.width; ++column) {
      double highest = 0;
      for (int i = 0; i < size.depth; ++i) {
        highest = std::max(highest, work.axis == 0   ? Voxel(i, column, row)
                                    : work.axis == 1 ? Voxel(column, i, row)
                                                     : Voxel(column, row, i));
      }
      if (*pixels++ != highest) {
        char text[96];
        std::snprintf(text, sizeof text, "wrong: %d instead of %g at (%d, %d)", pixels[-1], highest,
                      column, row);
        return text;
      }
    }
  }
  return "";
}

}  // namespace peers
