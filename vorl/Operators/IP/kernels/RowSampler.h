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
    m_changes.assign(width + 1, 0);
    const auto count = [&](const PointRange& range) {
      ++m_changes[static_cast<std::size_t>(range.begin)];
      --m_changes[static_cast<std::size_t>(range.end)];
    };
    if (!Collect(slab, point, step, width, RowSink::Sum, count)) {
      return false;
    }
    std::int32_t inside = 0;
    for (std::size_t i = 0; i < width; ++i) {
      inside += m_changes[i];
      target[i] = inside != 0 ? static_cast<T>(m_numbers[i] / inside) : T{0};
    }
    return true;
  }

  /// The largest inside sample of each pixel's slab, at least 0.
  bool Maximum(const SlabSamples& slab, const FixedVector& point, const FixedVector& step,
               T* target, std::size_t width) {
    if (!Collect(slab, point, step, width, RowSink::Maximum, [](const PointRange&) {})) {
      return false;
    }
    for (std::size_t i = 0; i < width; ++i) {
      target[i] = static_cast<T>(m_numbers[i]);
    }
    return true;
  }

 private:
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
    if (range.begin < range.end) {
      FixedVector first = point;
      first += step.Times(range.begin);
      m_run(*m_grid, first, step, static_cast<std::size_t>(range.end - range.begin), sink,
            row + range.begin);
    }
  }

  // Slab after slab row, so that each is a row of neighbouring points. Calls `note` with what is
  // inside of each.
  template <class Note>
  bool Collect(const SlabSamples& slab, const FixedVector& point, const FixedVector& step,
               std::size_t width, RowSink sink, Note&& note) {
    m_numbers.assign(width, 0);
    FixedVector start = point;
    for (std::int32_t k = 0; k < slab.count; ++k) {
      PointRange range;
      if (!FindRange(start, step, width, range)) {
        return false;
      }
      note(range);
      Sample(range, start, step, sink, m_numbers.data());
      start += slab.step;
    }
    return true;
  }

  FixedVector m_limits;
  std::optional<VolumeGrid> m_grid;
  SampleRun* m_run = nullptr;
  std::vector<std::int32_t> m_numbers;  ///< of a row
  std::vector<std::int32_t> m_changes;  ///< of the number of inside samples, from pixel to pixel
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
