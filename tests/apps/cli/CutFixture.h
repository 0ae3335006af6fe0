#ifndef VORL_TESTS_APPS_CLI_CUTFIXTURE_H
#define VORL_TESTS_APPS_CLI_CUTFIXTURE_H

/// @file
/// Cutting planes with the tool and looking at what comes out.

#include "PictureFile.h"
#include "PlaneModel.h"
#include "Tool.h"

#include <study/Study.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "../TestFolder.h"

namespace cli_test {

/// The phantom as the definition places it, with its stored values.
VolumeModel PhantomModel(int width, int height, int slices);

/// Writes a volume as a study file: value = stored - 1000, "HU".
void WriteVolume(const VolumeModel& volume, const std::filesystem::path& path);

class CutFixture : public testing::Test {
 protected:
  std::string PathOf(const std::string& name) const { return (m_folder / name).string(); }

  /// `vorl mpr` with these arguments; a failure fails the test.
  void Cut(Arguments arguments) const;
  /// The slice that `--save-slice` gives.
  std::unique_ptr<study::Study> CutSlice(Arguments arguments) const;
  /// The picture as PNG.
  Picture CutPicture(Arguments arguments) const;

  study_test::TestFolder m_folder;
};

/// A small volume of random values on a straight grid of 1 mm, the first voxel at the origin; the
/// tool reads it from "volume.bdf".
class SmallVolume : public CutFixture {
 protected:
  /// `count` different values from `lowest` on. Slices lie `sliceStep` mm apart.
  SmallVolume(const std::array<int, 3>& size, double sliceStep, unsigned seed, int lowest,
              int count);

  /// Writes the file anew, after values have been changed.
  void Write() const { WriteVolume(Model(), PathOf("volume.bdf")); }
  /// What stands in the file; lives as long as the test.
  VolumeModel Model() const;

  int& At(int i, int j, int k) { return m_values[IndexOf(i, j, k)]; }
  int At(int i, int j, int k) const { return m_values[IndexOf(i, j, k)]; }

  std::vector<int> m_values;

 private:
  std::size_t IndexOf(int i, int j, int k) const {
    return static_cast<std::size_t>((k * m_size[1] + j) * m_size[0] + i);
  }

  std::array<int, 3> m_size;
  double m_sliceStep;
};

/// The samples of a study's only slice.
std::vector<std::uint16_t> SamplesOf(const study::Study& study);

/// Fails unless the slice has the plane's size and, undecided pixels aside, its samples. Of all
/// pixels, at most `undecidedShare` may be undecided.
void ExpectCut(const study::Study& slice, const VolumeModel& volume, const PlaneModel& plane,
               double undecidedShare);

/// "1.5,-2,3"
std::string TripleText(const Point& point);

}  // namespace cli_test

#endif
