// Random images and factors, against a plain reading of what a rescale is.

#include <vorl/Operators/IP/opPixelRescale.h>

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <limits>

#include "GuardedVolume.h"

namespace {

using rasters::Bytes;
using rasters::BytesOf;
using rasters::Format;
using rasters::GuardedMemory;
using rasters::MakeRandom;
using rasters::MessageOf;
using rasters::Random;

// One sample, the whole part taken before the bounds are.
template <class T>
T PlainRescale(T sample, double factor, double offset) {
  const volatile double product = static_cast<double>(sample) * factor;  // rounded on its own
  const double whole = std::trunc(product + offset);
  if (std::isnan(whole)) {
    return 0;
  }
  if (whole < static_cast<double>(std::numeric_limits<T>::min())) {
    return std::numeric_limits<T>::min();
  }
  if (whole > static_cast<double>(std::numeric_limits<T>::max())) {
    return std::numeric_limits<T>::max();
  }
  return static_cast<T>(static_cast<int>(whole));
}

template <class T>
void RescaleDense(const Bytes& source, Bytes& target, std::size_t count, double factor,
                  double offset) {
  for (std::size_t i = 0; i < count; ++i) {
    T sample;
    std::memcpy(&sample, &source[i * sizeof(T)], sizeof(T));
    sample = PlainRescale(sample, factor, offset);
    std::memcpy(&target[i * sizeof(T)], &sample, sizeof(T));
  }
}

// What the target holds afterwards: the run rescaled, the rest as it was.
Bytes Expected(const dImage& source, const Bytes& targetBefore, double factor, double offset) {
  const Bytes from = BytesOf(source);
  Bytes to = targetBefore;
  const std::size_t channels = std::string(source.GetChannelSequence()).size();
  const std::size_t count = source.GetWidth() * source.GetHeight() * channels;
  switch (source.GetDataType()) {
    case ImageDataType_U8:
      RescaleDense<std::uint8_t>(from, to, count, factor, offset);
      break;
    case ImageDataType_S8:
      RescaleDense<std::int8_t>(from, to, count, factor, offset);
      break;
    case ImageDataType_U16:
      RescaleDense<std::uint16_t>(from, to, count, factor, offset);
      break;
    default:
      RescaleDense<std::int16_t>(from, to, count, factor, offset);
      break;
  }
  return to;
}

double RandomFactor(Random& random) {
  static constexpr double kInfinity = std::numeric_limits<double>::infinity();
  static constexpr std::array<double, 16> kFactors = {
      1.0, 2.0,   -1.0,   0.5,       -0.25,      0.1,
      0.0, 1e300, -1e10,  kInfinity, -kInfinity, std::numeric_limits<double>::quiet_NaN(),
      3.7, 257.0, 1e-300, 1.0000001};
  return random.Between(0, 1) != 0 ? random.Pick(kFactors) : random.Between(-4000, 4000) / 1024.0;
}

double RandomOffset(Random& random) {
  static constexpr std::array<double, 9> kOffsets = {
      0.0, 0.5, -0.5, 127.9, -1e300, std::numeric_limits<double>::infinity(), 1e9, -128.5, 65535.0};
  return random.Between(0, 1) != 0 ? random.Pick(kOffsets) : random.Between(-70000, 70000) / 3.0;
}

Format RandomFormat(Random& random) {
  static constexpr std::array<unsigned short, 4> kTypes = {ImageDataType_U8, ImageDataType_S8,
                                                           ImageDataType_U16, ImageDataType_S16};
  static constexpr std::array<const char*, 3> kChannels = {"G", "GA", "RGB"};
  static constexpr std::array<unsigned short, 4> kAlignments = {1, 2, 8, 32};
  return {.width = static_cast<unsigned long>(random.Between(1, 20)),
          .height = static_cast<unsigned long>(random.Between(1, 5)),
          .type = random.Pick(kTypes),
          .channels = random.Pick(kChannels),
          .order = static_cast<unsigned short>(random.Between(0, 1)),
          .alignment = random.Pick(kAlignments)};
}

TEST(opPixelRescaleModel, AllTypesOrdersPaddingsAndExtremeFactors) {
  Random random(4711);
  for (int i = 0; i < 800; ++i) {
    const Format format = RandomFormat(random);
    const double factor = RandomFactor(random);
    const double offset = RandomOffset(random);
    if (factor == 1.0 && offset == 0.0) {
      continue;  // the identity writes nothing
    }
    SCOPED_TRACE(testing::Message()
                 << "case " << i << ": " << format.width << " x " << format.height << ", type "
                 << format.type << ", " << format.channels << ", order " << format.order
                 << ", alignment " << format.alignment << ", " << factor << ", " << offset);
    dImage source;
    MakeRandom(source, format, random);
    dImage target;
    MakeRandom(target, format, random);
    const Bytes expected = Expected(source, BytesOf(target), factor, offset);
    rasters::GuardedInput input;
    for (const rasters::Around around : rasters::kSurroundings) {
      SCOPED_TRACE(rasters::NameOf(around));
      input.PutUnder(source, around, false);  // padding is rescaled, too
      ASSERT_EQ(MessageOf(opPixelRescale(&source, &target, factor, offset)), "success");
      ASSERT_EQ(BytesOf(target), expected);
      ASSERT_NO_FATAL_FAILURE(input.ExpectUntouched());
    }

    const Bytes inPlace = Expected(source, BytesOf(source), factor, offset);
    ASSERT_EQ(MessageOf(opPixelRescale(&source, factor, offset)), "success");
    ASSERT_EQ(BytesOf(source), inPlace);
    ASSERT_NO_FATAL_FAILURE(input.ExpectSurroundingsUntouched());
  }
}

TEST(opPixelRescaleModel, WritesNothingBesideThePixels) {
  Random random(4712);
  for (int i = 0; i < 100; ++i) {
    Format format = RandomFormat(random);
    format.alignment = 1;  // the run covers every byte
    dImage source;
    MakeRandom(source, format, random);
    dImage target;
    GuardedMemory memory;
    memory.PutUnder(target, format);
    ASSERT_EQ(MessageOf(opPixelRescale(&source, &target, 0.75, 3.0)), "success");
    ASSERT_EQ(BytesOf(target), Expected(source, Bytes(target.GetImageSize()), 0.75, 3.0));
    memory.ExpectSurroundingsUntouched();
  }
}

}  // namespace
