#include <vorl/GUI/InputEventHandler.h>

#include <vorl/Platform/Gdi.h>

inline namespace vorl {

namespace {

/// In the order in which the buttons are asked for.
enum class Button { Left, Right, Middle, None };

Button ButtonOf(int flags) {
  if ((flags & MK_LBUTTON) != 0) {
    return Button::Left;
  }
  if ((flags & MK_RBUTTON) != 0) {
    return Button::Right;
  }
  return (flags & MK_MBUTTON) != 0 ? Button::Middle : Button::None;
}

}  // namespace

InputEventHandler::InputEventHandler() = default;

InputEventHandler::InputEventHandler(const InputEventHandler& source) = default;

InputEventHandler& InputEventHandler::operator=(const InputEventHandler& source) = default;

InputEventHandler::~InputEventHandler() = default;

bool InputEventHandler::ProcessMouseEvent(int event, int flags, dVect2D& point) {
  if (!m_mouseEvents) {
    return false;
  }
  using Handler = bool (InputEventHandler::*)(int, dVect2D&);
  struct Row {
    int event;
    Handler byButton[4];  // in the order of `Button`
  };
  using Self = InputEventHandler;
  static constexpr Row kRows[] = {
      {MouseEvent_Move,
       {&Self::OnMouseMoveL, &Self::OnMouseMoveR, &Self::OnMouseMoveM, &Self::OnMouseMove}},
      {MouseEvent_ButtonDown,
       {&Self::OnMouseDownL, &Self::OnMouseDownR, &Self::OnMouseDownM, nullptr}},
      {MouseEvent_ButtonUp, {&Self::OnMouseUpL, &Self::OnMouseUpR, &Self::OnMouseUpM, nullptr}}};
  for (const Row& row : kRows) {
    if (row.event == event) {
      const Handler handler = row.byButton[static_cast<int>(ButtonOf(flags))];
      return handler != nullptr && (this->*handler)(flags, point);
    }
  }
  return false;
}

bool InputEventHandler::ProcessMouseEvent(int event, int flags, tagPOINT& point) {
  dVect2D vector(point);
  return ProcessMouseEvent(event, flags, vector);
}

bool InputEventHandler::ProcessKeyEvent(int, int, int) {
  return false;
}

void InputEventHandler::EnableMouseEvents(bool enable) {
  m_mouseEvents = enable;
}

void InputEventHandler::EnableKeyEvents(bool enable) {
  m_keyEvents = enable;
}

bool InputEventHandler::MouseEventsEnabled() const {
  return m_mouseEvents;
}

bool InputEventHandler::KeyEventsEnabled() const {
  return m_keyEvents;
}

bool InputEventHandler::OnMouseMove(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseMoveL(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseMoveM(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseMoveR(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseDownL(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseDownM(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseDownR(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseUpL(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseUpM(int, dVect2D&) {
  return false;
}

bool InputEventHandler::OnMouseUpR(int, dVect2D&) {
  return false;
}

}  // namespace vorl
