#ifndef VORL_APPS_CLI_SHEETVIEWPORT_H
#define VORL_APPS_CLI_SHEETVIEWPORT_H

/// @file
/// A rectangle of a sheet that shows a part of some plane.

#include <cli/SheetCanvas.h>
#include <cli/SheetPlan.h>
#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>

namespace cli {

/// A viewport with two layers: what lies in the picture is clipped to it, what lies around it may
/// also stand in the margins.
class SheetViewPort {
 public:
  /// `canvas` must outlive this.
  explicit SheetViewPort(const SheetCanvas& canvas) : m_canvas(canvas) {}

  /// Shows a rectangle of the graphic plane in a rectangle of the sheet without its margins. Not
  /// `isProportional`: as large as that is in both directions.
  void Place(const Rect2D& shown, const tagRECT& rect, const Margins& margins, bool isProportional);
  GraphicHandler& Inside() { return m_inside; }
  GraphicHandler& Around() { return m_around; }
  const GraphicViewPort& GetViewPort() const { return m_viewPort; }
  /// Draws background, what lies in the picture, and what lies around it.
  void Draw();

 private:
  const SheetCanvas& m_canvas;
  GraphicHandler m_inside;
  GraphicHandler m_around;
  GraphicViewPort m_viewPort;
};

/// What is left of a rectangle within its margins.
tagRECT WithoutMargins(const tagRECT& rect, const Margins& margins);

}  // namespace cli

#endif
