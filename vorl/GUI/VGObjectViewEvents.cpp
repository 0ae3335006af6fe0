// What the mouse does with an object: from events to the handlers of operations.

#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/VGObjectView.h>
#include <vorl/GUI/detail/ObjectWatch.h>

inline namespace vorl {

namespace {

/// The handlers of one operation.
struct OperationHandlers {
  using Handler = bool (VGObjectView::*)(dVect2D&);

  short operation;
  Handler begin;
  Handler proceed;
  Handler end;
};

constexpr OperationHandlers kOperations[] = {
    {VGOperation_Move, &VGObjectView::OnBeginMove, &VGObjectView::OnMove, &VGObjectView::OnEndMove},
    {VGOperation_Resize, &VGObjectView::OnBeginResize, &VGObjectView::OnResize,
     &VGObjectView::OnEndResize},
    {VGOperation_Modify, &VGObjectView::OnBeginModify, &VGObjectView::OnModify,
     &VGObjectView::OnEndModify},
    {VGOperation_Rotate, &VGObjectView::OnBeginRotate, &VGObjectView::OnRotate,
     &VGObjectView::OnEndRotate},
};

const OperationHandlers* HandlersOf(short operation) {
  for (const OperationHandlers& handlers : kOperations) {
    if (handlers.operation == operation) {
      return &handlers;
    }
  }
  return nullptr;
}

}  // namespace

bool VGObjectView::IsPointOnGraphic(tagPOINT& point, int tolerance) {
  dVect2D p(point);
  return IsPointOnGraphic(p, tolerance);
}

bool VGObjectView::IsPointOnGraphic(dVect2D& /*point*/, int /*tolerance*/) {
  return false;
}

short VGObjectView::GetSelectionState(int flags, tagPOINT& point) {
  dVect2D p(point);
  return GetSelectionState(flags, p);
}

short VGObjectView::GetSelectionState(int /*flags*/, dVect2D& /*point*/) {
  return VGOperation_None;
}

bool VGObjectView::ProcessMouseEvent(int event, int flags, tagPOINT& point) {
  dVect2D p(point);
  return ProcessMouseEvent(event, flags, p);
}

bool VGObjectView::ProcessMouseEvent(int event, int flags, dVect2D& point) {
  const bool isLeftClick = event == MouseEvent_ButtonDown && (flags & MK_LBUTTON) != 0;
  if (isLeftClick && m_viewState == 0 && IsEnabled(VGOperation_Create)) {
    AssignViewState(VGViewState_Visible);
    SetOpState(VGOperation_Create);
  }
  if (!IsVisible()) {
    return false;
  }
  if (isLeftClick && m_opState == VGOperation_None) {
    const Watch watch(*this);
    const short grabbed = GetSelectionState(flags, point);
    if (watch.IsGone()) {
      return false;
    }
    if (IsEnabled(grabbed)) {
      SetOpState(grabbed);
    } else if (IsEnabled(VGOperation_Move)) {
      SetOpState(VGOperation_Move);
    }
  }
  return Dispatch(event, flags, point);
}

bool VGObjectView::Dispatch(int event, int flags, dVect2D& point) {
  if (event != MouseEvent_ButtonDown && event != MouseEvent_Move && event != MouseEvent_ButtonUp) {
    return false;
  }
  const short operation = GetOpState();  // before a handler ends it
  if (operation == VGOperation_Create) {
    return OnCreate(event, flags, point);
  }
  const OperationHandlers* const handlers = HandlersOf(operation);
  if (handlers == nullptr) {
    return false;
  }
  const Watch watch(*this);
  const bool isDown = event == MouseEvent_ButtonDown;
  const bool isMove = event == MouseEvent_Move;
  const bool result = (this->*(isDown   ? handlers->begin
                               : isMove ? handlers->proceed
                                        : handlers->end))(point);
  if (watch.IsGone() || m_pInterface == nullptr) {
    return result;
  }
  // The interface is told last: its client may destroy the object.
  if (isDown) {
    m_pInterface->OnBeginGraphicOp(this, operation);
  } else if (isMove) {
    m_pInterface->OnGraphicChanged(this, operation);
  } else {
    m_pInterface->OnEndGraphicOp(this, operation);
  }
  return result;
}

bool VGObjectView::OnCreate(int /*event*/, int /*flags*/, dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginMove(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnMove(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndMove(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginResize(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnResize(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndResize(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginModify(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnModify(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndModify(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginRotate(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnRotate(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndRotate(dVect2D& /*point*/) {
  return false;
}

}  // namespace vorl
