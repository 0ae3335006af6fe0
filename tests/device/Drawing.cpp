#include "Drawing.h"

#include "Harness.h"

void DrawLine(HDC dc, int x0, int y0, int x1, int y1) {
  MoveToEx(dc, x0, y0, nullptr);
  LineTo(dc, x1, y1);
}

int FillRectangle(HDC dc, int left, int top, int right, int bottom, std::uint32_t colour) {
  HBRUSH brush = CreateSolidBrush(colour);
  const RECT rect{left, top, right, bottom};
  const int result = FillRect(dc, &rect, brush);
  DeleteObject(brush);
  return result;
}

void ReportClipBox(HDC dc) {
  RECT box{-7, -7, -7, -7};
  const int kind = GetClipBox(dc, &box);
  Report("box", kind);
  if (kind == SIMPLEREGION || kind == COMPLEXREGION) {
    Report("l", box.left);
    Report("t", box.top);
    Report("r", box.right);
    Report("b", box.bottom);
  }
}

std::uint32_t TernaryCode(int index) {
  static const std::uint32_t known[] = {
      BLACKNESS,   NOTSRCERASE, NOTSRCCOPY,  SRCERASE,    DSTINVERT,   PATINVERT,
      SRCINVERT,   SRCAND,      MERGEPAINT,  MERGECOPY,   SRCCOPY,     SRCPAINT,
      PATCOPY,     PATPAINT,    WHITENESS,   0x00B8074AU, 0x00E20746U, 0x00CA0749U,
      0x00AC0744U, 0x00690145U, 0x00960169U, 0x00A000C9U};
  for (const std::uint32_t code : known) {
    if (code >> 16U == static_cast<std::uint32_t>(index)) {
      return code;
    }
  }
  return static_cast<std::uint32_t>(index) << 16U;
}
