// Objects of an application may be destroyed after everything else and still report.
#include <gtest/gtest.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>

#include <cstdlib>

namespace {

class LogsAtExit {
 public:
  ~LogsAtExit() {
    if (armed) {
      LogContext context("destructor", "f", 1, true);
      context.Error(1, "error");
      const bool ok =
          context.GetLogDepth() == 1 && GetLogManager().GetSession("DEFAULT") != nullptr;
      std::_Exit(ok ? 42 : 1);
    }
  }
  bool armed = false;
};

// Made before, and so destroyed after, every static object of the library.
__attribute__((init_priority(101))) LogsAtExit last;

TEST(LogAtExitDeathTest, LastDestructorMayReport) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  const auto exitArmed = [] {
    last.armed = true;
    std::exit(0);
  };
  EXPECT_EXIT(exitArmed(), testing::ExitedWithCode(42), "");
}

}  // namespace
