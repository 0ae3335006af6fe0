#ifndef VORL_TESTS_APPS_CLI_TOOL_H
#define VORL_TESTS_APPS_CLI_TOOL_H

/// @file
/// Running the command-line tool as its users do.

#include <csignal>
#include <functional>
#include <sstream>
#include <string>
#include <vector>

namespace cli_test {

using Arguments = std::vector<std::string>;

/// What a run of the tool left behind. A run on a terminal shows everything in `errors`.
struct Outcome {
  int code = -1;       ///< the exit code; 128 more than the signal that ended it, if one did
  std::string output;  ///< standard output
  std::string errors;  ///< standard error
};

/// What a run meets. Without anything else, standard output and error are pipes. Windows knows
/// pipes and files only, and asking for more throws; line ends read as '\n' there too.
struct Conditions {
  int terminalColumns = 0;             ///< more than 0: a terminal of this width instead of pipes
  std::string terminalKind = "xterm";  ///< TERM on a terminal
  std::string standardOutput;          ///< a file to be opened instead of a pipe
  long largestFile = -1;               ///< bytes that a file may grow to; negative: no limit
  bool interruptsIgnored = false;      ///< as for a background job of a script
  int signal = SIGINT;                 ///< sent once `when` holds
  std::function<bool(const Outcome& soFar)> when;
};

/// Runs the tool to its end. After a minute it is killed.
Outcome RunTool(const Arguments& arguments, const Conditions& conditions = {});

/// The lines of a text, without their ends.
inline std::vector<std::string> Lines(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream stream(text);
  for (std::string line; std::getline(stream, line);) {
    lines.push_back(line);
  }
  return lines;
}

}  // namespace cli_test

#endif
