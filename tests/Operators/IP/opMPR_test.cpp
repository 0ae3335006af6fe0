// What opMPR is, what it refuses, and with which words.

#include <vorl/Operators/IP/opMPR.h>

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <numeric>
#include <vector>

#include "Volumes.h"

namespace {

using rasters::AddSlice;
using rasters::CodeOf;
using rasters::Make;
using rasters::MakeCounting;
using rasters::MakeSlice;
using rasters::MessageOf;

void ExpectFailure(opMPR& op, const char* message) {
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), message);
}

/// An operator with a volume of 2 x 2 x 3 voxels and a slice that fits it.
struct Workbench {
  explicit Workbench(unsigned short type = ImageDataType_U16) {
    for (int i = 0; i < 3; ++i) {
      dSlice added;
      MakeSlice(added, 2, 2, type);
      EXPECT_EQ(volume.AddSlice(added), i);
    }
    MakeSlice(slice, 2, 2, type);
    op.volume = &volume;
    op.mprSlice = &slice;
  }

  dVolume volume;
  dSlice slice;
  opMPR op;
};

TEST(opMPR, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<opMPR>("opMPR");
}

TEST(opMPR, StartsWithTheThinNearestPlane) {
  const opMPR op;
  EXPECT_EQ(op.mprSlice, nullptr);
  EXPECT_EQ(op.volume, nullptr);
  EXPECT_EQ(op.algoID, 102);
  EXPECT_EQ(op.depthSteps, 0);
}

TEST(opMPR, StoresAlgorithmAndDepthStepsUnchecked) {
  opMPR op;
  op.SelectAlgo(-5);
  op.SetDepthSteps(-9);
  EXPECT_EQ(op.algoID, -5);
  EXPECT_EQ(op.depthSteps, -9);
}

TEST(opMPR, ResetRestoresTheDefaults) {
  Workbench bench;
  bench.op.SelectAlgo(101);
  bench.op.SetDepthSteps(4);
  EXPECT_TRUE(bench.op.Reset());
  EXPECT_EQ(bench.op.mprSlice, nullptr);
  EXPECT_EQ(bench.op.volume, nullptr);
  EXPECT_EQ(bench.op.algoID, 102);
  EXPECT_EQ(bench.op.depthSteps, 0);
}

TEST(opMPR, CopiesCarryEveryField) {
  Workbench bench;
  bench.op.SelectAlgo(101);
  bench.op.SetDepthSteps(4);
  ASSERT_TRUE(bench.op());
  const opMPR copy(bench.op);
  opMPR assigned;
  assigned = bench.op;
  for (const opMPR* other : {&copy, static_cast<const opMPR*>(&assigned)}) {
    EXPECT_EQ(other->mprSlice, &bench.slice);
    EXPECT_EQ(other->volume, &bench.volume);
    EXPECT_EQ(other->algoID, 101);
    EXPECT_EQ(other->depthSteps, 4);
    EXPECT_EQ(MessageOf(*other), "success");
  }
}

TEST(opMPR, SucceedsWithEveryAlgorithmTypeAndThickness) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_S16}) {
    for (const int algo : {MPRAlgo_Trilinear, MPRAlgo_Nearest}) {
      for (const int steps : {0, 1, -1}) {
        Workbench bench(type);
        bench.op.SelectAlgo(algo);
        bench.op.SetDepthSteps(steps);
        EXPECT_TRUE(bench.op.Run());
        EXPECT_EQ(CodeOf(bench.op), 0);
        EXPECT_EQ(MessageOf(bench.op), "success");
        EXPECT_EQ(bench.op.GetProgress(), 1.0);
      }
    }
  }
}

TEST(opMPR, NamesWhatIsMissingVolumeFirst) {
  opMPR op;
  op.SelectAlgo(100);
  ExpectFailure(op, "missing input parameter 'Volume'");
  dVolume volume;
  op.volume = &volume;
  ExpectFailure(op, "given Volume is empty");
  MakeCounting(volume, 2, 2, 1);
  ExpectFailure(op, "missing input parameter 'MPR Slice'");
}

TEST(opMPR, RefusesASliceOfAnotherType) {
  Workbench bench;
  bench.op.SelectAlgo(100);  // found only later
  MakeSlice(bench.slice, 2, 2, ImageDataType_S16);
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x1010");
  MakeSlice(bench.slice, 2, 2, ImageDataType_U8);
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x8");
  bench.slice.Reset();
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x0");
}

TEST(opMPR, RefusesAnUnknownAlgorithmBeforeTheDataType) {
  Workbench bench;
  bench.op.SelectAlgo(100);
  ExpectFailure(bench.op, "invalid MPR Algo ID: 100");
  bench.op.SelectAlgo(103);
  ExpectFailure(bench.op, "invalid MPR Algo ID: 103");
  Workbench bytes(ImageDataType_U8);
  bytes.op.SelectAlgo(-1);
  ExpectFailure(bytes.op, "invalid MPR Algo ID: -1");
}

TEST(opMPR, RefusesEveryOtherDataType) {
  const std::pair<unsigned short, const char*> cases[] = {
      {ImageDataType_U1, "unsupported data type: 1"},
      {ImageDataType_U8, "unsupported data type: 8"},
      {ImageDataType_S8, "unsupported data type: 4104"},
      {ImageDataType_U32, "unsupported data type: 32"},
      {ImageDataType_S32, "unsupported data type: 4128"},
      {ImageDataType_F32, "unsupported data type: 8224"},
      {ImageDataType_F64, "unsupported data type: 8256"}};
  for (const auto& [type, message] : cases) {
    Workbench bench(type);
    ExpectFailure(bench.op, message);
    EXPECT_EQ(rasters::BytesOf(bench.slice.GetImage()),
              rasters::Bytes(bench.slice.GetImage().GetImageSize(), 0x5A));
  }
}

TEST(opMPR, RefusesAVolumeWhoseSlicesLostTheirPixels) {
  Workbench bench;
  bench.volume.GetSlice(2)->GetImage().Reset();
  ExpectFailure(bench.op, "invalid pixel data in slice 2 of the Volume");
  bench.volume.GetSlice(1)->GetImage().Reset();
  ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
  bench.volume.GetSlice(0)->GetImage().Reset();
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x0, Slice: 0x10");
}

TEST(opMPR, RefusesAVolumeWhoseSlicesWereFormattedAnew) {
  const rasters::Format others[] = {
      {.width = 2, .height = 1, .type = ImageDataType_U16},
      {.width = 1, .height = 2, .type = ImageDataType_U16},
      {.width = 3, .height = 3, .type = ImageDataType_U16},
      {.width = 2, .height = 2, .type = ImageDataType_U8, .alignment = 32},
      {.width = 2, .height = 2, .type = ImageDataType_U16, .channels = "GA"}};
  for (const rasters::Format& other : others) {
    Workbench bench;
    Make(bench.volume.GetSlice(1)->GetImage(), other);
    ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
  }
}

TEST(opMPR, RefusesASliceWithShorterRowsThanTheFirst) {
  dVolume volume;
  for (const unsigned short alignment : std::to_array<unsigned short>({32, 2})) {
    dSlice slice;
    Make(slice.GetImage(),
         {.width = 2, .height = 2, .type = ImageDataType_U16, .alignment = alignment});
    ASSERT_GE(volume.AddSlice(slice), 0);
  }
  Workbench bench;
  bench.op.volume = &volume;
  ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
}

// Rows are taken as far apart as those of slice 0, in every slice.
TEST(opMPR, ReadsASliceWithLongerRowsAtTheFirstSlicesPitch) {
  dVolume volume;
  for (const unsigned short alignment : std::to_array<unsigned short>({2, 32})) {
    dSlice slice;
    dImage& image = slice.GetImage();
    Make(image, {.width = 2, .height = 2, .type = ImageDataType_U16, .alignment = alignment});
    auto* samples = static_cast<std::uint16_t*>(image.GetDataPtr());
    std::iota(samples, samples + image.GetImageSize() / 2, std::uint16_t{alignment});
    ASSERT_GE(volume.AddSlice(slice), 0);
  }
  Workbench bench;
  bench.op.volume = &volume;
  for (const int algo : {101, 102}) {
    bench.op.SelectAlgo(algo);
    bench.slice.SetPosition(dVect3D(0, 0, 0));
    EXPECT_TRUE(bench.op.Run());
    EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(bench.slice.GetImage()),
              (std::vector<std::uint16_t>{2, 3, 4, 5}));
    bench.slice.SetPosition(dVect3D(0, 0, 1));
    EXPECT_TRUE(bench.op.Run());
    EXPECT_EQ(rasters::SamplesOf<std::uint16_t>(bench.slice.GetImage()),
              (std::vector<std::uint16_t>{32, 33, 34, 35}));
  }
}

TEST(opMPR, RefusesBuffersThatDoNotHoldTheRows) {
  alignas(2) unsigned char memory[16] = {};
  Workbench bench;
  dBuffer& pixels = bench.volume.GetSlice(0)->GetImage().GetDataBuffer();
  pixels.Init(memory, 7, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in slice 0 of the Volume");
  pixels.Init(memory + 1, 8, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in slice 0 of the Volume");
  pixels.Init(memory, 8, DTM_Reference);
  EXPECT_TRUE(bench.op.Run());

  dBuffer& output = bench.slice.GetImage().GetDataBuffer();
  output.Init(memory + 8, 7, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in the MPR Slice");
  output.Init(memory + 7, 8, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in the MPR Slice");
}

TEST(opMPR, StoppedBeforeItsWorkWritesNothing) {
  Workbench bench;
  rasters::StoppedBeforeWork<opMPR> op;
  op.volume = &bench.volume;
  op.mprSlice = &bench.slice;
  ExpectFailure(op, "stopped");
  EXPECT_EQ(rasters::BytesOf(bench.slice.GetImage()), rasters::Bytes(8, 0x5A));
}

TEST(opMPR, StoppedBeforeItsPreparationSaysSo) {
  Workbench bench;
  rasters::StoppedAtStart<opMPR> op;
  ExpectFailure(op, "missing input parameter 'Volume'");
  op.volume = &bench.volume;
  op.mprSlice = &bench.slice;
  ExpectFailure(op, "stopped");
}

/// The samples of row 0 of a 1 x 1 x 1 step walk through a volume of `width` x 1 x 1 voxels,
/// each 7.
std::vector<std::uint16_t> RowThrough(unsigned long width, float firstX, unsigned long count) {
  dVolume volume;
  dSlice added;
  EXPECT_TRUE(added.GetImage().Init(width, 1, ImageDataType_U16, "G", 0, 2));
  added.GetImage().GetDataBuffer().Set(static_cast<unsigned short>(7));
  EXPECT_EQ(volume.AddSlice(added), 0);
  dSlice slice;
  EXPECT_TRUE(slice.GetImage().Init(count, 1, ImageDataType_U16, "G", 0, 2));
  slice.SetPosition(dVect3D(firstX, 0, 0));
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  EXPECT_TRUE(op.Run());
  const auto* samples = static_cast<const std::uint16_t*>(slice.GetImage().GetDataPtr());
  return {samples, samples + count};
}

TEST(opMPR, VolumesOf32768VoxelsAndMoreWrapTheirLimits) {
  EXPECT_EQ(RowThrough(32767, 32765, 3), (std::vector<std::uint16_t>{7, 7, 0}));
  EXPECT_EQ(RowThrough(32768, 0, 3), (std::vector<std::uint16_t>{0, 0, 0}));
  EXPECT_EQ(RowThrough(65536 + 5, 3, 4), (std::vector<std::uint16_t>{7, 7, 0, 0}));
}

TEST(opMPR, VolumeAndSliceWithoutPixelsHaveNoSupportedType) {
  dVolume volume;
  dSlice empty;
  ASSERT_EQ(volume.AddSlice(empty), 0);
  dSlice slice;
  opMPR op;
  op.volume = &volume;
  op.mprSlice = &slice;
  ExpectFailure(op, "unsupported data type: 0");
}

}  // namespace
