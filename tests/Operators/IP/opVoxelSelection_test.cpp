// Which voxels of a classified volume are listed.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <gtest/gtest.h>

#include <numeric>

#include "ClassificationBench.h"

namespace {

using classification_bench::Workbench;
using voxel_lists::Pack;
using Entries = std::vector<std::uint32_t>;
using Unsigned = std::vector<std::uint16_t>;

TEST(opVoxelSelection, ListsTheHighestClassesThatFitUnderTheLimit) {
  Unsigned samples(100, 0);
  Entries highest;
  for (std::uint32_t i = 0; i < 25; ++i) {
    samples[i * 4] = i % 5 == 0 ? 900 : 800;
    if (i % 5 == 0) {
      highest.push_back(Pack(i * 4 % 10, i * 4 / 10, 0));
    }
  }
  Workbench bench(ImageDataType_U16, 10, samples);
  bench.Classify(401);
  EXPECT_EQ(bench.Select(10), highest);  // 5 of 900 and 20 of 800 are more than 10
  EXPECT_EQ(bench.Select(5), highest);
  EXPECT_EQ(bench.Select(24), highest);
  EXPECT_EQ(bench.Select(25).size(), 25U);
  EXPECT_EQ(bench.Select(4), Entries{});
  EXPECT_EQ(bench.Select(99).size(), 25U);
}

TEST(opVoxelSelection, EntriesComeInScanOrder) {
  dVolume volume;
  for (int z = 0; z < 2; ++z) {
    rasters::AddSlice(volume, {.width = 2, .height = 2, .type = ImageDataType_U16},
                      Unsigned{4, 3, 2, 5});
  }
  Workbench bench;
  bench.op.volume = &volume;
  bench.Classify(401);
  EXPECT_EQ(bench.Select(6), (Entries{Pack(0, 0, 0), Pack(1, 0, 0), Pack(1, 1, 0), Pack(0, 0, 1),
                                      Pack(1, 0, 1), Pack(1, 1, 1)}));
}

TEST(opVoxelSelection, HighestUnsignedValueIsCountedButNotListed) {
  Workbench bench(ImageDataType_U16, 6, Unsigned{65535, 100, 65535, 100, 65535, 0});
  bench.Classify(401);
  EXPECT_EQ(bench.Select(2), Entries{});
  EXPECT_EQ(bench.Select(4), Entries{});
  EXPECT_EQ(bench.Select(5), (Entries{1, 3}));
}

TEST(opVoxelSelection, HighestSignedValueIsCountedButNotListed) {
  Workbench bench(ImageDataType_S16, 4, std::vector<std::int16_t>{32767, 32766, -5, -6});
  bench.Classify(401);
  EXPECT_EQ(bench.Select(1), Entries{});
  EXPECT_EQ(bench.Select(2), Entries{1});
  EXPECT_EQ(bench.Select(3), (Entries{1, 2}));
}

TEST(opVoxelSelection, ListsEverythingBelowTheHighestWhenAllFits) {
  Workbench bench(ImageDataType_U16, 4, Unsigned{65535, 0, 7, 0});
  bench.Classify(401);
  EXPECT_EQ(bench.Select(4), (Entries{1, 2, 3}));
  EXPECT_EQ(bench.Select(1000), (Entries{1, 2, 3}));
  Workbench lowest(ImageDataType_S16, 2, std::vector<std::int16_t>{-32768, -32767});
  lowest.Classify(401);
  EXPECT_EQ(lowest.Select(1), Entries{1});
  EXPECT_EQ(lowest.Select(2), (Entries{0, 1}));
}

TEST(opVoxelSelection, EdgesAreListedByTheirStrength) {
  // Columns 0 and 1 of rows 0 and 1 are looked at: they rise by 4, 1, 0 and -1.
  Workbench bench(ImageDataType_U16, 3, Unsigned{9, 5, 4, 7, 7, 8, 8, 9, 0});
  bench.Classify(402);
  EXPECT_EQ(bench.Select(1), Entries{Pack(0, 0, 0)});
  EXPECT_EQ(bench.Select(2), (Entries{Pack(0, 0, 0), Pack(1, 0, 0)}));
  // The two that do not rise are both counted as 0.
  EXPECT_EQ(bench.Select(3), (Entries{Pack(0, 0, 0), Pack(1, 0, 0)}));
}

// When all fit, those below 0 are listed, too.
TEST(opVoxelSelection, AllEdgesAreListedWhenTheyFit) {
  Workbench bench(ImageDataType_S16, 3, std::vector<std::int16_t>{9, 5, 4, 7, 7, 8, 8, 9, 0});
  bench.Classify(402);
  EXPECT_EQ(bench.Select(4), (Entries{Pack(0, 0, 0), Pack(1, 0, 0), Pack(0, 1, 0), Pack(1, 1, 0)}));
}

TEST(opVoxelSelection, SignedEdgesAreClassesFromZeroOn) {
  // 0xFFF against 0: an edge of 4095; and none
  Workbench bench(ImageDataType_S16, 3, std::vector<std::int16_t>{-1, 0, 0, 0, 0, 0});
  bench.Classify(402);
  EXPECT_EQ(bench.Select(1), Entries{0});
}

TEST(opVoxelSelection, IndicesBeyondTheirBitsRunIntoTheNext) {
  Workbench bench(ImageDataType_U16, 2050, Unsigned(2050, 3));
  bench.Classify(401);
  Entries expected(2050);
  for (std::uint32_t x = 0; x < 2050; ++x) {
    expected[x] = x;
  }
  EXPECT_EQ(bench.Select(2050), expected);
}

// The volume is another one by now: classes hold more voxels than were counted.
TEST(opVoxelSelection, StaysUnderTheLimitWhenTheVolumeHasChanged) {
  Workbench bench(ImageDataType_U16, 4, Unsigned{900, 0, 0, 0});
  Workbench brighter(ImageDataType_U16, 10, Unsigned(10, 900));
  Workbench isSigned(ImageDataType_S16, 10, std::vector<std::int16_t>(10, 900));
  Workbench larger(ImageDataType_U16, 100, Unsigned(10000, 1000));
  for (dVolume* volume : {&brighter.volume, &isSigned.volume, &larger.volume}) {
    for (const unsigned long limit : {1UL, 2UL, 3UL, 9UL}) {
      bench.op.volume = &bench.volume;
      bench.Classify(401);
      bench.op.volume = volume;
      Entries first(limit);
      std::iota(first.begin(), first.end(), 0U);
      EXPECT_EQ(bench.Select(limit), first);
    }
  }
}

TEST(opVoxelSelection, StaysUnderTheLimitWhenTheEdgesHaveChanged) {
  Workbench bench(ImageDataType_U16, 2, Unsigned{9, 0, 0, 0});
  Workbench more(ImageDataType_U16, 5, Unsigned{9, 0, 9, 0, 9, 9, 0, 9, 0, 9, 9, 0, 9, 0, 9});
  bench.Classify(402);
  bench.op.volume = &more.volume;
  EXPECT_EQ(bench.Select(2), (Entries{Pack(0, 0, 0), Pack(1, 0, 0)}));
  EXPECT_EQ(bench.Select(3).size(), 3U);
}

TEST(opVoxelSelection, ClassificationServesSeveralSelections) {
  Workbench bench(ImageDataType_U16, 4, Unsigned{4, 3, 2, 1});
  bench.Classify(401);
  EXPECT_EQ(bench.Select(3), (Entries{0, 1, 2}));
  EXPECT_EQ(bench.Select(1), Entries{0});
  EXPECT_EQ(bench.Select(2), (Entries{0, 1}));
}

TEST(opVoxelSelection, ListIsSizedByTheOperatorWhateverItWas) {
  Workbench bench(ImageDataType_U16, 4, Unsigned{4, 3, 2, 1});
  bench.Classify(401);
  bench.list.New(100, false);
  EXPECT_EQ(bench.Select(2), (Entries{0, 1}));
  std::vector<unsigned char> memory(7, 0xA5);
  bench.list.Init(memory.data(), 7, DTM_Reference);
  EXPECT_EQ(bench.Select(2), (Entries{0, 1}));
  EXPECT_FALSE(bench.list.IsReference());
  EXPECT_EQ(memory, std::vector<unsigned char>(7, 0xA5));
}

TEST(opVoxelSelection, ListOverForeignMemoryIsFilledThereAtAnyAddress) {
  Workbench bench(ImageDataType_U16, 4, Unsigned{4, 3, 2, 1});
  bench.Classify(401);
  std::vector<unsigned char> memory(11, 0xA5);
  bench.list.Init(memory.data() + 1, 8, DTM_Reference);
  EXPECT_EQ(bench.Select(2), (Entries{0, 1}));
  EXPECT_EQ(memory, (std::vector<unsigned char>{0xA5, 0, 0, 0, 0, 1, 0, 0, 0, 0xA5, 0xA5}));
}

TEST(opVoxelSelection, ClassCountersCannotBeTheList) {
  Workbench bench(ImageDataType_U16, 4, Unsigned{4, 3, 2, 1});
  bench.Classify(401);
  const auto counters = classification_bench::CountersOf(bench.op);
  bench.op.voxelList = &bench.op.classCounters;
  bench.op.SelectAlgo(403);
  bench.op.SetSelectionLimit(2);
  EXPECT_FALSE(bench.op.Run());
  EXPECT_EQ(rasters::MessageOf(bench.op), "the class counters can't be the 'Voxel List'");
  EXPECT_EQ(classification_bench::CountersOf(bench.op), counters);
}

}  // namespace
