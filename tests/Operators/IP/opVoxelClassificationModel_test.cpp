// Random volumes classified and selected from, against a plain model.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <limits>

#include "ClassificationBench.h"
#include "Scenes.h"

namespace {

using classification_bench::Counts;
using rasters::Around;
using rasters::Random;
using rasters::Voxels;
using Entries = std::vector<std::uint32_t>;

struct Classified {
  std::uint32_t entry;
  int voxelClass;
};

/// Every voxel that a classification looks at, in scan order.
template <class T>
std::vector<Classified> ClassesOf(const dVolume& volume, int algo) {
  std::vector<Classified> classes;
  for (int z = 0; z < volume.GetSizeZ(); ++z) {
    const dImage& image = volume.GetSlice(z)->GetImage();
    const auto at = [&](int x, int y) {
      return int{*static_cast<const T*>(image.GetDataPtr(x, y))};
    };
    const auto low = [&](int x, int y) { return ((at(x, y) % 4096) + 4096) % 4096; };
    const int leftOut = algo == 402 ? 1 : 0;
    for (int y = 0; y < volume.GetSizeY() - leftOut; ++y) {
      for (int x = 0; x < volume.GetSizeX() - leftOut; ++x) {
        const int edge =
            algo == 402 ? low(x, y) - std::min(low(x + 1, y), low(x, y + 1)) : at(x, y);
        classes.push_back(
            {voxel_lists::Pack(static_cast<std::uint32_t>(x), static_cast<std::uint32_t>(y),
                               static_cast<std::uint32_t>(z)),
             edge});
      }
    }
  }
  return classes;
}

Counts CountsOf(const std::vector<Classified>& classes, int algo) {
  Counts counts;
  for (const Classified& voxel : classes) {
    ++counts[algo == 402 ? std::max(voxel.voxelClass, 0) : voxel.voxelClass];
  }
  return counts;
}

/// The voxels of the highest classes of which no more than `limit` are counted.
Entries Selected(const std::vector<Classified>& classes, int algo, int highest,
                 std::uint32_t limit) {
  const Counts counts = CountsOf(classes, algo);
  int lowest = -100000;
  std::uint32_t sum = 0;
  for (auto it = counts.rbegin(); it != counts.rend(); ++it) {
    if (sum + it->second > limit) {
      lowest = it->first + 1;
      break;
    }
    sum += it->second;
  }
  Entries entries;
  for (const Classified& voxel : classes) {
    if (voxel.voxelClass >= lowest && voxel.voxelClass < highest) {
      entries.push_back(voxel.entry);
    }
  }
  return entries;
}

struct Coverage {
  long none = 0;
  long some = 0;
  long all = 0;
  long highest = 0;  ///< voxels of the class that is never selected
};

/// An operator in watched memory: what it reads, its counters and its list.
class GuardedClassification : public opVoxelClassification {
 public:
  GuardedClassification(rasters::GuardedVolume& source, Around around)
      : m_around(around), m_source(source) {
    m_source.Surround(around, true);
    volume = &m_source;
    voxelList = &m_list;
  }

  void Classify(int algo) {
    SelectAlgo(static_cast<short>(algo));
    ASSERT_TRUE(Run()) << rasters::MessageOf(*this);
    ASSERT_NO_FATAL_FAILURE(m_counters.ExpectSurroundingsUntouched());
    ASSERT_NO_FATAL_FAILURE(m_source.ExpectUntouched());
    m_counters.Watch();
  }

  void ExpectSelected(std::uint32_t limit, const Entries& expected) {
    SelectAlgo(403);
    SetSelectionLimit(limit);
    m_list.New(limit * 4UL, true);
    rasters::GuardedInput memory;
    memory.PutUnder(m_list, m_around);  // of the size that is asked for, so it stays there
    ASSERT_TRUE(Run()) << rasters::MessageOf(*this);
    ASSERT_EQ(voxel_lists::EntriesOf(m_list), expected);
    ASSERT_TRUE(std::equal(expected.begin(), expected.end(), FirstEntry(memory)));
    ASSERT_NO_FATAL_FAILURE(memory.ExpectSurroundingsUntouched());
    ASSERT_NO_FATAL_FAILURE(m_counters.ExpectUntouched());
    ASSERT_NO_FATAL_FAILURE(m_source.ExpectUntouched());
    m_list.Delete();
  }

 protected:
  // A classification finds its new counters in memory of the test's.
  bool Prepare() override {
    const bool ok = opVoxelClassification::Prepare();
    if (ok && algoID != VoxelClassificationAlgo_Select) {
      m_counters.PutUnder(classCounters, m_around);
    }
    return ok;
  }

 private:
  static const std::uint32_t* FirstEntry(const rasters::GuardedInput& memory) {
    return reinterpret_cast<const std::uint32_t*>(memory.Data());
  }

  Around m_around;
  rasters::GuardedVolume& m_source;
  rasters::GuardedInput m_counters;
  dBuffer m_list;
};

template <class T>
void CheckCase(unsigned short type, Random& random, Coverage& coverage) {
  rasters::GuardedVolume volume;
  rasters::MakeRandomVolume(volume, type, random);
  const int algo = random.Between(401, 402);
  const bool signedValues = type == ImageDataType_S16 && algo == 401;
  const std::vector<Classified> classes = ClassesOf<T>(volume, algo);
  const int highest = signedValues ? 32767 : 65535;
  for (const Classified& voxel : classes) {
    coverage.highest += voxel.voxelClass == highest ? 1 : 0;
  }
  std::array<std::uint32_t, 5> limits = {};
  for (std::uint32_t& limit : limits) {
    limit = static_cast<std::uint32_t>(random.Between(1, static_cast<int>(classes.size()) + 2));
  }
  for (const Around around : rasters::kSurroundings) {
    SCOPED_TRACE(rasters::NameOf(around));
    GuardedClassification op(volume, around);
    ASSERT_NO_FATAL_FAILURE(op.Classify(algo));
    ASSERT_EQ(classification_bench::CountsOf(op, signedValues ? 32768 : 0),
              CountsOf(classes, algo));
    for (const std::uint32_t limit : limits) {
      SCOPED_TRACE(testing::Message() << "limit " << limit << " of " << classes.size());
      const Entries expected = Selected(classes, algo, highest, limit);
      ASSERT_NO_FATAL_FAILURE(op.ExpectSelected(limit, expected));
      ++(expected.empty()                    ? coverage.none
         : expected.size() == classes.size() ? coverage.all
                                             : coverage.some);
    }
  }
}

template <class T>
void CheckCases(unsigned short type, std::uint32_t seed) {
  Random random(seed);
  Coverage coverage;
  for (int i = 0; i < 400; ++i) {
    SCOPED_TRACE(testing::Message() << "case " << i);
    CheckCase<T>(type, random, coverage);
    if (testing::Test::HasFatalFailure()) {
      return;
    }
  }
  EXPECT_GT(coverage.none, 300);
  EXPECT_GT(coverage.some, 1500);
  EXPECT_GT(coverage.all, 60);
  EXPECT_GT(coverage.highest, 500);
}

TEST(opVoxelClassificationModel, UnsignedVolumesEqualTheModel) {
  CheckCases<std::uint16_t>(ImageDataType_U16, 51);
}

TEST(opVoxelClassificationModel, SignedVolumesEqualTheModel) {
  CheckCases<std::int16_t>(ImageDataType_S16, 52);
}

// As many voxels as are counted apart from the operator's counters first. Runs of equal values
// among random ones.
template <class T>
void CheckLarge(unsigned short type) {
  Random random(77);
  dVolume volume;
  for (int z = 0; z < 9; ++z) {
    dSlice slice;
    dImage& image = slice.GetImage();
    ASSERT_TRUE(image.Init(131UL, 127UL, type, "G", ImageDataOrder_Pixel, 4));
    int value = 0;
    for (int y = 0; y < 127; ++y) {
      for (int x = 0; x < 131; ++x) {
        if (z % 2 == 0 || random.Between(0, 60) == 0) {
          value = random.Between(std::numeric_limits<T>::min(), std::numeric_limits<T>::max());
        }
        *static_cast<T*>(image.GetDataPtr(x, y)) = static_cast<T>(value);
      }
    }
    ASSERT_EQ(volume.AddSlice(slice), z);
  }
  for (const int algo : {401, 402}) {
    const bool signedValues = type == ImageDataType_S16 && algo == 401;
    opVoxelClassification op;
    op.volume = &volume;
    op.SelectAlgo(static_cast<short>(algo));
    ASSERT_TRUE(op.Run()) << rasters::MessageOf(op);
    EXPECT_EQ(classification_bench::CountsOf(op, signedValues ? 32768 : 0),
              CountsOf(ClassesOf<T>(volume, algo), algo))
        << algo;
  }
}

TEST(opVoxelClassificationModel, LargeVolumesOfUnsignedValuesAreCountedAsSmallOnes) {
  CheckLarge<unsigned short>(ImageDataType_U16);
}

TEST(opVoxelClassificationModel, LargeVolumesOfSignedValuesAreCountedAsSmallOnes) {
  CheckLarge<short>(ImageDataType_S16);
}

}  // namespace
