// The handlers that a viewport shows, and drawing them.

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>

#include <algorithm>
#include <new>

#include <vorl/GUI/detail/Truncated.h>

inline namespace vorl {

using vorl_detail::Truncated;

namespace {

void IntersectClip(HDC dc, const tagRECT& rect) {
  IntersectClipRect(dc, rect.left, rect.top, rect.right, rect.bottom);
}

void ExcludeClip(HDC dc, const tagRECT& rect) {
  ExcludeClipRect(dc, rect.left, rect.top, rect.right, rect.bottom);
}

/// Fills what the clip region leaves of a rectangle.
void Fill(HDC dc, const tagRECT& rect, std::uint32_t color) {
  const HBRUSH brush = CreateSolidBrush(color);
  if (brush != nullptr) {
    FillRect(dc, &rect, brush);
    DeleteObject(brush);
  }
}

/// What borders leave of a window: nothing when they overlap. A mirrored window stays mirrored.
void EmptyWhereBordersOverlap(const tagRECT& view, tagRECT& draw) {
  if (view.left <= view.right && draw.right < draw.left) {
    draw.right = draw.left;
  }
  if (view.top <= view.bottom && draw.bottom < draw.top) {
    draw.bottom = draw.top;
  }
}

LONG WholePixel(float edge) {
  return Truncated<LONG>(edge + 0.5);
}

}  // namespace

GraphicViewPort::HandlerRef::HandlerRef(const GraphicHandler& handler) : m_life(handler.m_life) {}

GraphicViewPort::HandlerList::HandlerList() = default;

GraphicViewPort::HandlerList::HandlerList(const HandlerList& source) : std::vector<HandlerRef>() {
  *this = source;
}

GraphicViewPort::HandlerList& GraphicViewPort::HandlerList::operator=(const HandlerList& source) {
  try {
    std::vector<HandlerRef>::operator=(source);
  } catch (const std::bad_alloc&) {
    clear();
  }
  return *this;
}

void GraphicViewPort::SetGraphic(GraphicHandler* graphic) {
  m_handlers.clear();
  AddGraphic(graphic);
}

bool GraphicViewPort::AddGraphic(GraphicHandler* graphic) {
  if (graphic == nullptr || !graphic->StartLife()) {
    return false;
  }
  Unlist(graphic);
  try {
    m_handlers.push_back(HandlerRef(*graphic));
  } catch (const std::bad_alloc&) {
    return false;
  }
  return true;
}

void GraphicViewPort::RemoveGraphic(GraphicHandler* graphic) {
  if (graphic == nullptr) {
    m_captured = HandlerRef();
    TakeMapFromHandlers();
    m_handlers.clear();
    return;
  }
  if (m_captured.Get() == graphic) {
    m_captured = HandlerRef();
  }
  Unlist(nullptr);
  if (!m_handlers.empty()) {
    graphic->SetTransformation(nullptr);
    Unlist(graphic);
  }
}

void GraphicViewPort::Unlist(const GraphicHandler* handler) {
  std::erase_if(m_handlers, [=](const HandlerRef& ref) {
    return ref.Get() == handler || ref.Get() == nullptr;
  });
}

bool GraphicViewPort::IsShown(const GraphicHandler* handler) const {
  return handler != nullptr &&
         std::any_of(m_handlers.begin(), m_handlers.end(),
                     [=](const HandlerRef& ref) { return ref.Get() == handler; });
}

void GraphicViewPort::TakeMapFromHandlers() {
  // Without a copy, for which there may be no memory when the map is about to go. Where a handler
  // has left meanwhile, the next one stands in its place; whoever comes again has no map to lose.
  Unlist(nullptr);
  for (std::size_t i = 0; i < m_handlers.size();) {
    GraphicHandler* const handler = m_handlers[i].Get();
    if (handler != nullptr) {
      handler->SetTransformation(nullptr);
    }
    i += i < m_handlers.size() && m_handlers[i].Get() == handler ? 1 : 0;
  }
}

void GraphicViewPort::SetBgColor(long color) {
  m_bgColor = static_cast<std::uint32_t>(color);
}

void GraphicViewPort::SetBorderColor(long color) {
  m_borderColor = static_cast<std::uint32_t>(color);
}

long GraphicViewPort::GetBgColor() const {
  return static_cast<long>(m_bgColor);
}

long GraphicViewPort::GetBorderColor() const {
  return static_cast<long>(m_borderColor);
}

void GraphicViewPort::GetDeviceWins(tagRECT& view, tagRECT& draw) const {
  const dVect2D topLeft = m_viewWin.GetTL();
  const dVect2D bottomRight = m_viewWin.GetBR();
  view = {WholePixel(topLeft.x), WholePixel(topLeft.y), WholePixel(bottomRight.x),
          WholePixel(bottomRight.y)};
  GetDrawWin(draw);
  EmptyWhereBordersOverlap(view, draw);
}

void GraphicViewPort::ClipToWindow(HDC dc) const {
  tagRECT view;
  tagRECT draw;
  GetDeviceWins(view, draw);
  IntersectClip(dc, IsEnabled(ViewPortFlag_ClipBorders) ? draw : view);
}

void GraphicViewPort::ClipTo(HDC dc, Rect2D* clip, bool clipIsGraphic) const {
  if (clip == nullptr) {
    return;
  }
  if (clipIsGraphic) {
    GraphicToView(*clip);
  }
  const dVect2D topLeft = clip->GetTL();
  const dVect2D bottomRight = clip->GetBR();
  IntersectClip(dc, {WholePixel(topLeft.x), WholePixel(topLeft.y), WholePixel(bottomRight.x),
                     WholePixel(bottomRight.y)});
}

void GraphicViewPort::Draw(HDC dc, GraphicHandler* graphic, Rect2D* clip, bool clipIsGraphic) {
  if (graphic == nullptr || !IsVisible()) {
    return;
  }
  ClipToWindow(dc);
  ClipTo(dc, clip, clipIsGraphic);
  graphic->SetTransformation(&m_trafo);
  graphic->Draw(dc, *this);
}

void GraphicViewPort::Draw(HDC dc, Rect2D* clip, bool clipIsGraphic) {
  if (!IsVisible()) {
    return;
  }
  // Once for all handlers: the clip rectangle is mapped in place.
  ClipToWindow(dc);
  ClipTo(dc, clip, clipIsGraphic);
  const HandlerList handlers(m_handlers);
  for (const HandlerRef& ref : handlers) {
    GraphicHandler* const handler = ref.Get();
    if (!IsShown(handler)) {
      continue;
    }
    handler->SetTransformation(&m_trafo);
    if (IsShown(ref.Get())) {
      handler->Draw(dc, *this);
    }
  }
}

void GraphicViewPort::DrawActiveObject(HDC dc) {
  GraphicHandler* const handler = m_captured.Get();
  if (handler == nullptr || !IsVisible()) {
    return;
  }
  SelectClipRgn(dc, nullptr);
  ClipToWindow(dc);
  handler->SetTransformation(&m_trafo);
  if (m_captured.Get() == handler) {
    handler->DrawActiveObject(dc, *this);
  }
  SelectClipRgn(dc, nullptr);
}

void GraphicViewPort::EraseBkgnd(HDC dc, Rect2D* clip, bool clipIsGraphic) {
  if (!IsVisible()) {
    return;
  }
  tagRECT view;
  tagRECT draw;
  GetDeviceWins(view, draw);
  IntersectClip(dc, view);
  ClipTo(dc, clip, clipIsGraphic);
  Fill(dc, draw, m_bgColor);
  if (m_topBorder != 0 || m_bottomBorder != 0 || m_leftBorder != 0 || m_rightBorder != 0) {
    ExcludeClip(dc, draw);
    Fill(dc, view, m_borderColor);
  }
}

VGObjectView* GraphicViewPort::GetActiveGraphicObject() {
  GraphicHandler* const handler = m_captured.Get();
  return handler != nullptr ? handler->GetActiveObject() : nullptr;
}

}  // namespace vorl
