#ifndef TESTS_OPERATORS_IP_CLASSIFICATIONBENCH_H
#define TESTS_OPERATORS_IP_CLASSIFICATIONBENCH_H

/// @file
/// What a classification works on.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <map>

#include "Volumes.h"
#include "VoxelLists.h"

namespace classification_bench {

/// All counters.
inline std::vector<std::uint32_t> CountersOf(const opVoxelClassification& op) {
  return voxel_lists::EntriesOf(op.classCounters);
}

using Counts = std::map<int, std::uint32_t>;

/// The counters that are not 0, by class; `base` is the counter of class 0.
inline Counts CountsOf(const opVoxelClassification& op, int base = 0) {
  Counts counts;
  const std::vector<std::uint32_t> counters = CountersOf(op);
  for (std::size_t i = 0; i < counters.size(); ++i) {
    if (counters[i] != 0) {
      counts[static_cast<int>(i) - base] = counters[i];
    }
  }
  return counts;
}

/// An operator with a list and a volume: of 2 x 2 x 3 marked voxels, or one that the test fills.
struct Workbench {
  explicit Workbench(unsigned short type = ImageDataType_U16) {
    for (int i = 0; i < 3; ++i) {
      dSlice added;
      rasters::MakeSlice(added, 2, 2, type);
      EXPECT_EQ(volume.AddSlice(added), i);
    }
    Connect();
  }

  /// One slice of these samples.
  template <class T>
  Workbench(unsigned short type, unsigned long width, const std::vector<T>& samples) {
    const auto height = static_cast<unsigned long>(samples.size() / width);
    rasters::AddSlice(volume, {.width = width, .height = height, .type = type}, samples);
    Connect();
  }

  void Connect() {
    op.volume = &volume;
    op.voxelList = &list;
  }

  void Classify(short algo) {
    op.SelectAlgo(algo);
    EXPECT_TRUE(op.Run()) << rasters::MessageOf(op);
  }

  /// The entries that are selected under this limit.
  std::vector<std::uint32_t> Select(unsigned long limit) {
    op.SelectAlgo(403);
    op.SetSelectionLimit(limit);
    EXPECT_TRUE(op.Run()) << rasters::MessageOf(op);
    EXPECT_EQ(list.GetSize() % 4, 0U);
    return voxel_lists::EntriesOf(list);
  }

  dVolume volume;
  dBuffer list;
  opVoxelClassification op;
};

}  // namespace classification_bench

#endif
