#include <stdexcept>

#include "BinaryFileTest.h"

namespace {

/// Does what its two functions say.
class Scripted : public IBinaryDataIO {
 public:
  void Write(BinaryDataOut& out) override { write(out); }
  void Read(BinaryDataIn& in) override { read(in); }

  std::function<void(BinaryDataOut&)> write = [](BinaryDataOut&) {};
  std::function<void(BinaryDataIn&)> read = [](BinaryDataIn&) {};
};

using IBinaryDataIOTest = BinaryFileTest;

TEST_F(IBinaryDataIOTest, AnObjectWithoutItemsIsOnlyTheHeader) {
  Scripted object;
  EXPECT_TRUE(object.WriteFile(FileName(), "X"));
  EXPECT_EQ(FileBytes(), (Bytes{0x42, 0x44, 0x46, 0x00, 0x58, 0x00}));
  EXPECT_TRUE(object.ReadFile(FileName(), "X"));
  EXPECT_TRUE(object.ReadFile(FileName(), nullptr));
}

TEST_F(IBinaryDataIOTest, ItemsStandDirectlyBehindTheHeader) {
  Scripted object;
  object.write = [](BinaryDataOut& out) { out.WriteU16(0x1234); };
  EXPECT_TRUE(object.WriteFile(FileName(), nullptr));
  EXPECT_EQ(FileBytes(), (Bytes{'B', 'D', 'F', 0, '?', '?', '?', 0, 0x03, 0x34, 0x12}));
  unsigned short value = 0;
  object.read = [&](BinaryDataIn& in) { in.ReadU16(value); };
  EXPECT_TRUE(object.ReadFile(FileName(), "???"));
  EXPECT_EQ(value, 0x1234);
}

TEST_F(IBinaryDataIOTest, NestedObjectsStandInBlocks) {
  unsigned char value = 9;
  Scripted inner;
  inner.write = [&](BinaryDataOut& out) { out.WriteU8(value); };
  inner.read = [&](BinaryDataIn& in) { in.ReadU8(value); };
  Scripted outer;
  outer.write = [&](BinaryDataOut& out) {
    out.OpenBlock(300);
    out.Write(&inner);
    out.CloseBlock();
  };
  outer.read = [&](BinaryDataIn& in) {
    in.OpenBlock(300);
    in.Read(&inner);
    EXPECT_TRUE(in.IsEndOfBlock());
    in.CloseBlock();
  };
  EXPECT_TRUE(outer.WriteFile(FileName(), "T"));
  EXPECT_EQ(ItemBytes(), (Bytes{0xF2, 0x2C, 0x01, 0xF0, 0x01, 9, 0x00, 0x00}));
  value = 0;
  EXPECT_TRUE(outer.ReadFile(FileName(), "T"));
  EXPECT_EQ(value, 9);
}

TEST_F(IBinaryDataIOTest, StreamErrorsBecomeFalse) {
  Scripted object;
  EXPECT_FALSE(object.ReadFile(FileName(), "T"));
  EXPECT_FALSE(object.ReadFile(nullptr, "T"));
  EXPECT_FALSE(object.WriteFile(nullptr, "T"));
  EXPECT_FALSE(object.WriteFile((m_path + "/none/file").c_str(), "T"));
  EXPECT_TRUE(object.WriteFile(FileName(), "T"));
  EXPECT_FALSE(object.ReadFile(FileName(), "U"));
  object.read = [](BinaryDataIn& in) { in.OpenBlock(); };
  EXPECT_FALSE(object.ReadFile(FileName(), "T"));
  object.write = [](BinaryDataOut&) { throw dStatus(-7, "own"); };
  EXPECT_FALSE(object.WriteFile(FileName(), "T"));
  object.read = [](BinaryDataIn&) { throw dStatus(-7, "own"); };
  EXPECT_FALSE(object.ReadFile(FileName(), "T"));
}

TEST_F(IBinaryDataIOTest, OtherExceptionsPassOn) {
  Scripted object;
  object.write = [](BinaryDataOut& out) {
    out.WriteU8(1);
    throw std::runtime_error("own");
  };
  EXPECT_THROW(object.WriteFile(FileName(), "T"), std::runtime_error);
  EXPECT_EQ(ItemBytes(), (Bytes{0x01, 1}));  // the file has been closed
  object.read = [](BinaryDataIn&) { throw 7; };
  EXPECT_THROW(object.ReadFile(FileName(), "T"), int);
}

}  // namespace
