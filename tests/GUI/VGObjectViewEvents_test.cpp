// What the mouse does with an object.

#include <vorl/GUI/VGObjectView.h>

#include <gtest/gtest.h>

#include "HandlerTesting.h"

namespace {

using gui_testing::BareView;
using gui_testing::Lines;
using gui_testing::RecordingView;
using gui_testing::RecordingViewClient;

constexpr int kDown = 4098;
constexpr int kMove = 4097;
constexpr int kUp = 4099;

bool Send(VGObjectView& view, int event, int flags = MK_LBUTTON) {
  dVect2D p(3, 4);
  return view.ProcessMouseEvent(event, flags, p);
}

TEST(VGObjectViewEvents, FirstLeftClickBeginsCreation) {
  BareView view;
  view.Enable(1);
  EXPECT_FALSE(Send(view, kDown, MK_RBUTTON));
  EXPECT_FALSE(Send(view, kMove));
  EXPECT_FALSE(view.IsVisible());
  Send(view, kDown, MK_LBUTTON | MK_SHIFT);
  EXPECT_TRUE(view.IsVisible());
  EXPECT_FALSE(view.IsSelected());
  EXPECT_EQ(view.GetOpState(), 1);
}

TEST(VGObjectViewEvents, CreationTakesAllThreeEventsAndTellsNobody) {
  Lines lines;
  RecordingView view(lines, "v");
  RecordingViewClient client(lines);
  view.SetInterface(&client);
  view.ResetViewState(2);
  view.Enable(1);
  EXPECT_TRUE(Send(view, kDown));
  EXPECT_TRUE(Send(view, kMove, 0));
  EXPECT_TRUE(Send(view, kUp));
  EXPECT_EQ(lines, (Lines{"v: create 4098 1 (3, 4)", "v: create 4097 0 (3, 4)",
                          "v: create 4099 1 (3, 4)"}));
  EXPECT_FALSE(Send(view, 5000));
  view.answer = false;
  EXPECT_FALSE(Send(view, kMove));
}

TEST(VGObjectViewEvents, CreationNeedsItsBitAndAnUntouchedState) {
  Lines lines;
  RecordingView forbidden(lines, "v");
  forbidden.ResetViewState(2);
  EXPECT_FALSE(Send(forbidden, kDown));
  RecordingView selected(lines, "v");
  selected.ResetViewState(2);
  selected.Select(true);
  selected.Enable(1);
  EXPECT_FALSE(Send(selected, kDown));
  EXPECT_FALSE(selected.IsVisible());
  EXPECT_EQ(lines, Lines{});
}

struct OperationCase {
  short operation;
  const char* down;
  const char* move;
  const char* up;
};

class VGObjectViewOperation : public ::testing::TestWithParam<OperationCase> {};

TEST_P(VGObjectViewOperation, RunsFromDownToUp) {
  const OperationCase& expected = GetParam();
  const std::string number = " 7 " + std::to_string(expected.operation);
  Lines lines;
  RecordingView view(lines, "v");
  RecordingViewClient client(lines);
  view.SetInterface(&client);
  view.SetUserData(7);
  view.grabbedFor = expected.operation;
  view.Enable(expected.operation);
  EXPECT_FALSE(Send(view, kMove));
  EXPECT_TRUE(Send(view, kDown));
  EXPECT_EQ(view.GetOpState(), expected.operation);
  EXPECT_FALSE(Send(view, 4096));
  EXPECT_TRUE(Send(view, kMove, 0));
  EXPECT_TRUE(Send(view, kUp, 0));
  EXPECT_EQ(view.GetOpState(), 0);
  EXPECT_FALSE(Send(view, kUp));
  EXPECT_EQ(lines, (Lines{expected.down, "OnBeginGraphicOp" + number, expected.move,
                          "OnGraphicChanged" + number, expected.up, "OnEndGraphicOp" + number}));
}

TEST_P(VGObjectViewOperation, ReturnsWhatItsHandlerReturns) {
  Lines lines;
  RecordingView view(lines, "v");
  RecordingViewClient client(lines);
  view.SetInterface(&client);
  view.grabbedFor = GetParam().operation;
  view.Enable(GetParam().operation);
  view.answer = false;
  EXPECT_FALSE(Send(view, kDown));
  EXPECT_FALSE(Send(view, kMove));
  EXPECT_FALSE(Send(view, kUp));
  EXPECT_EQ(lines.size(), 6u) << "the interface is told all the same";
}

INSTANTIATE_TEST_SUITE_P(
    All, VGObjectViewOperation,
    ::testing::Values(
        OperationCase{4, "v: modify (3, 4)", "v: modifying (3, 4)", "v: modified (3, 4)"},
        OperationCase{8, "v: move (3, 4)", "v: moving (3, 4)", "v: moved (3, 4)"},
        OperationCase{16, "v: resize (3, 4)", "v: resizing (3, 4)", "v: resized (3, 4)"},
        OperationCase{32, "v: rotate (3, 4)", "v: rotating (3, 4)", "v: rotated (3, 4)"}),
    [](const auto& instance) { return "Operation" + std::to_string(instance.param.operation); });

TEST(VGObjectViewEvents, HandleThatIsNotAllowedMovesInstead) {
  Lines lines;
  RecordingView view(lines, "v");
  view.grabbedFor = 32;
  view.Enable(8);
  EXPECT_TRUE(Send(view, kDown));
  EXPECT_EQ(view.GetOpState(), 8);
  EXPECT_EQ(lines, Lines{"v: move (3, 4)"});
}

TEST(VGObjectViewEvents, NothingBeginsWhereNothingIsAllowed) {
  Lines lines;
  RecordingView view(lines, "v");
  view.grabbedFor = 32;
  EXPECT_FALSE(Send(view, kDown));
  EXPECT_EQ(view.GetOpState(), 0);
}

TEST(VGObjectViewEvents, ClickBesideTheObjectBeginsNothing) {
  Lines lines;
  RecordingView view(lines, "v", 50, 50);
  view.Enable(8);
  EXPECT_FALSE(Send(view, kDown));
  EXPECT_EQ(view.GetOpState(), 0);
}

TEST(VGObjectViewEvents, OtherButtonsBeginNothing) {
  Lines lines;
  RecordingView view(lines, "v");
  view.Enable(8);
  EXPECT_FALSE(Send(view, kDown, MK_RBUTTON));
  EXPECT_FALSE(Send(view, kDown, MK_MBUTTON));
  EXPECT_EQ(lines, Lines{});
}

TEST(VGObjectViewEvents, RunningOperationIsNotChosenAnew) {
  Lines lines;
  RecordingView view(lines, "v");
  view.Enable(8 | 16);
  Send(view, kDown);
  view.grabbedFor = 16;
  EXPECT_TRUE(Send(view, kDown));
  EXPECT_EQ(lines, (Lines{"v: move (3, 4)", "v: move (3, 4)"}));
}

TEST(VGObjectViewEvents, UnknownOperationTakesNoEvents) {
  BareView view;
  view.AssignViewState(2);
  view.SetOpState(2);
  EXPECT_FALSE(Send(view, kDown));
  EXPECT_FALSE(Send(view, kMove));
  EXPECT_FALSE(Send(view, kUp));
}

TEST(VGObjectViewEvents, InvisibleObjectTakesNoEvents) {
  Lines lines;
  RecordingView view(lines, "v");
  view.Enable(8);
  Send(view, kDown);
  lines.clear();
  view.ResetViewState(2);
  EXPECT_FALSE(Send(view, kMove));
  EXPECT_EQ(lines, Lines{});
}

}  // namespace
