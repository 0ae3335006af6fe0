#ifndef VORL_TESTS_SUPPORT_TESTFOLDER_H
#define VORL_TESTS_SUPPORT_TESTFOLDER_H

/// @file
/// A folder of its own for a test: tests run side by side, the same one in several programs too.

#include <algorithm>
#include <filesystem>
#include <random>
#include <string>
#include <system_error>
#include <vector>

/// An empty folder that is removed with all its content.
class TestFolder {
 public:
  TestFolder() {
    std::random_device random;
    do {
      m_path = std::filesystem::temp_directory_path() / ("vorl-test-" + std::to_string(random()));
    } while (!std::filesystem::create_directory(m_path));  // throws where there can be none
  }
  ~TestFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(m_path, ignored);
  }
  TestFolder(const TestFolder&) = delete;
  TestFolder& operator=(const TestFolder&) = delete;

  const std::filesystem::path& Path() const { return m_path; }
  std::filesystem::path operator/(const std::string& name) const { return m_path / name; }

  /// The names in the folder, sorted.
  std::vector<std::string> Names() const {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(m_path)) {
      names.push_back(entry.path().filename().string());
    }
    std::sort(names.begin(), names.end());
    return names;
  }

 private:
  std::filesystem::path m_path;
};

#endif
