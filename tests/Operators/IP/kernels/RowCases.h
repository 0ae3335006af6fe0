#ifndef TESTS_OPERATORS_IP_KERNELS_ROWCASES_H
#define TESTS_OPERATORS_IP_KERNELS_ROWCASES_H

/// @file
/// Rows of sampling points, done by a variant's kernels and by the plain loops.

#include <vorl/Operators/IP/kernels/Mip.h>
#include <vorl/Operators/IP/kernels/Mpr.h>
#include <vorl/Operators/IP/kernels/RowSampler.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <ostream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "GuardedVolume.h"

namespace row_cases {

using vorl_detail::CpuVariant;
using vorl_detail::FixedVector;
using vorl_detail::SlabSamples;
using vorl_detail::VolumeView;

struct RowCase {
  FixedVector point;
  FixedVector step;
  FixedVector depth;            ///< one slab thickness
  std::int32_t depthSteps = 2;  ///< samples through it
  std::size_t width = 0;
  std::size_t shift = 0;  ///< samples between the guard and the row, for its alignment
};

inline std::string Text(const FixedVector& vector) {
  return "(" + std::to_string(vector.x) + ", " + std::to_string(vector.y) + ", " +
         std::to_string(vector.z) + ")";
}

inline std::ostream& operator<<(std::ostream& out, const RowCase& row) {
  return out << row.width << " points from " << Text(row.point) << " by " << Text(row.step)
             << ", slab " << Text(row.depth) << " in " << row.depthSteps << ", at misalignment "
             << row.shift;
}

/// How many rows the kernels have done, and how many they have left to the plain loops.
struct Tally {
  int done = 0;
  int left = 0;
};

/// True when a coordinate of the row or of the place behind it wraps.
inline bool Wraps(const FixedVector& point, const FixedVector& step, std::size_t width) {
  const auto wraps = [&](std::int64_t start, std::int64_t stride) {
    const std::int64_t end = start + stride * static_cast<std::int64_t>(width);
    return end < std::numeric_limits<std::int32_t>::min() ||
           end > std::numeric_limits<std::int32_t>::max();
  };
  return wraps(point.x, step.x) || wraps(point.y, step.y) || wraps(point.z, step.z);
}

/// The rows of one volume.
template <class T>
class RowCheck {
 public:
  RowCheck(const VolumeView& view, CpuVariant variant, Tally& tally)
      : m_view(view),
        m_variant(variant),
        m_tally(tally),
        m_nearest(view),
        m_linear(view),
        m_nearestRows(view, false, variant),
        m_linearRows(view, true, variant) {}

  /// Both ways of sampling, one sample per pixel and slabs. Stops at the first difference.
  void Run(const RowCase& row) {
    RunSampler(row, m_nearest, m_nearestRows, "nearest");
    RunSampler(row, m_linear, m_linearRows, "trilinear");
  }

 private:
  static constexpr std::size_t kGuard = 40;
  static constexpr T kMark = 0x5A5A;

  template <class Sampler>
  void RunSampler(const RowCase& row, const Sampler& sampler, vorl_detail::RowSampler<T>& rows,
                  const char* name) {
    const SlabSamples slab(row.depth, row.depthSteps);
    const bool canThin = CanDo(row, 1, slab);
    const bool canSlab = CanDo(row, slab.count, slab);
    Compare(
        row, canThin, name, "thin",
        [&](T* pixels) { return rows.Thin(row.point, row.step, pixels, row.width); },
        [&](FixedVector& point, T* pixels) {
          vorl_detail::MprThinRowRef(m_view, sampler, point, row.step, pixels, row.width);
        });
    Compare(
        row, canSlab, name, "mean",
        [&](T* pixels) { return rows.Mean(slab, row.point, row.step, pixels, row.width); },
        [&](FixedVector& point, T* pixels) {
          vorl_detail::MprThickRowRef(m_view, sampler, slab, point, row.step, pixels, row.width);
        });
    Compare(
        row, canSlab, name, "maximum",
        [&](T* pixels) { return rows.Maximum(slab, row.point, row.step, pixels, row.width); },
        [&](FixedVector& point, T* pixels) {
          vorl_detail::MipRowRef(m_view, sampler, slab, point, row.step, pixels, row.width);
        });
  }

  // The kernels do every row but those for which their conditions say that they do not.
  bool CanDo(const RowCase& row, std::int32_t count, const SlabSamples& slab) const {
    FixedVector start = row.point;
    bool can = m_variant != CpuVariant::Reference && m_view.Width() >= 2;
    for (std::int32_t k = 0; k < count; ++k) {
      can = can && !Wraps(start, row.step, row.width);
      start += slab.step;
    }
    return can;
  }

  // A row that the sampler leaves is done by the plain loop, in the same pixels, as the operators
  // do it.
  template <class Sample, class Plain>
  void Compare(const RowCase& row, bool canDo, const char* sampler, const char* sink,
               Sample&& sample, Plain&& plain) {
    if (testing::Test::HasFailure()) {
      return;
    }
    const std::size_t first = kGuard + row.shift;
    m_given.assign(first + row.width + kGuard, kMark);
    m_expected = m_given;
    FixedVector point = row.point;
    plain(point, m_expected.data() + first);
    const bool isDone = sample(m_given.data() + first);
    ++(isDone ? m_tally.done : m_tally.left);
    ASSERT_EQ(isDone, canDo) << sampler << ' ' << sink << ", " << row;
    if (!isDone) {
      ASSERT_EQ(std::count(m_given.begin(), m_given.end(), kMark),
                static_cast<std::ptrdiff_t>(m_given.size()))
          << sampler << ' ' << sink << " did a part of " << row;
      point = row.point;
      plain(point, m_given.data() + first);
    }
    if (m_given != m_expected) {
      const auto [given, expected] =
          std::mismatch(m_given.begin(), m_given.end(), m_expected.begin());
      FAIL() << "pixel " << (given - m_given.begin()) - static_cast<std::ptrdiff_t>(first) << " is "
             << *given << " instead of " << *expected << ", " << sampler << ' ' << sink << ", "
             << row;
    }
  }

  const VolumeView& m_view;
  CpuVariant m_variant;
  Tally& m_tally;
  vorl_detail::NearestSampler<T> m_nearest;
  vorl_detail::TrilinearSampler<T> m_linear;
  vorl_detail::RowSampler<T> m_nearestRows;
  vorl_detail::RowSampler<T> m_linearRows;
  std::vector<T> m_given;
  std::vector<T> m_expected;
};

}  // namespace row_cases

#endif
