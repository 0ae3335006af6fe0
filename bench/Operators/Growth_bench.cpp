// Time per sample as volumes and pictures grow, from those that fit into the caches to those that
// do not: it stays level but for what memory adds. Volumes are as deep as wide, up to 256 slices.

#include <vorl/Data/dWindowingLUT.h>
#include <vorl/Operators/IP/opLookup.h>
#include <vorl/Operators/IP/opMPR.h>
#include <vorl/Operators/IP/opVoxelClassification.h>

#include <memory>

#include "../Fixtures.h"

namespace {

constexpr unsigned long kDeepest = 256;

void MakeVolume(dVolume& volume, unsigned long edge) {
  for (unsigned long z = 0; z < bench::Shrunk(std::min(edge, kDeepest)); ++z) {
    dSlice slice;
    bench::MakeImage(slice.GetImage(), edge, ImageDataType_U16);
    volume.AddSlice(slice);
  }
}

// The time of one sample, as the figure to compare down the list.
void ReportGrowth(benchmark::State& state, std::uint64_t samples, std::uint64_t bytes) {
  bench::Report(state, samples, bytes);
  state.counters["per_sample"] =
      benchmark::Counter(static_cast<double>(samples) * static_cast<double>(state.iterations()),
                         benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

// Every voxel once.
void Count(benchmark::State& state) {
  const auto edge = static_cast<unsigned long>(state.range(0));
  dVolume volume;
  MakeVolume(volume, edge);
  opVoxelClassification op;
  op.volume = &volume;
  op.SelectAlgo(VoxelClassificationAlgo_Edge);
  bench::Run(state, op);
  const std::uint64_t voxels =
      std::uint64_t{volume.GetSliceList().size()} * bench::Shrunk(edge) * bench::Shrunk(edge);
  ReportGrowth(state, voxels, voxels * sizeof(std::uint16_t));
}

// An oblique plane through the middle, of one size in volumes that grow, or growing in one volume.
void Reconstruct(benchmark::State& state, unsigned long volumeEdge, unsigned long planeEdge) {
  dVolume volume;
  MakeVolume(volume, volumeEdge);
  dSlice slice;
  bench::MakeImage(slice.GetImage(), planeEdge, ImageDataType_U16);
  // The plane spans the volume's width whatever its own size.
  const double step = static_cast<double>(volume.GetSizeX()) / slice.GetWidth();
  const dVect3D axisX = dVect3D(0.64F, 0.48F, 0.36F) * step;
  const dVect3D axisY = dVect3D(-0.48F, 0.64F, 0.48F) * step;
  dVect3D corner;
  volume.GetVolCenter(corner);
  corner -= axisX * (0.5 * slice.GetWidth());
  corner -= axisY * (0.5 * slice.GetHeight());
  slice.SetCoordinates(corner, axisX, axisY, dVect3D(0, -0.6F, 0.8F));
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  op.SelectAlgo(MPRAlgo_Trilinear);
  bench::Run(state, op);
  const std::uint64_t pixels = slice.GetImage().GetNumDataSamples();
  ReportGrowth(state, pixels, pixels * sizeof(std::uint16_t));
}

void ReconstructFromLarger(benchmark::State& state) {
  Reconstruct(state, static_cast<unsigned long>(state.range(0)), 512);
}

void ReconstructLarger(benchmark::State& state) {
  Reconstruct(state, 256, static_cast<unsigned long>(state.range(0)));
}

// A picture through a windowing table.
void Window(benchmark::State& state) {
  const auto edge = static_cast<unsigned long>(state.range(0));
  dImage source;
  bench::MakeImage(source, edge, ImageDataType_U16);
  dImage target;
  bench::MakeImage(target, edge, ImageDataType_U8);
  dWindowingLUT table;
  table.SetWindow(30000, 20000);
  opLookup op;
  op.m_pSource = &source;
  op.m_pTarget = &target;
  op.m_pLUT = &table;
  bench::Run(state, op);
  const std::uint64_t pixels = source.GetNumDataSamples();
  ReportGrowth(state, pixels, pixels * 3);
}

BENCHMARK(Count)->Name("growth/opVoxelClassification/volume")->RangeMultiplier(2)->Range(64, 1024);
BENCHMARK(ReconstructFromLarger)->Name("growth/opMPR/volume")->RangeMultiplier(2)->Range(64, 1024);
BENCHMARK(ReconstructLarger)->Name("growth/opMPR/plane")->RangeMultiplier(2)->Range(64, 1024);
BENCHMARK(Window)->Name("growth/opLookup/picture")->RangeMultiplier(2)->Range(64, 1024);

}  // namespace
