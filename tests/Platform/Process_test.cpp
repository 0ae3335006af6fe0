#include <vorl/Platform/detail/Process.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <thread>

#if !defined(_WIN32)
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>
#endif

namespace {

using vorl_detail::CurrentProcessId;
using vorl_detail::CurrentThreadId;

TEST(Process, ThreadsShareTheProcessAndHaveTheirOwnIdentifier) {
  std::uint32_t process = 0;
  std::uint32_t thread = 0;
  std::thread([&] {
    process = CurrentProcessId();
    thread = CurrentThreadId();
  }).join();
  EXPECT_EQ(process, CurrentProcessId());
  EXPECT_NE(thread, CurrentThreadId());
}

#if !defined(_WIN32)
TEST(Process, IdentifiersAreTheSystems) {
  EXPECT_EQ(CurrentProcessId(), static_cast<std::uint32_t>(getpid()));
  EXPECT_EQ(CurrentThreadId(), static_cast<std::uint32_t>(syscall(SYS_gettid)));
}

TEST(Process, ForkedChildHasItsOwnIdentifier) {
  const std::uint32_t parent = CurrentProcessId();
  const pid_t child = fork();
  ASSERT_GE(child, 0);
  if (child == 0) {
    _exit(CurrentProcessId() == static_cast<std::uint32_t>(getpid()) ? 0 : 1);
  }
  int status = 0;
  ASSERT_EQ(waitpid(child, &status, 0), child);
  EXPECT_TRUE(WIFEXITED(status));
  EXPECT_EQ(WEXITSTATUS(status), 0);
  EXPECT_EQ(CurrentProcessId(), parent);
}
#endif

}  // namespace
