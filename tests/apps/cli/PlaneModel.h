#ifndef VORL_TESTS_APPS_CLI_PLANEMODEL_H
#define VORL_TESTS_APPS_CLI_PLANEMODEL_H

/// @file
/// What a cut through a volume must be, computed from the definition in double precision, without
/// any code of the library or the applications.

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <vector>

namespace cli_test {

using Point = std::array<double, 3>;

/// A volume whose axes may point anywhere.
struct VolumeModel {
  std::array<int, 3> size{};
  Point firstVoxel{};  ///< its centre, in millimetres
  std::array<Point, 3> step{};
  std::function<int(int i, int j, int k)> stored;
};

/// A plane: a point in the middle of the picture, and where it runs.
struct PlaneModel {
  Point centre{};
  Point right{};
  Point down{};
  int width = 0;
  int height = 0;
  double spacing = 1;
  double thickness = 0;
  int steps = 1;  ///< samples across the thickness

  /// The plane turned about its own direction to the right, then down, then its normal.
  PlaneModel Turned(double aboutRight, double aboutDown, double aboutNormal) const;
};

PlaneModel AxialPlane();
PlaneModel CoronalPlane();
PlaneModel SagittalPlane();

/// The samples row by row: of the voxels around the points, or, with steps, their mean (a whole
/// number, cut off) over the points inside; 0 where there is none. A pixel one of whose points lies
/// close to a voxel's border is empty: there, rounding decides. (Steps are kept to 1/65536 of a
/// voxel, which adds up from pixel to pixel.)
std::vector<std::optional<int>> NearestSamples(const VolumeModel& volume, const PlaneModel& plane);

/// How `actual` compares with `expected`.
struct Comparison {
  std::size_t equal = 0;
  std::size_t different = 0;
  std::size_t undecided = 0;
};
Comparison Compare(const std::vector<std::optional<int>>& expected,
                   const std::vector<std::uint16_t>& actual);

}  // namespace cli_test

#endif
