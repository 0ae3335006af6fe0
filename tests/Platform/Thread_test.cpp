#include <vorl/Platform/detail/Thread.h>

#include <gtest/gtest.h>
#include <tests/Support/ThreadSanitizer.h>
#include <vorl/Platform/detail/Process.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <random>
#include <thread>
#include <vector>

namespace {

using std::chrono::microseconds;
using std::chrono::milliseconds;
using vorl_detail::Thread;

void Sleep(int count) {
  std::this_thread::sleep_for(milliseconds(count));
}

// Looks again and again: not every standard library's atomics wake up all who wait.
void WaitFor(const std::atomic<bool>& flag) {
  while (!flag) {
    std::this_thread::sleep_for(milliseconds(1));
  }
}

[[noreturn]] void SleepForEver() {
  while (true) {
    Sleep(1);
  }
}

TEST(Thread, RunsItsBodyInAnotherThread) {
  std::uint32_t id = 0;
  const auto thread = Thread::Start([&] { id = vorl_detail::CurrentThreadId(); });
  ASSERT_NE(thread, nullptr);
  thread->Join();
  EXPECT_NE(id, vorl_detail::CurrentThreadId());
  EXPECT_EQ(thread->Id(), id);
}

TEST(Thread, IsCurrentOnlyInItself) {
  std::atomic<Thread*> self{nullptr};
  bool inside = false;
  const auto thread = Thread::Start([&] {
    while (self == nullptr) {
      Sleep(1);
    }
    inside = self.load()->IsCurrent();
  });
  self = thread.get();
  EXPECT_FALSE(thread->IsCurrent());
  thread->Join();
  EXPECT_TRUE(inside);
}

// The system hands the handle of an ended thread to the next one.
TEST(Thread, EndedThreadIsNotCurrentInItsSuccessor) {
  const auto ended = Thread::Start([] {});
  ended->Join();
  bool mistaken = true;
  const auto next = Thread::Start([&] { mistaken = ended->IsCurrent(); });
  next->Join();
  EXPECT_FALSE(mistaken);
}

TEST(Thread, WaitsForTheEndOfTheBody) {
  std::atomic<bool> release{false};
  const auto thread = Thread::Start([&] { WaitFor(release); });
  EXPECT_FALSE(thread->WaitFor(milliseconds(0)));
  EXPECT_FALSE(thread->WaitFor(milliseconds(5)));
  release = true;
  EXPECT_TRUE(thread->WaitFor(milliseconds(30000)));
  EXPECT_TRUE(thread->WaitFor(milliseconds(0)));
}

TEST(Thread, JoinIsHarmlessTwice) {
  const auto thread = Thread::Start([] {});
  thread->Join();
  thread->Join();
  EXPECT_TRUE(thread->WaitFor(milliseconds(0)));
}

TEST(Thread, RunsOnWhenItsObjectIsDestroyed) {
  const auto finished = std::make_shared<std::atomic<bool>>(false);
  Thread::Start([finished] {
    Sleep(5);
    *finished = true;
  });
  for (int i = 0; i < 30000 && !*finished; ++i) {
    Sleep(1);
  }
  EXPECT_TRUE(*finished);
}

TEST(Thread, LetsGoOfItsBodyAtItsEnd) {
  const auto held = std::make_shared<int>(0);
  const auto thread = Thread::Start([held] {});
  thread->Join();
  EXPECT_EQ(held.use_count(), 1);
}

TEST(Thread, LetsGoOfItsBodyAfterAForcedEnd) {
  const auto held = std::make_shared<int>(0);
  const auto thread = Thread::Start([held] { SleepForEver(); });
  thread->Kill();
  thread->Join();
  EXPECT_EQ(held.use_count(), 1);
}

TEST(Thread, StackHoldsWhatTheBodyDeclares) {
  const char* address = nullptr;
  const auto thread =
      Thread::Start([&] { address = static_cast<const char*>(__builtin_frame_address(0)); });
  thread->WaitFor(milliseconds(30000));
  EXPECT_LE(thread->StackLow(), static_cast<const void*>(address));
  EXPECT_GT(thread->StackHigh(), static_cast<const void*>(address));
  thread->Join();
}

TEST(ThreadKill, EndsASleepingThread) {
  std::atomic<unsigned long> counter{0};
  const auto thread = Thread::Start([&] {
    while (true) {
      ++counter;
      Sleep(1);
    }
  });
  Sleep(5);
  thread->Kill();
  const unsigned long counted = counter;
  Sleep(10);
  EXPECT_EQ(counter, counted);
  thread->Join();
}

TEST(ThreadKill, EndsAThreadThatWaitsForEver) {
  SKIP_UNDER_THREAD_SANITIZER("signals reach a thread only at its next call");
  const auto thread = Thread::Start([] {
    std::atomic<bool> never{false};
    never.wait(false);
  });
  Sleep(5);
  thread->Kill();
  thread->Join();
  EXPECT_TRUE(thread->WaitFor(milliseconds(0)));
}

TEST(ThreadKill, EndsALoopWithoutACall) {
  SKIP_UNDER_THREAD_SANITIZER("signals reach a thread only at its next call");
  std::atomic<unsigned long> counter{0};
  const auto thread = Thread::Start([&] {
    while (true) {
      counter.store(counter.load(std::memory_order_relaxed) + 1, std::memory_order_relaxed);
    }
  });
  Sleep(5);
  thread->Kill();
  const unsigned long counted = counter;
  Sleep(10);
  EXPECT_EQ(counter, counted);
  thread->Join();
}

TEST(ThreadKill, IsHarmlessAfterTheEndAndTwice) {
  const auto ended = Thread::Start([] {});
  ended->WaitFor(milliseconds(30000));
  ended->Kill();
  ended->Kill();
  ended->Join();
  ended->Kill();

  const auto killed = Thread::Start([] { SleepForEver(); });
  killed->Kill();
  killed->Kill();
  killed->Join();
  killed->Join();
  EXPECT_TRUE(killed->WaitFor(milliseconds(0)));
}

TEST(ThreadKill, MeetsAThreadAtAnyMoment) {
  std::mt19937 random(987654);
  for (int round = 0; round < 500; ++round) {
    const bool finite = random() % 2 == 0;
    const auto lifetime = microseconds(random() % 200);
    const auto thread = Thread::Start([=] {
      std::this_thread::sleep_for(lifetime);
      if (!finite) {
        SleepForEver();
      }
    });
    ASSERT_NE(thread, nullptr);
    std::this_thread::sleep_for(microseconds(random() % 200));
    thread->Kill();
    ASSERT_TRUE(thread->WaitFor(milliseconds(0)));
    thread->Join();
  }
}

TEST(ThreadExitCurrent, EndsTheCallingThread) {
  const auto held = std::make_shared<int>(0);
  std::atomic<bool> cameBack{false};
  const auto thread = Thread::Start([&cameBack, held] {
    Thread::ExitCurrent();
    cameBack = true;
  });
  EXPECT_TRUE(thread->WaitFor(milliseconds(30000)));
  thread->Join();
  EXPECT_FALSE(cameBack);
  EXPECT_EQ(held.use_count(), 1);
}

}  // namespace
