#include <vorl/Data/dRect.h>

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <string>

#include "../Support/TestFolder.h"

namespace {

/// A file that is gone after the test.
class dRectFile : public ::testing::Test {
 protected:
  const char* Name() const { return m_name.c_str(); }
  std::string Bytes() const {
    std::ifstream file(m_name, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }

 private:
  const TestFolder m_folder;
  const std::string m_name = (m_folder / "rect.bdf").string();
};

TEST_F(dRectFile, HoldsSignedPositionThenUnsignedSize) {
  dRect rect(-2, 0x01020304, 0xFFFFFFFFU, 5);
  ASSERT_TRUE(rect.WriteFile(Name(), "dRect"));
  const std::string expected(
      "BDF\0"
      "dRect\0"
      "\x06\xFE\xFF\xFF\xFF"
      "\x06\x04\x03\x02\x01"
      "\x05\xFF\xFF\xFF\xFF"
      "\x05\x05\x00\x00\x00",
      30);
  EXPECT_EQ(Bytes(), expected);
}

TEST_F(dRectFile, ReadsWhatWasWritten) {
  dRect written(-2147483647 - 1, 2147483647, 4294967295U, 0);
  ASSERT_TRUE(written.WriteFile(Name(), "dRect"));
  dRect read(1, 2, 3, 4);
  EXPECT_TRUE(read.ReadFile(Name(), "dRect"));
  EXPECT_TRUE(read == written);
}

TEST_F(dRectFile, AFailedReadLeavesTheRectangleAsItWas) {
  {
    BinaryDataOut out(Name(), "dRect");
    out.WriteS32(100L);
    out.WriteS32(200L);
    out.WriteU32(300UL);
  }
  dRect rect(1, 2, 3, 4);
  EXPECT_FALSE(rect.ReadFile(Name(), "dRect"));
  EXPECT_TRUE(rect == dRect(1, 2, 3, 4));
}

TEST_F(dRectFile, AnItemOfAnotherTypeIsRefused) {
  {
    BinaryDataOut out(Name(), "dRect");
    out.WriteS32(100L);
    out.WriteS32(200L);
    out.WriteS32(300L);  // the width is unsigned
    out.WriteU32(400UL);
  }
  dRect rect(1, 2, 3, 4);
  EXPECT_FALSE(rect.ReadFile(Name(), "dRect"));
  EXPECT_TRUE(rect == dRect(1, 2, 3, 4));
}

}  // namespace
