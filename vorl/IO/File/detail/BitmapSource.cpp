#include <vorl/IO/File/detail/BitmapSource.h>

#include <algorithm>
#include <bit>
#include <cstdlib>
#include <cstring>
#include <limits>

inline namespace vorl {
namespace vorl_detail {

namespace {

static_assert(std::endian::native == std::endian::little, "bitmap headers are read as they lie");

constexpr DWORD kInfoHeaderSize = sizeof(tagBITMAPINFOHEADER);
// The header with red, green and blue masks, with alpha, with colour space, and with profile: each
// begins with the fields of the one before.
constexpr DWORD kLongerHeaders[] = {52, 56, 108, 124};
constexpr DWORD kLargestHeader = 124;
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

bool BitmapSource::HasKnownHeader() const {
  return header.biSize == kInfoHeaderSize ||
         std::find(std::begin(kLongerHeaders), std::end(kLongerHeaders), header.biSize) !=
             std::end(kLongerHeaders);
}

bool BitmapSource::HasPlainMasks() const {
  constexpr std::array<DWORD, 3> kPlain{0xFF0000, 0xFF00, 0xFF};
  // Those of 16 bits are not looked at: such a bitmap is always read as five bits per colour.
  return header.biBitCount == 16 || (header.biBitCount == 32 && masks == kPlain);
}

std::size_t BitmapSource::BytesBeforePalette() const {
  const bool masksFollow =
      header.biSize == kInfoHeaderSize && header.biCompression == kCompressionBitFields;
  return header.biSize - kInfoHeaderSize + (masksFollow ? sizeof(masks) : 0);
}

std::size_t BitmapSource::StatedColours() const {
  const std::size_t nameable = NameableColours(header.biBitCount);
  return header.biClrUsed != 0 ? std::min<std::size_t>(header.biClrUsed, nameable) : nameable;
}

void BitmapSource::SetTables(const unsigned char* tables, std::size_t bytes) {
  std::memcpy(masks.data(), tables, std::min(bytes, sizeof(masks)));
  const std::size_t skipped = std::min(bytes, BytesBeforePalette());
  const std::size_t entries = std::min(StatedColours(), (bytes - skipped) / sizeof(tagRGBQUAD));
  std::memcpy(palette.data(), tables + skipped, entries * sizeof(tagRGBQUAD));
  paletteEntries = static_cast<unsigned int>(entries);
}

bool BitmapSource::ReadAllRows(unsigned char* first, std::ptrdiff_t step) {
  for (std::uint64_t i = 0; i < Height(); ++i) {
    if (!ReadRow(first + step * static_cast<std::ptrdiff_t>(i),
                 static_cast<std::size_t>(RowBytes()))) {
      return false;
    }
  }
  return true;
}

BitmapInMemory::BitmapInMemory(const tagBITMAPINFO* info, const void* bits)
    : m_bits(static_cast<const unsigned char*>(bits)) {
  std::memcpy(&header, info, sizeof(header.biSize));
  if (HasKnownHeader()) {
    std::memcpy(&header, info, sizeof(header));
    // What the header speaks of, and no more: the block may end there.
    SetTables(reinterpret_cast<const unsigned char*>(info) + kInfoHeaderSize,
              BytesBeforePalette() + StatedColours() * sizeof(tagRGBQUAD));
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
  if (!HasKnownHeader()) {
    return true;  // refused by the operator, like such a header in memory
  }
  if (!Read(bytes + sizeof(header.biSize), kInfoHeaderSize - sizeof(header.biSize))) {
    status.Set(false, "file '%s' ends within its header", m_path);
    return false;
  }
  if (fileHeader.bfOffBits < sizeof(fileHeader) + header.biSize ||
      fileHeader.bfSize < fileHeader.bfOffBits || fileHeader.bfSize > FileSize(m_file.get())) {
    status.Set(false, "file '%s' has sizes that cannot be true", m_path);
    return false;
  }
  std::array<unsigned char, kLargestHeader + sizeof(masks) + sizeof(palette)> tables{};
  const std::size_t tableBytes =
      std::min<std::size_t>(fileHeader.bfOffBits - kHeaderSizes, tables.size());
  if (!Read(tables.data(), tableBytes) || !SeekFile(m_file.get(), fileHeader.bfOffBits)) {
    SetCutOff(status);
    return false;
  }
  SetTables(tables.data(), tableBytes);
  m_pixelPosition = fileHeader.bfOffBits;
  pixelBytes = fileHeader.bfSize - fileHeader.bfOffBits;
  return true;
}

bool BitmapInFile::Read(void* target, std::size_t bytes) {
  return std::fread(target, 1, bytes, m_file.get()) == bytes;
}

bool BitmapInFile::ReadRow(void* target, std::size_t bytes) {
  return Read(target, bytes);
}

bool BitmapInFile::ReadAllRows(unsigned char* first, std::ptrdiff_t step) {
  return ReadFileRows(m_file.get(), m_pixelPosition, first, step,
                      static_cast<std::size_t>(RowBytes()), static_cast<std::size_t>(Height()));
}

void BitmapInFile::SetCutOff(dStatus& status) const {
  status.Set(false, "file '%s' ends within its pixel data", m_path);
}

}  // namespace vorl_detail
}  // namespace vorl
