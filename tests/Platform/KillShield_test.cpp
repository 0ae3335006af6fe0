#include <vorl/Platform/detail/KillShield.h>

#include <gtest/gtest.h>
#include <tests/Support/ThreadSanitizer.h>
#include <vorl/Platform/detail/Thread.h>

#include <atomic>
#include <chrono>
#include <memory>
#include <random>
#include <thread>

namespace {

using std::chrono::microseconds;
using std::chrono::milliseconds;
using vorl_detail::KillShield;
using vorl_detail::Thread;

// Looks again and again: not every standard library's atomics wake up all who wait.
void WaitFor(const std::atomic<bool>& flag) {
  while (!flag) {
    std::this_thread::sleep_for(milliseconds(1));
  }
}

TEST(KillShield, PutsOffTheEndUntilItIsGone) {
  std::atomic<bool> shielded{false};
  std::atomic<bool> finished{false};
  const auto thread = Thread::Start([&] {
    {
      const KillShield shield;
      shielded = true;
      std::this_thread::sleep_for(milliseconds(60));
      finished = true;
    }
    while (true) {
      std::this_thread::sleep_for(milliseconds(1));
    }
  });
  WaitFor(shielded);
  thread->Kill();
  thread->Join();
  EXPECT_TRUE(finished);
}

TEST(KillShield, Nests) {
  std::atomic<bool> shielded{false};
  std::atomic<bool> finished{false};
  const auto thread = Thread::Start([&] {
    {
      const KillShield outer;
      { const KillShield inner; }
      shielded = true;
      std::this_thread::sleep_for(milliseconds(60));
      finished = true;
    }
    while (true) {
      std::this_thread::sleep_for(milliseconds(1));
    }
  });
  WaitFor(shielded);
  thread->Kill();
  thread->Join();
  EXPECT_TRUE(finished);
}

TEST(KillShield, IsHarmlessInThreadsOfOthers) {
  const KillShield here;
  std::thread([] { const KillShield there; }).join();
}

// Two numbers that are equal outside every shield stay equal, whenever the end comes.
TEST(KillShield, WhatItGuardsIsDoneWholeOrNotAtAll) {
  SKIP_UNDER_THREAD_SANITIZER("signals reach a thread only at its next call");
  std::mt19937 random(13579);
  for (int round = 0; round < 300; ++round) {
    std::atomic<unsigned long> first{0};
    std::atomic<unsigned long> second{0};
    const auto thread = Thread::Start([&] {
      while (true) {
        const KillShield shield;
        ++first;
        ++second;
      }
    });
    std::this_thread::sleep_for(microseconds(random() % 300));
    thread->Kill();
    thread->Join();
    ASSERT_EQ(first, second);
  }
}

}  // namespace
