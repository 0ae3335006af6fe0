#ifndef VORL_OPERATORS_IP_KERNELS_MPR_H
#define VORL_OPERATORS_IP_KERNELS_MPR_H

/// @file
/// The inner loops of multi-planar reconstruction: one output row each. Plain references: faster
/// variants must equal them bit for bit.

#include <vorl/Operators/IP/kernels/Sampling.h>
#include <vorl/Operators/IP/kernels/Slab.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// Samples `width` points from `point` on, `step` apart; 0 outside. `point` ends behind the row.
template <class T, class Sampler>
void MprThinRowRef(const VolumeView& view, const Sampler& sampler, FixedVector& point,
                   const FixedVector& step, T* target, std::size_t width) {
  for (std::size_t i = 0; i < width; ++i) {
    target[i] = view.IsInside(point) ? static_cast<T>(sampler(point)) : T{0};
    point += step;
  }
}

/// The mean of the inside samples of each pixel's slab; 0 without any.
template <class T, class Sampler>
void MprThickRowRef(const VolumeView& view, const Sampler& sampler, const SlabSamples& slab,
                    FixedVector& point, const FixedVector& step, T* target, std::size_t width) {
  for (std::size_t i = 0; i < width; ++i) {
    std::int32_t sum = 0;
    std::int32_t inside = 0;
    FixedVector sample = point;
    for (std::int32_t k = 0; k < slab.count; ++k) {
      if (view.IsInside(sample)) {
        sum = WrapAdd(sum, sampler(sample));
        ++inside;
      }
      sample += slab.step;
    }
    target[i] = inside != 0 ? static_cast<T>(sum / inside) : T{0};
    point += step;
  }
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
