// What a buffer does with sizes that cannot be met and with sources inside its own block.

#include <vorl/Data/dBuffer.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "../Support/LogRecorder.h"

namespace {

using Bytes = std::vector<unsigned char>;

constexpr unsigned long kFirstRefusedSize = 0xFFFFFFF1ul;  // rounds up to 4 GiB - 8

Bytes BytesOf(const dBuffer& buffer) {
  const auto* data = static_cast<const unsigned char*>(buffer.Get(0));
  return Bytes(data, data + buffer.GetSize());
}

void ExpectEmpty(const dBuffer& buffer) {
  EXPECT_EQ(buffer.Get(0), nullptr);
  EXPECT_EQ(buffer.GetSize(), 0u);
  EXPECT_EQ(buffer.GetCapacity(), 0u);
}

TEST(dBufferLimits, NewReportsWhatItCannotAllocate) {
  dBuffer buffer(10);
  LogRecorder log;
  EXPECT_EQ(&buffer.New(kFirstRefusedSize, true), &buffer);
  ExpectEmpty(buffer);
  EXPECT_EQ(log.errors,
            (std::vector<std::string>{"dBuffer::New: can't allocate 4294967288 bytes"}));
  EXPECT_EQ(log.errorCodes, (std::vector<long>{-1}));
}

TEST(dBufferLimits, SizeConstructorLeavesAnEmptyBuffer) {
  LogRecorder log;
  const dBuffer buffer(kFirstRefusedSize);
  ExpectEmpty(buffer);
  EXPECT_EQ(log.errors.size(), 1u);
}

TEST(dBufferLimits, ResizeReportsWhatItCannotAllocate) {
  dBuffer buffer(10);
  LogRecorder log;
  buffer.Resize(kFirstRefusedSize);
  ExpectEmpty(buffer);
  EXPECT_EQ(log.errors,
            (std::vector<std::string>{"dBuffer::New: can't allocate 4294967288 bytes"}));
}

TEST(dBufferLimits, InitRefusesACopyItCannotAllocate) {
  unsigned char byte = 1;
  dBuffer buffer(10);
  LogRecorder log;
  buffer.Init(&byte, kFirstRefusedSize, DTM_Copy);
  ExpectEmpty(buffer);
  EXPECT_EQ(log.errors,
            (std::vector<std::string>{"dBuffer::New: can't allocate 4294967288 bytes"}));
}

TEST(dBufferLimits, LargestSizesAreNotTruncated) {
  if constexpr (sizeof(unsigned long) > 4) {
    constexpr auto beyond = static_cast<unsigned long>((std::uint64_t{1} << 32) + 4);
    unsigned char byte = 1;
    dBuffer buffer(10);
    LogRecorder log;
    buffer.New(beyond, false);
    ExpectEmpty(buffer);
    buffer.Resize(beyond);
    ExpectEmpty(buffer);
    buffer.Init(&byte, beyond, DTM_Copy);
    ExpectEmpty(buffer);
    buffer.Init(&byte, beyond, DTM_Reference);
    ExpectEmpty(buffer);
    EXPECT_EQ(log.errors,
              (std::vector<std::string>{"dBuffer::New: can't allocate 4294967304 bytes",
                                        "dBuffer::New: can't allocate 4294967304 bytes",
                                        "dBuffer::New: can't allocate 4294967304 bytes",
                                        "dBuffer::Init: can't allocate 4294967304 bytes"}));
  }
}

TEST(dBufferLimits, RoundingUpTheLargestNumberDoesNotWrap) {
  dBuffer buffer(10);
  LogRecorder log;
  buffer.New(std::numeric_limits<unsigned long>::max(), true);
  ExpectEmpty(buffer);
  EXPECT_EQ(log.errors.size(), 1u);
  EXPECT_EQ(buffer.Get(std::numeric_limits<unsigned long>::max()), nullptr);
}

TEST(dBufferLimits, AReferenceMayHaveAnySizeThatFits32Bits) {
  unsigned char byte = 1;
  const dBuffer buffer(&byte, 0xFFFFFFFFul, DTM_Reference);
  EXPECT_EQ(buffer.GetSize(), 0xFFFFFFFFul);
  EXPECT_TRUE(buffer.IsReference());
}

/// A buffer of the bytes 0 to 15 and ways to point into it.
class dBufferAlias : public testing::Test {
 protected:
  dBufferAlias() : m_buffer(16) {
    for (int i = 0; i < 16; ++i) {
      *static_cast<unsigned char*>(m_buffer.Get(static_cast<unsigned long>(i))) =
          static_cast<unsigned char>(i);
    }
  }

  dBuffer m_buffer;
};

TEST_F(dBufferAlias, InitFromItsOwnBlockCopies) {
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    dBuffer buffer(m_buffer);
    buffer.Init(buffer.Get(4), 3, mode);
    EXPECT_EQ(BytesOf(buffer), (Bytes{4, 5, 6}));
    EXPECT_EQ(buffer.GetCapacity(), 8u);
  }
}

TEST_F(dBufferAlias, InitFromABufferThatRefersIntoItsOwnBlockCopies) {
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    for (const unsigned long offset : {0ul, 5ul}) {
      dBuffer buffer(m_buffer);
      dBuffer part(buffer.Get(offset), 3, DTM_Reference);
      buffer.Init(part, mode);
      const auto first = static_cast<unsigned char>(offset);
      EXPECT_EQ(BytesOf(buffer), (Bytes{first, static_cast<unsigned char>(first + 1),
                                        static_cast<unsigned char>(first + 2)}));
      EXPECT_EQ(buffer.GetCapacity(), 8u);
      EXPECT_EQ(part.GetSize(), mode == DTM_TakeOver ? 0u : 3u);
    }
  }
}

TEST_F(dBufferAlias, AssignmentFromItsOwnBlockMovesTheBytes) {
  const dBuffer part(m_buffer.Get(2), 10, DTM_Reference);
  m_buffer = part;
  EXPECT_EQ(BytesOf(m_buffer), (Bytes{2, 3, 4, 5, 6, 7, 8, 9, 10, 11}));
  EXPECT_EQ(m_buffer.GetCapacity(), 16u);
}

TEST_F(dBufferAlias, AReferenceTakesOverTheBlockItRefersTo) {
  dBuffer reference(m_buffer, DTM_Reference);
  reference <<= m_buffer;
  EXPECT_EQ(reference.GetCapacity(), 16u);
  EXPECT_EQ(reference.GetSize(), 16u);
  ExpectEmpty(m_buffer);
}

TEST_F(dBufferAlias, AReferenceCopiesTheBlockItRefersToOnlyByInit) {
  dBuffer reference(m_buffer, DTM_Reference);
  reference.Init(m_buffer, DTM_Copy);
  EXPECT_FALSE(reference.IsReference());
  EXPECT_NE(reference.Get(0), m_buffer.Get(0));
  EXPECT_EQ(BytesOf(reference), BytesOf(m_buffer));
}

}  // namespace
