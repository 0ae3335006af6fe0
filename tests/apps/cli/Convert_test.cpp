#include "Tool.h"

#include <study/Phantom.h>
#include <study/StudyFile.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>

#include "../TestFolder.h"

namespace {

using cli_test::Arguments;
using cli_test::Outcome;
using cli_test::RunTool;
using study_test::ReadBytes;
using study_test::TestFolder;
using Names = std::vector<std::string>;

void ExpectSame(const study::Study& a, const study::Study& b) {
  EXPECT_EQ(a.scale, b.scale);
  EXPECT_EQ(a.offset, b.offset);
  EXPECT_EQ(a.unit, b.unit);
  EXPECT_EQ(a.windowCentre, b.windowCentre);
  EXPECT_EQ(a.windowWidth, b.windowWidth);
  ASSERT_EQ(a.volume.GetSliceCount(), b.volume.GetSliceCount());
  const auto same = [](const dVect3D& p, const dVect3D& q) {
    return p.x == q.x && p.y == q.y && p.z == q.z;
  };
  for (int k = 0; k < a.volume.GetSliceCount(); ++k) {
    const dSlice& first = *a.volume.GetSlice(k);
    const dSlice& second = *b.volume.GetSlice(k);
    EXPECT_TRUE(same(first.GetCoordinates().origin, second.GetCoordinates().origin)) << k;
    EXPECT_TRUE(same(first.GetCoordinates().axisZ, second.GetCoordinates().axisZ)) << k;
    const auto p = study::SamplesOf(first);
    const auto q = study::SamplesOf(second);
    EXPECT_TRUE(std::equal(p.begin(), p.end(), q.begin(), q.end())) << k;
  }
}

TEST(Convert, KeepsTheStudyBitForBit) {
  const TestFolder folder;
  const std::string path = (folder / "a.bdf").string();
  const Outcome outcome = RunTool({"convert", "--phantom=40x32x10", path});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.output, "");
  EXPECT_EQ(outcome.errors, "");
  EXPECT_EQ(folder.Names(), Names{"a.bdf"});
  ExpectSame(*study::ReadStudyFile(path), *study::MakePhantom(40, 32, 10));
}

TEST(Convert, AStudyFileConvertedIsTheSameFile) {
  const TestFolder folder;
  const std::string first = (folder / "a.bdf").string();
  const std::string second = (folder / "b.BDF").string();
  ASSERT_EQ(RunTool({"phantom", "--size", "40x32x10", first}).code, 0);
  ASSERT_EQ(RunTool({"convert", first, second}).code, 0);
  EXPECT_EQ(ReadBytes(second), ReadBytes(first));
  ASSERT_EQ(RunTool({"convert", first, first}).code, 0) << "onto itself";
  EXPECT_EQ(ReadBytes(first), ReadBytes(second));
}

TEST(Convert, TheInputsComeBeforeTheOutputWhereverTheOptionsStand) {
  const TestFolder folder;
  const std::string series = (folder / "series").string();
  ASSERT_EQ(RunTool({"phantom", "--size", "8x8x3", series}).code, 0);
  const std::string one = series + "/S001-00001.dcm";
  const std::string two = series + "/S001-00002.dcm";
  for (const Arguments& arguments :
       {Arguments{"convert", "--series", "1", one, two, (folder / "a.bdf").string()},
        Arguments{"convert", one, "--series", "1", two, (folder / "a.bdf").string()},
        Arguments{"convert", one, two, (folder / "a.bdf").string(), "--series", "1"},
        Arguments{"convert", "--series=1", "--", one, two, (folder / "a.bdf").string()}}) {
    const Outcome outcome = RunTool(arguments);
    EXPECT_EQ(outcome.code, 0) << outcome.errors;
    EXPECT_EQ(study::ReadStudyFile(folder / "a.bdf")->volume.GetSliceCount(), 2);
  }
}

class PhantomEncoding : public testing::TestWithParam<const char*> {};

TEST_P(PhantomEncoding, ASeriesBroughtBackHoldsTheSameValues) {
  const TestFolder folder;
  const std::string series = (folder / "series").string();
  Arguments arguments{"phantom", series, "--size", "40x32x10"};
  if (*GetParam() != '\0') {
    arguments.insert(arguments.end(), {"--encoding", GetParam()});
  }
  const Outcome written = RunTool(arguments);
  EXPECT_EQ(written.code, 0) << written.errors;
  const Outcome converted = RunTool({"convert", series, (folder / "a.bdf").string()});
  EXPECT_EQ(converted.code, 0);
  EXPECT_EQ(converted.errors, "");
  ExpectSame(*study::ReadStudyFile(folder / "a.bdf"), *study::MakePhantom(40, 32, 10));
}

INSTANTIATE_TEST_SUITE_P(All, PhantomEncoding,
                         testing::Values("", "explicit", "implicit", "big-endian", "rle", "jpeg",
                                         "jpeg-ls"),
                         [](const auto& one) {
                           std::string name = *one.param == '\0' ? "default" : one.param;
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

TEST(Phantom, IsTheSameInEveryRun) {
  const TestFolder folder;
  for (const char* name : {"a.bdf", "b.bdf"}) {
    ASSERT_EQ(RunTool({"phantom", (folder / name).string(), "--size", "20x20x16"}).code, 0);
  }
  EXPECT_EQ(ReadBytes(folder / "a.bdf"), ReadBytes(folder / "b.bdf"));
}

TEST(Phantom, TakesAnEmptyFolderButNoOther) {
  const TestFolder folder;
  const std::string series = (folder / "series.1").string();
  study_test::fs::create_directory(series);
  EXPECT_EQ(RunTool({"phantom", series, "--size", "4x4x2"}).code, 0);
  const Outcome again = RunTool({"phantom", series, "--size", "4x4x2"});
  EXPECT_EQ(again.code, 1);
  EXPECT_EQ(again.errors, "vorl: the folder '" + series + "' is not empty\n");
}

}  // namespace
