#ifndef VORL_OPERATORS_IP_KERNELS_BACKPROJECTION_H
#define VORL_OPERATORS_IP_KERNELS_BACKPROJECTION_H

/// @file
/// A maximum intensity projection along rays that end at a given depth. A plain reference: faster
/// variants must equal it bit for bit.

#include <vorl/Operators/IP/kernels/Sampling.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// The depth of a pixel in front of which nothing has been drawn.
inline constexpr std::int16_t kFarthestDepth = 32767;
inline constexpr std::int32_t kNearestDepth = -32768;

/// The whole steps of a ray from `begin` up to, but not including, `end`.
struct RayRange {
  std::int64_t begin;
  std::int64_t end;

  /// Keeps the steps that may lie in 0 <= position + t * step < limit: a range that the integer
  /// divisions round, so that a test of each sample still decides. A step of 0 keeps all.
  void Clip(std::int32_t position, std::int32_t step, std::int32_t limit) {
    if (step == 0) {
      return;
    }
    const std::int64_t atLow = -(std::int64_t{position} / step);
    const std::int64_t atHigh = (std::int64_t{limit} - position) / step;
    begin = std::max(begin, std::min(atLow, atHigh));
    end = std::min(end, std::max(atLow, atHigh));
  }
};

/// Raises each pixel to the largest inside sample of its ray, `ray` steps apart from the pixel's
/// point on, in front of its depth. `point` ends behind the row.
template <class T>
void BackProjectRowRef(const VolumeView& view, const FixedVector& ray, FixedVector& point,
                       const FixedVector& step, const std::int16_t* depths, T* target,
                       std::size_t width) {
  const NearestSampler<T> sampler(view);
  const FixedVector limits = view.Limits();
  for (std::size_t i = 0; i < width; ++i) {
    RayRange range{kNearestDepth, depths != nullptr ? depths[i] : kFarthestDepth};
    range.Clip(point.x, ray.x, limits.x);
    range.Clip(point.y, ray.y, limits.y);
    range.Clip(point.z, ray.z, limits.z);
    std::int32_t maximum = target[i];
    FixedVector sample = point;
    sample += ray.Times(static_cast<std::int32_t>(range.begin));
    for (std::int64_t t = range.begin; t < range.end; ++t) {
      if (view.IsInside(sample)) {
        maximum = std::max(maximum, sampler(sample));
      }
      sample += ray;
    }
    target[i] = static_cast<T>(maximum);
    point += step;
  }
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
