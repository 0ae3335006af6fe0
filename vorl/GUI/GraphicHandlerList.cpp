// The list of a handler's objects.
//
// Whatever the handler calls may delete objects, so nothing here trusts a pointer across a call:
//
// 1. Each object knows the handlers that list it (it is registered with them), and has them forget
//    it when it is destroyed.
// 2. Each loop that calls the application's code is a walk, during which deleted objects leave
//    empty places, so that the others keep theirs; new ones are appended. When the last walk ends,
//    the empty places go.

#include <vorl/GUI/GraphicHandler.h>

#include <algorithm>
#include <new>

#include <vorl/GUI/detail/HandlerWalk.h>

inline namespace vorl {

/// An object that is about to be destroyed, as long as nobody else has done it. There is room for
/// it: `Append` has seen to that.
class GraphicHandler::Doomed {
 public:
  Doomed(GraphicHandler& handler, VGObjectView* object)
      : m_list(handler.m_doomed), m_index(handler.m_doomed.size()) {
    m_list.push_back(object);
  }
  Doomed(const Doomed&) = delete;
  Doomed& operator=(const Doomed&) = delete;
  ~Doomed() { m_list.pop_back(); }

  /// Null when it is gone.
  VGObjectView* Object() const { return m_list[m_index]; }

 private:
  std::vector<VGObjectView*>& m_list;
  std::size_t m_index;
};

GraphicHandler::GraphicHandler() = default;

GraphicHandler::GraphicHandler(const GraphicHandler& source) : InputEventHandler(source) {
  CopyState(source);
}

GraphicHandler& GraphicHandler::operator=(const GraphicHandler& source) {
  if (this != &source) {
    InputEventHandler::operator=(source);
    DeleteWhere([&](const VGObjectView& object) { return !source.IsRegistered(&object); });
    CopyState(source);
  }
  return *this;
}

GraphicHandler::~GraphicHandler() {
  m_life.reset();
  m_pInterface = nullptr;
  DeleteWhere([](const VGObjectView&) { return true; });
  for (const Entry& entry : m_list) {
    Unregister(entry.object);  // added meanwhile by the destructor of an object
  }
}

bool GraphicHandler::StartLife() {
  try {
    if (!m_life) {
      m_life = std::shared_ptr<GraphicHandler>(this, [](GraphicHandler*) {});
    }
  } catch (const std::bad_alloc&) {
    return false;
  }
  return true;
}

void GraphicHandler::CopyState(const GraphicHandler& source) {
  if (!CopyList(source)) {
    DeleteWhere([](const VGObjectView&) { return true; });
  }
  m_flags = source.m_flags;
  m_pActive = IsListed(source.m_pActive) ? source.m_pActive : nullptr;
  m_createMode = source.m_createMode;
  m_createID = source.m_createID;
  // The viewport that the source's map belongs to knows nothing of this handler, and could not tell
  // it when the map goes.
  m_pTrafo = nullptr;
  m_unitTrafoX = source.m_unitTrafoX;
  m_unitTrafoY = source.m_unitTrafoY;
  m_pInterface = source.m_pInterface;
}

// Replaces the list by the source's, which holds all that is in it. False without memory.
bool GraphicHandler::CopyList(const GraphicHandler& source) {
  const Walk walk(*this);
  for (const Entry& entry : source.m_list) {
    if (entry.object != nullptr && !Append(entry.object, !Owns(entry.object))) {
      return false;
    }
  }
  for (std::size_t i = 0; i < walk.End(); ++i) {
    VGObjectView*& object = m_list[i].object;
    if (object != nullptr && !source.IsRegistered(object)) {
      Unregister(object);  // added when the others were deleted
    }
    object = nullptr;
  }
  return true;
}

bool GraphicHandler::IsEmpty() const {
  return std::none_of(m_list.begin(), m_list.end(),
                      [](const Entry& entry) { return entry.object != nullptr; });
}

bool GraphicHandler::IsListed(const VGObjectView* object) const {
  return object != nullptr && std::any_of(m_list.begin(), m_list.end(), [&](const Entry& entry) {
           return entry.object == object;
         });
}

bool GraphicHandler::Owns(const VGObjectView* object) const {
  return IsRegistered(object) && std::any_of(m_list.begin(), m_list.end(), [&](const Entry& entry) {
           return entry.object == object && !entry.isBorrowed;
         });
}

bool GraphicHandler::IsDoomed(const VGObjectView* object) const {
  return std::find(m_doomed.begin(), m_doomed.end(), object) != m_doomed.end();
}

bool GraphicHandler::IsRegistered(const VGObjectView* object) const {
  return std::find(object->m_handlers.begin(), object->m_handlers.end(), this) !=
         object->m_handlers.end();
}

// False without memory.
bool GraphicHandler::Register(VGObjectView* object) {
  if (IsRegistered(object)) {
    return true;
  }
  try {
    object->m_handlers.push_back(this);
  } catch (const std::bad_alloc&) {
    return false;
  }
  return true;
}

void GraphicHandler::Unregister(VGObjectView* object) {
  std::erase(object->m_handlers, this);
}

void GraphicHandler::Forget(VGObjectView* object) {
  const Walk walk(*this);
  for (Entry& entry : m_list) {
    if (entry.object == object) {
      entry.object = nullptr;
    }
  }
  if (m_pActive == object) {
    m_pActive = nullptr;
  }
  std::replace(m_doomed.begin(), m_doomed.end(), object, static_cast<VGObjectView*>(nullptr));
}

bool GraphicHandler::Append(VGObjectView* object, bool isBorrowed) {
  const bool isRepeated = IsRegistered(object) && IsListed(object);
  if (!Register(object)) {
    return false;
  }
  try {
    if (m_doomed.capacity() <= m_list.size()) {
      m_doomed.reserve(2 * m_list.size() + 8);  // all may be destroyed, one within the other
    }
    m_list.push_back({object, isBorrowed});
  } catch (const std::bad_alloc&) {
    if (!isRepeated && m_pActive != object) {
      Unregister(object);
    }
    return false;
  }
  m_mayRepeat = m_mayRepeat || isRepeated;
  return true;
}

bool GraphicHandler::AddObject(VGObjectView* object) {
  if (object == nullptr || IsDoomed(object)) {
    return false;
  }
  object->SetTransformation(m_pTrafo);
  return Append(object, false);
}

void GraphicHandler::ClearEntries(const VGObjectView* object) {
  for (Entry& entry : m_list) {
    if (entry.object == object) {
      entry.object = nullptr;
    }
  }
}

// Takes the object out of all its places, and destroys it if it is the handler's. Only in a walk.
void GraphicHandler::Delete(std::size_t index) {
  VGObjectView* const object = m_list[index].object;
  const bool isOwned =
      object->IsDynamicCreated() && (m_mayRepeat ? Owns(object) : !m_list[index].isBorrowed);
  m_list[index].object = nullptr;
  if (m_mayRepeat) {
    ClearEntries(object);
  }
  if (m_pActive == object) {
    m_pActive = nullptr;
  }
  if (!isOwned) {
    Unregister(object);
    return;
  }
  const Doomed doomed(*this, object);
  if (m_pInterface != nullptr) {
    m_pInterface->OnDeleteObject(this, object);
  }
  if (doomed.Object() != nullptr) {
    Unregister(object);
    delete object;
  }
}

template <typename Predicate>
bool GraphicHandler::DeleteWhere(Predicate predicate) {
  bool isAnyDeleted = false;
  const Walk walk(*this);
  for (std::size_t i = 0; i < walk.End(); ++i) {
    VGObjectView* const object = m_list[i].object;
    if (object != nullptr && predicate(*object) && m_list[i].object == object) {
      Delete(i);
      isAnyDeleted = true;
    }
  }
  return isAnyDeleted;
}

bool GraphicHandler::DeleteObject(long id) {
  VGObjectView* const object = GetObject(id);
  return object != nullptr && DeleteObject(object);
}

bool GraphicHandler::DeleteObject(VGObjectView* object) {
  if (object == nullptr || IsEmpty()) {
    return false;
  }
  const Walk walk(*this);
  for (std::size_t i = 0; i < m_list.size(); ++i) {
    if (m_list[i].object == object) {
      Delete(i);
      break;
    }
  }
  return true;
}

bool GraphicHandler::DeleteObjects(VGType type, long id) {
  return DeleteWhere([=](VGObjectView& object) {
    if (id != -1 && object.GetObjID() != id) {
      return false;
    }
    const VGType own = object.GetObjType();
    return own == type || own == VGType_None;
  });
}

bool GraphicHandler::DeleteAll() {
  DeleteWhere([](const VGObjectView&) { return true; });
  return true;
}

bool GraphicHandler::DeleteSelected() {
  return DeleteWhere([](const VGObjectView& object) { return object.IsSelected(); });
}

bool GraphicHandler::DeleteActive() {
  return DeleteObject(m_pActive);
}

}  // namespace vorl
