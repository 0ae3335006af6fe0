#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/VGObjectView.h>

#include <gtest/gtest.h>

#include "HandlerTesting.h"

namespace {

using gui_testing::BareView;
using gui_testing::Lines;
using gui_testing::RecordingView;
using gui_testing::RecordingViewClient;

TEST(VGType, NumbersTheClasses) {
  EXPECT_EQ(VGType_None, 0);
  EXPECT_EQ(VGType_Point, 1);
  EXPECT_EQ(VGType_Line, 2);
  EXPECT_EQ(VGType_Rect, 3);
  EXPECT_EQ(VGType_Bitmap, 4);
  EXPECT_EQ(VGType_Text, 7);
  EXPECT_EQ(VGType_Axis, 8);
  EXPECT_EQ(VGType_Curve, 9);
  EXPECT_EQ(VGType_CrossCursor, 10);
}

TEST(VGObjectView, StartsInvisibleWithNothingAllowed) {
  BareView view;
  for (int bit = 1; bit <= 0x4000; bit *= 2) {
    EXPECT_FALSE(view.IsEnabled(static_cast<short>(bit))) << bit;
  }
  EXPECT_FALSE(view.IsDynamicCreated());
  EXPECT_FALSE(view.IsVisible());
  EXPECT_FALSE(view.IsSelected());
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_EQ(view.GetUserData(), 0);
  EXPECT_EQ(view.GetInterface(), nullptr);
  EXPECT_EQ(view.GetPenStyle(), 0);
  EXPECT_EQ(view.GetPenThickness(), 1);
  EXPECT_EQ(view.GetPenColor(), 0);
  EXPECT_EQ(view.GetROPMode(), 13);
  EXPECT_EQ(view.GetLineDistance(), 2);
  EXPECT_EQ(view.GetHandleDistance(), 4);
}

TEST(VGObjectView, IdIsTheAddressUntilItIsSet) {
  BareView view;
  EXPECT_EQ(view.GetObjID(),
            static_cast<long>(reinterpret_cast<std::uintptr_t>(static_cast<VGObjectView*>(&view))));
  view.SetObjID(17);
  EXPECT_EQ(view.GetObjID(), 17);
}

TEST(VGObjectView, DefaultTransformationIsOneSharedIdentity) {
  BareView a;
  BareView b;
  ASSERT_NE(a.GetTransformation(), nullptr);
  EXPECT_EQ(a.GetTransformation(), b.GetTransformation());
  const auto* identity = dynamic_cast<Translate2D*>(a.GetTransformation());
  ASSERT_NE(identity, nullptr);
  EXPECT_EQ(identity->GetTx(), 0);
  EXPECT_EQ(identity->GetTy(), 0);
}

TEST(VGObjectView, SetTransformationRefreshesTheViewGeometry) {
  BareView view;
  Trafo2DBase* const identity = view.GetTransformation();
  Translate2D trafo(1, 2);
  view.SetTransformation(&trafo);
  EXPECT_EQ(view.GetTransformation(), &trafo);
  EXPECT_EQ(view.refreshed, 1);
  view.SetTransformation(nullptr);
  EXPECT_EQ(view.GetTransformation(), identity);
  EXPECT_EQ(view.refreshed, 2);
  EXPECT_EQ(view.written, 0);
}

TEST(VGObjectView, ViewDataChangedWritesTheGeometryBack) {
  BareView view;
  view.ViewDataChanged();
  EXPECT_EQ(view.written, 1);
  EXPECT_EQ(view.refreshed, 0);
}

TEST(VGObjectView, ViewStateBitsAreSetAndCleared) {
  BareView view;
  view.SetViewState(2);
  EXPECT_TRUE(view.IsVisible());
  EXPECT_FALSE(view.IsSelected());
  view.SetViewState(1);
  EXPECT_TRUE(view.IsVisible());
  EXPECT_TRUE(view.IsSelected());
  view.ResetViewState(2);
  EXPECT_FALSE(view.IsVisible());
  EXPECT_TRUE(view.IsSelected());
  view.Select(false);
  EXPECT_FALSE(view.IsSelected());
  view.Select(true);
  EXPECT_TRUE(view.IsSelected());
}

TEST(VGObjectView, IsEnabledAsksForAllBits) {
  BareView view;
  view.Enable(4 | 8);
  EXPECT_TRUE(view.IsEnabled(4));
  EXPECT_TRUE(view.IsEnabled(4 | 8));
  EXPECT_FALSE(view.IsEnabled(4 | 16));
  EXPECT_TRUE(view.IsEnabled(0));
  view.Disable(4);
  EXPECT_FALSE(view.IsEnabled(4));
  EXPECT_TRUE(view.IsEnabled(8));
}

TEST(VGObjectView, DynamicCreationIsAnEnableBit) {
  BareView view;
  view.SetDynamicCreationFlag();
  EXPECT_TRUE(view.IsDynamicCreated());
  EXPECT_TRUE(view.IsEnabled(static_cast<short>(0x8000)));
  EXPECT_FALSE(view.IsEnabled(0x4000));
}

TEST(VGObjectView, DrawParametersAreSetTogetherAndAlone) {
  BareView view;
  view.SetDrawParams(2, 3, 0x00FF80, 7);
  EXPECT_EQ(view.GetPenStyle(), 2);
  EXPECT_EQ(view.GetPenThickness(), 3);
  EXPECT_EQ(view.GetPenColor(), 0x00FF80);
  EXPECT_EQ(view.GetROPMode(), 7);
  view.SetPenStyle(1);
  view.SetPenThickness(9);
  view.SetPenColor(5);
  view.SetROPMode(13);
  EXPECT_EQ(view.GetPenStyle(), 1);
  EXPECT_EQ(view.GetPenThickness(), 9);
  EXPECT_EQ(view.GetPenColor(), 5);
  EXPECT_EQ(view.GetROPMode(), 13);
}

TEST(VGObjectView, SelectionDistancesHoldAByte) {
  BareView view;
  view.SetSelectionDistances(0, 255);
  EXPECT_EQ(view.GetLineDistance(), 0);
  EXPECT_EQ(view.GetHandleDistance(), 255);
}

TEST(VGObjectView, HandlersAndQuestionsAreFalseByDefault) {
  BareView view;
  dVect2D p;
  EXPECT_FALSE(view.IsPointOnGraphic(p, 100));
  EXPECT_EQ(view.GetSelectionState(MK_LBUTTON, p), 0);
  EXPECT_FALSE(view.OnCreate(MouseEvent_ButtonDown, MK_LBUTTON, p));
  using Handler = bool (VGObjectView::*)(dVect2D&);
  const Handler handlers[] = {
      &VGObjectView::OnBeginMove,   &VGObjectView::OnMove,   &VGObjectView::OnEndMove,
      &VGObjectView::OnBeginResize, &VGObjectView::OnResize, &VGObjectView::OnEndResize,
      &VGObjectView::OnBeginModify, &VGObjectView::OnModify, &VGObjectView::OnEndModify,
      &VGObjectView::OnBeginRotate, &VGObjectView::OnRotate, &VGObjectView::OnEndRotate};
  for (const Handler handler : handlers) {
    EXPECT_FALSE((view.*handler)(p));
  }
}

TEST(VGObjectView, IntegerPointsAreTakenAsNumbers) {
  Lines lines;
  RecordingView view(lines, "v", 5, 5);
  tagPOINT corner{5, 5};
  tagPOINT outside{4, 5};
  EXPECT_TRUE(view.IsPointOnGraphic(corner, 0));
  EXPECT_FALSE(view.IsPointOnGraphic(outside, 0));
  EXPECT_TRUE(view.IsPointOnGraphic(outside, 1));
  EXPECT_EQ(view.GetSelectionState(0, corner), 8);
  EXPECT_EQ(view.GetSelectionState(0, outside), 0);
  view.Enable(8);
  EXPECT_TRUE(static_cast<VGObjectView&>(view).ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON,
                                                                 corner));
  EXPECT_EQ(lines, Lines{"v: move (5, 5)"});
}

TEST(VGObjectView, BoundingBoxGrowsInEachComponent) {
  Lines lines;
  RecordingView view(lines, "v");
  dVect2D min(2, 2);
  dVect2D max(4, 4);
  view.UpdateBoundingBox(dVect2D(3, 3), min, max);
  EXPECT_EQ(gui_testing::Text(min) + gui_testing::Text(max), "(2, 2)(4, 4)");
  view.UpdateBoundingBox(dVect2D(1, 5), min, max);
  EXPECT_EQ(gui_testing::Text(min) + gui_testing::Text(max), "(1, 2)(4, 5)");
  view.UpdateBoundingBox(dVect2D(6, -1), min, max);
  EXPECT_EQ(gui_testing::Text(min) + gui_testing::Text(max), "(1, -1)(6, 5)");
}

TEST(VGObjectView, DrawsHandlesOverTheVisibleSelectedObject) {
  Lines lines;
  RecordingView view(lines, "v");
  view.Draw(nullptr);
  EXPECT_EQ(lines, Lines{"v: draw"});
  lines.clear();
  view.Select(true);
  view.Draw(nullptr);
  EXPECT_EQ(lines, (Lines{"v: draw", "v: draw selection"}));
  lines.clear();
  view.ResetViewState(2);
  view.Draw(nullptr);
  EXPECT_EQ(lines, Lines{});
}

TEST(VGObjectView, ViewportFormsOfDrawingCallTheOthers) {
  Lines lines;
  RecordingView view(lines, "v");
  GraphicViewPort viewPort;
  view.Select(true);
  static_cast<VGObjectView&>(view).Draw(nullptr, viewPort);
  EXPECT_EQ(lines, (Lines{"v: draw", "v: draw selection"}));
  lines.clear();
  view.ResetViewState(2);
  static_cast<VGObjectView&>(view).Draw(nullptr, viewPort);
  EXPECT_EQ(lines, Lines{});
}

TEST(VGObjectView, CopyIsAnObjectOfItsOwn) {
  Lines lines;
  RecordingViewClient client(lines);
  BareView view;
  Translate2D trafo(1, 2);
  view.SetTransformation(&trafo);
  view.SetDynamicCreationFlag();
  view.Enable(8);
  view.SetUserData(3);
  view.SetInterface(&client);
  view.SetDrawParams(1, 2, 3, 7);
  view.SetSelectionDistances(5, 6);
  view.SetViewState(3);
  view.SetOpState(8);
  BareView copy(view);
  EXPECT_NE(copy.GetObjID(), view.GetObjID());
  EXPECT_FALSE(copy.IsDynamicCreated());
  EXPECT_TRUE(copy.IsEnabled(8));
  EXPECT_EQ(copy.GetUserData(), 3);
  EXPECT_EQ(copy.GetInterface(), &client);
  EXPECT_EQ(copy.GetTransformation(), &trafo);
  EXPECT_EQ(copy.GetPenStyle(), 1);
  EXPECT_EQ(copy.GetPenThickness(), 2);
  EXPECT_EQ(copy.GetPenColor(), 3);
  EXPECT_EQ(copy.GetROPMode(), 7);
  EXPECT_EQ(copy.GetLineDistance(), 5);
  EXPECT_EQ(copy.GetHandleDistance(), 6);
  EXPECT_TRUE(copy.IsVisible());
  EXPECT_TRUE(copy.IsSelected());
  EXPECT_EQ(copy.GetOpState(), 8);
  view.SetObjID(44);
  EXPECT_EQ(BareView(view).GetObjID(), 44);
}

TEST(VGObjectView, AssignmentKeepsThePlace) {
  Translate2D trafo(1, 2);
  Translate2D otherTrafo(3, 4);
  BareView view;
  view.SetTransformation(&trafo);
  view.SetDynamicCreationFlag();
  const long id = view.GetObjID();
  BareView other;
  other.SetTransformation(&otherTrafo);
  other.Enable(16);
  view = other;
  EXPECT_TRUE(view.IsDynamicCreated());
  EXPECT_TRUE(view.IsEnabled(16));
  EXPECT_EQ(view.GetTransformation(), &trafo);
  EXPECT_EQ(view.GetObjID(), id);
}

}  // namespace
