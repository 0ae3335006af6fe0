#include "Tool.h"

#include <gtest/gtest.h>

#include <string>

#include "../TestFolder.h"

namespace {

using cli_test::Arguments;
using cli_test::Lines;
using cli_test::Outcome;
using cli_test::RunTool;

bool Contains(const std::string& text, const std::string& part) {
  return text.find(part) != std::string::npos;
}

TEST(CommandLine, HelpNamesAllCommandsAndGivesExamples) {
  const Outcome outcome = RunTool({"--help"});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  EXPECT_TRUE(Contains(outcome.output, "Usage: vorl COMMAND ..."));
  for (const char* part : {"\n  info ", "\n  mpr ", "\n  mip ", "\n  project ", "\n  render ",
                           "\n  select ", "\n  convert ", "\n  phantom ", "\n  bmp ", "Examples:\n",
                           "The exit code is 0 after success"}) {
    EXPECT_TRUE(Contains(outcome.output, part)) << part;
  }
  EXPECT_EQ(RunTool({"-h"}).output, outcome.output);
}

struct HelpCase {
  const char* command;
  const char* usage;
  std::vector<const char*> options;
};

class CommandHelp : public testing::TestWithParam<HelpCase> {};

TEST_P(CommandHelp, TellsUsageOptionsAndExamples) {
  const HelpCase& wanted = GetParam();
  const Outcome outcome = RunTool({wanted.command, "--help"});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  EXPECT_TRUE(Contains(outcome.output,
                       std::string("Usage: vorl ") + wanted.command + " [OPTIONS] " + wanted.usage))
      << outcome.output;
  for (const char* option : wanted.options) {
    EXPECT_TRUE(Contains(outcome.output, std::string("  ") + option)) << option;
  }
  EXPECT_TRUE(Contains(outcome.output, std::string("Examples:\n  vorl ") + wanted.command + " "));
  for (const std::string& line : Lines(outcome.output)) {
    EXPECT_LE(line.size(), 92u) << line;
  }
}

INSTANTIATE_TEST_SUITE_P(
    AllCommands, CommandHelp,
    testing::Values(
        HelpCase{"info", "INPUT...\n", {"--series SERIES", "--phantom[=WxHxN]", "-q,--quiet"}},
        HelpCase{"mpr",
                 "INPUT... -o OUT.png|OUT.bmp\n",
                 {"--series SERIES", "--phantom[=WxHxN]", "-o,--output FILE", "--save-slice FILE",
                  "--plane NAME", "--center X,Y,Z", "--rotate X,Y,Z", "--size WxH", "--spacing MM",
                  "--thickness MM", "--steps N", "--filter NAME", "--window WINDOW",
                  "--brightness B", "--contrast C", "--gamma G", "-q,--quiet"}},
        HelpCase{"mip",
                 "INPUT... -o OUT.png|OUT.bmp\n",
                 {"--series SERIES", "--phantom[=WxHxN]", "-o,--output FILE", "--turntable N",
                  "--plane NAME", "--center X,Y,Z", "--rotate X,Y,Z", "--size WxH", "--spacing MM",
                  "--slab MM", "--filter NAME", "--window WINDOW", "--gamma G", "-q,--quiet"}},
        HelpCase{"project",
                 "INPUT... -o OUT.png|OUT.bmp\n",
                 {"-o,--output FILE", "--plane NAME", "--center X,Y,Z", "--rotate X,Y,Z",
                  "--size WxH", "--spacing MM", "--slices LIST", "--volume NAME", "--filter NAME",
                  "--window WINDOW", "-q,--quiet"}},
        HelpCase{"render",
                 "INPUT... -o SHEET.png|SHEET.bmp\n",
                 {"--series SERIES", "--phantom[=WxHxN]", "-o,--output FILE", "--size WxH",
                  "--layout NAME", "--center X,Y,Z", "--no-annotations", "--line X,Y,X,Y",
                  "--region X,Y,X,Y", "--window WINDOW", "--gamma G", "-q,--quiet"}},
        HelpCase{"select",
                 "INPUT... -o LIST.bdf\n",
                 {"--by NAME", "--limit N|P%", "-o,--output LIST.bdf", "--draw FILE",
                  "--plane NAME", "--window WINDOW", "-q,--quiet"}},
        HelpCase{"convert", "INPUT... OUT.bdf\n", {"--series SERIES", "--phantom[=WxHxN]"}},
        HelpCase{"phantom", "OUT.bdf\n", {"--size WxHxN", "--encoding NAME"}}),
    [](const auto& one) { return std::string(one.param.command); });

TEST(CommandLine, VersionIsThatOfTheProject) {
  const Outcome outcome = RunTool({"--version"});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.output, "vorl " VORL_VERSION "\n");
}

#if !defined(_WIN32)  // no device is full there
TEST(CommandLine, HelpThatCantBeWrittenIsAFailure) {
  cli_test::Conditions full;
  full.standardOutput = "/dev/full";
  const Outcome outcome = RunTool({"--help"}, full);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: can't write to the standard output: No space left on device\n");
}
#endif

struct UsageCase {
  const char* name;
  Arguments arguments;
  const char* message;  ///< of the first line, behind "vorl: "
};

class WrongUsage : public testing::TestWithParam<UsageCase> {};

TEST_P(WrongUsage, EndsWithTwoAndSaysWhy) {
  const study_test::TestFolder folder;
  const Outcome outcome = RunTool(GetParam().arguments);
  EXPECT_EQ(outcome.code, 2);
  EXPECT_EQ(outcome.output, "");
  const std::vector<std::string> lines = Lines(outcome.errors);
  ASSERT_EQ(lines.size(), 2u) << outcome.errors;
  EXPECT_EQ(lines[0], std::string("vorl: ") + GetParam().message);
  EXPECT_EQ(lines[1].substr(0, 11), "vorl: try '");
}

constexpr const char* kPhantom = "--phantom=4x4x4";

INSTANTIATE_TEST_SUITE_P(
    Commands, WrongUsage,
    testing::Values(
        UsageCase{"NoCommand",
                  {},
                  "no command is named; there are info, mpr, mip, project, render, select, "
                  "convert, phantom, bmp"},
        UsageCase{"UnknownCommand",
                  {"show", "x"},
                  "there is no command 'show'; there are info, mpr, mip, project, render, select, "
                  "convert, phantom, bmp"},
        UsageCase{"OptionInsteadOfCommand",
                  {"--fast"},
                  "the following argument was not expected: --fast"},
        UsageCase{"UnknownOption",
                  {"info", "--fast", kPhantom},
                  "the following argument was not expected: --fast"},
        UsageCase{
            "MissingValue", {"info", kPhantom, "--series"}, "--series: 1 required SERIES missing"},
        UsageCase{"OptionTwice",
                  {"mpr", kPhantom, "--size", "2x2", "--size", "3x3"},
                  "--size: At Most 1 required but received 2"}),
    [](const auto& one) { return std::string(one.param.name); });

INSTANTIATE_TEST_SUITE_P(
    Inputs, WrongUsage,
    testing::Values(
        UsageCase{"None", {"info"}, "no input is named (files, a folder, or --phantom)"},
        UsageCase{"NoneForPlane",
                  {"mpr", "-o", "x.png"},
                  "no input is named (files, a folder, or --phantom)"},
        UsageCase{
            "PhantomAndPath", {"info", "x", kPhantom}, "'x' and --phantom exclude each other"},
        UsageCase{"PhantomAndSeries",
                  {"info", kPhantom, "--series", "2"},
                  "--series and --phantom exclude each other"},
        UsageCase{"PhantomSizeIncomplete",
                  {"info", "--phantom=4x4"},
                  "--phantom: '4x4' is not WIDTHxHEIGHTxSLICES (whole numbers from 1 to 32767)"},
        UsageCase{"PhantomSizeZero",
                  {"info", "--phantom", "4x0x4"},
                  "--phantom: '4x0x4' is not WIDTHxHEIGHTxSLICES (whole numbers from 1 to 32767)"},
        UsageCase{"PhantomSizeTooLarge",
                  {"info", "--phantom=4x32768x4"},
                  "--phantom: '4x32768x4' is not WIDTHxHEIGHTxSLICES (whole numbers from 1 to "
                  "32767)"},
        UsageCase{"NothingToConvert", {"convert"}, "no input and no output file are named"},
        UsageCase{
            "ConvertWithoutOutput", {"convert", "x"}, "after 'x', the output file is missing"},
        UsageCase{"ConvertToOtherKind",
                  {"convert", "x", "y.png"},
                  "the output: the name 'y.png' does not end in .bdf"},
        UsageCase{
            "ConvertWithoutInput", {"convert", kPhantom}, "no input and no output file are named"},
        UsageCase{
            "PhantomNowhere", {"phantom"}, "no output is named (a file OUT.bdf, or a folder)"},
        UsageCase{"PhantomAsPicture",
                  {"phantom", "x.png"},
                  "the output: the name 'x.png' does not end in .bdf, and is not that of a folder "
                  "either"},
        UsageCase{"PhantomOfNoSize",
                  {"phantom", "x.bdf", "--size", "big"},
                  "--size: 'big' is not WIDTHxHEIGHTxSLICES (whole numbers from 1 to 32767)"},
        UsageCase{"EncodingOfAFile",
                  {"phantom", "x.bdf", "--encoding", "rle"},
                  "--encoding is for DICOM series only"},
        UsageCase{"UnknownEncoding",
                  {"phantom", "x", "--encoding", "zip"},
                  "--encoding: 'zip' is not one of explicit, implicit, big-endian, rle, "
                  "jpeg, jpeg-ls"}),
    [](const auto& one) { return std::string(one.param.name); });

UsageCase MprCase(const char* name, Arguments options, const char* message) {
  Arguments arguments{"mpr", kPhantom, "-o", "/no/such/folder/x.png"};
  arguments.insert(arguments.end(), options.begin(), options.end());
  return {name, arguments, message};
}

INSTANTIATE_TEST_SUITE_P(
    PlaneOptions, WrongUsage,
    testing::Values(
        UsageCase{"NoOutput",
                  {"mpr", kPhantom},
                  "no output is named (-o OUT.png, -o OUT.bmp or --save-slice OUT.bdf)"},
        UsageCase{"OtherPicture",
                  {"mpr", "/no/such", "-o", "x.jpg"},
                  "-o: the name 'x.jpg' does not end in .png or .bmp"},
        UsageCase{"PictureWithoutExtension",
                  {"mpr", "/no/such", "-o", "png"},
                  "-o: the name 'png' does not end in .png or .bmp"},
        UsageCase{"OtherSlice",
                  {"mpr", "/no/such", "--save-slice", "x.raw"},
                  "--save-slice: the name 'x.raw' does not end in .bdf"},
        MprCase("Plane", {"--plane", "Axial"},
                "--plane: 'Axial' is not one of axial, coronal, sagittal, oblique"),
        MprCase("CenterOfTwo", {"--center", "1,2"},
                "--center: '1,2' is not X,Y,Z (three numbers with commas between them)"),
        MprCase("CenterOfWords", {"--center", "a,b,c"},
                "--center: 'a,b,c' is not X,Y,Z (three numbers with commas between them)"),
        MprCase("CenterWithoutEnd", {"--center", "1,2,inf"},
                "--center: '1,2,inf' is not X,Y,Z (three numbers with commas between them)"),
        MprCase("Rotate", {"--rotate", "1,2,3,4"},
                "--rotate: '1,2,3,4' is not X,Y,Z (three numbers with commas between them)"),
        MprCase("Size", {"--size", "512"},
                "--size: '512' is not WIDTHxHEIGHT (whole numbers from 1 to 32767)"),
        MprCase("SizeNegative", {"--size", "-5x5"},
                "--size: '-5x5' is not WIDTHxHEIGHT (whole numbers from 1 to 32767)"),
        MprCase("SpacingZero", {"--spacing", "0"}, "--spacing: '0' is not a number greater than 0"),
        MprCase("SpacingWithUnit", {"--spacing", "1mm"},
                "--spacing: '1mm' is not a number greater than 0"),
        MprCase("Thickness", {"--thickness", "-1"},
                "--thickness: '-1' is not a number greater than 0"),
        MprCase("StepsAlone", {"--steps", "5"}, "--steps needs --thickness"),
        MprCase("OneStep", {"--thickness", "5", "--steps", "1"},
                "--steps: '1' is not a whole number from 2 to 32767"),
        MprCase("HalfSteps", {"--thickness", "5", "--steps", "2.5"},
                "--steps: '2.5' is not a whole number from 2 to 32767"),
        MprCase("Filter", {"--filter", "cubic"},
                "--filter: 'cubic' is not one of nearest, linear")),
    [](const auto& one) { return std::string(one.param.name); });

constexpr const char* kWindowMessage =
    " is neither CENTER,WIDTH (a width greater than 0) nor one of auto, bone, lung, soft, brain, "
    "mediastinum, liver, angio";

TEST(CommandLine, WindowsThatAreNoneAreWrongUsage) {
  for (const char* window : {"bones", "40", "40,0", "40,-400", "40,400,1", "nan,1"}) {
    const Outcome outcome =
        RunTool({"mpr", kPhantom, "-o", "/no/such/folder/x.png", "--window", window});
    EXPECT_EQ(outcome.code, 2) << window;
    EXPECT_EQ(Lines(outcome.errors)[0],
              std::string("vorl: --window: '") + window + "'" + kWindowMessage);
  }
}

INSTANTIATE_TEST_SUITE_P(
    GreyOptions, WrongUsage,
    testing::Values(
        MprCase("Brightness", {"--brightness", "1.1"},
                "--brightness: '1.1' is not a number from -1 to 1"),
        MprCase("Contrast", {"--contrast", "-2"}, "--contrast: '-2' is not a number from -1 to 1"),
        MprCase("Gamma", {"--gamma", "0"}, "--gamma: '0' is not a number from 0.01 to 10")),
    [](const auto& one) { return std::string(one.param.name); });

TEST(CommandLine, NegativeNumbersAreValuesNotOptions) {
  const study_test::TestFolder folder;
  const std::string picture = (folder / "a.png").string();
  const Outcome outcome =
      RunTool({"mpr", kPhantom, "-o", picture, "--center", "-10,5,-3", "--rotate", "-1,-2,-3",
               "--window", "-600,1500", "--brightness", "-0.5", "--contrast", "-.25"});
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  EXPECT_TRUE(study_test::fs::exists(picture));
}

TEST(CommandLine, ThePhantomsSizeMayStandBehindASpace) {
  const Outcome joined = RunTool({"info", "--phantom=6x5x4"});
  const Outcome apart = RunTool({"info", "--phantom", "6x5x4"});
  EXPECT_EQ(joined.code, 0);
  EXPECT_TRUE(Contains(joined.output, "Matrix:       6 x 5 x 4\n"));
  EXPECT_EQ(apart.output, joined.output);
}

TEST(CommandLine, FoldersMayBeNamedLikeCommandsOrLists) {
  const study_test::TestFolder folder;
  for (const char* name : {"info", "[a,b]"}) {
    const std::string path = (folder / name).string();
    ASSERT_EQ(RunTool({"phantom", path, "--size", "4x4x2"}).code, 0);
  }
  const auto current = study_test::fs::current_path();
  study_test::fs::current_path(folder.Path());
  const Outcome command = RunTool({"info", "info"});
  const Outcome list = RunTool({"info", "[a,b]"});
  study_test::fs::current_path(current);
  EXPECT_EQ(command.code, 0) << command.errors;
  EXPECT_EQ(list.code, 0) << list.errors;
}

}  // namespace
