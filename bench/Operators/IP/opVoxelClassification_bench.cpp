// Classifying 512 x 512 x 300 voxels, and listing the highest of them.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <string>

#include "../../Fixtures.h"

namespace {

std::uint64_t VoxelsOf(const dVolume& volume) {
  return static_cast<std::uint64_t>(volume.GetSizeX()) *
         static_cast<std::uint64_t>(volume.GetSizeY()) *
         static_cast<std::uint64_t>(volume.GetSizeZ());
}

void Classify(benchmark::State& state, short algo) {
  opVoxelClassification op;
  op.volume = &bench::Volume();
  op.SelectAlgo(algo);
  bench::Run(state, op);
  const std::uint64_t voxels = VoxelsOf(bench::Volume());
  bench::Report(state, voxels, voxels * sizeof(std::uint16_t));
}

// One voxel in a hundred is listed.
void Select(benchmark::State& state, short algo) {
  dBuffer list;
  opVoxelClassification op;
  op.volume = &bench::Volume();
  op.voxelList = &list;
  op.SelectAlgo(algo);
  op.Run();
  op.SetSelectionLimit(1.0);
  op.SelectAlgo(VoxelClassificationAlgo_Select);
  bench::Run(state, op);
  const std::uint64_t voxels = VoxelsOf(bench::Volume());
  bench::Report(state, voxels, voxels * sizeof(std::uint16_t) + list.GetSize());
}

// Half the bytes of the volume, copied: as many move as a pass reads.
void ClassifyMemcpy(benchmark::State& state) {
  bench::Memcpy(state, VoxelsOf(bench::Volume()));
}

void Register() {
  const std::pair<const char*, short> algos[] = {{"value", VoxelClassificationAlgo_Value},
                                                 {"edge", VoxelClassificationAlgo_Edge}};
  for (const auto& [algoName, algo] : algos) {
    const std::string name = std::string("opVoxelClassification/") + algoName;
    benchmark::RegisterBenchmark(name.c_str(), Classify, algo)->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark((name + "/select").c_str(), Select, algo)
        ->Unit(benchmark::kMillisecond);
  }
  benchmark::RegisterBenchmark("opVoxelClassification/memcpy", ClassifyMemcpy)
      ->Unit(benchmark::kMillisecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
