#ifndef BENCH_PEERS_WORKS_H
#define BENCH_PEERS_WORKS_H

/// @file
/// What is to be computed. Each library enters for those works that it has a function for.

#include <array>
#include <vector>

#include "Contest.h"
#include "TestData.h"

namespace peers {

/// 12 of 16 bits to grey levels: values below the window become 0, above it 255.
struct WindowWork {
  Work work;
  int centre;
  int width;
};
const WindowWork& TheWindow();

/// The lowest and the highest value.
struct ExtremesWork {
  Work work;
  const Samples<std::uint16_t>& (*samples)();
  int width;
  int height;
};
const std::vector<ExtremesWork>& ExtremesWorks();

/// value * scale + shift, in the type of the source; what does not fit becomes the nearest value
/// that does.
struct RescaleWork {
  Work work;
  int bits;
  double scale;
  double shift;
};
const std::vector<RescaleWork>& RescaleWorks();

/// In voxels; voxel centres have whole numbers.
using Position = std::array<double, 3>;

enum class Mode { Thin, Maximum, Mean };

/// Square cuts through the volume, thin or of several samples across. Where a plane lies does not
/// depend on its number of pixels: they are as large as voxels are wide in a plane of 512.
struct PlaneWork {
  Work work;
  bool isLinear;  ///< interpolated between voxels, or the nearest one
  Mode mode;
  int edge;          ///< in pixels
  int samples;       ///< across the slab, 1 mm apart; 1 in a thin plane
  Position corner;   ///< of pixel (0, 0), in the middle of the slab
  Position right;    ///< from pixel to pixel
  Position down;     ///< from row to row
  Position through;  ///< from sample to sample
};
const std::vector<PlaneWork>& PlaneWorks();
Position PositionOf(const PlaneWork& plane, int column, int row, int sample);

/// The highest of all voxels behind each voxel of a face.
struct DepthWork {
  Work work;
  int axis;  ///< that is looked along: 0 is x
};
const std::vector<DepthWork>& DepthWorks();
/// Of the picture and of what lies behind a pixel.
struct DepthSize {
  int width;
  int height;
  int depth;
};
DepthSize SizeOf(const DepthWork& work);

/// How often each value occurs in the volume.
const Work& TheHistogram();
/// How often each edge strength occurs: how far a voxel rises above the lower one of its right and
/// its lower neighbour.
const Work& TheEdges();
/// The places of the highest hundredth of the voxels, by value and by edge strength. They have been
/// counted before.
const Work& SelectionByValue();
const Work& SelectionByEdge();

/// An image onto 3840 x 2160 pixels of the same format; the nearest pixel.
struct StretchWork {
  Work work;
  int sourceEdge;
  int bytes;  ///< in a pixel
};
inline constexpr int kScreenWidth = 3840;
inline constexpr int kScreenHeight = 2160;
inline constexpr std::size_t kScreenPixels = std::size_t{kScreenWidth} * kScreenHeight;
const std::vector<StretchWork>& StretchWorks();
/// The pixels of the source.
const void* SourceOf(const StretchWork& work);

/// A bitmap file of 2048 x 2048 pixels of 24 bits.
const Work& BitmapSaving();
const Work& BitmapLoading();
/// A file of 300 slices of the volume.
const Work& StudyWriting();
const Work& StudyReading();

}  // namespace peers

#endif
