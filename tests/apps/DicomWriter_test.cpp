#include "DicomEdit.h"
#include "FileSizeLimit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/DicomWriter.h>
#include <study/Error.h>

using namespace study;
using namespace study_test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

std::string AttributeOf(const fs::path& file, const DcmTagKey& tag) {
  DcmFileFormat dicom;
  OFString value;
  dicom.loadFile(OFFilename(file.c_str()));
  dicom.getDataset()->findAndGetOFStringArray(tag, value);
  return value.c_str();
}

TEST(DicomWriter, WritesOneFilePerSliceInOrder) {
  const TestFolder folder;
  const auto files = WriteDicomSeries(*MakePatternStudy(4, 3, 3), folder / "new/out");
  ASSERT_EQ(files.size(), 3u);
  EXPECT_EQ(files[0], folder / "new/out/S001-00001.dcm");
  EXPECT_EQ(files[2], folder / "new/out/S001-00003.dcm");
  EXPECT_EQ(AttributeOf(files[1], DCM_InstanceNumber), "2");
  EXPECT_EQ(AttributeOf(files[1], DCM_ImagePositionPatient), "10\\20\\35");
  EXPECT_EQ(AttributeOf(files[1], DCM_PixelSpacing), "3\\2");
  EXPECT_EQ(AttributeOf(files[1], DCM_RescaleIntercept), "-1024");
  EXPECT_EQ(AttributeOf(files[1], DCM_SOPClassUID), UID_CTImageStorage);
  EXPECT_EQ(AttributeOf(files[1], DCM_PatientName), "");
}

TEST(DicomWriter, SignedFilesHoldTheRealValues) {
  const TestFolder folder;
  DicomWriteOptions options;
  options.isSigned = true;
  const auto files = WriteDicomSeries(*MakePatternStudy(4, 3, 1), folder / "out", options);
  EXPECT_EQ(AttributeOf(files[0], DCM_RescaleIntercept), "0");
  EXPECT_EQ(AttributeOf(files[0], DCM_PixelRepresentation), "1");
}

TEST(DicomWriter, EqualInputGivesEqualFiles) {
  const TestFolder folder;
  const auto study = MakePatternStudy(4, 3, 2);
  const auto first = WriteDicomSeries(*study, folder / "a");
  const auto second = WriteDicomSeries(*study, folder / "b");
  for (std::size_t i = 0; i < first.size(); ++i) {
    EXPECT_EQ(ReadBytes(first[i]), ReadBytes(second[i]));
  }
}

TEST(DicomWriter, IdentifiersTellContentAndSeriesApart) {
  const TestFolder folder;
  const auto study = MakePatternStudy(4, 3, 2);
  const auto files = WriteDicomSeries(*study, folder / "a");
  EXPECT_NE(AttributeOf(files[0], DCM_SOPInstanceUID), AttributeOf(files[1], DCM_SOPInstanceUID));
  EXPECT_EQ(AttributeOf(files[0], DCM_SeriesInstanceUID),
            AttributeOf(files[1], DCM_SeriesInstanceUID));

  DicomWriteOptions options;
  options.seriesNumber = 2;
  const auto other = WriteDicomSeries(*study, folder / "b", options);
  EXPECT_EQ(AttributeOf(files[0], DCM_StudyInstanceUID),
            AttributeOf(other[0], DCM_StudyInstanceUID));
  EXPECT_NE(AttributeOf(files[0], DCM_SeriesInstanceUID),
            AttributeOf(other[0], DCM_SeriesInstanceUID));

  SamplesOf(*study->volume.GetSlice(1))[5] ^= 1;
  const auto changed = WriteDicomSeries(*study, folder / "c");
  EXPECT_NE(AttributeOf(files[0], DCM_SOPInstanceUID), AttributeOf(changed[0], DCM_SOPInstanceUID));
}

TEST(DicomWriter, ValuesThatDoNotFitAreAnError) {
  const TestFolder folder;
  DicomWriteOptions options;
  options.bitsStored = 8;
  EXPECT_EQ(ErrorOf([&] { WriteDicomSeries(*MakePatternStudy(4, 3, 1), folder / "out", options); }),
            "a value of 262 does not fit 8 unsigned bits");
  EXPECT_THAT(folder.Names(), IsEmpty());
  for (const unsigned bits : {0u, 7u, 17u}) {
    options.bitsStored = bits;
    EXPECT_EQ(
        ErrorOf([&] { WriteDicomSeries(*MakePatternStudy(4, 3, 1), folder / "out", options); }),
        std::to_string(bits) + " stored bits; 8 to 16 can be written");
  }
}

TEST(DicomWriter, PicturesTooSmallForJpegLsAreAnError) {
  const TestFolder folder;
  DicomWriteOptions options;
  options.encoding = DicomEncoding::JpegLsLossless;
  EXPECT_EQ(
      ErrorOf([&] { WriteDicomSeries(*MakePatternStudy(33, 31, 1), folder / "out", options); }),
      "slices of less than 1024 pixels can't be written as JPEG-LS");
  EXPECT_EQ(WriteDicomSeries(*MakePatternStudy(32, 32, 1), folder / "out", options).size(), 1u);
}

TEST(DicomWriter, FolderWithContentIsLeftAlone) {
  const TestFolder folder;
  WriteBytes(folder / "precious.dcm", "mine");
  const auto study = MakePatternStudy(4, 3, 1);
  EXPECT_EQ(ErrorOf([&] { WriteDicomSeries(*study, folder.Path()); }),
            "the folder '" + folder.Path().string() + "' is not empty");
  EXPECT_EQ(ErrorOf([&] { WriteDicomSeries(*study, folder / "precious.dcm"); }),
            "'" + (folder / "precious.dcm").string() + "' is no folder");
  EXPECT_THAT(folder.Names(), ElementsAre("precious.dcm"));
}

#if !defined(_WIN32)  // there nothing limits the size of a process's files, and no device is full
TEST(DicomWriter, FullDiskIsAnErrorAndLeavesNothing) {
  const TestFolder folder;
  const auto study = MakePatternStudy(60, 50, 2);
  WriteDicomSeries(*study, folder / "good");
  const auto size = fs::file_size(folder / "good/S001-00001.dcm");
  for (const auto room : {std::uintmax_t{0}, std::uintmax_t{200}, size / 2, size - 1}) {
    const FileSizeLimit limit(room);
    EXPECT_NE(ErrorOf([&] { WriteDicomSeries(*study, folder / "bad"); }), "no error") << room;
  }
  EXPECT_THAT(folder.Names(), ElementsAre("good"));
}
#endif

TEST(DicomWriter, CancellingRemovesWhatWasWritten) {
  const TestFolder folder;
  const Progress refuse = [](double fraction, const std::string&) { return fraction < 0.5; };
  EXPECT_THROW(WriteDicomSeries(*MakePatternStudy(4, 3, 4), folder / "out", {}, refuse), Cancelled);
  EXPECT_THAT(folder.Names(), IsEmpty());
}

TEST(DicomWriter, RefusesAnEmptyStudy) {
  const TestFolder folder;
  EXPECT_EQ(ErrorOf([&] { WriteDicomSeries(Study(), folder / "out"); }), "the study is empty");
}

}  // namespace
