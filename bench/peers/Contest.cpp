#include "Contest.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

#if defined(__x86_64__)
#include <immintrin.h>
#endif

namespace peers {
namespace {

struct Entry {
  Work work;
  std::string name;
  std::function<Contender()> prepare;
};

std::vector<Entry>& Entries() {
  static std::vector<Entry> entries;
  return entries;
}

#if defined(__x86_64__)
__attribute__((target("avx"))) void ClearUpperHalves() {
  _mm256_zeroupper();
}

/// Whoever returns with used upper halves of the vector registers slows down what follows and is
/// built without AVX, severalfold on some processors. Each contender is to pay for its own ones.
void ClearRegisters() {
  if (__builtin_cpu_supports("avx")) {
    ClearUpperHalves();
  }
}
#else
void ClearRegisters() {}
#endif

/// The contender whose turn it is. A benchmark is called several times, until it has found out how
/// often to iterate.
const Contender& Prepared(const Entry& entry) {
  static const Entry* owner = nullptr;
  static Contender contender;
  if (owner != &entry) {
    contender = Contender();  // before the next one asks for memory
    contender = entry.prepare();
    owner = &entry;
  }
  return contender;
}

void Time(benchmark::State& state, const Entry& entry) {
  ClearRegisters();
  const Contender& contender = Prepared(entry);
  if (!contender.run()) {
    state.SkipWithError("fails");
    return;
  }
  const std::string wrong = contender.check();
  if (!wrong.empty()) {
    state.SkipWithError(wrong.c_str());
    return;
  }
  ClearRegisters();
  for (auto _ : state) {
    if (!contender.run()) {
      state.SkipWithError("fails");
      return;
    }
    benchmark::ClobberMemory();
  }
  const double samples = entry.work.samples * static_cast<double>(state.iterations());
  state.SetItemsProcessed(static_cast<std::int64_t>(samples));
}

}  // namespace

void Enter(const Work& work, const std::string& name, std::function<Contender()> prepare) {
  Entries().push_back({work, name, std::move(prepare)});
}

void RegisterBenchmarks() {
  std::vector<Entry>& entries = Entries();
  std::vector<std::string> order;
  for (const Entry& entry : entries) {
    if (std::find(order.begin(), order.end(), entry.work.name) == order.end()) {
      order.push_back(entry.work.name);
    }
  }
  for (const std::string& work : order) {
    for (const Entry& entry : entries) {
      if (entry.work.name == work) {
        benchmark::RegisterBenchmark((work + "/" + entry.name).c_str(),
                                     [&entry](benchmark::State& state) { Time(state, entry); })
            ->MeasureProcessCPUTime()
            ->Unit(benchmark::kMicrosecond);
      }
    }
  }
}

}  // namespace peers
