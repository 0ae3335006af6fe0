#ifndef VORL_TESTS_GUI_CANVAS_H
#define VORL_TESTS_GUI_CANVAS_H

#include <vorl/Data/dDIB.h>
#include <vorl/GUI/vIma2Device.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

/// A bitmap with a device context to draw on it.
class Canvas {
 public:
  Canvas(long width, long height, short channels = 3)
      : m_dib(width, height, channels, 8),
        m_dc(CreateCompatibleDC(nullptr)),
        m_old(SelectObject(m_dc, m_dib.GetHandle())) {
    EXPECT_NE(m_old, nullptr);
  }
  Canvas(const Canvas&) = delete;
  Canvas& operator=(const Canvas&) = delete;
  ~Canvas() {
    SelectObject(m_dc, m_old);
    DeleteDC(m_dc);
  }
  operator HDC() const { return m_dc; }

  dDIB& Bitmap() { return m_dib; }
  int Width() const { return static_cast<int>(m_dib.GetWidth()); }
  int Height() const { return static_cast<int>(m_dib.GetHeight()); }
  void Fill(char value) { m_dib.Fill(value); }
  /// 0x00bbggrr, as the device counts colours.
  unsigned At(int x, int y) const {
    GdiFlush();
    const auto* pixel = static_cast<const unsigned char*>(m_dib.GetDataPtr(x, y));
    return pixel[2] | static_cast<unsigned>(pixel[1]) << 8 | static_cast<unsigned>(pixel[0]) << 16;
  }

 private:
  dDIB m_dib;
  HDC m_dc;
  HGDIOBJ m_old;
};

/// An image in which every pixel has a colour of its own: `PixelOf`.
inline dImage NumberedImage(int width, int height, unsigned short type, const char* sequence,
                            unsigned short alignment = 4) {
  dImage image;
  EXPECT_TRUE(image.Init(static_cast<unsigned long>(width), static_cast<unsigned long>(height),
                         type, sequence, ImageDataOrder_Pixel, alignment));
  image.Fill(0);
  const int channels = image.GetNumChannels();
  for (int y = 0; y < height; ++y) {
    auto* row = static_cast<unsigned char*>(image.GetRowPtr(y));
    for (int x = 0; x < width; ++x) {
      const int number = 1 + x + y * width;
      if (type == ImageDataType_U1) {
        row[x / 8] = static_cast<unsigned char>(row[x / 8] | (number % 3 == 0 ? 128 >> x % 8 : 0));
        continue;
      }
      for (int channel = 0; channel < channels; ++channel) {
        row[x * channels + channel] = static_cast<unsigned char>(number * (channel + 1));
      }
    }
  }
  return image;
}

/// The colour of a pixel of that image, as the device counts colours.
inline unsigned PixelOf(const dImage& image, int x, int y) {
  const auto* row = static_cast<const unsigned char*>(image.GetRowPtr(y));
  if (image.GetDataType() == ImageDataType_U1) {
    return (row[x / 8] >> (7 - x % 8) & 1) != 0 ? 0xFFFFFF : 0;
  }
  if (image.GetNumChannels() == 1) {
    return row[x] * 0x010101U;
  }
  const auto* pixel = row + x * image.GetNumChannels();
  return pixel[2] | static_cast<unsigned>(pixel[1]) << 8 | static_cast<unsigned>(pixel[0]) << 16;
}

inline bool operator==(const tagRECT& a, const tagRECT& b) {
  return a.left == b.left && a.top == b.top && a.right == b.right && a.bottom == b.bottom;
}

inline std::string RectText(const tagRECT& rect) {
  return std::to_string(rect.left) + " " + std::to_string(rect.top) + " " +
         std::to_string(rect.right) + " " + std::to_string(rect.bottom);
}

#endif
