#include <study/Phantom.h>
#include <study/phantom/Shapes.h>

#include <algorithm>
#include <string>
#include <vector>

// How the phantom is made:
// 1. Each slice is filled with air inside the round field of view.
// 2. The solids are painted over it in turn, each within its own box.
// 3. Noise is added: a little everywhere, a coarse grain in spongy bone.
// 4. When all slices are there, the smallest value becomes 0.

namespace study {
namespace {

constexpr std::int16_t kNothing = -1024;
constexpr std::int16_t kAir = -1000;
constexpr std::int16_t kLargestValue = 3000;
constexpr std::int64_t kMostVoxels = std::int64_t{1} << 31;
constexpr double kGrainMm = 3;

/// The voxel centres along one direction.
struct Raster {
  int count;
  double first;
  double step;

  Raster(int voxels, double length)
      : count(voxels), first(-0.5 * length + 0.5 * length / voxels), step(length / voxels) {}

  double At(int index) const { return first + step * index; }
  /// The first index at or after `position`, and the first one after it.
  int From(double position) const { return Clamped((position - first) / step - 1e-9, 0); }
  int Behind(double position) const { return Clamped((position - first) / step + 1e-9, 1); }

 private:
  /// The smallest whole number not less than `index` (0), or the one above the largest not greater
  /// than it (1), within 0 to `count`.
  int Clamped(double index, int above) const {
    if (!(index > -1)) {
      return 0;
    }
    if (index > count) {
      return count;
    }
    const double whole = above != 0 ? std::floor(index) + 1 : std::ceil(index);
    return std::clamp(static_cast<int>(whole), 0, count);
  }
};

struct Grid {
  Raster x, y, z;
};

/// A slice of values in Hounsfield units.
using Values = std::vector<std::int16_t>;

void FillWithAir(const Grid& grid, Values& values) {
  const double radius = 0.5 * kPhantomWidthMm;
  std::size_t at = 0;
  for (int j = 0; j < grid.y.count; ++j) {
    for (int i = 0; i < grid.x.count; ++i) {
      const double x = grid.x.At(i);
      const double y = grid.y.At(j);
      values[at++] = x * x + y * y <= radius * radius ? kAir : kNothing;
    }
  }
}

void Paint(const Grid& grid, double z, const Shape& shape, Values& values) {
  const Vec3 lower = shape.Lower();
  const Vec3 upper = shape.Upper();
  if (z < lower.z || z > upper.z) {
    return;
  }
  const int firstColumn = grid.x.From(lower.x);
  const int behindColumn = grid.x.Behind(upper.x);
  for (int j = grid.y.From(lower.y); j < grid.y.Behind(upper.y); ++j) {
    std::int16_t* row = values.data() + static_cast<std::ptrdiff_t>(j) * grid.x.count;
    for (int i = firstColumn; i < behindColumn; ++i) {
      if (row[i] <= shape.onlyUpTo && shape.Contains({grid.x.At(i), grid.y.At(j), z})) {
        row[i] = shape.value;
      }
    }
  }
}

/// Spreads three coordinates over 32 bits; wraps.
std::uint32_t Hash(std::uint32_t x, std::uint32_t y, std::uint32_t z) {
  std::uint32_t h = x * 0x8DA6B343u ^ y * 0xD8163841u ^ z * 0xCB1AB31Fu;
  h = (h ^ (h >> 15)) * 0x2C1B3C6Du;
  h = (h ^ (h >> 12)) * 0x297A2D39u;
  return h ^ (h >> 15);
}

/// From -amplitude to amplitude.
int Spread(std::uint32_t hash, int amplitude) {
  return static_cast<int>(hash % static_cast<std::uint32_t>(2 * amplitude + 1)) - amplitude;
}

std::uint32_t Grain(double position) {
  return static_cast<std::uint32_t>(static_cast<std::int32_t>(std::floor(position / kGrainMm)));
}

void AddNoise(const Grid& grid, int k, Values& values) {
  std::size_t at = 0;
  for (int j = 0; j < grid.y.count; ++j) {
    for (int i = 0; i < grid.x.count; ++i) {
      const int value = values[at];
      if (value != kNothing) {
        int noise = Spread(Hash(static_cast<std::uint32_t>(i), static_cast<std::uint32_t>(j),
                                static_cast<std::uint32_t>(k)),
                           8);
        if (value == kSpongyBone) {
          noise += Spread(Hash(Grain(grid.x.At(i)), Grain(grid.y.At(j)), Grain(grid.z.At(k))), 90);
        }
        values[at] =
            static_cast<std::int16_t>(std::clamp<int>(value + noise, kNothing, kLargestValue));
      }
      ++at;
    }
  }
}

void CheckSize(int width, int height, int slices) {
  const std::string size =
      std::to_string(width) + " x " + std::to_string(height) + " x " + std::to_string(slices);
  for (const int side : {width, height, slices}) {
    if (side < 1 || side > kLargestVolumeSide) {
      throw Error("a phantom of " + size + " voxels: each side must be from 1 to 32767");
    }
  }
  if (std::int64_t{width} * height > kMostVoxels / slices) {
    throw Error("a phantom of " + size + " voxels has more than 2147483648 of them");
  }
}

/// Turns values (as two's complement) into stored ones: the smallest becomes 0.
void StoreFromSmallest(Study& study, int smallest) {
  study.offset = smallest;
  for (dSlice& slice : study.volume.GetSliceList()) {
    for (std::uint16_t& sample : SamplesOf(slice)) {
      sample = static_cast<std::uint16_t>(static_cast<std::int16_t>(sample) - smallest);
    }
  }
}

}  // namespace

std::unique_ptr<Study> MakePhantom(int width, int height, int slices, const Progress& progress) {
  CheckSize(width, height, slices);
  auto study = std::make_unique<Study>();
  study->unit = "HU";
  study->modality = "CT";
  study->description = "Phantom";
  study->windowCentre = 40;
  study->windowWidth = 400;

  const Grid grid{{width, kPhantomWidthMm}, {height, kPhantomDepthMm}, {slices, kPhantomHeightMm}};
  const std::vector<Shape> shapes = TorsoShapes();
  Values values(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
  int smallest = kLargestValue;
  for (int k = 0; k < slices; ++k) {
    Report(progress, static_cast<double>(k) / slices, "making the phantom");
    FillWithAir(grid, values);
    for (const Shape& shape : shapes) {
      Paint(grid, grid.z.At(k), shape, values);
    }
    AddNoise(grid, k, values);
    smallest = std::min<int>(smallest, *std::min_element(values.begin(), values.end()));
    const auto samples = AppendSlice(*study, width, height);
    std::copy(values.begin(), values.end(), samples.begin());
  }
  StoreFromSmallest(*study, smallest);
  PlaceVolume(*study, {grid.x.first, grid.y.first, grid.z.first}, {grid.x.step, 0, 0},
              {0, grid.y.step, 0}, {0, 0, grid.z.step});
  Report(progress, 1, "made the phantom");
  return study;
}

}  // namespace study
