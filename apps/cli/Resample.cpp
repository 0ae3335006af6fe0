#include <cli/Cuts.h>
#include <cli/Resample.h>
#include <cli/Statistics.h>
#include <cli/Watch.h>
#include <study/Planes.h>
#include <vorl/Operators/IP/opMPR.h>

#include <algorithm>
#include <cstddef>

namespace cli {
namespace {

using study::ToVec3;
using study::ToVect;

/// Steps of a whole pixel are that much longer, so that their fixed-point numbers, which are cut
/// off, do not fall behind by and by.
constexpr double kWholeStep = 1 + 5e-7;

std::unique_ptr<study::Study> Sample(study::Study& cut, const dCoordSys3D& place, int width,
                                     int height, const study::Progress& progress) {
  auto result = MakeCut(cut, width, height);
  dSlice& slice = *result->volume.GetSlice(0);
  slice.SetCoordinates(study::ForTrilinear(cut, place));
  opMPR op;
  op.volume = &cut.volume;
  op.mprSlice = &slice;
  op.SelectAlgo(MPRAlgo_Trilinear);
  RunWatched(op, progress, "interpolating the picture");
  CheckStatus(op, "interpolate the picture");
  PlaceCut(*result, place);
  return result;
}

/// The world's point in the middle of a cut's first pixel.
study::Vec3 FirstPixel(const dCoordSys3D& place) {
  return ToVec3(place.origin) +
         0.5 * (ToVec3(place.axisX) + ToVec3(place.axisY) + ToVec3(place.axisZ));
}

/// The cut with its first column and its first row doubled: interpolation begins at the centres of
/// the first pixels, and would leave their outer halves black.
std::unique_ptr<study::Study> Padded(const study::Study& cut) {
  const int width = static_cast<int>(cut.volume.GetSizeX());
  const int height = static_cast<int>(cut.volume.GetSizeY());
  auto padded = MakeCut(cut, width + 1, height + 1);
  const auto source = study::SamplesOf(cut.volume.GetSliceList().front());
  auto target = study::SamplesOf(*padded->volume.GetSlice(0)).begin();
  for (int j = 0; j <= height; ++j) {
    const auto row = source.begin() + std::ptrdiff_t{std::max(0, j - 1)} * width;
    *target++ = *row;
    target = std::copy(row, row + width, target);
  }
  dCoordSys3D place = cut.volume.GetCoordinates();
  place.origin = ToVect(FirstPixel(place) - ToVec3(place.axisX) - ToVec3(place.axisY));
  PlaceCut(*padded, place);
  return padded;
}

}  // namespace

std::unique_ptr<study::Study> Resample(study::Study& cut, const PixelRaster& raster,
                                       const study::Progress& progress) {
  const auto moved = [](const study::Vec3& point, const study::Vec3& direction, double position) {
    return point + direction * (position - Dot(point, direction));
  };
  const double first = 0.5 * raster.spacing;
  const auto padded = Padded(cut);
  const dCoordSys3D& source = padded->volume.GetCoordinates();
  const PlaneFrame frame(source);
  // Planes have no depth. Tiny pixels are given one with which they can be placed.
  constexpr double kLeastVolume = 1e-5;
  const double least = std::min(raster.spacing, Length(ToVec3(source.axisY)));
  const dVect3D depth =
      ToVect(frame.normal * std::max(Length(ToVec3(source.axisZ)), kLeastVolume / (least * least)));
  dCoordSys3D place;
  place.Set(ToVect(moved(FirstPixel(source), frame.right, raster.left + first)),
            ToVect(frame.right * raster.spacing), ToVect(ToVec3(source.axisY) * kWholeStep), depth);
  const auto wide =
      Sample(*padded, place, raster.width, static_cast<int>(padded->volume.GetSizeY()),
             study::PartOf(progress, 0, 0.5));
  const dCoordSys3D& between = wide->volume.GetCoordinates();
  place.Set(ToVect(moved(FirstPixel(between), frame.down, raster.top + first)),
            ToVect(ToVec3(between.axisX) * kWholeStep), ToVect(frame.down * raster.spacing), depth);
  return Sample(*wide, place, raster.width, raster.height, study::PartOf(progress, 0.5, 1));
}

}  // namespace cli
