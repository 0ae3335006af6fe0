// Planes of 512 x 512 pixels out of 512 x 512 x 300 voxels.

#include <vorl/Operators/IP/opMPR.h>

#include <string>

#include "../../Fixtures.h"

namespace {

constexpr unsigned long kEdge = 512;

/// Steps in voxels. Those along z are scaled by slices over columns, so that an upright plane spans
/// the volume.
struct Plane {
  const char* name;
  dVect3D axisX;   ///< per pixel
  dVect3D axisY;   ///< per row
  dVect3D normal;  ///< through the slab; not scaled
};

// Each passes through the middle of the volume.
const Plane kPlanes[] = {{"axial", dVect3D(1, 0, 0), dVect3D(0, 1, 0), dVect3D(0, 0, 16)},
                         {"coronal", dVect3D(1, 0, 0), dVect3D(0, 0, 1), dVect3D(0, 16, 0)},
                         {"sagittal", dVect3D(0, 1, 0), dVect3D(0, 0, 1), dVect3D(16, 0, 0)},
                         {"oblique", dVect3D(0.64F, 0.48F, 0.36F), dVect3D(-0.48F, 0.64F, 0.48F),
                          dVect3D(0, -9.6F, 12.8F)}};

void Place(dSlice& slice, const Plane& plane, const dVolume& volume) {
  const double slices = static_cast<double>(volume.GetSizeZ()) / volume.GetSizeX();
  dVect3D axisX = plane.axisX;
  dVect3D axisY = plane.axisY;
  axisX.Scale(1.0, 1.0, slices);
  axisY.Scale(1.0, 1.0, slices);
  dVect3D corner;
  volume.GetVolCenter(corner);
  corner -= axisX * (0.5 * slice.GetWidth());
  corner -= axisY * (0.5 * slice.GetHeight());
  slice.SetCoordinates(corner, axisX, axisY, plane.normal);
}

void Reconstruct(benchmark::State& state, const Plane& plane, int algo, int depthSteps) {
  dVolume& volume = bench::Volume();
  dSlice slice;
  bench::MakeImage(slice.GetImage(), kEdge, ImageDataType_U16);
  Place(slice, plane, volume);
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

void ReconstructMemcpy(benchmark::State& state) {
  bench::Memcpy(state, bench::Shrunk(kEdge) * bench::Shrunk(kEdge) * sizeof(std::uint16_t));
}

void Register() {
  const std::pair<const char*, int> algos[] = {{"nearest", MPRAlgo_Nearest},
                                               {"trilinear", MPRAlgo_Trilinear}};
  for (const int depthSteps : {0, 16}) {
    for (const auto& [algoName, algo] : algos) {
      for (const Plane& plane : kPlanes) {
        const std::string name = std::string("opMPR/") + (depthSteps != 0 ? "thick16/" : "thin/") +
                                 algoName + "/" + plane.name;
        benchmark::RegisterBenchmark(name.c_str(), Reconstruct, plane, algo, depthSteps)
            ->Unit(benchmark::kMicrosecond);
      }
    }
  }
  benchmark::RegisterBenchmark("opMPR/memcpy", ReconstructMemcpy)->Unit(benchmark::kMicrosecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
