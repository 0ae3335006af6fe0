#ifndef VORL_APPS_STUDY_DICOMLOADER_H
#define VORL_APPS_STUDY_DICOMLOADER_H

/// @file
/// Loading a DICOM series as a study.

#include <study/LoadReport.h>
#include <study/Progress.h>
#include <study/Study.h>

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

namespace study {

/// Loads one series out of files and folders (searched with all their subfolders).
///
/// *Choice.* `series` is empty (the series with the most slices), a series instance UID, "#k" (the
/// k-th series of the report's list, from 1), or a series number; a number that no series has is
/// taken as the place in the list.
///
/// *Stack.* Slices are sorted by position along their normal; the step from slice to slice is the
/// mean one, which follows a gantry tilt. Slices that do not fit the others (size, orientation,
/// pixel spacing), repeat a position, or cannot be read are left out and named in `report.refused`;
/// missing and unequally spaced slices are told in `report.notes`. Loading goes on as long as one
/// slice remains.
///
/// *Values.* Rescale slope and intercept are kept in the study's `scale` and `offset` without loss
/// when the slope is the same in all slices. Slopes that differ (PET) are brought to one common
/// scale, and a note tells the largest error. Values of MONOCHROME1 files are mirrored within the
/// range of their bits, so that larger is always brighter.
///
/// `report` is filled as far as the load came, also when it fails. Throws `Error`.
std::unique_ptr<Study> LoadDicom(const std::vector<std::filesystem::path>& paths,
                                 const std::string& series, LoadReport& report,
                                 const Progress& progress = {});

}  // namespace study

#endif
