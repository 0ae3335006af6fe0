// What the streams do with files that are shared, special, full or large.

#include <vorl/Data/dBuffer.h>

#include <cstring>

#if !defined(_WIN32)
#include <sys/stat.h>
#endif

#include "BinaryFileTest.h"

namespace {

using BinaryDataFiles = BinaryFileTest;

TEST_F(BinaryDataFiles, CopiesWriteToTheSameFile) {
  BinaryDataOut out(FileName(), "T");
  out.WriteU8(1);
  {
    BinaryDataOut copy(out);
    EXPECT_EQ(static_cast<long>(copy.GetStatus()), 0);
    copy.WriteU8(2);
  }
  out.WriteU8(3);
  BinaryDataOut assigned;
  assigned = out;
  out.Close();
  EXPECT_EQ(ThrownCode([&] { out.WriteU8(4); }), -4);
  assigned.WriteU8(5);
  EXPECT_TRUE(assigned.Finish());
  EXPECT_EQ(ItemBytes(), (Bytes{1, 1, 1, 2, 1, 3, 1, 5}));
}

TEST_F(BinaryDataFiles, FinishingOneCopyHandsOnWhatIsBuffered) {
  BinaryDataOut out(FileName(), "T");
  const BinaryDataOut copy(out);
  out.WriteU8(1);
  EXPECT_TRUE(out.Finish());
  EXPECT_EQ(ItemBytes(), (Bytes{1, 1}));
}

TEST_F(BinaryDataFiles, CopiesReadFromTheSamePosition) {
  MakeItems({1, 1, 1, 2, 1, 3});
  BinaryDataIn in(FileName(), "T");
  unsigned char value = 0;
  in.ReadU8(value);
  {
    BinaryDataIn copy(in);
    copy.ReadU8(value);
    EXPECT_EQ(value, 2);
  }
  EXPECT_EQ(in.GetRemainingBytes(), 2u);
  BinaryDataIn assigned;
  assigned = in;
  in.Close();
  EXPECT_EQ(ThrownCode([&] { in.ReadU8(value); }), -4);
  assigned.ReadU8(value);
  EXPECT_EQ(value, 3);
}

TEST_F(BinaryDataFiles, AssignmentClosesTheFormerFileAndCopiesTheStatus) {
  BinaryDataOut out(FileName(), "T");
  out.WriteU8(1);
  out = BinaryDataOut();
  EXPECT_STREQ(out.GetStatus(), "uninitialized");
  EXPECT_EQ(ItemBytes(), (Bytes{1, 1}));
  const BinaryDataOut& same = out;
  out = same;
  EXPECT_STREQ(out.GetStatus(), "uninitialized");
}

TEST_F(BinaryDataFiles, SelfAssignmentKeepsTheFileOpen) {
  BinaryDataOut out(FileName(), "T");
  const BinaryDataOut& same = out;
  out = same;
  EXPECT_TRUE(out.WriteU8(1));
  out.Close();
  BinaryDataIn in(FileName(), "T");
  const BinaryDataIn& sameIn = in;
  in = sameIn;
  EXPECT_EQ(in.GetRemainingBytes(), 2u);
}

TEST_F(BinaryDataFiles, CloseAndFinishWithoutAFileAreHarmless) {
  BinaryDataOut out;
  out.Close();
  EXPECT_TRUE(out.Finish());
  EXPECT_STREQ(out.GetStatus(), "uninitialized");
  BinaryDataIn in;
  in.Close();
  EXPECT_STREQ(in.GetStatus(), "uninitialized");
}

TEST_F(BinaryDataFiles, PayloadsOfEverySizeAroundTheBufferSurvive) {
  std::vector<dBuffer> buffers;
  for (const unsigned long size : {1ul, 65535ul, 65536ul, 65537ul, 200000ul, 1000003ul, 5ul}) {
    dBuffer& buffer = buffers.emplace_back(size);
    for (unsigned long i = 0; i < size; ++i) {
      *static_cast<unsigned char*>(buffer.Get(i)) = static_cast<unsigned char>(i * 31 + size);
    }
  }
  Written([&](BinaryDataOut& out) {
    for (const dBuffer& buffer : buffers) {
      out.WriteBuffer(buffer);
      out.WriteU16(0xABCD);
    }
  });
  BinaryDataIn in(FileName(), "T");
  for (const dBuffer& buffer : buffers) {
    dBuffer read;
    unsigned short mark = 0;
    in.ReadBuffer(read, false);
    EXPECT_FALSE(in.IsEndOfBlock());
    in.ReadU16(mark);
    ASSERT_EQ(read.GetSize(), buffer.GetSize());
    EXPECT_EQ(std::memcmp(read.Get(0), buffer.Get(0), buffer.GetSize()), 0) << buffer.GetSize();
    EXPECT_EQ(mark, 0xABCD);
  }
  EXPECT_EQ(in.GetRemainingBytes(), 0u);
}

TEST_F(BinaryDataFiles, AFileThatShrinksWhileItIsReadIsAShortRead) {
  MakeItems(Bytes{0xE4, 0, 0, 4, 0, 1} + Bytes(262144, 9) + Bytes{0x01, 1});
  BinaryDataIn in(FileName(), "T");
  std::filesystem::resize_file(m_path, 100000);
  dBuffer buffer;
  EXPECT_EQ(ThrownCode([&] { in.ReadBuffer(buffer, false); }), -200);
  unsigned char value = 0;
  EXPECT_EQ(ThrownCode([&] { in.ReadU8(value); }), -201);
}

TEST_F(BinaryDataFiles, DirectoriesCannotBeOpened) {
  std::filesystem::create_directory(m_path);
  EXPECT_EQ(ThrownCode([&] { BinaryDataIn in(FileName(), nullptr); }), -3);
  EXPECT_EQ(ThrownCode([&] { BinaryDataOut out(FileName(), nullptr); }), -3);
}

#if !defined(_WIN32)

/// Three bytes' worth of an object, and one that is larger than any buffer.
class Sized : public IBinaryDataIO {
 public:
  explicit Sized(unsigned long size) : m_buffer(size) { m_buffer.Set(0); }
  void Write(BinaryDataOut& out) override { out.WriteBuffer(m_buffer); }
  void Read(BinaryDataIn& in) override { in.ReadBuffer(m_buffer, false); }

 private:
  dBuffer m_buffer;
};

TEST_F(BinaryDataFiles, PipesAreRefusedWithoutWaiting) {
  ASSERT_EQ(mkfifo(FileName(), 0600), 0);
  EXPECT_EQ(ThrownCode([&] { BinaryDataIn in(FileName(), nullptr); }), -3);
  EXPECT_EQ(ThrownCode([&] { BinaryDataOut out(FileName(), nullptr); }), -3);
}

TEST_F(BinaryDataFiles, DevicesCannotBeRead) {
  EXPECT_EQ(ThrownCode([] { BinaryDataIn in("/dev/zero", nullptr); }), -3);
  EXPECT_EQ(ThrownCode([] { BinaryDataIn in("/dev/null", nullptr); }), -3);
}

TEST_F(BinaryDataFiles, TheNullDeviceTakesEverything) {
  EXPECT_TRUE(Sized(1000000).WriteFile("/dev/null", "T"));
}

#endif

#if defined(__linux__)

TEST_F(BinaryDataFiles, AFullDiskMakesWriteFileFail) {
  EXPECT_FALSE(Sized(1).WriteFile("/dev/full", "T"));
  EXPECT_FALSE(Sized(1000000).WriteFile("/dev/full", "T"));
}

TEST_F(BinaryDataFiles, AFullDiskShowsInALargePayload) {
  dBuffer buffer(1000000);
  buffer.Set(0);
  BinaryDataOut out("/dev/full", "T");
  EXPECT_EQ(ThrownCode([&] { out.WriteBuffer(buffer); }), -100);
}

TEST_F(BinaryDataFiles, AFullDiskShowsAtTheLatestWhenTheFileIsClosed) {
  BinaryDataOut out("/dev/full", "T");
  out.OpenBlock();
  out.CloseBlock();
  EXPECT_EQ(static_cast<long>(out.GetStatus()), 0);
  out.Close();
  EXPECT_EQ(static_cast<long>(out.GetStatus()), -100);
  EXPECT_EQ(
      std::string(out.GetStatus()).find("Error -100 in class BinaryDataOut [BinaryDataIO/line "),
      0u);

  out.Open("/dev/full", "T");
  EXPECT_EQ(static_cast<long>(out.GetStatus()), 0);
  EXPECT_FALSE(out.Finish());
  EXPECT_EQ(static_cast<long>(out.GetStatus()), -100);
}

TEST_F(BinaryDataFiles, AFullDiskShowsInEveryCopy) {
  BinaryDataOut out("/dev/full", "T");
  BinaryDataOut copy(out);
  EXPECT_FALSE(copy.Finish());
  EXPECT_FALSE(out.Finish());
}

TEST_F(BinaryDataFiles, FilesBeyondFourGigabytesAreMeasuredInFull) {
  MakeItems({0x01, 42});
  std::error_code failed;
  const std::uint64_t size = 5'000'000'000;
  std::filesystem::resize_file(m_path, size, failed);  // sparse: takes no room on the disk
  if (failed) {
    GTEST_SKIP() << "the temporary directory holds no such files";
  }
  BinaryDataIn in(FileName(), "T");
  EXPECT_EQ(in.GetRemainingBytes(), size - 6);
  unsigned char value = 0;
  in.ReadU8(value);
  EXPECT_EQ(value, 42);
}

#endif

}  // namespace
