// 1. Prepare checks the inputs.
// 2. Process picks the worker for algorithm, data type and thickness.
// 3. A worker carries the output plane into voxel coordinates (SlicePlane), looks at the volume's
//    pixels through a validated view (VolumeView), and walks the output rows. A row is done by the
//    kernels of the active variant (RowSampler, SlabBands) or, where those do not apply, by the
//    plain loop (Mpr.h) with a sampler (Sampling.h).

#include <vorl/Operators/IP/opMPR.h>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Operators/IP/kernels/Mpr.h>
#include <vorl/Operators/IP/kernels/PlaneLoop.h>
#include <vorl/Operators/IP/kernels/RowSampler.h>
#include <vorl/Operators/IP/kernels/SamplingCheck.h>
#include <vorl/Operators/IP/kernels/SlabBands.h>

inline namespace vorl {

using vorl_detail::FixedVector;
using vorl_detail::NearestSampler;
using vorl_detail::SlabSamples;
using vorl_detail::TrilinearSampler;
using vorl_detail::VolumeView;

namespace {

constexpr char kSliceName[] = "MPR Slice";

}  // namespace

VORL_REGISTER_CLASS(opMPR, OpBase);

opMPR::opMPR() {
  opMPR::Reset();
}

opMPR::opMPR(const opMPR& source) = default;
opMPR& opMPR::operator=(const opMPR& source) = default;

opMPR::~opMPR() {
  Terminate();
  opMPR::Reset();
}

bool opMPR::Reset() {
  mprSlice = nullptr;
  volume = nullptr;
  algoID = MPRAlgo_Nearest;
  depthSteps = 0;
  return true;
}

void opMPR::SelectAlgo(int id) {
  algoID = id;
}

void opMPR::SetDepthSteps(int count) {
  depthSteps = count;
}

bool opMPR::Prepare() {
  if (!vorl_detail::CheckSampling(volume, mprSlice, kSliceName, m_status)) {
    return false;
  }
  m_status = true;
  return m_stopRequested ? Stopped() : true;
}

bool opMPR::Process() {
  if (algoID != MPRAlgo_Trilinear && algoID != MPRAlgo_Nearest) {
    m_status.Set(false, "invalid MPR Algo ID: %d", algoID);
    return false;
  }
  if (!vorl_detail::CheckSampleType(*volume, m_status)) {
    return false;
  }
  using Worker = bool (opMPR::*)(dVolume&, dSlice&);
  static constexpr Worker kWorkers[2][2][2] = {
      {{&opMPR::MPRThinNearestU16, &opMPR::MPRThickNearestU16},
       {&opMPR::MPRThinTrilinearU16, &opMPR::MPRThickTrilinearU16}},
      {{&opMPR::MPRThinNearestS16, &opMPR::MPRThickNearestS16},
       {&opMPR::MPRThinTrilinearS16, &opMPR::MPRThickTrilinearS16}}};
  const Worker worker = kWorkers[volume->GetDataType() == ImageDataType_S16 ? 1 : 0]
                                [algoID == MPRAlgo_Trilinear ? 1 : 0][depthSteps != 0 ? 1 : 0];
  const bool ok = (this->*worker)(*volume, *mprSlice);
  return m_stopRequested ? Stopped() : ok;
}

template <class T, class Sampler>
bool opMPR::Reconstruct(dVolume& source, dSlice& target, bool thick) {
  const VolumeView view(source);
  if (!vorl_detail::CheckSamples(view, target, kSliceName, m_status)) {
    return false;
  }
  const Sampler sampler(view);
  const vorl_detail::SlicePlane plane(target, source.GetCoordinates(),
                                      thick ? vorl_detail::kSlabBegin : 0.0);
  const SlabSamples slab(plane.depthStep, depthSteps);
  vorl_detail::RowSampler<T> rows(view, algoID == MPRAlgo_Trilinear, vorl_detail::ActiveVariant());
  vorl_detail::SlabBands<T> bands(rows, plane, slab, vorl_detail::RowSink::Sum, m_stopRequested);
  const std::size_t height = target.GetImage().GetHeight();
  std::size_t index = 0;
  const auto row = [&](FixedVector& point, T* pixels, std::size_t width) {
    const bool isDone = thick ? bands.Row(index++, height, point, pixels, width)
                              : rows.Thin(point, plane.columnStep, pixels, width);
    if (isDone) {
      point += plane.columnStep.Times(static_cast<std::int32_t>(width));
    } else if (thick) {
      MprThickRowRef(view, sampler, slab, point, plane.columnStep, pixels, width);
    } else {
      MprThinRowRef(view, sampler, point, plane.columnStep, pixels, width);
    }
    return !bands.HasLeftRow();
  };
  vorl_detail::ForEachPlaneRow<T>({m_stopRequested, m_progress, HasThread()}, target, plane, row);
  return true;
}

bool opMPR::MPRThinNearestU16(dVolume& source, dSlice& target) {
  return Reconstruct<std::uint16_t, NearestSampler<std::uint16_t>>(source, target, false);
}

bool opMPR::MPRThickNearestU16(dVolume& source, dSlice& target) {
  return Reconstruct<std::uint16_t, NearestSampler<std::uint16_t>>(source, target, true);
}

bool opMPR::MPRThinTrilinearU16(dVolume& source, dSlice& target) {
  return Reconstruct<std::uint16_t, TrilinearSampler<std::uint16_t>>(source, target, false);
}

bool opMPR::MPRThickTrilinearU16(dVolume& source, dSlice& target) {
  return Reconstruct<std::uint16_t, TrilinearSampler<std::uint16_t>>(source, target, true);
}

bool opMPR::MPRThinNearestS16(dVolume& source, dSlice& target) {
  return Reconstruct<std::int16_t, NearestSampler<std::int16_t>>(source, target, false);
}

bool opMPR::MPRThickNearestS16(dVolume& source, dSlice& target) {
  return Reconstruct<std::int16_t, NearestSampler<std::int16_t>>(source, target, true);
}

bool opMPR::MPRThinTrilinearS16(dVolume& source, dSlice& target) {
  return Reconstruct<std::int16_t, TrilinearSampler<std::int16_t>>(source, target, false);
}

bool opMPR::MPRThickTrilinearS16(dVolume& source, dSlice& target) {
  return Reconstruct<std::int16_t, TrilinearSampler<std::int16_t>>(source, target, true);
}

}  // namespace vorl
