#ifndef VORL_OPERATORS_IP_KERNELS_VOXELCLASSES_H
#define VORL_OPERATORS_IP_KERNELS_VOXELCLASSES_H

/// @file
/// The classes of voxels, row by row. Plain references: faster variants must equal them bit for
/// bit.

#include <vorl/Data/dVOI.h>
#include <vorl/Data/dVolume.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// One row of voxels and the row below it (null at the last row).
template <class T>
struct VoxelRow {
  const T* voxels;
  const T* below;
  std::uint32_t firstX;
  std::uint32_t endX;
  std::uint32_t y;
  std::uint32_t z;
};

/// The class of a voxel is its value.
struct ValueClass {
  static constexpr std::uint32_t kNeighbours = 0;

  template <class T>
  static std::int32_t Of(const VoxelRow<T>& row, std::uint32_t x) {
    return row.voxels[x];
  }
};

/// The class of a voxel is what it rises above the lower of its right and lower neighbours, each by
/// its low 12 bits; below 0 where it does not rise.
struct EdgeClass {
  static constexpr std::uint32_t kNeighbours = 1;

  template <class T>
  static std::int32_t Of(const VoxelRow<T>& row, std::uint32_t x) {
    return Low12Bits(row.voxels[x]) -
           std::min(Low12Bits(row.voxels[x + 1]), Low12Bits(row.below[x]));
  }

 private:
  static std::int32_t Low12Bits(std::int32_t value) { return value & 0xFFF; }
};

/// The part of a volume that a pass looks at.
struct VoxelBox {
  /// The region, or the whole volume without one, as far as it lies in the volume. A box that
  /// reaches the last column or row leaves `neighbours` of them out.
  VoxelBox(const dVolume& volume, const dVOI* region, std::uint32_t neighbours) {
    const auto width = static_cast<std::uint32_t>(volume.GetSizeX());
    const auto height = static_cast<std::uint32_t>(volume.GetSizeY());
    const auto depth = static_cast<std::uint32_t>(volume.GetSizeZ());
    const dVOI box = region != nullptr ? *region : dVOI{0, 0, 0, width, height, depth};
    firstX = box.firstX;
    endX = EndOf(box.firstX, box.sizeX, width, neighbours);
    firstY = box.firstY;
    endY = EndOf(box.firstY, box.sizeY, height, neighbours);
    firstZ = box.firstZ;
    endZ = EndOf(box.firstZ, box.sizeZ, depth, 0);
  }

  bool IsEmpty() const { return firstX >= endX || firstY >= endY || firstZ >= endZ; }

  std::uint64_t Count() const {
    return IsEmpty() ? 0 : std::uint64_t{endX - firstX} * (endY - firstY) * (endZ - firstZ);
  }

  std::uint32_t firstX;
  std::uint32_t endX;
  std::uint32_t firstY;
  std::uint32_t endY;
  std::uint32_t firstZ;
  std::uint32_t endZ;

 private:
  // The end of [first, first + size) inside [0, length), less `leftOut` at the far end of that.
  static std::uint32_t EndOf(std::uint32_t first, std::uint32_t size, std::uint32_t length,
                             std::uint32_t leftOut) {
    const std::uint64_t last = length > leftOut ? length - leftOut : 0;
    return static_cast<std::uint32_t>(std::min(std::uint64_t{first} + size, last));
  }
};

/// Calls `visit(row)` for every row of the box, slice by slice, top to bottom. All slices are of
/// the volume's size. Returns false when stopped.
template <class T, class Visit>
bool ForEachVoxelRow(const RunControl& control, const dVolume& volume, const VoxelBox& box,
                     Visit&& visit) {
  std::vector<const dImage*> images;
  for (const dSlice& slice : volume.GetSliceList()) {
    images.push_back(&slice.GetImage());
  }
  const std::size_t rows = box.IsEmpty() ? 0 : box.endY - box.firstY;
  return ForEachRow(control, rows * (box.endZ - box.firstZ), [&](std::size_t index) {
    const auto z = static_cast<std::uint32_t>(box.firstZ + index / rows);
    const auto y = static_cast<std::uint32_t>(box.firstY + index % rows);
    const dImage& image = *images[z];
    const bool isLast = y + 1 >= image.GetHeight();
    visit(VoxelRow<T>{RowOf<const T>(image, y), isLast ? nullptr : RowOf<const T>(image, y + 1),
                      box.firstX, box.endX, y, z});
  });
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
