#ifndef VORL_TESTS_APPS_FILESIZELIMIT_H
#define VORL_TESTS_APPS_FILESIZELIMIT_H

/// @file
/// A full disk for tests. There is none on Windows, where nothing limits what a process writes.

#if !defined(_WIN32)

#include <csignal>

#include <sys/resource.h>

namespace study_test {

/// While it lives, no file of this process grows beyond `bytes`: a disk that is full.
class FileSizeLimit {
 public:
  explicit FileSizeLimit(rlim_t bytes) {
    m_handler = std::signal(SIGXFSZ, SIG_IGN);
    getrlimit(RLIMIT_FSIZE, &m_old);
    rlimit limit = m_old;
    limit.rlim_cur = bytes;
    setrlimit(RLIMIT_FSIZE, &limit);
  }
  ~FileSizeLimit() {
    setrlimit(RLIMIT_FSIZE, &m_old);
    std::signal(SIGXFSZ, m_handler);
  }
  FileSizeLimit(const FileSizeLimit&) = delete;
  FileSizeLimit& operator=(const FileSizeLimit&) = delete;

 private:
  rlimit m_old{};
  void (*m_handler)(int);
};

}  // namespace study_test

#endif

#endif
