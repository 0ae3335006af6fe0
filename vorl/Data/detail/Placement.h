#ifndef VORL_DATA_DETAIL_PLACEMENT_H
#define VORL_DATA_DETAIL_PLACEMENT_H

/// @file
/// What slices and volumes share: a coordinate system, its parts, and the centre of a voxel grid.

#include <vorl/Data/dCoordSys.h>

inline namespace vorl {
namespace vorl_detail {

/// The world position of the middle of a grid of nx x ny x nz voxels. The halved diagonal is
/// rounded to single precision before the origin is added.
void GridCenter(const dCoordSys3D& coordinates, double nx, double ny, double nz, dVect3D& center);

void CopyParts(const dCoordSys3D& coordinates, dVect3D& origin, dVect3D& axisX, dVect3D& axisY,
               dVect3D& axisZ);

}  // namespace vorl_detail
}  // namespace vorl

#endif
