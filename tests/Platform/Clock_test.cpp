#include <vorl/Platform/detail/Clock.h>

#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <thread>

namespace {

using vorl_detail::Clock;
using vorl_detail::SystemClock;

TEST(Clock, CounterIsFinerThanMilliseconds) {
  EXPECT_GT(SystemClock().counterFrequency(), 1000);
}

TEST(Clock, CounterAndMillisecondsTellTheSameTime) {
  const Clock& clock = SystemClock();
  const std::int64_t counts = clock.counter();
  const std::int64_t milliseconds = clock.milliseconds();
  std::this_thread::sleep_for(std::chrono::milliseconds(50));
  const double byMilliseconds = static_cast<double>(clock.milliseconds() - milliseconds) / 1000.0;
  const double byCounter =
      static_cast<double>(clock.counter() - counts) / static_cast<double>(clock.counterFrequency());
  EXPECT_GE(byMilliseconds, 0.049);
  EXPECT_GE(byCounter, byMilliseconds - 0.002);
}

TEST(Clock, MillisecondsNeverRunBackwards) {
  const Clock& clock = SystemClock();
  std::int64_t last = clock.milliseconds();
  for (int i = 0; i < 1000; ++i) {
    const std::int64_t now = clock.milliseconds();
    ASSERT_GE(now, last);
    last = now;
  }
}

}  // namespace
