#ifndef VORL_TESTS_APPS_CLI_PICTUREFILE_H
#define VORL_TESTS_APPS_CLI_PICTUREFILE_H

/// @file
/// Reading pictures with other code than that which writes them.

#include <cstddef>
#include <filesystem>
#include <vector>

namespace cli_test {

/// Grey levels, top row first.
struct Picture {
  int width = 0;
  int height = 0;
  std::vector<unsigned char> levels;

  int At(int x, int y) const {
    return levels.at(static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
                     static_cast<std::size_t>(x));
  }
  /// The mean level of the pixels from (x0, y0) up to, not including, (x1, y1).
  double Mean(int x0, int y0, int x1, int y1) const;
};

/// Reads an 8-bit grey PNG with the PNG library. Throws when it is anything else.
Picture ReadPng(const std::filesystem::path& path);

/// Reads an uncompressed 8-bit BMP byte by byte, through its palette, which must be grey. Throws
/// when it is anything else.
Picture ReadBmp(const std::filesystem::path& path);

/// Colours 0xRRGGBB, top row first.
struct ColourPicture {
  int width = 0;
  int height = 0;
  std::vector<unsigned> colours;

  unsigned At(int x, int y) const {
    return colours.at(static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
                      static_cast<std::size_t>(x));
  }
};

/// Reads an 8-bit colour PNG with the PNG library. Throws when it is anything else.
ColourPicture ReadColourPng(const std::filesystem::path& path);

/// Reads an uncompressed 24-bit BMP byte by byte. Throws when it is anything else.
ColourPicture ReadColourBmp(const std::filesystem::path& path);

}  // namespace cli_test

#endif
