// Times vorl, other libraries and plain loops at the same works. scripts/bench.sh --peers runs it.
#include <benchmark/benchmark.h>

#include "Contest.h"

int main(int argc, char** argv) {
  peers::EnterVorlImages();
  peers::EnterVorlVolumes();
  peers::EnterVorlFiles();
#ifdef PEERS_WITH_OPENCV
  peers::EnterOpenCv();
#endif
#ifdef PEERS_WITH_VTK
  peers::EnterVtkFilters();
  peers::EnterVtkReslice();
#endif
#ifdef PEERS_WITH_LIBYUV
  peers::EnterLibyuv();
#endif
  peers::EnterPlainImages();
  peers::EnterPlainVolumes();
  peers::EnterPlainFiles();
  peers::RegisterBenchmarks();
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) {
    return 1;
  }
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  return 0;
}
