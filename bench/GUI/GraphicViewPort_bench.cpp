// A whole scene in a viewport, drawn and zoomed: 2000 objects over an image of 2048 x 2048 pixels,
// on 1920 x 1080 pixels of a device.
#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/VGBitmapView.h>
#include <vorl/GUI/VGLine.h>
#include <vorl/GUI/VGPoint.h>
#include <vorl/GUI/VGRect.h>
#include <vorl/GUI/VGText.h>

#include <memory>
#include <random>
#include <string>

#include "../Screen.h"

namespace {

constexpr unsigned long kWidth = 1920;
constexpr unsigned long kHeight = 1080;
constexpr unsigned long kImageEdge = 2048;
constexpr int kObjects = 2000;

/// The image in one layer and the objects in another, shown whole and centred.
class Scene {
 public:
  Scene() : m_screen(kWidth, kHeight) {
    m_image.Init(bench::Shrunk(kImageEdge), bench::Shrunk(kImageEdge), ImageDataType_U8, "G",
                 ImageDataOrder_Pixel, 4);
    bench::Fill(m_image);
    const auto edge = static_cast<float>(m_image.GetWidth());
    m_bitmap.Init(&m_image, 0, 0, edge, edge);
    m_bitmap.SetViewState(VGViewState_Visible);
    m_background.AddObject(&m_bitmap);
    std::mt19937 random(1);
    std::uniform_real_distribution<float> place(0, edge);
    for (int i = 0; i < kObjects; ++i) {
      AddObject(i, {place(random), place(random)}, edge / 40);
    }
    const Rect2D area(0, 0, edge, edge);
    m_viewPort.Init(
        area, area,
        Rect2D(0, 0, static_cast<float>(m_screen.Width()), static_cast<float>(m_screen.Height())));
    m_viewPort.FitSize();
    m_viewPort.SetAlignment(ViewAlignment_CenterX | ViewAlignment_CenterY);
    m_viewPort.AddGraphic(&m_background);
    m_viewPort.AddGraphic(&m_layer);
    m_viewPort.UpdateTransformation();
    m_viewPort.Draw(m_screen, nullptr, false);
  }
  Scene(const Scene&) = delete;
  Scene& operator=(const Scene&) = delete;
  ~Scene() { m_viewPort.RemoveGraphic(nullptr); }

  GraphicViewPort& ViewPort() { return m_viewPort; }
  GraphicHandler& Background() { return m_background; }
  GraphicHandler& Layer() { return m_layer; }
  const bench::Screen& GetScreen() const { return m_screen; }

  /// The window painted anew.
  void Draw() {
    m_viewPort.EraseBkgnd(m_screen, nullptr, false);
    m_viewPort.Draw(m_screen, nullptr, false);
  }

 private:
  void AddObject(int index, const dVect2D& place, float size) {
    std::unique_ptr<VGObjectView> object;
    switch (index % 4) {
      case 0:
        object = std::make_unique<VGPointView>(VGPoint(place));
        break;
      case 1: {
        VGLine line;
        line.Init(place, {place.x + size, place.y - size}, TLine_Segment);
        object = std::make_unique<VGLineView>(line);
        break;
      }
      case 2: {
        VGRect rect;
        rect.Init(place.x, place.y, place.x + size, place.y + size / 2);
        object = std::make_unique<VGRectView>(rect);
        break;
      }
      default: {
        VGText text;
        text.SetPos(place, 0);
        text = std::to_string(index).c_str();
        object = std::make_unique<VGTextView>(text);
      }
    }
    object->SetDynamicCreationFlag();
    object->SetViewState(VGViewState_Visible);
    object->SetPenColor(static_cast<int>(RGB(255, 200, index % 256)));
    object->Enable(VGOperation_All);
    m_layer.AddObject(object.release());
  }

  bench::Screen m_screen;
  dImage m_image;
  VGBitmapView m_bitmap;
  GraphicHandler m_background;
  GraphicHandler m_layer;
  GraphicViewPort m_viewPort;
};

void DrawScene(benchmark::State& state) {
  Scene scene;
  for (auto _ : state) {
    scene.Draw();
    benchmark::ClobberMemory();
  }
  scene.GetScreen().Report(state);
}

void DrawImage(benchmark::State& state) {
  Scene scene;
  for (auto _ : state) {
    scene.ViewPort().Draw(scene.GetScreen(), &scene.Background(), nullptr, false);
    benchmark::ClobberMemory();
  }
  scene.GetScreen().Report(state);
}

void DrawObjects(benchmark::State& state) {
  Scene scene;
  for (auto _ : state) {
    scene.ViewPort().Draw(scene.GetScreen(), &scene.Layer(), nullptr, false);
    benchmark::ClobberMemory();
  }
  state.SetItemsProcessed(state.iterations() * kObjects);
}

// What a movement of the mouse by one pixel costs while it zooms, in and out in turn, painting
// included.
void ZoomStep(benchmark::State& state) {
  Scene scene;
  scene.Background().Disable(GraphicHandlerFlag_Interactive);
  scene.Layer().Disable(GraphicHandlerFlag_Interactive);
  GraphicViewPort& viewPort = scene.ViewPort();
  const tagPOINT start = {scene.GetScreen().Width() / 2, scene.GetScreen().Height() / 2};
  const int flags = MK_LBUTTON | MK_SHIFT;
  viewPort.ProcessMouseEvent(MouseEvent_ButtonDown, flags, start);
  int step = 0;
  for (auto _ : state) {
    const tagPOINT point = {start.x, start.y - (++step % 20 < 10 ? step % 10 : 10 - step % 10)};
    if (!viewPort.ProcessMouseEvent(MouseEvent_Move, flags, point)) {
      state.SkipWithError("nothing zooms");
      return;
    }
    viewPort.UpdateTransformation();
    scene.Draw();
    benchmark::ClobberMemory();
  }
  scene.GetScreen().Report(state);
}

// A point that no object lies under: every one is asked.
void HitTest(benchmark::State& state) {
  Scene scene;
  dVect2D point(-100, -100);
  for (auto _ : state) {
    if (scene.Layer().HitTest(point, 2) != nullptr) {
      state.SkipWithError("something is hit");
      return;
    }
  }
  state.SetItemsProcessed(state.iterations() * kObjects);
}

BENCHMARK(DrawScene)->Name("scene/draw")->Unit(benchmark::kMicrosecond);
BENCHMARK(DrawImage)->Name("scene/draw/image")->Unit(benchmark::kMicrosecond);
BENCHMARK(DrawObjects)->Name("scene/draw/objects")->Unit(benchmark::kMicrosecond);
BENCHMARK(ZoomStep)->Name("scene/zoomStep")->Unit(benchmark::kMicrosecond);
BENCHMARK(HitTest)->Name("GraphicHandler/HitTest")->Unit(benchmark::kMicrosecond);

}  // namespace
