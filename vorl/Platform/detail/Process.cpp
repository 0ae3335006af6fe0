#include <vorl/Platform/detail/Process.h>

#if defined(_WIN32)
#include <windows.h>
#else
#include <sys/syscall.h>
#include <unistd.h>
#endif

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
std::uint32_t CurrentProcessId() {
  return static_cast<std::uint32_t>(getpid());
}
std::uint32_t CurrentThreadId() {
  return static_cast<std::uint32_t>(syscall(SYS_gettid));
}
#endif

}  // namespace vorl_detail
}  // namespace vorl
