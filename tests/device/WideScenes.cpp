#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>
#include <vector>

namespace {

// Lines in many directions, each combined with the picture once: a pixel that a line touched twice
// would show.
void Directions(int width) {
  Section p(90, 90, {8, width % 2 == 0});
  SetROP2(p.dc, R2_XORPEN);
  const SelectedPen pen(p.dc, PS_SOLID, width, Grey(255));
  const POINT ends[] = {{35, 0},  {33, 5},   {28, 21},  {20, 20},   {12, 35},  {0, 31},  {-5, 33},
                        {-24, 7}, {-30, 16}, {-37, 0},  {-20, -15}, {-8, -15}, {0, -36}, {3, -29},
                        {15, -8}, {27, -36}, {36, -27}, {1, 1},     {2, -1},   {-1, 0}};
  for (const POINT& end : ends) {
    DrawLine(p.dc, 45, 45, 45 + end.x, 45 + end.y);
  }
  Show(p);
}

void Random20(int width, Random& random) {
  Section p(64, 64, {8, true});
  SetROP2(p.dc, R2_XORPEN);
  const SelectedPen pen(p.dc, PS_SOLID, width, Grey(255));
  for (int i = 0; i < 20; ++i) {
    const int x0 = random.In(-40, 100);
    const int y0 = random.In(-40, 100);
    const int x1 = random.In(-40, 100);
    const int y1 = random.In(-40, 100);
    DrawLine(p.dc, x0, y0, x1, y1);
  }
  Show(p);
}

// A polygon's outline is one shape: its corners are round, and where its sides cross each pixel is
// combined once. The inside leaves it out.
void Outline(int width, int style, bool hasBrush) {
  Section p(60, 56, kFormats[(width + (hasBrush ? 4 : 0)) % 8]);
  p.Ramp();
  SetROP2(p.dc, R2_XORPEN);
  const SelectedPen pen(p.dc, style, width, p.Paint(6));
  const SelectedObject brush(
      p.dc, hasBrush ? HGDIOBJ(CreateSolidBrush(p.Paint(3))) : GetStockObject(NULL_BRUSH),
      hasBrush);
  const std::vector<POINT> star = {{10, 10}, {50, 20}, {12, 44}, {30, 4}, {44, 50}};
  Polygon(p.dc, star.data(), static_cast<int>(star.size()));
  const std::vector<POINT> repeated = {{50, 40}, {50, 40}, {55, 52}, {50, 40}};
  Polygon(p.dc, repeated.data(), static_cast<int>(repeated.size()));
  Show(p);
}

void Dots() {
  Section p(130, 60, {24, true});
  SetROP2(p.dc, R2_XORPEN);
  int x = 4;
  for (const int width : {2, 3, 4, 5, 6, 8, 10, 13, 14, 16}) {
    x += width;
    const SelectedPen pen(p.dc, width % 2 == 0 ? PS_SOLID : PS_DASH, width, p.Ink());
    DrawLine(p.dc, x, 20, x, 20);
    const POINT twice[2] = {{x, 45}, {x, 45}};
    Polygon(p.dc, twice, 2);
  }
  Show(p);
}

void Huge(int width) {
  Section p(50, 50, {1, true});
  const SelectedPen pen(p.dc, PS_SOLID, width, 0xFFFFFF);
  DrawLine(p.dc, 25 - width / 2, 25 + width / 7, 20 - width / 3, 25 - width / 5);
  Show(p);
}

void NegativeWidth() {
  Section p(30, 20, {8, true});
  const SelectedPen pen(p.dc, PS_SOLID, -5, Grey(200));
  DrawLine(p.dc, 6, 6, 22, 12);
  Show(p);
}

}  // namespace

void WideScenes() {
  for (int width = 2; width <= 20; ++width) {
    Scene("wide/directions-width" + std::to_string(width), [width](Random&) { Directions(width); });
  }
  for (const int width : {2, 3, 7, 16, 31, 50}) {
    Scene("wide/random-width" + std::to_string(width),
          [width](Random& random) { Random20(width, random); });
  }
  for (const int width : {2, 3, 4, 5, 8, 11}) {
    Scene("wide/outline-width" + std::to_string(width),
          [width](Random&) { Outline(width, PS_SOLID, false); });
    Scene("wide/filled-width" + std::to_string(width),
          [width](Random&) { Outline(width, width % 2 == 0 ? PS_INSIDEFRAME : PS_DOT, true); });
  }
  for (const int width : {100, 333, 1000}) {
    Scene("wide/huge" + std::to_string(width), [width](Random&) { Huge(width); });
  }
  Scene("wide/dots", [](Random&) { Dots(); });
  Scene("wide/negative-width", [](Random&) { NegativeWidth(); });
}
