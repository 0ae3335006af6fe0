#include "Sha256.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/DicomLoader.h>
#include <study/StudyFile.h>

#include <algorithm>
#include <sstream>

using namespace study;
using namespace study_test;
using testing::IsEmpty;

namespace {

/// One line of the table beside the series.
struct TableLine {
  double z;
  int smallest;
  int largest;
  std::string sum;  ///< the first half of the check sum of the samples, as 32-bit numbers
};

std::vector<TableLine> ReadTable() {
  std::istringstream table(ReadBytes(fs::path(VORL_TEST_DATA) / "dicom-slices.csv"));
  std::vector<TableLine> lines;
  std::string text;
  std::getline(table, text);
  while (std::getline(table, text)) {
    std::vector<std::string> cells;
    std::istringstream line(text);
    for (std::string cell; std::getline(line, cell, ',');) {
      cells.push_back(cell);
    }
    if (cells.size() == 10 && cells[0] == "ct-a") {
      lines.push_back({std::stod(cells[6]), std::stoi(cells[7]), std::stoi(cells[8]), cells[9]});
    }
  }
  std::sort(lines.begin(), lines.end(),
            [](const TableLine& a, const TableLine& b) { return a.z < b.z; });
  return lines;
}

/// The samples as little-endian 32-bit numbers.
std::string Widened(std::span<const std::uint16_t> samples) {
  std::string bytes;
  for (const std::uint16_t sample : samples) {
    bytes += {static_cast<char>(sample & 0xFF), static_cast<char>(sample >> 8), '\0', '\0'};
  }
  return bytes;
}

TEST(RealSeries, CheckSumIsTheStandardOne) {
  EXPECT_EQ(Sha256("abc"), "ba7816bf8f01cfea414140de5dae2223b00361a396177a9cb410ff61f20015ad");
  EXPECT_EQ(Sha256(std::string(56, 'a')).substr(0, 16), "b35439a4ac6f0948");
}

TEST(RealSeries, MatchesItsTable) {
  LoadReport report;
  const auto study = Load(fs::path(VORL_TEST_DATA) / "ct-a", report);
  const auto table = ReadTable();
  EXPECT_THAT(report.notes, IsEmpty());
  EXPECT_THAT(Refusals(report), IsEmpty());
  ASSERT_EQ(table.size(), 96u);
  ASSERT_EQ(study->volume.GetSizeX(), 512);
  ASSERT_EQ(study->volume.GetSizeY(), 512);
  ASSERT_EQ(study->volume.GetSizeZ(), 96);
  EXPECT_EQ(study->unit, "HU");
  EXPECT_EQ(study->offset, -1024);
  EXPECT_EQ(study->scale, 1);
  EXPECT_NEAR(Length(ToVec3(study->volume.GetCoordinates().axisX)), 0.451171875, 1e-6);
  EXPECT_NEAR(Length(ToVec3(study->volume.GetCoordinates().axisZ)), 1, 1e-5);
  for (int k = 0; k < 96; ++k) {
    const TableLine& line = table[static_cast<std::size_t>(k)];
    const auto samples = SamplesOf(*study->volume.GetSlice(k));
    const auto [smallest, largest] = std::minmax_element(samples.begin(), samples.end());
    EXPECT_EQ(*smallest, line.smallest) << k;
    EXPECT_EQ(*largest, line.largest) << k;
    EXPECT_EQ(Sha256(Widened(samples)).substr(0, 16), line.sum) << k;
    EXPECT_NEAR(WorldFromVoxel(*study, {0.5, 0.5, k + 0.5}).z, line.z, 1e-3) << k;
  }
}

TEST(RealSeries, SurvivesTheStudyFile) {
  const TestFolder folder;
  const auto study = Load(fs::path(VORL_TEST_DATA) / "ct-a");
  WriteStudyFile(*study, folder / "a.bdf");
  EXPECT_EQ(StoredValues(*ReadStudyFile(folder / "a.bdf")), StoredValues(*study));
}

}  // namespace
