#include <vorl/Platform/soft/Surface.h>

#include <algorithm>

inline namespace vorl {
namespace vorl_detail {
namespace {

constexpr std::array<COLORREF, 16> kColours4 = {
    RGB(0, 0, 0),       RGB(128, 0, 0),   RGB(0, 128, 0),   RGB(128, 128, 0),
    RGB(0, 0, 128),     RGB(128, 0, 128), RGB(0, 128, 128), RGB(128, 128, 128),
    RGB(192, 192, 192), RGB(255, 0, 0),   RGB(0, 255, 0),   RGB(255, 255, 0),
    RGB(0, 0, 255),     RGB(255, 0, 255), RGB(0, 255, 255), RGB(255, 255, 255)};

// The first and the last ten of the 256.
constexpr std::array<COLORREF, 20> kSystemColours = {
    RGB(0, 0, 0),       RGB(128, 0, 0),     RGB(0, 128, 0),     RGB(128, 128, 0),
    RGB(0, 0, 128),     RGB(128, 0, 128),   RGB(0, 128, 128),   RGB(192, 192, 192),
    RGB(192, 220, 192), RGB(166, 202, 240), RGB(255, 251, 240), RGB(160, 160, 164),
    RGB(128, 128, 128), RGB(255, 0, 0),     RGB(0, 255, 0),     RGB(255, 255, 0),
    RGB(0, 0, 255),     RGB(255, 0, 255),   RGB(0, 255, 255),   RGB(255, 255, 255)};

// Three bits of red, three of green, two of blue, with the system's colours at both ends.
void FillColours8(std::array<COLORREF, 256>* colours) {
  for (int i = 0; i < 256; ++i) {
    (*colours)[static_cast<std::size_t>(i)] = RGB(i % 8 * 0x20, i / 8 % 8 * 0x20, i / 64 * 0x40);
  }
  std::copy_n(kSystemColours.begin(), 10, colours->begin());
  std::copy_n(kSystemColours.begin() + 10, 10, colours->end() - 10);
}

}  // namespace

PixelFormat DefaultFormat(int depth) {
  PixelFormat format;
  format.depth = depth;
  switch (depth) {
    case 1:
      format.monochrome = true;
      format.colourCount = 2;
      format.colours[1] = RGB(255, 255, 255);
      break;
    case 4:
      format.colourCount = 16;
      std::copy(kColours4.begin(), kColours4.end(), format.colours.begin());
      break;
    case 8:
      format.colourCount = 256;
      FillColours8(&format.colours);
      break;
    case 16:
      format.masks = {0x7C00, 0x03E0, 0x001F};
      break;
    case 32:
      format.masks = {0xFF0000, 0x00FF00, 0x0000FF};
      break;
    default:
      break;
  }
  return format;
}

}  // namespace vorl_detail
}  // namespace vorl
