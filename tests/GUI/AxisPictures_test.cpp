// Axes at several scales, in both directions. One sheet has no texts and is the same everywhere; on
// the other one they are in place, in the letters of the system that drew it.
#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/VGAxis.h>

#include <gtest/gtest.h>

#include "ContactSheet.h"
#include "PictureTesting.h"

namespace {

using gui_testing::Cell;
using gui_testing::CellLook;
using gui_testing::ContactSheet;
using gui_testing::ExpectPicture;
using gui_testing::HasStoredFont;

constexpr int kDrawn = VGAxisDisplay_Line | VGAxisDisplay_Ticks | VGAxisDisplay_Arrow;

/// An axis as users of a viewer have it, with its unit.
VGAxisView Axis(float x, float y, double length, TAxis type, float tickDistance, bool hasTexts) {
  VGAxis axis;
  axis.Init(dVect2D(x, y), length, type, "mm");
  VGAxisView view(axis);
  view.DefineAxisScala(tickDistance, 0);
  view.SetDisplayFlags(static_cast<unsigned char>(hasTexts ? VGAxisDisplay_All : kDrawn));
  return view;
}

void Highlight(VGAxisView& view, double first, double second, bool hasTexts) {
  const int type = hasTexts ? VGAxisHLType_MarkAndValue : VGAxisHLType_Mark;
  view.EnableHLValue(true, 0);
  view.SetHLValue(first, 0);
  view.SetHLValueType(type, 0);
  view.EnableHLValue(true, 1);
  view.SetHLValue(second, 1);
  view.SetHLValueType(type, 1);
  view.SetHLColors(0x40FFFF, 0x804000, 1);
}

void DrawAxis(const ContactSheet& sheet, int column, int row, VGAxisView view,
              const CellLook& look = {1.0F, 0x301808}) {
  view.SetViewState(VGViewState_Visible);
  GraphicHandler handler;
  handler.AddObject(&view);
  Cell cell(sheet, column, row, handler, look);
  cell.Draw();
}

void DrawHorizontal(const ContactSheet& sheet, bool hasTexts) {
  constexpr COLORREF kDark = 0x301808;
  DrawAxis(sheet, 0, 0, Axis(10, 30, 180, TAxis_X, 40, hasTexts));
  // The same on the device, in other values
  DrawAxis(sheet, 1, 0, Axis(1, 3, 18, TAxis_X, 40, hasTexts), {10.0F, kDark});
  DrawAxis(sheet, 0, 1, Axis(100, 300, 1800, TAxis_X, 30, hasTexts), {0.1F, kDark});
  // Longer than the window
  DrawAxis(sheet, 1, 1, Axis(-50, 30, 400, TAxis_X, 25, hasTexts));
  VGAxisView highlighted = Axis(10, 28, 180, TAxis_X, 40, hasTexts);
  Highlight(highlighted, 42.5, 130, hasTexts);
  DrawAxis(sheet, 0, 2, highlighted);
  // Thick, from right to left, where there is no room below
  VGAxisView thick = Axis(185, 46, -170, TAxis_X, 50, hasTexts);
  thick.SetPenThickness(2);
  DrawAxis(sheet, 1, 2, thick);
  UnitTrafo unit;
  unit.SetUnitTrafo(0, 0.01, -0.5);
  unit.SetUnitText(0, "HU", "Hounsfield units");
  VGAxisView converted = Axis(10, 30, 180, TAxis_X, 36, hasTexts);
  converted.SetAxisUnit(&unit);
  DrawAxis(sheet, 0, 3, converted);
  UnitTrafo integers;
  integers.SetUnitTrafo(0, 0.05, 0);
  integers.SetIntegerUnit(0, true);
  VGAxisView whole = Axis(10, 29, 180, TAxis_X, 5, hasTexts);
  whole.SetAxisUnit(&integers);
  Highlight(whole, 3, 7, hasTexts);
  DrawAxis(sheet, 1, 3, whole);
}

void DrawVertical(const ContactSheet& sheet, bool hasTexts) {
  constexpr COLORREF kDark = 0x301808;
  DrawAxis(sheet, 0, 0, Axis(60, 10, 110, TAxis_Y, 40, hasTexts));
  DrawAxis(sheet, 1, 0, Axis(50, 10, 110, TAxis_Y, 40, hasTexts), {1.0F, kDark, true});
  DrawAxis(sheet, 2, 0, Axis(5, 1, 11, TAxis_Y, 20, hasTexts), {10.0F, kDark, true});
  VGAxisView highlighted = Axis(50, 10, 110, TAxis_Y, 25, hasTexts);
  Highlight(highlighted, 42.5, 90, hasTexts);
  DrawAxis(sheet, 3, 0, highlighted, {1.0F, kDark, true});
}

/// Four rows of two horizontal axes, or one of four vertical ones.
class HorizontalSheet : public ContactSheet {
 public:
  HorizontalSheet() : ContactSheet(2, 4, 200, 56) {}
};
class VerticalSheet : public ContactSheet {
 public:
  VerticalSheet() : ContactSheet(4, 1, 96, 132) {}
};

TEST(AxisPictures, HorizontalWithoutTexts) {
  HorizontalSheet sheet;
  DrawHorizontal(sheet, false);
  ExpectPicture(sheet, "AxesX");
}

TEST(AxisPictures, VerticalWithoutTexts) {
  VerticalSheet sheet;
  DrawVertical(sheet, false);
  ExpectPicture(sheet, "AxesY");
}

TEST(AxisPictures, HorizontalWithTexts) {
  HorizontalSheet sheet;
  DrawHorizontal(sheet, true);
  if (!HasStoredFont()) {
    GTEST_SKIP() << "the letters here are not those of the stored picture";
  }
  ExpectPicture(sheet, "AxesXTexts");
}

TEST(AxisPictures, VerticalWithTexts) {
  VerticalSheet sheet;
  DrawVertical(sheet, true);
  if (!HasStoredFont()) {
    GTEST_SKIP() << "the letters here are not those of the stored picture";
  }
  ExpectPicture(sheet, "AxesYTexts");
}

}  // namespace
