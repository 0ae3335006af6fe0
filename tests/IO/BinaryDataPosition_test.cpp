// Where a reader stands after it has failed: the file stays open, what was read stays read.
#include <vorl/Data/dBuffer.h>

#include "BinaryFileTest.h"

namespace {

class BinaryDataPosition : public BinaryFileTest {
 protected:
  /// Opens a file with these items and a U8 of value 7 behind them.
  void OpenItems(const Bytes& items) {
    MakeItems(items + Bytes{0x01, 7});
    m_in.Open(FileName(), "T");
  }
  /// The code that is raised.
  template <class Action>
  long CodeOf(Action action) {
    try {
      action();
    } catch (const dStatus& status) {
      return status;
    }
    return 0;
  }
  void ExpectSeven() {
    unsigned char value = 0;
    EXPECT_TRUE(m_in.ReadU8(value));
    EXPECT_EQ(value, 7);
  }

  BinaryDataIn m_in;
};

TEST_F(BinaryDataPosition, TagOfAnotherTypeIsTaken) {
  OpenItems({0x04});
  unsigned char value = 0;
  EXPECT_EQ(CodeOf([&] { m_in.ReadU8(value); }), -206);
  ExpectSeven();
}

TEST_F(BinaryDataPosition, TagThatIsNoLengthIsTaken) {
  OpenItems({0x04});
  EXPECT_EQ(CodeOf([&] { m_in.ReadArrayLength(); }), -204);
  ExpectSeven();
}

TEST_F(BinaryDataPosition, TagThatIsNoBlockIsTaken) {
  OpenItems({0xF0});
  EXPECT_EQ(CodeOf([&] { m_in.OpenBlock(5UL); }), -205);
  ExpectSeven();
}

TEST_F(BinaryDataPosition, StartOfAnotherBlockIsTaken) {
  OpenItems({0xF1, 6});
  EXPECT_EQ(CodeOf([&] { m_in.OpenBlock(5UL); }), -207);
  ExpectSeven();
}

TEST_F(BinaryDataPosition, LengthOfABufferThatDoesNotFitIsTaken) {
  OpenItems({0xE1, 3});
  dBuffer buffer(2);
  EXPECT_EQ(CodeOf([&] { m_in.ReadBuffer(buffer, true); }), -208);
  ExpectSeven();
}

TEST_F(BinaryDataPosition, FileOfAnotherTypeStaysOpen) {
  MakeItems({0x01, 7});
  EXPECT_EQ(CodeOf([&] { m_in.Open(FileName(), "U"); }), -202);
  ExpectSeven();
}

}  // namespace
