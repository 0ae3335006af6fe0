#ifndef VORL_OPERATORS_IP_KERNELS_PLANENEAREST_BODY_H
#define VORL_OPERATORS_IP_KERNELS_PLANENEAREST_BODY_H

// The nearest voxels of a row of sampling points: a part of Planes_body.h.

#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// A position and its step as they are walked: wrapping at 32 bits.
struct Walk {
  std::uint32_t x, y, z;

  explicit Walk(const FixedVector& vector)
      : x(static_cast<std::uint32_t>(vector.x)),
        y(static_cast<std::uint32_t>(vector.y)),
        z(static_cast<std::uint32_t>(vector.z)) {}
  void Add(const Walk& step) {
    x += step.x;
    y += step.y;
    z += step.z;
  }
};

constexpr std::int32_t kOneVoxel = 65536;

bool IsAlongRow(const FixedVector& step) {
  return step.x == kOneVoxel && step.y == 0 && step.z == 0;
}

template <class T>
const T* SliceOf(const VolumeGrid& grid, std::uint32_t z) {
  return static_cast<const T*>(grid.Origin()) + grid.Slices()[z >> 16];
}

/// Inside points have no sign, so the shifts may be logical.
template <class T, class Sink>
void NearestRow(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
                std::size_t count, const Sink& sink) {
  Walk place(point);
  const Walk stride(step);
  const auto width = static_cast<std::size_t>(grid.Width());
  if (IsAlongRow(step)) {
    const T* const row = SliceOf<T>(grid, place.z) + (place.y >> 16) * width + (place.x >> 16);
    std::size_t i = 0;
    for (; i + Words::kCount <= count; i += Words::kCount) {
      sink.Put(i, Words::Load(row + i));
    }
    for (; i < count; ++i) {
      sink.Put(i, row[i]);
    }
  } else if (step.z == 0) {
    const T* const slice = SliceOf<T>(grid, place.z);
    for (std::size_t i = 0; i < count; ++i) {
      sink.Put(i, slice[(place.y >> 16) * width + (place.x >> 16)]);
      place.Add(stride);
    }
  } else {
    for (std::size_t i = 0; i < count; ++i) {
      sink.Put(i, SliceOf<T>(grid, place.z)[(place.y >> 16) * width + (place.x >> 16)]);
      place.Add(stride);
    }
  }
}

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#endif
