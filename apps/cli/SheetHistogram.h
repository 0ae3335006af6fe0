#ifndef VORL_APPS_CLI_SHEETHISTOGRAM_H
#define VORL_APPS_CLI_SHEETHISTOGRAM_H

/// @file
/// The histogram of a sheet.

#include <cli/Histogram.h>
#include <cli/SheetCanvas.h>
#include <cli/SheetViewPort.h>
#include <cli/TextLayer.h>
#include <cli/Windows.h>
#include <study/Study.h>
#include <vorl/GUI/Trafo1D.h>

namespace cli {

/// How many voxels have which value, as a curve over an axis with real values, and the window as a
/// line from black to white.
///
/// *Scaling.* Heights are logarithmic: air around a body counts a thousand times as much as an
/// organ and leaves it visible nevertheless. The axis leaves out one voxel in 100,000 at either
/// end. Graphic coordinates are stored values, and heights from 0 to -1, the upper end.
class SheetHistogram {
 public:
  /// `canvas` must outlive this.
  SheetHistogram(const study::Study& study, const RealWindow& window, const SheetCanvas& canvas,
                 const tagRECT& rect);
  void Draw();

 private:
  void AddMargins(const study::Study& study);
  void PlaceViewPort();
  void AddCurve(const Histogram& counts);
  void AddFrame();
  void AddWindow(double low, double high);
  void AddAxis(const study::Study& study);

  const SheetCanvas& m_canvas;
  tagRECT m_rect;
  tagRECT m_picture{};  ///< without the margins
  double m_first = 0;   ///< the stored values at the ends
  double m_last = 1;
  UnitTrafo m_unit;
  SheetViewPort m_viewPort;
  TextLayer m_title;
};

}  // namespace cli

#endif
