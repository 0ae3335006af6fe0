#include <vorl/Data/dImaDescriptorDIB.h>

#include <bit>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <new>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/BitmapFile.h>

inline namespace vorl {

namespace {

static_assert(std::endian::native == std::endian::little, "bitmap headers are written as they lie");

constexpr std::uint32_t kInfoHeaderSize = sizeof(tagBITMAPINFOHEADER);
constexpr std::uint32_t kFileHeaderSize = sizeof(tagBITMAPFILEHEADER);

constexpr char kConversionPrefix[] = "unable to convert into 'Bitmap':\n\t";

unsigned PaletteEntries(unsigned bitsPerPixel) {
  return bitsPerPixel < 9 ? 1U << bitsPerPixel : 0;
}

// The row length in pixels of the bitmap whose rows are the image's.
std::uint64_t PaddedWidth(const dImage& image, unsigned bitsPerPixel) {
  return std::uint64_t{image.GetBytesPerRow()} * 8 / bitsPerPixel;
}

bool IsBitmapLayout(const dImage& image) {
  if (image.GetDataOrder() != ImageDataOrder_Pixel) {
    return false;
  }
  const unsigned dataType = image.GetDataType();
  switch (image.GetNumChannels()) {
    case 1:
      return dataType == ImageDataType_U1 || dataType == ImageDataType_U8;
    case 3:
      return dataType == ImageDataType_U8;
    case 4:
      return dataType == ImageDataType_U8 && std::strcmp(image.GetChannelSequence(), "BGRA") == 0;
    default:
      return false;
  }
}

// A bitmap states its width in 31 bits; the image's own is larger only at one bit per pixel.
bool FitsBitmap(const dImage& image) {
  const unsigned bits = static_cast<unsigned>(image.GetNumChannels()) * image.GetDataType();
  return PaddedWidth(image, bits) <= std::numeric_limits<LONG>::max();
}

}  // namespace

VORL_REGISTER_CLASS(dImaDescriptorDIB, DataBase);

dImaDescriptorDIB::dImaDescriptorDIB() = default;

dImaDescriptorDIB::dImaDescriptorDIB(dImage& image) {
  Init(image);
}

dImaDescriptorDIB::dImaDescriptorDIB(const dImaDescriptorDIB& source) : DataBase(source) {
  dImaDescriptorDIB::operator=(source);
}

dImaDescriptorDIB& dImaDescriptorDIB::operator=(const dImaDescriptorDIB& source) {
  if (this == &source) {
    return *this;
  }
  try {
    m_block = source.m_block;
  } catch (const std::bad_alloc&) {
    Reset();
    m_status.Set(false, "%s no memory for 'BITMAPINFO' structure", kConversionPrefix);
    return *this;
  }
  m_status = source.m_status;
  m_pImage = source.m_pImage;
  m_pixelData = source.m_pixelData;
  m_imageWidth = source.m_imageWidth;
  m_headerSize = source.m_headerSize;
  return *this;
}

dImaDescriptorDIB::~dImaDescriptorDIB() = default;

void dImaDescriptorDIB::Reset() {
  m_pImage = nullptr;
  m_block.clear();
  m_pixelData = nullptr;
  m_imageWidth = 0;
  m_headerSize = 0;
}

bool dImaDescriptorDIB::IsValid() {
  return !m_block.empty();
}
bool dImaDescriptorDIB::IsValid() const {
  return !m_block.empty();
}

const dStatus& dImaDescriptorDIB::GetStatus() const {
  return m_status;
}

bool dImaDescriptorDIB::CheckImage(dImage* image) {
  LogContext context("dImaDescriptorDIB::CheckImage", __FILE__, __LINE__, true);
  if (image == nullptr || !static_cast<const dImage*>(image)->IsValid()) {
    m_status.Set(false, "uninitialized image");
  } else if (image->GetBytesPerRow() % 4 != 0) {
    m_status.Set(false, "image rows are not 4 byte aligned");
  } else if (!IsBitmapLayout(*image) || !FitsBitmap(*image)) {
    m_status.Set(false, "not a 'Bitmap' format: %d x %d bit - '%s' - %s", image->GetNumChannels(),
                 image->GetDataType(), image->GetChannelSequence(),
                 dImage::DataOrder2Str(image->GetDataOrder()));
  } else {
    return true;
  }
  context.Status(__LINE__, m_status);
  return false;
}

tagBITMAPINFO* dImaDescriptorDIB::Init(dImage& image) {
  LogContext context("dImaDescriptorDIB::Init", __FILE__, __LINE__, true);
  Reset();
  if (!CheckImage(&image)) {
    return nullptr;
  }
  const unsigned bits = static_cast<unsigned>(image.GetNumChannels()) * image.GetDataType();
  const unsigned entries = PaletteEntries(bits);
  const auto headerSize = static_cast<std::uint32_t>(kInfoHeaderSize + entries * sizeof(RGBQUAD));
  try {
    m_block.assign((headerSize + sizeof(tagBITMAPINFO) - 1) / sizeof(tagBITMAPINFO), {});
  } catch (const std::bad_alloc&) {
    m_status.Set(false, "%s no memory for 'BITMAPINFO' structure", kConversionPrefix);
    context.Status(__LINE__, m_status);
    return nullptr;
  }
  BITMAPINFOHEADER& header = m_block.front().bmiHeader;
  header.biSize = kInfoHeaderSize;
  header.biWidth = static_cast<LONG>(PaddedWidth(image, bits));
  header.biHeight = -static_cast<LONG>(image.GetHeight());
  header.biPlanes = 1;
  header.biBitCount = static_cast<WORD>(bits);
  header.biCompression = BI_RGB;
  header.biSizeImage = static_cast<DWORD>(image.GetBytesPerRow() * image.GetHeight());
  header.biClrUsed = entries;
  header.biClrImportant = entries;
  m_pImage = &image;
  m_pixelData = image.GetDataPtr();
  m_imageWidth = static_cast<std::uint32_t>(image.GetWidth());
  m_headerSize = headerSize;
  ResetPalette(true);
  m_status = true;
  return GetHeader();
}

tagBITMAPINFO* dImaDescriptorDIB::GetHeader() const {
  return m_block.empty() ? nullptr : const_cast<tagBITMAPINFO*>(m_block.data());
}

void* dImaDescriptorDIB::GetPixelData() const {
  return m_pixelData;
}

unsigned short dImaDescriptorDIB::GetPaletteSize() const {
  return m_block.empty() ? WORD{0}
                         : static_cast<WORD>((m_headerSize - kInfoHeaderSize) / sizeof(RGBQUAD));
}

tagRGBQUAD* dImaDescriptorDIB::GetPalette() const {
  if (GetPaletteSize() == 0) {
    return nullptr;
  }
  // The table goes on behind the structure's one declared entry.
  auto* block = reinterpret_cast<unsigned char*>(GetHeader());
  return reinterpret_cast<tagRGBQUAD*>(block + kInfoHeaderSize);
}

bool dImaDescriptorDIB::ResetPalette(bool ascending) {
  tagRGBQUAD* palette = GetPalette();
  if (palette == nullptr) {
    return false;
  }
  const int entries = GetPaletteSize();
  const double step = (ascending ? 255.0 : -255.0) / (entries - 1);
  double value = ascending ? 0.5 : 255.5;
  for (int i = 0; i < entries; ++i) {
    const auto grey = static_cast<BYTE>(value);
    palette[i] = {grey, grey, grey, 0};
    value += step;
  }
  return true;
}

std::uint64_t dImaDescriptorDIB::RowCount() const {
  return static_cast<std::uint64_t>(std::llabs(m_block.front().bmiHeader.biHeight));
}

std::uint64_t dImaDescriptorDIB::MemoryRowBytes() const {
  const BITMAPINFOHEADER& header = m_block.front().bmiHeader;
  const auto width = static_cast<std::uint64_t>(std::llabs(header.biWidth));
  return vorl_detail::BitmapRowBytes(width, header.biBitCount);
}

std::uint64_t dImaDescriptorDIB::FileRowBytes() const {
  return vorl_detail::BitmapRowBytes(m_imageWidth, m_block.front().bmiHeader.biBitCount);
}

// The caller may have formatted the image anew since, or written into the block: what is saved or
// drawn must lie inside the pixels.
bool dImaDescriptorDIB::IsCurrent() const {
  return !m_block.empty() && m_pixelData != nullptr && m_pImage->GetDataPtr() == m_pixelData &&
         m_block.front().bmiHeader.biSize == kInfoHeaderSize &&
         m_block.front().bmiHeader.biCompression == BI_RGB &&
         m_pImage->GetWidth() == m_imageWidth && m_pImage->GetHeight() == RowCount() &&
         m_pImage->GetColumnOffset() == m_block.front().bmiHeader.biBitCount &&
         m_pImage->GetBytesPerRow() == MemoryRowBytes() && FileRowBytes() <= MemoryRowBytes() &&
         MemoryRowBytes() * RowCount() <= m_pImage->GetImageSize();
}

bool dImaDescriptorDIB::Save(const char* filePath, bool overwrite) {
  LogContext context("dImaDescriptorDIB::Save", __FILE__, __LINE__, true);
  const auto fail = [&](int line, const char* format, const char* path) {
    m_status.Set(false, format, path);
    context.Status(line, m_status);
    return false;
  };
  if (!IsCurrent()) {
    return fail(__LINE__, "dImaDescriptorDIB: not initialized", "");
  }
  if (filePath == nullptr || *filePath == '\0') {
    return fail(__LINE__, "NULL parameter:'FilePath'", "");
  }
  if (vorl_detail::FileExists(filePath)) {
    if (!overwrite) {
      return fail(__LINE__, "file already exists:'%s'", filePath);
    }
    if (!vorl_detail::MakeRoomForFile(filePath)) {
      return fail(__LINE__, "can't remove '%s'", filePath);
    }
  }
  vorl_detail::BitmapFile file(filePath);
  if (!file.IsOpen()) {
    return fail(__LINE__, "unable to open file '%s'", filePath);
  }
  // Each part is flushed, so that a full disk is told of the part that it cut off.
  if (!WriteFileHeader(file) || !file.Flush()) {
    return fail(__LINE__, "error while writing file header to '%s'", filePath);
  }
  if (!WriteInfo(file) || !file.Flush()) {
    return fail(__LINE__, "error while writing bitmap info to '%s'", filePath);
  }
  if (!WriteRows(file) || !file.Finish()) {
    return fail(__LINE__, "error while writing pixel data to '%s'", filePath);
  }
  m_status = true;
  return true;
}

bool dImaDescriptorDIB::WriteFileHeader(vorl_detail::BitmapFile& file) const {
  const std::uint64_t fileBytes = FileRowBytes() * RowCount() + m_headerSize + kFileHeaderSize;
  if (fileBytes > std::numeric_limits<DWORD>::max()) {
    return false;  // the header cannot state it
  }
  tagBITMAPFILEHEADER fileHeader{};
  fileHeader.bfType = vorl_detail::kBitmapFileType;
  fileHeader.bfSize = static_cast<DWORD>(fileBytes);
  fileHeader.bfOffBits = m_headerSize + kFileHeaderSize;
  return file.Write(&fileHeader, sizeof(fileHeader));
}

// In the file the bitmap has the image's real width and its bottom row first.
bool dImaDescriptorDIB::WriteInfo(vorl_detail::BitmapFile& file) const {
  BITMAPINFOHEADER header = m_block.front().bmiHeader;
  header.biWidth = static_cast<LONG>(m_imageWidth);
  header.biHeight = static_cast<LONG>(RowCount());
  return file.Write(&header, kInfoHeaderSize) &&
         file.Write(GetPalette(), GetPaletteSize() * sizeof(RGBQUAD));
}

bool dImaDescriptorDIB::WriteRows(vorl_detail::BitmapFile& file) const {
  const auto rows = static_cast<std::size_t>(RowCount());
  const auto memoryRow = static_cast<std::ptrdiff_t>(MemoryRowBytes());
  const auto* const pixels = static_cast<const unsigned char*>(m_pixelData);
  const auto last = static_cast<std::ptrdiff_t>(rows) - 1;
  return rows == 0 || file.WriteRows(pixels + last * memoryRow, -memoryRow,
                                     static_cast<std::size_t>(FileRowBytes()), rows);
}

}  // namespace vorl
