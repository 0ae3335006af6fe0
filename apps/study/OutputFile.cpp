#include <study/Error.h>
#include <study/OutputFile.h>

#include <atomic>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <string>
#include <system_error>

#ifdef _WIN32
#include <fcntl.h>
#include <io.h>
#include <process.h>
#else
#include <fcntl.h>
#include <unistd.h>
#endif

namespace study {
namespace {

namespace fs = std::filesystem;

#ifdef _WIN32
int ProcessId() {
  return _getpid();
}
int OpenToFlush(const fs::path& path) {
  return _wopen(path.c_str(), _O_RDWR | _O_BINARY | _O_NOINHERIT);
}
int Flush(int file) {
  return _commit(file);
}
void Close(int file) {
  _close(file);
}
#else
int ProcessId() {
  return getpid();
}
int OpenToFlush(const fs::path& path) {
  return open(path.c_str(), O_RDONLY | O_CLOEXEC);
}
int Flush(int file) {
  return fsync(file);
}
void Close(int file) {
  close(file);
}
#endif

/// Differs between processes and between the files of one process.
std::string UniqueSuffix() {
  static std::atomic<unsigned> count{0};
  return ".part-" + std::to_string(ProcessId()) + "-" + std::to_string(++count);
}

/// Makes sure that the bytes have reached the disk: with delayed allocation a full disk shows no
/// earlier than here.
void FlushToDisk(const fs::path& path, const fs::path& target) {
  const int file = OpenToFlush(path);
  const bool opened = file >= 0;
  const bool flushed = opened && Flush(file) == 0;
  const int reason = errno;
  if (opened) {
    Close(file);
  }
  if (!flushed) {
    throw Error("can't write " + Quoted(target.string()) + ": " + std::strerror(reason));
  }
}

}  // namespace

OutputFile::OutputFile(const fs::path& path) : m_target(path) {
  if (path.empty()) {
    throw Error("the name of the output file is empty");
  }
  std::error_code error;
  const fs::file_status status = fs::status(path, error);
  if (fs::is_directory(status)) {
    throw Error(Quoted(path.string()) + " is a folder");
  }
  if (fs::is_symlink(fs::symlink_status(path, error))) {
    const fs::path resolved = fs::weakly_canonical(path, error);
    if (!error) {
      m_target = resolved;
    }
  }
  m_replace = !fs::exists(status) || fs::is_regular_file(status);
  const fs::path folder = m_target.has_parent_path() ? m_target.parent_path() : fs::path(".");
  if (!fs::is_directory(folder, error)) {
    throw Error("the folder of " + Quoted(path.string()) + " does not exist");
  }
  m_temporary = m_replace ? m_target : fs::temp_directory_path() / m_target.filename();
  m_temporary += UniqueSuffix();
}

OutputFile::~OutputFile() {
  std::error_code ignored;
  if (!m_committed) {
    fs::remove(m_temporary, ignored);
  }
}

void OutputFile::Commit() {
  FlushToDisk(m_temporary, m_target);
  if (!m_replace) {
    CopyIntoTarget();
    return;  // the destructor removes the temporary file
  }
  std::error_code error;
  fs::rename(m_temporary, m_target, error);
  if (error) {
    throw Error("can't write " + Quoted(m_target.string()) + ": " + error.message());
  }
  m_committed = true;
}

void OutputFile::CopyIntoTarget() const {
  std::ifstream source(m_temporary, std::ios::binary);
  std::ofstream target(m_target, std::ios::binary);
  errno = 0;
  target << source.rdbuf();
  target.close();
  if (!source || !target) {
    const std::string reason = errno != 0 ? std::strerror(errno) : "the writing failed";
    throw Error("can't write " + Quoted(m_target.string()) + ": " + reason);
  }
}

}  // namespace study
