#include <vorl/Operators/IP/kernels/WindowRamp.h>

#include <vorl/Data/dWindowingLUT.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdlib>
#include <numeric>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr int kEntries = 65536;

/// Calls `visit(index, entry)` for the indices from `first` to `last` at which the ramp gives
/// another entry than the table, as long as it returns true. Returns false where one did not.
template <class Visit>
bool ForEachDifference(const WindowRamp& ramp, int first, int last, WindowRun* run, Visit&& visit) {
  constexpr int kChunk = 1024;
  std::uint16_t samples[kChunk];
  std::uint8_t given[kChunk];
  // An index becomes a sample by adding as well as by exclusive or: only the top bit may flip.
  std::iota(samples, samples + kChunk, static_cast<std::uint16_t>(first ^ ramp.flip));
  for (int start = first; start <= last; start += kChunk) {
    const int count = std::min(kChunk, last + 1 - start);
    run(samples, given, kChunk, ramp);  // whole: what is left of a run is looked up
    for (std::uint16_t& sample : samples) {
      sample = static_cast<std::uint16_t>(sample + kChunk);
    }
    if (std::equal(given, given + count, ramp.entries + start)) {
      continue;
    }
    for (int i = 0; i < count; ++i) {
      if (given[i] != ramp.entries[start + i] && !visit(start + i, ramp.entries[start + i])) {
        return false;
      }
    }
  }
  return true;
}

/// Notes the entries on the line that it misses. False when there are too many.
bool FindExceptions(WindowRamp& ramp, WindowRun* run) {
  ramp.numExceptions = 0;
  ramp.hasEnds = false;
  const auto note = [&](int index, std::uint8_t entry) {
    if (ramp.numExceptions == WindowRamp::kMostExceptions) {
      return false;
    }
    ramp.exceptions[ramp.numExceptions++] = {static_cast<std::uint16_t>(index), entry};
    return true;
  };
  WindowRamp plain = ramp;
  if (!ForEachDifference(plain, ramp.first, ramp.first + ramp.last, run, note)) {
    return false;
  }
  for (int i = ramp.numExceptions; i < WindowRamp::kMostExceptions; ++i) {
    ramp.exceptions[i] = {ramp.first, ramp.entries[ramp.first]};
  }
  return true;
}

/// A line as the table's definition has it, in double precision.
struct Line {
  double value;  ///< at k = 0
  double step;
};

/// Sets a ramp to a line in single precision.
void SetFloat(WindowRamp& ramp, const Line& line) {
  ramp.isFixed = false;
  ramp.factor = static_cast<float>(line.step);
  ramp.offset = static_cast<float>(line.value);
}

/// Sets a ramp to a line of 24 fractional bits. What 8 of them cannot say of the line's value, the
/// shift does: it adds its own multiple of the step's fraction.
void SetFixed(WindowRamp& ramp, const Line& line) {
  const std::int64_t step = std::llround(std::ldexp(line.step, 24));
  const std::int64_t value = std::llround(std::ldexp(line.value, 24));
  ramp.isFixed = true;
  ramp.whole = static_cast<std::uint16_t>(step >> 16);
  ramp.fraction = static_cast<std::uint16_t>(step);
  const auto missOf = [&](int shift) {
    const auto low = static_cast<std::int16_t>(value - std::int64_t{shift} * ramp.fraction);
    return std::abs(int{low});
  };
  const int mostShift = std::min(255, kEntries - 1 - ramp.last);
  int best = 0;
  for (int shift = 1; shift <= mostShift; ++shift) {
    best = missOf(shift) < missOf(best) ? shift : best;
  }
  const std::int64_t rest = value - std::int64_t{best} * ramp.fraction;
  ramp.shift = static_cast<std::uint16_t>(best);
  ramp.base = static_cast<std::uint16_t>((rest + 0x8000) >> 16);
}

/// The ways to lean the line a little: entries that lie exactly between two grey values fall to one
/// side where the rounding errors of the repeated addition are positive, to the other where they
/// are negative, and those change their sign where the value passes a power of two. Calls
/// `tryLine(line)` until one returns true.
template <class TryLine>
bool ForEachLeaning(const Line& line, int last, double nudge, TryLine&& tryLine) {
  for (const double side : {1.0, -1.0}) {
    if (tryLine(Line{line.value + side * nudge, line.step})) {
      return true;
    }
  }
  for (const double level : {128.0, 64.0, 32.0, 16.0}) {
    const double pivot = (level - line.value) / line.step;
    if (pivot <= 0 || pivot >= last) {
      continue;
    }
    const double slope = nudge / std::max(pivot, last - pivot);
    for (const double side : {1.0, -1.0}) {
      if (tryLine(Line{line.value + side * slope * pivot, line.step - side * slope})) {
        return true;
      }
    }
  }
  return false;
}

}  // namespace

std::optional<WindowRamp> WindowRamp::Of(dWindowingLUT& lut, bool signedSamples, WindowRun* run) {
  const int base = signedSamples ? -32768 : 0;
  const std::uint8_t* const table = lut.GetLUT(0);
  if (run == nullptr || table == nullptr || lut.GetSize() != kEntries ||
      lut.GetStartIndex() != base) {
    return std::nullopt;
  }
  const int width = lut.GetWinWidth();
  const int lowerEdge = lut.GetWinCenter() - width / 2;
  const int begin = std::max(lowerEdge - base, 0);
  const int end = std::min(lowerEdge + width - base, kEntries);
  if (begin >= end || width <= 0) {
    return std::nullopt;
  }
  std::uint8_t low = 0;
  std::uint8_t high = 0;
  lut.GetTargetRange(low, high);
  WindowRamp ramp{};
  ramp.flip = signedSamples ? 0x8000 : 0;
  ramp.first = static_cast<std::uint16_t>(begin);
  ramp.entries = table;
  lut.GetLimits(ramp.below, ramp.above);
  // Mostly the line goes one step further than the window.
  const int last = end < kEntries && ramp.above == high ? end : end - 1;
  ramp.last = static_cast<std::uint16_t>(last - begin);

  const int range = high - low;
  const double step = static_cast<double>(range) / width;
  const Line line{low + 0.5 + (begin - (lowerEdge - base)) * step, step};
  // Entries that do not lie exactly between two grey values keep a distance from that.
  const double distance = std::gcd(2 * width, 2 * range) / (2.0 * width);
  const auto fits = [&](auto setLine) {
    return ForEachLeaning(line, ramp.last, distance / 4, [&](const Line& candidate) {
      setLine(ramp, candidate);
      return FindExceptions(ramp, run);
    });
  };
  if (!fits(SetFixed) && !fits(SetFloat)) {
    return std::nullopt;
  }
  ramp.hasEnds =
      (begin > 0 && ramp.below != table[begin]) || (end < kEntries && ramp.above != table[last]);
  const bool isTrue =
      ForEachDifference(ramp, 0, kEntries - 1, run, [](int, std::uint8_t) { return false; });
  return isTrue ? std::optional(ramp) : std::nullopt;
}

}  // namespace vorl_detail
}  // namespace vorl
