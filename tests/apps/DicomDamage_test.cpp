#include "DicomEdit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/DicomLoader.h>
#include <study/DicomWriter.h>

#include <random>

using namespace study;
using namespace study_test;
using testing::AnyOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

/// One good 40 x 30 file and what loading a damaged version of it says.
class DicomDamage : public testing::Test {
 protected:
  DicomDamage() { Write(DicomEncoding::ExplicitLittle); }

  void Write(DicomEncoding encoding) {
    fs::remove_all(m_folder / "in");
    DicomWriteOptions options;
    options.encoding = encoding;
    m_file = WriteDicomSeries(*MakePatternStudy(40, 30, 1), m_folder / "in", options)[0];
    m_good = ReadBytes(m_file);
  }

  /// What is said after the file's name; "no error" when the file is loaded.
  std::string LoadingSays() {
    LoadReport report;
    const std::string text = ErrorOf([&] { LoadDicom({m_file}, "", report); });
    const std::string prefix = "'" + m_file.string() + "': ";
    return text.rfind(prefix, 0) == 0 ? text.substr(prefix.size()) : text;
  }
  std::string LoadingSays(const std::string& bytes) {
    WriteBytes(m_file, bytes);
    return LoadingSays();
  }
  /// The same with one attribute changed.
  std::string WithAttribute(const DcmTagKey& tag, const std::string& value) {
    WriteBytes(m_file, m_good);
    SetAttribute(m_file, tag, value);
    return LoadingSays();
  }
  std::string Without(const DcmTagKey& tag) {
    WriteBytes(m_file, m_good);
    RemoveAttribute(m_file, tag);
    return LoadingSays();
  }

  TestFolder m_folder;
  fs::path m_file;
  std::string m_good;
};

TEST_F(DicomDamage, TheGoodFileIsLoaded) {
  EXPECT_EQ(LoadingSays(), "no error");
}

TEST_F(DicomDamage, CutAtEveryByteIsAnError) {
  for (std::size_t size = 0; size < m_good.size(); ++size) {
    ASSERT_THAT(
        LoadingSays(m_good.substr(0, size)),
        AnyOf(StartsWith("the file is cut short or damaged ("), StartsWith("it is no DICOM file"),
              StartsWith("it holds no pixel data"), StartsWith("it has no ")))
        << size;
  }
}

TEST_F(DicomDamage, CompressedFilesCutAnywhereAreErrors) {
  for (const DicomEncoding encoding :
       {DicomEncoding::Rle, DicomEncoding::JpegLossless, DicomEncoding::JpegLsLossless}) {
    Write(encoding);
    for (std::size_t size = 132; size + 8 < m_good.size(); size += 7) {
      ASSERT_NE(LoadingSays(m_good.substr(0, size)), "no error")
          << static_cast<int>(encoding) << ", " << size;
    }
  }
}

TEST_F(DicomDamage, RandomBytesNeverDoHarm) {
  // Nothing is asked of the result but that there is one.
  std::mt19937 random(12345);
  int loaded = 0;
  for (const DicomEncoding encoding :
       {DicomEncoding::ExplicitLittle, DicomEncoding::ImplicitLittle, DicomEncoding::ExplicitBig,
        DicomEncoding::Rle, DicomEncoding::JpegLossless, DicomEncoding::JpegLsLossless}) {
    Write(encoding);
    for (int round = 0; round < 150; ++round) {
      std::string bytes = m_good;
      const int changes = 1 + round % 6;
      for (int i = 0; i < changes; ++i) {
        bytes[132 + random() % (bytes.size() - 132)] = static_cast<char>(random());
      }
      loaded += LoadingSays(bytes) == "no error" ? 1 : 0;
    }
  }
  EXPECT_GT(loaded, 0) << "changed samples are no damage that can be seen";
  EXPECT_LT(loaded, 6 * 150);
}

TEST_F(DicomDamage, MissingAttributesAreNamed) {
  EXPECT_EQ(Without(DCM_Rows), "it has no Rows (0028,0010)");
  EXPECT_EQ(Without(DCM_Columns), "it has no Columns (0028,0011)");
  EXPECT_EQ(Without(DCM_BitsAllocated), "it has no BitsAllocated (0028,0100)");
  EXPECT_EQ(Without(DCM_BitsStored), "it has no BitsStored (0028,0101)");
  EXPECT_EQ(Without(DCM_PixelData), "it holds no pixel data");
  EXPECT_EQ(Without(DCM_ImageOrientationPatient),
            "it has a position but no ImageOrientationPatient (0020,0037)");
}

TEST_F(DicomDamage, AttributesThatCanBeDoneWithoutAre) {
  for (const DcmTagKey& tag :
       {DCM_SeriesInstanceUID, DCM_SeriesNumber, DCM_InstanceNumber, DCM_Modality, DCM_HighBit,
        DCM_PixelRepresentation, DCM_SamplesPerPixel, DCM_RescaleSlope, DCM_RescaleIntercept,
        DCM_SliceThickness, DCM_WindowCenter, DCM_SeriesDescription}) {
    EXPECT_EQ(Without(tag), "no error") << tag.toString().c_str();
  }
}

TEST_F(DicomDamage, AbsurdSizesAreRefused) {
  EXPECT_EQ(WithAttribute(DCM_Rows, "0"), "an image of 40 x 0 pixels");
  EXPECT_EQ(WithAttribute(DCM_Columns, "0"), "an image of 0 x 30 pixels");
  EXPECT_EQ(WithAttribute(DCM_Rows, "65535"), "an image of 40 x 65535 pixels");
  EXPECT_EQ(WithAttribute(DCM_Columns, "32768"), "an image of 32768 x 30 pixels");
}

TEST_F(DicomDamage, PixelDataShorterThanAnnouncedIsRefused) {
  EXPECT_EQ(WithAttribute(DCM_Rows, "31"),
            "its pixel data is too short: 2400 bytes instead of 2480");
  WriteBytes(m_file, m_good);
  EditDicom(m_file, [](DcmDataset& dataset) {
    dataset.putAndInsertUint16(DCM_Rows, 32767);
    dataset.putAndInsertUint16(DCM_Columns, 32767);
  });
  EXPECT_EQ(LoadingSays(), "its pixel data is too short: 2400 bytes instead of 2147352578");
}

TEST_F(DicomDamage, CompressedPixelsCannotClaimGigabytes) {
  for (const DicomEncoding encoding :
       {DicomEncoding::Rle, DicomEncoding::JpegLossless, DicomEncoding::JpegLsLossless}) {
    Write(encoding);
    EditDicom(m_file, [](DcmDataset& dataset) {
      dataset.putAndInsertUint16(DCM_Rows, 32767);
      dataset.putAndInsertUint16(DCM_Columns, 32767);
    });
    EXPECT_THAT(LoadingSays(), StartsWith("its compressed pixel data is too short: "));
  }
}

TEST_F(DicomDamage, CompressedPicturesOfAnotherSizeAreRefused) {
  for (const DicomEncoding encoding :
       {DicomEncoding::JpegLossless, DicomEncoding::JpegLsLossless}) {
    Write(encoding);
    EXPECT_EQ(WithAttribute(DCM_Rows, "29"),
              "its compressed pixel data is damaged (it is 40 x 30 pixels instead of 40 x 29)");
    EXPECT_EQ(WithAttribute(DCM_Columns, "41"),
              "its compressed pixel data is damaged (it is 40 x 30 pixels instead of 41 x 30)");
  }
}

TEST_F(DicomDamage, ImpossibleSamplesAreRefused) {
  EXPECT_EQ(WithAttribute(DCM_BitsAllocated, "32"),
            "unsupported samples: 32 bits allocated, 16 stored, high bit 15");
  EXPECT_EQ(WithAttribute(DCM_BitsAllocated, "1"),
            "unsupported samples: 1 bits allocated, 16 stored, high bit 15");
  EXPECT_EQ(WithAttribute(DCM_BitsStored, "0"),
            "unsupported samples: 16 bits allocated, 0 stored, high bit 15");
  EXPECT_EQ(WithAttribute(DCM_BitsStored, "17"),
            "unsupported samples: 16 bits allocated, 17 stored, high bit 15");
  EXPECT_EQ(WithAttribute(DCM_HighBit, "65535"),
            "unsupported samples: 16 bits allocated, 16 stored, high bit 65535");
}

TEST_F(DicomDamage, ColourImagesAreRefused) {
  EXPECT_EQ(WithAttribute(DCM_PhotometricInterpretation, "RGB"),
            "a colour image (RGB); only grey images make a volume");
  EXPECT_EQ(WithAttribute(DCM_PhotometricInterpretation, "PALETTE COLOR"),
            "a colour image (PALETTE COLOR); only grey images make a volume");
  EXPECT_EQ(WithAttribute(DCM_SamplesPerPixel, "3"),
            "a colour image (MONOCHROME2); only grey images make a volume");
}

TEST_F(DicomDamage, ImpossibleNumbersAreNamed) {
  EXPECT_EQ(WithAttribute(DCM_PixelSpacing, "abc\\1"),
            "the value 'abc\\1' of PixelSpacing (0028,0030) is not valid");
  EXPECT_EQ(WithAttribute(DCM_PixelSpacing, "0\\1"),
            "the value of PixelSpacing (0028,0030) is not valid");
  EXPECT_EQ(WithAttribute(DCM_PixelSpacing, "1\\-1"),
            "the value of PixelSpacing (0028,0030) is not valid");
  EXPECT_EQ(WithAttribute(DCM_PixelSpacing, "1e300\\1"),
            "the value of PixelSpacing (0028,0030) is not valid");
  EXPECT_THAT(WithAttribute(DCM_PixelSpacing, "1"), HasSubstr("PixelSpacing (0028,0030)"));
  EXPECT_THAT(WithAttribute(DCM_ImagePositionPatient, "1\\2"),
              HasSubstr("ImagePositionPatient (0020,0032)"));
  EXPECT_EQ(WithAttribute(DCM_ImagePositionPatient, "1\\2\\1e99"),
            "the value of ImagePositionPatient (0020,0032) is not valid");
  EXPECT_EQ(WithAttribute(DCM_ImageOrientationPatient, "1\\0\\0\\1\\0\\0"),
            "the value of ImageOrientationPatient (0020,0037) is not a pair of perpendicular "
            "directions");
  EXPECT_EQ(WithAttribute(DCM_ImageOrientationPatient, "0\\0\\0\\0\\0\\0"),
            "the value of ImageOrientationPatient (0020,0037) is not a pair of perpendicular "
            "directions");
  EXPECT_EQ(WithAttribute(DCM_RescaleSlope, "0"),
            "the value of RescaleSlope (0028,1053) is not valid");
  EXPECT_EQ(WithAttribute(DCM_RescaleIntercept, "1e200"),
            "the value of RescaleIntercept (0028,1052) is not valid");
}

TEST_F(DicomDamage, NumbersThatAreNoNumbersAreNamed) {
  EXPECT_THAT(WithAttribute(DCM_RescaleSlope, "nan"), HasSubstr("RescaleSlope (0028,1053)"));
  EXPECT_THAT(WithAttribute(DCM_RescaleIntercept, "inf"),
              HasSubstr("RescaleIntercept (0028,1052)"));
}

TEST_F(DicomDamage, UnsupportedTransferSyntaxesAreNamed) {
  Write(DicomEncoding::JpegLossless);
  const std::string own = "1.2.840.10008.1.2.4.70";
  const auto with = [&](const std::string& other) {
    std::string bytes = m_good;
    bytes.replace(bytes.find(own), own.size(), other);
    return LoadingSays(bytes);
  };
  EXPECT_EQ(with("1.2.840.10008.1.2.4.90"),
            "its transfer syntax 'JPEG 2000 (Lossless only)' (1.2.840.10008.1.2.4.90) is not "
            "supported");
  EXPECT_EQ(with("1.2.840.10008.1.2.4.91"),
            "its transfer syntax 'JPEG 2000 (Lossless or Lossy)' (1.2.840.10008.1.2.4.91) is not "
            "supported");
  EXPECT_EQ(with("1.2.840.10008.1.2.4.ab"),
            "its transfer syntax 'unknown' (1.2.840.10008.1.2.4.ab) is not supported");
}

TEST_F(DicomDamage, DeflatedDataSetsAreNotSupported) {
  DcmFileFormat file;
  file.loadFile(OFFilename(m_file.c_str()));
  file.loadAllDataIntoMemory();
  file.saveFile(OFFilename(m_file.c_str()), EXS_DeflatedLittleEndianExplicit);
  EXPECT_EQ(LoadingSays(),
            "its transfer syntax 'Deflated Explicit VR Little Endian' (1.2.840.10008.1.2.1.99) is "
            "not supported");
}

TEST_F(DicomDamage, LyingLengthsAreRefusedWithoutMemory) {
  // Pixel data: tag 7FE0,0010, VR OW, two reserved bytes, then the length.
  const std::string pixels("\xE0\x7F\x10\0OW\0\0", 8);
  for (const char* const length : {"\xFE\xFF\xFF\xFF", "\xFE\xFF\xFF\x7F", "\x62\x09\0\0"}) {
    std::string bytes = m_good;
    bytes.replace(bytes.find(pixels) + 8, 4, std::string(length, 4));
    EXPECT_NE(LoadingSays(bytes), "no error");
  }
}

TEST_F(DicomDamage, OneBadFileOfAFolderIsNamedAndTheRestLoaded) {
  const auto files = WriteDicomSeries(*MakePatternStudy(4, 3, 4), m_folder / "series");
  const std::string bytes = ReadBytes(files[3]);
  WriteBytes(files[3], bytes.substr(0, bytes.size() - 10));
  LoadReport report;
  EXPECT_EQ(Load(m_folder / "series", report)->volume.GetSizeZ(), 3);
  ASSERT_EQ(report.refused.size(), 1u);
  EXPECT_THAT(RefusalText(report.refused[0]),
              StartsWith("'" + files[3].string() + "': the file is cut short or damaged ("));
}

TEST_F(DicomDamage, OtherKindsOfDicomInAFolderAreLeftOut) {
  const auto files = WriteDicomSeries(*MakePatternStudy(4, 3, 3), m_folder / "series");
  RemoveAttribute(files[2], DCM_PixelData);
  LoadReport report;
  EXPECT_EQ(Load(m_folder / "series", report)->volume.GetSizeZ(), 2);
  EXPECT_THAT(Refusals(report), ElementsAre("S001-00003.dcm: it holds no pixel data"));
  EXPECT_EQ(report.refused[0].seriesUid, report.series[0].uid);
}

TEST_F(DicomDamage, SeveralUselessFilesAreCounted) {
  const auto files = WriteDicomSeries(*MakePatternStudy(4, 3, 3), m_folder / "series");
  for (const fs::path& file : files) {
    RemoveAttribute(file, DCM_PixelData);
  }
  EXPECT_EQ(ErrorOf([&] { Load(m_folder / "series"); }),
            "'" + files[0].string() + "': it holds no pixel data (and 2 more can't be used)");
}

}  // namespace
