#ifndef VORL_PLATFORM_SOFT_SURFACE_H
#define VORL_PLATFORM_SOFT_SURFACE_H

#include <vorl/Platform/Gdi.h>

#include <array>
#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// How the bits of a pixel make a colour.
///
/// depth  pixel values
/// 1      index into the colours; without colours (`monochrome`) 0 is black and 1 white
/// 4, 8   index into the colours
/// 16, 32 by the masks; by default 5-5-5 and 8-8-8, blue lowest
/// 24     blue lowest
struct PixelFormat {
  int depth = 1;
  bool monochrome = false;               ///< a device bitmap of one bit
  int colourCount = 0;                   ///< 0 above 8 bits
  std::array<COLORREF, 256> colours{};   ///< as COLORREF, not as RGBQUAD
  std::array<std::uint32_t, 3> masks{};  ///< red, green, blue; 16 and 32 bits
  int BytesPerUnit() const {
    return depth <= 8 ? 1 : depth / 8;
  }  ///< of one pixel in a row of units
  bool HasDefaultMasks() const;
};

/// The format of a depth without colours or unusual masks: 1 bit is monochrome, 4 and 8 bits have
/// the system's colours.
PixelFormat DefaultFormat(int depth);

/// Do pixels of one format mean the same in the other, so that they may be copied as they are?
bool SamePixels(const PixelFormat& a, const PixelFormat& b);

/// The pixels of a bitmap. Owns nothing. Row 0 is the top row, whatever their order in memory.
struct Surface {
  std::uint8_t* top = nullptr;  ///< first byte of row 0
  std::ptrdiff_t pitch = 0;     ///< bytes from one row to the next one below
  int width = 0;
  int height = 0;
  PixelFormat format;

  std::uint8_t* Row(int y) const { return top + pitch * y; }
  RECT Bounds() const { return RECT{0, 0, width, height}; }
  bool Contains(int x, int y) const { return x >= 0 && y >= 0 && x < width && y < height; }
};

/// The bytes of a row whose length is padded to a multiple of `alignment` bits.
std::uint64_t RowBytes(int width, int depth, int alignment);

/// The value of the pixel at column x of a row.
std::uint32_t ReadPixel(const std::uint8_t* row, int x, int depth);
void WritePixel(std::uint8_t* row, int x, int depth, std::uint32_t pixel);

/// The colour of a pixel value.
COLORREF ColourOf(const PixelFormat& format, std::uint32_t pixel);

/// The pixel value that comes nearest to a colour; the first one of several as near.
std::uint32_t NearestPixel(const PixelFormat& format, COLORREF colour);

}  // namespace vorl_detail
}  // namespace vorl

#endif
