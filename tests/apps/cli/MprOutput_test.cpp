#include "CutFixture.h"

#include <fstream>

namespace {

using cli_test::Arguments;
using cli_test::Conditions;
using cli_test::Outcome;
using cli_test::RunTool;
using study_test::ReadBytes;
using study_test::WriteBytes;
using Names = std::vector<std::string>;

/// What must hold after every failure: the code, one line of errors, nothing on standard output.
void ExpectFailure(const Outcome& outcome, const std::string& message) {
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.output, "");
  EXPECT_EQ(outcome.errors, "vorl: " + message + "\n");
}

class OutputFailure : public cli_test::CutFixture {
 protected:
  static constexpr const char* kPhantom = "--phantom=64x64x40";
};

#if !defined(_WIN32)  // there no device is full, and nothing limits the size of files
TEST_F(OutputFailure, AFullDeviceIsAnError) {
  const std::string message = "can't write '/dev/full': No space left on device";
  ExpectFailure(RunTool({"mpr", kPhantom, "-o", "/dev/full"}), message);
  ExpectFailure(RunTool({"mpr", kPhantom, "--save-slice", "/dev/full"}), message);
  ExpectFailure(RunTool({"mip", kPhantom, "-o", "/dev/full"}), message);
  ExpectFailure(RunTool({"project", kPhantom, "-o", "/dev/full"}), message);
  ExpectFailure(RunTool({"select", kPhantom, "-o", "/dev/full"}), message);
  ExpectFailure(RunTool({"convert", kPhantom, "/dev/full"}), message);
  ExpectFailure(RunTool({"phantom", "--size", "8x8x8", "/dev/full"}), message);
}

TEST_F(OutputFailure, AFullDeviceBehindALinkIsAnErrorForBothKindsOfPicture) {
  for (const char* name : {"full.png", "full.bmp"}) {
    study_test::fs::create_symlink("/dev/full", m_folder / name);
    ExpectFailure(RunTool({"mpr", kPhantom, "-o", PathOf(name)}),
                  "can't write '/dev/full': No space left on device");
  }
  EXPECT_EQ(m_folder.Names(), (Names{"full.bmp", "full.png"}));
}

TEST_F(OutputFailure, AFullDiskLeavesNoFileAndKeepsTheEarlierOne) {
  Conditions full;
  full.largestFile = 500;
  for (const auto& [name, command] :
       {std::pair<const char*, Arguments>{"a.png", {"mpr", kPhantom, "-o"}},
        std::pair<const char*, Arguments>{"a.bmp", {"mpr", kPhantom, "-o"}},
        std::pair<const char*, Arguments>{"a.bdf", {"mpr", kPhantom, "--save-slice"}},
        std::pair<const char*, Arguments>{"m.bmp", {"mip", kPhantom, "-o"}},
        std::pair<const char*, Arguments>{"p.bmp", {"project", kPhantom, "-o"}},
        std::pair<const char*, Arguments>{"s.bdf", {"select", kPhantom, "-o"}},
        std::pair<const char*, Arguments>{"b.bdf", {"convert", kPhantom}},
        std::pair<const char*, Arguments>{"c.bdf", {"phantom", "--size", "64x64x40"}}}) {
    SCOPED_TRACE(name);
    Arguments arguments = command;
    arguments.push_back(PathOf(name));
    for (const bool earlier : {false, true}) {
      if (earlier) {
        WriteBytes(PathOf(name), "earlier");
      }
      const Outcome outcome = RunTool(arguments, full);
      EXPECT_EQ(outcome.code, 1);
      EXPECT_EQ(outcome.errors.substr(0, 18 + PathOf(name).size()),
                "vorl: can't write '" + PathOf(name).substr(0, PathOf(name).size() - 1))
          << outcome.errors;
      EXPECT_EQ(m_folder.Names(), earlier ? Names{name} : Names{});
    }
    EXPECT_EQ(ReadBytes(PathOf(name)), "earlier");
    study_test::fs::remove(PathOf(name));
  }
}

TEST_F(OutputFailure, AFullDiskLeavesNoSeriesBehind) {
  Conditions full;
  full.largestFile = 500;
  const Outcome outcome = RunTool({"phantom", "--size", "64x64x4", PathOf("series")}, full);
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(outcome.errors.substr(0, 19), "vorl: can't write '");
  EXPECT_TRUE(m_folder.Names().empty());
}
#endif

TEST_F(OutputFailure, AFolderThatIsMissingIsToldBeforeAnythingIsLoaded) {
  const std::string path = PathOf("missing/a.png");
  // The input does not exist either: the output is what is complained about.
  ExpectFailure(RunTool({"mpr", "/no/such", "-o", path}),
                "the folder of '" + path + "' does not exist");
  const std::string study = PathOf("missing/a.bdf");
  ExpectFailure(RunTool({"mpr", "/no/such", "--save-slice", study}),
                "the folder of '" + study + "' does not exist");
  ExpectFailure(RunTool({"convert", "/no/such", study}),
                "the folder of '" + study + "' does not exist");
  ExpectFailure(RunTool({"phantom", study}), "the folder of '" + study + "' does not exist");
}

TEST_F(OutputFailure, AFolderCantBeReplacedByAFile) {
  study_test::fs::create_directory(m_folder / "a.png");
  ExpectFailure(RunTool({"mpr", kPhantom, "-o", PathOf("a.png")}),
                "'" + PathOf("a.png") + "' is a folder");
}

TEST_F(OutputFailure, AFailedInputLeavesNoFile) {
  WriteBytes(PathOf("bad.bdf"), std::string("BDF\0vorlStudy", 14));
  for (const Arguments& arguments :
       {Arguments{"mpr", PathOf("bad.bdf"), "-o", PathOf("a.png")},
        Arguments{"mpr", PathOf("bad.bdf"), "--save-slice", PathOf("a.bdf")},
        Arguments{"convert", PathOf("bad.bdf"), PathOf("a.bdf")}}) {
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.errors.substr(0, 18), "vorl: can't read '") << outcome.errors;
    EXPECT_EQ(m_folder.Names(), Names{"bad.bdf"});
  }
}

TEST_F(OutputFailure, PlanesOfImpossibleSizeAreFailures) {
  ExpectFailure(RunTool({"mpr", kPhantom, "-o", PathOf("a.png"), "--spacing", "0.001"}),
                "the picture would have more than 32767 pixels on a side");
  EXPECT_TRUE(m_folder.Names().empty());
}

TEST_F(OutputFailure, ASuccessReplacesTheEarlierFile) {
  WriteBytes(PathOf("a.png"), "earlier");
  Cut({kPhantom, "-o", PathOf("a.png")});
  EXPECT_EQ(cli_test::ReadPng(PathOf("a.png")).width, 64);
  EXPECT_EQ(m_folder.Names(), Names{"a.png"});
}

#if !defined(_WIN32)  // pipes have no name there
TEST_F(OutputFailure, APipeGetsThePicture) {
  const Outcome outcome = RunTool({"mpr", kPhantom, "-o", "/dev/stdout"});
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  WriteBytes(PathOf("piped.png"), outcome.output);
  Cut({kPhantom, "-o", PathOf("direct.png")});
  EXPECT_EQ(outcome.output, ReadBytes(PathOf("direct.png")));
}
#endif

}  // namespace
