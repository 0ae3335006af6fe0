#include "RenderFixture.h"

#include <algorithm>

namespace {

using cli_test::Arguments;
using cli_test::ColourPicture;
using cli_test::Conditions;
using cli_test::Lines;
using cli_test::Outcome;
using cli_test::ReadColourBmp;
using cli_test::ReadColourPng;
using cli_test::Render;
using cli_test::RunTool;
using Names = std::vector<std::string>;

TEST_F(Render, TheSheetHasTheSizeThatIsAskedFor) {
  const ColourPicture usual = BoxSheet();
  EXPECT_EQ(usual.width, 1600);
  EXPECT_EQ(usual.height, 1200);
  const ColourPicture other = BoxSheet({"--size", "321x243"});
  EXPECT_EQ(other.width, 321);
  EXPECT_EQ(other.height, 243);
}

TEST_F(Render, TwoRunsGiveTheSameBytes) {
  BoxSheet({"--size", "800x600"});
  const std::string first = study_test::ReadBytes(PathOf("sheet.png"));
  BoxSheet({"--size", "800x600"});
  EXPECT_EQ(study_test::ReadBytes(PathOf("sheet.png")), first);
}

TEST_F(Render, BmpAndPngHoldTheSamePixels) {
  const ColourPicture png = BoxSheet({"--size", "401x300"});
  const Outcome outcome = RunTool({"render", PathOf("box.bdf"), "--window", "0,4000", "--size",
                                   "401x300", "-o", PathOf("sheet.bmp")});
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  EXPECT_EQ(ReadColourBmp(PathOf("sheet.bmp")).colours, png.colours);
}

TEST_F(Render, ThePhantomIsDrawnWithWhatIsMeasuredInIt) {
  const Outcome outcome = RunTool({"render", "--phantom=64x64x40", "-o", PathOf("a.png")});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  const std::vector<std::string> lines = Lines(outcome.output);
  ASSERT_EQ(lines.size(), 7u) << outcome.output;
  const char* const names[] = {"Planes:", "Line:", "Region:", "Voxels:", "Mean:", "SD:", "Range:"};
  for (std::size_t i = 0; i < lines.size(); ++i) {
    EXPECT_EQ(lines[i].substr(0, 14), (names[i] + std::string(14, ' ')).substr(0, 14));
    EXPECT_NE(lines[i].substr(14, 1), " ");
  }
  EXPECT_EQ(m_folder.Names(), (Names{"a.png", "box.bdf"}));
  cli_test::FindFrames(ReadColourPng(PathOf("a.png")));
}

TEST_F(Render, VolumesOfOneVoxelOrOneSliceAreDrawn) {
  for (const char* size : {"1x1x1", "1x9x1", "16x16x1", "1x16x16", "16x1x16"}) {
    const Outcome outcome =
        RunTool({"render", "--phantom=" + std::string(size), "-o", PathOf("a.png")});
    EXPECT_EQ(outcome.code, 0) << size << outcome.errors;
    cli_test::FindFrames(ReadColourPng(PathOf("a.png")));
  }
}

TEST_F(Render, PlanesThatMissTheVolumeAreTold) {
  const Outcome outcome =
      RunTool({"render", PathOf("box.bdf"), "--center", "100,0,-61", "-o", PathOf("a.png")});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors,
            "vorl: note: the axial plane does not meet the volume\n"
            "vorl: note: the sagittal plane does not meet the volume\n");
  const Outcome quiet =
      RunTool({"render", PathOf("box.bdf"), "--center", "100,0,-61", "-q", "-o", PathOf("a.png")});
  EXPECT_EQ(quiet.errors, "");
  EXPECT_EQ(quiet.output, outcome.output);
}

TEST_F(Render, AFailureLeavesNoFile) {
  const Outcome outcome = RunTool({"render", PathOf("no.bdf"), "-o", PathOf("a.png")});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(m_folder.Names(), Names{"box.bdf"});
}

#if !defined(_WIN32)  // no devices there
TEST_F(Render, IntoADeviceGoesThePictureAlone) {
  const Outcome outcome =
      RunTool({"render", PathOf("box.bdf"), "--size", "200x150", "-o", "/dev/stdout"});
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  ASSERT_GT(outcome.output.size(), 20u);
  EXPECT_EQ(outcome.output.substr(1, 3), "PNG");
  EXPECT_EQ(outcome.output.substr(outcome.output.size() - 8, 4), "IEND");
}

TEST_F(Render, AnInterruptedSheetLeavesNoFile) {
  Conditions interrupted;
  interrupted.terminalColumns = 80;
  interrupted.when = [](const Outcome& soFar) {
    return soFar.errors.find("cutting the plane") != std::string::npos ||
           soFar.errors.find("projecting the volume") != std::string::npos ||
           soFar.errors.find("making the phantom") != std::string::npos;
  };
  const Outcome outcome = RunTool({"render", "--phantom", "-o", PathOf("a.png")}, interrupted);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(m_folder.Names(), Names{"box.bdf"});
}
#endif

struct RefusalCase {
  const char* name;
  Arguments arguments;
  const char* message;
};

class RenderRefusal : public testing::TestWithParam<RefusalCase> {};

TEST_P(RenderRefusal, SaysWhatIsWrong) {
  Arguments arguments{"render", "--phantom=4x4x4"};
  arguments.insert(arguments.end(), GetParam().arguments.begin(), GetParam().arguments.end());
  const Outcome outcome = RunTool(arguments);
  EXPECT_EQ(outcome.code, 2);
  EXPECT_EQ(outcome.output, "");
  EXPECT_EQ(outcome.errors,
            std::string("vorl: ") + GetParam().message + "\nvorl: try 'vorl render --help'\n");
}

INSTANTIATE_TEST_SUITE_P(
    Options, RenderRefusal,
    testing::Values(
        RefusalCase{"NoOutput", {}, "no output is named (-o SHEET.png or -o SHEET.bmp)"},
        RefusalCase{
            "Extension", {"-o", "a.gif"}, "-o: the name 'a.gif' does not end in .png or .bmp"},
        RefusalCase{"Layout",
                    {"-o", "a.png", "--layout", "3x3"},
                    "--layout: '3x3' is not one of 2x2, row, column, main"},
        RefusalCase{"SizeText",
                    {"-o", "a.png", "--size", "800"},
                    "--size: '800' is not WIDTHxHEIGHT (whole numbers from 1 to 32767)"},
        RefusalCase{"SizeTooNarrow",
                    {"-o", "a.png", "--size", "159x120"},
                    "--size: '159x120' is not from 160x120 to 8192x8192"},
        RefusalCase{"SizeTooLow",
                    {"-o", "a.png", "--size", "160x119"},
                    "--size: '160x119' is not from 160x120 to 8192x8192"},
        RefusalCase{"SizeTooWide",
                    {"-o", "a.png", "--size", "8193x800"},
                    "--size: '8193x800' is not from 160x120 to 8192x8192"},
        RefusalCase{"SizeTooHigh",
                    {"-o", "a.png", "--size", "800x8193"},
                    "--size: '800x8193' is not from 160x120 to 8192x8192"},
        RefusalCase{"Centre",
                    {"-o", "a.png", "--center", "1,2"},
                    "--center: '1,2' is not X,Y,Z (three numbers with commas between them)"},
        RefusalCase{"Line",
                    {"-o", "a.png", "--line", "1,2,3"},
                    "--line: '1,2,3' is not X,Y,X,Y (four numbers with commas between them)"},
        RefusalCase{"LineTooFar",
                    {"-o", "a.png", "--line", "1,2,3,1e7"},
                    "--line: '1,2,3,1e7' is not within a kilometre"},
        RefusalCase{"Region",
                    {"-o", "a.png", "--region", "a,b,c,d"},
                    "--region: 'a,b,c,d' is not X,Y,X,Y (four numbers with commas between them)"},
        RefusalCase{"RegionWithoutArea",
                    {"-o", "a.png", "--region", "1,2,1,4"},
                    "--region: '1,2,1,4' has no area"},
        RefusalCase{"RegionWithoutAnnotations",
                    {"-o", "a.png", "--no-annotations", "--region", "1,2,3,4"},
                    "--region and --no-annotations exclude each other"},
        RefusalCase{"LineWithoutAnnotations",
                    {"-o", "a.png", "--no-annotations", "--line", "1,2,3,4"},
                    "--line and --no-annotations exclude each other"}),
    [](const auto& one) { return std::string(one.param.name); });

}  // namespace
