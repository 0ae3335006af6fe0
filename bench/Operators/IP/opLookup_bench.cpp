#include <vorl/Data/dBCGLUT.h>
#include <vorl/Data/dWindowingLUT.h>
#include <vorl/Operators/IP/opLookup.h>

#include "../../Fixtures.h"

namespace {

constexpr unsigned long kEdge = 2048;

void Lookup(benchmark::State& state, dLUT& lut, unsigned short type) {
  dImage source;
  bench::MakeImage(source, kEdge, type);
  dImage target;
  opLookup op;
  op.m_pSource = &source;
  op.m_pTarget = &target;
  op.m_pLUT = &lut;
  bench::Run(state, op);
  const std::uint64_t samples = source.GetNumDataSamples();
  bench::Report(state, samples, samples * (source.GetChannelDepth() / 8U + 1));
}

void LookupWindow16to8(benchmark::State& state) {
  dWindowingLUT lut;
  lut.SetWindow(30000, 20000);
  Lookup(state, lut, ImageDataType_U16);
}

// A table that does not cover the samples' range.
void LookupShort16to8(benchmark::State& state) {
  dBCGLUT lut;
  Lookup(state, lut, ImageDataType_U16);
}

void Lookup8to8(benchmark::State& state) {
  dBCGLUT lut;
  Lookup(state, lut, ImageDataType_U8);
}

void LookupMemcpy(benchmark::State& state) {
  bench::Memcpy(state, std::uint64_t{bench::Shrunk(kEdge)} * bench::Shrunk(kEdge));
}

BENCHMARK(LookupWindow16to8)->Name("opLookup/16to8/window")->Unit(benchmark::kMicrosecond);
BENCHMARK(LookupShort16to8)->Name("opLookup/16to8/short")->Unit(benchmark::kMicrosecond);
BENCHMARK(Lookup8to8)->Name("opLookup/8to8")->Unit(benchmark::kMicrosecond);
BENCHMARK(LookupMemcpy)->Name("opLookup/memcpy")->Unit(benchmark::kMicrosecond);

}  // namespace
