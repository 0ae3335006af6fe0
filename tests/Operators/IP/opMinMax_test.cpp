#include <vorl/Operators/IP/opMinMax.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <limits>

#include "GuardedVolume.h"

namespace {

using rasters::CodeOf;
using rasters::Format;
using rasters::Make;
using rasters::MakeOf;
using rasters::MakeRandom;
using rasters::MessageOf;
using rasters::Random;
using rasters::SamplesOf;

constexpr std::int32_t kLargest = std::numeric_limits<std::int32_t>::max();
constexpr std::int32_t kSmallest = std::numeric_limits<std::int32_t>::min();

struct Extent {
  long minimum = kLargest;
  long maximum = kSmallest;
};

Extent ExtentOf(dImage& image, Extent seed = {}) {
  opMinMax op;
  EXPECT_TRUE(op.Run(&image, seed.minimum, seed.maximum));
  EXPECT_EQ(CodeOf(op), 0);
  EXPECT_EQ(MessageOf(op), "success");
  EXPECT_EQ(op.m_minimum, seed.minimum);
  EXPECT_EQ(op.m_maximum, seed.maximum);
  return seed;
}

TEST(opMinMax, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<opMinMax>("opMinMax");
}

TEST(opMinMax, ResetDropsTheSourceAndStartsAfresh) {
  dImage image;
  opMinMax op;
  op.m_pSource = &image;
  op.m_minimum = op.m_maximum = 3;
  EXPECT_TRUE(op.Reset());
  EXPECT_EQ(op.m_pSource, nullptr);
  EXPECT_EQ(op.m_minimum, kLargest);
  EXPECT_EQ(op.m_maximum, kSmallest);
}

TEST(opMinMax, CopiesCarrySourceAndResults) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {3, 9});
  opMinMax op;
  op.m_pSource = &image;
  ASSERT_TRUE(op());
  const opMinMax copy(op);
  opMinMax assigned;
  assigned = op;
  for (const opMinMax* other : {&copy, static_cast<const opMinMax*>(&assigned)}) {
    EXPECT_EQ(other->m_pSource, &image);
    EXPECT_EQ(other->m_minimum, 3);
    EXPECT_EQ(other->m_maximum, 9);
    EXPECT_EQ(MessageOf(*other), "success");
  }
}

TEST(opMinMax, ConstantImageHasEqualExtremes) {
  dImage image;
  Make(image, {.width = 5, .height = 3});
  image.Fill(7);
  const Extent extent = ExtentOf(image);
  EXPECT_EQ(extent.minimum, 7);
  EXPECT_EQ(extent.maximum, 7);
}

TEST(opMinMax, ComparesEachTypeInItsOwnRange) {
  const auto expect = [](auto low, auto high, unsigned short type) {
    dImage image;
    MakeOf<decltype(low)>(image, {.width = 3, .type = type}, {high, 0, low});
    const Extent extent = ExtentOf(image);
    EXPECT_EQ(extent.minimum, std::min<long>(low, 0));
    EXPECT_EQ(extent.maximum, high);
  };
  expect(std::uint8_t{0}, std::uint8_t{255}, ImageDataType_U8);
  expect(std::int8_t{-128}, std::int8_t{127}, ImageDataType_S8);
  expect(std::uint16_t{0}, std::uint16_t{65535}, ImageDataType_U16);
  expect(std::int16_t{-32768}, std::int16_t{32767}, ImageDataType_S16);
  expect(kSmallest, kLargest, ImageDataType_S32);
}

TEST(opMinMax, ExtendsTheSeedsOverSeveralImages) {
  dImage first;
  dImage second;
  MakeOf<std::uint8_t>(first, {.width = 2}, {10, 20});
  MakeOf<std::int16_t>(second, {.width = 2, .type = ImageDataType_S16}, {-5, 15});
  const Extent extent = ExtentOf(second, ExtentOf(first));
  EXPECT_EQ(extent.minimum, -5);
  EXPECT_EQ(extent.maximum, 20);
  const Extent wide = ExtentOf(first, {-100, 100});
  EXPECT_EQ(wide.minimum, -100);
  EXPECT_EQ(wide.maximum, 100);
}

// Where `long` has 64 bits, its ends lie beyond what the operator holds.
TEST(opMinMax, TakesTheEndsOfLongAsSeedsToStartAfresh) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {10, 20});
  long minimum = std::numeric_limits<long>::max();
  long maximum = std::numeric_limits<long>::min();
  const opMinMax op(&image, minimum, maximum);
  EXPECT_EQ(minimum, 10);
  EXPECT_EQ(maximum, 20);
}

TEST(opMinMax, TheConstructorsRunAtOnce) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {10, 20});
  long minimum = kLargest;
  long maximum = kSmallest;
  EXPECT_EQ(MessageOf(opMinMax(&image, minimum, maximum)), "success");
  EXPECT_EQ(minimum, 10);
  EXPECT_EQ(maximum, 20);
  std::int32_t minimum32 = 15;
  std::int32_t maximum32 = 17;
  EXPECT_EQ(MessageOf(opMinMax(&image, minimum32, maximum32)), "success");
  EXPECT_EQ(minimum32, 10);
  EXPECT_EQ(maximum32, 20);
}

TEST(opMinMax, AnImageWithoutSamplesGivesZeros) {
  dImage image;
  image.GetDataBuffer().New(8, true);
  ASSERT_TRUE(image.IsValid());
  const Extent fresh = ExtentOf(image);
  EXPECT_EQ(fresh.minimum, 0);
  EXPECT_EQ(fresh.maximum, 0);
  const Extent seeded = ExtentOf(image, {4, 4});
  EXPECT_EQ(seeded.minimum, 4);
  EXPECT_EQ(seeded.maximum, 4);
}

void ExpectFailure(dImage* image, const char* message) {
  long minimum = 11;
  long maximum = 12;
  opMinMax op;
  EXPECT_FALSE(op.Run(image, minimum, maximum));
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), message);
  EXPECT_EQ(minimum, 11) << "untouched on failure";
  EXPECT_EQ(maximum, 12);
}

TEST(opMinMax, NamesWhatIsWrongWithTheSource) {
  dImage image;
  ExpectFailure(nullptr, "missing source image");
  ExpectFailure(&image, "uninitialized source image");
  Make(image, {.width = 4, .height = 2, .type = ImageDataType_U16});
  alignas(2) unsigned char memory[20] = {};
  image.GetDataBuffer().Init(memory, 15, DTM_Reference);
  ExpectFailure(&image, "invalid pixel data in the source image");
  image.GetDataBuffer().Init(memory + 1, 16, DTM_Reference);
  ExpectFailure(&image, "invalid pixel data in the source image");
}

TEST(opMinMax, RefusesEveryOtherDataType) {
  const std::pair<unsigned short, const char*> cases[] = {
      {ImageDataType_U1, "unsupported data type: 1(1 bit)"},
      {ImageDataType_U32, "unsupported data type: 32(32 bit)"},
      {ImageDataType_U64, "unsupported data type: 64(64 bit)"},
      {ImageDataType_S64, "unsupported data type: 4160(64 bit)"},
      {ImageDataType_F32, "unsupported data type: 8224(32 bit)"},
      {ImageDataType_F64, "unsupported data type: 8256(64 bit)"}};
  for (const auto& [type, message] : cases) {
    dImage image;
    Make(image, {.width = 2, .type = type});
    ExpectFailure(&image, message);
  }
}

TEST(opMinMax, StoppedLeavesTheReferencesAlone) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {10, 20});
  rasters::StoppedBeforeWork<opMinMax> op;
  long minimum = kLargest;
  long maximum = kSmallest;
  EXPECT_FALSE(op.Run(&image, minimum, maximum));
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), "stopped");
  EXPECT_EQ(minimum, kLargest);
  EXPECT_EQ(maximum, kSmallest);
}

template <class T>
Extent PlainExtent(const dImage& image) {
  const std::vector<T> samples = SamplesOf<T>(image);
  return {static_cast<long>(*std::min_element(samples.begin(), samples.end())),
          static_cast<long>(*std::max_element(samples.begin(), samples.end()))};
}

Extent PlainExtent(const dImage& image) {
  switch (image.GetDataType()) {
    case ImageDataType_U8:
      return PlainExtent<std::uint8_t>(image);
    case ImageDataType_S8:
      return PlainExtent<std::int8_t>(image);
    case ImageDataType_U16:
      return PlainExtent<std::uint16_t>(image);
    case ImageDataType_S16:
      return PlainExtent<std::int16_t>(image);
    default:
      return PlainExtent<std::int32_t>(image);
  }
}

TEST(opMinMaxModel, AllTypesOrdersAndPaddings) {
  static constexpr std::array<unsigned short, 5> kTypes = {
      ImageDataType_U8, ImageDataType_S8, ImageDataType_U16, ImageDataType_S16, ImageDataType_S32};
  static constexpr std::array<const char*, 3> kChannels = {"G", "GA", "RGB"};
  static constexpr std::array<unsigned short, 3> kAlignments = {1, 4, 32};
  Random random(99);
  for (int i = 0; i < 500; ++i) {
    const Format format = {.width = static_cast<unsigned long>(random.Between(1, 12)),
                           .height = static_cast<unsigned long>(random.Between(1, 4)),
                           .type = random.Pick(kTypes),
                           .channels = random.Pick(kChannels),
                           .order = static_cast<unsigned short>(random.Between(0, 1)),
                           .alignment = random.Pick(kAlignments)};
    SCOPED_TRACE(testing::Message()
                 << "case " << i << ": " << format.width << " x " << format.height << ", type "
                 << format.type << ", " << format.channels << ", order " << format.order
                 << ", alignment " << format.alignment);
    dImage image;
    MakeRandom(image, format, random);
    const Extent expected = PlainExtent(image);
    rasters::GuardedInput input;
    for (const rasters::Around around : rasters::kSurroundings) {
      SCOPED_TRACE(rasters::NameOf(around));
      input.PutUnder(image, around, true);
      const Extent found = ExtentOf(image);
      ASSERT_EQ(found.minimum, expected.minimum);
      ASSERT_EQ(found.maximum, expected.maximum);
      ASSERT_NO_FATAL_FAILURE(input.ExpectUntouched());
    }
  }
}

}  // namespace
