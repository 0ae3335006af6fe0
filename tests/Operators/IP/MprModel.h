#ifndef TESTS_OPERATORS_IP_MPRMODEL_H
#define TESTS_OPERATORS_IP_MPRMODEL_H

/// @file
/// What multi-planar reconstruction is, written plainly: every pixel on its own, each position from
/// its definition instead of by walking, all arithmetic in 64 bits and cut to 32 where the operator
/// has no more.

#include <vorl/Data/dTrafo.h>
#include <vorl/Data/dVolume.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <vector>

namespace mpr_model {

/// The value as a signed 32-bit number, what lies above dropped.
inline std::int64_t Cut(std::int64_t value) {
  const std::int64_t low = value & 0xFFFFFFFFLL;
  return low >= 0x80000000LL ? low - 0x100000000LL : low;
}

/// Rounded down.
inline std::int64_t Over65536(std::int64_t value) {
  return value >= 0 ? value / 65536 : -((-value + 65535) / 65536);
}

struct Triple {
  std::int64_t x, y, z;
};

inline Triple Fixed(const dVect3D& v) {
  const auto fixed = [](double value) {
    // Truncated; as near as 32 bits come to what they do not hold.
    return static_cast<std::int64_t>(
        std::trunc(std::clamp(value * 65536.0, -2147483648.0, 2147483647.0)));
  };
  return {fixed(v.x), fixed(v.y), fixed(v.z)};
}

inline Triple Along(const Triple& from, const Triple& step, std::int64_t count) {
  return {Cut(from.x + step.x * count), Cut(from.y + step.y * count), Cut(from.z + step.z * count)};
}

/// What the cases of a test have met, so that the test can tell whether it tested anything.
struct Coverage {
  long inside = 0;
  long outside = 0;
  long partlyInside = 0;  ///< thick pixels with samples on either side
  long wrapped = 0;       ///< products beyond 32 bits
  long floored = 0;
  long onLastPlane = 0;  ///< samples whose next neighbour would be outside
};

template <class T>
class Model {
 public:
  Model(const dVolume& volume, bool trilinear, Coverage& coverage)
      : m_width(volume.GetSizeX()),
        m_height(volume.GetSizeY()),
        m_trilinear(trilinear),
        m_coverage(coverage) {
    for (const dSlice& slice : volume.GetSliceList()) {
      m_slices.push_back(static_cast<const T*>(slice.GetImage().GetDataPtr()));
    }
    const dImage& first = volume.GetSliceList().front().GetImage();
    m_pitch = static_cast<std::int64_t>(first.GetBytesPerRow() / sizeof(T));
  }

  /// The pixels of `slice`, row by row.
  std::vector<T> Run(const dSlice& slice, const dCoordSys3D& volume, int depthSteps) {
    const dTrafo3D toVolume(slice.GetCoordinates(), volume);
    const bool thick = depthSteps != 0;
    dVect3D corner(0.0F, 0.0F, thick ? -0.5F : 0.0F);
    toVolume.pS2T(corner);
    const Triple start = Fixed(corner);
    const Triple right = Fixed(toVolume.s2t[0]);
    const Triple down = Fixed(toVolume.s2t[1]);
    const Triple through = Fixed(toVolume.s2t[2]);

    std::vector<T> pixels;
    for (int y = 0; y < slice.GetHeight(); ++y) {
      for (int x = 0; x < slice.GetWidth(); ++x) {
        const Triple point = Along(Along(start, down, y), right, x);
        const std::int64_t value = thick ? Mean(point, through, depthSteps) : Thin(point);
        pixels.push_back(static_cast<T>(value));  // the low 16 bits
      }
    }
    return pixels;
  }

 private:
  bool IsInside(const Triple& p) const {
    const auto depth = static_cast<std::int64_t>(m_slices.size());
    return p.x >= 0 && p.x < m_width * 65536 && p.y >= 0 && p.y < m_height * 65536 && p.z >= 0 &&
           p.z < depth * 65536;
  }

  std::int64_t Thin(const Triple& point) {
    const bool inside = IsInside(point);
    ++(inside ? m_coverage.inside : m_coverage.outside);
    return inside ? Sample(point) : 0;
  }

  std::int64_t Mean(const Triple& first, const Triple& through, int depthSteps) {
    std::int64_t n = depthSteps;
    if (n < 0) {
      n = std::max({std::abs(through.x), std::abs(through.y), std::abs(through.z)}) / 65536;
    }
    n = std::max<std::int64_t>(n, 2);
    const Triple step = {through.x / (n - 1), through.y / (n - 1), through.z / (n - 1)};
    std::int64_t sum = 0;
    std::int64_t count = 0;
    for (std::int64_t k = 0; k < n; ++k) {
      const Triple point = Along(first, step, k);
      if (IsInside(point)) {
        sum = Cut(sum + Sample(point));
        ++count;
      }
    }
    m_coverage.partlyInside += count > 0 && count < n ? 1 : 0;
    ++(count != 0 ? m_coverage.inside : m_coverage.outside);
    return count != 0 ? sum / count : 0;
  }

  std::int64_t Sample(const Triple& p) {
    const std::int64_t x = p.x / 65536, y = p.y / 65536, z = p.z / 65536;
    return m_trilinear ? Interpolated(p, x, y, z)
                       : m_slices[static_cast<std::size_t>(z)][y * m_width + x];
  }

  // start + (difference * fraction) / 65536
  std::int64_t Weigh(std::int64_t start, std::int64_t difference, std::int64_t fraction) {
    const std::int64_t product = Cut(difference) * fraction;
    m_coverage.wrapped += Cut(product) != product ? 1 : 0;
    return Cut(start + Over65536(Cut(product)));
  }

  std::int64_t InPlane(std::int64_t z, std::int64_t x, std::int64_t y, std::int64_t fx,
                       std::int64_t fy) {
    const T* plane = m_slices[static_cast<std::size_t>(z)];
    const std::int64_t x1 = std::min(x + 1, m_width - 1), y1 = std::min(y + 1, m_height - 1);
    const std::int64_t a00 = plane[y * m_pitch + x], a01 = plane[y * m_pitch + x1];
    const std::int64_t a10 = plane[y1 * m_pitch + x], a11 = plane[y1 * m_pitch + x1];
    const std::int64_t a = Weigh(a00, a01 - a00, fx);
    const std::int64_t b = Weigh(a10, a10 - a11, fx);  // reversed
    return Weigh(a, b - a, fy);
  }

  std::int64_t Interpolated(const Triple& p, std::int64_t x, std::int64_t y, std::int64_t z) {
    const auto depth = static_cast<std::int64_t>(m_slices.size());
    m_coverage.onLastPlane += x == m_width - 1 || y == m_height - 1 || z == depth - 1 ? 1 : 0;
    const std::int64_t fx = p.x % 65536, fy = p.y % 65536, fz = p.z % 65536;
    const std::int64_t below = InPlane(z, x, y, fx, fy);
    const std::int64_t above = InPlane(std::min(z + 1, depth - 1), x, y, fx, fy);
    const std::int64_t value = Weigh(below, above - below, fz);
    m_coverage.floored += value < 0 ? 1 : 0;
    return std::max<std::int64_t>(value, 0);
  }

  std::int64_t m_width;
  std::int64_t m_height;
  std::int64_t m_pitch;
  bool m_trilinear;
  Coverage& m_coverage;
  std::vector<const T*> m_slices;
};

}  // namespace mpr_model

#endif
