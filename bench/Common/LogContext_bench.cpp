// What the log context costs that every method makes, while no target listens.
#include <vorl/Common/LogContext.h>

#include <benchmark/benchmark.h>

namespace {

void Open(benchmark::State& state, const char* title) {
  for (auto _ : state) {
    LogContext context(title, __FILE__, __LINE__, true);
    benchmark::DoNotOptimize(&context);
  }
  state.SetItemsProcessed(state.iterations());
}

BENCHMARK_CAPTURE(Open, short, "dImage::Init")->Name("LogContext/open");
BENCHMARK_CAPTURE(Open, long, "opVoxelClassification::Prepare")->Name("LogContext/open/long title");

}  // namespace
