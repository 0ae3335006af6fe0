// Reporting a failure must not fail itself, also when there is no memory left to do it with.
#include <gtest/gtest.h>
#include <tests/Support/Allocation.h>
#include <vorl/Common/HRTimer.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>
#include <vorl/Common/OpBase.h>
#include <vorl/Common/dStatus.h>

#include <string>

namespace {

const std::string kLongText(500, 'x');

class IdleOperator : public OpBase {
 public:
  ~IdleOperator() override { OpBase::Terminate(); }

 protected:
  bool Prepare() override { return true; }
  bool Process() override { return true; }
};

TEST(OutOfMemory, StatusKeepsTheCodeAndDropsTheText) {
  dStatus status(true, "old");
  const dStatus inner(-3, kLongText.c_str());
  {
    const AllocationFailure failure;
    status.Set(-12L, "%s", kLongText.c_str());
    EXPECT_TRUE(status == -12);
    EXPECT_STREQ(status, "");
    status.Set(false, "%s", kLongText.c_str());
    EXPECT_TRUE(status == -1);
    status.Set(inner, "short:");
    EXPECT_TRUE(status == -3);
    EXPECT_STREQ(status, "short:");
    status = kLongText;
    EXPECT_STREQ(status, "");
    status = inner;
    EXPECT_TRUE(status == -3);
    EXPECT_STREQ(status, "");
    EXPECT_TRUE(dStatus(inner) == -3);
    EXPECT_TRUE(dStatus(-9, kLongText.c_str()) == -9);
  }
}

TEST(OutOfMemory, StatusKeepsWhatItHadWhenNothingCanBeAppended) {
  dStatus status(-3, "old");
  const AllocationFailure failure;
  status += kLongText;
  status += kLongText.c_str();
  status.AddMsg("%s", kLongText.c_str());
  EXPECT_TRUE(status == -3);
  EXPECT_STREQ(status, "old");
}

TEST(OutOfMemory, ContextReportsWithoutTexts) {
  {
    const AllocationFailure failure;
    LogContext context("dImage::CheckPixelAccess", "f", 1, true);
    context.Error(7, "%s", kLongText.c_str());
    EXPECT_STREQ(context.GetTitle(), "");
    EXPECT_STREQ(context.GetMsg(), "");
    EXPECT_EQ(context.GetCode(), -1);
    EXPECT_EQ(context.GetLineNo(), 7u);
    EXPECT_EQ(context.GetLogDepth(), 0u);
  }
  EXPECT_EQ(GetLogManager().GetLogThread()->GetLogDepth(), 0u);
}

TEST(OutOfMemory, RecordGoesNowhere) {
  class Target : public LogTarget {
   public:
    void OnError(LogContext*) override { ++errors; }
    int errors = 0;
  } target;
  LogContext context("t", "f", 1, false);
  GetLogManager().AddLogTarget(&target, nullptr);
  {
    const AllocationFailure failure;
    context.Error(7, "e");
  }
  context.Error(7, "e");
  GetLogManager().RemoveLogTarget(&target);
  EXPECT_EQ(target.errors, 1);
}

TEST(OutOfMemory, SessionsAndTargetsAreNotAdded) {
  LogTarget target;
  const AllocationFailure failure;
  EXPECT_EQ(GetLogManager().RegisterSession("no memory"), nullptr);
  GetLogManager().AddLogTarget(&target, "no memory");
  EXPECT_EQ(GetLogManager().GetSession("no memory"), nullptr);
  GetLogManager().AddLogTarget(&target, "DEFAULT");
}

TEST(OutOfMemory, FactoriesGiveNull) {
  const AllocationFailure failure;
  EXPECT_EQ(dStatus::Create(), nullptr);
  EXPECT_EQ(HRTimer::Create(), nullptr);
  EXPECT_EQ(dStatus::CI().Create(), nullptr);
}

TEST(OutOfMemory, OperatorIsNotStarted) {
  IdleOperator op;
  {
    const AllocationFailure failure;
    EXPECT_FALSE(op.RunAsThread(0));
    EXPECT_FALSE(op.IsRunning());
  }
  EXPECT_TRUE(op.RunAsThread(0));
}

}  // namespace
