#ifndef VORL_PLATFORM_DETAIL_FILE_H
#define VORL_PLATFORM_DETAIL_FILE_H

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <memory>

inline namespace vorl {
namespace vorl_detail {

/// Opens a regular file for binary reading. Null when there is none that may be read, and for
/// everything that has no size to rely on: directories, pipes (never waits for a writer), devices.
std::FILE* OpenFileForReading(const char* name);

/// Creates or truncates a file for binary writing. Null when that is impossible, and for anything
/// but regular files and character devices (never waits for the reader of a pipe).
std::FILE* OpenFileForWriting(const char* name);

struct CloseFile {
  void operator()(std::FILE* file) const { std::fclose(file); }
};
/// An open file that is closed with its owner. For reading: what closing tells is not looked at.
using FileHandle = std::unique_ptr<std::FILE, CloseFile>;

/// The size of an open regular file in bytes; 0 when the system does not tell.
std::uint64_t FileSize(std::FILE* file);

/// Puts the position of an open file at a byte; false when the system refuses.
bool SeekFile(std::FILE* file, std::uint64_t position);

/// Fills rows with the bytes of an open file from a position on, one row after the other, past the
/// file's buffer and without a copy. The rows lie `step` bytes apart, downwards or upwards. False
/// when the file has fewer bytes or the system refuses. The file's own position is undefined
/// afterwards.
bool ReadFileRows(std::FILE* file, std::uint64_t position, unsigned char* first,
                  std::ptrdiff_t step, std::size_t rowBytes, std::size_t rows);

/// The way back: appends rows to what has been written and flushed, without a copy. False when the
/// system did not take all, which may show only later.
bool WriteFileRows(std::FILE* file, const unsigned char* first, std::ptrdiff_t step,
                   std::size_t rowBytes, std::size_t rows);

}  // namespace vorl_detail
}  // namespace vorl

#endif
