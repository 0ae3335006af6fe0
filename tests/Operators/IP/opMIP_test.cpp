// What opMIP is, what it refuses, and with which words.

#include <vorl/Operators/IP/opMIP.h>

#include <gtest/gtest.h>

#include <array>

#include "Volumes.h"

namespace {

using rasters::CodeOf;
using rasters::Make;
using rasters::MakeSlice;
using rasters::MessageOf;

void ExpectFailure(opMIP& op, const char* message) {
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), message);
}

/// An operator with a volume of 2 x 2 x 3 voxels, a slice that fits it, and a list of one voxel.
struct Workbench {
  explicit Workbench(unsigned short type = ImageDataType_U16) : list(4UL) {
    for (int i = 0; i < 3; ++i) {
      dSlice added;
      MakeSlice(added, 2, 2, type);
      EXPECT_EQ(volume.AddSlice(added), i);
    }
    MakeSlice(slice, 2, 2, type);
    list.Set(0);
    op.volume = &volume;
    op.mipSlice = &slice;
    op.voxelList = &list;
  }

  dVolume volume;
  dSlice slice;
  dBuffer list;
  opMIP op;
};

TEST(opMIP, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<opMIP>("opMIP");
}

void ExpectDefaults(const opMIP& op) {
  EXPECT_EQ(op.mipSlice, nullptr);
  EXPECT_EQ(op.volume, nullptr);
  EXPECT_EQ(op.voxelList, nullptr);
  EXPECT_EQ(op.algoID, 201);
  EXPECT_EQ(op.depthSteps, -1);
}

TEST(opMIP, StartsWithTheNearestVoxelAndStepsFromTheThickness) {
  ExpectDefaults(opMIP());
}

TEST(opMIP, StoresAlgorithmAndDepthStepsUnchecked) {
  opMIP op;
  op.SelectAlgo(-5);
  op.SetDepthSteps(-9);
  EXPECT_EQ(op.algoID, -5);
  EXPECT_EQ(op.depthSteps, -9);
}

TEST(opMIP, ResetRestoresTheDefaults) {
  Workbench bench;
  bench.op.SelectAlgo(202);
  bench.op.SetDepthSteps(4);
  EXPECT_TRUE(bench.op.Reset());
  ExpectDefaults(bench.op);
}

TEST(opMIP, CopiesCarryEveryField) {
  Workbench bench;
  bench.op.SelectAlgo(205);
  bench.op.SetDepthSteps(4);
  ASSERT_TRUE(bench.op());
  const opMIP copy(bench.op);
  opMIP assigned;
  assigned = bench.op;
  for (const opMIP* other : {&copy, static_cast<const opMIP*>(&assigned)}) {
    EXPECT_EQ(other->mipSlice, &bench.slice);
    EXPECT_EQ(other->volume, &bench.volume);
    EXPECT_EQ(other->voxelList, &bench.list);
    EXPECT_EQ(other->algoID, 205);
    EXPECT_EQ(other->depthSteps, 4);
    EXPECT_EQ(MessageOf(*other), "success");
  }
}

TEST(opMIP, SucceedsWithEveryAlgorithmAndType) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_S16}) {
    for (const int algo : {MIPAlgo_Nearest, MIPAlgo_Trilinear, MIPAlgo_VoxelList}) {
      Workbench bench(type);
      bench.op.SelectAlgo(algo);
      EXPECT_TRUE(bench.op.Run());
      EXPECT_EQ(CodeOf(bench.op), 0);
      EXPECT_EQ(MessageOf(bench.op), "success");
      EXPECT_EQ(bench.op.GetProgress(), 1.0);
    }
  }
}

TEST(opMIP, NamesWhatIsMissingVolumeFirst) {
  opMIP op;
  op.SelectAlgo(203);  // found only later
  ExpectFailure(op, "missing input parameter 'Volume'");
  dVolume volume;
  op.volume = &volume;
  ExpectFailure(op, "given Volume is empty");
  rasters::MakeCounting(volume, 2, 2, 1);
  ExpectFailure(op, "missing input parameter 'MIP Slice'");
}

TEST(opMIP, RefusesASliceOfAnotherTypeBeforeItLooksAtTheList) {
  Workbench bench;
  bench.op.SelectAlgo(205);
  bench.op.voxelList = nullptr;
  MakeSlice(bench.slice, 2, 2, ImageDataType_S16);
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x1010");
  bench.slice.Reset();
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x0");
  Workbench other(ImageDataType_S16);
  MakeSlice(other.slice, 2, 2, ImageDataType_U8);
  ExpectFailure(other.op, "incompatible data types(Volume: 0x1010, Slice: 0x8");
}

TEST(opMIP, NeedsAListWithEntriesForTheVoxelListOnly) {
  Workbench bench;
  bench.op.SelectAlgo(205);
  bench.op.voxelList = nullptr;
  ExpectFailure(bench.op, "missing input parameter 'Voxel List'");
  dBuffer empty;
  bench.op.voxelList = &empty;
  ExpectFailure(bench.op, "'Voxel List' is empty");
  for (const int algo : {201, 202}) {
    bench.op.SelectAlgo(algo);
    EXPECT_TRUE(bench.op.Run());
    bench.op.voxelList = nullptr;
    EXPECT_TRUE(bench.op.Run());
  }
}

TEST(opMIP, RefusesAnUnknownAlgorithmBeforeTheDataType) {
  Workbench bytes(ImageDataType_U8);
  for (const int algo : {203, 204, 206, 200, 0, -1}) {
    const std::string message = "invalid MIP Algo ID: " + std::to_string(algo);
    Workbench bench;
    bench.op.SelectAlgo(algo);
    ExpectFailure(bench.op, message.c_str());
    bytes.op.SelectAlgo(algo);
    ExpectFailure(bytes.op, message.c_str());
  }
}

TEST(opMIP, RefusesEveryOtherDataType) {
  const std::pair<unsigned short, const char*> cases[] = {
      {ImageDataType_U1, "unsupported data type: 1"},
      {ImageDataType_U8, "unsupported data type: 8"},
      {ImageDataType_S8, "unsupported data type: 4104"},
      {ImageDataType_U32, "unsupported data type: 32"},
      {ImageDataType_S32, "unsupported data type: 4128"},
      {ImageDataType_F64, "unsupported data type: 8256"}};
  for (const auto& [type, message] : cases) {
    for (const int algo : {201, 202, 205}) {
      Workbench bench(type);
      bench.op.SelectAlgo(algo);
      ExpectFailure(bench.op, message);
      EXPECT_EQ(rasters::BytesOf(bench.slice.GetImage()),
                rasters::Bytes(bench.slice.GetImage().GetImageSize(), 0x5A));
    }
  }
}

TEST(opMIP, RefusesAVolumeWhoseSlicesLostTheirPixels) {
  for (const int algo : {201, 202, 205}) {
    Workbench bench;
    bench.op.SelectAlgo(algo);
    bench.volume.GetSlice(2)->GetImage().Reset();
    ExpectFailure(bench.op, "invalid pixel data in slice 2 of the Volume");
    Make(bench.volume.GetSlice(1)->GetImage(),
         {.width = 2, .height = 1, .type = ImageDataType_U16});
    ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
  }
}

TEST(opMIP, RefusesBuffersThatDoNotHoldTheRows) {
  alignas(2) unsigned char memory[16] = {};
  Workbench bench;
  dBuffer& output = bench.slice.GetImage().GetDataBuffer();
  output.Init(memory, 7, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in the MIP Slice");
  output.Init(memory + 1, 8, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in the MIP Slice");
  output.Init(memory, 8, DTM_Reference);
  EXPECT_TRUE(bench.op.Run());
}

TEST(opMIP, StoppedBeforeItsWorkWritesNothing) {
  for (const int algo : {201, 202, 205}) {
    Workbench bench;
    rasters::StoppedBeforeWork<opMIP> op;
    op.volume = &bench.volume;
    op.mipSlice = &bench.slice;
    op.voxelList = &bench.list;
    op.SelectAlgo(algo);
    ExpectFailure(op, "stopped");
    EXPECT_EQ(rasters::BytesOf(bench.slice.GetImage()), rasters::Bytes(8, 0x5A));
    EXPECT_EQ(op.GetProgress(), 0.0);
  }
}

TEST(opMIP, StoppedBeforeItsPreparationSaysSo) {
  Workbench bench;
  rasters::StoppedAtStart<opMIP> op;
  ExpectFailure(op, "missing input parameter 'Volume'");
  op.volume = &bench.volume;
  op.mipSlice = &bench.slice;
  ExpectFailure(op, "stopped");
}

}  // namespace
