#include <cli/HelpFormatter.h>

#include <algorithm>
#include <sstream>
#include <utility>
#include <vector>

namespace cli {

HelpFormatter::HelpFormatter(std::string program, std::string usage)
    : m_program(std::move(program)), m_usage(std::move(usage)) {
  column_width(31);
}

std::string HelpFormatter::make_help(const CLI::App* app, std::string,
                                     CLI::AppFormatMode mode) const {
  return app->get_description() + "\n\n" + UsageLines() + OptionGroups(*app) +
         make_subcommands(app, mode) + "\n" + make_footer(app);
}

std::string HelpFormatter::UsageLines() const {
  std::istringstream forms(m_usage);
  std::string text;
  for (std::string form; std::getline(forms, form);) {
    text += (text.empty() ? "Usage: " : "       ") + m_program + " " + form + "\n";
  }
  return text;
}

std::string HelpFormatter::OptionGroups(const CLI::App& app) const {
  std::vector<std::string> groups = app.get_groups();
  std::stable_partition(groups.begin(), groups.end(),
                        [](const std::string& group) { return group != kGeneralGroup; });
  std::string text;
  for (const std::string& group : groups) {
    const std::vector<const CLI::Option*> options =
        app.get_options([&group](const CLI::Option* option) {
          return option->get_group() == group && option->nonpositional();
        });
    if (!options.empty()) {
      text += make_group(group, false, options);
    }
  }
  return text;
}

// The name of a flag with a value ends in its default, in braces.
std::string HelpFormatter::make_option_name(const CLI::Option* option, bool isPositional) const {
  const std::string name = CLI::Formatter::make_option_name(option, isPositional);
  return name.substr(0, name.find('{'));
}

std::string HelpFormatter::make_option_opts(const CLI::Option* option) const {
  const std::string text = option->get_option_text();
  return text.empty() || text.front() == '[' ? text : " " + text;
}

}  // namespace cli
