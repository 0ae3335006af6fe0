#ifndef VORL_TESTS_IO_FILE_BITMAPBYTES_H
#define VORL_TESTS_IO_FILE_BITMAPBYTES_H

/// @file
/// Bitmap files made byte by byte, and their pixels by definition: slow, and with no code of the
/// library.

#include <vorl/Data/dImage.h>

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <optional>
#include <string>
#include <vector>

namespace bitmap_test {

using Bytes = std::vector<unsigned char>;

/// Blue, green, red.
using Colour = std::array<int, 3>;

/// What a bitmap file states; where a value is left open, the one that is true.
struct Bitmap {
  std::int32_t width = 0;
  std::int32_t height = 0;  ///< negative: top row first
  int bits = 0;
  std::vector<Colour> palette;
  Bytes rows;  ///< as they are stored; empty: made up
  std::uint32_t infoSize = 40;
  Bytes infoRest;  ///< of a longer header, behind its first 40 bytes
  int planes = 1;
  std::uint32_t compression = 0;
  std::uint32_t coloursUsed = 0;
  Bytes gap;  ///< between palette and pixels: masks, for example
  std::optional<std::uint32_t> fileSize;
  std::optional<std::uint32_t> offset;
};

inline std::size_t RowBytes(const Bitmap& bitmap) {
  const auto bits =
      static_cast<std::size_t>(std::abs(bitmap.width)) * static_cast<std::size_t>(bitmap.bits);
  return (bits + 31) / 32 * 4;
}

inline void Append(Bytes& bytes, std::uint64_t value, int count) {
  for (int i = 0; i < count; ++i) {
    bytes.push_back(i < 8 ? static_cast<unsigned char>(value >> 8 * i & 0xFF) : std::uint8_t{0});
  }
}

/// Rows in which hardly a pixel is like its neighbours; their padding is not zero.
inline Bytes MadeUpRows(const Bitmap& bitmap) {
  Bytes rows(RowBytes(bitmap) * static_cast<std::size_t>(std::abs(bitmap.height)));
  std::uint32_t state = 99;
  for (unsigned char& byte : rows) {
    state = state * 1664525U + 1013904223U;
    byte = static_cast<unsigned char>(state >> 24);
  }
  return rows;
}

inline Bytes PaletteBytes(const Bitmap& bitmap) {
  Bytes bytes;
  for (const Colour& colour : bitmap.palette) {
    for (const int part : colour) {
      Append(bytes, static_cast<std::uint64_t>(part), 1);
    }
    Append(bytes, 0, 1);
  }
  return bytes;
}

/// The information header, the palette and the gap.
inline Bytes InfoBytes(const Bitmap& bitmap) {
  Bytes bytes;
  Append(bytes, bitmap.infoSize, 4);
  Append(bytes, static_cast<std::uint32_t>(bitmap.width), 4);
  Append(bytes, static_cast<std::uint32_t>(bitmap.height), 4);
  Append(bytes, static_cast<std::uint64_t>(bitmap.planes), 2);
  Append(bytes, static_cast<std::uint64_t>(bitmap.bits), 2);
  Append(bytes, bitmap.compression, 4);
  Append(bytes, 0, 12);
  Append(bytes, bitmap.coloursUsed, 4);
  Append(bytes, 0, 4);
  bytes.insert(bytes.end(), bitmap.infoRest.begin(), bitmap.infoRest.end());
  const Bytes palette = PaletteBytes(bitmap);
  bytes.insert(bytes.end(), palette.begin(), palette.end());
  bytes.insert(bytes.end(), bitmap.gap.begin(), bitmap.gap.end());
  return bytes;
}

inline Bytes FileOf(const Bitmap& bitmap) {
  const Bytes info = InfoBytes(bitmap);
  const Bytes rows = bitmap.rows.empty() ? MadeUpRows(bitmap) : bitmap.rows;
  Bytes bytes{'B', 'M'};
  Append(bytes, bitmap.fileSize.value_or(14 + info.size() + rows.size()), 4);
  Append(bytes, 0, 4);
  Append(bytes, bitmap.offset.value_or(14 + info.size()), 4);
  bytes.insert(bytes.end(), info.begin(), info.end());
  bytes.insert(bytes.end(), rows.begin(), rows.end());
  return bytes;
}

/// The bits of a pixel of up to 8 bits: the first pixel stands in the highest bits.
inline int IndexAt(const Bitmap& bitmap, int x, int y) {
  const Bytes rows = bitmap.rows.empty() ? MadeUpRows(bitmap) : bitmap.rows;
  const int row = bitmap.height > 0 ? bitmap.height - 1 - y : y;
  int index = 0;
  for (int i = 0; i < bitmap.bits; ++i) {
    const int bit = x * bitmap.bits + i;
    const unsigned char byte = rows.at(static_cast<std::size_t>(row) * RowBytes(bitmap) +
                                       static_cast<std::size_t>(bit / 8));
    index = index * 2 + (byte >> (7 - bit % 8) & 1);
  }
  return index;
}

/// The byte `channel` of the pixel at (x, y), the top row being 0, of a bitmap with whole bytes.
inline int ByteAt(const Bitmap& bitmap, int x, int y, int channel) {
  const Bytes rows = bitmap.rows.empty() ? MadeUpRows(bitmap) : bitmap.rows;
  const int row = bitmap.height > 0 ? bitmap.height - 1 - y : y;
  return rows.at(static_cast<std::size_t>(row) * RowBytes(bitmap) +
                 static_cast<std::size_t>(x * (bitmap.bits / 8) + channel));
}

/// The colour of a pixel.
inline Colour ColourAt(const Bitmap& bitmap, int x, int y) {
  if (bitmap.bits <= 8) {
    const auto index = static_cast<std::size_t>(IndexAt(bitmap, x, y));
    const std::size_t used = bitmap.coloursUsed != 0 ? bitmap.coloursUsed : bitmap.palette.size();
    return index < used && index < bitmap.palette.size() ? bitmap.palette[index] : Colour{};
  }
  if (bitmap.bits == 16) {
    const int pixel = ByteAt(bitmap, x, y, 0) + 256 * ByteAt(bitmap, x, y, 1);
    return {pixel % 32 * 8, pixel / 32 % 32 * 8, pixel / 1024 % 32 * 8};
  }
  return {ByteAt(bitmap, x, y, 0), ByteAt(bitmap, x, y, 1), ByteAt(bitmap, x, y, 2)};
}

/// The colour of an image's pixel.
inline Colour ColourAt(const dImage& image, int x, int y) {
  const auto* pixel = static_cast<const unsigned char*>(image.GetDataPtr(x, y));
  if (image.GetNumChannels() == 1) {
    return {pixel[0], pixel[0], pixel[0]};
  }
  return {pixel[0], pixel[1], pixel[2]};
}

/// An even ramp of so many colours that differ in each part, or of greys.
inline std::vector<Colour> Ramp(int count, bool grey) {
  std::vector<Colour> colours;
  for (int i = 0; i < count; ++i) {
    const int level = 255 - i * 255 / (count > 1 ? count - 1 : 1);
    colours.push_back(grey ? Colour{level, level, level} : Colour{level, 255 - level, i / 2});
  }
  return colours;
}

}  // namespace bitmap_test

#endif
