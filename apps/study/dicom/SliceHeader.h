#ifndef VORL_APPS_STUDY_DICOM_SLICEHEADER_H
#define VORL_APPS_STUDY_DICOM_SLICEHEADER_H

/// @file
/// What the loader knows of one DICOM slice before it reads the pixels.

#include <study/Vec3.h>

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>

namespace study {

/// How the samples of a slice lie in the file and what they mean.
struct SampleFormat {
  unsigned bitsAllocated = 16;  ///< 8 or 16
  unsigned bitsStored = 16;     ///< 1 to `bitsAllocated`
  unsigned highBit = 15;        ///< the position of the highest stored bit
  bool isSigned = false;        ///< two's complement within the stored bits
  bool inverted = false;        ///< smaller values are brighter
};

/// The orientation and grid of a slice: what all slices of one stack share.
struct SliceGrid {
  std::uint32_t columns = 0;
  std::uint32_t rows = 0;
  double columnSpacing = 1;       ///< millimetres from one column to the next
  double rowSpacing = 1;          ///< millimetres from one row to the next
  Vec3 rowDirection{1, 0, 0};     ///< unit vector along a row (increasing column index)
  Vec3 columnDirection{0, 1, 0};  ///< unit vector down a column (increasing row index)

  /// The unit vector along which a stack is sorted.
  Vec3 Normal() const { return Normalised(Cross(rowDirection, columnDirection)); }
};

/// The attributes of one slice. Positions are patient coordinates in millimetres: x to the
/// patient's left, y to the back, z to the head.
struct SliceHeader {
  std::filesystem::path file;
  std::uint32_t frame = 0;  ///< counted from 0 within the file
  std::string seriesUid;
  std::optional<long> seriesNumber;
  std::optional<long> instanceNumber;
  std::string modality;
  std::string description;
  std::string unit;  ///< of the real values; empty when unknown

  SliceGrid grid;
  std::optional<Vec3> position;  ///< the centre of the first pixel
  bool hasOrientation = false;
  bool hasSpacing = false;
  double thickness = 0;     ///< millimetres; 0 when unknown
  double sliceSpacing = 0;  ///< announced distance to the next slice; 0 when unknown

  SampleFormat format;
  double slope = 1;  ///< real = sample * slope + intercept; never 0
  double intercept = 0;
  std::optional<double> windowCentre;  ///< in real values
  std::optional<double> windowWidth;   ///< greater than 0
  bool hasLookupTable = false;         ///< a modality table that replaces slope and intercept
};

}  // namespace study

#endif
