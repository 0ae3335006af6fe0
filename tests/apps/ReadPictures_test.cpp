// Reading pictures: what the tool's conversions begin with.
#include <study/Error.h>
#include <study/Pictures.h>

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <vector>

#include <png.h>

#include "TestFolder.h"

using namespace study;
using namespace study_test;

namespace {

using Bytes = std::vector<unsigned char>;

/// Writes a PNG with the library's own simple interface.
void WritePng(const fs::path& path, int width, int height, png_uint_32 format, const Bytes& pixels,
              const Bytes& colours = {}) {
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  png.width = static_cast<png_uint_32>(width);
  png.height = static_cast<png_uint_32>(height);
  png.format = format;
  png.colormap_entries = static_cast<png_uint_32>(colours.size() / 3);
  ASSERT_NE(png_image_write_to_file(&png, path.string().c_str(), 0, pixels.data(), 0,
                                    colours.empty() ? nullptr : colours.data()),
            0)
      << png.message;
}

Bytes RowOf(const dImage& image, int y) {
  const auto* row = static_cast<const unsigned char*>(image.GetRowPtr(y));
  return {row, row + image.GetWidth() * image.GetNumChannels()};
}

std::string Problem(const fs::path& path) {
  dImage image;
  try {
    LoadPng(path, image);
  } catch (const Error& error) {
    EXPECT_FALSE(image.IsValid());
    const std::string start = "can't read '" + path.string() + "': ";
    const std::string text = error.what();
    EXPECT_EQ(text.substr(0, start.size()), start);
    return text.substr(start.size());
  }
  return "none";
}

TEST(LoadPng, GreyStaysGrey) {
  const TestFolder folder;
  WritePng(folder / "a.png", 3, 2, PNG_FORMAT_GRAY, {1, 2, 3, 250, 251, 252});
  dImage image;
  LoadPng(folder / "a.png", image);
  EXPECT_STREQ(image.GetChannelSequence(), "G");
  EXPECT_EQ(image.GetBytesPerRow(), 4U);
  EXPECT_EQ(RowOf(image, 0), (Bytes{1, 2, 3}));
  EXPECT_EQ(RowOf(image, 1), (Bytes{250, 251, 252}));
}

TEST(LoadPng, ColoursAndPalettesBecomeBlueGreenRed) {
  const TestFolder folder;
  WritePng(folder / "a.png", 2, 1, PNG_FORMAT_RGB, {1, 2, 3, 4, 5, 6});
  WritePng(folder / "b.png", 2, 1, PNG_FORMAT_RGB_COLORMAP, {1, 0}, {4, 5, 6, 1, 2, 3});
  for (const char* const name : {"a.png", "b.png"}) {
    dImage image;
    LoadPng(folder / name, image);
    EXPECT_STREQ(image.GetChannelSequence(), "BGR") << name;
    EXPECT_EQ(RowOf(image, 0), (Bytes{3, 2, 1, 6, 5, 4})) << name;
  }
}

TEST(LoadPng, TransparencyIsTheFourthChannel) {
  const TestFolder folder;
  WritePng(folder / "a.png", 2, 1, PNG_FORMAT_RGBA, {1, 2, 3, 9, 4, 5, 6, 255});
  WritePng(folder / "b.png", 2, 1, PNG_FORMAT_GA, {7, 9, 8, 255});
  dImage image;
  LoadPng(folder / "a.png", image);
  EXPECT_STREQ(image.GetChannelSequence(), "BGRA");
  EXPECT_EQ(RowOf(image, 0), (Bytes{3, 2, 1, 9, 6, 5, 4, 255}));
  LoadPng(folder / "b.png", image);
  EXPECT_STREQ(image.GetChannelSequence(), "BGRA");
  EXPECT_EQ(RowOf(image, 0), (Bytes{7, 7, 7, 9, 8, 8, 8, 255}));
}

TEST(LoadPng, WhatWasSavedIsRead) {
  const TestFolder folder;
  for (const char* const sequence : {"G", "BGR"}) {
    dImage image;
    ASSERT_TRUE(image.Init(33, 21, ImageDataType_U8, sequence, 0, 4));
    for (unsigned long i = 0; i < image.GetImageSize(); ++i) {
      static_cast<unsigned char*>(image.GetDataPtr())[i] = static_cast<unsigned char>(i * 31);
    }
    SavePng(image, folder / "a.png");
    dImage copy;
    LoadPng(folder / "a.png", copy);
    for (int y = 0; y < 21; ++y) {
      EXPECT_EQ(RowOf(copy, y), RowOf(image, y));
    }
  }
}

TEST(LoadPng, SixteenBitsAreRefused) {
  const TestFolder folder;
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U16, "G", 0, 4));
  image.Fill(3);
  SavePng(image, folder / "a.png");
  EXPECT_EQ(Problem(folder / "a.png"), "it has 16 bits per sample, 8 are the most");
}

TEST(LoadPng, FilesThatAreNoneAreTold) {
  const TestFolder folder;
  EXPECT_EQ(Problem(folder / "a.png"), "there is no such file");
  EXPECT_EQ(Problem(folder.Path()), "there is no such file");
  WriteBytes(folder / "a.png", "no picture at all");
  EXPECT_EQ(Problem(folder / "a.png"), "Not a PNG file");
}

TEST(LoadPng, FileMayBeCutOffAnywhere) {
  const TestFolder folder;
  WritePng(folder / "a.png", 5, 4, PNG_FORMAT_GRAY, Bytes(20, 77));
  const std::string whole = ReadBytes(folder / "a.png");
  for (std::size_t length = 0; length < whole.size(); ++length) {
    WriteBytes(folder / "b.png", whole.substr(0, length));
    EXPECT_EQ(Problem(folder / "b.png"), "it ends too early") << length;
  }
}

TEST(LoadPng, DamageIsToldAndTheNextFileIsRead) {
  const TestFolder folder;
  WritePng(folder / "a.png", 5, 4, PNG_FORMAT_GRAY, Bytes(20, 77));
  const std::string whole = ReadBytes(folder / "a.png");
  for (std::size_t place = 8; place < whole.size(); ++place) {
    std::string damaged = whole;
    damaged[place] = static_cast<char>(damaged[place] ^ 0x24);
    WriteBytes(folder / "b.png", damaged);
    Problem(folder / "b.png");  // most are told, and none does harm
    if (place == 20) {          // in the header, whose check sum then differs
      EXPECT_EQ(Problem(folder / "b.png"), "IHDR: CRC error");
    }
  }
  EXPECT_EQ(Problem(folder / "a.png"), "none");
}

TEST(LoadPng, SmallFileThatClaimsAHugePictureIsRefusedAtOnce) {
  const TestFolder folder;
  // Signature and header of 30000 x 30000 grey pixels, the header's check sum included.
  const unsigned char start[] = {0x89, 'P', 'N',  'G',  '\r', '\n', 0x1A, '\n', 0,    0,
                                 0,    13,  'I',  'H',  'D',  'R',  0,    0,    0x75, 0x30,
                                 0,    0,   0x75, 0x30, 8,    0,    0,    0,    0};
  std::string bytes(reinterpret_cast<const char*>(start), sizeof(start));
  std::uint32_t crc = 0xFFFFFFFF;
  for (std::size_t i = 12; i < bytes.size(); ++i) {
    crc ^= static_cast<unsigned char>(bytes[i]);
    for (int bit = 0; bit < 8; ++bit) {
      crc = crc >> 1 ^ (crc % 2 != 0 ? 0xEDB88320 : 0);
    }
  }
  for (int shift = 24; shift >= 0; shift -= 8) {
    bytes += static_cast<char>(~crc >> shift & 0xFF);
  }
  bytes += std::string("\0\0\0\0IDAT\x35\xAF\x06\x1E", 12);  // the data has begun, and is empty
  WriteBytes(folder / "a.png", bytes);
  EXPECT_EQ(Problem(folder / "a.png"), "it is too short for its size");
}

TEST(LoadBmp, ReasonNamesTheFile) {
  const TestFolder folder;
  WriteBytes(folder / "a.bmp", "no bitmap at all");
  dImage image;
  const std::string name = "'" + (folder / "a.bmp").string() + "'";
  try {
    LoadBmp(folder / "a.bmp", image);
    ADD_FAILURE() << "no error";
  } catch (const Error& error) {
    EXPECT_EQ(error.what(), "can't read " + name + ": file " + name + " is not a bitmap file");
  }
}

}  // namespace
