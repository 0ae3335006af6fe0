// Drawing into a plane of 512 x 512 pixels through its depth buffer.

#include <vorl/Operators/IP/opSliceProjection.h>

#include <string>

#include "../../Planes.h"

namespace {

using bench::Plane;

/// An operator with its plane, ready to draw the volume.
struct Drawing {
  explicit Drawing(const Plane& place) {
    bench::MakePlane(plane, place, bench::Volume(), 1.0 / 16.0);
    op.volume = &bench::Volume();
    op.projectionPlane = &plane;
    op.InitZBuffer();
    op.ClearProjectionPlane();
  }

  dSlice plane;
  opSliceProjection op;
};

// Each iteration begins with a fresh depth buffer, so that every pixel is drawn.
void DrawSlice(benchmark::State& state, const Plane& place) {
  Drawing drawing(place);
  dSlice slice(drawing.plane);
  drawing.op.slice = &slice;
  drawing.op.SelectAlgo(SliceProjectionAlgo_Slice);
  for (auto _ : state) {
    if (!drawing.op.InitZBuffer() || !drawing.op.Run()) {
      state.SkipWithError(static_cast<const char*>(drawing.op.GetStatus()));
      return;
    }
    benchmark::ClobberMemory();
  }
  const std::uint64_t pixels = slice.GetImage().GetNumDataSamples();
  bench::Report(state, pixels, 5 * pixels * sizeof(std::uint16_t));
}

void DrawHiddenSlice(benchmark::State& state, const Plane& place) {
  Drawing drawing(place);
  dSlice slice(drawing.plane);
  drawing.op.zBuffer.Fill(0);
  drawing.op.slice = &slice;
  drawing.op.SelectAlgo(SliceProjectionAlgo_Slice);
  bench::Run(state, drawing.op);
  const std::uint64_t pixels = slice.GetImage().GetNumDataSamples();
  bench::Report(state, pixels, pixels * sizeof(std::uint16_t));
}

// Counts rays; upright ones pass through 300 or 512 voxels.
void DrawVolume(benchmark::State& state, const Plane& place) {
  Drawing drawing(place);
  drawing.op.SelectAlgo(SliceProjectionAlgo_Volume);
  bench::Run(state, drawing.op);
  const std::uint64_t pixels = drawing.plane.GetImage().GetNumDataSamples();
  bench::Report(state, pixels, 3 * pixels * sizeof(std::uint16_t));
}

void DrawVoxels(benchmark::State& state, const Plane& place) {
  Drawing drawing(place);
  dBuffer list;
  bench::MakeList(list, bench::Volume());
  drawing.op.voxelList = &list;
  drawing.op.SelectAlgo(SliceProjectionAlgo_VoxelList);
  bench::Run(state, drawing.op);
  bench::Report(state, list.GetSize() / 4, 2UL * list.GetSize());
}

void Register() {
  using Benchmark = void (*)(benchmark::State&, const Plane&);
  const std::pair<const char*, Benchmark> objects[] = {{"slice", DrawSlice},
                                                       {"hiddenSlice", DrawHiddenSlice},
                                                       {"volume", DrawVolume},
                                                       {"list", DrawVoxels}};
  for (const auto& [objectName, object] : objects) {
    for (const Plane& plane : bench::kPlanes) {
      const std::string name = std::string("opSliceProjection/") + objectName + "/" + plane.name;
      benchmark::RegisterBenchmark(name.c_str(), object, plane)->Unit(benchmark::kMicrosecond);
    }
  }
  benchmark::RegisterBenchmark("opSliceProjection/memcpy", bench::PlaneMemcpy)
      ->Unit(benchmark::kMicrosecond);
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
