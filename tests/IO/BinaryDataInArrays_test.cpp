// Reading of arrays, strings and buffers.

#include <vorl/Data/dBuffer.h>
#include <vorl/Data/dString.h>

#include "BinaryFileTest.h"

namespace {

TEST_F(BinaryDataInTest, ReadsArrayLengthsOfEveryForm) {
  MakeItems({0xE1, 0xFF, 0xE2, 0x01, 0x02, 0xE4, 0x01, 0x02, 0x03, 0xF4, 0xE4, 1, 0, 0, 0});
  BinaryDataIn in(FileName(), "T");
  EXPECT_EQ(in.ReadArrayLength(), 255u);
  EXPECT_EQ(in.ReadArrayLength(), 0x0201u);
  EXPECT_EQ(in.ReadArrayLength(), 0xF4030201u);
  EXPECT_EQ(in.ReadArrayLength(), 1u);  // longer than it had to be
}

TEST_F(BinaryDataInTest, ReadsArrays) {
  MakeItems({0x02, 1, 0xFF,                                //
             0x01, 1, 0xFF,                                //
             0x04, 1, 0,    0xFF, 0xFF,                    //
             0x03, 1, 0,    3,    2,                       //
             0x07, 0, 0,    0x80, 0x3F, 0, 0, 0xC0, 0x3F,  //
             0x08, 0, 0,    0,    0,    0, 0, 0xF0, 0x3F});
  BinaryDataIn in(FileName(), "T");
  char s8[2];
  unsigned char u8[2];
  short s16[2];
  unsigned short u16[2];
  float f32[2];
  double f64[1];
  EXPECT_TRUE(in.ReadS8Array(s8, 2));
  EXPECT_TRUE(in.ReadU8Array(u8, 2));
  EXPECT_TRUE(in.ReadS16Array(s16, 2));
  EXPECT_TRUE(in.ReadU16Array(u16, 2));
  EXPECT_TRUE(in.ReadF32Array(f32, 2));
  EXPECT_TRUE(in.ReadF64Array(f64, 1));
  EXPECT_EQ(s8[1], static_cast<char>(-1));
  EXPECT_EQ(u8[1], 255);
  EXPECT_EQ(s16[1], -1);
  EXPECT_EQ(u16[1], 0x0203);
  EXPECT_EQ(f32[1], 1.5f);
  EXPECT_EQ(f64[0], 1.0);
  EXPECT_EQ(in.GetRemainingBytes(), 0u);
}

TEST_F(BinaryDataInTest, Reads32BitArraysIntoBothTypes) {
  const Bytes elements = {1, 0, 0, 0, 0xFE, 0xFF, 0xFF, 0xFF};
  const Bytes signedItem = Bytes{0x06} + elements;
  const Bytes unsignedItem = Bytes{0x05} + elements;
  MakeItems(signedItem + signedItem + unsignedItem + unsignedItem);
  BinaryDataIn in(FileName(), "T");
  long s32Long[3] = {7, 7, 7};
  std::int32_t s32[2];
  unsigned long u32Long[3] = {7, 7, 7};
  std::uint32_t u32[2];
  EXPECT_TRUE(in.ReadS32Array(s32Long, 2));
  EXPECT_TRUE(in.ReadS32Array(s32, 2));
  EXPECT_TRUE(in.ReadU32Array(u32Long, 2));
  EXPECT_TRUE(in.ReadU32Array(u32, 2));
  EXPECT_EQ(s32Long[0], 1);
  EXPECT_EQ(s32Long[1], -2);
  EXPECT_EQ(s32Long[2], 7);
  EXPECT_EQ(s32[1], -2);
  EXPECT_EQ(u32Long[1], 0xFFFFFFFEul);
  EXPECT_EQ(u32Long[2], 7u);
  EXPECT_EQ(u32[1], 0xFFFFFFFEu);
}

TEST_F(BinaryDataInTest, LargeArraysOfLongSurviveTheRoundTrip) {
  std::vector<long> values(10001);
  for (std::size_t i = 0; i < values.size(); ++i) {
    values[i] = static_cast<long>(i * 214013) - 1000000000;
  }
  const int count = static_cast<int>(values.size());
  Written([&](BinaryDataOut& out) { out.WriteS32Array(values.data(), count); });
  BinaryDataIn in(FileName(), "T");
  ASSERT_EQ(in.ReadArrayLength(), values.size());
  std::vector<long> read(values.size());
  in.ReadS32Array(read.data(), count);
  EXPECT_EQ(read, values);
  EXPECT_EQ(in.GetRemainingBytes(), 0u);
}

TEST_F(BinaryDataInTest, BadArrayArgumentsFail) {
  const Bytes items = {0x01, 1, 2, 3};
  unsigned char bytes[4] = {};
  EXPECT_EQ(CodeOf(items, [&](BinaryDataIn& in) { in.ReadU8Array(bytes, -1); }), -200);
  EXPECT_EQ(CodeOf(items, [&](BinaryDataIn& in) { in.ReadU8Array(nullptr, 1); }), -200);
  EXPECT_EQ(CodeOf(items, [&](BinaryDataIn& in) { in.ReadU8Array(nullptr, 0); }), 0);
  long numbers[1] = {};
  EXPECT_EQ(CodeOf({0x06, 0, 0, 0, 0}, [&](BinaryDataIn& in) { in.ReadS32Array(numbers, -1); }),
            -200);
}

TEST_F(BinaryDataInTest, AShortArrayLeavesTheStorageAsItWas) {
  unsigned short values[3] = {7, 7, 7};
  EXPECT_EQ(CodeOf({0x03, 1, 0, 2, 0, 3}, [&](BinaryDataIn& in) { in.ReadU16Array(values, 3); }),
            -200);
  EXPECT_EQ(values[0], 7);
  std::uint32_t number = 7;
  EXPECT_EQ(CodeOf({0x05, 1, 2, 3}, [&](BinaryDataIn& in) { in.ReadU32(number); }), -200);
  EXPECT_EQ(number, 7u);
}

TEST_F(BinaryDataInTest, StandardStringsKeepTheZeroByteAsACharacter) {
  MakeItems({0xE1, 0x03, 0x01, 0x61, 0x62, 0x00});
  BinaryDataIn in(FileName(), "T");
  std::string text = "former text";
  EXPECT_TRUE(in.ReadString(text));
  EXPECT_EQ(text, std::string("ab\0", 3));
  EXPECT_STREQ(text.c_str(), "ab");
}

TEST_F(BinaryDataInTest, StringsTakeTheirZeroByteAsTerminator) {
  MakeItems({0xE1, 0x03, 0x01, 0x61, 0x62, 0x00});
  BinaryDataIn in(FileName(), "T");
  dString text("former text");
  EXPECT_TRUE(in.ReadString(text));
  EXPECT_EQ(text.Size(), 2u);
  EXPECT_TRUE(text == "ab");
}

TEST_F(BinaryDataInTest, StringsWithoutTerminatorGetOne) {
  for (const std::size_t size : {1u, 7u, 8u, 9u}) {
    MakeItems(Bytes{0xE1, static_cast<unsigned char>(size), 0x01} + Bytes(size, 'x'));
    BinaryDataIn in(FileName(), "T");
    dString text;
    EXPECT_TRUE(in.ReadString(text));
    EXPECT_EQ(text.Size(), size);
    EXPECT_STREQ(text.GetText(), std::string(size, 'x').c_str());
  }
}

TEST_F(BinaryDataInTest, StringsOfNoBytesAreEmpty) {
  MakeItems({0xE1, 0, 1, 0xE1, 0, 1, 0xE1, 1, 1, 0});
  BinaryDataIn in(FileName(), "T");
  dString text("abc");
  EXPECT_TRUE(in.ReadString(text));
  EXPECT_EQ(text.Size(), 0u);
  EXPECT_TRUE(text.IsReference());
  std::string standard = "abc";
  EXPECT_TRUE(in.ReadString(standard));
  EXPECT_EQ(standard, "");
  text = "abc";
  EXPECT_TRUE(in.ReadString(text));
  EXPECT_EQ(text.Size(), 0u);
}

TEST_F(BinaryDataInTest, BuffersTakeTheStoredSize) {
  MakeItems({0xE1, 3, 1, 7, 8, 9, 0xE1, 0, 1});
  BinaryDataIn in(FileName(), "T");
  dBuffer buffer;
  EXPECT_TRUE(in.ReadBuffer(buffer, false));
  ASSERT_EQ(buffer.GetSize(), 3u);
  EXPECT_EQ(*static_cast<unsigned char*>(buffer.Get(2)), 9);
  EXPECT_TRUE(in.ReadBuffer(buffer, false));
  EXPECT_EQ(buffer.GetSize(), 0u);
}

TEST_F(BinaryDataInTest, BuffersOfAKeptSizeAreFilledInPlace) {
  MakeItems({0xE1, 3, 1, 7, 8, 9});
  BinaryDataIn in(FileName(), "T");
  unsigned char bytes[3] = {};
  dBuffer buffer(bytes, 3, DTM_Reference);
  EXPECT_TRUE(in.ReadBuffer(buffer, true));
  EXPECT_EQ(bytes[0], 7);
  EXPECT_EQ(bytes[2], 9);
}

TEST_F(BinaryDataInTest, BuffersOfAnotherSizeThanTheKeptOneFail) {
  for (const unsigned long size : {0ul, 2ul, 4ul}) {
    dBuffer buffer(size);
    EXPECT_EQ(CodeOf({0xE1, 3, 1, 7, 8, 9}, [&](BinaryDataIn& in) { in.ReadBuffer(buffer, true); }),
              -208);
    EXPECT_EQ(buffer.GetSize(), size);
  }
}

}  // namespace
