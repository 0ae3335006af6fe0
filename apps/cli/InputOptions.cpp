#include <cli/Command.h>
#include <cli/InputOptions.h>
#include <cli/Values.h>
#include <study/LoadStudy.h>
#include <study/Phantom.h>

#include <CLI/CLI.hpp>
#include <filesystem>

namespace cli {
namespace {

constexpr char kInputGroup[] = "Input";
constexpr std::size_t kMostRefusals = 5;

std::string Joined(const std::vector<std::string>& paths) {
  if (paths.size() > 1) {
    return paths.front() + " and " + std::to_string(paths.size() - 1) + " more";
  }
  return paths.front();
}

void TellOtherSeries(Console& console, const study::LoadReport& report) {
  if (report.series.size() < 2) {
    return;
  }
  const std::string how = report.chosen == 0 ? "the largest is taken" : "the chosen one is taken";
  console.Note("there are " + std::to_string(report.series.size()) + " series, " + how +
               "; choose with --series:");
  for (std::size_t i = 0; i < report.series.size(); ++i) {
    console.Note("  #" + std::to_string(i + 1) + (i == report.chosen ? " (taken) " : " ") +
                 study::SeriesText(report.series[i]));
  }
}

void TellRefused(Console& console, const study::LoadReport& report) {
  const std::size_t told = std::min(report.refused.size(), kMostRefusals);
  for (std::size_t i = 0; i < told; ++i) {
    console.Note("left out " + study::RefusalText(report.refused[i]));
  }
  if (report.refused.size() > told) {
    console.Note("left out " + std::to_string(report.refused.size() - told) + " more");
  }
}

void Tell(Console& console, const study::LoadReport& report) {
  TellOtherSeries(console, report);
  TellRefused(console, report);
  for (const std::string& note : report.notes) {
    console.Note(note);
  }
}

}  // namespace

void InputOptions::AddTo(CLI::App& command) {
  command.add_option("INPUT", m_paths)->type_name("PATH");
  command
      .add_option("--series", m_series,
                  "Which series of a folder: its number, its UID, or its\n"
                  "place in the list as '#2' (default: the one with the\n"
                  "most slices; the others are listed)")
      ->option_text("SERIES")
      ->type_name("SERIES")
      ->group(kInputGroup);
  command
      .add_flag(std::string("--phantom{") + kPhantomSize + "}", m_phantom,
                "The built-in phantom instead of files; its size in\nvoxels may follow: "
                "--phantom=128x128x80\n(default: " +
                    std::string(kPhantomSize) + ")")
      ->option_text("[=WxHxN]")
      ->group(kInputGroup);
}

std::string InputOptions::TakeLastPath(const std::string& what) {
  if (m_paths.empty() || (m_paths.size() == 1 && !WantsPhantom())) {
    throw UsageError(m_paths.empty()
                         ? "no input and no " + what + " are named"
                         : "after " + study::Quoted(m_paths[0]) + ", the " + what + " is missing");
  }
  std::string last = m_paths.back();
  m_paths.pop_back();
  return last;
}

void InputOptions::Check() const {
  if (WantsPhantom()) {
    ParseSize("--phantom", m_phantom, 3, "WIDTHxHEIGHTxSLICES");
    if (!m_paths.empty()) {
      throw UsageError(study::Quoted(m_paths.front()) + " and --phantom exclude each other");
    }
    if (!m_series.empty()) {
      throw UsageError("--series and --phantom exclude each other");
    }
  } else if (m_paths.empty()) {
    throw UsageError("no input is named (files, a folder, or --phantom)");
  }
}

Input InputOptions::Load(Console& console, const study::Progress& progress) const {
  Input input;
  if (WantsPhantom()) {
    const std::vector<int> size = ParseSize("--phantom", m_phantom, 3, "WIDTHxHEIGHTxSLICES");
    input.name = "phantom";
    input.study = study::MakePhantom(size[0], size[1], size[2], progress);
    return input;
  }
  input.name = Joined(m_paths);
  const std::vector<std::filesystem::path> paths(m_paths.begin(), m_paths.end());
  input.study = study::LoadStudy(paths, m_series, input.report, progress);
  Tell(console, input.report);
  return input;
}

std::vector<std::string> NormaliseArguments(const std::vector<std::string>& arguments) {
  std::vector<std::string> normal;
  for (const std::string& argument : arguments) {
    const bool inBrackets =
        argument.size() > 1 && argument.front() == '[' && argument.back() == ']';
    if (!normal.empty() && normal.back() == "--phantom" && LooksLikeSize(argument, 3)) {
      normal.back() += "=" + argument;
    } else {
      normal.push_back(inBrackets ? "./" + argument : argument);
    }
  }
  return normal;
}

}  // namespace cli
