#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/OutputFile.h>

using namespace study;
using namespace study_test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

TEST(OutputFile, AppearsWithCommitOnly) {
  const TestFolder folder;
  {
    OutputFile output(folder / "a.txt");
    WriteBytes(output.TemporaryPath(), "new");
    EXPECT_FALSE(fs::exists(folder / "a.txt"));
    EXPECT_EQ(output.TemporaryPath().parent_path(), folder.Path());
    output.Commit();
    EXPECT_EQ(ReadBytes(folder / "a.txt"), "new");
  }
  EXPECT_THAT(folder.Names(), ElementsAre("a.txt"));
}

TEST(OutputFile, WithoutCommitTheOldFileStays) {
  const TestFolder folder;
  WriteBytes(folder / "a.txt", "old");
  {
    OutputFile output(folder / "a.txt");
    WriteBytes(output.TemporaryPath(), "new");
  }
  EXPECT_EQ(ReadBytes(folder / "a.txt"), "old");
  EXPECT_THAT(folder.Names(), ElementsAre("a.txt"));
}

TEST(OutputFile, CommitReplacesTheOldFile) {
  const TestFolder folder;
  WriteBytes(folder / "a.txt", "old and longer");
  OutputFile output(folder / "a.txt");
  WriteBytes(output.TemporaryPath(), "new");
  output.Commit();
  EXPECT_EQ(ReadBytes(folder / "a.txt"), "new");
}

TEST(OutputFile, TwoWritersOfOneNameDoNotMeet) {
  const TestFolder folder;
  OutputFile first(folder / "a.txt");
  OutputFile second(folder / "a.txt");
  EXPECT_NE(first.TemporaryPath(), second.TemporaryPath());
}

#if !defined(_WIN32)  // its standard library makes no symbolic links
TEST(OutputFile, FollowsASymbolicLink) {
  const TestFolder folder;
  WriteBytes(folder / "real.txt", "old");
  fs::create_symlink(folder / "real.txt", folder / "link.txt");
  OutputFile output(folder / "link.txt");
  WriteBytes(output.TemporaryPath(), "new");
  output.Commit();
  EXPECT_TRUE(fs::is_symlink(folder / "link.txt"));
  EXPECT_EQ(ReadBytes(folder / "real.txt"), "new");
}
#endif

#if !defined(_WIN32)  // devices there have no place in a folder
TEST(OutputFile, NeverReplacesADevice) {
  OutputFile output("/dev/null");
  WriteBytes(output.TemporaryPath(), "new");
  EXPECT_NE(output.TemporaryPath().parent_path(), fs::path("/dev"));
  output.Commit();
  EXPECT_TRUE(fs::is_character_file("/dev/null"));
}

TEST(OutputFile, FullDeviceIsAnError) {
  OutputFile output("/dev/full");
  WriteBytes(output.TemporaryPath(), "new");
  EXPECT_EQ(ErrorOf([&] { output.Commit(); }), "can't write '/dev/full': No space left on device");
  EXPECT_TRUE(fs::is_character_file("/dev/full"));
}
#endif

TEST(OutputFile, NothingWrittenIsAnError) {
  const TestFolder folder;
  {
    OutputFile output(folder / "a.txt");
    EXPECT_EQ(ErrorOf([&] { output.Commit(); }),
              "can't write '" + (folder / "a.txt").string() + "': No such file or directory");
  }
  EXPECT_THAT(folder.Names(), IsEmpty());
}

TEST(OutputFile, RefusesNamesThatCannotBeFiles) {
  const TestFolder folder;
  EXPECT_EQ(ErrorOf([] { OutputFile(""); }), "the name of the output file is empty");
  EXPECT_EQ(ErrorOf([&] { OutputFile(folder.Path()); }),
            "'" + folder.Path().string() + "' is a folder");
  EXPECT_EQ(ErrorOf([&] { OutputFile(folder / "no/a.txt"); }),
            "the folder of '" + (folder / "no/a.txt").string() + "' does not exist");
}

}  // namespace
