#ifndef BENCH_PEERS_CHECKS_H
#define BENCH_PEERS_CHECKS_H

/// @file
/// Whether a result is right: against slow and simple computations of the same, in double
/// precision. Each check returns what is wrong, or nothing.
///
/// Libraries round differently, and each is right: grey levels and rescaled values may differ by 1
/// from the exact one. What an interpolated sample may be is said at `CheckPlane`. Everything else
/// is exact.

#include <cstddef>
#include <cstdint>
#include <string>

#include "Works.h"

namespace peers {

/// How a filter interpolates in a slice.
enum class LinearRule {
  Textbook,  ///< in both rows, then between them
  Vorl       ///< vorl's own (see `opMPR`): in the lower row the difference has the opposite sign
};

std::string CheckWindow(const std::uint8_t* levels);
std::string CheckExtremes(const ExtremesWork& work, double lowest, double highest);
std::string CheckRescale(const RescaleWork& work, const void* values);
/// Samples may be taken 1/50 voxel aside, since 1024 fixed-point steps add up to that, and an
/// interpolated one may be up to 3 of 4096 values lower and 1 higher. Where a position lies within
/// a voxel of the volume's border anything goes, since libraries end their volumes differently; in
/// half of the pixels it must not. Of slabs, every fifth pixel of every fifth row is checked.
std::string CheckPlane(const PlaneWork& work, const std::uint16_t* pixels,
                       LinearRule rule = LinearRule::Textbook);
std::string CheckDepth(const DepthWork& work, const std::uint16_t* pixels);
/// `counts` are those of the values, or of the edge strengths, below 4096.
std::string CheckHistogram(const std::uint32_t* counts);
std::string CheckEdges(const std::uint32_t* counts);
/// Places are (z << 22) | (y << 11) | x, slice after slice.
std::string CheckSelection(bool isByEdge, const std::uint32_t* places, std::size_t count);
/// Of how many places `CheckSelection` may know.
std::uint32_t SelectionLimit();
/// The source's pixel whose area holds the middle of the target's pixel, or one beside it.
std::string CheckStretch(const StretchWork& work, const void* pixels);
/// Rows from top to bottom, each pixel blue, green, red.
std::string CheckBitmap(const std::uint8_t* pixels);
/// The same in a file.
std::string CheckBitmapFile(const std::string& path);

}  // namespace peers

#endif
