#ifndef VORL_OPERATORS_IP_KERNELS_SLABBANDS_H
#define VORL_OPERATORS_IP_KERNELS_SLABBANDS_H

/// @file
/// The slabs of an output slice, sampled in bands of rows: neighbouring rows need the same voxels.

#include <vorl/Operators/IP/kernels/RowSampler.h>
#include <vorl/Operators/IP/kernels/SlicePlane.h>

#include <algorithm>
#include <atomic>
#include <cstddef>

inline namespace vorl {
namespace vorl_detail {

template <class T>
class SlabBands {
 public:
  SlabBands(RowSampler<T>& sampler, const SlicePlane& plane, const SlabSamples& slab, RowSink sink,
            const std::atomic<bool>& stopRequested)
      : m_sampler(sampler),
        m_plane(plane),
        m_slab(slab),
        m_sink(sink),
        m_stopRequested(stopRequested) {}

  /// Fills the pixels of row `index` of `height`, which begins at `point`; rows come in order.
  /// False, and nothing is done, for a row that needs the plain loop. When stopped, the row may be
  /// left as it is; then `HasLeftRow`.
  bool Row(std::size_t index, std::size_t height, const FixedVector& point, T* pixels,
           std::size_t width) {
    if (index >= m_end) {
      m_begin = index;
      m_end = index + std::min(BandRows(width, height), height - index);
      // Where one of the rows needs the plain loop, each goes by itself.
      if (!Collect(point, width)) {
        m_end = index + 1;
        if (!Collect(point, width)) {
          return false;
        }
      }
    }
    if (m_stopRequested.load(std::memory_order_relaxed)) {
      m_hasLeftRow = true;
      return true;
    }
    return m_sink == RowSink::Sum ? m_sampler.StoreMean(index - m_begin, pixels)
                                  : m_sampler.StoreMaximum(index - m_begin, pixels);
  }

  /// True when the last row was left as it was, because the operator is to stop.
  bool HasLeftRow() const { return m_hasLeftRow; }

 private:
  static constexpr std::size_t kBandRows = 64;
  static constexpr std::size_t kMostNumbers = std::size_t{1} << 20;  // that a band may take

  // Fewer for rows of very many pixels or layers, and no more than an eighth of the picture, so
  // that its progress can be seen. Rows of few samples go one by one: handed out in bands they
  // would outrun a request to stop.
  std::size_t BandRows(std::size_t width, std::size_t height) const {
    const auto layers = static_cast<std::size_t>(m_slab.count);
    if (width * layers < 4096) {
      return 1;
    }
    return std::clamp(std::min(kMostNumbers / std::max(width, layers), height / 8), std::size_t{1},
                      kBandRows);
  }

  bool Collect(const FixedVector& point, std::size_t width) {
    return m_sampler.Collect(
        m_slab, {point, m_plane.columnStep, m_plane.rowStep, width, m_end - m_begin}, m_sink,
        [this] { return m_stopRequested.load(std::memory_order_relaxed); });
  }

  RowSampler<T>& m_sampler;
  SlicePlane m_plane;
  SlabSamples m_slab;
  RowSink m_sink;
  const std::atomic<bool>& m_stopRequested;
  std::size_t m_begin = 0;
  std::size_t m_end = 0;
  bool m_hasLeftRow = false;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
