#include <vorl/Data/dBuffer.h>

#include <gtest/gtest.h>

#include <array>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

namespace {

using Bytes = std::vector<unsigned char>;

Bytes BytesOf(const dBuffer& buffer, unsigned long count) {
  const auto* data = static_cast<const unsigned char*>(buffer.Get(0));
  return Bytes(data, data + count);
}

Bytes BytesOf(const dBuffer& buffer) {
  return BytesOf(buffer, buffer.GetSize());
}

void ExpectEmpty(const dBuffer& buffer) {
  EXPECT_EQ(buffer.Get(0), nullptr);
  EXPECT_EQ(buffer.GetSize(), 0u);
  EXPECT_EQ(buffer.GetCapacity(), 0u);
}

TEST(dBuffer, StartsEmpty) {
  dBuffer buffer;
  ExpectEmpty(buffer);
  EXPECT_FALSE(buffer);
  EXPECT_FALSE(buffer.IsValid());
  EXPECT_FALSE(buffer.IsReference());
}

TEST(dBuffer, NewRoundsTheCapacityAndKeepsABlockWithRoom) {
  dBuffer buffer;
  buffer.New(13, false);
  EXPECT_EQ(buffer.GetSize(), 13u);
  EXPECT_EQ(buffer.GetCapacity(), 16u);
  void* const block = buffer.Get(0);

  buffer.New(10, false);
  EXPECT_EQ(buffer.GetSize(), 10u);
  EXPECT_EQ(buffer.GetCapacity(), 16u);
  EXPECT_EQ(buffer.Get(0), block);

  buffer.New(20, false);
  EXPECT_EQ(buffer.GetSize(), 20u);
  EXPECT_EQ(buffer.GetCapacity(), 24u);
}

TEST(dBuffer, ReferenceLeavesForeignMemoryUntouchedWhenDestroyed) {
  auto memory = std::make_unique<std::array<unsigned char, 5>>();
  memory->fill(7);
  {
    dBuffer buffer(memory->data(), 5, DTM_Reference);
    EXPECT_TRUE(buffer.IsReference());
    EXPECT_EQ(buffer.Get(0), memory->data());
    EXPECT_EQ(buffer.GetCapacity(), 0u);
  }
  EXPECT_EQ(*memory, (std::array<unsigned char, 5>{7, 7, 7, 7, 7}));
}

TEST(dBuffer, TakeOverMovesTheBlockAndEmptiesTheSource) {
  dBuffer source(9);
  void* const block = source.Get(0);
  dBuffer destination;
  destination <<= source;
  EXPECT_EQ(destination.Get(0), block);
  EXPECT_EQ(destination.GetSize(), 9u);
  EXPECT_EQ(destination.GetCapacity(), 16u);
  ExpectEmpty(source);
}

TEST(dBuffer, HandingOverEmptiesThisBuffer) {
  dBuffer source(9);
  void* const block = source.Get(0);
  dBuffer destination(3);
  source >>= destination;
  EXPECT_EQ(destination.Get(0), block);
  ExpectEmpty(source);
}

TEST(dBuffer, ResizeKeepsTheFirstBytesAndZeroesTheRest) {
  unsigned char bytes[4] = {1, 2, 3, 4};
  dBuffer buffer(bytes, 4, DTM_Copy);
  buffer.Resize(12);
  EXPECT_EQ(BytesOf(buffer), (Bytes{1, 2, 3, 4, 0, 0, 0, 0, 0, 0, 0, 0}));
}

TEST(dBuffer, GetGivesTheEndButNothingBeyond) {
  dBuffer buffer(6);
  EXPECT_EQ(buffer.Get(6), static_cast<unsigned char*>(buffer.Get(0)) + 6);
  EXPECT_EQ(buffer.Get(7), nullptr);
}

TEST(dBuffer, SetFillsTheRoundedSize) {
  dBuffer buffer(5);
  buffer.Set(static_cast<unsigned char>(0xAB));
  EXPECT_EQ(BytesOf(buffer, 8), Bytes(8, 0xAB));
}

}  // namespace
