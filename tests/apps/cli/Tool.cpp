#include "Tool.h"

#include <array>
#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <stdexcept>

#include <fcntl.h>
#include <poll.h>
#include <sys/ioctl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace cli_test {
namespace {

using Clock = std::chrono::steady_clock;

constexpr std::chrono::seconds kLongestRun(60);
constexpr int kPollMilliseconds = 5;

/// Two ends of a pipe or a terminal: `mine` is read here, `theirs` is written by the tool.
struct Channel {
  int mine = -1;
  int theirs = -1;
};

Channel OpenPipe() {
  std::array<int, 2> ends{};
  if (pipe2(ends.data(), O_CLOEXEC) != 0) {
    throw std::runtime_error("no pipe");
  }
  return {ends[0], ends[1]};
}

Channel OpenTerminal(int columns) {
  Channel channel;
  channel.mine = posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC);
  if (channel.mine < 0 || grantpt(channel.mine) != 0 || unlockpt(channel.mine) != 0) {
    throw std::runtime_error("no terminal");
  }
  channel.theirs = open(ptsname(channel.mine), O_RDWR | O_NOCTTY | O_CLOEXEC);
  winsize size{};
  size.ws_col = static_cast<unsigned short>(columns);
  size.ws_row = 24;
  ioctl(channel.theirs, TIOCSWINSZ, &size);
  return channel;
}

/// In the child: never returns.
[[noreturn]] void Become(const Arguments& arguments, const Conditions& conditions, int output,
                         int errors) {
  dup2(output, STDOUT_FILENO);
  dup2(errors, STDERR_FILENO);
  std::signal(SIGINT, conditions.interruptsIgnored ? SIG_IGN : SIG_DFL);
  std::signal(SIGPIPE, SIG_DFL);
  if (conditions.largestFile >= 0) {
    const rlimit limit{static_cast<rlim_t>(conditions.largestFile),
                       static_cast<rlim_t>(conditions.largestFile)};
    setrlimit(RLIMIT_FSIZE, &limit);
  }
  setenv("TERM", conditions.terminalKind.c_str(), 1);
  std::vector<char*> pointers{const_cast<char*>(VORL_TOOL)};
  for (const std::string& argument : arguments) {
    pointers.push_back(const_cast<char*>(argument.c_str()));
  }
  pointers.push_back(nullptr);
  execv(VORL_TOOL, pointers.data());
  _exit(127);
}

/// Appends what can be read; false at the end.
bool ReadSome(int file, std::string& text) {
  std::array<char, 4096> buffer{};
  const ssize_t count = read(file, buffer.data(), buffer.size());
  if (count > 0) {
    text.append(buffer.data(), static_cast<std::size_t>(count));
  }
  return count > 0 || (count < 0 && errno == EINTR);
}

/// Reads both channels until they end; sends the signal when its time has come.
void Attend(pid_t process, const Conditions& conditions, int output, int errors, Outcome& outcome) {
  std::array<pollfd, 2> files{pollfd{output, POLLIN, 0}, pollfd{errors, POLLIN, 0}};
  const Clock::time_point end = Clock::now() + kLongestRun;
  bool signalled = !conditions.when;
  while (files[0].fd >= 0 || files[1].fd >= 0) {
    poll(files.data(), files.size(), kPollMilliseconds);
    if (files[0].revents != 0 && !ReadSome(output, outcome.output)) {
      files[0].fd = -1;
    }
    if (files[1].revents != 0 && !ReadSome(errors, outcome.errors)) {
      files[1].fd = -1;
    }
    if (!signalled && conditions.when(outcome)) {
      kill(process, conditions.signal);
      signalled = true;
    }
    if (Clock::now() > end) {
      kill(process, SIGKILL);
    }
  }
}

int CodeOf(pid_t process) {
  int status = 0;
  while (waitpid(process, &status, 0) < 0 && errno == EINTR) {
  }
  return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
}

Channel OpenOutput(const Conditions& conditions) {
  if (conditions.standardOutput.empty()) {
    return OpenPipe();
  }
  return {-1, open(conditions.standardOutput.c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, 0600)};
}

}  // namespace

Outcome RunTool(const Arguments& arguments, const Conditions& conditions) {
  const bool onTerminal = conditions.terminalColumns > 0;
  const Channel errors = onTerminal ? OpenTerminal(conditions.terminalColumns) : OpenPipe();
  const Channel output = onTerminal ? Channel{-1, dup(errors.theirs)} : OpenOutput(conditions);
  const pid_t process = fork();
  if (process == 0) {
    Become(arguments, conditions, output.theirs, errors.theirs);
  }
  close(output.theirs);
  close(errors.theirs);
  Outcome outcome;
  Attend(process, conditions, output.mine, errors.mine, outcome);
  outcome.code = CodeOf(process);
  close(output.mine);
  close(errors.mine);
  return outcome;
}

}  // namespace cli_test
