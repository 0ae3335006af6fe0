#ifndef VORL_APPS_CLI_SHEETPLAN_H
#define VORL_APPS_CLI_SHEETPLAN_H

/// @file
/// Where the parts of a sheet stand.

#include <vorl/Platform/Gdi.h>

#include <array>
#include <cstddef>
#include <optional>
#include <string>

namespace cli {

/// How the four views of a sheet are arranged.
enum class SheetLayout {
  Grid,    ///< two above two
  Row,     ///< side by side
  Column,  ///< one below the other
  Main     ///< the first one large, the others beside it, one below the other
};

/// "2x2", "row", "column" and "main"; empty for any other name.
std::optional<SheetLayout> FindLayout(const std::string& name);
/// The names with commas between them.
std::string LayoutList();

inline constexpr std::size_t kViewCount = 4;

/// What a view shows, in millimetres.
struct ViewExtent {
  double width = 0;
  double height = 0;
};

/// What stands around a picture, in pixels.
struct Margins {
  int left = 0;
  int top = 0;
  int right = 0;
  int bottom = 0;
};

struct SheetRequest {
  int width = 0;
  int height = 0;
  SheetLayout layout = SheetLayout::Grid;
  /// The views in the order axial, projection, coronal, sagittal.
  std::array<ViewExtent, kViewCount> extents;
  int lineHeight = 0;   ///< of the text
  int penWidth = 1;     ///< of the pictures' outlines
  int rulerWidth = 0;   ///< what a vertical ruler takes
  int rulerHeight = 0;  ///< what a horizontal one takes
  bool isAnnotated = true;
};

/// The places of all parts, in pixels. Parts for which there is no room are left out: their
/// rectangles are empty.
struct SheetPlan {
  bool hasRulers = false;
  Margins margins;                        ///< within each view
  std::array<tagRECT, kViewCount> views;  ///< with their margins
  std::array<double, kViewCount> mmPerPixel{};
  tagRECT header{};
  tagRECT panel{};  ///< for the histogram and the measured values
};

/// Plans a sheet. All pictures but the large one of `SheetLayout::Main` have the same millimetres
/// per pixel. The panel stands beside the views or below them, where it leaves the first one
/// larger. On small sheets the header goes first, then the panel, then the rulers.
SheetPlan PlanSheet(const SheetRequest& request);

/// Nothing lies in it.
inline bool IsEmptyRect(const tagRECT& rect) {
  return rect.right <= rect.left || rect.bottom <= rect.top;
}

}  // namespace cli

#endif
