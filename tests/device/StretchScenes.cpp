#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

enum Kind { kLarger, kSmaller, kMirrored };

void Modes(int mode, Kind kind, Random& random) {
  const Format format = kFormats[(mode * 3 + kind) % 8];
  Section a(19, 15, format);
  Section p(45, 37, format);
  a.Noise(random);
  SetStretchBltMode(p.dc, mode);
  if (kind == kLarger) {
    StretchBlt(p.dc, 1, 2, 41, 33, a.dc, 0, 0, 19, 15, SRCCOPY);
  } else if (kind == kSmaller) {
    StretchBlt(p.dc, 3, 1, 11, 8, a.dc, 1, 1, 18, 13, SRCCOPY);
  } else {
    StretchBlt(p.dc, 40, 33, -37, -29, a.dc, 0, 0, 19, 15, SRCCOPY);
  }
  Show(p);
}

void FromMemory(int bits, bool topDown) {
  Memory a(17, 13, {bits, topDown});
  a.Ramp();
  Section p(48, 36, {24, true});
  SetStretchBltMode(p.dc, COLORONCOLOR);
  Report("r", StretchDIBits(p.dc, 2, 3, 40, 29, 0, 0, 17, 13, a.pixels, a.Info(), 0, SRCCOPY) != 0);
  Report("r",
         StretchDIBits(p.dc, 20, 8, 25, 26, 5, 3, 9, 7, a.pixels, a.Info(), 0, SRCINVERT) != 0);
  Show(p);
}

// A picture in memory drawn as a viewer does it: both heights of a top-down one are negated.
int DrawImage(HDC dc, Memory& a, const RECT& s, const RECT& t) {
  int sourceY = s.top;
  int sourceHeight = s.bottom - s.top;
  int y = t.top;
  int height = t.bottom - t.top;
  if (a.header.h.biHeight < 0) {
    sourceY = 1 - a.header.h.biHeight - s.top;
    sourceHeight = -sourceHeight;
    y = t.top + height - 1;
    height = -height;
  }
  SetStretchBltMode(dc, COLORONCOLOR);
  return StretchDIBits(dc, t.left, y, t.right - t.left, height, s.left, sourceY, s.right - s.left,
                       sourceHeight, a.pixels, a.Info(), DIB_RGB_COLORS, SRCCOPY) != 0;
}

void Draw(int number) {
  Memory a(18, 16, {number % 2 != 0 ? 8 : 24, true});
  a.Ramp();
  Section p(50, 40, {32, number < 2});
  if (number == 3) {
    a.header.h.biHeight = -a.header.h.biHeight;
  }
  const RECT source = number == 0 ? RECT{0, 0, 18, 16} : RECT{4, 3, 15, 14};
  const RECT target = number == 1 ? RECT{2, 2, 13, 13} : RECT{5, 4, 43, 35};
  Report("r", DrawImage(p.dc, a, source, target));
  Show(p);
}

// One picture after the other, between the same two sizes in each dimension.
void Sizes(int bits, int mode, Random& random) {
  Section a(24, 24, {bits, false});
  Section p(60, 60, {bits, true});
  a.Noise(random);
  SetStretchBltMode(p.dc, mode);
  const int sizes[] = {2, 3, 5, 8, 13, 21};
  int y = 0;
  for (const int height : sizes) {
    int x = 0;
    for (const int width : sizes) {
      StretchBlt(p.dc, x, y, width, height, a.dc, 1, 2, sizes[(x + y) % 6], sizes[(x + 3) % 6],
                 SRCCOPY);
      x += width;
    }
    y += height;
  }
  Show(p);
}

// Several rows and columns that share a place, of other depths than the destination.
void ModesAcrossDepths(int from, int mode) {
  Section a(20, 18, {from, false});
  a.Ramp();
  Section p(30, 30, {24, true});
  SetStretchBltMode(p.dc, mode);
  StretchBlt(p.dc, 1, 1, 9, 7, a.dc, 0, 0, 20, 18, SRCCOPY);
  StretchBlt(p.dc, 11, 1, 19, 7, a.dc, 2, 0, 10, 18, SRCINVERT);
  StretchBlt(p.dc, 1, 9, 6, 20, a.dc, 3, 4, 14, 12, SRCCOPY);
  StretchDIBits(p.dc, 9, 9, 7, 5, 0, 0, 20, 18, a.pixels, a.Info(), 0, SRCCOPY);
  StretchDIBits(p.dc, 18, 9, 7, 20, 0, 3, 20, 9, a.pixels, a.Info(), 0, SRCPAINT);
  Show(p);
}

// Sources that reach beyond their bitmap: what is missing is left out, the rest keeps its place.
void BeyondTheSource(int bits, Random& random) {
  Section a(14, 11, {bits, true});
  Section p(44, 40, {bits, true});
  a.Noise(random);
  SetStretchBltMode(p.dc, COLORONCOLOR);
  Report("r", StretchBlt(p.dc, 2, 2, 30, 12, a.dc, -4, 3, 14, 11, SRCCOPY));
  Report("r", StretchBlt(p.dc, 4, 16, 13, 21, a.dc, 5, -6, 12, 20, SRCCOPY));
  Report("r", StretchBlt(p.dc, 20, 16, 11, 9, a.dc, -5, -5, 24, 21, SRCCOPY));
  Report("r", StretchBlt(p.dc, 33, 30, 20, 20, a.dc, 0, 0, 7, 7, SRCCOPY));
  Report("r", StretchBlt(p.dc, -5, 30, 18, 20, a.dc, 2, 1, 9, 8, SRCINVERT));
  Report("r", StretchBlt(p.dc, 1, 1, 9, 9, a.dc, 20, 1, 5, 5, SRCCOPY));
  Report("r", StretchBlt(p.dc, 1, 1, 0, 9, a.dc, 1, 1, 5, 5, SRCCOPY));
  Report("r", StretchBlt(p.dc, 1, 1, 9, 9, a.dc, 1, 1, 5, 0, SRCCOPY));
  Show(p);
}

void BeyondTheMemory(Format format) {
  Memory a(14, 11, format);
  a.Ramp();
  Section p(44, 40, {32, true});
  SetStretchBltMode(p.dc, COLORONCOLOR);
  const auto stretch = [&](int x, int y, int w, int h, int sx, int sy, int sw, int sh) {
    Report("r", StretchDIBits(p.dc, x, y, w, h, sx, sy, sw, sh, a.pixels, a.Info(), 0, SRCCOPY));
  };
  stretch(2, 2, 30, 12, -4, 3, 14, 11);
  stretch(4, 16, 13, 21, 5, -6, 12, 20);
  stretch(20, 16, 11, 9, -5, -5, 24, 21);
  stretch(33, 30, 20, 20, 0, 0, 7, 7);
  stretch(-5, 30, 18, 20, 2, 1, 9, 8);
  stretch(1, 1, 9, 9, 20, 1, 5, 5);
  stretch(1, 1, 9, 9, 1, 1, 0, 5);
  stretch(1, 1, 0, 9, 1, 1, 5, 5);
  Show(p);
}

// Pictures of all small widths and heights, each stretched to one column and to one row.
void ToOne(bool topDown, int mode, Random& random) {
  Section a(16, 16, {24, topDown});
  Section p(40, 40, {24, true});
  a.Noise(random);
  SetStretchBltMode(p.dc, mode);
  for (int size = 1; size <= 12; ++size) {
    StretchBlt(p.dc, size, 0, 1, 6, a.dc, 2, 1, size, 6, SRCCOPY);
    StretchBlt(p.dc, 0, 12 + size, 6, 1, a.dc, 1, 2, 6, size, SRCCOPY);
    StretchBlt(p.dc, 14 + size, 5, 1, -6, a.dc, 2, 1, size, 6, SRCCOPY);
    StretchBlt(p.dc, 20, 12 + size, -6, 1, a.dc, 1, 2, 6, size, SRCCOPY);
    StretchDIBits(p.dc, 20 + size, 30, 1, 6, 2, 1, size, 6, a.pixels, a.Info(), 0, SRCCOPY);
  }
  Show(p);
}

}  // namespace

void StretchScenes() {
  for (int i = 0; i < 6; ++i) {
    Scene("stretch/to-one-" + std::to_string(i),
          [=](Random& random) { ToOne(i % 2 == 0, 1 + i / 2, random); });
  }
  const char* const kinds[] = {"-larger", "-smaller", "-mirrored"};
  for (int mode = BLACKONWHITE; mode <= COLORONCOLOR; ++mode) {
    for (const Kind kind : {kLarger, kSmaller, kMirrored}) {
      Scene("stretch/mode" + std::to_string(mode) + kinds[kind],
            [=](Random& random) { Modes(mode, kind, random); });
    }
  }
  for (const int bits : kDepths) {
    for (const bool topDown : {false, true}) {
      Scene("stretch/bits" + std::to_string(bits) + (topDown ? "-top-down" : "-bottom-up"),
            [=](Random&) { FromMemory(bits, topDown); });
    }
  }
  for (int n = 0; n < 4; ++n) {
    Scene("stretch/draw" + std::to_string(n), [n](Random&) { Draw(n); });
  }
  for (int mode = BLACKONWHITE; mode <= COLORONCOLOR; ++mode) {
    for (const int bits : {1, 4, 8, 16, 24, 32}) {
      const std::string suffix = std::to_string(bits) + "-mode" + std::to_string(mode);
      Scene("stretch/sizes-" + suffix, [=](Random& random) { Sizes(bits, mode, random); });
      Scene("stretch/to-24-from-" + suffix, [=](Random&) { ModesAcrossDepths(bits, mode); });
    }
  }
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    Scene("stretch/beyond-the-source-" + std::to_string(bits),
          [=](Random& random) { BeyondTheSource(bits, random); });
    for (const bool topDown : {false, true}) {
      Scene("stretch/beyond-the-memory-" + NameOf({bits, topDown}), [=](Random&) {
        BeyondTheMemory({bits, topDown});
      });
    }
  }
}
