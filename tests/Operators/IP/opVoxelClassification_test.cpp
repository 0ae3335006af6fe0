// What opVoxelClassification is, what it refuses, and with which words.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <gtest/gtest.h>

#include <array>

#include "ClassificationBench.h"

namespace {

using classification_bench::Workbench;
using rasters::CodeOf;
using rasters::Make;
using rasters::MakeSlice;
using rasters::MessageOf;

void ExpectFailure(opVoxelClassification& op, const std::string& message) {
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), message);
}

TEST(opVoxelClassification, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<opVoxelClassification>("opVoxelClassification");
}

void ExpectDefaults(const opVoxelClassification& op) {
  EXPECT_EQ(op.volume, nullptr);
  EXPECT_EQ(op.voxelList, nullptr);
  EXPECT_EQ(op.algoID, 400);
  EXPECT_EQ(op.classifiedBy, 400);
  EXPECT_EQ(op.selectionLimit, 0U);
  EXPECT_EQ(classification_bench::CountersOf(op), std::vector<std::uint32_t>(4096, 0));
}

TEST(opVoxelClassification, StartsWithNothingSelectedAndClearCounters) {
  ExpectDefaults(opVoxelClassification());
}

TEST(opVoxelClassification, ResetRestoresTheDefaults) {
  Workbench bench;
  bench.Classify(401);
  bench.Select(3);
  bench.op.classCounters.Set(-1);
  EXPECT_TRUE(bench.op.Reset());
  ExpectDefaults(bench.op);
}

TEST(opVoxelClassification, StoresTheAlgorithmUnchecked) {
  opVoxelClassification op;
  op.SelectAlgo(-5);
  EXPECT_EQ(op.algoID, -5);
}

TEST(opVoxelClassification, CopiesCarryEveryFieldAndTheirOwnCounters) {
  Workbench bench;
  bench.Classify(401);
  bench.Select(3);
  const std::vector<std::uint32_t> counters = classification_bench::CountersOf(bench.op);
  opVoxelClassification copy(bench.op);
  opVoxelClassification assigned;
  assigned = bench.op;
  bench.op.classCounters.Set(-1);
  for (opVoxelClassification* other : {&copy, &assigned}) {
    EXPECT_EQ(other->volume, &bench.volume);
    EXPECT_EQ(other->voxelList, &bench.list);
    EXPECT_EQ(other->algoID, 403);
    EXPECT_EQ(other->classifiedBy, 401);
    EXPECT_EQ(other->selectionLimit, 3U);
    EXPECT_EQ(classification_bench::CountersOf(*other), counters);
    EXPECT_EQ(MessageOf(*other), "success");
    EXPECT_TRUE(other->Run());
  }
}

TEST(opVoxelClassification, SucceedsWithEveryPassAndType) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_S16}) {
    for (const short algo : std::to_array<short>({401, 402})) {
      Workbench bench(type);
      bench.Classify(algo);
      EXPECT_EQ(CodeOf(bench.op), 0);
      EXPECT_EQ(MessageOf(bench.op), "success");
      EXPECT_EQ(bench.op.GetProgress(), 1.0);
      EXPECT_EQ(bench.op.classifiedBy, algo);
      bench.Select(100);
      EXPECT_EQ(MessageOf(bench.op), "success");
      EXPECT_EQ(bench.op.GetProgress(), 1.0);
      EXPECT_EQ(bench.op.classifiedBy, algo);
    }
  }
}

TEST(opVoxelClassification, NamesWhatIsMissingVolumeFirst) {
  opVoxelClassification op;
  ExpectFailure(op, "missing input parameter 'Volume'");
  dVolume volume;
  op.volume = &volume;
  ExpectFailure(op, "given Volume is empty");
  rasters::MakeCounting(volume, 2, 2, 1);
  ExpectFailure(op, "no 'Algorithm ID' specified");
}

TEST(opVoxelClassification, NamesWhatASelectionIsMissingInItsOrder) {
  Workbench bench;
  bench.op.voxelList = nullptr;
  bench.op.SelectAlgo(403);
  ExpectFailure(bench.op, "can't select voxels: voxels are not yet classified");
  bench.Classify(401);
  bench.op.SelectAlgo(403);
  ExpectFailure(bench.op, "can't select voxels: no 'Selection Limit' specified");
  bench.op.SetSelectionLimit(3);
  ExpectFailure(bench.op, "missing input parameter 'Voxel List'");
  bench.op.voxelList = &bench.list;
  EXPECT_TRUE(bench.op.Run());
}

TEST(opVoxelClassification, ClassificationNeedsNeitherLimitNorList) {
  Workbench bench;
  bench.op.voxelList = nullptr;
  bench.Classify(401);
  bench.Classify(402);
}

TEST(opVoxelClassification, RefusesAListThatCannotBeHad) {
  for (const unsigned long limit : {0x40000000UL, 0xFFFFFFFFUL, 0x3FFFFFFFUL}) {
    Workbench bench;
    bench.Classify(401);
    bench.op.SelectAlgo(403);
    bench.op.SetSelectionLimit(limit);
    ExpectFailure(bench.op, "can't create voxel list[Size: " + std::to_string(limit) + "]");
    EXPECT_EQ(bench.list.GetSize(), 0U);
    EXPECT_EQ(bench.op.classifiedBy, 401);
  }
}

TEST(opVoxelClassification, RefusesUnknownAlgorithmsWhenItComesToThem) {
  for (const short algo : std::to_array<short>({404, 399, 0, -1})) {
    Workbench bench;
    bench.op.SelectAlgo(algo);
    ExpectFailure(bench.op, "invalid algo ID: " + std::to_string(algo));
    Workbench bytes(ImageDataType_U8);
    bytes.op.SelectAlgo(algo);
    ExpectFailure(bytes.op, "invalid algo ID: " + std::to_string(algo));
  }
}

TEST(opVoxelClassification, UnknownAlgorithmsPassThePreparation) {
  Workbench bench;
  rasters::Preparing<opVoxelClassification> op;
  op.volume = &bench.volume;
  for (const short algo : std::to_array<short>({404, 399, 0, -1})) {
    op.SelectAlgo(algo);
    EXPECT_TRUE(op.Prepare());
    EXPECT_EQ(CodeOf(op), 0);
  }
}

TEST(opVoxelClassification, RefusesEveryOtherDataType) {
  const std::pair<unsigned short, const char*> cases[] = {
      {ImageDataType_U1, "unsupported data type: 1"},
      {ImageDataType_U8, "unsupported data type: 8"},
      {ImageDataType_S8, "unsupported data type: 4104"},
      {ImageDataType_U32, "class counter allocation failed[Size: 4294967296]"},
      {ImageDataType_F32, "class counter allocation failed[Size: 4294967296]"},
      {ImageDataType_S64, "class counter allocation failed[Size: 18446744073709551616]"}};
  for (const auto& [type, message] : cases) {
    for (const short algo : std::to_array<short>({401, 402})) {
      Workbench bench(type);
      bench.op.SelectAlgo(algo);
      ExpectFailure(bench.op, message);
      EXPECT_EQ(bench.op.classifiedBy, 400);
    }
  }
}

TEST(opVoxelClassification, SelectionRefusesAVolumeOfAnotherDataType) {
  Workbench bench;
  bench.Classify(401);
  Workbench bytes(ImageDataType_U8);
  bench.op.volume = &bytes.volume;
  bench.op.SetSelectionLimit(3);
  bench.op.SelectAlgo(403);
  ExpectFailure(bench.op, "unsupported data type: 8");
}

// Whatever the reason was, a selection finds nothing to work on.
TEST(opVoxelClassification, FailedClassificationsInvalidateTheOneBefore) {
  Workbench bench;
  for (const unsigned short type : {ImageDataType_U8, ImageDataType_U32}) {
    Workbench other(type);
    bench.op.volume = &bench.volume;
    bench.Classify(401);
    bench.op.volume = &other.volume;
    bench.op.SelectAlgo(401);
    EXPECT_FALSE(bench.op.Run());
    bench.op.volume = &bench.volume;
    bench.op.SetSelectionLimit(3);
    bench.op.SelectAlgo(403);
    ExpectFailure(bench.op, "can't select voxels: voxels are not yet classified");
  }
}

// Nothing has been counted anew, so what was counted before still holds.
TEST(opVoxelClassification, ClassificationsThatFindNoVolumeKeepTheOneBefore) {
  Workbench bench;
  bench.Classify(402);
  dVolume empty;
  for (dVolume* volume : {static_cast<dVolume*>(nullptr), &empty}) {
    bench.op.volume = volume;
    bench.op.SelectAlgo(401);
    EXPECT_FALSE(bench.op.Run());
    EXPECT_EQ(bench.op.classifiedBy, 402);
  }
  bench.op.volume = &bench.volume;
  bench.Select(3);
}

TEST(opVoxelClassification, RefusesAVolumeWhoseSlicesLostTheirPixels) {
  Workbench bench;
  bench.Classify(402);
  bench.op.SetSelectionLimit(3);
  bench.volume.GetSlice(1)->GetImage().Reset();
  for (const short algo : std::to_array<short>({403, 401, 402})) {
    bench.op.SelectAlgo(algo);
    ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
  }
  EXPECT_EQ(bench.op.classifiedBy, 400);
}

// Rows may lie farther apart than those of the first slice, as long as they are there.
TEST(opVoxelClassification, RefusesASliceThatDoesNotHoldItsOwnRows) {
  alignas(2) unsigned char memory[34] = {};
  dVolume volume;
  for (const unsigned short alignment : std::to_array<unsigned short>({2, 32})) {
    dSlice slice;
    Make(slice.GetImage(),
         {.width = 1, .height = 2, .type = ImageDataType_U16, .alignment = alignment});
    slice.GetImage().Fill(0);
    ASSERT_GE(volume.AddSlice(slice), 0);
  }
  opVoxelClassification op;
  op.volume = &volume;
  op.SelectAlgo(401);
  dBuffer& pixels = volume.GetSlice(1)->GetImage().GetDataBuffer();
  pixels.Init(memory, 33, DTM_Reference);
  ExpectFailure(op, "invalid pixel data in slice 1 of the Volume");
  pixels.Delete();
  pixels.Init(memory, 34, DTM_Reference);
  memory[32] = 7;  // the second row
  EXPECT_TRUE(op.Run());
  EXPECT_EQ(classification_bench::CountsOf(op), (classification_bench::Counts{{0, 3}, {7, 1}}));
}

TEST(opVoxelClassification, SelectionRefusesCountersThatAreNotThere) {
  alignas(4) static unsigned char memory[65536 * 4 + 4] = {};
  Workbench bench;
  bench.Classify(401);
  bench.op.SetSelectionLimit(3);
  bench.op.SelectAlgo(403);
  bench.op.classCounters.Delete();
  ExpectFailure(bench.op, "voxel selection error");
  bench.op.classCounters.Init(memory, 65536 * 4 - 1, DTM_Reference);
  ExpectFailure(bench.op, "voxel selection error");
  bench.op.classCounters.Init(memory + 1, 65536 * 4, DTM_Reference);
  ExpectFailure(bench.op, "voxel selection error");
  bench.op.classCounters.Init(memory, 65536 * 4, DTM_Reference);
  EXPECT_TRUE(bench.op.Run());
}

TEST(opVoxelClassification, StoppedBeforeItsWorkHasClassifiedNothing) {
  for (const short algo : std::to_array<short>({401, 402})) {
    Workbench bench;
    rasters::StoppedBeforeWork<opVoxelClassification> op;
    op.volume = &bench.volume;
    op.SelectAlgo(algo);
    ExpectFailure(op, "stopped");
    EXPECT_EQ(op.classifiedBy, 400);
    EXPECT_EQ(op.GetProgress(), 0.0);
  }
}

TEST(opVoxelClassification, StoppedBeforeItsWorkHasSelectedNothing) {
  Workbench bench;
  bench.Classify(401);
  rasters::StoppedBeforeWork<opVoxelClassification> op;
  static_cast<opVoxelClassification&>(op) = bench.op;
  op.SetSelectionLimit(3);
  op.SelectAlgo(403);
  ExpectFailure(op, "stopped");
  EXPECT_EQ(bench.list.GetSize(), 0U);
  EXPECT_EQ(op.classifiedBy, 401);
}

TEST(opVoxelClassification, StoppedBeforeItsPreparationSaysSo) {
  Workbench bench;
  rasters::StoppedAtStart<opVoxelClassification> op;
  ExpectFailure(op, "missing input parameter 'Volume'");
  op.volume = &bench.volume;
  op.SelectAlgo(401);
  ExpectFailure(op, "stopped");
}

}  // namespace
