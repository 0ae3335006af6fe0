// The plane and the depth buffer that belong to a sequence of drawings.

#include <vorl/Operators/IP/opSliceProjection.h>

#include <gtest/gtest.h>

#include <array>

#include "ProjectionBench.h"

namespace {

using projection_bench::Drawing;
using projection_bench::MakeFlat;
using projection_bench::Workbench;
using rasters::AddSlice;
using rasters::CodeOf;
using rasters::Make;
using rasters::MessageOf;
using Unsigned = std::vector<std::uint16_t>;
using Depths = std::vector<std::int16_t>;

TEST(opSliceProjectionPlane, DepthBufferIsFormattedLikeThePlaneAndFarthest) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_S16}) {
    dSlice plane;
    Make(plane.GetImage(), {.width = 5, .height = 3, .type = type, .alignment = 32});
    opSliceProjection op;
    op.projectionPlane = &plane;
    EXPECT_TRUE(op.InitZBuffer());
    EXPECT_EQ(op.zBuffer.GetWidth(), 5U);
    EXPECT_EQ(op.zBuffer.GetHeight(), 3U);
    EXPECT_EQ(op.zBuffer.GetDataType(), 0x1010);
    EXPECT_EQ(op.zBuffer.GetRowAlignment(), 32U);
    EXPECT_STREQ(op.zBuffer.GetChannelSequence(), "G");
    EXPECT_EQ(rasters::SamplesOf<std::int16_t>(op.zBuffer), Depths(15, 32767));
  }
}

TEST(opSliceProjectionPlane, InitialisingTheDepthBufferAgainForgetsTheDepths) {
  Workbench bench;
  bench.op.zBuffer.Fill(3);
  EXPECT_TRUE(bench.op.InitZBuffer());
  EXPECT_EQ(rasters::SamplesOf<std::int16_t>(bench.op.zBuffer), Depths(12, 32767));
  rasters::MakeSlice(bench.plane, 2, 1);
  EXPECT_TRUE(bench.op.InitZBuffer());
  EXPECT_EQ(rasters::SamplesOf<std::int16_t>(bench.op.zBuffer), Depths(2, 32767));
}

TEST(opSliceProjectionPlane, WithoutAPlaneTheDepthBufferIsEmptied) {
  Workbench bench;
  bench.op.projectionPlane = nullptr;
  EXPECT_TRUE(bench.op.InitZBuffer());
  EXPECT_FALSE(bench.op.zBuffer.IsValid());
  EXPECT_EQ(bench.op.zBuffer.GetWidth(), 0U);
}

TEST(opSliceProjectionPlane, DepthBufferOfAnEmptyPlaneCannotBeInitialised) {
  dSlice plane;
  opSliceProjection op;
  op.projectionPlane = &plane;
  EXPECT_FALSE(op.InitZBuffer());
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), "error while initializing the 'Z Buffer'");
  EXPECT_FALSE(op.zBuffer.IsValid());
}

TEST(opSliceProjectionPlane, RunningBeforeTheDepthBufferIsInitialisedFails) {
  Workbench bench;
  bench.op.zBuffer.Reset();
  bench.op.SelectAlgo(301);
  EXPECT_FALSE(bench.op.Run());
  EXPECT_EQ(MessageOf(bench.op), "Z-Buffer is incompatible to 'Projection Plane'");
}

TEST(opSliceProjectionPlane, ClearingFillsThePlaneWithZeroAndLeavesTheDepths) {
  Workbench bench;
  Make(bench.plane.GetImage(),
       {.width = 4, .height = 3, .type = ImageDataType_U16, .alignment = 32});
  bench.plane.GetImage().Fill(0x5A);
  bench.op.zBuffer.Fill(1);
  bench.op.ClearProjectionPlane();
  EXPECT_EQ(rasters::BytesOf(bench.plane.GetImage()), rasters::Bytes(96, 0));
  EXPECT_EQ(rasters::SamplesOf<std::int16_t>(bench.op.zBuffer), Depths(12, 257));
}

TEST(opSliceProjectionPlane, ClearingWithoutAPlaneDoesNothing) {
  Workbench bench;
  bench.op.projectionPlane = nullptr;
  bench.op.ClearProjectionPlane();
  EXPECT_EQ(rasters::BytesOf(bench.plane.GetImage()), rasters::Bytes(24, 0x5A));
}

// Two slices, then the volume behind them: what applications do.
TEST(opSliceProjectionPlane, DrawingsAddUpUntilThePlaneIsCleared) {
  Drawing<std::uint16_t> drawing(4, 1);
  drawing.op.SetBorderValue(50);
  dSlice near, far;
  MakeFlat<std::uint16_t>(near, 1, 1, 7, 1);
  MakeFlat<std::uint16_t>(far, 2, 1, 7, 2);
  drawing.DrawSlice(near);
  drawing.op.SetBorderValue(60);
  drawing.DrawSlice(far);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{50, 60, 0, 0}));
  EXPECT_EQ(drawing.Depths(), (Depths{1, 2, 32767, 32767}));

  // Rays begin half a step behind the plane, so step t lies in slice t - 1; a ray through four
  // slices has the steps 0 to 3.
  dVolume volume;
  for (const std::uint16_t value : std::to_array<std::uint16_t>({10, 20, 55, 70})) {
    AddSlice<std::uint16_t>(volume, {.width = 3, .type = ImageDataType_U16}, {value, value, value});
  }
  drawing.DrawVolume(volume);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{50, 60, 55, 0}));
  EXPECT_EQ(drawing.Depths(), (Depths{1, 2, 32767, 32767}));

  drawing.op.ClearProjectionPlane();
  drawing.DrawVolume(volume);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{0, 10, 55, 0}));
}

}  // namespace
