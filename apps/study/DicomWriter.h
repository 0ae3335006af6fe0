#ifndef VORL_APPS_STUDY_DICOMWRITER_H
#define VORL_APPS_STUDY_DICOMWRITER_H

/// @file
/// Writing a study as a DICOM series.

#include <study/Progress.h>
#include <study/Study.h>

#include <filesystem>
#include <string>
#include <vector>

namespace study {

/// How the pixels lie in the files.
enum class DicomEncoding {
  ExplicitLittle,
  ImplicitLittle,
  ExplicitBig,
  Rle,
  JpegLossless,
  JpegLsLossless
};

struct DicomWriteOptions {
  DicomEncoding encoding = DicomEncoding::ExplicitLittle;
  unsigned bitsStored = 16;  ///< 8 (in one byte), or 9 to 16 (in two)
  bool isSigned = false;     ///< real values with an intercept of 0, where the scale allows it
  bool inverted = false;     ///< MONOCHROME1
  int seriesNumber = 1;
  std::string seriesDescription;  ///< the study's when empty
  /// One rescale slope per slice, as PET has them; values are rounded. Empty: the study's scale.
  std::vector<double> sliceSlopes;
  bool intoExistingFolder = false;  ///< allow a folder that holds something already
};

/// Writes one CT image file per slice, "S001-00001.dcm" and so on, into `folder`, which is made
/// when it does not exist. Identifiers follow from the content and the options alone, so that equal
/// input gives equal files. Each file appears only when it is complete; when one fails, those
/// written before it are removed again. Returns the files in slice order. Throws `Error`: "the
/// folder 'name' is not empty", values that do not fit the bits, a full disk.
std::vector<std::filesystem::path> WriteDicomSeries(const Study& study,
                                                    const std::filesystem::path& folder,
                                                    const DicomWriteOptions& options = {},
                                                    const Progress& progress = {});

}  // namespace study

#endif
