#include "Tool.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "../TestFolder.h"

namespace {

using cli_test::Arguments;
using cli_test::Conditions;
using cli_test::Outcome;
using cli_test::RunTool;
using study_test::TestFolder;

#if !defined(_WIN32)  // no pseudo terminal stands in for a person's there
Conditions Terminal(int columns) {
  Conditions conditions;
  conditions.terminalColumns = columns;
  return conditions;
}

/// What a person sees in the end: what stands on each line after all goings back.
std::string Visible(const std::string& sent) {
  std::string text;
  std::string line;
  std::size_t column = 0;
  for (const char c : sent) {
    if (c == '\n') {
      text += line.substr(0, line.find_last_not_of(' ') + 1) + "\n";
      line.clear();
      column = 0;
    } else if (c == '\r') {
      column = 0;
    } else {
      line.resize(std::max(line.size(), column + 1), ' ');
      line[column++] = c;
    }
  }
  return text + line.substr(0, line.find_last_not_of(' ') + 1);
}

TEST(Progress, ATerminalShowsABarThatGoesAway) {
  const TestFolder folder;
  const Outcome outcome =
      RunTool({"convert", "--phantom=64x64x64", (folder / "a.bdf").string()}, Terminal(80));
  EXPECT_EQ(outcome.code, 0);
  EXPECT_NE(outcome.errors.find("\r[------------------------------]   0% making the phantom"),
            std::string::npos);
  EXPECT_EQ(Visible(outcome.errors), "");
}

TEST(Progress, WorkThatIsOverAtOnceIsNamedAllTheSame) {
  const TestFolder folder;
  const Outcome outcome =
      RunTool({"mpr", "--phantom=16x16x16", "-o", (folder / "a.png").string()}, Terminal(80));
  for (const char* const work :
       {"making the phantom", "cutting the plane", "making the picture", "writing the picture"}) {
    EXPECT_NE(outcome.errors.find(work), std::string::npos) << work;
  }
}

TEST(Progress, OnlyTheResultIsLeftOnATerminal) {
  const Outcome piped = RunTool({"info", "--phantom=32x32x32"});
  const Outcome shown = RunTool({"info", "--phantom=32x32x32"}, Terminal(200));
  EXPECT_NE(shown.errors.find("making the phantom"), std::string::npos);
  EXPECT_EQ(Visible(shown.errors), piped.output);
}

TEST(Progress, TheBarFitsANarrowTerminal) {
  const TestFolder folder;
  const Outcome outcome =
      RunTool({"convert", "--phantom=64x64x64", (folder / "a.bdf").string()}, Terminal(20));
  std::size_t longest = 0;
  std::size_t column = 0;
  for (const char c : outcome.errors) {
    column = c == '\r' || c == '\n' ? 0 : column + 1;
    longest = std::max(longest, column);
  }
  EXPECT_EQ(longest, 19u);
}
#endif

TEST(Progress, APipeGetsNoControlCharacters) {
  const TestFolder folder;
  for (const Arguments& arguments :
       {Arguments{"info", "--phantom=48x48x48"},
        Arguments{"mpr", "--phantom=48x48x48", "-o", (folder / "a.png").string()},
        Arguments{"mip", "--phantom=48x48x48", "-o", (folder / "a.png").string()},
        Arguments{"project", "--phantom=48x48x48", "-o", (folder / "a.png").string()},
        Arguments{"select", "--phantom=48x48x48", "-o", (folder / "l.bdf").string(), "--draw",
                  (folder / "a.png").string()},
        Arguments{"convert", "--phantom=48x48x48", (folder / "a.bdf").string()},
        Arguments{"phantom", "--size", "48x48x48", (folder / "b.bdf").string()}}) {
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.errors, "");
    for (const char c : outcome.output) {
      EXPECT_TRUE(c == '\n' || (c >= ' ' && c <= '~')) << static_cast<int>(c);
    }
  }
}

#if !defined(_WIN32)  // no pseudo terminal stands in for a person's there
TEST(Progress, QuietAndDumbTerminalsShowNoBar) {
  const TestFolder folder;
  const Arguments arguments{"phantom", "--size", "48x48x48", (folder / "a.bdf").string()};
  Arguments quiet = arguments;
  quiet.push_back("--quiet");
  EXPECT_EQ(RunTool(quiet, Terminal(80)).errors, "");
  Conditions dumb = Terminal(80);
  dumb.terminalKind = "dumb";
  EXPECT_EQ(RunTool(arguments, dumb).errors, "");
}

TEST(Progress, ErrorsStandOnALineOfTheirOwn) {
  const Outcome outcome = RunTool({"convert", "--phantom=32x32x32", "/dev/full"}, Terminal(80));
  EXPECT_EQ(outcome.code, 1);
  EXPECT_EQ(Visible(outcome.errors), "vorl: can't write '/dev/full': No space left on device\n");
}
#endif

}  // namespace
