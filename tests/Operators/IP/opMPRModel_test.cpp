// Random volumes and planes, bit for bit against a plain model.

#include <vorl/Operators/IP/opMPR.h>

#include <gtest/gtest.h>

#include <array>

#include "MprModel.h"
#include "Scenes.h"

namespace {

using mpr_model::Coverage;
using rasters::GuardedMemory;
using rasters::Random;

template <class T>
class Case {
 public:
  Case(unsigned short type, Random& random) {
    static constexpr std::array<int, 8> kDepthSteps = {0, 0, -1, -1, 1, 2, 5, 300};
    rasters::MakeRandomVolume(m_volume, type, random);
    m_memory.PutUnder(m_slice.GetImage(), {.width = rasters::RandomSize(random, 12),
                                           .height = rasters::RandomSize(random, 9),
                                           .type = type,
                                           .alignment = rasters::RandomAlignment(random)});
    rasters::PlacePlane(m_slice, m_volume, random);
    m_op.volume = &m_volume;
    m_op.mprSlice = &m_slice;
    m_op.SelectAlgo(random.Between(101, 102));
    m_op.SetDepthSteps(random.Pick(kDepthSteps));
  }

  testing::Message Text() const {
    return testing::Message() << "algorithm " << m_op.algoID << ", depth steps " << m_op.depthSteps
                              << ", " << rasters::TextOf(m_volume, m_slice);
  }

  void Check(Coverage& coverage) {
    mpr_model::Model<T> model(m_volume, m_op.algoID == MPRAlgo_Trilinear, coverage);
    const std::vector<T> expected = model.Run(m_slice, m_volume.GetCoordinates(), m_op.depthSteps);
    ASSERT_TRUE(m_op.Run()) << rasters::MessageOf(m_op);
    ASSERT_EQ(rasters::SamplesOf<T>(m_slice.GetImage()), expected);
    m_memory.ExpectSurroundingsUntouched();
  }

 private:
  dVolume m_volume;
  dSlice m_slice;
  GuardedMemory m_memory;
  opMPR m_op;
};

// Fails when the cases have not met what they are there for.
void ExpectCoverage(const Coverage& coverage) {
  EXPECT_GT(coverage.inside, 2000);
  EXPECT_GT(coverage.outside, 2000);
  EXPECT_GT(coverage.partlyInside, 200);
  EXPECT_GT(coverage.wrapped, 200);
  EXPECT_GT(coverage.floored, 200);
  EXPECT_GT(coverage.onLastPlane, 200);
}

template <class T>
void CheckCases(unsigned short type, std::uint32_t seed) {
  Random random(seed);
  Coverage coverage;
  for (int i = 0; i < 1000; ++i) {
    Case<T> testCase(type, random);
    SCOPED_TRACE(testing::Message() << "case " << i << ": " << testCase.Text());
    testCase.Check(coverage);
    if (testing::Test::HasFatalFailure()) {
      return;
    }
  }
  ExpectCoverage(coverage);
}

TEST(opMPRModel, UnsignedVolumesEqualTheModelBitForBit) {
  CheckCases<std::uint16_t>(ImageDataType_U16, 1);
}

TEST(opMPRModel, SignedVolumesEqualTheModelBitForBit) {
  CheckCases<std::int16_t>(ImageDataType_S16, 2);
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
