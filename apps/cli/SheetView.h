#ifndef VORL_APPS_CLI_SHEETVIEW_H
#define VORL_APPS_CLI_SHEETVIEW_H

/// @file
/// One of the pictures of a sheet.

#include <cli/Render.h>
#include <cli/SheetCanvas.h>
#include <cli/SheetPlan.h>
#include <cli/SheetViewPort.h>
#include <cli/Statistics.h>
#include <cli/TextLayer.h>
#include <study/Planes.h>
#include <study/Progress.h>
#include <study/Study.h>
#include <vorl/Data/dDIB.h>
#include <vorl/GUI/Trafo1D.h>

#include <optional>
#include <string>

namespace cli {

/// What a view shows.
struct ViewContent {
  std::string name;       ///< such as "Axial"
  std::string shortName;  ///< where there is no room for that
  study::Plane plane = study::Plane::Axial;
  bool isProjection = false;  ///< of the whole volume's brightest voxels, instead of a cut
  Display display;
  study::Vec3 cursor;  ///< a point of the plane, and where the other planes meet it
  COLORREF colour = colour::kText;
  COLORREF acrossColour = colour::kText;  ///< of the plane that is seen as a horizontal line
  COLORREF downColour = colour::kText;    ///< of the one that is seen as a vertical line
};

/// Where it stands.
struct ViewPlace {
  tagRECT rect{};  ///< with the margins
  Margins margins;
  double mmPerPixel = 1;
  bool hasRulers = false;
};

/// What is measured in a view, and how the results read. Empty texts are not shown.
struct Measured {
  std::optional<PlaneLine> line;
  std::string lineText;
  std::optional<PlaneRect> region;
  std::string regionText;
};

/// A picture in its viewport, whose graphic coordinates are those of its plane in millimetres: the
/// image, sampled once for each pixel of the sheet, and what is drawn over and around it. Nothing
/// is seen before `Draw`.
class SheetView {
 public:
  /// Cuts the picture. `canvas` must outlive this. Throws `study::Error`.
  SheetView(study::Study& study, const SheetCanvas& canvas, const ViewContent& content,
            const ViewPlace& place, const study::Progress& progress);

  /// Adds the cursor, the rulers, the letters of the directions, the name and the window.
  void Annotate(const study::Study& study);
  /// Adds measured things; after `Annotate`, whose texts they keep clear of.
  void Show(const Measured& measured);
  void Draw();

 private:
  void MakeImage(study::Study& study, const study::Progress& progress);
  void AddFrame();
  void AddCursor();
  void AddRulers();
  void AddRuler(bool isHorizontal, UnitTrafo& unit);
  void AddLetters();
  void AddTitle(const study::Study& study);
  tagRECT AddLine(const PlaneLine& measured);
  tagRECT AddRegion(const PlaneRect& region);
  double Brightness(const tagRECT& rect) const;
  void WriteLabel(const std::string& text, const tagRECT& object);
  dVect2D GraphicAt(double pixelX, double pixelY) const;
  tagRECT PixelsOf(const PlaneRect& rect) const;

  const SheetCanvas& m_canvas;
  ViewContent m_content;
  ViewPlace m_place;
  tagRECT m_picture{};  ///< without the margins
  study::PlaneGeometry m_plane;
  PlaneFrame m_frame;
  PlaneRect m_shown;  ///< what `m_picture` shows
  dDIB m_image;
  int m_imageLeft = 0;  ///< its place in `m_picture`
  int m_imageTop = 0;
  UnitTrafo m_unitX, m_unitY;
  SheetViewPort m_viewPort;
  TextLayer m_texts, m_title;
};

/// How far the ticks of a ruler are from each other at least, in lines of text.
inline constexpr int kLinesPerTick = 4;

/// What a view must show of a study for all of it to be seen.
ViewExtent ExtentOf(const study::Study& study, study::Plane plane);
/// The patient's coordinate in the middle of the view, from top to bottom.
double MiddleDown(const study::Study& study, study::Plane plane);

}  // namespace cli

#endif
