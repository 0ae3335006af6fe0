// Runs in the operator's own thread that end by themselves.
#include <gtest/gtest.h>
#include <tests/Common/TestOperators.h>
#include <vorl/Common/OpBase.h>

#include <atomic>
#include <chrono>
#include <memory>
#include <random>
#include <string>
#include <thread>
#include <vector>

namespace {

using Trail = std::vector<std::string>;
using std::chrono::microseconds;
using std::chrono::milliseconds;

/// Processes until it is told to end or to stop.
class WaitingOp : public RecordingOp {
 public:
  WaitingOp() {
    process = [this] {
      ++runs;
      while (!release) {
        if (m_stopRequested) {
          return Stopped();
        }
        std::this_thread::sleep_for(microseconds(100));
      }
      return result.load();
    };
  }
  ~WaitingOp() override { OpBase::Terminate(); }

  std::atomic<bool> release{false};
  std::atomic<bool> result{true};
  std::atomic<int> runs{0};
};

bool WaitForEnd(const OpBase& op) {
  return WaitUntil([&] { return !op.IsRunning(); });
}

TEST(OpBaseThread, RunsAllStepsInAnotherThread) {
  RecordingOp op;
  std::thread::id worker;
  op.process = [&] {
    worker = std::this_thread::get_id();
    return true;
  };
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(op));
  EXPECT_NE(worker, std::this_thread::get_id());
  EXPECT_EQ(op.trail, (Trail{"start", "prepare", "process", "exit true"}));
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST(OpBaseThread, HasAThreadFromTheStartUntilTheRunHasSucceeded) {
  RecordingOp op;
  bool inProcess = true;
  op.process = [&] {
    inProcess = op.HasThread();
    return true;
  };
  ASSERT_TRUE(op.Run());
  EXPECT_FALSE(inProcess) << "in the caller's thread";
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitUntil([&] { return !op.HasThread(); }));
  EXPECT_TRUE(inProcess) << "in its own thread";
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST(OpBaseThread, IsRunningAsSoonAsItIsStarted) {
  WaitingOp op;
  ASSERT_TRUE(op.RunAsThread(0));
  EXPECT_TRUE(op.IsRunning());
  op.release = true;
  EXPECT_TRUE(WaitForEnd(op));
}

TEST(OpBaseThread, ItsArgumentIsNotUsed) {
  for (const int priority : {-5, 0, 1, 1000000}) {
    RecordingOp op;
    ASSERT_TRUE(op.RunAsThread(priority));
    ASSERT_TRUE(WaitForEnd(op));
    EXPECT_STREQ(op.GetStatus(), "success");
  }
}

TEST(OpBaseThread, SecondStartDuringARunStartsNoOther) {
  WaitingOp op;
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitUntil([&] { return op.runs == 1; }));
  EXPECT_TRUE(op.RunAsThread(0));
  EXPECT_TRUE(op.RunAsThread(0));
  op.release = true;
  ASSERT_TRUE(WaitForEnd(op));
  EXPECT_EQ(op.runs, 1);
}

TEST(OpBaseThread, SecondStartDuringARunLeavesAStopRequest) {
  WaitingOp op;
  ASSERT_TRUE(op.RunAsThread(0));
  op.Stop();
  EXPECT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(op));
  EXPECT_STREQ(op.GetStatus(), "stopped");
}

TEST(OpBaseThread, StopEndsARunThatPollsTheRequest) {
  WaitingOp op;
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitUntil([&] { return op.runs == 1; }));
  op.Stop();
  ASSERT_TRUE(WaitForEnd(op));
  EXPECT_TRUE(op.GetStatus() == -1);
  EXPECT_STREQ(op.GetStatus(), "stopped");
  EXPECT_FALSE(op.m_stopRequested) << "cleared by the exit";
}

TEST(OpBaseThread, StopRightAfterTheStartIsHonoured) {
  for (int i = 0; i < 200; ++i) {
    WaitingOp op;
    ASSERT_TRUE(op.RunAsThread(0));
    op.Stop();
    ASSERT_TRUE(WaitForEnd(op)) << "round " << i;
    ASSERT_STREQ(op.GetStatus(), "stopped");
  }
}

TEST(OpBaseThread, StopRequestIsGoneAtTheNextStart) {
  WaitingOp op;
  ASSERT_TRUE(op.RunAsThread(0));
  op.Stop();
  ASSERT_TRUE(WaitForEnd(op));
  op.m_stopRequested = true;
  op.release = true;
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(op));
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST(OpBaseThread, CanStartAgainAfterASuccess) {
  WaitingOp op;
  op.release = true;
  for (int i = 1; i <= 20; ++i) {
    ASSERT_TRUE(op.RunAsThread(0));
    ASSERT_TRUE(WaitForEnd(op));
    ASSERT_EQ(op.runs, i);
    ASSERT_STREQ(op.GetStatus(), "success");
  }
}

TEST(OpBaseThread, CanStartAgainAfterAFailure) {
  WaitingOp op;
  op.release = true;
  op.result = false;
  for (int i = 1; i <= 20; ++i) {
    ASSERT_TRUE(op.RunAsThread(0));
    ASSERT_TRUE(WaitForEnd(op));
    ASSERT_EQ(op.runs, i);
    op.Stop();
    ASSERT_FALSE(op.m_stopRequested) << "no run, so the request is cleared";
  }
}

TEST(OpBaseThread, FailedRunKeepsItsStatus) {
  RecordingOp op;
  op.prepare = [&] {
    op.m_status.Set(-7, "no source");
    return false;
  };
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(op));
  EXPECT_TRUE(op.GetStatus() == -7);
  EXPECT_STREQ(op.GetStatus(), "no source");
  EXPECT_EQ(op.trail, (Trail{"start", "prepare", "exit false"}));
}

// A run has ended with its exit, though its thread takes a while to end.
TEST(OpBaseThread, RunInTheCallersThreadMayFollowAtOnce) {
  class LateOp : public RecordingOp {
   public:
    ~LateOp() override { OpBase::Terminate(); }
    bool Run() override {
      const bool ok = OpBase::Run();
      std::this_thread::sleep_for(milliseconds(30));
      return ok;
    }
  } op;
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(op));
  op.process = [&] {
    std::this_thread::sleep_for(milliseconds(60));
    return op.IsRunning();
  };
  EXPECT_TRUE(op.OpBase::Run()) << "the end of the thread reached into the next run";
}

TEST(OpBaseThread, ProcessingTimeAndProgressBeginWithTheStart) {
  WaitingOp op;
  op.release = true;
  op.Run();
  op.m_progress = 1.0;
  std::this_thread::sleep_for(milliseconds(1200));
  op.release = false;
  ASSERT_TRUE(op.RunAsThread(0));
  EXPECT_LT(op.GetProcessingTime(), 1.0) << "it counts from an earlier run";
  EXPECT_EQ(op.GetProgress(), 0.0);
}

TEST(OpBaseThread, ProcessingTimeNeverShrinksDuringARunAndThenStays) {
  WaitingOp op;
  double last = 0.0;
  ASSERT_TRUE(op.RunAsThread(0));
  // The end is asked of the clock: some systems round so short a sleep down to nothing.
  const auto end = std::chrono::steady_clock::now() + milliseconds(40);
  while (std::chrono::steady_clock::now() < end) {
    const double now = op.GetProcessingTime();
    ASSERT_GE(now, last);
    last = now;
    std::this_thread::sleep_for(microseconds(50));
  }
  EXPECT_GT(last, 0.005);
  op.release = true;
  ASSERT_TRUE(WaitForEnd(op));
  const double duration = op.GetProcessingTime();
  EXPECT_GE(duration, last);
  std::this_thread::sleep_for(milliseconds(5));
  EXPECT_EQ(op.GetProcessingTime(), duration);
}

TEST(OpBaseThread, OwnerSeesTheProgress) {
  RecordingOp op;
  std::atomic<bool> seen{false};
  op.process = [&] {
    op.m_progress = 0.25;
    return WaitUntil([&] { return seen.load(); });
  };
  ASSERT_TRUE(op.RunAsThread(0));
  EXPECT_TRUE(WaitUntil([&] { return op.GetProgress() == 0.25; }));
  EXPECT_TRUE(op.IsRunning());
  seen = true;
  EXPECT_TRUE(WaitForEnd(op));
  EXPECT_EQ(op.GetProgress(), 0.25);
}

TEST(OpBaseThread, OverriddenRunEndsTheRunWithItsReturn) {
  class OwnRun : public RecordingOp {
   public:
    ~OwnRun() override { OpBase::Terminate(); }
    bool Run() override {
      ++runs;
      return result;
    }
    std::atomic<int> runs{0};
    std::atomic<bool> result{true};
  } op;
  for (const bool result : {true, false, true}) {
    op.result = result;
    ASSERT_TRUE(op.RunAsThread(0));
    ASSERT_TRUE(WaitForEnd(op));
  }
  EXPECT_EQ(op.runs, 3);
}

TEST(OpBaseThread, OperatorsRunSideBySide) {
  std::vector<std::unique_ptr<WaitingOp>> ops;
  for (int i = 0; i < 8; ++i) {
    ops.push_back(std::make_unique<WaitingOp>());
    ASSERT_TRUE(ops.back()->RunAsThread(0));
  }
  for (const auto& op : ops) {
    EXPECT_TRUE(WaitUntil([&] { return op->runs == 1; }));
  }
  for (const auto& op : ops) {
    op->release = true;
  }
  for (const auto& op : ops) {
    EXPECT_TRUE(WaitForEnd(*op));
    EXPECT_STREQ(op->GetStatus(), "success");
  }
}

TEST(OpBaseThread, StartsStopsAndEndsAtRandomMoments) {
  std::mt19937 random(20240607);
  const auto below = [&](unsigned int limit) {
    return static_cast<unsigned int>(random() % limit);
  };
  const auto pause = [&] { std::this_thread::sleep_for(microseconds(below(300))); };
  for (int round = 0; round < 400; ++round) {
    SCOPED_TRACE(round);
    WaitingOp op;
    op.release = below(3) == 0;
    op.result = below(2) == 0;
    for (unsigned int step = 0, steps = 1 + below(5); step < steps; ++step) {
      switch (below(6)) {
        case 0:
          op.Stop();
          break;
        case 1:
          op.Terminate();
          EXPECT_FALSE(op.IsRunning());
          break;
        case 2:
          op.release = true;
          EXPECT_TRUE(WaitForEnd(op));
          break;
        default:
          EXPECT_TRUE(op.RunAsThread(0));
          break;
      }
      pause();
    }
  }
}

}  // namespace
