#include <cli/Interrupt.h>

#include <csignal>

#ifndef _WIN32
#include <signal.h>
#endif

namespace cli {
namespace {

volatile std::sig_atomic_t g_interrupted = 0;

extern "C" void OnInterrupt(int) {
  g_interrupted = 1;
}

#ifndef _WIN32
void Catch(int signal) {
  struct sigaction action {};
  if (sigaction(signal, nullptr, &action) != 0 || action.sa_handler == SIG_IGN) {
    return;
  }
  action = {};
  action.sa_handler = OnInterrupt;
  action.sa_flags = SA_RESTART;
  sigemptyset(&action.sa_mask);
  sigaction(signal, &action, nullptr);
}
#endif

}  // namespace

void CatchInterrupts() {
#ifdef _WIN32
  static_cast<void>(std::signal(SIGINT, OnInterrupt));
  static_cast<void>(std::signal(SIGTERM, OnInterrupt));
  static_cast<void>(std::signal(SIGBREAK, OnInterrupt));
#else
  Catch(SIGINT);
  Catch(SIGTERM);
  Catch(SIGHUP);
  static_cast<void>(std::signal(SIGPIPE, SIG_IGN));
  static_cast<void>(std::signal(SIGXFSZ, SIG_IGN));
#endif
}

bool IsInterrupted() {
  return g_interrupted != 0;
}

}  // namespace cli
