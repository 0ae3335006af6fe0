// Slabs of 16, 64 and 256 voxels, projected onto 512 x 512 pixels, and the whole volume, projected
// along its axes.

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

// Directions through the volume, from face to face, and those of the picture.
struct Depth {
  const char* name;
  dVect3D axisX;
  dVect3D axisY;
  dVect3D normal;
};

const Depth kDepths[] = {{"z", dVect3D(1, 0, 0), dVect3D(0, 1, 0), dVect3D(0, 0, 1)},
                         {"y", dVect3D(1, 0, 0), dVect3D(0, 0, 1), dVect3D(0, 1, 0)},
                         {"x", dVect3D(0, 1, 0), dVect3D(0, 0, 1), dVect3D(1, 0, 0)}};

// A pixel for each voxel of the face, and as many samples as there are voxels behind it.
void ProjectDepth(benchmark::State& state, const Depth& depth, int algo) {
  dVolume& volume = bench::Volume();
  const auto voxels = [&](const dVect3D& axis) {
    return double{axis.x} * volume.GetSizeX() + double{axis.y} * volume.GetSizeY() +
           double{axis.z} * volume.GetSizeZ();
  };
  dSlice slice;
  slice.GetImage().Init(static_cast<unsigned long>(voxels(depth.axisX)),
                        static_cast<unsigned long>(voxels(depth.axisY)), ImageDataType_U16, "G",
                        ImageDataOrder_Pixel, 1);
  const dVect3D thickness = depth.normal * voxels(depth.normal);
  slice.SetCoordinates(thickness * 0.5, depth.axisX, depth.axisY, thickness);
  opMIP op;
  op.volume = &volume;
  op.mipSlice = &slice;
  op.SelectAlgo(algo);
  bench::Run(state, op);

  const std::uint64_t pixels = slice.GetImage().GetNumDataSamples();
  const auto samples = pixels * static_cast<std::uint64_t>(voxels(depth.normal));
  bench::Report(state, samples, (samples + pixels) * sizeof(std::uint16_t));
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
  for (const int depthSteps : {16, 64, 256}) {
    for (const auto& [algoName, algo] : algos) {
      for (const Plane& plane : bench::kPlanes) {
        const std::string name =
            "opMIP/slab" + std::to_string(depthSteps) + "/" + algoName + "/" + plane.name;
        benchmark::RegisterBenchmark(name.c_str(), Project, plane, algo, depthSteps)
            ->Unit(benchmark::kMicrosecond);
      }
    }
  }
  for (const auto& [algoName, algo] : algos) {
    for (const Depth& depth : kDepths) {
      const std::string name = std::string("opMIP/depth/") + algoName + "/" + depth.name;
      benchmark::RegisterBenchmark(name.c_str(), ProjectDepth, depth, algo)
          ->Unit(benchmark::kMicrosecond);
    }
  }
  benchmark::RegisterBenchmark("opMIP/list", ProjectList)->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("opMIP/memcpy", bench::PlaneMemcpy)->Unit(benchmark::kMicrosecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
