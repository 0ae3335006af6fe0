#include "CutFixture.h"
#include "GreyModel.h"

#include <study/StudyFile.h>

namespace {

using cli_test::Arguments;
using cli_test::CutFixture;
using cli_test::Picture;
using cli_test::ReadBmp;
using cli_test::ReadPng;

/// The phantom, small enough for a debug build, large enough to see what is where.
constexpr const char* kPhantom = "--phantom=100x100x80";

using MprPictures = CutFixture;

// In the phantom, the block of line pairs lies before the body on the left side, the table behind
// it; the liver is on the right, below the lungs; the spine is at the back.

TEST_F(MprPictures, AxialShowsThePatientsLeftOnTheRightAndTheBackBelow) {
  const Picture picture = CutPicture({kPhantom, "--window", "soft"});
  ASSERT_EQ(picture.width, 100);
  ASSERT_EQ(picture.height, 100);
  // 4 mm per pixel: the block reaches from (88, -172) to (168, -108).
  EXPECT_GT(picture.Mean(74, 9, 90, 21), 150);
  EXPECT_LT(picture.Mean(10, 9, 26, 21), 20);
  // The table's upper and lower edges are at 118 and 134 mm behind the centre; nothing is before.
  EXPECT_GT(picture.Mean(20, 79, 80, 84), picture.Mean(20, 16, 80, 21) + 20);
  EXPECT_GT(picture.At(50, 65), 200);  // a vertebra, 62 mm behind the centre
}

TEST_F(MprPictures, CoronalShowsTheHeadUpAndThePatientsLeftOnTheRight) {
  const Picture picture = CutPicture({kPhantom, "--plane", "coronal", "--window", "soft"});
  ASSERT_EQ(picture.width, 100);
  ASSERT_EQ(picture.height, 80);
  EXPECT_LT(picture.Mean(30, 15, 36, 25), 40);   // the right lung, 70 mm above the centre
  EXPECT_LT(picture.Mean(64, 15, 70, 25), 40);   // the left one
  EXPECT_GT(picture.Mean(30, 50, 40, 60), 130);  // the liver, 60 mm below it, on the right
}

TEST_F(MprPictures, SagittalShowsTheHeadUpAndTheBackOnTheRight) {
  const Picture picture = CutPicture({kPhantom, "--plane", "sagittal", "--window", "soft"});
  ASSERT_EQ(picture.width, 100);
  ASSERT_EQ(picture.height, 80);
  EXPECT_GT(picture.Mean(62, 10, 69, 70), 200);                                // the spine
  EXPECT_GT(picture.Mean(26, 12, 29, 35), picture.Mean(26, 55, 29, 75) + 50);  // the sternum
}

TEST_F(MprPictures, APixelIsAsWideAsHigh) {
  // The voxels are 4 x 4 x 4 mm in one phantom and 4 x 8 x 16 mm in the other: the pictures show
  // the same 400 x 320 mm.
  const Picture fine = CutPicture({kPhantom, "--plane", "coronal"});
  const Picture coarse = CutPicture({"--phantom=100x50x20", "--plane", "coronal"});
  EXPECT_EQ(coarse.width, fine.width);
  EXPECT_EQ(coarse.height, fine.height);
}

TEST_F(MprPictures, BmpAndPngHoldTheSamePixels) {
  for (const char* plane : {"axial", "coronal", "sagittal", "oblique"}) {
    SCOPED_TRACE(plane);
    const Arguments arguments{"--phantom=33x31x21", "--plane", plane, "--spacing", "7.7"};
    const Picture png = CutPicture(arguments);
    Arguments bmpArguments = arguments;
    bmpArguments.insert(bmpArguments.end(), {"-o", PathOf("picture.bmp")});
    Cut(bmpArguments);
    const Picture bmp = ReadBmp(PathOf("picture.bmp"));
    EXPECT_EQ(bmp.width, png.width);
    EXPECT_EQ(bmp.height, png.height);
    EXPECT_EQ(bmp.levels, png.levels);
  }
}

TEST_F(MprPictures, TheExtensionMayBeInCapitals) {
  Cut({"--phantom=8x8x8", "-o", PathOf("a.PNG")});
  Cut({"--phantom=8x8x8", "-o", PathOf("a.Bmp")});
  EXPECT_EQ(ReadBmp(PathOf("a.Bmp")).levels, ReadPng(PathOf("a.PNG")).levels);
}

TEST_F(MprPictures, EqualRunsGiveEqualFiles) {
  Cut({kPhantom, "--plane", "oblique", "-o", PathOf("a.png")});
  Cut({kPhantom, "--plane", "oblique", "-o", PathOf("b.png")});
  EXPECT_EQ(study_test::ReadBytes(PathOf("a.png")), study_test::ReadBytes(PathOf("b.png")));
}

TEST_F(MprPictures, PictureAndSliceComeFromOneRun) {
  Cut({kPhantom, "-o", PathOf("a.png"), "--save-slice", PathOf("a.bdf"), "--window", "soft"});
  const Picture picture = ReadPng(PathOf("a.png"));
  const auto slice = study::ReadStudyFile(PathOf("a.bdf"));
  const std::vector<std::uint16_t> samples = cli_test::SamplesOf(*slice);
  ASSERT_EQ(samples.size(), picture.levels.size());
  const std::vector<int> levels = cli_test::WindowLevels(40 + 1024, 400, 65536);
  for (std::size_t i = 0; i < samples.size(); ++i) {
    ASSERT_EQ(picture.levels[i], levels[samples[i]]) << samples[i];
  }
}

TEST_F(MprPictures, ASavedSliceKeepsPlaceAndUnits) {
  const auto slice =
      CutSlice({kPhantom, "--plane", "coronal", "--center", "10,20,30", "--size", "21x11",
                "--spacing", "2.5", "--thickness", "12", "--window", "lung"});
  EXPECT_EQ(slice->scale, 1);
  EXPECT_EQ(slice->offset, -1024);
  EXPECT_EQ(slice->unit, "HU");
  EXPECT_EQ(slice->modality, "CT");
  EXPECT_EQ(slice->windowCentre, -600);
  EXPECT_EQ(slice->windowWidth, 1500);
  const study::Vec3 first = study::WorldFromVoxel(*slice, {0.5, 0.5, 0.5});
  EXPECT_NEAR(first.x, 10 - 10 * 2.5, 1e-4);
  EXPECT_NEAR(first.y, 20, 1e-4);
  EXPECT_NEAR(first.z, 30 + 5 * 2.5, 1e-4);
  EXPECT_NEAR(slice->volume.GetSlice(0)->GetSliceThickness(), 12, 1e-5);
}

TEST_F(MprPictures, ASavedSliceCutAlongItselfIsItself) {
  const auto slice = CutSlice(
      {kPhantom, "--plane", "sagittal", "--center", "33,4,5", "--size", "31x41", "--spacing", "3"});
  const std::vector<std::uint16_t> samples = cli_test::SamplesOf(*slice);
  study_test::fs::rename(PathOf("slice.bdf"), PathOf("first.bdf"));
  const auto again = CutSlice({PathOf("first.bdf"), "--plane", "sagittal"});
  EXPECT_EQ(cli_test::SamplesOf(*again), samples);
}

}  // namespace
