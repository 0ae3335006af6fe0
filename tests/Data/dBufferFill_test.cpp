#include <vorl/Data/dBuffer.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <vector>

namespace {

using Bytes = std::vector<unsigned char>;

Bytes FirstBytes(const dBuffer& buffer, unsigned long count) {
  const auto* data = static_cast<const unsigned char*>(buffer.Get(0));
  return Bytes(data, data + count);
}

/// The bytes of the word as this machine stores them, repeated.
Bytes Repeated(std::uint32_t word, unsigned long count) {
  unsigned char bytes[4];
  std::memcpy(bytes, &word, 4);
  Bytes result;
  for (unsigned long i = 0; i < count; ++i) {
    result.push_back(bytes[i % 4]);
  }
  return result;
}

TEST(dBufferSet, ByteFillsTheRoundedSize) {
  dBuffer buffer(5);
  buffer.Set(static_cast<unsigned char>(0xAB));
  EXPECT_EQ(FirstBytes(buffer, 8), Bytes(8, 0xAB));
}

TEST(dBufferSet, ShortStandsInBothHalvesOfEachWord) {
  dBuffer buffer(6);
  buffer.Set(static_cast<unsigned short>(0xA1B2));
  EXPECT_EQ(FirstBytes(buffer, 8), Repeated(0xA1B2A1B2, 8));
}

TEST(dBufferSet, EveryIntegerTypeGivesTheSame32BitPattern) {
  dBuffer buffer(8);
  buffer.Set(0x12345678);
  EXPECT_EQ(FirstBytes(buffer, 8), Repeated(0x12345678, 8));
  buffer.Set(0x9ABCDEF0u);
  EXPECT_EQ(FirstBytes(buffer, 8), Repeated(0x9ABCDEF0, 8));
  buffer.Set(0x0FEDCBA9ul);
  EXPECT_EQ(FirstBytes(buffer, 8), Repeated(0x0FEDCBA9, 8));
  buffer.Set(-1);
  EXPECT_EQ(FirstBytes(buffer, 8), Bytes(8, 0xFF));
  buffer.Set(~0ul);
  EXPECT_EQ(FirstBytes(buffer, 8), Bytes(8, 0xFF));
}

TEST(dBufferSet, StopsAtTheRoundedSizeWithinALargerBlock) {
  dBuffer buffer(24);
  buffer.Set(static_cast<unsigned char>(1));
  buffer.New(9, false);
  buffer.Set(static_cast<unsigned char>(2));
  Bytes expected(16, 2);
  expected.resize(24, 1);
  buffer.New(24, false);
  EXPECT_EQ(FirstBytes(buffer, 24), expected);
}

TEST(dBufferSet, FillsNothingAtSizeZero) {
  dBuffer buffer(8);
  buffer.Set(static_cast<unsigned char>(1));
  buffer.New(0, false);
  buffer.Set(static_cast<unsigned char>(2));
  buffer.New(8, false);
  EXPECT_EQ(FirstBytes(buffer, 8), Bytes(8, 1));
}

TEST(dBufferSet, OfAnEmptyBufferDoesNothing) {
  dBuffer buffer;
  buffer.Set(1);
  EXPECT_FALSE(buffer);
}

TEST(dBufferSet, NeverLeavesForeignMemoryWhateverItsAlignment) {
  for (unsigned long offset = 0; offset < 8; ++offset) {
    for (unsigned long size = 0; size <= 24; ++size) {
      Bytes memory(40, 0x55);
      dBuffer buffer(memory.data() + offset, size, DTM_Reference);
      buffer.Set(0x12345678);
      Bytes expected(40, 0x55);
      const Bytes pattern = Repeated(0x12345678, size);
      std::copy(pattern.begin(), pattern.end(),
                expected.begin() + static_cast<std::ptrdiff_t>(offset));
      EXPECT_EQ(memory, expected) << "offset " << offset << ", size " << size;
    }
  }
}

TEST(dBufferResize, GrowingKeepsTheFirstBytesAndZeroesTheRest) {
  unsigned char bytes[4] = {1, 2, 3, 4};
  dBuffer buffer(bytes, 4, DTM_Copy);
  buffer.Resize(12);
  EXPECT_EQ(buffer.GetCapacity(), 16u);
  EXPECT_EQ(FirstBytes(buffer, 16), (Bytes{1, 2, 3, 4, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
}

TEST(dBufferResize, GrowingWithinTheBlockZeroesTheNewPart) {
  dBuffer buffer(4);
  void* const block = buffer.Get(0);
  buffer.Set(static_cast<unsigned char>(9));
  buffer.Resize(7);
  EXPECT_EQ(buffer.Get(0), block);
  EXPECT_EQ(FirstBytes(buffer, 8), (Bytes{9, 9, 9, 9, 0, 0, 0, 0}));
}

TEST(dBufferResize, ShrinkingZeroesTheCutBytes) {
  dBuffer buffer(16);
  buffer.Set(static_cast<unsigned char>(9));
  buffer.Resize(3);
  EXPECT_EQ(buffer.GetSize(), 3u);
  EXPECT_EQ(buffer.GetCapacity(), 16u);
  Bytes expected(16, 0);
  expected[0] = expected[1] = expected[2] = 9;
  EXPECT_EQ(FirstBytes(buffer, 16), expected);
}

TEST(dBufferResize, OfAnEmptyBufferPresentsZeros) {
  dBuffer buffer;
  buffer.Resize(9);
  EXPECT_EQ(buffer.GetSize(), 9u);
  EXPECT_EQ(FirstBytes(buffer, 16), Bytes(16, 0));
}

TEST(dBufferResize, OfAReferenceMakesAnOwnCopy) {
  Bytes memory = {1, 2, 3, 4, 5, 6};
  for (const unsigned long size : {3ul, 6ul, 9ul}) {
    dBuffer buffer(memory.data(), 6, DTM_Reference);
    buffer.Resize(size);
    EXPECT_FALSE(buffer.IsReference());
    Bytes expected = memory;
    expected.resize(size);
    expected.resize(buffer.GetCapacity(), 0);
    EXPECT_EQ(FirstBytes(buffer, buffer.GetCapacity()), expected) << size;
  }
  EXPECT_EQ(memory, (Bytes{1, 2, 3, 4, 5, 6}));
}

TEST(dBufferResize, OfAReferenceToNothingKeepsTheMemoryUntouched) {
  Bytes memory = {1, 2, 3};
  dBuffer buffer(memory.data(), 3, DTM_Reference);
  buffer.Resize(0);
  EXPECT_EQ(buffer.GetSize(), 0u);
  EXPECT_EQ(buffer.GetCapacity(), 0u);
  EXPECT_EQ(memory, (Bytes{1, 2, 3}));
}

}  // namespace
