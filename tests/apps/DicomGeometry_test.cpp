#include "DicomEdit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/DicomWriter.h>

#include <cmath>

using namespace study;
using namespace study_test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

void ExpectNear(const Vec3& a, const Vec3& b, const char* what) {
  EXPECT_NEAR(a.x, b.x, 1e-4) << what;
  EXPECT_NEAR(a.y, b.y, 1e-4) << what;
  EXPECT_NEAR(a.z, b.z, 1e-4) << what;
}

void ExpectPlacement(const Study& study, const Vec3& first, const Vec3& x, const Vec3& y,
                     const Vec3& z) {
  ExpectNear(WorldFromVoxel(study, {0.5, 0.5, 0.5}), first, "centre of the first voxel");
  ExpectNear(ToVec3(study.volume.GetCoordinates().axisX), x, "axis x");
  ExpectNear(ToVec3(study.volume.GetCoordinates().axisY), y, "axis y");
  ExpectNear(ToVec3(study.volume.GetCoordinates().axisZ), z, "axis z");
}

/// A series of 4 x 3 pixel slices in a folder of its own.
class DicomGeometry : public testing::Test {
 protected:
  void Write(const Study& study) { m_files = WriteDicomSeries(study, m_folder / "out"); }
  void WritePattern(int slices) {
    m_study = MakePatternStudy(4, 3, slices);
    Write(*m_study);
  }
  std::unique_ptr<Study> LoadAll() { return Load(m_folder / "out", m_report); }
  void RemoveFromAll(const DcmTagKey& tag) {
    for (const fs::path& file : m_files) {
      RemoveAttribute(file, tag);
    }
  }

  TestFolder m_folder;
  std::unique_ptr<Study> m_study;
  std::vector<fs::path> m_files;
  LoadReport m_report;
};

TEST_F(DicomGeometry, PositionIsTheCentreOfTheFirstVoxel) {
  WritePattern(3);
  const auto loaded = LoadAll();
  ExpectPlacement(*loaded, {10, 20, 30}, {2, 0, 0}, {0, 3, 0}, {0, 0, 5});
  ExpectNear(ToVec3(loaded->volume.GetCoordinates().origin), {9, 18.5, 27.5}, "outer corner");
  EXPECT_THAT(m_report.notes, IsEmpty());
}

TEST_F(DicomGeometry, ObliqueAxesAreKept) {
  const auto study = MakePatternStudy(4, 3, 3);
  const Vec3 x = 0.7 * Normalised({1, 0.5, -0.2});
  const Vec3 y = 0.9 * Normalised(Cross({0.3, -0.1, 1}, x));
  const Vec3 z = 1.3 * Normalised(Cross(x, y));
  PlaceVolume(*study, {-100, 50, 900}, x, y, z);
  Write(*study);
  ExpectPlacement(*LoadAll(), {-100, 50, 900}, x, y, z);
}

TEST_F(DicomGeometry, GantryTiltIsKept) {
  const auto study = MakePatternStudy(4, 3, 3);
  PlaceVolume(*study, {0, 0, 0}, {2, 0, 0}, {0, 3, 0}, {0, 1.5, 5});
  Write(*study);
  ExpectPlacement(*LoadAll(), {0, 0, 0}, {2, 0, 0}, {0, 3, 0}, {0, 1.5, 5});
  EXPECT_THAT(m_report.notes, IsEmpty());
}

TEST_F(DicomGeometry, PixelSpacingIsRowSpacingFirst) {
  WritePattern(1);
  SetAttribute(m_files[0], DCM_PixelSpacing, "0.5\\0.25");
  const auto loaded = LoadAll();
  ExpectNear(ToVec3(loaded->volume.GetCoordinates().axisX), {0.25, 0, 0}, "along a row");
  ExpectNear(ToVec3(loaded->volume.GetCoordinates().axisY), {0, 0.5, 0}, "down a column");
}

TEST_F(DicomGeometry, SlicesAreSortedByPositionNotByName) {
  WritePattern(3);
  fs::rename(m_files[0], m_folder / "out/z.dcm");
  fs::rename(m_files[2], m_folder / "out/a.dcm");
  EXPECT_EQ(RealValues(*LoadAll()), RealValues(*m_study));
}

TEST_F(DicomGeometry, StackGrowsAlongTheNormalOfItsSlices) {
  // The slices of a left-handed volume lie against their normal: their order is turned round.
  const auto study = MakePatternStudy(4, 3, 3);
  PlaceVolume(*study, {0, 0, 0}, {2, 0, 0}, {0, 3, 0}, {0, 0, -5});
  Write(*study);
  const auto loaded = LoadAll();
  ExpectPlacement(*loaded, {0, 0, -10}, {2, 0, 0}, {0, 3, 0}, {0, 0, 5});
  EXPECT_EQ(loaded->RealValue(SamplesOf(*loaded->volume.GetSlice(0))[0]),
            PatternValue(0, 0, 2) - 1024);
}

TEST_F(DicomGeometry, MissingSliceIsToldAndTheMeanUsed) {
  WritePattern(5);
  fs::remove(m_files[2]);
  const auto loaded = LoadAll();
  EXPECT_EQ(loaded->volume.GetSizeZ(), 4);
  EXPECT_THAT(m_report.notes, ElementsAre("1 slice is missing between 35 and 45 mm",
                                          "the mean distance of 6.667 mm is used for all slices"));
  ExpectNear(ToVec3(loaded->volume.GetCoordinates().axisZ), {0, 0, 20.0 / 3}, "axis z");
}

TEST_F(DicomGeometry, UnequalDistancesAreTold) {
  WritePattern(4);
  SetAttribute(m_files[3], DCM_ImagePositionPatient, "10\\20\\46.5");
  LoadAll();
  EXPECT_THAT(m_report.notes,
              ElementsAre("the slices between 40 and 46.5 mm are 6.5 mm apart instead of 5 mm",
                          "the mean distance of 5.5 mm is used for all slices"));
}

TEST_F(DicomGeometry, RepeatedPositionsAreLeftOutAndNamed) {
  WritePattern(3);
  SetAttribute(m_files[2], DCM_ImagePositionPatient, "10\\20\\35");
  const auto loaded = LoadAll();
  EXPECT_EQ(loaded->volume.GetSizeZ(), 2);
  EXPECT_THAT(Refusals(m_report),
              ElementsAre("S001-00003.dcm: it repeats the position 35 mm of 'S001-00002.dcm'"));
}

TEST_F(DicomGeometry, SingleSliceIsAsThickAsItSays) {
  WritePattern(1);
  SetAttribute(m_files[0], DCM_SliceThickness, "4.5");
  ExpectPlacement(*LoadAll(), {10, 20, 30}, {2, 0, 0}, {0, 3, 0}, {0, 0, 4.5});
}

TEST_F(DicomGeometry, WithoutPositionsTheInstanceNumbersDecide) {
  WritePattern(3);
  RemoveFromAll(DCM_ImagePositionPatient);
  RemoveFromAll(DCM_ImageOrientationPatient);
  SetAttribute(m_files[0], DCM_InstanceNumber, "9");
  const auto loaded = LoadAll();
  ExpectPlacement(*loaded, {0, 0, 0}, {2, 0, 0}, {0, 3, 0}, {0, 0, 5});
  EXPECT_EQ(loaded->RealValue(SamplesOf(*loaded->volume.GetSlice(2))[0]),
            PatternValue(0, 0, 0) - 1024);
  EXPECT_THAT(
      m_report.notes,
      ElementsAre("the files tell no positions; the order is that of the instance numbers"));
}

TEST_F(DicomGeometry, WithoutSpacingOneMillimetreIsAssumedAndTold) {
  WritePattern(2);
  RemoveFromAll(DCM_PixelSpacing);
  ExpectPlacement(*LoadAll(), {10, 20, 30}, {1, 0, 0}, {0, 1, 0}, {0, 0, 5});
  EXPECT_THAT(m_report.notes, ElementsAre("the files tell no pixel spacing; 1 mm is assumed"));
}

TEST_F(DicomGeometry, SpacingAtTheDetectorServesWhenThereIsNoOther) {
  WritePattern(1);
  RemoveFromAll(DCM_PixelSpacing);
  SetAttribute(m_files[0], DCM_ImagerPixelSpacing, "0.5\\0.5");
  ExpectNear(ToVec3(LoadAll()->volume.GetCoordinates().axisX), {0.5, 0, 0}, "axis x");
  EXPECT_THAT(m_report.notes, IsEmpty());
}

TEST_F(DicomGeometry, MisfitsAreRefusedByName) {
  WritePattern(6);
  SetAttribute(m_files[0], DCM_ImageOrientationPatient, "1\\0\\0\\0\\0\\-1");
  SetAttribute(m_files[1], DCM_PixelSpacing, "9\\9");
  EditDicom(m_files[2], [](DcmDataset& dataset) {
    dataset.putAndInsertUint16(DCM_Rows, 4);
    dataset.putAndInsertUint16(DCM_Columns, 3);
  });
  EXPECT_EQ(LoadAll()->volume.GetSizeZ(), 3);
  EXPECT_THAT(Refusals(m_report),
              ElementsAre("S001-00001.dcm: it has another orientation than the series",
                          "S001-00002.dcm: it has a pixel spacing of 9 x 9 mm, the series has "
                          "2 x 3 mm",
                          "S001-00003.dcm: it is 3 x 4 pixels, the series is 4 x 3"));
}

TEST_F(DicomGeometry, SlicesWithoutAPositionAmongOthersAreRefused) {
  WritePattern(3);
  RemoveAttribute(m_files[1], DCM_ImagePositionPatient);
  EXPECT_EQ(LoadAll()->volume.GetSizeZ(), 2);
  EXPECT_THAT(Refusals(m_report),
              ElementsAre("S001-00002.dcm: it has no position, the other slices have one"));
}

TEST_F(DicomGeometry, VoxelsTooSmallForTheLibraryAreAnError) {
  const auto study = MakePatternStudy(4, 3, 2);
  PlaceVolume(*study, {0, 0, 0}, {0.1, 0, 0}, {0, 0.1, 0}, {0, 0, 0.1});
  Write(*study);
  for (const fs::path& file : m_files) {
    SetAttribute(file, DCM_PixelSpacing, "0.001\\0.001");
  }
  EXPECT_EQ(ErrorOf([this] { LoadAll(); }),
            "the voxels are too small or flat (more than 0.000001 cubic millimetres are needed)");
}

}  // namespace
