#include <cli/Cuts.h>
#include <cli/Measurements.h>
#include <cli/Render.h>
#include <cli/Tissue.h>
#include <cli/Values.h>
#include <vorl/GUI/VGLine.h>

#include <algorithm>

namespace cli {
namespace {

std::string Fixed(double value, int decimals, const std::string& unit) {
  std::string text = FixedText(value, decimals);
  return unit.empty() ? text : text.append(" ").append(unit);
}

double LengthOf(const PlaneLine& line) {
  VGLine measured;
  measured.Init(dVect2D(static_cast<float>(line.start.x), static_cast<float>(line.start.y)),
                dVect2D(static_cast<float>(line.end.x), static_cast<float>(line.end.y)),
                TLine_Segment);
  return static_cast<double>(measured.GetLength());
}

}  // namespace

Measured Measure(study::Study& study, const MeasureRequest& request, ResultTable& results,
                 const study::Progress& progress) {
  const auto cut =
      CutPlane(study, {VoxelPlane(study, study::Plane::Axial, request.cursor)}, progress);
  Measured measured{request.line, {}, request.region, {}};
  if (!measured.line || !measured.region) {
    const Tissue tissue(*cut);
    const PlanePoint cursor{request.cursor.x, request.cursor.y};
    if (!measured.line) {
      measured.line = tissue.LineAcross(cursor);
    }
    if (!measured.region) {
      measured.region = tissue.EvenRect(cursor, measured.line);
    }
  }
  // Tenths, or more decimals where voxels or the steps between values are smaller than that.
  const PixelGrid grid(*cut);
  const int lengths = std::max(1, DecimalsFor(std::min(grid.spacing, grid.spacingDown)));
  const int values = DecimalsFor(study.scale) + 1;
  if (measured.line) {
    measured.lineText = Fixed(LengthOf(*measured.line), lengths, "mm");
    results.emplace_back("Line", measured.lineText);
  }
  if (!measured.region) {
    return measured;
  }
  const PlaneRect& region = *measured.region;
  const Statistics statistics = StatisticsOf(*cut, region);
  results.emplace_back("Region", Fixed(region.right - region.left, lengths, {}) + " x " +
                                     Fixed(region.bottom - region.top, lengths, "mm"));
  results.emplace_back("Voxels", std::to_string(statistics.count));
  if (statistics.count > 0) {
    const std::string mean = Fixed(statistics.mean, values, study.unit);
    const std::string deviation = Fixed(statistics.deviation, values, study.unit);
    results.emplace_back("Mean", mean);
    results.emplace_back("SD", deviation);
    results.emplace_back("Range", NumberText(statistics.minimum) + " to " +
                                      NumberText(statistics.maximum) +
                                      (study.unit.empty() ? "" : " ") + study.unit);
    measured.regionText = "Mean " + mean + "\nSD " + deviation;
  }
  return measured;
}

}  // namespace cli
