#include <study/dicom/Samples.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <optional>

namespace study {
namespace {

constexpr std::int64_t kLargestStored = 65535;

std::int32_t ValueOf(std::uint16_t sample, bool isSigned) {
  return isSigned && sample >= 0x8000 ? std::int32_t{sample} - 0x10000 : std::int32_t{sample};
}

/// The value of a sample in units of the scale, measured so that it grows with the real value.
std::int64_t CodeOf(std::int32_t value, bool falling, std::int64_t shift) {
  return (falling ? -std::int64_t{value} : std::int64_t{value}) + shift;
}

/// The whole number of steps from `first` to `intercept`; empty when there is none.
std::optional<std::int64_t> WholeSteps(double intercept, double first, double step) {
  const double steps = (intercept - first) / step;
  if (!(std::abs(steps) <= 2.0 * kLargestStored)) {
    return std::nullopt;
  }
  const double whole = std::round(steps);
  if (std::abs(steps - whole) > 1e-6) {
    return std::nullopt;
  }
  return static_cast<std::int64_t>(whole);
}

struct CodeRange {
  std::int64_t minimum = std::numeric_limits<std::int64_t>::max();
  std::int64_t maximum = std::numeric_limits<std::int64_t>::min();
};

/// The mapping that keeps every value, if there is one.
std::optional<ValueMapping> ExactMapping(const std::vector<SliceValues>& slices) {
  const SliceValues& first = slices.front();
  const double scale = std::abs(first.slope);
  const bool falling = first.slope < 0;
  CodeRange codes;
  for (const SliceValues& slice : slices) {
    const auto shift = WholeSteps(slice.intercept, first.intercept, scale);
    if (slice.slope != first.slope || !shift) {
      return std::nullopt;
    }
    const std::int64_t a = CodeOf(slice.range.minimum, falling, *shift);
    const std::int64_t b = CodeOf(slice.range.maximum, falling, *shift);
    codes.minimum = std::min({codes.minimum, a, b});
    codes.maximum = std::max({codes.maximum, a, b});
  }
  if (codes.maximum - codes.minimum > kLargestStored) {
    return std::nullopt;
  }
  return ValueMapping{scale, first.intercept + scale * static_cast<double>(codes.minimum), 0};
}

ValueMapping SpreadMapping(const std::vector<SliceValues>& slices) {
  double minimum = std::numeric_limits<double>::infinity();
  double maximum = -minimum;
  for (const SliceValues& slice : slices) {
    const double a = slice.range.minimum * slice.slope + slice.intercept;
    const double b = slice.range.maximum * slice.slope + slice.intercept;
    minimum = std::min({minimum, a, b});
    maximum = std::max({maximum, a, b});
  }
  const double scale = (maximum - minimum) / static_cast<double>(kLargestStored);
  return scale > 0 ? ValueMapping{scale, minimum, scale / 2} : ValueMapping{1, minimum, 0};
}

}  // namespace

bool IsSupported(const SampleFormat& format) {
  const bool sizeKnown = format.bitsAllocated == 8 || format.bitsAllocated == 16;
  return sizeKnown && format.bitsStored >= 1 && format.bitsStored <= format.bitsAllocated &&
         format.highBit < format.bitsAllocated && format.highBit + 1 >= format.bitsStored;
}

SampleRange RangeOfFormat(const SampleFormat& format) {
  const std::int32_t count = std::int32_t{1} << format.bitsStored;
  if (format.isSigned) {
    return {-count / 2, count / 2 - 1};
  }
  return {0, count - 1};
}

void UnpackSamples(std::span<const std::uint8_t> bytes, const SampleFormat& format,
                   std::span<std::uint16_t> samples) {
  const unsigned shift = format.highBit + 1 - format.bitsStored;
  const std::uint32_t mask = (1u << format.bitsStored) - 1;
  const std::uint32_t signBit = format.isSigned ? 1u << (format.bitsStored - 1) : 0u;
  const std::uint32_t mirror = format.inverted ? mask : 0u;
  const bool wide = format.bitsAllocated == 16;
  for (std::size_t i = 0; i < samples.size(); ++i) {
    const std::uint32_t raw =
        wide ? static_cast<std::uint32_t>(bytes[2 * i] | (bytes[2 * i + 1] << 8)) : bytes[i];
    // Mirroring v to minimum + maximum - v is the one's complement, signed or not.
    const std::uint32_t value = ((raw >> shift) & mask) ^ mirror;
    const std::uint32_t extended = (value ^ signBit) - signBit;  // wraps for negative values
    samples[i] = static_cast<std::uint16_t>(extended & 0xFFFFu);
  }
}

SampleRange RangeOfSamples(std::span<const std::uint16_t> samples, bool isSigned) {
  if (samples.empty()) {
    return {};
  }
  SampleRange range{ValueOf(samples[0], isSigned), ValueOf(samples[0], isSigned)};
  for (const std::uint16_t sample : samples) {
    range.minimum = std::min(range.minimum, ValueOf(sample, isSigned));
    range.maximum = std::max(range.maximum, ValueOf(sample, isSigned));
  }
  return range;
}

ValueMapping ChooseMapping(const std::vector<SliceValues>& slices) {
  return ExactMapping(slices).value_or(SpreadMapping(slices));
}

void ApplyMapping(const ValueMapping& mapping, const SliceValues& slice,
                  std::span<std::uint16_t> samples) {
  // Each slice holds at most 65536 different samples: a table costs less than the arithmetic.
  std::vector<std::uint16_t> table(65536);
  for (std::int32_t value = slice.range.minimum; value <= slice.range.maximum; ++value) {
    const double real = value * slice.slope + slice.intercept;
    const double stored = std::round((real - mapping.offset) / mapping.scale);
    table[static_cast<std::uint32_t>(value) & 0xFFFFu] =
        static_cast<std::uint16_t>(std::clamp(stored, 0.0, static_cast<double>(kLargestStored)));
  }
  for (std::uint16_t& sample : samples) {
    sample = table[sample];
  }
}

}  // namespace study
