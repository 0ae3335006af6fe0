// Objects that the user creates by clicking: a handler of the application's own says what a click
// makes, and owns it. The same press and drag then pulls out the new object.
#include <vorl/vorl.h>

#include <cstdio>

namespace {

class Drawing : public GraphicHandler {
 public:
  VGObjectView* CreateObject(VGType type) override {
    VGObjectView* object = nullptr;
    switch (type) {
      case VGType_Point:
        object = new VGPointView;
        break;
      case VGType_Line:
        object = new VGLineView;
        break;
      case VGType_Rect:
        object = new VGRectView;
        break;
      default:
        return nullptr;
    }
    object->SetDynamicCreationFlag();  // the handler destroys it
    object->SetPenColor(RGB(255, 200, 0));
    return object;
  }
};

void Drag(GraphicViewPort& viewPort, tagPOINT from, tagPOINT to) {
  viewPort.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, from);
  viewPort.ProcessMouseEvent(MouseEvent_Move, MK_LBUTTON, to);
  viewPort.ProcessMouseEvent(MouseEvent_ButtonUp, MK_LBUTTON, to);
}

}  // namespace

int main() {
  Drawing drawing;
  // A millimetre of the drawing takes two pixels.
  GraphicViewPort viewPort(Rect2D(0, 0, 100, 100), Rect2D(0, 0, 100, 100), Rect2D(0, 0, 200, 200));
  viewPort.AddGraphic(&drawing);
  viewPort.UpdateTransformation();

  drawing.SetCreateMode(VGType_Line, 1);
  Drag(viewPort, {20, 20}, {80, 100});
  drawing.SetCreateMode(VGType_Rect, 2);
  Drag(viewPort, {100, 120}, {160, 180});

  if (const auto* const line = dynamic_cast<VGLineView*>(drawing.GetObject(1L))) {
    std::printf("line: %.0f mm long\n", line->GetLength());
  }
  if (const auto* const rect = dynamic_cast<VGRectView*>(drawing.GetObject(2L))) {
    std::printf("rectangle: %.0f, %.0f to %.0f, %.0f\n", rect->TopLeft().x, rect->TopLeft().y,
                rect->BottomRight().x, rect->BottomRight().y);
  }
  std::printf("deleted: %s\n", drawing.DeleteObject(1L) ? "line" : "nothing");
  std::printf("left: %s\n", drawing.GetObject(2L) != nullptr ? "rectangle" : "nothing");
  viewPort.RemoveGraphic(&drawing);
}

// Prints:
//   line: 50 mm long
//   rectangle: 50, 60 to 80, 90
//   deleted: line
//   left: rectangle
