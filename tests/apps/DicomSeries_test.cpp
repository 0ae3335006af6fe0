#include "DicomEdit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/DicomLoader.h>
#include <study/DicomWriter.h>

using namespace study;
using namespace study_test;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

namespace {

/// A folder with series 4 (2 slices), 7 (3 slices, the largest) and 9 (2 slices).
class DicomSeries : public testing::Test {
 protected:
  DicomSeries() {
    Add(4, 2);
    Add(7, 3);
    Add(9, 2);
  }

  void Add(int number, int slices) {
    DicomWriteOptions options;
    options.seriesNumber = number;
    options.seriesDescription = "Series " + std::to_string(number);
    options.intoExistingFolder = true;
    m_files.push_back(WriteDicomSeries(*MakePatternStudy(4, 3, slices), m_folder / "in", options));
  }
  std::unique_ptr<Study> LoadAll(const std::string& series = {}) {
    return Load(m_folder / "in", m_report, series);
  }
  std::string ChoiceError(const std::string& series) {
    return ErrorOf([&] { LoadAll(series); });
  }

  TestFolder m_folder;
  std::vector<std::vector<fs::path>> m_files;
  LoadReport m_report;
};

TEST_F(DicomSeries, LargestIsPickedAndOthersAreListed) {
  const auto loaded = LoadAll();
  EXPECT_EQ(loaded->description, "Series 7");
  EXPECT_EQ(loaded->volume.GetSizeZ(), 3);
  ASSERT_EQ(m_report.series.size(), 3u);
  EXPECT_EQ(m_report.chosen, 0u);
  EXPECT_EQ(m_report.series[0].number, 7);
  EXPECT_EQ(m_report.series[1].number, 4);
  EXPECT_EQ(m_report.series[2].number, 9);
  EXPECT_EQ(m_report.series[2].slices, 2u);
  EXPECT_THAT(Refusals(m_report), IsEmpty());
}

TEST_F(DicomSeries, TextTellsWhatASeriesIs) {
  LoadAll();
  EXPECT_EQ(SeriesText(m_report.series[0]),
            "series 7, CT 'Series 7', 3 slices of 4 x 3, UID " + m_report.series[0].uid);
  EXPECT_EQ(SeriesText({"", std::nullopt, "", "", 1, 5, 6}),
            "series without number, 1 slice of 5 x 6, UID missing");
}

TEST_F(DicomSeries, CanBeChosenByUidNumberAndPlace) {
  LoadAll();
  const std::string uid = m_report.series[2].uid;
  EXPECT_EQ(LoadAll(uid)->description, "Series 9");
  EXPECT_EQ(m_report.chosen, 2u);
  EXPECT_EQ(LoadAll("4")->description, "Series 4");
  EXPECT_EQ(LoadAll("#3")->description, "Series 9");
  EXPECT_EQ(LoadAll("#1")->description, "Series 7");
  EXPECT_EQ(LoadAll("2")->description, "Series 4") << "no series has the number 2: the second one";
}

TEST_F(DicomSeries, WrongChoicesListWhatThereIs) {
  const std::string text = ChoiceError("55");
  EXPECT_THAT(text, HasSubstr("there is no series '55'; there are:\n  #1 series 7, CT 'Series 7'"));
  EXPECT_THAT(text, HasSubstr("\n  #3 series 9, CT 'Series 9'"));
  for (const char* const choice :
       {"#0", "#4", "#", "#x", "x", "1.2.3", "-1", "0", "99999999999999999999", "4 "}) {
    EXPECT_THAT(ChoiceError(choice), HasSubstr("there is no series"));
  }
}

TEST_F(DicomSeries, SharedNumberNeedsAClearerChoice) {
  for (const fs::path& file : m_files[2]) {
    SetAttribute(file, DCM_SeriesNumber, "4");
  }
  EXPECT_THAT(ChoiceError("4"),
              HasSubstr("several series have the number '4', choose by UID or #place"));
  EXPECT_EQ(LoadAll("#2")->volume.GetSizeZ(), 2);
}

TEST_F(DicomSeries, FilesWithoutASeriesUidFormOneSeries) {
  for (const fs::path& file : m_files[1]) {
    RemoveAttribute(file, DCM_SeriesInstanceUID);
  }
  EXPECT_EQ(LoadAll()->volume.GetSizeZ(), 3);
  EXPECT_EQ(m_report.series[0].uid, "");
}

TEST_F(DicomSeries, SubfoldersAreSearchedAndOtherFilesCounted) {
  fs::create_directories(m_folder / "in/deep/er");
  fs::rename(m_files[1][0], m_folder / "in/deep/er/x");
  WriteBytes(m_folder / "in/readme.txt", "no picture");
  WriteBytes(m_folder / "in/deep/empty", "");
  EXPECT_EQ(LoadAll()->volume.GetSizeZ(), 3);
  EXPECT_EQ(m_report.notDicom, 2u);
  EXPECT_THAT(Refusals(m_report), IsEmpty());
}

TEST_F(DicomSeries, FilesCanBeNamedOneByOne) {
  const std::vector<fs::path> paths{m_files[1][2], m_files[1][0]};
  const auto loaded = LoadDicom(paths, "", m_report);
  EXPECT_EQ(loaded->volume.GetSizeZ(), 2);
  EXPECT_EQ(loaded->RealValue(SamplesOf(*loaded->volume.GetSlice(0))[0]), -1024);
}

#if !defined(_WIN32)  // its standard library makes no symbolic links
TEST_F(DicomSeries, FileNamedTwiceCountsOnce) {
  fs::create_symlink(m_files[0][0], m_folder / "link.dcm");
  const auto loaded =
      LoadDicom({m_folder / "in", m_files[0][0], m_folder / "link.dcm"}, "4", m_report);
  EXPECT_EQ(loaded->volume.GetSizeZ(), 2);
  EXPECT_THAT(Refusals(m_report), IsEmpty());
}
#endif

TEST_F(DicomSeries, NamedFileThatIsNoDicomIsRefused) {
  WriteBytes(m_folder / "a.txt", "no picture");
  LoadDicom({m_files[0][0], m_folder / "a.txt"}, "", m_report);
  EXPECT_THAT(Refusals(m_report), ElementsAre("a.txt: it is no DICOM file"));
}

TEST_F(DicomSeries, NothingToLoadIsAnError) {
  const fs::path text = m_folder / "a.txt";
  WriteBytes(text, "no picture");
  EXPECT_EQ(ErrorOf([&] { LoadDicom({text}, "", m_report); }),
            "'" + text.string() + "': it is no DICOM file");
  fs::create_directory(m_folder / "empty");
  EXPECT_EQ(ErrorOf([&] { LoadDicom({m_folder / "empty"}, "", m_report); }),
            "there is no DICOM file among 0 files");
  EXPECT_EQ(ErrorOf([&] { LoadDicom({m_folder / "missing"}, "", m_report); }),
            "'" + (m_folder / "missing").string() + "' does not exist");
}

TEST_F(DicomSeries, ProgressRisesToOneAndCanCancel) {
  std::vector<double> fractions;
  LoadDicom({m_folder / "in"}, "", m_report, [&](double fraction, const std::string&) {
    fractions.push_back(fraction);
    return true;
  });
  EXPECT_TRUE(std::is_sorted(fractions.begin(), fractions.end()));
  EXPECT_GE(fractions.size(), 7u + 3u);
  EXPECT_EQ(fractions.front(), 0);
  EXPECT_EQ(fractions.back(), 1);
  for (const double end : {0.1, 0.5, 0.97}) {
    const Progress refuse = [end](double fraction, const std::string&) { return fraction < end; };
    EXPECT_THROW(LoadDicom({m_folder / "in"}, "", m_report, refuse), Cancelled) << end;
  }
}

}  // namespace
