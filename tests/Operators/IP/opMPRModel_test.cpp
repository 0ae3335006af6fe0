// Random volumes and planes, bit for bit against a plain model.

#include <vorl/Operators/IP/opMPR.h>

#include <gtest/gtest.h>

#include "MprModel.h"
#include "PlaneCases.h"

namespace {

using mpr_model::Coverage;
using rasters::Random;

struct Traits {
  using Op = opMPR;
  template <class T>
  using Model = mpr_model::Model<T>;
  static constexpr int kNearest = MPRAlgo_Nearest;
  static constexpr int kTrilinear = MPRAlgo_Trilinear;
  static constexpr std::array<int, 8> kDepthSteps = {0, 0, -1, -1, 1, 2, 5, 300};
  static void SetSlice(Op& op, dSlice& slice) { op.mprSlice = &slice; }
};

TEST(opMPRModel, UnsignedVolumesEqualTheModelBitForBit) {
  plane_cases::CheckCases<Traits, std::uint16_t>(ImageDataType_U16, 1);
}

TEST(opMPRModel, SignedVolumesEqualTheModelBitForBit) {
  plane_cases::CheckCases<Traits, std::int16_t>(ImageDataType_S16, 2);
}

// Planes that touch the borders of the voxels exactly.
TEST(opMPRModel, PlanesOnVoxelBordersEqualTheModelBitForBit) {
  Random random(3);
  Coverage coverage;
  dVolume volume;
  rasters::AddRandomSlices(volume, {.width = 4, .height = 3, .type = ImageDataType_U16}, 3, random);
  for (const int algo : {MPRAlgo_Trilinear, MPRAlgo_Nearest}) {
    for (const int depthSteps : {0, 3}) {
      for (int z = -1; z <= 4; ++z) {
        dSlice slice;
        rasters::MakeSlice(slice, 8, 7);
        slice.SetPosition(dVect3D(-2, -2, static_cast<float>(z)));
        opMPR op;
        op.volume = &volume;
        op.mprSlice = &slice;
        op.SelectAlgo(algo);
        op.SetDepthSteps(depthSteps);
        ASSERT_TRUE(op.Run());
        mpr_model::Model<std::uint16_t> model(volume, algo == MPRAlgo_Trilinear, coverage);
        ASSERT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()),
                  model.Run(slice, volume.GetCoordinates(), depthSteps))
            << "algorithm " << algo << ", depth steps " << depthSteps << ", z " << z;
      }
    }
  }
}

// Sums beyond 32 bits: 65535 times 40000 samples.
TEST(opMPRModel, SumsWrapAtThirtyTwoBits) {
  dVolume volume;
  rasters::AddSlice<std::uint16_t>(volume, {.type = ImageDataType_U16}, {65535});
  dSlice slice;
  rasters::MakeSlice(slice, 1, 1);
  slice.SetPosition(dVect3D(0, 0, 0.5F));
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  op.SetDepthSteps(40000);
  ASSERT_TRUE(op.Run());
  Coverage coverage;
  mpr_model::Model<std::uint16_t> model(volume, false, coverage);
  EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()),
            model.Run(slice, volume.GetCoordinates(), 40000));
  // 65535 * 40000 - 2^32 = -1673567296, over 40000: -41839, of which 16 bits are kept
  EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(slice.GetImage()).front(), 65536 - 41839);
}

}  // namespace
