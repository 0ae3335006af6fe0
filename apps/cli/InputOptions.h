#ifndef VORL_APPS_CLI_INPUTOPTIONS_H
#define VORL_APPS_CLI_INPUTOPTIONS_H

/// @file
/// Naming the volume that a command works on.

#include <cli/Console.h>
#include <study/LoadReport.h>
#include <study/Study.h>

#include <memory>
#include <string>
#include <vector>

namespace CLI {
class App;
}  // namespace CLI

namespace cli {

/// The size of the phantom in voxels, unless another one is asked for.
inline constexpr char kPhantomSize[] = "256x256x160";

/// A volume and where it came from.
struct Input {
  std::unique_ptr<study::Study> study;
  study::LoadReport report;
  std::string name;  ///< the paths as given, or "phantom"
};

/// The options that name the input; the same for all commands that have one.
class InputOptions {
 public:
  /// Declares the options. Their texts are kept here, so this must live as long as `command`.
  void AddTo(CLI::App& command);
  /// For commands whose last path is an output: takes it away from the inputs. Throws `UsageError`
  /// when there is none.
  std::string TakeLastPath(const std::string& what);
  /// Throws `UsageError` unless there is exactly one input, named in an allowed way.
  void Check() const;
  /// Loads the input and tells the notable things. Throws `study::Error`.
  Input Load(Console& console, const study::Progress& progress) const;

 private:
  bool WantsPhantom() const { return !m_phantom.empty(); }

  std::vector<std::string> m_paths;
  std::string m_series;
  std::string m_phantom;
};

/// Prepares arguments for the parser: "--phantom 64x64x40" counts as "--phantom=64x64x40", and a
/// path in brackets is not the list that the parser would take it for.
std::vector<std::string> NormaliseArguments(const std::vector<std::string>& arguments);

}  // namespace cli

#endif
