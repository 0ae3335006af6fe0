// Random images and tables, against a plain reading of what a lookup is.

#include <vorl/Operators/IP/opLookup.h>

#include <gtest/gtest.h>

#include <array>

#include "GuardedVolume.h"

namespace {

using rasters::Format;
using rasters::GuardedMemory;
using rasters::MakeRandom;
using rasters::MessageOf;
using rasters::Random;
using rasters::SamplesOf;

constexpr std::array<unsigned short, 4> kTypes = {ImageDataType_U8, ImageDataType_S8,
                                                  ImageDataType_U16, ImageDataType_S16};
constexpr std::array<unsigned short, 4> kAlignments = {1, 2, 8, 32};

std::vector<long> ValuesOf(const dImage& image) {
  const auto widened = [](const auto& samples) {
    return std::vector<long>(samples.begin(), samples.end());
  };
  switch (image.GetDataType()) {
    case ImageDataType_U8:
      return widened(SamplesOf<std::uint8_t>(image));
    case ImageDataType_S8:
      return widened(SamplesOf<std::int8_t>(image));
    case ImageDataType_U16:
      return widened(SamplesOf<std::uint16_t>(image));
    default:
      return widened(SamplesOf<std::int16_t>(image));
  }
}

std::vector<std::uint8_t> Expected(const dImage& source, dLUT& lut) {
  const long first = lut.GetStartIndex();
  const long last = first + lut.GetSize() - 1;
  std::vector<std::uint8_t> expected;
  for (const long value : ValuesOf(source)) {
    const long known = value < first ? first : value > last ? last : value;
    expected.push_back(lut.GetLUT(0)[known - first]);
  }
  return expected;
}

void MakeRandomTable(dLUT& lut, bool sixteenBits, Random& random) {
  static constexpr std::array<long, 5> kSizes = {1, 3, 255, 256, 300};
  static constexpr std::array<long, 5> kWideSizes = {1, 256, 32768, 65536, 70000};
  static constexpr std::array<long, 7> kStarts = {0, -128, -1, 1, 100, -32768, -40000};
  const long size = random.Pick(sixteenBits ? kWideSizes : kSizes);
  ASSERT_TRUE(lut.Init(size, LUTType_U8, 1, random.Pick(kStarts)));
  random.Fill(lut.GetLUT(0), static_cast<std::size_t>(size));
}

Format RandomFormat(Random& random) {
  return {.width = static_cast<unsigned long>(random.Between(1, 40)),
          .height = static_cast<unsigned long>(random.Between(1, 6)),
          .type = random.Pick(kTypes),
          .alignment = random.Pick(kAlignments)};
}

TEST(opLookupModel, AllTypesTablesAndPaddings) {
  Random random(20240501);
  for (int i = 0; i < 600; ++i) {
    const Format format = RandomFormat(random);
    SCOPED_TRACE(testing::Message()
                 << "case " << i << ": " << format.width << " x " << format.height << ", type "
                 << format.type << ", alignment " << format.alignment);
    dImage source;
    MakeRandom(source, format, random);
    dLUT lut;
    MakeRandomTable(lut, source.GetChannelDepth() == 16, random);
    const auto expected = Expected(source, lut);

    rasters::GuardedInput input;
    for (const rasters::Around around : rasters::kSurroundings) {
      SCOPED_TRACE(rasters::NameOf(around));
      input.PutUnder(source, around, true);
      dImage target;
      ASSERT_EQ(MessageOf(opLookup(&source, &target, &lut)), "success");
      ASSERT_EQ(SamplesOf<std::uint8_t>(target), expected);
      ASSERT_EQ(target.GetRowAlignment(), source.GetRowAlignment());
      ASSERT_NO_FATAL_FAILURE(input.ExpectUntouched());
    }
    ASSERT_EQ(MessageOf(opLookup(&source, random.Between(0, 1) != 0 ? &source : nullptr, &lut)),
              "success");
    ASSERT_EQ(SamplesOf<std::uint8_t>(source), expected) << "in place";
    ASSERT_NO_FATAL_FAILURE(input.ExpectSurroundingsUntouched());
  }
}

TEST(opLookupModel, WritesNothingBesideTheSamples) {
  Random random(7);
  for (int i = 0; i < 100; ++i) {
    Format format = RandomFormat(random);
    format.type = random.Between(0, 1) != 0 ? ImageDataType_U8 : ImageDataType_S8;
    dImage source;
    MakeRandom(source, format, random);
    dLUT lut;
    MakeRandomTable(lut, false, random);
    dImage target;
    GuardedMemory memory;
    memory.PutUnder(target, format);
    ASSERT_EQ(MessageOf(opLookup(&source, &target, &lut)), "success");
    ASSERT_EQ(SamplesOf<std::uint8_t>(target), Expected(source, lut));
    memory.ExpectSurroundingsUntouched();
  }
}

}  // namespace
