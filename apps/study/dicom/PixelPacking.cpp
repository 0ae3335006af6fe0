#include <study/Error.h>
#include <study/dicom/PixelPacking.h>
#include <study/dicom/Samples.h>

#include <algorithm>
#include <cmath>

namespace study {
namespace {

/// What is added to a stored value to make it a signed sample whose rescale intercept is 0 or near.
std::int32_t SignedShift(const Study& study) {
  return static_cast<std::int32_t>(
      std::clamp(std::round(study.offset / study.scale), -32768.0, 0.0));
}

/// A sample as the file holds it.
std::uint16_t Encode(double value, const SampleFormat& format) {
  const SampleRange range = RangeOfFormat(format);
  if (!(value >= range.minimum && value <= range.maximum)) {
    throw Error("a value of " + std::to_string(std::llround(value)) + " does not fit " +
                std::to_string(format.bitsStored) + (format.isSigned ? " signed" : " unsigned") +
                " bits");
  }
  const auto whole = static_cast<std::int32_t>(value);
  const std::int32_t sample = format.inverted ? range.minimum + range.maximum - whole : whole;
  const std::uint32_t mask = (1u << format.bitsStored) - 1;
  return static_cast<std::uint16_t>(static_cast<std::uint32_t>(sample) & mask);
}

}  // namespace

SampleFormat FormatOf(const DicomWriteOptions& options) {
  if (options.bitsStored < 8 || options.bitsStored > 16) {
    throw Error(std::to_string(options.bitsStored) + " stored bits; 8 to 16 can be written");
  }
  SampleFormat format;
  format.bitsAllocated = options.bitsStored == 8 ? 8 : 16;
  format.bitsStored = options.bitsStored;
  format.highBit = options.bitsStored - 1;
  format.isSigned = options.isSigned;
  format.inverted = options.inverted;
  return format;
}

PackedSlice PackSlice(const Study& study, std::span<const std::uint16_t> stored,
                      const DicomWriteOptions& options, std::size_t index) {
  const SampleFormat format = FormatOf(options);
  PackedSlice packed;
  packed.samples.reserve(stored.size());
  if (!options.sliceSlopes.empty()) {
    packed.slope = options.sliceSlopes.at(index);
    for (const std::uint16_t value : stored) {
      packed.samples.push_back(Encode(std::round(study.RealValue(value) / packed.slope), format));
    }
    return packed;
  }
  const std::int32_t shift = options.isSigned ? SignedShift(study) : 0;
  packed.slope = study.scale;
  packed.intercept = study.offset - shift * study.scale;
  for (const std::uint16_t value : stored) {
    packed.samples.push_back(Encode(value + shift, format));
  }
  return packed;
}

}  // namespace study
