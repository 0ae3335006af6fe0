#ifndef VORL_APPS_STUDY_OUTPUTFILE_H
#define VORL_APPS_STUDY_OUTPUTFILE_H

/// @file
/// Writing files so that nobody ever meets a half-written one.

#include <filesystem>

namespace study {

/// A file that appears under its name only when it is complete.
///
/// The writer fills the file at `TemporaryPath()` (in the same folder, so that the last step is one
/// renaming) and then calls `Commit`. Without `Commit` the temporary file is removed and whatever
/// stood under the name stays. A symbolic link keeps its place: the file it leads to is replaced.
/// A target that is no regular file (a pipe, a device) is never replaced: the temporary file stands
/// in the system's folder for such files, and `Commit` copies it into the target.
class OutputFile {
 public:
  /// Throws `Error` when `path` is empty, a folder, or in a folder that does not exist.
  explicit OutputFile(const std::filesystem::path& path);
  /// Removes the temporary file when `Commit` was not called or failed.
  ~OutputFile();
  OutputFile(const OutputFile&) = delete;
  OutputFile& operator=(const OutputFile&) = delete;

  /// Where to write.
  const std::filesystem::path& TemporaryPath() const { return m_temporary; }
  /// Flushes the temporary file to the disk and puts it in place. Throws `Error` when either
  /// fails; the earlier file is then still there.
  void Commit();

 private:
  void CopyIntoTarget() const;

  std::filesystem::path m_target;
  std::filesystem::path m_temporary;
  bool m_replace = true;
  bool m_committed = false;
};

}  // namespace study

#endif
