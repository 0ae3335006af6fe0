// Blits inside one bitmap: the source is read as it was before.

#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

void Moves(Format format, std::uint32_t rop, Random& random) {
  Section p(40, 36, format);
  p.Noise(random);
  const int moves[8][2] = {{1, 0}, {-1, 0}, {0, 1}, {0, -1}, {3, 2}, {-2, 3}, {2, -3}, {-3, -2}};
  for (const auto& move : moves) {
    BitBlt(p.dc, 6 + move[0], 5 + move[1], 27, 24, p.dc, 6, 5, rop);
  }
  Show(p);
}

void Stretches(Format format, Random& random) {
  Section p(40, 36, format);
  p.Noise(random);
  SetStretchBltMode(p.dc, COLORONCOLOR);
  StretchBlt(p.dc, 2, 2, 30, 28, p.dc, 5, 6, 20, 17, SRCCOPY);
  StretchBlt(p.dc, 8, 9, 13, 12, p.dc, 4, 4, 27, 26, SRCCOPY);
  StretchBlt(p.dc, 30, 30, -20, -22, p.dc, 12, 11, 20, 22, SRCCOPY);
  Show(p);
}

}  // namespace

void OverlapScenes() {
  for (const int bits : {8, 16, 24, 32}) {
    for (const bool topDown : {false, true}) {
      const Format format{bits, topDown};
      Scene("overlap/copy-" + NameOf(format),
            [=](Random& random) { Moves(format, SRCCOPY, random); });
      Scene("overlap/stretch-" + NameOf(format),
            [=](Random& random) { Stretches(format, random); });
    }
    Scene("overlap/invert-" + std::to_string(bits), [=](Random& random) {
      Moves({bits, true}, SRCINVERT, random);
    });
  }
}
