#ifndef VORL_APPS_CLI_STATISTICS_H
#define VORL_APPS_CLI_STATISTICS_H

/// @file
/// Measuring on a plane: its coordinates, and the values inside a rectangle.

#include <study/Planes.h>
#include <study/Study.h>

#include <cstddef>

namespace cli {

/// A plane's own coordinates in millimetres: x along its direction to the right, y along its
/// direction down, both from the world's origin. On an axial plane they are the patient's.
struct PlaneFrame {
  study::Vec3 right, down, normal;

  explicit PlaneFrame(const dCoordSys3D& plane);
  double X(const study::Vec3& world) const { return Dot(world, right); }
  double Y(const study::Vec3& world) const { return Dot(world, down); }
};

struct PlanePoint {
  double x = 0;
  double y = 0;
};

/// A way between two points of a plane.
struct PlaneLine {
  PlanePoint start, end;
};

/// A rectangle of a plane; left < right, top < bottom.
struct PlaneRect {
  double left = 0;
  double top = 0;
  double right = 0;
  double bottom = 0;
};

/// The pixels of a cut: pixel (i, j) begins at (left + i * spacing, top + j * spacingDown).
struct PixelGrid {
  double left = 0;
  double top = 0;
  double spacing = 1;
  double spacingDown = 1;
  int width = 0;
  int height = 0;

  /// Of a cut as `CutPlane` makes it.
  explicit PixelGrid(const study::Study& cut);
  double CentreX(int i) const { return left + (i + 0.5) * spacing; }
  double CentreY(int j) const { return top + (j + 0.5) * spacingDown; }
};

/// Real values of samples.
struct Statistics {
  std::size_t count = 0;
  double mean = 0;
  double deviation =
      0;  ///< the standard deviation: the root of the mean squared distance to `mean`
  double minimum = 0;
  double maximum = 0;
};

/// Of the pixels of a cut whose centres lie in the rectangle, its left and top edges included. All
/// 0 where there are none.
Statistics StatisticsOf(const study::Study& cut, const PlaneRect& rect);

}  // namespace cli

#endif
