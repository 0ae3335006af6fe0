#include <cli/ProgressBar.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#ifdef _WIN32
#include <io.h>
#else
#include <sys/ioctl.h>
#include <unistd.h>
#endif

namespace cli {
namespace {

constexpr std::chrono::milliseconds kPause(50);
constexpr int kBarWidth = 30;
constexpr int kUsualColumns = 80;

/// A terminal that can go back to the beginning of its line.
bool IsTerminal() {
#ifdef _WIN32
  return _isatty(_fileno(stderr)) != 0;
#else
  const char* kind = std::getenv("TERM");
  return isatty(STDERR_FILENO) != 0 && (kind == nullptr || std::strcmp(kind, "dumb") != 0);
#endif
}

int TerminalColumns() {
#ifndef _WIN32
  winsize size{};
  if (ioctl(STDERR_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col > 0) {
    return size.ws_col;
  }
#endif
  return kUsualColumns;
}

void Write(const std::string& text) {
  std::fwrite(text.data(), 1, text.size(), stderr);
  std::fflush(stderr);
}

}  // namespace

std::string ProgressText(double fraction, const std::string& what, int columns) {
  const double done = std::clamp(fraction, 0.0, 1.0);
  const auto filled = static_cast<std::size_t>(std::lround(done * kBarWidth));
  const std::string percent = std::to_string(std::lround(done * 100));
  std::string text("[");
  text.append(filled, '#');
  text.append(std::size_t{kBarWidth} - filled, '-');
  text.append("] ");
  text.append(3 - std::min<std::size_t>(percent.size(), 3), ' ');
  text.append(percent).append("% ").append(what);
  // The last column stays free: some terminals begin a new line behind it.
  return text.substr(0, static_cast<std::size_t>(std::max(columns - 1, 0)));
}

ProgressBar::ProgressBar(bool wanted) : m_enabled(wanted && IsTerminal()) {}

void ProgressBar::Show(double fraction, const std::string& what) {
  const Clock::time_point now = Clock::now();
  const bool isRecent = !m_shown.empty() && what == m_what && now - m_shownAt < kPause;
  if (!m_enabled || isRecent) {
    return;
  }
  const std::string text = ProgressText(fraction, what, TerminalColumns());
  if (text == m_shown) {
    return;
  }
  const std::size_t leftOver = m_shown.size() > text.size() ? m_shown.size() - text.size() : 0;
  Write(std::string(1, '\r').append(text).append(leftOver, ' '));
  m_what = what;
  m_shown = text;
  m_shownAt = now;
}

void ProgressBar::Clear() {
  if (m_shown.empty()) {
    return;
  }
  Write(std::string(1, '\r').append(m_shown.size(), ' ').append(1, '\r'));
  m_shown.clear();
}

}  // namespace cli
