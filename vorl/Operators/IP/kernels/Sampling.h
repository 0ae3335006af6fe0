#ifndef VORL_OPERATORS_IP_KERNELS_SAMPLING_H
#define VORL_OPERATORS_IP_KERNELS_SAMPLING_H

/// @file
/// How a volume is sampled at a point inside it. Plain references: faster variants must equal them
/// bit for bit.

#include <vorl/Operators/IP/kernels/VolumeView.h>

#include <cstddef>
#include <cstdint>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// The voxel whose cell holds the point. Rows are taken as W samples apart: volumes are kept
/// unpadded.
template <class T>
class NearestSampler {
 public:
  explicit NearestSampler(const VolumeView& view) : m_view(view) {}

  /// The sample at an inside point.
  std::int32_t operator()(const FixedVector& point) const {
    return Voxel(point.x >> 16, point.y >> 16, point.z >> 16);
  }

  /// The value of a voxel of the volume.
  std::int32_t Voxel(std::int32_t x, std::int32_t y, std::int32_t z) const {
    return m_view.Slice<T>(z)[std::ptrdiff_t{y} * m_view.Width() + x];
  }

 private:
  const VolumeView& m_view;
};

/// The weighted mean of the voxel and its upper neighbours, at least 0.
template <class T>
class TrilinearSampler {
 public:
  explicit TrilinearSampler(const VolumeView& view)
      : m_view(view),
        m_columns(Offsets(view.Width(), 1)),
        m_rows(Offsets(view.Height(), view.Pitch())) {}

  /// The sample at an inside point.
  std::int32_t operator()(const FixedVector& point) const {
    const auto x = static_cast<std::size_t>(point.x >> 16);
    const auto y = static_cast<std::size_t>(point.y >> 16);
    const std::int32_t z = point.z >> 16;
    const std::ptrdiff_t offset = m_rows[y] + m_columns[x];
    const std::ptrdiff_t dx = m_columns[x + 1] - m_columns[x];
    const std::ptrdiff_t dy = m_rows[y + 1] - m_rows[y];
    const std::int32_t below = InPlane(m_view.Slice<T>(z) + offset, dx, dy, point);
    const std::int32_t above = InPlane(m_view.Slice<T>(z + 1) + offset, dx, dy, point);
    const std::int32_t sample = Interpolate(below, above, below, point.z);
    return sample < 0 ? 0 : sample;
  }

 private:
  // The offset of each column or row, and once more that of the last: there the next neighbour is
  // the voxel itself.
  static std::vector<std::ptrdiff_t> Offsets(std::int32_t count, std::int32_t distance) {
    std::vector<std::ptrdiff_t> offsets;
    offsets.reserve(static_cast<std::size_t>(count) + 1);
    for (std::int32_t i = 0; i < count; ++i) {
      offsets.push_back(std::ptrdiff_t{i} * distance);
    }
    offsets.push_back(offsets.empty() ? 0 : offsets.back());
    return offsets;
  }

  // start + ((to - from) * fraction >> 16), the product wrapping at 32 bits.
  static std::int32_t Interpolate(std::int32_t start, std::int32_t to, std::int32_t from,
                                  std::int32_t fixed) {
    return WrapAdd(start, WrapMultiply(WrapSubtract(to, from), fixed & 0xFFFF) >> 16);
  }

  static std::int32_t InPlane(const T* p, std::ptrdiff_t dx, std::ptrdiff_t dy,
                              const FixedVector& point) {
    const std::int32_t upper = Interpolate(p[0], p[dx], p[0], point.x);
    // The difference runs the other way round than in the upper row: kept so on purpose.
    const std::int32_t lower = Interpolate(p[dy], p[dy], p[dy + dx], point.x);
    return Interpolate(upper, lower, upper, point.y);
  }

  const VolumeView& m_view;
  std::vector<std::ptrdiff_t> m_columns;
  std::vector<std::ptrdiff_t> m_rows;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
