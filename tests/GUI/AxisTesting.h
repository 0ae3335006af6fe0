#ifndef VORL_TESTS_GUI_AXISTESTING_H
#define VORL_TESTS_GUI_AXISTESTING_H

/// @file
/// How axes are expected to be drawn. Texts are what the device draws by itself, because fonts
/// differ from machine to machine.

#include <vorl/GUI/VGAxis.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace gui_testing {

using Pixels = std::set<std::pair<int, int>>;

constexpr int kSize = 240;

/// From x = 10 to 220 at y = 20, so that main ticks stand at 100 and 200.
inline VGAxisView AxisView(int flags) {
  VGAxis axis;
  axis.Init(dVect2D(10, 20), 210, TAxis_X, "mm");
  VGAxisView view(axis);
  view.SetViewState(VGViewState_Visible);
  view.SetDisplayFlags(static_cast<unsigned char>(flags));
  return view;
}

inline Pixels Drawn(VGAxisView& view) {
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  view.VGObjectView::Draw(canvas);
  return Lit(canvas);
}

inline tagRECT SizeOf(const std::string& text) {
  Canvas canvas(1, 1);
  tagRECT size{0, 0, 0, 0};
  DrawTextA(canvas, text.c_str(), -1, &size, DT_CALCRECT);
  return size;
}

/// A text whose box begins at a place.
inline Pixels TextAt(const std::string& text, int left, int top) {
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  SetBkMode(canvas, TRANSPARENT);
  SetTextColor(canvas, 0xFFFFFF);
  tagRECT rect{left, top, 2 * kSize, 2 * kSize};
  DrawTextA(canvas, text.c_str(), -1, &rect, 0);
  EXPECT_FALSE(Lit(canvas).empty());
  return Lit(canvas);
}

/// A label below the axis, centred on x.
inline Pixels LabelAt(const std::string& text, int x) {
  return TextAt(text, static_cast<int>(x + 0.001 - SizeOf(text).right / 2.0), 30);
}

inline Pixels Line(int x1, int y1, int x2, int y2) {
  Canvas canvas(kSize, kSize);
  canvas.Fill(0);
  SelectObject(canvas, GetStockObject(WHITE_PEN));
  MoveToEx(canvas, x1, y1, nullptr);
  LineTo(canvas, x2, y2);
  return Lit(canvas);
}

inline Pixels operator+(Pixels a, Pixels b) {
  a.merge(b);
  return a;
}

}  // namespace gui_testing

#endif
