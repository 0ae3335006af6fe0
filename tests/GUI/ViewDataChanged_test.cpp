// When views tell that their copy in view coordinates was edited: once after each change, and in
// which state they are then.
#include <vorl/GUI/VGBitmapView.h>
#include <vorl/GUI/VGCrossCursorView.h>
#include <vorl/GUI/VGLine.h>
#include <vorl/GUI/VGPoint.h>
#include <vorl/GUI/VGRect.h>
#include <vorl/GUI/VGText.h>

#include <gtest/gtest.h>

#include "ShapeTesting.h"

namespace {

using gui_testing::BoxOf;

/// Writes down operation, raster operation and box at each change.
template <class View>
class Recorded : public View {
 public:
  void ViewDataChanged() override {
    View::ViewDataChanged();
    log += std::string("op") + std::to_string(this->GetOpState());
    log += std::string(" rop") + std::to_string(this->GetROPMode());
    log += this->IsVisible() ? " seen at " : " unseen at ";
    log += BoxOf(*this) + "; ";
  }
  /// What was written since the last call.
  std::string Log() { return std::exchange(log, {}); }

  std::string log;
};

/// A point that a handler may write to.
struct Hold {
  Hold(float x, float y) : point(x, y) {}
  operator dVect2D&() { return point; }
  dVect2D point;
};

constexpr int kDown = MouseEvent_ButtonDown;

template <class View>
class ChangesOfAnchors : public ::testing::Test {};
using Anchored = ::testing::Types<VGPointView, VGTextView>;
TYPED_TEST_SUITE(ChangesOfAnchors, Anchored);

TYPED_TEST(ChangesOfAnchors, AreToldAfterEachChange) {
  Recorded<TypeParam> view;
  EXPECT_TRUE(view.OnCreate(kDown, 0, Hold(5, 6)));
  EXPECT_EQ(view.Log(), "op0 rop13 unseen at 5 6 5 6; ") << "shown after that";
  EXPECT_TRUE(view.OnBeginMove(Hold(5, 6)));
  EXPECT_EQ(view.Log(), "");
  EXPECT_TRUE(view.OnMove(Hold(7, 9)));
  EXPECT_EQ(view.Log(), "op0 rop7 seen at 7 9 7 9; ");
  EXPECT_TRUE(view.OnEndMove(Hold(7, 9)));
  EXPECT_EQ(view.Log(), "");
}

TEST(ChangesOfLines, AreToldAfterEachChange) {
  Recorded<VGLineView> view;
  view.Enable(VGOperation_Create);
  EXPECT_TRUE(view.OnCreate(kDown, 0, Hold(5, 6)));
  EXPECT_EQ(view.Log(), "op4 rop13 seen at 5 6 6 6; op4 rop13 seen at 5 6 6 6; ")
      << "once for itself, once for the drag that it begins";
  EXPECT_TRUE(view.OnModify(Hold(15, 26)));
  EXPECT_EQ(view.Log(), "op4 rop7 seen at 5 6 15 26; ");
  EXPECT_TRUE(view.OnEndModify(Hold(15, 26)));
  EXPECT_TRUE(view.OnBeginMove(Hold(10, 10)));
  EXPECT_EQ(view.Log(), "");
  EXPECT_TRUE(view.OnMove(Hold(11, 12)));
  EXPECT_EQ(view.Log(), "op0 rop7 seen at 6 8 16 28; ");
  EXPECT_TRUE(view.OnEndMove(Hold(11, 12)));
  EXPECT_TRUE(view.OnBeginRotate(Hold(16, 28)));
  EXPECT_EQ(view.Log(), "");
  EXPECT_TRUE(view.OnRotate(Hold(6, 8)));
  EXPECT_EQ(view.Log(), "") << "nothing changes there";
  EXPECT_TRUE(view.OnRotate(Hold(12, 20)));  // (1, 2) from the midpoint, as before
  EXPECT_EQ(view.Log(), "op0 rop7 seen at 6 8 16 28; ");
  EXPECT_TRUE(view.OnEndRotate(Hold(12, 20)));
  EXPECT_EQ(view.Log(), "");
}

template <class View>
class ChangesOfRects : public ::testing::Test {};
using Rectangular = ::testing::Types<VGRectView, VGBitmapView>;
TYPED_TEST_SUITE(ChangesOfRects, Rectangular);

TYPED_TEST(ChangesOfRects, AreToldAfterEachChange) {
  Recorded<TypeParam> view;
  // Images keep their raster operation while they are dragged.
  const std::string drawn = view.GetObjType() == VGType_Bitmap ? " rop13" : " rop7";
  view.Enable(VGOperation_Create);
  EXPECT_TRUE(view.OnCreate(kDown, 0, Hold(5, 6)));
  EXPECT_EQ(view.Log(), "op4 rop13 seen at 5 6 6 7; ");
  EXPECT_TRUE(view.OnModify(Hold(15, 26)));
  EXPECT_EQ(view.Log(), std::string("op4") + drawn + " seen at 5 6 15 26; ");
  EXPECT_TRUE(view.OnEndModify(Hold(15, 26)));
  EXPECT_TRUE(view.OnBeginMove(Hold(10, 10)));
  EXPECT_EQ(view.Log(), "");
  EXPECT_TRUE(view.OnMove(Hold(11, 12)));
  EXPECT_EQ(view.Log(), std::string("op0") + drawn + " seen at 6 8 16 28; ");
  EXPECT_TRUE(view.OnEndMove(Hold(11, 12)));
  EXPECT_EQ(view.Log(), "");
}

TEST(ChangesOfCrossCursors, AreToldAfterEachChange) {
  Recorded<VGCrossCursorView> view;
  view.VGObjectView::Enable(VGOperation_Create);
  EXPECT_TRUE(view.OnCreate(kDown, 0, Hold(5, 6)));
  EXPECT_EQ(view.Log(), "op8 rop13 seen at 5 6 5 6; ");
  EXPECT_TRUE(view.OnMove(Hold(7, 9)));
  EXPECT_EQ(view.Log(), "op8 rop7 seen at 7 9 7 9; ");
  EXPECT_TRUE(view.OnEndMove(Hold(7, 9)));
  EXPECT_TRUE(view.OnBeginRotate(Hold(17, 9)));
  EXPECT_EQ(view.Log(), "");
  EXPECT_TRUE(view.OnRotate(Hold(7, 9)));
  EXPECT_EQ(view.Log(), "") << "no direction";
  EXPECT_TRUE(view.OnRotate(Hold(7, 19)));
  EXPECT_EQ(view.Log(), "op0 rop7 seen at 7 9 7 9; ");
  EXPECT_TRUE(view.OnEndRotate(Hold(7, 19)));
  EXPECT_EQ(view.Log(), "");
}

}  // namespace
