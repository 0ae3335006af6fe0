// Slabs of 16 and of 256 voxels, projected onto 512 x 512 pixels.

#include <vorl/Operators/IP/opMIP.h>

#include <string>

#include "../../Planes.h"

namespace {

using bench::Plane;

void Project(benchmark::State& state, const Plane& plane, int algo, int depthSteps) {
  dVolume& volume = bench::Volume();
  dSlice slice;
  bench::MakePlane(slice, plane, volume, depthSteps / 16.0);
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  op.SelectAlgo(algo);
  op.SetDepthSteps(depthSteps);
  bench::Run(state, op);

  const std::uint64_t pixels = slice.GetImage().GetNumDataSamples();
  const std::uint64_t samples = pixels * static_cast<std::uint64_t>(depthSteps);
  const std::uint64_t voxels = samples * (algo == MIPAlgo_Trilinear ? 8 : 1);
  bench::Report(state, samples, (voxels + pixels) * sizeof(std::uint16_t));
}

// A million voxels, none of which is drawn: the price of looking at them.
void ProjectList(benchmark::State& state) {
  dVolume& volume = bench::Volume();
  dSlice slice;
  bench::MakePlane(slice, bench::kPlanes[0], volume);
  dBuffer list;
  bench::MakeList(list, volume);
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  op.voxelList = &list;
  op.SelectAlgo(MIPAlgo_VoxelList);
  bench::Run(state, op);
  bench::Report(state, list.GetSize() / 4, list.GetSize());
}

void Register() {
  const std::pair<const char*, int> algos[] = {{"nearest", MIPAlgo_Nearest},
                                               {"trilinear", MIPAlgo_Trilinear}};
  for (const int depthSteps : {16, 256}) {
    for (const auto& [algoName, algo] : algos) {
      for (const Plane& plane : bench::kPlanes) {
        const std::string name =
            "opMIP/slab" + std::to_string(depthSteps) + "/" + algoName + "/" + plane.name;
        benchmark::RegisterBenchmark(name.c_str(), Project, plane, algo, depthSteps)
            ->Unit(benchmark::kMicrosecond);
      }
    }
  }
  benchmark::RegisterBenchmark("opMIP/list", ProjectList)->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opMIP/memcpy", bench::PlaneMemcpy)->Unit(benchmark::kMicrosecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
