#include <vorl/Platform/detail/Section.h>
#include <vorl/Platform/soft/Blit.h>
#include <vorl/Platform/soft/DibLayout.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <limits>

using namespace vorl::vorl_detail;

namespace {

std::shared_ptr<Bitmap> MakeCompatible(const DeviceContext& context, std::int64_t width,
                                       std::int64_t height) {
  const PixelFormat& format = context.Target().format;
  if (context.screen || !context.state.bitmap->section) {
    return MakeDeviceBitmap(width, height, format.depth);
  }
  const Bitmap& model = *context.state.bitmap;
  BITMAPINFOHEADER header = model.header;
  constexpr std::int64_t kMaximum = std::numeric_limits<LONG>::max();
  header.biWidth = static_cast<LONG>(std::min(width, kMaximum));
  header.biHeight = static_cast<LONG>(std::min(height, kMaximum));
  auto layout = ReadHeader(header);
  if (!layout) {
    return nullptr;
  }
  layout->format = format;
  return MakeSection(*layout);
}

std::int64_t Magnitude(int size) {
  return std::abs(std::int64_t{size});
}

// Sizes of nothing give the stock bitmap.
HBITMAP EnterOrStock(std::int64_t width, std::int64_t height,
                     const std::shared_ptr<Bitmap>& bitmap) {
  if (width == 0 || height == 0) {
    return static_cast<HBITMAP>(StockBitmap()->handle);
  }
  return bitmap ? Enter<HBITMAP>(bitmap) : nullptr;
}

// Copies a picture in memory onto a bitmap that nobody uses yet.
void Draw(const std::shared_ptr<Bitmap>& bitmap, const DibLayout& layout, const void* bits) {
  DeviceContext context(false);
  HandleTable::Instance().SelectAgain(*bitmap);
  context.state.bitmap = Selected<Bitmap>(bitmap);
  context.Update();
  BlitSource source;
  source.surface = layout.Over(static_cast<std::uint8_t*>(const_cast<void*>(bits)));
  Blit(context, Axis{0, layout.width, 0, layout.width}, Axis{0, layout.height, 0, layout.height},
       source, SRCCOPY);
}

int SupportedDepth(UINT bitCount) {
  for (const UINT depth : {1U, 4U, 8U, 16U, 24U, 32U}) {
    if (bitCount <= depth) {
      return static_cast<int>(depth);
    }
  }
  return 0;
}

HBITMAP CreateSection(HDC dc, const BITMAPINFO* info, UINT usage, void** bits, HANDLE section,
                      NewPixels pixels) {
  if (bits != nullptr) {
    *bits = nullptr;
  }
  return Guarded(HBITMAP{}, [&]() -> HBITMAP {
    if (dc != nullptr && !Find<DeviceContext>(dc)) {
      return nullptr;
    }
    const auto layout = ReadLayout(info, usage);
    if (!layout || section != nullptr) {
      SetError(ERROR_INVALID_PARAMETER);
      return nullptr;
    }
    const auto bitmap = MakeSection(*layout, pixels);
    const auto handle = Enter<HBITMAP>(bitmap);
    if (bits != nullptr && handle != nullptr) {
      *bits = bitmap->pixels.get();
    }
    return handle;
  });
}

}  // namespace

HBITMAP CreateDIBSection(HDC dc, const BITMAPINFO* info, UINT usage, void** bits, HANDLE section,
                         DWORD /*offset*/) {
  return CreateSection(dc, info, usage, bits, section, NewPixels::Zeros);
}

HBITMAP vorl::vorl_detail::CreateSectionToFill(HDC dc, const BITMAPINFO* info, void** bits) {
  return CreateSection(dc, info, DIB_RGB_COLORS, bits, nullptr, NewPixels::Unset);
}

HBITMAP CreateCompatibleBitmap(HDC dc, int width, int height) {
  return Guarded(HBITMAP{}, [&]() -> HBITMAP {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return nullptr;
    }
    const bool empty = width == 0 || height == 0;
    return EnterOrStock(
        width, height,
        empty ? nullptr : MakeCompatible(*context, Magnitude(width), Magnitude(height)));
  });
}

HBITMAP CreateBitmap(int width, int height, UINT planes, UINT bitCount, const void* bits) {
  return Guarded(HBITMAP{}, [&]() -> HBITMAP {
    const int depth = SupportedDepth(bitCount);
    if (planes != 1 || depth == 0) {
      SetError(ERROR_INVALID_PARAMETER);
      return nullptr;
    }
    if (width == 0 || height == 0) {
      return EnterOrStock(0, 0, nullptr);
    }
    const auto bitmap = MakeDeviceBitmap(Magnitude(width), Magnitude(height), depth);
    if (bitmap && bits != nullptr) {
      std::memcpy(bitmap->pixels.get(), bits,
                  static_cast<std::size_t>(bitmap->rowBytes) *
                      static_cast<std::size_t>(bitmap->surface.height));
    }
    return EnterOrStock(width, height, bitmap);
  });
}

HBITMAP CreateDIBitmap(HDC dc, const BITMAPINFOHEADER* header, DWORD flags, const void* bits,
                       const BITMAPINFO* info, UINT usage) {
  return Guarded(HBITMAP{}, [&]() -> HBITMAP {
    const auto context = dc == nullptr ? nullptr : Find<DeviceContext>(dc);
    if (dc != nullptr && !context) {
      return nullptr;
    }
    if (header == nullptr || header->biSize < sizeof *header) {
      SetError(ERROR_INVALID_PARAMETER);
      return nullptr;
    }
    const std::int64_t width = Magnitude(header->biWidth);
    const std::int64_t height = Magnitude(header->biHeight);
    if (width == 0 || height == 0) {
      return EnterOrStock(0, 0, nullptr);
    }
    const auto layout = (flags & CBM_INIT) != 0 ? ReadLayout(info, usage) : std::nullopt;
    if ((flags & CBM_INIT) != 0 && (!layout || bits == nullptr)) {
      SetError(ERROR_INVALID_PARAMETER);
      return nullptr;
    }
    const auto bitmap =
        context ? MakeCompatible(*context, width, height) : MakeDeviceBitmap(width, height, 1);
    if (bitmap && layout) {
      Draw(bitmap, *layout, bits);
    }
    return EnterOrStock(width, height, bitmap);
  });
}
