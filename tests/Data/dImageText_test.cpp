#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <map>
#include <string>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"

namespace {

TEST(dImageText, DataTypesHaveTheirNames) {
  const std::map<unsigned, std::string> names = {
      {0x0001, "1 bit unsigned"},       {0x0008, "8 bit unsigned"},
      {0x0010, "16 bit unsigned"},      {0x0020, "32 bit unsigned"},
      {0x0040, "64 bit unsigned"},      {0x1008, "8 bit signed"},
      {0x1010, "16 bit signed"},        {0x1020, "32 bit signed"},
      {0x1040, "64 bit signed"},        {0x2020, "32 bit floating point"},
      {0x2040, "64 bit floating point"}};
  for (unsigned type = 0; type <= 0xFFFF; ++type) {
    const auto entry = names.find(type);
    EXPECT_EQ(dImage::DataType2Str(static_cast<unsigned short>(type)),
              entry == names.end() ? std::string("unknown data type") : entry->second)
        << type;
  }
}

TEST(dImageText, TheNamedDataTypesAreTheCodes) {
  EXPECT_EQ(ImageDataType_U1, 1);
  EXPECT_EQ(ImageDataType_U8, 8);
  EXPECT_EQ(ImageDataType_U16, 16);
  EXPECT_EQ(ImageDataType_U32, 32);
  EXPECT_EQ(ImageDataType_U64, 64);
  EXPECT_EQ(ImageDataType_S8, 4104);
  EXPECT_EQ(ImageDataType_S16, 4112);
  EXPECT_EQ(ImageDataType_S32, 4128);
  EXPECT_EQ(ImageDataType_S64, 4160);
  EXPECT_EQ(ImageDataType_F32, 8224);
  EXPECT_EQ(ImageDataType_F64, 8256);
}

TEST(dImageText, DataOrdersHaveTheirNames) {
  EXPECT_STREQ(dImage::DataOrder2Str(0), "pixel order");
  EXPECT_STREQ(dImage::DataOrder2Str(1), "plane order");
  EXPECT_STREQ(dImage::DataOrder2Str(2), "unknown data order");
  EXPECT_STREQ(dImage::DataOrder2Str(65535), "unknown data order");
}

TEST(dImageText, ChannelsAreCountedByTheirUpperCaseLetters) {
  EXPECT_EQ(dImage::ScanNumberOfChannels(nullptr), 0);
  EXPECT_EQ(dImage::ScanNumberOfChannels(""), 0);
  EXPECT_EQ(dImage::ScanNumberOfChannels("gray"), 0);
  EXPECT_EQ(dImage::ScanNumberOfChannels("G"), 1);
  EXPECT_EQ(dImage::ScanNumberOfChannels("Gray"), 1);
  EXPECT_EQ(dImage::ScanNumberOfChannels("YCrCb"), 3);
  EXPECT_EQ(dImage::ScanNumberOfChannels("AZ"), 2);
  EXPECT_EQ(dImage::ScanNumberOfChannels("@[`1\xC4"), 0);  // the neighbours of the letters
}

TEST(dImageText, ChannelIndexIsThatOfTheFirstWholeName) {
  const LogRecorder log;
  EXPECT_EQ(dImage::ScanChannelIndex("YCrCb", "Y"), 0);
  EXPECT_EQ(dImage::ScanChannelIndex("YCrCb", "Cr"), 1);
  EXPECT_EQ(dImage::ScanChannelIndex("YCrCb", "Cb"), 2);
  EXPECT_EQ(dImage::ScanChannelIndex("BGRA", "A"), 3);
  EXPECT_EQ(dImage::ScanChannelIndex("AAB", "A"), 0);
  EXPECT_EQ(dImage::ScanChannelIndex("Gray", "Gray"), 0);
  EXPECT_EQ(dImage::ScanChannelIndex("C1C2", "C2"), 1);
  EXPECT_EQ(dImage::ScanChannelIndex("xyRG", "R"), 0);  // "xy" belongs to no channel
  EXPECT_TRUE(log.errors.empty());
}

TEST(dImageText, ChannelIndexReportsWhatItDoesNotFind) {
  struct Case {
    const char* sequence;
    const char* channel;
    const char* message;
  };
  const Case cases[] = {{"YCrCb", "C", "channel 'C' not found in 'YCrCb'"},
                        {"YCrCb", "Crx", "channel 'Crx' not found in 'YCrCb'"},
                        {"YCrCb", "cr", "channel 'cr' not found in 'YCrCb'"},
                        {"YCrCb", "CrCb", "channel 'CrCb' not found in 'YCrCb'"},
                        {"RGB", "", "channel '' not found in 'RGB'"},
                        {"", "G", "channel 'G' not found in ''"},
                        {"xyRG", "xy", "channel 'xy' not found in 'xyRG'"},
                        {nullptr, "G", "uninitialized parameter(s)"},
                        {"RGB", nullptr, "uninitialized parameter(s)"}};
  for (const Case& c : cases) {
    SCOPED_TRACE(c.message);
    const LogRecorder log;
    EXPECT_EQ(dImage::ScanChannelIndex(c.sequence, c.channel), -1);
    ASSERT_EQ(log.errors.size(), 1u);
    EXPECT_EQ(log.errors[0], std::string("dImage::ScanChannelIndex: ") + c.message);
    EXPECT_EQ(log.errorCodes[0], -1);
  }
}

TEST(dImageText, ColorModelsAreThoseOfTheTable) {
  const LogRecorder log;
  EXPECT_STREQ(dImage::ScanColorModel("G"), "G");
  EXPECT_STREQ(dImage::ScanColorModel("Gray"), "G");
  EXPECT_STREQ(dImage::ScanColorModel("RGB"), "RGB");
  EXPECT_STREQ(dImage::ScanColorModel("BGR"), "RGB");
  EXPECT_STREQ(dImage::ScanColorModel("RGBA"), "RGB");
  EXPECT_STREQ(dImage::ScanColorModel("BGRA"), "RGB");
  EXPECT_STREQ(dImage::ScanColorModel("HSV"), "HSV");
  EXPECT_STREQ(dImage::ScanColorModel("HLS"), "HLS");
  EXPECT_STREQ(dImage::ScanColorModel("LUV"), "LUV");
  EXPECT_STREQ(dImage::ScanColorModel("XYZ"), "XYZ");
  EXPECT_STREQ(dImage::ScanColorModel("YCrCb"), "YCrCb");
  EXPECT_STREQ(dImage::ScanColorModel("YUV"), "YUV");
  EXPECT_STREQ(dImage::ScanColorModel(nullptr), "");
  EXPECT_STREQ(dImage::ScanColorModel(""), "");
  EXPECT_TRUE(log.errors.empty());
}

TEST(dImageText, ColorModelReportsASequenceThatItDoesNotKnow) {
  for (const std::string sequence : {"ARGB", "rgb", "GRAY", "YCRCB", "RGBX", "g"}) {
    const LogRecorder log;
    EXPECT_STREQ(dImage::ScanColorModel(sequence.c_str()), "");
    ASSERT_EQ(log.errors.size(), 1u);
    EXPECT_EQ(log.errors[0],
              "dImage::ScanColorModel: can't map '" + sequence + "' to a color model");
  }
}

TEST(dImageText, AnImageAnswersForItsOwnSequence) {
  dImage image;
  EXPECT_STREQ(image.GetChannelSequence(), "");
  EXPECT_STREQ(image.GetColorModel(), "");
  ASSERT_TRUE(image.Init(1, 1, 8, "BGRA", 0, 1));
  EXPECT_STREQ(image.GetChannelSequence(), "BGRA");
  EXPECT_STREQ(image.GetColorModel(), "RGB");
  EXPECT_EQ(image.GetChannelIndex("R"), 2);
  EXPECT_EQ(image.GetAlphaChannelIndex(), 3);
  ASSERT_TRUE(image.Init(1, 1, 8, "YCrCb", 0, 1));
  EXPECT_EQ(image.GetChannelIndex("Cb"), 2);
  const LogRecorder log;
  EXPECT_EQ(image.GetAlphaChannelIndex(), -1);
  ASSERT_EQ(log.errors.size(), 1u);
  EXPECT_EQ(log.errors[0], "dImage::ScanChannelIndex: channel 'A' not found in 'YCrCb'");
}

}  // namespace
