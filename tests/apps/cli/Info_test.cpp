#include "Tool.h"

#include <study/Study.h>
#include <study/StudyFile.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include <sys/stat.h>

#include "../TestFolder.h"

namespace {

using cli_test::Lines;
using cli_test::Outcome;
using cli_test::RunTool;
using study_test::TestFolder;

/// The value behind a label of the report; empty when there is no such line.
std::string ValueOf(const std::string& report, const std::string& label) {
  for (const std::string& line : Lines(report)) {
    if (line.substr(0, label.size() + 1) == label + ":") {
      return line.substr(14);
    }
  }
  return {};
}

/// 3 x 2 x 2 voxels of 0.7 x 1.25 x 3 mm, cut from the front to the back: value = stored / 4 - 100.
void WriteCoronalStudy(const study_test::fs::path& path) {
  study::Study study;
  std::uint16_t value = 7;
  for (int k = 0; k < 2; ++k) {
    for (std::uint16_t& sample : study::AppendSlice(study, 3, 2)) {
      sample = value;
      value = static_cast<std::uint16_t>(value + 100);
    }
  }
  study.scale = 0.25;
  study.offset = -100;
  study.unit = "BQML";
  study.description = "made for a test";
  study::PlaceVolume(study, {10, -20.5, 30}, {0.7, 0, 0}, {0, 0, -1.25}, {0, 3, 0});
  study::WriteStudyFile(study, path);
}

TEST(Info, TellsGeometryAndValuesOfAStudyFile) {
  const TestFolder folder;
  const std::string path = (folder / "a.bdf").string();
  WriteCoronalStudy(path);
  const Outcome outcome = RunTool({"info", path});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  EXPECT_EQ(outcome.output, "Input:        " + path +
                                "\n"
                                "Description:  made for a test\n"
                                "Matrix:       3 x 2 x 2\n"
                                "Spacing:      0.7 x 1.25 x 3 mm\n"
                                "Size:         2.1 x 2.5 x 6 mm\n"
                                "First voxel:  10, -20.5, 30 mm (centre)\n"
                                "Centre:       10.7, -19, 29.375 mm\n"
                                "Orientation:  coronal\n"
                                "              rows run to L (1, 0, 0)\n"
                                "              columns run to F (0, 0, -1)\n"
                                "              slices follow to P (0, 1, 0)\n"
                                "Sample type:  16 bit unsigned, value = stored x 0.25 - 100\n"
                                "Stored range: 7 to 1107\n"
                                "Value range:  -98.25 to 176.75 BQML\n"
                                "Unit:         BQML\n");
}

TEST(Info, TellsThePhantom) {
  const Outcome outcome = RunTool({"info", "--phantom=40x20x16"});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(ValueOf(outcome.output, "Input"), "phantom");
  EXPECT_EQ(ValueOf(outcome.output, "Matrix"), "40 x 20 x 16");
  EXPECT_EQ(ValueOf(outcome.output, "Spacing"), "10 x 20 x 20 mm");
  EXPECT_EQ(ValueOf(outcome.output, "Orientation"), "axial");
  EXPECT_EQ(ValueOf(outcome.output, "Unit"), "HU");
  EXPECT_EQ(ValueOf(outcome.output, "Window"), "centre 40, width 400");
}

TEST(Info, ThePhantomHasAUsualSizeWithoutOne) {
  EXPECT_EQ(ValueOf(RunTool({"info", "--phantom"}).output, "Matrix"), "256 x 256 x 160");
}

/// Two series in one folder: the second one has more slices.
void WriteTwoSeries(const TestFolder& folder) {
  ASSERT_EQ(RunTool({"phantom", (folder / "a").string(), "--size", "8x8x3"}).code, 0);
  ASSERT_EQ(RunTool({"phantom", (folder / "b").string(), "--size", "10x6x5"}).code, 0);
}

TEST(Info, TakesTheLargestSeriesAndListsTheOthers) {
  const TestFolder folder;
  WriteTwoSeries(folder);
  const Outcome outcome = RunTool({"info", folder.Path().string()});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(ValueOf(outcome.output, "Matrix"), "10 x 6 x 5");
  EXPECT_EQ(ValueOf(outcome.output, "Series").substr(0, 52),
            "#1 series 1, CT 'Phantom', 5 slices of 10 x 6, UID 2");
  EXPECT_EQ(ValueOf(outcome.output, "Also there").substr(0, 51),
            "#2 series 1, CT 'Phantom', 3 slices of 8 x 8, UID 2");
  const std::vector<std::string> notes = Lines(outcome.errors);
  ASSERT_EQ(notes.size(), 3u) << outcome.errors;
  EXPECT_EQ(notes[0],
            "vorl: note: there are 2 series, the largest is taken; choose with --series:");
  EXPECT_EQ(notes[1].substr(0, 35), "vorl: note:   #1 (taken) series 1, ");
  EXPECT_EQ(notes[2].substr(0, 27), "vorl: note:   #2 series 1, ");
}

TEST(Info, TakesTheSeriesThatIsChosen) {
  const TestFolder folder;
  WriteTwoSeries(folder);
  const Outcome byPlace = RunTool({"info", folder.Path().string(), "--series", "#2"});
  EXPECT_EQ(byPlace.code, 0);
  EXPECT_EQ(ValueOf(byPlace.output, "Matrix"), "8 x 8 x 3");
  const std::string series = ValueOf(byPlace.output, "Series");
  const std::string uid = series.substr(series.find("UID ") + 4);
  const Outcome byUid = RunTool({"info", "--series", uid, folder.Path().string()});
  EXPECT_EQ(byUid.output, byPlace.output);
  EXPECT_EQ(Lines(byUid.errors).at(0),
            "vorl: note: there are 2 series, the chosen one is taken; choose with --series:");
}

TEST(Info, ASeriesThatIsNotThereIsAFailure) {
  const TestFolder folder;
  WriteTwoSeries(folder);
  const Outcome outcome = RunTool({"info", folder.Path().string(), "--series", "#3"});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.output, "");
  EXPECT_EQ(outcome.errors.substr(0, 6), "vorl: ");
}

TEST(Info, TakesSeveralPathsAndSaysSo) {
  const TestFolder folder;
  ASSERT_EQ(RunTool({"phantom", (folder / "a").string(), "--size", "8x8x4"}).code, 0);
  const std::string first = (folder / "a/S001-00001.dcm").string();
  const Outcome outcome = RunTool({"info", first, (folder / "a/S001-00002.dcm").string()});
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  EXPECT_EQ(ValueOf(outcome.output, "Input"), first + " and 1 more");
  EXPECT_EQ(ValueOf(outcome.output, "Matrix"), "8 x 8 x 2");
}

TEST(Info, FilesLeftOutAreNotedUnlessQuiet) {
  const TestFolder folder;
  ASSERT_EQ(RunTool({"phantom", (folder / "a").string(), "--size", "8x8x4"}).code, 0);
  const auto whole = folder / "a/S001-00003.dcm";
  study_test::fs::copy_file(whole, folder / "a/copy.dcm");
  const Outcome outcome = RunTool({"info", (folder / "a").string()});
  EXPECT_EQ(outcome.code, 0);
  ASSERT_EQ(Lines(outcome.errors).size(), 1u) << outcome.errors;
  EXPECT_EQ(outcome.errors.substr(0, 22), "vorl: note: left out '");
  const Outcome quiet = RunTool({"info", "-q", (folder / "a").string()});
  EXPECT_EQ(quiet.errors, "");
  EXPECT_EQ(quiet.output, outcome.output);
}

TEST(Info, MissingAndForeignInputsAreFailures) {
  const TestFolder folder;
  const std::string missing = (folder / "missing").string();
  Outcome outcome = RunTool({"info", missing});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: '" + missing + "' does not exist\n");
  const std::string foreign = (folder / "foreign.txt").string();
  study_test::WriteBytes(foreign, "no image");
  outcome = RunTool({"info", foreign});
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.output, "");
  EXPECT_EQ(outcome.errors.substr(0, 6), "vorl: ");
  EXPECT_EQ(Lines(outcome.errors).size(), 1u);
}

#if !defined(_WIN32)  // no named pipes, and no device is full there
TEST(Info, PipesAndDevicesAreNoInputsAndNobodyWaitsForThem) {
  const TestFolder folder;
  const std::string pipe = (folder / "pipe.bdf").string();
  ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
  for (const std::string& path : {pipe, std::string("/dev/null")}) {
    const Outcome outcome = RunTool({"info", path});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.output, "");
    EXPECT_EQ(outcome.errors, "vorl: '" + path + "' is neither a file nor a folder\n");
  }
}

TEST(Info, OutputThatCantBeWrittenIsAFailure) {
  cli_test::Conditions full;
  full.standardOutput = "/dev/full";
  const Outcome outcome = RunTool({"info", "--phantom=4x4x4"}, full);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: can't write to the standard output: No space left on device\n");
}
#endif

}  // namespace
