// What goes through the list of a handler: the map, drawing, selecting, finding.

#include <vorl/GUI/GraphicHandler.h>

#include <algorithm>

#include <vorl/GUI/detail/HandlerWalk.h>

inline namespace vorl {

void GraphicHandler::SetTransformation(Trafo2DBase* trafo) {
  if (trafo == m_pTrafo) {
    return;
  }
  m_pTrafo = trafo;
  const Walk walk(*this);
  for (std::size_t i = 0; i < walk.End(); ++i) {
    if (VGObjectView* const object = m_list[i].object) {
      object->SetTransformation(m_pTrafo);
    }
  }
}

void GraphicHandler::DrawObjects(HDC dc, GraphicViewPort* viewPort) {
  if (!IsEnabled(GraphicHandlerFlag_Visible)) {
    return;
  }
  const auto draw = [&](VGObjectView& object) {
    if (viewPort != nullptr) {
      object.Draw(dc, *viewPort);
    } else {
      object.Draw(dc);
    }
  };
  const Walk walk(*this);
  for (std::size_t i = 0; i < walk.End(); ++i) {
    VGObjectView* const object = m_list[i].object;
    if (object != nullptr && object != m_pActive) {
      draw(*object);
    }
  }
  if (m_pActive != nullptr) {
    draw(*m_pActive);
  }
  GdiFlush();
}

bool GraphicHandler::SelectObject(int flags, dVect2D& point) {
  if (!IsInteractive()) {
    return false;
  }
  if (m_pActive != nullptr) {
    m_pActive->Select(false);
    m_pActive = nullptr;
  }
  // The walk does not stop at a hit: all objects under the mouse are selected, and the last of
  // them, which is drawn above the others, becomes the active one.
  const Walk walk(*this);
  for (std::size_t i = 0; i < walk.End(); ++i) {
    VGObjectView* const object = m_list[i].object;
    if (object != nullptr && object->GetSelectionState(flags, point) != 0 &&
        m_list[i].object == object) {
      m_pActive = object;
      object->Select(true);
    }
  }
  return m_pActive != nullptr;
}

void GraphicHandler::CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) {
  min.Set(0, 0);
  max.Set(0, 0);
  bool isFirst = true;
  const Walk walk(*this);
  for (std::size_t i = 0; i < walk.End(); ++i) {
    VGObjectView* const object = m_list[i].object;
    if (object == nullptr) {
      continue;
    }
    dVect2D low;
    dVect2D high;
    object->CalcBoundingBox(dc, low, high);
    if (isFirst) {
      min = low;
      max = high;
      isFirst = false;
      continue;
    }
    min.Set(std::min(min.x, low.x), std::min(min.y, low.y));
    max.Set(std::max(max.x, high.x), std::max(max.y, high.y));
  }
}

template <typename Predicate>
VGObjectView* GraphicHandler::Find(Predicate predicate) {
  const Walk walk(*this);
  for (std::size_t i = 0; i < walk.End(); ++i) {
    VGObjectView* const object = m_list[i].object;
    if (object != nullptr && predicate(*object) && m_list[i].object == object) {
      return object;
    }
  }
  return nullptr;
}

VGObjectView* GraphicHandler::GetObject(VGType type, long id) {
  return Find(
      [=](VGObjectView& object) { return object.GetObjID() == id && object.GetObjType() == type; });
}

VGObjectView* GraphicHandler::GetObject(long id) {
  return Find([=](const VGObjectView& object) { return object.GetObjID() == id; });
}

VGObjectView* GraphicHandler::GetObjectByUserData(long data) {
  return Find([=](const VGObjectView& object) { return object.GetUserData() == data; });
}

VGObjectView* GraphicHandler::HitTest(dVect2D& point, int tolerance) {
  if (!IsEnabled(GraphicHandlerFlag_Visible)) {
    return nullptr;
  }
  return Find([&](VGObjectView& object) {
    return object.IsVisible() && object.IsPointOnGraphic(point, tolerance);
  });
}

}  // namespace vorl
