#ifndef TESTS_GUI_GESTURERULES_H
#define TESTS_GUI_GESTURERULES_H

/// @file
/// What holds of a viewport and its layers whatever a user has done.

#include <cmath>
#include <vector>

#include "GestureTesting.h"

namespace gui_testing {

struct Box {
  dVect2D min;
  dVect2D max;
};

inline Box BoxOf(VGObjectView& object, HDC dc) {
  Box box;
  object.CalcBoundingBox(dc, box.min, box.max);
  return box;
}

/// The single precision of numbers of this size, and a little.
inline double ToleranceAt(double size) {
  return 0.02 + 1e-5 * std::abs(size);
}

inline void ExpectClose(const dVect2D& point, double x, double y, const char* what) {
  EXPECT_NEAR(point.x, x, ToleranceAt(x)) << what;
  EXPECT_NEAR(point.y, y, ToleranceAt(y)) << what;
}

/// Scales are inside their limits, and the graphic window fills the draw window.
inline void ExpectViewportInOrder(const GraphicViewPort& viewPort) {
  const auto expectLegal = [](double scale, double lowest, double highest) {
    EXPECT_GE(std::abs(scale), lowest * 0.999);
    EXPECT_LE(std::abs(scale), highest * 1.001);
  };
  expectLegal(viewPort.GetScaleX(), viewPort.GetMinScaleX(), viewPort.GetMaxScaleX());
  expectLegal(viewPort.GetScaleY(), viewPort.GetMinScaleY(), viewPort.GetMaxScaleY());
  const Rect2D view = viewPort.GetViewWin();
  Rect2D mapped;
  viewPort.GraphicToView(viewPort.GetGraphicWin(), mapped);
  EXPECT_NEAR(mapped.GetTL().x, view.GetTL().x + viewPort.GetLeftBorder(), 0.05);
  EXPECT_NEAR(mapped.GetTL().y, view.GetTL().y + viewPort.GetTopBorder(), 0.05);
  EXPECT_NEAR(mapped.GetBR().x, view.GetBR().x - viewPort.GetRightBorder(), 0.05);
  EXPECT_NEAR(mapped.GetBR().y, view.GetBR().y - viewPort.GetBottomBorder(), 0.05);
}

/// Nothing is being done with any object, and its two geometries agree.
inline void ExpectAtRest(const GestureLayer& layer, HDC dc) {
  for (VGObjectView* object : layer.objects) {
    EXPECT_EQ(object->GetOpState(), VGOperation_None) << object->GetObjType();
    EXPECT_EQ(object->GetROPMode(), R2_COPYPEN) << object->GetObjType();
    const Box shown = BoxOf(*object, dc);
    object->Transform(false);
    const Box fresh = BoxOf(*object, dc);
    ExpectClose(shown.min, fresh.min.x, fresh.min.y, "view and graphic geometry agree");
    ExpectClose(shown.max, fresh.max.x, fresh.max.y, "view and graphic geometry agree");
  }
}

/// The captured object on a screen while it is drawn with XOR: drawn once more, it is gone.
class RubberBand {
 public:
  RubberBand(GraphicViewPort& viewPort, Screen& screen) : m_viewPort(viewPort), m_screen(screen) {}

  /// Takes the band from the screen, which then is as it was without. False when there is none.
  bool Lift() {
    if (m_object == nullptr) {
      return false;
    }
    m_screen.PaintActiveObject(m_viewPort);
    EXPECT_TRUE(m_screen.Pixels() == m_ground) << "the band leaves a trace";
    return true;
  }
  /// Draws the band, if there still is one, or begins a new one. False when there is none.
  bool Drop() {
    VGObjectView* const active = m_viewPort.GetActiveGraphicObject();
    // Text knows no raster operations.
    if (active == nullptr || active->GetROPMode() != R2_XORPEN ||
        active->GetObjType() == VGType_Text) {
      m_object = nullptr;
      return false;
    }
    if (m_object != active) {
      m_object = active;
      m_screen.PaintWithout(m_viewPort, *active);
      m_ground = m_screen.Pixels();
    }
    m_screen.PaintActiveObject(m_viewPort);
    return true;
  }
  /// The rest of the picture has changed.
  void Renew() { m_object = nullptr; }
  /// The screen shows what is drawn afresh.
  void ExpectSameAsFresh() {
    Screen fresh;
    fresh.PaintWithout(m_viewPort, *m_object);
    fresh.PaintActiveObject(m_viewPort);
    EXPECT_TRUE(m_screen.Pixels() == fresh.Pixels()) << "not what a fresh drawing shows";
  }

 private:
  GraphicViewPort& m_viewPort;
  Screen& m_screen;
  VGObjectView* m_object = nullptr;
  std::vector<unsigned char> m_ground;  ///< the screen without it
};

}  // namespace gui_testing

#endif
