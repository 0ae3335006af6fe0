// A viewport with a layer of objects, fed by mouse events as a window would feed it: a press on the
// rectangle drags it, a press beside it moves the picture, with shift it zooms.
#include <vorl/vorl.h>

#include <cstdio>

namespace {

class Listener : public IGraphicHandler {
 public:
  void OnSelectObject(GraphicHandler*, VGObjectView* object) override {
    std::printf("%s\n", object != nullptr ? "selected" : "nothing selected");
  }
  void OnObjectModified(GraphicHandler*, VGObjectView* object) override {
    const auto* const rect = dynamic_cast<const VGRectView*>(object);
    std::printf("moved to %.1f, %.1f\n", rect->TopLeft().x, rect->TopLeft().y);
  }
};

// Presses the left button at one point and releases it at another, twenty moves later.
void Drag(GraphicViewPort& viewPort, int keys, tagPOINT from, tagPOINT to) {
  const int flags = MK_LBUTTON | keys;
  viewPort.ProcessMouseEvent(MouseEvent_ButtonDown, flags, from);
  for (int step = 1; step <= 20; ++step) {
    viewPort.ProcessMouseEvent(
        MouseEvent_Move, flags,
        {from.x + (to.x - from.x) * step / 20, from.y + (to.y - from.y) * step / 20});
  }
  viewPort.ProcessMouseEvent(MouseEvent_ButtonUp, flags, to);
  viewPort.UpdateTransformation();
  const dVect2D topLeft = viewPort.GetGraphicWin().GetTL();
  const dVect2D bottomRight = viewPort.GetGraphicWin().GetBR();
  std::printf("shown: %.1f, %.1f to %.1f, %.1f\n", topLeft.x, topLeft.y, bottomRight.x,
              bottomRight.y);
}

}  // namespace

int main() {
  VGRectView rect;
  VGRect corners;
  corners.Init(20, 20, 40, 30);
  rect.SetData(corners);
  rect.Enable(VGOperation_All);
  rect.SetViewState(VGViewState_Visible);
  rect.SetPenColor(RGB(255, 255, 255));

  Listener listener;
  GraphicHandler layer;
  layer.SetInterface(&listener);
  layer.AddObject(&rect);

  // 100 x 50 units on 400 x 200 pixels. At scale 1 a unit takes four pixels.
  GraphicViewPort viewPort(Rect2D(0, 0, 100, 50), Rect2D(0, 0, 100, 50), Rect2D(0, 0, 400, 200));
  viewPort.SetScaleFactors(4, 4, 1, 8, 1, 8);
  viewPort.AddGraphic(&layer);
  viewPort.UpdateTransformation();

  Drag(viewPort, 0, {100, 80}, {140, 100});          // the rectangle, by its upper edge
  Drag(viewPort, MK_SHIFT, {300, 150}, {300, 110});  // zooms in
  Drag(viewPort, 0, {300, 150}, {340, 150});         // moves the picture

  dDIB window(400, 200, 4, 8);
  const HDC dc = CreateCompatibleDC(nullptr);
  const HGDIOBJ before = SelectObject(dc, window.GetHandle());
  viewPort.EraseBkgnd(dc, nullptr, false);
  viewPort.Draw(dc, nullptr, false);
  SelectObject(dc, before);
  DeleteDC(dc);
  viewPort.RemoveGraphic(&layer);
  return window.Save("viewport.bmp", true) ? 0 : 1;
}

// Prints:
//   selected
//   moved to 30.0, 25.0
//   shown: 0.0, 0.0 to 100.0, 50.0
//   nothing selected
//   shown: 24.5, 12.3 to 91.8, 45.9
//   nothing selected
//   shown: 17.8, 12.3 to 85.1, 45.9
