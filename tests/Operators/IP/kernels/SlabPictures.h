#ifndef TESTS_OPERATORS_IP_KERNELS_SLABPICTURES_H
#define TESTS_OPERATORS_IP_KERNELS_SLABPICTURES_H

/// @file
/// Output slices of slabs, as the kernels see them.

#include <vorl/Operators/IP/kernels/Slab.h>
#include <vorl/Operators/IP/kernels/SlicePlane.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <ostream>
#include <sstream>
#include <type_traits>

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

/// Calls `check(volume, picture)` for so many pictures that `next(sweep, shape)` makes, each in a
/// random volume of its own, until one fails.
template <class T, class Next, class Check>
void ForEachPicture(CpuVariant variant, unsigned seed, int count, Next&& next, Check&& check) {
  Sweep<T> sweep(variant, seed);
  const auto kinds = AllValues<T>();
  for (int i = 0; i < count && !testing::Test::HasFailure(); ++i) {
    const Shape shape{sweep.random() % 4 == 0 ? sweep.Between(1, 5) : sweep.Between(2, 140),
                      sweep.Between(1, 30), sweep.Between(1, 20), sweep.Alignment()};
    const Values& values = kinds[sweep.random() % kinds.size()];
    std::ostringstream text;
    text << vorl_detail::NameOf(variant) << ", seed " << seed << ", "
         << (std::is_signed_v<T> ? "signed " : "unsigned ") << values << ", " << shape;
    SCOPED_TRACE(text.str());
    const GuardedVolume<T> volume(shape, values, sweep.Side(), sweep.random);
    check(volume.View(), next(sweep, shape));
  }
}

}  // namespace slab_pictures

#endif
