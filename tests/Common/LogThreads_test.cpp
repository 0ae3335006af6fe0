// Operators report from their own threads, so contexts of several threads share the one log stack.
#include <gtest/gtest.h>
#include <vorl/Common/ILogging.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>
#include <vorl/Common/OpBase.h>

#include <atomic>
#include <thread>
#include <vector>

namespace {

constexpr int kRounds = 2000;

class CountingTarget : public LogTarget {
 public:
  CountingTarget() {
    SetLevelMask(31);
    GetLogManager().AddLogTarget(this, nullptr);
  }
  ~CountingTarget() override { GetLogManager().RemoveLogTarget(this); }
  void OnEntry(LogContext*) override { ++entries; }
  void OnExit(LogContext*) override { ++exits; }
  void OnError(LogContext*) override { ++errors; }

  std::atomic<int> entries{0};
  std::atomic<int> exits{0};
  std::atomic<int> errors{0};
};

void NestContexts() {
  for (int i = 0; i < kRounds; ++i) {
    LogContext outer("outer", __FILE__, __LINE__, true);
    LogContext inner("inner", __FILE__, __LINE__, true);
    inner.Error(__LINE__, "error %d", i);
  }
}

unsigned long Depth() {
  return GetLogManager().GetLogThread()->GetLogDepth();
}

TEST(LogThreads, ConcurrentContextsLeaveAnEmptyStack) {
  const CountingTarget target;
  std::thread first(NestContexts);
  std::thread second(NestContexts);
  first.join();
  second.join();
  EXPECT_EQ(Depth(), 0u);
  EXPECT_EQ(target.entries, 4 * kRounds);
  EXPECT_EQ(target.errors, 2 * kRounds);
  // Only contexts that are innermost of all threads when they end log their exit.
  EXPECT_GE(target.exits, 1);
  EXPECT_LE(target.exits, 4 * kRounds);
}

TEST(LogThreads, ConcurrentContextsWithoutTargetLeaveAnEmptyStack) {
  std::thread first(NestContexts);
  std::thread second(NestContexts);
  first.join();
  second.join();
  EXPECT_EQ(Depth(), 0u);
}

class ReportingOperator : public OpBase {
 protected:
  bool Prepare() override { return true; }
  bool Process() override {
    NestContexts();
    m_status.Set(-4, "reported");
    return false;
  }
};

TEST(LogThreads, OperatorsMayReportFromTheirThreads) {
  const CountingTarget target;
  ReportingOperator first;
  ReportingOperator second;
  ASSERT_TRUE(first.RunAsThread(0));
  ASSERT_TRUE(second.RunAsThread(0));
  while (first.IsRunning() || second.IsRunning()) {
    std::this_thread::yield();
  }
  EXPECT_EQ(Depth(), 0u);
  EXPECT_EQ(target.entries, 4 * kRounds);
  EXPECT_TRUE(first.GetStatus() == -4);
  EXPECT_TRUE(second.GetStatus() == -4);
}

}  // namespace
