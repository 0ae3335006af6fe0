#ifndef VORL_OPERATORS_IP_KERNELS_PLANEMAXIMUM_BODY_H
#define VORL_OPERATORS_IP_KERNELS_PLANEMAXIMUM_BODY_H

// The largest of voxels that lie in rows: a part of Planes_body.h.
//
// A register more or less at the end of a row is done twice instead of voxel by voxel: the largest
// stays the largest.

#include <vorl/Operators/IP/kernels/PlaneNearest_body.h>
#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

template <class T>
T LargerOf(T a, T b) {
  return a > b ? a : b;
}

/// Asks for the memory ahead of its use: neither the end of a row of voxels nor the begin of
/// another is foreseen by the machine.
void Fetch(const void* place) {
  __builtin_prefetch(place, 0, 2);
}

/// Raises `count` samples to those of four rows, and fetches those that come next.
template <class T>
void RaiseRow(void* row, const RowSources& sources, const RowSources& next, std::size_t count) {
  T* const target = static_cast<T*>(row);
  const auto source = [](const RowSources& rows, int k) {
    return static_cast<const T*>(rows.rows[k]);
  };
  const T* const a = source(sources, 0);
  const T* const b = source(sources, 1);
  const T* const c = source(sources, 2);
  const T* const d = source(sources, 3);
  const auto raise = [&](std::size_t i) {
    for (int k = 0; k < 4; ++k) {
      Fetch(source(next, k) + i);
    }
    const Words first = Words::Load(a + i).template Larger<T>(Words::Load(b + i));
    const Words second = Words::Load(c + i).template Larger<T>(Words::Load(d + i));
    Words::Load(target + i).template Larger<T>(first.template Larger<T>(second)).Store(target + i);
  };
  std::size_t i = 0;
  for (; i + Words::kCount <= count; i += Words::kCount) {
    raise(i);
  }
  if (i < count && count >= Words::kCount) {
    raise(count - Words::kCount);
    return;
  }
  for (; i < count; ++i) {
    target[i] = LargerOf(target[i], LargerOf(LargerOf(a[i], b[i]), LargerOf(c[i], d[i])));
  }
}

/// The largest of 0 and a run of samples, lane by lane and over all lanes.
template <class T>
class Largest {
 public:
  void See(const T* samples, std::size_t count) {
    if (count < Words::kCount) {
      for (std::size_t i = 0; i < count; ++i) {
        m_single = LargerOf(m_single, samples[i]);
      }
      return;
    }
    for (std::size_t i = 0; i + Words::kCount < count; i += Words::kCount) {
      m_lanes = m_lanes.template Larger<T>(Words::Load(samples + i));
    }
    m_lanes = m_lanes.template Larger<T>(Words::Load(samples + count - Words::kCount));
  }
  T Value() const { return LargerOf(m_single, static_cast<T>(m_lanes.LargestLane())); }

 private:
  Words m_lanes = Words::All(0);
  T m_single = 0;
};

/// For each of a row of points, none of which differ in x, the largest voxel of its row of voxels
/// in some ranges of columns, at least 0.
template <class T>
void LargestInRows(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
                   std::size_t count, const PointRange* columns, std::size_t ranges, void* row) {
  Walk place(point);
  const Walk stride(step);
  const auto width = static_cast<std::size_t>(grid.Width());
  T* const target = static_cast<T*>(row);
  constexpr std::size_t kAhead = 8;
  Walk ahead(point);
  for (std::size_t i = 0; i < kAhead; ++i) {
    ahead.Add(stride);
  }
  for (std::size_t i = 0; i < count; ++i) {
    if (i + kAhead < count) {
      const T* const voxels = SliceOf<T>(grid, ahead.z) + (ahead.y >> 16) * width;
      for (std::size_t k = 0; k < ranges; ++k) {
        for (std::int32_t x = columns[k].begin; x < columns[k].end; x += 32) {
          Fetch(voxels + x);
        }
      }
      ahead.Add(stride);
    }
    const T* const voxels = SliceOf<T>(grid, place.z) + (place.y >> 16) * width;
    Largest<T> largest;
    for (std::size_t k = 0; k < ranges; ++k) {
      largest.See(voxels + columns[k].begin,
                  static_cast<std::size_t>(columns[k].end - columns[k].begin));
    }
    target[i] = largest.Value();
    place.Add(stride);
  }
}

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#endif
