#ifndef VORL_APPS_CLI_COMMAND_H
#define VORL_APPS_CLI_COMMAND_H

/// @file
/// What all commands of the tool have in common.

#include <cli/Console.h>

#include <initializer_list>
#include <memory>
#include <stdexcept>
#include <string>
#include <utility>

namespace CLI {
class App;
class Option;
}  // namespace CLI

namespace cli {

/// The command line is wrong: the tool says so and ends with code 2. The text is one line without a
/// final full stop.
class UsageError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// How a command presents itself in the help.
struct CommandText {
  std::string name;
  std::string summary;   ///< one line
  std::string usage;     ///< what follows the command's name; several lines are several forms
  std::string examples;  ///< whole lines
};

/// Adds an option that takes one text, which is kept in `target`, to a command.
CLI::Option* AddText(CLI::App& command, const std::string& names, std::string& target,
                     const std::string& type, const std::string& description,
                     const std::string& group);

/// The first name whose text is not empty; empty when all are.
std::string FirstGiven(std::initializer_list<std::pair<const char*, const std::string*>> options);

/// One command of the tool. Constructing it declares its options; after the command line has been
/// parsed, `Check` turns their texts into values, and `Run` does the work.
class Command {
 public:
  Command(CLI::App& application, const CommandText& text);
  virtual ~Command() = default;
  Command(const Command&) = delete;
  Command& operator=(const Command&) = delete;

  /// True when the command line names this command.
  bool IsChosen() const;
  std::string GetName() const;
  bool IsQuiet() const { return m_quiet; }
  /// Looks at everything that can be judged without opening a file. Throws `UsageError`.
  virtual void Check() = 0;
  /// Throws `study::Error`.
  virtual void Run(Console& console) = 0;

 protected:
  /// Adds an option that takes one text.
  CLI::Option* AddText(const std::string& names, std::string& target, const std::string& type,
                       const std::string& description, const std::string& group) {
    return cli::AddText(*m_app, names, target, type, description, group);
  }
  CLI::App& GetApp() { return *m_app; }

 private:
  CLI::App* m_app;
  bool m_quiet = false;
};

std::unique_ptr<Command> MakeInfoCommand(CLI::App& application);
std::unique_ptr<Command> MakeMprCommand(CLI::App& application);
std::unique_ptr<Command> MakeMipCommand(CLI::App& application);
std::unique_ptr<Command> MakeProjectCommand(CLI::App& application);
std::unique_ptr<Command> MakeRenderCommand(CLI::App& application);
std::unique_ptr<Command> MakeSelectCommand(CLI::App& application);
std::unique_ptr<Command> MakeConvertCommand(CLI::App& application);
std::unique_ptr<Command> MakePhantomCommand(CLI::App& application);
std::unique_ptr<Command> MakeBmpCommand(CLI::App& application);

}  // namespace cli

#endif
