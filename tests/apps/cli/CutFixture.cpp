#include "CutFixture.h"

#include <study/Phantom.h>
#include <study/StudyFile.h>

#include <cstdio>
#include <random>

namespace cli_test {

VolumeModel PhantomModel(int width, int height, int slices) {
  const std::shared_ptr<const study::Study> phantom = study::MakePhantom(width, height, slices);
  VolumeModel model;
  model.size = {width, height, slices};
  const Point spacing{400.0 / width, 400.0 / height, 320.0 / slices};
  model.firstVoxel = {-200 + spacing[0] / 2, -200 + spacing[1] / 2, -160 + spacing[2] / 2};
  model.step = {Point{spacing[0], 0, 0}, Point{0, spacing[1], 0}, Point{0, 0, spacing[2]}};
  model.stored = [phantom, width](int i, int j, int k) {
    const auto samples = study::SamplesOf(*phantom->volume.GetSlice(k));
    return int{samples[static_cast<std::size_t>(j * width + i)]};
  };
  return model;
}

void WriteVolume(const VolumeModel& volume, const std::filesystem::path& path) {
  study::Study study;
  for (int k = 0; k < volume.size[2]; ++k) {
    const auto samples = study::AppendSlice(study, volume.size[0], volume.size[1]);
    std::size_t at = 0;
    for (int j = 0; j < volume.size[1]; ++j) {
      for (int i = 0; i < volume.size[0]; ++i) {
        samples[at++] = static_cast<std::uint16_t>(volume.stored(i, j, k));
      }
    }
  }
  study.offset = -1000;
  study.unit = "HU";
  const auto vector = [](const Point& p) { return study::Vec3{p[0], p[1], p[2]}; };
  study::PlaceVolume(study, vector(volume.firstVoxel), vector(volume.step[0]),
                     vector(volume.step[1]), vector(volume.step[2]));
  study::WriteStudyFile(study, path);
}

void CutFixture::Cut(Arguments arguments) const {
  arguments.insert(arguments.begin(), "mpr");
  const Outcome outcome = RunTool(arguments);
  EXPECT_EQ(outcome.code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, "");
}

std::unique_ptr<study::Study> CutFixture::CutSlice(Arguments arguments) const {
  const std::string path = PathOf("slice.bdf");
  arguments.insert(arguments.end(), {"--save-slice", path});
  Cut(arguments);
  return study::ReadStudyFile(path);
}

Picture CutFixture::CutPicture(Arguments arguments) const {
  const std::string path = PathOf("picture.png");
  arguments.insert(arguments.end(), {"-o", path});
  Cut(arguments);
  return ReadPng(path);
}

SmallVolume::SmallVolume(const std::array<int, 3>& size, double sliceStep, unsigned seed,
                         int lowest, int count)
    : m_size(size), m_sliceStep(sliceStep) {
  std::mt19937 random(seed);
  m_values.resize(static_cast<std::size_t>(size[0] * size[1] * size[2]));
  for (int& value : m_values) {
    value = lowest + static_cast<int>(random() % static_cast<unsigned>(count));
  }
  Write();
}

VolumeModel SmallVolume::Model() const {
  VolumeModel model;
  model.size = m_size;
  model.step = {Point{1, 0, 0}, Point{0, 1, 0}, Point{0, 0, m_sliceStep}};
  model.stored = [this](int i, int j, int k) { return At(i, j, k); };
  return model;
}

std::vector<std::uint16_t> SamplesOf(const study::Study& study) {
  const auto samples = study::SamplesOf(*study.volume.GetSlice(0));
  return {samples.begin(), samples.end()};
}

void ExpectCut(const study::Study& slice, const VolumeModel& volume, const PlaneModel& plane,
               double undecidedShare) {
  EXPECT_EQ(slice.volume.GetSizeX(), plane.width);
  EXPECT_EQ(slice.volume.GetSizeY(), plane.height);
  EXPECT_EQ(slice.volume.GetSizeZ(), 1);
  const Comparison result = Compare(NearestSamples(volume, plane), SamplesOf(slice));
  EXPECT_EQ(result.different, 0u);
  EXPECT_GT(result.equal, 0u);
  EXPECT_LE(static_cast<double>(result.undecided), undecidedShare * plane.width * plane.height);
}

std::string TripleText(const Point& point) {
  char text[128];
  std::snprintf(text, sizeof text, "%.9g,%.9g,%.9g", point[0], point[1], point[2]);
  return text;
}

}  // namespace cli_test
