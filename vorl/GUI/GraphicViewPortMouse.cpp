// What the mouse does with the viewport itself, and how events find the handlers.

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>

#include <cstdlib>

#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/detail/DeviceRect.h>
#include <vorl/GUI/detail/Truncated.h>

inline namespace vorl {

using vorl_detail::ToDevice;
using vorl_detail::Truncated;

namespace {

constexpr unsigned kScaleFlags = ViewPortFlag_ScaleX | ViewPortFlag_ScaleY;
constexpr unsigned kPanFlags = ViewPortFlag_PanX | ViewPortFlag_PanY;
constexpr unsigned kMoveFlags = ViewPortFlag_MoveX | ViewPortFlag_MoveY;

/// What one step of the mouse zooms by, whatever its length.
constexpr float kZoomIn = 1.02F;
constexpr float kZoomOut = 0.98F;

/// The way from one device coordinate to another: 33 bits.
std::int64_t Way(std::int64_t from, std::int64_t to) {
  return to - from;
}

void FreeWhen(bool condition, std::uint8_t& mode) {
  mode = condition ? static_cast<std::uint8_t>(ViewMode_Free) : mode;
}

float ZoomOfStep(std::int64_t step, float ofNegative, float ofPositive) {
  if (step == 0) {
    return 1.0F;
  }
  return step < 0 ? ofNegative : ofPositive;
}

}  // namespace

bool GraphicViewPort::ProcessMouseEvent(int event, int flags, tagPOINT point) {
  if (m_operation == 0 && m_captured.Get() == nullptr && !IsInside(point)) {
    return false;
  }
  if (event == MouseEvent_ButtonDown && !m_handlers.empty() &&
      OfferButtonDown(event, flags, point)) {
    return true;
  }
  if (m_captured.Get() != nullptr) {
    return event != MouseEvent_ButtonDown && PassToCaptured(event, flags, point);
  }
  switch (event) {
    case MouseEvent_Move:
      return ProcessInteractiveOp(point);
    case MouseEvent_ButtonDown:
      return StartInteractiveOp(point, flags);
    case MouseEvent_ButtonUp:
      return StopInteractiveOp(point);
    default:
      return false;
  }
}

bool GraphicViewPort::OfferButtonDown(int event, int flags, const tagPOINT& point) {
  const HandlerList handlers(m_handlers);
  for (const HandlerRef& ref : handlers) {
    GraphicHandler* const handler = ref.Get();
    if (!IsShown(handler)) {
      continue;
    }
    tagPOINT own(point);
    m_captured = ref;
    handler->SetTransformation(&m_trafo);
    if (m_captured.Get() == handler && handler->ProcessMouseEvent(event, flags, own)) {
      return true;
    }
  }
  m_captured = HandlerRef();
  return false;
}

bool GraphicViewPort::PassToCaptured(int event, int flags, tagPOINT& point) {
  GraphicHandler* const handler = m_captured.Get();
  handler->SetTransformation(&m_trafo);
  if (m_captured.Get() != handler) {
    return false;  // one of its objects has removed it
  }
  const bool used = handler->ProcessMouseEvent(event, flags, point);
  if (event != MouseEvent_ButtonUp) {
    return used;
  }
  m_captured = HandlerRef();
  return true;
}

bool GraphicViewPort::ProcessKeyEvent(int event, int flags, int key) {
  const HandlerList handlers(m_handlers);
  for (const HandlerRef& ref : handlers) {
    GraphicHandler* const handler = ref.Get();
    if (!IsShown(handler)) {
      continue;
    }
    handler->SetTransformation(&m_trafo);
    if (IsShown(ref.Get()) && handler->ProcessKeyEvent(event, flags, key)) {
      return true;
    }
  }
  return false;
}

bool GraphicViewPort::StartInteractiveOp(const tagPOINT& point, int flags) {
  if ((flags & MK_LBUTTON) == 0) {
    return false;
  }
  m_startPoint = point;
  SetViewRefPos(static_cast<float>(point.x), static_cast<float>(point.y));
  const bool inside = m_graphicWin.IsInside(m_graphicRefPos);
  unsigned wanted = kPanFlags;
  if (inside && (flags & MK_SHIFT) != 0) {
    wanted = kScaleFlags;
  } else if (inside && (flags & MK_CONTROL) != 0) {
    wanted = kMoveFlags;
  }
  m_operation = static_cast<std::uint16_t>(m_mode & wanted);
  if ((m_operation & kMoveFlags) != 0) {
    const dVect2D corner = m_viewWin.GetTL();
    m_moveOffset = {ToDevice(Way(Truncated<std::int32_t>(corner.x), point.x)),
                    ToDevice(Way(Truncated<std::int32_t>(corner.y), point.y))};
  } else if ((m_operation & kPanFlags) != 0) {
    FreeWhen(m_widthMode == ViewMode_Fit, m_widthMode);
    FreeWhen(m_heightMode == ViewMode_Fit, m_heightMode);
  } else {
    FreeWhen((m_operation & ViewPortFlag_ScaleX) != 0, m_widthMode);
    FreeWhen((m_operation & ViewPortFlag_ScaleY) != 0, m_heightMode);
  }
  return m_operation != 0;
}

bool GraphicViewPort::ProcessInteractiveOp(const tagPOINT& point) {
  if ((m_operation & kMoveFlags) != 0) {
    return Move(point);
  }
  if ((m_operation & kPanFlags) != 0) {
    return Pan(point);
  }
  return (m_operation & kScaleFlags) != 0 && Zoom(point);
}

bool GraphicViewPort::StopInteractiveOp(const tagPOINT&) {
  const bool wasRunning = m_operation != 0;
  m_operation = 0;
  return wasRunning;
}

bool GraphicViewPort::Move(const tagPOINT& point) {
  // The start stays where it is: the view window follows the whole way of the mouse.
  const bool inX = (m_operation & ViewPortFlag_MoveX) != 0;
  const bool inY = (m_operation & ViewPortFlag_MoveY) != 0;
  const std::int64_t x = Way(m_moveOffset.x, inX ? point.x : m_startPoint.x);
  const std::int64_t y = Way(m_moveOffset.y, inY ? point.y : m_startPoint.y);
  SetViewPos(ToDevice(x), ToDevice(y), true);
  UpdateTransformation();
  return true;
}

bool GraphicViewPort::Pan(const tagPOINT& point) {
  dVect2D way;
  way.Set(static_cast<double>(Way(point.x, m_startPoint.x)),
          static_cast<double>(Way(point.y, m_startPoint.y)));
  m_startPoint = point;
  way.x = (m_operation & ViewPortFlag_PanX) != 0 ? way.x : 0.0F;
  way.y = (m_operation & ViewPortFlag_PanY) != 0 ? way.y : 0.0F;
  m_trafo.vB2A(way);
  m_graphicWin.Move(way);
  UpdateTransformation();
  return true;
}

bool GraphicViewPort::Zoom(const tagPOINT& point) {
  const std::int64_t dx = Way(m_startPoint.x, point.x);
  const std::int64_t dy = Way(m_startPoint.y, point.y);
  m_startPoint = point;
  float x = 1.0F;
  float y = 1.0F;
  if ((m_operation & ViewPortFlag_ScaleX) != 0) {
    x = ZoomOfStep(dx, kZoomOut, kZoomIn);
  }
  // Dragging up zooms in, as dragging to the right does.
  if ((m_operation & ViewPortFlag_ScaleY) != 0) {
    y = ZoomOfStep(dy, kZoomIn, kZoomOut);
  }
  if (IsEnabled(ViewPortFlag_Proportional)) {
    x = y = std::abs(dy) < std::abs(dx) ? x : y;
  }
  // The centre of the zoom stays where the drag began, in graphic coordinates.
  m_viewRefPos.Set(point.x + 0.5, point.y + 0.5);
  return DoScale(x, y);
}

}  // namespace vorl
