#include <cli/Cuts.h>
#include <cli/Mip.h>
#include <cli/Watch.h>
#include <vorl/Operators/IP/opMIP.h>

#include <algorithm>
#include <cmath>

namespace cli {
namespace {

using study::Vec3;

/// So much of a layer or pixel is rounding and deserves no other one.
constexpr double kRounding = 1e-3;

/// The interpolated value is kept for a cell's lower corner, where rounding decides whether a
/// sample still lies inside the volume. So much of a voxel brings it safely inside.
constexpr double kIntoVoxel = 1.0 / 2048;

/// The plane in the middle of its slab, which is as thick as axisZ, and the samples across.
struct Slab {
  study::PlaneGeometry plane;
  double thickness = 0;
  int samples = 2;
};

Slab PlaceSlab(const study::Study& study, const study::PlaneRequest& request) {
  Slab slab;
  slab.plane = study::MakePlane(study, request);
  dCoordSys3D& place = slab.plane.coordinates;
  const Vec3 normal = study::Normalised(study::ToVec3(place.axisZ));
  const double density = VoxelsPerMillimetre(study, normal);
  const auto layersOf = [density](double mm) {
    return static_cast<int>(std::ceil(mm * density - kRounding));
  };
  slab.thickness = request.thickness;
  if (request.thickness > 0) {
    slab.samples = std::max(2, layersOf(request.thickness) + 1);
    return slab;
  }
  // One layer from sample to sample, the first and the last outside.
  const study::Extent extent = study::ExtentAlong(study, normal);
  slab.samples = layersOf(extent.maximum - extent.minimum) + 2;
  slab.thickness = (slab.samples - 1) / density;
  const Vec3 origin = study::ToVec3(place.origin);
  const double middle = 0.5 * (extent.minimum + extent.maximum);
  place.origin = study::ToVect(origin + normal * (middle - Dot(origin, normal)));
  place.axisZ = study::ToVect(normal * slab.thickness);
  return slab;
}

dCoordSys3D ForLinear(const study::Study& study, const dCoordSys3D& plane) {
  const dCoordSys3D& volume = study.volume.GetCoordinates();
  dCoordSys3D moved = study::ForTrilinear(study, plane);
  const Vec3 diagonal =
      study::ToVec3(volume.axisX) + study::ToVec3(volume.axisY) + study::ToVec3(volume.axisZ);
  moved.origin = study::ToVect(study::ToVec3(moved.origin) + diagonal * kIntoVoxel);
  return moved;
}

/// Pixels that show the extent when `centre` is in the middle of the picture.
int PixelsAround(const study::Extent& extent, double centre, double spacing) {
  const double reach = std::max(extent.maximum - centre, centre - extent.minimum);
  const double pixels = std::ceil(2 * reach / spacing - kRounding);
  return static_cast<int>(std::clamp(pixels, 1.0, 1.0 + study::kLargestVolumeSide));
}

}  // namespace

std::unique_ptr<study::Study> ProjectMaximum(study::Study& study, const MipRequest& request,
                                             const study::Progress& progress) {
  const Slab slab = PlaceSlab(study, request.plane);
  CheckReach(study, slab.plane, slab.thickness);
  auto cut = MakeCut(study, slab.plane.width, slab.plane.height);
  dSlice& slice = *cut->volume.GetSlice(0);
  const dCoordSys3D& place = slab.plane.coordinates;
  slice.SetCoordinates(request.linear ? ForLinear(study, place) : place);
  opMIP op;
  op.volume = &study.volume;
  op.mipSlice = &slice;
  op.SelectAlgo(request.linear ? MIPAlgo_Trilinear : MIPAlgo_Nearest);
  op.SetDepthSteps(slab.samples);
  RunWatched(op, progress, "projecting the volume");
  CheckStatus(op, "project the volume");
  PlaceCut(*cut, place);
  study::Report(progress, 1, "projecting the volume");
  return cut;
}

std::vector<study::PlaneRequest> TurntablePlanes(const study::Study& study,
                                                 const study::PlaneRequest& first, int count) {
  study::PlaneRequest pixel = first;
  pixel.width = pixel.height = 1;
  int width = 1;
  int height = 1;
  std::vector<study::PlaneRequest> views;
  for (int i = 0; i < count; ++i) {
    pixel.turnAboutBodyAxis = 360.0 * i / count;
    views.push_back(pixel);
    // A picture of one pixel has it in the centre of the plane.
    const study::PlaneGeometry plane = study::MakePlane(study, pixel);
    const Vec3 centre = study::ToVec3(plane.coordinates.origin);
    const Vec3 right = study::Normalised(study::ToVec3(plane.coordinates.axisX));
    const Vec3 down = study::Normalised(study::ToVec3(plane.coordinates.axisY));
    width = std::max(
        width, PixelsAround(study::ExtentAlong(study, right), Dot(centre, right), plane.spacing));
    height = std::max(
        height, PixelsAround(study::ExtentAlong(study, down), Dot(centre, down), plane.spacing));
  }
  for (study::PlaneRequest& view : views) {
    view.width = first.width > 0 ? first.width : width;
    view.height = first.height > 0 ? first.height : height;
  }
  return views;
}

}  // namespace cli
