#include <study/DicomLoader.h>
#include <study/LoadStudy.h>
#include <study/StudyFile.h>

#include <cctype>
#include <fstream>
#include <system_error>

namespace study {
namespace {

namespace fs = std::filesystem;

/// True for a binary data file of any type, and for a file that is named like one: such a file is
/// never DICOM, and its own reader knows best what is wrong with it.
bool IsMeantAsStudyFile(const fs::path& path) {
  std::error_code ignored;
  if (!fs::is_regular_file(path, ignored)) {
    return false;
  }
  std::string extension = path.extension().string();
  for (char& c : extension) {
    c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  }
  if (extension == ".bdf") {
    return true;
  }
  char head[4] = {};
  std::ifstream file(path, std::ios::binary);
  file.read(head, sizeof head);
  return std::string(head, sizeof head) == std::string("BDF\0", sizeof head);
}

}  // namespace

std::unique_ptr<Study> LoadStudy(const std::vector<fs::path>& paths, const std::string& series,
                                 LoadReport& report, const Progress& progress) {
  if (paths.empty()) {
    throw Error("no input is named");
  }
  for (const fs::path& path : paths) {
    std::error_code ignored;
    if (!fs::exists(path, ignored)) {
      throw Error(Quoted(path.string()) + " does not exist");
    }
    // Opening a pipe would wait for somebody who writes into it.
    if (!fs::is_regular_file(path, ignored) && !fs::is_directory(path, ignored)) {
      throw Error(Quoted(path.string()) + " is neither a file nor a folder");
    }
    if (!IsMeantAsStudyFile(path)) {
      continue;
    }
    if (paths.size() > 1) {
      throw Error("the study file " + Quoted(path.string()) + " must be the only input");
    }
    if (!series.empty()) {
      throw Error("the study file " + Quoted(path.string()) + " holds no series to choose from");
    }
    return ReadStudyFile(path, progress);
  }
  return LoadDicom(paths, series, report, progress);
}

}  // namespace study
