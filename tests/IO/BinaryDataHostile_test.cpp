// Damaged files: each one must end in a status, whatever is broken, without large allocations.

#include <vorl/Data/dBuffer.h>
#include <vorl/Data/dString.h>

#include "BinaryFileTest.h"

namespace {

/// An object that holds every kind of item.
class Everything : public IBinaryDataIO {
 public:
  void Write(BinaryDataOut& out) override {
    out.WriteS8(s8);
    out.WriteU8(u8);
    out.WriteS16(s16);
    out.WriteU16(u16);
    out.WriteS32(s32);
    out.WriteU32(u32);
    out.WriteF32(f32);
    out.WriteF64(f64);
    out.WriteBool(flag);
    out.OpenBlock(7);
    out.WriteS8Array(s8Array, 2);
    out.WriteU8Array(u8Array, 2);
    out.WriteS16Array(s16Array, 2);
    out.WriteU16Array(u16Array, 2);
    out.WriteS32Array(s32Array, 2);
    out.WriteU32Array(u32Array, 2);
    out.WriteF32Array(f32Array, 2);
    out.WriteF64Array(f64Array, 2);
    out.CloseBlock();
    out.OpenBlock(70000);
    out.OpenBlock(300);
    out.WriteString(standard);
    out.CloseBlock();
    out.WriteString(text);
    out.CloseBlock();
    out.OpenBlock();
    out.WriteBuffer(buffer);
    out.WriteBuffer(buffer);
    out.CloseBlock();
  }

  void Read(BinaryDataIn& in) override {
    in.ReadS8(s8);
    in.ReadU8(u8);
    in.ReadS16(s16);
    in.ReadU16(u16);
    in.ReadS32(s32);
    in.ReadU32(u32);
    in.ReadF32(f32);
    in.ReadF64(f64);
    in.ReadBool(flag);
    in.OpenBlock(7);
    ReadPair(in, &BinaryDataIn::ReadS8Array, s8Array);
    ReadPair(in, &BinaryDataIn::ReadU8Array, u8Array);
    ReadPair(in, &BinaryDataIn::ReadS16Array, s16Array);
    ReadPair(in, &BinaryDataIn::ReadU16Array, u16Array);
    ReadPair<long>(in, &BinaryDataIn::ReadS32Array, s32Array);
    ReadPair<std::uint32_t>(in, &BinaryDataIn::ReadU32Array, u32Array);
    ReadPair(in, &BinaryDataIn::ReadF32Array, f32Array);
    ReadPair(in, &BinaryDataIn::ReadF64Array, f64Array);
    in.CloseBlock();
    in.OpenBlock(70000);
    in.OpenBlock(300);
    in.ReadString(standard);
    in.CloseBlock();
    in.ReadString(text);
    in.CloseBlock();
    in.OpenBlock();
    in.ReadBuffer(buffer, false);
    in.ReadBuffer(buffer, true);
    in.CloseBlock();
  }

  char s8 = 1;
  unsigned char u8 = 2;
  short s16 = 3;
  unsigned short u16 = 4;
  long s32 = 5;
  unsigned long u32 = 6;
  float f32 = 7;
  double f64 = 8;
  bool flag = true;
  char s8Array[2] = {1, 2};
  unsigned char u8Array[2] = {3, 4};
  short s16Array[2] = {5, 6};
  unsigned short u16Array[2] = {7, 8};
  long s32Array[2] = {9, 10};
  std::uint32_t u32Array[2] = {11, 12};
  float f32Array[2] = {13, 14};
  double f64Array[2] = {15, 16};
  std::string standard = "standard";
  dString text = "text";
  dBuffer buffer = dBuffer(300);

 private:
  template <class Element>
  void ReadPair(BinaryDataIn& in, bool (BinaryDataIn::*readArray)(Element*, int),
                Element (&pair)[2]) {
    if (in.ReadArrayLength() != 2) {
      throw dStatus(-1, "no pair");
    }
    (in.*readArray)(pair, 2);
  }
};

/// The code with which reading the file fails; 0 when it succeeds.
long ReadingCode(const char* fileName) {
  return ThrownCode([&] {
    Everything object;
    BinaryDataIn in(fileName, "T");
    object.Read(in);
  });
}

/// Where the tags of the items stand in the bytes of a file of type "T".
std::vector<std::size_t> TagPositions(const Bytes& bytes) {
  const std::size_t sizes[] = {0, 1, 1, 2, 2, 4, 4, 4, 8, 1};
  std::vector<std::size_t> positions;
  std::size_t count = 1;
  for (std::size_t i = 6; i < bytes.size();) {
    positions.push_back(i);
    const unsigned char tag = bytes[i++];
    if (tag >= 0xE0) {
      const std::size_t size = tag & 7u;
      if (tag < 0xF0) {
        count = 0;
        for (std::size_t k = size; k > 0; --k) {
          count = count * 256 + bytes[i + k - 1];
        }
      }
      i += size;
    } else {
      i += sizes[tag] * count;
      count = 1;
    }
  }
  return positions;
}

class BinaryDataHostile : public BinaryFileTest {
 protected:
  BinaryDataHostile() {
    Everything object;
    object.buffer.Set(static_cast<unsigned char>(0));
    EXPECT_TRUE(object.WriteFile(FileName(), "T"));
    m_valid = FileBytes();
  }

  Bytes m_valid;
};

TEST_F(BinaryDataHostile, TheWholeFileIsRead) {
  Everything object;
  object.s32Array[1] = 0;
  object.text = "other";
  EXPECT_TRUE(object.ReadFile(FileName(), "T"));
  EXPECT_EQ(object.s32Array[1], 10);
  EXPECT_TRUE(object.text == "text");
  EXPECT_EQ(object.standard, std::string("standard\0", 9));
  EXPECT_EQ(object.buffer.GetSize(), 300u);
}

TEST_F(BinaryDataHostile, EveryCutIsNoticed) {
  for (std::size_t size = m_valid.size(); size-- > 0;) {
    std::filesystem::resize_file(m_path, size);
    const long code = ReadingCode(FileName());
    EXPECT_TRUE(code == -200 || code == -201 || code == -204 || code == -205)
        << "cut at " << size << ", code " << code;
    EXPECT_FALSE(Everything().ReadFile(FileName(), "T")) << "cut at " << size;
  }
}

TEST_F(BinaryDataHostile, EveryOtherTagIsNoticed) {
  const std::vector<std::size_t> positions = TagPositions(m_valid);
  ASSERT_EQ(positions.size(), 41u);  // 9 scalars, 12 arrays of two items, 8 block items
  for (const std::size_t position : positions) {
    for (unsigned int tag = 0; tag < 256; ++tag) {
      if (tag == m_valid[position]) {
        continue;
      }
      PatchFile(position, static_cast<unsigned char>(tag));
      EXPECT_NE(ReadingCode(FileName()), 0) << "tag " << tag << " at " << position;
    }
    PatchFile(position, m_valid[position]);
  }
  EXPECT_EQ(ReadingCode(FileName()), 0);
}

TEST_F(BinaryDataHostile, NoSingleByteBreaksTheReader) {
  for (std::size_t position = 0; position < m_valid.size(); ++position) {
    for (const unsigned int flip : {0x01u, 0x80u, 0xFFu}) {
      PatchFile(position, static_cast<unsigned char>(m_valid[position] ^ flip));
      const long code = ReadingCode(FileName());
      EXPECT_LE(code, 0);  // some changes are valid values
      if (position < 6) {
        EXPECT_LT(code, 0) << "header byte " << position;
      }
    }
    PatchFile(position, m_valid[position]);
  }
}

/// A length that no file of this size can hold.
class BinaryDataLength : public BinaryFileTest, public testing::WithParamInterface<Bytes> {
 protected:
  BinaryDataLength() { MakeItems(GetParam() + Bytes{0x01, 1, 2}); }
};

TEST_P(BinaryDataLength, StandardStringsStayAsTheyWere) {
  BinaryDataIn in(FileName(), "T");
  std::string text = "abc";
  const std::size_t capacity = text.capacity();
  EXPECT_EQ(ThrownCode([&] { in.ReadString(text); }), -200);
  EXPECT_EQ(text, "abc");
  EXPECT_EQ(text.capacity(), capacity);
}

TEST_P(BinaryDataLength, StringsStayAsTheyWere) {
  BinaryDataIn in(FileName(), "T");
  dString text("abc");
  EXPECT_EQ(ThrownCode([&] { in.ReadString(text); }), -200);
  EXPECT_TRUE(text == "abc");
  EXPECT_EQ(text.GetCapacity(), 8u);
}

TEST_P(BinaryDataLength, BuffersStayAsTheyWere) {
  BinaryDataIn in(FileName(), "T");
  dBuffer buffer(1);
  EXPECT_EQ(ThrownCode([&] { in.ReadBuffer(buffer, false); }), -200);
  EXPECT_EQ(buffer.GetSize(), 1u);
  EXPECT_EQ(buffer.GetCapacity(), 8u);
}

TEST_P(BinaryDataLength, BuffersOfThatKeptSizeAreNotWritten) {
  BinaryDataIn in(FileName(), "T");
  unsigned char byte = 7;
  BinaryDataIn length(FileName(), "T");
  dBuffer buffer(&byte, length.ReadArrayLength(), DTM_Reference);
  EXPECT_EQ(ThrownCode([&] { in.ReadBuffer(buffer, true); }), -200);
  EXPECT_EQ(byte, 7);
}

INSTANTIATE_TEST_SUITE_P(Lengths, BinaryDataLength,
                         testing::Values(Bytes{0xE1, 3}, Bytes{0xE2, 0xFF, 0xFF},
                                         Bytes{0xE4, 0xFF, 0xFF, 0xFF, 0x7F},
                                         Bytes{0xE4, 0xF1, 0xFF, 0xFF, 0xFF},
                                         Bytes{0xE4, 0xFF, 0xFF, 0xFF, 0xFF}));

}  // namespace
