#ifndef TESTS_DATA_TEXTFILE_H
#define TESTS_DATA_TEXTFILE_H

/// @file
/// A text file for streams to read.

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <string>

/// Holds ten digits, unless a test writes something else.
class TextFile : public testing::Test {
 protected:
  void SetUp() override {
    std::string name = testing::UnitTest::GetInstance()->current_test_info()->name();
    std::replace(name.begin(), name.end(), '/', '_');
    m_path = (std::filesystem::path(testing::TempDir()) / ("vorl_text_" + name)).string();
    Write("0123456789");
  }
  void TearDown() override { std::filesystem::remove_all(m_path); }
  void Write(const std::string& text) { std::ofstream(m_path, std::ios::binary) << text; }

  std::string m_path;
};

#endif
