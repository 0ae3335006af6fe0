#ifndef VORL_GUI_INPUTEVENTHANDLER_H
#define VORL_GUI_INPUTEVENTHANDLER_H

/// @file
/// Mouse and key events, sorted by what happened and with which button.

#include <vorl/GUI/Rect2D.h>
#include <vorl/Platform/GdiFwd.h>
#include <vorl/export.h>

inline namespace vorl {

/// What the mouse did.
enum MouseEvent : int {
  MouseEvent_Move = 4097,
  MouseEvent_ButtonDown = 4098,
  MouseEvent_ButtonUp = 4099
};

/// Turns raw mouse events into calls of ten handlers, each of which a derived class may override. A
/// handler returns true when it has used the event.
///
/// Flags are the device interface's mouse key bits (`MK_LBUTTON` ...). Of the buttons that they
/// name, the left one goes before the right one and the right one before the middle one.
class VORL_API InputEventHandler {
 public:
  /// Takes mouse and key events.
  InputEventHandler();
  InputEventHandler(const InputEventHandler& source);
  InputEventHandler& operator=(const InputEventHandler& source);
  virtual ~InputEventHandler();

  /// Passes an event (`MouseEvent`) on to the handler for it and returns what that returns. False
  /// for other event codes, for a button that goes down or up while no button is named, and while
  /// mouse events are disabled.
  virtual bool ProcessMouseEvent(int event, int flags, dVect2D& point);
  /// The same; a handler's changes to its point do not come back.
  virtual bool ProcessMouseEvent(int event, int flags, tagPOINT& point);
  /// False here: the meaning of the three codes is up to those who send and who override.
  virtual bool ProcessKeyEvent(int event, int flags, int key);

  void EnableMouseEvents(bool enable);
  /// A derived class that takes key events asks with `KeyEventsEnabled`.
  void EnableKeyEvents(bool enable);
  bool MouseEventsEnabled() const;
  bool KeyEventsEnabled() const;

 protected:
  /// The handlers, all false here: no button, then left, middle and right.
  virtual bool OnMouseMove(int flags, dVect2D& point);
  virtual bool OnMouseMoveL(int flags, dVect2D& point);
  virtual bool OnMouseMoveM(int flags, dVect2D& point);
  virtual bool OnMouseMoveR(int flags, dVect2D& point);
  virtual bool OnMouseDownL(int flags, dVect2D& point);
  virtual bool OnMouseDownM(int flags, dVect2D& point);
  virtual bool OnMouseDownR(int flags, dVect2D& point);
  virtual bool OnMouseUpL(int flags, dVect2D& point);
  virtual bool OnMouseUpM(int flags, dVect2D& point);
  virtual bool OnMouseUpR(int flags, dVect2D& point);

 private:
  bool m_mouseEvents = true;
  bool m_keyEvents = true;
};

}  // namespace vorl

#endif
