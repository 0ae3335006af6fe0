#ifndef VORL_OPERATORS_IP_KERNELS_ROWSAMPLER_H
#define VORL_OPERATORS_IP_KERNELS_ROWSAMPLER_H

/// @file
/// Whole output rows by the kernels of the active variant.

#include <vorl/Operators/IP/kernels/PlaneRows.h>
#include <vorl/Operators/IP/kernels/Slab.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <type_traits>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Samples the rows of an output slice out of a volume.
///
/// Each function returns false, and has done nothing that lasts, where the row needs the plain
/// loop: with the reference variant, for a volume that is no grid, where coordinates wrap.
template <class T>
class RowSampler {
 public:
  RowSampler(const VolumeView& view, bool isLinear, CpuVariant variant)
      : m_limits(view.Limits()), m_grid(VolumeGrid::Of(view)) {
    const PlaneKernels* const kernels = PlaneKernelsOf(variant);
    if (kernels != nullptr && m_grid) {
      m_run = (isLinear ? kernels->linear : kernels->nearest)[std::is_signed_v<T> ? 1 : 0];
    }
  }

  /// One sample per pixel, 0 outside.
  bool Thin(const FixedVector& point, const FixedVector& step, T* target, std::size_t width) {
    PointRange range;
    if (!FindRange(point, step, width, range)) {
      return false;
    }
    std::fill(target, target + range.begin, T{0});
    Sample(range, point, step, RowSink::Store, target);
    std::fill(target + range.end, target + width, T{0});
    return true;
  }

  /// The mean of the inside samples of each pixel's slab; 0 without any.
  bool Mean(const SlabSamples& slab, const FixedVector& point, const FixedVector& step, T* target,
            std::size_t width) {
    const SlabRows rows{point, step, {}, width, 1};
    return Collect(slab, rows, RowSink::Sum, [] { return false; }) && StoreMean(0, target);
  }

  /// The largest inside sample of each pixel's slab, at least 0.
  bool Maximum(const SlabSamples& slab, const FixedVector& point, const FixedVector& step,
               T* target, std::size_t width) {
    const SlabRows rows{point, step, {}, width, 1};
    return Collect(slab, rows, RowSink::Maximum, [] { return false; }) && StoreMaximum(0, target);
  }

  /// Some rows of pixels, the first of which begins at `point`.
  struct SlabRows {
    FixedVector point;
    FixedVector columnStep;
    FixedVector rowStep;
    std::size_t width;
    std::size_t height;
  };

  /// Sums the samples of the rows' slabs, or finds the largest ones: to be stored row by row. Ends
  /// early, with nothing to store, when `isStopped()`; asks that every few thousand samples.
  ///
  /// The volume is walked piece by piece: each is small enough to stay in the cache for all the
  /// samples in it.
  template <class IsStopped>
  bool Collect(const SlabSamples& slab, const SlabRows& rows, RowSink sink, IsStopped&& isStopped) {
    if (!FindRanges(slab, rows)) {
      return false;
    }
    m_width = rows.width;
    m_numbers.assign(rows.width * rows.height, 0);
    const bool isAlongRow =
        rows.columnStep.x == 65536 && rows.columnStep.y == 0 && rows.columnStep.z == 0;
    const auto count = static_cast<std::size_t>(slab.count);
    const std::size_t columns = isAlongRow ? rows.width : kPieceColumns;
    const std::size_t layers = isAlongRow ? 1 : kPieceLayers;
    for (std::size_t column = 0; column < rows.width; column += columns) {
      const std::size_t end = std::min(column + columns, rows.width);
      for (std::size_t layer = 0; layer < count; layer += layers) {
        if (isStopped()) {
          return true;
        }
        SamplePiece(slab, rows, sink, {column, end, layer, std::min(layer + layers, count)});
      }
    }
    return true;
  }

  /// Stores a collected row of means; true.
  bool StoreMean(std::size_t row, T* target) {
    m_changes.assign(m_width + 1, 0);
    for (std::size_t layer = 0; layer < m_layers; ++layer) {
      const PointRange& range = m_ranges[row * m_layers + layer];
      ++m_changes[static_cast<std::size_t>(range.begin)];
      --m_changes[static_cast<std::size_t>(range.end)];
    }
    const std::int32_t* const sums = m_numbers.data() + row * m_width;
    std::int32_t inside = 0;
    for (std::size_t i = 0; i < m_width; ++i) {
      inside += m_changes[i];
      target[i] = inside != 0 ? static_cast<T>(sums[i] / inside) : T{0};
    }
    return true;
  }

  /// Stores a collected row of maxima; true.
  bool StoreMaximum(std::size_t row, T* target) const {
    const std::int32_t* const maxima = m_numbers.data() + row * m_width;
    for (std::size_t i = 0; i < m_width; ++i) {
      target[i] = static_cast<T>(maxima[i]);
    }
    return true;
  }

 private:
  // Of 32 columns interpolation is slower, of 128 the nearest voxel; of fewer rows both.
  static constexpr std::size_t kPieceColumns = 64;
  static constexpr std::size_t kPieceLayers = 16;
  static constexpr std::int32_t kMostLayers = 65536;

  // Pixels of each row, and layers of the slab.
  struct Piece {
    std::size_t begin, end;
    std::size_t firstLayer, endLayer;
  };

  // The optional range is not passed on: its flag is a byte that would be read with its neighbours,
  // which waits until the row before is in the cache (20 ns).
  bool FindRange(const FixedVector& point, const FixedVector& step, std::size_t width,
                 PointRange& range) const {
    if (m_run == nullptr) {
      return false;
    }
    if (IsRowInside(m_limits, point, step, width)) {
      range = {0, static_cast<std::int32_t>(width)};
      return true;
    }
    const auto found = FindInside(m_limits, point, step, width);
    if (found) {
      range = *found;
    }
    return found.has_value();
  }

  void Sample(const PointRange& range, const FixedVector& point, const FixedVector& step,
              RowSink sink, auto* row) {
    if (range.begin >= range.end) {
      return;
    }
    const auto count = static_cast<std::size_t>(range.end - range.begin);
    if (range.begin == 0) {  // the usual case, which needs no copy of a point just written
      m_run(*m_grid, point, step, count, sink, row);
    } else {
      FixedVector first = point;
      first += step.Times(range.begin);
      m_run(*m_grid, first, step, count, sink, row + range.begin);
    }
  }

  // What of each row is inside, layer by layer. Not for slabs of more layers than voxels: a list of
  // them might not fit into memory.
  bool FindRanges(const SlabSamples& slab, const SlabRows& rows) {
    if (m_run == nullptr || slab.count > kMostLayers) {
      return false;
    }
    m_layers = static_cast<std::size_t>(slab.count);
    m_ranges.resize(rows.height * m_layers);
    FixedVector first = rows.point;
    for (std::size_t row = 0; row < rows.height; ++row, first += rows.rowStep) {
      FixedVector start = first;
      for (std::size_t layer = 0; layer < m_layers; ++layer, start += slab.step) {
        if (!FindRange(start, rows.columnStep, rows.width, m_ranges[row * m_layers + layer])) {
          return false;
        }
      }
    }
    return true;
  }

  void SamplePiece(const SlabSamples& slab, const SlabRows& rows, RowSink sink,
                   const Piece& piece) {
    FixedVector first = rows.point;
    first += slab.step.Times(static_cast<std::int32_t>(piece.firstLayer));
    for (std::size_t row = 0; row < rows.height; ++row, first += rows.rowStep) {
      FixedVector start = first;
      for (std::size_t layer = piece.firstLayer; layer < piece.endLayer; ++layer) {
        PointRange range = m_ranges[row * m_layers + layer];
        range.begin = std::max(range.begin, static_cast<std::int32_t>(piece.begin));
        range.end = std::min(range.end, static_cast<std::int32_t>(piece.end));
        Sample(range, start, rows.columnStep, sink, m_numbers.data() + row * rows.width);
        start += slab.step;
      }
    }
  }

  FixedVector m_limits;
  std::optional<VolumeGrid> m_grid;
  SampleRun* m_run = nullptr;
  std::vector<std::int32_t> m_numbers;  ///< sums or maxima of some rows
  std::vector<PointRange> m_ranges;     ///< of the inside samples, for each layer of each row
  std::vector<std::int32_t> m_changes;  ///< of the number of inside samples, from pixel to pixel
  std::size_t m_width = 0;
  std::size_t m_layers = 0;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
