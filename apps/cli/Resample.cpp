#include <cli/Cuts.h>
#include <cli/Resample.h>
#include <cli/Statistics.h>
#include <cli/Watch.h>
#include <study/Planes.h>
#include <vorl/Operators/IP/opMPR.h>

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

}  // namespace

std::unique_ptr<study::Study> Resample(study::Study& cut, const PixelRaster& raster,
                                       const study::Progress& progress) {
  const auto moved = [](const study::Vec3& point, const study::Vec3& direction, double position) {
    return point + direction * (position - Dot(point, direction));
  };
  const double first = 0.5 * raster.spacing;
  const dCoordSys3D& source = cut.volume.GetCoordinates();
  const PlaneFrame frame(source);
  dCoordSys3D place;
  place.Set(ToVect(moved(FirstPixel(source), frame.right, raster.left + first)),
            ToVect(frame.right * raster.spacing), ToVect(ToVec3(source.axisY) * kWholeStep),
            source.axisZ);
  const auto wide = Sample(cut, place, raster.width, static_cast<int>(cut.volume.GetSizeY()),
                           study::PartOf(progress, 0, 0.5));
  const dCoordSys3D& between = wide->volume.GetCoordinates();
  place.Set(ToVect(moved(FirstPixel(between), frame.down, raster.top + first)),
            ToVect(ToVec3(between.axisX) * kWholeStep), ToVect(frame.down * raster.spacing),
            between.axisZ);
  return Sample(*wide, place, raster.width, raster.height, study::PartOf(progress, 0.5, 1));
}

}  // namespace cli
