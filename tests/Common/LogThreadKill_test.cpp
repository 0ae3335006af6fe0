// A thread that is ended by force while it logs must not stop the others from logging.
#include <gtest/gtest.h>
#include <tests/Support/Allocation.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>
#include <vorl/Common/dStatus.h>
#include <vorl/Platform/detail/Thread.h>

#include <atomic>
#include <chrono>
#include <random>
#include <string>
#include <thread>

namespace {

using std::chrono::microseconds;
using std::chrono::milliseconds;
using vorl_detail::Thread;

// Looks again and again: not every standard library's atomics wake up all who wait.
void WaitFor(const std::atomic<bool>& flag) {
  while (!flag) {
    std::this_thread::sleep_for(milliseconds(1));
  }
}

TEST(LogThreadKill, LogStackStaysUsable) {
  std::mt19937 random(24680);
  for (int round = 0; round < 300; ++round) {
    const auto thread = Thread::Start([] {
      while (true) {
        const LogContext context("t", "f", 1, true);
      }
    });
    std::this_thread::sleep_for(microseconds(random() % 300));
    thread->Kill();
    LogThread& record = *GetLogManager().GetLogThread();
    ASSERT_LE(record.GetLogDepth(), 1u);
    {
      const LogContext context("t", "f", 1, true);
      ASSERT_GE(context.GetLogDepth(), 1u);
      // The context that the thread left behind stands on its stack, which is not joined yet.
      while (record.GetLogDepth() > 1) {
        context.GetLogStack().pop_back();
      }
    }
    ASSERT_EQ(record.GetLogDepth(), 0u);
    thread->Join();
  }
}

// Ends a thread by force while it stores something, which `store` makes it do; `store` finds memory
// only after a while, so that the end comes in the middle.
template <typename Store>
void KillWhileStoring(Store store) {
  std::atomic<bool> storing{false};
  const auto thread = Thread::Start([&] {
    const AllocationDelay delay(60);
    storing = true;
    store();
    while (true) {
      std::this_thread::sleep_for(milliseconds(1));
    }
  });
  WaitFor(storing);
  std::this_thread::sleep_for(milliseconds(20));
  thread->Kill();
  thread->Join();
}

TEST(LogThreadKill, StatusTextIsStoredWhole) {
  const std::string text(200, 'x');
  dStatus status(true, "old");
  KillWhileStoring([&] { status = text; });
  EXPECT_EQ(static_cast<const char*>(status), text);
  const std::string addition(500, 'y');
  KillWhileStoring([&] { status += addition; });
  EXPECT_EQ(static_cast<const char*>(status), text + addition);
  status.Set(-1, "still usable");
  EXPECT_STREQ(status, "still usable");
}

TEST(LogThreadKill, ContextIsPushedWhole) {
  KillWhileStoring([] {
    const LogContext context("t", "f", 1, true);
    while (true) {
      std::this_thread::sleep_for(milliseconds(1));
    }
  });
  EXPECT_EQ(GetLogManager().GetLogThread()->GetLogDepth(), 1u);
  LogContext().GetLogStack().clear();  // what the thread left behind
}

}  // namespace
