#include <cli/Cuts.h>
#include <study/Error.h>

#include <algorithm>
#include <cmath>
#include <string>

namespace cli {

void CheckReach(const study::Study& study, const study::PlaneGeometry& plane, double thickness) {
  using study::ToVec3;
  const study::Vec3 depth = study::Normalised(ToVec3(plane.coordinates.axisZ)) * (0.5 * thickness);
  for (int corner = 0; corner < 8; ++corner) {
    const study::Vec3 point = ToVec3(plane.coordinates.origin) +
                              ToVec3(plane.coordinates.axisX) * ((corner & 1) * plane.width) +
                              ToVec3(plane.coordinates.axisY) * ((corner >> 1 & 1) * plane.height) +
                              depth * ((corner & 4) != 0 ? 1.0 : -1.0);
    const study::Vec3 voxel = study::VoxelFromWorld(study, point);
    if (std::max({std::abs(voxel.x), std::abs(voxel.y), std::abs(voxel.z)}) >
        study::kLargestVolumeSide) {
      throw study::Error("the plane reaches more than " +
                         std::to_string(study::kLargestVolumeSide) + " voxels away");
    }
  }
}

std::unique_ptr<study::Study> MakeCut(const study::Study& study, int width, int height) {
  auto cut = std::make_unique<study::Study>();
  study::AppendSlice(*cut, width, height);
  cut->scale = study.scale;
  cut->offset = study.offset;
  cut->unit = study.unit;
  cut->modality = study.modality;
  cut->description = study.description;
  return cut;
}

void PlaceCut(study::Study& cut, const dCoordSys3D& plane) {
  study::PlaceVolume(cut, study::ToVec3(plane.origin), study::ToVec3(plane.axisX),
                     study::ToVec3(plane.axisY), study::ToVec3(plane.axisZ));
}

study::PlaneRequest VoxelPlane(const study::Study& study, study::Plane plane,
                               const study::Vec3& centre) {
  study::PlaneRequest request;
  request.plane = plane;
  request.width = request.height = 1;
  const dCoordSys3D place = MakePlane(study, request).coordinates;
  const auto step = [&study](const dVect3D& axis) {
    return 1 / VoxelsPerMillimetre(study, study::Normalised(study::ToVec3(axis)));
  };
  request.centre = centre;
  request.width = request.height = 0;
  request.spacing = step(place.axisX);
  request.spacingDown = step(place.axisY);
  return request;
}

double VoxelsPerMillimetre(const study::Study& study, const study::Vec3& direction) {
  const study::Vec3 step =
      study::VoxelFromWorld(study, direction) - study::VoxelFromWorld(study, {});
  return std::max({std::abs(step.x), std::abs(step.y), std::abs(step.z)});
}

}  // namespace cli
