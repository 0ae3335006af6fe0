// Curves in all modes and at several scales. From left to right: the polyline, bars and dots.
#include <vorl/GUI/VGCurve.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "ContactSheet.h"
#include "PictureTesting.h"

namespace {

using gui_testing::Cell;
using gui_testing::CellLook;
using gui_testing::ContactSheet;
using gui_testing::ExpectPicture;

using Values = std::vector<float>;

struct CurveLook {
  int thickness = 2;
  int style = PS_SOLID;
  double barOrigin = 0.0;
  bool isDragged = false;
};

/// A row of cells with one curve in the three modes.
void DrawModes(const ContactSheet& sheet, int row, Values values, float deltaX,
               const CurveLook& look, const CellLook& cellLook) {
  for (int column = 0; column < 3; ++column) {
    VGCurveView view;
    ASSERT_TRUE(view.SetData(4, deltaX, static_cast<int>(values.size()), values.data(),
                             CurveStorageMode_Reference));
    view.SetDrawMode(static_cast<CurveDrawMode>(CurveDrawMode_Polyline + column));
    view.SetBarOrigin(look.barOrigin);
    view.SetPenThickness(look.thickness);
    view.SetPenStyle(look.style);
    view.SetViewState(VGViewState_Visible);
    GraphicHandler handler;
    handler.AddObject(&view);
    Cell cell(sheet, column, row, handler, cellLook);
    if (look.isDragged) {
      cell.viewPort.SetFixedGraphicArea(false);
      cell.Down(20, 20);
      cell.Move(12, 30);
    }
    cell.Draw();
  }
}

TEST(CurvePictures, Curves) {
  Values wave;
  for (int i = 0; i < 23; ++i) {
    wave.push_back(20.0F + static_cast<float>(std::lround(14.0 * std::sin(i * 0.5))));
  }
  Values gaps = wave;
  for (const std::size_t i : {6U, 8U, 15U}) {
    gaps[i] = std::numeric_limits<float>::quiet_NaN();
  }
  gaps[22] = std::numeric_limits<float>::infinity();
  const CellLook upwards{1.0F, 0xFFFFFF, true};
  ContactSheet sheet(3, 6, 74, 40);
  DrawModes(sheet, 0, wave, 3, {}, upwards);
  DrawModes(sheet, 1, wave, 3, {1, PS_SOLID, 20.0}, upwards);
  DrawModes(sheet, 2, gaps, 3, {3, PS_SOLID, 8.0}, upwards);
  // Downwards and dotted, on black
  DrawModes(sheet, 3, wave, 3, {1, PS_DOT, 0.0}, {1.0F, 0x000000, false});
  // Enlarged, beyond the edges; a drag pans the viewport
  Values flat;
  for (const float value : wave) {
    flat.push_back(value / 4.0F);
  }
  DrawModes(sheet, 4, flat, 1, {2, PS_SOLID, 5.0, true}, {4.0F, 0xFFFFFF, true});
  // Closer together than pixels
  DrawModes(sheet, 5, wave, 0.5F, {1, PS_SOLID, 0.0}, upwards);
  ExpectPicture(sheet, "Curves");
}

}  // namespace
