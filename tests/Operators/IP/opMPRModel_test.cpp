// Random volumes and planes, bit for bit against a plain model.

#include <vorl/Operators/IP/opMPR.h>

#include <gtest/gtest.h>

#include <array>

#include "MprModel.h"
#include "Volumes.h"

namespace {

using mpr_model::Coverage;
using rasters::Format;
using rasters::GuardedMemory;
using rasters::Random;

enum class Voxels { Any, Extreme, Small };

// Replaces the pixels, padding included, by values that stress the arithmetic.
void SetVoxels(dImage& image, Voxels kind, Random& random) {
  static constexpr std::array<std::uint16_t, 5> kExtremes = {0, 1, 0x7FFF, 0x8000, 0xFFFF};
  auto* samples = static_cast<std::uint16_t*>(image.GetDataPtr());
  for (unsigned long i = 0; i < image.GetNumDataSamples(); ++i) {
    if (kind == Voxels::Extreme) {
      samples[i] = random.Pick(kExtremes);
    } else if (kind == Voxels::Small) {
      samples[i] = static_cast<std::uint16_t>(random.Between(-3, 100));
    }
  }
}

float Quarter(Random& random, int low, int high) {
  return static_cast<float>(random.Between(low * 4, high * 4)) / 4.0F;
}

dVect3D RandomVector(Random& random) {
  const auto component = [&] { return static_cast<float>(random.Between(-2500, 2500)) / 1000.0F; };
  const float x = component(), y = component(), z = component();
  return dVect3D(x, y, z);
}

// Upright, scaled or mirrored, askew, or, rarely, without one of its axes.
void RandomAxes(dCoordSys3D& system, Random& random) {
  static constexpr std::array<float, 8> kScales = {1, 0.25F, 2, 0.5F, -1, -0.25F, 0.1F, 30};
  switch (random.Between(0, 4)) {
    case 0:
      break;
    case 1:
    case 2:
      system.axisX *= random.Pick(kScales);
      system.axisY *= random.Pick(kScales);
      system.axisZ *= random.Pick(kScales);
      if (random.Between(0, 2) == 0) {
        std::swap(system.axisX, system.axisZ);
      }
      break;
    default:
      system.axisX = RandomVector(random);
      system.axisY = RandomVector(random);
      system.axisZ = RandomVector(random);
  }
  if (random.Between(0, 15) == 0) {
    (random.Between(0, 1) != 0 ? system.axisX : system.axisZ) = dVect3D(0, 0, 0);
  }
}

template <class T>
class Case {
 public:
  Case(unsigned short type, Random& random) {
    static constexpr std::array<unsigned short, 4> kAlignments = {1, 2, 8, 32};
    static constexpr std::array<int, 8> kDepthSteps = {0, 0, -1, -1, 1, 2, 5, 300};
    const Format slices = {.width = Size(random, 14),
                           .height = Size(random, 11),
                           .type = type,
                           .alignment = random.Pick(kAlignments)};
    rasters::AddRandomSlices(m_volume, slices, static_cast<int>(Size(random, 9)), random);
    const auto kind = static_cast<Voxels>(random.Between(0, 2));
    for (dSlice& slice : m_volume.GetSliceList()) {
      SetVoxels(slice.GetImage(), kind, random);
    }
    m_memory.PutUnder(m_slice.GetImage(), {.width = Size(random, 12),
                                           .height = Size(random, 9),
                                           .type = type,
                                           .alignment = random.Pick(kAlignments)});
    PlaceVolume(random);
    PlacePlane(random);
    m_op.volume = &m_volume;
    m_op.mprSlice = &m_slice;
    m_op.SelectAlgo(random.Between(101, 102));
    m_op.SetDepthSteps(random.Pick(kDepthSteps));
  }

  std::string Text() const {
    const auto text = [](const dVect3D& v) {
      return "(" + std::to_string(v.x) + " " + std::to_string(v.y) + " " + std::to_string(v.z) +
             ")";
    };
    const dCoordSys3D& plane = m_slice.GetCoordinates();
    return std::to_string(m_volume.GetSizeX()) + " x " + std::to_string(m_volume.GetSizeY()) +
           " x " + std::to_string(m_volume.GetSizeZ()) + " to " +
           std::to_string(m_slice.GetWidth()) + " x " + std::to_string(m_slice.GetHeight()) +
           ", algorithm " + std::to_string(m_op.algoID) + ", depth steps " +
           std::to_string(m_op.depthSteps) + ", plane " + text(plane.origin) + text(plane.axisX) +
           text(plane.axisY) + text(plane.axisZ);
  }

  void Check(Coverage& coverage) {
    mpr_model::Model<T> model(m_volume, m_op.algoID == MPRAlgo_Trilinear, coverage);
    const std::vector<T> expected = model.Run(m_slice, m_volume.GetCoordinates(), m_op.depthSteps);
    ASSERT_TRUE(m_op.Run()) << rasters::MessageOf(m_op);
    ASSERT_EQ(rasters::SamplesOf<T>(m_slice.GetImage()), expected);
    m_memory.ExpectSurroundingsUntouched();
  }

 private:
  // One in five is 1.
  static unsigned long Size(Random& random, int largest) {
    return random.Between(0, 4) == 0 ? 1UL : static_cast<unsigned long>(random.Between(1, largest));
  }

  void PlaceVolume(Random& random) {
    dCoordSys3D& system = m_volume.GetCoordinates();
    RandomAxes(system, random);
    system.origin = RandomVector(random);
    system.origin *= random.Between(0, 1) * 100.0;
  }

  // Axes relative to the volume's, or free; some pixel of the plane lies at a point in or around
  // the volume, often on a voxel's border.
  void PlacePlane(Random& random) {
    dCoordSys3D& plane = m_slice.GetCoordinates();
    if (random.Between(0, 3) != 0) {
      plane = m_volume.GetCoordinates();
    }
    RandomAxes(plane, random);
    dVect3D point(Quarter(random, 0, m_volume.GetSizeX()), Quarter(random, 0, m_volume.GetSizeY()),
                  Quarter(random, 0, m_volume.GetSizeZ()));
    if (random.Between(0, 1) == 0) {
      point += RandomVector(random);
    }
    m_volume.GetCoordinates().pCS2W(point, plane.origin);
    plane.origin -= plane.axisX * random.Between(0, m_slice.GetWidth());
    plane.origin -= plane.axisY * random.Between(0, m_slice.GetHeight());
  }

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
