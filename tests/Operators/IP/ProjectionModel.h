#ifndef TESTS_OPERATORS_IP_PROJECTIONMODEL_H
#define TESTS_OPERATORS_IP_PROJECTIONMODEL_H

/// @file
/// What drawing into a projection plane through a depth buffer is, written plainly.

#include <vorl/Operators/IP/opSliceProjection.h>

#include "VolumeModel.h"

namespace projection_model {

using volume_model::Grid;
using volume_model::Over65536;
using volume_model::Triple;

/// All samples of an image, padding included.
template <class T>
struct Raster {
  explicit Raster(const dImage& image)
      : width(static_cast<std::int64_t>(image.GetWidth())),
        height(static_cast<std::int64_t>(image.GetHeight())),
        pitch(static_cast<std::int64_t>(image.GetBytesPerRow() / sizeof(T))) {
    const auto* first = static_cast<const T*>(image.GetDataPtr());
    samples.assign(first, first + image.GetImageSize() / sizeof(T));
  }

  T& At(std::int64_t x, std::int64_t y) { return samples[static_cast<std::size_t>(y * pitch + x)]; }
  /// As if the rows were not padded.
  T& Dense(std::int64_t x, std::int64_t y) {
    return samples[static_cast<std::size_t>(y * width + x)];
  }
  bool Holds(const Triple& p) const {
    return p.x >= 0 && p.x < width * 65536 && p.y >= 0 && p.y < height * 65536;
  }

  std::int64_t width, height, pitch;
  std::vector<T> samples;
};

/// What the cases of a test have met.
struct Coverage {
  long drawn = 0;
  long border = 0;
  long hidden = 0;
  long ties = 0;
  long outside = 0;
  long noVoxel = 0;         ///< entries that name none of the volume
  long darker = 0;          ///< voxels that would have been drawn, were they brighter
  long limitedByDepth = 0;  ///< rays that end within the volume
  long wholeRays = 0;
};

template <class T>
class Model {
 public:
  Model(const dSlice& plane, const dImage& zBuffer, std::uint16_t borderValue, Coverage& coverage)
      : pixels(plane.GetImage()),
        depths(zBuffer),
        m_place(plane.GetCoordinates()),
        m_border(static_cast<T>(borderValue)),
        m_coverage(coverage) {}

  void DrawSlice(const dSlice& slice) {
    const Grid grid(slice.GetCoordinates(), m_place, 0);
    Raster<T> source(slice.GetImage());
    for (std::int64_t row = 0; row < source.height; ++row) {
      for (std::int64_t column = 0; column < source.width; ++column) {
        const bool border = IsBorder(column, row, source.width, source.height);
        m_coverage.border += border ? 1 : 0;
        DrawPixel(grid.At(column, row), border ? m_border : source.At(column, row));
      }
    }
  }

  void DrawVoxels(const dVolume& volume, const std::vector<std::uint32_t>& entries) {
    const Grid grid(volume.GetCoordinates(), m_place, 0);
    volume_model::Coverage unused;
    const volume_model::Voxels<T> voxels(volume, false, unused);
    for (const std::uint32_t entry : entries) {
      const std::int64_t x = entry % 2048, y = entry / 2048 % 2048;
      const std::int64_t z = entry / 4194304 >= 512 ? entry / 4194304 - 1024LL : entry / 4194304;
      if (z < 0 || x >= voxels.Width() || y >= voxels.Height() || z >= voxels.Depth()) {
        ++m_coverage.noVoxel;
      } else {
        DrawVoxel(grid.At(x, y, z), voxels.At(x, y, z));
      }
    }
  }

  void DrawVolume(const dVolume& volume, bool limitedByDepth = true) {
    const Grid grid(m_place, volume.GetCoordinates(), -0.5F);
    volume_model::Coverage unused;
    volume_model::Voxels<T> voxels(volume, false, unused);
    for (std::int64_t y = 0; y < pixels.height; ++y) {
      for (std::int64_t x = 0; x < pixels.width; ++x) {
        const std::int64_t end = limitedByDepth ? depths.At(x, y) : 32767;
        const T brightest = Brightest(voxels, grid.At(x, y), grid.through, end);
        pixels.At(x, y) = std::max(pixels.At(x, y), brightest);
      }
    }
  }

  Raster<T> pixels;
  Raster<std::int16_t> depths;

 private:
  static bool IsBorder(std::int64_t column, std::int64_t row, std::int64_t width,
                       std::int64_t height) {
    if (column == 0 || column == width - 1) {
      return true;
    }
    if (column >= 8) {
      return row == 0 || row == height - 1;
    }
    return !(row >= 8 && row != height - 1);
  }

  void DrawPixel(const Triple& p, T value) {
    if (!pixels.Holds(p)) {
      ++m_coverage.outside;
      return;
    }
    const std::int64_t depth = Over65536(p.z);
    std::int16_t& nearest = depths.At(p.x / 65536, p.y / 65536);
    if (depth < nearest) {
      nearest = static_cast<std::int16_t>(depth);
      pixels.At(p.x / 65536, p.y / 65536) = value;
      ++m_coverage.drawn;
    } else {
      ++(depth == nearest ? m_coverage.ties : m_coverage.hidden);
    }
  }

  void DrawVoxel(const Triple& p, std::int64_t value) {
    if (!pixels.Holds(p)) {
      ++m_coverage.outside;
      return;
    }
    const std::int64_t x = p.x / 65536, y = p.y / 65536;
    const std::int64_t depth = Over65536(p.z), nearest = depths.Dense(x, y);
    T& pixel = pixels.Dense(x, y);
    if (depth >= nearest) {
      ++(depth == nearest ? m_coverage.ties : m_coverage.hidden);
    } else if (value <= pixel) {
      ++m_coverage.darker;
    } else {
      pixel = static_cast<T>(value);
      ++m_coverage.drawn;
    }
  }

  // The lowest value when there is no voxel on the ray.
  T Brightest(volume_model::Voxels<T>& voxels, const Triple& p, const Triple& ray,
              std::int64_t end) {
    std::int64_t low = -32768, high = end;
    const auto narrow = [&](std::int64_t position, std::int64_t step, std::int64_t limit) {
      if (step != 0) {
        const std::int64_t a = -(position / step), b = (limit * 65536 - position) / step;
        low = std::max(low, std::min(a, b));
        high = std::min(high, std::max(a, b));
      }
    };
    narrow(p.x, ray.x, voxels.Width());
    narrow(p.y, ray.y, voxels.Height());
    narrow(p.z, ray.z, voxels.Depth());
    std::int64_t brightest = std::numeric_limits<T>::min();
    bool any = false;
    for (std::int64_t t = low; t < high; ++t) {
      const Triple point = Along(p, ray, t);
      if (voxels.IsInside(point)) {
        brightest = std::max(brightest, voxels.Sample(point));
        any = true;
      }
    }
    const bool more = any && voxels.IsInside(Along(p, ray, high));
    m_coverage.limitedByDepth += more && high == end ? 1 : 0;
    m_coverage.wholeRays += any && !more ? 1 : 0;
    ++(any ? m_coverage.drawn : m_coverage.outside);
    return static_cast<T>(brightest);
  }

  dCoordSys3D m_place;
  T m_border;
  Coverage& m_coverage;
};

}  // namespace projection_model

#endif
