#ifndef VORL_APPS_CLI_HELPFORMATTER_H
#define VORL_APPS_CLI_HELPFORMATTER_H

/// @file
/// How the help pages look.

#include <CLI/CLI.hpp>

#include <string>

namespace cli {

/// The group of the options that every command has; the last one on the page.
inline constexpr char kGeneralGroup[] = "General";

/// A help page whose usage lines are written by hand, because what follows what (inputs, then an
/// output; or the phantom instead of inputs) can't be told from the list of options.
class HelpFormatter : public CLI::Formatter {
 public:
  /// Each line of `usage` follows `program` on a line of its own.
  HelpFormatter(std::string program, std::string usage);

  /// Description, usage, options by groups, commands, examples.
  std::string make_help(const CLI::App* app, std::string name,
                        CLI::AppFormatMode mode) const override;
  std::string make_option_name(const CLI::Option* option, bool isPositional) const override;
  std::string make_option_opts(const CLI::Option* option) const override;

 private:
  std::string UsageLines() const;
  std::string OptionGroups(const CLI::App& app) const;

  std::string m_program;
  std::string m_usage;
};

}  // namespace cli

#endif
