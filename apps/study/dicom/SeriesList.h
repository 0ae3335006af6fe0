#ifndef VORL_APPS_STUDY_DICOM_SERIESLIST_H
#define VORL_APPS_STUDY_DICOM_SERIESLIST_H

/// @file
/// Which files there are, which series they form, and which one is meant.

#include <study/LoadReport.h>
#include <study/Progress.h>
#include <study/dicom/SliceHeader.h>

#include <cstddef>
#include <filesystem>
#include <string>
#include <vector>

namespace study {

/// The regular files named by `paths`: files as they stand, folders with all their subfolders, each
/// file once, sorted by name within a folder. Throws `Error` for a path that does not exist.
/// `named` tells which files the caller named one by one.
struct InputFile {
  std::filesystem::path path;
  bool named = false;
};

std::vector<InputFile> CollectFiles(const std::vector<std::filesystem::path>& paths);

/// Reads the headers of all slices. Files that are no DICOM files are counted in
/// `report.notDicom` when they come from a folder, and refused when they were named. DICOM files
/// without a usable slice are refused.
std::vector<SliceHeader> ReadAllHeaders(const std::vector<InputFile>& files, LoadReport& report,
                                        const Progress& progress);

/// Describes the series of the headers: most slices first, then by number, then by UID.
std::vector<SeriesInfo> ListSeries(const std::vector<SliceHeader>& headers);

/// The index in `series` (not empty) that `choice` means (see `LoadDicom`). Throws `Error` with the
/// list of the series when it means none, or more than one.
std::size_t ChooseSeries(const std::vector<SeriesInfo>& series, const std::string& choice);

}  // namespace study

#endif
