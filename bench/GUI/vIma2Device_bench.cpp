// Drawing images and the device operations that drawing consists of, onto a screen of 3840 x 2160
// pixels.
#include <vorl/GUI/vIma2Device.h>

#include "../Screen.h"

namespace {

constexpr unsigned long kScreenWidth = 3840;
constexpr unsigned long kScreenHeight = 2160;

using bench::Screen;

template <class Draw>
void Run(benchmark::State& state, const Screen& screen, Draw draw) {
  for (auto _ : state) {
    if (!draw()) {
      state.SkipWithError("the device refused");
      return;
    }
    benchmark::ClobberMemory();
  }
  screen.Report(state);
}

// An image of 512 x 512 pixels, stretched over the screen.
void DrawImage(benchmark::State& state, const char* sequence, bool transparent) {
  dImage image;
  image.Init(bench::Shrunk(512), bench::Shrunk(512), ImageDataType_U8, sequence,
             ImageDataOrder_Pixel, 4);
  bench::Fill(image);
  const Screen screen(kScreenWidth, kScreenHeight);
  const tagRECT target = screen.Rect();
  vIma2Device renderer;
  renderer.Init(&image, nullptr, &target, false, false);
  if (transparent) {
    renderer.EnableTransparency(0UL);
  }
  Run(state, screen, [&] { return renderer.Draw(screen); });
}

// An image of edge x edge pixels without the class around it.
void StretchBits(benchmark::State& state, const char* sequence, unsigned long imageEdge) {
  dImage image;
  image.Init(bench::Shrunk(imageEdge), bench::Shrunk(imageEdge), ImageDataType_U8, sequence,
             ImageDataOrder_Pixel, 4);
  bench::Fill(image);
  dImaDescriptorDIB descriptor(image);
  const Screen screen(kScreenWidth, kScreenHeight);
  const int edge = static_cast<int>(image.GetWidth());
  SetStretchBltMode(screen, COLORONCOLOR);
  Run(state, screen, [&] {
    return StretchDIBits(screen, 0, 0, screen.Width(), screen.Height(), 0, 0, edge, edge,
                         descriptor.GetPixelData(), descriptor.GetHeader(), DIB_RGB_COLORS,
                         SRCCOPY) != 0;
  });
}

void Copy(benchmark::State& state) {
  const Screen source(kScreenWidth, kScreenHeight);
  const Screen screen(kScreenWidth, kScreenHeight);
  Run(state, screen, [&] {
    return BitBlt(screen, 0, 0, screen.Width(), screen.Height(), source, 0, 0, SRCCOPY) != 0;
  });
}

void Invert(benchmark::State& state) {
  const Screen source(kScreenWidth, kScreenHeight);
  const Screen screen(kScreenWidth, kScreenHeight);
  Run(state, screen, [&] {
    return BitBlt(screen, 0, 0, screen.Width(), screen.Height(), source, 0, 0, SRCINVERT) != 0;
  });
}

void Fill(benchmark::State& state) {
  const Screen screen(kScreenWidth, kScreenHeight);
  const HBRUSH brush = CreateSolidBrush(0x302010);
  const tagRECT rect = screen.Rect();
  Run(state, screen, [&] { return FillRect(screen, &rect, brush) != 0; });
  DeleteObject(brush);
}

void Memcpy(benchmark::State& state) {
  bench::Memcpy(state,
                std::uint64_t{4} * bench::Shrunk(kScreenWidth) * bench::Shrunk(kScreenHeight));
}

// A thousand lines over the screen in all directions.
void Lines(benchmark::State& state, int width) {
  const Screen screen(kScreenWidth, kScreenHeight);
  const HPEN pen = CreatePen(PS_SOLID, width, 0x302010);
  const HGDIOBJ old = SelectObject(screen, pen);
  constexpr int kCount = 1000;
  for (auto _ : state) {
    for (int i = 0; i < kCount; ++i) {
      MoveToEx(screen, i * 7919 % screen.Width(), i * 104729 % screen.Height(), nullptr);
      LineTo(screen, i * 1299709 % screen.Width(), i * 15485 % screen.Height());
    }
    benchmark::ClobberMemory();
  }
  state.SetItemsProcessed(state.iterations() * kCount);
  SelectObject(screen, old);
  DeleteObject(pen);
}

BENCHMARK_CAPTURE(DrawImage, 8, "G", false)
    ->Name("vIma2Device/8bit")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(DrawImage, 32, "BGRA", false)
    ->Name("vIma2Device/32bit")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(DrawImage, transparent, "BGR", true)
    ->Name("vIma2Device/24bit/transparent")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(StretchBits, 8, "G", 512)
    ->Name("device/StretchDIBits/8bit")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(StretchBits, 8, "G", 2048)
    ->Name("device/StretchDIBits/8bit/2048")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(StretchBits, 32, "BGRA", 512)
    ->Name("device/StretchDIBits/32bit")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(StretchBits, 32, "BGRA", 2048)
    ->Name("device/StretchDIBits/32bit/2048")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK(Copy)->Name("device/BitBlt/copy")->Unit(benchmark::kMicrosecond);
BENCHMARK(Invert)->Name("device/BitBlt/invert")->Unit(benchmark::kMicrosecond);
BENCHMARK(Fill)->Name("device/FillRect")->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(Lines, 1, 1)->Name("device/LineTo/1")->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(Lines, 5, 5)->Name("device/LineTo/5")->Unit(benchmark::kMicrosecond);
BENCHMARK(Memcpy)->Name("device/memcpy")->Unit(benchmark::kMicrosecond);

}  // namespace
