#include <study/Error.h>
#include <study/Study.h>

#include <cmath>
#include <iterator>

namespace study {
namespace {

constexpr double kFarthestMm = 1e6;

struct Axes {
  Vec3 origin, x, y, z;
};

Axes AxesOf(const dCoordSys3D& coordinates) {
  return {ToVec3(coordinates.origin), ToVec3(coordinates.axisX), ToVec3(coordinates.axisY),
          ToVec3(coordinates.axisZ)};
}

double Determinant(const Axes& axes) {
  return Dot(axes.x, Cross(axes.y, axes.z));
}

bool IsInside(double coordinate, int size) {
  return coordinate >= 0 && coordinate < size;
}

}  // namespace

std::string PlacementProblem(const dCoordSys3D& coordinates) {
  const Axes axes = AxesOf(coordinates);
  if (!IsFinite(axes.origin) || !IsFinite(axes.x) || !IsFinite(axes.y) || !IsFinite(axes.z)) {
    return "the position of the volume is not finite";
  }
  for (const Vec3& v : {axes.origin, axes.x, axes.y, axes.z}) {
    if (Length(v) > kFarthestMm) {
      return "the volume reaches beyond a kilometre";
    }
  }
  const double volume = std::abs(Determinant(axes));
  // The library's limit is 1e-6 on numbers in single precision; keep clear of its rounding.
  if (volume <= 1.001e-6) {
    return "the voxels are too small or flat (more than 0.000001 cubic millimetres are needed)";
  }
  return {};
}

std::span<std::uint16_t> AppendSlice(Study& study, int width, int height) {
  dSlice slice;
  dImage& image = slice.GetImage();
  const bool made =
      image.Init(static_cast<unsigned long>(width), static_cast<unsigned long>(height),
                 ImageDataType_U16, "G", ImageDataOrder_Pixel, 2);
  if (!made || !image.Fill(0)) {
    throw Error("no memory for a slice of " + std::to_string(width) + " x " +
                std::to_string(height) + " voxels");
  }
  if (study.volume.AddSlice(slice) < 0) {
    throw Error("a slice of " + std::to_string(width) + " x " + std::to_string(height) +
                " voxels does not fit the volume");
  }
  return SamplesOf(study.volume.GetSliceList().back());
}

std::span<std::uint16_t> SamplesOf(dSlice& slice) {
  const dImage& image = slice.GetImage();
  return {static_cast<std::uint16_t*>(image.GetDataPtr()),
          std::size_t{image.GetWidth()} * image.GetHeight()};
}

std::span<const std::uint16_t> SamplesOf(const dSlice& slice) {
  const dImage& image = slice.GetImage();
  return {static_cast<const std::uint16_t*>(image.GetDataPtr()),
          std::size_t{image.GetWidth()} * image.GetHeight()};
}

void PlaceVolume(Study& study, const Vec3& firstVoxel, const Vec3& axisX, const Vec3& axisY,
                 const Vec3& axisZ) {
  const Vec3 corner = firstVoxel - 0.5 * (axisX + axisY + axisZ);
  const dCoordSys3D coordinates(ToVect(corner), ToVect(axisX), ToVect(axisY), ToVect(axisZ));
  const std::string problem = PlacementProblem(coordinates);
  if (!problem.empty()) {
    throw Error(problem);
  }
  study.volume.GetCoordinates() = coordinates;
  double k = 0;
  for (dSlice& slice : study.volume.GetSliceList()) {
    slice.SetCoordinates(coordinates);
    slice.SetPosition(ToVect(corner + k * axisZ));
    k += 1;
  }
}

Vec3 WorldFromVoxel(const Study& study, const Vec3& voxel) {
  const Axes axes = AxesOf(study.volume.GetCoordinates());
  return axes.origin + axes.x * voxel.x + axes.y * voxel.y + axes.z * voxel.z;
}

Vec3 VoxelFromWorld(const Study& study, const Vec3& world) {
  const Axes axes = AxesOf(study.volume.GetCoordinates());
  const Vec3 from = world - axes.origin;
  const double scale = 1 / Determinant(axes);
  return {Dot(from, Cross(axes.y, axes.z)) * scale, Dot(from, Cross(axes.z, axes.x)) * scale,
          Dot(from, Cross(axes.x, axes.y)) * scale};
}

std::optional<double> RealValueAt(const Study& study, const Vec3& world) {
  const Vec3 voxel = VoxelFromWorld(study, world);
  const dVolume& volume = study.volume;
  if (!IsInside(voxel.x, volume.GetSizeX()) || !IsInside(voxel.y, volume.GetSizeY()) ||
      !IsInside(voxel.z, volume.GetSizeZ())) {
    return std::nullopt;
  }
  const dSlice* slice = volume.GetSlice(static_cast<int>(voxel.z));
  const auto row = static_cast<std::size_t>(voxel.y);
  const auto column = static_cast<std::size_t>(voxel.x);
  return study.RealValue(
      SamplesOf(*slice)[row * static_cast<std::size_t>(volume.GetSizeX()) + column]);
}

}  // namespace study
