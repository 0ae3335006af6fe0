// Where texts stand, and how. Places are compared with a text that the device drew by itself, its
// box measured, because fonts differ from machine to machine.
#include <vorl/GUI/VGText.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::Lit;
using gui_testing::RopOf;
using Pixels = std::set<std::pair<int, int>>;

constexpr int kWidth = 128;
constexpr int kHeight = 64;

VGTextView TextView(const char* words, float x, float y, short alignment) {
  VGText text;
  text = words;
  text.SetPos(x, y, alignment);
  VGTextView view(text);
  view.SetViewState(VGViewState_Visible);
  view.SetPenColor(0x0000FF);
  return view;
}

tagRECT SizeOf(const char* words, HFONT font = nullptr) {
  Canvas canvas(1, 1);
  HGDIOBJ old = font != nullptr ? SelectObject(canvas, font) : nullptr;
  tagRECT size{0, 0, 0, 0};
  DrawTextA(canvas, words, -1, &size, DT_CALCRECT);
  if (old != nullptr) {
    SelectObject(canvas, old);
  }
  EXPECT_GT(size.right, 0);
  EXPECT_GT(size.bottom, 0);
  return size;
}

/// The pixels of a text whose box begins at a place.
Pixels TextAt(const char* words, int left, int top) {
  Canvas canvas(kWidth, kHeight);
  canvas.Fill(0);
  SetBkMode(canvas, TRANSPARENT);
  SetTextColor(canvas, 0x0000FF);
  tagRECT rect{left, top, 2 * kWidth, 2 * kHeight};
  DrawTextA(canvas, words, -1, &rect, 0);
  EXPECT_FALSE(Lit(canvas).empty());
  return Lit(canvas);
}

struct AlignmentCase {
  const char* name;
  short alignment;
  int x;  ///< of the text's left edge, in half widths
  int y;  ///< of its top edge, in half heights
};

class VGTextAlignment : public ::testing::TestWithParam<AlignmentCase> {};

TEST_P(VGTextAlignment, PlacesTheText) {
  const AlignmentCase& c = GetParam();
  const char* const words = "Wxyg";
  const tagRECT size = SizeOf(words);
  Canvas canvas(kWidth, kHeight);
  canvas.Fill(0);
  VGTextView view = TextView(words, 60, 30, c.alignment);
  view.VGObjectView::Draw(canvas);
  const int left = static_cast<int>(60 - c.x * size.right / 2.0);
  const int top = static_cast<int>(30 - c.y * size.bottom / 2.0);
  EXPECT_EQ(Lit(canvas), TextAt(words, left, top));
}

INSTANTIATE_TEST_SUITE_P(
    All, VGTextAlignment,
    ::testing::Values(
        AlignmentCase{"TopLeft", 0, 0, 0}, AlignmentCase{"BottomLeft", 1, 0, 2},
        AlignmentCase{"TopLeftToo", 2, 0, 0}, AlignmentCase{"MiddleLeft", 3, 0, 1},
        AlignmentCase{"TopRight", 4, 2, 0}, AlignmentCase{"BottomRight", 5, 2, 2},
        AlignmentCase{"TopRightToo", 6, 2, 0}, AlignmentCase{"MiddleRight", 7, 2, 1},
        AlignmentCase{"TopLeftOfEight", 8, 0, 0}, AlignmentCase{"BottomLeftOfNine", 9, 0, 2},
        AlignmentCase{"TopLeftOfTen", 10, 0, 0}, AlignmentCase{"MiddleLeftOfEleven", 11, 0, 1},
        AlignmentCase{"TopMiddle", 12, 1, 0}, AlignmentCase{"BottomMiddle", 13, 1, 2},
        AlignmentCase{"TopMiddleToo", 14, 1, 0}, AlignmentCase{"Centre", 15, 1, 1},
        AlignmentCase{"HigherBitsDoNothing", 0x70, 0, 0}, AlignmentCase{"AllBits", -1, 1, 1}),
    [](const auto& instance) { return instance.param.name; });

TEST(VGTextViewDraw, PlaceLosesItsDecimalsTowardsZero) {
  const char* const words = "abc";
  Canvas canvas(kWidth, kHeight);
  canvas.Fill(0);
  VGTextView view = TextView(words, 10.9F, -0.9F, 0);
  view.DrawGraphic(canvas);
  EXPECT_EQ(Lit(canvas), TextAt(words, 10, 0));
}

TEST(VGTextViewDraw, TransparentTextHasThePenColourOnly) {
  Canvas canvas(kWidth, kHeight);
  canvas.Fill(0);
  VGTextView view = TextView("Wxyg", 10, 10, 0);
  view.SetBgColor(0x00FF00);
  view.DrawGraphic(canvas);
  ASSERT_FALSE(Lit(canvas).empty());
  for (const auto& [x, y] : Lit(canvas)) {
    EXPECT_EQ(canvas.At(x, y) & 0xFFFF00U, 0u) << x << " " << y;
  }
}

TEST(VGTextViewDraw, OpaqueTextFillsItsBox) {
  const tagRECT size = SizeOf("Wxyg");
  Canvas canvas(kWidth, kHeight);
  canvas.Fill(0);
  VGTextView view = TextView("Wxyg", 10, 10, 0);
  view.SetTransparent(false);
  view.SetBgColor(0x00FF00);
  view.DrawGraphic(canvas);
  Pixels box;
  int background = 0;
  for (int y = 10; y < 10 + size.bottom; ++y) {
    for (int x = 10; x < 10 + size.right; ++x) {
      box.insert({x, y});
      background += canvas.At(x, y) == 0x00FF00 ? 1 : 0;
    }
  }
  EXPECT_EQ(Lit(canvas), box);
  EXPECT_GT(background, 0);
  EXPECT_LT(background, size.right * size.bottom);
}

TEST(VGTextViewDraw, OwnFontIsMeasuredAndDrawn) {
  HFONT font = CreateFontA(40, 0, 0, 0, FW_NORMAL, 0, 0, 0, DEFAULT_CHARSET, OUT_DEFAULT_PRECIS,
                           CLIP_DEFAULT_PRECIS, DEFAULT_QUALITY, DEFAULT_PITCH, nullptr);
  const tagRECT size = SizeOf("M", font);
  EXPECT_GT(size.bottom, SizeOf("M").bottom);
  Canvas canvas(kWidth, kHeight);
  canvas.Fill(0);
  VGTextView view = TextView("M", 100, 60, 5);
  view.SetFont(font);
  view.SetTransparent(false);
  view.DrawGraphic(canvas);
  Pixels box;
  for (int y = 60 - size.bottom; y < 60; ++y) {
    for (int x = 100 - size.right; x < 100; ++x) {
      box.insert({x, y});
    }
  }
  // The letter is not black, so that all of the box is lit.
  EXPECT_EQ(Lit(canvas), box);
  DeleteObject(font);
}

TEST(VGTextViewDraw, DeviceContextIsRestored) {
  Canvas canvas(kWidth, kHeight);
  HFONT font = CreateFontA(40, 0, 0, 0, FW_NORMAL, 0, 0, 0, DEFAULT_CHARSET, OUT_DEFAULT_PRECIS,
                           CLIP_DEFAULT_PRECIS, DEFAULT_QUALITY, DEFAULT_PITCH, nullptr);
  HGDIOBJ fontBefore = GetCurrentObject(canvas, OBJ_FONT);
  HGDIOBJ penBefore = GetCurrentObject(canvas, OBJ_PEN);
  SetROP2(canvas, R2_NOT);
  SetBkMode(canvas, OPAQUE);
  SetTextColor(canvas, 0x010203);
  SetBkColor(canvas, 0x040506);
  VGTextView view = TextView("Wxyg", 10, 10, 0);
  view.SetFont(font);
  view.Select(true);
  view.VGObjectView::Draw(canvas);
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_FONT), fontBefore);
  EXPECT_EQ(GetCurrentObject(canvas, OBJ_PEN), penBefore);
  EXPECT_EQ(RopOf(canvas), R2_NOT);
  EXPECT_EQ(SetBkMode(canvas, TRANSPARENT), OPAQUE);
  EXPECT_EQ(SetTextColor(canvas, 0), 0x010203u);
  EXPECT_EQ(SetBkColor(canvas, 0), 0x040506u);
  EXPECT_NE(DeleteObject(font), 0) << "no context holds it any more";
}

TEST(VGTextViewDraw, NothingAndNowhereAreDrawnWithoutHarm) {
  Canvas canvas(16, 16);
  canvas.Fill(0);
  TextView("", 8, 8, 15).DrawGraphic(canvas);
  for (const float distant : {1e30F, -1e30F, INFINITY, NAN}) {
    TextView("far", distant, 1e30F, 15).DrawGraphic(canvas);
  }
  EXPECT_EQ(Lit(canvas), Pixels{});
  TextView("far", 8, 8, 15).DrawGraphic(nullptr);
}

}  // namespace
