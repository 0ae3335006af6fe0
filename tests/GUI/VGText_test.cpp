#include <vorl/GUI/VGText.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;

/// A visible, selectable text that may be moved.
VGTextView TextView(float x, float y) {
  VGText text;
  text = "text";
  text.SetPos(x, y, 0);
  VGTextView view(text);
  view.SetViewState(VGViewState_Visible);
  view.Enable(VGOperation_Select | VGOperation_Move);
  return view;
}

TEST(VGText, StartsEmptyAndCentred) {
  const VGText text;
  EXPECT_STREQ(text.GetText(), "");
  EXPECT_EQ(At(text.GetPos()), "0 0");
  EXPECT_EQ(text.GetAlignment(), 15);
}

TEST(VGText, OwnsItsText) {
  char words[] = "before";
  VGText text;
  text.SetPos(1.0F, 2.0F, 3);
  text = words;
  words[0] = 'B';
  EXPECT_STREQ(text.GetText(), "before");
  text = text.GetText() + 3;
  EXPECT_STREQ(text.GetText(), "ore") << "a part of itself";
  const VGText copy(text);
  text = nullptr;
  EXPECT_STREQ(text.GetText(), "");
  EXPECT_STREQ(copy.GetText(), "ore");
  EXPECT_EQ(At(copy.GetPos()), "1 2");
  EXPECT_EQ(copy.GetAlignment(), 3);
  VGText assigned;
  assigned = copy;
  EXPECT_STREQ(assigned.GetText(), "ore");
  EXPECT_EQ(At(assigned.GetPos()), "1 2");
  EXPECT_EQ(assigned.GetAlignment(), 3);
}

TEST(VGText, PositionAndAlignmentAreSetTogether) {
  VGText text;
  text.SetPos(dVect2D(1.5F, 2.5F), 5);
  EXPECT_EQ(At(text.GetPos()), "1.5 2.5");
  EXPECT_EQ(text.GetAlignment(), 5);
  text.SetPos(tagPOINT{3, 4}, -1);
  EXPECT_EQ(At(text.GetPos()), "3 4");
  EXPECT_EQ(text.GetAlignment(), -1);
  text.SetPos(7.0F, 8.0F, 10);
  EXPECT_EQ(At(text.GetPos()), "7 8");
  EXPECT_EQ(text.GetAlignment(), 10);
  text.SetAlignment(3);
  EXPECT_EQ(At(text.GetPos()), "7 8");
  EXPECT_EQ(text.GetAlignment(), 3);
}

TEST(VGText, TransformMapsTheAnchorAsAPoint) {
  Translate2D move(10, 20);
  VGText text;
  text.SetPos(1.0F, 2.0F, 0);
  text.Transform(&move, false);
  EXPECT_EQ(At(text.GetPos()), "11 22");
  text.Transform(nullptr, true);
  EXPECT_EQ(At(text.GetPos()), "11 22");
  text.Transform(&move, true);
  EXPECT_EQ(At(text.GetPos()), "1 2");
}

TEST(VGTextView, Defaults) {
  const VGTextView view;
  EXPECT_EQ(view.GetFont(), nullptr);
  EXPECT_TRUE(view.IsTransparent());
  EXPECT_EQ(view.GetBgColor(), 0xFFFFFF);
  EXPECT_EQ(view.GetPenColor(), 0);
  EXPECT_EQ(view.GetAlignment(), 15);
}

TEST(VGTextView, IsATextInViewCoordinates) {
  Scale2D scale(2, 2, 0, 0);
  VGTextView view = TextView(3, 4);
  EXPECT_EQ(view.GetObjType(), 7);
  view.SetTransformation(&scale);
  EXPECT_EQ(At(view.GetViewPos()), "6 8");
  EXPECT_EQ(BoxOf(view), "6 8 6 8");
  view.SetViewPos(dVect2D(20, 30));
  EXPECT_EQ(At(view.GetPos()), "10 15");
  EXPECT_EQ(At(view.GetViewPos()), "20 30");
  EXPECT_EQ(view.GetAlignment(), 0);
  VGText text;
  text = "other";
  text.SetPos(1.0F, 2.0F, 5);
  view.SetData(text);
  EXPECT_EQ(At(view.GetViewPos()), "2 4");
  EXPECT_STREQ(view.GetText(), "other");
  EXPECT_EQ(view.GetAlignment(), 5);
  view = "third";
  EXPECT_STREQ(view.GetText(), "third");
  EXPECT_EQ(At(view.GetViewPos()), "2 4");
}

TEST(VGTextView, CopiesFromTextsAndViews) {
  Scale2D scale(2, 2, 0, 0);
  VGTextView view = TextView(3, 4);
  view.SetTransformation(&scale);
  auto* const font = static_cast<HFONT>(GetStockObject(SYSTEM_FONT));
  view.SetFont(font);
  view.SetTransparent(false);
  view.SetBgColor(0x123456);
  VGTextView assigned;
  assigned = view;
  for (const VGTextView& copy : {VGTextView(view), assigned}) {
    EXPECT_STREQ(copy.GetText(), "text");
    EXPECT_EQ(At(copy.GetPos()), "3 4");
    EXPECT_EQ(copy.GetFont(), font);
    EXPECT_FALSE(copy.IsTransparent());
    EXPECT_EQ(copy.GetBgColor(), 0x123456);
  }
  EXPECT_EQ(At(VGTextView(view).GetViewPos()), "6 8");
  EXPECT_EQ(At(assigned.GetViewPos()), "3 4") << "it has its own transformation";
  VGText text;
  text.SetPos(1.0F, 1.0F, 0);
  view = text;
  EXPECT_EQ(At(view.GetViewPos()), "2 2");
  EXPECT_EQ(view.GetFont(), font);
}

}  // namespace
