// GetDIBits: pixels out of bitmaps.

#include "Groups.h"
#include "Pictures.h"

#include <cstring>
#include <string>
#include <vector>

namespace {

struct Answer {
  Header header{};
  std::vector<std::uint8_t> bytes = std::vector<std::uint8_t>(4096, 0xEE);

  void Ask(int width, int height, int bits) {
    header.h.biSize = 40;
    header.h.biWidth = width;
    header.h.biHeight = height;
    header.h.biPlanes = 1;
    header.h.biBitCount = static_cast<WORD>(bits);
  }
  int Get(HDC dc, HBITMAP bitmap, unsigned start, unsigned count) {
    return GetDIBits(dc, bitmap, start, count, bytes.data(), Info(), DIB_RGB_COLORS);
  }
  BITMAPINFO* Info() { return reinterpret_cast<BITMAPINFO*>(&header); }
  void Show() {
    CheckSum sum;
    for (const std::uint8_t byte : bytes) {
      sum.Add(byte);
    }
    ReportHex("crc", sum.Get());
    if (header.h.biBitCount <= 8) {
      CheckSum table;
      for (const RGBQUAD& colour : header.colours) {
        table.Add(colour.rgbBlue);
        table.Add(colour.rgbGreen);
        table.Add(colour.rgbRed);
      }
      ReportHex("table", table.Get());
    }
    Report("image", header.h.biSizeImage);
    Report("used", header.h.biClrUsed);
  }
};

void Between(Format from, int bits, Random& random) {
  Section a(21, 7, from);
  a.NoiseFor(random, bits == 1 ? 1 : 0);
  HDC dc = CreateCompatibleDC(nullptr);
  Answer answer;
  answer.Ask(21, from.topDown ? 7 : -7, bits);
  Report("r", answer.Get(dc, a.bitmap, 0, 7));
  answer.Show();
  DeleteDC(dc);
}

// Some rows, of pictures that are as large as the bitmap, smaller or larger.
void Rows(int height, Random& random) {
  Section a(6, 9, {32, true});
  a.Noise(random);
  HDC dc = CreateCompatibleDC(nullptr);
  for (const unsigned start : {0U, 1U, 4U, 8U, 9U, 12U}) {
    for (const unsigned count : {0U, 2U, 4U, 9U, 20U}) {
      Answer answer;
      answer.Ask(6, height, 32);
      Report("r", answer.Get(dc, a.bitmap, start, count));
      CheckSum sum;
      for (const std::uint8_t byte : answer.bytes) {
        sum.Add(byte);
      }
      ReportHex("c", sum.Get());
    }
  }
  DeleteDC(dc);
}

void OtherWidths(Random& random) {
  Section a(6, 5, {24, false});
  a.Noise(random);
  HDC dc = CreateCompatibleDC(nullptr);
  for (const int width : {1, 4, 6, 9}) {
    Answer answer;
    answer.Ask(width, 5, 32);
    Report("r", answer.Get(dc, a.bitmap, 0, 5));
    answer.Show();
  }
  DeleteDC(dc);
}

void Description(int bits) {
  Section a(6, 5, {bits, true});
  Answer answer;
  answer.header.h.biSize = 40;
  Report("r", GetDIBits(a.dc, a.bitmap, 0, 5, nullptr, answer.Info(), DIB_RGB_COLORS));
  Report("w", answer.header.h.biWidth);
  Report("h", answer.header.h.biHeight);
  Report("bits", answer.header.h.biBitCount);
  Report("planes", answer.header.h.biPlanes);
  Report("image", answer.header.h.biSizeImage);
}

void FromMono() {
  const std::uint8_t data[6] = {0x50, 0x80, 0xA0, 0x00, 0x33, 0x40};
  const Mono mono(10, 3, data);
  HDC dc = CreateCompatibleDC(nullptr);
  for (const int bits : {1, 24}) {
    Answer answer;
    answer.Ask(10, -3, bits);
    Report("r", answer.Get(dc, mono.bitmap, 0, 3));
    answer.Show();
  }
  DeleteDC(dc);
}

void Failures() {
  Section a(6, 5, {24, false});
  HDC dc = CreateCompatibleDC(nullptr);
  Answer answer;
  answer.Ask(6, 5, 24);
  Report("null-dc", answer.Get(nullptr, a.bitmap, 0, 5));
  Report("null-bitmap", answer.Get(dc, nullptr, 0, 5));
  answer.Ask(0, 5, 24);
  Report("width", answer.Get(dc, a.bitmap, 0, 5));
  answer.Ask(6, 0, 24);
  Report("height", answer.Get(dc, a.bitmap, 0, 5));
  answer.Ask(6, 5, 7);
  Report("bits", answer.Get(dc, a.bitmap, 0, 5));
  DeleteDC(dc);
}

}  // namespace

void DibScenes() {
  for (const Format from :
       {Format{1, true}, Format{8, false}, Format{16, true}, Format{24, false}, Format{32, true}}) {
    for (const int bits : {1, 16, 24, 32}) {
      Scene("dib/" + NameOf(from) + "-as-" + std::to_string(bits),
            [=](Random& random) { Between(from, bits, random); });
    }
  }
  for (const int bits : {4, 8}) {
    Scene("dib/same-" + std::to_string(bits), [=](Random& random) {
      Between({bits, true}, bits, random);
    });
  }
  for (const int height : {9, -9, 5, -5, 12}) {
    Scene("dib/rows-of-" + std::to_string(height), [=](Random& random) { Rows(height, random); });
  }
  Scene("dib/other-widths", OtherWidths);
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    Scene("dib/description-" + std::to_string(bits), [=](Random&) { Description(bits); });
  }
  Scene("dib/from-mono", [](Random&) { FromMono(); });
  Scene("dib/failures", [](Random&) { Failures(); });
}
