#ifndef VORL_APPS_CLI_INTERRUPT_H
#define VORL_APPS_CLI_INTERRUPT_H

/// @file
/// Ending early, on Ctrl-C and its like.

namespace cli {

/// From now on a request to end (Ctrl-C, a closed terminal, a termination signal) is only noted,
/// so that the operation under way can tidy up; a request that the caller had switched off stays
/// so. Writing into a closed pipe or beyond a file size limit becomes an error of that write
/// instead of a sudden end, for the same reason.
void CatchInterrupts();

/// True once a request to end has come.
bool IsInterrupted();

}  // namespace cli

#endif
