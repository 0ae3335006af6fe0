#ifndef TESTS_GUI_HANDLERTESTING_H
#define TESTS_GUI_HANDLERTESTING_H

/// @file
/// A layer of objects that write down what is done with them.

#include <vorl/GUI/GraphicHandler.h>

#include <functional>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

namespace gui_testing {

/// What happened, a line each.
using Lines = std::vector<std::string>;

inline std::string Text(const dVect2D& p) {
  std::ostringstream out;
  out << "(" << p.x << ", " << p.y << ")";
  return out.str();
}

/// Overrides no more than it must.
class BareView : public VGObjectView {
 public:
  VGType GetObjType() override { return VGType_None; }
  void Transform(bool toGraphic) override { (toGraphic ? written : refreshed) += 1; }
  void CalcBoundingBox(HDC /*dc*/, dVect2D& /*min*/, dVect2D& /*max*/) override {}
  using VGObjectView::AssignViewState;
  using VGObjectView::GetHandleDistance;
  using VGObjectView::GetLineDistance;
  using VGObjectView::SetOpState;
  int refreshed = 0;
  int written = 0;
};

/// A square that is grabbed anywhere inside. It ends its operations itself, as shapes do.
class RecordingView : public VGObjectView {
 public:
  RecordingView(Lines& lines, const char* name, float x = 0, float y = 0)
      : m_lines(lines), m_name(name), m_x(x), m_y(y) {
    SetViewState(VGViewState_Visible);
    VGObjectView::Enable(VGOperation_Select);
  }
  RecordingView(const RecordingView& source) = default;
  RecordingView& operator=(const RecordingView&) = delete;
  ~RecordingView() override {
    if (recordsEnd) {
      Add("end");
    }
  }

  VGType GetObjType() override { return type; }
  void Transform(bool toGraphic) override { Add(toGraphic ? "to graphic" : "to view"); }
  using VGObjectView::Draw;
  using VGObjectView::GetSelectionState;
  using VGObjectView::IsPointOnGraphic;
  bool IsPointOnGraphic(dVect2D& p, int tolerance) override {
    if (onAsk) {
      onAsk();
    }
    return p.x >= m_x - static_cast<float>(tolerance) && p.x <= m_x + 10 && p.y >= m_y &&
           p.y <= m_y + 10;
  }
  short GetSelectionState(int /*flags*/, dVect2D& p) override {
    return IsPointOnGraphic(p, 0) ? grabbedFor : short{0};
  }
  void DrawGraphic(HDC /*dc*/) override {
    Add("draw");
    if (onDraw) {
      onDraw();
    }
  }
  void DrawSelection(HDC /*dc*/) override { Add("draw selection"); }
  void CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) override {
    min.Set(m_x, m_y);
    max.Set(m_x + 10, m_y + 10);
  }
  bool OnCreate(int event, int flags, dVect2D& p) override {
    Add("create " + std::to_string(event) + " " + std::to_string(flags) + " " + Text(p));
    return answer;
  }
  bool OnBeginMove(dVect2D& p) override { return Begin("move", p); }
  bool OnMove(dVect2D& p) override { return Begin("moving", p); }
  bool OnEndMove(dVect2D& p) override { return End("moved", p); }
  bool OnBeginResize(dVect2D& p) override { return Begin("resize", p); }
  bool OnResize(dVect2D& p) override { return Begin("resizing", p); }
  bool OnEndResize(dVect2D& p) override { return End("resized", p); }
  bool OnBeginModify(dVect2D& p) override { return Begin("modify", p); }
  bool OnModify(dVect2D& p) override { return Begin("modifying", p); }
  bool OnEndModify(dVect2D& p) override { return End("modified", p); }
  bool OnBeginRotate(dVect2D& p) override { return Begin("rotate", p); }
  bool OnRotate(dVect2D& p) override { return Begin("rotating", p); }
  bool OnEndRotate(dVect2D& p) override { return End("rotated", p); }

  using VGObjectView::UpdateBoundingBox;

  VGType type = VGType_Rect;
  short grabbedFor = VGOperation_Move;
  bool answer = true;
  bool recordsEnd = false;
  std::function<void()> onAsk;
  std::function<void()> onDraw;

 private:
  void Add(const std::string& line) { m_lines.push_back(m_name + ": " + line); }
  bool Begin(const char* what, const dVect2D& p) {
    Add(std::string(what) + " " + Text(p));
    return answer;
  }
  bool End(const char* what, const dVect2D& p) {
    SetOpState(VGOperation_None);
    return Begin(what, p);
  }

  Lines& m_lines;
  std::string m_name;
  float m_x;
  float m_y;
};

/// Writes down what a handler tells, and does what a test wants at that point.
class RecordingClient : public IGraphicHandler {
 public:
  explicit RecordingClient(Lines& lines) : m_lines(lines) {}
  void OnCreateObject(GraphicHandler* handler, VGObjectView* object) override {
    Add("OnCreateObject", handler, object);
  }
  void OnDeleteObject(GraphicHandler* handler, VGObjectView* object) override {
    Add("OnDeleteObject", handler, object);
  }
  void OnSelectObject(GraphicHandler* handler, VGObjectView* object) override {
    Add("OnSelectObject", handler, object);
  }
  void OnModifyObject(GraphicHandler* handler, VGObjectView* object) override {
    Add("OnModifyObject", handler, object);
  }
  void OnObjectModified(GraphicHandler* handler, VGObjectView* object) override {
    Add("OnObjectModified", handler, object);
  }
  void GHEvent(GraphicHandler* handler, int /*event*/, VGObjectView* object) override {
    Add("GHEvent", handler, object);
  }

  /// By the name of the call.
  std::map<std::string, std::function<void(GraphicHandler*, VGObjectView*)>> actions;

 private:
  void Add(const std::string& call, GraphicHandler* handler, VGObjectView* object) {
    m_lines.push_back(call + " " +
                      (object != nullptr ? std::to_string(object->GetUserData()) : "null"));
    if (const auto action = actions.find(call); action != actions.end()) {
      action->second(handler, object);
    }
  }

  Lines& m_lines;
};

/// Writes down what an object tells.
class RecordingViewClient : public IVGObjectView {
 public:
  explicit RecordingViewClient(Lines& lines) : m_lines(lines) {}
  void OnBeginGraphicOp(VGObjectView* object, short operation) override {
    Add("OnBeginGraphicOp", object, operation);
  }
  void OnGraphicChanged(VGObjectView* object, short operation) override {
    Add("OnGraphicChanged", object, operation);
  }
  void OnEndGraphicOp(VGObjectView* object, short operation) override {
    Add("OnEndGraphicOp", object, operation);
  }

  std::map<std::string, std::function<void(VGObjectView*)>> actions;

 private:
  void Add(const std::string& call, VGObjectView* object, short operation) {
    m_lines.push_back(call + " " + std::to_string(object->GetUserData()) + " " +
                      std::to_string(operation));
    if (const auto action = actions.find(call); action != actions.end()) {
      action->second(object);
    }
  }

  Lines& m_lines;
};

/// Creates recording objects, and opens the selection.
class CreatingHandler : public GraphicHandler {
 public:
  explicit CreatingHandler(Lines& lines) : m_lines(lines) {}
  CreatingHandler(const CreatingHandler& source) = default;
  VGObjectView* CreateObject(VGType type) override {
    m_lines.push_back("CreateObject " + std::to_string(type));
    if (createsNothing) {
      return nullptr;
    }
    auto* object = new RecordingView(m_lines, "new");
    object->recordsEnd = true;
    object->type = type;
    object->SetUserData(99);
    object->ResetViewState(VGViewState_Visible);
    object->Disable(VGOperation_All);
    object->SetDynamicCreationFlag();
    if (onCreate) {
      onCreate(*object);
    }
    return object;
  }
  bool AddObject(VGObjectView* object) override {
    return acceptsObjects && GraphicHandler::AddObject(object);
  }
  using GraphicHandler::SelectObject;

  bool createsNothing = false;
  bool acceptsObjects = true;
  std::function<void(RecordingView&)> onCreate;

 private:
  Lines& m_lines;
};

/// A handler with objects on a diagonal that overlap their neighbours, and all clients.
class Layer {
 public:
  Layer() { handler.SetInterface(&client); }

  /// A movable object of the test's own, with the name as its user data.
  RecordingView& Add(int number, float x, float y) {
    auto* view = NewView(number, x, y);
    m_views.emplace_back(view);
    handler.AddObject(view);
    lines.clear();
    return *view;
  }
  /// One that the handler owns.
  RecordingView& AddOwned(int number, float x, float y) {
    auto* view = NewView(number, x, y);
    view->SetDynamicCreationFlag();
    view->recordsEnd = true;
    handler.AddObject(view);
    lines.clear();
    return *view;
  }
  bool Mouse(int event, int flags, float x, float y) {
    dVect2D p(x, y);
    return handler.ProcessMouseEvent(event, flags, p);
  }
  bool Down(float x, float y) { return Mouse(MouseEvent_ButtonDown, MK_LBUTTON, x, y); }
  bool Move(float x, float y) { return Mouse(MouseEvent_Move, MK_LBUTTON, x, y); }
  bool Up(float x, float y) { return Mouse(MouseEvent_ButtonUp, MK_LBUTTON, x, y); }
  /// What happened since this was last asked.
  Lines Take() {
    Lines taken;
    taken.swap(lines);
    return taken;
  }

  Lines lines;
  RecordingClient client{lines};
  RecordingViewClient viewClient{lines};

 private:
  RecordingView* NewView(int number, float x, float y) {
    auto* view = new RecordingView(lines, std::to_string(number).c_str(), x, y);
    view->SetUserData(number);
    view->SetObjID(number);
    view->Enable(VGOperation_Move);
    return view;
  }

  std::vector<std::unique_ptr<RecordingView>> m_views;

 public:
  CreatingHandler handler{lines};
};

}  // namespace gui_testing

#endif
