#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

namespace {

void Holes(int number, Random& random) {
  Section p(44, 34, kFormats[number]);
  Report("i", IntersectClipRect(p.dc, 2 + number, 3, 40, 30 - number));
  for (int i = 0; i <= number; ++i) {
    const int left = random.In(0, 36);
    const int top = random.In(0, 28);
    const int bottom = top + random.In(2, 8);
    const int right = left + random.In(2, 8);
    Report("e", ExcludeClipRect(p.dc, left, top, right, bottom));
  }
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 0, 0, 44, 34, p.Paint(3));
  const SelectedPen pen(p.dc, PS_SOLID, number % 2 != 0 ? 3 : 1, p.Ink());
  DrawLine(p.dc, -2, 36, 46, -2);
  Show(p);
}

void Saved() {
  Section p(30, 30, kFormats[4]);
  Report("s", SaveDC(p.dc));
  IntersectClipRect(p.dc, 5, 5, 25, 20);
  Report("s", SaveDC(p.dc));
  ExcludeClipRect(p.dc, 5, 5, 25, 12);
  FillRectangle(p.dc, 0, 0, 30, 30, p.Paint(1));
  Report("r", RestoreDC(p.dc, -1) != 0 ? 1 : 0);
  FillRectangle(p.dc, 10, 0, 14, 30, p.Paint(2));
  Report("r", RestoreDC(p.dc, 1) != 0 ? 1 : 0);
  FillRectangle(p.dc, 0, 14, 30, 16, p.Paint(3));
  ReportClipBox(p.dc);
  Show(p);
}

void Reset() {
  Section p(30, 30, kFormats[6]);
  Report("i", IntersectClipRect(p.dc, 40, 40, 50, 50));
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 0, 0, 30, 30, p.Paint(1));
  Report("n", SelectClipRgn(p.dc, nullptr));
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 4, 4, 9, 30, p.Paint(1));
  Show(p);
}

// Blits of every kind through holes, into each depth.
void BlitThroughHoles(int bits, Random& random) {
  Section a(30, 26, {bits, true});
  Section p(40, 36, {bits, false});
  a.Noise(random);
  p.Noise(random);
  IntersectClipRect(p.dc, 3, 2, 38, 33);
  for (int i = 0; i < 6; ++i) {
    const int left = random.In(0, 34);
    const int top = random.In(0, 30);
    ExcludeClipRect(p.dc, left, top, left + 5, top + 4);
  }
  ReportClipBox(p.dc);
  BitBlt(p.dc, 1, 1, 22, 18, a.dc, 2, 1, SRCCOPY);
  BitBlt(p.dc, 15, 12, 24, 22, a.dc, 0, 0, SRCINVERT);
  StretchBlt(p.dc, 0, 20, 30, 15, a.dc, 4, 4, 13, 21, SRCPAINT);
  const SelectedBrush brush(p.dc, p.Paint(4));
  PatBlt(p.dc, 10, 10, 9, 20, PATINVERT);
  Show(p);
}

void SelectedRegion() {
  Section p(30, 24, {24, true});
  HRGN region = CreateRectRgn(22, 18, 5, 4);
  Report("s", SelectClipRgn(p.dc, region));
  Report("d", DeleteObject(region) != 0 ? 1 : 0);
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 0, 0, 30, 24, p.Paint(1));
  Report("e", ExcludeClipRect(p.dc, 0, 0, 30, 10));
  FillRectangle(p.dc, 0, 0, 30, 24, p.Paint(2));
  region = CreateRectRgn(-10, -10, 100, 100);
  Report("s", SelectClipRgn(p.dc, region));
  DeleteObject(region);
  ReportClipBox(p.dc);
  region = CreateRectRgn(3, 3, 3, 9);
  Report("s", SelectClipRgn(p.dc, region));
  DeleteObject(region);
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 0, 0, 30, 24, p.Paint(3));
  Show(p);
}

void ReversedCorners() {
  Section p(30, 24, {8, true});
  Report("i", IntersectClipRect(p.dc, 25, 20, 4, 3));
  ReportClipBox(p.dc);
  Report("e", ExcludeClipRect(p.dc, 20, 10, 12, 5));
  ReportClipBox(p.dc);
  FillRectangle(p.dc, 0, 0, 30, 24, p.Paint(1));
  Show(p);
}

// Without a region, what is excluded is taken from the whole bitmap.
void ExcludeFirst(int left, int top, int right, int bottom) {
  Section p(20, 16, {8, true});
  Report("e", ExcludeClipRect(p.dc, left, top, right, bottom));
  ReportClipBox(p.dc);
  FillRectangle(p.dc, -5, -5, 30, 24, p.Paint(1));
  Show(p);
}

}  // namespace

void ClipScenes() {
  for (int n = 0; n < 6; ++n) {
    Scene("clip/holes" + std::to_string(n), [n](Random& random) { Holes(n, random); });
  }
  Scene("clip/saved", [](Random&) { Saved(); });
  Scene("clip/reset", [](Random&) { Reset(); });
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    Scene("clip/blits-" + std::to_string(bits),
          [bits](Random& random) { BlitThroughHoles(bits, random); });
  }
  Scene("clip/region", [](Random&) { SelectedRegion(); });
  Scene("clip/reversed-corners", [](Random&) { ReversedCorners(); });
  Scene("clip/exclude-inside", [](Random&) { ExcludeFirst(4, 4, 9, 9); });
  Scene("clip/exclude-edge", [](Random&) { ExcludeFirst(-4, -4, 25, 6); });
  Scene("clip/exclude-all", [](Random&) { ExcludeFirst(-1, -1, 21, 17); });
  Scene("clip/exclude-nothing", [](Random&) { ExcludeFirst(30, 3, 35, 8); });
}
