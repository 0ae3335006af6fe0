#ifndef VORL_TESTS_APPS_CLI_PICTUREFILE_H
#define VORL_TESTS_APPS_CLI_PICTUREFILE_H

/// @file
/// Reading pictures with other code than that which writes them.

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

}  // namespace cli_test

#endif
