#include <memory>

#include "BinaryFileTest.h"

namespace {

/// Opens what derived classes may call.
class OpenIn : public BinaryDataIn {
 public:
  using BinaryDataIn::BinaryDataIn;
  using BinaryDataIn::Error;
  using BinaryDataIn::Read;
};

/// An object whose one field is a byte.
class Byte : public IBinaryDataIO {
 public:
  void Write(BinaryDataOut& out) override { out.WriteU8(value); }
  void Read(BinaryDataIn& in) override { in.ReadU8(value); }

  unsigned char value = 0;
};

TEST(BinaryDataIn, IsRegisteredUnderItsNameBelowBaseClass) {
  EXPECT_STREQ(BinaryDataIn::CI().name, "BinaryDataIn");
  EXPECT_EQ(BinaryDataIn::CI().parents[0], &BaseClass::CI());
  const std::unique_ptr<BinaryDataIn> created(BinaryDataIn::Create());
  EXPECT_EQ(created->GetClassInfo(), &BinaryDataIn::CI());
}

TEST(BinaryDataIn, StartsUninitialized) {
  const BinaryDataIn in;
  EXPECT_EQ(static_cast<long>(in.GetStatus()), -1);
  EXPECT_STREQ(in.GetStatus(), "uninitialized");
  EXPECT_EQ(in.GetRemainingBytes(), 0u);
}

TEST_F(BinaryDataInTest, OpenChecksMagicAndType) {
  MakeFile({'B', 'D', 'F', 0, 'X', 'Y', 0});
  BinaryDataIn in;
  EXPECT_TRUE(in.Open(FileName(), "XY"));
  EXPECT_EQ(static_cast<long>(in.GetStatus()), 0);
  EXPECT_STREQ(in.GetStatus(), "");
  EXPECT_TRUE(in.Open(FileName(), nullptr));
  for (const char* other : {"X", "XYZ", "xy", "", "???"}) {
    EXPECT_EQ(ThrownCode([&] { in.Open(FileName(), other); }), -202) << other;
  }
  EXPECT_EQ(static_cast<long>(in.GetStatus()), -202);
}

TEST_F(BinaryDataInTest, OpenRefusesAnotherMagic) {
  for (const Bytes& bytes : {Bytes{'B', 'D', 'F', 1, 'T', 0}, Bytes{'b', 'D', 'F', 0, 'T', 0},
                             Bytes{'B', 'D', 'G', 0, 'T', 0}, Bytes{0, 0, 0, 0, 0}}) {
    MakeFile(bytes);
    EXPECT_EQ(ThrownCode([&] { BinaryDataIn in(FileName(), "T"); }), -203);
  }
}

TEST_F(BinaryDataInTest, OpenRefusesAHeaderThatEndsEarly) {
  const Bytes header = {'B', 'D', 'F', 0, 'T', 0};
  for (std::size_t size = 0; size < header.size(); ++size) {
    MakeFile(Bytes(header.begin(), header.begin() + static_cast<std::ptrdiff_t>(size)));
    EXPECT_EQ(ThrownCode([&] { BinaryDataIn in(FileName(), "T"); }), -200) << size;
    EXPECT_EQ(ThrownCode([&] { BinaryDataIn in(FileName(), nullptr); }), -200) << size;
  }
}

TEST_F(BinaryDataInTest, OpenFailsWithoutANameOrAFile) {
  BinaryDataIn in;
  EXPECT_EQ(ThrownCode([&] { in.Open(nullptr, "T"); }), -2);
  EXPECT_EQ(ThrownCode([&] { in.Open(FileName(), "T"); }), -3);
  EXPECT_EQ(static_cast<long>(in.GetStatus()), -3);
}

TEST_F(BinaryDataInTest, TypeNamesOf500CharactersAreReadWhole) {
  const std::string name(500, 'n');
  BinaryDataOut(FileName(), name.c_str()).WriteU8(9);
  BinaryDataIn in(FileName(), name.c_str());
  unsigned char value = 0;
  in.ReadU8(value);
  EXPECT_EQ(value, 9);
}

TEST_F(BinaryDataInTest, LongerTypeNamesNeverMatch) {
  for (const std::size_t length : {501u, 502u, 5000u}) {
    const std::string name(length, 'n');
    BinaryDataOut(FileName(), name.c_str()).Close();
    EXPECT_EQ(ThrownCode([&] { BinaryDataIn in(FileName(), name.c_str()); }), -202) << length;
    const std::string prefix(500, 'n');
    EXPECT_EQ(ThrownCode([&] { BinaryDataIn in(FileName(), prefix.c_str()); }), -202) << length;
  }
}

TEST_F(BinaryDataInTest, AtMost501BytesOfATypeNameAreTaken) {
  BinaryDataOut(FileName(), std::string(510, 'n').c_str()).Close();
  const BinaryDataIn in(FileName(), nullptr);
  EXPECT_EQ(in.GetRemainingBytes(), 10u);  // nine characters and the zero byte
}

TEST_F(BinaryDataInTest, ReadsScalars) {
  MakeItems({0x01, 0xFE,                                      //
             0x02, 0xFE,                                      //
             0x03, 0x34, 0x92,                                //
             0x04, 0xFE, 0xFF,                                //
             0x05, 0x78, 0x56, 0x34, 0x92,                    //
             0x06, 0xFE, 0xFF, 0xFF, 0xFF,                    //
             0x07, 0x00, 0x00, 0xC0, 0x3F,                    //
             0x08, 0,    0,    0,    0,    0, 0, 0x00, 0xC0,  //
             0x09, 1,                                         //
             0x09, 0,                                         //
             0x09, 0x80});
  BinaryDataIn in(FileName(), "T");
  unsigned char u8 = 0;
  char s8 = 0;
  unsigned short u16 = 0;
  short s16 = 0;
  unsigned long u32 = 0;
  long s32 = 0;
  float f32 = 0;
  double f64 = 0;
  bool flags[3] = {false, true, false};
  EXPECT_TRUE(in.ReadU8(u8));
  EXPECT_TRUE(in.ReadS8(s8));
  EXPECT_TRUE(in.ReadU16(u16));
  EXPECT_TRUE(in.ReadS16(s16));
  EXPECT_TRUE(in.ReadU32(u32));
  EXPECT_TRUE(in.ReadS32(s32));
  EXPECT_TRUE(in.ReadF32(f32));
  EXPECT_TRUE(in.ReadF64(f64));
  for (bool& flag : flags) {
    EXPECT_TRUE(in.ReadBool(flag));
  }
  EXPECT_EQ(u8, 254);
  EXPECT_EQ(s8, static_cast<char>(-2));
  EXPECT_EQ(u16, 0x9234);
  EXPECT_EQ(s16, -2);
  EXPECT_EQ(u32, 0x92345678ul);
  EXPECT_EQ(s32, -2);
  EXPECT_EQ(f32, 1.5f);
  EXPECT_EQ(f64, -2.0);
  EXPECT_TRUE(flags[0]);
  EXPECT_FALSE(flags[1]);
  EXPECT_TRUE(flags[2]);
  EXPECT_EQ(in.GetRemainingBytes(), 0u);
}

TEST_F(BinaryDataInTest, ReadsScalarsOf32BitTypes) {
  MakeItems({0x05, 0xFE, 0xFF, 0xFF, 0xFF, 0x06, 0xFE, 0xFF, 0xFF, 0xFF});
  BinaryDataIn in(FileName(), "T");
  std::uint32_t u32 = 0;
  std::int32_t s32 = 0;
  EXPECT_TRUE(in.ReadU32(u32));
  EXPECT_TRUE(in.ReadS32(s32));
  EXPECT_EQ(u32, 0xFFFFFFFEu);
  EXPECT_EQ(s32, -2);
}

TEST_F(BinaryDataInTest, BlocksMustBeOfTheExpectedKind) {
  MakeItems({0xF0, 0xF1, 7, 0xF2, 0x2C, 0x01, 0xF4, 1, 2, 3, 4, 0x00});
  BinaryDataIn in(FileName(), "T");
  EXPECT_TRUE(in.OpenBlock());
  EXPECT_TRUE(in.OpenBlock(7));
  EXPECT_TRUE(in.OpenBlock(300));
  EXPECT_TRUE(in.OpenBlock(0x04030201ul));
  EXPECT_TRUE(in.CloseBlock());

  EXPECT_EQ(CodeOf({0xF2, 0x2C, 0x01}, [](BinaryDataIn& file) { file.OpenBlock(301); }), -207);
  EXPECT_EQ(CodeOf({0xF0}, [](BinaryDataIn& file) { file.OpenBlock(0); }), -205);
  EXPECT_EQ(CodeOf({0xF3, 0, 0, 0}, [](BinaryDataIn& file) { file.OpenBlock(0); }), -205);
  EXPECT_EQ(CodeOf({0xE1, 7}, [](BinaryDataIn& file) { file.OpenBlock(7); }), -205);
  EXPECT_EQ(CodeOf({0xF1, 7}, [](BinaryDataIn& file) { file.OpenBlock(); }), -206);
  EXPECT_EQ(CodeOf({0x01, 7}, [](BinaryDataIn& file) { file.CloseBlock(); }), -206);
}

TEST_F(BinaryDataInTest, BlockIdentifiersAreComparedIn64Bits) {
  if constexpr (sizeof(unsigned long) > 4) {
    const auto id = static_cast<unsigned long>(0x100000007ULL);
    EXPECT_EQ(CodeOf({0xF1, 7}, [&](BinaryDataIn& in) { in.OpenBlock(id); }), -207);
  }
}

TEST_F(BinaryDataInTest, EndOfBlockIsSeenWithoutMoving) {
  MakeItems({0xF0, 0x01, 9, 0x00});
  BinaryDataIn in(FileName(), "T");
  in.OpenBlock();
  EXPECT_FALSE(in.IsEndOfBlock());
  unsigned char value = 0;
  in.ReadU8(value);
  EXPECT_EQ(value, 9);
  EXPECT_TRUE(in.IsEndOfBlock());
  EXPECT_TRUE(in.IsEndOfBlock());
  EXPECT_EQ(in.GetRemainingBytes(), 1u);
  EXPECT_TRUE(in.CloseBlock());
  EXPECT_FALSE(in.IsEndOfBlock());
  EXPECT_EQ(ThrownCode([&] { in.CloseBlock(); }), -201);
  in.Close();
  EXPECT_FALSE(in.IsEndOfBlock());
}

TEST_F(BinaryDataInTest, AnotherTagFails) {
  unsigned short value = 7;
  EXPECT_EQ(CodeOf({0x04, 1, 0}, [&](BinaryDataIn& in) { in.ReadU16(value); }), -206);
  EXPECT_EQ(value, 7);
  std::string text = "abc";
  EXPECT_EQ(CodeOf({0xE1, 1, 0x02, 0}, [&](BinaryDataIn& in) { in.ReadString(text); }), -206);
  EXPECT_EQ(text, "abc");
  EXPECT_EQ(CodeOf({0x01, 1}, [](BinaryDataIn& in) { in.ReadArrayLength(); }), -204);
  EXPECT_EQ(CodeOf({0xE3, 1, 1, 1}, [](BinaryDataIn& in) { in.ReadArrayLength(); }), -204);
  EXPECT_EQ(CodeOf({0xE0, 1}, [](BinaryDataIn& in) { in.ReadArrayLength(); }), -204);
  EXPECT_EQ(CodeOf({0xF1, 1}, [](BinaryDataIn& in) { in.ReadArrayLength(); }), -204);
}

TEST_F(BinaryDataInTest, TheEndOfTheFileHasItsOwnCodes) {
  unsigned char value = 0;
  EXPECT_EQ(CodeOf({}, [&](BinaryDataIn& in) { in.ReadU8(value); }), -201);
  EXPECT_EQ(CodeOf({}, [](BinaryDataIn& in) { in.OpenBlock(); }), -201);
  EXPECT_EQ(CodeOf({}, [](BinaryDataIn& in) { in.ReadArrayLength(); }), -204);
  EXPECT_EQ(CodeOf({}, [](BinaryDataIn& in) { in.OpenBlock(1); }), -205);
  EXPECT_EQ(CodeOf({0x01}, [&](BinaryDataIn& in) { in.ReadU8(value); }), -200);
  EXPECT_EQ(CodeOf({0xE2, 1}, [](BinaryDataIn& in) { in.ReadArrayLength(); }), -200);
  EXPECT_EQ(CodeOf({0xF4, 1, 2, 3}, [](BinaryDataIn& in) { in.OpenBlock(1); }), -200);
  std::string text;
  EXPECT_EQ(CodeOf({0xE1, 1}, [&](BinaryDataIn& in) { in.ReadString(text); }), -201);
}

TEST_F(BinaryDataInTest, EveryReaderFailsWithoutAFile) {
  BinaryDataIn in;
  unsigned char byte = 0;
  long number = 0;
  std::string text;
  Byte object;
  EXPECT_EQ(ThrownCode([&] { in.ReadU8(byte); }), -4);
  EXPECT_EQ(ThrownCode([&] { in.ReadS32(number); }), -4);
  EXPECT_EQ(ThrownCode([&] { in.ReadU8Array(&byte, 1); }), -4);
  EXPECT_EQ(ThrownCode([&] { in.ReadS32Array(&number, 1); }), -4);
  EXPECT_EQ(ThrownCode([&] { in.OpenBlock(); }), -4);
  EXPECT_EQ(ThrownCode([&] { in.CloseBlock(); }), -4);
  EXPECT_EQ(ThrownCode([&] { in.Read(&object); }), -4);
  EXPECT_EQ(ThrownCode([&] { in.ReadArrayLength(); }), -204);
  EXPECT_EQ(ThrownCode([&] { in.ReadString(text); }), -204);
  EXPECT_EQ(ThrownCode([&] { in.OpenBlock(1); }), -205);
}

TEST_F(BinaryDataInTest, ObjectsAreReadFromABlock) {
  MakeItems({0xF0, 0x01, 0x5A, 0x00, 0x01, 1});
  BinaryDataIn in(FileName(), "T");
  Byte object;
  EXPECT_TRUE(in.Read(&object));
  EXPECT_EQ(object.value, 0x5A);
  EXPECT_FALSE(in.Read(nullptr));
  EXPECT_EQ(in.GetRemainingBytes(), 2u);
  EXPECT_EQ(CodeOf({0xF0, 0x01, 1, 0x01, 1}, [&](BinaryDataIn& file) { file.Read(&object); }),
            -206);  // an item more than the object knows
}

TEST_F(BinaryDataInTest, PrimitiveReadsTagAndBytes) {
  MakeItems({0x77, 1, 2, 0x78, 0x79});
  OpenIn in(FileName(), "T");
  unsigned char data[2] = {};
  EXPECT_TRUE(in.Read(0x77, data, 2));
  EXPECT_EQ(data[1], 2);
  EXPECT_TRUE(in.Read(0x78, nullptr, 5));
  EXPECT_TRUE(in.Read(0x79, data, 0));
  EXPECT_EQ(ThrownCode([&] { in.Read(0x79, data, 1); }), -201);
}

TEST_F(BinaryDataInTest, RequireBytesComparesWithWhatTheFileStillHolds) {
  MakeItems({0x01, 1, 0x01, 2});
  BinaryDataIn in(FileName(), "T");
  EXPECT_EQ(in.GetRemainingBytes(), 4u);
  EXPECT_TRUE(in.RequireBytes(4));
  EXPECT_EQ(ThrownCode([&] { in.RequireBytes(5); }), -200);
  EXPECT_EQ(ThrownCode([&] { in.RequireBytes(~std::uint64_t{0}); }), -200);
  unsigned char value = 0;
  in.ReadU8(value);
  EXPECT_EQ(in.GetRemainingBytes(), 2u);
  EXPECT_EQ(ThrownCode([&] { in.RequireBytes(3); }), -200);
}

TEST_F(BinaryDataInTest, ErrorsStateCodeAndLine) {
  OpenIn in;
  try {
    in.Error(-123, 45);
  } catch (const dStatus& status) {
    EXPECT_EQ(static_cast<long>(status), -123);
    EXPECT_STREQ(status, "Error -123 in class BinaryDataIn [BinaryDataIO/line 45]");
    EXPECT_STREQ(in.GetStatus(), status);
    return;
  }
  FAIL() << "nothing was thrown";
}

TEST_F(BinaryDataInTest, ThrownStatusEqualsTheStreams) {
  MakeItems({});
  BinaryDataIn in(FileName(), "T");
  unsigned char value = 0;
  try {
    in.ReadU8(value);
  } catch (const dStatus& status) {
    EXPECT_STREQ(in.GetStatus(), status);
    EXPECT_EQ(std::string(status).find("Error -201 in class BinaryDataIn [BinaryDataIO/line "), 0u);
    return;
  }
  FAIL() << "nothing was thrown";
}

}  // namespace
