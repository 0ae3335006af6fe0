#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <memory>
#include <set>
#include <string>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"

namespace {

TEST(dImage, IsRegisteredUnderDataBase) {
  EXPECT_STREQ(dImage::CI().name, "dImage");
  ASSERT_NE(dImage::CI().parents, nullptr);
  EXPECT_EQ(dImage::CI().parents[0], &DataBase::CI());
  EXPECT_EQ(dImage::CI().parents[1], nullptr);
  const std::unique_ptr<BaseClass> image(dImage::CI().Create());
  EXPECT_EQ(image->GetClassInfo(), &dImage::CI());
  const std::unique_ptr<dImage> created(dImage::Create());
  ExpectReset(*created);
}

TEST(dImage, StartsResetAndNotInitialized) {
  const dImage image;
  ExpectReset(image);
  ExpectStatus(image.GetStatus(), -1, "not initialized");
}

TEST(dImage, ResetForgetsFormatAndPixelsAndKeepsTheStatus) {
  HookedImage image;
  ASSERT_TRUE(image.Init(3, 2, ImageDataType_S16, "RGB", ImageDataOrder_Plane, 8));
  image.SetPosition(4, 5);
  ASSERT_FALSE(image.CheckPixelAccess(9, 0, 0));
  image.trail.clear();
  image.Reset();
  ExpectReset(image);
  EXPECT_EQ(image.trail, "R");
  ExpectStatus(image.GetStatus(), -1, "invalid pixel coordinates: 9/0");
}

TEST(dImage, InitLaysOutPixelOrder) {
  dImage image;
  ASSERT_TRUE(image.Init(3, 2, 8, "RGB", 0, 4));
  EXPECT_EQ(image.GetColumnOffset(), 24u);
  EXPECT_EQ(image.GetBytesPerRow(), 12u);
  EXPECT_EQ(image.GetImageSize(), 24u);
  EXPECT_EQ(image.GetChannelOffset(), 8u);
  const auto* start = static_cast<const char*>(image.GetDataPtr());
  EXPECT_EQ(static_cast<const char*>(image.GetDataPtr(1, 0)) - start, 3);
  EXPECT_EQ(static_cast<const char*>(image.GetDataPtr(0, 0, 1)) - start, 1);
}

TEST(dImage, InitLaysOutPlaneOrder) {
  dImage image;
  ASSERT_TRUE(image.Init(3, 2, 8, "RGB", 1, 4));
  EXPECT_EQ(image.GetColumnOffset(), 8u);
  EXPECT_EQ(image.GetBytesPerRow(), 4u);
  EXPECT_EQ(image.GetImageSize(), 24u);
  EXPECT_EQ(image.GetChannelOffset(), 64u);
  EXPECT_EQ(image.GetNumRows(), 6u);
  EXPECT_EQ(image.GetNumPlanes(), 3u);
  EXPECT_EQ(image.GetFormatID(), 0x10308u);
  const auto* start = static_cast<const char*>(image.GetDataPtr());
  EXPECT_EQ(static_cast<const char*>(image.GetDataPtr(0, 0, 1)) - start, 8);
}

TEST(dImage, InitPutsASingleChannelIntoPixelOrder) {
  dImage image;
  ASSERT_TRUE(image.Init(5, 1, 16, "G", 1, 1));
  EXPECT_EQ(image.GetDataOrder(), 0);
  EXPECT_EQ(image.GetRowAlignment(), 2);
  EXPECT_EQ(image.GetBytesPerRow(), 10u);
  // The order of a single channel is not looked at.
  EXPECT_TRUE(image.Init(5, 1, 16, "G", 99, 1));
  EXPECT_EQ(image.GetDataOrder(), 0);
}

TEST(dImage, InitRaisesRowAlignmentToSampleSize) {
  struct Case {
    unsigned short type;
    unsigned short given;
    unsigned short raised;
  };
  const Case cases[] = {{0x01, 1, 1},   {0x08, 1, 1},   {0x10, 1, 2},    {0x10, 2, 2},
                        {0x20, 1, 4},   {0x20, 2, 4},   {0x20, 8, 8},    {0x40, 4, 8},
                        {0x40, 16, 16}, {0x1008, 1, 1}, {0x1010, 1, 2},  {0x1020, 2, 4},
                        {0x1040, 1, 8}, {0x2020, 1, 4}, {0x2040, 32, 32}};
  for (const Case& c : cases) {
    dImage image;
    ASSERT_TRUE(image.Init(1, 1, c.type, "G", 0, c.given));
    EXPECT_EQ(image.GetRowAlignment(), c.raised) << std::hex << c.type << " given " << c.given;
    EXPECT_EQ(image.GetBytesPerRow(), c.raised);
  }
}

TEST(dImage, InitTakesElevenDataTypesOnly) {
  const std::set<unsigned> types = {1, 8, 16, 32, 64, 4104, 4112, 4128, 4160, 8224, 8256};
  for (unsigned type = 0; type <= 0xFFFF; ++type) {
    dImage image;
    EXPECT_EQ(image.Init(1, 1, static_cast<unsigned short>(type), "G", 0, 1),
              types.count(type) == 1)
        << type;
  }
}

TEST(dImage, InitTakesSixRowAlignmentsOnly) {
  for (unsigned alignment = 0; alignment <= 300; ++alignment) {
    const bool isAllowed = alignment == 1 || alignment == 2 || alignment == 4 || alignment == 8 ||
                           alignment == 16 || alignment == 32;
    dImage image;
    EXPECT_EQ(image.Init(1, 1, 8, "G", 0, static_cast<unsigned short>(alignment)), isAllowed)
        << alignment;
  }
}

struct BadFormat {
  const char* name;
  unsigned short dataType;
  const char* sequence;
  unsigned short dataOrder;
  unsigned short rowAlignment;
  const char* message;
};

// The checks come in the order sequence, type, order, alignment.
const BadFormat kBadFormats[] = {
    {"lower case only", 8, "rgb", 0, 1, "invalid 'ChannelSequence':'rgb'"},
    {"empty sequence", 8, "", 0, 1, "invalid 'ChannelSequence':''"},
    {"no sequence", 8, nullptr, 0, 1, "invalid 'ChannelSequence':''"},
    {"all wrong", 12, "g", 2, 3, "invalid 'ChannelSequence':'g'"},
    {"type", 12, "G", 0, 1, "invalid 'DataType': 12"},
    {"type before order", 65535, "RGB", 2, 3, "invalid 'DataType': 65535"},
    {"order", 8, "RGB", 2, 1, "invalid 'DataOrder': 2"},
    {"order before alignment", 8, "RGB", 65535, 3, "invalid 'DataOrder': 65535"},
    {"alignment", 8, "RGB", 1, 3, "invalid 'RowAlignment': 3"},
    {"alignment 0", 8, "G", 0, 0, "invalid 'RowAlignment': 0"},
    {"alignment 64", 8, "G", 0, 64, "invalid 'RowAlignment': 64"},
};

TEST(dImage, InitRefusesABadFormatAndLeavesTheImageReset) {
  for (const BadFormat& bad : kBadFormats) {
    SCOPED_TRACE(bad.name);
    HookedImage image;
    ASSERT_TRUE(image.Init(3, 2, 8, "RGB", 0, 4));
    image.SetPosition(7, 7);
    image.trail.clear();
    const LogRecorder log;
    EXPECT_FALSE(image.Init(3, 2, bad.dataType, bad.sequence, bad.dataOrder, bad.rowAlignment));
    ExpectReset(image);
    EXPECT_EQ(image.trail, "R");
    ExpectStatus(image.GetStatus(), -1, bad.message);
    ASSERT_EQ(log.errors.size(), 1u);
    EXPECT_EQ(log.errors[0], std::string("dImage::Init: ") + bad.message);
    EXPECT_EQ(log.errorCodes[0], -1);
  }
}

TEST(dImage, InitOfAnEqualByteSizeKeepsAddressAndContents) {
  HookedImage image;
  ASSERT_TRUE(image.Init(4, 3, 8, "RGB", 0, 4));
  FillWithPattern(image);
  image.SetPosition(3, 4);
  const void* const address = image.GetDataPtr();
  const Bytes contents = BytesOf(image);
  image.trail.clear();
  ASSERT_TRUE(image.Init(6, 3, 16, "G", 0, 1));
  EXPECT_EQ(image.GetDataPtr(), address);
  EXPECT_EQ(BytesOf(image), contents);
  EXPECT_EQ(image.trail, "I");
  EXPECT_EQ(image.GetWidth(), 6u);
  EXPECT_EQ(image.GetDataType(), 16);
  EXPECT_EQ(image.GetPosX(), 0);
  EXPECT_EQ(image.GetPosY(), 0);
}

TEST(dImage, InitOfAnotherByteSizeResetsFirst) {
  HookedImage image;
  ASSERT_TRUE(image.Init(4, 3, 8, "RGB", 0, 4));
  EXPECT_EQ(image.trail, "RI");
  image.trail.clear();
  ASSERT_TRUE(image.Init(4, 4, 8, "RGB", 0, 4));
  EXPECT_EQ(image.trail, "RI");
  EXPECT_TRUE(image.wasValidAtInit);
  EXPECT_EQ(image.GetImageSize(), 48u);
}

TEST(dImage, InitClearsAnOldFailure) {
  HookedImage image;
  ASSERT_FALSE(image.CheckPixelAccess(0, 0, 0));
  ASSERT_TRUE(image.Init(1, 1, 8, "G", 0, 1));
  ExpectStatus(image.GetStatus(), 0, "");
}

TEST(dImage, InitReturnsTheStatusThatOnInitLeaves) {
  HookedImage image;
  image.failOnInit = true;
  EXPECT_FALSE(image.Init(1, 1, 8, "G", 0, 1));
  ExpectStatus(image.GetStatus(), -7, "refused");
  EXPECT_TRUE(image.IsValid());
}

TEST(dImage, InitMayBeGivenItsOwnChannelSequence) {
  dImage image;
  ASSERT_TRUE(image.Init(2, 2, 8, "BlueGreenRedAlphaAndMore", 0, 1));
  ASSERT_TRUE(image.Init(5, 5, 8, image.GetChannelSequence(), 1, 1));
  EXPECT_STREQ(image.GetChannelSequence(), "BlueGreenRedAlphaAndMore");
  EXPECT_EQ(image.GetImageSize(), 150u);
}

TEST(dImage, InitOfAFreshImageWithoutPixelsKeepsTheFormat) {
  for (const unsigned long width : {0UL, 5UL}) {
    HookedImage image;
    const LogRecorder log;
    EXPECT_TRUE(image.Init(width, 5 - width, 16, "RGB", 1, 4));
    EXPECT_FALSE(image.IsValid());
    EXPECT_EQ(image.GetWidth(), width);
    EXPECT_EQ(image.GetHeight(), 5 - width);
    EXPECT_EQ(image.GetNumChannels(), 3);
    EXPECT_EQ(image.trail, "I");
    ExpectStatus(image.GetStatus(), 0, "");
    EXPECT_TRUE(log.errors.empty());
  }
}

TEST(dImage, InitWithoutPixelsDropsOldPixelsAndKeepsTheStatus) {
  HookedImage image;
  ASSERT_TRUE(image.Init(2, 2, 8, "G", 0, 1));
  const LogRecorder log;
  EXPECT_TRUE(image.Init(0, 2, 8, "G", 0, 1));
  ExpectReset(image);
  ExpectStatus(image.GetStatus(), 0, "");
  EXPECT_TRUE(log.errors.empty());

  ASSERT_TRUE(image.Init(2, 2, 8, "G", 0, 1));
  ASSERT_FALSE(image.CheckPixelAccess(5, 0, 0));
  EXPECT_FALSE(image.Init(2, 0, 8, "G", 0, 1));
  ExpectReset(image);
  ExpectStatus(image.GetStatus(), -1, "invalid pixel coordinates: 5/0");
}

}  // namespace
