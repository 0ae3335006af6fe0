#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/dicom/Samples.h>

#include <cmath>

using namespace study;
using testing::ElementsAre;

namespace {

std::vector<std::uint16_t> Unpack(const std::vector<std::uint8_t>& bytes,
                                  const SampleFormat& format) {
  std::vector<std::uint16_t> samples(bytes.size() / (format.bitsAllocated / 8));
  UnpackSamples(bytes, format, samples);
  return samples;
}

SliceValues Slice(SampleRange range, double slope, double intercept, bool isSigned = false) {
  return {isSigned, range, slope, intercept};
}

TEST(UnpackSamples, ReadsLittleEndianSixteenBits) {
  EXPECT_THAT(Unpack({0x34, 0x12, 0xFF, 0xFF}, {16, 16, 15, false, false}),
              ElementsAre(0x1234, 0xFFFF));
}

TEST(UnpackSamples, IgnoresBitsAboveTheStoredOnes) {
  EXPECT_THAT(Unpack({0x34, 0xF2}, {16, 12, 11, false, false}), ElementsAre(0x0234));
}

TEST(UnpackSamples, IgnoresBitsBelowTheStoredOnes) {
  EXPECT_THAT(Unpack({0x3F, 0x12}, {16, 12, 15, false, false}), ElementsAre(0x0123));
}

TEST(UnpackSamples, ExtendsTheSignOfTheStoredBits) {
  // 12 bits: 0x800 is -2048, 0xFFF is -1, 0x7FF is 2047.
  EXPECT_THAT(Unpack({0x00, 0x08, 0xFF, 0x0F, 0xFF, 0x07}, {16, 12, 11, true, false}),
              ElementsAre(0xF800, 0xFFFF, 0x07FF));
}

TEST(UnpackSamples, ReadsEightBits) {
  EXPECT_THAT(Unpack({0x00, 0x7F, 0x80, 0xFF}, {8, 8, 7, false, false}),
              ElementsAre(0, 127, 128, 255));
  EXPECT_THAT(Unpack({0x7F, 0x80, 0xFF}, {8, 8, 7, true, false}), ElementsAre(127, 0xFF80, 0xFFFF));
}

TEST(UnpackSamples, MirrorsInvertedSamplesWithinTheirBits) {
  EXPECT_THAT(Unpack({0x00, 0x00, 0xFF, 0x0F, 0x01, 0x00}, {16, 12, 11, false, true}),
              ElementsAre(4095, 0, 4094));
  // Signed, 8 bits: -128 becomes 127, -1 becomes 0, 0 becomes -1.
  EXPECT_THAT(Unpack({0x80, 0xFF, 0x00}, {8, 8, 7, true, true}), ElementsAre(127, 0, 0xFFFF));
}

TEST(UnpackSamples, ReadsOneBitStored) {
  EXPECT_THAT(Unpack({0, 1, 0xFE}, {8, 1, 0, false, false}), ElementsAre(0, 1, 0));
}

TEST(RangeOfFormat, FollowsBitsAndSign) {
  EXPECT_EQ(RangeOfFormat({16, 12, 11, false, false}).maximum, 4095);
  EXPECT_EQ(RangeOfFormat({16, 16, 15, true, false}).minimum, -32768);
  EXPECT_EQ(RangeOfFormat({16, 16, 15, true, false}).maximum, 32767);
}

TEST(RangeOfSamples, TellsSignedFromUnsigned) {
  const std::vector<std::uint16_t> samples{0xFFFF, 3, 0x8000};
  EXPECT_EQ(RangeOfSamples(samples, true).minimum, -32768);
  EXPECT_EQ(RangeOfSamples(samples, true).maximum, 3);
  EXPECT_EQ(RangeOfSamples(samples, false).minimum, 3);
  EXPECT_EQ(RangeOfSamples(samples, false).maximum, 65535);
  EXPECT_EQ(RangeOfSamples({}, false).maximum, 0);
}

TEST(IsSupported, WantsTheStoredBitsWithinTheAllocated) {
  EXPECT_TRUE(IsSupported({16, 12, 11, false, false}));
  EXPECT_TRUE(IsSupported({8, 8, 7, false, false}));
  EXPECT_FALSE(IsSupported({16, 17, 16, false, false}));
  EXPECT_FALSE(IsSupported({16, 0, 15, false, false}));
  EXPECT_FALSE(IsSupported({16, 12, 10, false, false}));
  EXPECT_FALSE(IsSupported({8, 8, 8, false, false}));
  EXPECT_FALSE(IsSupported({12, 12, 11, false, false}));
  EXPECT_FALSE(IsSupported({32, 32, 31, false, false}));
}

TEST(ChooseMapping, KeepsTheSlopeAndPutsTheSmallestValueAtZero) {
  const ValueMapping mapping = ChooseMapping({Slice({24, 4095}, 1, -1024)});
  EXPECT_EQ(mapping.scale, 1);
  EXPECT_EQ(mapping.offset, -1000);
  EXPECT_EQ(mapping.maximumError, 0);
}

TEST(ChooseMapping, KeepsFractionalSlopes) {
  const ValueMapping mapping = ChooseMapping({Slice({-10, 20}, 0.25, 3, true)});
  EXPECT_EQ(mapping.scale, 0.25);
  EXPECT_EQ(mapping.offset, 0.5);  // -10 * 0.25 + 3
  EXPECT_EQ(mapping.maximumError, 0);
}

TEST(ChooseMapping, TakesInterceptsThatDifferByWholeSteps) {
  const ValueMapping mapping = ChooseMapping({Slice({0, 100}, 2, 10), Slice({0, 100}, 2, 4)});
  EXPECT_EQ(mapping.scale, 2);
  EXPECT_EQ(mapping.offset, 4);
  EXPECT_EQ(mapping.maximumError, 0);
}

TEST(ChooseMapping, SpreadsValuesWhenSlopesDiffer) {
  const ValueMapping mapping = ChooseMapping({Slice({0, 1000}, 1, 0), Slice({0, 1000}, 0.5, 0)});
  EXPECT_DOUBLE_EQ(mapping.scale, 1000.0 / 65535);
  EXPECT_EQ(mapping.offset, 0);
  EXPECT_DOUBLE_EQ(mapping.maximumError, 500.0 / 65535);
}

TEST(ChooseMapping, SpreadsValuesThatWouldNotFitSixteenBits) {
  const ValueMapping mapping = ChooseMapping({Slice({0, 65535}, 1, 0), Slice({0, 65535}, 1, -10)});
  EXPECT_DOUBLE_EQ(mapping.scale, 65545.0 / 65535);
  EXPECT_EQ(mapping.offset, -10);
  EXPECT_GT(mapping.maximumError, 0.5);
}

TEST(ChooseMapping, FullSixteenBitRangeStaysExact) {
  EXPECT_EQ(ChooseMapping({Slice({-32768, 32767}, 1, 0, true)}).maximumError, 0);
  EXPECT_EQ(ChooseMapping({Slice({-32768, 32767}, 1, 0, true)}).offset, -32768);
}

TEST(ChooseMapping, EqualValuesOfDifferentScalesKeepAUsableScale) {
  const ValueMapping mapping = ChooseMapping({Slice({0, 0}, 1, 7), Slice({0, 0}, 2, 7)});
  EXPECT_EQ(mapping.scale, 1);
  EXPECT_EQ(mapping.offset, 7);
}

TEST(ApplyMapping, NegativeSlopeMakesLargerSamplesDarker) {
  const SliceValues slice = Slice({10, 12}, -2, 100);
  const ValueMapping mapping = ChooseMapping({slice});
  EXPECT_EQ(mapping.scale, 2);
  EXPECT_EQ(mapping.offset, 76);  // 12 * -2 + 100
  std::vector<std::uint16_t> samples{10, 11, 12};
  ApplyMapping(mapping, slice, samples);
  EXPECT_THAT(samples, ElementsAre(2, 1, 0));
}

TEST(ApplyMapping, StoresSignedSamplesFromTheSmallest) {
  const SliceValues slice = Slice({-1024, 3071}, 1, 0, true);
  std::vector<std::uint16_t> samples{0xFC00, 0, 3071};
  ApplyMapping(ChooseMapping({slice}), slice, samples);
  EXPECT_THAT(samples, ElementsAre(0, 1024, 4095));
}

TEST(ApplyMapping, KeepsEveryRealValueExactly) {
  const SliceValues slice = Slice({-32768, 32767}, 0.1, 5, true);
  const ValueMapping mapping = ChooseMapping({slice});
  std::vector<std::uint16_t> samples(65536);
  for (std::size_t i = 0; i < samples.size(); ++i) {
    samples[i] = static_cast<std::uint16_t>(i);
  }
  ApplyMapping(mapping, slice, samples);
  for (int value = -32768; value <= 32767; ++value) {
    const std::uint16_t stored = samples[static_cast<std::uint16_t>(value)];
    ASSERT_EQ(stored, value + 32768);
    ASSERT_NEAR(stored * mapping.scale + mapping.offset, value * 0.1 + 5, 1e-9);
  }
}

TEST(ApplyMapping, SpreadValuesStayWithinTheStatedError) {
  const std::vector<SliceValues> slices{Slice({0, 30000}, 0.37, 1.5), Slice({5, 20000}, 1.9, -3)};
  const ValueMapping mapping = ChooseMapping(slices);
  for (const SliceValues& slice : slices) {
    for (int value = slice.range.minimum; value <= slice.range.maximum; value += 7) {
      std::vector<std::uint16_t> sample{static_cast<std::uint16_t>(value)};
      ApplyMapping(mapping, slice, sample);
      const double real = value * slice.slope + slice.intercept;
      ASSERT_LE(std::abs(sample[0] * mapping.scale + mapping.offset - real),
                mapping.maximumError * 1.000001);
    }
  }
}

}  // namespace
