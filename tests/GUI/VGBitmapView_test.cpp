#include <vorl/GUI/VGBitmapView.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::At;
using gui_testing::BoxOf;
using gui_testing::Hand;
using gui_testing::IsHit;
using gui_testing::StateAt;

std::string Corners(const Rect2D& rect) {
  return At(rect.GetTL()) + " - " + At(rect.GetBR());
}

std::string ViewCorners(const VGBitmapView& view) {
  Rect2D rect;
  view.ViewRect(rect);
  return Corners(rect);
}

dImage GreyImage(int width, int height) {
  return NumberedImage(width, height, ImageDataType_U8, "G");
}

/// A visible, selectable view of an image that may be moved and modified.
class Picture : public VGBitmapView {
 public:
  Picture(dImage& image, float x1, float y1, float x2, float y2) {
    EXPECT_TRUE(Init(&image, x1, y1, x2, y2));
    SetViewState(VGViewState_Visible);
    Enable(VGOperation_Select | VGOperation_Move | VGOperation_Modify);
  }
};

TEST(VGBitmapView, StartsWithoutAnImage) {
  VGBitmapView view;
  EXPECT_EQ(view.GetObjType(), 4);
  EXPECT_EQ(view.GetImage(), nullptr);
  EXPECT_EQ(Corners(view.BaseRect()), "0 0 - 0 0");
  EXPECT_EQ(ViewCorners(view), "0 0 - 0 0");
  EXPECT_FALSE(view.IsVisible());
  EXPECT_EQ(view.GetPalette(), nullptr);
  EXPECT_EQ(view.GetPaletteSize(), 0);
  EXPECT_FALSE(view.ResetPalette(true));
}

TEST(VGBitmapView, ImageLiesOnItsPixels) {
  dImage image = GreyImage(8, 4);
  image.SetPosition(-3, 5);
  VGBitmapView view;
  EXPECT_TRUE(view.Init(&image));
  EXPECT_EQ(view.GetImage(), &image);
  EXPECT_EQ(Corners(view.BaseRect()), "-3 5 - 5 9");
  EXPECT_EQ(ViewCorners(view), "-3 5 - 5 9");
  dVect2D p(1.5F, 6);
  view.Graphic2Bitmap(p);
  EXPECT_EQ(At(p), "1.5 6") << "pixels count from the position";
  EXPECT_TRUE(view.Init(nullptr));
  EXPECT_EQ(view.GetImage(), nullptr);
  EXPECT_EQ(Corners(view.BaseRect()), "0 0 - 0 0");
}

TEST(VGBitmapView, BaseRectangleCanBeGiven) {
  dImage image = GreyImage(8, 4);
  VGBitmapView view;
  EXPECT_TRUE(view.Init(&image, 1.5F, 2, 17.5F, 6));
  EXPECT_EQ(Corners(view.BaseRect()), "1.5 2 - 17.5 6");
  EXPECT_TRUE(view.Init(&image, dVect2D(1, 2), dVect2D(3, 4)));
  EXPECT_EQ(Corners(view.BaseRect()), "1 2 - 3 4");
  EXPECT_TRUE(view.Init(&image, tagPOINT{5, 6}, tagPOINT{-7, 8}));
  Rect2D rect;
  view.BaseRect(rect);
  EXPECT_EQ(Corners(rect), "5 6 - -7 8");
  EXPECT_TRUE(view.Init(nullptr, 1, 2, 3, 4));
  EXPECT_EQ(Corners(view.BaseRect()), "1 2 - 3 4");
}

TEST(VGBitmapView, ImageThatCannotBeDrawnIsReported) {
  dImage words = NumberedImage(8, 4, ImageDataType_U8, "G");
  ASSERT_TRUE(words.Init(8, 4, ImageDataType_U16, "G", ImageDataOrder_Pixel, 4));
  VGBitmapView view;
  EXPECT_FALSE(view.Init(&words));
  EXPECT_STREQ(static_cast<const char*>(view.GetStatus()),
               "not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order");
  EXPECT_EQ(view.GetImage(), &words);
  EXPECT_EQ(Corners(view.BaseRect()), "0 0 - 8 4");
  dImage empty;
  EXPECT_FALSE(view.Init(&empty));
  EXPECT_STREQ(static_cast<const char*>(view.GetStatus()), "uninitialized image");
  words = GreyImage(8, 4);
  EXPECT_TRUE(view.Init(&words));
  EXPECT_TRUE(view.GetStatus().IsOK());
}

TEST(VGBitmapView, MapsBetweenGraphicsAndPixels) {
  dImage image = GreyImage(8, 4);
  image.SetPosition(100, 200);
  VGBitmapView view;
  view.Init(&image, 10, 20, 26, 40);  // 2 by 5 units for a pixel
  dVect2D p(12, 30);
  dVect2D q;
  view.Graphic2Bitmap(p, q);
  EXPECT_EQ(At(q), "101 202");
  view.Bitmap2Graphic(q);
  EXPECT_EQ(At(q), "12 30");
  view.Graphic2Bitmap(p);
  EXPECT_EQ(At(p), "101 202");
  view.Bitmap2Graphic(p, q);
  EXPECT_EQ(At(q), "12 30");
  Rect2D r(10, 20, 26, 40);
  Rect2D s;
  view.Graphic2Bitmap(r, s);
  EXPECT_EQ(Corners(s), "100 200 - 108 204");
  view.Bitmap2Graphic(s);
  EXPECT_EQ(Corners(s), "10 20 - 26 40");
  view.Graphic2Bitmap(r);
  EXPECT_EQ(Corners(r), "100 200 - 108 204");
  view.Bitmap2Graphic(r, s);
  EXPECT_EQ(Corners(s), "10 20 - 26 40");
}

TEST(VGBitmapView, IntegersAreMappedByPixelCentres) {
  dImage image = GreyImage(8, 4);
  VGBitmapView view;
  view.Init(&image, 10, 20, 26, 40);
  tagPOINT p{13, 29};
  tagPOINT q{};
  view.Graphic2Bitmap(p, q);
  EXPECT_EQ(q.x, 1) << "3.5 / 2";
  EXPECT_EQ(q.y, 1) << "9.5 / 5";
  view.Bitmap2Graphic(q);
  EXPECT_EQ(q.x, 13) << "10 + 1.5 * 2";
  EXPECT_EQ(q.y, 27) << "20 + 1.5 * 5";
  view.Graphic2Bitmap(p);
  EXPECT_EQ(p.x, 1);
  view.Bitmap2Graphic(p, q);
  EXPECT_EQ(q.x, 13);
  tagRECT r{10, 20, 25, 39};
  tagRECT s{};
  view.Graphic2Bitmap(r, s);
  EXPECT_EQ(RectText(s), "0 0 7 3");
  view.Bitmap2Graphic(s);
  EXPECT_EQ(RectText(s), "11 22 25 37");
  view.Graphic2Bitmap(r);
  EXPECT_EQ(RectText(r), "0 0 7 3");
  view.Bitmap2Graphic(r, s);
  EXPECT_EQ(RectText(s), "11 22 25 37");
}

TEST(VGBitmapView, BitmapTransformationNeedsAnImageAndAnArea) {
  dImage image = GreyImage(8, 4);
  VGBitmapView view;
  const auto mapped = [&view] {
    dVect2D p(3, 7);
    view.Graphic2Bitmap(p);
    return At(p);
  };
  view.Init(nullptr, 0, 0, 80, 40);
  EXPECT_EQ(mapped(), "3 7");
  view.Init(&image, 0, 0, 80, 40);
  EXPECT_EQ(mapped(), "0.3 0.7");
  view.Init(&image, 5, 0, 5, 40);
  EXPECT_EQ(mapped(), "3 7");
  view.Init(&image, 0, 5, 80, 5);
  EXPECT_EQ(mapped(), "3 7");
  view.BaseRect().Set(0, 0, 16, 16);
  EXPECT_EQ(mapped(), "3 7") << "until it is updated";
  view.UpdateBitmapTrafo();
  EXPECT_EQ(mapped(), "1.5 1.75");
  EXPECT_EQ(ViewCorners(view), "0 5 - 80 5");
  view.Transform(false);
  EXPECT_EQ(ViewCorners(view), "0 0 - 16 16");
}

TEST(VGBitmapView, ViewRectangleFollowsTheMap) {
  Scale2D scale(2, 3, 0, 0);
  dImage image = GreyImage(8, 4);
  VGBitmapView view;
  view.Init(&image);
  view.SetTransformation(&scale);
  EXPECT_EQ(ViewCorners(view), "0 0 - 16 12");
  EXPECT_EQ(BoxOf(view), "0 0 16 12");
  view.Init(&image, 4, 5, 3, 1);
  EXPECT_EQ(ViewCorners(view), "8 15 - 6 3");
  EXPECT_EQ(BoxOf(view), "6 3 8 15");
}

TEST(VGBitmapView, CopiesShowTheSameImage) {
  Scale2D scale(2, 2, 0, 0);
  dImage image = GreyImage(8, 4);
  Picture view(image, 0, 0, 16, 16);
  view.SetTransformation(&scale);
  const VGBitmapView copy(view);
  EXPECT_EQ(ViewCorners(copy), "0 0 - 32 32");
  VGBitmapView assigned;
  assigned = view;
  EXPECT_EQ(ViewCorners(assigned), "0 0 - 16 16") << "by its own map";
  for (const VGBitmapView* other : {&copy, static_cast<const VGBitmapView*>(&assigned)}) {
    EXPECT_EQ(other->GetImage(), &image);
    EXPECT_EQ(Corners(other->BaseRect()), "0 0 - 16 16");
    EXPECT_EQ(other->GetPaletteSize(), 256);
    EXPECT_NE(other->GetPalette(), view.GetPalette());
    dVect2D p(8, 8);
    other->Graphic2Bitmap(p);
    EXPECT_EQ(At(p), "4 2");
    EXPECT_TRUE(other->IsVisible());
  }
}

TEST(VGBitmapView, PaletteIsTheRenderersOwn) {
  dImage image = GreyImage(8, 4);
  VGBitmapView view;
  view.Init(&image);
  ASSERT_EQ(view.GetPaletteSize(), 256);
  ASSERT_NE(view.GetPalette(), nullptr);
  EXPECT_EQ(view.GetPalette()[200].rgbRed, 200);
  EXPECT_TRUE(view.ResetPalette(false));
  EXPECT_EQ(view.GetPalette()[200].rgbRed, 55);
  EXPECT_TRUE(view.UpdateViewer());
  EXPECT_EQ(view.GetPalette()[200].rgbRed, 200);
  dImage colours = NumberedImage(8, 4, ImageDataType_U8, "BGR");
  view.Init(&colours);
  EXPECT_EQ(view.GetPaletteSize(), 0);
  EXPECT_EQ(view.GetPalette(), nullptr);
  EXPECT_FALSE(view.ResetPalette(true));
}

TEST(VGBitmapView, InsideIsHit) {
  dImage image = GreyImage(8, 4);
  Picture view(image, 10, 20, 50, 60);
  EXPECT_TRUE(IsHit(view, 30, 40, 0));
  EXPECT_TRUE(IsHit(view, 10, 20, 0));
  EXPECT_TRUE(IsHit(view, 50, 60, 0));
  EXPECT_FALSE(IsHit(view, 9, 40, 5)) << "whatever the tolerance";
  EXPECT_FALSE(IsHit(view, 30, 61, 5));
  Picture swapped(image, 50, 60, 10, 20);
  EXPECT_TRUE(IsHit(swapped, 30, 40, 0));
  VGBitmapView none;
  EXPECT_FALSE(IsHit(none, 0, 0, 5));
}

TEST(VGBitmapView, HandlesAreGrabbedBeforeTheInside) {
  dImage image = GreyImage(8, 4);
  Picture view(image, 10, 20, 50, 80);
  EXPECT_EQ(StateAt(view, 6, 20), 4);
  EXPECT_EQ(StateAt(view, 5, 20), 0);
  EXPECT_EQ(StateAt(view, 14, 20), 4);
  EXPECT_EQ(StateAt(view, 15, 20), 8);
  EXPECT_EQ(StateAt(view, 30, 50), 8);
  EXPECT_EQ(StateAt(view, 20, 18), 0);
  view.Disable(2);
  EXPECT_EQ(StateAt(view, 30, 50), 0);
  view.Enable(2);
  view.ResetViewState(2);
  EXPECT_EQ(StateAt(view, 30, 50), 0);
}

struct HandleCase {
  const char* name;
  float x;
  float y;
  const char* after;  ///< a drag by (3, 5)
};

class VGBitmapViewHandle : public ::testing::TestWithParam<HandleCase> {};

TEST_P(VGBitmapViewHandle, PullsItsEdges) {
  const HandleCase& handle = GetParam();
  dImage image = GreyImage(8, 4);
  Picture view(image, 10, 20, 50, 80);
  view.SetROPMode(R2_NOT);
  Hand hand(view);
  EXPECT_TRUE(hand.Down(handle.x, handle.y));
  EXPECT_EQ(view.GetOpState(), 4);
  EXPECT_TRUE(hand.Move(handle.x + 3, handle.y + 5));
  EXPECT_TRUE(hand.Up(handle.x + 3, handle.y + 5));
  EXPECT_EQ(Corners(view.BaseRect()), handle.after);
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_EQ(view.GetROPMode(), R2_NOT);
}

INSTANTIATE_TEST_SUITE_P(All, VGBitmapViewHandle,
                         ::testing::Values(HandleCase{"TopLeft", 10, 20, "13 25 - 50 80"},
                                           HandleCase{"TopMiddle", 30, 20, "10 25 - 50 80"},
                                           HandleCase{"TopRight", 50, 20, "10 25 - 53 80"},
                                           HandleCase{"RightMiddle", 50, 50, "10 20 - 53 80"},
                                           HandleCase{"BottomRight", 50, 80, "10 20 - 53 85"},
                                           HandleCase{"BottomMiddle", 30, 80, "10 20 - 50 85"},
                                           HandleCase{"BottomLeft", 10, 80, "13 20 - 50 85"},
                                           HandleCase{"LeftMiddle", 10, 50, "13 20 - 50 80"}),
                         [](const auto& instance) { return instance.param.name; });

TEST(VGBitmapView, ResizingStretchesTheImage) {
  dImage image = GreyImage(8, 4);
  Picture view(image, 0, 0, 40, 40);
  Hand hand(view);
  hand.Drag(40, 40, 80, 20);
  dVect2D p(40, 10);
  view.Graphic2Bitmap(p);
  EXPECT_EQ(At(p), "4 2");
}

TEST(VGBitmapView, ModificationWithoutAHandleChangesNothing) {
  dImage image = GreyImage(8, 4);
  Picture view(image, 10, 20, 50, 80);
  EXPECT_EQ(StateAt(view, 10, 20), 4);
  EXPECT_EQ(StateAt(view, 30, 40), 8);
  dVect2D p(0, 0);
  EXPECT_TRUE(view.OnModify(p));
  EXPECT_EQ(Corners(view.BaseRect()), "10 20 - 50 80");
  EXPECT_EQ(StateAt(view, 10, 20), 4);
  view.ResetViewState(VGViewState_Visible);
  EXPECT_EQ(StateAt(view, 10, 20), 0);
  EXPECT_TRUE(view.OnModify(p));
  EXPECT_EQ(Corners(view.BaseRect()), "10 20 - 50 80") << "nor while it is not seen";
  view.SetViewState(VGViewState_Visible);
  EXPECT_EQ(StateAt(view, 10, 20), 4);
  EXPECT_TRUE(view.OnEndModify(p));
  EXPECT_TRUE(view.OnModify(p));
  EXPECT_EQ(Corners(view.BaseRect()), "10 20 - 50 80");
}

TEST(VGBitmapView, MoveKeepsTheSize) {
  Scale2D scale(2, 2, 0, 0);
  dImage image = GreyImage(8, 4);
  Picture view(image, 10, 20, 50, 80);
  Hand hand(view);
  hand.handler.SetTransformation(&scale);
  EXPECT_TRUE(hand.Down(40, 90));
  EXPECT_EQ(view.GetOpState(), 8);
  EXPECT_EQ(view.GetROPMode(), R2_COPYPEN);
  EXPECT_TRUE(hand.Move(50, 100));
  EXPECT_TRUE(hand.Move(60, 100));
  EXPECT_TRUE(hand.Up(60, 100));
  EXPECT_EQ(Corners(view.BaseRect()), "20 25 - 60 85");
  EXPECT_EQ(ViewCorners(view), "40 50 - 120 170");
  EXPECT_EQ(view.GetOpState(), 0);
  dVect2D p(20, 25);
  view.Graphic2Bitmap(p);
  EXPECT_EQ(At(p), "0 0") << "the pixels move with it";
}

TEST(VGBitmapView, HandlesMoveWhereModifyingIsNotAllowed) {
  dImage image = GreyImage(8, 4);
  Picture view(image, 10, 20, 50, 80);
  view.Disable(VGOperation_Modify);
  Hand hand(view);
  hand.Drag(10, 20, 13, 25);
  EXPECT_EQ(Corners(view.BaseRect()), "13 25 - 53 85");
}

TEST(VGBitmapView, CreatingDragPullsTheBottomRightCorner) {
  Scale2D scale(2, 2, 0, 0);
  dImage image = GreyImage(8, 4);
  VGBitmapView picture;
  picture.Init(&image);
  picture.SetTransformation(&scale);
  picture.Enable(VGOperation_Create);
  VGObjectView& view = picture;
  dVect2D p(20, 40);
  EXPECT_TRUE(view.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  EXPECT_EQ(ViewCorners(picture), "20 40 - 21 41");
  EXPECT_EQ(view.GetOpState(), 4);
  EXPECT_TRUE(view.IsVisible());
  EXPECT_TRUE(view.IsSelected());
  EXPECT_TRUE(view.IsEnabled(4));
  p.Set(60.0, 80.0);
  EXPECT_TRUE(view.ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_TRUE(view.ProcessMouseEvent(MouseEvent_ButtonUp, MK_LBUTTON, p));
  EXPECT_EQ(Corners(picture.BaseRect()), "10 20 - 30 40");
  EXPECT_EQ(view.GetOpState(), 0);
  p.Set(15.0, 25.0);
  picture.Graphic2Bitmap(p);
  EXPECT_EQ(At(p), "2 1");
}

TEST(VGBitmapView, CreationNeedsItsBitAndAClick) {
  VGBitmapView view;
  dVect2D p(20, 40);
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonDown, MK_LBUTTON, p));
  view.Enable(1);
  EXPECT_FALSE(view.OnCreate(MouseEvent_Move, MK_LBUTTON, p));
  EXPECT_EQ(Corners(view.BaseRect()), "0 0 - 0 0");
  EXPECT_FALSE(view.IsVisible());
}

}  // namespace
