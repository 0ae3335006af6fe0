#include <vorl/IO/File/opDIB2Ima.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <string>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/IO/File/detail/BitmapRows.h>
#include <vorl/IO/File/detail/BitmapSource.h>

inline namespace vorl {

using vorl_detail::BitmapInFile;
using vorl_detail::BitmapInMemory;
using vorl_detail::BitmapSource;

namespace {

constexpr LONG kLowest = std::numeric_limits<LONG>::min();

// Where a bitmap's depth has no image, its own depth is left for `InitOutputImage` to refuse.
int TargetBits(const BitmapSource& source) {
  switch (source.header.biBitCount) {
    case 2:
    case 4:
    case 8:
      return vorl_detail::IsGrayScalePalette(source.palette.data(), source.paletteEntries) ? 8 : 24;
    case 16:
      return 24;
    default:
      return source.header.biBitCount;
  }
}

/// True when every index stands for the grey level of its own number: the usual palette of grey
/// pictures, whose rows need no conversion.
bool IsPlainRamp(const BitmapSource& source) {
  for (std::size_t i = 0; i < source.palette.size(); ++i) {
    if (source.palette[i].rgbBlue != i) {
      return false;
    }
  }
  return true;
}

bool IsTargetDepth(int bits) {
  return bits == 1 || bits == 8 || bits == 24 || bits == 32;
}

/// Empty when the pixels lie plain, else the name of their compression.
std::string CompressionName(const BitmapSource& source) {
  switch (source.header.biCompression) {
    case BI_RGB:
      return {};
    case vorl_detail::kCompressionRle8:
      return "RLE8";
    case vorl_detail::kCompressionRle4:
      return "RLE4";
    case vorl_detail::kCompressionBitFields:
      return source.HasPlainMasks() ? std::string() : "bit fields";
    case vorl_detail::kCompressionJpeg:
      return "JPEG";
    case vorl_detail::kCompressionPng:
      return "PNG";
    default:
      return std::to_string(source.header.biCompression);
  }
}

/// True when the header is one that can be converted; the depth is judged later.
bool CheckHeader(const BitmapSource& source, dStatus& status) {
  const BITMAPINFOHEADER& header = source.header;
  const std::string compression = CompressionName(source);
  if (!source.HasKnownHeader()) {
    status.Set(false, "opDIB2Ima: unsupported header size: %lu",
               static_cast<unsigned long>(header.biSize));
  } else if (header.biPlanes != 1) {
    status.Set(false, "opDIB2Ima: invalid number of planes: %d", header.biPlanes);
  } else if (!compression.empty()) {
    status.Set(false, "opDIB2Ima: unsupported compression: %s", compression.c_str());
  } else if (header.biWidth == 0 || header.biHeight == 0 || header.biWidth == kLowest ||
             header.biHeight == kLowest) {
    status.Set(false, "opDIB2Ima: invalid bitmap size: %ld x %ld",
               static_cast<long>(header.biWidth), static_cast<long>(header.biHeight));
  } else {
    return true;
  }
  return false;
}

/// True when the image's pixels and these bytes have any in common. Addresses are compared as
/// numbers: so many bytes as a header claims need not exist.
bool SharesBytes(const dImage& image, const void* bytes, std::uint64_t size) {
  const auto first = reinterpret_cast<std::uintptr_t>(bytes);
  const auto pixels = reinterpret_cast<std::uintptr_t>(image.GetDataPtr());
  return pixels != 0 &&
         (pixels < first ? first - pixels < image.GetImageSize() : pixels - first < size);
}

/// True when the image has the pixels that were asked for: the `Init` of a derived class may have
/// given it others, of several planes for example, whose columns lie closer together. Rows may have
/// any alignment.
bool HasPixels(const dImage& image, unsigned long columns, unsigned long rows, int bitsPerPixel) {
  return image.IsValid() && image.GetWidth() == columns && image.GetHeight() == rows &&
         image.GetColumnOffset() == static_cast<unsigned long>(bitsPerPixel) &&
         std::uint64_t{image.GetBytesPerRow()} * rows <= image.GetImageSize();
}

/// Brings the rows of a bitmap into an image that has been formatted for them.
class RowConverter {
 public:
  RowConverter(BitmapSource& source, dImage& image, int targetBits)
      : m_source(source),
        m_image(image),
        m_targetBits(targetBits),
        m_isSame(targetBits == source.header.biBitCount &&
                 (targetBits != 8 || IsPlainRamp(source))),
        m_isCopied(m_isSame && source.RowBytes() <= image.GetBytesPerRow()) {}

  /// False, with the reason, when there is no memory or a row cannot be read.
  bool Run(dStatus& status) {
    const std::uint64_t rowBytes = m_source.RowBytes();
    if (!m_isCopied && !m_packed.New(static_cast<unsigned long>(rowBytes), false)) {
      status.Set(false, "no memory(%llu bytes required)",
                 static_cast<unsigned long long>(rowBytes));
      return false;
    }
    if (!(m_isCopied ? CopyRows() : ConvertRows())) {
      m_source.SetCutOff(status);
      return false;
    }
    return true;
  }

 private:
  unsigned char* RowPtr(int storedRow) {
    const int height = static_cast<int>(m_source.Height());
    return static_cast<unsigned char*>(
        m_image.GetRowPtr(m_source.IsBottomUp() ? height - 1 - storedRow : storedRow));
  }

  bool CopyRows() {
    const auto step = static_cast<std::ptrdiff_t>(m_image.GetBytesPerRow());
    return m_source.ReadAllRows(RowPtr(0), m_source.IsBottomUp() ? -step : step);
  }

  bool ConvertRows() {
    for (int i = 0; i < static_cast<int>(m_source.Height()); ++i) {
      if (!ReadPacked(RowPtr(i))) {
        return false;
      }
    }
    return true;
  }

  bool ReadPacked(unsigned char* row) {
    auto* packed = static_cast<unsigned char*>(m_packed.Get(0));
    const auto width = static_cast<std::size_t>(m_source.Width());
    const std::size_t used = (width * static_cast<std::size_t>(m_targetBits) + 7) / 8;
    std::memset(row + used, 0, m_image.GetBytesPerRow() - used);
    if (!m_source.ReadRow(packed, m_packed.GetSize())) {
      return false;
    }
    if (m_isSame) {
      std::memcpy(row, packed, used);
      return true;
    }
    if (m_source.header.biBitCount == 16) {
      return vorl_detail::ExpandRGB16(width, row, packed);
    }
    return vorl_detail::ExpandPalette(row, m_source.header.biBitCount, m_targetBits, packed, width,
                                      m_source.palette.data());
  }

  BitmapSource& m_source;
  dImage& m_image;
  dBuffer m_packed;  ///< a row as it is stored
  int m_targetBits;
  bool m_isSame;    ///< the pixels are stored as the image has them
  bool m_isCopied;  ///< whole rows, padding included
};

}  // namespace

VORL_REGISTER_CLASS(opDIB2Ima, OpBase);

opDIB2Ima::opDIB2Ima() = default;

opDIB2Ima::opDIB2Ima(const char* filePath, dImage& image) {
  Convert(filePath, image);
}

opDIB2Ima::opDIB2Ima(const tagBITMAPINFO* info, const void* bits, dImage& image) {
  Convert(info, bits, image);
}

opDIB2Ima::opDIB2Ima(const opDIB2Ima& source) = default;
opDIB2Ima& opDIB2Ima::operator=(const opDIB2Ima& source) = default;

opDIB2Ima::~opDIB2Ima() {
  Terminate();
}

bool opDIB2Ima::Reset() {
  return true;
}

bool opDIB2Ima::Prepare() {
  return true;
}

bool opDIB2Ima::Process() {
  return true;
}

bool opDIB2Ima::Convert(const char* filePath, dImage& image) {
  LogContext context("opDIB2Ima::Convert", __FILE__, __LINE__, true);
  BitmapInFile file;
  if (filePath == nullptr) {
    m_status.Set(false, "no name for bitmap file specified");
  } else if (file.Open(filePath, m_status)) {
    return ConvertSource(context, file, image);
  }
  return Fail(context, __LINE__, image);
}

bool opDIB2Ima::Convert(const tagBITMAPINFO* info, const void* bits, dImage& image) {
  LogContext context("opDIB2Ima::Convert", __FILE__, __LINE__, true);
  if (info == nullptr || bits == nullptr) {
    m_status.Set(false, info == nullptr ? "no bitmap information block specified"
                                        : "no pixel bits specified");
    return Fail(context, __LINE__, image);
  }
  BitmapInMemory bitmap(info, bits);
  if (!CheckHeader(bitmap, m_status)) {
    return Fail(context, __LINE__, image);
  }
  if (!SharesBytes(image, bits, bitmap.TotalBytes())) {
    return ConvertSource(context, bitmap, image);
  }
  dImage converted;
  if (!ConvertSource(context, bitmap, converted)) {
    image.Reset();
    return false;
  }
  if (!image.Init(DTM_TakeOver, converted)) {
    m_status.Set(image.GetStatus(), "can't initialize the output image: ");
    return Fail(context, __LINE__, image);
  }
  return true;
}

bool opDIB2Ima::ConvertSource(LogContext& context, BitmapSource& source, dImage& image) {
  if (!CheckHeader(source, m_status)) {
    return Fail(context, __LINE__, image);
  }
  const int targetBits = TargetBits(source);
  if (IsTargetDepth(targetBits) && source.TotalBytes() > source.pixelBytes) {
    source.SetCutOff(m_status);
    return Fail(context, __LINE__, image);
  }
  if (!InitOutputImage(image, static_cast<int>(source.Width()), static_cast<int>(source.Height()),
                       targetBits)) {
    image.Reset();
    return false;
  }
  if (!RowConverter(source, image, targetBits).Run(m_status)) {
    return Fail(context, __LINE__, image);
  }
  m_status = true;
  return true;
}

bool opDIB2Ima::Fail(LogContext& context, int line, dImage& image) {
  image.Reset();
  context.Status(line, m_status);
  return false;
}

bool opDIB2Ima::InitOutputImage(dImage& image, int width, int height, int bitsPerPixel) {
  LogContext context("opDIB2Ima::InitOutputImage", __FILE__, __LINE__, true);
  if (!IsTargetDepth(bitsPerPixel)) {
    m_status.Set(false, "opDIB2Ima: unsupported pixel depth: %d", bitsPerPixel);
    context.Status(__LINE__, m_status);
    return false;
  }
  const unsigned short dataType = bitsPerPixel == 1 ? ImageDataType_U1 : ImageDataType_U8;
  const char* const sequence = bitsPerPixel == 32 ? "BGRA" : bitsPerPixel == 24 ? "BGR" : "G";
  const auto columns = static_cast<unsigned long>(std::llabs(width));
  const auto rows = static_cast<unsigned long>(std::llabs(height));
  if (!image.Init(columns, rows, dataType, sequence, ImageDataOrder_Pixel, 4)) {
    m_status.Set(image.GetStatus(), "can't initialize the output image: ");
    context.Status(__LINE__, m_status);
    return false;
  }
  if (!HasPixels(image, columns, rows, bitsPerPixel)) {
    m_status.Set(false, "can't initialize the output image: it has another format");
    context.Status(__LINE__, m_status);
    return false;
  }
  return true;
}

}  // namespace vorl
