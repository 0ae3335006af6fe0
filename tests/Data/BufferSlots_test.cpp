// The order of the virtual functions of buffers, strings and text streams: applications that were
// built against an earlier library rely on it.
#include <vorl/Data/dASCIIStream.h>
#include <vorl/Data/dString.h>

#include <gtest/gtest.h>

#include "../Support/VirtualSlot.h"

namespace {

// GetClassInfo, a destructor of two places, and Release come first.
constexpr std::size_t kReset = 4;

TEST(BufferSlots, BufferResetsAndTellsItsValidity) {
  EXPECT_EQ(VirtualSlot(&dBuffer::GetClassInfo), 0U);
  EXPECT_EQ(VirtualSlot(&dBuffer::Release), kReset - 1);
  EXPECT_EQ(VirtualSlot(&dBuffer::Reset), kReset);
  EXPECT_EQ(VirtualSlot(&dBuffer::IsValid), kReset + 1);
}

TEST(BufferSlots, TextStreamResetsAndTellsItsValidity) {
  EXPECT_EQ(VirtualSlot(&dASCIIStreamIn::GetClassInfo), 0U);
  EXPECT_EQ(VirtualSlot(&dASCIIStreamIn::Release), kReset - 1);
  EXPECT_EQ(VirtualSlot(&dASCIIStreamIn::Reset), kReset);
  EXPECT_EQ(VirtualSlot(&dASCIIStreamIn::IsValid), kReset + 1);
}

TEST(BufferSlots, StringAddsItsInitialisationsAndIsEmpty) {
  EXPECT_EQ(VirtualSlot(&dString::Reset), kReset);
  EXPECT_EQ(VirtualSlot(&dString::IsValid), kReset + 1);
  EXPECT_EQ(VirtualSlot(static_cast<bool (dString::*)(unsigned int)>(&dString::Init)), kReset + 2);
  EXPECT_EQ(VirtualSlot(static_cast<bool (dString::*)()>(&dString::Init)), kReset + 3);
  EXPECT_EQ(VirtualSlot(&dString::IsEmpty), kReset + 4);
}

}  // namespace
