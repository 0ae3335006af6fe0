#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>
#include <vector>

namespace {

std::string StyleName(int style) {
  const char* const names[] = {"solid", "dash", "dot", "dash-dot", "dash-dot-dot"};
  return names[style];
}

// The state that all scenes share: gaps in a colour of their own where they are drawn.
struct Gaps {
  Gaps(const Section& p, int mode) {
    SetBkMode(p.dc, mode);
    SetBkColor(p.dc, p.Paint(3));
  }
};

// A pattern starts anew with every line.
void Chain(int style, int mode, Format format) {
  Section p(80, 46, format);
  p.Ramp();
  const Gaps gaps(p, mode);
  const SelectedPen pen(p.dc, style, 1, p.Paint(8));
  MoveToEx(p.dc, 2, 2, nullptr);
  const POINT ends[] = {{13, 2}, {70, 2}, {76, 20}, {40, 44}, {40, 44}, {3, 44}, {-9, 30}, {9, 5}};
  for (const POINT& end : ends) {
    LineTo(p.dc, end.x, end.y);
  }
  Show(p);
}

// Around a polygon and a rectangle the pattern goes on at the corners.
void Closed(int style, int mode) {
  Section p(64, 60, kFormats[(style + mode * 3) % 8]);
  p.Ramp();
  const Gaps gaps(p, mode);
  const SelectedPen pen(p.dc, style, 1, p.Paint(8));
  const SelectedStock brush(p.dc, NULL_BRUSH);
  const std::vector<POINT> points = {{4, 4}, {30, 9}, {61, 3}, {55, 33}, {20, 27}};
  Polygon(p.dc, points.data(), static_cast<int>(points.size()));
  Rectangle(p.dc, 5, 31, 60, 58);
  Rectangle(p.dc, 50, 50, 13, 40);
  Show(p);
}

void Combined(int style, int rop) {
  Section p(50, 40, kFormats[(style + rop) % 8]);
  p.Ramp();
  const Gaps gaps(p, OPAQUE);
  SetROP2(p.dc, rop);
  ExcludeClipRect(p.dc, 20, 10, 28, 22);
  const SelectedPen pen(p.dc, style, 0, p.Paint(8));
  DrawLine(p.dc, 1, 3, 48, 36);
  DrawLine(p.dc, 47, 1, 3, 38);
  DrawLine(p.dc, -30, 15, 60, 15);
  Show(p);
}

// Far lines: the pattern counts the pixels that cannot be seen.
void Far(int style, Random& random) {
  Section p(50, 40, {8, false});
  const Gaps gaps(p, OPAQUE);
  const SelectedPen pen(p.dc, style, 1, Grey(255));
  for (int i = 0; i < 6; ++i) {
    const int x = random.In(-30000, 30000);
    const int y = random.In(-30000, 30000);
    const int x1 = random.In(0, 50) - x;
    const int y1 = random.In(0, 40) - y;
    DrawLine(p.dc, x, y, x1, y1);
  }
  Show(p);
}

}  // namespace

void DashScenes() {
  for (int style = PS_DASH; style <= PS_DASHDOTDOT; ++style) {
    for (const int mode : {TRANSPARENT, OPAQUE}) {
      const std::string name = StyleName(style) + (mode == OPAQUE ? "-opaque" : "-transparent");
      for (const int bits : kDepths) {
        Scene("dash/" + name + "-" + std::to_string(bits), [=](Random&) {
          Chain(style, mode, {bits, mode == OPAQUE});
        });
      }
      Scene("dash/" + name + "-closed", [=](Random&) { Closed(style, mode); });
    }
    for (const int rop : {R2_XORPEN, R2_NOT, R2_MASKPEN, R2_NOTMERGEPEN}) {
      Scene("dash/" + StyleName(style) + "-rop" + std::to_string(rop),
            [=](Random&) { Combined(style, rop); });
    }
    Scene("dash/" + StyleName(style) + "-far", [style](Random& random) { Far(style, random); });
  }
}
