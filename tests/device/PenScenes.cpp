#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

namespace {

void Styled(int style, int mode) {
  Section p(72, 40, kFormats[(style * 2 + mode) % 8]);
  p.Fill(p.bits == 1 ? 0 : 0x303030);
  SetBkMode(p.dc, mode);
  SetBkColor(p.dc, p.bits == 1 ? 0xFFFFFF : Grey(0x70));
  const SelectedPen pen(p.dc, style, 1, p.bits == 1 ? 0 : p.Ink());
  DrawLine(p.dc, 2, 4, 70, 4);
  DrawLine(p.dc, 70, 8, 2, 37);
  DrawLine(p.dc, 5, 38, 5, -9);
  Show(p);
}

void Wide(int width, int dx, int dy, bool topDown) {
  Section p(45, 45, {8, topDown});
  const SelectedPen pen(p.dc, PS_SOLID, width, Grey(255));
  DrawLine(p.dc, 22, 22, 22 + dx, 22 + dy);
  Show(p);
}

}  // namespace

void PenScenes() {
  for (int style = PS_DASH; style <= PS_DASHDOTDOT; ++style) {
    for (const int mode : {TRANSPARENT, OPAQUE}) {
      Scene("pen/style" + std::to_string(style) + "-mode" + std::to_string(mode),
            [style, mode](Random&) { Styled(style, mode); });
    }
  }
  for (const int width : {2, 3, 4, 5, 6, 7, 9, 12}) {
    Scene("pen/dot-width" + std::to_string(width), [width](Random&) {
      Section p(29, 25, {8, true});
      const SelectedPen pen(p.dc, PS_SOLID, width, Grey(255));
      DrawLine(p.dc, 14, 12, 14, 12);
      Show(p);
    });
  }
  const int ends[5][2] = {{13, 0}, {0, -14}, {11, 4}, {-6, 12}, {-9, -9}};
  for (const int width : {2, 3, 5, 8}) {
    for (int i = 0; i < 5; ++i) {
      const int dx = ends[i][0];
      const int dy = ends[i][1];
      Scene("pen/wide" + std::to_string(width) + "-to" + std::to_string(dx) + "," +
                std::to_string(dy),
            [=](Random&) { Wide(width, dx, dy, i % 2 == 0); });
    }
  }
  Scene("pen/wide-dashed-is-solid", [](Random&) {
    Section p(40, 20, kFormats[0]);
    const SelectedPen pen(p.dc, PS_DASHDOT, 4, p.Ink());
    DrawLine(p.dc, 6, 9, 33, 9);
    Show(p);
  });
}
