#ifndef VORL_DATA_DETAIL_BITMAPFILE_H
#define VORL_DATA_DETAIL_BITMAPFILE_H

/// @file
/// Writing a bitmap file piece by piece, and what becomes of a file that stood in its place.

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <memory>
#include <string>

inline namespace vorl {
namespace vorl_detail {

/// What a bitmap file begins with: the characters "BM".
inline constexpr std::uint16_t kBitmapFileType = 19778;

/// Bytes of a bitmap row, which is a multiple of 32 bits long.
inline std::uint64_t BitmapRowBytes(std::uint64_t width, unsigned bitsPerPixel) {
  return (width * bitsPerPixel + 31) / 32 * 4;
}

/// A buffer for an open file that is read or written row by row: rows of many pages pass through it
/// in half the time that they take with the standard library's own small one. It must outlive the
/// file.
class RowBuffer {
 public:
  /// Without memory the file keeps its small buffer.
  void Attach(std::FILE* file);

 private:
  std::unique_ptr<char[]> m_bytes;
};

bool FileExists(const char* path);

/// Removes a file so that a new one can take its name. A device stays and is written to; a
/// directory is not removed. False when the name is not free afterwards.
bool MakeRoomForFile(const char* path);

/// A file being written. Unless it is finished, what was created is removed again.
class BitmapFile {
 public:
  explicit BitmapFile(const char* path);
  BitmapFile(const BitmapFile&) = delete;
  BitmapFile& operator=(const BitmapFile&) = delete;
  ~BitmapFile();

  bool IsOpen() const { return m_file != nullptr; }
  /// Writes bytes; false when the system did not take them, which may show only later.
  bool Write(const void* bytes, std::size_t count);
  /// Writes rows that lie `step` bytes apart, behind everything else, which must have been flushed.
  bool WriteRows(const unsigned char* first, std::ptrdiff_t step, std::size_t rowBytes,
                 std::size_t rows);
  /// True when everything written so far has reached the system.
  bool Flush();
  /// Closes the file and keeps it; false when the system did not take all.
  bool Finish();

 private:
  std::string m_path;
  RowBuffer m_buffer;
  std::FILE* m_file;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
