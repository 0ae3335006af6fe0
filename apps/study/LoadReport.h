#ifndef VORL_APPS_STUDY_LOADREPORT_H
#define VORL_APPS_STUDY_LOADREPORT_H

/// @file
/// What happened while a study was loaded.

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace study {

/// One series among the files.
struct SeriesInfo {
  std::string uid;
  std::optional<long> number;
  std::string modality;
  std::string description;
  std::size_t slices = 0;
  std::uint32_t columns = 0;  ///< of most of its slices
  std::uint32_t rows = 0;
};

/// A DICOM file, or a frame of one, that was left out.
struct RefusedFile {
  std::filesystem::path file;
  std::string reason;     ///< one line without the file's name
  std::string seriesUid;  ///< empty when it could not be told
};

/// What a load met besides the study itself.
struct LoadReport {
  std::vector<SeriesInfo> series;    ///< largest first; empty when no DICOM was involved
  std::size_t chosen = 0;            ///< index of the loaded series
  std::size_t notDicom = 0;          ///< files in folders that are no DICOM files, skipped
  std::vector<RefusedFile> refused;  ///< left out, in the order in which they were met
  std::vector<std::string> notes;  ///< what a user should know of the loaded series, one line each
};

/// One line: "'folder/a.dcm': it holds no pixel data".
std::string RefusalText(const RefusedFile& refused);

/// One line: "series 3, CT 'Thorax', 120 slices of 512 x 512, UID 1.2.3".
std::string SeriesText(const SeriesInfo& series);

}  // namespace study

#endif
