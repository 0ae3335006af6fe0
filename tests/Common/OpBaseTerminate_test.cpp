// Runs that are ended from outside, or from inside before their end.
//
// What a thread holds when it is ended by force is lost, so the texts below are short enough to
// need no memory of their own.
#include <gtest/gtest.h>
#include <tests/Common/TestOperators.h>
#include <tests/Support/ThreadSanitizer.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>
#include <vorl/Common/OpBase.h>

#include <atomic>
#include <chrono>
#include <memory>
#include <thread>

namespace {

using std::chrono::milliseconds;
using std::chrono::steady_clock;

enum class Work { Polls, Sleeps, Spins };

/// Works in its own way until it is ended; counts what it does.
class EndlessOp : public OpBase {
 public:
  explicit EndlessOp(Work work) : m_work(work) {}
  EndlessOp(const EndlessOp& source) : OpBase(source), m_work(source.m_work) {}
  EndlessOp& operator=(const EndlessOp&) = delete;
  ~EndlessOp() override { OpBase::Terminate(); }

  using OpBase::m_stopRequested;

  bool StartAndEnter() {
    entered = false;
    return RunAsThread(0) && WaitUntil([this] { return entered.load(); });
  }

  std::atomic<bool> entered{false};
  std::atomic<bool> finite{false};
  std::atomic<unsigned long> counter{0};

 protected:
  bool Prepare() override { return true; }
  bool Process() override {
    const LogContext context("Process", "f", 1, true);
    entered = true;
    if (finite) {
      return true;
    }
    switch (m_work) {
      case Work::Polls:
        while (!m_stopRequested) {
          ++counter;
        }
        return Stopped();
      case Work::Sleeps:
        while (true) {
          ++counter;
          std::this_thread::sleep_for(milliseconds(1));
        }
      case Work::Spins:
        while (true) {
          ++counter;
        }
    }
    return true;
  }

 private:
  Work m_work;
};

unsigned long Depth() {
  return GetLogManager().GetLogThread()->GetLogDepth();
}

class OpBaseTerminate : public testing::TestWithParam<Work> {
 protected:
  void SetUp() override {
    if (GetParam() == Work::Spins) {
      SKIP_UNDER_THREAD_SANITIZER(
          "signals reach a thread only at its next call, which never comes");
    }
    ASSERT_EQ(Depth(), 0u);
  }
  // Nothing runs on: the counter of an ended thread stands still.
  static void ExpectStandstill(const EndlessOp& op) {
    EXPECT_FALSE(op.IsRunning());
    const unsigned long counted = op.counter;
    std::this_thread::sleep_for(milliseconds(10));
    EXPECT_EQ(op.counter, counted);
    EXPECT_EQ(Depth(), 0u);
  }
};

TEST_P(OpBaseTerminate, EndsTheThread) {
  EndlessOp op(GetParam());
  ASSERT_TRUE(op.StartAndEnter());
  const auto start = steady_clock::now();
  op.Terminate();
  const auto duration = steady_clock::now() - start;
  ExpectStandstill(op);
  if (GetParam() == Work::Polls) {
    EXPECT_STREQ(op.GetStatus(), "stopped");
  } else {
    EXPECT_GE(duration, milliseconds(99)) << "asked to stop, and given time to";
  }
}

TEST_P(OpBaseTerminate, IsHarmlessTwice) {
  EndlessOp op(GetParam());
  ASSERT_TRUE(op.StartAndEnter());
  op.Terminate();
  op.Terminate();
  ExpectStandstill(op);
}

TEST_P(OpBaseTerminate, LeavesNoStopRequest) {
  EndlessOp op(GetParam());
  ASSERT_TRUE(op.StartAndEnter());
  op.Terminate();
  EXPECT_FALSE(op.m_stopRequested);
}

TEST_P(OpBaseTerminate, AnotherRunMayFollow) {
  EndlessOp op(GetParam());
  for (int i = 0; i < 3; ++i) {
    ASSERT_TRUE(op.StartAndEnter());
    EXPECT_TRUE(op.IsRunning());
    op.Terminate();
    ExpectStandstill(op);
  }
  op.finite = true;
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitUntil([&] { return !op.IsRunning(); }));
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST_P(OpBaseTerminate, DestructorEndsTheThread) {
  auto op = std::make_unique<EndlessOp>(GetParam());
  ASSERT_TRUE(op->StartAndEnter());
  op.reset();
  EXPECT_EQ(Depth(), 0u);
}

TEST_P(OpBaseTerminate, CopyEndsTheThreadOfItsSource) {
  EndlessOp op(GetParam());
  ASSERT_TRUE(op.StartAndEnter());
  EndlessOp copy(op);
  EXPECT_TRUE(copy.IsRunning());
  copy.Terminate();
  EXPECT_FALSE(copy.IsRunning());
  ExpectStandstill(op);
  op.Terminate();
  copy.Terminate();
  ASSERT_TRUE(op.StartAndEnter()) << "the source may run again";
  EXPECT_TRUE(op.IsRunning());
}

TEST_P(OpBaseTerminate, CopyMayOutliveItsSource) {
  auto op = std::make_unique<EndlessOp>(GetParam());
  ASSERT_TRUE(op->StartAndEnter());
  EndlessOp copy(*op);
  op.reset();
  copy.Terminate();
  EXPECT_FALSE(copy.IsRunning());
  ASSERT_TRUE(copy.StartAndEnter()) << "with a thread of its own";
}

INSTANTIATE_TEST_SUITE_P(Work, OpBaseTerminate,
                         testing::Values(Work::Polls, Work::Sleeps, Work::Spins),
                         [](const auto& instance) {
                           switch (instance.param) {
                             case Work::Polls:
                               return "PollingTheStopRequest";
                             case Work::Sleeps:
                               return "SleepingInALoop";
                             default:
                               return "SpinningWithoutACall";
                           }
                         });

TEST(OpBaseTerminateInside, EndsTheThreadAtOnce) {
  RecordingOp op;
  std::atomic<bool> cameBack{false};
  op.process = [&] {
    const LogContext context("Process", "f", 1, true);
    op.Terminate();
    cameBack = true;
    return true;
  };
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitUntil([&] { return !op.IsRunning(); }));
  op.Terminate();
  EXPECT_FALSE(cameBack);
  EXPECT_EQ(Depth(), 0u);

  op.process = nullptr;
  EXPECT_TRUE(op.Run());
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitUntil([&] { return !op.IsRunning(); }));
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST(OpBaseTerminateInside, EndsTheThreadFromACopyToo) {
  RecordingOp op;
  std::atomic<bool> cameBack{false};
  std::unique_ptr<RecordingOp> copy;
  op.process = [&] {
    copy = std::make_unique<RecordingOp>(op);
    copy->Terminate();
    cameBack = true;
    return true;
  };
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitUntil([&] { return !op.IsRunning(); }));
  op.Terminate();
  EXPECT_FALSE(cameBack);
}

// In the caller's thread there is no thread of the operator's own to end.
TEST(OpBaseTerminateInside, ReturnsWithoutOwnThread) {
  RecordingOp op;
  op.process = [&] {
    op.Terminate();
    return true;
  };
  EXPECT_TRUE(op.Run());
}

TEST(OpBaseAssignment, EndsTheThreadThatTheTargetStarted) {
  EndlessOp running(Work::Polls);
  ASSERT_TRUE(running.StartAndEnter());
  RecordingOp idle;
  static_cast<OpBase&>(running) = static_cast<OpBase&>(idle);
  EXPECT_FALSE(running.IsRunning());
  const unsigned long counted = running.counter;
  std::this_thread::sleep_for(milliseconds(10));
  EXPECT_EQ(running.counter, counted);
}

TEST(OpBaseAssignment, LeavesAThreadThatTheTargetOnlyShares) {
  EndlessOp running(Work::Polls);
  ASSERT_TRUE(running.StartAndEnter());
  RecordingOp target;
  RecordingOp idle;
  static_cast<OpBase&>(target) = static_cast<OpBase&>(running);
  EXPECT_TRUE(target.IsRunning());
  static_cast<OpBase&>(target) = static_cast<OpBase&>(idle);
  EXPECT_FALSE(target.IsRunning());
  EXPECT_TRUE(running.IsRunning());
  const unsigned long counted = running.counter;
  EXPECT_TRUE(WaitUntil([&] { return running.counter != counted; })) << "the source runs on";
}

}  // namespace
