#ifndef TESTS_GUI_GESTURETESTING_H
#define TESTS_GUI_GESTURETESTING_H

/// @file
/// A screen that shows a viewport, and three layers with objects of every kind in it.

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/VGAxis.h>
#include <vorl/GUI/VGBitmapView.h>
#include <vorl/GUI/VGCrossCursorView.h>
#include <vorl/GUI/VGCurve.h>
#include <vorl/GUI/VGLine.h>
#include <vorl/GUI/VGPoint.h>
#include <vorl/GUI/VGRect.h>
#include <vorl/GUI/VGText.h>

#include <algorithm>
#include <random>
#include <vector>

#include "Canvas.h"

namespace gui_testing {

/// Chance that falls alike everywhere, as the standard's distributions do not.
class Dice {
 public:
  explicit Dice(unsigned seed) : m_random(seed) {}
  int Number(int from, int to) {
    return from + static_cast<int>(m_random() % static_cast<unsigned>(to - from + 1));
  }
  bool Chance(int oneIn) { return Number(1, oneIn) == 1; }

 private:
  std::mt19937 m_random;
};

/// A window's pixels, drawn on as an application does: the device context is kept, and comes back
/// from everything that changes its clip region.
class Screen {
 public:
  static constexpr int kWidth = 100;
  static constexpr int kHeight = 80;

  /// Everything anew.
  void Paint(GraphicViewPort& viewPort) {
    GdiFlush();
    m_canvas.Fill(0x55);
    InSavedContext([&] { viewPort.EraseBkgnd(m_canvas, nullptr, false); });
    InSavedContext([&] { viewPort.Draw(m_canvas, nullptr, false); });
  }
  void PaintActiveObject(GraphicViewPort& viewPort) { viewPort.DrawActiveObject(m_canvas); }
  /// Everything but one object.
  void PaintWithout(GraphicViewPort& viewPort, VGObjectView& object) {
    object.ResetViewState(VGViewState_Visible);
    Paint(viewPort);
    object.SetViewState(VGViewState_Visible);
  }
  std::vector<unsigned char> Pixels() {
    GdiFlush();
    std::vector<unsigned char> pixels;
    for (int y = 0; y < kHeight; ++y) {
      const auto* row = static_cast<const unsigned char*>(m_canvas.Bitmap().GetDataPtr(0, y));
      pixels.insert(pixels.end(), row, row + 3 * kWidth);
    }
    return pixels;
  }
  HDC Context() const { return m_canvas; }

 private:
  template <typename Action>
  void InSavedContext(Action action) {
    const int saved = SaveDC(m_canvas);
    EXPECT_NE(saved, 0);
    action();
    RestoreDC(m_canvas, saved);
  }

  Canvas m_canvas{kWidth, kHeight};
};

/// A layer that counts its events, knows its objects, all of which it owns, and creates those that
/// a click can make.
class GestureLayer : public GraphicHandler, public IGraphicHandler {
 public:
  GestureLayer() { SetInterface(this); }
  GestureLayer(const GestureLayer&) = delete;
  GestureLayer& operator=(const GestureLayer&) = delete;

  /// Takes the object over and shows it.
  void Show(VGObjectView* object, int enabled) {
    object->SetDynamicCreationFlag();
    object->SetViewState(VGViewState_Visible);
    object->Enable(static_cast<short>(enabled));
    ASSERT_TRUE(AddObject(object));
    objects.push_back(object);
  }

  using GraphicHandler::ProcessMouseEvent;
  bool ProcessMouseEvent(int event, int flags, dVect2D& point) override {
    ++received;
    isUsed = GraphicHandler::ProcessMouseEvent(event, flags, point);
    return isUsed;
  }
  VGObjectView* CreateObject(VGType type) override {
    VGObjectView* const object = NewObject(type);
    if (object != nullptr) {
      object->SetDynamicCreationFlag();
      objects.push_back(object);
    }
    return object;
  }
  void OnDeleteObject(GraphicHandler* /*handler*/, VGObjectView* object) override {
    std::erase(objects, object);
  }
  void OnCreateObject(GraphicHandler* /*handler*/, VGObjectView* /*object*/) override { ++created; }

  bool Holds(const VGObjectView* object) const {
    return std::find(objects.begin(), objects.end(), object) != objects.end();
  }

  std::vector<VGObjectView*> objects;
  dImage* image = nullptr;  ///< what created bitmaps show
  int received = 0;
  int created = 0;
  bool isUsed = false;  ///< the last answer

 private:
  VGObjectView* NewObject(VGType type) const {
    switch (type) {
      case VGType_Point:
        return new VGPointView();
      case VGType_Line:
        return new VGLineView();
      case VGType_Rect:
        return new VGRectView();
      case VGType_CrossCursor:
        return new VGCrossCursorView();
      case VGType_Text: {
        auto* const text = new VGTextView();
        *text = "T";
        return text;
      }
      case VGType_Bitmap: {
        auto* const bitmap = new VGBitmapView();
        bitmap->Init(image);
        return bitmap;
      }
      default:
        return nullptr;
    }
  }
};

/// An image of 60 x 45 pixels with an axis and a curve, shapes over it, and a layer for what is
/// created by clicks.
class GestureScene {
 public:
  static constexpr int kWidth = 60;
  static constexpr int kHeight = 45;

  GestureScene() {
    ground.image = shapes.image = sketches.image = &m_image;
    ShowGround();
    ShowShapes();
    viewPort.Init(Area(), Area(), Rect2D(5, 4, 95, 76));
    viewPort.SetScaleFactors(1.5F, 1.5F, 0.25F, 8, 0.25F, 8);
    viewPort.SetBgColor(0x203040);
    viewPort.SetBorderColor(0x807060);
    viewPort.SetBorder(3, 2, 1, 4);
    for (GestureLayer* layer : layers) {
      viewPort.AddGraphic(layer);
    }
    viewPort.UpdateTransformation();
  }
  GestureScene(const GestureScene&) = delete;
  GestureScene& operator=(const GestureScene&) = delete;

  static Rect2D Area() { return Rect2D(0, 0, kWidth, kHeight); }

 private:
  void ShowGround() {
    auto* const bitmap = new VGBitmapView();
    EXPECT_TRUE(bitmap->Init(&m_image));
    ground.Show(bitmap, 0);
    auto* const small = new VGBitmapView();
    EXPECT_TRUE(small->Init(&m_image, 40.0F, 5.0F, 55.0F, 16.0F));
    ground.Show(small, VGOperation_Select | VGOperation_Move | VGOperation_Modify);
    auto* const axis = new VGAxisView();
    axis->VGAxis::Init(dVect2D(5, 40), 50.0, TAxis_X, "u");
    axis->DefineAxisScala(30.0F, 1.0F);
    ground.Show(axis, 0);
    auto* const curve = new VGCurveView();
    EXPECT_TRUE(curve->SetData(0.0F, 6.0F, 8, m_values, CurveStorageMode_Reference));
    ground.Show(curve, 0);
  }
  void ShowShapes() {
    auto* const rect = new VGRectView();
    rect->VGRect::Init(8.0F, 6.0F, 30.0F, 26.0F);
    rect->SetPenColor(0x0000FF);
    shapes.Show(rect, VGOperation_All);
    auto* const line = new VGLineView();
    line->VGLine::Init(dVect2D(12, 30), dVect2D(50, 10), TLine_Segment);
    line->SetPenColor(0x00FF00);
    shapes.Show(line, VGOperation_Select | VGOperation_Move | VGOperation_Modify);
    auto* const turning = new VGLineView();
    turning->VGLine::Init(dVect2D(20, 12), dVect2D(30, 35), TLine_Segment);
    turning->SetDrawParams(PS_SOLID, 3, 0x00C0FF, R2_COPYPEN);
    shapes.Show(turning, VGOperation_All);
    auto* const endless = new VGLineView();
    endless->VGLine::Init(dVect2D(30, 20), dVect2D(31, 21), TLine_Infinite);
    endless->SetPenColor(0xFF00FF);
    shapes.Show(endless, VGOperation_All);
    auto* const text = new VGTextView();
    *text = "ab";
    text->VGText::SetPos(25.0F, 20.0F, 15);
    shapes.Show(text, VGOperation_Select | VGOperation_Move);
    auto* const point = new VGPointView();
    *static_cast<VGPoint*>(point) = dVect2D(30, 26);
    point->SetPenThickness(4);
    shapes.Show(point, VGOperation_Select | VGOperation_Move);
    auto* const cursor = new VGCrossCursorView();
    cursor->dVect2D::Set(45.0, 30.0);
    shapes.Show(cursor, VGOperation_Select | VGOperation_Move | VGOperation_Rotate);
  }

  dImage m_image = NumberedImage(kWidth, kHeight, ImageDataType_U8, "RGB");
  float m_values[8] = {30, 12, 25, 25, 8, 40, 33, 20};

 public:
  // After what their objects show, before the viewport that they are removed from.
  GestureLayer ground;
  GestureLayer shapes;
  GestureLayer sketches;
  GestureLayer* const layers[3] = {&ground, &shapes, &sketches};
  GraphicViewPort viewPort;
};

}  // namespace gui_testing

#endif
