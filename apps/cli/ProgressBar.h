#ifndef VORL_APPS_CLI_PROGRESSBAR_H
#define VORL_APPS_CLI_PROGRESSBAR_H

/// @file
/// How far a command has come, for a person who watches.

#include <chrono>
#include <string>

namespace cli {

/// One line on standard error that is drawn over and over, and gone at the end. Where standard
/// error is no terminal (a pipe, a file) nothing is ever written.
class ProgressBar {
 public:
  /// `wanted` false: nothing is drawn on terminals either.
  explicit ProgressBar(bool wanted);
  ~ProgressBar() { Clear(); }
  ProgressBar(const ProgressBar&) = delete;
  ProgressBar& operator=(const ProgressBar&) = delete;

  /// Draws the bar, unless it was drawn a moment ago with the same `what`: work that is over soon
  /// is named all the same. `fraction` is from 0 to 1.
  void Show(double fraction, const std::string& what);
  /// Takes the bar away, so that other text can be written.
  void Clear();

 private:
  using Clock = std::chrono::steady_clock;

  bool m_enabled;
  std::string m_what;
  std::string m_shown;
  Clock::time_point m_shownAt{};
};

/// "[######------]  50% reading", cut to `columns` characters.
std::string ProgressText(double fraction, const std::string& what, int columns);

}  // namespace cli

#endif
