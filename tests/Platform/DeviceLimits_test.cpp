// Arguments that nobody should pass: null pointers, the ends of the number range, false headers.

#include "DeviceTesting.h"

#include <gtest/gtest.h>

#include <functional>
#include <limits>
#include <utility>
#include <vector>

namespace {

constexpr int kMin = std::numeric_limits<int>::min();
constexpr int kMax = std::numeric_limits<int>::max();
const int kEnds[] = {kMin, kMin + 1, -1, 0, 1, kMax - 1, kMax};

// Calls a function with every combination of four ends.
void ForAllEnds(const std::function<void(int, int, int, int)>& call) {
  for (const int a : kEnds) {
    for (const int b : kEnds) {
      for (const int c : kEnds) {
        for (const int d : kEnds) {
          call(a, b, c, d);
        }
      }
    }
  }
}

TEST(DeviceLimits, NullPointersFail) {
  const TestSection s(4, 4, 32);
  TestInfo info(4, 4, 32);
  std::uint8_t bits[64]{};
  EXPECT_EQ(CreateDIBSection(s.dc, nullptr, DIB_RGB_COLORS, nullptr, nullptr, 0), nullptr);
  EXPECT_EQ(CreateDIBitmap(s.dc, nullptr, 0, nullptr, nullptr, DIB_RGB_COLORS), nullptr);
  EXPECT_EQ(CreateDIBitmap(s.dc, &info.header, CBM_INIT, nullptr, info.Get(), 0), nullptr);
  EXPECT_EQ(CreateDIBitmap(s.dc, &info.header, CBM_INIT, bits, nullptr, 0), nullptr);
  EXPECT_EQ(StretchDIBits(s.dc, 0, 0, 4, 4, 0, 0, 4, 4, nullptr, info.Get(), 0, SRCCOPY), 0);
  EXPECT_EQ(StretchDIBits(s.dc, 0, 0, 4, 4, 0, 0, 4, 4, bits, nullptr, 0, SRCCOPY), 0);
  EXPECT_EQ(GetDIBits(s.dc, s.bitmap, 0, 4, bits, nullptr, DIB_RGB_COLORS), 0);
  EXPECT_EQ(FillRect(s.dc, nullptr, static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH))), 0);
  EXPECT_EQ(GetClipBox(s.dc, nullptr), RGN_ERROR);
  EXPECT_FALSE(Polygon(s.dc, nullptr, 3));
  EXPECT_EQ(GetObjectA(s.bitmap, 0, nullptr), int{sizeof(BITMAP)});
  EXPECT_TRUE(MoveToEx(s.dc, 1, 1, nullptr));
}

TEST(DeviceLimits, NullBitsOfASectionAreFine) {
  TestInfo info(4, 4, 32);
  HBITMAP bitmap = CreateDIBSection(nullptr, info.Get(), DIB_RGB_COLORS, nullptr, nullptr, 0);
  EXPECT_NE(bitmap, nullptr);
  EXPECT_TRUE(DeleteObject(bitmap));
}

TEST(DeviceLimits, SectionsOfOthersMemoryAreRefused) {
  TestInfo info(4, 4, 32);
  void* bits = &info;
  int handle = 0;
  EXPECT_EQ(CreateDIBSection(nullptr, info.Get(), DIB_RGB_COLORS, &bits, &handle, 0), nullptr);
  EXPECT_EQ(bits, nullptr);
  EXPECT_EQ(GetLastError(), ERROR_INVALID_PARAMETER);
}

TEST(DeviceLimits, ColourIndicesInsteadOfColoursAreRefused) {
  TestInfo info(4, 4, 8);
  std::uint8_t bits[16]{};
  const TestSection s(4, 4, 32);
  EXPECT_EQ(CreateDIBSection(s.dc, info.Get(), DIB_PAL_COLORS, nullptr, nullptr, 0), nullptr);
  EXPECT_EQ(StretchDIBits(s.dc, 0, 0, 4, 4, 0, 0, 4, 4, bits, info.Get(), DIB_PAL_COLORS, SRCCOPY),
            0);
  EXPECT_EQ(GetDIBits(s.dc, s.bitmap, 0, 4, bits, info.Get(), DIB_PAL_COLORS), 0);
}

TEST(DeviceLimits, HeadersThatAreNoBitmapAreRefused) {
  struct Case {
    const char* name;
    std::function<void(BITMAPINFOHEADER&)> change;
  };
  const Case cases[] = {
      {"no size", [](BITMAPINFOHEADER& h) { h.biSize = 0; }},
      {"old header", [](BITMAPINFOHEADER& h) { h.biSize = 12; }},
      {"header without end", [](BITMAPINFOHEADER& h) { h.biSize = 0x40000000; }},
      {"no width", [](BITMAPINFOHEADER& h) { h.biWidth = 0; }},
      {"negative width", [](BITMAPINFOHEADER& h) { h.biWidth = -4; }},
      {"lowest width", [](BITMAPINFOHEADER& h) { h.biWidth = kMin; }},
      {"no height", [](BITMAPINFOHEADER& h) { h.biHeight = 0; }},
      {"lowest height", [](BITMAPINFOHEADER& h) { h.biHeight = kMin; }},
      {"huge", [](BITMAPINFOHEADER& h) { h.biWidth = h.biHeight = kMax; }},
      {"just too large", [](BITMAPINFOHEADER& h) { h.biWidth = h.biHeight = 23171; }},
      {"planes", [](BITMAPINFOHEADER& h) { h.biPlanes = 4; }},
      {"2 bits", [](BITMAPINFOHEADER& h) { h.biBitCount = 2; }},
      {"65535 bits", [](BITMAPINFOHEADER& h) { h.biBitCount = 65535; }},
      {"compressed", [](BITMAPINFOHEADER& h) { h.biCompression = BI_RLE8; }},
      {"masks that are 0", [](BITMAPINFOHEADER& h) { h.biCompression = BI_BITFIELDS; }},
      {"unknown", [](BITMAPINFOHEADER& h) { h.biCompression = 0xFFFFFFFF; }}};
  const TestSection s(4, 4, 32);
  std::uint8_t bits[64]{};
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    TestInfo info(4, 4, 32);
    c.change(info.header);
    void* memory = bits;
    EXPECT_EQ(CreateDIBSection(s.dc, info.Get(), DIB_RGB_COLORS, &memory, nullptr, 0), nullptr);
    EXPECT_EQ(memory, nullptr);
    EXPECT_EQ(GetLastError(), ERROR_INVALID_PARAMETER);
    EXPECT_EQ(StretchDIBits(s.dc, 0, 0, 4, 4, 0, 0, 4, 4, bits, info.Get(), 0, SRCCOPY), 0);
    EXPECT_EQ(GetDIBits(s.dc, s.bitmap, 0, 4, bits, info.Get(), DIB_RGB_COLORS), 0);
  }
}

TEST(DeviceLimits, MoreColoursThanTheDepthAllowsAreLeftOut) {
  TestInfo info(4, 4, 8);
  info.header.biClrUsed = 0xFFFFFFFF;
  HBITMAP bitmap = CreateDIBSection(nullptr, info.Get(), DIB_RGB_COLORS, nullptr, nullptr, 0);
  DIBSECTION facts{};
  EXPECT_EQ(GetObjectA(bitmap, sizeof facts, &facts), int{sizeof facts});
  EXPECT_EQ(facts.dsBmih.biClrUsed, 256U);
  EXPECT_TRUE(DeleteObject(bitmap));
}

TEST(DeviceLimits, BitmapSizes) {
  const TestSection s(4, 4, 32);
  for (const auto& [width, height] :
       {std::pair{kMin, kMin}, {kMax, kMax}, {kMax, 1}, {1, kMin}, {kMin, 1}}) {
    EXPECT_EQ(CreateBitmap(width, height, 1, 32, nullptr), nullptr);
    EXPECT_EQ(CreateCompatibleBitmap(s.dc, width, height), nullptr);
  }
  EXPECT_EQ(CreateBitmap(3, 3, 1, 33, nullptr), nullptr);
  EXPECT_EQ(CreateBitmap(3, 3, 2, 1, nullptr), nullptr);
  EXPECT_EQ(CreateBitmap(3, 3, 0xFFFFFFFFU, 0xFFFFFFFFU, nullptr), nullptr);
}

TEST(DeviceLimits, BlitsFromEndToEnd) {
  TestSection a(9, 7, 32);
  const TestSection p(11, 5, 8);
  TestInfo info(9, 7, 32);
  SetStretchBltMode(p.dc, COLORONCOLOR);
  ForAllEnds([&](int x, int width, int sourceX, int sourceWidth) {
    EXPECT_TRUE(StretchBlt(p.dc, x, 0, width, 5, a.dc, sourceX, 0, sourceWidth, 7, SRCCOPY));
    EXPECT_TRUE(StretchBlt(p.dc, 0, x, 11, width, a.dc, 0, sourceX, 9, sourceWidth, SRCINVERT));
    EXPECT_TRUE(BitBlt(p.dc, x, width, 100, 100, a.dc, sourceX, sourceWidth, SRCCOPY));
    EXPECT_TRUE(BitBlt(p.dc, 0, 0, width, sourceWidth, a.dc, x, sourceX, SRCPAINT));
    EXPECT_TRUE(PatBlt(p.dc, x, sourceX, width, sourceWidth, PATINVERT));
    StretchDIBits(p.dc, x, 0, width, 5, sourceX, 0, sourceWidth, 7, a.pixels, info.Get(), 0,
                  SRCCOPY);
    StretchDIBits(p.dc, 0, x, 11, width, 0, sourceX, 9, sourceWidth, a.pixels, info.Get(), 0,
                  SRCAND);
  });
}

TEST(DeviceLimits, ShapesAndClippingFromEndToEnd) {
  const TestSection p(11, 5, 24);
  ForAllEnds([&](int left, int top, int right, int bottom) {
    const RECT rect{left, top, right, bottom};
    EXPECT_NE(FillRect(p.dc, &rect, static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH))), 0);
    EXPECT_NE(IntersectClipRect(p.dc, left, top, right, bottom), RGN_ERROR);
    EXPECT_NE(ExcludeClipRect(p.dc, left, top, right, bottom), RGN_ERROR);
    EXPECT_NE(SelectClipRgn(p.dc, nullptr), RGN_ERROR);
    HRGN region = CreateRectRgn(left, top, right, bottom);
    EXPECT_NE(region, nullptr);
    EXPECT_NE(SelectClipRgn(p.dc, region), RGN_ERROR);
    EXPECT_NE(SelectClipRgn(p.dc, nullptr), RGN_ERROR);
    EXPECT_TRUE(DeleteObject(region));
  });
  for (const int x : kEnds) {
    for (const int y : kEnds) {
      const bool inside = x >= 0 && x < 2 && y >= 0 && y < 2;
      EXPECT_EQ(SetPixel(p.dc, x, y, 5) != CLR_INVALID, inside);
      EXPECT_EQ(GetPixel(p.dc, x, y) != CLR_INVALID, inside);
      EXPECT_TRUE(MoveToEx(p.dc, x, y, nullptr));
    }
  }
}

TEST(DeviceLimits, RowsOfABitmapFromEndToEnd) {
  const TestSection s(4, 4, 32);
  for (const UINT start : {0U, 3U, 4U, 0x7FFFFFFFU, 0x80000000U, 0xFFFFFFFFU}) {
    for (const UINT count : {0U, 1U, 0x7FFFFFFFU, 0xFFFFFFFFU}) {
      TestInfo info(4, 4, 32);
      std::vector<std::uint8_t> bits(64);
      EXPECT_GE(GetDIBits(s.dc, s.bitmap, start, count, bits.data(), info.Get(), 0), 0);
    }
  }
}

TEST(DeviceLimits, LevelsThatWereNotSaved) {
  const TestSection s(4, 4, 32);
  EXPECT_EQ(SaveDC(s.dc), 1);
  for (const int level : {kMin, -2, 0, 2, kMax}) {
    EXPECT_FALSE(RestoreDC(s.dc, level));
    EXPECT_EQ(GetLastError(), ERROR_INVALID_PARAMETER);
  }
  EXPECT_TRUE(RestoreDC(s.dc, 1));
  EXPECT_FALSE(RestoreDC(s.dc, 1));
}

TEST(DeviceLimits, PenWidths) {
  for (const auto& [width, stored] : {std::pair{kMin, kMax}, {-3, 3}, {0, 0}, {kMax, kMax}}) {
    HPEN pen = CreatePen(PS_SOLID, width, 0);
    LOGPEN facts{};
    EXPECT_EQ(GetObjectA(pen, sizeof facts, &facts), int{sizeof facts});
    EXPECT_EQ(facts.lopnWidth.x, stored);
    EXPECT_TRUE(DeleteObject(pen));
  }
}

}  // namespace
