#include <vorl/Common/LogManager.h>

#include <gtest/gtest.h>
#include <tests/Support/RecordingTarget.h>
#include <vorl/Common/HRTimer.h>

#include <cstdlib>
#include <memory>
#include <string>
#include <thread>
#include <type_traits>

#if defined(_WIN32)
#include <windows.h>
#else
#include <sys/syscall.h>
#include <unistd.h>
#endif

namespace {

unsigned long CurrentProcess() {
#if defined(_WIN32)
  return GetCurrentProcessId();
#else
  return static_cast<unsigned long>(getpid());
#endif
}

long CurrentThread() {
#if defined(_WIN32)
  return static_cast<long>(GetCurrentThreadId());
#else
  return static_cast<long>(syscall(SYS_gettid));
#endif
}

TEST(LogManager, IsOneForTheProcess) {
  EXPECT_EQ(&GetLogManager(), &GetLogManager());
}

TEST(LogManager, DefaultSessionIsFoundByNullNameAndIdentifier) {
  LogSession* session = GetLogManager().GetSession("DEFAULT");
  ASSERT_NE(session, nullptr);
  EXPECT_EQ(session->GetID(), 0u);
  EXPECT_EQ(GetLogManager().GetSession(nullptr), session);
  EXPECT_EQ(GetLogManager().GetSession(0), session);
  EXPECT_EQ(GetLogManager().GetSession(-5), session) << "negative identifiers are taken as 0";
}

TEST(LogManager, UnknownSessionsAreNull) {
  EXPECT_EQ(GetLogManager().GetSession("nobody"), nullptr);
  EXPECT_EQ(GetLogManager().GetSession(1000000), nullptr);
  EXPECT_EQ(GetLogManager().GetSession(""), nullptr);
}

TEST(LogManager, SessionNamesAreCaseSensitiveAndWhole) {
  EXPECT_EQ(GetLogManager().GetSession("default"), nullptr);
  EXPECT_EQ(GetLogManager().GetSession("DEFAUL"), nullptr);
  EXPECT_EQ(GetLogManager().GetSession("DEFAULT "), nullptr);
}

TEST(LogManager, RegisterFindsAKnownSessionAndCreatesAnUnknownOne) {
  LogManager& manager = GetLogManager();
  LogSession* created = manager.RegisterSession("registered");
  ASSERT_NE(created, nullptr);
  EXPECT_EQ(manager.RegisterSession("registered"), created);
  EXPECT_EQ(manager.GetSession("registered"), created);
  EXPECT_EQ(manager.GetSession(static_cast<int>(created->GetID())), created);
  EXPECT_EQ(manager.RegisterSession(nullptr), manager.GetSession("DEFAULT"));
}

// Session identifiers count through the whole process, so this needs one of its own.
TEST(LogManagerDeathTest, FirstAddedSessionOfAProcessHasIdentifierOne) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  const auto firstSession = [] {
    LogTarget target;
    GetLogManager().AddLogTarget(&target, "X");
    LogSession* session = GetLogManager().GetSession("X");
    const bool ok = session != nullptr && session->GetID() == 1 &&
                    GetLogManager().GetSession(1) == session && LogSession().GetID() == 2;
    std::exit(ok ? 0 : 1);
  };
  EXPECT_EXIT(firstSession(), testing::ExitedWithCode(0), "");
}

TEST(LogManager, ContextsLogIntoTheDefaultSessionOnly) {
  RecordingTarget target(31, "elsewhere");
  { LogContext("t", "f", 1, true).Error(1, "e"); }
  EXPECT_TRUE(target.records.empty());
  GetLogManager().AddLogTarget(&target, nullptr);
  { LogContext("t", "f", 1, false).Error(1, "e"); }
  EXPECT_EQ(target.records.size(), 1u);
}

TEST(LogManager, RemovesATargetFromEverySession) {
  RecordingTarget target(31, "elsewhere");
  GetLogManager().AddLogTarget(&target, "DEFAULT");
  GetLogManager().RemoveLogTarget(&target);
  { LogContext("t", "f", 1, false).Error(1, "e"); }
  EXPECT_TRUE(target.records.empty());

  // It is gone from the other session as well: added once, it receives once.
  GetLogManager().GetSession("DEFAULT")->AddLogTarget(&target);
  { LogContext("t", "f", 1, false).Error(1, "e"); }
  EXPECT_EQ(target.records.size(), 1u);
}

TEST(LogManager, IgnoresNullTargets) {
  GetLogManager().AddLogTarget(nullptr, "DEFAULT");
  GetLogManager().RemoveLogTarget(nullptr);
  LogContext("t", "f", 1, true).Error(1, "e");
}

TEST(LogManager, AddingANullTargetStillCreatesTheSession) {
  GetLogManager().AddLogTarget(nullptr, "empty session");
  EXPECT_NE(GetLogManager().GetSession("empty session"), nullptr);
}

TEST(LogManager, LogRecordIsKeyedByTheProcessAndTheManagerByItsThread) {
  EXPECT_EQ(GetLogManager().GetLogThread()->GetThreadId(), CurrentProcess());
  long maker = 0;
  std::unique_ptr<LogManager> manager;
  std::thread([&] {
    maker = CurrentThread();
    manager = std::make_unique<LogManager>();
  }).join();
  EXPECT_EQ(manager->GetPID(), maker);
  EXPECT_NE(manager->GetPID(), GetLogManager().GetPID());
  EXPECT_EQ(manager->GetLogThread()->GetThreadId(), CurrentProcess());
}

TEST(LogManager, AllThreadsOfAProcessShareOneRecord) {
  LogThread* here = GetLogManager().GetLogThread();
  LogThread* there = nullptr;
  std::thread([&] { there = GetLogManager().GetLogThread(); }).join();
  EXPECT_EQ(here, there);
  EXPECT_EQ(LogContext().GetThreadID(), here->GetThreadId());
}

TEST(LogManager, AnotherManagerHasItsOwnDefaultSessionButLogsIntoTheGlobalOne) {
  LogManager other;
  LogSession* session = other.GetSession("DEFAULT");
  ASSERT_NE(session, nullptr);
  EXPECT_NE(session, GetLogManager().GetSession("DEFAULT"));
  EXPECT_NE(session->GetID(), 0u);
  EXPECT_NE(other.GetLogThread(), GetLogManager().GetLogThread());
  EXPECT_EQ(other.GetLogThread()->GetLogSession(), GetLogManager().GetSession(0));
}

TEST(LogManager, CopiesShareSessionsAndRecords) {
  auto source = std::make_unique<LogManager>();
  LogSession* session = source->RegisterSession("shared");
  LogThread* record = source->GetLogThread();
  const LogManager copy(*source);
  LogManager assigned;
  assigned = *source;
  EXPECT_EQ(copy.GetSession("shared"), session);
  EXPECT_EQ(assigned.GetSession("shared"), session);
  EXPECT_EQ(assigned.GetLogThread(), record);
  EXPECT_EQ(copy.GetPID(), source->GetPID());

  source.reset();
  EXPECT_EQ(copy.GetSession("shared")->GetID(), session->GetID()) << "shared, not left dangling";
  EXPECT_EQ(assigned.GetLogThread()->GetThreadId(), CurrentProcess());
}

TEST(LogManager, DestructionLeavesTargetsToTheirOwners) {
  LogTarget target;
  {
    LogManager manager;
    manager.AddLogTarget(&target, "x");
  }
  EXPECT_EQ(target.GetLevelMask(), 7);
}

TEST(LogManager, OnlyTheDestructorsAreVirtual) {
  EXPECT_TRUE(std::has_virtual_destructor_v<LogManager>);
  EXPECT_TRUE(std::has_virtual_destructor_v<LogSession>);
  EXPECT_TRUE(std::has_virtual_destructor_v<LogThread>);
}

TEST(LogThread, NewRecordIsEmptyAndLogsIntoTheDefaultSession) {
  const double before = HRTimer().GetTime();
  const LogThread record;
  EXPECT_EQ(record.GetThreadId(), CurrentProcess());
  EXPECT_GE(record.GetBaseTime(), before);
  EXPECT_LE(record.GetBaseTime(), HRTimer().GetTime());
  EXPECT_EQ(record.GetLogSession(), GetLogManager().GetSession(0));
  EXPECT_EQ(record.GetLogDepth(), 0u);
}

TEST(LogThread, CopiesTakeTheStack) {
  const LogContext context("t", "f", 1, true);
  const LogThread& source = *GetLogManager().GetLogThread();
  const LogThread copy(source);
  LogThread assigned;
  assigned = source;
  EXPECT_EQ(copy.GetLogDepth(), 1u);
  EXPECT_EQ(assigned.GetLogDepth(), 1u);
  EXPECT_EQ(copy.GetBaseTime(), source.GetBaseTime());
  EXPECT_EQ(assigned.GetBaseTime(), source.GetBaseTime());
  EXPECT_EQ(copy.GetThreadId(), source.GetThreadId());
  EXPECT_EQ(copy.GetLogSession(), source.GetLogSession());
}

}  // namespace
