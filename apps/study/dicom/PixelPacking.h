#ifndef VORL_APPS_STUDY_DICOM_PIXELPACKING_H
#define VORL_APPS_STUDY_DICOM_PIXELPACKING_H

/// @file
/// From stored values to the samples of a DICOM file: the way back of Samples.h.

#include <study/DicomWriter.h>
#include <study/dicom/SliceHeader.h>

#include <cstdint>
#include <span>
#include <vector>

namespace study {

/// The samples of one file and how to read them.
struct PackedSlice {
  std::vector<std::uint16_t> samples;  ///< in two's complement within the stored bits
  double slope = 1;
  double intercept = 0;
};

/// The sample format that the options ask for. Throws `Error` for impossible numbers of bits.
SampleFormat FormatOf(const DicomWriteOptions& options);

/// Throws `Error` when a value does not fit the format.
PackedSlice PackSlice(const Study& study, std::span<const std::uint16_t> stored,
                      const DicomWriteOptions& options, std::size_t index);

}  // namespace study

#endif
