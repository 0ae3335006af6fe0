#ifndef TESTS_OPERATORS_IP_WAITING_H
#define TESTS_OPERATORS_IP_WAITING_H

/// @file
/// Waiting for operators that run in threads of their own.

#include <vorl/Common/OpBase.h>

#include <chrono>
#include <thread>

namespace waiting {

constexpr auto kPatience = std::chrono::seconds(60);

/// Waits until the operator's run has ended; false when that takes too long.
inline bool WaitForEnd(const OpBase& op) {
  const auto limit = std::chrono::steady_clock::now() + kPatience;
  while (op.IsRunning() && std::chrono::steady_clock::now() < limit) {
    std::this_thread::yield();
  }
  return !op.IsRunning();
}

/// Waits until a part of the work is done; false when that takes too long.
inline bool WaitForProgress(OpBase& op) {
  const auto limit = std::chrono::steady_clock::now() + kPatience;
  while (op.GetProgress() == 0.0 && std::chrono::steady_clock::now() < limit) {
    std::this_thread::yield();
  }
  return op.GetProgress() > 0.0;
}

}  // namespace waiting

#endif
