// Draws an image into a device context: enlarged, keeping its aspect ratio, with one grey left
// transparent. The context stands over a bitmap in memory, which is saved as a file.
#include <vorl/vorl.h>

#include <cstdio>

int main() {
  dImage image;  // four pixels in a row: 0, 80, 160, 240
  image.Init(4, 1, ImageDataType_U8, "G", ImageDataOrder_Pixel, 4);
  for (int x = 0; x < 4; ++x) {
    *static_cast<unsigned char*>(image.GetDataPtr(x, 0)) = static_cast<unsigned char>(80 * x);
  }

  dDIB sheet(16, 8, 3, 8);
  sheet.Fill(100);
  const HDC dc = CreateCompatibleDC(nullptr);
  const HGDIOBJ before = SelectObject(dc, sheet.GetHandle());

  const tagRECT target = {0, 0, 16, 8};
  vIma2Device renderer;
  bool isDrawn = renderer.Init(&image, nullptr, &target, true, false);
  renderer.EnableTransparency(0x00F0F0F0);  // the pixel 240
  isDrawn = isDrawn && renderer.Draw(dc);

  SelectObject(dc, before);
  DeleteDC(dc);
  if (!isDrawn) {
    std::printf("not drawn: %s\n", static_cast<const char*>(renderer.GetStatus()));
    return 1;
  }
  for (int y = 0; y < 8; ++y) {
    for (int x = 0; x < 16; x += 2) {
      std::printf(" %3d", *static_cast<unsigned char*>(sheet.GetDataPtr(x, y)));
    }
    std::printf("\n");
  }
  return sheet.Save("draw_image.bmp", true) ? 0 : 1;
}

// Prints:
//    100 100 100 100 100 100 100 100
//    100 100 100 100 100 100 100 100
//      0   0  80  80 160 160 100 100
//      0   0  80  80 160 160 100 100
//      0   0  80  80 160 160 100 100
//      0   0  80  80 160 160 100 100
//    100 100 100 100 100 100 100 100
//    100 100 100 100 100 100 100 100
