#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <utility>

namespace {

// From one corner to points of the two far edges.
void Fan(int number) {
  Section p(48, 39, kFormats[number]);
  const SelectedPen pen(p.dc, PS_SOLID, 1, p.Ink());
  SetROP2(p.dc, R2_XORPEN);
  const int cx = number % 2 != 0 ? 47 : 0;
  const int cy = number / 2 != 0 ? 38 : 0;
  for (int i = 0; i < 48; i += 5) {
    DrawLine(p.dc, cx, cy, i, 38 - cy);
  }
  for (int i = 0; i < 39; i += 5) {
    DrawLine(p.dc, 47 - cx, i, cx, cy);
  }
  Show(p);
}

void Spiral(int number) {
  Section p(61, 61, kFormats[number]);
  const SelectedPen pen(p.dc, PS_SOLID, 1, p.Ink());
  int x = 30;
  int y = 30;
  int dx = 1;
  int dy = 0;
  MoveToEx(p.dc, x, y, nullptr);
  for (int i = 1; i < 26; ++i) {
    x += dx * i * 2 + i % 3;
    y += dy * i * 2 - i % 2;
    LineTo(p.dc, x, y);
    dx = -std::exchange(dy, dx);
  }
  Show(p);
}

void BeyondTheEdges(Random& random) {
  Section p(33, 27, kFormats[0]);
  for (int i = 0; i < 20; ++i) {
    const SelectedPen pen(p.dc, PS_SOLID, 1, p.Paint(i));
    const int y1 = random.In(0, 26);
    const int x1 = random.In(0, 32);
    const int y0 = random.In(-900, 900);
    const int x0 = random.In(-900, 900);
    DrawLine(p.dc, x0, y0, x1, y1);
  }
  Show(p);
}

void PositionAfter() {
  Section p(16, 16, kFormats[2]);
  POINT position{99, 99};
  MoveToEx(p.dc, 2, 3, nullptr);
  LineTo(p.dc, 11, 5);
  MoveToEx(p.dc, 0, 0, &position);
  Report("x", position.x);
  Report("y", position.y);
  Show(p);
}

}  // namespace

void LineScenes() {
  for (int n = 0; n < 4; ++n) {
    Scene("line/fan-" + NameOf(kFormats[n]), [n](Random&) { Fan(n); });
  }
  for (int n = 4; n < 8; ++n) {
    Scene("line/spiral-" + NameOf(kFormats[n]), [n](Random&) { Spiral(n); });
  }
  Scene("line/beyond-the-edges", BeyondTheEdges);
  Scene("line/position-after", [](Random&) { PositionAfter(); });
}

void Rop2Scenes() {
  for (int rop = R2_BLACK; rop <= R2_WHITE; ++rop) {
    Scene("rop2/" + std::to_string(rop), [rop](Random&) {
      Section p(34, 22, kFormats[rop * 3 % 8]);
      p.Ramp();
      SetROP2(p.dc, rop);
      const SelectedPen pen(p.dc, PS_SOLID, 1, p.Paint(rop + 2));
      DrawLine(p.dc, 1, 1, 32, 19);
      const SelectedPen wide(p.dc, PS_SOLID, 3, p.Paint(rop + 5));
      DrawLine(p.dc, 30, 4, 5, 18);
      Show(p);
    });
  }
}
