// Random sequences of drawings into one plane, bit for bit against a plain model: pixels, depths
// and the bytes around both.

#include <vorl/Operators/IP/opSliceProjection.h>

#include <gtest/gtest.h>

#include <array>
#include <limits>

#include "ProjectionModel.h"
#include "Scenes.h"
#include "VoxelLists.h"

namespace {

using projection_model::Coverage;
using projection_model::Model;
using projection_model::Raster;
using rasters::Around;
using rasters::Format;
using rasters::GuardedMemory;
using rasters::Random;

template <class T>
class Case {
 public:
  Case(unsigned short type, Random& random) : m_type(type), m_random(random) {
    rasters::MakeRandomVolume(m_volume, type, random);
    const Format plane = {.width = rasters::RandomSize(random, 16),
                          .height = rasters::RandomSize(random, 13),
                          .type = type,
                          .alignment = rasters::RandomAlignment(random)};
    m_planeMemory.PutUnder(m_plane.GetImage(), plane);
    if (random.Between(0, 1) == 0) {
      random.Fill(m_plane.GetImage().GetDataPtr(), m_plane.GetImage().GetImageSize());
    } else {
      m_plane.GetImage().Fill(0);
    }
    rasters::PlacePlane(m_plane, m_volume, random);
    PutDepths(plane);
    m_op.projectionPlane = &m_plane;
    m_op.volume = &m_volume;
    m_op.SetBorderValue(static_cast<std::uint16_t>(random.Between(0, 0xFFFF)));
  }

  std::string Text() const { return rasters::TextOf(m_volume, m_plane); }

  /// Draws some objects, one after the other.
  void Check(Coverage (&coverage)[3]) {
    for (int i = m_random.Between(1, 4); i > 0; --i) {
      const int object = m_random.Between(0, 2);
      Model<T> model(m_plane, m_op.zBuffer, m_op.borderValue, coverage[object]);
      switch (object) {
        case 0:
          DrawSlice(model);
          break;
        case 1:
          DrawVolume(model);
          break;
        default:
          DrawVoxels(model);
      }
      if (testing::Test::HasFatalFailure()) {
        return;
      }
    }
  }

 private:
  // In half of the cases as after InitZBuffer; else of another row alignment, and with any depths.
  void PutDepths(const Format& plane) {
    Format depths = plane;
    depths.type = ImageDataType_S16;
    const bool any = m_random.Between(0, 1) == 0;
    if (any) {
      depths.alignment = rasters::RandomAlignment(m_random);
    }
    m_depthMemory.PutUnder(m_op.zBuffer, depths);
    static constexpr std::array<std::int16_t, 8> kDepths = {-32768, -5, 0, 1, 3, 9, 200, 32767};
    auto* samples = static_cast<std::int16_t*>(m_op.zBuffer.GetDataPtr());
    for (unsigned long i = 0; i < m_op.zBuffer.GetNumDataSamples(); ++i) {
      samples[i] = any ? m_random.Pick(kDepths) : std::int16_t{32767};
    }
  }

  void DrawSlice(Model<T>& model) {
    dSlice slice;
    rasters::MakeRandom(slice.GetImage(),
                        {.width = rasters::RandomSize(m_random, 22),
                         .height = rasters::RandomSize(m_random, 15),
                         .type = m_type,
                         .alignment = rasters::RandomAlignment(m_random)},
                        m_random);
    rasters::PlacePlane(slice, m_volume, m_random);
    model.DrawSlice(slice);
    m_op.SelectAlgo(301);
    m_op.slice = &slice;
    RunInAllSurroundings(model, &slice.GetImage());
    m_op.slice = nullptr;
  }

  void DrawVolume(Model<T>& model) {
    model.DrawVolume(m_volume);
    m_op.SelectAlgo(302);
    RunInAllSurroundings(model);
  }

  void DrawVoxels(Model<T>& model) {
    voxel_lists::HostileList list(m_volume, m_random);
    model.DrawVoxels(m_volume, list.Entries());
    m_op.SelectAlgo(303);
    m_op.voxelList = &list.Buffer();
    RunInAllSurroundings(model);
    list.ExpectUntouched();
    m_op.voxelList = nullptr;
  }

  // Draws the object again and again from what was there before it. The padding of the volume's
  // rows stays: voxels are taken from rows as if there were none.
  void RunInAllSurroundings(const Model<T>& model, dImage* slice = nullptr) {
    rasters::GuardedInput sliceInput;
    const rasters::Bytes plane = rasters::BytesOf(m_plane.GetImage());
    const rasters::Bytes depths = rasters::BytesOf(m_op.zBuffer);
    for (const Around around : rasters::kSurroundings) {
      SCOPED_TRACE(rasters::NameOf(around));
      std::memcpy(m_plane.GetImage().GetDataPtr(), plane.data(), plane.size());
      std::memcpy(m_op.zBuffer.GetDataPtr(), depths.data(), depths.size());
      m_volume.Surround(around, false);
      if (slice != nullptr) {
        sliceInput.PutUnder(*slice, around, true);
      }
      ASSERT_TRUE(m_op.Run()) << rasters::MessageOf(m_op);
      ASSERT_EQ(m_op.GetProgress(), 1.0);
      ASSERT_EQ(Raster<T>(m_plane.GetImage()).samples, model.pixels.samples);
      ASSERT_EQ(Raster<std::int16_t>(m_op.zBuffer).samples, model.depths.samples);
      ASSERT_NO_FATAL_FAILURE(m_planeMemory.ExpectGuardsUntouched());
      ASSERT_NO_FATAL_FAILURE(m_depthMemory.ExpectGuardsUntouched());
      ASSERT_NO_FATAL_FAILURE(m_volume.ExpectUntouched());
      if (slice != nullptr) {
        ASSERT_NO_FATAL_FAILURE(sliceInput.ExpectUntouched());
      }
    }
  }

  unsigned short m_type;
  Random& m_random;
  rasters::GuardedVolume m_volume;
  dSlice m_plane;
  GuardedMemory m_planeMemory;
  GuardedMemory m_depthMemory;
  opSliceProjection m_op;
};

// Fails when the cases have not met what they are there for.
void ExpectCoverage(const Coverage (&coverage)[3]) {
  const auto& [slices, volumes, voxels] = coverage;
  for (const Coverage& any : coverage) {
    EXPECT_GT(any.drawn, 500);
    EXPECT_GT(any.outside, 1000);
  }
  EXPECT_GT(slices.border, 1000);
  EXPECT_GT(slices.hidden, 1000);
  EXPECT_GT(slices.ties, 500);
  EXPECT_GT(volumes.limitedByDepth, 300);
  EXPECT_GT(volumes.wholeRays, 500);
  EXPECT_GT(voxels.hidden, 500);
  EXPECT_GT(voxels.ties, 200);
  EXPECT_GT(voxels.noVoxel, 1000);
  EXPECT_GT(voxels.darker, 500);
}

template <class T>
void CheckCases(unsigned short type, std::uint32_t seed) {
  Random random(seed);
  Coverage coverage[3];
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

TEST(opSliceProjectionModel, UnsignedDrawingsEqualTheModelBitForBit) {
  CheckCases<std::uint16_t>(ImageDataType_U16, 41);
}

TEST(opSliceProjectionModel, SignedDrawingsEqualTheModelBitForBit) {
  CheckCases<std::int16_t>(ImageDataType_S16, 42);
}

// No algorithm selects these workers.
class VolumeProjector : public opSliceProjection {
 public:
  using opSliceProjection::VolumeProjectionS16;
  using opSliceProjection::VolumeProjectionU16;
};

TEST(opSliceProjectionModel, ProjectionsOfTheWholeVolumeDisregardDepths) {
  Random random(43);
  Coverage coverage;
  for (int i = 0; i < 200; ++i) {
    const bool isSigned = i % 2 != 0;
    const unsigned short type = isSigned ? ImageDataType_S16 : ImageDataType_U16;
    rasters::GuardedVolume volume;
    rasters::MakeRandomVolume(volume, type, random);
    dSlice plane;
    rasters::MakeSlice(plane, 5, 4, type);
    plane.GetImage().Fill(0);
    rasters::PlacePlane(plane, volume, random);
    VolumeProjector op;
    op.projectionPlane = &plane;
    ASSERT_TRUE(op.InitZBuffer());
    op.zBuffer.Fill(0);
    if (isSigned) {
      Model<std::int16_t> model(plane, op.zBuffer, 0, coverage);
      model.DrawVolume(volume, false);
      ASSERT_TRUE(op.VolumeProjectionS16(&volume, &plane));
      ASSERT_EQ(Raster<std::int16_t>(plane.GetImage()).samples, model.pixels.samples);
    } else {
      Model<std::uint16_t> model(plane, op.zBuffer, 0, coverage);
      model.DrawVolume(volume, false);
      ASSERT_TRUE(op.VolumeProjectionU16(&volume, &plane));
      ASSERT_EQ(Raster<std::uint16_t>(plane.GetImage()).samples, model.pixels.samples);
    }
  }
  EXPECT_GT(coverage.wholeRays, 100);
}

}  // namespace
