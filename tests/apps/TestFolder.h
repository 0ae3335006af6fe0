#ifndef VORL_TESTS_APPS_TESTFOLDER_H
#define VORL_TESTS_APPS_TESTFOLDER_H

/// @file
/// The files in a test's folder.

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "../Support/TestFolder.h"

namespace study_test {

namespace fs = std::filesystem;

using ::TestFolder;

inline std::string ReadBytes(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

inline void WriteBytes(const fs::path& path, const std::string& bytes) {
  std::ofstream file(path, std::ios::binary);
  file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

}  // namespace study_test

#endif
