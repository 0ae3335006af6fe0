#include "PlaneModel.h"

#include <cmath>
#include <numbers>

namespace cli_test {
namespace {

/// How far from a voxel's border a point must lie to be decided.
double BorderOf(const PlaneModel& plane) {
  return 1e-3 + (plane.width + plane.height + plane.steps) / 65536.0;
}

double Dot(const Point& a, const Point& b) {
  return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

Point Cross(const Point& a, const Point& b) {
  return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

/// a + f * b
Point Plus(const Point& a, double f, const Point& b) {
  return {a[0] + f * b[0], a[1] + f * b[1], a[2] + f * b[2]};
}

/// Turns two vectors of a right angle in their own plane: the first towards the second.
void TurnPair(Point& first, Point& second, double degrees) {
  const double angle = degrees * std::numbers::pi / 180;
  const Point old = first;
  first = Plus(Point{}, std::cos(angle), old);
  first = Plus(first, std::sin(angle), second);
  second = Plus(Plus(Point{}, std::cos(angle), second), -std::sin(angle), old);
}

/// Voxel coordinates, voxel centres at whole numbers, by Cramer's rule.
Point VoxelAt(const VolumeModel& volume, const Point& world) {
  const Point from = Plus(world, -1, volume.firstVoxel);
  const auto& [x, y, z] = volume.step;
  const double determinant = Dot(x, Cross(y, z));
  return {Dot(from, Cross(y, z)) / determinant, Dot(from, Cross(z, x)) / determinant,
          Dot(from, Cross(x, y)) / determinant};
}

enum class Place { Inside, Outside, Border };

Place Locate(const VolumeModel& volume, const Point& voxel, double border,
             std::array<int, 3>& index) {
  Place place = Place::Inside;
  for (std::size_t n = 0; n < 3; ++n) {
    const double cell = voxel[n] + 0.5;
    if (std::abs(cell - std::round(cell)) < border) {
      return Place::Border;
    }
    index[n] = static_cast<int>(std::floor(cell));
    if (index[n] < 0 || index[n] >= volume.size[n]) {
      place = Place::Outside;
    }
  }
  return place;
}

std::optional<int> SampleAt(const VolumeModel& volume, const PlaneModel& plane,
                            const Point& point) {
  const Point normal = Cross(plane.right, plane.down);
  long sum = 0;
  long count = 0;
  for (int k = 0; k < plane.steps; ++k) {
    const double depth =
        plane.steps > 1 ? plane.thickness * (-0.5 + static_cast<double>(k) / (plane.steps - 1)) : 0;
    std::array<int, 3> index{};
    const Place place =
        Locate(volume, VoxelAt(volume, Plus(point, depth, normal)), BorderOf(plane), index);
    if (place == Place::Border) {
      return std::nullopt;
    }
    if (place == Place::Inside) {
      sum += volume.stored(index[0], index[1], index[2]);
      ++count;
    }
  }
  return count > 0 ? static_cast<int>(sum / count) : 0;
}

}  // namespace

PlaneModel PlaneModel::Turned(double aboutRight, double aboutDown, double aboutNormal) const {
  PlaneModel turned = *this;
  Point normal = Cross(right, down);
  TurnPair(turned.down, normal, aboutRight);
  TurnPair(normal, turned.right, aboutDown);
  TurnPair(turned.right, turned.down, aboutNormal);
  return turned;
}

PlaneModel AxialPlane() {
  PlaneModel plane;
  plane.right = {1, 0, 0};
  plane.down = {0, 1, 0};
  return plane;
}

PlaneModel CoronalPlane() {
  PlaneModel plane;
  plane.right = {1, 0, 0};
  plane.down = {0, 0, -1};
  return plane;
}

PlaneModel SagittalPlane() {
  PlaneModel plane;
  plane.right = {0, 1, 0};
  plane.down = {0, 0, -1};
  return plane;
}

std::vector<std::optional<int>> NearestSamples(const VolumeModel& volume, const PlaneModel& plane) {
  std::vector<std::optional<int>> samples;
  for (int y = 0; y < plane.height; ++y) {
    for (int x = 0; x < plane.width; ++x) {
      const double across = (x - 0.5 * (plane.width - 1)) * plane.spacing;
      const double along = (y - 0.5 * (plane.height - 1)) * plane.spacing;
      const Point point = Plus(Plus(plane.centre, across, plane.right), along, plane.down);
      samples.push_back(SampleAt(volume, plane, point));
    }
  }
  return samples;
}

Comparison Compare(const std::vector<std::optional<int>>& expected,
                   const std::vector<std::uint16_t>& actual) {
  Comparison comparison;
  for (std::size_t i = 0; i < expected.size() && i < actual.size(); ++i) {
    if (!expected[i]) {
      ++comparison.undecided;
    } else if (*expected[i] == actual[i]) {
      ++comparison.equal;
    } else {
      ++comparison.different;
    }
  }
  comparison.different += expected.size() > actual.size() ? expected.size() - actual.size()
                                                          : actual.size() - expected.size();
  return comparison;
}

}  // namespace cli_test
