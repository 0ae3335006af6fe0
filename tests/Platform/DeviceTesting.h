#ifndef VORL_TESTS_PLATFORM_DEVICETESTING_H
#define VORL_TESTS_PLATFORM_DEVICETESTING_H

#include <vorl/Platform/Gdi.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <vector>

/// A header with room for 256 colours, grey where there are any.
struct TestInfo {
  BITMAPINFOHEADER header{};
  RGBQUAD colours[256]{};

  /// A positive height is that of a bottom-up picture.
  TestInfo(int width, int height, int bits) {
    header.biSize = sizeof header;
    header.biWidth = width;
    header.biHeight = height;
    header.biPlanes = 1;
    header.biBitCount = static_cast<WORD>(bits);
    const int count = bits <= 8 ? 1 << bits : 0;
    for (int i = 0; i < count; ++i) {
      const auto grey = static_cast<BYTE>(i * 255 / (count - 1));
      colours[i] = RGBQUAD{grey, grey, grey, 0};
    }
  }
  BITMAPINFO* Get() { return reinterpret_cast<BITMAPINFO*>(this); }
};

/// A section, selected into a memory context of its own. Its pixels start as 0.
struct TestSection {
  TestInfo info;
  HDC dc = CreateCompatibleDC(nullptr);
  std::uint8_t* pixels = nullptr;
  HBITMAP bitmap;

  TestSection(int width, int height, int bits) : info(width, height, bits) {
    void* memory = nullptr;
    bitmap = CreateDIBSection(dc, info.Get(), DIB_RGB_COLORS, &memory, nullptr, 0);
    pixels = static_cast<std::uint8_t*>(memory);
    m_old = SelectObject(dc, bitmap);
  }
  TestSection(const TestSection&) = delete;
  TestSection& operator=(const TestSection&) = delete;
  ~TestSection() {
    SelectObject(dc, m_old);
    DeleteDC(dc);
    DeleteObject(bitmap);
  }

  std::size_t RowBytes() const {
    const auto bits = static_cast<std::size_t>(info.header.biWidth) * info.header.biBitCount;
    return (bits + 31) / 32 * 4;
  }
  std::size_t Bytes() const {
    return RowBytes() * static_cast<std::size_t>(std::abs(info.header.biHeight));
  }
  /// Of 32 bits, the first row in memory being row 0.
  std::uint32_t At(int x, int y) const {
    std::uint32_t pixel = 0;
    std::memcpy(&pixel, pixels + static_cast<std::size_t>(y) * RowBytes() + 4U * unsigned(x), 4);
    return pixel;
  }
  void Set(int x, int y, std::uint32_t pixel) {
    std::memcpy(pixels + static_cast<std::size_t>(y) * RowBytes() + 4U * unsigned(x), &pixel, 4);
  }

 private:
  HGDIOBJ m_old;
};

#endif
