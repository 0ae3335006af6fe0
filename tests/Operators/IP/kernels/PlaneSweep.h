#ifndef TESTS_OPERATORS_IP_KERNELS_PLANESWEEP_H
#define TESTS_OPERATORS_IP_KERNELS_PLANESWEEP_H

/// @file
/// Random rows through random volumes.

#include <gtest/gtest.h>

#include <cstdint>
#include <iterator>
#include <random>
#include <sstream>
#include <type_traits>
#include <utility>
#include <vector>

#include "RowCases.h"

namespace plane_sweep {

using guarded_volume::GuardedVolume;
using guarded_volume::Shape;
using guarded_volume::Values;
using row_cases::CpuVariant;
using row_cases::FixedVector;
using row_cases::RowCase;
using row_cases::RowCheck;
using row_cases::Tally;

inline constexpr std::int32_t kOne = 65536;
/// Four AVX-512 registers of 16-bit lanes, one more sample, and its neighbour.
inline constexpr int kWidest = 4 * 32 + 2;
/// On a voxel, beside it, and about where a fraction of 16 bits turns negative.
inline constexpr std::int32_t kFractions[] = {0, 1, 32767, 32768, 65535};

/// Samples of 13 bits are interpolated in 16: their borders and one beyond; where 16 bits no longer
/// do, three times the range being 32767; and everything.
template <class T>
std::vector<Values> AllValues() {
  if constexpr (std::is_signed_v<T>) {
    return {{-4096, 4095},         {-4096, 4095, true},  {-4097, 4095, true}, {-4096, 4096, true},
            {-4096, 12287, true},  {-12288, 4095, true}, {0, 10923, true},    {-32768, 32767},
            {-32768, 32767, true}, {-900, -1},           {-77, -77},          {0, 4095, false, 3}};
  } else {
    return {{0, 8191},        {0, 8191, true},  {0, 8192, true},    {0, 10923, true},
            {0, 16383, true}, {0, 32768, true}, {0, 65535},         {0, 65535, true},
            {1234, 1234},     {65535, 65535},   {0, 4095, false, 3}};
  }
}

/// Makes volumes and rows for a variant, and checks them.
template <class T>
struct Sweep {
  Sweep(CpuVariant chosen, unsigned firstSeed) : variant(chosen), seed(firstSeed), random(seed) {}

  /// Checks the rows that `next` makes, `count` of them, in one volume.
  template <class Next>
  void Check(const Shape& shape, const Values& values, GuardPages::Side side, int count,
             Next&& next) {
    if (testing::Test::HasFailure()) {
      return;
    }
    std::ostringstream text;
    text << vorl_detail::NameOf(variant) << ", seed " << seed << ", "
         << (std::is_signed_v<T> ? "signed " : "unsigned ") << values << ", " << shape
         << (side == GuardPages::Side::Behind ? ", guarded behind" : ", guarded before");
    SCOPED_TRACE(text.str());
    const GuardedVolume<T> volume(shape, values, side, random);
    ASSERT_EQ(vorl_detail::VolumeGrid::Of(volume.View()).has_value(), shape.width >= 2);
    RowCheck<T> check(volume.View(), variant, tally);
    for (int i = 0; i < count; ++i) {
      check.Run(next());
    }
  }

  int Between(int low, int high) {
    return low + static_cast<int>(random() % static_cast<unsigned>(high - low + 1));
  }
  std::int32_t Fraction() { return kFractions[random() % std::size(kFractions)]; }
  GuardPages::Side Side() { return GuardPages::kSides[random() % 2]; }
  unsigned short Alignment() { return static_cast<unsigned short>(2 << random() % 5); }
  /// A place along an axis of so many voxels, rarely outside.
  std::int32_t Place(int size) {
    const int voxel = random() % 8 == 0 ? Between(-2, size + 1) : Between(0, size - 1);
    return voxel * kOne + (random() % 2 != 0 ? Fraction() : Between(0, kOne - 1));
  }
  FixedVector Point(const Shape& shape) {
    return {Place(shape.width), Place(shape.height), Place(shape.depth)};
  }
  /// A slab through a few slices, in either direction, or an oblique one.
  FixedVector Depth(const Shape& shape) {
    if (random() % 2 != 0) {
      const std::int32_t thickness = shape.depth * kOne + Between(0, kOne - 1);
      return {0, 0, random() % 2 != 0 ? thickness : -thickness};
    }
    return {Between(-9 * kOne, 9 * kOne), Between(-4 * kOne, 4 * kOne), Between(-kOne, 3 * kOne)};
  }

  CpuVariant variant;
  unsigned seed;
  std::mt19937 random;
  Tally tally;
};

/// Runs one sweep for each type of samples.
template <template <class> class Check>
void ForBothTypes(CpuVariant variant) {
  Check<std::uint16_t>::Run(variant);
  Check<std::int16_t>::Run(variant);
}

}  // namespace plane_sweep

#endif
