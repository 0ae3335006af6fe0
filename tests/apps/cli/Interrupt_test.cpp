#include "Tool.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "../TestFolder.h"

namespace {

using cli_test::Conditions;
using cli_test::Outcome;
using cli_test::RunTool;
using study_test::ReadBytes;
using study_test::TestFolder;
using study_test::WriteBytes;
using Names = std::vector<std::string>;

/// Sends `signal` once the folder holds a file that is being written.
Conditions WhileWriting(const study_test::fs::path& folder, int signal) {
  Conditions conditions;
  conditions.signal = signal;
  conditions.when = [folder](const Outcome&) {
    std::error_code ignored;
    for (const auto& entry : study_test::fs::directory_iterator(folder, ignored)) {
      if (entry.path().filename().string().find(".part-") != std::string::npos) {
        return true;
      }
    }
    return false;
  };
  return conditions;
}

/// Sends Ctrl-C's signal once the terminal shows `text`.
Conditions OnceShown(const std::string& text) {
  Conditions conditions;
  conditions.terminalColumns = 80;
  conditions.when = [text](const Outcome& soFar) {
    return soFar.errors.find(text) != std::string::npos;
  };
  return conditions;
}

class Interrupt : public testing::TestWithParam<int> {};

TEST_P(Interrupt, WhileAStudyIsWrittenLeavesTheEarlierFileOnly) {
  const TestFolder folder;
  const std::string path = (folder / "a.bdf").string();
  WriteBytes(path, "earlier");
  const Outcome outcome =
      RunTool({"phantom", "--size", "200x200x200", path}, WhileWriting(folder.Path(), GetParam()));
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: cancelled\n");
  EXPECT_EQ(folder.Names(), Names{"a.bdf"});
  EXPECT_EQ(ReadBytes(path), "earlier");
}

INSTANTIATE_TEST_SUITE_P(Signals, Interrupt, testing::Values(SIGINT, SIGTERM, SIGHUP));

TEST(Interrupt, WhileASeriesIsWrittenLeavesNothing) {
  const TestFolder folder;
  Conditions conditions = WhileWriting(folder / "series", SIGINT);
  const Outcome outcome =
      RunTool({"phantom", "--size", "200x200x200", (folder / "series").string()}, conditions);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors, "vorl: cancelled\n");
  EXPECT_TRUE(folder.Names().empty());
}

TEST(Interrupt, WhileAnInputIsMadeEndsTheRun) {
  const TestFolder folder;
  const Outcome outcome =
      RunTool({"mpr", "--phantom=600x600x600", "-o", (folder / "a.png").string()},
              OnceShown("making the phantom"));
  EXPECT_EQ(outcome.code, 1);
  EXPECT_NE(outcome.errors.find("vorl: cancelled"), std::string::npos);
  EXPECT_TRUE(folder.Names().empty());
}

TEST(Interrupt, WhileAPlaneIsCutEndsTheRun) {
  const TestFolder folder;
  // Some 2.6e11 samples: minutes, if nothing ended it.
  const Outcome outcome =
      RunTool({"mpr", "--phantom=32x32x32", "-o", (folder / "a.png").string(), "--thickness", "300",
               "--steps", "32767", "--size", "200x40000000"},
              OnceShown("cutting the plane"));
  EXPECT_EQ(outcome.code, 2);
  const Outcome cut =
      RunTool({"mpr", "--phantom=32x32x32", "-o", (folder / "a.png").string(), "--thickness", "300",
               "--steps", "32767", "--size", "400x20000", "--spacing", "0.02"},
              OnceShown("cutting the plane"));
  EXPECT_EQ(cut.code, 1);
  EXPECT_NE(cut.errors.find("vorl: cancelled"), std::string::npos);
  EXPECT_TRUE(folder.Names().empty());
}

TEST(Interrupt, WhileVoxelsAreCountedEndsTheRun) {
  const TestFolder folder;
  const Outcome outcome =
      RunTool({"select", "--phantom=400x400x300", "--by", "edge", "-o",
               (folder / "list.bdf").string(), "--draw", (folder / "list.png").string()},
              OnceShown("counting the voxels"));
  EXPECT_EQ(outcome.code, 1);
  EXPECT_NE(outcome.errors.find("vorl: cancelled"), std::string::npos);
  EXPECT_TRUE(folder.Names().empty());
}

TEST(Interrupt, WhileAListIsWrittenLeavesTheEarlierFileOnly) {
  const TestFolder folder;
  const std::string path = (folder / "list.bdf").string();
  WriteBytes(path, "earlier");
  const Outcome outcome = RunTool({"select", "--phantom=200x200x200", "--limit", "100%", "-o", path,
                                   "--draw", (folder / "list.png").string()},
                                  WhileWriting(folder.Path(), SIGINT));
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.output, "");
  EXPECT_EQ(outcome.errors, "vorl: cancelled\n");
  EXPECT_EQ(folder.Names(), Names{"list.bdf"});
  EXPECT_EQ(ReadBytes(path), "earlier");
}

TEST(Interrupt, ARunThatIsToIgnoreInterruptsGoesOn) {
  const TestFolder folder;
  Conditions conditions = WhileWriting(folder.Path(), SIGINT);
  conditions.interruptsIgnored = true;
  const Outcome outcome =
      RunTool({"phantom", "--size", "100x100x100", (folder / "a.bdf").string()}, conditions);
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  EXPECT_EQ(folder.Names(), Names{"a.bdf"});
}

}  // namespace
