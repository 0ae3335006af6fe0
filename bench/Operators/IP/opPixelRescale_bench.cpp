#include <vorl/Operators/IP/opPixelRescale.h>

#include "../../Fixtures.h"

namespace {

constexpr unsigned long kEdge = 2048;

void Rescale(benchmark::State& state, unsigned short type) {
  dImage source;
  bench::MakeImage(source, kEdge, type);
  dImage target;
  opPixelRescale op;
  op.m_pSource = &source;
  op.m_pTarget = &target;
  op.m_factor = 1.7;  // saturates a part of the samples
  op.m_offset = -20.0;
  bench::Run(state, op);
  bench::Report(state, source.GetNumDataSamples(), 2 * std::uint64_t{source.GetImageSize()});
}

void RescaleMemcpy(benchmark::State& state, std::uint64_t sampleBytes) {
  bench::Memcpy(state, bench::Shrunk(kEdge) * bench::Shrunk(kEdge) * sampleBytes);
}

void Register() {
  const std::pair<const char*, unsigned short> types[] = {
      {"opPixelRescale/U8", ImageDataType_U8},
      {"opPixelRescale/S8", ImageDataType_S8},
      {"opPixelRescale/U16", ImageDataType_U16},
      {"opPixelRescale/S16", ImageDataType_S16}};
  for (const auto& [name, type] : types) {
    benchmark::RegisterBenchmark(name, Rescale, type)->Unit(benchmark::kMicrosecond);
  }
  benchmark::RegisterBenchmark("opPixelRescale/memcpy/8", RescaleMemcpy, 1)
      ->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opPixelRescale/memcpy/16", RescaleMemcpy, 2)
      ->Unit(benchmark::kMicrosecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
