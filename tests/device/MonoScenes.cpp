// Monochrome device bitmaps: text and background colours stand for 0 and 1.

#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

const std::uint8_t kStripes[4 * 4] = {0x5A, 0xA5, 0xF0, 0, 0x0F, 0x33, 0xCC, 0,
                                      0x81, 0x7E, 0x18, 0, 0xFF, 0x00, 0xAA, 0};

void ToColours(int bits, Random& random) {
  const Mono mono(24, 4, kStripes);
  Section p(30, 24, {bits, bits != 8});
  p.Noise(random);
  SetTextColor(p.dc, p.Paint(1));
  SetBkColor(p.dc, p.Paint(4));
  BitBlt(p.dc, 1, 1, 24, 4, mono.dc, 0, 0, SRCCOPY);
  BitBlt(p.dc, 3, 6, 24, 4, mono.dc, 0, 0, SRCAND);
  SetStretchBltMode(p.dc, COLORONCOLOR);
  StretchBlt(p.dc, 2, 11, 27, 5, mono.dc, 1, 0, 20, 4, SRCCOPY);
  StretchBlt(p.dc, 28, 22, -9, -3, mono.dc, 1, 0, 20, 4, SRCINVERT);
  Show(p);
}

// The pixels that have the source's background colour, or what comes nearest to it, are white.
void FromColours(int bits, std::uint32_t background, Random& random) {
  Section a(24, 6, {bits, true});
  for (int y = 0; y < 6; ++y) {
    for (int x = 0; x < 24; ++x) {
      const std::uint32_t grey = Grey(random.In(0x40, 0x43));
      a.Set(x, y, bits == 8 ? grey & 0xFFU : bits == 16 ? grey & 0x0421U : grey);
    }
  }
  SetBkColor(a.dc, background);
  const Mono mono(26, 8);
  BitBlt(mono.dc, 1, 1, 24, 6, a.dc, 0, 0, SRCCOPY);
  mono.Show("copied");
  BitBlt(mono.dc, 2, 2, 20, 6, a.dc, 3, 0, SRCINVERT);
  mono.Show("inverted");
}

void FromOneBit(bool inverted, std::uint32_t background) {
  Section a(24, 4, {1, true}, inverted);
  for (int y = 0; y < 4; ++y) {
    for (int x = 0; x < 24; ++x) {
      a.Set(x, y, (x * 3 + y * 5) % 7 < 3 ? 1 : 0);
    }
  }
  SetBkColor(a.dc, background);
  const Mono mono(24, 4);
  BitBlt(mono.dc, 0, 0, 24, 4, a.dc, 0, 0, SRCCOPY);
  mono.Show("mono");
}

void ToOneBit(bool inverted, std::uint32_t text, std::uint32_t background) {
  const Mono mono(24, 4, kStripes);
  Section p(24, 4, {1, true}, inverted);
  SetTextColor(p.dc, text);
  SetBkColor(p.dc, background);
  BitBlt(p.dc, 0, 0, 24, 4, mono.dc, 0, 0, SRCCOPY);
  Show(p);
}

// Between two of them the colours do not matter.
void BetweenMonos() {
  const Mono a(24, 4, kStripes);
  const Mono b(30, 9);
  SetTextColor(b.dc, 0xFFFFFF);
  SetBkColor(b.dc, 0);
  SetBkColor(a.dc, 0x123456);
  BitBlt(b.dc, 1, 1, 24, 4, a.dc, 0, 0, SRCCOPY);
  b.Show("copied");
  SetStretchBltMode(b.dc, COLORONCOLOR);
  StretchBlt(b.dc, 0, 3, 30, 6, a.dc, 2, 1, 17, 3, SRCPAINT);
  b.Show("stretched");
}

void FromMemory(int bits) {
  Memory a(24, 4, {bits, true});
  for (int x = 0; x < 24; ++x) {
    a.Set(x, 0, x % 3 == 0 ? 0xFFFFFF : x % 3 == 1 ? 0x808080 : 0);
    a.Set(x, 1, 0xFFFFFF);
    a.Set(x, 2, 0xFEFEFE);
  }
  const Mono mono(24, 4);
  SetBkColor(mono.dc, 0x808080);
  StretchDIBits(mono.dc, 0, 0, 24, 4, 0, 0, 24, 4, a.pixels, a.Info(), DIB_RGB_COLORS, SRCCOPY);
  mono.Show("mono");
}

void Drawn(std::uint32_t background) {
  const Mono mono(24, 6);
  SetBkColor(mono.dc, background);
  for (int i = 0; i < 24; ++i) {
    ReportHex("s", SetPixel(mono.dc, i, 1, Grey(i * 11)));
    const SelectedPen pen(mono.dc, PS_SOLID, 1, Grey(i * 11));
    DrawLine(mono.dc, i, 3, i, 6);
  }
  mono.Show("mono");
}

}  // namespace

void MonoScenes() {
  for (const int bits : {4, 8, 16, 24, 32}) {
    Scene("mono/to-" + std::to_string(bits), [=](Random& random) { ToColours(bits, random); });
  }
  for (const int bits : {8, 16, 24, 32}) {
    for (const std::uint32_t background : {0x414141U, 0x424242U, 0xFFFFFFU}) {
      Scene("mono/from-" + std::to_string(bits) + "-" + std::to_string(background & 0xFFU),
            [=](Random& random) { FromColours(bits, background, random); });
    }
  }
  for (const bool inverted : {false, true}) {
    const std::string kind = inverted ? "inverted-" : "";
    for (const std::uint32_t background : {0x000000U, 0x606060U, 0x909090U, 0xFFFFFFU}) {
      const std::string name = kind + std::to_string(background & 0xFFU);
      Scene("mono/from-one-bit-" + name, [=](Random&) { FromOneBit(inverted, background); });
      Scene("mono/to-one-bit-" + name,
            [=](Random&) { ToOneBit(inverted, background ^ 0xFFFFFFU, background); });
    }
  }
  Scene("mono/between", [](Random&) { BetweenMonos(); });
  for (const int bits : {1, 8, 24, 32}) {
    Scene("mono/from-memory-" + std::to_string(bits), [=](Random&) { FromMemory(bits); });
  }
  Scene("mono/drawn-on-white", [](Random&) { Drawn(0xFFFFFF); });
  Scene("mono/drawn-on-dark", [](Random&) { Drawn(0x212121); });
}
