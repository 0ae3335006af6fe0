#include <cli/Console.h>
#include <cli/Interrupt.h>

#include <cerrno>
#include <cstdio>
#include <system_error>

namespace cli {

study::Progress Console::GetProgress() {
  return [this](double fraction, const std::string& what) {
    m_bar.Show(fraction, what);
    return !IsInterrupted();
  };
}

void Console::Note(const std::string& text) {
  if (m_quiet) {
    return;
  }
  m_bar.Clear();
  static_cast<void>(std::fprintf(stderr, "vorl: note: %s\n", text.c_str()));
}

void Console::Print(const std::string& text) {
  m_bar.Clear();
  errno = 0;
  const bool written = std::fwrite(text.data(), 1, text.size(), stdout) == text.size();
  if (std::fflush(stdout) != 0 || !written) {
    throw study::Error(
        std::string("can't write to the standard output: ") +
        (errno != 0 ? std::generic_category().message(errno) : "the writing failed"));
  }
}

}  // namespace cli
