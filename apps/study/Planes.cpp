#include <study/Error.h>
#include <study/Planes.h>
#include <vorl/Data/dTrafo.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <numbers>

namespace study {
namespace {

constexpr double kLongestMm = 1e6;
constexpr double kSmallestSpacingMm = 1e-4;
constexpr double kRoundingVoxels = 1e-3;
constexpr int kAttempts = 8;

/// Right, down and normal of a plane.
struct Frame {
  Vec3 right, down, normal;
};

Frame StandardFrame(Plane plane) {
  switch (plane) {
    case Plane::Axial:
      return {{1, 0, 0}, {0, 1, 0}, {0, 0, 1}};
    case Plane::Coronal:
      return {{1, 0, 0}, {0, 0, -1}, {0, 1, 0}};
    case Plane::Sagittal:
      return {{0, 1, 0}, {0, 0, -1}, {-1, 0, 0}};
  }
  throw Error("there is no such plane");
}

void Turn(Frame& frame, const Vec3& axis, double degrees) {
  if (degrees == 0) {
    return;
  }
  const double radians = degrees * std::numbers::pi / 180;
  frame = {Rotated(frame.right, axis, radians), Rotated(frame.down, axis, radians),
           Rotated(frame.normal, axis, radians)};
}

Frame FrameOf(const PlaneRequest& request) {
  Frame frame = StandardFrame(request.plane);
  Turn(frame, frame.right, request.turnAboutRight);
  Turn(frame, frame.down, request.turnAboutDown);
  Turn(frame, frame.normal, request.turnAboutNormal);
  Turn(frame, {0, 0, 1}, request.turnAboutBodyAxis);
  return frame;
}

void Require(bool holds, const char* what) {
  if (!holds) {
    throw Error(what);
  }
}

bool IsLength(double value) {
  return value >= 0 && value <= kLongestMm;
}

void CheckRequest(const PlaneRequest& request) {
  Require(std::isfinite(request.turnAboutRight) && std::isfinite(request.turnAboutDown) &&
              std::isfinite(request.turnAboutNormal) && std::isfinite(request.turnAboutBodyAxis),
          "the angles of the plane are not finite");
  Require(!request.centre || (IsFinite(*request.centre) && Length(*request.centre) <= kLongestMm),
          "the centre of the plane is not within a kilometre");
  Require(IsLength(request.spacing) && IsLength(request.spacingDown) && IsLength(request.thickness),
          "the spacing and thickness of the plane must be positive numbers of millimetres");
  for (const double spacing : {request.spacing, request.spacingDown}) {
    Require(spacing == 0 || spacing >= kSmallestSpacingMm,
            "the spacing of the plane is less than 0.0001 mm");
  }
  Require(request.width >= 0 && request.height >= 0, "the size of the plane is negative");
}

/// The centre of the middle voxel.
Vec3 MiddleVoxel(const Study& study) {
  const auto middle = [](int size) { return size / 2 + 0.5; };
  return WorldFromVoxel(study, {middle(study.volume.GetSizeX()), middle(study.volume.GetSizeY()),
                                middle(study.volume.GetSizeZ())});
}

/// The pixels of one direction: how many, and where the centre of the first lies along it.
struct Row {
  int count;
  double first;
};

Row PlaceRow(const Study& study, const Vec3& direction, int wanted, double centre, double spacing) {
  if (wanted > 0) {
    return {wanted, centre - 0.5 * (wanted - 1) * spacing};
  }
  const Extent extent = ExtentAlong(study, direction);
  // A thousandth of a pixel too much does not deserve another one: it is rounding.
  const double pixels = std::ceil((extent.maximum - extent.minimum) / spacing - 1e-3);
  Require(pixels <= kLargestVolumeSide, "the picture would have more than 32767 pixels on a side");
  const int count = std::max(1, static_cast<int>(pixels));
  return {count, 0.5 * (extent.minimum + extent.maximum) - 0.5 * (count - 1) * spacing};
}

/// A thin plane has no thickness of its own, but its coordinates must be invertible.
double AxisLength(double thickness, double spacing, double spacingDown) {
  if (thickness > 0) {
    return thickness;
  }
  return std::max(spacing, 1e-5 / (spacing * spacingDown));
}

/// How much the plane's first sample lacks to whole voxel coordinates that it misses only by the
/// rounding of single precision. Below 0, such a sample would count as outside the volume.
Vec3 MissingToWhole(const dCoordSys3D& plane, const dCoordSys3D& volume) {
  dVect3D start;
  dTrafo3D(plane, volume).pS2T(dVect3D(), start);
  const auto missing = [](double coordinate) {
    const double lack = std::ceil(coordinate) - coordinate;
    return lack > 0 && lack < kRoundingVoxels ? lack : 0.0;
  };
  return {missing(start.x), missing(start.y), missing(start.z)};
}

}  // namespace

PlaneGeometry MakePlane(const Study& study, const PlaneRequest& request) {
  Require(study.volume.IsValid(), "the study is empty");
  CheckRequest(request);
  Require(request.width <= kLargestVolumeSide && request.height <= kLargestVolumeSide,
          "the picture would have more than 32767 pixels on a side");
  const Frame frame = FrameOf(request);
  const Vec3 centre = request.centre.value_or(MiddleVoxel(study));
  PlaneGeometry plane;
  plane.spacing = request.spacing > 0 ? request.spacing : SmallestSpacing(study);
  const double spacingDown = request.spacingDown > 0 ? request.spacingDown : plane.spacing;
  const Row across =
      PlaceRow(study, frame.right, request.width, Dot(centre, frame.right), plane.spacing);
  const Row along =
      PlaceRow(study, frame.down, request.height, Dot(centre, frame.down), spacingDown);
  plane.width = across.count;
  plane.height = along.count;

  const Vec3 origin = frame.right * across.first + frame.down * along.first +
                      frame.normal * Dot(centre, frame.normal);
  const double depth = AxisLength(request.thickness, plane.spacing, spacingDown);
  plane.coordinates.Set(ToVect(origin), ToVect(frame.right * plane.spacing),
                        ToVect(frame.down * spacingDown), ToVect(frame.normal * depth));
  Require(PlacementProblem(plane.coordinates).empty(), "the plane's pixels are too small");
  return plane;
}

dCoordSys3D ForTrilinear(const Study& study, const dCoordSys3D& plane) {
  const dCoordSys3D& volume = study.volume.GetCoordinates();
  const std::array<Vec3, 3> axes{ToVec3(volume.axisX), ToVec3(volume.axisY), ToVec3(volume.axisZ)};
  dCoordSys3D moved = plane;
  moved.origin = ToVect(ToVec3(plane.origin) - 0.5 * (axes[0] + axes[1] + axes[2]));
  for (int attempt = 0; attempt < kAttempts; ++attempt) {
    const Vec3 lift = MissingToWhole(moved, volume);
    if (lift == Vec3{}) {
      break;
    }
    const double more = 1 + attempt;  // the step must outgrow the rounding of the origin
    moved.origin = ToVect(ToVec3(moved.origin) +
                          (axes[0] * lift.x + axes[1] * lift.y + axes[2] * lift.z) * more);
  }
  return moved;
}

std::vector<PlaneGeometry> StackPlanes(const PlaneGeometry& plane, int count, double distance) {
  const Vec3 normal = Normalised(ToVec3(plane.coordinates.axisZ));
  std::vector<PlaneGeometry> planes;
  for (int i = 0; i < count; ++i) {
    planes.push_back(plane);
    const double along = (i - 0.5 * (count - 1)) * distance;
    planes.back().coordinates.origin = ToVect(ToVec3(plane.coordinates.origin) + normal * along);
  }
  return planes;
}

Extent ExtentAlong(const Study& study, const Vec3& direction) {
  Extent extent{std::numeric_limits<double>::infinity(), -std::numeric_limits<double>::infinity()};
  for (int corner = 0; corner < 8; ++corner) {
    const Vec3 voxel{(corner & 1) != 0 ? double(study.volume.GetSizeX()) : 0.0,
                     (corner & 2) != 0 ? double(study.volume.GetSizeY()) : 0.0,
                     (corner & 4) != 0 ? double(study.volume.GetSizeZ()) : 0.0};
    const double along = Dot(WorldFromVoxel(study, voxel), direction);
    extent.minimum = std::min(extent.minimum, along);
    extent.maximum = std::max(extent.maximum, along);
  }
  return extent;
}

double SmallestSpacing(const Study& study) {
  const dCoordSys3D& volume = study.volume.GetCoordinates();
  return std::min(
      {Length(ToVec3(volume.axisX)), Length(ToVec3(volume.axisY)), Length(ToVec3(volume.axisZ))});
}

char DirectionLetter(const Vec3& direction) {
  const std::array<double, 3> size{std::abs(direction.x), std::abs(direction.y),
                                   std::abs(direction.z)};
  const auto largest = std::max_element(size.begin(), size.end()) - size.begin();
  if (largest == 0) {
    return direction.x > 0 ? 'L' : 'R';
  }
  if (largest == 1) {
    return direction.y > 0 ? 'P' : 'A';
  }
  return direction.z > 0 ? 'H' : 'F';
}

}  // namespace study
