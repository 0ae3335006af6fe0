#ifndef VORL_TESTS_GUI_VIEWPORTTESTING_H
#define VORL_TESTS_GUI_VIEWPORTTESTING_H

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/VGObjectView.h>

#include <gtest/gtest.h>

#include <functional>
#include <string>

/// Opens what derived viewports may call.
class OpenViewPort : public GraphicViewPort {
 public:
  using GraphicViewPort::CorrectPosition;
  using GraphicViewPort::CorrectScaleLimits;
  using GraphicViewPort::CorrectSize;
  using GraphicViewPort::GraphicViewPort;
  using GraphicViewPort::IsInside;
  using GraphicViewPort::ProcessInteractiveOp;
  using GraphicViewPort::StartInteractiveOp;
  using GraphicViewPort::StopInteractiveOp;

  OpenViewPort() = default;
};

/// A viewport over a view window without borders and a graphic area and window, computed.
inline OpenViewPort Shown(const Rect2D& area, const Rect2D& window, const Rect2D& view) {
  OpenViewPort viewPort;
  viewPort.Init(area, window, view);
  viewPort.UpdateTransformation();
  return viewPort;
}

/// Counts what it is told.
class TrafoListener : public IGraphicViewPort {
 public:
  int count = 0;
  GraphicViewPort* last = nullptr;
  void OnTrafoChanged(GraphicViewPort* viewPort) override {
    ++count;
    last = viewPort;
  }
};

/// An object that nobody sees and that remembers the map it has been given.
class MapProbe : public VGObjectView {
 public:
  Trafo2DBase* map = nullptr;
  int given = 0;
  std::function<void()> atMap;
  VGType GetObjType() override { return VGType_None; }
  void SetTransformation(Trafo2DBase* trafo) override {
    map = trafo;
    ++given;
    if (atMap) {
      atMap();
    }
  }
  void Transform(bool) override {}
  void CalcBoundingBox(HDC, dVect2D&, dVect2D&) override {}
};

/// A handler that writes what reaches it into a common log, and does as it is told.
class TestHandler : public GraphicHandler {
 public:
  TestHandler(std::string handlerName, std::string& log)
      : name(std::move(handlerName)), m_log(log) {
    AddObject(&probe);
  }
  TestHandler(const TestHandler&) = delete;
  TestHandler& operator=(const TestHandler&) = delete;
  ~TestHandler() override { DeleteAll(); }

  std::string name;
  MapProbe probe;
  bool takesDown = false;
  bool takesOthers = false;
  bool takesKeys = false;
  VGObjectView* active = nullptr;
  dVect2D lastPoint;
  Trafo2DBase* mapAtEvent = nullptr;
  std::function<void()> atEvent;
  std::function<void(HDC)> draw;

  using GraphicHandler::Draw;
  using GraphicHandler::DrawActiveObject;
  using GraphicHandler::ProcessMouseEvent;
  bool ProcessMouseEvent(int event, int flags, dVect2D& point) override {
    m_log += name + ":" + std::to_string(event) + "/" + std::to_string(flags) + " ";
    lastPoint = point;
    point.Set(-1.0, -1.0);  // seen by nobody else
    mapAtEvent = probe.map;
    if (atEvent) {
      atEvent();
    }
    return event == MouseEvent_ButtonDown ? takesDown : takesOthers;
  }
  bool ProcessKeyEvent(int event, int flags, int key) override {
    m_log += name + ":key" + std::to_string(event) + "/" + std::to_string(flags) + "/" +
             std::to_string(key) + " ";
    mapAtEvent = probe.map;
    if (atEvent) {
      atEvent();
    }
    return takesKeys;
  }
  void Draw(HDC dc, GraphicViewPort& viewPort) override { DrawOn(dc, viewPort, ":draw "); }
  void DrawActiveObject(HDC dc, GraphicViewPort& viewPort) override {
    DrawOn(dc, viewPort, ":active ");
  }
  VGObjectView* GetActiveObject() override { return active; }

 private:
  void DrawOn(HDC dc, GraphicViewPort& viewPort, const char* what) {
    m_log += name + what;
    EXPECT_EQ(probe.map, &viewPort.GetTrafo());
    if (draw) {
      draw(dc);
    }
  }

  std::string& m_log;
};

/// All four edges, but for the last bits.
inline void ExpectEdges(const Rect2D& rect, float left, float top, float right, float bottom) {
  EXPECT_FLOAT_EQ(rect.GetTL().x, left);
  EXPECT_FLOAT_EQ(rect.GetTL().y, top);
  EXPECT_FLOAT_EQ(rect.GetBR().x, right);
  EXPECT_FLOAT_EQ(rect.GetBR().y, bottom);
}

/// The transformation takes the graphic window to this rectangle.
inline void ExpectMapsWindowTo(const GraphicViewPort& viewPort, float left, float top, float right,
                               float bottom) {
  Rect2D mapped;
  viewPort.GraphicToView(viewPort.GetGraphicWin(), mapped);
  ExpectEdges(mapped, left, top, right, bottom);
}

inline void ExpectPoint(const dVect2D& point, float x, float y) {
  EXPECT_FLOAT_EQ(point.x, x);
  EXPECT_FLOAT_EQ(point.y, y);
}

#endif
