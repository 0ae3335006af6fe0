#ifndef VORL_OPERATORS_IP_KERNELS_SLICEPLANE_H
#define VORL_OPERATORS_IP_KERNELS_SLICEPLANE_H

/// @file
/// A plane of sampling points in a volume: where it starts and how it is walked.

#include <vorl/Data/dSlice.h>
#include <vorl/Operators/IP/kernels/GridProjection.h>

inline namespace vorl {
namespace vorl_detail {

/// The voxel coordinates of an output slice's pixels, in 16.16.
struct SlicePlane {
  /// The plane of `slice`, whose pixel (0, 0) is taken at (0, 0, depth) of its coordinate system.
  SlicePlane(const dSlice& slice, const dCoordSys3D& volume, double depth)
      : SlicePlane(GridProjection(slice.GetCoordinates(), volume, depth)) {}

  FixedVector start;
  FixedVector columnStep;  ///< from one pixel of a row to the next
  FixedVector rowStep;     ///< from one row to the next
  FixedVector depthStep;   ///< through one slice thickness

 private:
  explicit SlicePlane(const GridProjection& toVolume)
      : start(toVolume.start),
        columnStep(toVolume.columnX),
        rowStep(toVolume.columnY),
        depthStep(toVolume.columnZ) {}
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
