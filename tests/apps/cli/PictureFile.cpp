#include "PictureFile.h"

#include "../TestFolder.h"

#include <stdexcept>
#include <string>

#include <png.h>

namespace cli_test {
namespace {

void Require(bool holds, const std::string& what) {
  if (!holds) {
    throw std::runtime_error(what);
  }
}

/// The bytes of a file, read with checks.
class Bytes {
 public:
  explicit Bytes(const std::filesystem::path& path) : m_bytes(study_test::ReadBytes(path)) {}

  unsigned U8(std::size_t at) const { return static_cast<unsigned char>(m_bytes.at(at)); }
  unsigned U16(std::size_t at) const { return U8(at) | U8(at + 1) << 8; }
  unsigned U32(std::size_t at) const { return U16(at) | U16(at + 2) << 16; }
  int S32(std::size_t at) const { return static_cast<int>(U32(at)); }

 private:
  std::string m_bytes;
};

}  // namespace

double Picture::Mean(int x0, int y0, int x1, int y1) const {
  double sum = 0;
  for (int y = y0; y < y1; ++y) {
    for (int x = x0; x < x1; ++x) {
      sum += At(x, y);
    }
  }
  return sum / ((x1 - x0) * (y1 - y0));
}

Picture ReadPng(const std::filesystem::path& path) {
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  Require(png_image_begin_read_from_file(&png, path.string().c_str()) != 0,
          path.string() + " is no PNG");
  Require(png.format == PNG_FORMAT_GRAY, "the PNG is not of 8-bit grey");
  Picture picture{static_cast<int>(png.width), static_cast<int>(png.height), {}};
  picture.levels.resize(PNG_IMAGE_SIZE(png));
  Require(png_image_finish_read(&png, nullptr, picture.levels.data(), 0, nullptr) != 0,
          "the PNG is damaged");
  return picture;
}

Picture ReadBmp(const std::filesystem::path& path) {
  const Bytes file(path);
  Require(file.U16(0) == 0x4D42 && file.U32(14) == 40, "no BMP with the usual header");
  Require(file.U16(28) == 8 && file.U32(30) == 0, "the BMP is not of 8 bits, uncompressed");
  const int height = file.S32(22);
  Picture picture{file.S32(18), height < 0 ? -height : height, {}};
  const auto rowBytes = static_cast<std::size_t>((picture.width + 3) / 4 * 4);
  for (int y = 0; y < picture.height; ++y) {
    const auto row = static_cast<std::size_t>(height < 0 ? y : height - 1 - y);
    for (int x = 0; x < picture.width; ++x) {
      const unsigned index = file.U8(file.U32(10) + row * rowBytes + static_cast<std::size_t>(x));
      const unsigned colour = file.U32(54 + 4 * index);
      Require((colour & 0xFF) == (colour >> 8 & 0xFF) && (colour & 0xFF) == (colour >> 16 & 0xFF),
              "the palette is not grey");
      picture.levels.push_back(static_cast<unsigned char>(colour & 0xFF));
    }
  }
  return picture;
}

ColourPicture ReadColourPng(const std::filesystem::path& path) {
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  Require(png_image_begin_read_from_file(&png, path.string().c_str()) != 0,
          path.string() + " is no PNG");
  Require(png.format == PNG_FORMAT_RGB, "the PNG is not of 8-bit colours");
  std::vector<unsigned char> bytes(PNG_IMAGE_SIZE(png));
  Require(png_image_finish_read(&png, nullptr, bytes.data(), 0, nullptr) != 0,
          "the PNG is damaged");
  ColourPicture picture{static_cast<int>(png.width), static_cast<int>(png.height), {}};
  for (std::size_t at = 0; at < bytes.size(); at += 3) {
    picture.colours.push_back(bytes[at] * 0x10000U + bytes[at + 1] * 0x100U + bytes[at + 2]);
  }
  return picture;
}

ColourPicture ReadColourBmp(const std::filesystem::path& path) {
  const Bytes file(path);
  Require(file.U16(0) == 0x4D42 && file.U32(14) == 40, "no BMP with the usual header");
  Require(file.U16(28) == 24 && file.U32(30) == 0, "the BMP is not of 24 bits, uncompressed");
  const int height = file.S32(22);
  ColourPicture picture{file.S32(18), height < 0 ? -height : height, {}};
  const auto rowBytes = static_cast<std::size_t>((3 * picture.width + 3) / 4 * 4);
  for (int y = 0; y < picture.height; ++y) {
    const auto row = static_cast<std::size_t>(height < 0 ? y : height - 1 - y);
    for (int x = 0; x < picture.width; ++x) {
      const std::size_t at = file.U32(10) + row * rowBytes + 3 * static_cast<std::size_t>(x);
      picture.colours.push_back(file.U16(at) + file.U8(at + 2) * 0x10000U);
    }
  }
  return picture;
}

}  // namespace cli_test
