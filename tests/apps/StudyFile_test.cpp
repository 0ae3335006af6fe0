#include "FileSizeLimit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/StudyFile.h>

#include <algorithm>

using namespace study;
using namespace study_test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

bool SamePlacement(const dCoordSys3D& a, const dCoordSys3D& b) {
  return ToVec3(a.origin) == ToVec3(b.origin) && ToVec3(a.axisX) == ToVec3(b.axisX) &&
         ToVec3(a.axisY) == ToVec3(b.axisY) && ToVec3(a.axisZ) == ToVec3(b.axisZ);
}

TEST(StudyFile, KeepsEverythingBitForBit) {
  const TestFolder folder;
  const auto study = MakePatternStudy(5, 4, 3);
  study->scale = 0.1;
  study->offset = -1.0 / 3;
  PlaceVolume(*study, {0.1, -7.7, 1e3}, {0.3, 0.4, 0}, {-0.4, 0.3, 0.01}, {0.1, 0.2, 2});
  WriteStudyFile(*study, folder / "a.bdf");

  const auto copy = ReadStudyFile(folder / "a.bdf");
  EXPECT_EQ(copy->scale, 0.1);
  EXPECT_EQ(copy->offset, -1.0 / 3);
  EXPECT_EQ(copy->unit, "HU");
  EXPECT_EQ(copy->modality, "CT");
  EXPECT_EQ(copy->description, "Pattern");
  EXPECT_EQ(copy->windowCentre, 50);
  EXPECT_EQ(copy->windowWidth, 350);
  EXPECT_EQ(copy->volume.GetSizeX(), 5);
  EXPECT_EQ(copy->volume.GetSizeY(), 4);
  EXPECT_EQ(copy->volume.GetSizeZ(), 3);
  EXPECT_EQ(StoredValues(*copy), StoredValues(*study));
  EXPECT_TRUE(SamePlacement(copy->volume.GetCoordinates(), study->volume.GetCoordinates()));
  for (int k = 0; k < 3; ++k) {
    EXPECT_TRUE(SamePlacement(copy->volume.GetSlice(k)->GetCoordinates(),
                              study->volume.GetSlice(k)->GetCoordinates()));
  }
}

TEST(StudyFile, WritingTwiceGivesTheSameBytes) {
  const TestFolder folder;
  WriteStudyFile(*MakePatternStudy(5, 4, 3), folder / "a.bdf");
  WriteStudyFile(*ReadStudyFile(folder / "a.bdf"), folder / "b.bdf");
  EXPECT_EQ(ReadBytes(folder / "a.bdf"), ReadBytes(folder / "b.bdf"));
}

TEST(StudyFile, BeginsWithTheFormatsMarks) {
  const TestFolder folder;
  WriteStudyFile(*MakePatternStudy(1, 1, 1), folder / "a.bdf");
  const std::string bytes = ReadBytes(folder / "a.bdf");
  // Magic, type name, then version 1 as U32 (tag 5) and the scale 1.0 as F64 (tag 8).
  const std::string expected("BDF\0vorlStudy\0\5\1\0\0\0\x8\0\0\0\0\0\0\xF0\x3F", 28);
  EXPECT_EQ(bytes.substr(0, expected.size()), expected);
  EXPECT_TRUE(IsStudyFile(folder / "a.bdf"));
}

TEST(StudyFile, OtherFilesAreNotTakenForStudies) {
  const TestFolder folder;
  WriteBytes(folder / "a.bdf", std::string("BDF\0other\0......", 16));
  EXPECT_FALSE(IsStudyFile(folder / "a.bdf"));
  EXPECT_FALSE(IsStudyFile(folder / "missing.bdf"));
}

TEST(StudyFile, ProgressRisesToOne) {
  const TestFolder folder;
  std::vector<double> fractions;
  const Progress listen = [&](double fraction, const std::string&) {
    fractions.push_back(fraction);
    return true;
  };
  WriteStudyFile(*MakePatternStudy(2, 2, 4), folder / "a.bdf", listen);
  EXPECT_TRUE(std::is_sorted(fractions.begin(), fractions.end()));
  EXPECT_EQ(fractions.front(), 0);
  EXPECT_EQ(fractions.back(), 1);
  fractions.clear();
  ReadStudyFile(folder / "a.bdf", listen);
  EXPECT_TRUE(std::is_sorted(fractions.begin(), fractions.end()));
  EXPECT_EQ(fractions.back(), 1);
}

TEST(StudyFile, CancellingLeavesNothingBehind) {
  const TestFolder folder;
  const auto study = MakePatternStudy(2, 2, 4);
  const Progress refuse = [](double fraction, const std::string&) { return fraction < 0.5; };
  EXPECT_THROW(WriteStudyFile(*study, folder / "a.bdf", refuse), Cancelled);
  EXPECT_THAT(folder.Names(), IsEmpty());
}

#if !defined(_WIN32)  // there nothing limits the size of a process's files, and no device is full
TEST(StudyFile, FullDiskIsAnErrorAtEverySize) {
  const TestFolder folder;
  const auto study = MakePatternStudy(50, 40, 3);
  WriteStudyFile(*study, folder / "whole.bdf");
  const std::uintmax_t size = fs::file_size(folder / "whole.bdf");
  for (const std::uintmax_t room : {std::uintmax_t{0}, std::uintmax_t{10}, size / 2, size - 1}) {
    const FileSizeLimit limit(room);
    EXPECT_EQ(ErrorOf([&] { WriteStudyFile(*study, folder / "a.bdf"); }),
              "can't write '" + (folder / "a.bdf").string() +
                  "': the disk is full, or the writing failed")
        << room;
  }
  EXPECT_THAT(folder.Names(), ElementsAre("whole.bdf"));
}

TEST(StudyFile, FullDiskKeepsTheOldFile) {
  const TestFolder folder;
  WriteBytes(folder / "a.bdf", "old");
  {
    const FileSizeLimit limit(100);
    EXPECT_NE(ErrorOf([&] { WriteStudyFile(*MakePatternStudy(9, 9, 9), folder / "a.bdf"); }),
              "no error");
  }
  EXPECT_EQ(ReadBytes(folder / "a.bdf"), "old");
}

TEST(StudyFile, FullDeviceIsAnError) {
  const auto study = MakePatternStudy(2, 2, 2);
  EXPECT_EQ(ErrorOf([&] { WriteStudyFile(*study, "/dev/full"); }),
            "can't write '/dev/full': No space left on device");
}
#endif

TEST(StudyFile, RefusesAnEmptyStudy) {
  const TestFolder folder;
  Study study;
  EXPECT_EQ(ErrorOf([&] { WriteStudyFile(study, folder / "a.bdf"); }),
            "can't write '" + (folder / "a.bdf").string() + "': the study is empty");
  EXPECT_THAT(folder.Names(), IsEmpty());
}

TEST(StudyFile, MissingFileIsAnError) {
  EXPECT_EQ(ErrorOf([] { ReadStudyFile("/no/such.bdf"); }),
            "can't read '/no/such.bdf': the file can't be opened");
}

}  // namespace
