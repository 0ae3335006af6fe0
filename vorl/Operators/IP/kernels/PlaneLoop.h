#ifndef VORL_OPERATORS_IP_KERNELS_PLANELOOP_H
#define VORL_OPERATORS_IP_KERNELS_PLANELOOP_H

/// @file
/// How the volume operators walk the pixels of an output slice.

#include <vorl/Data/dSlice.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>
#include <vorl/Operators/IP/kernels/SlicePlane.h>

#include <cstddef>

inline namespace vorl {
namespace vorl_detail {

/// Calls `row(point, pixels, width)` for each row of the slice, top to bottom: with the sampling
/// point of the row's first pixel, which the call moves on by `width` column steps, and the row's
/// pixels. Returns false when stopped.
template <class T, class Row>
bool ForEachPlaneRow(const RunControl& control, const dSlice& slice, const SlicePlane& plane,
                     Row&& row) {
  const dImage& image = slice.GetImage();
  const std::size_t width = image.GetWidth();
  const FixedVector toNextRow =
      plane.rowStep - plane.columnStep.Times(static_cast<std::int32_t>(image.GetWidth()));
  FixedVector point = plane.start;
  return ForEachRow(control, image.GetHeight(), [&](std::size_t index) {
    const bool isDone = DoRow(row, point, RowOf<T>(image, index), width);
    point += toNextRow;
    return isDone;
  });
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
