#ifndef VORL_APPS_CLI_APPLICATION_H
#define VORL_APPS_CLI_APPLICATION_H

/// @file
/// The command-line tool as a whole.

#include <string>
#include <vector>

namespace cli {

/// What the tool returns to its caller.
enum ExitCode { kExitSuccess = 0, kExitFailure = 1, kExitUsage = 2 };

/// Runs the tool with the arguments that follow the program's name. Failures are told on standard
/// error, each line beginning with "vorl: ".
int RunApplication(const std::vector<std::string>& arguments);

}  // namespace cli

#endif
