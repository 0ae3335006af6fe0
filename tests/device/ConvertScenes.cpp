// Pictures of one format into bitmaps of another.

#include "Groups.h"
#include "Pictures.h"

#include <string>
#include <vector>

namespace {

const std::vector<std::uint32_t> kBright = {0x000000, 0xFFFFFF, 0x0000FF, 0x00FF00, 0xFF0000,
                                            0x00FFFF, 0xFF00FF, 0xFFFF00, 0x808080, 0x404040};

void Between(Format from, Format to, Random& random) {
  Section a(23, 9, from);
  Section p(26, 20, to);
  a.Noise(random);
  p.Noise(random);
  BitBlt(p.dc, 1, 1, 22, 8, a.dc, 1, 1, SRCCOPY);
  BitBlt(p.dc, 3, 10, 22, 8, a.dc, 0, 0, SRCINVERT);
  Show(p);
}

// From colours to colours, by way of a table that is not grey.
void FromColours(int bits, Format to, Random& random) {
  Section a(23, 9, {bits, false}, {kBright.begin(), kBright.begin() + (bits == 1 ? 2 : 10)});
  Section p(26, 20, to);
  for (int y = 0; y < 9; ++y) {
    for (int x = 0; x < 23; ++x) {
      a.Set(x, y, static_cast<std::uint32_t>(random.In(0, bits == 1 ? 1 : 9)));
    }
  }
  BitBlt(p.dc, 1, 1, 22, 8, a.dc, 1, 1, SRCCOPY);
  StretchDIBits(p.dc, 3, 10, 20, 8, 0, 0, 20, 8, a.pixels, a.Info(), DIB_RGB_COLORS, SRCCOPY);
  Show(p);
}

// Indices behind the end of a short table are black.
void ShortTable(int bits, Random& random) {
  Section a(16, 8, {bits, true}, {0x302010, 0xFFFFFF, 0x0000FF, 0x00FF00});
  a.Noise(random);
  Section p(16, 8, {24, true});
  BitBlt(p.dc, 0, 0, 16, 8, a.dc, 0, 0, SRCCOPY);
  for (int i = 0; i < 6; ++i) {
    ReportHex("g", GetPixel(a.dc, i, i));
  }
  Show(p);
}

// Of two equal colours the first is found.
void TwiceTheSame() {
  Section p(8, 2, {8, true}, {0x000000, 0x808080, 0xFFFFFF, 0x808080, 0xFFFFFF, 0x7F7F7F});
  const std::uint32_t colours[8] = {0x808080, 0xFFFFFF, 0x7F7F7F, 0x000000,
                                    0xFEFEFE, 0x010101, 0x818181, 0x303030};
  for (int i = 0; i < 8; ++i) {
    ReportHex("s", SetPixel(p.dc, i, 0, colours[i]));
  }
  Show(p);
}

void FourthByte() {
  Memory a(4, 1, {32, true});
  for (int x = 0; x < 4; ++x) {
    a.Set(x, 0, 0xA1B2C3D4U + static_cast<std::uint32_t>(x) * 0x11111111U);
  }
  Section p(4, 4, {32, true});
  p.Fill(0x80402010U);
  StretchDIBits(p.dc, 0, 0, 4, 1, 0, 0, 4, 1, a.pixels, a.Info(), DIB_RGB_COLORS, SRCCOPY);
  StretchDIBits(p.dc, 0, 1, 4, 1, 0, 0, 4, 1, a.pixels, a.Info(), DIB_RGB_COLORS, SRCPAINT);
  PatBlt(p.dc, 0, 2, 1, 1, WHITENESS);
  PatBlt(p.dc, 1, 2, 1, 1, BLACKNESS);
  PatBlt(p.dc, 2, 2, 1, 1, PATCOPY);
  PatBlt(p.dc, 3, 2, 1, 1, DSTINVERT);
  SetPixel(p.dc, 0, 3, 0x123456);
  PatBlt(p.dc, 1, 3, 1, 1, PATINVERT);
  Show(p);
}

}  // namespace

void ConvertScenes() {
  for (const int from : {1, 4, 8, 16, 24, 32}) {
    for (const int to : {16, 24, 32}) {
      if (from != to) {
        Scene("convert/" + std::to_string(from) + "-to-" + std::to_string(to), [=](Random& random) {
          Between({from, true}, {to, false}, random);
        });
      }
    }
  }
  for (const int from : {1, 4, 8}) {
    for (const int to : {1, 4, 8}) {
      Scene("convert/grey-" + std::to_string(from) + "-to-" + std::to_string(to),
            [=](Random& random) {
              Between({from, false}, {to, true}, random);
            });
    }
    for (const int to : {1, 4, 8, 16, 24, 32}) {
      Scene("convert/colours-" + std::to_string(from) + "-to-" + std::to_string(to),
            [=](Random& random) {
              FromColours(from, {to, true}, random);
            });
    }
  }
  for (const int from : {16, 24, 32}) {
    Scene("convert/" + std::to_string(from) + "-to-1", [=](Random& random) {
      Between({from, true}, {1, false}, random);
    });
    Scene("convert/" + std::to_string(from) + "-to-4", [=](Random& random) {
      Between({from, true}, {4, false}, random);
    });
  }
  for (const int bits : {4, 8}) {
    Scene("convert/short-table-" + std::to_string(bits),
          [=](Random& random) { ShortTable(bits, random); });
  }
  Scene("convert/twice-the-same", [](Random&) { TwiceTheSame(); });
  Scene("convert/fourth-byte", [](Random&) { FourthByte(); });
}
