#ifndef VORL_OPERATORS_IP_KERNELS_GRIDPROJECTION_H
#define VORL_OPERATORS_IP_KERNELS_GRIDPROJECTION_H

/// @file
/// The grid of one coordinate system seen from another.

#include <vorl/Data/dTrafo.h>
#include <vorl/Operators/IP/kernels/FixedPoint.h>
#include <vorl/Operators/IP/kernels/VoxelList.h>

#include <cmath>

inline namespace vorl {
namespace vorl_detail {

/// The place of grid points of one coordinate system in another, in 16.16. Where the systems give
/// no place, as one of them holds what is not a number, every point lies outside.
struct GridProjection {
  /// Grid points are counted from (0, 0, depth) of the source on.
  GridProjection(const dCoordSys3D& source, const dCoordSys3D& target, double depth = 0.0) {
    const dTrafo3D toTarget(source, target);
    dVect3D corner;
    corner.Set(0.0, 0.0, depth);
    toTarget.pS2T(corner);
    if (!std::isfinite(corner.x) || !std::isfinite(corner.y) || !std::isfinite(corner.z)) {
      return;
    }
    start = FixedVector::Of(corner);
    columnX = FixedVector::Of(toTarget.s2t[0]);
    columnY = FixedVector::Of(toTarget.s2t[1]);
    columnZ = FixedVector::Of(toTarget.s2t[2]);
  }

  FixedVector operator()(const VoxelAddress& voxel) const {
    FixedVector place = start;
    place += columnX.Times(voxel.x);
    place += columnY.Times(voxel.y);
    place += columnZ.Times(voxel.z);
    return place;
  }

  FixedVector start = FixedVector::Outside();
  FixedVector columnX;  ///< one step along the source's axisX
  FixedVector columnY;
  FixedVector columnZ;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
