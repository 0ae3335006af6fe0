// Points, lines, rectangles and cross cursors in all states. From left to right: as it is, selected
// by a click, while it is dragged, after that, and created by a drag. While it is dragged an object
// is drawn in exclusive or: on white, in the complement of its colour.
#include <vorl/GUI/VGCrossCursorView.h>
#include <vorl/GUI/VGLine.h>
#include <vorl/GUI/VGPoint.h>
#include <vorl/GUI/VGRect.h>
#include <vorl/GUI/VGText.h>

#include <gtest/gtest.h>

#include "ContactSheet.h"
#include "PictureTesting.h"

namespace {

using gui_testing::CellLook;
using gui_testing::ContactSheet;
using gui_testing::Drag;
using gui_testing::DrawStates;
using gui_testing::ExpectPicture;
using gui_testing::HasStoredFont;
using gui_testing::kNumStates;

constexpr int kRed = 0x0000D0;
constexpr int kBlue = 0xC04000;
constexpr int kGreen = 0x208000;
constexpr short kEditable = VGOperation_Select | VGOperation_Move | VGOperation_Modify;

class ShapeSheet : public ContactSheet {
 public:
  explicit ShapeSheet(int rows) : ContactSheet(kNumStates, rows, 48, 36) {}
};

VGPointView Point(float x, float y, int thickness, int color) {
  VGPointView view(VGPoint(dVect2D(x, y)));
  view.SetDrawParams(PS_SOLID, thickness, color, R2_COPYPEN);
  view.Enable(kEditable);
  return view;
}

TEST(ShapePictures, Points) {
  const Drag drag{{16, 14}, {34, 24}};
  ShapeSheet sheet(4);
  // The thinnest pen leaves no dot: such a point is seen when it is selected.
  DrawStates(sheet, 0, Point(16, 14, 1, kRed), drag);
  DrawStates(sheet, 1, Point(16, 14, 3, kRed), drag);
  DrawStates(sheet, 2, Point(16, 14, 9, kBlue), drag);
  // Grabbed beside its centre, it jumps under the mouse.
  DrawStates(sheet, 3, Point(6.5F, 6.5F, 7, kGreen), Drag{{16, 14}, {34, 24}}, CellLook{2.0F});
  ExpectPicture(sheet, "Points");
}

VGLineView Line(dVect2D pos, dVect2D end, TLine type, int style, int thickness, int color) {
  VGLine line;
  line.Init(pos, end, type);
  VGLineView view(line);
  view.SetDrawParams(style, thickness, color, R2_COPYPEN);
  view.Enable(kEditable);
  return view;
}

TEST(ShapePictures, Lines) {
  const dVect2D a(8, 8);
  const dVect2D b(34, 22);
  ShapeSheet sheet(6);
  DrawStates(sheet, 0, Line(a, b, TLine_Segment, PS_SOLID, 1, kRed), Drag{{34, 22}, {40, 6}});
  DrawStates(sheet, 1, Line(a, b, TLine_Segment, PS_SOLID, 3, kBlue), Drag{{21, 15}, {25, 21}});
  VGLineView turned = Line(a, b, TLine_Segment, PS_SOLID, 1, kGreen);
  turned.Enable(VGOperation_Rotate);
  DrawStates(sheet, 2, turned, Drag{{34, 22}, {21, 30}});
  DrawStates(sheet, 3, Line(a, b, TLine_Infinite, PS_SOLID, 1, kRed), Drag{{8, 8}, {10, 18}});
  VGLineView infinite = Line(dVect2D(20, 14), b, TLine_Infinite, PS_SOLID, 2, kBlue);
  infinite.Enable(VGOperation_Rotate);
  DrawStates(sheet, 4, infinite, Drag{{34, 22}, {30, 8}});
  DrawStates(sheet, 5, Line(a, b, TLine_Segment, PS_DASH, 1, kGreen), Drag{{8, 8}, {6, 30}});
  ExpectPicture(sheet, "Lines");
}

VGRectView Rect(float x1, float y1, float x2, float y2, int style, int thickness, int color) {
  VGRect rect;
  rect.Init(x1, y1, x2, y2);
  VGRectView view(rect);
  view.SetDrawParams(style, thickness, color, R2_COPYPEN);
  view.Enable(kEditable);
  return view;
}

TEST(ShapePictures, Rectangles) {
  ShapeSheet sheet(6);
  DrawStates(sheet, 0, Rect(6, 6, 31, 25, PS_SOLID, 1, kRed), Drag{{31, 25}, {41, 30}});
  DrawStates(sheet, 1, Rect(6, 6, 31, 25, PS_SOLID, 3, kBlue), Drag{{12, 6}, {22, 12}});
  // The upper edge is pulled below the lower one.
  DrawStates(sheet, 2, Rect(6, 6, 31, 17, PS_SOLID, 1, kGreen), Drag{{18, 6}, {30, 30}});
  DrawStates(sheet, 3, Rect(6, 6, 32, 26, PS_DOT, 1, kRed), Drag{{6, 16}, {14, 20}});
  DrawStates(sheet, 4, Rect(3, 3, 6.5F, 6.5F, PS_SOLID, 1, kBlue), Drag{{12, 12}, {40, 30}},
             CellLook{4.0F});
  // Its corners are swapped.
  DrawStates(sheet, 5, Rect(31, 25, 6, 6, PS_SOLID, 2, kGreen), Drag{{31, 16}, {40, 16}});
  ExpectPicture(sheet, "Rectangles");
}

VGTextView Text(const char* words, short alignment, int color) {
  VGText text;
  text = words;
  text.SetPos(36.0F, 18.0F, alignment);
  VGTextView view(text);
  view.SetPenColor(color);
  view.Enable(kEditable);
  return view;
}

// The letters are the system's; where they stand is compared everywhere in VGTextDraw_test.cpp.
TEST(ShapePictures, Texts) {
  const Drag drag{{36, 18}, {30, 24}};
  ContactSheet sheet(kNumStates, 4, 72, 36);
  DrawStates(sheet, 0, Text("Centre", 15, kRed), drag);
  DrawStates(sheet, 1, Text("right", 5, kBlue), drag);
  DrawStates(sheet, 2, Text("left", 0, kGreen), drag);
  VGTextView opaque = Text("Label", 12, 0xFFFFFF);
  opaque.SetTransparent(false);
  opaque.SetBgColor(kBlue);
  DrawStates(sheet, 3, opaque, drag, CellLook{1.0F, 0x402000});
  if (!HasStoredFont()) {
    GTEST_SKIP() << "the letters here are not those of the stored picture";
  }
  ExpectPicture(sheet, "Texts");
}

VGCrossCursorView Cursor(float x, float y, short mode, int thickness) {
  VGCrossCursorView view;
  view.Set(x, y);
  view.SetCursorMode(mode);
  view.SetCursorColors(kRed, kGreen);
  view.SetDrawParams(PS_SOLID, thickness, kBlue, R2_COPYPEN);
  view.Enable(kEditable | VGOperation_Rotate);
  return view;
}

TEST(ShapePictures, CrossCursors) {
  ShapeSheet sheet(7);
  DrawStates(sheet, 0, Cursor(18, 12, CursorMode_First, 1), Drag{{30, 12}, {30, 22}});
  DrawStates(sheet, 1, Cursor(18, 12, CursorMode_Second, 1), Drag{{18, 30}, {30, 22}});
  DrawStates(sheet, 2, Cursor(18, 12, CursorMode_Both, 1), Drag{{18, 30}, {30, 22}});
  DrawStates(sheet, 3, Cursor(24, 18, CursorMode_Both, 1), Drag{{40, 18}, {38, 27}, MK_SHIFT});
  DrawStates(sheet, 4, Cursor(24, 18, CursorMode_Both, 3), Drag{{40, 18}, {30, 27}});
  VGCrossCursorView oblique = Cursor(24, 18, CursorMode_Both, 1);
  oblique.SetCursorOrientation(dVect2D(2, 1), dVect2D(-1, 2));
  DrawStates(sheet, 5, oblique, Drag{{30, 21}, {16, 12}});
  VGCrossCursorView dashed = Cursor(24, 18, CursorMode_Both, 1);
  dashed.SetPenStyle(PS_DASH);
  dashed.SetCursorColors(0x00E0E0, 0xE0E000);
  dashed.SetPenColor(0xFFFFFF);
  DrawStates(sheet, 6, dashed, Drag{{24, 30}, {12, 10}}, CellLook{1.0F, 0x402000});
  ExpectPicture(sheet, "CrossCursors");
}

}  // namespace
