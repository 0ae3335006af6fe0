#include <vorl/Data/dDIB.h>
#include <vorl/IO/File/opDIB2Ima.h>

#include <filesystem>
#include <random>
#include <string>
#include <system_error>

#include "../Fixtures.h"

namespace {

constexpr unsigned long kEdge = 2048;

long Edge() {
  return static_cast<long>(bench::Shrunk(kEdge));
}

/// The name of a file that no other run uses; what is written there is removed at the end.
class ScratchFile {
 public:
  ScratchFile()
      : m_path((std::filesystem::temp_directory_path() /
                (std::string("vorl_bench_") + std::to_string(std::random_device()()) + ".bmp"))
                   .string()) {}
  ScratchFile(const ScratchFile&) = delete;
  ScratchFile& operator=(const ScratchFile&) = delete;
  ~ScratchFile() {
    std::error_code ignored;
    std::filesystem::remove(m_path, ignored);
  }

  const char* Name() const { return m_path.c_str(); }

 private:
  std::string m_path;
};

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
  const ScratchFile file;
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
  const ScratchFile file;
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

void Memcpy24(benchmark::State& state) {
  bench::Memcpy(state, std::uint64_t{3} * bench::Shrunk(kEdge) * bench::Shrunk(kEdge));
}

BENCHMARK(Create)->Name("dDIB/create/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(CreateSmall)->Name("dDIB/create/16x16")->Unit(benchmark::kMicrosecond);
BENCHMARK(Save)->Name("dDIB/save/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(LoadImage24)->Name("opDIB2Ima/load/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(LoadImage8)->Name("opDIB2Ima/load/8bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(LoadBitmap24)->Name("dDIB/load/24bit")->Unit(benchmark::kMicrosecond);
BENCHMARK(Memcpy24)->Name("dDIB/memcpy/24bit")->Unit(benchmark::kMicrosecond);

}  // namespace
