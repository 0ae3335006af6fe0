// Every variant of the sampling loops that can run here gives the same bits as the plain loops, and
// reads nothing but the voxels: each slice's raster touches a page that nobody may read, first with
// its end, then with its begin.
#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <gtest/gtest.h>
#include <tests/Support/VariantTest.h>

#include <cstdint>
#include <iterator>
#include <string>

#include "PlaneSweep.h"

namespace {

using namespace plane_sweep;

class PlaneVariants : public VariantTest {};

INSTANTIATE_TEST_SUITE_P(, PlaneVariants, testing::Values(CpuVariant::Avx2, CpuVariant::Avx512),
                         &VariantName);

// ---- Along rows of voxels --------------------------------------------------------------------

// Volumes and runs of every width, and every combination of fractions, with every kind of values.
template <class T>
struct AlongRows {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 101);
    std::size_t turn = 0;
    for (const Values& values : AllValues<T>()) {
      for (int width = 1; width <= kWidest; ++width, ++turn) {
        const Shape shape{width, sweep.Between(1, 6), sweep.Between(1, 6), sweep.Alignment()};
        sweep.Check(shape, values, GuardPages::kSides[turn % 2], 2, [&] {
          RowCase row;
          row.point = sweep.Point(shape);
          row.point.x = sweep.random() % 2 != 0 ? 0 : sweep.Between(-4, width - 1) * kOne;
          row.point.x += kFractions[turn % 5];
          row.point.y = (row.point.y & ~0xFFFF) + kFractions[turn / 5 % 5];
          row.point.z = (row.point.z & ~0xFFFF) + kFractions[turn / 25 % 5];
          row.step = {kOne, 0, 0};
          row.depth = sweep.Depth(shape);
          row.depthSteps = sweep.Between(2, 5);
          row.width = static_cast<std::size_t>(
              sweep.random() % 2 != 0 ? width + 5 : sweep.Between(0, width + 5));
          row.shift = sweep.random() % 32;
          return row;
        });
      }
    }
    EXPECT_GT(sweep.tally.done, 20 * sweep.tally.left);
  }
};

TEST_P(PlaneVariants, RowsAlongVoxelsEqualThePlainLoops) {
  ForBothTypes<AlongRows>(GetParam());
}

// Along a row of voxels by a voxel and less, in either direction, and by a little more.
template <class T>
struct WithinRows {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 110);
    const std::int32_t steps[] = {0, 1, 300, 21845, 32768, kOne / 3 * 2, kOne - 1, kOne, kOne + 1};
    for (int width = 2; width <= kWidest; ++width) {
      for (const std::int32_t step : steps) {
        const Shape shape{width, sweep.Between(1, 3), sweep.Between(1, 3), sweep.Alignment()};
        sweep.Check(shape, {0, 65535 >> std::is_signed_v<T>, true}, sweep.Side(), 2, [&] {
          RowCase row;
          row.point = sweep.Point(shape);
          row.step = {sweep.random() % 2 != 0 ? step : -step, 0, 0};
          if (sweep.random() % 2 != 0) {  // from one end of the row towards the other
            row.point.x = row.step.x < 0 ? width * kOne - 1 : 0;
          }
          row.depth = sweep.Depth(shape);
          row.width = static_cast<std::size_t>(sweep.Between(0, 2 * kWidest));
          row.shift = sweep.random() % 32;
          return row;
        });
      }
    }
    EXPECT_GT(sweep.tally.done, 20 * sweep.tally.left);
  }
};

TEST_P(PlaneVariants, RowsWithinARowOfVoxelsEqualThePlainLoops) {
  ForBothTypes<WithinRows>(GetParam());
}

// More registers than the kernels do between two looks at the values: few of those have no room.
template <class T>
struct LongRows {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 102);
    for (const int width : {257, 258, 289, 512, 513, 514, 545, 1025, 1026, 1100}) {
      for (const unsigned outliers : {0U, 1U, 2U}) {
        const Shape shape{width, 2, 2, sweep.Alignment()};
        const Values values{0, 4095, true, outliers};
        sweep.Check(shape, values, sweep.Side(), 3, [&] {
          RowCase row;
          row.point = {sweep.Between(-2, 30) * kOne + sweep.Fraction(), sweep.Fraction(),
                       sweep.Fraction()};
          row.step = {kOne, 0, 0};
          row.depth = {0, 0, kOne};
          row.width = static_cast<std::size_t>(width);
          row.shift = sweep.random() % 32;
          return row;
        });
      }
    }
    EXPECT_EQ(sweep.tally.left, 0);
  }
};

TEST_P(PlaneVariants, LongRowsEqualThePlainLoops) {
  ForBothTypes<LongRows>(GetParam());
}

// Each voxel in turn is the only one without room, one beyond the border on either side.
template <class T>
struct LonelyOutliers {
  static void Run(CpuVariant variant) {
    constexpr int kWidth = 67;
    Sweep<T> sweep(variant, 103);
    const GuardedVolume<T> volume({kWidth, 2, 2, 2}, {5, 5}, GuardPages::Side::Behind,
                                  sweep.random);
    RowCheck<T> check(volume.View(), variant, sweep.tally);
    for (int z = 0; z < 2; ++z) {
      T* const slice = const_cast<T*>(volume.View().template Slice<T>(z));
      for (int i = 0; i < 2 * kWidth; ++i) {
        SCOPED_TRACE("voxel " + std::to_string(i) + " of slice " + std::to_string(z));
        for (const int value : {32767, std::is_signed_v<T> ? -32768 : 65535}) {
          slice[i] = static_cast<T>(value);
          RowCase row;
          row.point = {sweep.Fraction(), sweep.Between(1, kOne - 1), sweep.Between(1, kOne - 1)};
          row.step = {kOne, 0, 0};
          row.width = kWidth;
          check.Run(row);
        }
        slice[i] = 5;
      }
    }
  }
};

TEST_P(PlaneVariants, OneVoxelWithoutRoomIsSeenWhereverItIs) {
  ForBothTypes<LonelyOutliers>(GetParam());
}

// ---- In any direction ------------------------------------------------------------------------

constexpr FixedVector kSteps[] = {{kOne, 0, 0},      {-kOne, 0, 0},       {2 * kOne, 0, 0},
                                  {kOne / 2, 0, 0},  {-kOne / 3, 0, 0},   {kOne + 1, 0, 0},
                                  {kOne - 1, 0, 0},  {0, kOne, 0},        {0, -kOne, 0},
                                  {0, 3001, 0},      {0, 0, kOne},        {0, 0, -kOne},
                                  {0, 0, 2500},      {kOne, 1, 0},        {kOne, 0, 1},
                                  {kOne, -1, -1},    {0, 0, 0},           {1, 1, 1},
                                  {-1, -1, -1},      {50000, 2900, 1700}, {-41111, 999, -2222},
                                  {30000, -1800, 0}, {20 * kOne, kOne, 0}};

template <class T>
struct AnyDirection {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 104);
    const auto kinds = AllValues<T>();
    for (int i = 0; i < 300; ++i) {
      const Shape shape{sweep.random() % 4 == 0 ? sweep.Between(1, 3) : sweep.Between(2, 90),
                        sweep.Between(1, 6), sweep.Between(1, 6), sweep.Alignment()};
      const Values& values = kinds[sweep.random() % kinds.size()];
      sweep.Check(shape, values, sweep.Side(), 5, [&] {
        RowCase row;
        row.step = kSteps[sweep.random() % std::size(kSteps)];
        row.point = sweep.Point(shape);
        row.width = sweep.random() % (sweep.random() % 4 == 0 ? 80 : 24);
        if (sweep.random() % 2 != 0) {  // the row's middle in the volume, not its first point
          row.point = row.point - row.step.Times(static_cast<std::int32_t>(row.width / 2));
        }
        row.depth = sweep.Depth(shape);
        row.depthSteps = sweep.random() % 8 == 0 ? sweep.Between(2, 70) : sweep.Between(2, 6);
        row.shift = sweep.random() % 32;
        return row;
      });
    }
    EXPECT_GT(sweep.tally.done, 5 * sweep.tally.left);
  }
};

TEST_P(PlaneVariants, RowsInAnyDirectionEqualThePlainLoops) {
  ForBothTypes<AnyDirection>(GetParam());
}

// Rows that run through the last column, row and slice, and end or turn to the outside there.
template <class T>
struct LastVoxels {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 105);
    const auto kinds = AllValues<T>();
    for (int i = 0; i < 120; ++i) {
      const Shape shape{sweep.Between(2, 40), sweep.Between(1, 4), sweep.Between(1, 4),
                        sweep.Alignment()};
      sweep.Check(shape, kinds[sweep.random() % kinds.size()], sweep.Side(), 4, [&] {
        const FixedVector last{shape.width * kOne - 1, shape.height * kOne - 1,
                               shape.depth * kOne - 1};
        RowCase row;
        row.width = 1 + sweep.random() % 40;
        row.point = {last.x - sweep.Between(0, 2 * kOne - 1), last.y - sweep.Between(0, kOne - 1),
                     last.z - sweep.Between(0, kOne - 1)};
        switch (sweep.random() % 4) {
          case 0:  // to the last point of all, backwards along each axis in turn
            row.point = last;
            row.step = {sweep.Between(-kOne, 0), sweep.Between(-200, 0), sweep.Between(-200, 0)};
            break;
          case 1:
            row.step = {0, sweep.Between(-3000, 3000), sweep.Between(-3000, 3000)};
            break;
          case 2:
            row.step = {sweep.Between(-900, 900), 0, 0};
            break;
          default:
            row.step = {kOne, 0, 0};
            row.point.x = last.x - static_cast<std::int32_t>(row.width) * kOne;
            break;
        }
        row.depth = sweep.Depth(shape);
        row.depthSteps = sweep.Between(2, 4);
        row.shift = sweep.random() % 32;
        return row;
      });
    }
    EXPECT_EQ(sweep.tally.left, 0);
  }
};

TEST_P(PlaneVariants, RowsAtTheLastVoxelsEqualThePlainLoops) {
  ForBothTypes<LastVoxels>(GetParam());
}

// Numbers of 32 bits to their ends: many rows are left to the plain loops, none half done.
template <class T>
struct HugeNumbers {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 106);
    const auto any = [&] {
      return static_cast<std::int32_t>(sweep.random()) / (1 << sweep.random() % 16);
    };
    for (int i = 0; i < 150; ++i) {
      const Shape shape{sweep.Between(2, 50), sweep.Between(1, 6), sweep.Between(1, 6), 2};
      sweep.Check(shape, {0, 5000}, sweep.Side(), 6, [&] {
        RowCase row;
        row.point = sweep.random() % 4 == 0 ? FixedVector{any(), any(), any()} : sweep.Point(shape);
        row.step = {any(), sweep.random() % 2 != 0 ? any() : 0,
                    sweep.random() % 2 != 0 ? any() : 0};
        row.depth = {any(), any(), sweep.random() % 2 != 0 ? any() : 0};
        row.depthSteps = sweep.Between(2, 70);
        row.width = sweep.random() % 20;
        row.shift = sweep.random() % 32;
        return row;
      });
    }
    EXPECT_GT(sweep.tally.done, 500);
    EXPECT_GT(sweep.tally.left, 500);
  }
};

TEST_P(PlaneVariants, RowsOfHugeStepsEqualThePlainLoops) {
  ForBothTypes<HugeNumbers>(GetParam());
}

// A row that starts inside, leaves at 2^31 and comes back from the other end: no kernel's.
TEST_P(PlaneVariants, RowsThatWrapBackIntoTheVolumeAreThePlainLoops) {
  Sweep<std::uint16_t> sweep(GetParam(), 107);
  const Shape shape{9, 2, 2, 2};
  sweep.Check(shape, {1, 999}, GuardPages::Side::Behind, 1, [] {
    RowCase row;
    row.point = {kOne, kOne / 2, kOne / 2};
    row.step = {1 << 30, 0, 0};  // round in four steps
    row.width = 30;
    return row;
  });
  EXPECT_EQ(sweep.tally.done, 0);
  // A slab whose starts wrap as a whole is a kernel's: no row of it does.
  sweep.Check(shape, {1, 999}, GuardPages::Side::Behind, 1, [] {
    RowCase row;
    row.point = {kOne, kOne / 2, kOne / 2};
    row.step = {kOne, 0, 0};
    row.depth = {INT32_MIN, 0, 0};
    row.depthSteps = 2;
    row.width = 30;
    return row;
  });
  EXPECT_EQ(sweep.tally.done, 6);
}

// ---- Sizes -----------------------------------------------------------------------------------

// From 32768 columns on the size in 16.16 wraps, and nothing or a part of each row is inside.
template <class T>
struct ManyColumns {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 108);
    for (const int width : {32766, 32767, 32768, 32769, 40000, 65535, 65536, 65537, 65570}) {
      const Shape shape{width, 2, 1, 2};
      sweep.Check(shape, {0, 4095, false, 3}, sweep.Side(), 8, [&] {
        RowCase row;
        row.width = 90;
        const int column = sweep.random() % 2 != 0 ? width : width & 0x7FFF;
        row.point = {vorl_detail::FixedSize(column - 90 + sweep.Between(0, 40)) + sweep.Fraction(),
                     sweep.Place(2), sweep.Fraction()};
        row.step = {kOne, 0, 0};
        if (sweep.random() % 2 != 0) {
          row.step = {sweep.Between(-kOne, kOne), sweep.Between(-300, 300), 0};
        }
        row.depth = {0, kOne, 0};
        row.depthSteps = 3;
        return row;
      });
    }
    EXPECT_GT(sweep.tally.done, 200);
  }
};

TEST_P(PlaneVariants, VolumesOfManyColumnsEqualThePlainLoops) {
  ForBothTypes<ManyColumns>(GetParam());
}

// Slabs of every number of samples, up and down.
template <class T>
struct SlabCounts {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 109);
    const auto kinds = AllValues<T>();
    for (int count = 2; count <= 70; ++count) {
      const Shape shape{37, 3, 6, sweep.Alignment()};
      sweep.Check(shape, kinds[sweep.random() % kinds.size()], sweep.Side(), 2, [&] {
        RowCase row;
        row.point = {sweep.Fraction(), sweep.Place(3), sweep.Between(0, 6) * kOne};
        row.step = sweep.random() % 2 != 0 ? FixedVector{kOne, 0, 0} : FixedVector{40000, 700, 9};
        row.depth = sweep.Depth(shape);
        row.depth.z = count % 2 != 0 ? 7 * kOne : -7 * kOne;
        row.depthSteps = count;
        row.width = 41;
        return row;
      });
    }
    EXPECT_EQ(sweep.tally.left, 0);
  }
};

TEST_P(PlaneVariants, SlabsOfEveryCountEqualThePlainLoops) {
  ForBothTypes<SlabCounts>(GetParam());
}

TEST(PlaneReference, LeavesEveryRowToThePlainLoops) {
  EXPECT_EQ(vorl_detail::PlaneKernelsOf(CpuVariant::Reference), nullptr);
  Sweep<std::int16_t> sweep(CpuVariant::Reference, 110);
  const Shape shape{20, 3, 3, 2};
  sweep.Check(shape, {-500, 500}, GuardPages::Side::Behind, 20, [&] {
    RowCase row;
    row.point = sweep.Point(shape);
    row.step = {kOne, 0, 0};
    row.depth = sweep.Depth(shape);
    row.width = 20;
    return row;
  });
  EXPECT_EQ(sweep.tally.done, 0);
}

}  // namespace
