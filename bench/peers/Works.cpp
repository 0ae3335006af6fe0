#include "Works.h"

#include <string>

namespace peers {
namespace {

constexpr double kImage = static_cast<double>(kImagePixels);
constexpr double kVolume = static_cast<double>(kVoxels);
constexpr double kScreen = static_cast<double>(kScreenPixels);

/// A plane's directions in space, each of unit length.
struct Orientation {
  const char* name;
  Position right;
  Position down;
  Position normal;
  double aside;  ///< from the middle of the volume along the normal, in mm
};

// The upright planes lie between voxels: a linear filter finds something to do. The sagittal one
// lies where both of its columns of voxels share cache lines. The oblique one is turned by 30
// degrees about x, then by 20 degrees about y.
constexpr double kCos30 = 0.86602540378443864676;
constexpr double kSin30 = 0.5;
constexpr double kCos20 = 0.93969262078590838405;
constexpr double kSin20 = 0.34202014332566873304;
constexpr Orientation kAxial{"axial", {1, 0, 0}, {0, 1, 0}, {0, 0, 1}, 0.3 * kSpacing[2]};
constexpr Orientation kCoronal{"coronal", {1, 0, 0}, {0, 0, 1}, {0, -1, 0}, 0.3 * kSpacing[1]};
constexpr Orientation kSagittal{"sagittal", {0, 1, 0}, {0, 0, 1}, {1, 0, 0}, 10.3 * kSpacing[0]};
constexpr Orientation kOblique{"oblique",
                               {kCos20, 0, -kSin20},
                               {kSin20 * kSin30, kCos30, kCos20* kSin30},
                               {kSin20 * kCos30, -kSin30, kCos20* kCos30},
                               0.3};

/// A vector in mm, in voxels.
Position InVoxels(const Position& vector, double length) {
  return {vector[0] * length / kSpacing[0], vector[1] * length / kSpacing[1],
          vector[2] * length / kSpacing[2]};
}

PlaneWork MakePlane(const Orientation& orientation, bool isLinear, int edge, Mode mode = Mode::Thin,
                    int samples = 1) {
  constexpr double kSampleDistance = 1;
  const std::string filter = isLinear ? "linear/" : "nearest/";
  const std::string size = edge == kWidth ? "" : std::to_string(edge);
  const std::string name = mode == Mode::Thin      ? "mpr/" + filter + orientation.name + size
                           : mode == Mode::Maximum ? "slab/" + filter + "maximum"
                                                   : "slab/" + filter + "mean";
  const double pixel = kSpacing[0] * kWidth / edge;
  PlaneWork plane{{name, static_cast<double>(edge) * edge * samples},
                  isLinear,
                  mode,
                  edge,
                  samples,
                  {},
                  InVoxels(orientation.right, pixel),
                  InVoxels(orientation.down, pixel),
                  InVoxels(orientation.normal, kSampleDistance)};
  const Position aside = InVoxels(orientation.normal, orientation.aside);
  const double middle[3] = {0.5 * (kWidth - 1), 0.5 * (kHeight - 1), 0.5 * (kDepth - 1)};
  for (std::size_t axis = 0; axis < 3; ++axis) {
    plane.corner[axis] =
        middle[axis] + aside[axis] - 0.5 * (edge - 1) * (plane.right[axis] + plane.down[axis]);
  }
  return plane;
}

std::vector<PlaneWork> MakePlanes() {
  constexpr int kSlab = 64;
  std::vector<PlaneWork> planes;
  for (const bool isLinear : {false, true}) {
    for (const Orientation* const orientation : {&kAxial, &kCoronal, &kSagittal, &kOblique}) {
      planes.push_back(MakePlane(*orientation, isLinear, kWidth));
    }
  }
  planes.push_back(MakePlane(kOblique, true, 2 * kWidth));
  planes.push_back(MakePlane(kOblique, true, kWidth, Mode::Maximum, kSlab));
  planes.push_back(MakePlane(kOblique, true, kWidth, Mode::Mean, kSlab));
  planes.push_back(MakePlane(kOblique, false, kWidth, Mode::Maximum, kSlab));
  return planes;
}

}  // namespace

const WindowWork& TheWindow() {
  static const WindowWork work{{"window", kImage}, 1064, 1500};
  return work;
}

const std::vector<ExtremesWork>& ExtremesWorks() {
  static const std::vector<ExtremesWork> works{
      {{"minmax/image", kImage}, Image16, kImageEdge, kImageEdge},
      {{"minmax/volume", kVolume}, Volume, kWidth, kHeight * kDepth}};
  return works;
}

const std::vector<RescaleWork>& RescaleWorks() {
  static const std::vector<RescaleWork> works{{{"rescale/8bit", kImage}, 8, 1.37, -20.25},
                                              {{"rescale/16bit", kImage}, 16, 33.7, -9000.25}};
  return works;
}

const std::vector<PlaneWork>& PlaneWorks() {
  static const std::vector<PlaneWork> works = MakePlanes();
  return works;
}

Position PositionOf(const PlaneWork& plane, int column, int row, int sample) {
  const double across = sample - 0.5 * (plane.samples - 1);
  Position position = plane.corner;
  for (std::size_t axis = 0; axis < 3; ++axis) {
    position[axis] +=
        column * plane.right[axis] + row * plane.down[axis] + across * plane.through[axis];
  }
  return position;
}

const std::vector<DepthWork>& DepthWorks() {
  static const std::vector<DepthWork> works{
      {{"depth/z", kVolume}, 2}, {{"depth/y", kVolume}, 1}, {{"depth/x", kVolume}, 0}};
  return works;
}

DepthSize SizeOf(const DepthWork& work) {
  switch (work.axis) {
    case 0:
      return {kHeight, kDepth, kWidth};
    case 1:
      return {kWidth, kDepth, kHeight};
    default:
      return {kWidth, kHeight, kDepth};
  }
}

const Work& TheHistogram() {
  static const Work work{"classification/value", kVolume};
  return work;
}

const Work& TheEdges() {
  static const Work work{"classification/edge", kVolume};
  return work;
}

const Work& SelectionByValue() {
  static const Work work{"selection/value", kVolume};
  return work;
}

const Work& SelectionByEdge() {
  static const Work work{"selection/edge", kVolume};
  return work;
}

const std::vector<StretchWork>& StretchWorks() {
  static const std::vector<StretchWork> works{{{"stretch/8bit/512", kScreen}, kWidth, 1},
                                              {{"stretch/8bit/2048", kScreen}, kImageEdge, 1},
                                              {{"stretch/32bit/512", kScreen}, kWidth, 4},
                                              {{"stretch/32bit/2048", kScreen}, kImageEdge, 4}};
  return works;
}

const void* SourceOf(const StretchWork& work) {
  return work.bytes == 1 ? static_cast<const void*>(Image8(work.sourceEdge).data())
                         : Image32(work.sourceEdge).data();
}

const Work& BitmapSaving() {
  static const Work work{"bmp/save", kImage};
  return work;
}

const Work& BitmapLoading() {
  static const Work work{"bmp/load", kImage};
  return work;
}

const Work& StudyWriting() {
  static const Work work{"bdf/write", kVolume};
  return work;
}

const Work& StudyReading() {
  static const Work work{"bdf/read", kVolume};
  return work;
}

}  // namespace peers
