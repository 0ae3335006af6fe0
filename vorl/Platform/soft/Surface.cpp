#include <vorl/Platform/soft/Surface.h>

#include <algorithm>
#include <bit>
#include <limits>

inline namespace vorl {
namespace vorl_detail {
namespace {

constexpr std::array<std::uint32_t, 3> kMasks16 = {0x7C00, 0x03E0, 0x001F};
constexpr std::array<std::uint32_t, 3> kMasks32 = {0xFF0000, 0x00FF00, 0x0000FF};

// The bits of a mask, spread over 8 bits: short fields are repeated, long ones lose their low bits.
std::uint32_t Channel(std::uint32_t pixel, std::uint32_t mask) {
  if (mask == 0) {
    return 0;
  }
  const int bits = std::bit_width(mask >> std::countr_zero(mask));
  std::uint32_t value = (pixel & mask) >> std::countr_zero(mask);
  if (bits >= 8) {
    return (value >> (bits - 8)) & 0xFF;
  }
  value <<= 8 - bits;
  for (int have = bits; have < 8; have *= 2) {
    value |= value >> have;
  }
  return value;
}

std::uint32_t Field(std::uint32_t channel, std::uint32_t mask) {
  if (mask == 0) {
    return 0;
  }
  const int shift = std::countr_zero(mask);
  const int bits = std::bit_width(mask >> shift);
  const std::uint32_t value = bits >= 8 ? channel << (bits - 8) : channel >> (8 - bits);
  return (value << shift) & mask;
}

int Distance(COLORREF a, COLORREF b) {
  const int red = GetRValue(a) - GetRValue(b);
  const int green = GetGValue(a) - GetGValue(b);
  const int blue = GetBValue(a) - GetBValue(b);
  return red * red + green * green + blue * blue;
}

}  // namespace

bool PixelFormat::HasDefaultMasks() const {
  return depth == 16 ? masks == kMasks16 : depth != 32 || masks == kMasks32;
}

bool SamePixels(const PixelFormat& a, const PixelFormat& b) {
  if (a.depth != b.depth || a.monochrome != b.monochrome) {
    return false;
  }
  if (a.depth > 8) {
    return a.depth == 24 || a.masks == b.masks;
  }
  return a.colourCount == b.colourCount &&
         std::equal(a.colours.begin(), a.colours.begin() + a.colourCount, b.colours.begin());
}

std::uint64_t RowBytes(int width, int depth, int alignment) {
  const std::uint64_t bits = static_cast<std::uint64_t>(width) * static_cast<std::uint64_t>(depth);
  const auto step = static_cast<std::uint64_t>(alignment);
  return (bits + step - 1) / step * (step / 8);
}

std::uint32_t ReadPixel(const std::uint8_t* row, int x, int depth) {
  const std::uint8_t* p = row + static_cast<std::ptrdiff_t>(x) * depth / 8;
  switch (depth) {
    case 1:
      return (*p >> (7 - x % 8)) & 1U;
    case 4:
      return x % 2 == 0 ? *p >> 4U : *p & 0xFU;
    case 8:
      return *p;
    case 16:
      return static_cast<std::uint32_t>(p[0] | p[1] << 8);
    case 24:
      return static_cast<std::uint32_t>(p[0] | p[1] << 8 | p[2] << 16);
    default:
      return static_cast<std::uint32_t>(p[0] | p[1] << 8 | p[2] << 16) |
             static_cast<std::uint32_t>(p[3]) << 24U;
  }
}

void WritePixel(std::uint8_t* row, int x, int depth, std::uint32_t pixel) {
  std::uint8_t* p = row + static_cast<std::ptrdiff_t>(x) * depth / 8;
  if (depth < 8) {
    const unsigned shift = static_cast<unsigned>(8 - depth - x * depth % 8);
    const unsigned mask = ((1U << static_cast<unsigned>(depth)) - 1U) << shift;
    *p = static_cast<std::uint8_t>((*p & ~mask) | ((pixel << shift) & mask));
    return;
  }
  for (int i = 0; i < depth / 8; ++i) {
    p[i] = static_cast<std::uint8_t>(pixel >> static_cast<unsigned>(8 * i));
  }
}

COLORREF ColourOf(const PixelFormat& format, std::uint32_t pixel) {
  if (format.monochrome) {
    return pixel == 0 ? RGB(0, 0, 0) : RGB(255, 255, 255);
  }
  if (format.depth <= 8) {
    return format.colours[pixel & 0xFFU];
  }
  if (format.depth == 24 || (format.depth == 32 && format.HasDefaultMasks())) {
    return (pixel & 0xFFU) << 16U | (pixel & 0xFF00U) | (pixel >> 16U & 0xFFU);
  }
  return Channel(pixel, format.masks[0]) | Channel(pixel, format.masks[1]) << 8U |
         Channel(pixel, format.masks[2]) << 16U;
}

std::uint32_t NearestPixel(const PixelFormat& format, COLORREF colour) {
  if (format.monochrome) {
    return Distance(colour, RGB(255, 255, 255)) < Distance(colour, RGB(0, 0, 0)) ? 1 : 0;
  }
  if (format.depth == 24 || (format.depth == 32 && format.HasDefaultMasks())) {
    return (colour & 0xFFU) << 16U | (colour & 0xFF00U) | (colour >> 16U & 0xFFU);
  }
  if (format.depth > 8) {
    return Field(GetRValue(colour), format.masks[0]) | Field(GetGValue(colour), format.masks[1]) |
           Field(GetBValue(colour), format.masks[2]);
  }
  int nearest = 0;
  int distance = std::numeric_limits<int>::max();
  for (int i = 0; i < format.colourCount && distance > 0; ++i) {
    const int d = Distance(format.colours[static_cast<std::size_t>(i)], colour);
    if (d < distance) {
      nearest = i;
      distance = d;
    }
  }
  return static_cast<std::uint32_t>(nearest);
}

}  // namespace vorl_detail
}  // namespace vorl
