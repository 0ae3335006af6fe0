#ifndef VORL_OPERATORS_IP_KERNELS_VOLUMEPROJECTION_H
#define VORL_OPERATORS_IP_KERNELS_VOLUMEPROJECTION_H

/// @file
/// The raster into which voxels and slice pixels are carried, and the walk through a voxel list.

#include <vorl/Operators/IP/kernels/GridProjection.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// The size of an image's raster in 16.16.
class RasterBounds {
 public:
  explicit RasterBounds(const dImage& image)
      : m_width(FixedSize(static_cast<std::int32_t>(image.GetWidth()))),
        m_height(FixedSize(static_cast<std::int32_t>(image.GetHeight()))) {}

  bool HoldsColumn(const FixedVector& place) const { return place.x >= 0 && place.x < m_width; }
  bool HoldsRow(const FixedVector& place) const { return place.y >= 0 && place.y < m_height; }
  bool Holds(const FixedVector& place) const { return HoldsColumn(place) && HoldsRow(place); }

 private:
  std::int32_t m_width;
  std::int32_t m_height;
};

/// Calls `voxel(i)` for i = 0 .. count - 1, looking for a stop request and storing the progress
/// every few thousand. Returns false when stopped.
template <class Voxel>
bool ForEachVoxel(const RunControl& control, std::size_t count, Voxel&& voxel) {
  constexpr std::size_t kPiece = 4096;
  const std::size_t pieces = (count + kPiece - 1) / kPiece;
  return ForEachRow(control, pieces, [&](std::size_t piece) {
    const std::size_t end = std::min(count, (piece + 1) * kPiece);
    for (std::size_t i = piece * kPiece; i < end; ++i) {
      voxel(i);
    }
  });
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
