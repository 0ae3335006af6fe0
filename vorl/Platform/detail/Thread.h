#ifndef VORL_PLATFORM_DETAIL_THREAD_H
#define VORL_PLATFORM_DETAIL_THREAD_H

/// @file
/// One thread of execution that can be ended from outside.

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>

inline namespace vorl {
namespace vorl_detail {

/// A started thread. Destroying the object of a thread that still runs lets it run on; its body
/// must then keep alive what it needs.
class Thread {
 public:
  /// Starts a thread that runs `body`, which must not throw; null when the system has no thread or
  /// no memory to give.
  static std::unique_ptr<Thread> Start(std::function<void()> body);

  Thread(const Thread&) = delete;
  Thread& operator=(const Thread&) = delete;
  ~Thread();

  /// The system's identifier of the thread.
  std::uint32_t Id() const;
  /// True in the thread itself.
  bool IsCurrent() const;
  /// Waits until the body has ended, at most so long; returns whether it has ended.
  bool WaitFor(std::chrono::milliseconds timeout) const;
  /// Ends the thread wherever it is, but for a `KillShield`, and returns when its body has ended.
  /// No destructor of what stands on its stack runs: what it had locked stays locked, what it had
  /// allocated is lost. Its stack stays in memory until `Join`, where the system allows.
  void Kill();
  /// Waits until the thread is gone and lets go of it; again is harmless.
  void Join();
  /// Ends the calling thread, which must be one of ours, as `Kill` would; does not return.
  [[noreturn]] static void ExitCurrent();

  /// The thread's stack: its lowest address and the first behind it; both null where the system
  /// does not tell.
  const void* StackLow() const;
  const void* StackHigh() const;

  struct State;

 private:
  explicit Thread(std::shared_ptr<State> state);

  std::shared_ptr<State> m_state;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
