#include <vorl/Platform/detail/Clock.h>

#if defined(_WIN32)
#include <windows.h>
#endif

#include <chrono>

inline namespace vorl {
namespace vorl_detail {

namespace {

#if defined(_WIN32)
std::int64_t CounterFrequency() {
  LARGE_INTEGER frequency;
  return QueryPerformanceFrequency(&frequency) != 0 ? frequency.QuadPart : 0;
}

std::int64_t Counter() {
  LARGE_INTEGER value;
  return QueryPerformanceCounter(&value) != 0 ? value.QuadPart : 0;
}
#else
using CounterClock = std::chrono::steady_clock;

std::int64_t CounterFrequency() {
  return CounterClock::period::den / CounterClock::period::num;
}

std::int64_t Counter() {
  return CounterClock::now().time_since_epoch().count();
}
#endif

std::int64_t Milliseconds() {
  using namespace std::chrono;
  return duration_cast<milliseconds>(steady_clock::now().time_since_epoch()).count();
}

}  // namespace

const Clock& SystemClock() {
  static constexpr Clock clock{&CounterFrequency, &Counter, &Milliseconds};
  return clock;
}

}  // namespace vorl_detail
}  // namespace vorl
