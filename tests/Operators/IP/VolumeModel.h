#ifndef TESTS_OPERATORS_IP_VOLUMEMODEL_H
#define TESTS_OPERATORS_IP_VOLUMEMODEL_H

/// @file
/// What sampling a volume is, written plainly: every position from its definition instead of by
/// walking, all arithmetic in 64 bits and cut to 32 where the operators have no more.

#include <vorl/Data/dTrafo.h>
#include <vorl/Data/dVolume.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <vector>

namespace volume_model {

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

/// The grid points of one coordinate system in another.
struct Grid {
  /// Begins at (0, 0, depth) of the source.
  Grid(const dCoordSys3D& source, const dCoordSys3D& target, float depth) {
    const dTrafo3D toTarget(source, target);
    dVect3D corner(0.0F, 0.0F, depth);
    toTarget.pS2T(corner);
    start = Fixed(corner);
    right = Fixed(toTarget.s2t[0]);
    down = Fixed(toTarget.s2t[1]);
    through = Fixed(toTarget.s2t[2]);
  }

  Triple At(std::int64_t x, std::int64_t y, std::int64_t z = 0) const {
    return Along(Along(Along(start, right, x), down, y), through, z);
  }

  Triple start, right, down, through;
};

/// The samples of a slab: their number and the way from one to the next.
struct Slab {
  Slab(const Triple& through, int depthSteps) : count(depthSteps) {
    if (count < 0) {
      count = std::max({std::abs(through.x), std::abs(through.y), std::abs(through.z)}) / 65536;
    }
    count = std::max<std::int64_t>(count, 2);
    step = {through.x / (count - 1), through.y / (count - 1), through.z / (count - 1)};
  }

  std::int64_t count;
  Triple step;
};

/// What the cases of a test have met, so that the test can tell whether it tested anything.
struct Coverage {
  long inside = 0;
  long outside = 0;
  long partlyInside = 0;  ///< slabs with samples on either side
  long wrapped = 0;       ///< products beyond 32 bits
  long floored = 0;       ///< results below 0
  long cut = 0;           ///< results beyond the type
  long onLastPlane = 0;   ///< samples whose next neighbour would be outside
};

template <class T>
class Voxels {
 public:
  Voxels(const dVolume& volume, bool trilinear, Coverage& coverage)
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

  std::int64_t Width() const { return m_width; }
  std::int64_t Height() const { return m_height; }
  std::int64_t Depth() const { return static_cast<std::int64_t>(m_slices.size()); }

  bool IsInside(const Triple& p) const {
    return p.x >= 0 && p.x < m_width * 65536 && p.y >= 0 && p.y < m_height * 65536 && p.z >= 0 &&
           p.z < Depth() * 65536;
  }

  /// The sample at a point inside.
  std::int64_t Sample(const Triple& p) {
    const std::int64_t x = p.x / 65536, y = p.y / 65536, z = p.z / 65536;
    return m_trilinear ? Interpolated(p, x, y, z) : At(x, y, z);
  }

  /// A voxel of the volume, its rows taken as `Width` samples apart.
  std::int64_t At(std::int64_t x, std::int64_t y, std::int64_t z) const {
    return m_slices[static_cast<std::size_t>(z)][y * m_width + x];
  }

 private:
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
    m_coverage.onLastPlane += x == m_width - 1 || y == m_height - 1 || z == Depth() - 1 ? 1 : 0;
    const std::int64_t fx = p.x % 65536, fy = p.y % 65536, fz = p.z % 65536;
    const std::int64_t below = InPlane(z, x, y, fx, fy);
    const std::int64_t above = InPlane(std::min(z + 1, Depth() - 1), x, y, fx, fy);
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

}  // namespace volume_model

#endif
