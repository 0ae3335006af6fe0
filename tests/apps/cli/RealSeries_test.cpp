#include "CutFixture.h"

#include <study/StudyFile.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <map>

#include <dcmtk/config/osconfig.h>
#include <dcmtk/dcmdata/dctk.h>

// The CT of a head phantom: 96 axial slices of 512 x 512 pixels of 0.451171875 mm, 1 mm apart,
// 12 bits, value = stored - 1024.

namespace {

namespace fs = std::filesystem;

using cli_test::CutFixture;
using cli_test::ExpectCut;
using cli_test::Outcome;
using cli_test::Picture;
using cli_test::PlaneModel;
using cli_test::Point;
using cli_test::RunTool;
using cli_test::VolumeModel;

constexpr double kSpacing = 0.451171875;

std::string Folder() {
  return VORL_TEST_DATA "/ct-a";
}

/// The samples straight from the files, by slice position.
const std::vector<std::vector<Uint16>>& Slices() {
  static const std::vector<std::vector<Uint16>> slices = [] {
    std::map<double, std::vector<Uint16>> sorted;
    for (const auto& entry : fs::directory_iterator(Folder())) {
      DcmFileFormat file;
      EXPECT_TRUE(file.loadFile(entry.path().c_str()).good());
      Float64 z = 0;
      EXPECT_TRUE(file.getDataset()->findAndGetFloat64(DCM_ImagePositionPatient, z, 2).good());
      const Uint16* samples = nullptr;
      unsigned long count = 0;
      EXPECT_TRUE(file.getDataset()->findAndGetUint16Array(DCM_PixelData, samples, &count).good());
      sorted[z].assign(samples, samples + count);
    }
    std::vector<std::vector<Uint16>> list;
    for (auto& [z, samples] : sorted) {
      list.push_back(std::move(samples));
    }
    return list;
  }();
  return slices;
}

class RealSeries : public CutFixture {
 protected:
  void SetUp() override {
    ASSERT_EQ(Slices().size(), 96u);
    m_volume.size = {512, 512, 96};
    m_volume.firstVoxel = {-115.5, -1.85, 724.21};
    m_volume.step = {Point{kSpacing, 0, 0}, Point{0, kSpacing, 0}, Point{0, 0, 1}};
    m_volume.stored = [](int i, int j, int k) {
      return int{Slices()[static_cast<std::size_t>(k)][static_cast<std::size_t>(j * 512 + i)]};
    };
  }

  /// The centre of the middle voxel (256, 256, 48).
  Point Middle() const { return {-115.5 + 256 * kSpacing, -1.85 + 256 * kSpacing, 724.21 + 48}; }
  /// The middle between the outermost voxel borders.
  Point Centre() const {
    return {-115.5 + 255.5 * kSpacing, -1.85 + 255.5 * kSpacing, 724.21 + 47.5};
  }

  VolumeModel m_volume;
};

TEST_F(RealSeries, InfoTellsWhatItIs) {
  const Outcome outcome = RunTool({"info", Folder()});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  for (const char* line :
       {"Matrix:       512 x 512 x 96\n", "Spacing:      0.451171875 x 0.451171875 x 1 mm\n",
        "First voxel:  -115.5, -1.85, 724.21 mm (centre)\n", "Orientation:  axial\n",
        "rows run to L (1, 0, 0)\n", "columns run to P (0, 1, 0)\n",
        "slices follow to H (0, 0, 1)\n",
        "Sample type:  16 bit unsigned, value = stored x 1 - 1024\n",
        "Value range:  -1024 to 825 HU\n", "Unit:         HU\n",
        "Window:       centre 40, width 80\n", "96 slices of 512 x 512"}) {
    EXPECT_NE(outcome.output.find(line), std::string::npos) << line << outcome.output;
  }
}

TEST_F(RealSeries, AxialIsTheMiddleSlice) {
  const auto slice = CutSlice({Folder()});
  const std::vector<std::uint16_t> samples = cli_test::SamplesOf(*slice);
  EXPECT_TRUE(std::equal(samples.begin(), samples.end(), Slices()[48].begin(), Slices()[48].end()));
}

TEST_F(RealSeries, CoronalAndSagittalShowTheWholeVolumeWithTheHeadUp) {
  PlaneModel coronal = cli_test::CoronalPlane();
  coronal.width = 512;
  coronal.height = 213;  // 96 mm
  coronal.spacing = kSpacing;
  coronal.centre = {Centre()[0], Middle()[1], Centre()[2]};
  ExpectCut(*CutSlice({Folder(), "--plane", "coronal"}), m_volume, coronal, 0.03);
  PlaneModel sagittal = coronal;
  sagittal.right = {0, 1, 0};
  sagittal.centre = {Middle()[0], Centre()[1], Centre()[2]};
  ExpectCut(*CutSlice({Folder(), "--plane", "sagittal"}), m_volume, sagittal, 0.03);
}

TEST_F(RealSeries, ObliquePlanesAndSlabsAreMadeOfTheFilesSamples) {
  PlaneModel plane = cli_test::AxialPlane().Turned(30, 20, 0);
  plane.centre = {3.3, 110.1, 770.7};
  plane.width = 300;
  plane.height = 200;
  plane.spacing = 0.6;
  ExpectCut(*CutSlice({Folder(), "--plane", "oblique", "--center", "3.3,110.1,770.7", "--size",
                       "300x200", "--spacing", "0.6"}),
            m_volume, plane, 0.06);
  plane.width = 60;
  plane.height = 40;
  plane.spacing = 2.9;
  plane.thickness = 12;
  plane.steps = 9;
  ExpectCut(*CutSlice({Folder(), "--plane", "oblique", "--center", "3.3,110.1,770.7", "--size",
                       "60x40", "--spacing", "2.9", "--thickness", "12", "--steps", "9"}),
            m_volume, plane, 0.2);
}

TEST_F(RealSeries, PicturesAreRightSideUp) {
  const Picture axial = CutPicture({Folder(), "--window", "bone"});
  EXPECT_EQ(axial.width, 512);
  EXPECT_EQ(axial.height, 512);
  // The head rest is behind the head, open to the front.
  EXPECT_GT(axial.Mean(200, 480, 300, 512), 2);
  EXPECT_LT(axial.Mean(200, 0, 300, 30), 1);
  const Picture coronal = CutPicture({Folder(), "--plane", "coronal", "--window", "bone"});
  EXPECT_EQ(coronal.height, 213);
  // The vault of the skull is closed above, its base is thick below.
  EXPECT_LT(coronal.Mean(90, 0, 140, 20), 5);
  EXPECT_GT(coronal.Mean(120, 195, 200, 212), 60);
}

TEST_F(RealSeries, ASheetMeasuresTheFilesSamples) {
  const Outcome outcome =
      RunTool({"render", Folder(), "--region", "-30,70,-15,85", "-o", PathOf("sheet.png")});
  EXPECT_EQ(outcome.code, 0);
  EXPECT_EQ(outcome.errors, "");
  std::vector<double> values;
  for (int j = 0; j < 512; ++j) {
    for (int i = 0; i < 512; ++i) {
      const double x = -115.5 + i * kSpacing;
      const double y = -1.85 + j * kSpacing;
      if (x > -30 && x < -15 && y > 70 && y < 85) {
        values.push_back(m_volume.stored(i, j, 48) - 1024);
      }
    }
  }
  double mean = 0;
  for (const double value : values) {
    mean += value / static_cast<double>(values.size());
  }
  double variance = 0;
  for (const double value : values) {
    variance += (value - mean) * (value - mean) / static_cast<double>(values.size());
  }
  char text[200];
  std::snprintf(text, sizeof text,
                "Voxels:       %d\nMean:         %.1f HU\nSD:           %.1f HU\n",
                static_cast<int>(values.size()), mean, std::sqrt(variance));
  EXPECT_NE(outcome.output.find(text), std::string::npos) << text << outcome.output;
}

TEST_F(RealSeries, ConvertedItHoldsTheFilesSamplesBitForBit) {
  const std::string path = PathOf("a.bdf");
  ASSERT_EQ(RunTool({"convert", Folder(), path}).code, 0);
  const auto study = study::ReadStudyFile(path);
  EXPECT_EQ(study->scale, 1);
  EXPECT_EQ(study->offset, -1024);
  EXPECT_EQ(study->unit, "HU");
  ASSERT_EQ(study->volume.GetSliceCount(), 96);
  for (int k = 0; k < 96; ++k) {
    const auto samples = study::SamplesOf(*study->volume.GetSlice(k));
    const auto& expected = Slices()[static_cast<std::size_t>(k)];
    EXPECT_TRUE(std::equal(samples.begin(), samples.end(), expected.begin(), expected.end())) << k;
  }
  const std::string again = PathOf("b.bdf");
  ASSERT_EQ(RunTool({"convert", path, again}).code, 0);
  EXPECT_EQ(study_test::ReadBytes(again), study_test::ReadBytes(path));
}

}  // namespace
