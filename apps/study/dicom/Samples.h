#ifndef VORL_APPS_STUDY_DICOM_SAMPLES_H
#define VORL_APPS_STUDY_DICOM_SAMPLES_H

/// @file
/// From the bytes of a slice to the unsigned 16-bit values of a study.
///
/// 1. `UnpackSamples` brings every slice to one form: 16-bit samples in two's complement.
/// 2. `ChooseMapping` looks at the value ranges of all slices and finds one scale and offset.
/// 3. `ApplyMapping` replaces each slice's samples by the stored values.

#include <study/dicom/SliceHeader.h>

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace study {

/// The smallest and largest value that `format` can hold.
struct SampleRange {
  std::int32_t minimum = 0;
  std::int32_t maximum = 0;
};

/// 8 or 16 bits allocated, and the stored bits within them.
bool IsSupported(const SampleFormat& format);

SampleRange RangeOfFormat(const SampleFormat& format);

/// Reads `samples.size()` little-endian samples of `format` from `bytes` (which must hold as many,
/// at 1 or 2 bytes each). Bits outside the stored ones are ignored. Inverted formats are mirrored
/// within the range of the format, so that larger values are brighter. A negative sample is written
/// as its two's complement in 16 bits.
void UnpackSamples(std::span<const std::uint8_t> bytes, const SampleFormat& format,
                   std::span<std::uint16_t> samples);

/// The smallest and largest of unpacked samples; (0, 0) for none.
SampleRange RangeOfSamples(std::span<const std::uint16_t> samples, bool isSigned);

/// What the choice of a mapping needs to know of one slice.
struct SliceValues {
  bool isSigned = false;
  SampleRange range;
  double slope = 1;
  double intercept = 0;
};

/// How the samples of a series become stored values: real = stored * scale + offset, with a scale
/// greater than 0 and the series' smallest value stored as 0.
struct ValueMapping {
  double scale = 1;
  double offset = 0;
  /// The largest difference between a stored value's real value and the file's; 0 when the mapping
  /// loses nothing.
  double maximumError = 0;
};

/// The common mapping of the given slices (at least one).
///
/// When all slopes are equal and the intercepts differ by whole multiples of the slope, the mapping
/// keeps every value exactly: `scale` is the slope's absolute value. Otherwise, or when the values
/// would not fit 16 bits, the real values are spread evenly over 0 to 65535, and `maximumError` is
/// half a step.
ValueMapping ChooseMapping(const std::vector<SliceValues>& slices);

/// Replaces the unpacked samples of one slice by their stored values.
void ApplyMapping(const ValueMapping& mapping, const SliceValues& slice,
                  std::span<std::uint16_t> samples);

}  // namespace study

#endif
