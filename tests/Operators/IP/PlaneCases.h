#ifndef TESTS_OPERATORS_IP_PLANECASES_H
#define TESTS_OPERATORS_IP_PLANECASES_H

/// @file
/// Random volumes and planes for an operator that samples a volume into a slice, compared with a
/// plain model of it.

#include <array>

#include "Scenes.h"
#include "VolumeModel.h"

namespace plane_cases {

using volume_model::Coverage;

/// `Traits` tell of the operator: its type `Op`, the model `Model<T>`, the algorithms `kNearest`
/// and `kTrilinear`, the numbers of `kDepthSteps` to try, and `SetSlice`, which sets its output.
template <class Traits, class T>
class Case {
 public:
  Case(unsigned short type, rasters::Random& random) {
    rasters::MakeRandomVolume(m_volume, type, random);
    m_memory.PutUnder(m_slice.GetImage(), {.width = rasters::RandomSize(random, 12),
                                           .height = rasters::RandomSize(random, 9),
                                           .type = type,
                                           .alignment = rasters::RandomAlignment(random)});
    rasters::PlacePlane(m_slice, m_volume, random);
    m_op.volume = &m_volume;
    Traits::SetSlice(m_op, m_slice);
    m_op.SelectAlgo(random.Between(0, 1) == 0 ? Traits::kNearest : Traits::kTrilinear);
    m_op.SetDepthSteps(random.Pick(Traits::kDepthSteps));
  }

  testing::Message Text() const {
    return testing::Message() << "algorithm " << m_op.algoID << ", depth steps " << m_op.depthSteps
                              << ", " << rasters::TextOf(m_volume, m_slice);
  }

  void Check(Coverage& coverage) {
    typename Traits::template Model<T> model(m_volume, m_op.algoID == Traits::kTrilinear, coverage);
    const std::vector<T> expected = model.Run(m_slice, m_volume.GetCoordinates(), m_op.depthSteps);
    for (const rasters::Around around : rasters::kSurroundings) {
      SCOPED_TRACE(rasters::NameOf(around));
      // Nearest samples take rows as unpadded, and so read padding where there is some.
      m_volume.Surround(around, m_op.algoID == Traits::kTrilinear);
      ASSERT_TRUE(m_op.Run()) << rasters::MessageOf(m_op);
      ASSERT_EQ(rasters::SamplesOf<T>(m_slice.GetImage()), expected);
      ASSERT_NO_FATAL_FAILURE(m_memory.ExpectSurroundingsUntouched());
      ASSERT_NO_FATAL_FAILURE(m_volume.ExpectUntouched());
    }
  }

 private:
  rasters::GuardedVolume m_volume;
  dSlice m_slice;
  rasters::GuardedMemory m_memory;
  typename Traits::Op m_op;
};

/// Fails when the cases have not met what they are there for.
inline void ExpectCoverage(const Coverage& coverage) {
  EXPECT_GT(coverage.inside, 2000);
  EXPECT_GT(coverage.outside, 2000);
  EXPECT_GT(coverage.partlyInside, 200);
  EXPECT_GT(coverage.wrapped, 200);
  EXPECT_GT(coverage.floored, 200);
  EXPECT_GT(coverage.onLastPlane, 200);
}

/// A thousand cases; what they met.
template <class Traits, class T>
Coverage CheckCases(unsigned short type, std::uint32_t seed) {
  rasters::Random random(seed);
  Coverage coverage;
  for (int i = 0; i < 1000; ++i) {
    Case<Traits, T> testCase(type, random);
    SCOPED_TRACE(testing::Message() << "case " << i << ": " << testCase.Text());
    testCase.Check(coverage);
    if (testing::Test::HasFatalFailure()) {
      return coverage;
    }
  }
  ExpectCoverage(coverage);
  return coverage;
}

}  // namespace plane_cases

#endif
