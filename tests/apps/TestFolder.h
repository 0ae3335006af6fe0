#ifndef VORL_TESTS_APPS_TESTFOLDER_H
#define VORL_TESTS_APPS_TESTFOLDER_H

/// @file
/// A folder of its own for a test.

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <string>
#include <vector>

namespace study_test {

namespace fs = std::filesystem;

/// An empty folder that is removed with all its content.
class TestFolder {
 public:
  TestFolder() {
    std::random_device random;
    do {
      m_path = fs::temp_directory_path() / ("vorl-test-" + std::to_string(random()));
    } while (!fs::create_directory(m_path));  // throws where there can be none
  }
  ~TestFolder() {
    std::error_code ignored;
    fs::remove_all(m_path, ignored);
  }
  TestFolder(const TestFolder&) = delete;
  TestFolder& operator=(const TestFolder&) = delete;

  const fs::path& Path() const { return m_path; }
  fs::path operator/(const std::string& name) const { return m_path / name; }

  /// The names in the folder, sorted.
  std::vector<std::string> Names() const {
    std::vector<std::string> names;
    for (const auto& entry : fs::directory_iterator(m_path)) {
      names.push_back(entry.path().filename().string());
    }
    std::sort(names.begin(), names.end());
    return names;
  }

 private:
  fs::path m_path;
};

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
