#include "Tool.h"

#include <study/Error.h>
#include <study/Pictures.h>
#include <vorl/Data/dDIB.h>

#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include <png.h>

#include "../../Data/DibTesting.h"
#include "../TestFolder.h"
#include "PictureFile.h"

namespace {

using cli_test::Arguments;
using cli_test::Outcome;
using cli_test::RunTool;
using study_test::ReadBytes;
using study_test::TestFolder;
using study_test::WriteBytes;
using Names = std::vector<std::string>;

std::string WriteBitmap(const TestFolder& folder, const char* name, short channels, short bits) {
  dDIB bitmap(5, 3, channels, bits);
  FillWithCount(bitmap);
  const std::string path = (folder / name).string();
  EXPECT_TRUE(bitmap.Save(path.c_str(), true)) << bitmap.GetStatus();
  return path;
}

TEST(BmpInfo, TellsWhatAFileHolds) {
  const TestFolder folder;
  const std::string path = WriteBitmap(folder, "a.bmp", 1, 8);
  const Outcome outcome = RunTool({"bmp", "info", path});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  EXPECT_EQ(outcome.output, "File:         " + path +
                                "\n"
                                "Size:         5 x 3 pixels\n"
                                "Stored:       8 bits per pixel, 256 colours\n"
                                "Rows:         bottom row first\n"
                                "Image:        1 channel of 8 bit ('G')\n");
}

TEST(BmpInfo, SeveralFilesStandApart) {
  const TestFolder folder;
  const std::string first = WriteBitmap(folder, "a.bmp", 3, 8);
  const std::string second = WriteBitmap(folder, "b.bmp", 1, 1);
  const Outcome outcome = RunTool({"bmp", "info", first, second});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.output, "File:         " + first +
                                "\n"
                                "Size:         5 x 3 pixels\n"
                                "Stored:       24 bits per pixel\n"
                                "Rows:         bottom row first\n"
                                "Image:        3 channels of 8 bit ('BGR')\n\n"
                                "File:         " +
                                second +
                                "\n"
                                "Size:         5 x 3 pixels\n"
                                "Stored:       1 bit per pixel, 2 colours\n"
                                "Rows:         bottom row first\n"
                                "Image:        1 channel of 1 bit ('G')\n");
}

TEST(BmpInfo, BitmapThatCannotBeReadTellsWhy) {
  const TestFolder folder;
  const std::string path = WriteBitmap(folder, "a.bmp", 3, 8);
  std::string bytes = ReadBytes(path);
  bytes[30] = 1;  // the compression
  WriteBytes(path, bytes);
  const Outcome outcome = RunTool({"bmp", "info", path});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_NE(outcome.output.find("Image:        none: opDIB2Ima: unsupported compression: RLE8\n"),
            std::string::npos)
      << outcome.output;
}

TEST(BmpInfo, OtherFilesAreErrors) {
  const TestFolder folder;
  WriteBytes(folder / "a.txt", "BA text");
  for (const std::string& path : {(folder / "a.txt").string(), (folder / "none.bmp").string()}) {
    const Outcome outcome = RunTool({"bmp", "info", path});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.output, "");
    EXPECT_EQ(outcome.errors, "vorl: '" + path + "' is not a bitmap file, or can't be read\n");
  }
}

TEST(BmpConvert, EveryKindBringsEveryDepthBack) {
  for (const auto& [channels, bits] : {std::pair<short, short>{1, 8}, {3, 8}}) {
    for (const char* const between : {"b.bdf", "b.png", "b.bmp"}) {
      const TestFolder folder;
      const std::string first = WriteBitmap(folder, "a.bmp", channels, bits);
      const std::string second = (folder / between).string();
      const std::string third = (folder / "c.bmp").string();
      const Outcome outcome = RunTool({"bmp", "convert", first, second});
      ASSERT_EQ(outcome.code, 0) << outcome.errors;
      EXPECT_EQ(outcome.output, "");
      EXPECT_EQ(outcome.errors, "");
      ASSERT_EQ(RunTool({"bmp", "convert", second, third}).code, 0);
      EXPECT_TRUE(SamePixels(dDIB(first.c_str()), dDIB(third.c_str()))) << between << channels;
      EXPECT_EQ(folder.Names(), (Names{"a.bmp", between, "c.bmp"}));
    }
  }
}

TEST(BmpConvert, DataFilesKeepOneBitAndFourChannels) {
  for (const auto& [channels, bits] : {std::pair<short, short>{1, 1}, {4, 8}}) {
    const TestFolder folder;
    const std::string first = WriteBitmap(folder, "a.bmp", channels, bits);
    const std::string second = (folder / "b.bdf").string();
    const std::string third = (folder / "c.bmp").string();
    ASSERT_EQ(RunTool({"bmp", "convert", first, second}).code, 0);
    ASSERT_EQ(RunTool({"bmp", "convert", second, third}).code, 0);
    EXPECT_TRUE(SamePixels(dDIB(first.c_str()), dDIB(third.c_str()))) << channels;
  }
}

TEST(BmpConvert, PngOfOneBitIsBlackAndWhite) {
  const TestFolder folder;
  dDIB bitmap(10, 1, 1, 1);
  std::memcpy(bitmap.GetDataPtr(), "\xA5\x40", 2);
  ASSERT_TRUE(bitmap.Save((folder / "a.bmp").string().c_str(), true));
  ASSERT_EQ(
      RunTool({"bmp", "convert", (folder / "a.bmp").string(), (folder / "a.png").string()}).code,
      0);
  const cli_test::Picture picture = cli_test::ReadPng(folder / "a.png");
  EXPECT_EQ(picture.levels, (std::vector<unsigned char>{255, 0, 255, 0, 0, 255, 0, 255, 0, 255}));
}

TEST(BmpConvert, PngLeavesTheFourthByteOut) {
  const TestFolder folder;
  const std::string first = WriteBitmap(folder, "a.bmp", 4, 8);
  const std::string second = (folder / "a.png").string();
  ASSERT_EQ(RunTool({"bmp", "convert", first, second}).code, 0);
  dImage picture;
  study::LoadPng(second, picture);
  ASSERT_STREQ(picture.GetChannelSequence(), "BGR");
  const dDIB bitmap(first.c_str());
  for (int y = 0; y < 3; ++y) {
    for (int x = 0; x < 5; ++x) {
      EXPECT_EQ(std::memcmp(picture.GetDataPtr(x, y), bitmap.GetDataPtr(x, y), 3), 0);
    }
  }
}

TEST(BmpConvert, PngWithTransparencyBecomesThirtyTwoBits) {
  const TestFolder folder;
  const unsigned char pixels[] = {1, 2,   3, 9, 4,  5,
                                  6, 255, 7, 8, 10, 0};  // red, green, blue, alpha
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  png.width = 3;
  png.height = 1;
  png.format = PNG_FORMAT_RGBA;
  const std::string first = (folder / "a.png").string();
  ASSERT_NE(png_image_write_to_file(&png, first.c_str(), 0, pixels, 0, nullptr), 0);
  const std::string second = (folder / "b.bmp").string();
  const Outcome outcome = RunTool({"bmp", "convert", first, second});
  ASSERT_EQ(outcome.code, 0) << outcome.errors;
  const std::string bytes = ReadBytes(second);
  ASSERT_EQ(bytes.size(), 54U + 12U);
  EXPECT_EQ(bytes[28], 32);  // bits per pixel
  EXPECT_EQ(bytes.substr(54), std::string("\3\2\1\x9\6\5\4\xFF\xA\x8\7\0", 12));
}

TEST(BmpConvert, PaletteIsOfGreyPicturesOnly) {
  const TestFolder folder;
  for (const short channels : {short{3}, short{4}}) {
    const std::string first = WriteBitmap(folder, "a.bmp", channels, 8);
    for (const char* const order : {"ascending", "descending"}) {
      const std::string second = (folder / "b.bmp").string();
      const Outcome outcome = RunTool({"bmp", "convert", "--palette", order, first, second});
      EXPECT_EQ(outcome.code, 0) << outcome.errors;
      EXPECT_EQ(ReadBytes(second), ReadBytes(first)) << channels << order;
    }
  }
}

TEST(BmpConvert, DescendingPaletteOfOneBitBeginsWithWhite) {
  const TestFolder folder;
  const std::string first = WriteBitmap(folder, "a.bmp", 1, 1);
  const std::string second = (folder / "b.bmp").string();
  ASSERT_EQ(RunTool({"bmp", "convert", "--palette", "ascending", first, second}).code, 0);
  EXPECT_EQ(ReadBytes(second), ReadBytes(first));
  ASSERT_EQ(RunTool({"bmp", "convert", "--palette", "descending", first, second}).code, 0);
  std::string expected = ReadBytes(first);
  ASSERT_EQ(expected.substr(54, 8), std::string("\0\0\0\0\xFF\xFF\xFF\0", 8));
  expected.replace(54, 8, std::string("\xFF\xFF\xFF\0\0\0\0\0", 8));
  EXPECT_EQ(ReadBytes(second), expected);  // the pixels stay as they are
}

TEST(BmpConvert, DescendingPaletteMakesTheNegative) {
  const TestFolder folder;
  const std::string first = WriteBitmap(folder, "a.bmp", 1, 8);
  const std::string second = (folder / "b.bmp").string();
  ASSERT_EQ(RunTool({"bmp", "convert", "--palette", "ascending", first, second}).code, 0);
  EXPECT_EQ(cli_test::ReadBmp(second).levels, cli_test::ReadBmp(first).levels);
  ASSERT_EQ(RunTool({"bmp", "convert", "--palette", "descending", first, second}).code, 0);
  const cli_test::Picture original = cli_test::ReadBmp(first);
  const cli_test::Picture negative = cli_test::ReadBmp(second);
  ASSERT_EQ(negative.levels.size(), original.levels.size());
  for (std::size_t i = 0; i < original.levels.size(); ++i) {
    EXPECT_EQ(negative.levels[i], 255 - original.levels[i]);
  }
}

TEST(BmpConvert, FailureKeepsTheOldOutputAndLeavesNothing) {
  const TestFolder folder;
  const std::string good = WriteBitmap(folder, "good.bmp", 3, 8);
  std::string bytes = ReadBytes(good);
  bytes.resize(70);
  const std::string bad = (folder / "bad.bmp").string();
  const std::string output = (folder / "out.png").string();
  WriteBytes(bad, bytes);
  WriteBytes(output, "old");
  const Outcome outcome = RunTool({"bmp", "convert", bad, output});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors,
            "vorl: can't read '" + bad + "': file '" + bad + "' has sizes that cannot be true\n");
  EXPECT_EQ(ReadBytes(output), "old");
#if !defined(_WIN32)  // nothing limits the size of files there
  for (const char* const name : {"full.bmp", "full.bdf", "full.png"}) {
    cli_test::Conditions full;
    full.largestFile = 20;
    EXPECT_EQ(RunTool({"bmp", "convert", good, (folder / name).string()}, full).code, 1) << name;
  }
#endif
  EXPECT_EQ(folder.Names(), (Names{"bad.bmp", "good.bmp", "out.png"}));
}

TEST(BmpConvert, InputsOfOtherKindsAreTold) {
  const TestFolder folder;
  const std::string output = (folder / "out.bmp").string();
  ASSERT_EQ(RunTool({"phantom", "--size", "4x4x2", (folder / "study.bdf").string()}).code, 0);
  WriteBytes(folder / "text.png", "no picture");
  for (const char* const name : {"study.bdf", "text.png", "none.png", "none.bdf"}) {
    const std::string path = (folder / name).string();
    const Outcome outcome = RunTool({"bmp", "convert", path, output});
    EXPECT_EQ(outcome.code, 1) << name;
    EXPECT_EQ(outcome.errors.substr(0, 20 + path.size()), "vorl: can't read '" + path + "':")
        << outcome.errors;
  }
  EXPECT_FALSE(study_test::fs::exists(output));
}

struct WrongLine {
  Arguments arguments;
  const char* message;
};

TEST(BmpUsage, WrongLinesAreTold) {
  const WrongLine kLines[] = {
      {{"bmp"}, "say what to do: 'info' or 'convert'"},
      {{"bmp", "show", "a.bmp"}, "'show' is not 'info' or 'convert'"},
      {{"bmp", "info"}, "no file is named"},
      {{"bmp", "info", "a.bmp", "--palette", "ascending"},
       "--palette is for the output of 'convert'"},
      {{"bmp", "convert", "a.bmp"}, "'convert' wants two names: the picture and the output file"},
      {{"bmp", "convert", "a.gif", "b.bmp"},
       "the input: the name 'a.gif' does not end in .bmp or .bdf or .png"},
      {{"bmp", "convert", "a.bmp", "b"},
       "the output: the name 'b' does not end in .bmp or .bdf or .png"},
      {{"bmp", "convert", "a.bmp", "b.bmp", "--palette", "up"},
       "--palette: 'up' is not 'ascending' or 'descending'"},
      {{"bmp", "convert", "a.bmp", "b.png", "--palette", "ascending"},
       "--palette is for an output that ends in .bmp"}};
  for (const WrongLine& line : kLines) {
    const Outcome outcome = RunTool(line.arguments);
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.errors,
              std::string("vorl: ") + line.message + "\nvorl: try 'vorl bmp --help'\n");
  }
}

}  // namespace
