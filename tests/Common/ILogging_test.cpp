#include <vorl/Common/ILogging.h>

#include <gtest/gtest.h>
#include <tests/Support/VirtualSlot.h>
#include <vorl/Common/LogContext.h>

#include <type_traits>

namespace {

class Target : public LogTarget {
 public:
  using LogTarget::PrintLogStack;
};

TEST(ILogging, WantsErrorsWarningsAndInfosAtFirst) {
  EXPECT_EQ(ILogging().GetLevelMask(), 7);
  EXPECT_EQ(LogTarget().GetLevelMask(), 7);
}

TEST(ILogging, LevelBitsAreFixed) {
  EXPECT_EQ(LogLevel_Error, 1);
  EXPECT_EQ(LogLevel_Warning, 2);
  EXPECT_EQ(LogLevel_Info, 4);
  EXPECT_EQ(LogLevel_Entry, 8);
  EXPECT_EQ(LogLevel_Exit, 16);
}

TEST(ILogging, KeepsTheMaskItIsGiven) {
  ILogging target;
  target.SetLevelMask(0xffff);
  EXPECT_EQ(target.GetLevelMask(), 0xffff);
  target.SetLevelMask(0);
  EXPECT_EQ(target.GetLevelMask(), 0);
}

TEST(ILogging, CopiesTakeTheMask) {
  ILogging source;
  source.SetLevelMask(24);
  const ILogging copy(source);
  ILogging assigned;
  assigned = source;
  EXPECT_EQ(copy.GetLevelMask(), 24);
  EXPECT_EQ(assigned.GetLevelMask(), 24);

  LogTarget target;
  target.SetLevelMask(9);
  const LogTarget targetCopy(target);
  LogTarget targetAssigned;
  targetAssigned = target;
  EXPECT_EQ(targetCopy.GetLevelMask(), 9);
  EXPECT_EQ(targetAssigned.GetLevelMask(), 9);
}

TEST(ILogging, VirtualFunctionsStandInOrder) {
  EXPECT_TRUE(std::has_virtual_destructor_v<ILogging>);  // places 0 and 1
  EXPECT_EQ(VirtualSlot(&ILogging::OnEntry), 2u);
  EXPECT_EQ(VirtualSlot(&ILogging::OnExit), 3u);
  EXPECT_EQ(VirtualSlot(&ILogging::OnError), 4u);
  EXPECT_EQ(VirtualSlot(&ILogging::OnWarning), 5u);
  EXPECT_EQ(VirtualSlot(&ILogging::OnInfo), 6u);
  EXPECT_EQ(VirtualSlot(&LogTarget::OnEntry), 2u);
  EXPECT_EQ(VirtualSlot(&LogTarget::OnInfo), 6u);
}

TEST(ILogging, ItsOwnOperationsLeaveTheContextAlone) {
  LogContext context("title", "file", 12, false);
  ILogging plain;
  Target target;
  for (ILogging* logging : {&plain, static_cast<ILogging*>(&target)}) {
    logging->OnEntry(&context);
    logging->OnExit(&context);
    logging->OnError(&context);
    logging->OnWarning(&context);
    logging->OnInfo(&context);
    logging->OnInfo(nullptr);
  }
  target.PrintLogStack(&context);
  target.PrintLogStack(nullptr);
  EXPECT_STREQ(context.GetTitle(), "title");
  EXPECT_STREQ(context.GetMsg(), "");
  EXPECT_EQ(context.GetCode(), 0);
  EXPECT_EQ(context.GetLineNo(), 12u);
}

}  // namespace
