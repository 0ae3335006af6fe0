// Slices drawn into a plane: their outline and mark, and what hides what.

#include <vorl/Operators/IP/opSliceProjection.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <limits>
#include <string>

#include "ProjectionBench.h"

namespace {

using projection_bench::Drawing;
using projection_bench::MakeFlat;
using Unsigned = std::vector<std::uint16_t>;
using Signed = std::vector<std::int16_t>;
using Depths = std::vector<std::int16_t>;
using Picture = std::vector<std::string>;

constexpr std::uint16_t kBorder = 9;
constexpr std::uint16_t kPixel = 5;

/// The plane: '#' for the border value, '.' for a pixel of the slice, '_' where nothing is drawn.
Picture PictureOf(const Drawing<std::uint16_t>& drawing) {
  const Unsigned pixels = drawing.Pixels();
  const auto width = static_cast<std::size_t>(drawing.plane.GetWidth());
  Picture picture;
  for (std::size_t i = 0; i < pixels.size(); ++i) {
    if (i % width == 0) {
      picture.emplace_back();
    }
    picture.back() += pixels[i] == kBorder ? '#' : pixels[i] == kPixel ? '.' : '_';
  }
  return picture;
}

/// A slice of this size, drawn into a plane of the same size.
Picture Outline(unsigned long width, unsigned long height) {
  Drawing<std::uint16_t> drawing(width, height);
  drawing.op.SetBorderValue(kBorder);
  dSlice slice;
  MakeFlat(slice, width, height, kPixel, 0);
  drawing.DrawSlice(slice);
  return PictureOf(drawing);
}

TEST(opSliceOutline, MarksTheCornerAtTheFirstPixel) {
  EXPECT_EQ(Outline(20, 20), (Picture{"####################",  //
                                      "########...........#",  //
                                      "########...........#",  //
                                      "########...........#",  //
                                      "########...........#",  //
                                      "########...........#",  //
                                      "########...........#",  //
                                      "########...........#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "#..................#",  //
                                      "####################"}));
}

TEST(opSliceOutline, SmallSlicesAreAllBorder) {
  for (const unsigned long width : {1UL, 2UL, 3UL, 8UL, 9UL}) {
    for (const unsigned long height : {1UL, 2UL, 3UL, 8UL, 9UL}) {
      EXPECT_EQ(Outline(width, height), Picture(height, std::string(width, '#')))
          << width << " x " << height;
    }
  }
  EXPECT_EQ(Outline(20, 1), Picture{"####################"});
  EXPECT_EQ(Outline(20, 2), Picture(2, "####################"));
  EXPECT_EQ(Outline(1, 20), Picture(20, "#"));
  EXPECT_EQ(Outline(2, 20), Picture(20, "##"));
}

TEST(opSliceOutline, MarkEndsAtTheEighthRowAndColumn) {
  EXPECT_EQ(Outline(12, 5), (Picture{"############",  //
                                     "########...#",  //
                                     "########...#",  //
                                     "########...#",  //
                                     "############"}));
  EXPECT_EQ(Outline(5, 12), (Picture{"#####", "#####", "#####", "#####", "#####", "#####", "#####",
                                     "#####", "#...#", "#...#", "#...#", "#####"}));
  EXPECT_EQ(Outline(10, 10), (Picture{"##########",  //
                                      "########.#",  //
                                      "########.#",  //
                                      "########.#",  //
                                      "########.#",  //
                                      "########.#",  //
                                      "########.#",  //
                                      "########.#",  //
                                      "#........#",  //
                                      "##########"}));
}

TEST(opSliceOutline, MarkTurnsWithTheSlice) {
  Drawing<std::uint16_t> drawing(5, 12);
  drawing.op.SetBorderValue(kBorder);
  dSlice slice;  // its columns run down, its rows to the left
  MakeFlat(slice, 12, 5, kPixel, 0);
  slice.SetCoordinates(dVect3D(4, 0, 0), dVect3D(0, 1, 0), dVect3D(-1, 0, 0), dVect3D(0, 0, 1));
  drawing.DrawSlice(slice);
  EXPECT_EQ(PictureOf(drawing), (Picture{"#####", "#####", "#####", "#####", "#####", "#####",
                                         "#####", "#####", "#...#", "#...#", "#...#", "#####"}));
  Drawing<std::uint16_t> mirrored(12, 5);
  mirrored.op.SetBorderValue(kBorder);
  slice.SetCoordinates(dVect3D(11, 4, 0), dVect3D(-1, 0, 0), dVect3D(0, -1, 0), dVect3D(0, 0, 1));
  mirrored.DrawSlice(slice);
  EXPECT_EQ(PictureOf(mirrored), (Picture{"############",  //
                                          "#...########",  //
                                          "#...########",  //
                                          "#...########",  //
                                          "############"}));
}

TEST(opSliceOutline, InnerPixelsKeepTheirPlaces) {
  Drawing<std::uint16_t> drawing(11, 11);
  Unsigned samples;
  for (std::uint16_t i = 0; i < 121; ++i) {
    samples.push_back(i);
  }
  dSlice slice;
  rasters::MakeOf(slice.GetImage(), {.width = 11, .height = 11, .type = ImageDataType_U16},
                  samples);
  drawing.DrawSlice(slice);
  const Unsigned pixels = drawing.Pixels();
  EXPECT_EQ(pixels[8 * 11 + 8], 8 * 11 + 8);
  EXPECT_EQ(pixels[9 * 11 + 1], 9 * 11 + 1);
  EXPECT_EQ(pixels[1 * 11 + 9], 1 * 11 + 9);
  EXPECT_EQ(pixels[7 * 11 + 7], 0xFFFF);
}

TEST(opSliceOutline, BorderOfSignedSlicesTakesTheSameBits) {
  Drawing<std::int16_t> drawing(1, 1, ImageDataType_S16);
  dSlice slice;
  MakeFlat<std::int16_t>(slice, 1, 1, -300, 0, ImageDataType_S16);
  drawing.DrawSlice(slice);
  EXPECT_EQ(drawing.Pixels(), Signed{-1});
}

TEST(opSliceOutline, PartsOutsideThePlaneAreNotDrawn) {
  Drawing<std::uint16_t> drawing(4, 3);
  drawing.op.SetBorderValue(kBorder);
  dSlice slice;
  MakeFlat(slice, 2, 2, kPixel, 0);
  slice.SetPosition(dVect3D(-1, -1, 0));
  drawing.DrawSlice(slice);
  EXPECT_EQ(PictureOf(drawing), (Picture{"#___", "____", "____"}));
  slice.SetPosition(dVect3D(3.5F, 2.5F, 0));
  drawing.DrawSlice(slice);
  EXPECT_EQ(PictureOf(drawing), (Picture{"#___", "____", "___#"}));
  for (const auto& [x, y] : {std::pair(4.0F, 0.0F), {0.0F, 3.0F}, {-2.0F, 0.0F}, {0.0F, -2.0F}}) {
    slice.SetPosition(dVect3D(x, y, 0));
    drawing.DrawSlice(slice);
  }
  EXPECT_EQ(PictureOf(drawing), (Picture{"#___", "____", "___#"}));
}

TEST(opSliceOutline, NearerSlicesHideFartherOnes) {
  Drawing<std::uint16_t> drawing(2, 1);
  dSlice far, near;
  MakeFlat(far, 1, 1, kPixel, 10);
  MakeFlat(near, 2, 1, kPixel, 5);
  drawing.op.SetBorderValue(1);
  drawing.DrawSlice(far);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{1, 0}));
  EXPECT_EQ(drawing.Depths(), (Depths{10, 32767}));
  drawing.op.SetBorderValue(2);
  drawing.DrawSlice(near);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{2, 2}));
  EXPECT_EQ(drawing.Depths(), (Depths{5, 5}));
  drawing.op.SetBorderValue(3);
  drawing.DrawSlice(far);
  EXPECT_EQ(drawing.Pixels(), (Unsigned{2, 2}));
  EXPECT_EQ(drawing.Depths(), (Depths{5, 5}));
}

TEST(opSliceOutline, TiesKeepTheEarlierDrawing) {
  Drawing<std::uint16_t> drawing(1, 1);
  dSlice slice;
  MakeFlat(slice, 1, 1, kPixel, 3);
  drawing.op.SetBorderValue(1);
  drawing.DrawSlice(slice);
  slice.SetPosition(dVect3D(0, 0, 3.9F));  // in the same whole step
  drawing.op.SetBorderValue(2);
  drawing.DrawSlice(slice);
  EXPECT_EQ(drawing.Pixels(), Unsigned{1});
}

// Two columns and two rows of the slice fall onto each pixel: the first of them stays.
TEST(opSliceOutline, TiesWithinASliceKeepTheFirstPixel) {
  Drawing<std::uint16_t> drawing(10, 10);
  drawing.op.SetBorderValue(kBorder);
  dSlice slice;
  MakeFlat(slice, 20, 20, kPixel, 0);
  slice.GetCoordinates().axisX = dVect3D(0.5F, 0, 0);
  slice.GetCoordinates().axisY = dVect3D(0, 0.5F, 0);
  drawing.DrawSlice(slice);
  EXPECT_EQ(PictureOf(drawing), (Picture{"##########",  //
                                         "####......",  //
                                         "####......",  //
                                         "####......",  //
                                         "#.........",  //
                                         "#.........",  //
                                         "#.........",  //
                                         "#.........",  //
                                         "#.........",  //
                                         "#........."}));
}

TEST(opSliceOutline, DepthsAreWholeStepsRoundedDown) {
  Drawing<std::uint16_t> drawing(5, 1);
  dSlice slice;
  MakeFlat(slice, 5, 1, kPixel, -0.75F);
  slice.GetCoordinates().axisX = dVect3D(1, 0, 0.5F);
  drawing.DrawSlice(slice);
  EXPECT_EQ(drawing.Depths(), (Depths{-1, -1, 0, 0, 1}));
}

TEST(opSliceOutline, DepthsAreMeasuredInThicknessesOfThePlane) {
  Drawing<std::uint16_t> drawing(1, 1);
  drawing.plane.GetCoordinates().axisZ = dVect3D(0, 0, -2);
  dSlice slice;
  MakeFlat(slice, 1, 1, kPixel, 7);
  drawing.DrawSlice(slice);
  EXPECT_EQ(drawing.Depths(), Depths{-4});  // -3.5
}

TEST(opSliceOutline, DepthsAsFarAsTheFarthestAreNotDrawn) {
  Drawing<std::uint16_t> drawing(1, 1);
  dSlice slice;
  for (const float depth : {32767.0F, 40000.0F, 1e30F}) {
    MakeFlat(slice, 1, 1, kPixel, depth);
    drawing.DrawSlice(slice);
    EXPECT_EQ(drawing.Pixels(), Unsigned{0});
    EXPECT_EQ(drawing.Depths(), Depths{32767});
  }
  MakeFlat(slice, 1, 1, kPixel, 32766);
  drawing.DrawSlice(slice);
  EXPECT_EQ(drawing.Depths(), Depths{32766});
  MakeFlat(slice, 1, 1, kPixel, -1e30F);
  drawing.DrawSlice(slice);
  EXPECT_EQ(drawing.Depths(), Depths{-32768});
}

TEST(opSliceOutline, SlicesWithoutAPlaceAreNotDrawn) {
  const float nan = std::numeric_limits<float>::quiet_NaN();
  const float infinite = std::numeric_limits<float>::infinity();
  for (const float odd : {nan, infinite, -infinite}) {
    for (int part = 0; part < 4; ++part) {
      Drawing<std::uint16_t> drawing(3, 3);
      dSlice slice;
      MakeFlat(slice, 2, 2, kPixel, 0);
      dCoordSys3D& place = slice.GetCoordinates();
      (part == 0   ? place.origin
       : part == 1 ? place.axisX
       : part == 2 ? place.axisY
                   : place.axisZ) = dVect3D(odd, odd, odd);
      drawing.DrawSlice(slice);
      EXPECT_EQ(drawing.Pixels(), Unsigned(9, 0));
    }
  }
}

TEST(opSliceOutline, PlanesOf32768PixelsAndMoreWrapTheirLimits) {
  for (const auto& [width, drawn] : {std::pair(32768UL, 0), {65536UL + 5, 5}}) {
    Drawing<std::uint16_t> drawing(width, 1);
    dSlice slice;
    MakeFlat(slice, 10, 1, kPixel, 0);
    drawing.DrawSlice(slice);
    const Unsigned pixels = drawing.Pixels();
    EXPECT_EQ(std::count(pixels.begin(), pixels.end(), 0xFFFF), drawn);
    EXPECT_EQ(std::count(pixels.begin(), pixels.begin() + drawn, 0xFFFF), drawn);
  }
}

TEST(opSliceOutline, PlaneCanBeDrawnIntoItself) {
  Drawing<std::uint16_t> drawing(3, 3);
  drawing.op.SetBorderValue(kBorder);
  drawing.DrawSlice(drawing.plane);
  EXPECT_EQ(PictureOf(drawing), Picture(3, "###"));
}

}  // namespace
