#ifndef VORL_APPS_STUDY_PLANES_H
#define VORL_APPS_STUDY_PLANES_H

/// @file
/// Cut planes in patient directions, right side up whatever the acquisition was.

#include <study/Study.h>

#include <optional>
#include <string>
#include <vector>

namespace study {

/// The three standard views. Pictures are seen
/// - axial: from the feet; right is the patient's left, down is the back;
/// - coronal: from the front; right is the patient's left, down is towards the feet;
/// - sagittal: from the patient's left; right is the back, down is towards the feet.
enum class Plane { Axial, Coronal, Sagittal };

/// What is wanted of a plane. Lengths are millimetres.
struct PlaneRequest {
  Plane plane = Plane::Axial;
  /// A world point on the plane. Without one: the centre of the volume's middle voxel, so that a
  /// plane along the acquisition shows one slice and not the boundary of two.
  std::optional<Vec3> centre;
  /// Turns the plane about the centre by degrees: first about its own direction to the right, then
  /// about its own direction down, then about its normal. Positive angles are right-handed.
  double turnAboutRight = 0;
  double turnAboutDown = 0;
  double turnAboutNormal = 0;
  /// Then turns it about the patient's own axis from feet to head, as if the patient stood on a
  /// turntable: 90 degrees take the view from the front to the one from the patient's left.
  double turnAboutBodyAxis = 0;
  /// Pixels; 0: as many as show the whole volume. A size that is given is centred on `centre`.
  int width = 0;
  int height = 0;
  /// From pixel to pixel, the same in both directions; 0: the smallest voxel spacing.
  double spacing = 0;
  /// From row to row, where that is to be another distance; 0: as from pixel to pixel.
  double spacingDown = 0;
  /// Of the slab; 0: a thin plane.
  double thickness = 0;
};

/// A plane ready for an output slice.
///
/// The sampling operators take pixel (x, y) at the point (x, y, 0) of the slice's coordinates, so
/// `coordinates.origin` is the world position of the centre of pixel (0, 0), unlike a volume's
/// origin, which is the outer corner of its first voxel. axisX points right and axisY down, as long
/// as the distances of pixels and rows; axisZ is perpendicular to both and as long as the slab is
/// thick.
struct PlaneGeometry {
  dCoordSys3D coordinates;
  int width = 0;
  int height = 0;
  double spacing = 1;  ///< from pixel to pixel
};

/// Places a plane. Throws `Error` when the numbers of the request make no sense, or when the
/// picture would have more than 32,767 pixels on a side.
PlaneGeometry MakePlane(const Study& study, const PlaneRequest& request);

/// The same plane for trilinear sampling. The operators take a voxel's value for its whole cell
/// when they sample the nearest voxel, but for the cell's lower corner when they interpolate;
/// moving the plane by half a voxel along each axis makes both pictures show a thing at the same
/// place. (The outermost half voxel at the low sides of the volume then counts as outside.) A plane
/// through voxel centres stays one in single precision.
dCoordSys3D ForTrilinear(const Study& study, const dCoordSys3D& plane);

/// The planes of a stack: `count` copies of `plane`, `distance` millimetres apart along its normal,
/// centred on it.
std::vector<PlaneGeometry> StackPlanes(const PlaneGeometry& plane, int count, double distance);

/// How far the volume reaches in the direction of the unit vector `direction`, in millimetres along
/// it from the world's origin.
struct Extent {
  double minimum = 0;
  double maximum = 0;
};
Extent ExtentAlong(const Study& study, const Vec3& direction);

/// The shortest distance between neighbouring voxels, in millimetres.
double SmallestSpacing(const Study& study);

/// The letter of the patient direction that `direction` is nearest to: L, R, P, A, H (head) or
/// F (feet).
char DirectionLetter(const Vec3& direction);

}  // namespace study

#endif
