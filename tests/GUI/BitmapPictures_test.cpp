// Images in viewports: fitted, zoomed, panned, clipped and transparent, and in all states of a
// shape.
#include <vorl/GUI/VGBitmapView.h>

#include <gtest/gtest.h>

#include "ContactSheet.h"
#include "PictureTesting.h"

namespace {

using gui_testing::Cell;
using gui_testing::CellLook;
using gui_testing::ContactSheet;
using gui_testing::Drag;
using gui_testing::DrawStates;
using gui_testing::ExpectPicture;
using gui_testing::kNumStates;

constexpr unsigned long kGround = RGB(40, 110, 190);

/// A letter F on blue, in a frame of another colour on each side: any turn, mirroring or missing
/// edge shows.
dImage Letter() {
  dImage image;
  EXPECT_TRUE(image.Init(24, 20, ImageDataType_U8, "BGR", ImageDataOrder_Pixel, 4));
  for (int y = 0; y < 20; ++y) {
    auto* row = static_cast<unsigned char*>(image.GetRowPtr(y));
    for (int x = 0; x < 24; ++x) {
      const bool isLetter = (x >= 8 && x < 11 && y >= 4 && y < 16) ||
                            (x >= 8 && x < 17 && y >= 4 && y < 7) ||
                            (x >= 8 && x < 15 && y >= 9 && y < 11);
      const COLORREF colour = y == 0     ? RGB(220, 40, 40)
                              : y == 19  ? RGB(40, 180, 60)
                              : x == 0   ? RGB(230, 180, 30)
                              : x == 23  ? RGB(160, 60, 200)
                              : isLetter ? RGB(250, 245, 230)
                                         : static_cast<COLORREF>(kGround);
      row[3 * x] = static_cast<unsigned char>(colour >> 16 & 255U);
      row[3 * x + 1] = static_cast<unsigned char>(colour >> 8 & 255U);
      row[3 * x + 2] = static_cast<unsigned char>(colour & 255U);
    }
  }
  return image;
}

/// A layer with one view.
class ImageLayer {
 public:
  explicit ImageLayer(VGBitmapView& view) {
    view.SetViewState(VGViewState_Visible);
    m_handler.AddObject(&view);
  }

 protected:
  GraphicHandler m_handler;
};

/// A cell that shows one view, to be zoomed and panned.
class ImageCell : private ImageLayer, public Cell {
 public:
  ImageCell(const ContactSheet& sheet, int column, int row, VGBitmapView& view,
            const CellLook& look = {1.0F, 0xC8D0D8})
      : ImageLayer(view), Cell(sheet, column, row, m_handler, look) {}
  /// Shows the graphic plane from a position on.
  void Look(float x, float y, float zoom) {
    Rect2D rect;
    viewPort.GetDrawWin(rect);
    viewPort.SetFixedGraphicArea(false);
    viewPort.SetGraphicWin(Rect2D(x, y, x + static_cast<float>(rect.Width()) / zoom,
                                  y + static_cast<float>(rect.Height()) / zoom));
    viewPort.UpdateTransformation();
  }
};

TEST(BitmapPictures, Images) {
  dImage letter = Letter();
  VGBitmapView view;
  ASSERT_TRUE(view.Init(&letter, 6, 6, 30, 26));
  ContactSheet sheet(5, 3, 56, 44);
  ImageCell(sheet, 0, 0, view).Draw();
  ImageCell zoomed(sheet, 1, 0, view);
  zoomed.Look(4, 4, 2);
  zoomed.Draw();
  ImageCell large(sheet, 2, 0, view);
  large.Look(12.5F, 7.25F, 5);
  large.Draw();
  ImageCell reduced(sheet, 3, 0, view);
  reduced.Look(-20, -20, 0.5F);
  reduced.Draw();
  // Its window is shown upside down: the image is not.
  ImageCell(sheet, 4, 0, view, {1.0F, 0xC8D0D8, true}).Draw();

  // Panned by the mouse, with its button down and up
  ImageCell panned(sheet, 0, 1, view);
  panned.viewPort.SetFixedGraphicArea(false);
  EXPECT_TRUE(panned.Down(40, 30));
  EXPECT_TRUE(panned.Move(24, 42));
  EXPECT_TRUE(panned.Up(24, 42));
  panned.Draw();
  // Cut by the borders of the viewport
  ImageCell cut(sheet, 1, 1, view);
  cut.viewPort.SetBorder(12, 9, 20, 5);
  cut.viewPort.SetBorderColor(0x4878A0);
  cut.Look(10, 10, 1);
  cut.Draw();
  view.EnableTransparency(kGround);
  ImageCell(sheet, 2, 1, view).Draw();
  view.EnableTransparency(9, 5);
  ImageCell transparent(sheet, 3, 1, view);
  transparent.Look(2, 3, 1.5F);
  transparent.Draw();
  view.DisableTransparency();
  // Stretched, with its corners swapped
  VGBitmapView stretched;
  ASSERT_TRUE(stretched.Init(&letter, 50, 20, 4, 8));
  ImageCell(sheet, 4, 1, stretched).Draw();

  dImage grey = NumberedImage(16, 14, ImageDataType_U8, "G");
  VGBitmapView ramp;
  ASSERT_TRUE(ramp.Init(&grey, 4, 4, 52, 40));
  ImageCell(sheet, 0, 2, ramp).Draw();
  ramp.ResetPalette(false);
  ImageCell(sheet, 1, 2, ramp).Draw();
  dImage bits = NumberedImage(16, 14, ImageDataType_U1, "G");
  VGBitmapView stipple;
  ASSERT_TRUE(stipple.Init(&bits, 4, 4, 52, 40));
  ImageCell(sheet, 2, 2, stipple).Draw();
  // Without an image: the viewport's background
  VGBitmapView none;
  none.Init(nullptr, 6, 6, 30, 26);
  none.SetPenColor(0x0000D0);
  none.Select(true);
  ImageCell(sheet, 3, 2, none).Draw();
  // By its position
  letter.SetPosition(20, 12);
  VGBitmapView placed;
  ASSERT_TRUE(placed.Init(&letter));
  ImageCell(sheet, 4, 2, placed).Draw();
  ExpectPicture(sheet, "Images");
}

TEST(BitmapPictures, States) {
  dImage letter = Letter();
  VGBitmapView view;
  ASSERT_TRUE(view.Init(&letter, 6, 6, 30, 26));
  view.SetPenColor(0x0000D0);
  view.Enable(VGOperation_Select | VGOperation_Move | VGOperation_Modify);
  ContactSheet sheet(kNumStates, 4, 56, 44);
  DrawStates(sheet, 0, view, Drag{{18, 14}, {32, 26}});
  DrawStates(sheet, 1, view, Drag{{30, 26}, {48, 36}});
  DrawStates(sheet, 2, view, Drag{{18, 6}, {22, 38}});
  view.SetPenColor(0x00FFFF);
  DrawStates(sheet, 3, view, Drag{{12, 32}, {4, 24}}, CellLook{2.0F, 0x604020});
  ExpectPicture(sheet, "ImageStates");
}

}  // namespace
