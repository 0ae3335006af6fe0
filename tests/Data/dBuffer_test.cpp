#include <vorl/Data/dBuffer.h>

#include <gtest/gtest.h>

#include <array>
#include <memory>
#include <vector>

#include "../Support/LogRecorder.h"

namespace {

using Bytes = std::vector<unsigned char>;

Bytes BytesOf(const dBuffer& buffer) {
  const auto* data = static_cast<const unsigned char*>(buffer.Get(0));
  return Bytes(data, data + buffer.GetSize());
}

void ExpectEmpty(const dBuffer& buffer) {
  EXPECT_EQ(buffer.Get(0), nullptr);
  EXPECT_EQ(buffer.GetSize(), 0u);
  EXPECT_EQ(buffer.GetCapacity(), 0u);
  EXPECT_FALSE(buffer.IsReference());
}

/// Three bytes that a test may copy, take over or refer to.
class dBufferInit : public testing::Test {
 protected:
  unsigned char m_bytes[3] = {5, 6, 7};
};

TEST(dBuffer, IsRegisteredUnderItsNameBelowDataBase) {
  EXPECT_STREQ(dBuffer::CI().name, "dBuffer");
  EXPECT_EQ(dBuffer::CI().parents[0], &DataBase::CI());
  const std::unique_ptr<dBuffer> created(dBuffer::Create());
  EXPECT_EQ(created->GetClassInfo(), &dBuffer::CI());
  ExpectEmpty(*created);
}

TEST(dBuffer, StartsEmpty) {
  dBuffer buffer;
  ExpectEmpty(buffer);
  EXPECT_FALSE(buffer);
  EXPECT_FALSE(buffer.IsValid());
}

TEST(dBuffer, SizeConstructorAllocates) {
  dBuffer buffer(13);
  EXPECT_TRUE(buffer);
  EXPECT_TRUE(buffer.IsValid());
  EXPECT_EQ(buffer.GetSize(), 13u);
  EXPECT_EQ(buffer.GetCapacity(), 16u);
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

  buffer.New(16, false);
  EXPECT_EQ(buffer.GetCapacity(), 16u);
  EXPECT_EQ(buffer.Get(0), block);

  buffer.New(20, false);
  EXPECT_EQ(buffer.GetSize(), 20u);
  EXPECT_EQ(buffer.GetCapacity(), 24u);
}

TEST(dBuffer, NewOfAMultipleOfEightAddsNothing) {
  EXPECT_EQ(dBuffer(8).GetCapacity(), 8u);
  EXPECT_EQ(dBuffer(9).GetCapacity(), 16u);
  EXPECT_EQ(dBuffer(1).GetCapacity(), 8u);
}

TEST(dBuffer, NewOfNothingOnAnEmptyBufferStaysEmpty) {
  dBuffer buffer;
  buffer.New(0, true);
  ExpectEmpty(buffer);
}

TEST(dBuffer, NewOfNothingKeepsTheBlock) {
  dBuffer buffer(13);
  void* const block = buffer.Get(0);
  buffer.New(0, false);
  EXPECT_EQ(buffer.GetSize(), 0u);
  EXPECT_EQ(buffer.GetCapacity(), 16u);
  EXPECT_EQ(buffer.Get(0), block);
}

TEST(dBuffer, NewClearsOnlyWhenAsked) {
  dBuffer buffer(4);
  buffer.Set(0x01010101);
  buffer.New(3, false);
  EXPECT_EQ(BytesOf(buffer), (Bytes{1, 1, 1}));
  buffer.New(4, true);
  EXPECT_EQ(BytesOf(buffer), (Bytes{0, 0, 0, 0}));
}

TEST_F(dBufferInit, NewKeepsAReferenceWithRoom) {
  dBuffer buffer(m_bytes, 3, DTM_Reference);
  buffer.New(2, false);
  EXPECT_TRUE(buffer.IsReference());
  EXPECT_EQ(buffer.Get(0), m_bytes);
  EXPECT_EQ(buffer.GetSize(), 2u);

  buffer.New(3, false);  // the third byte is no longer known to be there
  EXPECT_FALSE(buffer.IsReference());
  EXPECT_EQ(buffer.GetCapacity(), 8u);
}

TEST_F(dBufferInit, CopyAndTakeOverOfAPointerCopy) {
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver}) {
    dBuffer buffer(m_bytes, 3, mode);
    EXPECT_NE(buffer.Get(0), m_bytes);
    EXPECT_EQ(BytesOf(buffer), (Bytes{5, 6, 7}));
    EXPECT_EQ(buffer.GetCapacity(), 8u);
  }
}

TEST_F(dBufferInit, ReferenceLeavesForeignMemoryUntouchedWhenDestroyed) {
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

TEST_F(dBufferInit, UnknownModesAndNullPointersLeaveTheBufferEmpty) {
  for (const int mode : {-1, 0, 4}) {
    dBuffer buffer(10);
    buffer.Init(m_bytes, 3, static_cast<DataTransferMode>(mode));
    ExpectEmpty(buffer);
    dBuffer source(m_bytes, 3, DTM_Copy);
    buffer.New(10, false);
    buffer.Init(source, static_cast<DataTransferMode>(mode));
    ExpectEmpty(buffer);
    EXPECT_EQ(source.GetSize(), 3u);
  }
  dBuffer buffer(10);
  buffer.Init(nullptr, 3, DTM_Copy);
  ExpectEmpty(buffer);
}

TEST_F(dBufferInit, TheBuffersOwnPointerChangesNothing) {
  dBuffer buffer(m_bytes, 3, DTM_Copy);
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    buffer.Init(buffer.Get(0), 1, mode);
    EXPECT_EQ(BytesOf(buffer), (Bytes{5, 6, 7}));
    EXPECT_EQ(buffer.GetCapacity(), 8u);
  }
}

TEST_F(dBufferInit, CopyOfNothingIsEmpty) {
  dBuffer buffer(m_bytes, 0, DTM_Copy);
  ExpectEmpty(buffer);
}

TEST_F(dBufferInit, FromABufferCopiesOrRefers) {
  dBuffer source(m_bytes, 3, DTM_Copy);
  const dBuffer copy(source, DTM_Copy);
  EXPECT_NE(copy.Get(0), source.Get(0));
  EXPECT_EQ(BytesOf(copy), (Bytes{5, 6, 7}));

  const dBuffer reference(source, DTM_Reference);
  EXPECT_EQ(reference.Get(0), source.Get(0));
  EXPECT_EQ(reference.GetSize(), 3u);
  EXPECT_TRUE(reference.IsReference());
  EXPECT_EQ(source.GetCapacity(), 8u);
}

TEST_F(dBufferInit, FromItselfChangesNothing) {
  dBuffer buffer(m_bytes, 3, DTM_Copy);
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    buffer.Init(buffer, mode);
    buffer.Init(static_cast<const dBuffer&>(buffer), mode);
    EXPECT_EQ(BytesOf(buffer), (Bytes{5, 6, 7}));
    EXPECT_EQ(buffer.GetCapacity(), 8u);
  }
  buffer <<= buffer;
  EXPECT_EQ(BytesOf(buffer), (Bytes{5, 6, 7}));
}

TEST_F(dBufferInit, TakeOverMovesTheBlockAndEmptiesTheSource) {
  dBuffer source(9);
  void* const block = source.Get(0);
  dBuffer destination(100);
  destination <<= source;
  EXPECT_EQ(destination.Get(0), block);
  EXPECT_EQ(destination.GetSize(), 9u);
  EXPECT_EQ(destination.GetCapacity(), 16u);
  ExpectEmpty(source);

  dBuffer constructed(destination, DTM_TakeOver);
  EXPECT_EQ(constructed.Get(0), block);
  ExpectEmpty(destination);
}

TEST_F(dBufferInit, TakeOverOfAReferenceMovesTheReference) {
  dBuffer source(m_bytes, 3, DTM_Reference);
  dBuffer destination;
  destination <<= source;
  EXPECT_EQ(destination.Get(0), m_bytes);
  EXPECT_TRUE(destination.IsReference());
  ExpectEmpty(source);
}

TEST_F(dBufferInit, TakeOverOfAConstantBufferCopies) {
  const dBuffer source(m_bytes, 3, DTM_Copy);
  const dBuffer destination(source, DTM_TakeOver);
  EXPECT_NE(destination.Get(0), source.Get(0));
  EXPECT_EQ(BytesOf(destination), BytesOf(source));
}

TEST_F(dBufferInit, HandingOverEmptiesThisBuffer) {
  dBuffer source(9);
  void* const block = source.Get(0);
  dBuffer destination(3);
  source >>= destination;
  EXPECT_EQ(destination.Get(0), block);
  ExpectEmpty(source);
}

TEST_F(dBufferInit, CopiesAreDeep) {
  dBuffer source(m_bytes, 3, DTM_Copy);
  {
    const dBuffer copy(source);
    EXPECT_NE(copy.Get(0), source.Get(0));
    EXPECT_EQ(BytesOf(copy), (Bytes{5, 6, 7}));
  }
  EXPECT_EQ(BytesOf(source), (Bytes{5, 6, 7}));

  const dBuffer reference(m_bytes, 3, DTM_Reference);
  const dBuffer copy(reference);
  EXPECT_NE(copy.Get(0), reference.Get(0));
  EXPECT_FALSE(copy.IsReference());
}

TEST_F(dBufferInit, AssignmentReusesABlockWithRoom) {
  const dBuffer source(m_bytes, 3, DTM_Copy);
  dBuffer destination(16);
  void* const block = destination.Get(0);
  destination = source;
  EXPECT_EQ(destination.Get(0), block);
  EXPECT_EQ(destination.GetCapacity(), 16u);
  EXPECT_EQ(BytesOf(destination), (Bytes{5, 6, 7}));
}

TEST_F(dBufferInit, AssignmentToAReferenceWithRoomWritesToItsMemory) {
  unsigned char foreign[4] = {1, 1, 1, 1};
  dBuffer destination(foreign, 4, DTM_Reference);
  destination = dBuffer(m_bytes, 3, DTM_Copy);
  EXPECT_TRUE(destination.IsReference());
  EXPECT_EQ(destination.GetSize(), 3u);
  EXPECT_EQ((Bytes{foreign, foreign + 4}), (Bytes{5, 6, 7, 1}));
}

TEST_F(dBufferInit, AssignmentOfAnEmptyBufferGivesSizeZero) {
  dBuffer buffer(m_bytes, 3, DTM_Copy);
  buffer = dBuffer();
  EXPECT_EQ(buffer.GetSize(), 0u);
}

TEST_F(dBufferInit, SelfAssignmentChangesNothing) {
  dBuffer buffer(m_bytes, 3, DTM_Copy);
  const dBuffer& same = buffer;
  buffer = same;
  EXPECT_EQ(BytesOf(buffer), (Bytes{5, 6, 7}));
}

TEST_F(dBufferInit, DeleteAndResetEmptyTheBuffer) {
  dBuffer buffer(m_bytes, 3, DTM_Copy);
  EXPECT_TRUE(buffer.Delete());
  ExpectEmpty(buffer);
  EXPECT_TRUE(buffer.Delete());

  buffer.Init(m_bytes, 3, DTM_Reference);
  buffer.Reset();
  ExpectEmpty(buffer);
  EXPECT_EQ(m_bytes[0], 5);
}

TEST(dBuffer, GetGivesTheEndButNothingBeyond) {
  dBuffer buffer(6);
  EXPECT_EQ(buffer.Get(5), static_cast<unsigned char*>(buffer.Get(0)) + 5);
  EXPECT_EQ(buffer.Get(6), static_cast<unsigned char*>(buffer.Get(0)) + 6);
  EXPECT_EQ(buffer.Get(7), nullptr);
}

TEST(dBuffer, MethodsThatMayFailLogTheirEntry) {
  dBuffer source(8);
  dBuffer buffer;
  LogRecorder log;
  buffer.Init(source, DTM_Copy);
  buffer.Resize(20);
  EXPECT_EQ(log.entries,
            (std::vector<std::string>{"dBuffer::Init", "dBuffer::operator = ", "dBuffer::New",
                                      "dBuffer::Resize", "dBuffer::New"}));
  EXPECT_TRUE(log.errors.empty());
}

}  // namespace
