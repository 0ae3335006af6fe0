// Fonts as objects, regions as clips, brushes that paint nothing, the bitmap of new contexts, and
// headers that hold more than the usual one.

#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <cstring>
#include <string>

namespace {

void ReportFont(const LOGFONTA& font) {
  Report("height", font.lfHeight);
  Report("width", font.lfWidth);
  Report("escapement", font.lfEscapement);
  Report("orientation", font.lfOrientation);
  Report("weight", font.lfWeight);
  Report("italic", font.lfItalic);
  Report("underline", font.lfUnderline);
  Report("strike-out", font.lfStrikeOut);
  Report("charset", font.lfCharSet);
  Report("precisions", font.lfOutPrecision * 100 + font.lfClipPrecision);
  Report("quality", font.lfQuality);
  Report("family", font.lfPitchAndFamily);
  ReportWord(font.lfFaceName[0] != '\0' ? font.lfFaceName : "no-name");
}

// What a font was made with is what it tells.
void Fonts() {
  HFONT font = CreateFontA(-17, 9, 450, 900, 650, 1, 1, 1, 0, 4, 2, 3, 0x31, "Some-Name");
  LOGFONTA description{};
  Report("r", GetObjectA(font, sizeof description, &description));
  ReportFont(description);
  DeleteObject(font);
  font = CreateFontA(0, 0, 0, 0, 0, 2, 4, 256, 1, 0, 0, 0, 0, nullptr);
  Report("r", GetObjectA(font, sizeof description, &description));
  ReportFont(description);
  std::memset(&description, 0x55, sizeof description);
  Report("short", GetObjectA(font, 8, &description));
  Report("height", description.lfHeight);
  ReportHex("behind", static_cast<std::uint32_t>(description.lfEscapement));
  Report("none", GetObjectA(font, 0, &description));
  DeleteObject(font);
}

void StockFont(int index) {
  LOGFONTA font{};
  Report("r", GetObjectA(GetStockObject(index), sizeof font, &font));
  Report("weight", font.lfWeight);
  Report("italic", font.lfItalic);
  Report("pitch", font.lfPitchAndFamily & 3);
  Report("family", font.lfPitchAndFamily & 0xF0);
  Report("d", DeleteObject(GetStockObject(index)) != 0);
  Report("again", GetObjectA(GetStockObject(index), sizeof font, &font));
}

// What a new context has selected, and what it has after a change.
void Current() {
  HDC dc = CreateCompatibleDC(nullptr);
  Report("pen", GetCurrentObject(dc, OBJ_PEN) == GetStockObject(BLACK_PEN));
  Report("brush", GetCurrentObject(dc, OBJ_BRUSH) == GetStockObject(WHITE_BRUSH));
  Report("font", GetCurrentObject(dc, OBJ_FONT) == GetStockObject(SYSTEM_FONT));
  HFONT font = CreateFontA(-17, 0, 0, 0, 400, 0, 0, 0, 1, 0, 0, 0, 0, "");
  HGDIOBJ old = SelectObject(dc, font);
  Report("old", old == GetStockObject(SYSTEM_FONT));
  Report("font", GetCurrentObject(dc, OBJ_FONT) == HGDIOBJ(font));
  SaveDC(dc);
  SelectObject(dc, GetStockObject(ANSI_FIXED_FONT));
  Report("font", GetCurrentObject(dc, OBJ_FONT) == GetStockObject(ANSI_FIXED_FONT));
  RestoreDC(dc, -1);
  Report("font", GetCurrentObject(dc, OBJ_FONT) == HGDIOBJ(font));
  SelectObject(dc, old);
  Report("d", DeleteObject(font) != 0);
  Report("none", GetCurrentObject(dc, 99) == nullptr);
  DeleteDC(dc);
}

// A region that is selected is copied, and its kind returned.
void Region() {
  Section p(20, 16, {24, true});
  HRGN region = CreateRectRgn(3, 4, 12, 9);
  Report("r", reinterpret_cast<std::intptr_t>(SelectObject(p.dc, region)));
  Report("d", DeleteObject(region) != 0);
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 0, 0, 20, 16, p.Ink());
  HRGN empty = CreateRectRgn(5, 5, 5, 9);
  Report("r", reinterpret_cast<std::intptr_t>(SelectObject(p.dc, empty)));
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 0, 0, 20, 16, Grey(90));
  DeleteObject(empty);
  Show(p);
}

// A brush of nothing.
void NullBrush(Format format) {
  Section p(12, 10, format);
  p.Ramp();
  const RECT rect{2, 1, 9, 8};
  const auto brush = static_cast<HBRUSH>(GetStockObject(NULL_BRUSH));
  Report("r", FillRect(p.dc, &rect, brush) != 0);
  Show(p);
  const SelectedStock selected(p.dc, NULL_BRUSH);
  Report("p", PatBlt(p.dc, 3, 3, 4, 4, PATCOPY) != 0);
  Report("p", PatBlt(p.dc, 5, 5, 4, 4, PATINVERT) != 0);
  Report("p", PatBlt(p.dc, 0, 0, 2, 2, DSTINVERT) != 0);
  Rectangle(p.dc, 1, 1, 8, 8);
  Show(p);
}

// The bitmap that every new context has. It shows what was drawn last.
void StockBitmap() {
  HDC dc = CreateCompatibleDC(nullptr);
  const auto bitmap = static_cast<HBITMAP>(GetCurrentObject(dc, OBJ_BITMAP));
  Header header{};
  header.h.biSize = 40;
  const auto info = reinterpret_cast<BITMAPINFO*>(&header);
  Report("r", GetDIBits(dc, bitmap, 0, 1, nullptr, info, 0));
  Report("w", header.h.biWidth);
  Report("h", header.h.biHeight);
  Report("bits", header.h.biBitCount);
  Report("image", header.h.biSizeImage);
  for (const int bits : {1, 8, 24}) {
    for (const DWORD rop : {WHITENESS, BLACKNESS}) {
      PatBlt(dc, 0, 0, 1, 1, rop);
      header.h.biWidth = 1;
      header.h.biHeight = 1;
      header.h.biPlanes = 1;
      header.h.biBitCount = static_cast<WORD>(bits);
      std::uint8_t pixels[4] = {9, 9, 9, 9};
      Report("r", GetDIBits(dc, bitmap, 0, 1, pixels, info, 0));
      Report("p", pixels[0]);
      Report("q", pixels[2]);
    }
  }
  header.h.biClrUsed = 7;
  header.h.biClrImportant = 5;
  header.h.biBitCount = 8;
  Report("r", GetDIBits(dc, bitmap, 0, 1, nullptr, info, 0));
  Report("used", header.h.biClrUsed);
  Report("important", header.h.biClrImportant);
  DeleteDC(dc);
}

// Memory that is shared by a handle that is none.
void SectionOfNoHandle() {
  Header header{};
  header.h.biSize = 40;
  header.h.biWidth = 4;
  header.h.biHeight = 4;
  header.h.biPlanes = 1;
  header.h.biBitCount = 24;
  void* memory = &header;
  const auto handle = reinterpret_cast<HANDLE>(std::intptr_t{0x12344});
  Report("null", CreateDIBSection(nullptr, reinterpret_cast<BITMAPINFO*>(&header), 0, &memory,
                                  handle, 0) == nullptr);
  Report("bits", memory == nullptr);
}

// Masks are part of the longer headers; a colour table stands behind them.
struct LongHeader {
  LongHeader(DWORD size, int bits, int columns, int rows) {
    header.biSize = size;
    header.biWidth = columns;
    header.biHeight = -rows;
    header.biPlanes = 1;
    header.biBitCount = static_cast<WORD>(bits);
  }
  BITMAPINFO* Info() {
    std::memcpy(bytes, &header, sizeof header);
    return reinterpret_cast<BITMAPINFO*>(bytes);
  }
  void SetMasks(std::uint32_t red, std::uint32_t green, std::uint32_t blue) {
    header.biCompression = BI_BITFIELDS;
    const std::uint32_t masks[3] = {red, green, blue};
    std::memcpy(bytes + sizeof header, masks, sizeof masks);
  }
  BITMAPINFOHEADER header{};
  alignas(8) unsigned char bytes[124 + 1024]{};
};

void LongHeaders(DWORD size, int bits, Random& random) {
  LongHeader info(size, bits, 9, 7);
  if (bits == 16) {
    info.SetMasks(0xF800, 0x07E0, 0x001F);
  } else if (bits == 32) {
    info.SetMasks(0x000000FF, 0x0000FF00, 0x00FF0000);
  } else {
    for (DWORD i = 0; i < 1024; ++i) {
      info.bytes[size + i] = static_cast<unsigned char>(i % 4 == 3 ? 0 : random.In(0, 255));
    }
  }
  std::uint8_t pixels[9 * 4 * 7];
  for (std::uint8_t& byte : pixels) {
    byte = static_cast<std::uint8_t>(random.In(0, 255));
  }
  Section p(20, 16, {24, true});
  Report("r", StretchDIBits(p.dc, 1, 1, 9, 7, 0, 0, 9, 7, pixels, info.Info(), 0, SRCCOPY) != 0);
  Show(p);
  void* memory = nullptr;
  HDC dc = CreateCompatibleDC(nullptr);
  HBITMAP section = CreateDIBSection(dc, info.Info(), DIB_RGB_COLORS, &memory, nullptr, 0);
  Report("section", section != nullptr && memory != nullptr);
  if (memory != nullptr) {
    HGDIOBJ old = SelectObject(dc, section);
    std::memcpy(memory, pixels, static_cast<std::size_t>((9 * bits + 31) / 32 * 4 * 7));
    BitBlt(p.dc, 10, 8, 9, 7, dc, 0, 0, SRCCOPY);
    SelectObject(dc, old);
    Show(p);
    DIBSECTION facts{};
    GetObjectA(section, sizeof facts, &facts);
    ReportHex("red", facts.dsBitfields[0]);
    ReportHex("green", facts.dsBitfields[1]);
    ReportHex("blue", facts.dsBitfields[2]);
  }
  DeleteDC(dc);
  DeleteObject(section);
}

// The mode is taken and returned; with sizes that stay the pixels do, too.
void Halftone(Random& random) {
  Section a(9, 7, {24, false});
  Section p(20, 16, {24, true});
  a.Noise(random);
  Report("old", SetStretchBltMode(p.dc, HALFTONE));
  StretchBlt(p.dc, 1, 1, 9, 7, a.dc, 0, 0, 9, 7, SRCCOPY);
  StretchDIBits(p.dc, 10, 8, 9, 7, 0, 0, 9, 7, a.pixels, a.Info(), 0, SRCCOPY);
  Report("old", SetStretchBltMode(p.dc, COLORONCOLOR));
  Show(p);
}

}  // namespace

void ObjectScenes() {
  Scene("object/fonts", [](Random&) { Fonts(); });
  for (const int index : {OEM_FIXED_FONT, ANSI_FIXED_FONT, ANSI_VAR_FONT, SYSTEM_FONT,
                          DEVICE_DEFAULT_FONT, SYSTEM_FIXED_FONT, DEFAULT_GUI_FONT}) {
    Scene("object/stock-font-" + std::to_string(index), [=](Random&) { StockFont(index); });
  }
  Scene("object/current", [](Random&) { Current(); });
  Scene("object/region", [](Random&) { Region(); });
  for (const Format format : kFormats) {
    Scene("object/null-brush-" + NameOf(format), [=](Random&) { NullBrush(format); });
  }
  Scene("object/stock-bitmap", [](Random&) { StockBitmap(); });
  Scene("object/section-of-no-handle", [](Random&) { SectionOfNoHandle(); });
  for (const DWORD size : {DWORD{40}, DWORD{52}, DWORD{56}, DWORD{108}, DWORD{124}}) {
    for (const int bits : {8, 16, 32}) {
      Scene("object/header-" + std::to_string(size) + "-" + std::to_string(bits),
            [=](Random& random) { LongHeaders(size, bits, random); });
    }
  }
  Scene("object/halftone", Halftone);
}
