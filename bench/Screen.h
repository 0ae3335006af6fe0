#ifndef BENCH_SCREEN_H
#define BENCH_SCREEN_H

/// @file
/// What the benchmarks of drawing draw on.

#include <vorl/Data/dDIB.h>

#include "Fixtures.h"

namespace bench {

/// A bitmap of 32 bits, selected into a context.
class Screen {
 public:
  Screen(unsigned long width, unsigned long height)
      : m_dib(static_cast<long>(Shrunk(width)), static_cast<long>(Shrunk(height)), 4, 8),
        m_dc(CreateCompatibleDC(nullptr)),
        m_old(SelectObject(m_dc, m_dib.GetHandle())) {}
  Screen(const Screen&) = delete;
  Screen& operator=(const Screen&) = delete;
  ~Screen() {
    SelectObject(m_dc, m_old);
    DeleteDC(m_dc);
  }
  operator HDC() const { return m_dc; }

  int Width() const { return static_cast<int>(m_dib.GetWidth()); }
  int Height() const { return static_cast<int>(m_dib.GetHeight()); }
  tagRECT Rect() const { return {0, 0, Width(), Height()}; }
  /// Each iteration wrote every pixel.
  void Report(benchmark::State& state) const {
    bench::Report(state, m_dib.GetWidth() * m_dib.GetHeight(), m_dib.GetImageSize());
  }

 private:
  dDIB m_dib;
  HDC m_dc;
  HGDIOBJ m_old;
};

}  // namespace bench

#endif
