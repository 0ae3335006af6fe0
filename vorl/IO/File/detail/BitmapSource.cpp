#include <vorl/IO/File/detail/BitmapSource.h>

#include <algorithm>
#include <bit>
#include <cstdlib>
#include <cstring>
#include <limits>

#include <vorl/Platform/detail/File.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

static_assert(std::endian::native == std::endian::little, "bitmap headers are read as they lie");

constexpr WORD kBitmapFileType = 19778;  // the characters "BM"
constexpr DWORD kInfoHeaderSize = sizeof(tagBITMAPINFOHEADER);
constexpr DWORD kHeaderSizes = sizeof(tagBITMAPFILEHEADER) + kInfoHeaderSize;

std::uint64_t Magnitude(LONG value) {
  return static_cast<std::uint64_t>(std::llabs(value));
}

// The colours that indices of so many bits can name; 0 where pixels are no indices.
std::size_t NameableColours(unsigned int bits) {
  return bits == 1 || bits == 2 || bits == 4 || bits == 8 ? std::size_t{1} << bits : 0;
}

}  // namespace

std::uint64_t BitmapSource::Width() const {
  return Magnitude(header.biWidth);
}

std::uint64_t BitmapSource::Height() const {
  return Magnitude(header.biHeight);
}

std::uint64_t BitmapSource::RowBytes() const {
  return BitmapRowBytes(Width(), header.biBitCount);
}

std::uint64_t BitmapSource::TotalBytes() const {
  return header.biBitCount <= 32 ? RowBytes() * Height() : 0;  // up to 32 bits it fits
}

bool BitmapSource::HasMasks() const {
  return header.biBitCount == 32 && header.biCompression == kCompressionBitFields;
}

void BitmapSource::SetPalette(const void* table, std::size_t bytes) {
  const std::size_t nameable = NameableColours(header.biBitCount);
  const std::size_t stated = header.biClrUsed != 0 ? header.biClrUsed : nameable;
  const std::size_t entries = std::min({nameable, stated, bytes / sizeof(tagRGBQUAD)});
  std::memcpy(palette.data(), table, entries * sizeof(tagRGBQUAD));
  paletteEntries = static_cast<unsigned int>(entries);
}

BitmapInMemory::BitmapInMemory(const tagBITMAPINFO* info, const void* bits)
    : m_bits(static_cast<const unsigned char*>(bits)) {
  std::memcpy(&header, info, sizeof(header));
  if (header.biSize == kInfoHeaderSize) {
    const auto* table = reinterpret_cast<const unsigned char*>(info) + kInfoHeaderSize;
    SetPalette(table, sizeof(palette));
    std::memcpy(masks.data(), table, HasMasks() ? sizeof(masks) : 0);
  }
  pixelBytes = std::numeric_limits<std::uint64_t>::max();
}

bool BitmapInMemory::ReadRow(void* target, std::size_t bytes) {
  std::memcpy(target, m_bits, bytes);
  m_bits += bytes;
  return true;
}

void BitmapInMemory::SetCutOff(dStatus& status) const {
  status.Set(false, "no pixel bits specified");
}

bool BitmapInFile::Open(const char* path, dStatus& status) {
  m_path = path;
  m_file.reset(OpenFileForReading(path));
  if (m_file == nullptr) {
    status.Set(false, "unable to open file '%s'", path);
    return false;
  }
  m_buffer.Attach(m_file.get());
  return ReadHeaders(status);
}

bool BitmapInFile::ReadHeaders(dStatus& status) {
  tagBITMAPFILEHEADER fileHeader{};
  if (!Read(&fileHeader, sizeof(fileHeader)) || fileHeader.bfType != kBitmapFileType) {
    status.Set(false, "file '%s' is not a bitmap file", m_path);
    return false;
  }
  auto* bytes = reinterpret_cast<unsigned char*>(&header);
  if (!Read(bytes, sizeof(header.biSize))) {
    status.Set(false, "file '%s' ends within its header", m_path);
    return false;
  }
  if (header.biSize != kInfoHeaderSize) {
    return true;  // refused by the operator, like such a header in memory
  }
  if (!Read(bytes + sizeof(header.biSize), kInfoHeaderSize - sizeof(header.biSize))) {
    status.Set(false, "file '%s' ends within its header", m_path);
    return false;
  }
  if (fileHeader.bfOffBits < kHeaderSizes || fileHeader.bfSize < fileHeader.bfOffBits ||
      fileHeader.bfSize > FileSize(m_file.get())) {
    status.Set(false, "file '%s' has sizes that cannot be true", m_path);
    return false;
  }
  std::array<unsigned char, sizeof(palette)> table{};
  const std::size_t tableBytes =
      std::min<std::size_t>(fileHeader.bfOffBits - kHeaderSizes, table.size());
  if (!Read(table.data(), tableBytes) || !SeekFile(m_file.get(), fileHeader.bfOffBits)) {
    SetCutOff(status);
    return false;
  }
  SetPalette(table.data(), tableBytes);
  std::memcpy(masks.data(), table.data(), sizeof(masks));
  pixelBytes = fileHeader.bfSize - fileHeader.bfOffBits;
  return true;
}

bool BitmapInFile::Read(void* target, std::size_t bytes) {
  return std::fread(target, 1, bytes, m_file.get()) == bytes;
}

bool BitmapInFile::ReadRow(void* target, std::size_t bytes) {
  return Read(target, bytes);
}

void BitmapInFile::SetCutOff(dStatus& status) const {
  status.Set(false, "file '%s' ends within its pixel data", m_path);
}

}  // namespace vorl_detail
}  // namespace vorl
