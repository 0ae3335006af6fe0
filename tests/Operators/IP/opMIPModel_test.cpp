// Random volumes, planes and lists, bit for bit against a plain model.

#include <vorl/Operators/IP/opMIP.h>

#include <gtest/gtest.h>

#include "PlaneCases.h"

namespace {

using rasters::Random;
using volume_model::Coverage;
using volume_model::Grid;
using volume_model::Slab;
using volume_model::Triple;

template <class T>
class MipModel {
 public:
  MipModel(const dVolume& volume, bool trilinear, Coverage& coverage)
      : m_voxels(volume, trilinear, coverage), m_coverage(coverage) {}

  std::vector<T> Run(const dSlice& slice, const dCoordSys3D& volume, int depthSteps) {
    const Grid grid(slice.GetCoordinates(), volume, -0.5F);
    const Slab slab(grid.through, depthSteps);
    std::vector<T> pixels;
    for (int y = 0; y < slice.GetHeight(); ++y) {
      for (int x = 0; x < slice.GetWidth(); ++x) {
        const std::int64_t largest = Largest(grid.At(x, y), slab);
        m_coverage.cut += static_cast<T>(largest) != largest ? 1 : 0;
        pixels.push_back(static_cast<T>(largest));  // the low 16 bits
      }
    }
    return pixels;
  }

 private:
  std::int64_t Largest(const Triple& first, const Slab& slab) {
    std::vector<std::int64_t> samples;
    for (std::int64_t k = 0; k < slab.count; ++k) {
      const Triple point = Along(first, slab.step, k);
      if (m_voxels.IsInside(point)) {
        samples.push_back(m_voxels.Sample(point));
      }
    }
    const auto inside = static_cast<std::int64_t>(samples.size());
    m_coverage.partlyInside += inside > 0 && inside < slab.count ? 1 : 0;
    ++(inside != 0 ? m_coverage.inside : m_coverage.outside);
    samples.push_back(0);
    return *std::max_element(samples.begin(), samples.end());
  }

  volume_model::Voxels<T> m_voxels;
  Coverage& m_coverage;
};

struct Traits {
  using Op = opMIP;
  template <class T>
  using Model = MipModel<T>;
  static constexpr int kNearest = MIPAlgo_Nearest;
  static constexpr int kTrilinear = MIPAlgo_Trilinear;
  static constexpr std::array<int, 8> kDepthSteps = {-1, -1, -1, 0, 1, 2, 5, 300};
  static void SetSlice(Op& op, dSlice& slice) { op.mipSlice = &slice; }
};

TEST(opMIPModel, UnsignedVolumesEqualTheModelBitForBit) {
  const Coverage coverage = plane_cases::CheckCases<Traits, std::uint16_t>(ImageDataType_U16, 21);
  EXPECT_GT(coverage.cut, 20);
}

TEST(opMIPModel, SignedVolumesEqualTheModelBitForBit) {
  const Coverage coverage = plane_cases::CheckCases<Traits, std::int16_t>(ImageDataType_S16, 22);
  EXPECT_GT(coverage.cut, 20);
}

// Slabs that begin, lie and end exactly on the borders of voxels.
TEST(opMIPModel, SlabsOnVoxelBordersEqualTheModelBitForBit) {
  Random random(23);
  Coverage coverage;
  dVolume volume;
  rasters::AddRandomSlices(volume, {.width = 4, .height = 3, .type = ImageDataType_U16}, 3, random);
  for (const int algo : {MIPAlgo_Nearest, MIPAlgo_Trilinear}) {
    for (const int depthSteps : {-1, 2, 3, 5}) {
      for (int z = -4; z <= 10; ++z) {
        dSlice slice;
        rasters::MakeSlice(slice, 8, 7);
        slice.SetPosition(dVect3D(-2, -2, static_cast<float>(z) / 2));
        slice.GetCoordinates().axisZ = dVect3D(0, 0, static_cast<float>(depthSteps));
        opMIP op;
        op.volume = &volume;
        op.mipSlice = &slice;
        op.SelectAlgo(algo);
        op.SetDepthSteps(depthSteps);
        ASSERT_TRUE(op.Run());
        MipModel<std::uint16_t> model(volume, algo == MIPAlgo_Trilinear, coverage);
        ASSERT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()),
                  model.Run(slice, volume.GetCoordinates(), depthSteps))
            << "algorithm " << algo << ", depth steps " << depthSteps << ", z " << z;
      }
    }
  }
}

}  // namespace
