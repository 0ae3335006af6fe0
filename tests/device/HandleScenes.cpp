#include "Groups.h"
#include "Pictures.h"

namespace {

void NullAndDeleted() {
  Section p(6, 6, kFormats[0]);
  HBRUSH brush = CreateSolidBrush(5);
  Report("d", DeleteObject(brush) != 0);
  Report("d", DeleteObject(brush) != 0);
  Report("s", SelectObject(p.dc, brush) != nullptr);
  Report("l", LineTo(nullptr, 1, 1) != 0);
  ReportHex("g", GetPixel(nullptr, 1, 1));
}

void SelectedElsewhere() {
  Section p(6, 6, kFormats[1]);
  HDC dc = CreateCompatibleDC(nullptr);
  Report("s", SelectObject(dc, p.bitmap) != nullptr);
  DeleteDC(dc);
  Report("d", DeleteDC(dc) != 0);
}

void State() {
  Section p(6, 6, kFormats[2]);
  Report("rop", SetROP2(p.dc, R2_XORPEN));
  Report("rop", SetROP2(p.dc, 99));
  Report("rop", SetROP2(p.dc, R2_COPYPEN));
  Report("bk", SetBkMode(p.dc, TRANSPARENT));
  Report("st", SetStretchBltMode(p.dc, COLORONCOLOR));
  ReportHex("t", SetTextColor(p.dc, 7));
  ReportHex("b", SetBkColor(p.dc, 7));
}

void Screen() {
  Section p(6, 6, {24, true});
  HDC screen = GetDC(nullptr);
  HBITMAP bitmap = CreateBitmap(3, 3, 1, 1, nullptr);
  Report("select", SelectObject(screen, bitmap) != nullptr);
  Report("mem", ReleaseDC(nullptr, p.dc));
  Report("screen", ReleaseDC(nullptr, screen));
  Report("again", ReleaseDC(nullptr, screen));
  Report("d", DeleteObject(bitmap) != 0);
}

void Stock() {
  Report("d", DeleteObject(GetStockObject(WHITE_BRUSH)) != 0);
  Report("same", GetStockObject(WHITE_BRUSH) == GetStockObject(WHITE_BRUSH));
  for (const int index : {-1, 9, 99}) {
    Report("none", GetStockObject(index) == nullptr);
  }
  LOGPEN pen{};
  HPEN made = CreatePen(7, -3, 5);
  Report("size", GetObjectA(made, sizeof pen, &pen));
  Report("style", pen.lopnStyle);
  Report("width", pen.lopnWidth.x);
  LOGBRUSH brush{};
  Report("size", GetObjectA(GetStockObject(LTGRAY_BRUSH), sizeof brush, &brush));
  ReportHex("colour", brush.lbColor);
  Report("needs", GetObjectA(made, 0, nullptr));
  Report("needs", GetObjectA(GetStockObject(SYSTEM_FONT), 0, nullptr));
  DeleteObject(made);
}

// A device bitmap can be selected when it is monochrome or as deep as the screen.
void SelectDepths() {
  for (const unsigned bits : {1U, 4U, 8U, 16U, 24U, 32U}) {
    HDC dc = CreateCompatibleDC(nullptr);
    HBITMAP bitmap = CreateBitmap(3, 3, 1, bits, nullptr);
    Report("s", SelectObject(dc, bitmap) != nullptr);
    DeleteDC(dc);
    DeleteObject(bitmap);
  }
}

}  // namespace

void HandleScenes() {
  Scene("handle/null-and-deleted", [](Random&) { NullAndDeleted(); });
  Scene("handle/selected-elsewhere", [](Random&) { SelectedElsewhere(); });
  Scene("handle/state", [](Random&) { State(); });
  Scene("handle/screen", [](Random&) { Screen(); });
  Scene("handle/stock", [](Random&) { Stock(); });
  Scene("handle/select-depths", [](Random&) { SelectDepths(); });
}
