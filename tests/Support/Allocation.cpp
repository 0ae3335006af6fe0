#include <tests/Support/Allocation.h>

#include <chrono>
#include <cstddef>
#include <cstdlib>
#include <limits>
#include <new>
#include <thread>

namespace {

constexpr std::size_t kNever = std::numeric_limits<std::size_t>::max();

thread_local std::size_t failingSize = kNever;  // from which on there is no memory
thread_local int delay = 0;

}  // namespace

AllocationFailure::AllocationFailure() {
  failingSize = 0;
}

AllocationFailure::~AllocationFailure() {
  failingSize = kNever;
}

LargeAllocationFailure::LargeAllocationFailure(std::size_t bytes) {
  failingSize = bytes;
}

LargeAllocationFailure::~LargeAllocationFailure() {
  failingSize = kNever;
}

AllocationDelay::AllocationDelay(int milliseconds) {
  delay = milliseconds;
}

AllocationDelay::~AllocationDelay() {
  delay = 0;
}

void* operator new(std::size_t size) {
  if (delay > 0) {
    std::this_thread::sleep_for(std::chrono::milliseconds(delay));
  }
  void* memory = size >= failingSize ? nullptr : std::malloc(size != 0 ? size : 1);
  if (memory == nullptr) {
    throw std::bad_alloc();
  }
  return memory;
}

// Where the standard library is a DLL, its other forms do not come to the one above.
void* operator new[](std::size_t size) {
  return operator new(size);
}

void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
  try {
    return operator new(size);
  } catch (const std::bad_alloc&) {
    return nullptr;
  }
}

void* operator new[](std::size_t size, const std::nothrow_t& tag) noexcept {
  return operator new(size, tag);
}

void operator delete[](void* memory) noexcept {
  operator delete(memory);
}

void operator delete[](void* memory, std::size_t) noexcept {
  operator delete(memory);
}

void operator delete(void* memory) noexcept {
  std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept {
  std::free(memory);
}
