// Planes of 512 x 512 pixels out of 512 x 512 x 300 voxels.

#include <vorl/Operators/IP/opMPR.h>

#include <algorithm>
#include <string>

#include "../../Planes.h"

namespace {

using bench::Plane;

void Reconstruct(benchmark::State& state, const Plane& plane, int algo, int depthSteps) {
  dVolume& volume = bench::Volume();
  dSlice slice;
  bench::MakePlane(slice, plane, volume, std::max(depthSteps, 16) / 16.0);
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  op.SelectAlgo(algo);
  op.SetDepthSteps(depthSteps);
  bench::Run(state, op);

  const std::uint64_t pixels = slice.GetImage().GetNumDataSamples();
  const std::uint64_t samples = pixels * static_cast<std::uint64_t>(std::max(depthSteps, 1));
  const std::uint64_t voxels = samples * (algo == MPRAlgo_Trilinear ? 8 : 1);
  bench::Report(state, samples, (voxels + pixels) * sizeof(std::uint16_t));
}

void Register() {
  const std::pair<const char*, int> algos[] = {{"nearest", MPRAlgo_Nearest},
                                               {"trilinear", MPRAlgo_Trilinear}};
  for (const int depthSteps : {0, 16, 64}) {
    for (const auto& [algoName, algo] : algos) {
      for (const Plane& plane : bench::kPlanes) {
        const std::string name = "opMPR/" +
                                 (depthSteps != 0 ? "thick" + std::to_string(depthSteps) : "thin") +
                                 "/" + algoName + "/" + plane.name;
        benchmark::RegisterBenchmark(name.c_str(), Reconstruct, plane, algo, depthSteps)
            ->Unit(benchmark::kMicrosecond);
      }
    }
  }
  benchmark::RegisterBenchmark("opMPR/memcpy", bench::PlaneMemcpy)->Unit(benchmark::kMicrosecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
