#ifndef VORL_APPS_CLI_MIP_H
#define VORL_APPS_CLI_MIP_H

/// @file
/// Maximum intensity projections: pictures of the brightest voxels on each ray.

#include <study/Planes.h>
#include <study/Progress.h>
#include <study/Study.h>

#include <memory>
#include <vector>

namespace cli {

/// What is projected, and how.
struct MipRequest {
  study::PlaneRequest plane;  ///< its thickness is that of the slab; 0: the whole volume
  bool linear = false;        ///< trilinear interpolation instead of the nearest voxel
};

/// The projection as a study of one slice with the volume's scale, offset and unit. Samples are so
/// dense that a ray meets every layer of voxels it crosses; the whole volume, seen along one of its
/// axes, is sampled at the voxels' centres. Rays that miss the volume are 0, its smallest value.
/// Throws `study::Error`.
std::unique_ptr<study::Study> ProjectMaximum(study::Study& study, const MipRequest& request,
                                             const study::Progress& progress);

/// `count` views around the patient's axis from feet to head through the plane's centre, the first
/// as requested, the next seen from further to the patient's left. All have the same size: the one
/// requested, or the smallest that holds the whole volume in every view.
std::vector<study::PlaneRequest> TurntablePlanes(const study::Study& study,
                                                 const study::PlaneRequest& first, int count);

}  // namespace cli

#endif
