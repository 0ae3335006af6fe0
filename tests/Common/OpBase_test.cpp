#include <vorl/Common/OpBase.h>

#include <gtest/gtest.h>
#include <tests/Common/TestOperators.h>
#include <tests/Support/VirtualSlot.h>

#include <chrono>
#include <string>
#include <thread>
#include <type_traits>
#include <vector>

namespace {

using Trail = std::vector<std::string>;

TEST(OpBase, NewOperatorIsIdle) {
  RecordingOp op;
  EXPECT_FALSE(op.IsRunning());
  EXPECT_EQ(op.GetProgress(), 0.0);
  EXPECT_EQ(op.GetProcessingTime(), 0.0);
  EXPECT_FALSE(op.m_stopRequested);
}

TEST(OpBase, RunStartsPreparesProcessesAndExits) {
  RecordingOp op;
  EXPECT_TRUE(op.Run());
  EXPECT_EQ(op.trail, (Trail{"start", "prepare", "process", "exit true"}));
}

TEST(OpBase, FailedPreparationSkipsTheProcessing) {
  RecordingOp op;
  op.prepare = [&] {
    op.m_status.Set(-7, "no source");
    return false;
  };
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(op.trail, (Trail{"start", "prepare", "exit false"}));
  EXPECT_TRUE(op.GetStatus() == -7);
  EXPECT_STREQ(op.GetStatus(), "no source");
  EXPECT_FALSE(op.IsRunning());
}

TEST(OpBase, FailedProcessingKeepsItsStatus) {
  RecordingOp op;
  op.process = [&] {
    op.m_status.Set(-8, "no memory");
    return false;
  };
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(op.trail, (Trail{"start", "prepare", "process", "exit false"}));
  EXPECT_TRUE(op.GetStatus() == -8);
  EXPECT_STREQ(op.GetStatus(), "no memory");
  EXPECT_FALSE(op.IsRunning());
}

TEST(OpBase, SuccessfulRunSaysSo) {
  RecordingOp op;
  op.process = [&] {
    op.m_status.Set(5, "a warning on the way");
    return true;
  };
  EXPECT_TRUE(op.Run());
  EXPECT_TRUE(op.GetStatus() == 0);
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST(OpBase, RunReturnsWhatExitReturns) {
  RecordingOp op;
  op.exitResult = false;
  EXPECT_FALSE(op.Run());
  EXPECT_TRUE(op.GetStatus() == 0);
}

TEST(OpBase, StartClearsWhatTheLastRunLeft) {
  RecordingOp op;
  op.process = [&] {
    op.m_progress = 1.0;
    op.m_status.Set(-8, "no memory");
    return false;
  };
  op.Run();
  op.m_stopRequested = true;

  op.prepare = [&] {
    EXPECT_TRUE(op.IsRunning());
    EXPECT_TRUE(op.GetStatus() == 0);
    EXPECT_STREQ(op.GetStatus(), "");
    EXPECT_EQ(op.GetProgress(), 0.0);
    EXPECT_FALSE(op.m_stopRequested);
    EXPECT_LT(op.GetProcessingTime(), 10.0);
    return true;
  };
  op.process = nullptr;
  EXPECT_TRUE(op.Run());
}

TEST(OpBase, ExitClearsAStopRequest) {
  RecordingOp op;
  op.process = [&] {
    op.m_stopRequested = true;
    return true;
  };
  EXPECT_TRUE(op.Run());
  EXPECT_FALSE(op.m_stopRequested);
}

TEST(OpBase, RunsUntilItsExit) {
  RecordingOp op;
  bool running = false;
  op.process = [&] {
    running = op.IsRunning();
    return true;
  };
  op.Run();
  EXPECT_TRUE(running);
  EXPECT_FALSE(op.IsRunning());
}

TEST(OpBase, ProcessingTimeGrowsDuringARunAndThenStays) {
  RecordingOp op;
  double first = 0.0;
  double second = 0.0;
  op.process = [&] {
    first = op.GetProcessingTime();
    std::this_thread::sleep_for(std::chrono::milliseconds(20));
    second = op.GetProcessingTime();
    return true;
  };
  op.Run();
  const double duration = op.GetProcessingTime();
  std::this_thread::sleep_for(std::chrono::milliseconds(5));
  EXPECT_GE(first, 0.0);
  EXPECT_GE(second, first + 0.019);
  EXPECT_GE(duration, second);
  EXPECT_EQ(op.GetProcessingTime(), duration);
}

TEST(OpBase, FailedRunHasAProcessingTimeToo) {
  RecordingOp op;
  op.process = [] {
    std::this_thread::sleep_for(std::chrono::milliseconds(5));
    return false;
  };
  op.Run();
  EXPECT_GE(op.GetProcessingTime(), 0.004);
}

TEST(OpBase, ProgressStaysWhereTheRunLeftIt) {
  RecordingOp op;
  op.process = [&] {
    op.m_progress = 0.75;
    return true;
  };
  op.Run();
  EXPECT_EQ(op.GetProgress(), 0.75);
}

TEST(OpBase, CallOperatorRunsTheOverriddenRun) {
  class OwnRun : public RecordingOp {
   public:
    bool Run() override {
      ++runs;
      return result;
    }
    int runs = 0;
    bool result = true;
  } op;
  EXPECT_TRUE(op());
  op.result = false;
  EXPECT_FALSE(op());
  EXPECT_EQ(op.runs, 2);
  EXPECT_TRUE(op.trail.empty());
}

TEST(OpBase, StopOfAnIdleOperatorOnlyClearsTheRequest) {
  RecordingOp op;
  op.m_stopRequested = true;
  op.Stop();
  EXPECT_FALSE(op.m_stopRequested);
  EXPECT_TRUE(op.Run());
}

TEST(OpBase, StopWithoutOwnThreadClearsTheRequest) {
  RecordingOp op;
  op.process = [&] {
    op.m_stopRequested = true;
    op.Stop();
    return !op.m_stopRequested;
  };
  EXPECT_TRUE(op.Run());
}

TEST(OpBase, TerminateOfAnIdleOperatorIsHarmless) {
  RecordingOp op;
  op.Terminate();
  op.Terminate();
  EXPECT_TRUE(op.Run());
  op.Terminate();
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST(OpBase, StoppedFailsWithItsStatus) {
  RecordingOp op;
  op.process = [&] { return op.Stopped(); };
  EXPECT_FALSE(op.Run());
  EXPECT_TRUE(op.GetStatus() == -1);
  EXPECT_STREQ(op.GetStatus(), "stopped");
}

TEST(OpBase, ResetSucceeds) {
  RecordingOp op;
  EXPECT_TRUE(op.Reset());
}

TEST(OpBase, CopiesTakeTheResultOfTheLastRun) {
  RecordingOp source;
  source.process = [&] {
    source.m_progress = 0.5;
    std::this_thread::sleep_for(std::chrono::milliseconds(1));
    source.m_status.Set(-8, "no memory");
    return false;
  };
  source.Run();
  RecordingOp copy(source);
  RecordingOp assigned;
  assigned = source;
  for (RecordingOp* op : {&copy, &assigned}) {
    EXPECT_TRUE(op->GetStatus() == -8);
    EXPECT_STREQ(op->GetStatus(), "no memory");
    EXPECT_EQ(op->GetProgress(), 0.5);
    EXPECT_EQ(op->GetProcessingTime(), source.GetProcessingTime());
    EXPECT_FALSE(op->IsRunning());
  }
}

TEST(OpBase, SelfAssignmentChangesNothing) {
  RecordingOp op;
  op.Run();
  const RecordingOp& same = op;
  op = same;
  EXPECT_STREQ(op.GetStatus(), "success");
}

TEST(OpBase, IsAbstractAndHasNoFactory) {
  EXPECT_TRUE(std::is_abstract_v<OpBase>);
  EXPECT_STREQ(OpBase::CI().name, "OpBase");
  EXPECT_EQ(OpBase::CI().Create(), nullptr);
  RecordingOp op;
  EXPECT_EQ(op.GetClassInfo(), &OpBase::CI());
}

TEST(OpBase, VirtualFunctionsStandInOrder) {
  EXPECT_EQ(VirtualSlot(&RecordingOp::GetClassInfo), 0u);
  EXPECT_TRUE(std::has_virtual_destructor_v<OpBase>);  // places 1 and 2
  EXPECT_EQ(VirtualSlot(&RecordingOp::Release), 3u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Reset), 4u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Run), 5u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Stop), 6u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Terminate), 7u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::GetProgress), 8u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Prepare), 9u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Process), 10u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Start), 11u);
  EXPECT_EQ(VirtualSlot(&RecordingOp::Exit), 12u);
}

}  // namespace
