#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/dicom/StackGeometry.h>

using namespace study;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

/// Axial slices of 4 x 3 pixels of 1 mm at these heights.
std::vector<SliceHeader> SlicesAt(const std::vector<double>& heights) {
  std::vector<SliceHeader> headers;
  for (const double z : heights) {
    SliceHeader header;
    header.grid.columns = 4;
    header.grid.rows = 3;
    header.position = Vec3{-5, 7, z};
    header.file = std::to_string(headers.size());
    headers.push_back(header);
  }
  return headers;
}

std::vector<std::string> NotesFor(const std::vector<double>& heights) {
  return PlaceStack(SlicesAt(heights)).notes;
}

TEST(Millimetres, ShowsWhatMatters) {
  EXPECT_EQ(Millimetres(2), "2");
  EXPECT_EQ(Millimetres(0.451171875), "0.451");
  EXPECT_EQ(Millimetres(-10.5), "-10.5");
  EXPECT_EQ(Millimetres(-0.0001), "0");
}

TEST(PlaceStack, RegularStackNeedsNoNote) {
  const StackPlacement placement = PlaceStack(SlicesAt({10, 12.5, 15}));
  EXPECT_EQ(placement.first, (Vec3{-5, 7, 10}));
  EXPECT_EQ(placement.step, (Vec3{0, 0, 2.5}));
  EXPECT_THAT(placement.notes, IsEmpty());
}

TEST(PlaceStack, RoundedPositionsNeedNoNote) {
  EXPECT_THAT(NotesFor({0, 0.625, 1.249, 1.876, 2.5}), IsEmpty());
}

TEST(PlaceStack, TellsOneMissingSlice) {
  EXPECT_THAT(NotesFor({0, 1, 2, 4, 5}),
              ElementsAre("1 slice is missing between 2 and 4 mm",
                          "the mean distance of 1.25 mm is used for all slices"));
}

TEST(PlaceStack, TellsSeveralMissingSlices) {
  EXPECT_THAT(NotesFor({0, 1, 2, 3, 7.08}),
              ElementsAre("3 slices are missing between 3 and 7.08 mm",
                          "the mean distance of 1.77 mm is used for all slices"));
}

TEST(PlaceStack, TellsUnequalDistances) {
  EXPECT_THAT(NotesFor({0, 2, 4, 5.5, 7.5}),
              ElementsAre("the slices between 4 and 5.5 mm are 1.5 mm apart instead of 2 mm",
                          "the mean distance of 1.875 mm is used for all slices"));
}

TEST(PlaceStack, LimitsTheNumberOfNotes) {
  std::vector<double> heights{0};
  for (int i = 0; i < 40; ++i) {
    heights.push_back(heights.back() + (i % 3 == 0 ? 2 : 1));
  }
  const auto notes = NotesFor(heights);
  ASSERT_EQ(notes.size(), 12u);
  EXPECT_EQ(notes[10], "and 4 more irregular distances");  // 14 of 40 distances are 2
}

TEST(PlaceStack, FollowsAGantryTilt) {
  auto headers = SlicesAt({0, 2, 4});
  headers[1].position->y += 1;
  headers[2].position->y += 2;
  const StackPlacement placement = PlaceStack(headers);
  EXPECT_EQ(placement.step, (Vec3{0, 1, 2}));
  EXPECT_THAT(placement.notes, IsEmpty());
}

TEST(PlaceStack, TellsSlicesBesideTheLine) {
  auto headers = SlicesAt({0, 2, 4});
  headers[1].position->x += 3;
  EXPECT_THAT(PlaceStack(headers).notes,
              ElementsAre("the slices do not lie on a line: up to 3 mm beside it"));
}

TEST(PlaceStack, SingleSliceStepsByItsAnnouncedSpacing) {
  auto headers = SlicesAt({10});
  EXPECT_EQ(PlaceStack(headers).step, (Vec3{0, 0, 1}));
  headers[0].thickness = 3;
  EXPECT_EQ(PlaceStack(headers).step, (Vec3{0, 0, 3}));
  headers[0].sliceSpacing = 4;
  EXPECT_EQ(PlaceStack(headers).step, (Vec3{0, 0, 4}));
}

TEST(PlaceStack, SlicesWithoutPositionsStepAlongTheNormal) {
  auto headers = SlicesAt({0, 0});
  headers[0].position.reset();
  headers[1].position.reset();
  headers[0].thickness = 3;
  const StackPlacement placement = PlaceStack(headers);
  EXPECT_EQ(placement.first, (Vec3{0, 0, 0}));
  EXPECT_EQ(placement.step, (Vec3{0, 0, 3}));
  EXPECT_THAT(placement.notes, IsEmpty());
}

TEST(SortSlices, SortsAlongTheNormal) {
  auto headers = SlicesAt({5, -3, 1});
  SortSlices(headers, {0, 0, 1});
  EXPECT_EQ(headers[0].position->z, -3);
  EXPECT_EQ(headers[2].position->z, 5);
  SortSlices(headers, {0, 0, -1});
  EXPECT_EQ(headers[0].position->z, 5);
}

TEST(SortSlices, EqualPositionsFollowTheInstanceNumbers) {
  auto headers = SlicesAt({1, 1, 1});
  headers[0].instanceNumber = 9;
  headers[1].instanceNumber = 2;
  SortSlices(headers, {0, 0, 1});
  EXPECT_EQ(headers[0].file, "1");
  EXPECT_EQ(headers[1].file, "0");
  EXPECT_EQ(headers[2].file, "2");  // no number: last
}

TEST(MisfitOf, NamesWhatDiffers) {
  const SliceGrid stack = SlicesAt({0})[0].grid;
  SliceGrid slice = stack;
  EXPECT_EQ(MisfitOf(slice, stack), "");
  slice.rowSpacing = 1.0005;
  EXPECT_EQ(MisfitOf(slice, stack), "");
  slice.rowSpacing = 1.5;
  EXPECT_EQ(MisfitOf(slice, stack), "has a pixel spacing of 1 x 1.5 mm, the series has 1 x 1 mm");
  slice.columnDirection = {0, 0, 1};
  EXPECT_EQ(MisfitOf(slice, stack), "has another orientation than the series");
  slice.rows = 5;
  EXPECT_EQ(MisfitOf(slice, stack), "is 4 x 5 pixels, the series is 4 x 3");
}

TEST(TypicalSlice, IsOneOfTheMostCommonKind) {
  auto headers = SlicesAt({0, 1, 2, 3});
  headers[0].grid.rows = 9;
  headers[2].grid.rowDirection = {0, 0, 1};
  EXPECT_EQ(TypicalSlice(headers), 1u);
}

}  // namespace
