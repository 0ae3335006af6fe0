#ifndef VORL_APPS_CLI_WATCH_H
#define VORL_APPS_CLI_WATCH_H

/// @file
/// Running operators so that they can be watched and stopped.

#include <study/Progress.h>
#include <vorl/Common/OpBase.h>

#include <string>

namespace cli {

/// Throws `study::Error` ("can't <what>: ...") when the operator has failed.
void CheckStatus(const OpBase& op, const std::string& what);

/// Runs an operator in its own thread, so that its progress can be shown as `doing` and it can be
/// stopped. Throws `study::Cancelled` once it has stopped on request.
void RunWatched(OpBase& op, const study::Progress& progress, const std::string& doing);

}  // namespace cli

#endif
