#include "DicomEdit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dcspchrs.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/DicomWriter.h>

using namespace study;
using namespace study_test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

/// The one encoding, format and size of a case.
struct FormatCase {
  const char* name;
  DicomEncoding encoding;
  unsigned bitsStored;
  bool isSigned;
  bool inverted;
  int width;  ///< odd widths make odd numbers of bytes, with the odd height of 37
};

void PrintTo(const FormatCase& format, std::ostream* out) {
  *out << format.name;
}

class DicomFormats : public testing::TestWithParam<FormatCase> {};

/// A study whose values fit the format: real values from -1024, or from -100 in 8 bits.
std::unique_ptr<Study> StudyFor(const FormatCase& format) {
  auto study = MakePatternStudy(format.width, 37, 3);
  if (format.bitsStored == 8) {
    study->offset = format.isSigned ? -100 : 3;
    for (dSlice& slice : study->volume.GetSliceList()) {
      for (std::uint16_t& sample : SamplesOf(slice)) {
        sample = static_cast<std::uint16_t>(sample % 201);
      }
    }
  }
  SamplesOf(*study->volume.GetSlice(0))[0] = 0;
  return study;
}

TEST_P(DicomFormats, KeepsEveryRealValue) {
  const FormatCase& format = GetParam();
  const TestFolder folder;
  const auto study = StudyFor(format);
  DicomWriteOptions options;
  options.encoding = format.encoding;
  options.bitsStored = format.bitsStored;
  options.isSigned = format.isSigned;
  options.inverted = format.inverted;
  WriteDicomSeries(*study, folder / "out", options);

  LoadReport report;
  const auto loaded = Load(folder / "out", report);
  EXPECT_THAT(report.notes, IsEmpty());
  EXPECT_THAT(Refusals(report), IsEmpty());
  EXPECT_EQ(RealValues(*loaded), RealValues(*study));
  EXPECT_EQ(StoredValues(*loaded), StoredValues(*study)) << "the smallest value is stored as 0";
  EXPECT_EQ(loaded->offset, study->offset);
}

constexpr FormatCase kFormats[] = {
    {"Unsigned16", DicomEncoding::ExplicitLittle, 16, false, false, 6},
    {"Signed16", DicomEncoding::ExplicitLittle, 16, true, false, 6},
    {"Unsigned12", DicomEncoding::ExplicitLittle, 12, false, false, 7},
    {"Signed13", DicomEncoding::ExplicitLittle, 13, true, false, 7},
    {"Unsigned8Odd", DicomEncoding::ExplicitLittle, 8, false, false, 7},
    {"Signed8Odd", DicomEncoding::ExplicitLittle, 8, true, false, 7},
    {"Inverted12", DicomEncoding::ExplicitLittle, 12, false, true, 6},
    {"InvertedSigned16", DicomEncoding::ExplicitLittle, 16, true, true, 6},
    {"Inverted8", DicomEncoding::ExplicitLittle, 8, false, true, 7},
    {"ImplicitSigned16", DicomEncoding::ImplicitLittle, 16, true, false, 6},
    {"ImplicitUnsigned8Odd", DicomEncoding::ImplicitLittle, 8, false, false, 7},
    {"BigEndianSigned16", DicomEncoding::ExplicitBig, 16, true, false, 6},
    {"BigEndianUnsigned12", DicomEncoding::ExplicitBig, 12, false, false, 7},
    {"BigEndianUnsigned8Odd", DicomEncoding::ExplicitBig, 8, false, false, 7},
    {"RleUnsigned16", DicomEncoding::Rle, 16, false, false, 7},
    {"RleSigned16", DicomEncoding::Rle, 16, true, false, 6},
    {"RleUnsigned8Odd", DicomEncoding::Rle, 8, false, false, 7},
    {"RleInverted12", DicomEncoding::Rle, 12, false, true, 6},
    {"JpegUnsigned16", DicomEncoding::JpegLossless, 16, false, false, 7},
    {"JpegSigned16", DicomEncoding::JpegLossless, 16, true, false, 6},
    {"JpegUnsigned12", DicomEncoding::JpegLossless, 12, false, false, 6},
    {"JpegUnsigned8Odd", DicomEncoding::JpegLossless, 8, false, false, 7},
    {"JpegInverted12", DicomEncoding::JpegLossless, 12, false, true, 6},
    {"JpegLsUnsigned16", DicomEncoding::JpegLsLossless, 16, false, false, 31},
    {"JpegLsSigned16", DicomEncoding::JpegLsLossless, 16, true, false, 30},
    {"JpegLsUnsigned12", DicomEncoding::JpegLsLossless, 12, false, false, 30},
    {"JpegLsUnsigned8Odd", DicomEncoding::JpegLsLossless, 8, false, false, 31},
};

INSTANTIATE_TEST_SUITE_P(All, DicomFormats, testing::ValuesIn(kFormats),
                         [](const auto& test) { return std::string(test.param.name); });

/// A series of three 4 x 4 slices, written with default options and changed by the test.
class DicomValues : public testing::Test {
 protected:
  DicomValues() : m_study(MakePatternStudy(4, 4, 3)) { Write({}); }

  void Write(const DicomWriteOptions& options) {
    fs::remove_all(m_folder / "out");
    m_files = WriteDicomSeries(*m_study, m_folder / "out", options);
  }
  void SetAll(const DcmTagKey& tag, const std::string& value) {
    for (const fs::path& file : m_files) {
      SetAttribute(file, tag, value);
    }
  }
  std::unique_ptr<Study> LoadAll() { return Load(m_folder / "out", m_report); }

  TestFolder m_folder;
  std::unique_ptr<Study> m_study;
  std::vector<fs::path> m_files;
  LoadReport m_report;
};

TEST_F(DicomValues, SlopeBecomesTheScale) {
  SetAll(DCM_RescaleSlope, "0.25");
  SetAll(DCM_RescaleIntercept, "-7");
  const auto loaded = LoadAll();
  EXPECT_EQ(loaded->scale, 0.25);
  EXPECT_EQ(loaded->offset, -7);
  EXPECT_EQ(StoredValues(*loaded), StoredValues(*m_study));
}

TEST_F(DicomValues, MissingSlopeAndInterceptMeanTheSamplesThemselves) {
  for (const fs::path& file : m_files) {
    RemoveAttribute(file, DCM_RescaleSlope);
    RemoveAttribute(file, DCM_RescaleIntercept);
  }
  const auto loaded = LoadAll();
  EXPECT_EQ(loaded->scale, 1);
  EXPECT_EQ(loaded->offset, 0);
}

TEST_F(DicomValues, InterceptsThatDifferAreKeptExactly) {
  SetAttribute(m_files[1], DCM_RescaleIntercept, "-1000");
  const auto loaded = LoadAll();
  EXPECT_THAT(m_report.notes, IsEmpty());
  const auto expected = RealValues(*m_study);
  const auto values = RealValues(*loaded);
  for (std::size_t i = 0; i < values.size(); ++i) {
    ASSERT_EQ(values[i], expected[i] + (i >= 16 && i < 32 ? 24 : 0)) << i;
  }
}

TEST_F(DicomValues, SlopesThatDifferAreBroughtToOneScaleAndTold) {
  DicomWriteOptions options;
  options.isSigned = true;
  options.sliceSlopes = {0.5, 0.25, 2};
  Write(options);
  const auto loaded = LoadAll();
  ASSERT_EQ(m_report.notes.size(), 1u);
  const double error = loaded->scale / 2;
  char text[200];
  std::snprintf(text, sizeof text,
                "the slices are scaled differently: values were brought to one scale, with an "
                "error of at most %.3g HU",
                error);
  EXPECT_EQ(m_report.notes[0], text);
  EXPECT_LT(error, 0.03);
  const auto expected = RealValues(*m_study);
  const auto values = RealValues(*loaded);
  for (std::size_t i = 0; i < values.size(); ++i) {
    const double written = i < 32 ? 0 : 1;  // slope 2 rounds odd values by one
    ASSERT_NEAR(values[i], expected[i], written + error * 1.001) << i;
  }
}

TEST_F(DicomValues, UnitFollowsRescaleTypeThenModality) {
  EXPECT_EQ(LoadAll()->unit, "HU");
  SetAll(DCM_RescaleType, "mGy");
  EXPECT_EQ(LoadAll()->unit, "mGy");
  SetAll(DCM_RescaleType, "US");
  EXPECT_EQ(LoadAll()->unit, "HU");
  SetAll(DCM_Modality, "MR");
  EXPECT_EQ(LoadAll()->unit, "");
  SetAll(DCM_Modality, "PT");
  SetAll(DCM_Units, "BQML");
  EXPECT_EQ(LoadAll()->unit, "BQML");
}

TEST_F(DicomValues, WindowModalityAndDescriptionTravel) {
  const auto loaded = LoadAll();
  EXPECT_EQ(loaded->windowCentre, 50);
  EXPECT_EQ(loaded->windowWidth, 350);
  EXPECT_EQ(loaded->modality, "CT");
  EXPECT_EQ(loaded->description, "Pattern");
}

TEST_F(DicomValues, FirstOfSeveralWindowsIsTaken) {
  SetAll(DCM_WindowCenter, "40\\80");
  SetAll(DCM_WindowWidth, "80\\90");
  const auto loaded = LoadAll();
  EXPECT_EQ(loaded->windowCentre, 40);
  EXPECT_EQ(loaded->windowWidth, 80);
}

TEST_F(DicomValues, ImpossibleWindowIsNoWindow) {
  SetAll(DCM_WindowWidth, "0");
  EXPECT_EQ(LoadAll()->windowWidth, 0);
}

TEST_F(DicomValues, WindowOfAnInvertedSeriesIsMirrored) {
  DicomWriteOptions options;
  options.inverted = true;
  options.bitsStored = 12;
  Write(options);
  SetAll(DCM_WindowCenter, "0");
  SetAll(DCM_WindowWidth, "100");
  // 12 bits with intercept -1024 hold -1024 to 3071: 0 lies where 2047 was.
  EXPECT_EQ(LoadAll()->windowCentre, 2047);
}

TEST_F(DicomValues, TextsComeInUtf8WithoutControlCharacters) {
  if (!DcmSpecificCharacterSet::isConversionAvailable()) {
    GTEST_SKIP() << "this build of DCMTK converts no texts";
  }
  EditDicom(m_files[0], [](DcmDataset& dataset) {
    dataset.putAndInsertString(DCM_SpecificCharacterSet, "ISO_IR 100");
    dataset.putAndInsertString(DCM_SeriesDescription,
                               "Sch\xE4"
                               "del\tnativ");
  });
  EXPECT_EQ(LoadAll()->description,
            "Sch\xC3\xA4"
            "del nativ");
}

TEST_F(DicomValues, LookupTableIsTold) {
  for (const fs::path& file : m_files) {
    EditDicom(file, [](DcmDataset& dataset) {
      DcmItem* item = nullptr;
      dataset.findOrCreateSequenceItem(DCM_ModalityLUTSequence, item);
      item->putAndInsertString(DCM_LUTExplanation, "test");
    });
  }
  LoadAll();
  EXPECT_THAT(m_report.notes,
              ElementsAre("the files hold a modality lookup table, which is not applied"));
}

}  // namespace
