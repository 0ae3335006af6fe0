#include <cli/Application.h>
#include <cli/Command.h>
#include <cli/Console.h>
#include <cli/HelpFormatter.h>
#include <cli/InputOptions.h>
#include <cli/Interrupt.h>

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <memory>
#include <new>

namespace cli {
namespace {

constexpr char kDescription[] =
    "vorl looks at image volumes: it tells what is in a DICOM series, cuts planes out of\n"
    "it, projects it, draws sheets for reports, lists its brightest voxels, and converts it\n"
    "into study files.\n\n"
    "An INPUT is a folder with a DICOM series, the files of one, or a study file (.bdf);\n"
    "--phantom stands for a built-in torso.";
constexpr char kFooter[] =
    "Examples:\n"
    "  vorl info scans/\n"
    "  vorl mpr scans/ --plane coronal --window bone -o coronal.png\n"
    "  vorl mpr --phantom --plane oblique -o oblique.png\n"
    "  vorl mip scans/ --turntable 36 -o film/turn.png\n"
    "  vorl project scans/ -o view.png\n"
    "  vorl render scans/ -o sheet.png\n"
    "  vorl select scans/ --limit 2% -o bones.bdf --draw bones.png\n"
    "  vorl convert scans/ study.bdf\n\n"
    "'vorl COMMAND --help' tells more. The exit code is 0 after success, 1 when something\n"
    "failed (or was ended with Ctrl-C), 2 when the command line is wrong. Output files\n"
    "appear only when they are complete.";

using Commands = std::vector<std::unique_ptr<Command>>;

Commands DeclareCommands(CLI::App& app) {
  app.formatter(std::make_shared<HelpFormatter>("vorl", "COMMAND ..."));
  app.footer(kFooter);
  app.set_help_flag("-h,--help", "Print this help and exit")->group(kGeneralGroup);
  app.set_version_flag("--version", "vorl " VORL_VERSION, "Print the version and exit")
      ->group(kGeneralGroup);
  app.allow_windows_style_options(false);  // names of inputs begin with a slash, too
  app.require_subcommand(0, 1);
  Commands commands;
  commands.push_back(MakeInfoCommand(app));
  commands.push_back(MakeMprCommand(app));
  commands.push_back(MakeMipCommand(app));
  commands.push_back(MakeProjectCommand(app));
  commands.push_back(MakeRenderCommand(app));
  commands.push_back(MakeSelectCommand(app));
  commands.push_back(MakeConvertCommand(app));
  commands.push_back(MakePhantomCommand(app));
  commands.push_back(MakeBmpCommand(app));
  return commands;
}

std::string CommandNames(const Commands& commands) {
  std::string names;
  for (const auto& command : commands) {
    names += (names.empty() ? "" : ", ") + command->GetName();
  }
  return names;
}

std::string NoCommandText(const Commands& commands) {
  return "no command is named; there are " + CommandNames(commands);
}

/// To the parser an unknown command is just one more unexpected argument.
void CheckCommandName(const std::vector<std::string>& arguments, const Commands& commands) {
  if (arguments.empty()) {
    throw UsageError(NoCommandText(commands));
  }
  const std::string& name = arguments.front();
  const bool isKnown = std::any_of(commands.begin(), commands.end(), [&name](const auto& command) {
    return command->GetName() == name;
  });
  if (!isKnown && name.substr(0, 1) != "-") {
    throw UsageError("there is no command " + study::Quoted(name) + "; there are " +
                     CommandNames(commands));
  }
}

Command* FindChosen(const Commands& commands) {
  const auto chosen = std::find_if(commands.begin(), commands.end(),
                                   [](const auto& command) { return command->IsChosen(); });
  return chosen != commands.end() ? chosen->get() : nullptr;
}

void TellError(const std::string& text) {
  static_cast<void>(std::fprintf(stderr, "vorl: %s\n", text.c_str()));
}

int TellUsageError(const std::string& text, const Command* command) {
  TellError(text);
  TellError("try 'vorl " + (command != nullptr ? command->GetName() + " " : std::string()) +
            "--help'");
  return kExitUsage;
}

/// The parser's own messages as one line in our style.
std::string TextOf(const CLI::ParseError& error) {
  std::string text = error.what();
  std::replace(text.begin(), text.end(), '\n', ' ');
  if (!text.empty()) {
    text[0] = static_cast<char>(std::tolower(static_cast<unsigned char>(text[0])));
  }
  return text;
}

/// Parses, and answers requests for help; true when there is a command to run.
bool Parse(CLI::App& app, const std::vector<std::string>& arguments, Console& console) {
  std::vector<std::string> reversed = NormaliseArguments(arguments);
  std::reverse(reversed.begin(), reversed.end());
  try {
    app.parse(reversed);
    return true;
  } catch (const CLI::CallForVersion& version) {
    console.Print(version.what() + std::string("\n"));
  } catch (const CLI::Success&) {
    const auto chosen = app.get_subcommands();
    console.Print((chosen.empty() ? app : *chosen.front()).help());
  }
  return false;
}

int Run(const std::vector<std::string>& arguments) {
  CLI::App app(kDescription, "vorl");
  const Commands commands = DeclareCommands(app);
  try {
    CheckCommandName(arguments, commands);
    Console plain(true);
    if (!Parse(app, arguments, plain)) {
      return kExitSuccess;
    }
    Command* const command = FindChosen(commands);
    if (command == nullptr) {
      throw UsageError(NoCommandText(commands));
    }
    command->Check();
    Console console(command->IsQuiet());
    command->Run(console);
    return kExitSuccess;
  } catch (const CLI::ParseError& error) {
    return TellUsageError(TextOf(error), FindChosen(commands));
  } catch (const UsageError& error) {
    return TellUsageError(error.what(), FindChosen(commands));
  }
}

}  // namespace

int RunApplication(const std::vector<std::string>& arguments) {
  CatchInterrupts();
  try {
    return Run(arguments);
  } catch (const study::Error& error) {
    TellError(error.what());
  } catch (const std::bad_alloc&) {
    TellError("there is not enough memory");
  } catch (const std::exception& error) {
    TellError(error.what());
  }
  return kExitFailure;
}

}  // namespace cli
