#ifndef VORL_APPS_CLI_CUTS_H
#define VORL_APPS_CLI_CUTS_H

/// @file
/// What cuts through a volume and projections of it have in common.

#include <study/Planes.h>
#include <study/Study.h>

#include <memory>

namespace cli {

/// The operators walk the volume in 16.16 fixed point; beyond its range they would wrap around and
/// show the volume again. Throws `study::Error` when the plane, `thickness` millimetres thick,
/// reaches so far.
void CheckReach(const study::Study& study, const study::PlaneGeometry& plane, double thickness);

/// A black slice that takes samples of `study`: with its scale, offset, unit, modality and
/// description. Throws `study::Error` when there is no memory for it.
std::unique_ptr<study::Study> MakeCut(const study::Study& study, int width, int height);

/// Places a cut where its plane lies, whose origin is the centre of the first pixel.
void PlaceCut(study::Study& cut, const dCoordSys3D& plane);

/// The whole plane through a point with the voxels that it meets as pixels: as far apart as they
/// are in the directions to the right and down.
study::PlaneRequest VoxelPlane(const study::Study& study, study::Plane plane,
                               const study::Vec3& centre);

/// How many voxels a millimetre in the direction of a unit vector crosses, counted along the
/// volume's axis on which it crosses most.
double VoxelsPerMillimetre(const study::Study& study, const study::Vec3& direction);

}  // namespace cli

#endif
