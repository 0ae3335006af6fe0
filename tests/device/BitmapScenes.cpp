#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

void DeviceCopy(int bits) {
  Memory a(15, 11, {8, true});
  a.Ramp();
  Section p(22, 17, {bits, true});
  HBITMAP copy = CreateDIBitmap(p.dc, &a.header.h, CBM_INIT, a.pixels, a.Info(), DIB_RGB_COLORS);
  HDC dc = CreateCompatibleDC(p.dc);
  HGDIOBJ old = SelectObject(dc, copy);
  Report("r", BitBlt(p.dc, 3, 2, 15, 11, dc, 0, 0, SRCCOPY) != 0);
  SelectObject(dc, old);
  DeleteDC(dc);
  DeleteObject(copy);
  Show(p);
}

// A picture without the pixels of one colour, by way of a mask.
void Transparent(Random& random) {
  Memory a(14, 12, {24, true});
  for (int y = 0; y < 12; ++y) {
    for (int x = 0; x < 14; ++x) {
      a.Set(x, y, random.Flip() ? 0x0000FF : random.Next() & 0xFFFFFFU);
    }
  }
  Section p(34, 30, {32, true});
  p.Noise(random);
  HDC image = CreateCompatibleDC(p.dc);
  HBITMAP bitmap = CreateDIBitmap(p.dc, &a.header.h, CBM_INIT, a.pixels, a.Info(), DIB_RGB_COLORS);
  HGDIOBJ old = SelectObject(image, bitmap);
  const Mono mask(14, 12);
  SetBkColor(image, Colour(255, 0, 0));
  BitBlt(mask.dc, 0, 0, 14, 12, image, 0, 0, SRCCOPY);
  BitBlt(image, 0, 0, 14, 12, mask.dc, 0, 0, SRCINVERT);
  SetStretchBltMode(p.dc, COLORONCOLOR);
  SetBkColor(p.dc, 0xFFFFFF);
  SetTextColor(p.dc, 0);
  StretchBlt(p.dc, 2, 3, 29, 25, mask.dc, 0, 0, 14, 12, SRCAND);
  StretchBlt(p.dc, 2, 3, 29, 25, image, 0, 0, 14, 12, SRCPAINT);
  SelectObject(image, old);
  DeleteDC(image);
  DeleteObject(bitmap);
  Show(p);
}

void ReportFacts(HBITMAP bitmap) {
  BITMAP facts{};
  Report("size", GetObjectA(bitmap, sizeof facts, &facts) != 0);
  Report("w", facts.bmWidth);
  Report("h", facts.bmHeight);
  Report("row", facts.bmWidthBytes);
  Report("planes", facts.bmPlanes);
  Report("bits", facts.bmBitsPixel);
  Report("memory", facts.bmBits != nullptr);
}

void SectionFacts(Format format) {
  Section p(11, 6, format);
  ReportFacts(p.bitmap);
  DIBSECTION facts{};
  Report("section", GetObjectA(p.bitmap, sizeof facts, &facts) == int{sizeof facts});
  Report("height", facts.dsBmih.biHeight);
  Report("image", facts.dsBmih.biSizeImage);
  Report("colours", facts.dsBmih.biClrUsed);
  Report("short", GetObjectA(p.bitmap, 10, &facts));
}

void DeviceFacts(int bits) {
  HBITMAP bitmap = CreateBitmap(13, -5, 1, static_cast<UINT>(bits), nullptr);
  ReportFacts(bitmap);
  DeleteObject(bitmap);
}

void CompatibleFacts(int bits) {
  Section p(11, 6, {bits, true});
  HBITMAP bitmap = CreateCompatibleBitmap(p.dc, 9, 4);
  ReportFacts(bitmap);
  DeleteObject(bitmap);
  bitmap = CreateDIBitmap(p.dc, &p.header.h, 0, nullptr, nullptr, DIB_RGB_COLORS);
  ReportFacts(bitmap);
  DeleteObject(bitmap);
}

void Defaults() {
  HDC memory = CreateCompatibleDC(nullptr);
  HDC screen = GetDC(nullptr);
  ReportFacts(static_cast<HBITMAP>(GetCurrentObject(memory, OBJ_BITMAP)));
  for (HDC dc : {memory, screen}) {
    HBITMAP bitmap = CreateCompatibleBitmap(dc, 7, 3);
    BITMAP facts{};
    GetObjectA(bitmap, sizeof facts, &facts);
    Report("bits", facts.bmBitsPixel);
    DeleteObject(bitmap);
    bitmap = CreateCompatibleBitmap(dc, 0, 3);
    ReportFacts(bitmap);
  }
  Report("null", CreateCompatibleBitmap(nullptr, 3, 3) != nullptr);
  DeleteDC(memory);
  ReleaseDC(nullptr, screen);
}

// Headers that are no bitmaps, and some that are in spite of their looks.
void Headers() {
  HDC dc = CreateCompatibleDC(nullptr);
  const auto attempt = [dc](const char* name, const auto& change) {
    Header header{};
    header.h.biSize = 40;
    header.h.biWidth = 3;
    header.h.biHeight = 3;
    header.h.biPlanes = 1;
    header.h.biBitCount = 24;
    change(header.h);
    void* memory = &header;
    HBITMAP bitmap =
        CreateDIBSection(dc, reinterpret_cast<BITMAPINFO*>(&header), 0, &memory, nullptr, 0);
    Report(name, bitmap != nullptr && memory != nullptr   ? 1
                 : bitmap == nullptr && memory == nullptr ? 0
                                                          : -1);
    DeleteObject(bitmap);
  };
  attempt("good", [](BITMAPINFOHEADER&) {});
  attempt("width0", [](BITMAPINFOHEADER& h) { h.biWidth = 0; });
  attempt("width-1", [](BITMAPINFOHEADER& h) { h.biWidth = -1; });
  attempt("height0", [](BITMAPINFOHEADER& h) { h.biHeight = 0; });
  attempt("height-min", [](BITMAPINFOHEADER& h) { h.biHeight = -2147483647 - 1; });
  for (const int bits : {0, 3, 5, 64}) {
    attempt("bits", [=](BITMAPINFOHEADER& h) { h.biBitCount = static_cast<WORD>(bits); });
  }
  attempt("planes0", [](BITMAPINFOHEADER& h) { h.biPlanes = 0; });
  attempt("planes3", [](BITMAPINFOHEADER& h) { h.biPlanes = 3; });
  attempt("compressed", [](BITMAPINFOHEADER& h) { h.biCompression = 1; });
  attempt("fields24", [](BITMAPINFOHEADER& h) { h.biCompression = 3; });
  attempt("huge", [](BITMAPINFOHEADER& h) { h.biWidth = h.biHeight = 0x7FFFFFFF; });
  attempt("wide", [](BITMAPINFOHEADER& h) { h.biWidth = 0x7FFFFFFF; });
  attempt("size0", [](BITMAPINFOHEADER& h) { h.biSize = 0; });
  attempt("size44", [](BITMAPINFOHEADER& h) { h.biSize = 44; });
  attempt("image1", [](BITMAPINFOHEADER& h) { h.biSizeImage = 1; });
  attempt("colours", [](BITMAPINFOHEADER& h) {
    h.biBitCount = 8;
    h.biClrUsed = 300;
  });
  DeleteDC(dc);
}

}  // namespace

void BitmapScenes() {
  for (const int bits : {8, 24, 32}) {
    Scene("bitmap/device-copy-on-" + std::to_string(bits), [=](Random&) { DeviceCopy(bits); });
  }
  Scene("bitmap/transparent", Transparent);
  Scene("bitmap/facts", [](Random&) {
    Section p(11, 6, {24, false});
    BITMAP facts{};
    GetObjectA(p.bitmap, static_cast<int>(sizeof facts), &facts);
    Report("w", facts.bmWidth);
    Report("h", facts.bmHeight);
    Report("row", facts.bmWidthBytes);
    Report("bits", facts.bmBitsPixel);
  });
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    Scene("bitmap/section-facts-" + std::to_string(bits), [=](Random&) {
      SectionFacts({bits, bits != 8});
    });
    Scene("bitmap/compatible-facts-" + std::to_string(bits),
          [=](Random&) { CompatibleFacts(bits); });
  }
  for (const int bits : {1, 2, 3, 4, 5, 8, 15, 16, 24, 32}) {
    Scene("bitmap/device-facts-" + std::to_string(bits), [=](Random&) { DeviceFacts(bits); });
  }
  Scene("bitmap/defaults", [](Random&) { Defaults(); });
  Scene("bitmap/headers", [](Random&) { Headers(); });
}
