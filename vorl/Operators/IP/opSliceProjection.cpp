// 1. Prepare checks the inputs against each other and the depth buffer against the plane.
// 2. Process picks the worker for algorithm and data type.
// 3. Slices and voxel lists are carried forward into the plane (VolumeProjection.h) and drawn where
//    they lie in front of the depth buffer; only slices move it. The volume is sampled backward,
//    along a ray from each pixel of the plane that ends at the pixel's depth (BackProjection.h).

#include <vorl/Operators/IP/opSliceProjection.h>

#include <algorithm>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Operators/IP/kernels/BackProjection.h>
#include <vorl/Operators/IP/kernels/ImageCheck.h>
#include <vorl/Operators/IP/kernels/PlaneLoop.h>
#include <vorl/Operators/IP/kernels/Slab.h>
#include <vorl/Operators/IP/kernels/VolumeProjection.h>

inline namespace vorl {

using vorl_detail::FixedVector;
using vorl_detail::RowOf;
using vorl_detail::VolumeView;

namespace {

bool IsAlgorithm(std::int32_t id) {
  return id == SliceProjectionAlgo_Slice || id == SliceProjectionAlgo_Volume ||
         id == SliceProjectionAlgo_VoxelList || id == SliceProjectionAlgo_SliceBack;
}

// Whether a slice's pixel is drawn in the border value: the outline, and a mark of 7 x 7 pixels
// inside it at the first one.
bool IsBorder(std::size_t column, std::size_t row, std::size_t width, std::size_t height) {
  constexpr std::size_t kMarkEnd = 8;
  const bool onOutline = column == 0 || column == width - 1 || row == 0 || row == height - 1;
  return onOutline || (column < kMarkEnd && row < kMarkEnd);
}

}  // namespace

VORL_REGISTER_CLASS(opSliceProjection, OpBase);

opSliceProjection::opSliceProjection() {
  opSliceProjection::Reset();
}

opSliceProjection::opSliceProjection(const opSliceProjection& source) = default;
opSliceProjection& opSliceProjection::operator=(const opSliceProjection& source) = default;

opSliceProjection::~opSliceProjection() {
  Terminate();
  opSliceProjection::Reset();
}

bool opSliceProjection::Reset() {
  projectionPlane = nullptr;
  slice = nullptr;
  voxelList = nullptr;
  volume = nullptr;
  borderValue = 0xFFFF;
  zBuffer.Reset();
  return true;
}

void opSliceProjection::SelectAlgo(int id) {
  algoID = id;
}

void opSliceProjection::SetBorderValue(unsigned short value) {
  borderValue = value;
}

bool opSliceProjection::InitZBuffer() {
  if (projectionPlane == nullptr) {
    zBuffer.Reset();
    return true;
  }
  if (!zBuffer.Init(projectionPlane->GetImage(), 0, 0, ImageDataType_S16)) {
    m_status.Set(false, "error while initializing the 'Z Buffer'");
    return false;
  }
  auto* depths = static_cast<std::int16_t*>(zBuffer.GetDataPtr());
  std::fill_n(depths, zBuffer.GetNumDataSamples(), vorl_detail::kFarthestDepth);
  return true;
}

void opSliceProjection::ClearProjectionPlane() {
  if (projectionPlane != nullptr) {
    projectionPlane->GetImage().Fill(0);
  }
}

bool opSliceProjection::Prepare() {
  if (projectionPlane == nullptr) {
    m_status.Set(false, "missing input parameter 'Projection Slice'");
    return false;
  }
  const unsigned short planeType = projectionPlane->GetDataType();
  const bool drawsSlice =
      algoID == SliceProjectionAlgo_Slice || algoID == SliceProjectionAlgo_SliceBack;
  const dImage& planeImage = projectionPlane->GetImage();
  if (drawsSlice && slice == nullptr) {
    m_status.Set(false, "no slice to project");
  } else if (drawsSlice && slice->GetDataType() != planeType) {
    m_status.Set(false, "incompatible data types(Projection Plane: 0x%x, Slice: 0x%x", planeType,
                 slice->GetDataType());
  } else if (volume == nullptr) {
    m_status.Set(false, "no volume to project");
  } else if (!volume->IsValid()) {
    m_status.Set(false, "given Volume is empty");
  } else if (volume->GetDataType() != planeType) {
    m_status.Set(false, "incompatible data types(Projection Plane: 0x%x, Volume: 0x%x", planeType,
                 volume->GetDataType());
  } else if (algoID == SliceProjectionAlgo_VoxelList && voxelList == nullptr) {
    m_status.Set(false, "no voxel list to project");
  } else if (zBuffer.GetWidth() != planeImage.GetWidth() ||
             zBuffer.GetHeight() != planeImage.GetHeight()) {
    m_status.Set(false, "Z-Buffer is incompatible to 'Projection Plane'");
  } else {
    m_status = true;
    return m_stopRequested ? Stopped() : true;
  }
  return false;
}

bool opSliceProjection::Process() {
  const unsigned short dataType = projectionPlane->GetDataType();
  const bool isSigned = dataType == ImageDataType_S16;
  if (!IsAlgorithm(algoID) || (dataType != ImageDataType_U16 && !isSigned)) {
    // One text serves for an unknown algorithm, too.
    m_status.Set(false, "unsupported data type: %d", dataType);
    return false;
  }
  if (!CheckBuffers()) {
    return false;
  }
  bool ok = true;
  switch (algoID) {
    case SliceProjectionAlgo_Slice:
      ok = isSigned ? SliceProjectionS16(slice, projectionPlane)
                    : SliceProjectionU16(slice, projectionPlane);
      break;
    case SliceProjectionAlgo_Volume:
      ok = isSigned ? VolumeBackProjectionS16(volume, projectionPlane)
                    : VolumeBackProjectionU16(volume, projectionPlane);
      break;
    case SliceProjectionAlgo_VoxelList:
      ok = isSigned ? VoxelListProjectionS16(volume, voxelList, projectionPlane)
                    : VoxelListProjectionU16(volume, voxelList, projectionPlane);
      break;
    default:
      ok = isSigned ? SliceBackProjectionS16(slice, projectionPlane)
                    : SliceBackProjectionU16(slice, projectionPlane);
      break;
  }
  return m_stopRequested ? Stopped() : ok;
}

// The depth buffer is the application's to exchange, as are the pixels of slices and volume.
bool opSliceProjection::CheckBuffers() {
  const bool readsVolume =
      algoID == SliceProjectionAlgo_Volume || algoID == SliceProjectionAlgo_VoxelList;
  if (readsVolume && !vorl_detail::CheckPixels(vorl_detail::VolumeView(*volume), m_status)) {
    return false;
  }
  if (!vorl_detail::HoldsRows(projectionPlane->GetImage())) {
    m_status.Set(false, "invalid pixel data in the Projection Plane");
  } else if (zBuffer.GetDataType() != ImageDataType_S16 || !vorl_detail::HoldsRows(zBuffer)) {
    m_status.Set(false, "invalid pixel data in the Z Buffer");
  } else if (algoID == SliceProjectionAlgo_Slice && !vorl_detail::HoldsRows(slice->GetImage())) {
    m_status.Set(false, "invalid pixel data in the Slice");
  } else {
    return true;
  }
  return false;
}

template <class T>
bool opSliceProjection::DrawSlice(const dSlice& source, dSlice& plane) {
  const dImage& from = source.GetImage();
  const dImage& to = plane.GetImage();
  const std::size_t width = from.GetWidth();
  const std::size_t height = from.GetHeight();
  const vorl_detail::GridProjection toPlane(source.GetCoordinates(), plane.GetCoordinates());
  const vorl_detail::RasterBounds bounds(to);
  const T border = static_cast<T>(borderValue);
  FixedVector rowStart = toPlane.start;
  const auto drawRow = [&](std::size_t row) {
    const T* pixels = RowOf<const T>(from, row);
    FixedVector place = rowStart;
    for (std::size_t column = 0; column < width; ++column) {
      if (bounds.Holds(place)) {
        const auto x = place.x >> 16;
        const auto y = static_cast<std::size_t>(place.y >> 16);
        const std::int32_t depth = place.z >> 16;
        std::int16_t& nearest = RowOf<std::int16_t>(zBuffer, y)[x];
        if (depth < nearest) {
          nearest = static_cast<std::int16_t>(depth);
          RowOf<T>(to, y)[x] = IsBorder(column, row, width, height) ? border : pixels[column];
        }
      }
      place += toPlane.columnX;
    }
    rowStart += toPlane.columnY;
  };
  vorl_detail::ForEachRow({m_stopRequested, m_progress, HasThread()}, height, drawRow);
  return true;
}

template <class T>
bool opSliceProjection::DrawVolume(const dVolume& source, dSlice& plane, bool limitedByDepth) {
  const VolumeView view(source);
  const vorl_detail::SlicePlane rays(plane, source.GetCoordinates(), vorl_detail::kSlabBegin);
  std::size_t index = 0;
  const auto row = [&](FixedVector& point, T* pixels, std::size_t width) {
    const std::int16_t* depths = limitedByDepth ? RowOf<std::int16_t>(zBuffer, index) : nullptr;
    BackProjectRowRef(view, rays.depthStep, point, rays.columnStep, depths, pixels, width);
    ++index;
  };
  vorl_detail::ForEachPlaneRow<T>({m_stopRequested, m_progress, HasThread()}, plane, rays, row);
  return true;
}

// Plane and depths are indexed with the plane's width as row pitch: planes are kept unpadded.
template <class T>
bool opSliceProjection::DrawVoxels(const dVolume& source, const dBuffer& list, dSlice& plane) {
  const VolumeView view(source);
  const vorl_detail::NearestSampler<T> sampler(view);
  const vorl_detail::VoxelListView voxels(list);
  const vorl_detail::GridProjection toPlane(source.GetCoordinates(), plane.GetCoordinates());
  const vorl_detail::RasterBounds bounds(plane.GetImage());
  const std::size_t pitch = plane.GetImage().GetWidth();
  auto* pixels = static_cast<T*>(plane.GetImage().GetDataPtr());
  const auto* depths = static_cast<const std::int16_t*>(zBuffer.GetDataPtr());
  const auto draw = [&](std::size_t entry) {
    const vorl_detail::VoxelAddress voxel = voxels[entry];
    const FixedVector place = toPlane(voxel);
    if (!bounds.Holds(place) || !view.HoldsVoxel(voxel.x, voxel.y, voxel.z)) {
      return;
    }
    const std::size_t index =
        static_cast<std::size_t>(place.y >> 16) * pitch + static_cast<std::size_t>(place.x >> 16);
    if (place.z >> 16 < depths[index]) {
      pixels[index] =
          std::max(pixels[index], static_cast<T>(sampler.Voxel(voxel.x, voxel.y, voxel.z)));
    }
  };
  vorl_detail::ForEachVoxel({m_stopRequested, m_progress, HasThread()}, voxels.Count(), draw);
  return true;
}

bool opSliceProjection::SliceProjectionU16(dSlice* source, dSlice* plane) {
  return DrawSlice<std::uint16_t>(*source, *plane);
}

bool opSliceProjection::SliceProjectionS16(dSlice* source, dSlice* plane) {
  return DrawSlice<std::int16_t>(*source, *plane);
}

bool opSliceProjection::VolumeBackProjectionU16(dVolume* source, dSlice* plane) {
  return DrawVolume<std::uint16_t>(*source, *plane, true);
}

bool opSliceProjection::VolumeBackProjectionS16(dVolume* source, dSlice* plane) {
  return DrawVolume<std::int16_t>(*source, *plane, true);
}

bool opSliceProjection::VoxelListProjectionU16(dVolume* source, dBuffer* list, dSlice* plane) {
  return DrawVoxels<std::uint16_t>(*source, *list, *plane);
}

bool opSliceProjection::VoxelListProjectionS16(dVolume* source, dBuffer* list, dSlice* plane) {
  return DrawVoxels<std::int16_t>(*source, *list, *plane);
}

bool opSliceProjection::SliceBackProjectionU16(dSlice*, dSlice*) {
  return false;
}

bool opSliceProjection::SliceBackProjectionS16(dSlice*, dSlice*) {
  return false;
}

bool opSliceProjection::VolumeProjectionU16(dVolume* source, dSlice* plane) {
  return DrawVolume<std::uint16_t>(*source, *plane, false);
}

bool opSliceProjection::VolumeProjectionS16(dVolume* source, dSlice* plane) {
  return DrawVolume<std::int16_t>(*source, *plane, false);
}

}  // namespace vorl
