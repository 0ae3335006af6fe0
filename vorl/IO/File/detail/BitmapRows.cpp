#include <vorl/IO/File/detail/BitmapRows.h>

#include <algorithm>

#include <vorl/Common/LogContext.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

bool IsIndexDepth(int bits) {
  return bits == 1 || bits == 2 || bits == 4 || bits == 8;
}

/// Hands the index of each pixel on, from left to right.
template <class Store>
void ForEachIndex(const unsigned char* source, int bits, std::size_t width, Store store) {
  if (bits == 8) {
    for (std::size_t x = 0; x < width; ++x) {
      store(x, source[x]);
    }
    return;
  }
  const auto pixelsPerByte = static_cast<std::size_t>(8 / bits);
  const unsigned int mask = (1U << bits) - 1U;
  for (std::size_t x = 0; x < width; ++x) {
    const auto shift = static_cast<unsigned int>(bits) *
                       static_cast<unsigned int>(pixelsPerByte - 1 - x % pixelsPerByte);
    store(x, source[x / pixelsPerByte] >> shift & mask);
  }
}

}  // namespace

bool IsGrayScalePalette(const tagRGBQUAD* palette, unsigned int entries) {
  LogContext context("IsGrayScalePalette", __FILE__, __LINE__, true);
  if (palette == nullptr) {
    context.Error(__LINE__, "invalid parameter(s)");
    return false;
  }
  return std::all_of(palette, palette + entries, [](const tagRGBQUAD& colour) {
    return colour.rgbBlue == colour.rgbGreen && colour.rgbGreen == colour.rgbRed;
  });
}

bool ExpandPalette(unsigned char* target, int sourceBits, int targetBits,
                   const unsigned char* source, std::size_t width, const tagRGBQUAD* palette) {
  LogContext context("ExpandPalette", __FILE__, __LINE__, true);
  if (target == nullptr || source == nullptr || palette == nullptr || width == 0) {
    context.Error(__LINE__, "invalid parameter(s)");
    return false;
  }
  if (!IsIndexDepth(sourceBits)) {
    context.Error(__LINE__, "unsupported source pixel depth: %d(must be 8)", sourceBits);
    return false;
  }
  if (targetBits == 8) {
    ForEachIndex(source, sourceBits, width,
                 [&](std::size_t x, unsigned int index) { target[x] = palette[index].rgbBlue; });
    return true;
  }
  if (targetBits == 24) {
    ForEachIndex(source, sourceBits, width, [&](std::size_t x, unsigned int index) {
      target[3 * x] = palette[index].rgbBlue;
      target[3 * x + 1] = palette[index].rgbGreen;
      target[3 * x + 2] = palette[index].rgbRed;
    });
    return true;
  }
  context.Error(__LINE__, "unsupported target pixel depth: %d(must be 8 or 24)", targetBits);
  return false;
}

bool ExpandRGB16(std::size_t width, unsigned char* target, const unsigned char* source) {
  LogContext context("ExpandRGB16", __FILE__, __LINE__, true);
  if (target == nullptr || source == nullptr) {
    context.Error(__LINE__, "invalid parameter(s)");
    return false;
  }
  for (std::size_t x = 0; x < width; ++x) {
    const unsigned int pixel = source[2 * x] | static_cast<unsigned int>(source[2 * x + 1]) << 8;
    target[3 * x] = static_cast<unsigned char>((pixel & 0x1F) * 8);
    target[3 * x + 1] = static_cast<unsigned char>((pixel >> 5 & 0x1F) * 8);
    target[3 * x + 2] = static_cast<unsigned char>((pixel >> 10 & 0x1F) * 8);
  }
  return true;
}

}  // namespace vorl_detail
}  // namespace vorl
