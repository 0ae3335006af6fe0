#include <vorl/GUI/GraphicHandler.h>

inline namespace vorl {

IGraphicHandler::IGraphicHandler() = default;

IGraphicHandler::IGraphicHandler(const IGraphicHandler& source) = default;

IGraphicHandler& IGraphicHandler::operator=(const IGraphicHandler& source) = default;

IGraphicHandler::~IGraphicHandler() = default;

void IGraphicHandler::OnCreateObject(GraphicHandler* /*handler*/, VGObjectView* /*object*/) {}

void IGraphicHandler::OnDeleteObject(GraphicHandler* /*handler*/, VGObjectView* /*object*/) {}

void IGraphicHandler::OnSelectObject(GraphicHandler* /*handler*/, VGObjectView* /*object*/) {}

void IGraphicHandler::OnModifyObject(GraphicHandler* /*handler*/, VGObjectView* /*object*/) {}

void IGraphicHandler::OnObjectModified(GraphicHandler* /*handler*/, VGObjectView* /*object*/) {}

void IGraphicHandler::GHEvent(GraphicHandler* /*handler*/, int /*event*/,
                              VGObjectView* /*object*/) {}

bool GraphicHandler::ProcessMouseEvent(int event, int flags, dVect2D& point) {
  if (!IsInteractive()) {
    return false;
  }
  VGObjectView* const active = m_pActive;
  if (active == nullptr || !active->ProcessMouseEvent(event, flags, point)) {
    return InputEventHandler::ProcessMouseEvent(event, flags, point);
  }
  // It may be gone by now.
  if (m_pInterface != nullptr && m_pActive == active) {
    if (event == MouseEvent_Move) {
      m_pInterface->OnModifyObject(this, active);
    } else if (event == MouseEvent_ButtonUp) {
      m_pInterface->OnObjectModified(this, active);
    }
  }
  return true;
}

bool GraphicHandler::OnMouseDownL(int flags, dVect2D& point) {
  SelectObject(flags, point);
  if (m_pActive != nullptr) {
    m_pActive->Select(true);
    m_pActive->ProcessMouseEvent(MouseEvent_ButtonDown, flags, point);
    NotifySelection();
    return true;
  }
  if (m_createMode != VGType_None && CreateByClick(flags, point)) {
    return true;
  }
  NotifySelection();
  return false;
}

bool GraphicHandler::OnMouseDownR(int flags, dVect2D& point) {
  SelectObject(flags, point);
  NotifySelection();
  return m_pActive != nullptr;
}

// False when no object came of it. After each call of the application's code the object is touched
// only if it is still the active one: its end, by whatever hand, resets that.
bool GraphicHandler::CreateByClick(int flags, dVect2D& point) {
  m_pActive = nullptr;
  VGObjectView* const object = CreateObject(m_createMode);
  m_createMode = VGType_None;
  if (object == nullptr) {
    return false;
  }
  m_pActive = object;
  const bool isAdded = Register(object) && AddObject(object);
  if (m_pActive != object) {
    return false;
  }
  if (!IsListed(object)) {
    m_pActive = nullptr;
    Unregister(object);
    if (!isAdded && object->IsDynamicCreated()) {
      delete object;
    }
    return false;
  }
  if (m_createID != -1) {
    object->SetObjID(m_createID);
    m_createID = -1;
  }
  object->Enable(VGOperation_All);
  object->ProcessMouseEvent(MouseEvent_ButtonDown, flags, point);
  if (m_pActive == object) {
    object->Select(true);
    if (m_pInterface != nullptr) {
      m_pInterface->OnCreateObject(this, object);
    }
  }
  return true;
}

void GraphicHandler::NotifySelection() {
  if (m_pInterface != nullptr) {
    m_pInterface->OnSelectObject(this, m_pActive);
  }
}

void GraphicHandler::Draw(HDC dc, GraphicViewPort& viewPort) {
  DrawObjects(dc, &viewPort);
}

void GraphicHandler::Draw(HDC dc) {
  DrawObjects(dc, nullptr);
}

void GraphicHandler::DrawActiveObject(HDC dc, GraphicViewPort& viewPort) {
  if (IsEnabled(GraphicHandlerFlag_Visible) && m_pActive != nullptr) {
    m_pActive->Draw(dc, viewPort);
    GdiFlush();
  }
}

void GraphicHandler::DrawActiveObject(HDC dc) {
  if (IsEnabled(GraphicHandlerFlag_Visible) && m_pActive != nullptr) {
    m_pActive->Draw(dc);
    GdiFlush();
  }
}

VGObjectView* GraphicHandler::GetActiveObject() {
  return m_pActive;
}

VGObjectView* GraphicHandler::CreateObject(VGType /*type*/) {
  return nullptr;
}

void GraphicHandler::SetInterface(IGraphicHandler* client) {
  m_pInterface = client;
}

void GraphicHandler::SetCreateMode(VGType type, long id) {
  m_createMode = type;
  m_createID = id;
}

void GraphicHandler::Enable(short flags) {
  m_flags = static_cast<std::uint16_t>(m_flags | static_cast<std::uint16_t>(flags));
}

void GraphicHandler::Disable(short flags) {
  m_flags = static_cast<std::uint16_t>(m_flags & ~static_cast<std::uint16_t>(flags));
}

bool GraphicHandler::IsEnabled(short flags) const {
  const auto asked = static_cast<std::uint16_t>(flags);
  return (m_flags & asked) == asked;
}

bool GraphicHandler::IsInteractive() const {
  return IsEnabled(GraphicHandlerFlag_Visible | GraphicHandlerFlag_Interactive);
}

void GraphicHandler::SetUnitTrafo(const UnitTrafo& x, const UnitTrafo& y) {
  const UnitTrafo newY(y);  // they may be this handler's own, swapped
  m_unitTrafoX = x;
  m_unitTrafoY = newY;
}

UnitTrafo& GraphicHandler::GetUnitTrafoX() {
  return m_unitTrafoX;
}

const UnitTrafo& GraphicHandler::GetUnitTrafoX() const {
  return m_unitTrafoX;
}

UnitTrafo& GraphicHandler::GetUnitTrafoY() {
  return m_unitTrafoY;
}

const UnitTrafo& GraphicHandler::GetUnitTrafoY() const {
  return m_unitTrafoY;
}

void GraphicHandler::SelectUnitX(int unit) {
  m_unitTrafoX.SelectUnit(unit);
}

void GraphicHandler::SelectUnitY(int unit) {
  m_unitTrafoY.SelectUnit(unit);
}

}  // namespace vorl
