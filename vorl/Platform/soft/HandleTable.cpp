#include <vorl/Platform/soft/HandleTable.h>

#include <bit>
#include <utility>

inline namespace vorl {
namespace vorl_detail {
namespace {

// The lowest two bits stay 0, as in addresses; the place follows, then its generation. Generations
// have their highest bit set: small numbers and the addresses of applications are no handles.
constexpr unsigned kIndexShift = 2;
constexpr unsigned kIndexBits = 18;
constexpr unsigned kGenerationShift = kIndexShift + kIndexBits;
constexpr std::size_t kMaximumPlaces = std::size_t{1} << kIndexBits;
constexpr std::uintptr_t kMaximumGeneration = ~std::uintptr_t{0} >> kGenerationShift;
constexpr std::uintptr_t kFirstGeneration = kMaximumGeneration / 2 + 1;

void* HandleOf(std::size_t index, std::uintptr_t generation) {
  return std::bit_cast<void*>(generation << kGenerationShift | index << kIndexShift);
}

thread_local DWORD lastError = ERROR_SUCCESS;

}  // namespace

void SetError(DWORD error) {
  lastError = error;
}

HandleTable& HandleTable::Instance() {
  // Never destroyed: static objects of applications may delete their handles after us.
  static HandleTable& table = *new HandleTable;
  return table;
}

HandleTable::Place* HandleTable::PlaceOf(const void* handle) {
  const auto bits = std::bit_cast<std::uintptr_t>(handle);
  const std::size_t index = (bits >> kIndexShift) & (kMaximumPlaces - 1);
  if (index >= m_places.size()) {
    return nullptr;
  }
  Place& place = m_places[index];
  return place.object && HandleOf(index, place.generation) == handle ? &place : nullptr;
}

void* HandleTable::Add(const std::shared_ptr<Object>& object) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  std::size_t index = m_places.size();
  if (!m_free.empty()) {
    index = m_free.front();
    m_free.pop_front();
  } else if (index == kMaximumPlaces) {
    return nullptr;
  } else {
    m_places.emplace_back();
  }
  Place& place = m_places[index];
  place.generation = place.generation < kFirstGeneration || place.generation == kMaximumGeneration
                         ? kFirstGeneration
                         : place.generation + 1;
  place.object = object;
  object->handle = HandleOf(index, place.generation);
  if (object->stock) {
    ++m_stockCount;
  }
  return object->handle;
}

std::shared_ptr<Object> HandleTable::Find(const void* handle) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  const Place* place = PlaceOf(handle);
  return place == nullptr ? nullptr : place->object;
}

bool HandleTable::Remove(const void* handle, bool deviceContext) {
  std::shared_ptr<Object> removed;  // destroyed behind the lock: contexts let go of their objects
  const std::lock_guard<std::mutex> lock(m_mutex);
  Place* place = PlaceOf(handle);
  if (place == nullptr || (place->object->kind == ObjectKind::kDeviceContext) != deviceContext) {
    SetError(ERROR_INVALID_HANDLE);
    return false;
  }
  if (place->object->stock) {
    return true;
  }
  if (place->object->selections != 0) {
    SetError(ERROR_BUSY);
    return false;
  }
  m_free.push_back(static_cast<std::size_t>(std::bit_cast<std::uintptr_t>(handle) >> kIndexShift) &
                   (kMaximumPlaces - 1));
  removed = std::move(place->object);
  return true;
}

bool HandleTable::Select(Object& object, const void* owner) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  if (PlaceOf(object.handle) == nullptr) {
    SetError(ERROR_INVALID_HANDLE);
    return false;
  }
  if (object.kind == ObjectKind::kBitmap && !object.stock) {
    if (object.selections != 0 && object.owner != owner) {
      SetError(ERROR_BUSY);
      return false;
    }
    object.owner = owner;
  }
  ++object.selections;
  return true;
}

void HandleTable::SelectAgain(Object& object) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  ++object.selections;
}

void HandleTable::Deselect(Object& object) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  --object.selections;
}

std::size_t HandleTable::LiveCount() {
  const std::lock_guard<std::mutex> lock(m_mutex);
  return m_places.size() - m_free.size() - m_stockCount;
}

}  // namespace vorl_detail
}  // namespace vorl

DWORD GetLastError() {
  return vorl::vorl_detail::lastError;
}
