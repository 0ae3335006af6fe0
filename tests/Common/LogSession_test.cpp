#include <gtest/gtest.h>
#include <tests/Support/RecordingTarget.h>
#include <vorl/Common/LogManager.h>

#include <functional>
#include <string>
#include <utility>
#include <vector>

namespace {

using Trail = std::vector<std::string>;

class OpenSession : public LogSession {
 public:
  using LogSession::LogEntry;
  using LogSession::LogError;
  using LogSession::LogExit;
  using LogSession::LogInfo;
  using LogSession::LogWarning;
};

// Writes its name into a shared trail, and may do more.
class NamedTarget : public LogTarget {
 public:
  NamedTarget(std::string name, Trail& trail) : m_name(std::move(name)), m_trail(trail) {
    SetLevelMask(31);
  }
  void OnEntry(LogContext*) override { Note("entry"); }
  void OnExit(LogContext*) override { Note("exit"); }
  void OnError(LogContext*) override { Note("error"); }
  void OnWarning(LogContext*) override { Note("warning"); }
  void OnInfo(LogContext*) override { Note("info"); }

  std::function<void()> more;

 private:
  void Note(const char* kind) {
    m_trail.push_back(m_name + " " + kind);
    if (more) {
      more();
    }
  }

  std::string m_name;
  Trail& m_trail;
};

class LogSessionTest : public testing::Test {
 protected:
  Trail trail;
  NamedTarget a{"a", trail};
  NamedTarget b{"b", trail};
  NamedTarget c{"c", trail};
  OpenSession session;
  LogContext context{"t", "f", 1, false};
};

TEST_F(LogSessionTest, IdentifiersCountUp) {
  const LogSession first;
  const LogSession second;
  EXPECT_EQ(second.GetID(), first.GetID() + 1);
}

TEST_F(LogSessionTest, EachKindReachesItsOperation) {
  session.AddLogTarget(&a);
  session.LogInfo(&context);
  session.LogError(&context);
  session.LogWarning(&context);
  session.LogEntry(&context);
  session.LogExit(&context);
  EXPECT_EQ(trail, (Trail{"a info", "a error", "a warning", "a entry", "a exit"}));
}

TEST_F(LogSessionTest, TargetsAreCalledInTheOrderOfAddition) {
  session.AddLogTarget(&b);
  session.AddLogTarget(&a);
  session.LogInfo(&context);
  EXPECT_EQ(trail, (Trail{"b info", "a info"}));
}

TEST_F(LogSessionTest, EachTargetIsAskedForItsOwnMask) {
  a.SetLevelMask(LogLevel_Error);
  b.SetLevelMask(LogLevel_Info);
  session.AddLogTarget(&a);
  session.AddLogTarget(&b);
  session.LogInfo(&context);
  session.LogError(&context);
  EXPECT_EQ(trail, (Trail{"b info", "a error"}));
}

TEST_F(LogSessionTest, NullContextsAndEmptySessionsDoNothing) {
  session.LogInfo(&context);
  session.AddLogTarget(&a);
  session.LogInfo(nullptr);
  session.LogError(nullptr);
  session.LogWarning(nullptr);
  session.LogEntry(nullptr);
  session.LogExit(nullptr);
  EXPECT_TRUE(trail.empty());
}

TEST_F(LogSessionTest, NullTargetsAreIgnored) {
  session.AddLogTarget(nullptr);
  session.RemoveLogTarget(nullptr);
  session.AddLogTarget(&a);
  session.RemoveLogTarget(nullptr);
  session.LogInfo(&context);
  EXPECT_EQ(trail, Trail{"a info"});
}

TEST_F(LogSessionTest, TargetAddedTwiceReceivesTwiceAndIsRemovedAtOnce) {
  session.AddLogTarget(&a);
  session.AddLogTarget(&b);
  session.AddLogTarget(&a);
  session.LogInfo(&context);
  EXPECT_EQ(trail, (Trail{"a info", "b info", "a info"}));
  trail.clear();
  session.RemoveLogTarget(&a);
  session.LogInfo(&context);
  EXPECT_EQ(trail, Trail{"b info"});
}

TEST_F(LogSessionTest, RemovesAllTargets) {
  session.AddLogTarget(&a);
  session.AddLogTarget(&b);
  session.RemoveAllLogTargets();
  session.LogInfo(&context);
  EXPECT_TRUE(trail.empty());
}

TEST_F(LogSessionTest, CopiesTakeTargetsAndIdentifier) {
  session.AddLogTarget(&a);
  OpenSession copy(session);
  OpenSession assigned;
  assigned = session;
  EXPECT_EQ(copy.GetID(), session.GetID());
  EXPECT_EQ(assigned.GetID(), session.GetID());
  session.RemoveAllLogTargets();
  copy.LogInfo(&context);
  assigned.LogError(&context);
  EXPECT_EQ(trail, (Trail{"a info", "a error"}));
}

TEST_F(LogSessionTest, TargetMayRemoveItselfDuringItsCall) {
  a.more = [&] { session.RemoveLogTarget(&a); };
  session.AddLogTarget(&a);
  session.AddLogTarget(&b);
  session.AddLogTarget(&a);
  session.LogInfo(&context);
  EXPECT_EQ(trail, (Trail{"a info", "b info"})) << "its second entry is gone as well";
}

TEST_F(LogSessionTest, TargetMayRemoveTheNextOneDuringItsCall) {
  a.more = [&] { session.RemoveLogTarget(&b); };
  session.AddLogTarget(&a);
  session.AddLogTarget(&b);
  session.AddLogTarget(&c);
  session.LogInfo(&context);
  EXPECT_EQ(trail, (Trail{"a info", "c info"}));
}

TEST_F(LogSessionTest, TargetMayRemoveAllDuringItsCall) {
  a.more = [&] { session.RemoveAllLogTargets(); };
  session.AddLogTarget(&a);
  session.AddLogTarget(&b);
  session.LogInfo(&context);
  EXPECT_EQ(trail, Trail{"a info"});
}

TEST_F(LogSessionTest, TargetAddedDuringACallReceivesTheNextRecord) {
  a.more = [&] { session.AddLogTarget(&b); };
  session.AddLogTarget(&a);
  session.LogInfo(&context);
  EXPECT_EQ(trail, Trail{"a info"});
  a.more = nullptr;
  session.LogInfo(&context);
  EXPECT_EQ(trail, (Trail{"a info", "a info", "b info"}));
}

// A target may itself use methods that report.
TEST(LogSession, TargetMayReportDuringItsCall) {
  Trail trail;
  NamedTarget target("a", trail);
  target.more = [&] {
    target.more = nullptr;
    LogContext("inner", "f", 1, true).Warning(1, "w");
  };
  GetLogManager().AddLogTarget(&target, nullptr);
  LogContext("outer", "f", 1, false).Error(1, "e");
  GetLogManager().RemoveLogTarget(&target);
  EXPECT_EQ(trail, (Trail{"a error", "a entry", "a warning", "a exit"}));
}

}  // namespace
