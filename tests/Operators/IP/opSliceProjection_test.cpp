// What opSliceProjection is, what it refuses, and with which words.

#include <vorl/Operators/IP/opSliceProjection.h>

#include <gtest/gtest.h>

#include <array>

#include "ProjectionBench.h"

namespace {

using projection_bench::Workbench;
using rasters::CodeOf;
using rasters::Make;
using rasters::MakeSlice;
using rasters::MessageOf;

constexpr std::array kAlgorithms = {301, 302, 303};

void ExpectFailure(opSliceProjection& op, const char* message) {
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), message);
}

TEST(opSliceProjection, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<opSliceProjection>("opSliceProjection");
}

void ExpectDefaults(const opSliceProjection& op) {
  EXPECT_EQ(op.projectionPlane, nullptr);
  EXPECT_EQ(op.slice, nullptr);
  EXPECT_EQ(op.voxelList, nullptr);
  EXPECT_EQ(op.volume, nullptr);
  EXPECT_EQ(op.borderValue, 0xFFFF);
  EXPECT_FALSE(op.zBuffer.IsValid());
  EXPECT_EQ(op.zBuffer.GetWidth(), 0U);
}

TEST(opSliceProjection, StartsWithoutInputsAndWithTheBrightestBorder) {
  ExpectDefaults(opSliceProjection());
}

TEST(opSliceProjection, StoresAlgorithmAndBorderValueUnchecked) {
  opSliceProjection op;
  op.SelectAlgo(-5);
  op.SetBorderValue(17);
  EXPECT_EQ(op.algoID, -5);
  EXPECT_EQ(op.borderValue, 17);
}

TEST(opSliceProjection, ResetDropsAllButTheAlgorithm) {
  Workbench bench;
  bench.op.SelectAlgo(303);
  bench.op.SetBorderValue(3);
  EXPECT_TRUE(bench.op.Reset());
  ExpectDefaults(bench.op);
  EXPECT_EQ(bench.op.algoID, 303);
}

TEST(opSliceProjection, CopiesCarryEveryFieldAndTheirOwnDepths) {
  Workbench bench;
  bench.op.SelectAlgo(302);
  bench.op.SetBorderValue(3);
  ASSERT_TRUE(bench.op());
  const opSliceProjection copy(bench.op);
  opSliceProjection assigned;
  assigned = bench.op;
  const rasters::Bytes depths = rasters::BytesOf(bench.op.zBuffer);
  bench.op.zBuffer.Fill(0);
  for (const opSliceProjection* other : {&copy, static_cast<const opSliceProjection*>(&assigned)}) {
    EXPECT_EQ(other->projectionPlane, &bench.plane);
    EXPECT_EQ(other->slice, &bench.slice);
    EXPECT_EQ(other->voxelList, &bench.list);
    EXPECT_EQ(other->volume, &bench.volume);
    EXPECT_EQ(other->algoID, 302);
    EXPECT_EQ(other->borderValue, 3);
    EXPECT_EQ(rasters::BytesOf(other->zBuffer), depths);
    EXPECT_EQ(MessageOf(*other), "success");
  }
}

TEST(opSliceProjection, SucceedsWithEveryAlgorithmAndType) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_S16}) {
    for (const int algo : kAlgorithms) {
      Workbench bench(type);
      bench.op.SelectAlgo(algo);
      EXPECT_TRUE(bench.op.Run());
      EXPECT_EQ(CodeOf(bench.op), 0);
      EXPECT_EQ(MessageOf(bench.op), "success");
      EXPECT_EQ(bench.op.GetProgress(), 1.0);
    }
  }
}

TEST(opSliceProjection, BackProjectionOfASliceFailsWithoutAMessage) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_S16}) {
    Workbench bench(type);
    bench.op.SelectAlgo(311);
    EXPECT_FALSE(bench.op.Run());
    EXPECT_EQ(CodeOf(bench.op), 0);
    EXPECT_EQ(MessageOf(bench.op), "");
    EXPECT_EQ(rasters::BytesOf(bench.plane.GetImage()), rasters::Bytes(24, 0x5A));
  }
}

TEST(opSliceProjection, NamesWhatIsMissingInItsOrder) {
  for (const int algo : {301, 311}) {
    Workbench bench;
    opSliceProjection op;
    op.SelectAlgo(algo);
    ExpectFailure(op, "missing input parameter 'Projection Slice'");
    op.projectionPlane = &bench.plane;
    ExpectFailure(op, "no slice to project");
    dSlice other;
    op.slice = &other;
    ExpectFailure(op, "incompatible data types(Projection Plane: 0x10, Slice: 0x0");
    op.slice = &bench.slice;
    ExpectFailure(op, "no volume to project");
    dVolume empty;
    op.volume = &empty;
    ExpectFailure(op, "given Volume is empty");
    Workbench bytes(ImageDataType_U8);
    op.volume = &bytes.volume;
    ExpectFailure(op, "incompatible data types(Projection Plane: 0x10, Volume: 0x8");
    op.volume = &bench.volume;
    ExpectFailure(op, "Z-Buffer is incompatible to 'Projection Plane'");
  }
}

// They need no slice; the list is looked at when the volume has been.
TEST(opSliceProjection, NamesWhatIsMissingForTheVolumeInItsOrder) {
  for (const int algo : {302, 303, 304}) {
    Workbench bench;
    opSliceProjection op;
    op.SelectAlgo(algo);
    ExpectFailure(op, "missing input parameter 'Projection Slice'");
    op.projectionPlane = &bench.plane;
    ExpectFailure(op, "no volume to project");
    dVolume empty;
    op.volume = &empty;
    ExpectFailure(op, "given Volume is empty");
    Workbench bytes(ImageDataType_U8);
    op.volume = &bytes.volume;
    ExpectFailure(op, "incompatible data types(Projection Plane: 0x10, Volume: 0x8");
    op.volume = &bench.volume;
    ExpectFailure(op, algo == 303 ? "no voxel list to project"
                                  : "Z-Buffer is incompatible to 'Projection Plane'");
  }
}

TEST(opSliceProjection, NeedsAListForTheVoxelListOnly) {
  for (const int algo : {301, 302}) {
    Workbench bench;
    bench.op.SelectAlgo(algo);
    bench.op.voxelList = nullptr;
    EXPECT_TRUE(bench.op.Run());
  }
  Workbench bench;
  bench.op.SelectAlgo(303);
  bench.op.voxelList = nullptr;
  bench.op.zBuffer.Reset();  // found only later
  ExpectFailure(bench.op, "no voxel list to project");
}

TEST(opSliceProjection, RefusesSlicesAndVolumesOfAnotherType) {
  Workbench bench(ImageDataType_S16);
  MakeSlice(bench.slice, 2, 2, ImageDataType_U16);
  bench.op.SelectAlgo(301);
  ExpectFailure(bench.op, "incompatible data types(Projection Plane: 0x1010, Slice: 0x10");
  Workbench other(ImageDataType_U16);
  bench.op.volume = &other.volume;
  for (const int algo : {302, 303, 304}) {
    bench.op.SelectAlgo(algo);
    ExpectFailure(bench.op, "incompatible data types(Projection Plane: 0x1010, Volume: 0x10");
  }
}

TEST(opSliceProjection, RefusesADepthBufferOfAnotherSize) {
  for (const auto& [width, height] : {std::pair(3UL, 4UL), {4UL, 2UL}, {5UL, 3UL}, {4UL, 4UL}}) {
    for (const int algo : {301, 302, 303, 304}) {
      Workbench bench;
      bench.op.SelectAlgo(algo);
      Make(bench.op.zBuffer, {.width = width, .height = height, .type = ImageDataType_S16});
      ExpectFailure(bench.op, "Z-Buffer is incompatible to 'Projection Plane'");
    }
  }
}

TEST(opSliceProjection, RefusesUnknownAlgorithmsAndTypesWithOneText) {
  for (const int algo : {300, 304, 310, 312, 0, -1}) {
    Workbench bench;
    bench.op.SelectAlgo(algo);
    ExpectFailure(bench.op, "unsupported data type: 16");
    Workbench negative(ImageDataType_S16);
    negative.op.SelectAlgo(algo);
    ExpectFailure(negative.op, "unsupported data type: 4112");
  }
  for (const int algo : {301, 302, 303, 311}) {
    Workbench bytes(ImageDataType_U8);
    bytes.op.SelectAlgo(algo);
    ExpectFailure(bytes.op, "unsupported data type: 8");
    Workbench real(ImageDataType_F32);
    real.op.SelectAlgo(algo);
    ExpectFailure(real.op, "unsupported data type: 8224");
  }
}

TEST(opSliceProjection, UnknownAlgorithmsPassThePreparation) {
  Workbench bench;
  rasters::Preparing<opSliceProjection> op;
  static_cast<opSliceProjection&>(op) = bench.op;
  for (const int algo : {300, 304, 310, 312, 0, -1}) {
    op.SelectAlgo(algo);
    EXPECT_TRUE(op.Prepare());
    EXPECT_EQ(CodeOf(op), 0);
  }
}

TEST(opSliceProjection, RefusesAVolumeWhoseSlicesLostTheirPixelsWhereItReadsThem) {
  Workbench bench;
  bench.volume.GetSlice(1)->GetImage().Reset();
  for (const int algo : {302, 303}) {
    bench.op.SelectAlgo(algo);
    ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
  }
  bench.op.SelectAlgo(301);
  EXPECT_TRUE(bench.op.Run());
}

TEST(opSliceProjection, RefusesBuffersThatDoNotHoldTheRows) {
  alignas(2) unsigned char memory[32] = {};
  for (const int algo : kAlgorithms) {
    Workbench bench;
    bench.op.SelectAlgo(algo);
    bench.op.zBuffer.GetDataBuffer().Init(memory, 23, DTM_Reference);
    ExpectFailure(bench.op, "invalid pixel data in the Z Buffer");
    bench.op.zBuffer.GetDataBuffer().Init(memory + 1, 24, DTM_Reference);
    ExpectFailure(bench.op, "invalid pixel data in the Z Buffer");
    bench.plane.GetImage().GetDataBuffer().Init(memory, 23, DTM_Reference);
    ExpectFailure(bench.op, "invalid pixel data in the Projection Plane");
  }
  Workbench bench;
  bench.op.SelectAlgo(301);
  bench.slice.GetImage().GetDataBuffer().Init(memory, 7, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in the Slice");
  bench.op.SelectAlgo(302);
  EXPECT_TRUE(bench.op.Run());
}

TEST(opSliceProjection, RefusesADepthBufferOfAnotherType) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_U8, ImageDataType_F64}) {
    Workbench bench;
    Make(bench.op.zBuffer, {.width = 4, .height = 3, .type = type});
    bench.op.SelectAlgo(301);
    ExpectFailure(bench.op, "invalid pixel data in the Z Buffer");
  }
}

TEST(opSliceProjection, StoppedBeforeItsWorkWritesNothing) {
  for (const int algo : kAlgorithms) {
    Workbench bench;
    rasters::StoppedBeforeWork<opSliceProjection> op;
    static_cast<opSliceProjection&>(op) = bench.op;
    op.SelectAlgo(algo);
    ExpectFailure(op, "stopped");
    EXPECT_EQ(rasters::BytesOf(bench.plane.GetImage()), rasters::Bytes(24, 0x5A));
    EXPECT_EQ(op.GetProgress(), 0.0);
  }
}

TEST(opSliceProjection, StoppedBeforeItsPreparationSaysSo) {
  Workbench bench;
  rasters::StoppedAtStart<opSliceProjection> op;
  ExpectFailure(op, "missing input parameter 'Projection Slice'");
  static_cast<opSliceProjection&>(op) = bench.op;
  ExpectFailure(op, "stopped");
}

}  // namespace
