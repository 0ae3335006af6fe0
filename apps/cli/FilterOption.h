#ifndef VORL_APPS_CLI_FILTEROPTION_H
#define VORL_APPS_CLI_FILTEROPTION_H

/// @file
/// The option that says how a volume is sampled between its voxels.

#include <string>

namespace CLI {
class App;
}  // namespace CLI

namespace cli {

/// --filter.
class FilterOption {
 public:
  /// Declares the option. Its text is kept here, so this must live as long as `command`.
  void AddTo(CLI::App& command, const std::string& group);
  /// True for linear, false for nearest. Throws `UsageError`.
  bool CheckLinear() const;

 private:
  std::string m_filter = "nearest";
};

}  // namespace cli

#endif
