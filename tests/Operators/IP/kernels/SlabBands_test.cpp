// Slabs that are sampled in bands of rows, piece by piece, give the same bits as the plain loops.
#include <vorl/Operators/IP/kernels/Mip.h>
#include <vorl/Operators/IP/kernels/Mpr.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>
#include <vorl/Operators/IP/kernels/SlabBands.h>

#include <gtest/gtest.h>
#include <tests/Support/VariantTest.h>

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <sstream>
#include <string>
#include <type_traits>
#include <vector>

#include "SlabPictures.h"

namespace {

using namespace slab_pictures;
using vorl_detail::RowSampler;
using vorl_detail::RowSink;
using vorl_detail::SlabBands;

class SlabBandVariants : public VariantTest {};

INSTANTIATE_TEST_SUITE_P(, SlabBandVariants, testing::Values(CpuVariant::Avx2, CpuVariant::Avx512),
                         &VariantName);

/// Whether a coordinate of the row's slab wraps, so that the plain loop is to do it.
bool Wraps(const Picture& picture, const FixedVector& start) {
  const SlabSamples slab(picture.depth, picture.depthSteps);
  FixedVector point = start;
  for (std::int32_t k = 0; k < slab.count; ++k, point += slab.step) {
    if (row_cases::Wraps(point, picture.columnStep, picture.width)) {
      return true;
    }
  }
  return false;
}

/// The picture by bands and by the plain loops; rows that the bands leave must be left as they are.
template <class T, class Sampler>
void Check(const VolumeView& view, CpuVariant variant, const Picture& picture, RowSink sink,
           Tally& tally) {
  constexpr bool kIsLinear = std::is_same_v<Sampler, vorl_detail::TrilinearSampler<T>>;
  constexpr std::size_t kGuard = 40;
  constexpr T kMark = 0x5A5A;
  SCOPED_TRACE(testing::Message() << picture << (kIsLinear ? ", trilinear " : ", nearest ")
                                  << (sink == RowSink::Sum ? "mean" : "maximum"));
  const SlabSamples slab(picture.depth, picture.depthSteps);
  const Sampler sampler(view);
  const std::atomic<bool> isStopped = false;
  RowSampler<T> rows(view, kIsLinear, variant);
  SlabBands<T> bands(rows, PlaneOf(picture), slab, sink, isStopped);
  FixedVector start = picture.start;
  for (std::size_t row = 0; row < picture.height; ++row, start += picture.rowStep) {
    std::vector<T> given(picture.width + 2 * kGuard, kMark);
    std::vector<T> expected = given;
    const bool isDone = bands.Row(row, picture.height, start, given.data() + kGuard, picture.width);
    ++(isDone ? tally.done : tally.left);
    ASSERT_EQ(isDone, view.Width() >= 2 && !Wraps(picture, start)) << "row " << row;
    FixedVector point = start;
    if (isDone && sink == RowSink::Sum) {
      vorl_detail::MprThickRowRef(view, sampler, slab, point, picture.columnStep,
                                  expected.data() + kGuard, picture.width);
    } else if (isDone) {
      vorl_detail::MipRowRef(view, sampler, slab, point, picture.columnStep,
                             expected.data() + kGuard, picture.width);
    }
    ASSERT_EQ(given, expected) << "row " << row;
  }
}

/// Random pictures that `next` makes, in random volumes, in all ways.
template <class T, class Next>
void SweepPictures(CpuVariant variant, unsigned seed, int count, Tally& tally, Next&& next) {
  ForEachPicture<T>(
      variant, seed, count, next, [&](const VolumeView& view, const Picture& picture) {
        for (const RowSink sink : {RowSink::Maximum, RowSink::Sum}) {
          Check<T, vorl_detail::NearestSampler<T>>(view, variant, picture, sink, tally);
          Check<T, vorl_detail::TrilinearSampler<T>>(view, variant, picture, sink, tally);
        }
      });
}

// More columns than a piece has, more layers, and more rows than a band.
template <class T>
struct AnyDirection {
  static void Run(CpuVariant variant) {
    Tally tally;
    SweepPictures<T>(variant, 301, 40, tally, [](Sweep<T>& sweep, const Shape& shape) {
      const auto step = [&] { return sweep.Between(-kOne, kOne); };
      Picture picture;
      picture.width = static_cast<std::size_t>(sweep.Between(0, 3) * 64 + sweep.Between(-2, 2));
      picture.width = picture.width > 400 ? 1 : picture.width;  // none below 0
      picture.height = static_cast<std::size_t>(sweep.random() % 4 == 0 ? sweep.Between(63, 130)
                                                                        : sweep.Between(1, 9));
      picture.depthSteps = sweep.random() % 3 == 0 ? sweep.Between(15, 50) : sweep.Between(2, 9);
      picture.start = sweep.Point(shape);
      picture.columnStep = sweep.random() % 3 == 0 ? FixedVector{kOne, 0, 0}
                                                   : FixedVector{step(), step() / 8, step() / 16};
      picture.rowStep = {step() / 4, step() / 2, step() / 4};
      picture.depth = sweep.Depth(shape);
      return picture;
    });
    EXPECT_GT(tally.done, 10 * tally.left);
  }
};

TEST_P(SlabBandVariants, PicturesInAnyDirectionEqualThePlainLoops) {
  ForBothTypes<AnyDirection>(GetParam());
}

// Row after row moves on until one begins before 2^31 and ends behind it.
template <class T>
struct WrappingRows {
  static void Run(CpuVariant variant) {
    Tally tally;
    SweepPictures<T>(variant, 302, 6, tally, [](Sweep<T>& sweep, const Shape&) {
      Picture picture;
      picture.width = 20;
      picture.height = 90;
      const std::int32_t rowStep = sweep.Between(600, 900);
      const std::int32_t wrappingRow = sweep.Between(20, 40);
      picture.start = {(32767 - sweep.Between(0, 8) - wrappingRow * rowStep) * kOne,
                       sweep.Fraction(), sweep.Fraction()};
      picture.columnStep = {kOne / 2, 0, 0};
      picture.rowStep = {rowStep * kOne, 0, 0};
      picture.depth = {kOne, kOne, 0};
      return picture;
    });
    EXPECT_GT(tally.done, 0);
    EXPECT_GT(tally.left, 0);
  }
};

TEST_P(SlabBandVariants, OnlyRowsThatWrapAreLeftToThePlainLoops) {
  ForBothTypes<WrappingRows>(GetParam());
}

TEST_P(SlabBandVariants, AStoppedRowIsLeftAsItIs) {
  Sweep<std::uint16_t> sweep(GetParam(), 303);
  const GuardedVolume<std::uint16_t> volume({20, 9, 3}, {1, 500}, GuardPages::Side::Behind,
                                            sweep.random);
  const Picture picture{{}, {kOne, 0, 0}, {0, kOne, 0}, {0, 0, kOne}, 3, 20, 9};
  std::atomic<bool> isStopped = true;
  RowSampler<std::uint16_t> rows(volume.View(), false, GetParam());
  SlabBands<std::uint16_t> bands(rows, PlaneOf(picture), SlabSamples(picture.depth, 3),
                                 RowSink::Maximum, isStopped);
  std::vector<std::uint16_t> pixels(picture.width, 0x5A5A);
  EXPECT_TRUE(bands.Row(0, picture.height, picture.start, pixels.data(), picture.width));
  EXPECT_EQ(pixels, std::vector<std::uint16_t>(picture.width, 0x5A5A));
  EXPECT_TRUE(bands.HasLeftRow());
}

TEST(RowLoop, ARowThatWasStoppedOnTheWayDoesNotCount) {
  const std::atomic<bool> isStopped = false;
  std::atomic<double> progress = 0.0;
  const auto untilThird = [](std::size_t index) { return index < 2; };
  EXPECT_FALSE(vorl_detail::ForEachRow({isStopped, progress, true}, 4, untilThird));
  EXPECT_EQ(progress, 0.5);
}

TEST_P(SlabBandVariants, SlabsOfFarMoreLayersThanVoxelsAreLeftToThePlainLoops) {
  Sweep<std::uint16_t> sweep(GetParam(), 304);
  const GuardedVolume<std::uint16_t> volume({20, 9, 3}, {1, 500}, GuardPages::Side::Behind,
                                            sweep.random);
  const std::atomic<bool> isStopped = false;
  RowSampler<std::uint16_t> rows(volume.View(), false, GetParam());
  for (const bool isTooMany : {false, true}) {
    const std::int32_t layers = isTooMany ? 65537 : 65536;
    const Picture picture{{}, {kOne, 0, 0}, {0, kOne, 0}, {0, 0, kOne}, layers, 2, 2};
    SlabBands<std::uint16_t> bands(rows, PlaneOf(picture), SlabSamples(picture.depth, layers),
                                   RowSink::Maximum, isStopped);
    std::vector<std::uint16_t> pixels(picture.width);
    EXPECT_EQ(bands.Row(0, picture.height, picture.start, pixels.data(), picture.width),
              !isTooMany);
  }
}

}  // namespace
