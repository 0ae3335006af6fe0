#ifndef VORL_TESTS_SUPPORT_ALLOCATION_H
#define VORL_TESTS_SUPPORT_ALLOCATION_H

#include <cstddef>

/// While one lives, `new` finds no memory in the thread that made it. Works in executables that
/// link Allocation.cpp.
class AllocationFailure {
 public:
  AllocationFailure();
  AllocationFailure(const AllocationFailure&) = delete;
  AllocationFailure& operator=(const AllocationFailure&) = delete;
  ~AllocationFailure();
};

/// While one lives, `new` finds no memory for so many bytes or more in the thread that made it.
class LargeAllocationFailure {
 public:
  explicit LargeAllocationFailure(std::size_t bytes);
  LargeAllocationFailure(const LargeAllocationFailure&) = delete;
  LargeAllocationFailure& operator=(const LargeAllocationFailure&) = delete;
  ~LargeAllocationFailure();
};

/// While one lives, `new` takes so many milliseconds in the thread that made it.
class AllocationDelay {
 public:
  explicit AllocationDelay(int milliseconds);
  AllocationDelay(const AllocationDelay&) = delete;
  AllocationDelay& operator=(const AllocationDelay&) = delete;
  ~AllocationDelay();
};

/// While one lives, the blocks that `new` gives in the thread that made it, 16 at a time, end
/// where memory ends (see `GuardPages`). They may live longer.
class AllocationGuard {
 public:
  AllocationGuard();
  AllocationGuard(const AllocationGuard&) = delete;
  AllocationGuard& operator=(const AllocationGuard&) = delete;
  ~AllocationGuard();
};

#endif
