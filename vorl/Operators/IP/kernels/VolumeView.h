#ifndef VORL_OPERATORS_IP_KERNELS_VOLUMEVIEW_H
#define VORL_OPERATORS_IP_KERNELS_VOLUMEVIEW_H

/// @file
/// What the volume kernels see of a volume: validated once, so that the loops stay plain.

#include <vorl/Data/dVolume.h>
#include <vorl/Operators/IP/kernels/FixedPoint.h>

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// The pixels of a volume of 16-bit samples.
///
/// Slice pointers stand behind a guard entry on either side that repeats the first and the last
/// slice, so an interpolating reader may step one slice beyond either end.
class VolumeView {
 public:
  explicit VolumeView(const dVolume& volume);

  /// The first slice, if any, whose size or format is not that of slice 0, or whose pixels are too
  /// few for its own rows or for rows as far apart as those of slice 0.
  std::optional<int> FindInvalidSlice() const { return m_invalidSlice; }

  /// True for a point whose voxel lies inside the volume.
  bool IsInside(const FixedVector& point) const {
    return point.x >= 0 && point.x < m_limitX && point.y >= 0 && point.y < m_limitY &&
           point.z >= 0 && point.z < m_limitZ;
  }

  /// True for the indices of a voxel of the volume.
  bool HoldsVoxel(std::int32_t x, std::int32_t y, std::int32_t z) const {
    return x >= 0 && x < m_width && y >= 0 && y < m_height && z >= 0 && z < m_depth;
  }

  /// The pixels of slice z, -1 <= z <= number of slices.
  template <class T>
  const T* Slice(std::int32_t z) const {
    return static_cast<const T*>(m_slices[static_cast<std::size_t>(z + 1)]);
  }

  std::int32_t Width() const { return m_width; }
  std::int32_t Height() const { return m_height; }
  std::int32_t Depth() const { return m_depth; }
  /// The sizes in 16.16.
  FixedVector Limits() const { return {m_limitX, m_limitY, m_limitZ}; }
  /// Samples from one row to the next.
  std::int32_t Pitch() const { return m_pitch; }

 private:
  std::vector<const void*> m_slices;
  std::optional<int> m_invalidSlice;
  std::int32_t m_width;
  std::int32_t m_height;
  std::int32_t m_depth;
  std::int32_t m_pitch;
  std::int32_t m_limitX;
  std::int32_t m_limitY;
  std::int32_t m_limitZ;
};

/// False, with the status "invalid pixel data in slice %d of the Volume", when there is such a
/// slice.
bool CheckPixels(const VolumeView& view, dStatus& status);

}  // namespace vorl_detail
}  // namespace vorl

#endif
