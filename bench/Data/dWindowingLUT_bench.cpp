// Building the 65,536 entries of a windowing table, as each drag of the window does.
#include <vorl/Data/dWindowingLUT.h>

#include "../Fixtures.h"

namespace {

void Build(benchmark::State& state, int width) {
  dWindowingLUT table;
  int center = 1000;
  for (auto _ : state) {
    center ^= 1;
    table.SetWindow(center, width);
    benchmark::DoNotOptimize(table.GetLUT(0));
  }
  bench::Report(state, 65536, 65536);
}

BENCHMARK_CAPTURE(Build, narrow, 400)
    ->Name("dWindowingLUT/build/400")
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(Build, wide, 65536)
    ->Name("dWindowingLUT/build/65536")
    ->Unit(benchmark::kMicrosecond);

}  // namespace
