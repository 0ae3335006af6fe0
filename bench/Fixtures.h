#ifndef BENCH_FIXTURES_H
#define BENCH_FIXTURES_H

/// @file
/// What the benchmarks share: images, a volume, and how a throughput is reported.
///
/// Throughputs count the samples that an operator takes and the bytes that it reads and writes. A
/// memcpy over as much memory stands beside each, as the bound that memory sets.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dVolume.h>

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <vector>

namespace bench {

/// A size, divided by the environment variable VORL_BENCH_SHRINK: for runs that only show that the
/// benchmarks work.
inline unsigned long Shrunk(unsigned long size) {
  const char* text = std::getenv("VORL_BENCH_SHRINK");
  const unsigned long divisor = text != nullptr ? std::strtoul(text, nullptr, 10) : 1;
  return std::max(size / std::max(divisor, 1UL), 1UL);
}

/// Fills the image with noise: no run of equal samples for caches or branches to profit from.
inline void Fill(dImage& image) {
  auto* bytes = static_cast<unsigned char*>(image.GetDataPtr());
  std::uint32_t state = 12345;
  for (unsigned long i = 0; i < image.GetImageSize(); ++i) {
    state = state * 1664525U + 1013904223U;
    bytes[i] = static_cast<unsigned char>(state >> 24);
  }
}

/// A square one-channel image of noise.
inline void MakeImage(dImage& image, unsigned long edge, unsigned short type) {
  image.Init(Shrunk(edge), Shrunk(edge), type, "G", ImageDataOrder_Pixel, 1);
  Fill(image);
}

/// 512 x 512 x 300 voxels of 16 bits, of which 12 are used as by a scanner, made once.
inline dVolume& Volume() {
  static dVolume* const volume = [] {
    static dVolume made;
    for (unsigned long z = 0; z < Shrunk(300); ++z) {
      dSlice slice;
      dImage& image = slice.GetImage();
      MakeImage(image, 512, ImageDataType_U16);
      auto* const voxels = static_cast<unsigned short*>(image.GetDataPtr());
      std::for_each(voxels, voxels + image.GetNumDataSamples(),
                    [](unsigned short& voxel) { voxel &= 0xFFF; });
      made.AddSlice(slice);
    }
    return &made;
  }();
  return *volume;
}

/// Reports what one iteration takes and moves.
inline void Report(benchmark::State& state, std::uint64_t samples, std::uint64_t bytes) {
  const auto iterations = static_cast<std::uint64_t>(state.iterations());
  state.SetItemsProcessed(static_cast<std::int64_t>(iterations * samples));
  state.SetBytesProcessed(static_cast<std::int64_t>(iterations * bytes));
}

/// Runs the operator as the benchmark's loop.
inline void Run(benchmark::State& state, OpBase& op) {
  for (auto _ : state) {
    if (!op.Run()) {
      state.SkipWithError(static_cast<const char*>(op.GetStatus()));
      return;
    }
    benchmark::ClobberMemory();
  }
}

/// Copies `bytes` bytes from one block to another: as many are read as written.
inline void Memcpy(benchmark::State& state, std::uint64_t bytes) {
  std::vector<unsigned char> source(bytes, 1);
  std::vector<unsigned char> target(bytes, 2);
  for (auto _ : state) {
    std::memcpy(target.data(), source.data(), bytes);
    benchmark::DoNotOptimize(target.data());
    benchmark::ClobberMemory();
  }
  Report(state, bytes, 2 * bytes);
}

}  // namespace bench

#endif
