#ifndef VORL_APPS_STUDY_DICOM_FILEWINDOW_H
#define VORL_APPS_STUDY_DICOM_FILEWINDOW_H

/// @file
/// Reading a few bytes here and there in a file.

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <optional>
#include <span>
#include <string>

namespace study {

/// A file seen through a window of a few kilobytes that moves along. Every read is checked against
/// the size of the file.
class FileWindow {
 public:
  explicit FileWindow(const std::filesystem::path& path);

  /// 0 when the file cannot be opened.
  std::uint64_t Size() const { return m_size; }
  /// The bytes from `offset` on; empty when the file does not hold that many. Valid until the next
  /// call. `count` is at most `kLargestRead`.
  std::span<const std::uint8_t> At(std::uint64_t offset, std::size_t count);

  static constexpr std::size_t kLargestRead = 4096;

 private:
  static constexpr std::size_t kWindow = 65536;

  std::ifstream m_file;
  std::uint64_t m_size = 0;
  std::uint64_t m_begin = 0;
  std::string m_bytes;
};

}  // namespace study

#endif
