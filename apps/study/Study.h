#ifndef VORL_APPS_STUDY_STUDY_H
#define VORL_APPS_STUDY_STUDY_H

/// @file
/// A volume with what is needed to show it in real units.

#include <study/Vec3.h>
#include <vorl/Data/dVolume.h>

#include <cstdint>
#include <optional>
#include <span>
#include <string>

namespace study {

/// One volume of a patient or an object.
///
/// *Values.* The slices hold unsigned 16-bit samples in one channel, rows without padding. The
/// sampling operators floor at 0, so values are stored with an offset: real = stored * scale +
/// offset, with the smallest value of the volume stored as 0. Windows and thresholds are converted
/// with `StoredValue` before the library sees them; read-outs show `RealValue`.
///
/// *Space.* World coordinates are patient coordinates in millimetres: x grows to the patient's
/// left, y to the back, z to the head. Voxel (i, j, k) covers the cell from (i, j, k) to (i + 1, j
/// + 1, k + 1) of the volume's coordinate system, so the system's origin is the outer corner of the
/// first voxel: its centre less half of each axis. The coordinates of slice k are the volume's with
/// the origin moved by k steps.
///
/// Studies are not copied: a copied volume would share its cached slice addresses.
struct Study {
  dVolume volume;
  double scale = 1;  ///< greater than 0
  double offset = 0;
  std::string unit;         ///< of the real values, such as "HU"; may be empty
  std::string modality;     ///< such as "CT"; may be empty
  std::string description;  ///< what it shows; names no patient
  double windowCentre = 0;  ///< the window to start with, in real values
  double windowWidth = 0;   ///< 0: none is known

  Study() = default;
  Study(const Study&) = delete;
  Study& operator=(const Study&) = delete;

  /// The real value of a stored one (or of a mean of stored ones).
  double RealValue(double stored) const { return stored * scale + offset; }
  /// The stored value of a real one; may lie between or outside the values that can be stored.
  double StoredValue(double real) const { return (real - offset) / scale; }
};

/// The largest width, height and number of slices: the operators step through the volume in 16.16
/// fixed point.
inline constexpr int kLargestVolumeSide = 32767;

/// What is wrong with a volume's placement: "is not finite", or a reason why the reconstruction
/// could not invert it (it takes a voxel of at most 1e-6 cubic millimetres for a flat one). Empty
/// when all is well.
std::string PlacementProblem(const dCoordSys3D& coordinates);

/// Appends a black slice of `width` x `height` unsigned 16-bit samples without padding and returns
/// its samples. Throws `Error` when there is no memory for it or it does not fit the others.
std::span<std::uint16_t> AppendSlice(Study& study, int width, int height);

/// The samples of a slice that was appended like that, or read from a file.
std::span<std::uint16_t> SamplesOf(dSlice& slice);
std::span<const std::uint16_t> SamplesOf(const dSlice& slice);

/// Places the volume and its slices: `firstVoxel` is the centre of voxel (0, 0, 0), the axes are
/// the steps from voxel to voxel. Throws `Error` with the `PlacementProblem`.
void PlaceVolume(Study& study, const Vec3& firstVoxel, const Vec3& axisX, const Vec3& axisY,
                 const Vec3& axisZ);

/// Conversions between the cells of the volume (voxel centres lie at .5) and the world.
Vec3 WorldFromVoxel(const Study& study, const Vec3& voxel);
Vec3 VoxelFromWorld(const Study& study, const Vec3& world);

/// The real value of the voxel whose cell contains the point; empty outside the volume.
std::optional<double> RealValueAt(const Study& study, const Vec3& world);

/// The library's vector in double precision and back.
inline Vec3 ToVec3(const dVect3D& v) {
  return {v.x, v.y, v.z};
}
inline dVect3D ToVect(const Vec3& v) {
  return {static_cast<float>(v.x), static_cast<float>(v.y), static_cast<float>(v.z)};
}

}  // namespace study

#endif
