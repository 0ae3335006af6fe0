// The stack of open contexts, and the entry and exit records.
#include <gtest/gtest.h>
#include <tests/Support/RecordingTarget.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>

#include <memory>
#include <string>
#include <vector>

#if !defined(_WIN32)
#include <sys/wait.h>
#include <unistd.h>
#endif

namespace {

using Trail = std::vector<std::string>;

unsigned long Depth() {
  return GetLogManager().GetLogThread()->GetLogDepth();
}

TEST(LogStack, NestedContextsStandInnermostFirst) {
  ASSERT_EQ(Depth(), 0u);
  {
    const LogContext outer("outer", "f", 1, true);
    EXPECT_EQ(outer.GetLogDepth(), 1u);
    {
      const LogContext inner("inner", "f", 2, true);
      EXPECT_EQ(inner.GetLogDepth(), 2u);
      const std::list<LogContext*> expected{const_cast<LogContext*>(&inner),
                                            const_cast<LogContext*>(&outer)};
      EXPECT_EQ(inner.GetLogStack(), expected);
    }
    EXPECT_EQ(outer.GetLogDepth(), 1u);
  }
  EXPECT_EQ(Depth(), 0u);
}

TEST(LogStack, EntriesAndExitsArePaired) {
  const RecordingTarget target;
  {
    const LogContext outer("outer", "f", 1, true);
    const LogContext inner("inner", "f", 2, true);
  }
  EXPECT_EQ(target.Trail(), (Trail{"entry outer", "entry inner", "exit inner", "exit outer"}));
}

TEST(LogStack, EntryIsLoggedBeforeThePushAndExitAfterThePop) {
  const RecordingTarget target;
  { const LogContext context("t", "f", 1, true); }
  ASSERT_EQ(target.records.size(), 2u);
  EXPECT_EQ(target.records[0].depth, 0u);
  EXPECT_EQ(target.records[1].depth, 0u);
}

TEST(LogStack, EntryRecordCarriesTheConstructionLine) {
  const RecordingTarget target;
  const LogContext context("t", "f", 12, true);
  ASSERT_EQ(target.records.size(), 1u);
  EXPECT_EQ(target.records[0].line, 12u);
  EXPECT_EQ(target.records[0].code, 0);
  EXPECT_EQ(target.records[0].message, "");
}

TEST(LogStack, ContextWithoutEntryLeavesNoTrace) {
  const RecordingTarget target;
  {
    const LogContext context("t", "f", 1, false);
    EXPECT_EQ(Depth(), 0u);
  }
  EXPECT_EQ(Depth(), 0u);
  EXPECT_TRUE(target.records.empty());
}

TEST(LogStack, ContextWithoutEntryEndsInsideAnotherWithoutTrace) {
  const RecordingTarget target;
  {
    const LogContext outer("outer", "f", 1, true);
    { const LogContext inner("inner", "f", 2, false); }
    EXPECT_EQ(Depth(), 1u);
  }
  EXPECT_EQ(target.Trail(), (Trail{"entry outer", "exit outer"}));
}

TEST(LogStack, ContextThatEndsBeforeAnInnerOneLogsNoExitAndLeavesNothingBehind) {
  const RecordingTarget target;
  auto outer = std::make_unique<LogContext>("outer", "f", 1, true);
  auto inner = std::make_unique<LogContext>("inner", "f", 2, true);
  outer.reset();
  EXPECT_EQ(Depth(), 1u);
  EXPECT_EQ(inner->GetLogStack().front(), inner.get());
  inner.reset();
  EXPECT_EQ(Depth(), 0u);
  EXPECT_EQ(target.Trail(), (Trail{"entry outer", "entry inner", "exit inner"}));
}

TEST(LogStack, CopiesOfAContextDoNotStandOnIt) {
  const RecordingTarget target;
  {
    const LogContext context("t", "f", 1, true);
    {
      const LogContext copy(context);
      LogContext assigned;
      assigned = context;
      EXPECT_EQ(Depth(), 1u);
    }
    EXPECT_EQ(Depth(), 1u);
    EXPECT_EQ(target.Trail(), Trail{"entry t"});
  }
  EXPECT_EQ(target.Trail(), (Trail{"entry t", "exit t"}));
}

TEST(LogStack, TargetWithTheFirstMaskReceivesNoEntriesAndExits) {
  const RecordingTarget target(7);
  {
    LogContext context("t", "f", 1, true);
    context.Error(1, "e");
    context.Warning(1, "w");
    context.Info("i");
  }
  EXPECT_EQ(target.Trail(), (Trail{"error t", "warning t", "info t"}));
}

TEST(LogStack, TargetWithTheFullMaskReceivesAllFive) {
  const RecordingTarget target(31);
  {
    LogContext context("t", "f", 1, true);
    context.Error(1, "e");
    context.Warning(1, "w");
    context.Info("i");
  }
  EXPECT_EQ(target.Trail(), (Trail{"entry t", "error t", "warning t", "info t", "exit t"}));
}

TEST(LogStack, EachMaskBitAdmitsItsKindAlone) {
  struct {
    unsigned short mask;
    const char* trail;
  } const cases[] = {
      {1, "error t"}, {2, "warning t"}, {4, "info t"}, {8, "entry t"}, {16, "exit t"},
  };
  for (const auto& expected : cases) {
    SCOPED_TRACE(expected.mask);
    const RecordingTarget target(expected.mask);
    {
      LogContext context("t", "f", 1, true);
      context.Error(1, "e");
      context.Warning(1, "w");
      context.Info("i");
    }
    EXPECT_EQ(target.Trail(), Trail{expected.trail});
  }
}

TEST(LogStack, MaskZeroAdmitsNothing) {
  const RecordingTarget target(0);
  {
    LogContext context("t", "f", 1, true);
    context.Error(1, "e");
  }
  EXPECT_TRUE(target.records.empty());
}

#if !defined(_WIN32)
// A child process has the identifier of its own, and its contexts stand on a stack of its own.
TEST(LogStack, ForkedChildHasItsOwnRecord) {
  const LogContext open("open", "f", 1, true);
  const pid_t child = fork();
  ASSERT_GE(child, 0);
  if (child == 0) {
    const LogContext context("child", "f", 2, true);
    const bool own = context.GetThreadID() == static_cast<unsigned long>(getpid()) &&
                     context.GetLogDepth() == 1 && open.GetLogDepth() == 1;
    _exit(own ? 0 : 1);
  }
  int status = 0;
  ASSERT_EQ(waitpid(child, &status, 0), child);
  EXPECT_TRUE(WIFEXITED(status));
  EXPECT_EQ(WEXITSTATUS(status), 0);
  EXPECT_EQ(open.GetLogDepth(), 1u);
}
#endif

}  // namespace
