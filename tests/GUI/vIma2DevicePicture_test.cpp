// One picture of everything: fitted, cropped, enlarged, flipped, mirrored and transparent, compared
// with one that was looked at.
#include <vorl/GUI/vIma2Device.h>

#include <gtest/gtest.h>

#include "Canvas.h"
#include "PictureTesting.h"

namespace {

/// A letter F in a ring: any turn or mirroring shows.
dImage Letter() {
  dImage image;
  EXPECT_TRUE(image.Init(40, 30, ImageDataType_U8, "BGR", 0, 4));
  for (int y = 0; y < 30; ++y) {
    auto* row = static_cast<unsigned char*>(image.GetRowPtr(y));
    for (int x = 0; x < 40; ++x) {
      const bool isLetter = (x >= 14 && x < 18 && y >= 6 && y < 24) ||
                            (x >= 14 && x < 27 && y >= 6 && y < 10) ||
                            (x >= 14 && x < 24 && y >= 14 && y < 17);
      const int distance = (x - 20) * (x - 20) + (y - 15) * (y - 15);
      const bool isRing = distance >= 144 && distance < 200;
      row[3 * x] = static_cast<unsigned char>(isLetter ? 240 : isRing ? 40 : 200);
      row[3 * x + 1] = static_cast<unsigned char>(isLetter ? 240 : isRing ? 200 : 120);
      row[3 * x + 2] = static_cast<unsigned char>(isLetter ? 250 : isRing ? 80 : 30);
    }
  }
  return image;
}

/// A grey ramp with a step in it.
dImage Ramp() {
  dImage image;
  EXPECT_TRUE(image.Init(32, 16, ImageDataType_U8, "G", 0, 4));
  for (int y = 0; y < 16; ++y) {
    auto* row = static_cast<unsigned char*>(image.GetRowPtr(y));
    for (int x = 0; x < 32; ++x) {
      row[x] = static_cast<unsigned char>(x * 7 + (y < 8 ? 0 : 30));
    }
  }
  return image;
}

void DrawAll(Canvas& canvas) {
  dImage letter = Letter();
  dImage ramp = Ramp();
  const tagRECT whole{0, 0, 240, 160};
  vIma2Device renderer;
  EXPECT_TRUE(renderer.EraseBackground(canvas, &whole, nullptr, 0x604020));
  const auto draw = [&](dImage& image, const tagRECT* source, tagRECT target, bool hold,
                        bool flip) {
    EXPECT_TRUE(renderer.Init(&image, source, &target, hold, flip));
    EXPECT_TRUE(renderer.EraseBackground(canvas, &target, 0x90B0C0, true) || !hold);
    EXPECT_TRUE(renderer.Draw(canvas));
  };
  const auto frame = [&](tagRECT cell) {
    EXPECT_TRUE(renderer.EraseBackground(canvas, &cell, nullptr, 0x8090A0));
  };
  const tagRECT part{10, 3, 30, 18};
  frame({5, 5, 75, 50});
  draw(letter, nullptr, {5, 5, 75, 50}, true, false);  // fitted into a wide cell
  frame({85, 5, 155, 50});
  draw(letter, &part, {90, 8, 150, 47}, false, false);  // a part, enlarged unevenly
  frame({165, 5, 235, 50});
  draw(letter, nullptr, {180, 12, 220, 42}, false, true);  // flipped
  frame({5, 58, 75, 103});
  draw(letter, nullptr, {59, 65, 19, 95}, false, false);  // mirrored
  frame({85, 58, 155, 103});
  draw(ramp, nullptr, {85, 58, 155, 103}, true, false);
  renderer.EnableTransparency(RGB(30, 120, 200) + 0UL);
  frame({165, 58, 235, 103});
  draw(letter, nullptr, {170, 60, 230, 105}, false, false);  // without the blue ground
  renderer.EnableTransparency(20, 2);
  draw(letter, &part, {5, 112, 75, 155}, false, true);  // without the ring's green, flipped
  renderer.DisableTransparency();
  draw(letter, nullptr, {85, 112, 101, 124}, false, false);  // smaller
  draw(ramp, nullptr, {120, 112, 136, 155}, true, false);
  renderer.ResetPalette(false);
  tagRECT negative{150, 112, 240, 155};
  EXPECT_TRUE(renderer.SetTargetRect(&negative));
  EXPECT_TRUE(renderer.Draw(canvas));
}

TEST(vIma2DevicePicture, IsTheOneThatWasLookedAt) {
  Canvas canvas(240, 160);
  DrawAll(canvas);
  gui_testing::ExpectPicture(canvas, "vIma2Device");
}

}  // namespace
