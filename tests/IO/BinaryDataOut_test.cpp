#include <vorl/Data/dBuffer.h>
#include <vorl/Data/dString.h>

#include <limits>
#include <memory>

#include "BinaryFileTest.h"

namespace {

/// Opens what derived classes may call.
class OpenOut : public BinaryDataOut {
 public:
  using BinaryDataOut::BinaryDataOut;
  using BinaryDataOut::Error;
  using BinaryDataOut::Write;
  using BinaryDataOut::WriteArray;
};

/// An object whose one field is a byte.
class Byte : public IBinaryDataIO {
 public:
  void Write(BinaryDataOut& out) override { out.WriteU8(value); }
  void Read(BinaryDataIn& in) override { in.ReadU8(value); }

  unsigned char value = 0x5A;
};

using BinaryDataOutTest = BinaryFileTest;

TEST(BinaryDataOut, IsRegisteredUnderItsNameBelowBaseClass) {
  EXPECT_STREQ(BinaryDataOut::CI().name, "BinaryDataOut");
  EXPECT_EQ(BinaryDataOut::CI().parents[0], &BaseClass::CI());
  const std::unique_ptr<BinaryDataOut> created(BinaryDataOut::Create());
  EXPECT_EQ(created->GetClassInfo(), &BinaryDataOut::CI());
}

TEST(BinaryDataOut, StartsUninitialized) {
  const BinaryDataOut out;
  EXPECT_EQ(static_cast<long>(out.GetStatus()), -1);
  EXPECT_STREQ(out.GetStatus(), "uninitialized");
}

TEST_F(BinaryDataOutTest, OpenWritesMagicAndTypeName) {
  BinaryDataOut out;
  EXPECT_TRUE(out.Open(FileName(), "Type"));
  EXPECT_EQ(static_cast<long>(out.GetStatus()), 0);
  EXPECT_STREQ(out.GetStatus(), "");
  out.Close();
  EXPECT_EQ(FileBytes(), (Bytes{'B', 'D', 'F', 0, 'T', 'y', 'p', 'e', 0}));
  EXPECT_EQ(static_cast<long>(out.GetStatus()), 0);
}

TEST_F(BinaryDataOutTest, OpenWithoutTypeNameWritesQuestionMarks) {
  BinaryDataOut(FileName(), nullptr).Close();
  EXPECT_EQ(FileBytes(), (Bytes{'B', 'D', 'F', 0, '?', '?', '?', 0}));
  BinaryDataOut(FileName(), "").Close();
  EXPECT_EQ(FileBytes(), (Bytes{'B', 'D', 'F', 0, 0}));
}

TEST_F(BinaryDataOutTest, OpenTruncatesAndClosesWhatWasOpen) {
  MakeFile(Bytes(1000, 1));
  BinaryDataOut out(FileName(), "T");
  out.WriteU8(1);
  EXPECT_TRUE(out.Open(FileName(), "U"));
  out.Close();
  EXPECT_EQ(FileBytes(), (Bytes{'B', 'D', 'F', 0, 'U', 0}));
}

TEST_F(BinaryDataOutTest, ScalarsStandLittleEndianBehindTheirTags) {
  EXPECT_EQ(Written([](BinaryDataOut& out) {
              EXPECT_TRUE(out.WriteU8(0xFE));
              EXPECT_TRUE(out.WriteS8(static_cast<char>(-2)));
              EXPECT_TRUE(out.WriteU16(0x1234));
              EXPECT_TRUE(out.WriteS16(-2));
              EXPECT_TRUE(out.WriteU32(0x12345678ul));
              EXPECT_TRUE(out.WriteS32(-2));
              EXPECT_TRUE(out.WriteF32(1.5f));
              EXPECT_TRUE(out.WriteF64(-2.0));
              EXPECT_TRUE(out.WriteBool(true));
              EXPECT_TRUE(out.WriteBool(false));
            }),
            (Bytes{0x01, 0xFE,                                      //
                   0x02, 0xFE,                                      //
                   0x03, 0x34, 0x12,                                //
                   0x04, 0xFE, 0xFF,                                //
                   0x05, 0x78, 0x56, 0x34, 0x12,                    //
                   0x06, 0xFE, 0xFF, 0xFF, 0xFF,                    //
                   0x07, 0x00, 0x00, 0xC0, 0x3F,                    // 0x3FC00000
                   0x08, 0,    0,    0,    0,    0, 0, 0x00, 0xC0,  // 0xC000000000000000
                   0x09, 1,                                         //
                   0x09, 0}));
}

TEST_F(BinaryDataOutTest, ThirtyTwoBitExtremesFit) {
  EXPECT_EQ(Written([](BinaryDataOut& out) {
              out.WriteS32(std::numeric_limits<std::int32_t>::min());
              out.WriteS32(std::numeric_limits<std::int32_t>::max());
              out.WriteU32(std::numeric_limits<std::uint32_t>::max());
              out.WriteU32(5);
            }),
            (Bytes{0x06, 0x00, 0x00, 0x00, 0x80,  //
                   0x06, 0xFF, 0xFF, 0xFF, 0x7F,  //
                   0x05, 0xFF, 0xFF, 0xFF, 0xFF,  //
                   0x05, 0x05, 0x00, 0x00, 0x00}));
}

TEST_F(BinaryDataOutTest, ValuesBeyond32BitsFailAndWriteNothing) {
  if constexpr (sizeof(long) > 4) {
    const long tooSmall = static_cast<long>(-0x80000001LL);
    const long tooLarge = static_cast<long>(0x80000000LL);
    const auto tooLargeUnsigned = static_cast<unsigned long>(0x100000000ULL);
    EXPECT_EQ(Written([&](BinaryDataOut& out) {
                EXPECT_EQ(ThrownCode([&] { out.WriteS32(tooSmall); }), -100);
                EXPECT_EQ(ThrownCode([&] { out.WriteS32(tooLarge); }), -100);
                EXPECT_EQ(ThrownCode([&] { out.WriteU32(tooLargeUnsigned); }), -100);
                EXPECT_EQ(ThrownCode([&] { out.OpenBlock(tooLargeUnsigned); }), -100);
                const long signedValues[] = {1, tooLarge};
                EXPECT_EQ(ThrownCode([&] { out.WriteS32Array(signedValues, 2); }), -100);
                const unsigned long unsignedValues[] = {1, tooLargeUnsigned};
                EXPECT_EQ(ThrownCode([&] { out.WriteU32Array(unsignedValues, 2); }), -100);
              }),
              Bytes{});
  }
}

TEST_F(BinaryDataOutTest, ArraysAreALengthAndOneItem) {
  const char s8[] = {1, static_cast<char>(-1)};
  const unsigned char u8[] = {1, 255};
  const short s16[] = {1, -1};
  const unsigned short u16[] = {1, 0x0203};
  const float f32[] = {1.0f};
  const double f64[] = {1.0};
  EXPECT_EQ(Written([&](BinaryDataOut& out) {
              EXPECT_TRUE(out.WriteS8Array(s8, 2));
              EXPECT_TRUE(out.WriteU8Array(u8, 2));
              EXPECT_TRUE(out.WriteS16Array(s16, 2));
              EXPECT_TRUE(out.WriteU16Array(u16, 2));
              EXPECT_TRUE(out.WriteF32Array(f32, 1));
              EXPECT_TRUE(out.WriteF64Array(f64, 1));
            }),
            (Bytes{0xE1, 2, 0x02, 1, 0xFF,              //
                   0xE1, 2, 0x01, 1, 0xFF,              //
                   0xE1, 2, 0x04, 1, 0,    0xFF, 0xFF,  //
                   0xE1, 2, 0x03, 1, 0,    3,    2,     //
                   0xE1, 1, 0x07, 0, 0,    0x80, 0x3F,  //
                   0xE1, 1, 0x08, 0, 0,    0,    0,    0, 0, 0xF0, 0x3F}));
}

TEST_F(BinaryDataOutTest, ThirtyTwoBitArraysTakeFourBytesPerElementFromBothTypes) {
  const long s32Long[] = {1, -2};
  const std::int32_t s32[] = {1, -2};
  const unsigned long u32Long[] = {1, 0xFFFFFFFEul};
  const std::uint32_t u32[] = {1, 0xFFFFFFFEu};
  const Bytes elements = {1, 0, 0, 0, 0xFE, 0xFF, 0xFF, 0xFF};
  const Bytes signedArray = Bytes{0xE1, 2, 0x06} + elements;
  const Bytes unsignedArray = Bytes{0xE1, 2, 0x05} + elements;
  EXPECT_EQ(Written([&](BinaryDataOut& out) {
              EXPECT_TRUE(out.WriteS32Array(s32Long, 2));
              EXPECT_TRUE(out.WriteS32Array(s32, 2));
              EXPECT_TRUE(out.WriteU32Array(u32Long, 2));
              EXPECT_TRUE(out.WriteU32Array(u32, 2));
            }),
            signedArray + signedArray + unsignedArray + unsignedArray);
}

TEST_F(BinaryDataOutTest, LengthItemsTakeAsFewBytesAsTheCountNeeds) {
  const Bytes zeros(65536, 0);
  const auto written = [&](int count) {
    return Written([&](BinaryDataOut& out) { out.WriteU8Array(zeros.data(), count); });
  };
  const auto data = [](std::size_t count) { return Bytes{0x01} + Bytes(count, 0); };
  EXPECT_EQ(written(0), (Bytes{0xE1, 0}) + data(0));
  EXPECT_EQ(written(255), (Bytes{0xE1, 0xFF}) + data(255));
  EXPECT_EQ(written(256), (Bytes{0xE2, 0x00, 0x01}) + data(256));
  EXPECT_EQ(written(65535), (Bytes{0xE2, 0xFF, 0xFF}) + data(65535));
  EXPECT_EQ(written(65536), (Bytes{0xE4, 0x00, 0x00, 0x01, 0x00}) + data(65536));
}

TEST_F(BinaryDataOutTest, LengthItemsCountElementsNotBytes) {
  const double values[200] = {};
  const Bytes items = Written([&](BinaryDataOut& out) { out.WriteF64Array(values, 200); });
  EXPECT_EQ(items, (Bytes{0xE1, 200, 0x08}) + Bytes(1600, 0));
}

TEST_F(BinaryDataOutTest, BadArrayArgumentsFailAndWriteNothing) {
  const unsigned char bytes[1] = {1};
  const long longs[1] = {1};
  EXPECT_EQ(Written([&](BinaryDataOut& out) {
              EXPECT_EQ(ThrownCode([&] { out.WriteU8Array(bytes, -1); }), -100);
              EXPECT_EQ(ThrownCode([&] { out.WriteS32Array(longs, -1); }), -100);
              EXPECT_EQ(ThrownCode([&] { out.WriteU8Array(nullptr, 1); }), -100);
              EXPECT_EQ(ThrownCode([&] {
                          out.WriteU32Array(static_cast<const unsigned long*>(nullptr), 1);
                        }),
                        -100);
            }),
            Bytes{});
}

TEST_F(BinaryDataOutTest, NullArraysOfNoElementsAreEmptyArrays) {
  EXPECT_EQ(Written([](BinaryDataOut& out) {
              EXPECT_TRUE(out.WriteU16Array(nullptr, 0));
              EXPECT_TRUE(out.WriteS32Array(static_cast<const long*>(nullptr), 0));
            }),
            (Bytes{0xE1, 0, 0x03, 0xE1, 0, 0x06}));
}

TEST_F(BinaryDataOutTest, StringsCarryTheirTerminator) {
  EXPECT_EQ(Written([](BinaryDataOut& out) {
              EXPECT_TRUE(out.WriteString(std::string("ab")));
              EXPECT_TRUE(out.WriteString(dString("ab")));
            }),
            (Bytes{0xE1, 0x03, 0x01, 0x61, 0x62, 0x00, 0xE1, 0x03, 0x01, 0x61, 0x62, 0x00}));
}

TEST_F(BinaryDataOutTest, EmptyStringsAreOneZeroByte) {
  dString deleted("ab");
  deleted.Delete();
  EXPECT_EQ(Written([&](BinaryDataOut& out) {
              out.WriteString(std::string());
              out.WriteString(dString());
              out.WriteString(deleted);
            }),
            (Bytes{0xE1, 1, 1, 0, 0xE1, 1, 1, 0, 0xE1, 1, 1, 0}));
}

TEST_F(BinaryDataOutTest, StringsKeepZeroBytesInside) {
  EXPECT_EQ(Written([](BinaryDataOut& out) { out.WriteString(std::string("a\0b", 3)); }),
            (Bytes{0xE1, 4, 1, 'a', 0, 'b', 0}));
}

TEST_F(BinaryDataOutTest, BuffersAreTheirBytesInUse) {
  dBuffer buffer(5);
  buffer.Set(static_cast<unsigned char>(7));
  EXPECT_EQ(Written([&](BinaryDataOut& out) {
              EXPECT_TRUE(out.WriteBuffer(buffer));
              EXPECT_TRUE(out.WriteBuffer(dBuffer()));
            }),
            (Bytes{0xE1, 5, 1, 7, 7, 7, 7, 7, 0xE1, 0, 1}));
}

TEST_F(BinaryDataOutTest, BlockIdentifiersTakeAsFewBytesAsTheyNeed) {
  EXPECT_EQ(Written([](BinaryDataOut& out) {
              EXPECT_TRUE(out.OpenBlock());
              EXPECT_TRUE(out.OpenBlock(0));
              EXPECT_TRUE(out.OpenBlock(255));
              EXPECT_TRUE(out.OpenBlock(256));
              EXPECT_TRUE(out.OpenBlock(300));
              EXPECT_TRUE(out.OpenBlock(65535));
              EXPECT_TRUE(out.OpenBlock(65536));
              EXPECT_TRUE(out.OpenBlock(0xFFFFFFFFul));
              EXPECT_TRUE(out.CloseBlock());
            }),
            (Bytes{0xF0,                          //
                   0xF1, 0x00,                    //
                   0xF1, 0xFF,                    //
                   0xF2, 0x00, 0x01,              //
                   0xF2, 0x2C, 0x01,              //
                   0xF2, 0xFF, 0xFF,              //
                   0xF4, 0x00, 0x00, 0x01, 0x00,  //
                   0xF4, 0xFF, 0xFF, 0xFF, 0xFF,  //
                   0x00}));
}

TEST_F(BinaryDataOutTest, ObjectsStandInABlock) {
  Byte object;
  EXPECT_EQ(Written([&](BinaryDataOut& out) {
              EXPECT_TRUE(out.Write(&object));
              EXPECT_FALSE(out.Write(nullptr));
            }),
            (Bytes{0xF0, 0x01, 0x5A, 0x00}));
}

TEST_F(BinaryDataOutTest, PrimitivesWriteTagsAndBytesAsTheyStand) {
  unsigned char data[] = {1, 2, 3, 4, 5, 6};
  OpenOut out(FileName(), "T");
  EXPECT_TRUE(out.Write(0x77, data, 2));
  EXPECT_TRUE(out.Write(0x77, nullptr, 2));
  EXPECT_TRUE(out.Write(0x77, data, 0));
  EXPECT_TRUE(out.WriteArray(0x78, data, 3, 2));
  out.Close();
  EXPECT_EQ(ItemBytes(), (Bytes{0x77, 1, 2, 0x77, 0x77, 0xE1, 2, 0x78, 1, 2, 3, 4, 5, 6}));
}

TEST_F(BinaryDataOutTest, PrimitiveArraysThatCannotBeFail) {
  if constexpr (sizeof(unsigned long) > 4) {
    unsigned char data[1] = {1};
    OpenOut out(FileName(), "T");
    EXPECT_EQ(ThrownCode([&] { out.WriteArray(1, data, 1, ~0ul); }), -100);
    EXPECT_EQ(ThrownCode([&] { out.WriteArray(1, data, ~0ul, 2); }), -100);
    out.Close();
    EXPECT_EQ(ItemBytes(), Bytes{});
  }
}

TEST_F(BinaryDataOutTest, EveryWriterFailsWithoutAFile) {
  const unsigned char byte[1] = {1};
  const long number[1] = {1};
  Byte object;
  BinaryDataOut out;
  const std::vector<std::function<void()>> writers = {
      [&] { out.WriteU8(1); },
      [&] { out.WriteS32(1); },
      [&] { out.WriteBool(true); },
      [&] { out.WriteU8Array(byte, 1); },
      [&] { out.WriteU8Array(byte, -1); },
      [&] { out.WriteS32Array(number, 1); },
      [&] { out.WriteString(std::string("a")); },
      [&] { out.WriteString(dString("a")); },
      [&] { out.WriteBuffer(dBuffer(1)); },
      [&] { out.OpenBlock(); },
      [&] { out.OpenBlock(1); },
      [&] { out.CloseBlock(); },
      [&] { out.Write(&object); },
  };
  for (std::size_t i = 0; i < writers.size(); ++i) {
    EXPECT_EQ(ThrownCode(writers[i]), -4) << "writer " << i;
  }
}

TEST_F(BinaryDataOutTest, OpenFailsWithoutANameOrWhereNothingCanBeCreated) {
  BinaryDataOut out;
  EXPECT_EQ(ThrownCode([&] { out.Open(nullptr, "T"); }), -2);
  EXPECT_EQ(static_cast<long>(out.GetStatus()), -2);
  EXPECT_EQ(ThrownCode([&] { out.Open((m_path + "/none/file").c_str(), "T"); }), -3);
  EXPECT_EQ(static_cast<long>(out.GetStatus()), -3);
  EXPECT_EQ(ThrownCode([] { BinaryDataOut(nullptr, "T"); }), -2);
}

TEST_F(BinaryDataOutTest, ErrorsStateCodeAndLine) {
  OpenOut out;
  try {
    out.Error(-123, 45);
  } catch (const dStatus& status) {
    EXPECT_EQ(static_cast<long>(status), -123);
    EXPECT_STREQ(status, "Error -123 in class BinaryDataOut [BinaryDataIO/line 45]");
    EXPECT_STREQ(out.GetStatus(), status);
    EXPECT_EQ(static_cast<long>(out.GetStatus()), -123);
    return;
  }
  FAIL() << "nothing was thrown";
}

TEST_F(BinaryDataOutTest, AFailedOpenHasClosedTheFormerFile) {
  BinaryDataOut out(FileName(), "T");
  EXPECT_EQ(ThrownCode([&] { out.Open(nullptr, "T"); }), -2);
  EXPECT_EQ(ThrownCode([&] { out.WriteU8(1); }), -4);
}

}  // namespace
