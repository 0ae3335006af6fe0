#ifndef VORL_APPS_STUDY_LOADSTUDY_H
#define VORL_APPS_STUDY_LOADSTUDY_H

/// @file
/// Loading a study from whatever the user names.

#include <study/LoadReport.h>
#include <study/Progress.h>
#include <study/Study.h>

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

namespace study {

/// Loads a study file when `paths` is one file of that kind (`series` must then be empty), else a
/// series out of DICOM files and folders (see `LoadDicom`). Throws `Error`.
std::unique_ptr<Study> LoadStudy(const std::vector<std::filesystem::path>& paths,
                                 const std::string& series, LoadReport& report,
                                 const Progress& progress = {});

}  // namespace study

#endif
