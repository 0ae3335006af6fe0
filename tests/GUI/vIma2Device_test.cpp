// What is drawn where: images, rectangles, aspect ratio; and clearing what lies around.
#include <vorl/GUI/vIma2Device.h>

#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <vector>

#include "../Support/LogRecorder.h"
#include "Canvas.h"

namespace {

constexpr LONG kLowest = std::numeric_limits<LONG>::min();
constexpr LONG kHighest = std::numeric_limits<LONG>::max();
const std::string kNoRect = "0 0 0 0";

std::string StatusText(const vIma2Device& renderer) {
  return static_cast<const char*>(renderer.GetStatus());
}

TEST(vIma2Device, DrawsNothingAtFirst) {
  vIma2Device renderer;
  Canvas canvas(4, 4);
  EXPECT_FALSE(renderer.IsInitialized());
  EXPECT_EQ(StatusText(renderer), "not initialized");
  EXPECT_TRUE(renderer.GetStatus() == -1);
  EXPECT_FALSE(renderer.Draw(canvas));
  EXPECT_EQ(RectText(*renderer.GetImageRect()), kNoRect);
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), kNoRect);
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), kNoRect);
  EXPECT_EQ(renderer.GetPaletteSize(), 0);
  EXPECT_EQ(renderer.GetPalette(), nullptr);
  EXPECT_FALSE(renderer.ResetPalette(true));
  const tagRECT rect{1, 2, 3, 4};
  EXPECT_FALSE(renderer.SetSourceRect(&rect));
  EXPECT_FALSE(renderer.SetTargetRect(&rect));
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), kNoRect);
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), kNoRect);
}

TEST(vIma2Device, AskingWhetherThereIsAnImageClearsAnOldFailure) {
  dImage image = NumberedImage(5, 3, 8, "BGR");
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, false));
  EXPECT_FALSE(renderer.EraseBackground(nullptr, nullptr, nullptr, 0));
  EXPECT_EQ(StatusText(renderer), "EraseBackground: no region specified");
  EXPECT_TRUE(renderer.IsInitialized());
  EXPECT_TRUE(renderer.GetStatus() == 0);
}

TEST(vIma2Device, TakesTheWholeImageWithoutRectangles) {
  dImage image = NumberedImage(5, 3, 8, "BGR");
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, true, false));
  EXPECT_EQ(renderer.GetStatus(), 0);
  EXPECT_TRUE(renderer.IsInitialized());
  EXPECT_EQ(RectText(*renderer.GetImageRect()), "0 0 5 3");
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), "0 0 5 3");
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), "0 0 5 3");
}

TEST(vIma2Device, TakesTheGivenRectangles) {
  dImage image = NumberedImage(5, 3, 8, "BGR");
  const tagRECT source{1, 0, 4, 2};
  const tagRECT target{10, 20, 90, 21};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, &source, &target, false, false));
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), "1 0 4 2");
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), "10 20 90 21");
  ASSERT_TRUE(renderer.SetSourceRect(nullptr));
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), "0 0 5 3");
  ASSERT_TRUE(renderer.SetSourceRect(&source));
  ASSERT_TRUE(renderer.SetTargetRect(nullptr));
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), "1 0 4 2");
}

TEST(vIma2Device, RectanglesMayBeItsOwn) {
  dImage image = NumberedImage(5, 3, 8, "BGR");
  const tagRECT source{1, 0, 4, 2};
  const tagRECT target{10, 20, 90, 21};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, &source, &target, false, false));
  ASSERT_TRUE(
      renderer.Init(&image, renderer.GetSourceRect(), renderer.GetTargetRect(), false, true));
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), "1 0 4 2");
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), "10 20 90 21");
}

TEST(vIma2Device, NoImageIsNoFailureButNothingToDraw) {
  dImage image = NumberedImage(5, 3, 8, "G");
  const tagRECT rect{1, 2, 3, 4};
  vIma2Device renderer;
  Canvas canvas(4, 4);
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, false));
  EXPECT_TRUE(renderer.Init(nullptr, &rect, &rect, true, true));
  EXPECT_EQ(renderer.GetStatus(), 0);
  EXPECT_EQ(renderer.GetPaletteSize(), 0);
  EXPECT_EQ(RectText(*renderer.GetImageRect()), kNoRect);
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), kNoRect);
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), kNoRect);
  EXPECT_FALSE(renderer.Draw(canvas));
  EXPECT_EQ(StatusText(renderer), "not initialized");
}

TEST(vIma2Device, ImageOfAnotherLayoutIsRefusedWithTheDescriptorsReason) {
  dImage good = NumberedImage(5, 3, 8, "BGR");
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U16, "G", 0, 4));
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&good, nullptr, nullptr, false, false));
  const std::string reason = "not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order";
  LogRecorder log;
  EXPECT_FALSE(renderer.Init(&image, nullptr, nullptr, false, false));
  EXPECT_EQ(StatusText(renderer), reason);
  EXPECT_EQ(log.errors.back(), "vIma2Device::Init: " + reason);
  EXPECT_EQ(RectText(*renderer.GetImageRect()), kNoRect);
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), kNoRect);
  EXPECT_FALSE(renderer.IsInitialized());
  EXPECT_EQ(StatusText(renderer), "not initialized");
  dImage empty;
  EXPECT_FALSE(renderer.Init(&empty, nullptr, nullptr, false, false));
  EXPECT_EQ(StatusText(renderer), "uninitialized image");
  dImage loose = NumberedImage(5, 3, 8, "G", 1);
  EXPECT_FALSE(renderer.Init(&loose, nullptr, nullptr, false, false));
  EXPECT_EQ(StatusText(renderer), "image rows are not 4 byte aligned");
}

TEST(vIma2Device, ImageFormattedAnewIsDescribedAnew) {
  dImage image = NumberedImage(5, 3, 8, "BGR");
  vIma2Device renderer;
  Canvas canvas(8, 8);
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, false));
  image = NumberedImage(8, 2, 8, "G");
  EXPECT_TRUE(renderer.IsInitialized());
  EXPECT_EQ(RectText(*renderer.GetImageRect()), "0 0 8 2");
  EXPECT_EQ(RectText(*renderer.GetSourceRect()), "0 0 5 3");
  ASSERT_TRUE(renderer.SetSourceRect(nullptr));
  ASSERT_TRUE(renderer.SetTargetRect(nullptr));
  ASSERT_TRUE(renderer.Draw(canvas));
  EXPECT_EQ(canvas.At(7, 1), PixelOf(image, 7, 1));
  image.Reset();
  EXPECT_FALSE(renderer.Draw(canvas));
  EXPECT_EQ(StatusText(renderer), "not initialized");
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U16, "G", 0, 4));
  EXPECT_FALSE(renderer.IsInitialized());
  EXPECT_EQ(StatusText(renderer), "not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order");
}

struct Fit {
  int sourceWidth;
  int sourceHeight;
  tagRECT target;
  const char* fitted;
};

TEST(vIma2Device, TargetIsFittedToTheProportionsOfTheSource) {
  const Fit kFits[] = {
      {100, 50, {0, 0, 200, 200}, "0 50 200 150"},  // the height is cut down
      {50, 100, {0, 0, 200, 200}, "50 0 150 200"},  // the width is cut down
      {100, 50, {0, 0, 100, 50}, "0 0 100 50"},     // equal sizes
      {100, 50, {7, 9, 207, 109}, "7 9 207 109"},   // equal proportions
      {100, 50, {10, 20, 40, 95}, "10 50 40 65"},   // 30 x 75: 15 high, 60 above and below
      {3, 2, {0, 0, 10, 10}, "0 2 10 8"},           // 6.67 is cut to 6; 4 / 2 above
      {2, 3, {0, 0, 10, 10}, "2 0 8 10"},
      {7, 7, {0, 0, 10, 5}, "2 0 7 5"},                   // 5 / 2 is cut to 2
      {10, 10, {-50, -20, -30, -19}, "-41 -20 -40 -19"},  // 20 x 1: 1 wide, 19 / 2 = 9
      {10, 10, {0, 0, 0, 5}, "0 2 0 2"},                  // no width: 0 high
      {100, 50, {200, 0, 0, 200}, "200 50 0 150"},        // mirrored: stays so
      {100, 50, {0, 200, 200, 0}, "0 150 200 50"}};
  for (const Fit& fit : kFits) {
    dImage image;
    ASSERT_TRUE(image.Init(static_cast<unsigned long>(fit.sourceWidth),
                           static_cast<unsigned long>(fit.sourceHeight), 8, "G", 0, 4));
    vIma2Device renderer;
    ASSERT_TRUE(renderer.Init(&image, nullptr, &fit.target, true, false));
    EXPECT_EQ(RectText(*renderer.GetTargetRect()), fit.fitted)
        << fit.sourceWidth << " x " << fit.sourceHeight << " into " << RectText(fit.target);
    ASSERT_TRUE(renderer.Init(&image, nullptr, &fit.target, false, false));
    EXPECT_EQ(RectText(*renderer.GetTargetRect()), RectText(fit.target));
    renderer.HoldAspectRatio(true);
    EXPECT_EQ(RectText(*renderer.GetTargetRect()), RectText(fit.target));
    ASSERT_TRUE(renderer.SetTargetRect(&fit.target));
    EXPECT_EQ(RectText(*renderer.GetTargetRect()), fit.fitted);
  }
}

class OpenRenderer : public vIma2Device {
 public:
  using vIma2Device::CorrectTargetRect;
};

TEST(vIma2Device, FittingTellsWhetherItWasDone) {
  dImage image = NumberedImage(10, 10, 8, "G");
  OpenRenderer renderer;
  EXPECT_FALSE(renderer.CorrectTargetRect());  // the aspect ratio is not held
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, true, false));
  EXPECT_TRUE(renderer.CorrectTargetRect());
  const tagRECT none{3, 3, 3, 8};
  const tagRECT target{0, 0, 20, 30};
  ASSERT_TRUE(renderer.SetSourceRect(&none));
  ASSERT_TRUE(renderer.SetTargetRect(&target));
  EXPECT_FALSE(renderer.CorrectTargetRect());
  EXPECT_EQ(RectText(*renderer.GetTargetRect()), "0 0 20 30");
}

TEST(vIma2Device, ExtremeRectanglesAreHarmless) {
  dImage image = NumberedImage(10, 10, 8, "G");
  Canvas canvas(8, 8);
  const LONG kEdges[] = {kLowest, -1, 0, 5, kHighest};
  vIma2Device renderer;
  for (const LONG left : kEdges) {
    for (const LONG top : kEdges) {
      for (const LONG right : kEdges) {
        const tagRECT rect{left, top, right, top == 5 ? kLowest : kHighest};
        for (const bool transparent : {false, true}) {
          ASSERT_TRUE(renderer.Init(&image, nullptr, &rect, true, false));
          if (transparent) {
            renderer.EnableTransparency(5UL);
          } else {
            renderer.DisableTransparency();
          }
          renderer.Draw(canvas);
          ASSERT_TRUE(renderer.Init(&image, &rect, nullptr, false, true));
          renderer.Draw(canvas);
          renderer.EraseBackground(canvas, &rect, &rect, 0UL);
          renderer.EraseBackground(canvas, &rect, 7UL, true);
        }
      }
    }
  }
}

TEST(vIma2Device, CopyDrawsTheSameImage) {
  dImage image = NumberedImage(2, 2, 8, "BGR");
  const tagRECT target{1, 1, 3, 3};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, true, true));
  renderer.EnableTransparency(PixelOf(image, 0, 0));
  Canvas first(4, 4);
  Canvas second(4, 4);
  ASSERT_TRUE(renderer.Draw(first));
  vIma2Device copy(renderer);
  vIma2Device assigned;
  assigned = copy;
  assigned = *&assigned;
  EXPECT_EQ(RectText(*assigned.GetTargetRect()), "1 1 3 3");
  ASSERT_TRUE(assigned.Draw(second));
  for (int y = 0; y < 4; ++y) {
    for (int x = 0; x < 4; ++x) {
      EXPECT_EQ(second.At(x, y), first.At(x, y));
    }
  }
}

TEST(vIma2Device, CopyKeepsHowToDraw) {
  dImage image = NumberedImage(4, 2, 8, "G");
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, true, true));
  EXPECT_FALSE(renderer.EraseBackground(nullptr, nullptr, nullptr, 0));
  vIma2Device copy(renderer);
  EXPECT_EQ(StatusText(copy), "EraseBackground: no region specified");
  const tagRECT square{0, 0, 4, 4};
  ASSERT_TRUE(copy.SetTargetRect(&square));
  EXPECT_EQ(RectText(*copy.GetTargetRect()), "0 1 4 3") << "it is fitted";
  image = NumberedImage(5, 2, 8, "G");  // described anew: still upside down
  ASSERT_TRUE(copy.SetSourceRect(nullptr));
  ASSERT_TRUE(copy.SetTargetRect(nullptr));
  Canvas canvas(5, 2);
  ASSERT_TRUE(copy.Draw(canvas));
  EXPECT_EQ(canvas.At(4, 0), PixelOf(image, 4, 1));
  EXPECT_EQ(canvas.At(4, 1), PixelOf(image, 4, 0));
}

TEST(vIma2Device, IsRegisteredUnderBaseClass) {
  EXPECT_STREQ(vIma2Device::CI().name, "vIma2Device");
  EXPECT_EQ(vIma2Device::CI().parents[0], &BaseClass::CI());
  BaseClass* object = vIma2Device::CI().Create();
  ASSERT_NE(object, nullptr);
  EXPECT_STREQ(object->ClassName(), "vIma2Device");
  object->Release();
}

/// Which pixels have the colour, as text: one line per row.
std::string Painted(const Canvas& canvas, unsigned colour) {
  std::string text;
  for (int y = 0; y < canvas.Height(); ++y) {
    for (int x = 0; x < canvas.Width(); ++x) {
      text += canvas.At(x, y) == colour ? '#' : '.';
    }
    text += '\n';
  }
  return text;
}

constexpr unsigned kColour = 0x302010;

TEST(vIma2DeviceErase, RegionMustBeGiven) {
  vIma2Device renderer;
  Canvas canvas(2, 2);
  LogRecorder log;
  EXPECT_FALSE(renderer.EraseBackground(canvas, nullptr, nullptr, kColour));
  EXPECT_EQ(StatusText(renderer), "EraseBackground: no region specified");
  EXPECT_FALSE(renderer.EraseBackground(canvas, nullptr, kColour, true));
  const std::string text = "vIma2Device::EraseBackground: EraseBackground: no region specified";
  EXPECT_EQ(log.errors, (std::vector<std::string>{text, text}));
}

TEST(vIma2DeviceErase, WholeRegionIsFilledWithoutAnExclusion) {
  vIma2Device renderer;
  const tagRECT region{1, 0, 4, 2};
  const tagRECT empty{2, 1, 2, 1};
  for (const tagRECT* excluded : {static_cast<const tagRECT*>(nullptr), &empty}) {
    Canvas canvas(5, 3);
    EXPECT_TRUE(renderer.EraseBackground(canvas, &region, excluded, kColour));
    EXPECT_EQ(Painted(canvas, kColour), ".###.\n.###.\n.....\n");
  }
}

TEST(vIma2DeviceErase, ExcludedRectangleStays) {
  vIma2Device renderer;
  const tagRECT region{0, 0, 6, 4};
  const struct {
    tagRECT excluded;
    const char* painted;
  } kCases[] = {{{2, 1, 4, 3}, "######\n##..##\n##..##\n######\n"},
                {{-5, -5, 3, 2}, "...###\n...###\n######\n######\n"},
                {{4, 2, 99, 99}, "######\n######\n####..\n####..\n"},
                {{0, 1, 6, 2}, "######\n......\n######\n######\n"},
                {{6, 0, 9, 4}, "######\n######\n######\n######\n"},
                {{0, 0, 6, 4}, "......\n......\n......\n......\n"},
                {{-1, -1, 7, 5}, "......\n......\n......\n......\n"},
                {{4, 3, 2, 1}, "######\n##..##\n##..##\n######\n"}};
  for (const auto& one : kCases) {
    Canvas canvas(6, 4);
    EXPECT_TRUE(renderer.EraseBackground(canvas, &region, &one.excluded, kColour));
    EXPECT_EQ(Painted(canvas, kColour), one.painted) << RectText(one.excluded);
  }
}

TEST(vIma2DeviceErase, TargetIsExcludedWhenThereIsAnImage) {
  dImage image = NumberedImage(2, 2, 8, "G");
  const tagRECT target{2, 1, 4, 3};
  const tagRECT region{0, 0, 6, 4};
  vIma2Device renderer;
  ASSERT_TRUE(renderer.Init(&image, nullptr, &target, false, false));
  const auto paint = [&](bool exclude) {
    Canvas canvas(6, 4);
    EXPECT_TRUE(renderer.EraseBackground(canvas, &region, kColour, exclude));
    return Painted(canvas, kColour);
  };
  const std::string whole = "######\n######\n######\n######\n";
  EXPECT_EQ(paint(true), "######\n##..##\n##..##\n######\n");
  EXPECT_EQ(paint(false), whole);
  ASSERT_TRUE(renderer.SetTargetRect(&region));
  EXPECT_EQ(paint(true), "......\n......\n......\n......\n");
  image.Reset();
  EXPECT_EQ(paint(true), whole);
  ASSERT_TRUE(renderer.Init(nullptr, nullptr, nullptr, false, false));
  EXPECT_EQ(paint(true), whole);
}

TEST(vIma2DeviceErase, DeviceThatIsNoneFails) {
  vIma2Device renderer;
  const tagRECT region{0, 0, 6, 4};
  EXPECT_FALSE(renderer.EraseBackground(nullptr, &region, nullptr, kColour));
#if !defined(_WIN32)  // not every system tells of a device that is gone
  const tagRECT excluded{1, 1, 2, 2};
  const HDC dc = CreateCompatibleDC(nullptr);
  DeleteDC(dc);
  EXPECT_FALSE(renderer.EraseBackground(dc, &region, nullptr, kColour));
  EXPECT_FALSE(renderer.EraseBackground(dc, &region, &excluded, kColour));
#endif
}

}  // namespace
