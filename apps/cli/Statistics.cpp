#include <cli/Statistics.h>

#include <algorithm>
#include <cmath>

namespace cli {

PlaneFrame::PlaneFrame(const dCoordSys3D& plane)
    : right(study::Normalised(study::ToVec3(plane.axisX))),
      down(study::Normalised(study::ToVec3(plane.axisY))),
      normal(study::Normalised(study::ToVec3(plane.axisZ))) {}

PixelGrid::PixelGrid(const study::Study& cut)
    : spacing(Length(study::ToVec3(cut.volume.GetCoordinates().axisX))),
      spacingDown(Length(study::ToVec3(cut.volume.GetCoordinates().axisY))),
      width(cut.volume.GetSizeX()),
      height(cut.volume.GetSizeY()) {
  const PlaneFrame frame(cut.volume.GetCoordinates());
  const study::Vec3 corner = study::ToVec3(cut.volume.GetCoordinates().origin);
  left = frame.X(corner);
  top = frame.Y(corner);
}

// The sums are those of distances to one of them: squares of the values themselves would
// lose the small digits.
Statistics StatisticsOf(const study::Study& cut, const PlaneRect& rect) {
  const PixelGrid grid(cut);
  const auto samples = study::SamplesOf(cut.volume.GetSliceList().front());
  Statistics result;
  double first = 0;
  double sum = 0;
  double squares = 0;
  for (int j = 0; j < grid.height; ++j) {
    if (grid.CentreY(j) < rect.top || grid.CentreY(j) >= rect.bottom) {
      continue;
    }
    for (int i = 0; i < grid.width; ++i) {
      if (grid.CentreX(i) < rect.left || grid.CentreX(i) >= rect.right) {
        continue;
      }
      const double value =
          cut.RealValue(samples[static_cast<std::size_t>(j) * static_cast<std::size_t>(grid.width) +
                                static_cast<std::size_t>(i)]);
      if (result.count == 0) {
        first = result.minimum = result.maximum = value;
      }
      ++result.count;
      sum += value - first;
      squares += (value - first) * (value - first);
      result.minimum = std::min(result.minimum, value);
      result.maximum = std::max(result.maximum, value);
    }
  }
  if (result.count > 0) {
    const double shift = sum / static_cast<double>(result.count);
    result.mean = first + shift;
    result.deviation =
        std::sqrt(std::max(0.0, squares / static_cast<double>(result.count) - shift * shift));
  }
  return result;
}

}  // namespace cli
