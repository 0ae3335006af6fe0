// The state of a context, saving and restoring it.

#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

namespace {

void ReportState(HDC dc) {
  const int rop = SetROP2(dc, R2_COPYPEN);
  const int background = SetBkMode(dc, OPAQUE);
  const int stretch = SetStretchBltMode(dc, COLORONCOLOR);
  const int fill = SetPolyFillMode(dc, ALTERNATE);
  const std::uint32_t text = SetTextColor(dc, 0);
  const std::uint32_t colour = SetBkColor(dc, 0xFFFFFF);
  POINT position{};
  MoveToEx(dc, 0, 0, &position);
  Report("rop", rop);
  Report("bk", background);
  Report("st", stretch);
  Report("pf", fill);
  ReportHex("t", text);
  ReportHex("b", colour);
  Report("x", position.x);
  Report("y", position.y);
}

void Change(HDC dc, int number) {
  SetROP2(dc, number);
  SetBkMode(dc, TRANSPARENT);
  SetStretchBltMode(dc, WHITEONBLACK);
  SetPolyFillMode(dc, WINDING);
  SetTextColor(dc, static_cast<std::uint32_t>(number) * 0x010203U);
  SetBkColor(dc, static_cast<std::uint32_t>(number) * 0x050403U);
  MoveToEx(dc, number, -number, nullptr);
}

void Levels() {
  Section p(6, 6, {24, true});
  for (int i = 1; i <= 4; ++i) {
    Change(p.dc, i);
    Report("s", SaveDC(p.dc));
  }
  ReportState(p.dc);
  Report("r", RestoreDC(p.dc, 5));
  Report("r", RestoreDC(p.dc, 0));
  Report("r", RestoreDC(p.dc, -5));
  Report("r", RestoreDC(p.dc, -2));
  ReportState(p.dc);
  Report("r", RestoreDC(p.dc, 3));
  Report("r", RestoreDC(p.dc, 1));
  ReportState(p.dc);
  Report("r", RestoreDC(p.dc, -1));
  Report("s", SaveDC(p.dc));
}

void SelectedObjects() {
  Section p(10, 10, {24, true});
  HPEN pen = CreatePen(PS_SOLID, 1, 0x112233);
  HBRUSH brush = CreateSolidBrush(0x445566);
  SelectObject(p.dc, pen);
  SelectObject(p.dc, brush);
  SaveDC(p.dc);
  SelectObject(p.dc, GetStockObject(WHITE_PEN));
  SelectObject(p.dc, GetStockObject(BLACK_BRUSH));
  HBITMAP bitmap = CreateBitmap(4, 4, 1, 1, nullptr);
  Report("s", SelectObject(p.dc, bitmap) == HGDIOBJ(p.bitmap));
  RestoreDC(p.dc, -1);
  Report("pen", GetCurrentObject(p.dc, OBJ_PEN) == HGDIOBJ(pen));
  Report("brush", GetCurrentObject(p.dc, OBJ_BRUSH) == HGDIOBJ(brush));
  Report("bitmap", GetCurrentObject(p.dc, OBJ_BITMAP) == HGDIOBJ(p.bitmap));
  PatBlt(p.dc, 1, 1, 5, 5, PATCOPY);
  SelectObject(p.dc, GetStockObject(WHITE_PEN));
  SelectObject(p.dc, GetStockObject(BLACK_BRUSH));
  Report("d", DeleteObject(pen) != 0);
  Report("d", DeleteObject(brush) != 0);
  Report("d", DeleteObject(bitmap) != 0);
  Show(p);
}

void BadValues() {
  Section p(6, 6, {24, true});
  Report("rop", SetROP2(p.dc, 0));
  Report("rop", SetROP2(p.dc, 17));
  Report("rop", SetROP2(p.dc, -1));
  Report("bk", SetBkMode(p.dc, 0));
  Report("bk", SetBkMode(p.dc, 3));
  Report("st", SetStretchBltMode(p.dc, 0));
  Report("st", SetStretchBltMode(p.dc, 5));
  Report("pf", SetPolyFillMode(p.dc, 0));
  Report("pf", SetPolyFillMode(p.dc, 3));
  ReportState(p.dc);
}

// Another bitmap leaves the rest of the state as it is.
void BitmapChange() {
  Section p(20, 20, {24, true});
  Section q(12, 30, {8, true});
  IntersectClipRect(p.dc, 3, 3, 18, 18);
  HDC dc = q.dc;
  IntersectClipRect(dc, 2, 2, 25, 25);
  HBITMAP bitmap = CreateCompatibleBitmap(dc, 30, 10);
  HGDIOBJ old = SelectObject(dc, bitmap);
  ReportClipBox(dc);
  SelectObject(dc, old);
  ReportClipBox(dc);
  DeleteObject(bitmap);
}

}  // namespace

void StateScenes() {
  Scene("state/levels", [](Random&) { Levels(); });
  Scene("state/selected-objects", [](Random&) { SelectedObjects(); });
  Scene("state/bad-values", [](Random&) { BadValues(); });
  Scene("state/bitmap-change", [](Random&) { BitmapChange(); });
}
