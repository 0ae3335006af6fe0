#ifndef VORL_TESTS_DATA_DIBTESTING_H
#define VORL_TESTS_DATA_DIBTESTING_H

#include <vorl/Data/dDIB.h>

#include <gtest/gtest.h>

#include <cstring>
#include <string>

/// Text of an object's status.
template <class Object>
std::string StatusText(const Object& object) {
  return static_cast<const char*>(object.GetStatus());
}

/// Fills the pixels, padding included, with bytes that differ from their neighbours.
inline void FillWithCount(dImage& image) {
  auto* bytes = static_cast<unsigned char*>(image.GetDataPtr());
  for (unsigned long i = 0; i < image.GetImageSize(); ++i) {
    bytes[i] = static_cast<unsigned char>(i * 7 + 1);
  }
}

/// True when all pixels, padding left out, are equal.
inline bool SamePixels(const dImage& a, const dImage& b) {
  if (a.GetWidth() != b.GetWidth() || a.GetHeight() != b.GetHeight() ||
      a.GetColumnOffset() != b.GetColumnOffset()) {
    return false;
  }
  const std::size_t bytes = (a.GetWidth() * a.GetColumnOffset() + 7) / 8;
  for (int y = 0; y < static_cast<int>(a.GetHeight()); ++y) {
    if (std::memcmp(a.GetRowPtr(y), b.GetRowPtr(y), bytes) != 0) {
      return false;
    }
  }
  return true;
}

/// A memory device context with a bitmap selected, for the length of a scope.
class SelectedBitmap {
 public:
  explicit SelectedBitmap(HBITMAP bitmap)
      : m_dc(CreateCompatibleDC(nullptr)), m_old(SelectObject(m_dc, bitmap)) {
    EXPECT_NE(m_old, nullptr);
  }
  SelectedBitmap(const SelectedBitmap&) = delete;
  SelectedBitmap& operator=(const SelectedBitmap&) = delete;
  ~SelectedBitmap() {
    SelectObject(m_dc, m_old);
    DeleteDC(m_dc);
  }
  operator HDC() const { return m_dc; }

 private:
  HDC m_dc;
  HGDIOBJ m_old;
};

/// True when what is drawn into the handle shows in the pixels: the one at (0, 0) becomes white.
inline bool ShowsItsSection(dDIB& dib) {
  auto* first = static_cast<unsigned char*>(dib.GetDataPtr());
  first[0] = 0;
  {
    const SelectedBitmap dc(dib.GetHandle());
    SetPixel(dc, 0, 0, 0xFFFFFF);
    GdiFlush();
  }
  return (first[0] & 0x80) != 0;
}

#endif
