#include "DicomEdit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/DicomLoader.h>
#include <study/DicomWriter.h>
#include <study/dicom/Codecs.h>

#include <dcmtk/dcmdata/dcrleerg.h>

using namespace study;
using namespace study_test;
using testing::IsEmpty;

namespace {

constexpr int kWidth = 40;  // not too small for the JPEG-LS encoder
constexpr int kHeight = 30;
constexpr int kFrames = 3;

/// The value of a sample, from the frame it stands in.
std::uint16_t FrameValue(int frame, int at) {
  return static_cast<std::uint16_t>(1000 * frame + at);
}

void AddFrameGroups(DcmDataset& dataset, int frame, double z) {
  DcmItem* item = nullptr;
  DcmItem* position = nullptr;
  dataset.findOrCreateSequenceItem(DCM_PerFrameFunctionalGroupsSequence, item, frame);
  item->findOrCreateSequenceItem(DCM_PlanePositionSequence, position);
  const std::string text = "10\\20\\" + std::to_string(z);
  position->putAndInsertString(DCM_ImagePositionPatient, text.c_str());
}

void AddSharedGroups(DcmDataset& dataset) {
  DcmItem* shared = nullptr;
  DcmItem* group = nullptr;
  dataset.findOrCreateSequenceItem(DCM_SharedFunctionalGroupsSequence, shared);
  shared->findOrCreateSequenceItem(DCM_PlaneOrientationSequence, group);
  group->putAndInsertString(DCM_ImageOrientationPatient, "1\\0\\0\\0\\1\\0");
  shared->findOrCreateSequenceItem(DCM_PixelMeasuresSequence, group);
  group->putAndInsertString(DCM_PixelSpacing, "3\\2");
  shared->findOrCreateSequenceItem(DCM_PixelValueTransformationSequence, group);
  group->putAndInsertString(DCM_RescaleSlope, "1");
  group->putAndInsertString(DCM_RescaleIntercept, "-1000");
  shared->findOrCreateSequenceItem(DCM_FrameVOILUTSequence, group);
  group->putAndInsertString(DCM_WindowCenter, "30");
  group->putAndInsertString(DCM_WindowWidth, "60");
}

/// A file with all slices; frame 0 lies highest. Without groups the frames lie nowhere.
void WriteFrames(const fs::path& path, bool withGroups, E_TransferSyntax syntax) {
  RegisterDicomCodecs();
  DcmFileFormat file;
  DcmDataset& dataset = *file.getDataset();
  dataset.putAndInsertString(DCM_SOPClassUID, UID_EnhancedCTImageStorage);
  dataset.putAndInsertString(DCM_SOPInstanceUID, "2.25.1");
  dataset.putAndInsertString(DCM_SeriesInstanceUID, "2.25.2");
  dataset.putAndInsertString(DCM_Modality, "CT");
  dataset.putAndInsertUint16(DCM_SamplesPerPixel, 1);
  dataset.putAndInsertString(DCM_PhotometricInterpretation, "MONOCHROME2");
  dataset.putAndInsertString(DCM_NumberOfFrames, std::to_string(kFrames).c_str());
  dataset.putAndInsertUint16(DCM_Rows, kHeight);
  dataset.putAndInsertUint16(DCM_Columns, kWidth);
  dataset.putAndInsertUint16(DCM_BitsAllocated, 16);
  dataset.putAndInsertUint16(DCM_BitsStored, 16);
  dataset.putAndInsertUint16(DCM_HighBit, 15);
  dataset.putAndInsertUint16(DCM_PixelRepresentation, 0);
  std::vector<Uint16> samples;
  for (int frame = 0; frame < kFrames; ++frame) {
    for (int at = 0; at < kWidth * kHeight; ++at) {
      samples.push_back(FrameValue(frame, at));
    }
    if (withGroups) {
      AddFrameGroups(dataset, frame, 50 - 5.0 * frame);
    }
  }
  if (withGroups) {
    AddSharedGroups(dataset);
  }
  dataset.putAndInsertUint16Array(DCM_PixelData, samples.data(),
                                  static_cast<unsigned long>(samples.size()));
  dataset.chooseRepresentation(syntax, nullptr);
  ASSERT_TRUE(file.saveFile(OFFilename(path.c_str()), syntax).good());
}

class DicomFrames : public testing::TestWithParam<E_TransferSyntax> {};

TEST_P(DicomFrames, BecomeSlicesWithTheirOwnPositions) {
  const TestFolder folder;
  WriteFrames(folder / "a.dcm", true, GetParam());
  LoadReport report;
  const auto study = LoadDicom({folder / "a.dcm"}, "", report);
  EXPECT_THAT(report.notes, IsEmpty());
  EXPECT_THAT(Refusals(report), IsEmpty());
  ASSERT_EQ(study->volume.GetSizeZ(), kFrames);
  EXPECT_EQ(study->offset, -1000);
  EXPECT_EQ(study->windowCentre, 30);
  EXPECT_EQ(ToVec3(study->volume.GetCoordinates().axisX), (Vec3{2, 0, 0}));
  EXPECT_EQ(ToVec3(study->volume.GetCoordinates().axisY), (Vec3{0, 3, 0}));
  EXPECT_EQ(ToVec3(study->volume.GetCoordinates().axisZ), (Vec3{0, 0, 5}));
  for (int k = 0; k < kFrames; ++k) {
    for (int at = 0; at < kWidth * kHeight; ++at) {
      EXPECT_EQ(SamplesOf(*study->volume.GetSlice(k))[static_cast<std::size_t>(at)],
                FrameValue(kFrames - 1 - k, at));
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Encodings, DicomFrames,
                         testing::Values(EXS_LittleEndianExplicit, EXS_RLELossless,
                                         EXS_JPEGLSLossless));

TEST(DicomFramesDamage, FramesWithoutPositionsAreRefused) {
  const TestFolder folder;
  WriteFrames(folder / "a.dcm", false, EXS_LittleEndianExplicit);
  LoadReport report;
  EXPECT_EQ(ErrorOf([&] { LoadDicom({folder / "a.dcm"}, "", report); }),
            "'" + (folder / "a.dcm").string() +
                "': 3 frames in one file that does not say where each lies");
}

TEST(DicomFramesDamage, AnnouncedFramesMustBeThere) {
  const TestFolder folder;
  const fs::path path = folder / "a.dcm";
  WriteFrames(path, true, EXS_LittleEndianExplicit);
  const auto error = [&](const char* frames) {
    SetAttribute(path, DCM_NumberOfFrames, frames);
    LoadReport report;
    return ErrorOf([&] { LoadDicom({path}, "", report); });
  };
  const std::string name = "'" + path.string() + "': ";
  EXPECT_EQ(error("2"), name + "2 frames in one file that does not say where each lies");
  EXPECT_EQ(error("2000000000"), name + "it announces 2000000000 frames");
  EXPECT_EQ(error("-1"), name + "it announces -1 frames");
  EXPECT_EQ(error("0"), name + "it announces 0 frames");
}

TEST(DicomFramesDamage, FramesBeyondThePixelsAreRefused) {
  const TestFolder folder;
  const fs::path path = folder / "a.dcm";
  WriteFrames(path, true, EXS_LittleEndianExplicit);
  EditDicom(path, [](DcmDataset& dataset) {
    const std::vector<Uint16> samples(kWidth * kHeight * 2);
    dataset.putAndInsertUint16Array(DCM_PixelData, samples.data(),
                                    static_cast<unsigned long>(samples.size()));
  });
  LoadReport report;
  const auto study = LoadDicom({path}, "", report);
  EXPECT_EQ(study->volume.GetSizeZ(), 2);
  EXPECT_EQ(
      Refusals(report),
      std::vector<std::string>{"a.dcm: its pixel data is too short: 4800 bytes instead of 7200"});
}

}  // namespace
