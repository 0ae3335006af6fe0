#ifndef VORL_APPS_CLI_SHEET_H
#define VORL_APPS_CLI_SHEET_H

/// @file
/// A study on one page.

#include <cli/Measurements.h>
#include <cli/Render.h>
#include <cli/SheetCanvas.h>
#include <cli/SheetPlan.h>
#include <study/Progress.h>
#include <study/Study.h>

#include <array>

namespace cli {

/// What is drawn, and how.
struct SheetContent {
  int width = 1600;
  int height = 1200;
  SheetLayout layout = SheetLayout::Grid;
  bool isAnnotated = true;
  Display display;              ///< of the planes
  RealWindow projectionWindow;  ///< of the projection, whose other grey levels are the planes'
  study::Vec3 cursor;           ///< where the planes meet
  Measured measured;            ///< on the axial plane
  ResultTable results;          ///< for the table beside the histogram
};

/// Draws three planes through the cursor, a projection from the front, and the histogram of a study
/// on a canvas of the sheet's size. Throws `study::Error`.
void DrawSheet(study::Study& study, const SheetContent& content, const SheetCanvas& canvas,
               const study::Progress& progress);

}  // namespace cli

#endif
