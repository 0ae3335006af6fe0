// A ruler in millimetres below a picture: graphic coordinates are pixels of 0.25 mm, which a
// UnitTrafo turns into what the axis shows. A line is measured in pixels and told in millimetres,
// too.
#include <vorl/vorl.h>

#include <cstdio>

namespace {

constexpr double kPixelMm = 0.25;

template <class View>
void Show(GraphicHandler& layer, View& view) {
  view.SetViewState(VGViewState_Visible);
  view.SetPenColor(RGB(230, 230, 230));
  layer.AddObject(&view);
}

}  // namespace

int main() {
  UnitTrafo millimetres;
  millimetres.SetUnitTrafo(0, kPixelMm, -50);  // pixel 200 is the origin
  millimetres.SetUnitText(0, "mm", "millimetres");

  GraphicHandler layer;
  VGAxisView ruler;
  ruler.Init(dVect2D(0, 200), 400, TAxis_X, "");
  ruler.SetAxisUnit(&millimetres);
  ruler.DefineAxisScala(60, 0);  // ticks about 60 pixels apart
  Show(layer, ruler);
  VGLineView line;
  line.Init(dVect2D(80, 40), dVect2D(200, 130), TLine_Segment);
  Show(layer, line);

  // The picture shows 400 x 200 units on as many pixels; the ruler stands in the border below.
  GraphicViewPort viewPort(Rect2D(0, 0, 400, 200), Rect2D(0, 0, 400, 200), Rect2D(0, 0, 400, 240));
  viewPort.SetBorder(0, 0, 0, 40);
  viewPort.ClipBorders(false);
  viewPort.AddGraphic(&layer);
  viewPort.UpdateTransformation();

  dDIB window(400, 240, 3, 8);
  const HDC dc = CreateCompatibleDC(nullptr);
  const HGDIOBJ before = SelectObject(dc, window.GetHandle());
  const int whole = SaveDC(dc);  // each step cuts down what the next one may draw on
  viewPort.EraseBkgnd(dc, nullptr, false);
  RestoreDC(dc, whole);
  viewPort.Draw(dc, nullptr, false);
  std::printf("the line begins with a pixel of %06lx\n",
              static_cast<unsigned long>(GetPixel(dc, 80, 40)));
  SelectObject(dc, before);
  DeleteDC(dc);
  viewPort.RemoveGraphic(&layer);

  double start = 0;
  double end = 0;
  ruler.GetValueRange(start, end);
  std::printf("from %.0f to %.0f mm\n", start, end);
  std::printf("a tick every %.0f mm\n", ruler.CalcScalaValueDistance());
  std::printf("the line is %.1f mm long\n", kPixelMm * static_cast<double>(line.GetLength()));
  return window.Save("ruler.bmp", true) ? 0 : 1;
}

// Prints:
//   the line begins with a pixel of e6e6e6
//   from -50 to 50 mm
//   a tick every 20 mm
//   the line is 37.5 mm long
