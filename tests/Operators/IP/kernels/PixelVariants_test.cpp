// Every variant of the pixel loops that can run here gives the same bits as the plain loops, for
// every length up to four registers and one sample more, at every misalignment, on random samples
// and the extremes, reads nothing beside its run, and writes nothing beside its target.
#include <vorl/Operators/IP/kernels/Pixels.h>
#include <vorl/Operators/IP/kernels/WindowRamp.h>

#include <gtest/gtest.h>
#include <tests/Support/GuardPages.h>
#include <tests/Support/VariantTest.h>

#include <algorithm>
#include <limits>
#include <numeric>
#include <random>
#include <string>
#include <tuple>
#include <vector>

#include <vorl/Data/dBCGLUT.h>
#include <vorl/Data/dWindowingLUT.h>

namespace {

using vorl_detail::CpuVariant;
using vorl_detail::PixelKernels;
using vorl_detail::WindowRamp;

// Four AVX-512 registers of bytes, and one byte.
constexpr std::size_t kLongest = 4 * 64 + 1;
constexpr std::size_t kGuard = 64;

class PixelVariants : public VariantTest {
 protected:
  const PixelKernels& Kernels() const { return vorl_detail::PixelKernelsOf(GetParam()); }
};

INSTANTIATE_TEST_SUITE_P(, PixelVariants, testing::ValuesIn(vorl_detail::kCpuVariants),
                         &VariantName);

template <class T>
std::vector<T> RandomSamples(std::size_t count, std::mt19937& random) {
  std::vector<T> samples(count);
  for (T& sample : samples) {
    const unsigned choice = random() % 16;
    sample = choice == 0   ? std::numeric_limits<T>::min()
             : choice == 1 ? std::numeric_limits<T>::max()
                           : static_cast<T>(random());
  }
  return samples;
}

// Calls `check(samples, count)` with runs of every length and misalignment. What may not be read
// follows upon each run, or precedes it.
template <class T, class Check>
void ForEachRun(Check check) {
  constexpr unsigned kSeed = 7;
  SCOPED_TRACE("seed " + std::to_string(kSeed));
  std::mt19937 random(kSeed);
  std::vector<std::size_t> counts(kLongest + 1);
  std::iota(counts.begin(), counts.end(), std::size_t{0});
  counts.insert(counts.end(), {511, 512, 513, 1000});  // some steps of the longest loop
  for (const std::size_t count : counts) {
    const std::vector<T> samples = RandomSamples<T>(count, random);
    for (const GuardPages::Side side : GuardPages::kSides) {
      const GuardPages block(count * sizeof(T), side);
      T* const run = static_cast<T*>(block.Data());
      std::copy(samples.begin(), samples.end(), run);
      check(run, count);
    }
    const std::size_t shift = random() % 32;
    const std::vector<T> block = RandomSamples<T>(shift + count, random);
    check(block.data() + shift, count);
  }
}

// The target of a run, at some misalignment between guards.
template <class T>
class GuardedTarget {
 public:
  explicit GuardedTarget(std::size_t count)
      : m_block(kGuard + count % 32 + count + kGuard, kMark), m_first(kGuard + count % 32) {}

  T* Data() { return m_block.data() + m_first; }
  /// The samples are these, and the guards as they were. Says where they are not.
  testing::AssertionResult Holds(const std::vector<T>& expected) const {
    auto all = std::vector<T>(m_block.size(), kMark);
    const auto first = static_cast<std::ptrdiff_t>(m_first);
    std::copy(expected.begin(), expected.end(), all.begin() + first);
    const auto [given, wanted] = std::mismatch(m_block.begin(), m_block.end(), all.begin());
    if (given == m_block.end()) {
      return testing::AssertionSuccess();
    }
    return testing::AssertionFailure() << "sample " << given - m_block.begin() - first << " is "
                                       << +*given << " instead of " << +*wanted;
  }

 private:
  static constexpr T kMark = 77;

  std::vector<T> m_block;
  std::size_t m_first;
};

template <class T>
void ExpectSameExtremes(const PixelKernels& kernels) {
  ForEachRun<T>([&](const T* samples, std::size_t count) {
    for (const auto& [low, high] : {std::pair(INT32_MAX, INT32_MIN), std::pair(-3, 3)}) {
      std::int32_t expectedLow = low, expectedHigh = high, givenLow = low, givenHigh = high;
      vorl_detail::MinMaxRunRef(samples, count, expectedLow, expectedHigh);
      std::get<vorl_detail::MinMaxRun<T>*>(kernels.minMax)(samples, count, givenLow, givenHigh);
      ASSERT_EQ(givenLow, expectedLow) << count << " samples";
      ASSERT_EQ(givenHigh, expectedHigh) << count << " samples";
    }
  });
}

TEST_P(PixelVariants, MinMaxEqualsThePlainLoop) {
  ExpectSameExtremes<std::uint8_t>(Kernels());
  ExpectSameExtremes<std::int8_t>(Kernels());
  ExpectSameExtremes<std::uint16_t>(Kernels());
  ExpectSameExtremes<std::int16_t>(Kernels());
  ExpectSameExtremes<std::int32_t>(Kernels());
}

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kScalings[][2] = {{1.5, 3.2},
                                   {-0.7, 200},
                                   {0, 0},
                                   {1e308, -1e308},
                                   {-1e-320, 0.999999},
                                   {2.0 / 3, -0.5},
                                   {kInfinity, 0},
                                   {1, -kInfinity},
                                   {1, kInfinity},
                                   {0, kInfinity},
                                   {-1, 65535},
                                   {1.0000001, -1},
                                   {std::numeric_limits<double>::quiet_NaN(), 1},
                                   {1, std::numeric_limits<double>::quiet_NaN()}};

template <class T>
void ExpectSameScaling(const PixelKernels& kernels) {
  const auto rescale = std::get<vorl_detail::RescaleRun<T>*>(kernels.rescale);
  ForEachRun<T>([&](const T* samples, std::size_t count) {
    for (const auto& [factor, offset] : kScalings) {
      std::vector<T> expected(count);
      vorl_detail::RescaleRunRef(samples, expected.data(), count, factor, offset);
      GuardedTarget<T> given(count);
      rescale(samples, given.Data(), count, factor, offset);
      ASSERT_TRUE(given.Holds(expected)) << count << ", * " << factor << " + " << offset;
      std::vector<T> inPlace(samples, samples + count);
      rescale(inPlace.data(), inPlace.data(), count, factor, offset);
      ASSERT_EQ(inPlace, expected) << count << ", * " << factor << " + " << offset;
    }
  });
}

TEST_P(PixelVariants, RescaleEqualsThePlainLoop) {
  ExpectSameScaling<std::uint16_t>(Kernels());
  ExpectSameScaling<std::int16_t>(Kernels());
}

TEST_P(PixelVariants, MappedBytesAreThePlainLoops) {
  std::mt19937 random(3);
  for (const GuardPages::Side side : GuardPages::kSides) {
    const GuardPages table(256, side);
    auto* const entries = static_cast<std::uint8_t*>(table.Data());
    const std::vector<std::uint8_t> values = RandomSamples<std::uint8_t>(256, random);
    std::copy(values.begin(), values.end(), entries);
    ForEachRun<std::uint8_t>([&](const std::uint8_t* samples, std::size_t count) {
      std::vector<std::uint8_t> expected(samples, samples + count);
      for (std::uint8_t& sample : expected) {
        sample = entries[sample];
      }
      GuardedTarget<std::uint8_t> given(count);
      Kernels().mapBytes(samples, given.Data(), count, entries);
      ASSERT_TRUE(given.Holds(expected)) << count;
      std::vector<std::uint8_t> inPlace(samples, samples + count);
      Kernels().mapBytes(inPlace.data(), inPlace.data(), count, entries);
      ASSERT_EQ(inPlace, expected) << count << " in place";
    });
  }
}

// Every sample there is, through the ramp and through the table. The ramps are counted by their
// arithmetic.
void ExpectRampEqualsTable(dWindowingLUT& lut, bool isSigned, const PixelKernels& kernels,
                           int (&ramps)[2]) {
  const auto ramp = WindowRamp::Of(lut, isSigned, kernels.window);
  ASSERT_TRUE(ramp) << lut.GetWinCenter() << " / " << lut.GetWinWidth();
  std::vector<std::uint16_t> samples(65536);
  for (std::size_t i = 0; i < samples.size(); ++i) {
    samples[i] = static_cast<std::uint16_t>(i);
  }
  std::vector<std::uint8_t> given(samples.size());
  kernels.window(samples.data(), given.data(), samples.size(), *ramp);
  const std::uint8_t* const entries = lut.GetLUT(0);
  for (std::size_t i = 0; i < samples.size(); ++i) {
    ASSERT_EQ(given[i], entries[isSigned ? i ^ 0x8000U : i])
        << "sample " << i << " of " << lut.GetWinCenter() << " / " << lut.GetWinWidth();
  }
  ++ramps[ramp->isFixed ? 1 : 0];
}

TEST_P(PixelVariants, WindowEqualsTheTable) {
  if (Kernels().window == nullptr) {
    ASSERT_EQ(GetParam(), CpuVariant::Reference);  // which looks every sample up
    return;
  }
  dWindowingLUT lut;
  int ramps[2] = {};
  for (const bool isSigned : {false, true}) {
    lut.SetSignedSource(isSigned);
    const int base = isSigned ? -32768 : 0;
    for (const int width :
         {2, 3, 100, 254, 255, 256, 350, 400, 1500, 2000, 4096, 20133, 31381, 65535, 65536}) {
      for (const int center : {1, 1064, 32768, 65000}) {
        lut.SetWindow(base + center, width);
        ExpectRampEqualsTable(lut, isSigned, Kernels(), ramps);
      }
    }
    lut.SetTargetRange(200, 10);
    lut.SetLimits(3, 255);
    for (const int width : {2, 90, 1500, 65536}) {
      lut.SetWindow(base + 20000, width);
      ExpectRampEqualsTable(lut, isSigned, Kernels(), ramps);
    }
    lut.SetTargetRange(0, 255);
    lut.SetLimits(0, 255);
  }
  EXPECT_GT(ramps[0], 0) << "lines in single precision";
  EXPECT_GT(ramps[1], 0) << "lines in whole numbers";
}

TEST_P(PixelVariants, WindowOfAnyLengthStaysInItsRun) {
  if (Kernels().window == nullptr) {
    ASSERT_EQ(GetParam(), CpuVariant::Reference);
    return;
  }
  dWindowingLUT lut;
  lut.SetWindow(30000, 40000);
  for (const bool hasEnds : {false, true}) {
    lut.SetLimits(hasEnds ? 9 : 0, 255);
    const auto ramp = WindowRamp::Of(lut, false, Kernels().window);
    ASSERT_TRUE(ramp);
    ASSERT_EQ(ramp->hasEnds, hasEnds);
    ForEachRun<std::uint16_t>([&](const std::uint16_t* samples, std::size_t count) {
      std::vector<std::uint8_t> expected;
      for (std::size_t i = 0; i < count; ++i) {
        expected.push_back(lut.GetLUT(0)[samples[i]]);
      }
      GuardedTarget<std::uint8_t> given(count);
      Kernels().window(samples, given.Data(), count, *ramp);
      ASSERT_TRUE(given.Holds(expected)) << count;
    });
  }
}

TEST(WindowRamp, TablesWithoutALineHaveNone) {
  vorl_detail::WindowRun* const run =
      vorl_detail::PixelKernelsOf(vorl_detail::ChooseVariant(nullptr)).window;
  dWindowingLUT lut;
  lut.SetWindow(1000, 1500);
  EXPECT_EQ(WindowRamp::Of(lut, false, run).has_value(), run != nullptr);
  EXPECT_FALSE(WindowRamp::Of(lut, true, run)) << "an unsigned table, signed samples";
  EXPECT_FALSE(WindowRamp::Of(lut, false, nullptr));
  for (int i = 0; i < 5; ++i) {  // more entries changed by hand than a ramp can name
    lut.GetLUT(0)[900 + 40 * i] ^= 0x80;
  }
  EXPECT_FALSE(WindowRamp::Of(lut, false, run));
  dBCGLUT curve;
  curve.SetGamma(2);
  lut.SetBCGLUT(&curve);
  EXPECT_FALSE(WindowRamp::Of(lut, false, run));
}

TEST(WindowRamp, EntryChangedByHandOutsideTheLineIsNotOverlooked) {
  vorl_detail::WindowRun* const run =
      vorl_detail::PixelKernelsOf(vorl_detail::ChooseVariant(nullptr)).window;
  dWindowingLUT lut;
  lut.SetWindow(1000, 400);
  for (const int index : {0, 799, 1201, 65535}) {
    std::uint8_t& entry = lut.GetLUT(0)[index];
    const std::uint8_t before = entry;
    entry ^= 1;
    EXPECT_FALSE(WindowRamp::Of(lut, false, run)) << index;
    entry = before;
  }
  EXPECT_EQ(WindowRamp::Of(lut, false, run).has_value(), run != nullptr);
}

TEST_P(PixelVariants, WindowKnowsAnEntryChangedByHandOnTheLine) {
  if (Kernels().window == nullptr) {
    ASSERT_EQ(GetParam(), CpuVariant::Reference);
    return;
  }
  dWindowingLUT lut;
  lut.SetWindow(1000, 256);
  int ramps[2] = {};
  for (const int index : {872, 1000, 1127, 1128}) {  // the first and last of the window, the next
    lut.GetLUT(0)[index] ^= 0x40;
    ExpectRampEqualsTable(lut, false, Kernels(), ramps);
  }
}

}  // namespace
