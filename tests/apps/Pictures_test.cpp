#include "FileSizeLimit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/Pictures.h>

#include <cstring>

#include <png.h>

using namespace study;
using namespace study_test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

/// An image whose bytes count up, with padded rows.
dImage CountingImage(int width, int height, unsigned short type, const char* channels,
                     unsigned short alignment) {
  dImage image;
  image.Init(static_cast<unsigned long>(width), static_cast<unsigned long>(height), type, channels,
             ImageDataOrder_Pixel, alignment);
  image.Fill(static_cast<char>(0xEE));
  const unsigned long bytes = image.GetDataSamplesInRow() * (image.GetChannelDepth() / 8u);
  unsigned value = 5;
  for (int y = 0; y < height; ++y) {
    auto* row = static_cast<unsigned char*>(image.GetRowPtr(y));
    for (unsigned long i = 0; i < bytes; ++i) {
      row[i] = static_cast<unsigned char>(value = value * 7 + 3);
    }
  }
  return image;
}

/// The rows of a PNG file as another reader sees them: 8-bit grey, or RGB.
std::string ReadPng(const fs::path& path, png_uint_32 format) {
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  if (png_image_begin_read_from_file(&png, path.string().c_str()) == 0) {
    return png.message;
  }
  png.format = format;
  std::string pixels(PNG_IMAGE_SIZE(png), '\0');
  png_image_finish_read(&png, nullptr, pixels.data(), 0, nullptr);
  return pixels;
}

std::string RowsOf(const dImage& image, std::size_t bytes) {
  std::string rows;
  for (int y = 0; y < static_cast<int>(image.GetHeight()); ++y) {
    rows.append(static_cast<const char*>(image.GetRowPtr(y)), bytes);
  }
  return rows;
}

TEST(SavePicture, PngKeepsGreyPixels) {
  const TestFolder folder;
  const dImage image = CountingImage(5, 3, ImageDataType_U8, "G", 4);
  SavePicture(image, folder / "a.png");
  EXPECT_EQ(ReadPng(folder / "a.png", PNG_FORMAT_GRAY), RowsOf(image, 5));
}

TEST(SavePicture, PngTurnsBlueGreenRedRound) {
  const TestFolder folder;
  const dImage image = CountingImage(3, 2, ImageDataType_U8, "BGR", 4);
  SavePicture(image, folder / "a.PNG");
  EXPECT_EQ(ReadPng(folder / "a.PNG", PNG_FORMAT_BGR), RowsOf(image, 9));
}

TEST(SavePicture, PngKeepsSixteenBits) {
  const TestFolder folder;
  dImage image = CountingImage(2, 1, ImageDataType_U16, "G", 2);
  const std::uint16_t values[2] = {0x1234, 0xFFFE};
  std::memcpy(image.GetDataPtr(), values, sizeof values);
  SavePicture(image, folder / "a.png");
  // The file has the high byte first; the picture's header tells 16 bits of grey.
  const std::string bytes = ReadBytes(folder / "a.png");
  EXPECT_EQ(bytes.substr(16, 10), std::string("\0\0\0\2\0\0\0\1\x10\0", 10));
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  ASSERT_NE(png_image_begin_read_from_file(&png, (folder / "a.png").string().c_str()), 0);
  EXPECT_NE(png.format & PNG_FORMAT_FLAG_LINEAR, 0u);
  png_image_free(&png);
}

TEST(SavePicture, PngInputIsLeftAlone) {
  const TestFolder folder;
  const dImage image = CountingImage(3, 2, ImageDataType_U8, "BGR", 4);
  const std::string before = RowsOf(image, 12);
  SavePicture(image, folder / "a.png");
  EXPECT_EQ(RowsOf(image, 12), before);
}

TEST(SavePicture, BmpKeepsGreyPixelsWithAnyAlignment) {
  const TestFolder folder;
  for (const unsigned short alignment : std::initializer_list<unsigned short>{1, 4, 32}) {
    const dImage image = CountingImage(5, 3, ImageDataType_U8, "G", alignment);
    SavePicture(image, folder / "a.bmp");
    const std::string bytes = ReadBytes(folder / "a.bmp");
    ASSERT_EQ(bytes.size(), 1078u + 3 * 8);  // headers and 256 colours, rows of 8 bytes
    for (int y = 0; y < 3; ++y) {
      EXPECT_EQ(bytes.substr(1078 + 8 * static_cast<std::size_t>(2 - y), 5),
                std::string(static_cast<const char*>(image.GetRowPtr(y)), 5))
          << alignment;
    }
  }
}

TEST(SavePicture, BmpKeepsColours) {
  const TestFolder folder;
  const dImage image = CountingImage(3, 2, ImageDataType_U8, "BGR", 1);
  SavePicture(image, folder / "a.bmp");
  const std::string bytes = ReadBytes(folder / "a.bmp");
  ASSERT_EQ(bytes.size(), 54u + 2 * 12);
  EXPECT_EQ(bytes.substr(54, 9), RowsOf(image, 9).substr(9, 9));
  EXPECT_EQ(bytes.substr(66, 9), RowsOf(image, 9).substr(0, 9));
}

TEST(SavePicture, RefusesOtherNamesAndImages) {
  const TestFolder folder;
  const dImage grey = CountingImage(2, 2, ImageDataType_U8, "G", 1);
  const fs::path jpeg = folder / "a.jpg";
  EXPECT_EQ(ErrorOf([&] { SavePicture(grey, jpeg); }),
            "the name '" + jpeg.string() + "' must end in .png or .bmp");
  const char* const notPng =
      "only grey images of 8 or 16 bits and BGR images can be written as PNG";
  const dImage four = CountingImage(2, 2, ImageDataType_U8, "BGRA", 1);
  EXPECT_EQ(ErrorOf([&] { SavePng(four, folder / "a.png"); }), notPng);
  const dImage isSigned = CountingImage(2, 2, ImageDataType_S16, "G", 1);
  EXPECT_EQ(ErrorOf([&] { SavePng(isSigned, folder / "a.png"); }), notPng);
  EXPECT_EQ(ErrorOf([&] { SavePng(dImage(), folder / "a.png"); }), notPng);
  const dImage wide = CountingImage(2, 2, ImageDataType_U16, "G", 1);
  EXPECT_EQ(ErrorOf([&] { SaveBmp(wide, folder / "a.bmp"); }),
            "only images of 1 or 8 bits can be written as BMP");
  EXPECT_THAT(folder.Names(), IsEmpty());
}

#if !defined(_WIN32)  // there nothing limits the size of a process's files, and no device is full
TEST(SavePicture, FullDiskIsAnErrorAndKeepsTheOldFile) {
  const TestFolder folder;
  const dImage image = CountingImage(90, 80, ImageDataType_U8, "G", 1);
  for (const char* const name : {"a.png", "a.bmp"}) {
    WriteBytes(folder / name, "old");
    for (const rlim_t room : {rlim_t{0}, rlim_t{40}, rlim_t{300}}) {
      const FileSizeLimit limit(room);
      EXPECT_NE(ErrorOf([&] { SavePicture(image, folder / name); }), "no error") << name << room;
    }
    EXPECT_EQ(ReadBytes(folder / name), "old");
  }
  EXPECT_THAT(folder.Names(), ElementsAre("a.bmp", "a.png"));
}

TEST(SavePicture, FullDeviceIsAnError) {
  const dImage image = CountingImage(2, 2, ImageDataType_U8, "G", 1);
  EXPECT_EQ(ErrorOf([&] { SavePng(image, "/dev/full"); }),
            "can't write '/dev/full': No space left on device");
  EXPECT_EQ(ErrorOf([&] { SaveBmp(image, "/dev/full"); }),
            "can't write '/dev/full': No space left on device");
}
#endif

}  // namespace
