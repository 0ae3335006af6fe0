#ifndef VORL_TESTS_DEVICE_DRAWING_H
#define VORL_TESTS_DEVICE_DRAWING_H

#include "Device.h"

#include <cstdint>

/// Selects an object, restores the one before and deletes it.
class SelectedObject {
 public:
  SelectedObject(HDC context, HGDIOBJ chosen, bool isOwn = true)
      : m_dc(context), m_object(chosen), m_old(SelectObject(context, chosen)), m_own(isOwn) {}
  SelectedObject(const SelectedObject&) = delete;
  SelectedObject& operator=(const SelectedObject&) = delete;
  ~SelectedObject() {
    SelectObject(m_dc, m_old);
    if (m_own) {
      DeleteObject(m_object);
    }
  }

 private:
  HDC m_dc;
  HGDIOBJ m_object;
  HGDIOBJ m_old;
  bool m_own;
};

struct SelectedPen : SelectedObject {
  SelectedPen(HDC dc, int style, int width, std::uint32_t colour)
      : SelectedObject(dc, CreatePen(style, width, colour)) {}
};

struct SelectedBrush : SelectedObject {
  SelectedBrush(HDC dc, std::uint32_t colour) : SelectedObject(dc, CreateSolidBrush(colour)) {}
};

struct SelectedStock : SelectedObject {
  SelectedStock(HDC dc, int index) : SelectedObject(dc, GetStockObject(index), false) {}
};

void DrawLine(HDC dc, int x0, int y0, int x1, int y1);
int FillRectangle(HDC dc, int left, int top, int right, int bottom, std::uint32_t colour);

/// Adds kind and, unless it is empty, corners of the clip box to the line.
void ReportClipBox(HDC dc);

/// The code of one of the 256 ternary raster operations: the published one of the best known, the
/// bare index of the others.
std::uint32_t TernaryCode(int index);

#endif
