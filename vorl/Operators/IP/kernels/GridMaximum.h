#ifndef VORL_OPERATORS_IP_KERNELS_GRIDMAXIMUM_H
#define VORL_OPERATORS_IP_KERNELS_GRIDMAXIMUM_H

/// @file
/// The largest voxel of slabs that lie along the grid, in 16 bits and in the order in which the
/// voxels lie in memory. Equals the plain loop (Mip.h) bit for bit.
///
/// 1. Where a row of pixels is a row of voxels in each layer of the slab, the layers' rows are
///    raised to one another, four at a time. When layers are slices, some rows are done together:
///    a slice then gives a run of neighbouring rows.
/// 2. Where the slab runs along rows of voxels, each pixel is the largest voxel of a row.

#include <vorl/Operators/IP/kernels/PlaneRows.h>
#include <vorl/Operators/IP/kernels/Slab.h>
#include <vorl/Operators/IP/kernels/SlicePlane.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <optional>
#include <type_traits>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Projects the nearest voxels of such slabs, output row after output row.
template <class T>
class GridMaximum {
 public:
  /// For `width` x `height` pixels.
  GridMaximum(const VolumeView& view, const SlicePlane& plane, const SlabSamples& slab,
              CpuVariant variant, std::size_t width, std::size_t height)
      : m_view(view),
        m_grid(VolumeGrid::Of(view)),
        m_kernels(PlaneKernelsOf(variant)),
        m_plane(plane),
        m_slab(slab),
        m_width(width),
        m_height(height) {
    const FixedVector& column = plane.columnStep;
    m_isAcrossRows = slab.step.x == 0 && column.x == 65536 && column.y == 0 && column.z == 0;
    m_isAlongRows = slab.step.y == 0 && slab.step.z == 0 && column.x == 0;
    m_isUsable =
        m_kernels != nullptr && m_grid && (m_isAcrossRows || m_isAlongRows) && FindRanges();
  }

  /// Fills the pixels of row `index`; rows come in order. False, and nothing is done, for slabs in
  /// any other direction, with the reference variant, for a volume that is no grid, where
  /// coordinates wrap along a row.
  bool Row(std::size_t index, T* pixels) {
    if (!m_isUsable) {
      return false;
    }
    if (index >= m_bandBegin + m_bandRows) {
      MakeBand(index);
    }
    const auto first =
        m_band.begin() + static_cast<std::ptrdiff_t>((index - m_bandBegin) * m_width);
    std::copy(first, first + static_cast<std::ptrdiff_t>(m_width), pixels);
    return true;
  }

 private:
  static constexpr std::int32_t kSources = 4;   // rows that are raised to one another at once
  static constexpr std::size_t kBandRows = 16;  // fill a quarter of the nearest cache
  static constexpr std::size_t kIsSigned = std::is_signed_v<T> ? 1 : 0;

  FixedVector PointOf(std::size_t row) const {
    FixedVector point = m_plane.start;
    point += m_plane.rowStep.Times(static_cast<std::int32_t>(row));
    return point;
  }

  // The inside pixels of each row, as far as the row's direction decides it: the slab's is seen to
  // where it is walked.
  bool FindRanges() {
    m_ranges.reserve(m_height);
    for (std::size_t row = 0; row < m_height; ++row) {
      FixedVector point = PointOf(row);
      if (m_isAcrossRows) {
        point.y = point.z = 0;
      } else {
        point.x = 0;
      }
      const auto range = FindInside(m_view.Limits(), point, m_plane.columnStep, m_width);
      if (!range) {
        return false;
      }
      m_ranges.push_back(*range);
    }
    return true;
  }

  void MakeBand(std::size_t begin) {
    m_bandBegin = begin;
    // No more than an eighth of the picture, so that its progress can be seen; and rows of few
    // samples one by one: handed out in bands they would outrun a request to stop.
    const bool hasBands =
        m_slab.step.z != 0 && m_width * static_cast<std::size_t>(m_slab.count) >= 4096;
    const std::size_t most = std::clamp(m_height / 8, std::size_t{1}, kBandRows);
    m_bandRows = std::min(hasBands ? most : 1, m_height - begin);
    m_band.assign(m_bandRows * m_width, 0);
    if (m_isAcrossRows) {
      RaiseBand();
    } else {
      FindColumns(PointOf(begin).x);
      const PointRange& range = m_ranges[begin];
      FixedVector point = PointOf(begin);
      point += m_plane.columnStep.Times(range.begin);
      m_kernels->largestInRows[kIsSigned](
          *m_grid, point, m_plane.columnStep, static_cast<std::size_t>(range.end - range.begin),
          m_columns.data(), m_columns.size(), m_band.data() + range.begin);
    }
  }

  // Some rows of pixels, and the rows of voxels that they are raised to.
  struct Raise {
    std::size_t row = 0;
    RowSources sources = {};
  };

  // Row after row to a few layers, then to the next ones.
  void RaiseBand() {
    Raise last;
    bool hasLast = false;
    const auto raise = [&](const RowSources& next) {
      const PointRange& range = m_ranges[m_bandBegin + last.row];
      m_kernels->raiseRow[kIsSigned](m_band.data() + last.row * m_width + range.begin, last.sources,
                                     next, static_cast<std::size_t>(range.end - range.begin));
    };
    for (std::int64_t first = 0; first < m_slab.count; first += kSources) {
      for (std::size_t row = 0; row < m_bandRows; ++row) {
        Raise next{row, {}};
        if (FindSources(row, static_cast<std::int32_t>(first), next.sources)) {
          if (hasLast) {
            raise(next.sources);
          }
          last = next;
          hasLast = true;
        }
      }
    }
    if (hasLast) {
      raise(last.sources);
    }
  }

  // The rows of voxels in a few layers from one on; the first of them stands for those that are
  // outside. False when all are.
  bool FindSources(std::size_t row, std::int32_t firstLayer, RowSources& sources) const {
    const PointRange& range = m_ranges[m_bandBegin + row];
    if (range.begin >= range.end) {
      return false;
    }
    const std::int32_t layers = std::min(kSources, m_slab.count - firstLayer);
    FixedVector point = PointOf(m_bandBegin + row);
    point += m_slab.step.Times(firstLayer);
    point += m_plane.columnStep.Times(range.begin);
    std::size_t found = 0;
    for (std::int32_t layer = 0; layer < layers; ++layer, point += m_slab.step) {
      if (m_view.IsInside(point)) {
        sources.rows[found++] = m_view.Slice<T>(point.z >> 16) +
                                std::ptrdiff_t{point.y >> 16} * m_view.Width() + (point.x >> 16);
      }
    }
    std::fill(std::begin(sources.rows) + found, std::end(sources.rows), sources.rows[0]);
    return found != 0;
  }

  // The columns that a slab along rows of voxels from x on meets. Steps are rarely as long as a
  // voxel, so that a column may be met again, or left out.
  void FindColumns(std::int32_t x) {
    if (m_columnsOf == x) {
      return;
    }
    m_columnsOf = x;
    m_columns.clear();
    for (std::int32_t k = 0; k < m_slab.count; ++k, x = WrapAdd(x, m_slab.step.x)) {
      if (x < 0 || x >= m_view.Limits().x) {
        continue;
      }
      const std::int32_t column = x >> 16;
      if (!m_columns.empty() && column >= m_columns.back().begin - 1 &&
          column <= m_columns.back().end) {
        m_columns.back().begin = std::min(m_columns.back().begin, column);
        m_columns.back().end = std::max(m_columns.back().end, column + 1);
      } else {
        m_columns.push_back({column, column + 1});
      }
    }
  }

  const VolumeView& m_view;
  std::optional<VolumeGrid> m_grid;
  const PlaneKernels* m_kernels;
  SlicePlane m_plane;
  SlabSamples m_slab;
  std::size_t m_width;
  std::size_t m_height;
  bool m_isAcrossRows = false;
  bool m_isAlongRows = false;
  bool m_isUsable = false;
  std::vector<PointRange> m_ranges;  ///< of the rows' pixels
  std::vector<T> m_band;             ///< the results of some rows
  std::size_t m_bandBegin = 0;
  std::size_t m_bandRows = 0;
  std::vector<PointRange> m_columns;
  std::optional<std::int32_t> m_columnsOf;  ///< the slab's first x
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
