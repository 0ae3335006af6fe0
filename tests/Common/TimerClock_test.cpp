// What a timer makes of a clock, with clocks that a test sets.
#include <vorl/Common/detail/TimerClock.h>

#include <gtest/gtest.h>
#include <vorl/Common/HRTimer.h>

#include <cstdint>

namespace {

using vorl_detail::Clock;
using vorl_detail::SystemClock;
using vorl_detail::TimerScale;

constexpr std::int64_t kCounts = 5'000'000'000;  // more than 32 bits hold
constexpr std::int64_t kMilliseconds = 1234;

template <std::int64_t frequency>
constexpr Clock ClockWithFrequency() {
  return {[] { return frequency; }, [] { return kCounts; }, [] { return kMilliseconds; }};
}

TEST(TimerClock, UsesTheCounterWhereThereIsOne) {
  const Clock clock = ClockWithFrequency<2'500'000>();
  const TimerScale scale = TimerScale::Of(clock);
  EXPECT_TRUE(scale.supported);
  EXPECT_EQ(scale.frequency, 2.5e6);
  EXPECT_EQ(scale.resolution, 1.0 / 2.5e6);
  EXPECT_DOUBLE_EQ(scale.Now(clock), 2000.0);
}

TEST(TimerClock, FallsBackToMillisecondsWithoutCounter) {
  for (const Clock& clock : {ClockWithFrequency<0>(), ClockWithFrequency<-1>()}) {
    const TimerScale scale = TimerScale::Of(clock);
    EXPECT_FALSE(scale.supported);
    EXPECT_EQ(scale.frequency, 1000.0);
    EXPECT_EQ(scale.resolution, 0.001);
    EXPECT_DOUBLE_EQ(scale.Now(clock), 1.234);
  }
}

TEST(TimerClock, CounterAsSlowAsMillisecondsIsStillTheCounter) {
  const Clock clock = ClockWithFrequency<1000>();
  const TimerScale scale = TimerScale::Of(clock);
  EXPECT_TRUE(scale.supported);
  EXPECT_DOUBLE_EQ(scale.Now(clock), 5.0e6);
}

TEST(TimerClock, TimerUsesTheScaleOfTheMachine) {
  const TimerScale scale = TimerScale::Of(SystemClock());
  const HRTimer timer;
  EXPECT_EQ(HRTimer::IsHRSupported(), scale.supported);
  EXPECT_EQ(timer.GetFrequency(), scale.frequency);
  EXPECT_EQ(timer.GetResolution(), scale.resolution);

  const double before = scale.Now(SystemClock());
  const double now = timer.GetTime();
  const double after = scale.Now(SystemClock());
  EXPECT_LE(before, now);
  EXPECT_LE(now, after);
  EXPECT_GE(vorl_detail::SecondsNow(), after);
}

}  // namespace
