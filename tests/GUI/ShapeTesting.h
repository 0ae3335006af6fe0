#ifndef TESTS_GUI_SHAPETESTING_H
#define TESTS_GUI_SHAPETESTING_H

/// @file
/// What the tests of the shapes share.

#include <vorl/GUI/GraphicHandler.h>

#include <cmath>
#include <set>
#include <sstream>
#include <string>
#include <utility>

#include "Canvas.h"

namespace gui_testing {

/// "x y" of a point, to two decimals.
inline std::string At(const dVect2D& p) {
  const auto rounded = [](float x) { return std::round(x * 100.0F) / 100.0F + 0.0F; };
  std::ostringstream out;
  out << rounded(p.x) << " " << rounded(p.y);
  return out.str();
}

/// Sends a left button's events to an object through a handler that holds it.
class Hand {
 public:
  explicit Hand(VGObjectView& view) { handler.AddObject(&view); }
  bool Down(float x, float y) { return Send(MouseEvent_ButtonDown, x, y); }
  bool Move(float x, float y) { return Send(MouseEvent_Move, x, y); }
  bool Up(float x, float y) { return Send(MouseEvent_ButtonUp, x, y); }
  /// A whole drag in one step.
  void Drag(float x1, float y1, float x2, float y2) {
    Down(x1, y1);
    Move(x2, y2);
    Up(x2, y2);
  }
  GraphicHandler handler;

 private:
  bool Send(int event, float x, float y) {
    dVect2D p(x, y);
    return handler.ProcessMouseEvent(event, MK_LBUTTON, p);
  }
};

/// Asks an object how the mouse would grab it.
inline int StateAt(VGObjectView& view, float x, float y) {
  dVect2D p(x, y);
  return view.GetSelectionState(0, p);
}

inline bool IsHit(VGObjectView& view, float x, float y, int tolerance) {
  dVect2D p(x, y);
  return view.IsPointOnGraphic(p, tolerance);
}

inline std::string BoxOf(VGObjectView& view) {
  dVect2D min;
  dVect2D max;
  view.CalcBoundingBox(nullptr, min, max);
  return At(min) + " " + At(max);
}

/// The raster operation of a device context.
inline int RopOf(HDC dc) {
  const int rop = SetROP2(dc, R2_COPYPEN);
  SetROP2(dc, rop);
  return rop;
}

/// The pixels of a canvas that are not black.
inline std::set<std::pair<int, int>> Lit(const Canvas& canvas) {
  std::set<std::pair<int, int>> lit;
  for (int y = 0; y < canvas.Height(); ++y) {
    for (int x = 0; x < canvas.Width(); ++x) {
      if (canvas.At(x, y) != 0) {
        lit.insert({x, y});
      }
    }
  }
  return lit;
}

}  // namespace gui_testing

#endif
