// The volume operators in threads of their own: progress, stopping, and ending by force.

#include <gtest/gtest.h>

#include <chrono>
#include <string>
#include <thread>

#include "ThreadJobs.h"
#include "Waiting.h"

namespace {

using rasters::MessageOf;
using thread_jobs::Amount;
using thread_jobs::Job;
using waiting::WaitForEnd;
using waiting::WaitForProgress;
using namespace std::chrono_literals;

class VolumeOperatorThread : public testing::TestWithParam<int> {
 protected:
  static std::unique_ptr<Job> MakeJob(Amount amount) {
    return thread_jobs::Make(GetParam(), amount);
  }

  // What a run in the caller's thread gives; the job is as before afterwards.
  static rasters::Bytes ExpectedOf(Job& job) {
    job.Clear();
    EXPECT_TRUE(job.Op().Run()) << MessageOf(job.Op());
    rasters::Bytes result = job.Result();
    job.Clear();
    return result;
  }
};

TEST_P(VolumeOperatorThread, GivesWhatTheCallersThreadGives) {
  const auto job = MakeJob(Amount::Small);
  const rasters::Bytes expected = ExpectedOf(*job);
  ASSERT_TRUE(job->Op().RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(job->Op()));
  EXPECT_EQ(MessageOf(job->Op()), "success");
  EXPECT_EQ(job->Result(), expected);
}

TEST_P(VolumeOperatorThread, ProgressRisesFromZeroToOne) {
  const auto job = MakeJob(Amount::Small);
  ASSERT_TRUE(job->Op().RunAsThread(0));
  double last = 0.0;
  const auto limit = std::chrono::steady_clock::now() + waiting::kPatience;
  while (job->Op().IsRunning() && std::chrono::steady_clock::now() < limit) {
    const double now = job->Op().GetProgress();
    ASSERT_GE(now, last);
    ASSERT_LE(now, 1.0);
    last = now;
  }
  ASSERT_FALSE(job->Op().IsRunning());
  EXPECT_EQ(job->Op().GetProgress(), 1.0);
}

/// All but the projection of a list by its maxima: it draws nothing, and is done before a request
/// has travelled from one processor to the other.
class VolumeOperatorThreadStop : public VolumeOperatorThread {};

// The row that is being worked on when the request comes is finished, and no other is begun.
TEST_P(VolumeOperatorThreadStop, StopsWithinOneRow) {
  // Should the machine be so busy that the work is done before the request comes, it is tried
  // again.
  for (int attempt = 0; attempt < 20; ++attempt) {
    const auto job = MakeJob(Amount::Large);
    OpBase& op = job->Op();
    ASSERT_TRUE(op.RunAsThread(0));
    ASSERT_TRUE(WaitForProgress(op));
    op.Stop();
    const double asked = op.GetProgress();
    ASSERT_TRUE(WaitForEnd(op));
    if (MessageOf(op) != "success") {
      EXPECT_EQ(MessageOf(op), "stopped");
      EXPECT_EQ(rasters::CodeOf(op), -1);
      EXPECT_GT(op.GetProgress(), 0.0);
      EXPECT_LT(op.GetProgress(), 1.0);
      EXPECT_LE((op.GetProgress() - asked) * job->Rows(), 1.001);
      return;
    }
  }
  FAIL() << "never stopped";
}

TEST_P(VolumeOperatorThread, EndedAtAnyMomentItsOperatorRunsAgain) {
  const auto job = MakeJob(Amount::Small);
  const rasters::Bytes expected = ExpectedOf(*job);
  rasters::Random random(81);
  for (int i = 0; i < 20; ++i) {
    ASSERT_TRUE(job->Op().RunAsThread(0));
    std::this_thread::sleep_for(std::chrono::microseconds(random.Between(0, 50) * i));
    job->Op().Terminate();
    ASSERT_FALSE(job->Op().IsRunning());
    if (i % 4 == 0) {
      job->Clear();
      ASSERT_TRUE(job->Op().Run()) << MessageOf(job->Op());
      ASSERT_EQ(job->Result(), expected);
    }
  }
  job->Clear();
  ASSERT_TRUE(job->Op().RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(job->Op()));
  EXPECT_EQ(job->Result(), expected);
}

TEST_P(VolumeOperatorThread, EndsWithItsOperator) {
  for (int i = 0; i < 5; ++i) {
    const auto job = MakeJob(Amount::Small);
    ASSERT_TRUE(job->Op().RunAsThread(0));
    std::this_thread::sleep_for(i * 500us);
  }
}

INSTANTIATE_TEST_SUITE_P(Algorithms, VolumeOperatorThreadStop,
                         testing::Values(201, 202, 301, 302, 303, 401, 402, 403),
                         [](const auto& algo) { return std::to_string(algo.param); });

INSTANTIATE_TEST_SUITE_P(Algorithms, VolumeOperatorThread,
                         testing::Values(201, 202, 205, 301, 302, 303, 401, 402, 403),
                         [](const auto& algo) { return std::to_string(algo.param); });

// A stopped classification has counted only a part of the voxels.
TEST(VolumeOperatorThreadClasses, StoppedClassificationsAreNoneToSelectFrom) {
  thread_jobs::ClassificationJob job(401, Amount::Large);
  auto& op = static_cast<opVoxelClassification&>(job.Op());
  ASSERT_TRUE(op.RunAsThread(0));
  ASSERT_TRUE(WaitForProgress(op));
  op.Stop();
  ASSERT_TRUE(WaitForEnd(op));
  ASSERT_EQ(MessageOf(op), "stopped");
  EXPECT_EQ(op.classifiedBy, 400);
  op.SelectAlgo(403);
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(MessageOf(op), "can't select voxels: voxels are not yet classified");
}

}  // namespace
