// Scales, limits, modes and flags.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include <string>

#include "ViewPortTesting.h"

namespace {

std::string ModesOf(const GraphicViewPort& viewPort) {
  return std::to_string(viewPort.GetWidthMode()) + " " + std::to_string(viewPort.GetHeightMode());
}

TEST(GraphicViewPortModes, ScaleFactorsAreStoredInTheirOrder) {
  GraphicViewPort viewPort;
  viewPort.SetScaleFactors(1.5F, 2.5F, 0.25F, 4.0F, 0.5F, 8.0F);
  EXPECT_EQ(viewPort.GetOrigSizeScaleX(), 1.5);
  EXPECT_EQ(viewPort.GetOrigSizeScaleY(), 2.5);
  EXPECT_EQ(viewPort.GetMinScaleX(), 0.25);
  EXPECT_EQ(viewPort.GetMaxScaleX(), 4.0);
  EXPECT_EQ(viewPort.GetMinScaleY(), 0.5);
  EXPECT_EQ(viewPort.GetMaxScaleY(), 8.0);
}

TEST(GraphicViewPortModes, SizesAreScalesOfTheGraphicArea) {
  GraphicViewPort viewPort(Rect2D(0, 0, 50, 20), Rect2D(0, 0, 7, 8));
  viewPort.SetScaleSizes(100, 60, 25, 400, 30, 180);
  EXPECT_EQ(viewPort.GetOrigSizeScaleX(), 2.0);
  EXPECT_EQ(viewPort.GetOrigSizeScaleY(), 3.0);
  EXPECT_EQ(viewPort.GetMinScaleX(), 0.25);
  EXPECT_EQ(viewPort.GetMaxScaleX(), 4.0);
  EXPECT_EQ(viewPort.GetMinScaleY(), 0.5);
  EXPECT_EQ(viewPort.GetMaxScaleY(), 3.0);
  EXPECT_EQ(viewPort.GetOrigSizeX(), 100.0);
  EXPECT_EQ(viewPort.GetOrigSizeY(), 60.0);
  EXPECT_EQ(viewPort.GetMinSizeX(), 25.0);
  EXPECT_EQ(viewPort.GetMaxSizeX(), 400.0);
  EXPECT_EQ(viewPort.GetMinSizeY(), 30.0);
  EXPECT_EQ(viewPort.GetMaxSizeY(), 180.0);
}

TEST(GraphicViewPortModes, ScalesAreThoseOfTheTransformationPerOriginalScale) {
  GraphicViewPort viewPort;
  viewPort.GetTrafo().SetScale(6.0, -5.0);
  viewPort.SetScaleFactors(4.0F, 2.0F, 0.1F, 10.0F, 0.1F, 10.0F);
  EXPECT_EQ(viewPort.GetScaleX(), 1.5F);
  EXPECT_EQ(viewPort.GetScaleY(), -2.5F);
}

TEST(GraphicViewPortModes, ViewModeSetsBothAsGiven) {
  GraphicViewPort viewPort;
  viewPort.SetViewMode(3, 4);
  EXPECT_EQ(ModesOf(viewPort), "3 4");
  viewPort.SetProportional(false);
  viewPort.SetViewMode(200, 1);
  EXPECT_EQ(ModesOf(viewPort), "200 1");
}

TEST(GraphicViewPortModes, OneDirectionTakesTheOtherAlongWhenProportional) {
  GraphicViewPort viewPort;
  viewPort.SetWidthMode(2);
  EXPECT_EQ(ModesOf(viewPort), "2 2");
  viewPort.SetHeightMode(4);
  EXPECT_EQ(ModesOf(viewPort), "4 4");
  viewPort.SetProportional(false);
  viewPort.SetWidthMode(1);
  EXPECT_EQ(ModesOf(viewPort), "1 4");
  viewPort.SetHeightMode(3);
  EXPECT_EQ(ModesOf(viewPort), "1 3");
}

struct Action {
  void (GraphicViewPort::*function)();
  const char* free;          // the modes after it from 0 0
  const char* proportional;  // the same when proportional
};

constexpr Action kActions[] = {
    {&GraphicViewPort::FitWidth, "1 0", "1 1"},   {&GraphicViewPort::FitHeight, "0 1", "1 1"},
    {&GraphicViewPort::FitSize, "1 1", "1 1"},    {&GraphicViewPort::OrigWidth, "2 0", "2 2"},
    {&GraphicViewPort::OrigHeight, "0 2", "2 2"}, {&GraphicViewPort::OrigSize, "2 2", "2 2"},
    {&GraphicViewPort::MaxWidth, "3 0", "3 3"},   {&GraphicViewPort::MaxHeight, "0 3", "3 3"},
    {&GraphicViewPort::MaxSize, "3 3", "3 3"},    {&GraphicViewPort::MinWidth, "4 0", "4 4"},
    {&GraphicViewPort::MinHeight, "0 4", "4 4"},  {&GraphicViewPort::MinSize, "4 4", "4 4"},
};

TEST(GraphicViewPortModes, NamedModesSetTheirDirections) {
  for (const Action& action : kActions) {
    TrafoListener listener;
    GraphicViewPort viewPort;
    viewPort.SetInterface(&listener);
    (viewPort.*action.function)();
    EXPECT_EQ(ModesOf(viewPort), action.proportional);
    viewPort.SetViewMode(0, 0);
    viewPort.SetProportional(false);
    (viewPort.*action.function)();
    EXPECT_EQ(ModesOf(viewPort), action.free);
    EXPECT_EQ(listener.count, 0) << "the transformation is not computed";
    viewPort.SetInterface(nullptr);
  }
}

TEST(GraphicViewPortModes, FlagsAreReplacedSetClearedAndAsked) {
  GraphicViewPort viewPort;
  viewPort.SetMode(0x0005);
  EXPECT_TRUE(viewPort.IsEnabled(0x0005));
  EXPECT_TRUE(viewPort.IsEnabled(0x0001));
  EXPECT_FALSE(viewPort.IsEnabled(0x0002));
  EXPECT_FALSE(viewPort.IsEnabled(0x0003)) << "all flags, not some";
  viewPort.Enable(0x0300);
  EXPECT_TRUE(viewPort.IsEnabled(0x0305));
  viewPort.Disable(0x0101);
  EXPECT_TRUE(viewPort.IsEnabled(0x0204));
  EXPECT_FALSE(viewPort.IsEnabled(0x0001));
  EXPECT_FALSE(viewPort.IsEnabled(0x0100));
  viewPort.SetMode(-1);
  EXPECT_TRUE(viewPort.IsEnabled(-1));
  viewPort.Disable(-32768);
  EXPECT_TRUE(viewPort.IsEnabled(0x7FFF));
  EXPECT_FALSE(viewPort.IsEnabled(-32768));
}

/// The flags that are set, as the word they make.
int FlagsOf(const GraphicViewPort& viewPort) {
  int flags = 0;
  for (int bit = 1; bit <= 0x4000; bit *= 2) {
    flags |= viewPort.IsEnabled(static_cast<short>(bit)) ? bit : 0;
  }
  return flags;
}

TEST(GraphicViewPortModes, EachSetterSwitchesItsOwnFlags) {
  GraphicViewPort viewPort;
  const auto expectSwitch = [&](auto&& set, int flag) {
    viewPort.SetMode(0);
    set(true);
    EXPECT_EQ(FlagsOf(viewPort), flag);
    viewPort.SetMode(0x7FFF);
    set(false);
    EXPECT_EQ(FlagsOf(viewPort), 0x7FFF & ~flag);
  };
  expectSwitch([&](bool on) { viewPort.SetVisible(on); }, 0x0001);
  expectSwitch([&](bool on) { viewPort.SetProportional(on); }, 0x0002);
  expectSwitch([&](bool on) { viewPort.ClipBorders(on); }, 0x0004);
  expectSwitch([&](bool on) { viewPort.SetFixedGraphicArea(on); }, 0x0008);
  expectSwitch([&](bool on) { viewPort.EnableScale(on, on); }, 0x0300);
  expectSwitch([&](bool on) { viewPort.EnablePan(on, on); }, 0x0C00);
  expectSwitch([&](bool on) { viewPort.EnableMove(on, on); }, 0x3000);
}

TEST(GraphicViewPortModes, DirectionsAreSwitchedApart) {
  GraphicViewPort viewPort;
  viewPort.SetMode(0);
  viewPort.EnableScale(true, false);
  EXPECT_EQ(FlagsOf(viewPort), 0x0100);
  viewPort.EnableScale(false, true);
  EXPECT_EQ(FlagsOf(viewPort), 0x0200);
  viewPort.SetMode(0);
  viewPort.EnablePan(true, false);
  EXPECT_EQ(FlagsOf(viewPort), 0x0400);
  viewPort.EnablePan(false, true);
  EXPECT_EQ(FlagsOf(viewPort), 0x0800);
  viewPort.SetMode(0);
  viewPort.EnableMove(true, false);
  EXPECT_EQ(FlagsOf(viewPort), 0x1000);
  viewPort.EnableMove(false, true);
  EXPECT_EQ(FlagsOf(viewPort), 0x2000);
}

TEST(GraphicViewPortModes, VisibleNeedsTheFlagAndTwoRectanglesWithArea) {
  const Rect2D full(0, 0, 10, 10);
  for (const Rect2D& empty : {Rect2D(5, 0, 5, 10), Rect2D(0, 5, 10, 5)}) {
    GraphicViewPort flatView(full, full, empty);
    EXPECT_FALSE(flatView.IsVisible());
    GraphicViewPort flatWindow(full, empty, full);
    EXPECT_FALSE(flatWindow.IsVisible());
    GraphicViewPort flatArea(empty, full, full);
    EXPECT_TRUE(flatArea.IsVisible());
  }
  GraphicViewPort viewPort;
  EXPECT_TRUE(viewPort.IsVisible());
  viewPort.SetVisible(false);
  EXPECT_FALSE(viewPort.IsVisible());
}

TEST(GraphicViewPortModes, KeepsTheAlignment) {
  GraphicViewPort viewPort;
  viewPort.SetAlignment(0xFE);
  EXPECT_EQ(viewPort.GetAlignment(), 0xFE);
}

}  // namespace
