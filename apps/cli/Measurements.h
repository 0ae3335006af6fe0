#ifndef VORL_APPS_CLI_MEASUREMENTS_H
#define VORL_APPS_CLI_MEASUREMENTS_H

/// @file
/// What a sheet measures on its axial plane, and how the results read.

#include <cli/SheetView.h>
#include <cli/Statistics.h>
#include <study/Progress.h>
#include <study/Study.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace cli {

/// Names and values, in the order in which they are shown.
using ResultTable = std::vector<std::pair<std::string, std::string>>;

/// What is to be measured, in the patient's millimetres; what is not given is found.
struct MeasureRequest {
  study::Vec3 cursor;
  std::optional<PlaneLine> line;
  std::optional<PlaneRect> region;
};

/// Measures on the axial plane through the cursor. Lengths follow from the coordinates; statistics
/// are those of the voxels that the plane meets, whose centres lie in the rectangle. Throws
/// `study::Error`.
Measured Measure(study::Study& study, const MeasureRequest& request, ResultTable& results,
                 const study::Progress& progress);

}  // namespace cli

#endif
