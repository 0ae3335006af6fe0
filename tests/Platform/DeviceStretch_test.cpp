// Stretched pictures of random sizes, depths and places, mirrored, cropped and clipped, against a
// model that looks at one target pixel after the other.

#include "DeviceTesting.h"

#include <gtest/gtest.h>

#include <optional>
#include <random>
#include <sstream>

namespace {

std::mt19937 g_random;

int Between(int low, int high) {
  return low + static_cast<int>(g_random() % static_cast<unsigned>(high - low + 1));
}

// The source position that a target position shows; none where it shows none. Of several columns
// that fall into one target pixel the last one is shown, of several rows the first.
enum class Shown { First, Last };

std::optional<int> SourceOf(Shown which, int target, int start, int length, int sourceStart,
                            int sourceLength, int sourceSize) {
  const int count = std::abs(length);
  const int sourceCount = std::abs(sourceLength);
  const int step = length < 0 ? -1 : 1;
  const int sourceStep = sourceLength < 0 ? -1 : 1;
  const int index = step * (target - start);
  if (index < 0 || index >= count) {
    return std::nullopt;
  }
  std::optional<int> shown;
  if (sourceCount <= count) {
    shown = sourceStart + sourceStep * (((2 * index + 1) * sourceCount - 1) / (2 * count));
    return *shown >= 0 && *shown < sourceSize ? shown : std::nullopt;
  }
  for (int i = 0; i < sourceCount; ++i) {
    const int position = sourceStart + sourceStep * i;
    if (((2 * i + 1) * count - 1) / (2 * sourceCount) == index && position >= 0 &&
        position < sourceSize && (which == Shown::Last || !shown)) {
      shown = position;
    }
  }
  return shown;
}

// A picture of 8, 24 or 32 bits, the rows from top to bottom.
struct Picture {
  TestInfo info;
  std::vector<std::uint8_t> bits;
  bool isGrey = Between(0, 1) == 0;

  Picture(int width, int height, int depth) : info(width, -height, depth) {
    bits.resize(RowBytes() * static_cast<std::size_t>(height));
    for (std::uint8_t& byte : bits) {
      byte = static_cast<std::uint8_t>(g_random());
    }
    for (RGBQUAD& colour : info.colours) {
      const auto random = static_cast<std::uint32_t>(g_random());
      colour.rgbBlue = static_cast<BYTE>(random);
      colour.rgbGreen = static_cast<BYTE>(isGrey ? random : random >> 8);
      colour.rgbRed = static_cast<BYTE>(isGrey ? random : random >> 16);
    }
  }

  std::size_t RowBytes() const {
    const int bitCount = info.header.biWidth * info.header.biBitCount;
    return static_cast<std::size_t>((bitCount + 31) / 32 * 4);
  }

  // As a pixel of a section of 32 bits.
  std::uint32_t At(int x, int y) const {
    const std::size_t bytes = info.header.biBitCount / 8U;
    std::uint32_t pixel = 0;
    std::memcpy(&pixel,
                bits.data() + static_cast<std::size_t>(y) * RowBytes() +
                    static_cast<std::size_t>(x) * bytes,
                bytes);
    if (bytes > 1) {
      return pixel;
    }
    const RGBQUAD& colour = info.colours[pixel];
    return static_cast<std::uint32_t>(colour.rgbRed << 16 | colour.rgbGreen << 8 | colour.rgbBlue);
  }
};

// Of lengths that fill registers and of few pixels, forwards or mirrored; where it starts, the
// picture lies partly outside now and then.
struct Side {
  int start;
  int length;

  explicit Side(int size) : start(Between(-size / 4, size)), length(Between(1, 3 * size / 2)) {
    if (Between(0, 2) == 0) {
      start = 0;
      length = size;
    }
    if (Between(0, 3) == 0) {
      start += length - 1;
      length = -length;
    }
  }
};

TEST(DeviceStretch, EveryPixelIsTheOneThatTheModelTakes) {
  g_random.seed(3840);
  const int depths[] = {8, 24, 32};
  for (int round = 0; round < 400; ++round) {
    TestSection target(Between(1, 300), -Between(1, 12), 32);
    const int targetHeight = -target.info.header.biHeight;
    const Picture picture(Between(1, 200), Between(1, 12), depths[round % 3]);
    const int width = picture.info.header.biWidth;
    const int height = -picture.info.header.biHeight;
    const Side x(target.info.header.biWidth);
    const Side y(targetHeight);
    const Side sourceX(width);
    const Side fromTop(height);
    // Rows of the source are counted from the bottom, whatever their order in memory.
    const int sourceY = height - fromTop.start - fromTop.length;
    const int left = Between(0, 200);
    const int top = Between(0, 8);
    const RECT hole{left, top, left + Between(1, 100), top + Between(0, 4)};
    ExcludeClipRect(target.dc, hole.left, hole.top, hole.right, hole.bottom);
    SetStretchBltMode(target.dc, COLORONCOLOR);
    StretchDIBits(target.dc, x.start, y.start, x.length, y.length, sourceX.start, sourceY,
                  sourceX.length, fromTop.length, picture.bits.data(),
                  const_cast<TestInfo&>(picture.info).Get(), DIB_RGB_COLORS, SRCCOPY);
    std::ostringstream call;
    call << "round " << round << ": " << x.start << ", " << y.start << ", " << x.length << ", "
         << y.length << " from " << sourceX.start << ", " << sourceY << ", " << sourceX.length
         << ", " << fromTop.length << " of " << width << " x " << height;
    for (int row = 0; row < targetHeight; ++row) {
      for (int column = 0; column < target.info.header.biWidth; ++column) {
        const auto fromX =
            SourceOf(Shown::Last, column, x.start, x.length, sourceX.start, sourceX.length, width);
        const auto fromY =
            SourceOf(Shown::First, row, y.start, y.length, fromTop.start, fromTop.length, height);
        const bool isClipped =
            column >= hole.left && column < hole.right && row >= hole.top && row < hole.bottom;
        const bool isShown = fromX && fromY && !isClipped;
        ASSERT_EQ(target.At(column, row), isShown ? picture.At(*fromX, *fromY) : 0U)
            << call.str() << ", at " << column << ", " << row;
      }
    }
  }
}

// Pictures from a size on are written past the caches; their parts are not.
TEST(DeviceStretch, AsAWholeALargePictureIsWhatItsPartsAre) {
  g_random.seed(16);
  constexpr int kWidth = 2064;
  constexpr int kHeight = 2100;
  const Picture picture(1900, 2000, 32);
  TestInfo& info = const_cast<TestInfo&>(picture.info);
  TestSection whole(kWidth, -kHeight, 32);
  TestSection parts(kWidth, -kHeight, 32);
  ASSERT_GT(whole.Bytes(), std::size_t{1} << 24);
  const auto stretch = [&](const TestSection& target) {
    SetStretchBltMode(target.dc, COLORONCOLOR);
    StretchDIBits(target.dc, 0, 0, kWidth, kHeight, 0, 0, 1900, 2000, picture.bits.data(),
                  info.Get(), DIB_RGB_COLORS, SRCCOPY);
  };
  stretch(whole);
  for (int top = 0; top < kHeight; top += 700) {
    SaveDC(parts.dc);
    IntersectClipRect(parts.dc, 0, top, kWidth, top + 700);
    stretch(parts);
    RestoreDC(parts.dc, -1);
  }
  EXPECT_EQ(std::memcmp(whole.pixels, parts.pixels, whole.Bytes()), 0);
  EXPECT_EQ(whole.At(0, 0), picture.At(0, 0));
  EXPECT_EQ(whole.At(kWidth - 1, kHeight - 1), picture.At(1899, 1999));
}

}  // namespace
