#ifndef VORL_OPERATORS_IP_KERNELS_SLAB_H
#define VORL_OPERATORS_IP_KERNELS_SLAB_H

/// @file
/// The samples that are taken across a slab, and the plane on which a slab begins.

#include <vorl/Operators/IP/kernels/SlicePlane.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>

inline namespace vorl {
namespace vorl_detail {

/// A slab is centred on its plane: its samples begin half a thickness below.
inline constexpr double kSlabBegin = -0.5;

/// The samples taken along the normal for each pixel: from the pixel's point on, `count` of them,
/// `step` apart.
struct SlabSamples {
  /// `depthSteps` samples through one thickness `depth`, at least 2; a negative number stands for
  /// the whole voxels that the thickness crosses along its dominant axis.
  SlabSamples(const FixedVector& depth, std::int32_t depthSteps)
      : count(std::max(depthSteps < 0 ? VoxelsAcross(depth) : depthSteps, 2)),
        step(depth.DividedBy(count - 1)) {}

  std::int32_t count;
  FixedVector step;

 private:
  static std::int32_t VoxelsAcross(const FixedVector& depth) {
    const std::int64_t largest =
        std::max({std::llabs(depth.x), std::llabs(depth.y), std::llabs(depth.z)});
    return static_cast<std::int32_t>(largest >> 16);
  }
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
