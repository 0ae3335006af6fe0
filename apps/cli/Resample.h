#ifndef VORL_APPS_CLI_RESAMPLE_H
#define VORL_APPS_CLI_RESAMPLE_H

/// @file
/// Cuts in another resolution.

#include <study/Progress.h>
#include <study/Study.h>

#include <memory>

namespace cli {

/// Square pixels on a plane, in its own coordinates in millimetres (see `PlaneFrame`).
struct PixelRaster {
  double left = 0;  ///< outer edges
  double top = 0;
  double spacing = 1;
  int width = 1;
  int height = 1;
};

/// The cut interpolated for other pixels of its plane, first along its rows and then along its
/// columns. From the centres of the outermost pixels to the cut's edges
/// it goes on as it is there; half a pixel further out it is 0. Throws `study::Error`.
///
/// The reconstruction's own interpolation goes wrong at edges where a point lies between voxels in
/// both directions of a slice at once; in one direction at a time it is exact.
std::unique_ptr<study::Study> Resample(study::Study& cut, const PixelRaster& raster,
                                       const study::Progress& progress);

}  // namespace cli

#endif
