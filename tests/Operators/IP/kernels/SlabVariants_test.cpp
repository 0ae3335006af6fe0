// Every variant of the projection of slabs along the grid that can run here gives the same bits as
// the plain loop, reads nothing but the voxels, and takes the slabs that it says it takes.
#include <vorl/Operators/IP/kernels/GridMaximum.h>
#include <vorl/Operators/IP/kernels/Mip.h>
#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <gtest/gtest.h>
#include <tests/Support/VariantTest.h>

#include <cstddef>
#include <cstdint>
#include <iterator>
#include <sstream>
#include <string>
#include <type_traits>
#include <vector>

#include "SlabPictures.h"

namespace {

using namespace slab_pictures;

class SlabVariants : public VariantTest {};

INSTANTIATE_TEST_SUITE_P(, SlabVariants, testing::Values(CpuVariant::Avx2, CpuVariant::Avx512),
                         &VariantName);

/// Whether any row's coordinates wrap in the directions in which its points differ.
bool WrapsAlongRows(const Picture& picture) {
  const bool isAcross = picture.columnStep.x != 0;
  FixedVector start = picture.start;
  for (std::size_t row = 0; row < picture.height; ++row, start += picture.rowStep) {
    const FixedVector point =
        isAcross ? FixedVector{start.x, 0, 0} : FixedVector{0, start.y, start.z};
    if (row_cases::Wraps(point, picture.columnStep, picture.width)) {
      return true;
    }
  }
  return false;
}

/// Projects the picture both ways. Rows that are not taken must be left as they are.
template <class T>
void Check(const VolumeView& view, CpuVariant variant, const Picture& picture, bool isOnGrid,
           Tally& tally) {
  constexpr std::size_t kGuard = 40;
  constexpr T kMark = 0x5A5A;
  SCOPED_TRACE(testing::Message() << picture);
  const SlabSamples slab(picture.depth, picture.depthSteps);
  const SlicePlane plane = PlaneOf(picture);
  const vorl_detail::NearestSampler<T> sampler(view);
  vorl_detail::GridMaximum<T> maximum(view, plane, slab, variant, picture.width, picture.height);
  const bool canDo = isOnGrid && view.Width() >= 2 && !WrapsAlongRows(picture);
  FixedVector start = picture.start;
  for (std::size_t row = 0; row < picture.height; ++row, start += picture.rowStep) {
    std::vector<T> given(picture.width + 2 * kGuard, kMark);
    std::vector<T> expected = given;
    const bool isDone = maximum.Row(row, given.data() + kGuard);
    ++(isDone ? tally.done : tally.left);
    ASSERT_EQ(isDone, canDo) << "row " << row;
    if (isDone) {
      FixedVector point = start;
      vorl_detail::MipRowRef(view, sampler, slab, point, picture.columnStep,
                             expected.data() + kGuard, picture.width);
    }
    ASSERT_EQ(given, expected) << "row " << row;
  }
}

/// Random pictures that `next` makes, `count` of them, in random volumes.
template <class T, class Next>
void SweepPictures(CpuVariant variant, unsigned seed, int count, bool isOnGrid, Tally& tally,
                   Next&& next) {
  const auto withSteps = [&](Sweep<T>& sweep, const Shape& shape) {
    Picture picture = next(sweep, shape);
    picture.depthSteps = sweep.random() % 4 == 0 ? sweep.Between(2, 70) : sweep.Between(2, 9);
    picture.height = sweep.random() % 4 == 0 ? sweep.Between(15, 36) : sweep.Between(1, 6);
    return picture;
  };
  ForEachPicture<T>(variant, seed, count, withSteps,
                    [&](const VolumeView& view, const Picture& picture) {
                      Check<T>(view, variant, picture, isOnGrid, tally);
                    });
}

// Through all of the axis and beyond, from any place, in either direction.
std::int32_t Through(auto& sweep, int size) {
  const std::int32_t thickness = size * kOne + sweep.Between(-kOne, kOne);
  return sweep.random() % 2 != 0 ? thickness : -thickness;
}

// ---- Rows of pixels that are rows of voxels ----------------------------------------------------

template <class T>
struct AcrossRows {
  static void Run(CpuVariant variant) {
    Tally tally;
    SweepPictures<T>(variant, 201, 400, true, tally, [](Sweep<T>& sweep, const Shape& shape) {
      Picture picture;
      picture.start = sweep.Point(shape);
      picture.start.x =
          (sweep.random() % 2 != 0 ? 0 : sweep.Between(-4, shape.width)) * kOne + sweep.Fraction();
      picture.columnStep = {kOne, 0, 0};
      picture.rowStep = {sweep.random() % 4 == 0 ? sweep.Between(-kOne, kOne) : 0,
                         sweep.random() % 2 != 0 ? kOne : sweep.Between(-kOne, kOne),
                         sweep.random() % 2 != 0 ? 0 : sweep.Between(-kOne, kOne)};
      picture.depth = {0, sweep.random() % 2 != 0 ? Through(sweep, shape.height) : 0,
                       sweep.random() % 2 != 0 ? Through(sweep, shape.depth) : 0};
      picture.width = static_cast<std::size_t>(sweep.Between(0, shape.width + 5));
      return picture;
    });
    EXPECT_GT(tally.done, 10 * tally.left);
  }
};

TEST_P(SlabVariants, SlabsAcrossRowsOfVoxelsEqualThePlainLoop) {
  ForBothTypes<AcrossRows>(GetParam());
}

// ---- Slabs along rows of voxels ----------------------------------------------------------------

template <class T>
struct AlongRows {
  static void Run(CpuVariant variant) {
    Tally tally;
    SweepPictures<T>(variant, 202, 400, true, tally, [](Sweep<T>& sweep, const Shape& shape) {
      Picture picture;
      picture.start = sweep.Point(shape);
      if (sweep.random() % 2 != 0) {
        picture.start.x = sweep.random() % 2 != 0 ? 0 : shape.width * kOne - 1;
      }
      picture.columnStep = {0, sweep.random() % 2 != 0 ? kOne : sweep.Between(-kOne, kOne),
                            sweep.random() % 2 != 0 ? 0 : sweep.Between(-kOne, kOne)};
      picture.rowStep = {sweep.random() % 4 == 0 ? sweep.Between(-kOne, kOne) : 0,
                         sweep.Between(-kOne, kOne), sweep.Between(-kOne, kOne)};
      picture.depth = {Through(sweep, shape.width), 0, 0};
      picture.width = static_cast<std::size_t>(sweep.Between(0, 30));
      return picture;
    });
    EXPECT_GT(tally.done, 10 * tally.left);
  }
};

TEST_P(SlabVariants, SlabsAlongRowsOfVoxelsEqualThePlainLoop) {
  ForBothTypes<AlongRows>(GetParam());
}

// A voxel more or less than one per step: columns are met twice, or left out.
template <class T>
struct EveryCount {
  static void Run(CpuVariant variant) {
    Sweep<T> sweep(variant, 203);
    const GuardedVolume<T> volume({131, 4, 3}, {0, 4095, false, 3}, GuardPages::Side::Behind,
                                  sweep.random);
    Tally tally;
    for (int count = 2; count <= 300; ++count) {
      const Picture picture{{0, 0, 0}, {0, kOne, 0}, {0, 0, kOne}, {131 * kOne - 1, 0, 0}, count, 4,
                            3};
      Check<T>(volume.View(), variant, picture, true, tally);
    }
    EXPECT_EQ(tally.left, 0);
  }
};

TEST_P(SlabVariants, SlabsOfEveryCountEqualThePlainLoop) {
  ForBothTypes<EveryCount>(GetParam());
}

// ---- What is left to others --------------------------------------------------------------------

template <class T>
struct OtherDirections {
  static void Run(CpuVariant variant) {
    Tally tally;
    SweepPictures<T>(variant, 204, 100, false, tally, [](Sweep<T>& sweep, const Shape& shape) {
      static const Picture kPictures[] = {
          {{}, {kOne, 0, 0}, {0, kOne, 0}, {100 * kOne, 0, kOne}},  // across rows, but oblique
          {{}, {kOne + 1, 0, 0}, {0, kOne, 0}, {0, 0, kOne}},       // not from voxel to voxel
          {{}, {kOne, 1, 0}, {0, kOne, 0}, {0, 0, kOne}},
          {{}, {kOne, 0, 1}, {0, kOne, 0}, {0, 0, kOne}},
          {{}, {-kOne, 0, 0}, {0, kOne, 0}, {0, 0, kOne}},
          {{}, {0, kOne, 0}, {0, 0, kOne}, {kOne, 100 * kOne, 0}},  // along rows, but oblique
          {{}, {0, kOne, 0}, {0, 0, kOne}, {kOne, 0, 100 * kOne}},
          {{}, {1, kOne, 0}, {0, 0, kOne}, {kOne, 0, 0}}};
      Picture picture = kPictures[sweep.random() % std::size(kPictures)];
      picture.start = sweep.Point(shape);
      picture.width = 7;
      return picture;
    });
    EXPECT_EQ(tally.done, 0);
  }
};

TEST_P(SlabVariants, SlabsInOtherDirectionsAreLeft) {
  ForBothTypes<OtherDirections>(GetParam());
}

// The third row wraps behind its end.
TEST_P(SlabVariants, PicturesWithARowThatWrapsAreLeft) {
  Sweep<std::int16_t> sweep(GetParam(), 205);
  const GuardedVolume<std::int16_t> volume({20, 3, 3}, {-500, 500}, GuardPages::Side::Behind,
                                           sweep.random);
  Tally tally;
  const Picture picture{
      {INT32_MAX - 30 * kOne, 0, 0}, {kOne, 0, 0}, {5 * kOne, 0, 0}, {0, 0, kOne}, 3, 19, 4};
  Check<std::int16_t>(volume.View(), GetParam(), picture, true, tally);
  EXPECT_EQ(tally.left, 4);
}

TEST(SlabReference, LeavesEverySlab) {
  Sweep<std::uint16_t> sweep(CpuVariant::Reference, 206);
  const GuardedVolume<std::uint16_t> volume({20, 3, 3}, {0, 500}, GuardPages::Side::Behind,
                                            sweep.random);
  Tally tally;
  const Picture picture{{0, 0, 0}, {kOne, 0, 0}, {0, kOne, 0}, {0, 0, kOne}, 3, 19, 4};
  Check<std::uint16_t>(volume.View(), CpuVariant::Reference, picture, false, tally);
  EXPECT_EQ(tally.left, 4);
}

}  // namespace
