#include <vorl/Platform/soft/DibLayout.h>

#include <vorl/Platform/soft/HandleTable.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <new>

inline namespace vorl {
namespace vorl_detail {
namespace {

constexpr std::uint64_t kMaximumBytes = 0x7FFFFFFF;
constexpr DWORD kLargestHeader = 124;       // of those that have been published
constexpr DWORD kHeaderSizeWithMasks = 52;  // longer headers hold the masks themselves

bool IsKnownDepth(int depth) {
  return depth == 1 || depth == 4 || depth == 8 || depth == 16 || depth == 24 || depth == 32;
}

const char* BehindHeader(const BITMAPINFO* info, DWORD headerSize) {
  return reinterpret_cast<const char*>(info) + headerSize;
}

bool ReadMasks(const BITMAPINFO* info, DibLayout* layout) {
  const DWORD size = layout->header.biSize;
  const DWORD offset = size >= kHeaderSizeWithMasks ? DWORD{sizeof(BITMAPINFOHEADER)} : size;
  std::memcpy(layout->format.masks.data(), BehindHeader(info, offset), 12);
  const auto& masks = layout->format.masks;
  return masks[0] != 0 && masks[1] != 0 && masks[2] != 0;
}

void ReadColours(const BITMAPINFO* info, DibLayout* layout) {
  const DWORD possible = DWORD{1} << layout->format.depth;
  const DWORD used = layout->header.biClrUsed;
  layout->format.colourCount = static_cast<int>(used == 0 ? possible : std::min(used, possible));
  const char* table = BehindHeader(info, layout->header.biSize);
  for (int i = 0; i < layout->format.colourCount; ++i) {
    RGBQUAD colour;
    std::memcpy(&colour, table + static_cast<std::size_t>(i) * sizeof colour, sizeof colour);
    layout->format.colours[static_cast<std::size_t>(i)] =
        RGB(colour.rgbRed, colour.rgbGreen, colour.rgbBlue);
  }
}

// Pixels begin at a cache line, so that no register of them is written into two; how far the
// allocation begins before them stands in front of them.
constexpr std::size_t kCacheLine = 64;

std::unique_ptr<std::uint8_t, FreePixels> MakePixels(std::uint64_t bytes, NewPixels pixels) {
  const std::size_t size = static_cast<std::size_t>(bytes) + kCacheLine;
  auto* const memory = static_cast<std::uint8_t*>(pixels == NewPixels::Zeros ? std::calloc(size, 1)
                                                                             : std::malloc(size));
  if (memory == nullptr) {
    throw std::bad_alloc();
  }
  const std::size_t head = kCacheLine - reinterpret_cast<std::uintptr_t>(memory) % kCacheLine;
  memory[head - 1] = static_cast<std::uint8_t>(head);
  return std::unique_ptr<std::uint8_t, FreePixels>(memory + head);
}

}  // namespace

void FreePixels::operator()(std::uint8_t* pixels) const {
  std::free(pixels - pixels[-1]);
}

Surface DibLayout::Over(std::uint8_t* pixels) const {
  Surface surface;
  surface.pitch = static_cast<std::ptrdiff_t>(rowBytes);
  surface.top = pixels;
  if (bottomUp) {
    surface.top += surface.pitch * (height - 1);
    surface.pitch = -surface.pitch;
  }
  surface.width = width;
  surface.height = height;
  surface.format = format;
  return surface;
}

std::optional<DibLayout> ReadHeader(const BITMAPINFOHEADER& header) {
  const int depth = header.biBitCount;
  const bool hasMasks = header.biCompression == BI_BITFIELDS && (depth == 16 || depth == 32);
  SetError(ERROR_INVALID_PARAMETER);  // until all is well
  if (header.biSize < sizeof header || header.biSize > kLargestHeader || header.biPlanes != 1 ||
      !IsKnownDepth(depth) || (header.biCompression != BI_RGB && !hasMasks) ||
      header.biWidth <= 0 || header.biHeight == 0 ||
      header.biHeight == std::numeric_limits<LONG>::min()) {
    return std::nullopt;
  }
  DibLayout layout;
  layout.header = header;
  layout.format = DefaultFormat(depth);
  layout.format.monochrome = false;
  layout.width = header.biWidth;
  layout.height = std::abs(header.biHeight);
  layout.bottomUp = header.biHeight > 0;
  layout.rowBytes = RowBytes(layout.width, depth, 32);
  if (layout.Bytes() > kMaximumBytes) {
    return std::nullopt;
  }
  return layout;
}

std::optional<DibLayout> ReadLayout(const BITMAPINFO* info, UINT usage) {
  if (info == nullptr || usage != DIB_RGB_COLORS) {
    SetError(ERROR_INVALID_PARAMETER);
    return std::nullopt;
  }
  const DWORD before = GetLastError();
  BITMAPINFOHEADER header;
  std::memcpy(&header, info, sizeof header);
  auto layout = ReadHeader(header);
  if (!layout || (header.biCompression == BI_BITFIELDS && !ReadMasks(info, &*layout))) {
    return std::nullopt;
  }
  if (layout->format.depth <= 8) {
    layout->format.colours.fill(0);
    ReadColours(info, &*layout);
  }
  SetError(before);
  return layout;
}

std::shared_ptr<Bitmap> MakeSection(const DibLayout& layout, NewPixels pixels) {
  auto bitmap = std::make_shared<Bitmap>();
  bitmap->pixels = MakePixels(layout.Bytes(), pixels);
  bitmap->surface = layout.Over(bitmap->pixels.get());
  bitmap->section = true;
  bitmap->bottomUp = layout.bottomUp;
  bitmap->rowBytes = static_cast<int>(layout.rowBytes);
  bitmap->header = layout.header;
  bitmap->header.biSize = sizeof(BITMAPINFOHEADER);
  bitmap->header.biHeight = layout.height;
  bitmap->header.biSizeImage = static_cast<DWORD>(layout.Bytes());
  bitmap->header.biClrUsed = static_cast<DWORD>(layout.format.colourCount);
  return bitmap;
}

std::shared_ptr<Bitmap> MakeDeviceBitmap(std::int64_t width, std::int64_t height, int depth) {
  constexpr std::int64_t kMaximumSide = 0x7FFFFFF;
  if (width > kMaximumSide || height > kMaximumSide ||
      RowBytes(static_cast<int>(width), depth, 16) * static_cast<std::uint64_t>(height) >
          kMaximumBytes) {
    SetError(ERROR_NOT_ENOUGH_MEMORY);
    return nullptr;
  }
  auto bitmap = std::make_shared<Bitmap>();
  bitmap->rowBytes = static_cast<int>(RowBytes(static_cast<int>(width), depth, 16));
  bitmap->pixels =
      MakePixels(static_cast<std::uint64_t>(bitmap->rowBytes) * static_cast<std::uint64_t>(height),
                 NewPixels::Zeros);
  bitmap->surface.top = bitmap->pixels.get();
  bitmap->surface.pitch = bitmap->rowBytes;
  bitmap->surface.width = static_cast<int>(width);
  bitmap->surface.height = static_cast<int>(height);
  bitmap->surface.format = DefaultFormat(depth);
  return bitmap;
}

}  // namespace vorl_detail
}  // namespace vorl
