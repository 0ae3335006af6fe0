#include <tests/Support/Allocation.h>
#include <tests/Support/GuardPages.h>

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdlib>
#include <limits>
#include <new>
#include <optional>
#include <thread>

namespace {

constexpr std::size_t kNever = std::numeric_limits<std::size_t>::max();

thread_local std::size_t failingSize = kNever;  // from which on there is no memory
thread_local int delay = 0;
thread_local bool guarding = false;

// A block beside a guard page, or room for one.
struct GuardedBlock {
  std::atomic<bool> isTaken{false};
  std::atomic<void*> data{nullptr};
  std::optional<GuardPages> pages;
};

GuardedBlock guardedBlocks[16];
std::atomic<int> numGuardedBlocks{0};

// Null when all are taken.
void* AllocateGuarded(std::size_t size) {
  for (GuardedBlock& block : guardedBlocks) {
    if (!block.isTaken.exchange(true)) {
      block.pages.emplace(size, GuardPages::Side::Behind);
      block.data = block.pages->Data();
      ++numGuardedBlocks;
      return block.pages->Data();
    }
  }
  return nullptr;
}

// False for any other block.
bool FreeGuarded(void* memory) {
  if (memory == nullptr || numGuardedBlocks == 0) {
    return false;
  }
  for (GuardedBlock& block : guardedBlocks) {
    if (block.data == memory) {
      --numGuardedBlocks;
      block.data = nullptr;
      block.pages.reset();
      block.isTaken = false;
      return true;
    }
  }
  return false;
}

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

AllocationGuard::AllocationGuard() {
  guarding = true;
}

AllocationGuard::~AllocationGuard() {
  guarding = false;
}

void* operator new(std::size_t size) {
  if (delay > 0) {
    std::this_thread::sleep_for(std::chrono::milliseconds(delay));
  }
  void* memory = nullptr;
  if (size < failingSize) {
    memory = guarding ? AllocateGuarded(size) : std::malloc(size != 0 ? size : 1);
  }
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

void operator delete(void* memory) noexcept {
  if (!FreeGuarded(memory)) {
    std::free(memory);
  }
}

void operator delete(void* memory, std::size_t) noexcept {
  operator delete(memory);
}

void operator delete[](void* memory) noexcept {
  operator delete(memory);
}

void operator delete[](void* memory, std::size_t) noexcept {
  operator delete(memory);
}
