#ifndef VORL_PLATFORM_SOFT_HANDLETABLE_H
#define VORL_PLATFORM_SOFT_HANDLETABLE_H

#include <vorl/Platform/soft/Object.h>

#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory>
#include <mutex>
#include <new>

inline namespace vorl {
namespace vorl_detail {

/// Why the last call failed in this thread; `GetLastError` returns it.
void SetError(DWORD error);

/// Every object that a handle names. A handle is no address: it holds the number of a place in the
/// table and the generation of that place, which grows with each use, so that the handle of a
/// deleted object names nothing even when its place is taken again. All functions may be called
/// from any thread.
class HandleTable {
 public:
  static HandleTable& Instance();

  /// Enters an object and sets its handle, which it returns. Null when all places are taken.
  void* Add(const std::shared_ptr<Object>& object);

  /// The object of a handle; null for null, stale and foreign handles.
  std::shared_ptr<Object> Find(const void* handle);

  /// Takes an object out of the table; it is destroyed when its last user lets go of it. False,
  /// with the error set, for an invalid handle, another kind than the wanted and a selected object.
  bool Remove(const void* handle, bool deviceContext);

  /// Counts an object as selected. False when it is no longer in the table, or when it is a bitmap
  /// that another context has selected.
  bool Select(Object& object, const void* owner);
  void SelectAgain(Object& object);
  void Deselect(Object& object);

  /// The objects that exist, stock objects left out.
  std::size_t LiveCount();

 private:
  struct Place {
    std::shared_ptr<Object> object;
    std::uintptr_t generation = 0;
  };

  Place* PlaceOf(const void* handle);

  std::mutex m_mutex;
  std::deque<Place> m_places;
  std::deque<std::size_t> m_free;  // the longest unused place is taken first
  std::size_t m_stockCount = 0;
};

/// The object of a handle if it is of the given type; else null, with the error set.
template <class T>
std::shared_ptr<T> Find(const void* handle) {
  std::shared_ptr<Object> object = HandleTable::Instance().Find(handle);
  if (!object || object->kind != T::kKind) {
    SetError(ERROR_INVALID_HANDLE);
    return nullptr;
  }
  return std::static_pointer_cast<T>(std::move(object));
}

/// Enters a new object into the table and returns its handle as the given type.
template <class Handle>
Handle Enter(const std::shared_ptr<Object>& object) {
  void* handle = HandleTable::Instance().Add(object);
  if (handle == nullptr) {
    SetError(ERROR_NOT_ENOUGH_MEMORY);
  }
  return static_cast<Handle>(handle);
}

/// Runs the body of a function of the interface: exhausted memory becomes its failure result.
template <class Result, class Body>
Result Guarded(Result failure, Body&& body) noexcept {
  try {
    return body();
  } catch (const std::bad_alloc&) {
    SetError(ERROR_NOT_ENOUGH_MEMORY);
  }
  return failure;
}

/// Keeps an object counted as selected as long as it, or a copy of it, lives.
template <class T>
class Selected {
 public:
  Selected() = default;
  /// Takes over an object that `HandleTable::Select` has counted.
  explicit Selected(std::shared_ptr<T> counted) : m_object(std::move(counted)) {}
  Selected(const Selected& other) : m_object(other.m_object) {
    if (m_object) {
      HandleTable::Instance().SelectAgain(*m_object);
    }
  }
  Selected(Selected&& other) noexcept : m_object(std::move(other.m_object)) {}
  Selected& operator=(Selected other) noexcept {
    std::swap(m_object, other.m_object);
    return *this;
  }
  ~Selected() {
    if (m_object) {
      HandleTable::Instance().Deselect(*m_object);
    }
  }

  T* operator->() const { return m_object.get(); }
  T& operator*() const { return *m_object; }

 private:
  std::shared_ptr<T> m_object;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
