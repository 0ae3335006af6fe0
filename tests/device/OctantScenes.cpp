#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

// Ends of lines from the centre: the axes, the diagonals, both sides of each, and slopes whose
// ideal line runs midway between two pixels.
constexpr POINT kEnds[] = {
    {19, 0},   {19, 1},  {19, 9},  {18, 9},   {19, 18},  {19, 19},   {18, 19},   {9, 19},
    {9, 18},   {1, 19},  {0, 19},  {-1, 19},  {-9, 18},  {-18, 19},  {-19, 19},  {-19, 18},
    {-18, 9},  {-19, 1}, {-19, 0}, {-19, -1}, {-18, -9}, {-19, -18}, {-19, -19}, {-9, -18},
    {-1, -19}, {0, -19}, {1, -19}, {9, -18},  {19, -19}, {18, -9},   {19, -1}};

void Star(int rop, bool inwards) {
  Section p(41, 41, kFormats[(rop * 3 + (inwards ? 1 : 0)) % 8]);
  p.Ramp();
  SetROP2(p.dc, rop);
  const SelectedPen pen(p.dc, PS_SOLID, 1, p.Paint(rop));
  for (const POINT& end : kEnds) {
    if (inwards) {
      DrawLine(p.dc, 20 + end.x, 20 + end.y, 20, 20);
    } else {
      DrawLine(p.dc, 20, 20, 20 + end.x, 20 + end.y);
    }
  }
  Show(p);
}

// Lines that start and end far away show the same pixels as if nothing were cut off.
void Far(int reach, Random& random) {
  Section p(40, 40, {8, true});
  SetROP2(p.dc, R2_XORPEN);
  const SelectedPen pen(p.dc, PS_SOLID, 1, Grey(255));
  for (int i = 0; i < 40; ++i) {
    const int x = random.In(-reach, reach);
    const int y = random.In(-reach, reach);
    const int dx = random.In(-20, 60);
    const int dy = random.In(-20, 60);
    DrawLine(p.dc, x, y, dx - x, dy - y);
  }
  Show(p);
}

void Clipped(int width, Random& random) {
  Section p(50, 44, kFormats[width % 8]);
  IntersectClipRect(p.dc, 4, 3, 45, 40);
  ExcludeClipRect(p.dc, 12, 9, 20, 33);
  ExcludeClipRect(p.dc, 27, 15, 38, 19);
  SetROP2(p.dc, R2_XORPEN);
  const SelectedPen pen(p.dc, PS_SOLID, width, p.Ink());
  for (int i = 0; i < 12; ++i) {
    const int x0 = random.In(-10, 60);
    const int y0 = random.In(-10, 60);
    const int x1 = random.In(-10, 60);
    const int y1 = random.In(-10, 60);
    DrawLine(p.dc, x0, y0, x1, y1);
  }
  Show(p);
}

// A line without length draws nothing with a thin pen, and moves nothing.
void WithoutLength() {
  Section p(9, 9, {24, true});
  for (const int style : {PS_SOLID, PS_DOT, PS_NULL}) {
    for (const int width : {0, 1}) {
      const SelectedPen pen(p.dc, style, width, p.Ink());
      DrawLine(p.dc, 4, 4, 4, 4);
    }
  }
  POINT position{0, 0};
  MoveToEx(p.dc, 1, 1, &position);
  Report("x", position.x);
  Report("y", position.y);
  Show(p);
}

// The pen that draws nothing moves all the same.
void NullPen() {
  Section p(9, 9, {32, true});
  const SelectedPen pen(p.dc, PS_NULL, 5, p.Ink());
  MoveToEx(p.dc, 1, 1, nullptr);
  Report("r", LineTo(p.dc, 7, 5) != 0 ? 1 : 0);
  POINT position{0, 0};
  MoveToEx(p.dc, 0, 0, &position);
  Report("x", position.x);
  Report("y", position.y);
  Show(p);
}

}  // namespace

void OctantScenes() {
  for (int rop = R2_BLACK; rop <= R2_WHITE; ++rop) {
    Scene("octant/outwards-rop" + std::to_string(rop), [rop](Random&) { Star(rop, false); });
    Scene("octant/inwards-rop" + std::to_string(rop), [rop](Random&) { Star(rop, true); });
  }
  for (const int reach : {100, 3000, 100000, 1 << 22, 1 << 26}) {
    Scene("octant/far" + std::to_string(reach), [reach](Random& random) { Far(reach, random); });
  }
  for (const int width : {0, 1, 2, 5}) {
    Scene("octant/clipped-width" + std::to_string(width),
          [width](Random& random) { Clipped(width, random); });
  }
  Scene("octant/without-length", [](Random&) { WithoutLength(); });
  Scene("octant/null-pen", [](Random&) { NullPen(); });
}
