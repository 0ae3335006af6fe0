#include <vorl/Data/dDIB.h>
#include <vorl/IO/File/opDIB2Ima.h>

#include <cstdio>
#include <memory>

#include "../Fixtures.h"
#include "../ScratchFile.h"

namespace {

constexpr unsigned long kEdge = 2048;

long Edge() {
  return static_cast<long>(bench::Shrunk(kEdge));
}

void ReportPixels(benchmark::State& state, const dImage& image) {
  bench::Report(state, image.GetWidth() * image.GetHeight(), image.GetImageSize());
}

// A section of zeros and its description.
void Create(benchmark::State& state) {
  dDIB dib;
  for (auto _ : state) {
    if (!dib.Init(Edge(), Edge(), 3, 8)) {
      state.SkipWithError(static_cast<const char*>(dib.GetStatus()));
      return;
    }
    benchmark::DoNotOptimize(dib.GetDataPtr());
  }
  ReportPixels(state, dib);
}

// A small one: what the objects cost, without the pixels.
void CreateSmall(benchmark::State& state) {
  for (auto _ : state) {
    dDIB dib(16, 16, 3, 8);
    benchmark::DoNotOptimize(dib.GetDataPtr());
  }
}

void Save(benchmark::State& state) {
  const bench::ScratchFile file(".bmp");
  dDIB dib(Edge(), Edge(), 3, 8);
  bench::Fill(dib);
  for (auto _ : state) {
    if (!dib.Save(file.Name(), true)) {
      state.SkipWithError(static_cast<const char*>(dib.GetStatus()));
      return;
    }
  }
  ReportPixels(state, dib);
}

// `target` is formatted once: later loads reuse its pixels if it is a plain image.
void Load(benchmark::State& state, dImage& target, short channels) {
  const bench::ScratchFile file(".bmp");
  dDIB dib(Edge(), Edge(), channels, 8);
  bench::Fill(dib);
  dib.Save(file.Name(), true);
  opDIB2Ima reader;
  for (auto _ : state) {
    if (!reader.Convert(file.Name(), target)) {
      state.SkipWithError(static_cast<const char*>(reader.GetStatus()));
      return;
    }
    benchmark::ClobberMemory();
  }
  ReportPixels(state, target);
}

void LoadImage24(benchmark::State& state) {
  dImage image;
  Load(state, image, 3);
}

void LoadImage8(benchmark::State& state) {
  dImage image;
  Load(state, image, 1);
}

void LoadBitmap24(benchmark::State& state) {
  dDIB bitmap;
  Load(state, bitmap, 3);
}

// The class's own reader, into a new section each time.
void Open(benchmark::State& state) {
  const bench::ScratchFile file(".bmp");
  dDIB dib(Edge(), Edge(), 3, 8);
  bench::Fill(dib);
  dib.Save(file.Name(), true);
  dDIB opened;
  for (auto _ : state) {
    if (!opened.Init(file.Name())) {
      state.SkipWithError(static_cast<const char*>(opened.GetStatus()));
      return;
    }
    benchmark::ClobberMemory();
  }
  ReportPixels(state, opened);
}

// As many bytes without the format: what the file system takes.
void WriteRaw(benchmark::State& state) {
  const bench::ScratchFile file(".raw");
  dDIB dib(Edge(), Edge(), 3, 8);
  bench::Fill(dib);
  for (auto _ : state) {
    std::FILE* const raw = std::fopen(file.Name(), "wb");
    if (raw == nullptr || std::fwrite(dib.GetDataPtr(), dib.GetImageSize(), 1, raw) != 1) {
      state.SkipWithError("cannot write");
      return;
    }
    std::fclose(raw);
  }
  ReportPixels(state, dib);
}

void ReadRaw(benchmark::State& state) {
  const bench::ScratchFile file(".raw");
  dDIB dib(Edge(), Edge(), 3, 8);
  bench::Fill(dib);
  dib.Save(file.Name(), true);
  for (auto _ : state) {
    std::FILE* const raw = std::fopen(file.Name(), "rb");
    if (raw == nullptr || std::fread(dib.GetDataPtr(), dib.GetImageSize(), 1, raw) != 1) {
      state.SkipWithError("cannot read");
      return;
    }
    std::fclose(raw);
    benchmark::ClobberMemory();
  }
  ReportPixels(state, dib);
}

void Memcpy24(benchmark::State& state) {
  bench::Memcpy(state, std::uint64_t{3} * bench::Shrunk(kEdge) * bench::Shrunk(kEdge));
}

BENCHMARK(Create)->Name("dDIB/create/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(CreateSmall)->Name("dDIB/create/16x16")->Unit(benchmark::kMicrosecond);
BENCHMARK(Save)->Name("dDIB/save/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(LoadImage24)->Name("opDIB2Ima/load/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(LoadImage8)->Name("opDIB2Ima/load/8bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(LoadBitmap24)->Name("dDIB/load/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(Open)->Name("dDIB/open/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(WriteRaw)->Name("dDIB/fwrite/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(ReadRaw)->Name("dDIB/fread/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(Memcpy24)->Name("dDIB/memcpy/24bit")->Unit(benchmark::kMicrosecond);

}  // namespace
