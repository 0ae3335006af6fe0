#include <vorl/Operators/IP/opLookup.h>

#include <vorl/Data/dBCGLUT.h>
#include <vorl/Data/dWindowingLUT.h>

#include <gtest/gtest.h>

#include "Rasters.h"

namespace {

using rasters::BytesOf;
using rasters::CodeOf;
using rasters::Format;
using rasters::Make;
using rasters::MakeOf;
using rasters::MessageOf;
using rasters::SamplesOf;
using Samples8 = std::vector<std::uint8_t>;

/// A table whose entry i is first + i, cut to eight bits.
class CountingLUT : public dLUT {
 public:
  CountingLUT(long size, long start, int first = 0) : m_first(first) {
    Init(size, LUTType_U8, 1, start);
  }
  void MarkOutdated(int first) {
    m_first = first;
    m_recalculate = true;
  }
  bool IsOutdated() const { return m_recalculate; }

 protected:
  bool CalculateLUT() override {
    auto* entries = static_cast<std::uint8_t*>(m_table.GetDataPtr());
    for (unsigned long i = 0; i < m_table.GetWidth(); ++i) {
      entries[i] = static_cast<std::uint8_t>(static_cast<unsigned long>(m_first) + i);
    }
    return true;
  }

 private:
  int m_first;
};

std::string MessageFor(dImage* source, dLUT* lut) {
  dImage target;
  opLookup op(source, &target, lut);
  EXPECT_EQ(CodeOf(op), -1);
  return MessageOf(op);
}

TEST(opLookup, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<opLookup>("opLookup");
}

TEST(opLookup, ResetDropsTheOperands) {
  dImage image;
  dLUT lut;
  opLookup op;
  op.m_pSource = op.m_pTarget = &image;
  op.m_pLUT = &lut;
  EXPECT_TRUE(op.Reset());
  EXPECT_EQ(op.m_pSource, nullptr);
  EXPECT_EQ(op.m_pTarget, nullptr);
  EXPECT_EQ(op.m_pLUT, nullptr);
}

TEST(opLookup, CopiesCarryTheOperands) {
  dImage source;
  dImage target;
  dLUT lut;
  opLookup op(&source, &target, &lut);
  const opLookup copy(op);
  opLookup assigned;
  assigned = op;
  for (const opLookup* other : {&copy, static_cast<const opLookup*>(&assigned)}) {
    EXPECT_EQ(other->m_pSource, &source);
    EXPECT_EQ(other->m_pTarget, &target);
    EXPECT_EQ(other->m_pLUT, &lut);
    EXPECT_EQ(MessageOf(*other), "uninitialized source image");
  }
}

TEST(opLookup, NamesWhatIsWrongWithTheSource) {
  dWindowingLUT lut;
  dImage image;
  EXPECT_EQ(MessageFor(nullptr, &lut), "missing source image");
  EXPECT_EQ(MessageFor(&image, &lut), "uninitialized source image");
  Make(image, {.width = 2, .channels = "GA"});
  EXPECT_EQ(MessageFor(&image, &lut), "multi channel(2) source images are not supported");
  Make(image, {.width = 2, .type = ImageDataType_U1});
  EXPECT_EQ(MessageFor(&image, &lut), "invalid channel depth:1 bit(must be 8 or 16 bit)");
  Make(image, {.width = 2, .type = ImageDataType_S32});
  EXPECT_EQ(MessageFor(&image, &lut), "invalid channel depth:32 bit(must be 8 or 16 bit)");
}

TEST(opLookup, NamesWhatIsWrongWithTheTable) {
  dImage image;
  Make(image, {.width = 2});
  dLUT lut;
  EXPECT_EQ(MessageFor(&image, nullptr), "missing LUT");
  EXPECT_EQ(MessageFor(&image, &lut), "uninitialized LUT");
  ASSERT_TRUE(lut.Init(4, LUTType_U8, 3, 0));
  EXPECT_EQ(MessageFor(&image, &lut), "LUT has more(3) than 1 channel");
  ASSERT_TRUE(lut.Init(4, static_cast<LUTType>(ImageDataType_U16), 1, 0));
  EXPECT_EQ(MessageFor(&image, &lut), "data depth of the LUT(16 bit) must be 8 bit");
}

TEST(opLookup, ChecksTheSourceBeforeTheTableAndChannelsBeforeDepths) {
  dImage image;
  dLUT lut;
  EXPECT_EQ(MessageFor(nullptr, nullptr), "missing source image");
  EXPECT_EQ(MessageFor(&image, nullptr), "uninitialized source image");
  Make(image, {.width = 2, .type = ImageDataType_F32, .channels = "RGB"});
  EXPECT_EQ(MessageFor(&image, nullptr), "multi channel(3) source images are not supported");
  Make(image, {.width = 2, .type = ImageDataType_F32});
  EXPECT_EQ(MessageFor(&image, nullptr), "invalid channel depth:32 bit(must be 8 or 16 bit)");
  Make(image, {.width = 2});
  ASSERT_TRUE(lut.Init(4, static_cast<LUTType>(ImageDataType_U16), 2, 0));
  EXPECT_EQ(MessageFor(&image, &lut), "LUT has more(2) than 1 channel");
}

TEST(opLookup, RefusesASourceWhoseBufferDoesNotHoldItsRows) {
  dWindowingLUT lut;
  dImage image;
  Make(image, {.width = 4, .height = 4, .type = ImageDataType_U16});
  alignas(2) unsigned char memory[40] = {};
  image.GetDataBuffer().Init(memory, 31, DTM_Reference);
  EXPECT_EQ(MessageFor(&image, &lut), "invalid pixel data in the source image");
  image.GetDataBuffer().Init(memory + 1, 32, DTM_Reference);
  EXPECT_EQ(MessageFor(&image, &lut), "invalid pixel data in the source image");
  image.GetDataBuffer().Init(memory, 32, DTM_Reference);
  dImage target;
  EXPECT_EQ(MessageOf(opLookup(&image, &target, &lut)), "success");
}

TEST(opLookup, ReportsATargetThatCannotBeFormatted) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {1, 2});
  rasters::StubbornImage target;
  dBCGLUT lut;
  const opLookup op(&image, &target, &lut);
  EXPECT_EQ(CodeOf(op), -7);
  EXPECT_EQ(MessageOf(op), "error while creating image buffer:no room");
}

TEST(opLookup, StoppedLeavesThePixelsAsTheyAre) {
  dImage image;
  MakeOf<std::uint16_t>(image, {.width = 2, .type = ImageDataType_U16}, {1, 2});
  dImage bytes;
  MakeOf<std::uint8_t>(bytes, {.width = 2}, {1, 2});
  CountingLUT lut(256, 0, 9);
  rasters::StoppedBeforeWork<opLookup> op;
  op.m_pLUT = &lut;
  for (dImage* source : {&image, &bytes}) {
    const rasters::Bytes before = BytesOf(*source);
    op.m_pSource = source;
    EXPECT_FALSE(op());
    EXPECT_EQ(CodeOf(op), -1);
    EXPECT_EQ(MessageOf(op), "stopped");
    EXPECT_EQ(BytesOf(*source), before);
  }
}

TEST(opLookup, SucceedsWithTheBaseMessage) {
  dImage image;
  Make(image, {.width = 2});
  dBCGLUT lut;
  const opLookup op(&image, nullptr, &lut);
  EXPECT_EQ(CodeOf(op), 0);
  EXPECT_EQ(MessageOf(op), "success");
}

TEST(opLookup, SixteenBitsThroughTheDefaultWindowTakeEveryEntry) {
  dImage image;
  dImage target;
  MakeOf<std::uint16_t>(image, {.width = 4, .type = ImageDataType_U16}, {0, 257, 32768, 65535});
  dWindowingLUT lut;
  ASSERT_EQ(MessageOf(opLookup(&image, &target, &lut)), "success");
  // 0.5 + i * 255 / 65536, truncated
  EXPECT_EQ(SamplesOf<std::uint8_t>(target), (Samples8{0, 1, 128, 255}));
  EXPECT_EQ(target.GetDataType(), ImageDataType_U8);
}

TEST(opLookup, SixteenBitsThroughAShortTableClampToItsLastEntry) {
  dImage image;
  dImage target;
  MakeOf<std::uint16_t>(image, {.width = 6, .type = ImageDataType_U16},
                        {0, 254, 255, 256, 257, 65535});
  dBCGLUT lut;
  const std::uint8_t last = lut.GetLUT(0)[255];
  ASSERT_EQ(last, 254);
  ASSERT_EQ(MessageOf(opLookup(&image, &target, &lut)), "success");
  EXPECT_EQ(SamplesOf<std::uint8_t>(target),
            (Samples8{lut.GetLUT(0)[0], lut.GetLUT(0)[254], last, last, last, last}));
}

TEST(opLookup, SignedBytesBelowTheTableTakeItsFirstEntry) {
  dImage image;
  MakeOf<std::int8_t>(image, {.width = 5, .type = ImageDataType_S8}, {-128, -1, 0, 1, 127});
  CountingLUT lut(256, 0, 10);
  ASSERT_EQ(MessageOf(opLookup(&image, nullptr, &lut)), "success");
  EXPECT_EQ(SamplesOf<std::uint8_t>(image), (Samples8{10, 10, 10, 11, 137}));
  EXPECT_EQ(image.GetDataType(), ImageDataType_S8) << "eight bits keep the source's type";
}

TEST(opLookup, ASampleJustBehindTheTableTakesItsLastEntry) {
  dImage image;
  MakeOf<std::int16_t>(image, {.width = 4, .type = ImageDataType_S16}, {-6, -5, -2, -1});
  dImage target;
  CountingLUT lut(4, -5, 20);  // -5 .. -2
  ASSERT_EQ(MessageOf(opLookup(&image, &target, &lut)), "success");
  EXPECT_EQ(SamplesOf<std::uint8_t>(target), (Samples8{20, 20, 23, 23}));
}

TEST(opLookup, BringsTheTableUpToDateFirst) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {0, 5});
  CountingLUT lut(256, 0, 0);
  lut.MarkOutdated(100);
  ASSERT_EQ(MessageOf(opLookup(&image, &image, &lut)), "success");
  EXPECT_EQ(SamplesOf<std::uint8_t>(image), (Samples8{100, 105}));
  EXPECT_FALSE(lut.IsOutdated());
}

TEST(opLookup, TakesTheStartIndexFromTheTableOnceItIsUpToDate) {
  dImage image;
  MakeOf<std::int16_t>(image, {.width = 3, .type = ImageDataType_S16}, {-32768, -1, 32767});
  dWindowingLUT lut;
  lut.SetSignedSource(true);
  lut.SetWindow(0, 65536);
  ASSERT_EQ(MessageOf(opLookup(&image, nullptr, &lut)), "success");
  // 0.5 + i * 255 / 65536 for i = 0, 32767, 65535
  EXPECT_EQ(SamplesOf<std::uint8_t>(image), (Samples8{0, 127, 255}));
}

TEST(opLookup, WithoutTargetSixteenBitsReplaceTheSource) {
  dImage image;
  MakeOf<std::uint16_t>(image, {.width = 3, .height = 2, .type = ImageDataType_U16, .alignment = 2},
                        {0, 1, 2, 3, 4, 5});
  CountingLUT lut(65536, 0, 7);
  ASSERT_EQ(MessageOf(opLookup(&image, nullptr, &lut)), "success");
  EXPECT_EQ(image.GetDataType(), ImageDataType_U8);
  EXPECT_EQ(image.GetBytesPerRow(), 4u) << "the row alignment stays";
  EXPECT_EQ(SamplesOf<std::uint8_t>(image), (Samples8{7, 8, 9, 10, 11, 12}));
}

TEST(opLookup, WithATargetTheSourceStays) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 3}, {1, 2, 3});
  dImage target;
  CountingLUT lut(256, 0, 50);
  ASSERT_EQ(MessageOf(opLookup(&image, &target, &lut)), "success");
  EXPECT_EQ(BytesOf(image), (rasters::Bytes{1, 2, 3}));
  EXPECT_EQ(BytesOf(target), (rasters::Bytes{51, 52, 53}));
}

TEST(opLookup, SixteenBitsGiveAnImageOfTheTablesType) {
  dImage image;
  MakeOf<std::uint16_t>(image, {.width = 1, .type = ImageDataType_U16}, {3});
  dImage target;
  dLUT lut;
  ASSERT_TRUE(lut.Init(16, static_cast<LUTType>(ImageDataType_S8), 1, 0));
  lut.GetLUT(0)[3] = 200;
  ASSERT_EQ(MessageOf(opLookup(&image, &target, &lut)), "success");
  EXPECT_EQ(target.GetDataType(), ImageDataType_S8);
  EXPECT_EQ(SamplesOf<std::uint8_t>(target), (Samples8{200}));
}

TEST(opLookup, RefusesATableWhoseEntriesWereExchanged) {
  dImage source;
  MakeOf<std::uint8_t>(source, {4, 1, ImageDataType_U8}, {0, 1, 254, 255});
  CountingLUT lut(256, 0);
  std::uint8_t few[10] = {};
  static_cast<dImage&>(lut).GetDataBuffer().Init(few, sizeof few, DTM_Reference);
  EXPECT_EQ(MessageFor(&source, &lut), "invalid entries in the LUT");
}

/// A table that claims entries of a type that no image has.
class StrangeLUT : public dLUT {
 public:
  StrangeLUT() {
    Init(256, LUTType_U8, 1, 0);
    m_type = static_cast<LUTType>(0x4008);
  }
};

TEST(opLookup, SixteenBitSourceStaysWhenTheResultCannotBeMade) {
  dImage source;
  MakeOf<std::uint16_t>(source, {2, 1, ImageDataType_U16}, {3, 70});
  const auto before = BytesOf(source);
  StrangeLUT lut;
  EXPECT_EQ(MessageFor(&source, &lut),
            "error while creating image buffer:invalid 'DataType': 16392");
  opLookup inPlace(&source, nullptr, &lut);
  EXPECT_EQ(CodeOf(inPlace), -1);
  EXPECT_EQ(BytesOf(source), before);
}

class LookupSteps : public opLookup {
 public:
  using opLookup::Prepare;
  using opLookup::Process;
};

TEST(opLookup, ProcessesOnlyWhatWasPrepared) {
  dImage source;
  MakeOf<std::uint8_t>(source, {2, 1, ImageDataType_U8}, {3, 70});
  CountingLUT lut(256, 0, 1);
  LookupSteps op;
  EXPECT_FALSE(op.Process());
  op.m_pSource = &source;
  op.m_pLUT = &lut;
  EXPECT_TRUE(op.Prepare());
  EXPECT_TRUE(op.Process());
  op.m_pLUT = nullptr;
  EXPECT_FALSE(op.Prepare());
  EXPECT_FALSE(op.Process());
  op.m_pLUT = &lut;
  EXPECT_TRUE(op.Prepare());
  op.Reset();
  EXPECT_FALSE(op.Process());
}

}  // namespace
