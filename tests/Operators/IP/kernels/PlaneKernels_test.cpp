// The sampling loops of every variant keep within the row that they are given, whatever is in it
// before, and within the list of slices.
#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <gtest/gtest.h>
#include <tests/Support/Allocation.h>
#include <tests/Support/VariantTest.h>

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <limits>
#include <optional>
#include <random>
#include <string>
#include <type_traits>
#include <vector>

#include "PlaneSweep.h"

namespace {

using namespace plane_sweep;
using vorl_detail::PlaneKernels;
using vorl_detail::RowSink;
using vorl_detail::VolumeGrid;

class PlaneKernelsTest : public VariantTest {};

INSTANTIATE_TEST_SUITE_P(, PlaneKernelsTest, testing::Values(CpuVariant::Avx2, CpuVariant::Avx512),
                         &VariantName);

// A volume in whose middle every step of a row of kWidest points stays.
constexpr Shape kShape{kWidest + 4, 4, 4, 16};

struct Start {
  FixedVector point;
  FixedVector step;
};

constexpr Start kStarts[] = {{{kOne, kOne, kOne}, {kOne, 0, 0}},
                             {{3 * kOne + 32768, kOne + 1, 2 * kOne + 65535}, {kOne, 0, 0}},
                             {{9, 9, 9}, {kOne - 300, 0, 0}},
                             {{kShape.width * kOne - 1, 9, 9}, {-kOne, 0, 0}},
                             {{9, 9, 9}, {kOne - 300, 900, 1300}},
                             {{kShape.width * kOne - 1, 9, 9}, {-40000, 900, 0}}};

/// What is in a row beforehand: numbers about which sums wrap, and any others.
std::int32_t AnyNumber(std::mt19937& random) {
  switch (random() % 4) {
    case 0:
      return std::numeric_limits<std::int32_t>::max();
    case 1:
      return std::numeric_limits<std::int32_t>::min();
    default:
      return static_cast<std::int32_t>(random()) >> (random() % 20);
  }
}

std::int32_t Sunk(std::int32_t before, std::int32_t sample, RowSink sink) {
  if (sink == RowSink::Maximum) {
    return std::max(before, sample);
  }
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(before) +
                                   static_cast<std::uint32_t>(sample));
}

template <class T>
class RowsBetweenGuards {
 public:
  RowsBetweenGuards(CpuVariant variant, const Values& values)
      : m_kernels(*vorl_detail::PlaneKernelsOf(variant)),
        m_volume(kShape, values, GuardPages::Side::Behind, m_random),
        m_grid(VolumeGrid::Of(m_volume.View())),
        m_nearest(m_volume.View()),
        m_linear(m_volume.View()) {}

  void Run() {
    constexpr std::size_t kType = std::is_signed_v<T> ? 1 : 0;
    ASSERT_TRUE(m_grid);
    for (const Start& start : kStarts) {
      for (std::size_t count = 1; count <= kWidest; ++count) {
        for (const GuardPages::Side side : GuardPages::kSides) {
          Check(start, count, side, m_nearest, *m_kernels.nearest[kType]);
          Check(start, count, side, m_linear, *m_kernels.linear[kType]);
        }
      }
    }
  }

 private:
  template <class Sampler>
  void Check(const Start& start, std::size_t count, GuardPages::Side side, const Sampler& sampler,
             vorl_detail::SampleRun& run) {
    if (testing::Test::HasFailure()) {
      return;
    }
    m_samples.clear();
    FixedVector point = start.point;
    for (std::size_t i = 0; i < count; ++i) {
      ASSERT_TRUE(m_volume.View().IsInside(point));
      m_samples.push_back(sampler(point));
      point += start.step;
    }
    const GuardPages pixels(count * sizeof(T), side);
    run(*m_grid, start.point, start.step, count, RowSink::Store, pixels.Data());
    for (std::size_t i = 0; i < count; ++i) {
      ASSERT_EQ(static_cast<const T*>(pixels.Data())[i], static_cast<T>(m_samples[i]))
          << i << " of " << count << " from " << row_cases::Text(start.point);
    }
    for (const RowSink sink : {RowSink::Maximum, RowSink::Sum}) {
      const GuardPages row(count * sizeof(std::int32_t), side);
      auto* const numbers = static_cast<std::int32_t*>(row.Data());
      std::generate_n(numbers, count, [this] { return AnyNumber(m_random); });
      const std::vector<std::int32_t> before(numbers, numbers + count);
      run(*m_grid, start.point, start.step, count, sink, numbers);
      for (std::size_t i = 0; i < count; ++i) {
        ASSERT_EQ(numbers[i], Sunk(before[i], m_samples[i], sink))
            << i << " of " << count << " from " << row_cases::Text(start.point)
            << (sink == RowSink::Sum ? ", sum" : ", maximum");
      }
    }
  }

  std::mt19937 m_random{201};
  const PlaneKernels& m_kernels;
  GuardedVolume<T> m_volume;
  std::optional<VolumeGrid> m_grid;
  vorl_detail::NearestSampler<T> m_nearest;
  vorl_detail::TrilinearSampler<T> m_linear;
  std::vector<std::int32_t> m_samples;
};

TEST_P(PlaneKernelsTest, EverySinkTakesTheSamplesIntoItsRowOnly) {
  RowsBetweenGuards<std::uint16_t>(GetParam(), {0, 8191}).Run();
  RowsBetweenGuards<std::uint16_t>(GetParam(), {0, 65535}).Run();
  RowsBetweenGuards<std::int16_t>(GetParam(), {-4096, 4095}).Run();
  RowsBetweenGuards<std::int16_t>(GetParam(), {-32768, 32767}).Run();
}

// The list of slices and the rows of numbers end where memory ends.
TEST_P(PlaneKernelsTest, TablesOfASamplerAreReadWithinTheirEnds) {
  std::mt19937 random(202);
  for (int depth = 1; depth <= 5; ++depth) {
    const GuardedVolume<std::uint16_t> volume({kWidest, 2, depth, 2}, {0, 65535},
                                              GuardPages::Side::Behind, random);
    const vorl_detail::SlabSamples slab({0, 0, depth * kOne - 2}, depth + 1);
    const vorl_detail::TrilinearSampler<std::uint16_t> sampler(volume.View());
    for (std::size_t width = 0; width <= kWidest; ++width) {
      for (const FixedVector& step : {FixedVector{kOne, 0, 0}, FixedVector{kOne - 1, 900, 0}}) {
        std::vector<std::uint16_t> given(width), maximum(width), expected(width), highest(width);
        bool isDone = false;
        {
          const AllocationGuard guard;
          vorl_detail::RowSampler<std::uint16_t> rows(volume.View(), true, GetParam());
          isDone = rows.Mean(slab, {0, 0, 1}, step, given.data(), width);
          vorl_detail::RowSampler<std::uint16_t> other(volume.View(), true, GetParam());
          isDone = other.Maximum(slab, {0, 0, 1}, step, maximum.data(), width) && isDone;
        }
        ASSERT_TRUE(isDone);
        FixedVector point{0, 0, 1};
        vorl_detail::MprThickRowRef(volume.View(), sampler, slab, point, step, expected.data(),
                                    width);
        ASSERT_EQ(given, expected) << width << " of " << depth << " slices";
        point = {0, 0, 1};
        vorl_detail::MipRowRef(volume.View(), sampler, slab, point, step, highest.data(), width);
        ASSERT_EQ(maximum, highest) << width << " of " << depth << " slices";
      }
    }
  }
}

}  // namespace
