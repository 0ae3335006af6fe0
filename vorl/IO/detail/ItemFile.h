#ifndef VORL_IO_DETAIL_ITEMFILE_H
#define VORL_IO_DETAIL_ITEMFILE_H

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <memory>

inline namespace vorl {
namespace vorl_detail {

/// The open file behind a stream and its copies.
class ItemFile {
 public:
  /// Null when the file cannot be opened.
  static std::shared_ptr<ItemFile> OpenForReading(const char* name);
  static std::shared_ptr<ItemFile> OpenForWriting(const char* name);

  /// What `PeekByte` and `ReadByte` return at the end of the file.
  static constexpr int kEnd = -1;

  ItemFile(const ItemFile&) = delete;
  ItemFile& operator=(const ItemFile&) = delete;
  /// Closes the file.
  ~ItemFile();

  /// False when the bytes could not be taken; a failure that is not yet visible shows later.
  bool Write(const void* data, std::uint64_t size);
  /// Hands on what is buffered; false when anything since opening was lost.
  bool Flush();
  /// Closes the file; false when anything since opening was lost.
  bool Close();

  /// Bytes from the position to the end that the file had when it was opened.
  std::uint64_t GetRemaining() const { return m_remaining; }
  /// False, with nothing read, when fewer bytes remain; false as well when the file fails.
  bool Read(void* data, std::uint64_t size);
  int ReadByte();
  /// The next byte, or `kEnd`; the position stays.
  int PeekByte();

 private:
  explicit ItemFile(std::FILE* file);
  static std::shared_ptr<ItemFile> Adopt(std::FILE* file);

  std::unique_ptr<char[]> m_buffer;  // outlives the file, which is closed in the destructor's body
  std::FILE* m_file;
  std::uint64_t m_remaining = 0;
  bool m_failed = false;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
