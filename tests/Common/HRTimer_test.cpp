#include <vorl/Common/HRTimer.h>

#include <gtest/gtest.h>
#include <tests/Support/VirtualSlot.h>

#include <atomic>
#include <chrono>
#include <memory>
#include <thread>
#include <type_traits>

namespace {

using std::chrono::milliseconds;

TEST(HRTimer, ResolutionIsOneByFrequency) {
  const HRTimer timer;
  EXPECT_GT(timer.GetFrequency(), 0.0);
  EXPECT_EQ(timer.GetResolution(), 1.0 / timer.GetFrequency());
}

TEST(HRTimer, FrequencyTellsWhetherTheCounterIsThere) {
  const HRTimer timer;
  if (HRTimer::IsHRSupported()) {
    EXPECT_GT(timer.GetFrequency(), 1000.0);
  } else {
    EXPECT_EQ(timer.GetFrequency(), 1000.0);
    EXPECT_EQ(timer.GetResolution(), 0.001);
  }
  EXPECT_EQ(HRTimer::IsHRSupported(), HRTimer::IsHRSupported());
}

TEST(HRTimer, MeasuresSeconds) {
  HRTimer timer;
  const auto start = std::chrono::steady_clock::now();
  std::this_thread::sleep_for(milliseconds(30));
  const double measured = timer.GetDiffTime(false);
  const std::chrono::duration<double> around = std::chrono::steady_clock::now() - start;
  EXPECT_GE(measured, 0.029);
  EXPECT_LE(measured, around.count() + 0.001);
}

TEST(HRTimer, TimeNeverRunsBackwards) {
  const HRTimer timer;
  double last = timer.GetTime();
  for (int i = 0; i < 1000; ++i) {
    const double now = timer.GetTime();
    ASSERT_GE(now, last);
    last = now;
  }
}

TEST(HRTimer, DifferenceWithoutRestartNeverShrinks) {
  HRTimer timer;
  const double first = timer.GetDiffTime(false);
  std::this_thread::sleep_for(milliseconds(5));
  const double second = timer.GetDiffTime(false);
  EXPECT_GE(first, 0.0);
  EXPECT_GE(second, first + 0.004);
}

TEST(HRTimer, DifferenceWithRestartMovesTheStartToNow) {
  HRTimer timer;
  std::this_thread::sleep_for(milliseconds(200));
  EXPECT_GE(timer.GetDiffTime(true), 0.199);
  EXPECT_LT(timer.GetDiffTime(false), 0.1);
}

TEST(HRTimer, ResetStartsAnew) {
  HRTimer timer;
  std::this_thread::sleep_for(milliseconds(200));
  timer.Reset();
  EXPECT_LT(timer.GetDiffTime(false), 0.1);
}

TEST(HRTimer, CopiesTakeTheStartTime) {
  HRTimer source;
  std::this_thread::sleep_for(milliseconds(200));
  HRTimer copy(source);
  HRTimer assigned;
  assigned = source;
  EXPECT_GE(copy.GetDiffTime(false), 0.199);
  EXPECT_GE(assigned.GetDiffTime(false), 0.199);
}

TEST(HRTimer, CreateGivesARunningTimer) {
  const std::unique_ptr<HRTimer> timer(HRTimer::Create());
  ASSERT_NE(timer, nullptr);
  EXPECT_STREQ(timer->ClassName(), "HRTimer");
  EXPECT_EQ(timer->GetClassInfo(), &HRTimer::CI());
  EXPECT_LT(timer->GetDiffTime(false), 60.0);
}

TEST(HRTimer, AddsNoVirtualFunctions) {
  EXPECT_EQ(VirtualSlot(&HRTimer::GetClassInfo), 0u);
  EXPECT_TRUE(std::has_virtual_destructor_v<HRTimer>);
}

TEST(HRTimer, OneThreadMayReadWhileAnotherRestarts) {
  HRTimer timer;
  std::atomic<bool> done{false};
  std::thread restarter([&] {
    for (int i = 0; i < 1000; ++i) {
      timer.Reset();
    }
    done = true;
  });
  double least = 0.0;
  while (!done) {
    least = std::min(least, timer.GetDiffTime(false));
  }
  restarter.join();
  EXPECT_GT(least, -1.0) << "a start time was read in halves";
}

}  // namespace
