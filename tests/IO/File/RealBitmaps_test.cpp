// Published test bitmaps, against the table that came with them.
#include <vorl/IO/File/opDIB2Ima.h>

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "../../apps/Sha256.h"

namespace {

namespace fs = std::filesystem;

using Row = std::map<std::string, std::string>;

const fs::path kFolder = fs::path(VORL_TEST_DATA) / "bmp";

std::vector<std::string> Cells(const std::string& line) {
  std::vector<std::string> cells;
  std::istringstream stream(line);
  for (std::string cell; std::getline(stream, cell, ',');) {
    cells.push_back(cell);
  }
  return cells;
}

std::vector<Row> ReadTable() {
  std::ifstream file(kFolder / "bmp.csv");
  std::string line;
  std::getline(file, line);
  const auto names = Cells(line);
  std::vector<Row> rows;
  while (std::getline(file, line)) {
    const auto cells = Cells(line);
    Row row;
    for (std::size_t i = 0; i < names.size(); ++i) {
      row[names[i]] = i < cells.size() ? cells[i] : "";
    }
    rows.push_back(row);
  }
  return rows;
}

/// Red, green and blue of every pixel; of 16-bit files the five bits of each.
std::string RgbOf(const dImage& image, const fs::path& path, bool fiveBits) {
  std::ifstream file(path, std::ios::binary);
  const std::string bytes{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  std::string rgb;
  for (int y = 0; y < static_cast<int>(image.GetHeight()); ++y) {
    const auto* row = static_cast<const char*>(image.GetRowPtr(y));
    for (int x = 0; x < static_cast<int>(image.GetWidth()); ++x) {
      if (image.GetDataType() == ImageDataType_U1) {
        // The image has the indices; a palette of one entry is black behind it.
        const std::size_t entry = 54 + 4 * static_cast<std::size_t>(row[x / 8] >> (7 - x % 8) & 1);
        const bool isThere = entry < static_cast<unsigned char>(bytes.at(10));
        for (const std::size_t part : {2U, 1U, 0U}) {
          rgb += isThere ? bytes.at(entry + part) : '\0';
        }
      } else {
        const int channels = image.GetNumChannels();
        for (const int part : {2, 1, 0}) {
          const char value = row[x * channels + (channels > 1 ? part : 0)];
          rgb += fiveBits ? static_cast<char>(static_cast<unsigned char>(value) / 8) : value;
        }
      }
    }
  }
  return rgb;
}

TEST(RealBitmaps, AreReadAsTheirTableSaysOrRefused) {
  const auto table = ReadTable();
  ASSERT_EQ(table.size(), 23U);
  int matched = 0;
  for (const Row& row : table) {
    const fs::path path = kFolder / row.at("file");
    dImage image;
    opDIB2Ima op;
    const bool read = op.Convert(path.string().c_str(), image);
    if (row.at("basic_reader") == "yes") {
      EXPECT_TRUE(read) << path << op.GetStatus();
    }
    EXPECT_EQ(read, image.IsValid()) << path;
    if (!read) {
      EXPECT_STRNE(op.GetStatus(), "") << path;
      continue;
    }
    EXPECT_EQ(std::to_string(image.GetWidth()), row.at("width")) << path;
    EXPECT_EQ(std::to_string(image.GetHeight()), row.at("height")) << path;
    if (!row.at("rgb_sha256").empty()) {
      const bool fiveBits = row.at("bits_per_pixel") == "16";
      EXPECT_EQ(study_test::Sha256(RgbOf(image, path, fiveBits)), row.at("rgb_sha256")) << path;
      ++matched;
    }
  }
  EXPECT_EQ(matched, 13);
}

TEST(RealBitmaps, WithAColourProfileAreThoseWithout) {
  dImage image, plain;
  opDIB2Ima op;
  ASSERT_TRUE(op.Convert((kFolder / "questionable/bs-rgb24prof.bmp").string().c_str(), image))
      << op.GetStatus();
  ASSERT_TRUE(op.Convert((kFolder / "good/bs-rgb24.bmp").string().c_str(), plain));
  ASSERT_EQ(image.GetImageSize(), plain.GetImageSize());
  EXPECT_EQ(std::memcmp(image.GetDataPtr(), plain.GetDataPtr(), plain.GetImageSize()), 0);
}

TEST(RealBitmaps, ThatAreNotPlainAreRefusedByName) {
  const struct {
    const char* file;
    const char* reason;
  } kRefusals[] = {
      {"good/bs-pal8rle.bmp", "opDIB2Ima: unsupported compression: RLE8"},
      {"questionable/bs-pal4rletrns.bmp", "opDIB2Ima: unsupported compression: RLE4"},
      {"questionable/bs-pal8os2sp.bmp", "opDIB2Ima: unsupported header size: 12"},
      {"questionable/bs-rgb24png.bmp", "opDIB2Ima: unsupported compression: PNG"},
      {"questionable/bs-rgb32h52.bmp", "opDIB2Ima: unsupported compression: bit fields"}};
  for (const auto& refusal : kRefusals) {
    dImage image;
    opDIB2Ima op;
    EXPECT_FALSE(op.Convert((kFolder / refusal.file).string().c_str(), image)) << refusal.file;
    EXPECT_STREQ(op.GetStatus(), refusal.reason) << refusal.file;
  }
}

}  // namespace
