#include "TestStudies.h"

#include <study/DicomLoader.h>
#include <study/Error.h>

namespace study_test {

std::uint16_t PatternValue(int i, int j, int k) {
  return static_cast<std::uint16_t>((i * 7 + j * 131 + k * 577) % 3001);
}

std::unique_ptr<study::Study> MakePatternStudy(int width, int height, int slices) {
  auto result = std::make_unique<study::Study>();
  result->offset = -1024;
  result->unit = "HU";
  result->modality = "CT";
  result->description = "Pattern";
  result->windowCentre = 50;
  result->windowWidth = 350;
  for (int k = 0; k < slices; ++k) {
    auto samples = study::AppendSlice(*result, width, height);
    std::size_t at = 0;
    for (int j = 0; j < height; ++j) {
      for (int i = 0; i < width; ++i) {
        samples[at++] = PatternValue(i, j, k);
      }
    }
  }
  study::PlaceVolume(*result, {10, 20, 30}, {2, 0, 0}, {0, 3, 0}, {0, 0, 5});
  return result;
}

std::vector<double> RealValues(const study::Study& study) {
  std::vector<double> values;
  for (const std::uint16_t stored : StoredValues(study)) {
    values.push_back(study.RealValue(stored));
  }
  return values;
}

std::vector<std::uint16_t> StoredValues(const study::Study& study) {
  std::vector<std::uint16_t> values;
  for (const dSlice& slice : study.volume.GetSliceList()) {
    const auto samples = study::SamplesOf(slice);
    values.insert(values.end(), samples.begin(), samples.end());
  }
  return values;
}

std::string ErrorOf(const std::function<void()>& action) {
  try {
    action();
  } catch (const study::Error& error) {
    return error.what();
  }
  return "no error";
}

std::unique_ptr<study::Study> Load(const std::filesystem::path& folder, study::LoadReport& report,
                                   const std::string& series) {
  return study::LoadDicom({folder}, series, report);
}

std::unique_ptr<study::Study> Load(const std::filesystem::path& folder) {
  study::LoadReport report;
  return Load(folder, report);
}

std::vector<std::string> Refusals(const study::LoadReport& report) {
  std::vector<std::string> lines;
  for (const study::RefusedFile& refused : report.refused) {
    lines.push_back(refused.file.filename().string() + ": " + refused.reason);
  }
  return lines;
}

}  // namespace study_test
