// Every combination of signs of the sizes of source and destination.

#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

struct Signs {
  int x, y, sourceX, sourceY;

  std::string Name() const {
    const auto sign = [](int value) { return value < 0 ? "-" : "+"; };
    return std::string(sign(x)) + sign(y) + sign(sourceX) + sign(sourceY);
  }
};

// The corner from which a stretch of `size` in the direction of `sign` covers the same pixels.
int Start(int low, int size, int sign) {
  return sign < 0 ? low + size - 1 : low;
}

void BetweenSections(const Signs& s, int width, int height, int mode, Random& random) {
  const Format format = kFormats[random.In(0, 7)];
  Section a(19, 17, format);
  Section p(40, 36, {format.bits, !format.topDown});
  a.Noise(random);
  SetStretchBltMode(p.dc, mode);
  Report("r", StretchBlt(p.dc, Start(3, width, s.x), Start(2, height, s.y), s.x * width,
                         s.y * height, a.dc, Start(2, 15, s.sourceX), Start(1, 13, s.sourceY),
                         s.sourceX * 15, s.sourceY * 13, SRCCOPY));
  Show(p);
}

void FromMemory(const Signs& s, int width, int height, Format format) {
  Memory a(19, 17, format);
  a.Ramp();
  Section p(40, 36, {32, true});
  SetStretchBltMode(p.dc, COLORONCOLOR);
  // Rows count from the bottom, and those of a negative height from behind the last one.
  const int sourceY = s.sourceY < 0 ? 1 + 13 + 1 : 1;
  Report("r", StretchDIBits(p.dc, Start(3, width, s.x), Start(2, height, s.y), s.x * width,
                            s.y * height, Start(2, 15, s.sourceX), sourceY, s.sourceX * 15,
                            s.sourceY * 13, a.pixels, a.Info(), DIB_RGB_COLORS, SRCCOPY));
  Show(p);
}

}  // namespace

void MirrorScenes() {
  for (int n = 0; n < 16; ++n) {
    const Signs s{(n & 1) != 0 ? -1 : 1, (n & 2) != 0 ? -1 : 1, (n & 4) != 0 ? -1 : 1,
                  (n & 8) != 0 ? -1 : 1};
    const int mode = n % 3 + 1;
    Scene("mirror/larger" + s.Name(),
          [=](Random& random) { BetweenSections(s, 31, 29, mode, random); });
    Scene("mirror/smaller" + s.Name(),
          [=](Random& random) { BetweenSections(s, 8, 7, COLORONCOLOR, random); });
    Scene("mirror/equal" + s.Name(),
          [=](Random& random) { BetweenSections(s, 15, 13, mode, random); });
    Scene("mirror/memory-larger" + s.Name(),
          [=](Random&) { FromMemory(s, 31, 29, kFormats[n % 8]); });
    Scene("mirror/memory-smaller" + s.Name(),
          [=](Random&) { FromMemory(s, 8, 7, kFormats[(n + 3) % 8]); });
  }
}
