#ifndef VORL_OPERATORS_IP_KERNELS_SLICEPLANE_H
#define VORL_OPERATORS_IP_KERNELS_SLICEPLANE_H

/// @file
/// A plane of sampling points in a volume: where it starts and how it is walked.

#include <vorl/Data/dSlice.h>
#include <vorl/Data/dTrafo.h>
#include <vorl/Operators/IP/kernels/FixedPoint.h>

inline namespace vorl {
namespace vorl_detail {

/// The voxel coordinates of an output slice's pixels, in 16.16.
struct SlicePlane {
  /// The plane of `slice`, whose pixel (0, 0) is taken at (0, 0, depth) of its coordinate system.
  SlicePlane(const dSlice& slice, const dCoordSys3D& volume, double depth) {
    const dTrafo3D toVolume(slice.GetCoordinates(), volume);
    dVect3D corner;
    corner.Set(0.0, 0.0, depth);
    toVolume.pS2T(corner);
    start = FixedVector::Point(corner);
    columnStep = FixedVector::Step(toVolume.s2t[0]);
    rowStep = FixedVector::Step(toVolume.s2t[1]);
    depthStep = FixedVector::Step(toVolume.s2t[2]);
  }

  FixedVector start;
  FixedVector columnStep;  ///< from one pixel of a row to the next
  FixedVector rowStep;     ///< from one row to the next
  FixedVector depthStep;   ///< through one slice thickness
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
