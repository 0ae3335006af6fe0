#include "DeviceTesting.h"

#include <vorl/Platform/soft/HandleTable.h>

#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

namespace {

using vorl::vorl_detail::HandleTable;

// Every function, with a handle that is none. The other arguments are in order.
void ExpectAllFail(void* handle) {
  const auto dc = static_cast<HDC>(handle);
  const TestSection good(4, 4, 32);
  TestInfo info(4, 4, 32);
  std::vector<std::uint8_t> bits(64);
  POINT points[3] = {{0, 0}, {3, 0}, {0, 3}};
  RECT rect{0, 0, 3, 3};
  EXPECT_EQ(CreateCompatibleBitmap(dc, 3, 3), nullptr);
  EXPECT_FALSE(DeleteDC(dc));
  EXPECT_EQ(ReleaseDC(nullptr, dc), 0);
  EXPECT_EQ(SaveDC(dc), 0);
  EXPECT_FALSE(RestoreDC(dc, -1));
  EXPECT_EQ(SelectObject(dc, GetStockObject(BLACK_PEN)), nullptr);
  EXPECT_EQ(SelectObject(good.dc, handle), nullptr);
  EXPECT_FALSE(DeleteObject(handle));
  EXPECT_EQ(GetCurrentObject(dc, OBJ_PEN), nullptr);
  EXPECT_EQ(GetObjectA(handle, 64, bits.data()), 0);
  EXPECT_EQ(GetDIBits(dc, good.bitmap, 0, 4, bits.data(), info.Get(), DIB_RGB_COLORS), 0);
  EXPECT_EQ(GetDIBits(good.dc, static_cast<HBITMAP>(handle), 0, 4, bits.data(), info.Get(), 0), 0);
  EXPECT_FALSE(BitBlt(dc, 0, 0, 3, 3, good.dc, 0, 0, SRCCOPY));
  EXPECT_FALSE(BitBlt(good.dc, 0, 0, 3, 3, dc, 0, 0, SRCCOPY));
  EXPECT_FALSE(PatBlt(dc, 0, 0, 3, 3, PATCOPY));
  EXPECT_FALSE(StretchBlt(dc, 0, 0, 3, 3, good.dc, 0, 0, 2, 2, SRCCOPY));
  EXPECT_FALSE(StretchBlt(good.dc, 0, 0, 3, 3, dc, 0, 0, 2, 2, SRCCOPY));
  EXPECT_EQ(StretchDIBits(dc, 0, 0, 3, 3, 0, 0, 4, 4, bits.data(), info.Get(), 0, SRCCOPY), 0);
  EXPECT_EQ(SetStretchBltMode(dc, COLORONCOLOR), 0);
  EXPECT_EQ(FillRect(dc, &rect, static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH))), 0);
  EXPECT_EQ(FillRect(good.dc, &rect, static_cast<HBRUSH>(handle)), 0);
  EXPECT_FALSE(Rectangle(dc, 0, 0, 3, 3));
  EXPECT_FALSE(MoveToEx(dc, 1, 1, nullptr));
  EXPECT_FALSE(LineTo(dc, 1, 1));
  EXPECT_FALSE(Polygon(dc, points, 3));
  EXPECT_EQ(SetPolyFillMode(dc, WINDING), 0);
  EXPECT_EQ(SetROP2(dc, R2_XORPEN), 0);
  EXPECT_EQ(SetPixel(dc, 0, 0, 0), CLR_INVALID);
  EXPECT_EQ(GetPixel(dc, 0, 0), CLR_INVALID);
  EXPECT_EQ(DrawTextA(dc, "A", 1, &rect, 0), 0);
  EXPECT_EQ(SetTextColor(dc, 0), CLR_INVALID);
  EXPECT_EQ(SetBkColor(dc, 0), CLR_INVALID);
  EXPECT_EQ(SetBkMode(dc, OPAQUE), 0);
  EXPECT_EQ(IntersectClipRect(dc, 0, 0, 3, 3), RGN_ERROR);
  EXPECT_EQ(ExcludeClipRect(dc, 0, 0, 3, 3), RGN_ERROR);
  EXPECT_EQ(SelectClipRgn(dc, nullptr), RGN_ERROR);
  EXPECT_EQ(GetClipBox(dc, &rect), RGN_ERROR);
  EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
}

TEST(DeviceHandles, NullFails) {
  ExpectAllFail(nullptr);
}

TEST(DeviceHandles, NumbersAndAddressesFail) {
  int variable = 0;
  ExpectAllFail(&variable);
  for (const std::uintptr_t number : {std::uintptr_t{1}, std::uintptr_t{4}, std::uintptr_t{0x1234},
                                      std::uintptr_t{0x100000}, ~std::uintptr_t{0}}) {
    SCOPED_TRACE(number);
    ExpectAllFail(reinterpret_cast<void*>(number));
  }
}

TEST(DeviceHandles, StaleHandlesFailAfterTheirPlaceIsTakenAgain) {
  HBRUSH brush = CreateSolidBrush(1);
  HDC dc = CreateCompatibleDC(nullptr);
  ASSERT_TRUE(DeleteObject(brush));
  ASSERT_TRUE(DeleteDC(dc));
  std::vector<HBRUSH> others;
  for (int i = 0; i < 2000; ++i) {
    others.push_back(CreateSolidBrush(2));
    EXPECT_NE(others.back(), brush);
    EXPECT_NE(static_cast<HGDIOBJ>(others.back()), static_cast<HGDIOBJ>(dc));
  }
  ExpectAllFail(brush);
  ExpectAllFail(dc);
  for (HBRUSH other : others) {
    EXPECT_TRUE(DeleteObject(other));
  }
}

TEST(DeviceHandles, DeletingTwiceIsHarmless) {
  HDC dc = CreateCompatibleDC(nullptr);
  EXPECT_TRUE(DeleteDC(dc));
  EXPECT_FALSE(DeleteDC(dc));
  HPEN pen = CreatePen(PS_SOLID, 1, 0);
  EXPECT_TRUE(DeleteObject(pen));
  EXPECT_FALSE(DeleteObject(pen));
  EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
}

TEST(DeviceHandles, OneKindDoesNotPassForAnother) {
  const TestSection section(4, 4, 32);
  HBRUSH brush = CreateSolidBrush(0);
  const RECT rect{0, 0, 2, 2};
  EXPECT_FALSE(DeleteDC(reinterpret_cast<HDC>(brush)));
  EXPECT_EQ(SaveDC(reinterpret_cast<HDC>(section.bitmap)), 0);
  EXPECT_EQ(FillRect(section.dc, &rect, reinterpret_cast<HBRUSH>(section.bitmap)), 0);
  EXPECT_EQ(SelectClipRgn(section.dc, reinterpret_cast<HRGN>(brush)), RGN_ERROR);
  EXPECT_EQ(SelectObject(section.dc, section.dc), nullptr);
  EXPECT_EQ(GetCurrentObject(section.dc, OBJ_REGION), nullptr);
  EXPECT_TRUE(DeleteObject(brush));
}

TEST(DeviceHandles, SelectedObjectsCannotBeDeleted) {
  HDC dc = CreateCompatibleDC(nullptr);
  HPEN pen = CreatePen(PS_SOLID, 1, 0);
  HBITMAP bitmap = CreateBitmap(3, 3, 1, 1, nullptr);
  HGDIOBJ oldPen = SelectObject(dc, pen);
  HGDIOBJ oldBitmap = SelectObject(dc, bitmap);
  EXPECT_FALSE(DeleteObject(pen));
  EXPECT_EQ(GetLastError(), ERROR_BUSY);
  EXPECT_FALSE(DeleteObject(bitmap));
  EXPECT_EQ(SelectObject(dc, oldPen), pen);
  EXPECT_EQ(SelectObject(dc, oldBitmap), bitmap);
  EXPECT_TRUE(DeleteObject(pen));
  EXPECT_TRUE(DeleteObject(bitmap));
  EXPECT_TRUE(DeleteDC(dc));
}

TEST(DeviceHandles, ObjectsOfASavedStateCannotBeDeletedUntilItIsGone) {
  HDC dc = CreateCompatibleDC(nullptr);
  HPEN pen = CreatePen(PS_SOLID, 1, 0);
  SelectObject(dc, pen);
  SaveDC(dc);
  SelectObject(dc, GetStockObject(BLACK_PEN));
  EXPECT_FALSE(DeleteObject(pen));
  EXPECT_TRUE(RestoreDC(dc, -1));
  EXPECT_EQ(GetCurrentObject(dc, OBJ_PEN), pen);
  EXPECT_TRUE(DeleteDC(dc));
  EXPECT_TRUE(DeleteObject(pen));
}

TEST(DeviceHandles, DeletingTheContextReleasesWhatItHadSelected) {
  HDC first = CreateCompatibleDC(nullptr);
  HDC second = CreateCompatibleDC(nullptr);
  HBITMAP bitmap = CreateBitmap(3, 3, 1, 1, nullptr);
  HPEN pen = CreatePen(PS_SOLID, 1, 0);
  EXPECT_NE(SelectObject(first, bitmap), nullptr);
  EXPECT_NE(SelectObject(first, pen), nullptr);
  EXPECT_NE(SelectObject(second, pen), nullptr);
  EXPECT_EQ(SelectObject(second, bitmap), nullptr);
  EXPECT_EQ(GetLastError(), ERROR_BUSY);
  EXPECT_TRUE(DeleteDC(first));
  EXPECT_NE(SelectObject(second, bitmap), nullptr);
  EXPECT_TRUE(DeleteDC(second));
  EXPECT_TRUE(DeleteObject(bitmap));
  EXPECT_TRUE(DeleteObject(pen));
}

TEST(DeviceHandles, SelectingTheSameObjectAgainCountsOnce) {
  HDC dc = CreateCompatibleDC(nullptr);
  HBITMAP bitmap = CreateBitmap(3, 3, 1, 1, nullptr);
  HGDIOBJ old = SelectObject(dc, bitmap);
  EXPECT_EQ(SelectObject(dc, bitmap), bitmap);
  EXPECT_EQ(SelectObject(dc, old), bitmap);
  EXPECT_TRUE(DeleteObject(bitmap));
  DeleteDC(dc);
}

TEST(DeviceHandles, StockObjectsStay) {
  HGDIOBJ pen = GetStockObject(BLACK_PEN);
  EXPECT_TRUE(DeleteObject(pen));
  EXPECT_EQ(GetStockObject(BLACK_PEN), pen);
  HDC dc = CreateCompatibleDC(nullptr);
  EXPECT_EQ(SelectObject(dc, pen), pen);
  EXPECT_TRUE(DeleteObject(GetCurrentObject(dc, OBJ_BITMAP)));
  EXPECT_TRUE(DeleteDC(dc));
  for (const int index : {-1, 9, 18, 2147483647}) {
    EXPECT_EQ(GetStockObject(index), nullptr);
  }
}

TEST(DeviceHandles, TheScreenIsReleasedNotDeleted) {
  HDC screen = GetDC(nullptr);
  ASSERT_NE(screen, nullptr);
  EXPECT_FALSE(DeleteDC(screen));
  EXPECT_FALSE(DeleteObject(screen));
  EXPECT_EQ(ReleaseDC(nullptr, screen), 1);
  EXPECT_EQ(ReleaseDC(nullptr, screen), 0);
  EXPECT_EQ(GetDC(reinterpret_cast<HWND>(std::uintptr_t{16})), nullptr);
}

TEST(DeviceHandles, NothingIsLeftBehind) {
  const std::size_t before = HandleTable::Instance().LiveCount();
  {
    const TestSection section(30, 20, 8);
    HDC screen = GetDC(nullptr);
    HBITMAP bitmap = CreateCompatibleBitmap(screen, 4, 4);
    HRGN region = CreateRectRgn(0, 0, 4, 4);
    SaveDC(section.dc);
    SelectObject(section.dc, GetStockObject(WHITE_PEN));
    EXPECT_EQ(HandleTable::Instance().LiveCount(), before + 5);
    EXPECT_TRUE(DeleteObject(region));
    EXPECT_TRUE(DeleteObject(bitmap));
    ReleaseDC(nullptr, screen);
  }
  EXPECT_EQ(HandleTable::Instance().LiveCount(), before);
}

TEST(DeviceHandles, FailedCreationsEnterNothing) {
  const std::size_t before = HandleTable::Instance().LiveCount();
  TestInfo info(0, 4, 32);
  void* bits = &info;
  EXPECT_EQ(CreateDIBSection(nullptr, info.Get(), DIB_RGB_COLORS, &bits, nullptr, 0), nullptr);
  EXPECT_EQ(bits, nullptr);
  EXPECT_EQ(CreateBitmap(2000000000, 2000000000, 1, 32, nullptr), nullptr);
  EXPECT_EQ(HandleTable::Instance().LiveCount(), before);
}

// Contexts of their own, objects that they share.
TEST(DeviceHandles, ThreadsDrawAtTheSameTime) {
  const std::size_t before = HandleTable::Instance().LiveCount();
  HBRUSH shared = CreateSolidBrush(RGB(10, 20, 30));
  std::atomic<int> wrong{0};
  std::vector<std::thread> threads;
  for (int t = 0; t < 4; ++t) {
    threads.emplace_back([&] {
      for (int i = 0; i < 200; ++i) {
        const TestSection section(8, -8, 32);
        HGDIOBJ old = SelectObject(section.dc, shared);
        PatBlt(section.dc, 1, 1, 4, 4, PATCOPY);
        wrong += section.At(2, 2) == 0x0A141EU ? 0 : 1;
        SelectObject(section.dc, old);
      }
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  EXPECT_EQ(wrong, 0);
  EXPECT_TRUE(DeleteObject(shared));
  EXPECT_EQ(HandleTable::Instance().LiveCount(), before);
}

// So that a register of pixels is written into one line of the cache.
TEST(DeviceHandles, PixelsOfASectionBeginAtACacheLine) {
  for (const int width : {1, 3, 64, 1000, 3840}) {
    const TestSection small(width, 1, 8);
    const TestSection large(width, width, 32);
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(small.pixels) % 64, 0U) << width;
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(large.pixels) % 64, 0U) << width;
    for (std::size_t i = 0; i < large.Bytes(); ++i) {
      ASSERT_EQ(large.pixels[i], 0);
    }
  }
}

}  // namespace
