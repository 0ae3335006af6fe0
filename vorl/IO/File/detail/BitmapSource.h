#ifndef VORL_IO_FILE_DETAIL_BITMAPSOURCE_H
#define VORL_IO_FILE_DETAIL_BITMAPSOURCE_H

/// @file
/// Where a bitmap to be converted comes from: memory, or a file.

#include <vorl/Common/dStatus.h>
#include <vorl/Data/detail/BitmapFile.h>
#include <vorl/Platform/Gdi.h>
#include <vorl/Platform/detail/File.h>

#include <array>
#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// Compression codes beside `BI_RGB`.
inline constexpr DWORD kCompressionRle8 = 1;
inline constexpr DWORD kCompressionRle4 = 2;
inline constexpr DWORD kCompressionBitFields = 3;
inline constexpr DWORD kCompressionJpeg = 4;
inline constexpr DWORD kCompressionPng = 5;

/// A bitmap's header and colour table, and its rows one after another as they are stored.
class BitmapSource {
 public:
  virtual ~BitmapSource() = default;
  BitmapSource(const BitmapSource&) = delete;
  BitmapSource& operator=(const BitmapSource&) = delete;

  /// Copies the next bytes of the pixels; false when they cannot be had.
  virtual bool ReadRow(void* target, std::size_t bytes) = 0;
  /// Copies all rows as they are stored, before any was read, to places `step` bytes apart; false
  /// when they cannot be had.
  virtual bool ReadAllRows(unsigned char* first, std::ptrdiff_t step);
  /// What to tell when rows are missing.
  virtual void SetCutOff(dStatus& status) const = 0;

  /// The size of the rows as they are stored.
  std::uint64_t RowBytes() const;
  /// The size of all rows; 0 for a depth at which they have none to be converted.
  std::uint64_t TotalBytes() const;
  /// Width and height without their signs.
  std::uint64_t Width() const;
  std::uint64_t Height() const;
  bool IsBottomUp() const { return header.biHeight >= 0; }
  /// True for the header of 40 bytes and for those that go on behind its fields.
  bool HasKnownHeader() const;
  /// True when bit fields, if there are any, lie where they would without being told.
  bool HasPlainMasks() const;

  BITMAPINFOHEADER header{};
  std::array<tagRGBQUAD, 256> palette{};  ///< black behind the entries that there are
  unsigned int paletteEntries = 0;        ///< no more than the bits per pixel can name
  std::array<DWORD, 3> masks{};           ///< of red, green and blue; 0: none
  std::uint64_t pixelBytes = 0;           ///< the bytes of pixels that there are

 protected:
  BitmapSource() = default;
  /// Takes masks and palette from what follows the first 40 bytes of the header.
  void SetTables(const unsigned char* tables, std::size_t bytes);
  /// From the end of the header's first 40 bytes on.
  std::size_t BytesBeforePalette() const;
  /// The entries of the palette that the header speaks of.
  std::size_t StatedColours() const;
};

/// A bitmap in memory. Header and colour table are copied.
class BitmapInMemory : public BitmapSource {
 public:
  BitmapInMemory(const tagBITMAPINFO* info, const void* bits);

  bool ReadRow(void* target, std::size_t bytes) override;
  void SetCutOff(dStatus& status) const override;

 private:
  const unsigned char* m_bits;
};

/// A bitmap file.
class BitmapInFile : public BitmapSource {
 public:
  /// Opens the file and reads what comes before the pixels; false with the reason.
  bool Open(const char* path, dStatus& status);

  bool ReadRow(void* target, std::size_t bytes) override;
  bool ReadAllRows(unsigned char* first, std::ptrdiff_t step) override;
  void SetCutOff(dStatus& status) const override;

 private:
  bool ReadHeaders(dStatus& status);
  bool Read(void* target, std::size_t bytes);

  RowBuffer m_buffer;
  FileHandle m_file;
  const char* m_path = nullptr;
  std::uint64_t m_pixelPosition = 0;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
