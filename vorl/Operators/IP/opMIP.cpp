// 1. Prepare checks the inputs.
// 2. Process picks the worker for algorithm and data type.
// 3. The slab workers walk the output rows like a thick reconstruction and keep the largest sample
//    (GridMaximum, SlabBands, Mip.h); the voxel-list worker carries listed voxels into the slice.

#include <vorl/Operators/IP/opMIP.h>

#include <algorithm>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Operators/IP/kernels/GridMaximum.h>
#include <vorl/Operators/IP/kernels/Mip.h>
#include <vorl/Operators/IP/kernels/PlaneLoop.h>
#include <vorl/Operators/IP/kernels/RowSampler.h>
#include <vorl/Operators/IP/kernels/SamplingCheck.h>
#include <vorl/Operators/IP/kernels/SlabBands.h>
#include <vorl/Operators/IP/kernels/VolumeProjection.h>

inline namespace vorl {

using vorl_detail::FixedVector;
using vorl_detail::NearestSampler;
using vorl_detail::SlabSamples;
using vorl_detail::TrilinearSampler;
using vorl_detail::VolumeView;

namespace {

constexpr char kSliceName[] = "MIP Slice";

}  // namespace

VORL_REGISTER_CLASS(opMIP, OpBase);

opMIP::opMIP() {
  opMIP::Reset();
}

opMIP::opMIP(const opMIP& source) = default;
opMIP& opMIP::operator=(const opMIP& source) = default;

opMIP::~opMIP() {
  Terminate();
  opMIP::Reset();
}

bool opMIP::Reset() {
  mipSlice = nullptr;
  volume = nullptr;
  voxelList = nullptr;
  algoID = MIPAlgo_Nearest;
  depthSteps = -1;
  return true;
}

void opMIP::SelectAlgo(int id) {
  algoID = id;
}

void opMIP::SetDepthSteps(int count) {
  depthSteps = count;
}

bool opMIP::Prepare() {
  if (!vorl_detail::CheckSampling(volume, mipSlice, kSliceName, m_status)) {
    return false;
  }
  if (algoID == MIPAlgo_VoxelList && voxelList == nullptr) {
    m_status.Set(false, "missing input parameter 'Voxel List'");
    return false;
  }
  if (algoID == MIPAlgo_VoxelList && voxelList->GetSize() == 0) {
    m_status.Set(false, "'Voxel List' is empty");
    return false;
  }
  m_status = true;
  return m_stopRequested ? Stopped() : true;
}

bool opMIP::Process() {
  if (algoID != MIPAlgo_Nearest && algoID != MIPAlgo_Trilinear && algoID != MIPAlgo_VoxelList) {
    m_status.Set(false, "invalid MIP Algo ID: %d", algoID);
    return false;
  }
  if (!vorl_detail::CheckSampleType(*volume, m_status)) {
    return false;
  }
  const bool isSigned = volume->GetDataType() == ImageDataType_S16;
  bool ok = false;
  if (algoID == MIPAlgo_VoxelList) {
    ok = isSigned ? MIPVoxelListS16(*volume, *voxelList, *mipSlice)
                  : MIPVoxelListU16(*volume, *voxelList, *mipSlice);
  } else if (algoID == MIPAlgo_Trilinear) {
    ok = isSigned ? MIPTrilinearS16(*volume, *mipSlice) : MIPTrilinearU16(*volume, *mipSlice);
  } else {
    ok = isSigned ? MIPNearestS16(*volume, *mipSlice) : MIPNearestU16(*volume, *mipSlice);
  }
  return m_stopRequested ? Stopped() : ok;
}

template <class T, class Sampler>
bool opMIP::Project(dVolume& source, dSlice& target) {
  const VolumeView view(source);
  if (!vorl_detail::CheckSamples(view, target, kSliceName, m_status)) {
    return false;
  }
  const Sampler sampler(view);
  const vorl_detail::SlicePlane plane(target, source.GetCoordinates(), vorl_detail::kSlabBegin);
  const SlabSamples slab(plane.depthStep, depthSteps);
  const bool isLinear = algoID == MIPAlgo_Trilinear;
  const auto variant = vorl_detail::ActiveVariant();
  vorl_detail::RowSampler<T> rows(view, isLinear, variant);
  const dImage& image = target.GetImage();
  vorl_detail::GridMaximum<T> grid(view, plane, slab,
                                   isLinear ? vorl_detail::CpuVariant::Reference : variant,
                                   image.GetWidth(), image.GetHeight());
  vorl_detail::SlabBands<T> bands(rows, plane, slab, vorl_detail::RowSink::Maximum,
                                  m_stopRequested);
  std::size_t index = 0;
  const auto row = [&](FixedVector& point, T* pixels, std::size_t width) {
    const std::size_t at = index++;
    if (grid.Row(at, pixels) || bands.Row(at, image.GetHeight(), point, pixels, width)) {
      point += plane.columnStep.Times(static_cast<std::int32_t>(width));
    } else {
      MipRowRef(view, sampler, slab, point, plane.columnStep, pixels, width);
    }
    return !bands.HasLeftRow();
  };
  vorl_detail::ForEachPlaneRow<T>({m_stopRequested, m_progress, HasThread()}, target, plane, row);
  return true;
}

// A voxel is admitted when its place in the slice is outside in both directions; the loop ends once
// as many have been admitted as the list is long. What lies outside the raster is not drawn, so
// together the two rules draw nothing: the slice stays as it is. Both are written out nevertheless,
// so that a change of the one finds the other in place.
template <class T>
bool opMIP::ProjectList(dVolume& source, dBuffer& list, dSlice& target) {
  const VolumeView view(source);
  if (!vorl_detail::CheckSamples(view, target, kSliceName, m_status)) {
    return false;
  }
  const NearestSampler<T> sampler(view);
  const vorl_detail::VoxelListView voxels(list);
  const vorl_detail::GridProjection toSlice(source.GetCoordinates(), target.GetCoordinates());
  const vorl_detail::RasterBounds bounds(target.GetImage());
  std::size_t left = voxels.Count();
  const auto draw = [&](std::size_t index) {
    const vorl_detail::VoxelAddress voxel = voxels[index];
    const FixedVector place = toSlice(voxel);
    if (left == 0 || bounds.HoldsRow(place) || bounds.HoldsColumn(place)) {
      return;
    }
    --left;
    if (bounds.Holds(place) && view.HoldsVoxel(voxel.x, voxel.y, voxel.z)) {
      T& pixel = vorl_detail::RowOf<T>(target.GetImage(),
                                       static_cast<std::size_t>(place.y >> 16))[place.x >> 16];
      pixel = std::max(pixel, static_cast<T>(sampler.Voxel(voxel.x, voxel.y, voxel.z)));
    }
  };
  vorl_detail::ForEachVoxel({m_stopRequested, m_progress, HasThread()}, voxels.Count(), draw);
  return true;
}

bool opMIP::MIPNearestU16(dVolume& source, dSlice& target) {
  return Project<std::uint16_t, NearestSampler<std::uint16_t>>(source, target);
}

bool opMIP::MIPTrilinearU16(dVolume& source, dSlice& target) {
  return Project<std::uint16_t, TrilinearSampler<std::uint16_t>>(source, target);
}

bool opMIP::MIPVoxelListU16(dVolume& source, dBuffer& list, dSlice& target) {
  return ProjectList<std::uint16_t>(source, list, target);
}

bool opMIP::MIPNearestS16(dVolume& source, dSlice& target) {
  return Project<std::int16_t, NearestSampler<std::int16_t>>(source, target);
}

bool opMIP::MIPTrilinearS16(dVolume& source, dSlice& target) {
  return Project<std::int16_t, TrilinearSampler<std::int16_t>>(source, target);
}

bool opMIP::MIPVoxelListS16(dVolume& source, dBuffer& list, dSlice& target) {
  return ProjectList<std::int16_t>(source, list, target);
}

}  // namespace vorl
