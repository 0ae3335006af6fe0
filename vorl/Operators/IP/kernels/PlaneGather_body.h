#ifndef VORL_OPERATORS_IP_KERNELS_PLANEGATHER_BODY_H
#define VORL_OPERATORS_IP_KERNELS_PLANEGATHER_BODY_H

// Rows of sampling points by registers: a part of Planes_body.h.

#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// Samples by registers of points, by a class that gathers what they need.
template <class Gatherer, class Sink>
void GatherRow(const Gatherer& gatherer, const FixedVector& point, const FixedVector& step,
               std::size_t count, const Sink& sink) {
  const Numbers lane = Numbers::Lanes();
  const auto at = [&](std::int32_t start, std::int32_t stride) {
    return Numbers::All(start) + lane * Numbers::All(stride);
  };
  Numbers x = at(point.x, step.x);
  Numbers y = at(point.y, step.y);
  Numbers z = at(point.z, step.z);
  const Numbers lanes = Numbers::All(static_cast<int>(Numbers::kCount));
  const Numbers strideX = Numbers::All(step.x) * lanes;
  const Numbers strideY = Numbers::All(step.y) * lanes;
  const Numbers strideZ = Numbers::All(step.z) * lanes;
  std::size_t i = 0;
  for (; i + Numbers::kCount <= count; i += Numbers::kCount) {
    sink.Put(i, gatherer.At(x, y, z));
    x = x + strideX;
    y = y + strideY;
    z = z + strideZ;
  }
  if (i < count) {  // lanes beyond the row repeat its first point, and are not used
    const auto isUsed = lane.IsBelow(Numbers::All(static_cast<int>(count - i)));
    std::int32_t samples[Numbers::kCount];
    gatherer
        .At(Numbers::All(point.x).Replaced(isUsed, x), Numbers::All(point.y).Replaced(isUsed, y),
            Numbers::All(point.z).Replaced(isUsed, z))
        .Store(samples);
    for (std::size_t k = 0; i + k < count; ++k) {
      sink.Put(i + k, samples[k]);
    }
  }
}

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#endif
