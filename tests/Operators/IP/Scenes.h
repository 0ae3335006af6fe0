#ifndef TESTS_OPERATORS_IP_SCENES_H
#define TESTS_OPERATORS_IP_SCENES_H

/// @file
/// Random volumes and planes that stress the volume operators.

#include <array>
#include <sstream>
#include <string>

#include "GuardedVolume.h"

namespace rasters {

enum class Voxels { Any, Extreme, Small };

/// Replaces the pixels, padding included, by values that stress the arithmetic.
inline void SetVoxels(dImage& image, Voxels kind, Random& random) {
  static constexpr std::array<std::uint16_t, 5> kExtremes = {0, 1, 0x7FFF, 0x8000, 0xFFFF};
  auto* samples = static_cast<std::uint16_t*>(image.GetDataPtr());
  for (unsigned long i = 0; i < image.GetNumDataSamples(); ++i) {
    if (kind == Voxels::Extreme) {
      samples[i] = random.Pick(kExtremes);
    } else if (kind == Voxels::Small) {
      samples[i] = static_cast<std::uint16_t>(random.Between(-3, 100));
    }
  }
}

/// 1 to `largest`; at least one in five is 1.
inline unsigned long RandomSize(Random& random, int largest) {
  return random.Between(0, 4) == 0 ? 1UL : static_cast<unsigned long>(random.Between(1, largest));
}

inline unsigned short RandomAlignment(Random& random) {
  static constexpr std::array<unsigned short, 4> kAlignments = {1, 2, 8, 32};
  return random.Pick(kAlignments);
}

inline float Quarter(Random& random, int low, int high) {
  return static_cast<float>(random.Between(low * 4, high * 4)) / 4.0F;
}

inline dVect3D RandomVector(Random& random) {
  const auto component = [&] { return static_cast<float>(random.Between(-2500, 2500)) / 1000.0F; };
  const float x = component(), y = component(), z = component();
  return dVect3D(x, y, z);
}

/// Upright, scaled or mirrored, askew, or, rarely, without one of its axes.
inline void RandomAxes(dCoordSys3D& system, Random& random) {
  static constexpr std::array<float, 8> kScales = {1, 0.25F, 2, 0.5F, -1, -0.25F, 0.1F, 30};
  switch (random.Between(0, 4)) {
    case 0:
      break;
    case 1:
    case 2:
      system.axisX *= random.Pick(kScales);
      system.axisY *= random.Pick(kScales);
      system.axisZ *= random.Pick(kScales);
      if (random.Between(0, 2) == 0) {
        std::swap(system.axisX, system.axisZ);
      }
      break;
    default:
      system.axisX = RandomVector(random);
      system.axisY = RandomVector(random);
      system.axisZ = RandomVector(random);
  }
  if (random.Between(0, 15) == 0) {
    dVect3D* const axes[] = {&system.axisX, &system.axisY, &system.axisZ};
    *axes[random.Between(0, 2)] = dVect3D(0, 0, 0);
  }
}

/// Fills the volume with up to 14 x 11 x 9 voxels of any kind, in allocations of just their size,
/// and places it in space.
inline void MakeRandomVolume(GuardedVolume& volume, unsigned short type, Random& random) {
  const Format slices = {.width = RandomSize(random, 14),
                         .height = RandomSize(random, 11),
                         .type = type,
                         .alignment = RandomAlignment(random)};
  AddRandomSlices(volume, slices, static_cast<int>(RandomSize(random, 9)), random);
  const auto kind = static_cast<Voxels>(random.Between(0, 2));
  for (dSlice& slice : volume.GetSliceList()) {
    SetVoxels(slice.GetImage(), kind, random);
  }
  volume.Surround(Around::Nothing, false);
  RandomAxes(volume.GetCoordinates(), random);
  volume.GetCoordinates().origin = RandomVector(random);
  volume.GetCoordinates().origin *= random.Between(0, 1) * 100.0;
}

/// Gives the plane axes relative to the volume's, or free ones; some pixel of it lies at a point in
/// or around the volume, often on a voxel's border.
inline void PlacePlane(dSlice& slice, const dVolume& volume, Random& random) {
  dCoordSys3D& plane = slice.GetCoordinates();
  if (random.Between(0, 3) != 0) {
    plane = volume.GetCoordinates();
  }
  RandomAxes(plane, random);
  dVect3D point(Quarter(random, 0, volume.GetSizeX()), Quarter(random, 0, volume.GetSizeY()),
                Quarter(random, 0, volume.GetSizeZ()));
  if (random.Between(0, 1) == 0) {
    point += RandomVector(random);
  }
  volume.GetCoordinates().pCS2W(point, plane.origin);
  plane.origin -= plane.axisX * random.Between(0, slice.GetWidth());
  plane.origin -= plane.axisY * random.Between(0, slice.GetHeight());
}

/// Sizes and places, for the text of a failure.
inline std::string TextOf(const dVolume& volume, const dSlice& slice) {
  std::ostringstream text;
  const auto put = [&](const char* name, const dVect3D& v) {
    text << ", " << name << " (" << v.x << ' ' << v.y << ' ' << v.z << ')';
  };
  text << volume.GetSizeX() << " x " << volume.GetSizeY() << " x " << volume.GetSizeZ() << " to "
       << slice.GetWidth() << " x " << slice.GetHeight();
  const dCoordSys3D& plane = slice.GetCoordinates();
  put("at", plane.origin);
  put("axisX", plane.axisX);
  put("axisY", plane.axisY);
  put("axisZ", plane.axisZ);
  return text.str();
}

}  // namespace rasters

#endif
