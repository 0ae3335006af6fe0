#include <cli/Command.h>
#include <cli/GreyOptions.h>
#include <cli/Values.h>

namespace cli {
namespace {

constexpr char kGreyGroup[] = "Grey levels";

}  // namespace

void GreyOptions::AddTo(CLI::App& command, const std::string& usual) {
  AddText(command, "--window", m_window, "WINDOW",
          "CENTER,WIDTH in real values such as -600,1500; auto\n(from the data); or one of\n" +
              PresetList() + "\n(default: " + usual + ")",
          kGreyGroup);
  AddText(command, "--brightness", m_brightness, "B", "From -1 to 1 (default: 0)", kGreyGroup);
  AddText(command, "--contrast", m_contrast, "C", "From -1 to 1 (default: 0)", kGreyGroup);
  AddText(command, "--gamma", m_gamma, "G", "From 0.01 to 10 (default: 1)", kGreyGroup);
}

void GreyOptions::Check() {
  m_choice = ParseWindow("--window", m_window);
  if (!m_brightness.empty()) {
    m_display.brightness = ParseNumberIn("--brightness", m_brightness, -1, 1);
  }
  if (!m_contrast.empty()) {
    m_display.contrast = ParseNumberIn("--contrast", m_contrast, -1, 1);
  }
  if (!m_gamma.empty()) {
    m_display.gamma = ParseNumberIn("--gamma", m_gamma, 0.01, 10);
  }
}

std::string GreyOptions::FirstGiven() const {
  return cli::FirstGiven({{"--window", &m_window},
                          {"--brightness", &m_brightness},
                          {"--contrast", &m_contrast},
                          {"--gamma", &m_gamma}});
}

bool GreyOptions::WantsAuto() const {
  return m_choice.kind == WindowChoice::Kind::Input || m_choice.kind == WindowChoice::Kind::Auto;
}

Display GreyOptions::Resolve(study::Study& study, Console& console) const {
  if (m_choice.kind == WindowChoice::Kind::Preset && study.unit != "HU") {
    console.Note("the window " + study::Quoted(m_window) +
                 " is meant for Hounsfield units, the values are in " +
                 (study.unit.empty() ? "no unit" : study.unit));
  }
  return With(ResolveWindow(m_choice, study));
}

Display GreyOptions::With(const RealWindow& window) const {
  Display display = m_display;
  display.window = window;
  return display;
}

}  // namespace cli
