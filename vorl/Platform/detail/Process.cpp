#include <vorl/Platform/detail/Process.h>

#if defined(_WIN32)
#include <windows.h>
#else
#include <pthread.h>
#include <sys/syscall.h>
#include <unistd.h>
#endif

#include <atomic>

inline namespace vorl {
namespace vorl_detail {

#if defined(_WIN32)
std::uint32_t CurrentProcessId() {
  return GetCurrentProcessId();
}
std::uint32_t CurrentThreadId() {
  return GetCurrentThreadId();
}
#else
namespace {

// Asking the system costs half of a log context's time, so the answer is kept until a fork.
std::atomic<std::uint32_t> knownProcessId{0};

void ForgetProcessId() {
  knownProcessId.store(0, std::memory_order_relaxed);
}

}  // namespace

std::uint32_t CurrentProcessId() {
  std::uint32_t id = knownProcessId.load(std::memory_order_relaxed);
  if (id == 0) {
    static const bool forgottenByChildren = pthread_atfork(nullptr, nullptr, &ForgetProcessId) == 0;
    id = static_cast<std::uint32_t>(getpid());
    if (forgottenByChildren) {
      knownProcessId.store(id, std::memory_order_relaxed);
    }
  }
  return id;
}
std::uint32_t CurrentThreadId() {
  return static_cast<std::uint32_t>(syscall(SYS_gettid));
}
#endif

}  // namespace vorl_detail
}  // namespace vorl
