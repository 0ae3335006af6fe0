#ifndef TESTS_OPERATORS_IP_KERNELS_SLABPICTURES_H
#define TESTS_OPERATORS_IP_KERNELS_SLABPICTURES_H

/// @file
/// Output slices of slabs, as the kernels see them.

#include <vorl/Operators/IP/kernels/Slab.h>
#include <vorl/Operators/IP/kernels/SlicePlane.h>

#include <cstddef>
#include <cstdint>
#include <ostream>

#include "PlaneSweep.h"

namespace slab_pictures {

using namespace plane_sweep;
using vorl_detail::SlabSamples;
using vorl_detail::SlicePlane;
using vorl_detail::VolumeView;

struct Picture {
  FixedVector start;
  FixedVector columnStep;
  FixedVector rowStep;
  FixedVector depth;
  std::int32_t depthSteps = 2;
  std::size_t width = 1;
  std::size_t height = 1;
};

inline std::ostream& operator<<(std::ostream& out, const Picture& picture) {
  return out << picture.width << " x " << picture.height << " pixels from "
             << row_cases::Text(picture.start) << ", columns "
             << row_cases::Text(picture.columnStep) << ", rows " << row_cases::Text(picture.rowStep)
             << ", slab " << row_cases::Text(picture.depth) << " in " << picture.depthSteps;
}

inline SlicePlane PlaneOf(const Picture& picture) {
  SlicePlane plane{dSlice(), dCoordSys3D(), 0.0};
  plane.start = picture.start;
  plane.columnStep = picture.columnStep;
  plane.rowStep = picture.rowStep;
  plane.depthStep = picture.depth;
  return plane;
}

}  // namespace slab_pictures

#endif
