#ifndef VORL_TESTS_DATA_IMAGEFILE_H
#define VORL_TESTS_DATA_IMAGEFILE_H

#include <gtest/gtest.h>

#include <cstdint>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "../Support/TestFolder.h"
#include "ImageTesting.h"

/// A file of its own for each test, gone with it.
class ImageFile : public testing::Test {
 protected:
  void Store(const Bytes& bytes) const {
    std::ofstream file(m_path, std::ios::binary | std::ios::trunc);
    file.write(reinterpret_cast<const char*>(bytes.data()),
               static_cast<std::streamsize>(bytes.size()));
    ASSERT_TRUE(file.good());
  }
  Bytes Stored() const {
    std::ifstream file(m_path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }

  const TestFolder m_folder;
  const std::string m_path = (m_folder / "image.bdf").string();
};

/// What an image file of the type "dImage" holds, item by item, as it stands in the file.
struct ImageItems {
  std::uint32_t x = 0;
  std::uint32_t y = 0;
  std::uint32_t width = 3;
  std::uint32_t height = 2;
  std::uint32_t dataType = 0x1010;
  std::uint32_t dataOrder = 1;
  std::uint32_t rowAlignment = 8;
  std::string sequence = std::string("RGB\0", 4);
  std::uint32_t sequenceLength = 4;
  Bytes pixels = Bytes(48, 0x5A);
  std::uint32_t pixelLength = 48;
  bool hasLongLengths = false;  ///< each length in four bytes, as a writer would not do

  static constexpr std::size_t kHeaderSize = 4 + 7;

  Bytes File() const {
    Bytes file = {'B', 'D', 'F', 0, 'd', 'I', 'm', 'a', 'g', 'e', 0};
    file.push_back(0xF0);
    Number(file, 0x06, x, 4);
    Number(file, 0x06, y, 4);
    Number(file, 0x05, width, 4);
    Number(file, 0x05, height, 4);
    file.push_back(0x00);
    Number(file, 0x03, dataType, 2);
    Number(file, 0x03, dataOrder, 2);
    Number(file, 0x03, rowAlignment, 2);
    Length(file, sequenceLength);
    file.push_back(0x01);
    file.insert(file.end(), sequence.begin(), sequence.end());
    Length(file, pixelLength);
    file.push_back(0x01);
    file.insert(file.end(), pixels.begin(), pixels.end());
    return file;
  }

  /// Where the tags of `File()` stand when all lengths take one byte.
  std::vector<std::size_t> TagOffsets() const {
    const std::size_t block = kHeaderSize;
    const std::size_t formats = block + 1 + 4 * 5 + 1;
    const std::size_t text = formats + 3 * 3;
    const std::size_t data = text + 2 + 1 + sequence.size();
    return {block,       block + 1,   block + 6, block + 11, block + 16, block + 21, formats,
            formats + 3, formats + 6, text,      text + 2,   data,       data + 2};
  }

 private:
  static void Number(Bytes& file, unsigned char tag, std::uint32_t value, int size) {
    file.push_back(tag);
    for (int i = 0; i < size; ++i) {
      file.push_back(static_cast<unsigned char>(value >> (8 * i)));
    }
  }
  void Length(Bytes& file, std::uint32_t value) const {
    if (hasLongLengths || value > 0xFFFF) {
      Number(file, 0xE4, value, 4);
    } else if (value > 0xFF) {
      Number(file, 0xE2, value, 2);
    } else {
      Number(file, 0xE1, value, 1);
    }
  }
};

#endif
