#ifndef VORL_APPS_CLI_GREYOPTIONS_H
#define VORL_APPS_CLI_GREYOPTIONS_H

/// @file
/// The options that turn samples into grey levels.

#include <cli/Console.h>
#include <cli/Render.h>
#include <cli/Windows.h>

#include <string>

namespace CLI {
class App;
}  // namespace CLI

namespace cli {

/// --window, --brightness, --contrast and --gamma; the same for all commands that make pictures.
class GreyOptions {
 public:
  /// Declares the options. Their texts are kept here, so this must live as long as `command`.
  /// `usual` tells which window is taken where none is given.
  void AddTo(CLI::App& command, const std::string& usual = "the input's own window, else auto");
  /// Throws `UsageError`.
  void Check();
  /// The first of the options that stands on the command line, such as "--gamma"; else empty.
  std::string FirstGiven() const;
  /// True when the window follows from the input and not from numbers or a preset: it was not
  /// given, or is "auto".
  bool WantsAuto() const;
  /// How to show `study`; tells when a preset is not meant for its unit.
  Display Resolve(study::Study& study, Console& console) const;
  /// The same with the window that the command has found itself.
  Display With(const RealWindow& window) const;

 private:
  std::string m_window, m_brightness, m_contrast, m_gamma;
  WindowChoice m_choice;
  Display m_display;
};

}  // namespace cli

#endif
