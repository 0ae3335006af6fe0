#include "Tool.h"

#include <array>
#include <memory>
#include <stdexcept>
#include <string>
#include <thread>

#include <windows.h>

namespace cli_test {
namespace {

constexpr DWORD kLongestRunMilliseconds = 60000;

struct HandleCloser {
  void operator()(HANDLE handle) const { CloseHandle(handle); }
};
using Handle = std::unique_ptr<void, HandleCloser>;

/// Makes a handle that the tool inherits.
SECURITY_ATTRIBUTES Inherited() {
  return {sizeof(SECURITY_ATTRIBUTES), nullptr, TRUE};
}

/// Two ends of a pipe: `mine` is read here, `theirs` is written by the tool.
struct Channel {
  Handle mine;
  Handle theirs;
};

Channel OpenPipe() {
  SECURITY_ATTRIBUTES inherited = Inherited();
  HANDLE mine = nullptr;
  HANDLE theirs = nullptr;
  if (!CreatePipe(&mine, &theirs, &inherited, 0)) {
    throw std::runtime_error("no pipe");
  }
  SetHandleInformation(mine, HANDLE_FLAG_INHERIT, 0);
  return {Handle(mine), Handle(theirs)};
}

Handle OpenFile(const char* name, DWORD access, DWORD disposition) {
  SECURITY_ATTRIBUTES inherited = Inherited();
  const HANDLE file = CreateFileA(name, access, FILE_SHARE_READ | FILE_SHARE_WRITE, &inherited,
                                  disposition, FILE_ATTRIBUTE_NORMAL, nullptr);
  if (file == INVALID_HANDLE_VALUE) {
    throw std::runtime_error(std::string("can't open ") + name);
  }
  return Handle(file);
}

Channel OpenOutput(const Conditions& conditions) {
  if (conditions.standardOutput.empty()) {
    return OpenPipe();
  }
  return {nullptr, OpenFile(conditions.standardOutput.c_str(), GENERIC_WRITE, OPEN_ALWAYS)};
}

/// Appends one argument as the system's own rules split the command line again: a backslash counts
/// as itself but before a quotation mark.
void AppendQuoted(std::string& commandLine, const std::string& argument) {
  commandLine += commandLine.empty() ? "\"" : " \"";
  std::size_t backslashes = 0;
  for (const char c : argument) {
    if (c == '"') {
      commandLine.append(backslashes + 1, '\\');
    }
    backslashes = c == '\\' ? backslashes + 1 : 0;
    commandLine += c;
  }
  commandLine.append(backslashes, '\\');
  commandLine += '"';
}

/// Reads to the end of the pipe, with the line ends of a text file turned into '\n'.
std::string ReadText(HANDLE pipe) {
  std::string text;
  std::array<char, 4096> buffer{};
  DWORD count = 0;
  while (ReadFile(pipe, buffer.data(), static_cast<DWORD>(buffer.size()), &count, nullptr) &&
         count > 0) {
    text.append(buffer.data(), count);
  }
  for (std::size_t end = text.find("\r\n"); end != std::string::npos;
       end = text.find("\r\n", end)) {
    text.erase(end, 1);
  }
  return text;
}

/// Starts the tool; its output and errors go into these handles.
Handle Start(const Arguments& arguments, HANDLE output, HANDLE errors) {
  std::string commandLine;
  AppendQuoted(commandLine, VORL_TOOL);
  for (const std::string& argument : arguments) {
    AppendQuoted(commandLine, argument);
  }
  const Handle input = OpenFile("NUL", GENERIC_READ, OPEN_EXISTING);
  STARTUPINFOA startup{};
  startup.cb = sizeof(startup);
  startup.dwFlags = STARTF_USESTDHANDLES;
  startup.hStdInput = input.get();
  startup.hStdOutput = output;
  startup.hStdError = errors;
  PROCESS_INFORMATION process{};
  // An emulated system at times starts no process, for reasons of its own, and then the next one.
  for (int attempts = 3; !CreateProcessA(VORL_TOOL, commandLine.data(), nullptr, nullptr, TRUE, 0,
                                         nullptr, nullptr, &startup, &process);) {
    const DWORD error = GetLastError();
    if (--attempts == 0) {
      throw std::runtime_error("the tool can't be started: error " + std::to_string(error));
    }
    Sleep(500);
  }
  CloseHandle(process.hThread);
  return Handle(process.hProcess);
}

}  // namespace

Outcome RunTool(const Arguments& arguments, const Conditions& conditions) {
  if (conditions.terminalColumns > 0 || conditions.largestFile >= 0 ||
      conditions.interruptsIgnored || conditions.when) {
    throw std::logic_error("no such conditions on Windows");
  }
  Channel output = OpenOutput(conditions);
  Channel errors = OpenPipe();
  const Handle process = Start(arguments, output.theirs.get(), errors.theirs.get());
  output.theirs.reset();
  errors.theirs.reset();
  Outcome outcome;
  std::thread outputReader([&] {
    if (output.mine != nullptr) {
      outcome.output = ReadText(output.mine.get());
    }
  });
  std::thread errorReader([&] { outcome.errors = ReadText(errors.mine.get()); });
  if (WaitForSingleObject(process.get(), kLongestRunMilliseconds) != WAIT_OBJECT_0) {
    TerminateProcess(process.get(), 1);
  }
  outputReader.join();
  errorReader.join();
  DWORD code = 0;
  GetExitCodeProcess(process.get(), &code);
  outcome.code = static_cast<int>(code);
  return outcome;
}

}  // namespace cli_test
