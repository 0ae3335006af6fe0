// Rows read from a file to where they belong, and written to one from where they are.

#include <vorl/Platform/detail/File.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "../Support/TestFolder.h"

namespace {

using vorl_detail::FileHandle;
using vorl_detail::ReadFileRows;
using vorl_detail::WriteFileRows;

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

// Rows of a pitch, in the order in which they are written, and a head before them.
void ExpectWritten(const std::string& path, std::size_t rowBytes, std::size_t rows,
                   bool isUpwards) {
  SCOPED_TRACE(testing::Message() << rows << " rows of " << rowBytes << " bytes");
  const std::size_t pitch = rowBytes + 5;
  std::vector<unsigned char> memory(pitch * rows);
  for (std::size_t i = 0; i < memory.size(); ++i) {
    memory[i] = ByteAt(i);
  }
  std::vector<unsigned char> expected{'h', 'e', 'a', 'd'};
  for (std::size_t row = 0; row < rows; ++row) {
    const std::size_t place = isUpwards ? rows - 1 - row : row;
    const auto begin = memory.begin() + static_cast<std::ptrdiff_t>(place * pitch);
    expected.insert(expected.end(), begin, begin + static_cast<std::ptrdiff_t>(rowBytes));
  }
  const auto step = static_cast<std::ptrdiff_t>(pitch);
  const unsigned char* const first = memory.data() + (isUpwards ? pitch * (rows - 1) : 0);
  FileHandle file(vorl_detail::OpenFileForWriting(path.c_str()));
  ASSERT_NE(file, nullptr);
  ASSERT_EQ(std::fwrite("head", 1, 4, file.get()), 4U);
  ASSERT_EQ(std::fflush(file.get()), 0);
  ASSERT_TRUE(WriteFileRows(file.get(), first, isUpwards ? -step : step, rowBytes, rows));
  file.reset(vorl_detail::OpenFileForReading(path.c_str()));
  ASSERT_NE(file, nullptr);
  std::vector<unsigned char> written(expected.size() + 1);
  written.resize(std::fread(written.data(), 1, written.size(), file.get()));
  ASSERT_EQ(written, expected);
}

TEST_F(FileRows, AreWrittenDownwardsAndUpwards) {
  for (const std::size_t rows : {1U, 2U, 63U, 64U, 65U, 200U}) {
    for (const std::size_t rowBytes : {1U, 4U, 1000U}) {
      ASSERT_NO_FATAL_FAILURE(ExpectWritten(m_path, rowBytes, rows, false));
      ASSERT_NO_FATAL_FAILURE(ExpectWritten(m_path, rowBytes, rows, true));
    }
  }
}

#if defined(__linux__)
TEST_F(FileRows, FullDevicesTakeNone) {
  const FileHandle full(vorl_detail::OpenFileForWriting("/dev/full"));
  ASSERT_NE(full, nullptr);
  const unsigned char rows[100] = {};
  EXPECT_FALSE(WriteFileRows(full.get(), rows, 10, 10, 10));
  EXPECT_TRUE(WriteFileRows(full.get(), rows, 10, 10, 0));
}
#endif

}  // namespace
