#ifndef VORL_APPS_CLI_RENDER_H
#define VORL_APPS_CLI_RENDER_H

/// @file
/// From a volume to a picture.

#include <cli/Windows.h>
#include <study/Planes.h>
#include <study/Progress.h>
#include <study/Study.h>

#include <memory>

namespace cli {

/// What is cut out of a volume, and how.
struct CutRequest {
  study::PlaneRequest plane;
  bool linear = false;  ///< trilinear interpolation instead of the nearest voxel
  int steps = 0;        ///< samples across the slab; 0: one per voxel
};

/// The plane as a study of one slice: its samples are those of the reconstruction as they are, with
/// the volume's scale, offset and unit, and its coordinates lie where the plane does. The samples
/// of a slab are the means across its thickness. Points outside the volume are 0, which is the
/// volume's smallest value. Throws `study::Error`.
std::unique_ptr<study::Study> CutPlane(study::Study& study, const CutRequest& request,
                                       const study::Progress& progress);

/// True when the plane, with its thickness, may meet the volume; false when it certainly does not.
bool MeetsVolume(const study::Study& study, const study::Study& cut);

/// How grey levels follow from samples.
struct Display {
  RealWindow window;
  double brightness = 0;  ///< -1 to 1
  double contrast = 0;    ///< -1 to 1
  double gamma = 1;       ///< 0.01 to 10
};

/// The slice of `cut` as an 8-bit grey picture. Throws `study::Error`.
void MakePicture(study::Study& cut, const Display& display, dImage& picture);

}  // namespace cli

#endif
