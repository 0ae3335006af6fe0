#ifndef TESTS_OPERATORS_IP_MPRMODEL_H
#define TESTS_OPERATORS_IP_MPRMODEL_H

/// @file
/// What multi-planar reconstruction is, written plainly: every pixel on its own.

#include "VolumeModel.h"

namespace mpr_model {

using volume_model::Coverage;
using volume_model::Grid;
using volume_model::Slab;
using volume_model::Triple;

template <class T>
class Model {
 public:
  Model(const dVolume& volume, bool trilinear, Coverage& coverage)
      : m_voxels(volume, trilinear, coverage), m_coverage(coverage) {}

  /// The pixels of `slice`, row by row.
  std::vector<T> Run(const dSlice& slice, const dCoordSys3D& volume, int depthSteps) {
    const bool thick = depthSteps != 0;
    const Grid grid(slice.GetCoordinates(), volume, thick ? -0.5F : 0.0F);
    const Slab slab(grid.through, depthSteps);
    std::vector<T> pixels;
    for (int y = 0; y < slice.GetHeight(); ++y) {
      for (int x = 0; x < slice.GetWidth(); ++x) {
        const std::int64_t value = thick ? Mean(grid.At(x, y), slab) : Thin(grid.At(x, y));
        pixels.push_back(static_cast<T>(value));  // the low 16 bits
      }
    }
    return pixels;
  }

 private:
  std::int64_t Thin(const Triple& point) {
    const bool inside = m_voxels.IsInside(point);
    ++(inside ? m_coverage.inside : m_coverage.outside);
    return inside ? m_voxels.Sample(point) : 0;
  }

  std::int64_t Mean(const Triple& first, const Slab& slab) {
    std::int64_t sum = 0;
    std::int64_t count = 0;
    for (std::int64_t k = 0; k < slab.count; ++k) {
      const Triple point = Along(first, slab.step, k);
      if (m_voxels.IsInside(point)) {
        sum = volume_model::Cut(sum + m_voxels.Sample(point));
        ++count;
      }
    }
    m_coverage.partlyInside += count > 0 && count < slab.count ? 1 : 0;
    ++(count != 0 ? m_coverage.inside : m_coverage.outside);
    return count != 0 ? sum / count : 0;
  }

  volume_model::Voxels<T> m_voxels;
  Coverage& m_coverage;
};

}  // namespace mpr_model

#endif
