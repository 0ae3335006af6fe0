#ifndef TESTS_DATA_TEXTFILE_H
#define TESTS_DATA_TEXTFILE_H

/// @file
/// A text file for streams to read.

#include <gtest/gtest.h>

#include <fstream>
#include <string>

#include "../Support/TestFolder.h"

/// Holds ten digits, unless a test writes something else.
class TextFile : public testing::Test {
 protected:
  TextFile() { Write("0123456789"); }
  void Write(const std::string& text) { std::ofstream(m_path, std::ios::binary) << text; }

  const TestFolder m_folder;
  const std::string m_path = (m_folder / "text").string();
};

#endif
