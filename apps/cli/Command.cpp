#include <cli/Command.h>
#include <cli/HelpFormatter.h>

namespace cli {

Command::Command(CLI::App& application, const CommandText& text)
    : m_app(application.add_subcommand(text.name, text.summary)) {
  m_app->group("Commands");
  m_app->formatter(std::make_shared<HelpFormatter>("vorl " + text.name, text.usage));
  m_app->footer("Examples:\n" + text.examples);
  m_app->set_help_flag("-h,--help", "Print this help and exit")->group(kGeneralGroup);
  m_app->add_flag("-q,--quiet", m_quiet, "No progress bar and no notes; errors are still told")
      ->group(kGeneralGroup);
}

bool Command::IsChosen() const {
  return m_app->parsed();
}

std::string Command::GetName() const {
  return m_app->get_name();
}

CLI::Option* AddText(CLI::App& command, const std::string& names, std::string& target,
                     const std::string& type, const std::string& description,
                     const std::string& group) {
  return command.add_option(names, target, description)
      ->option_text(type)
      ->type_name(type)
      ->group(group);
}

std::string FirstGiven(std::initializer_list<std::pair<const char*, const std::string*>> options) {
  for (const auto& [name, text] : options) {
    if (!text->empty()) {
      return name;
    }
  }
  return {};
}

}  // namespace cli
