#ifndef VORL_APPS_CLI_CONSOLE_H
#define VORL_APPS_CLI_CONSOLE_H

/// @file
/// What a command says while it runs.

#include <cli/ProgressBar.h>
#include <study/Progress.h>

#include <string>

namespace cli {

/// The two ways to the user: results on standard output, everything else on standard error.
class Console {
 public:
  /// `quiet`: neither a progress bar nor notes.
  explicit Console(bool quiet) : m_quiet(quiet), m_bar(!quiet) {}

  /// Shows how far the operation is, and cancels it when the user has asked for the end. It must
  /// not outlive the console.
  study::Progress GetProgress();
  /// Something the user should know, as a line on standard error: "vorl: note: ...".
  void Note(const std::string& text);
  /// Results, written as they are. Throws `study::Error` when they can't be written.
  void Print(const std::string& text);

 private:
  bool m_quiet;
  ProgressBar m_bar;
};

}  // namespace cli

#endif
