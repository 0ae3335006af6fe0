#include <vorl/Operators/IP/opMinMax.h>

#include <limits>

#include "../../Fixtures.h"

namespace {

constexpr unsigned long kEdge = 2048;

void MinMax(benchmark::State& state, unsigned short type) {
  dImage source;
  bench::MakeImage(source, kEdge, type);
  opMinMax op;
  op.m_pSource = &source;
  bench::Run(state, op);
  bench::Report(state, source.GetNumDataSamples(), source.GetImageSize());
}

// Slice by slice, each extending the result of those before it.
void MinMaxVolume(benchmark::State& state) {
  dVolume& volume = bench::Volume();
  for (auto _ : state) {
    std::int32_t minimum = std::numeric_limits<std::int32_t>::max();
    std::int32_t maximum = std::numeric_limits<std::int32_t>::min();
    opMinMax op;
    for (dSlice& slice : volume.GetSliceList()) {
      if (!op.Run(&slice.GetImage(), minimum, maximum)) {
        state.SkipWithError(static_cast<const char*>(op.GetStatus()));
        return;
      }
    }
    benchmark::DoNotOptimize(minimum);
    benchmark::DoNotOptimize(maximum);
  }
  const dImage& first = volume.GetSliceList().front().GetImage();
  const auto count = static_cast<std::uint64_t>(volume.GetSliceCount());
  bench::Report(state, count * first.GetNumDataSamples(), count * first.GetImageSize());
}

// Half the bytes of the 16-bit image, copied: as many move as the search reads.
void MinMaxMemcpy(benchmark::State& state) {
  bench::Memcpy(state, std::uint64_t{bench::Shrunk(kEdge)} * bench::Shrunk(kEdge));
}

void MinMaxVolumeMemcpy(benchmark::State& state) {
  bench::Memcpy(state, std::uint64_t{bench::Shrunk(512)} * bench::Shrunk(512) * bench::Shrunk(300));
}

void Register() {
  benchmark::RegisterBenchmark("opMinMax/U8", MinMax, ImageDataType_U8)
      ->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opMinMax/S16", MinMax, ImageDataType_S16)
      ->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opMinMax/U16", MinMax, ImageDataType_U16)
      ->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opMinMax/memcpy", MinMaxMemcpy)->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opMinMax/U16/volume", MinMaxVolume)->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opMinMax/memcpy/volume", MinMaxVolumeMemcpy)
      ->Unit(benchmark::kMicrosecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
