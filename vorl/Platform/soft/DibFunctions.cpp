#include <vorl/Platform/soft/Blit.h>
#include <vorl/Platform/soft/DibLayout.h>
#include <vorl/Platform/soft/Rop3.h>
#include <vorl/Platform/soft/RowConverter.h>

#include <algorithm>
#include <cstring>
#include <vector>

using namespace vorl::vorl_detail;

namespace {

void WriteColours(const PixelFormat& format, LPBITMAPINFO info, DWORD headerSize) {
  char* table = reinterpret_cast<char*>(info) + headerSize;
  for (int i = 0; i < format.colourCount; ++i) {
    const COLORREF colour = format.colours[static_cast<std::size_t>(i)];
    const RGBQUAD entry{GetBValue(colour), GetGValue(colour), GetRValue(colour), 0};
    std::memcpy(table + static_cast<std::size_t>(i) * sizeof entry, &entry, sizeof entry);
  }
}

// The bitmap's own format, for a caller that asks with a bit count of 0.
int DescribeFormat(const Surface& surface, LPBITMAPINFO info) {
  BITMAPINFOHEADER& header = info->bmiHeader;
  const int depth = surface.format.depth;
  header.biWidth = surface.width;
  header.biHeight = surface.height;
  header.biPlanes = 1;
  header.biBitCount = static_cast<WORD>(depth);
  header.biCompression = surface.format.HasDefaultMasks() ? BI_RGB : BI_BITFIELDS;
  header.biSizeImage = static_cast<DWORD>(RowBytes(surface.width, depth, 32) *
                                          static_cast<std::uint64_t>(surface.height));
  header.biClrUsed = 0;
  header.biClrImportant = 0;
  return surface.height;
}

// The stock bitmap has no pixel of its own: each context that has it selected has one for it.
Surface SurfaceOf(const Bitmap& bitmap, const DeviceContext& context) {
  if (!bitmap.stock) {
    return bitmap.surface;
  }
  static std::uint8_t black[4]{};
  Surface surface = bitmap.surface;
  surface.top = context.state.bitmap->stock && !context.screen ? context.Target().top : black;
  return surface;
}

PixelFormat FormatFor(const PixelFormat& bitmap, const DibLayout& layout) {
  if (layout.format.depth <= 8 && bitmap.depth == layout.format.depth) {
    PixelFormat format = bitmap;
    format.monochrome = false;
    return format;
  }
  return layout.format;
}

// Copies rows into a picture of the layout's size, of which `bits` holds those from `start` on,
// counted from the bottom. The pictures share their upper left corner; what the bitmap lacks is 0.
int CopyRows(const Surface& bitmap, const DibLayout& layout, std::int64_t start, std::int64_t count,
             std::uint8_t* bits) {
  const PixelFormat& format = layout.format;
  const MonoColours colours{NearestPixel(format, RGB(0, 0, 0)),
                            NearestPixel(format, RGB(255, 255, 255)),
                            NearestPixel(bitmap.format, RGB(255, 255, 255))};
  RowConverter converter(bitmap.format, format, colours);
  const int columns = std::min(bitmap.width, layout.width);
  std::vector<std::uint8_t> units(static_cast<std::size_t>(columns) * 4);
  std::vector<std::uint8_t> converted(units.size());
  int copied = 0;
  for (std::int64_t i = 0; i < count; ++i) {
    const std::int64_t y = layout.height - 1 - (start + i);
    const std::int64_t place = layout.bottomUp ? i : count - 1 - i;
    std::uint8_t* row = bits + place * static_cast<std::int64_t>(layout.rowBytes);
    std::memset(row, 0, static_cast<std::size_t>(layout.rowBytes));
    if (y >= bitmap.height) {
      continue;
    }
    UnpackRow(bitmap.Row(static_cast<int>(y)), bitmap.format.depth, 0, columns, units.data());
    if (!converter.IsCopy()) {
      converter.Convert(units.data(), converted.data(), columns);
    }
    PackRow(row, format.depth, 0, columns, converter.IsCopy() ? units.data() : converted.data());
    ++copied;
  }
  return copied;
}

}  // namespace

int StretchDIBits(HDC dc, int x, int y, int width, int height, int sourceX, int sourceY,
                  int sourceWidth, int sourceHeight, const void* bits, const BITMAPINFO* info,
                  UINT usage, DWORD rop) {
  return Guarded(0, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return 0;
    }
    const auto layout = ReadLayout(info, usage);
    if (!layout || bits == nullptr) {
      SetError(ERROR_INVALID_PARAMETER);
      return 0;
    }
    // Rows of the source count from the bottom, those of a surface from the top.
    const std::int64_t top = std::int64_t{layout->height} - sourceY - sourceHeight;
    const Axis columns{x, width, sourceX, sourceWidth};
    const Axis rows{y, height, top, sourceHeight};
    if (!TouchesSource(columns, layout->width) || !TouchesSource(rows, layout->height)) {
      SetError(ERROR_INVALID_PARAMETER);
      return 0;
    }
    if (!UsesSource(rop)) {
      FillByRop(*context, columns, rows, rop);
      return layout->height;
    }
    BlitSource source;
    source.surface = layout->Over(static_cast<std::uint8_t*>(const_cast<void*>(bits)));
    Blit(*context, columns, rows, source, rop);
    return layout->height;
  });
}

int GetDIBits(HDC dc, HBITMAP handle, UINT start, UINT count, LPVOID bits, LPBITMAPINFO info,
              UINT usage) {
  return Guarded(0, [&] {
    const auto context = Find<DeviceContext>(dc);
    const auto bitmap = Find<Bitmap>(handle);
    if (!context || !bitmap || info == nullptr || usage != DIB_RGB_COLORS) {
      SetError(context && bitmap ? ERROR_INVALID_PARAMETER : ERROR_INVALID_HANDLE);
      return 0;
    }
    const Surface surface = SurfaceOf(*bitmap, *context);
    BITMAPINFOHEADER& header = info->bmiHeader;
    if (header.biSize >= sizeof header && header.biBitCount == 0) {
      return DescribeFormat(surface, info);
    }
    auto layout = ReadHeader(header);
    if (!layout || header.biCompression != BI_RGB) {
      return 0;
    }
    layout->format = FormatFor(surface.format, *layout);
    header.biClrUsed = 0;
    header.biSizeImage = static_cast<DWORD>(layout->Bytes());
    WriteColours(layout->format, info, header.biSize);
    const std::int64_t rows = std::min<std::int64_t>(
        count, std::max<std::int64_t>(0, std::int64_t{layout->height} - start));
    if (bits == nullptr || rows == 0) {
      return 1;
    }
    return CopyRows(surface, *layout, start, rows, static_cast<std::uint8_t*>(bits));
  });
}
