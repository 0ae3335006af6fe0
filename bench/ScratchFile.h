#ifndef BENCH_SCRATCHFILE_H
#define BENCH_SCRATCHFILE_H

#include <filesystem>
#include <random>
#include <string>
#include <system_error>

namespace bench {

/// The name of a file that no other run uses; what is written there is removed at the end.
class ScratchFile {
 public:
  explicit ScratchFile(const char* extension)
      : m_path((std::filesystem::temp_directory_path() /
                (std::string("vorl_bench_") + std::to_string(std::random_device()()) + extension))
                   .string()) {}
  ScratchFile(const ScratchFile&) = delete;
  ScratchFile& operator=(const ScratchFile&) = delete;
  ~ScratchFile() {
    std::error_code ignored;
    std::filesystem::remove(m_path, ignored);
  }

  const char* Name() const { return m_path.c_str(); }

 private:
  std::string m_path;
};

}  // namespace bench

#endif
