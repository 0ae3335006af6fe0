#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

// Rectangles of ordinary and of hardly any size, some with their corners the wrong way round.
constexpr RECT kRectangles[] = {{2, 2, 22, 14},   {44, 14, 26, 3},  {2, 18, 3, 19},
                                {6, 18, 8, 20},   {11, 18, 12, 30}, {15, 18, 40, 19},
                                {15, 22, 15, 30}, {18, 22, 30, 22}, {18, 25, 21, 28},
                                {30, 24, 60, 50}, {-9, 33, 12, 36}};

void WithPen(int style, int width, int rop, bool hasBrush) {
  Section p(48, 40, kFormats[(style + width + rop) % 8]);
  p.Ramp();
  SetROP2(p.dc, rop);
  SetBkColor(p.dc, p.Paint(2));
  const SelectedPen pen(p.dc, style, width, p.Paint(6));
  const SelectedObject brush(
      p.dc, hasBrush ? HGDIOBJ(CreateSolidBrush(p.Paint(3))) : GetStockObject(NULL_BRUSH),
      hasBrush);
  for (const RECT& r : kRectangles) {
    Report("r", Rectangle(p.dc, r.left, r.top, r.right, r.bottom) != 0 ? 1 : 0);
  }
  Show(p);
}

}  // namespace

void RectangleScenes() {
  for (const int rop : {R2_COPYPEN, R2_XORPEN}) {
    for (const bool hasBrush : {false, true}) {
      const std::string name =
          std::string(hasBrush ? "-filled" : "-hollow") + "-rop" + std::to_string(rop);
      for (const int width : {1, 2, 3, 6}) {
        Scene("rectangle/width" + std::to_string(width) + name,
              [=](Random&) { WithPen(PS_SOLID, width, rop, hasBrush); });
        Scene("rectangle/inside-width" + std::to_string(width) + name,
              [=](Random&) { WithPen(PS_INSIDEFRAME, width, rop, hasBrush); });
      }
      Scene("rectangle/no-pen" + name, [=](Random&) { WithPen(PS_NULL, 1, rop, hasBrush); });
      Scene("rectangle/dashed" + name, [=](Random&) { WithPen(PS_DASHDOT, 1, rop, hasBrush); });
    }
  }
}
