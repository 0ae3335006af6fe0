#include "TestFolder.h"
#include "TestStudies.h"

#include <gtest/gtest.h>
#include <study/DicomWriter.h>
#include <study/LoadStudy.h>
#include <study/StudyFile.h>

using namespace study;
using namespace study_test;

namespace {

class LoadStudyTest : public testing::Test {
 protected:
  std::string ErrorFor(const std::vector<fs::path>& paths, const std::string& series = {}) {
    return ErrorOf([&] { LoadStudy(paths, series, m_report); });
  }

  TestFolder m_folder;
  LoadReport m_report;
};

TEST_F(LoadStudyTest, ReadsAStudyFileWhateverItsName) {
  const auto study = MakePatternStudy(4, 3, 2);
  WriteStudyFile(*study, m_folder / "a.bdf");
  fs::copy_file(m_folder / "a.bdf", m_folder / "b");
  EXPECT_EQ(StoredValues(*LoadStudy({m_folder / "a.bdf"}, "", m_report)), StoredValues(*study));
  EXPECT_EQ(StoredValues(*LoadStudy({m_folder / "b"}, "", m_report)), StoredValues(*study));
}

TEST_F(LoadStudyTest, ReadsDicom) {
  const auto study = MakePatternStudy(4, 3, 2);
  const auto files = WriteDicomSeries(*study, m_folder / "out");
  EXPECT_EQ(RealValues(*LoadStudy({m_folder / "out"}, "", m_report)), RealValues(*study));
  EXPECT_EQ(LoadStudy({files[0]}, "", m_report)->volume.GetSizeZ(), 1);
  EXPECT_EQ(m_report.series.size(), 1u);
}

TEST_F(LoadStudyTest, DicomAndBackKeepsEveryBit) {
  const auto study = MakePatternStudy(4, 3, 2);
  WriteDicomSeries(*study, m_folder / "out");
  const auto loaded = LoadStudy({m_folder / "out"}, "", m_report);
  WriteStudyFile(*loaded, m_folder / "a.bdf");
  WriteStudyFile(*study, m_folder / "b.bdf");
  EXPECT_EQ(ReadBytes(m_folder / "a.bdf"), ReadBytes(m_folder / "b.bdf"));
}

TEST_F(LoadStudyTest, NamesWhatIsWrongWithTheInput) {
  EXPECT_EQ(ErrorFor({}), "no input is named");
  const fs::path missing = m_folder / "missing";
  EXPECT_EQ(ErrorFor({missing}), "'" + missing.string() + "' does not exist");
  const fs::path text = m_folder / "text.bdf";
  WriteBytes(text, "no study");
  EXPECT_EQ(ErrorFor({text}), "can't read '" + text.string() + "': it is no binary data file");
}

TEST_F(LoadStudyTest, StudyFileStandsAlone) {
  const fs::path file = m_folder / "a.bdf";
  WriteStudyFile(*MakePatternStudy(4, 3, 2), file);
  EXPECT_EQ(ErrorFor({file, m_folder.Path()}),
            "the study file '" + file.string() + "' must be the only input");
  EXPECT_EQ(ErrorFor({file}, "3"),
            "the study file '" + file.string() + "' holds no series to choose from");
}

}  // namespace
