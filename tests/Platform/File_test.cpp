// Rows read from a file to where they belong.

#include <vorl/Platform/detail/File.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "../Support/TestFolder.h"

namespace {

using vorl_detail::FileHandle;
using vorl_detail::ReadFileRows;

constexpr std::size_t kHead = 54;

unsigned char ByteAt(std::size_t position) {
  return static_cast<unsigned char>(position * 7 + position / 256);
}

// A file of so many bytes behind a head, none like its neighbours.
class FileRows : public testing::Test {
 protected:
  void MakeFile(std::size_t bytes) {
    m_file.reset(vorl_detail::OpenFileForWriting(m_path.c_str()));
    ASSERT_NE(m_file, nullptr);
    for (std::size_t i = 0; i < kHead + bytes; ++i) {
      ASSERT_NE(std::fputc(ByteAt(i), m_file.get()), EOF);
    }
    m_file.reset(vorl_detail::OpenFileForReading(m_path.c_str()));
    ASSERT_NE(m_file, nullptr);
  }

  // What is between the rows stays as it was.
  void ExpectRows(std::size_t rowBytes, std::size_t rows, bool isUpwards) {
    SCOPED_TRACE(testing::Message() << rows << " rows of " << rowBytes << " bytes");
    ASSERT_NO_FATAL_FAILURE(MakeFile(rowBytes * rows));
    const std::size_t pitch = rowBytes + 5;
    std::vector<unsigned char> expected(pitch * rows, 0xA5);
    for (std::size_t row = 0; row < rows; ++row) {
      const std::size_t place = isUpwards ? rows - 1 - row : row;
      for (std::size_t i = 0; i < rowBytes; ++i) {
        expected[place * pitch + i] = ByteAt(kHead + row * rowBytes + i);
      }
    }
    std::vector<unsigned char> memory(pitch * rows, 0xA5);
    const auto step = static_cast<std::ptrdiff_t>(pitch);
    unsigned char* const first = memory.data() + (isUpwards ? pitch * (rows - 1) : 0);
    ASSERT_TRUE(ReadFileRows(m_file.get(), kHead, first, isUpwards ? -step : step, rowBytes, rows));
    ASSERT_EQ(memory, expected);
  }

  const TestFolder m_folder;
  const std::string m_path = (m_folder / "rows").string();
  FileHandle m_file;
};

// More and fewer than the 64 that are asked for at once.
TEST_F(FileRows, AreFilledDownwardsAndUpwards) {
  for (const std::size_t rows : {1U, 2U, 63U, 64U, 65U, 200U}) {
    for (const std::size_t rowBytes : {1U, 4U, 1000U}) {
      ASSERT_NO_FATAL_FAILURE(ExpectRows(rowBytes, rows, false));
      ASSERT_NO_FATAL_FAILURE(ExpectRows(rowBytes, rows, true));
    }
  }
}

TEST_F(FileRows, WhatWasReadBeforeDoesNotMatter) {
  MakeFile(100);
  char head[30];
  ASSERT_EQ(std::fread(head, 1, sizeof(head), m_file.get()), sizeof(head));
  unsigned char rows[2][50];
  ASSERT_TRUE(ReadFileRows(m_file.get(), kHead, rows[0], 50, 50, 2));
  EXPECT_EQ(rows[0][0], ByteAt(kHead));
  EXPECT_EQ(rows[1][49], ByteAt(kHead + 99));
}

TEST_F(FileRows, FilesThatEndTooSoonFail) {
  MakeFile(999);
  std::vector<unsigned char> memory(1000);
  EXPECT_FALSE(ReadFileRows(m_file.get(), kHead, memory.data(), 10, 10, 100));
  EXPECT_FALSE(ReadFileRows(m_file.get(), kHead + 999, memory.data(), 1, 1, 1));
  EXPECT_FALSE(ReadFileRows(m_file.get(), 100000, memory.data(), 10, 10, 1));
  EXPECT_TRUE(ReadFileRows(m_file.get(), kHead, memory.data(), 999, 999, 1));
  EXPECT_TRUE(ReadFileRows(m_file.get(), 100000, memory.data(), 10, 10, 0));
}

}  // namespace
