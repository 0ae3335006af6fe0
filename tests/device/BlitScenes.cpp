#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>
#include <vector>

namespace {

// Sixteen operations with a common first digit, in one picture.
void SixteenOperations(int digit, Format source, Format target, Random& random) {
  Section a(12, 12, source);
  Section p(40, 40, target);
  a.Noise(random);
  p.Noise(random);
  const SelectedBrush brush(p.dc, p.Paint(digit + 3));
  for (int i = 0; i < 16; ++i) {
    BitBlt(p.dc, i % 4 * 10, i / 4 * 10, 9, 9, a.dc, i % 3, i % 4, TernaryCode(digit * 16 + i));
  }
  Show(p);
}

void BetweenDepths(int from, int to, Random& random) {
  Section a(16, 14, {from, true});
  Section p(20, 18, {to, false});
  a.NoiseFor(random, to);
  p.Noise(random);
  BitBlt(p.dc, 1, 2, 15, 7, a.dc, 1, 0, SRCCOPY);
  BitBlt(p.dc, 3, 9, 15, 7, a.dc, 0, 6, SRCINVERT);
  Show(p);
}

void FromMono(int bits, Random& random) {
  std::uint8_t data[4 * 9];
  for (std::uint8_t& byte : data) {
    byte = static_cast<std::uint8_t>(random.Next() >> 6U);
  }
  Mono mono(21, 9, data);
  Section p(24, 12, {bits, true});
  SetTextColor(p.dc, p.Paint(2));
  SetBkColor(p.dc, p.Paint(9));
  BitBlt(p.dc, 2, 1, 20, 8, mono.dc, 1, 1, SRCCOPY);
  Show(p);
}

void ToMono(int bits, Random& random) {
  Section a(21, 9, {bits, true});
  for (int y = 0; y < 9; ++y) {
    for (int x = 0; x < 21; ++x) {
      a.Set(x, y, random.Flip() ? 0x414141 : 0x232323);
    }
  }
  SetBkColor(a.dc, Grey(0x41));
  Mono mono(21, 9);
  BitBlt(mono.dc, 0, 0, 21, 9, a.dc, 0, 0, SRCCOPY);
  mono.Show("mono");
}

// Sizes and places around and beyond the edges of both bitmaps, some of them mirrored.
void Places(int bits, Random& random) {
  Section a(17, 13, {bits, false});
  Section p(37, 33, {bits, true});
  a.Noise(random);
  for (int i = 0; i < 24; ++i) {
    const int x = random.In(-8, 36);
    const int y = random.In(-8, 32);
    const int width = random.In(1, 20);
    const int height = random.In(1, 20);
    const int sourceX = random.In(-5, 14);
    const int sourceY = random.In(-5, 11);
    Report("r", BitBlt(p.dc, x, y, width, height, a.dc, sourceX, sourceY,
                       i % 3 == 0 ? SRCINVERT : SRCCOPY));
  }
  Show(p);
}

// Negative sizes run from the given corner upwards and to the left, in source and destination.
void NegativeSizes(int bits, Random& random) {
  Section a(20, 18, {bits, true});
  Section p(30, 28, {bits, true});
  a.Noise(random);
  BitBlt(p.dc, 12, 11, -10, 8, a.dc, 14, 3, SRCCOPY);
  BitBlt(p.dc, 15, 12, 11, -9, a.dc, 3, 15, SRCCOPY);
  BitBlt(p.dc, 25, 26, -20, -13, a.dc, 19, 17, SRCINVERT);
  Show(p);
}

void Patterns(int bits, Random& random) {
  Section p(40, 30, {bits, true});
  p.Noise(random);
  const std::uint32_t codes[] = {PATCOPY,   PATINVERT,  DSTINVERT,  BLACKNESS,
                                 WHITENESS, 0x00A000C9, 0x000F0001, 0x00AF0229};
  for (int i = 0; i < 8; ++i) {
    const SelectedBrush brush(p.dc, p.Paint(i + 1));
    const int width = i % 2 != 0 ? -11 : 11;
    const int height = i % 3 != 0 ? 8 : -8;
    Report("r", PatBlt(p.dc, i * 4 + 2, i * 3 + 3, width, height, codes[i]));
  }
  Show(p);
}

void NullBrush() {
  Section p(12, 8, {24, true});
  p.Ramp();
  const SelectedStock brush(p.dc, NULL_BRUSH);
  Report("r", PatBlt(p.dc, 1, 1, 6, 6, PATCOPY));
  Report("r", PatBlt(p.dc, 2, 2, 6, 6, DSTINVERT));
  Show(p);
}

}  // namespace

void BlitScenes() {
  for (int digit = 0; digit < 16; digit += 3) {
    const Format format = kFormats[digit % 8];
    Scene(std::string("blt/rops-") + "0123456789ABCDEF"[digit], [=](Random& random) {
      SixteenOperations(digit, format, {format.bits, !format.topDown}, random);
    });
  }
  for (const int from : kDepths) {
    for (const int to : kDepths) {
      if (from != to) {
        Scene("blt/" + std::to_string(from) + "-to-" + std::to_string(to),
              [=](Random& random) { BetweenDepths(from, to, random); });
      }
    }
  }
  for (const int bits : {8, 24, 32}) {
    Scene("blt/mono-to-" + std::to_string(bits), [=](Random& random) { FromMono(bits, random); });
  }
  for (const int bits : {8, 24, 32}) {
    Scene("blt/mono-from-" + std::to_string(bits), [=](Random& random) { ToMono(bits, random); });
  }
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    Scene("blt/places-" + std::to_string(bits), [=](Random& random) { Places(bits, random); });
    Scene("blt/patterns-" + std::to_string(bits), [=](Random& random) { Patterns(bits, random); });
    Scene("blt/negative-sizes-" + std::to_string(bits),
          [=](Random& random) { NegativeSizes(bits, random); });
  }
  Scene("blt/null-brush", [](Random&) { NullBrush(); });
}

void Rop3Scenes() {
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    for (int digit = 0; digit < 16; ++digit) {
      Scene("rop3/" + std::to_string(bits) + "-" + "0123456789ABCDEF"[digit], [=](Random& random) {
        SixteenOperations(digit, {bits, digit % 2 == 0}, {bits, digit % 3 == 0}, random);
      });
    }
  }
}
