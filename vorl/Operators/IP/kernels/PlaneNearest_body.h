#ifndef VORL_OPERATORS_IP_KERNELS_PLANENEAREST_BODY_H
#define VORL_OPERATORS_IP_KERNELS_PLANENEAREST_BODY_H

// The nearest voxels of a row of sampling points: a part of Planes_body.h.

#include <vorl/Operators/IP/kernels/PlaneGather_body.h>
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

/// Registers of nearest voxels. Each is gathered with its right neighbour or, in the last column,
/// with the left one.
template <class T>
class NearestGatherer {
 public:
  explicit NearestGatherer(const VolumeGrid& grid)
      : m_grid(grid),
        m_lastColumn(Numbers::All(grid.Width() - 1)),
        m_lastPair(Numbers::All(grid.Width() - 2)),
        m_width(Numbers::All(grid.Width())) {}

  Numbers At(const Numbers& x, const Numbers& y, const Numbers& z) const {
    const Numbers column = x.ShiftedRight();
    const Numbers place = Numbers::Gather(m_grid.Slices(), z.ShiftedRight()) +
                          y.ShiftedRight() * m_width + column.Min(m_lastPair);
    const Numbers pair = Numbers::GatherPairs(m_grid.Origin(), place);
    return pair.template LowSample<T>().Replaced(column.Equals(m_lastColumn),
                                                 pair.template HighSample<T>());
  }

 private:
  const VolumeGrid& m_grid;
  Numbers m_lastColumn, m_lastPair, m_width;
};

/// True for points along a row of voxels that are at most a voxel apart.
bool IsWithinRow(const FixedVector& step) {
  return step.y == 0 && step.z == 0 && step.x >= -kOneVoxel && step.x <= kOneVoxel;
}

/// Such points, in a row of at least a register of voxels: the voxels of a register of points lie
/// in one register, too.
template <class T, class Sink>
void NearestWithinRow(const T* voxels, std::int32_t width, std::int32_t x, std::int32_t step,
                      std::size_t count, const Sink& sink) {
  constexpr auto kCount = static_cast<std::int32_t>(Words::kCount);
  const std::int32_t lastBegin = width - kCount;
  const Numbers toHigh = Numbers::All(step * (kCount / 2));
  const Numbers toNext = Numbers::All(step * kCount);
  Numbers low = Numbers::All(x) + Numbers::Lanes() * Numbers::All(step);
  std::size_t i = 0;
  for (; i + Words::kCount <= count; i += Words::kCount) {
    const std::int32_t first = x >> 16;
    const std::int32_t last = (x + step * (kCount - 1)) >> 16;
    const std::int32_t leftmost = first < last ? first : last;
    const std::int32_t begin = leftmost < lastBegin ? leftmost : lastBegin;
    const Words columns = Words::HighHalves(low, low + toHigh);
    sink.Put(i, Words::Chosen(voxels + begin, columns - Words::All(begin)));
    low = low + toNext;
    x += step * kCount;
  }
  for (; i < count; ++i, x += step) {
    sink.Put(i, voxels[x >> 16]);
  }
}

/// Inside points have no sign, so the shifts may be logical.
///
/// A single layer is fetched voxel by voxel: most are not in the cache, and a gathering waits for
/// all of its own (oblique: 760 million samples per second instead of 860; down the columns 215
/// instead of 285). Of layers that are collected in pieces most are.
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
  } else if (IsWithinRow(step) && width >= Words::kCount) {
    NearestWithinRow(SliceOf<T>(grid, place.z) + (place.y >> 16) * width, grid.Width(), point.x,
                     step.x, count, sink);
  } else if constexpr (Sink::kCollects) {
    GatherRow(NearestGatherer<T>(grid), point, step, count, sink);
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
