#ifndef VORL_OPERATORS_IP_KERNELS_MIP_H
#define VORL_OPERATORS_IP_KERNELS_MIP_H

/// @file
/// The inner loop of the maximum intensity projection: one output row. A plain reference: faster
/// variants must equal it bit for bit.

#include <vorl/Operators/IP/kernels/Sampling.h>
#include <vorl/Operators/IP/kernels/Slab.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// The largest inside sample of each pixel's slab, at least 0. `point` ends behind the row.
template <class T, class Sampler>
void MipRowRef(const VolumeView& view, const Sampler& sampler, const SlabSamples& slab,
               FixedVector& point, const FixedVector& step, T* target, std::size_t width) {
  for (std::size_t i = 0; i < width; ++i) {
    std::int32_t maximum = 0;
    FixedVector sample = point;
    for (std::int32_t k = 0; k < slab.count; ++k) {
      if (view.IsInside(sample)) {
        const std::int32_t value = sampler(sample);
        if (value > maximum) {
          maximum = value;
        }
      }
      sample += slab.step;
    }
    target[i] = static_cast<T>(maximum);
    point += step;
  }
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
