#ifndef VORL_APPS_STUDY_DICOM_STACKGEOMETRY_H
#define VORL_APPS_STUDY_DICOM_STACKGEOMETRY_H

/// @file
/// From the slices of a series to one stack: which belong together, in which order, how far apart.

#include <study/dicom/SliceHeader.h>

#include <cstddef>
#include <string>
#include <vector>

namespace study {

/// Why a slice does not belong to a stack of this grid: "is 256 x 256 pixels, the series is
/// 512 x 512", "has another orientation than the series", "has a pixel spacing of ... mm, the
/// series has ... mm". Empty when it fits (directions within 0.001 per component, spacings within
/// 0.1 %).
std::string MisfitOf(const SliceGrid& slice, const SliceGrid& stack);

/// The index of the header whose grid fits the most others; the first such one.
std::size_t TypicalSlice(const std::vector<SliceHeader>& headers);

/// Sorts by position along the stack's normal; equal positions keep the order of their instance
/// numbers, then of their file names. Without positions the instance numbers alone decide.
void SortSlices(std::vector<SliceHeader>& headers, const Vec3& normal);

/// Where the slices of a sorted stack lie.
struct StackPlacement {
  Vec3 first;                      ///< the centre of the first pixel of the first slice
  Vec3 step;                       ///< from one slice to the next, on average
  std::vector<std::string> notes;  ///< what is not regular, with positions in millimetres
};

/// Places a sorted stack of at least one slice, in which no position occurs twice. The step is the
/// mean one, (last - first) / (count - 1); it need not be along the normal (gantry tilt). A single
/// slice, and slices without positions, step along the normal by the announced spacing of slices,
/// else by the thickness, else by 1 mm. Distances that differ from the typical one by more than 1 %
/// (and 0.005 mm) are noted, as are slices that leave the line from first to last by more than half
/// a pixel.
StackPlacement PlaceStack(const std::vector<SliceHeader>& sorted);

/// A length for people: up to three decimals, no trailing zeros.
std::string Millimetres(double value);

}  // namespace study

#endif
