// A sixteen-to-eight lookup makes its result in memory of its own, which becomes the target's.
#include <vorl/Operators/IP/opLookup.h>

#include <vorl/Data/dBCGLUT.h>

#include <gtest/gtest.h>

#include "Rasters.h"

namespace {

using rasters::Make;
using rasters::MakeOf;
using rasters::MessageOf;
using rasters::SamplesOf;

TEST(opLookup, ATargetOfAnotherFormatIsFormatted) {
  dImage source;
  MakeOf<std::uint16_t>(source, {2, 2, ImageDataType_U16, "G", 0, 2}, {3, 70, 80, 90});
  dBCGLUT lut;
  const rasters::Format others[] = {
      {4, 1, ImageDataType_U8, "G", 0, 2}, {1, 2, ImageDataType_U8, "G", 0, 2},
      {2, 2, ImageDataType_S8, "G", 0, 2}, {2, 2, ImageDataType_U8, "G", ImageDataOrder_Plane, 2},
      {2, 2, ImageDataType_U8, "G", 0, 1}, {2, 2, ImageDataType_U8, "Y", 0, 2}};
  for (const rasters::Format& other : others) {
    dImage target;
    Make(target, other);
    ASSERT_EQ(target.GetImageSize(), 4U);
    EXPECT_EQ(MessageOf(opLookup(&source, &target, &lut)), "success");
    EXPECT_EQ(SamplesOf<std::uint8_t>(target), (std::vector<std::uint8_t>{3, 70, 80, 90}));
    EXPECT_EQ(target.GetWidth(), 2U);
    EXPECT_EQ(target.GetDataType(), ImageDataType_U8);
    EXPECT_EQ(target.GetDataOrder(), ImageDataOrder_Pixel);
    EXPECT_EQ(target.GetRowAlignment(), 2U);
    EXPECT_STREQ(target.GetChannelSequence(), "G");
  }
}

TEST(opLookup, AStoppedLookupLeavesItsTargetAsItIs) {
  dImage source;
  MakeOf<std::uint16_t>(source, {2, 2, ImageDataType_U16, "G", 0, 2}, {3, 70, 80, 90});
  dBCGLUT lut;
  dImage target;
  MakeOf<std::uint8_t>(target, {3, 1}, {1, 2, 3});
  const void* const pixels = target.GetDataPtr();
  rasters::StoppedBeforeWork<opLookup> op;
  op.m_pSource = &source;
  op.m_pTarget = &target;
  op.m_pLUT = &lut;
  EXPECT_FALSE(op());
  EXPECT_EQ(MessageOf(op), "stopped");
  EXPECT_EQ(target.GetDataPtr(), pixels);
  EXPECT_EQ(SamplesOf<std::uint8_t>(target), (std::vector<std::uint8_t>{1, 2, 3}));
}

TEST(opLookup, PixelsThatATargetRefersToStay) {
  dImage source;
  MakeOf<std::uint16_t>(source, {2, 2, ImageDataType_U16, "G", 0, 2}, {3, 70, 80, 90});
  dBCGLUT lut;
  unsigned char foreign[4] = {1, 2, 3, 4};
  dImage target;
  Make(target, {2, 2, ImageDataType_U8, "G", 0, 2});
  target.GetDataBuffer().Init(foreign, 4, DTM_Reference);
  EXPECT_EQ(MessageOf(opLookup(&source, &target, &lut)), "success");
  EXPECT_EQ(SamplesOf<std::uint8_t>(target), (std::vector<std::uint8_t>{3, 70, 80, 90}));
  EXPECT_EQ(foreign[0], 1);
}

TEST(opLookup, ATargetWhosePixelsTheSourceRefersToIsNotReadOverwritten) {
  dImage target;
  Make(target, {2, 2, ImageDataType_U8, "G", 0, 2});
  ASSERT_TRUE(target.GetDataBuffer().New(16, true));
  const std::uint16_t samples[] = {70, 3, 90, 80};
  std::memcpy(target.GetDataPtr(), samples, sizeof(samples));
  dImage source;
  Make(source, {2, 2, ImageDataType_U16, "G", 0, 2});
  source.GetDataBuffer().Init(target.GetDataPtr(), 8, DTM_Reference);
  dBCGLUT lut;
  EXPECT_EQ(MessageOf(opLookup(&source, &target, &lut)), "success");
  EXPECT_EQ(SamplesOf<std::uint8_t>(target), (std::vector<std::uint8_t>{70, 3, 90, 80}));
}

TEST(opLookup, TheTableMayTakeTheResult) {
  dBCGLUT lut;
  dImage& entries = lut;
  std::vector<std::uint16_t> samples(256);
  for (std::size_t i = 0; i < samples.size(); ++i) {
    lut.GetLUT(0)[i] = static_cast<std::uint8_t>(255 - i);
    samples[i] = static_cast<std::uint16_t>(i);
  }
  dImage source;
  MakeOf<std::uint16_t>(source,
                        {entries.GetWidth(), entries.GetHeight(), ImageDataType_U16,
                         entries.GetChannelSequence(), entries.GetDataOrder(), 2},
                        samples);
  EXPECT_EQ(MessageOf(opLookup(&source, &entries, &lut)), "success");
  const auto given = SamplesOf<std::uint8_t>(entries);
  ASSERT_EQ(given.size(), samples.size());
  for (std::size_t i = 0; i < given.size(); ++i) {
    EXPECT_EQ(given[i], 255 - i) << i;
  }
}

}  // namespace
