#ifndef BENCH_PLANES_H
#define BENCH_PLANES_H

/// @file
/// Planes of 512 x 512 pixels through the middle of the volume.

#include "Fixtures.h"

namespace bench {

inline constexpr unsigned long kPlaneEdge = 512;

/// Steps in voxels. Those along z are scaled by slices over columns, so that an upright plane spans
/// the volume.
struct Plane {
  const char* name;
  dVect3D axisX;   ///< per pixel
  dVect3D axisY;   ///< per row
  dVect3D normal;  ///< through a slab of 16 voxels; not scaled
};

inline const Plane kPlanes[] = {{"axial", dVect3D(1, 0, 0), dVect3D(0, 1, 0), dVect3D(0, 0, 16)},
                                {"coronal", dVect3D(1, 0, 0), dVect3D(0, 0, 1), dVect3D(0, 16, 0)},
                                {"sagittal", dVect3D(0, 1, 0), dVect3D(0, 0, 1), dVect3D(16, 0, 0)},
                                {"oblique", dVect3D(0.64F, 0.48F, 0.36F),
                                 dVect3D(-0.48F, 0.64F, 0.48F), dVect3D(0, -9.6F, 12.8F)}};

/// Formats the slice and places it; `thickness` multiplies the slab.
inline void MakePlane(dSlice& slice, const Plane& plane, const dVolume& volume,
                      double thickness = 1.0) {
  MakeImage(slice.GetImage(), kPlaneEdge, ImageDataType_U16);
  const double slices = static_cast<double>(volume.GetSizeZ()) / volume.GetSizeX();
  dVect3D axisX = plane.axisX;
  dVect3D axisY = plane.axisY;
  axisX.Scale(1.0, 1.0, slices);
  axisY.Scale(1.0, 1.0, slices);
  dVect3D corner;
  volume.GetVolCenter(corner);
  corner -= axisX * (0.5 * slice.GetWidth());
  corner -= axisY * (0.5 * slice.GetHeight());
  slice.SetCoordinates(corner, axisX, axisY, plane.normal * thickness);
}

/// A copy of as many bytes as a plane has.
inline void PlaneMemcpy(benchmark::State& state) {
  Memcpy(state, Shrunk(kPlaneEdge) * Shrunk(kPlaneEdge) * sizeof(std::uint16_t));
}

/// A list of a million voxels of the volume, in the order in which a selection lists them.
inline void MakeList(dBuffer& list, const dVolume& volume) {
  const auto width = static_cast<std::uint32_t>(volume.GetSizeX());
  const auto height = static_cast<std::uint32_t>(volume.GetSizeY());
  const auto depth = static_cast<std::uint32_t>(volume.GetSizeZ());
  const auto count = static_cast<std::uint32_t>(Shrunk(1000000));
  const std::uint64_t voxels = std::uint64_t{width} * height * depth;
  list.New(count * 4UL, false);
  for (std::uint32_t i = 0; i < count; ++i) {
    const auto voxel = static_cast<std::uint32_t>(voxels * i / count);
    const std::uint32_t entry =
        (voxel / width / height << 22) | (voxel / width % height << 11) | voxel % width;
    std::memcpy(list.Get(i * 4UL), &entry, sizeof(entry));
  }
}

}  // namespace bench

#endif
